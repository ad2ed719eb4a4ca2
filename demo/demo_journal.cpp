#include "demo/demo_parts.h"
#include "demo/demo_random.h"

#include <QStringList>

namespace ardcard::demo::detail {

namespace {

struct Move {
    QString key;
    qint64 agorot; // shekels
    qint64 cents;  // transaction currency
    int debitCredit;
    int fullMatch;
};

struct Trans {
    int type = 0;
    int status = 1;
    int fixedId = 0;
    QDate valueDate;
    QDate dueDate;
    QVariant referance;
    QVariant ref2;
    QVariant description;
    QVariant costCode;
    QString transType;
    int currency = 0; // index into kCurrencies
    QString debit;
    QString credit;
    QList<Move> moves;
};

const QDate kFirstDay(2019, 1, 1);
const QDate kLastDay(2025, 10, 31);
// Lines dated from here on are mostly still open.
const QDate kRecent(2025, 6, 1);

int vatPercent(const QDate& date) {
    return date.year() >= 2025 ? 18 : 17;
}

class JournalBuilder {
public:
    JournalBuilder(CompanyWriter& writer, const CompanyPlan& plan,
                   const QList<PlannedAccount>& accounts)
        : writer_(writer), plan_(plan), random_(plan.seed ^ 0x70A1ULL) {
        for (const PlannedAccount& a : accounts) {
            if (a.kind == AccountKind::Customer)
                customers_.append(a.key);
            else if (a.kind == AccountKind::Supplier)
                suppliers_.append(a.key);
            else if (a.kind == AccountKind::Bank)
                banks_.append(a.key);
            else if (a.kind == AccountKind::Expense)
                expenses_.append(a.key);
        }
    }

    void build() {
        const qint64 span = kFirstDay.daysTo(kLastDay);
        for (int t = 0; t < plan_.transactions; ++t) {
            const QDate date = kFirstDay.addDays(span * t / plan_.transactions + random_.below(3));
            randomTransaction(date);
        }
        demoAccountLines();
        if (customers_.contains(kNextYearAccountKey.toString()))
            nextYearLines();
    }

    QHash<QString, qint64> balances() const { return balances_; }

private:
    const QString& customer() {
        // One customer in twelve is the demo account; the rest lean to the
        // first customers, as a few large clients do.
        if (random_.chance(8))
            return customers_.first();
        const int a = random_.below(static_cast<int>(customers_.size()));
        const int b = random_.below(static_cast<int>(customers_.size()));
        return customers_[std::min(a, b)];
    }
    const QString& pick(const QStringList& keys) {
        return keys[random_.below(static_cast<int>(keys.size()))];
    }

    qint64 shekels(qint64 cents, int currency, const QDate& date) const {
        const Currency& c = kCurrencies[currency];
        qint64 rate = c.rateE4;
        if (c.id != 1)
            rate += (kFirstDay.daysTo(date) * 37) % 2001 - 1000;
        return (cents * rate + 5000) / 10000;
    }

    int matchFor(const QDate& date) {
        const int percent = date < kRecent ? 85 : 15;
        return random_.chance(percent) ? ++matchNumber_ : 0;
    }

    Trans start(const QDate& date, int dueDays, const QString& transType, const QString& text,
                int reference) {
        Trans t;
        t.valueDate = date;
        t.dueDate = date.addDays(dueDays);
        t.transType = transType;
        t.description = random_.chance(4) ? QVariant() : QVariant(text.arg(reference));
        t.referance = random_.chance(3) ? QVariant() : QVariant(reference);
        t.ref2 = random_.chance(60) ? QVariant() : QVariant(5000 + random_.below(4000));
        const int cost = random_.below(5);
        t.costCode = cost == 0 ? QVariant() : QVariant(QString::number(cost * 100));
        const int fate = random_.below(100);
        if (fate < 2)
            t.status = 0; // a draft not yet posted
        else if (fate < 3)
            t.fixedId = nextTransId_ + 7; // corrected by a later transaction
        else if (fate < 4)
            t.type = 1; // an opening-balance entry
        return t;
    }

    // A line of the credit account carries DebitCredit 0, so that its counter
    // account is the transaction's debit account, and the other way round.
    void credit(Trans& t, const QString& key, qint64 cents, bool matchable) {
        t.moves.append({key, shekels(cents, t.currency, t.valueDate), cents, 0,
                        matchable ? matchFor(t.valueDate) : 0});
    }
    void debit(Trans& t, const QString& key, qint64 cents, bool matchable) {
        t.moves.append({key, shekels(cents, t.currency, t.valueDate), cents, 1,
                        matchable ? matchFor(t.valueDate) : 0});
    }

