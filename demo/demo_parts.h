#pragma once

// The pieces BuildDemoCompany is put together from; internal to the demo.

#include "demo/company_writer.h"

#include <QDate>
#include <QHash>
#include <QList>
#include <QString>
#include <QStringView>
#include <QVariant>

namespace ardcard::demo::detail {

enum class AccountKind { Header, Customer, Supplier, Bank, Income, Expense, Vat, Private };

struct PlannedAccount {
    QString key;
    QVariant name; // Null for the one account without a name
    AccountKind kind;
    QVariant sortGroup;
    QVariant filter;
    int index = 0; // customers: the number shared by both companies
};

// What makes the two demo companies differ.
struct CompanyPlan {
    quint64 seed;
    QString companyName;
    QString shortName;
    QString vatNum;
    QString deductNum;
    QString hiddenFilter;
    int customers;
    int suppliers;
    int transactions;
    bool trading; // demo.db sells goods; demo2.db lets property
};

struct Currency {
    int id;
    QStringView code;
    int rateE4; // shekels per unit, times 10,000
};

inline constexpr Currency kCurrencies[] = {{1, u"שח", 10000},
                                           {2, u"$", 36500},
                                           {3, u"EUR", 39800},
                                           {4, u"GBP", 46200},
                                           {5, u"CHF", 41000}};

inline constexpr QStringView kDemoAccountKey = u"10001";
// The only account with journal lines dated after 2025.
inline constexpr QStringView kNextYearAccountKey = u"10160";
// A key that transactions name but the accounts table no longer holds.
inline constexpr QStringView kDeletedAccountKey = u"88888";

QList<PlannedAccount> PlanAccounts(const CompanyPlan& plan);
// Writes the journal and returns every account's balance in agorot, as the
// journal read totals it (Status 1, FixedID 0, Type 0).
QHash<QString, qint64> WriteJournal(CompanyWriter& writer, const CompanyPlan& plan,
                                    const QList<PlannedAccount>& accounts);
void WriteAccounts(CompanyWriter& writer, const CompanyPlan& plan,
                   const QList<PlannedAccount>& accounts, const QHash<QString, qint64>& balances);
void WriteContacts(CompanyWriter& writer, const CompanyPlan& plan,
                   const QList<PlannedAccount>& accounts);
void WriteAccountExtraFields(CompanyWriter& writer, const CompanyPlan& plan,
                             const QList<PlannedAccount>& accounts);
// Items and everything hung on them; customers take part in special prices
// and alternative keys.
void WriteCatalog(CompanyWriter& writer, const QList<PlannedAccount>& accounts);

QString IsoDate(const QDate& date);
QVariant Money(qint64 agorot);

} // namespace ardcard::demo::detail
