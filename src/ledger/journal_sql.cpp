#include "ledger/journal_sql.h"

namespace ardcard {

namespace {

QString tableList(bool incNegdiName) {
    QString sql = QStringLiteral(" FROM JurnalTrans, JurnalTransMoves, Currencies");
    if (incNegdiName)
        sql += QStringLiteral(", Accounts CAcc, Accounts DAcc");
    return sql;
}

// Posted (Status 1), not fixed, ordinary journal transactions of the account.
// With counter names both counter accounts are joined, so a transaction whose
// debit or credit account is missing from Accounts is not read at all.
QString condition(const QString& accountKey, bool onlyOpen, bool incNegdiName) {
    QString sql = QStringLiteral(" WHERE JurnalTrans.Status = 1");
    sql += QStringLiteral(" And JurnalTrans.FixedID = 0");
    sql += QStringLiteral(" And JurnalTrans.TransID = JurnalTransMoves.TransID");
    sql += QStringLiteral(" And JurnalTransMoves.AccountKey = '") + accountKey + u'\'';
    sql += QStringLiteral(" And Currencies.CurrencyCode = JurnalTrans.CurrencyCode");
    sql += QStringLiteral(" And JurnalTrans.Type = 0");
    if (incNegdiName) {
        sql += QStringLiteral(" And CAcc.AccountKey = JurnalTrans.TransCredID");
        sql += QStringLiteral(" And DAcc.AccountKey = JurnalTrans.TransDebID");
    }
    if (onlyOpen)
        sql += QStringLiteral(" And (JurnalTransMoves.FullMatch = 0)");
    return sql;
}

} // namespace

QString JournalCountSql(const QString& accountKey, bool onlyOpen, bool incNegdiName) {
    return QStringLiteral("SELECT Count(JurnalTrans.TransID) As RecCount") +
           tableList(incNegdiName) + condition(accountKey, onlyOpen, incNegdiName);
}

QString JournalMainSql(const QString& accountKey, bool onlyOpen, bool incNegdiName) {
    QString sql = QStringLiteral("SELECT JurnalTrans.TransID, JurnalTrans.Type");
    sql += QStringLiteral(", JurnalTrans.ValueDate, JurnalTrans.DueDate");
    sql += QStringLiteral(", JurnalTrans.BatchNo, JurnalTrans.Referance");
    sql += QStringLiteral(", JurnalTrans.Ref2, JurnalTrans.Description");
    sql += QStringLiteral(", JurnalTrans.CostCode, JurnalTrans.TransType");
    sql += QStringLiteral(", JurnalTrans.CurrencyCode, JurnalTrans.TransDebID");
    sql += QStringLiteral(", JurnalTrans.TransCredID");
    sql += QStringLiteral(", JurnalTransMoves.AccountKey, JurnalTransMoves.SuF");
    sql += QStringLiteral(", JurnalTransMoves.SuFDlr, JurnalTransMoves.DebitCredit");
    sql += QStringLiteral(", JurnalTransMoves.FullMatch");
    sql += QStringLiteral(", Currencies.ID As CurrencyID");
    if (incNegdiName) {
        sql += QStringLiteral(", CAcc.FullName As CName");
        sql += QStringLiteral(", DAcc.FullName As DName");
    }
    return sql + tableList(incNegdiName) + condition(accountKey, onlyOpen, incNegdiName);
}

} // namespace ardcard
