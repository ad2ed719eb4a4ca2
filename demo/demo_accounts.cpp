#include "demo/demo_parts.h"
#include "demo/demo_random.h"
#include "demo/demo_words.h"

namespace ardcard::demo::detail {

namespace {

using namespace words;

struct Fixed {
    QStringView key;
    QStringView name;
    AccountKind kind;
    int sortGroup;
};

// Header rows (Dumi 1) stand before their group, so stepping by ID has to
// skip them.
constexpr Fixed kHeaders[] = {{u"H100", u"כותרת - לקוחות", AccountKind::Header, 100},
                              {u"H200", u"כותרת - ספקים", AccountKind::Header, 200},
                              {u"H300", u"כותרת - בנקים וקופות", AccountKind::Header, 300},
                              {u"H400", u"כותרת - הכנסות", AccountKind::Header, 400},
                              {u"H500", u"כותרת - הוצאות", AccountKind::Header, 500}};

constexpr Fixed kBanks[] = {{u"BANK01", u"בנק לאומי - עו\"ש", AccountKind::Bank, 300},
                            {u"BANK02", u"בנק הפועלים - עו\"ש", AccountKind::Bank, 300},
                            {u"BANK03", u"בנק דיסקונט - מט\"ח", AccountKind::Bank, 300},
                            {u"CASH", u"קופה ראשית", AccountKind::Bank, 300},
                            {u"CHEQ", u"קופת שיקים לגבייה", AccountKind::Bank, 300}};

constexpr Fixed kTradeIncome[] = {{u"40001", u"הכנסות ממכירות", AccountKind::Income, 400},
                                  {u"40002", u"הכנסות מייצוא", AccountKind::Income, 400},
                                  {u"40003", u"הכנסות משירותי הובלה", AccountKind::Income, 400},
                                  {u"40009", u"הכנסות מראש", AccountKind::Income, 400}};

constexpr Fixed kRentIncome[] = {{u"40010", u"הכנסות משכירות", AccountKind::Income, 400},
                                 {u"40011", u"הכנסות מדמי ניהול", AccountKind::Income, 400}};

constexpr Fixed kExpenses[] = {
    {u"50001", u"שכר דירה", AccountKind::Expense, 500},
    {u"50002", u"חשמל", AccountKind::Expense, 500},
    {u"50003", u"מים", AccountKind::Expense, 500},
    {u"50004", u"טלפון ואינטרנט", AccountKind::Expense, 500},
    {u"50005", u"דלק", AccountKind::Expense, 500},
    {u"50006", u"אחזקת רכב", AccountKind::Expense, 500},
    {u"50007", u"ציוד משרדי", AccountKind::Expense, 500},
    {u"50008", u"פרסום", AccountKind::Expense, 500},
    {u"50009", u"ביטוח", AccountKind::Expense, 500},
    {u"50010", u"הנהלת חשבונות", AccountKind::Expense, 500},
    {u"50011", u"עמלות בנק", AccountKind::Expense, 500},
    {u"50012", u"קניות סחורה", AccountKind::Expense, 500},
};

constexpr Fixed kVat[] = {{u"VAT-OUT", u"מע\"מ עסקאות", AccountKind::Vat, 600},
                          {u"VAT-IN", u"מע\"מ תשומות", AccountKind::Vat, 600}};

PlannedAccount fromFixed(const Fixed& fixed) {
    return {
        fixed.key.toString(), fixed.name.toString(), fixed.kind, fixed.sortGroup, QVariant(), 0};
}

// A customer's name depends on its number only, so that the same key names
// the same customer in both companies.
QString customerName(int index) {
    DemoRandom random(0x5EED0000ULL + static_cast<quint64>(index));
    switch (random.below(3)) {
    case 0:
        return QStringLiteral("%1 %2").arg(random.pick(kLastNames), random.pick(kBusinessKinds));
    case 1:
        return QStringLiteral("%1 %2").arg(random.pick(kShopKinds), random.pick(kShopPlaces));
    default:
        return QStringLiteral("%1 %2").arg(random.pick(kFirstNames), random.pick(kLastNames));
    }
}

QString supplierName(DemoRandom& random) {
    return QStringLiteral("%1 %2").arg(random.pick(kLastNames), random.pick(kBusinessKinds));
}

} // namespace

QList<PlannedAccount> PlanAccounts(const CompanyPlan& plan) {
    DemoRandom random(plan.seed ^ 0xACC0ULL);
    QList<PlannedAccount> accounts;
    accounts.append(fromFixed(kHeaders[0]));
    for (int i = 1; i <= plan.customers; ++i) {
        PlannedAccount a{
            QString::number(10000 + i), customerName(i), AccountKind::Customer, 100, QVariant(), i};
        const int filter = random.below(10);
        if (filter < 3)
            a.filter = QStringLiteral("א");
        else if (filter < 5)
            a.filter = QStringLiteral("ב");
        else if (filter == 5)
            a.filter = QString();
        if (i % 37 == 0)
            a.sortGroup = 150; // a group without a name
        else if (i % 41 == 0)
            a.sortGroup = QVariant();
        accounts.append(a);
    }
    accounts.append(fromFixed(kHeaders[1]));
    for (int i = 1; i <= plan.suppliers; ++i)
        accounts.append({QString::number(20000 + i), supplierName(random), AccountKind::Supplier,
                         200, QVariant(), i});
    accounts.append(fromFixed(kHeaders[2]));
    for (const Fixed& f : kBanks)
        accounts.append(fromFixed(f));
    accounts.append(fromFixed(kHeaders[3]));
    for (const Fixed& f :
         plan.trading ? std::span<const Fixed>(kTradeIncome) : std::span<const Fixed>(kRentIncome))
        accounts.append(fromFixed(f));
    accounts.append(fromFixed(kHeaders[4]));
    for (const Fixed& f : kExpenses)
        accounts.append(fromFixed(f));
    // An expense account whose name was never filled in.
    accounts.append(
        {QStringLiteral("50013"), QVariant(), AccountKind::Expense, 500, QVariant(), 0});
    for (const Fixed& f : kVat)
        accounts.append(fromFixed(f));
    // Private accounts, masked by the company's hidden-accounts filter; the
    // second spells the filter in other letter case.
    PlannedAccount salary{QStringLiteral("90001"), QStringLiteral("משכורת מנכ\"ל"),
                          AccountKind::Private,    900,
                          plan.hiddenFilter,       0};
    PlannedAccount loan{QStringLiteral("90002"),     QStringLiteral("הלוואת בעלים"),
                        AccountKind::Private,        900,
                        plan.hiddenFilter.toLower(), 0};
    accounts.append(salary);
    accounts.append(loan);
    return accounts;
}

void WriteAccounts(CompanyWriter& writer, const CompanyPlan& plan,
                   const QList<PlannedAccount>& accounts, const QHash<QString, qint64>& balances) {
    DemoRandom random(plan.seed ^ 0xADD0ULL);
    int id = 0;
    for (const PlannedAccount& a : accounts) {
        // Row IDs leave gaps, as deleted accounts do.
        id += random.chance(10) ? 2 : 1;
        CompanyWriter::Columns row{{QStringLiteral("ID"), id},
                                   {QStringLiteral("AccountKey"), a.key},
                                   {QStringLiteral("FullName"), a.name},
                                   {QStringLiteral("Filter"), a.filter},
                                   {QStringLiteral("SortGroup"), a.sortGroup},
                                   {QStringLiteral("Dumi"), a.kind == AccountKind::Header ? 1 : 0},
                                   {QStringLiteral("Balance"), Money(balances.value(a.key))}};
        if (a.kind == AccountKind::Customer || a.kind == AccountKind::Supplier) {
            DemoRandom person(0xC17E0000ULL + static_cast<quint64>(a.key.toInt()));
            const City& city = kCities[person.below(std::size(kCities))];
            const QString number = QString::number(person.between(1000000, 9999999));
            row.append(
                {QStringLiteral("Phone"), QStringLiteral("%1-%2").arg(city.phonePrefix, number)});
            row.append({QStringLiteral("Fax"), person.chance(40)
                                                   ? QVariant(QStringLiteral("%1-%2").arg(
                                                         city.phonePrefix, number.left(6) + u'9'))
                                                   : QVariant()});
            row.append(
                {QStringLiteral("Address"),
                 QStringLiteral("%1 %2").arg(person.pick(kStreets)).arg(person.between(1, 120))});
            row.append({QStringLiteral("City"), city.name.toString()});
            row.append(
                {QStringLiteral("Zip"),
                 QStringLiteral("%1%2").arg(city.zipPrefix).arg(person.between(10000, 99999))});
            row.append({QStringLiteral("Country"), city.district.toString()});
            row.append({QStringLiteral("Details"),
                        person.chance(70) ? QVariant(person.pick(kAccountDetails).toString())
                                          : QVariant()});
            row.append({QStringLiteral("WorF"), person.pick(kTrades).toString()});
            row.append(
                {QStringLiteral("Email"), QStringLiteral("office%1@example.co.il").arg(a.key)});
            row.append({QStringLiteral("Agent"),
                        person.chance(85) ? QVariant(person.between(1, 6)) : QVariant()});
            row.append(
                {QStringLiteral("Obligo"),
                 Money(a.kind == AccountKind::Customer ? person.between(0, 40) * 250000LL : 0)});
            row.append({QStringLiteral("Delivery"),
                        Money(person.chance(30) ? person.between(10000, 2500000) : 0)});
            row.append({QStringLiteral("CustomerNote"),
                        person.chance(15) ? QVariant(QStringLiteral("לא לספק ללא אישור מנהל"))
                                          : QVariant()});
            if (person.chance(8))
                row.append({QStringLiteral("ExFile"),
                            QStringLiteral("\\\\fs01\\ardeco\\docs\\%1.pdf").arg(a.key)});
            else if (person.chance(10))
                row.append({QStringLiteral("ExFile"), QString()});
        } else {
            row.append({QStringLiteral("Obligo"), Money(0)});
            row.append({QStringLiteral("Delivery"), Money(0)});
        }
        writer.insert(QStringLiteral("Accounts"), row);
    }
}

void WriteContacts(CompanyWriter& writer, const CompanyPlan& plan,
                   const QList<PlannedAccount>& accounts) {
    DemoRandom random(plan.seed ^ 0xC0C0ULL);
    int id = 0;
    for (const PlannedAccount& a : accounts) {
        if (a.kind != AccountKind::Customer && a.kind != AccountKind::Supplier)
            continue;
        // The demo account has two active contacts and one who has left.
        const bool demo = a.key == kDemoAccountKey;
        const int count = demo ? 3 : random.below(4);
        for (int i = 0; i < count; ++i) {
            const QString first = random.pick(kFirstNames).toString();
            const QString phone = QStringLiteral("0%1-%2")
                                      .arg(random.between(2, 9))
                                      .arg(random.between(2000000, 9999999));
            const bool active = demo ? i < 2 : random.chance(80);
            writer.insert(
                QStringLiteral("CRMContact"),
                {{QStringLiteral("ID"), ++id},
                 {QStringLiteral("AccountKey"), a.key},
                 {QStringLiteral("CName"),
                  QStringLiteral("%1 %2").arg(first, random.pick(kLastNames))},
                 {QStringLiteral("CTitle"), random.pick(kJobTitles).toString()},
                 {QStringLiteral("CMail"),
                  random.chance(70) ? QVariant(QStringLiteral("c%1@example.co.il").arg(id))
                                    : QVariant()},
                 {QStringLiteral("CPhone"), phone},
                 {QStringLiteral("C2Phone"),
                  random.chance(30) ? QVariant(phone + u'1') : QVariant()},
                 {QStringLiteral("CCelular"), QStringLiteral("05%1-%2")
                                                  .arg(random.between(0, 8))
                                                  .arg(random.between(2000000, 9999999))},
                 {QStringLiteral("CFax"), QVariant()},
                 {QStringLiteral("Branch"), random.pick(kBranches).toString()},
                 {QStringLiteral("Address"),
                  random.chance(50) ? QVariant(QStringLiteral("%1 5").arg(random.pick(kStreets)))
                                    : QVariant()},
                 {QStringLiteral("Remark"),
                  random.chance(40) ? QVariant(QStringLiteral("זמין בבקרים")) : QVariant()},
                 {QStringLiteral("SecRemark"),
                  random.chance(20) ? QVariant(QString()) : QVariant()},
                 {QStringLiteral("CStatus"), active ? 1 : 0}});
        }
    }
}

void WriteAccountExtraFields(CompanyWriter& writer, const CompanyPlan& plan,
                             const QList<PlannedAccount>& accounts) {
    const QString notes[] = {QStringLiteral("איש מכירות אחראי"), QStringLiteral("תנאי תשלום"),
                             QStringLiteral("הערת גבייה")};
    const QString sums[] = {QStringLiteral("מסגרת אשראי נוספת"), QStringLiteral("הנחה קבועה %")};
    const QString dates[] = {QStringLiteral("תאריך פתיחת לקוח"),
                             QStringLiteral("תוקף ערבות בנקאית"), QStringLiteral("ביקור אחרון")};
    for (int i = 0; i < 3; ++i)
        writer.insert(QStringLiteral("ExtraNoteNames"), {{QStringLiteral("NoteID"), i + 1},
                                                         {QStringLiteral("ItemFlag"), 0},
                                                         {QStringLiteral("NoteName"), notes[i]}});
    for (int i = 0; i < 2; ++i)
        writer.insert(QStringLiteral("ExtraSumNames"), {{QStringLiteral("SuFID"), i + 1},
                                                        {QStringLiteral("ItemFlag"), 0},
                                                        {QStringLiteral("SuFName"), sums[i]}});
    for (int i = 0; i < 3; ++i)
        writer.insert(QStringLiteral("ExtraDateNames"), {{QStringLiteral("DatFID"), i + 1},
                                                         {QStringLiteral("ItemFlag"), 0},
                                                         {QStringLiteral("DatFName"), dates[i]}});
    DemoRandom random(plan.seed ^ 0xE47AULL);
    for (const PlannedAccount& a : accounts) {
        if (a.kind != AccountKind::Customer)
            continue;
        const bool demo = a.key == kDemoAccountKey;
        if (!demo && !random.chance(35))
            continue;
        const QString key = a.key;
        if (demo || random.chance(60))
            writer.insert(QStringLiteral("ExtraNotes"),
                          {{QStringLiteral("KeF"), key},
                           {QStringLiteral("NoteID"), 1},
                           {QStringLiteral("ItemFlag"), 0},
                           {QStringLiteral("Note"), random.pick(words::kFirstNames).toString()}});
        if (demo || random.chance(50))
            writer.insert(QStringLiteral("ExtraNotes"),
                          {{QStringLiteral("KeF"), key},
                           {QStringLiteral("NoteID"), 2},
                           {QStringLiteral("ItemFlag"), 0},
                           {QStringLiteral("Note"), random.pick(kAccountDetails).toString()}});
        if (demo || random.chance(50))
            writer.insert(QStringLiteral("ExtraSums"),
                          {{QStringLiteral("KeF"), key},
                           {QStringLiteral("SuFID"), 1},
                           {QStringLiteral("ItemFlag"), 0},
                           {QStringLiteral("SuF"), Money(random.between(1, 20) * 500000LL)}});
        if (demo || random.chance(30))
            writer.insert(QStringLiteral("ExtraSums"),
                          {{QStringLiteral("SuFID"), 2},
                           {QStringLiteral("KeF"), key},
                           {QStringLiteral("ItemFlag"), 0},
                           {QStringLiteral("SuF"), random.between(2, 12)}});
        const QDate opened = QDate(2012, 1, 1).addDays(random.below(2500));
        writer.insert(QStringLiteral("ExtraDates"), {{QStringLiteral("KeF"), key},
                                                     {QStringLiteral("DatFID"), 1},
                                                     {QStringLiteral("ItemFlag"), 0},
                                                     {QStringLiteral("DatF"), IsoDate(opened)}});
        // A guarantee date that was never filled in: the page leaves it out.
        writer.insert(QStringLiteral("ExtraDates"),
                      {{QStringLiteral("KeF"), key},
                       {QStringLiteral("DatFID"), 2},
                       {QStringLiteral("ItemFlag"), 0},
                       {QStringLiteral("DatF"),
                        demo || random.chance(50)
                            ? QVariant(IsoDate(QDate(2024, 1, 1).addDays(random.below(900))))
                            : QVariant()}});
    }
}

} // namespace ardcard::demo::detail
