#pragma once

#include <QStringView>

// Words the demo companies are made of.
namespace ardcard::demo::detail::words {

inline constexpr QStringView kFirstNames[] = {
    u"דוד",  u"משה",  u"יוסף",  u"אברהם", u"יעקב", u"שרה",  u"רחל",  u"לאה",   u"מרים", u"אסתר",
    u"אורי", u"נועה", u"תמר",   u"איתי",  u"יעל",  u"עומר", u"מיכל", u"רונית", u"אלון", u"גלית",
    u"חיים", u"שלמה", u"אילנה", u"ענת",   u"עמית", u"שירן", u"בני",  u"צביקה", u"רינה", u"זיוה"};

inline constexpr QStringView kLastNames[] = {
    u"כהן",    u"לוי",     u"מזרחי",     u"פרץ",  u"ביטון", u"דהן",  u"אברהמי",
    u"פרידמן", u"אזולאי",  u"מלכה",      u"גבאי", u"שפירא", u"קצב",  u"חדד",
    u"אוחיון", u"רוזנברג", u"גולדשטיין", u"שטרן", u"ברק",   u"נחום", u"סויסה",
    u"בן דוד", u"עמר",     u"וקנין",     u"טל",   u"קליין", u"יוסף", u"אשכנזי"};

inline constexpr QStringView kBusinessKinds[] = {
    u"סחר בע\"מ", u"שיווק והפצה",  u"ובניו", u"יבוא ויצוא",   u"אחזקות בע\"מ",
    u"מסחר כללי", u"שירותי הסעדה", u"ושות'", u"תעשיות בע\"מ", u"מוצרי מזון"};

inline constexpr QStringView kShopKinds[] = {u"מכולת",    u"סופר",    u"מעדניית", u"קיוסק",
                                             u"מינימרקט", u"בית קפה", u"מאפיית",  u"פיצריית"};

inline constexpr QStringView kShopPlaces[] = {u"השכונה", u"הגליל", u"המושבה", u"הכרמל", u"הנגב",
                                              u"העמק",   u"הים",   u"השרון",  u"הבירה", u"התחנה"};

inline constexpr QStringView kStreets[] = {
    u"הרצל",    u"ז'בוטינסקי", u"ויצמן",   u"בן גוריון", u"רוטשילד", u"אלנבי",     u"הנביאים",
    u"יפו",     u"העצמאות",    u"הגפן",    u"התאנה",     u"הזית",    u"דרך השלום", u"הנשיא",
    u"סוקולוב", u"ביאליק",     u"אחד העם", u"החרושת",    u"המלאכה",  u"הברזל"};

struct City {
    QStringView name;
    QStringView zipPrefix;
    QStringView district;
    QStringView phonePrefix;
};

inline constexpr City kCities[] = {
    {u"תל אביב", u"61", u"מרכז", u"03"},     {u"ירושלים", u"91", u"ירושלים", u"02"},
    {u"חיפה", u"31", u"צפון", u"04"},        {u"באר שבע", u"84", u"דרום", u"08"},
    {u"ראשון לציון", u"75", u"מרכז", u"03"}, {u"פתח תקווה", u"49", u"מרכז", u"03"},
    {u"נתניה", u"42", u"שרון", u"09"},       {u"אשדוד", u"77", u"דרום", u"08"},
    {u"חולון", u"58", u"מרכז", u"03"},       {u"כפר סבא", u"44", u"שרון", u"09"},
    {u"נצרת", u"16", u"צפון", u"04"},        {u"אילת", u"88", u"דרום", u"08"},
    {u"רחובות", u"76", u"מרכז", u"08"},      {u"טבריה", u"14", u"צפון", u"04"},
    {u"מודיעין", u"71", u"מרכז", u"08"},     {u"קריית שמונה", u"11", u"צפון", u"04"}};

inline constexpr QStringView kTrades[] = {u"קמעונאות", u"סיטונאות", u"מסעדנות",     u"מלונאות",
                                          u"הסעדה",    u"מוסדות",   u"רשתות שיווק", u"ייצוא"};

inline constexpr QStringView kAccountDetails[] = {
    u"לקוח קבוע",        u"שוטף + 30",       u"שוטף + 60",    u"מזומן בלבד",
    u"משלוח בימי שלישי", u"לתאם אספקה מראש", u"הנחת כמות 5%", u"דורש תעודת משלוח חתומה"};

inline constexpr QStringView kJobTitles[] = {u"מנהל רכש",     u"מנהלת חשבונות", u"בעלים",
                                             u"מחסנאי",       u"סמנכ\"ל כספים", u"מנהל סניף",
                                             u"אחראית הזמנות"};

inline constexpr QStringView kBranches[] = {u"סניף ראשי", u"סניף צפון", u"סניף דרום",
                                            u"מחסן מרכזי"};

} // namespace ardcard::demo::detail::words
