#include "demo/demo_parts.h"
#include "demo/demo_random.h"

namespace ardcard::demo::detail {

namespace {

struct Product {
    QStringView key;
    QStringView name;
    QStringView foreignName;
    QStringView unit;
    int sortGroup;
    int priceAgorot;
};

constexpr Product kProducts[] = {
    {u"P1001", u"קפה טורקי 200 גרם", u"Turkish coffee 200g", u"יח'", 10, 1490},
    {u"P1002", u"קפה נמס 100 גרם", u"Instant coffee 100g", u"יח'", 10, 2290},
    {u"P1003", u"תה ירוק 25 שקיקים", u"Green tea 25 bags", u"יח'", 10, 1190},
    {u"P1004", u"תה שחור 100 שקיקים", u"Black tea 100 bags", u"יח'", 10, 2450},
    {u"P1005", u"סוכר לבן 1 ק\"ג", u"White sugar 1kg", u"ק\"ג", 20, 590},
    {u"P1006", u"קמח לבן 1 ק\"ג", u"White flour 1kg", u"ק\"ג", 20, 490},
    {u"P1007", u"אורז פרסי 1 ק\"ג", u"Persian rice 1kg", u"ק\"ג", 20, 1290},
    {u"P1008", u"פסטה ספגטי 500 גרם", u"Spaghetti 500g", u"יח'", 20, 690},
    {u"P1009", u"שמן זית כתית 750 מ\"ל", u"Olive oil 750ml", u"בקבוק", 30, 3990},
    {u"P1010", u"שמן קנולה 1 ליטר", u"Canola oil 1l", u"בקבוק", 30, 1190},
    {u"P1011", u"טחינה גולמית 500 גרם", u"Raw tahini 500g", u"יח'", 30, 1690},
    {u"P1012", u"חומוס יבש 1 ק\"ג", u"Dry chickpeas 1kg", u"ק\"ג", 20, 990},
    {u"P1013", u"עדשים כתומות 1 ק\"ג", u"Red lentils 1kg", u"ק\"ג", 20, 1090},
    {u"P1014", u"ריבת תות 340 גרם", u"Strawberry jam 340g", u"צנצנת", 40, 1390},
    {u"P1015", u"דבש פרחי בר 500 גרם", u"Wildflower honey 500g", u"צנצנת", 40, 3490},
    {u"P1016", u"שוקולד מריר 100 גרם", u"Dark chocolate 100g", u"יח'", 40, 790},
    {u"P1017", u"עוגיות חמאה 400 גרם", u"Butter cookies 400g", u"קופסה", 40, 1990},
    {u"P1018", u"ופלים וניל 200 גרם", u"Vanilla wafers 200g", u"יח'", 40, 590},
    {u"P1019", u"מיץ ענבים 1 ליטר", u"Grape juice 1l", u"בקבוק", 50, 1290},
    {u"P1020", u"יין אדום יבש 750 מ\"ל", u"Dry red wine 750ml", u"בקבוק", 50, 5990},
    {u"P1021", u"מים מינרליים 6 יח'", u"Mineral water 6 pack", u"מארז", 50, 1490},
    {u"P1022", u"אגוזי מלך 200 גרם", u"Walnuts 200g", u"יח'", 60, 2190},
    {u"P1023", u"שקדים קלויים 200 גרם", u"Roasted almonds 200g", u"יח'", 60, 1990},
    {u"P1024", u"תמרים מג'הול 500 גרם", u"Medjool dates 500g", u"קופסה", 60, 2990},
    {u"P1025", u"צימוקים 250 גרם", u"Raisins 250g", u"יח'", 60, 890},
    {u"P1026", u"זעתר 100 גרם", u"Zaatar 100g", u"יח'", 70, 990},
    {u"P1027", u"פפריקה מתוקה 100 גרם", u"Sweet paprika 100g", u"יח'", 70, 890},
    {u"P1028", u"כמון טחון 100 גרם", u"Ground cumin 100g", u"יח'", 70, 790},
    {u"P1029", u"מלח ים 1 ק\"ג", u"Sea salt 1kg", u"ק\"ג", 70, 390},
    {u"P1030", u"סלסלת צלופן", u"Cellophane wrap", u"יח'", 80, 150},
    {u"P1031", u"סרט קישוט זהב", u"Gold ribbon", u"מטר", 80, 90},
    {u"P1032", u"קופסת קרטון מעוצבת", u"Gift carton box", u"יח'", 80, 650},
    {u"SAL-01", u"סלסלת שי לחג - קטנה", u"Holiday basket small", u"יח'", 90, 14900},
    {u"SAL-02", u"סלסלת שי לחג - גדולה", u"Holiday basket large", u"יח'", 90, 29900},
    {u"SAL-03", u"מארז יין ושוקולד", u"Wine and chocolate set", u"מארז", 90, 11900},
    {u"Exp-100", u"מארז ייצוא - דבש ותמרים", u"Export set honey and dates", u"מארז", 90, 8900},
};

void writeItems(CompanyWriter& writer) {
    DemoRandom random(0x17E5ULL);
    int id = 0;
    for (const Product& p : kProducts) {
        const bool hasPurchase = random.chance(80);
        writer.insert(
            QStringLiteral("Items"),
            {{QStringLiteral("ID"), ++id},
             {QStringLiteral("ItemKey"), p.key.toString()},
             {QStringLiteral("ItemName"), p.name.toString()},
             {QStringLiteral("SortGroup"), p.sortGroup},
             {QStringLiteral("Filter"),
              random.chance(50) ? QVariant(QStringLiteral("מזון")) : QVariant()},
             {QStringLiteral("ForignName"), p.foreignName.toString()},
             {QStringLiteral("SalesUnit"), p.unit.toString()},
             {QStringLiteral("Weight"), Money(random.between(5, 300) * 10LL)},
             {QStringLiteral("Volume"),
              random.chance(50) ? QVariant(Money(random.between(1, 90))) : QVariant()},
             {QStringLiteral("DefaultWarehouse"), random.between(1, 2)},
             {QStringLiteral("Localization"), QStringLiteral("%1-%2")
                                                  .arg(QChar(u'א' + random.below(6)))
                                                  .arg(random.between(1, 40))},
             {QStringLiteral("BarCode"),
              QStringLiteral("7290%1").arg(random.between(100000000, 999999999))},
             {QStringLiteral("Quantity"), random.between(-5, 2400)},
             {QStringLiteral("Price"), Money(p.priceAgorot)},
             {QStringLiteral("Currency"), QStringLiteral("שח")},
             {QStringLiteral("ExFile"),
              id % 9 == 0   ? QVariant(QStringLiteral("\\\\fs01\\ardeco\\items\\%1.jpg").arg(p.key))
              : id % 9 == 1 ? QVariant(QString())
                            : QVariant()},
             {QStringLiteral("PurchPrice"),
              hasPurchase ? Money(p.priceAgorot * 6 / 10) : QVariant()},
             {QStringLiteral("PurchCurrency"),
              hasPurchase ? QVariant(QStringLiteral("שח")) : QVariant()}});
    }
}

void writeItemExtraFields(CompanyWriter& writer) {
    // The same field numbers as the accounts' fields, told apart by ItemFlag.
    writer.insert(QStringLiteral("ExtraNoteNames"),
                  {{QStringLiteral("NoteID"), 1},
                   {QStringLiteral("ItemFlag"), 1},
                   {QStringLiteral("NoteName"), QStringLiteral("ספק מועדף")}});
    writer.insert(QStringLiteral("ExtraNoteNames"),
                  {{QStringLiteral("NoteID"), 2},
                   {QStringLiteral("ItemFlag"), 1},
                   {QStringLiteral("NoteName"), QStringLiteral("הוראות אחסון")}});
    writer.insert(QStringLiteral("ExtraSumNames"),
                  {{QStringLiteral("SuFID"), 1},
                   {QStringLiteral("ItemFlag"), 1},
                   {QStringLiteral("SuFName"), QStringLiteral("כמות מינימום להזמנה")}});
    writer.insert(QStringLiteral("ExtraSumNames"),
                  {{QStringLiteral("SuFID"), 2},
                   {QStringLiteral("ItemFlag"), 1},
                   {QStringLiteral("SuFName"), QStringLiteral("עלות שילוח")}});
    writer.insert(QStringLiteral("ExtraDateNames"),
                  {{QStringLiteral("DatFID"), 1},
                   {QStringLiteral("ItemFlag"), 1},
                   {QStringLiteral("DatFName"), QStringLiteral("תאריך השקה")}});
    writer.insert(QStringLiteral("ExtraDateNames"),
                  {{QStringLiteral("DatFID"), 2},
                   {QStringLiteral("ItemFlag"), 1},
                   {QStringLiteral("DatFName"), QStringLiteral("תוקף תו תקן")}});
    DemoRandom random(0xE1E1ULL);
    const QString storage[] = {QStringLiteral("לאחסן במקום יבש"), QStringLiteral("לשמור בקירור"),
                               QStringLiteral("להרחיק מאור שמש")};
    for (const Product& p : kProducts) {
        const QString key = p.key.toString();
        if (random.chance(60))
            writer.insert(QStringLiteral("ExtraNotes"),
                          {{QStringLiteral("KeF"), key},
                           {QStringLiteral("NoteID"), 2},
                           {QStringLiteral("ItemFlag"), 1},
                           {QStringLiteral("Note"), storage[random.below(3)]}});
        if (random.chance(50))
            writer.insert(QStringLiteral("ExtraSums"),
                          {{QStringLiteral("KeF"), key},
                           {QStringLiteral("SuFID"), 1},
                           {QStringLiteral("ItemFlag"), 1},
                           {QStringLiteral("SuF"), random.between(1, 20) * 12}});
        writer.insert(
            QStringLiteral("ExtraDates"),
            {{QStringLiteral("KeF"), key},
             {QStringLiteral("DatFID"), random.chance(70) ? 1 : 2},
             {QStringLiteral("ItemFlag"), 1},
             {QStringLiteral("DatF"),
              random.chance(80) ? QVariant(IsoDate(QDate(2015, 1, 1).addDays(random.below(3000))))
                                : QVariant()}});
    }
}

// Three lists, each item priced anew on some of three dates; the view keeps
// the latest price of each list.
void writePriceLists(CompanyWriter& writer) {
    const QString names[] = {QStringLiteral("מחירון קמעונאי"), QStringLiteral("מחירון סיטונאי"),
                             QStringLiteral("מחירון ייצוא")};
    for (int i = 0; i < 3; ++i)
        writer.insert(
            QStringLiteral("PriceListNames"),
            {{QStringLiteral("PriceListID"), i + 1}, {QStringLiteral("PriceListName"), names[i]}});
    const QDate dates[] = {QDate(2022, 1, 1), QDate(2023, 7, 1), QDate(2025, 1, 1)};
    DemoRandom random(0x9A1CULL);
    for (const Product& p : kProducts) {
        for (int list = 1; list <= 3; ++list) {
            if (list == 3 && random.chance(50))
                continue;
            qint64 price = list == 2 ? p.priceAgorot * 85 / 100 : p.priceAgorot;
            const bool dollars = list == 3;
            if (dollars)
                price = price * 10000 / kCurrencies[1].rateE4;
            for (const QDate& date : dates) {
                if (date != dates[2] && random.chance(40))
                    continue;
                // Now and then a price was withdrawn and left empty.
                const bool empty = date == dates[2] && random.chance(5);
                writer.insert(QStringLiteral("PriceLists"),
                              {{QStringLiteral("PriceListNumber"), list},
                               {QStringLiteral("ItemKey"), p.key.toString()},
                               {QStringLiteral("PriceDate"), IsoDate(date)},
                               {QStringLiteral("Price"), empty ? QVariant() : Money(price)},
                               {QStringLiteral("CurrencyCode"),
                                dollars ? QStringLiteral("$") : QStringLiteral("שח")}});
                price = price * 105 / 100;
            }
        }
    }
}

void writeSpecialPrices(CompanyWriter& writer, const QStringList& customers) {
    DemoRandom random(0x5BECULL);
    int id = 0;
    int moveId = 0;
    for (int i = 0; i < 45; ++i) {
        const QString& account =
            i < 4 ? customers.first() : customers[random.below(static_cast<int>(customers.size()))];
        const Product& p = kProducts[i < 4 ? i * 3 : random.below(std::size(kProducts))];
        writer.insert(
            QStringLiteral("SpecialPrices"),
            {{QStringLiteral("ID"), ++id},
             {QStringLiteral("AccountKey"), account},
             {QStringLiteral("ItemKey"), p.key.toString()},
             {QStringLiteral("ValidDate"), IsoDate(QDate(2024, 1, 1).addDays(random.below(900)))}});
        const qint64 price = p.priceAgorot * random.between(70, 95) / 100;
        writer.insert(QStringLiteral("SpecialPricesMoves"),
                      {{QStringLiteral("ID"), ++moveId},
                       {QStringLiteral("SPID"), id},
                       {QStringLiteral("MinQuantity"), 0},
                       {QStringLiteral("Price"), i % 15 == 14 ? QVariant() : Money(price)},
                       {QStringLiteral("CurrencyCode"), QStringLiteral("שח")}});
        if (random.chance(40))
            writer.insert(QStringLiteral("SpecialPricesMoves"),
                          {{QStringLiteral("ID"), ++moveId},
                           {QStringLiteral("SPID"), id},
                           {QStringLiteral("MinQuantity"), 10 * random.between(1, 10)},
                           {QStringLiteral("Price"), Money(price * 9 / 10)},
                           {QStringLiteral("CurrencyCode"), QStringLiteral("שח")}});
    }
}

void writeAlterKeys(CompanyWriter& writer, const QStringList& customers) {
    DemoRandom random(0xA17EULL);
    for (int i = 0; i < 40; ++i) {
        const QString& account =
            i < 3 ? customers.first() : customers[random.below(static_cast<int>(customers.size()))];
        const Product& p = kProducts[i < 3 ? i : random.below(std::size(kProducts))];
        const int def = random.below(3);
        writer.insert(QStringLiteral("AlterKeys"),
                      {{QStringLiteral("ID"), i + 1},
                       {QStringLiteral("ItemKey"), p.key.toString()},
                       {QStringLiteral("AccountKey"), account},
                       {QStringLiteral("AlterKey"),
                        i % 13 == 12 ? QVariant()
                                     : QVariant(QStringLiteral("C%1-%2").arg(account).arg(
                                           random.between(100, 999)))},
                       {QStringLiteral("Def"), def == 2 ? QVariant() : QVariant(def)}});
    }
}

void writeAlternativeItems(CompanyWriter& writer) {
    const QStringView pairs[][2] = {
        {u"P1001", u"P1002"}, {u"P1001", u"P1004"}, {u"P1002", u"P1001"}, {u"P1003", u"P1004"},
        {u"P1005", u"P1015"}, {u"P1007", u"P1008"}, {u"P1009", u"P1010"}, {u"P1010", u"P1009"},
        {u"P1012", u"P1013"}, {u"P1016", u"P1018"}, {u"P1017", u"P1018"}, {u"P1022", u"P1023"},
        {u"P1023", u"P1022"}, {u"P1024", u"P1025"}, {u"P1027", u"P1028"}};
    int id = 0;
    for (const auto& pair : pairs) {
        ++id;
        writer.insert(QStringLiteral("AlternativeItems"),
                      {{QStringLiteral("ID"), id},
                       {QStringLiteral("ItemKey"), pair[0].toString()},
                       {QStringLiteral("AlterItem"), pair[1].toString()},
                       {QStringLiteral("Priority"), id % 3 + 1}});
    }
}

void writeTrees(CompanyWriter& writer) {
    const std::pair<int, QStringView> types[] = {
        {1, u"עץ ייצור"}, {2, u"מארז מכירה"}, {3, u"עץ אריזה"}};
    for (const auto& [type, name] : types)
        writer.insert(QStringLiteral("TreeTypes"),
                      {{QStringLiteral("TreeType"), type},
                       {QStringLiteral("TreeTypeName"), name.toString()}});
    struct Part {
        QStringView parent;
        QStringView component;
        int type;
        int level;
        int quantityE3;
        int sonQuantE3;
    };
    const Part parts[] = {
        {u"SAL-01", u"P1001", 2, 1, 1000, 1000},    {u"SAL-01", u"P1014", 2, 1, 1000, 2000},
        {u"SAL-01", u"P1017", 2, 1, 1000, 1000},    {u"SAL-01", u"P1030", 3, 1, 1000, 1000},
        {u"SAL-01", u"P1031", 3, 1, 1000, 1500},    {u"SAL-02", u"P1009", 2, 1, 1000, 1000},
        {u"SAL-02", u"P1015", 2, 1, 1000, 1000},    {u"SAL-02", u"P1020", 2, 1, 1000, 2000},
        {u"SAL-02", u"P1024", 2, 1, 1000, 1000},    {u"SAL-02", u"P1032", 3, 1, 1000, 1000},
        {u"SAL-02", u"P1031", 3, 2, 1000, 2000},    {u"SAL-03", u"P1020", 1, 1, 1000, 1000},
        {u"SAL-03", u"P1016", 1, 1, 1000, 3000},    {u"SAL-03", u"P1032", 3, 1, 1000, 1000},
        {u"Exp-100", u"P1015", 1, 1, 12000, 12000}, {u"Exp-100", u"P1024", 1, 1, 12000, 6000},
        {u"Exp-100", u"P1032", 3, 1, 12000, 12250}};
    int id = 0;
    for (const Part& p : parts)
        writer.insert(QStringLiteral("Trees"),
                      {{QStringLiteral("ID"), ++id},
                       {QStringLiteral("TreeType"), p.type},
                       {QStringLiteral("ParentKey"), p.parent.toString()},
                       {QStringLiteral("ItemKey"), p.component.toString()},
                       {QStringLiteral("LeveF"), p.level},
                       {QStringLiteral("Quantity"), p.quantityE3 / 1000.0},
                       {QStringLiteral("SonQuant"), p.sonQuantE3 / 1000.0}});
}

} // namespace

void WriteCatalog(CompanyWriter& writer, const QList<PlannedAccount>& accounts) {
    QStringList customers;
    for (const PlannedAccount& a : accounts) {
        if (a.kind == AccountKind::Customer)
            customers.append(a.key);
    }
    writeItems(writer);
    writeItemExtraFields(writer);
    writePriceLists(writer);
    writeSpecialPrices(writer, customers);
    writeAlterKeys(writer, customers);
    writeAlternativeItems(writer);
    writeTrees(writer);
}

} // namespace ardcard::demo::detail