    void simple(Trans t, const QString& debitKey, const QString& creditKey, qint64 cents,
                bool matchDebit, bool matchCredit) {
        t.debit = debitKey;
        t.credit = creditKey;
        debit(t, debitKey, cents, matchDebit);
        credit(t, creditKey, cents, matchCredit);
        post(t);
    }

    // Net amount plus VAT, in shekels.
    void withVat(Trans t, const QString& debitKey, const QString& creditKey, qint64 net,
                 bool sale) {
        const qint64 vat = (net * vatPercent(t.valueDate) + 50) / 100;
        t.debit = debitKey;
        t.credit = creditKey;
        if (sale) {
            debit(t, debitKey, net + vat, true);
            credit(t, creditKey, net, false);
            credit(t, QStringLiteral("VAT-OUT"), vat, false);
        } else {
            credit(t, creditKey, net + vat, true);
            debit(t, debitKey, net, false);
            debit(t, QStringLiteral("VAT-IN"), vat, false);
        }
        post(t);
    }

    QString incomeKey() const {
        return plan_.trading ? QStringLiteral("40001") : QStringLiteral("40010");
    }

    void randomTransaction(const QDate& date) {
        const int kind = random_.below(100);
        const qint64 amount = random_.between(50, 4000) * 100LL + random_.below(100);
        if (kind < 40) {
            withVat(start(date, 30 * random_.below(3), QStringLiteral("חש"),
                          QStringLiteral("חשבונית מס %1"), ++invoice_),
                    customer(), incomeKey(), amount, true);
        } else if (kind < 48) {
            Trans t = start(date, 60, QStringLiteral("יצ"), QStringLiteral("חשבונית ייצוא %1"),
                            ++invoice_);
            t.currency = random_.chance(60) ? 1 : 2;
            simple(t, customer(), plan_.trading ? QStringLiteral("40002") : QStringLiteral("40011"),
                   amount, true, false);
        } else if (kind < 73) {
            Trans t = start(date, 0, QStringLiteral("קב"), QStringLiteral("קבלה %1"), ++receipt_);
            simple(t, pick(banks_), customer(), amount * 2, false, true);
        } else if (kind < 86) {
            Trans t = start(date, 30, QStringLiteral("חס"), QStringLiteral("חשבונית ספק %1"),
                            random_.between(10000, 99999));
            if (random_.chance(25)) {
                t.currency = random_.between(2, 4);
                simple(t, QStringLiteral("50012"), pick(suppliers_), amount * 2, false, true);
            } else {
                const QString expense =
                    random_.chance(50) ? QStringLiteral("50012") : pick(expenses_);
                withVat(t, expense, pick(suppliers_), amount, false);
            }
        } else if (kind < 96) {
            Trans t =
                start(date, 0, QStringLiteral("תש"), QStringLiteral("תשלום לספק %1"), ++payment_);
            simple(t, pick(suppliers_), pick(banks_), amount * 2, true, false);
        } else if (kind < 98) {
            withVat(start(date, 0, QStringLiteral("זי"), QStringLiteral("חשבונית זיכוי %1"),
                          ++invoice_),
                    incomeKey(), customer(), amount / 2, false);
        } else if (kind < 99) {
            simple(start(date, 0, QStringLiteral("שכ"), QStringLiteral("משכורת %1"), date.month()),
                   QStringLiteral("90001"), QStringLiteral("BANK01"), 2850000, false, false);
        } else {
            simple(start(date, 0, QStringLiteral("הל"), QStringLiteral("הלוואת בעלים %1"),
                         date.year()),
                   QStringLiteral("BANK01"), QStringLiteral("90002"), 5000000, false, false);
        }
    }

