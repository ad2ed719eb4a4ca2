#include "demo/demo_builder.h"
#include "demo/demo_parts.h"

#include "common/failure.h"

namespace ardcard::demo {

namespace {

using detail::IsoDate;
using detail::Money;

struct Counter {
    QString key;
    QString name;
};

} // namespace

void BuildLedgerCompany(const QString& path, const QString& accountKey, int lineCount) {
    if (lineCount < 0)
        throw Failure(QStringLiteral("מספר שורות שלילי: %1").arg(lineCount));
    const Counter counters[] = {{QStringLiteral("LDG-BANK"), QStringLiteral("בנק לבדיקות")},
                                {QStringLiteral("LDG-SALES"), QStringLiteral("הכנסות לבדיקות")},
                                {QStringLiteral("LDG-BUY"), QStringLiteral("קניות לבדיקות")},
                                {QStringLiteral("LDG-FX"), QStringLiteral("הפרשי שער")}};
    for (const Counter& c : counters) {
        if (c.key.compare(accountKey, Qt::CaseInsensitive) == 0)
            throw Failure(QStringLiteral("המפתח %1 שמור לחשבונות הנגדיים").arg(accountKey));
    }

    CreateCompanyFile(path);
    CompanyWriter writer(path);
    writer.insert(QStringLiteral("CompanyDefenitions"),
                  {{QStringLiteral("ID"), 1},
                   {QStringLiteral("CompanyName"), QStringLiteral("חברת בדיקות ספר חשבונות")},
                   {QStringLiteral("ShortName"), QStringLiteral("ספר חשבונות")},
                   {QStringLiteral("HiddenAccountsFilter"), QString()}});
    for (const detail::Currency& c : detail::kCurrencies)
        writer.insert(
            QStringLiteral("Currencies"),
            {{QStringLiteral("ID"), c.id}, {QStringLiteral("CurrencyCode"), c.code.toString()}});

    // Amounts and dates follow from the line number alone; lines are spread
    // evenly over 2019 to 2025, so that every graph period has some.
    const QDate first(2019, 1, 1);
    const qint64 days = first.daysTo(QDate(2025, 12, 31)) + 1;
    const QString trans =
        QStringLiteral("INSERT INTO JurnalTrans (TransID, Type, Status, FixedID, ValueDate, "
                       "DueDate, BatchNo, Referance, Ref2, Description, CostCode, TransType, "
                       "CurrencyCode, TransDebID, TransCredID) "
                       "VALUES (?, 0, 1, 0, ?, ?, ?, ?, NULL, ?, NULL, 'חש', ?, ?, ?)");
    const QString move = QStringLiteral("INSERT INTO JurnalTransMoves (ID, TransID, AccountKey, "
                                        "SuF, SuFDlr, DebitCredit, FullMatch) "
                                        "VALUES (?, ?, ?, ?, ?, ?, ?)");
    qint64 balance = 0;
    for (int i = 0; i < lineCount; ++i) {
        const int id = i + 1;
        const QDate date = first.addDays(static_cast<qint64>(i) * days / std::max(lineCount, 1));
        const Counter& counter = counters[i % 4];
        const int currency = i % 7 == 6 ? 1 : 0; // one line in seven in dollars
        const qint64 cents = 1000 + (static_cast<qint64>(i) * 7919) % 500000;
        const qint64 agorot = currency == 0 ? cents : cents * detail::kCurrencies[1].rateE4 / 10000;
        // Even lines credit the account, odd lines debit it; a line of the
        // credit account carries DebitCredit 0.
        const bool accountCredited = i % 2 == 0;
        const QString debitKey = accountCredited ? counter.key : accountKey;
        const QString creditKey = accountCredited ? accountKey : counter.key;
        writer.execPrepared(trans,
                            {id, IsoDate(date), IsoDate(date.addDays(30)),
                             1000 + date.year() * 100 + date.month(), 100000 + id,
                             QStringLiteral("שורת בדיקה %1").arg(id),
                             detail::kCurrencies[currency].code.toString(), debitKey, creditKey});
        const int dc = accountCredited ? 0 : 1;
        const int match = date.year() < 2025 && i % 3 != 0 ? id : 0;
        writer.execPrepared(move,
                            {2 * id - 1, id, accountKey, Money(agorot), Money(cents), dc, match});
        writer.execPrepared(move,
                            {2 * id, id, counter.key, Money(agorot), Money(cents), 1 - dc, 0});
        balance += dc == 0 ? agorot : -agorot;
    }

    writer.insert(QStringLiteral("Accounts"),
                  {{QStringLiteral("ID"), 1},
                   {QStringLiteral("AccountKey"), accountKey},
                   {QStringLiteral("FullName"), QStringLiteral("חשבון לבדיקת ביצועים")},
                   {QStringLiteral("Balance"), Money(balance)},
                   {QStringLiteral("Obligo"), Money(0)},
                   {QStringLiteral("Delivery"), Money(0)},
                   {QStringLiteral("Dumi"), 0}});
    int id = 1;
    for (const Counter& c : counters)
        writer.insert(QStringLiteral("Accounts"), {{QStringLiteral("ID"), ++id},
                                                   {QStringLiteral("AccountKey"), c.key},
                                                   {QStringLiteral("FullName"), c.name},
                                                   {QStringLiteral("Dumi"), 0}});
    writer.commit();
}

} // namespace ardcard::demo
