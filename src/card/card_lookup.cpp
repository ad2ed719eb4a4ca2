// Finding one account and showing it: the navigation buttons, the label
// searches and ShowAccount all come down to readAct7.

#include "card/card.h"

#include "card/account_query.h"
#include "card/card_screen.h"
#include "common/failure.h"
#include "common/formats.h"
#include "common/module_state.h"
#include "common/text_helpers.h"
#include "connection/company_details.h"
#include "connection/conn_string.h"
#include "connection/database.h"
#include "host/seams.h"

#include <QLineEdit>
#include <limits>

namespace ardcard {

namespace {

const QString kHidden = QStringLiteral("חשבון חסוי");

QString text(const QVariant& value) {
    return value.isNull() ? QString() : PlainText(value);
}

// Money as "##,##0.00"; Null shows an empty box.
QString money(const QVariant& value) {
    if (value.isNull())
        return {};
    bool ok = false;
    const double number = value.toDouble(&ok);
    return ok ? FormatMoney(number) : value.toString();
}

int toId(const QVariant& value) {
    bool ok = false;
    const qint64 id = value.toLongLong(&ok);
    if (!ok || id < std::numeric_limits<int>::min() || id > std::numeric_limits<int>::max())
        throw Failure(QStringLiteral("מזהה החשבון %1 אינו תקין").arg(value.toString()));
    return static_cast<int>(id);
}

} // namespace

QVariant Card::ReadACT7(const QString& CompPath, const QString& pSearchBy,
                        const QVariant& pSearchValue, const QString& pStartFrom) {
    QVariant value = pSearchValue;
    const bool found = readAct7(CompPath, pSearchBy, value, pStartFrom);
    if (&pSearchValue == &PubSearchValue)
        PubSearchValue = value;
    return found;
}

bool Card::readAct7(const QString& compPath, const QString& searchBy, QVariant& searchValue,
                    const QString& startFrom) {
    ModuleState& state = moduleState();
    try {
        const ConnValues& c = state.conn;
        // Several company directories name several databases; the accounts
        // shown are those of the first.
        Connection connection;
        connection.setTimeout(60);
        connection.open(BuildConnString(c.ConnServer, c.ConnUID, c.ConnPWD,
                                        FirstCompanyDir(compPath), c.ConnType));
        Recordset rs(connection);

        if (!searchValue.isNull())
            searchValue = TrimBlanks(searchValue.toString());

        rs.Open(ChoosingQuery(startFrom, PubACTLocation, searchBy, text(searchValue)));
        bool found = false;
        if (rs.Eof() || rs.isNull(QStringLiteral("StartID"))) {
            PubACTLocation = 0;
        } else {
            PubACTLocation = toId(rs.field(QStringLiteral("StartID")));
            found = true;
        }
        rs.Close();

        if (found) {
            rs.Open(AccountRowQuery(PubACTLocation), CursorKind::Dynamic);
            if (rs.Eof())
                found = false;
            else
                showAccountRow(rs);
            rs.Close();
        }
        if (!found)
            clearAccountBoxes();
        return true;
    } catch (const Failure& failure) {
        host::messageBox().show(QStringLiteral("תקלה בקריאת החשבונות"), failure.description(),
                                host::MessageIcon::Critical);
        return false;
    }
}

void Card::showAccountRow(const Recordset& row) {
    CardScreen& ui = *ui_;
    ModuleState& state = moduleState();
    const QVariant key = row.field(QStringLiteral("AccountKey"));
    if (key.isNull())
        throw Failure(QStringLiteral("לחשבון אין מפתח"));
    const QString name = text(row.field(QStringLiteral("FullName")));
    const QString phone = text(row.field(QStringLiteral("Phone")));
    state.CurrentAccountFilter = text(row.field(QStringLiteral("Filter")));

    const QString& hidden = state.company.HiddenAccountsFilter;
    if (!hidden.isEmpty() && hidden.compare(state.CurrentAccountFilter, Qt::CaseInsensitive) == 0) {
        ui.txtAccountKey->setText(kHidden);
        ui.txtAccountName->setText(kHidden);
        for (QLineEdit* box :
             {ui.txtBalance, ui.txtAddress, ui.txtCity, ui.txtTelephone, ui.txtOblig,
              ui.txtShipBalance, ui.txtDetails, ui.txtZip, ui.txtDistrict, ui.txtAgent})
            box->clear();
        return;
    }

    ui.txtAccountKey->setText(PlainText(key));
    ui.txtAccountName->setText(name);
    ui.txtBalance->setText(money(row.field(QStringLiteral("Balance"))));
    ui.txtAddress->setText(text(row.field(QStringLiteral("Address"))));
    ui.txtCity->setText(text(row.field(QStringLiteral("City"))));
    ui.txtTelephone->setText(phone);
    ui.txtOblig->setText(money(row.field(QStringLiteral("Obligo"))));
    ui.txtShipBalance->setText(money(row.field(QStringLiteral("Delivery"))));
    ui.txtDetails->setText(text(row.field(QStringLiteral("Details"))));
    ui.txtZip->setText(text(row.field(QStringLiteral("Zip"))));
    ui.txtDistrict->setText(text(row.field(QStringLiteral("Country"))));
    ui.txtAgent->setText(text(row.field(QStringLiteral("Agent"))));
}

void Card::clearAccountBoxes() {
    CardScreen& ui = *ui_;
    for (QLineEdit* box : {ui.txtAccountKey, ui.txtAccountName, ui.txtBalance, ui.txtAddress,
                           ui.txtCity, ui.txtTelephone, ui.txtOblig, ui.txtShipBalance,
                           ui.txtDetails, ui.txtZip, ui.txtDistrict, ui.txtAgent})
        box->clear();
}

void Card::navigate(const QString& startFrom) {
    InitDocLines();
    PubSearchBy.clear();
    PubSearchValue = QString();
    readAct7(moduleState().CompanyDirText, PubSearchBy, PubSearchValue, startFrom);
}

void Card::FirstButt_Click() {
    navigate(QStringLiteral("First"));
}

void Card::LastButt_Click() {
    navigate(QStringLiteral("Last"));
}

void Card::PrevButt_Click() {
    navigate(QStringLiteral("Previous"));
}

void Card::NextButt_Click() {
    // Next keeps the current search: it steps through the matches.
    InitDocLines();
    readAct7(moduleState().CompanyDirText, PubSearchBy, PubSearchValue, QStringLiteral("Next"));
}

void Card::searchBy(const QString& kind, const QVariant& value) {
    InitDocLines();
    PubSearchBy = kind;
    PubSearchValue = value;
    readAct7(moduleState().CompanyDirText, PubSearchBy, PubSearchValue, QStringLiteral("First"));
}

void Card::Label1_DblClick() {
    searchBy(QStringLiteral("AccountKey"), StripQuotes(ui_->txtAccountKey->text()));
}

void Card::Label2_DblClick() {
    searchBy(QStringLiteral("AccountName"), ui_->txtAccountName->text());
}

void Card::Label8_DblClick() {
    searchBy(QStringLiteral("Telephone"), ui_->txtTelephone->text());
}

void Card::Label7_DblClick() {
    searchBy(QStringLiteral("Address"), ui_->txtAddress->text());
}

void Card::LblDetails_DblClick() {
    searchBy(QStringLiteral("Details"), ui_->txtDetails->text());
}

int Card::ShowAccount(const QString& pServer, const QString& pUID, const QString& pPWD,
                      int pConnType, const QString& pDatabase, const QString& pAccountKey) {
    ModuleState& state = moduleState();
    state.conn.ConnServer = pServer;
    state.conn.ConnUID = pUID;
    state.conn.ConnPWD = pPWD;
    state.conn.ConnType = pConnType;
    state.conn.ConnDataBase = pDatabase;
    state.CompanyDirText = pDatabase;
    ui_->txtCompPath->setText(pDatabase);
    ui_->txtAccountKey->setText(StripQuotes(pAccountKey));
    Label1_DblClick();
    ShowTransButt_Click();
    return 0;
}

} // namespace ardcard