    // Lines of the demo account that every variant of the journal read has
    // something to show or leave out for.
    void demoAccountLines() {
        const QString key = kDemoAccountKey.toString();
        // A monthly fee and its payment, every month of the seven years.
        for (QDate month = kFirstDay; month <= kLastDay; month = month.addMonths(1)) {
            withVat(start(month.addDays(4), 30, QStringLiteral("חש"),
                          plan_.trading ? QStringLiteral("דמי הובלה חודשיים %1")
                                        : QStringLiteral("דמי שכירות חודש %1"),
                          month.month()),
                    key, plan_.trading ? QStringLiteral("40003") : incomeKey(),
                    plan_.trading ? 120000 : 850000, true);
            simple(start(month.addDays(20), 0, QStringLiteral("קב"), QStringLiteral("קבלה %1"),
                         ++receipt_),
                   QStringLiteral("BANK02"), key, plan_.trading ? 140400 : 994500, false, true);
        }
        for (int i = 0; i < 2; ++i) {
            Trans draft = start(QDate(2024, 3 + i, 10), 0, QStringLiteral("חש"),
                                QStringLiteral("טיוטה %1"), 900 + i);
            draft.status = 0;
            draft.fixedId = 0;
            draft.type = 0;
            simple(draft, key, incomeKey(), 99900, true, false);
            Trans fixed = start(QDate(2023, 5 + i, 3), 0, QStringLiteral("חש"),
                                QStringLiteral("נרשם בטעות %1"), 910 + i);
            fixed.status = 1;
            fixed.fixedId = nextTransId_ + 1;
            fixed.type = 0;
            simple(fixed, key, incomeKey(), 77700, true, false);
            Trans opening = start(QDate(2019, 1, 1), 0, QStringLiteral("פת"),
                                  QStringLiteral("יתרת פתיחה %1"), 920 + i);
            opening.status = 1;
            opening.fixedId = 0;
            opening.type = 1;
            simple(opening, key, QStringLiteral("CASH"), 55500, false, false);
        }
        // Counter accounts that the names join cannot find or finds nameless.
        for (int i = 0; i < 3; ++i) {
            Trans t = start(QDate(2021, 2 + i, 15), 0, QStringLiteral("הע"),
                            QStringLiteral("העברה מחשבון שנסגר %1"), 930 + i);
            t.status = 1;
            t.fixedId = 0;
            t.type = 0;
            simple(t, key, kDeletedAccountKey.toString(), 12345 * (i + 1), false, false);
        }
        for (int i = 0; i < 2; ++i) {
            Trans t = start(QDate(2022, 8 + i, 1), 0, QStringLiteral("הו"),
                            QStringLiteral("חיוב הוצאות %1"), 940 + i);
            t.status = 1;
            t.fixedId = 0;
            t.type = 0;
            simple(t, key, QStringLiteral("50013"), 4680 * (i + 1), false, false);
        }
    }

    void nextYearLines() {
        const QString key = kNextYearAccountKey.toString();
        for (int i = 0; i < 3; ++i) {
            Trans t = start(QDate(2026, 1 + i, 5 + i), 30, QStringLiteral("חש"),
                            QStringLiteral("הזמנה לשנה הבאה %1"), 950 + i);
            t.status = 1;
            t.fixedId = 0;
            t.type = 0;
            simple(t, key, QStringLiteral("40009"), 250000, true, false);
        }
    }

    void post(const Trans& t) {
        const int id = ++nextTransId_;
        const Currency& currency = kCurrencies[t.currency];
        writer_.execPrepared(
            QStringLiteral("INSERT INTO JurnalTrans (TransID, Type, Status, FixedID, ValueDate, "
                           "DueDate, BatchNo, Referance, Ref2, Description, CostCode, TransType, "
                           "CurrencyCode, TransDebID, TransCredID) "
                           "VALUES (?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?)"),
            {id, t.type, t.status, t.fixedId, IsoDate(t.valueDate), IsoDate(t.dueDate),
             1000 + (t.valueDate.year() - 2019) * 12 + t.valueDate.month(), t.referance, t.ref2,
             t.description, t.costCode, t.transType, currency.code.toString(), t.debit, t.credit});
        const bool counted = t.status == 1 && t.fixedId == 0 && t.type == 0;
        for (const Move& m : t.moves) {
            writer_.execPrepared(
                QStringLiteral("INSERT INTO JurnalTransMoves (ID, TransID, AccountKey, SuF, "
                               "SuFDlr, DebitCredit, FullMatch) VALUES (?, ?, ?, ?, ?, ?, ?)"),
                {++nextMoveId_, id, m.key, Money(m.agorot), Money(m.cents), m.debitCredit,
                 m.fullMatch});
            if (counted)
                balances_[m.key] += m.debitCredit == 0 ? m.agorot : -m.agorot;
        }
    }

    CompanyWriter& writer_;
    const CompanyPlan& plan_;
    DemoRandom random_;
    QStringList customers_;
    QStringList suppliers_;
    QStringList banks_;
    QStringList expenses_;
    QHash<QString, qint64> balances_;
    int nextTransId_ = 0;
    int nextMoveId_ = 0;
    int matchNumber_ = 0;
    int invoice_ = 20000;
    int receipt_ = 50000;
    int payment_ = 70000;
};

} // namespace

QHash<QString, qint64> WriteJournal(CompanyWriter& writer, const CompanyPlan& plan,
                                    const QList<PlannedAccount>& accounts) {
    JournalBuilder builder(writer, plan, accounts);
    builder.build();
    return builder.balances();
}

} // namespace ardcard::demo::detail
