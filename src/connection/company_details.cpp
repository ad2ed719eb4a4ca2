#include "connection/company_details.h"

#include "common/failure.h"
#include "common/module_state.h"
#include "common/text_helpers.h"
#include "connection/conn_string.h"
#include "connection/database.h"

namespace ardcard {

QString FirstCompanyDir(const QString& companyDirText) {
    QStringList entries;
    if (SplitCompanyDirs(companyDirText, entries) == 0)
        return {};
    return entries.at(1);
}

bool ReadCompanyDetails(const QString& compPath) {
    ModuleState& state = moduleState();
    const ConnValues& c = state.conn;
    CompanyDetails& company = state.company;
    try {
        Connection connection;
        connection.setTimeout(60);
        connection.open(BuildConnString(c.ConnServer, c.ConnUID, c.ConnPWD,
                                        FirstCompanyDir(compPath), c.ConnType));
        Recordset rs(connection);
        rs.Open(QStringLiteral("SELECT CompanyName, ShortName, VatNum, DeductNum, "
                               "HiddenAccountsFilter FROM CompanyDefenitions WHERE ID = 1"));
        if (rs.Eof())
            return false;
        const struct {
            const char16_t* column;
            QString* target;
        } columns[] = {
            {u"CompanyName", &company.CompanyName},
            {u"ShortName", &company.ShortName},
            {u"VatNum", &company.VatNum},
            {u"DeductNum", &company.DeductNum},
            {u"HiddenAccountsFilter", &company.HiddenAccountsFilter},
        };
        for (const auto& [column, target] : columns) {
            const QVariant value = rs.field(QString::fromUtf16(column));
            const QString text = value.isNull() ? QString() : PlainText(value);
            if (!text.isEmpty())
                *target = text;
        }
        rs.Close();
        return true;
    } catch (const Failure&) {
        // Company details are a nicety: whatever fails, the card goes on.
        return false;
    }
}

} // namespace ardcard
