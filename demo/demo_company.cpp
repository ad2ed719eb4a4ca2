#include "demo/demo_builder.h"
#include "demo/demo_parts.h"

#include "common/failure.h"

#include <QDir>

namespace ardcard::demo {

namespace detail {

QString IsoDate(const QDate& date) {
    return date.toString(Qt::ISODate);
}

QVariant Money(qint64 agorot) {
    return static_cast<double>(agorot) / 100.0;
}

} // namespace detail

namespace {

using namespace detail;

const CompanyPlan kTrading{0xD3110001ULL,
                           QStringLiteral("אופק סחר והפצה בע\"מ"),
                           QStringLiteral("אופק סחר"),
                           QStringLiteral("514276381"),
                           QStringLiteral("937465120"),
                           QStringLiteral("PRV"),
                           160,
                           45,
                           2600,
                           true};

const CompanyPlan kProperty{0xD3110002ULL,
                            QStringLiteral("אופק נכסים והשקעות בע\"מ"),
                            QStringLiteral("אופק נכסים"),
                            QStringLiteral("515390274"),
                            QStringLiteral("938112457"),
                            QStringLiteral("PRV"),
                            60,
                            15,
                            800,
                            false};

void writeCompany(CompanyWriter& writer, const CompanyPlan& plan) {
    writer.insert(QStringLiteral("CompanyDefenitions"),
                  {{QStringLiteral("ID"), 1},
                   {QStringLiteral("CompanyName"), plan.companyName},
                   {QStringLiteral("ShortName"), plan.shortName},
                   {QStringLiteral("VatNum"), plan.vatNum},
                   {QStringLiteral("DeductNum"), plan.deductNum},
                   {QStringLiteral("HiddenAccountsFilter"), plan.hiddenFilter}});
    for (const Currency& c : kCurrencies)
        writer.insert(
            QStringLiteral("Currencies"),
            {{QStringLiteral("ID"), c.id}, {QStringLiteral("CurrencyCode"), c.code.toString()}});
}

void writeNames(CompanyWriter& writer) {
    const std::pair<int, QStringView> sorts[] = {
        {100, u"לקוחות"}, {200, u"ספקים"}, {300, u"בנקים וקופות"},  {400, u"הכנסות"},
        {500, u"הוצאות"}, {600, u"מע\"מ"}, {900, u"חשבונות פרטיים"}};
    for (const auto& [code, name] : sorts)
        writer.insert(QStringLiteral("AccSortNames"),
                      {{QStringLiteral("AccSortCode"), code},
                       {QStringLiteral("SortCodeName"), name.toString()}});
    // Agent 6 has no name; warehouse numbers overlap the agents' numbers.
    const std::tuple<int, int, QStringView> names[] = {
        {1, 1, u"יוסי אברהם"},       {2, 1, u"מיכל דהן"},   {3, 1, u"רונן פרץ"},
        {4, 1, u"שירה ביטון"},       {5, 1, u"אבי מזרחי"},  {1, 2, u"מחסן ראשי - חולון"},
        {2, 2, u"מחסן צפון - חיפה"}, {3, 2, u"מחסן החזרות"}};
    for (const auto& [id, sort, name] : names)
        writer.insert(QStringLiteral("AgentWarehouseNames"),
                      {{QStringLiteral("NameID"), id},
                       {QStringLiteral("Sort"), sort},
                       {QStringLiteral("Name"), name.toString()}});
    const QStringView documents[] = {
        u"ללא מסמך",    u"חשבונית מס",       u"חשבונית מס/קבלה", u"קבלה",
        u"תעודת משלוח", u"הזמנת לקוח",       u"הצעת מחיר",       u"חשבונית זיכוי",
        u"החזרה מלקוח", u"הזמנת רכש",        u"תעודת כניסה",     u"חשבונית ספק",
        u"החזרה לספק",  u"העברה בין מחסנים", u"ספירת מלאי",      u"חשבון עסקה"};
    int id = 0;
    for (const QStringView name : documents)
        writer.insert(
            QStringLiteral("DocumentsDef"),
            {{QStringLiteral("DocumentID"), id++}, {QStringLiteral("DocName"), name.toString()}});
    writer.insert(QStringLiteral("DocumentsDef"),
                  {{QStringLiteral("DocumentID"), 20}, {QStringLiteral("DocName"), QVariant()}});
}

void buildCompany(const QString& path, const CompanyPlan& plan) {
    CreateCompanyFile(path);
    CompanyWriter writer(path);
    writeCompany(writer, plan);
    writeNames(writer);
    const QList<PlannedAccount> accounts = PlanAccounts(plan);
    const QHash<QString, qint64> balances = WriteJournal(writer, plan, accounts);
    WriteAccounts(writer, plan, accounts, balances);
    WriteContacts(writer, plan, accounts);
    WriteAccountExtraFields(writer, plan, accounts);
    WriteCatalog(writer, accounts);
    writer.commit();
}

} // namespace

QString DemoFileName() {
    return QStringLiteral("demo.db");
}

QString Demo2FileName() {
    return QStringLiteral("demo2.db");
}

QString DemoAccountKey() {
    return kDemoAccountKey.toString();
}

void BuildDemoCompany(const QString& dir) {
    if (!QDir().mkpath(dir))
        throw Failure(QStringLiteral("לא ניתן ליצור את התיקייה %1").arg(dir));
    buildCompany(QDir(dir).filePath(DemoFileName()), kTrading);
    buildCompany(QDir(dir).filePath(Demo2FileName()), kProperty);
}

} // namespace ardcard::demo
