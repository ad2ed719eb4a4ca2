#pragma once

// The two fixture companies of the server tests, written by the fixture
// writer into SQLite files. The loader copies those files into the test
// server's databases, and the tests read the same files directly, so every
// output can be compared between the two engines.

#include "common/failure.h"
#include "demo/company_writer.h"

#include <QDir>
#include <QString>
#include <QStringList>

namespace pgfixture {

// The login of the test server, and the databases (also the data-source
// names) the start script creates.
inline QString user() {
    return QStringLiteral("clerk");
}
inline QString password() {
    return QStringLiteral("Kx7-secret-Pw");
}
inline QString company1() {
    return QStringLiteral("ardco1");
}
inline QString company2() {
    return QStringLiteral("ardco2");
}
// A company database without the accounts table.
inline QString noAccounts() {
    return QStringLiteral("ardnoacc");
}

// Rows of the first company: accounts of every kind the lookup tells apart,
// three journal lines of account 1001 (plus lines the read must leave out),
// and everything the account and item pages show.
inline QStringList company1Rows() {
    return {
        QStringLiteral("INSERT INTO CompanyDefenitions (ID, CompanyName, ShortName, VatNum,"
                       " DeductNum, HiddenAccountsFilter) VALUES (1, 'חברת שרת בע\"מ', 'שרת',"
                       " '511111111', '941111111', 'SECRET')"),
        QStringLiteral("INSERT INTO AccSortNames VALUES (1, 'לקוחות')"),
        QStringLiteral("INSERT INTO AgentWarehouseNames VALUES (7, 1, 'משה הסוכן')"),
        QStringLiteral(
            "INSERT INTO Accounts (ID, AccountKey, FullName, Phone, Address, Details, Filter,"
            " Balance, Obligo, Delivery, City, Zip, Country, Agent, Dumi, SortGroup, Fax, WorF,"
            " ExFile, CustomerNote, Email) VALUES"
            " (1, '1001', 'אבי כהן', '03-1111111', 'הרצל 1', 'לקוח ותיק', '', 1234.5, 5000, 0,"
            " 'תל אביב', '61000', 'מרכז', 7, 0, 1, '03-1111112', 'מסחר', NULL, 'משלם בזמן',"
            " 'avi@example.com'),"
            " (2, '1002', 'O''Brien Ltd', '04-2222222', 'דרך הים 5', 'ספק', NULL, -250.75, 0,"
            " 1500, 'חיפה', '31000', 'צפון', 3, 0, NULL, NULL, NULL, NULL, NULL, NULL),"
            " (3, '9999', 'שורת דמה כהן', '03-9999999', 'דמה', 'דמה', '', 0, 0, 0, '', '', '',"
            " 0, 1, NULL, NULL, NULL, NULL, NULL, NULL),"
            " (4, '1004', 'חשבון סודי', '02-4444444', 'סוד 4', 'מנהלים', 'SECRET', 99, 0, 0,"
            " 'ירושלים', '91000', '', 1, 0, NULL, NULL, NULL, NULL, NULL, NULL),"
            " (5, '1005', 'דני כהן', NULL, NULL, NULL, NULL, NULL, NULL, NULL, NULL, NULL, NULL,"
            " NULL, 0, NULL, NULL, NULL, NULL, NULL, NULL),"
            " (6, '4000', 'הכנסות', '', 'כהן 4', '', '', 0, 0, 0, '', '', '', 0, 0, NULL, NULL,"
            " NULL, NULL, NULL, NULL),"
            " (7, '5000', 'קופה', '', '', '', '', 0, 0, 0, '', '', '', 0, 0, NULL, NULL, NULL,"
            " NULL, NULL, NULL)"),
        QStringLiteral("INSERT INTO Currencies VALUES (1, 'ש\"ח'), (2, '$'), (3, 'EUR')"),
        QStringLiteral(
            "INSERT INTO JurnalTrans (TransID, Type, Status, FixedID, ValueDate, DueDate, BatchNo,"
            " Referance, Ref2, Description, CostCode, TransType, CurrencyCode, TransDebID,"
            " TransCredID) VALUES"
            " (1, 0, 1, 0, '2024-01-15', '2024-02-15', 10, 501, 0, 'חשבונית 501', 'A1', 'SI',"
            " 'ש\"ח', '1001', '4000'),"
            " (2, 0, 1, 0, '2024-02-01', '2024-02-01', 11, 77, NULL, 'קבלה', NULL, 'RC', '$',"
            " '5000', '1001'),"
            " (3, 0, 1, 0, '2024-03-10', '2024-04-10', 12, 502, 9, NULL, 'B2', 'SI', 'EUR',"
            " '1001', '4000'),"
            " (4, 0, 2, 0, '2024-03-11', '2024-03-11', 13, 503, 0, 'טיוטה', '', 'SI', 'ש\"ח',"
            " '1001', '4000'),"
            " (5, 1, 1, 0, '2024-03-12', '2024-03-12', 14, 504, 0, 'סוג אחר', '', 'SI', 'ש\"ח',"
            " '1001', '4000')"),
        QStringLiteral("INSERT INTO JurnalTransMoves (ID, TransID, AccountKey, SuF, SuFDlr,"
                       " DebitCredit, FullMatch) VALUES"
                       " (1, 1, '1001', 1170, 0, 0, 0), (2, 1, '4000', 1170, 0, 1, 0),"
                       " (3, 2, '5000', 370, 100, 0, 0), (4, 2, '1001', 370, 100, 1, 3),"
                       " (5, 3, '1001', 2000.5, 500, 0, 0), (6, 3, '4000', 2000.5, 500, 1, 0),"
                       " (7, 4, '1001', 55, 0, 0, 0), (8, 5, '1001', 66, 0, 0, 0)"),
        QStringLiteral("INSERT INTO ExtraNoteNames VALUES (1, 0, 'תחביב'), (1, 1, 'הערת פריט')"),
        QStringLiteral("INSERT INTO ExtraNotes VALUES (1, '1001', 1, 0, 'שחמט'),"
                       " (2, 'P100', 1, 1, 'שביר')"),
        QStringLiteral("INSERT INTO ExtraSumNames VALUES (1, 0, 'הנחה'), (1, 1, 'עמלה')"),
        QStringLiteral("INSERT INTO ExtraSums VALUES (1, '1001', 1, 0, 12.5),"
                       " (2, 'P100', 1, 1, 3)"),
        QStringLiteral("INSERT INTO ExtraDateNames VALUES (1, 0, 'יום הולדת'), (1, 1, 'תפוגה')"),
        QStringLiteral("INSERT INTO ExtraDates VALUES (1, '1001', 1, 0, '1980-07-04'),"
                       " (2, 'P100', 1, 1, '2026-12-31')"),
        QStringLiteral(
            "INSERT INTO CRMContact (ID, AccountKey, CName, CTitle, CMail, CPhone, C2Phone,"
            " CCelular, CFax, Branch, Address, Remark, SecRemark, CStatus) VALUES"
            " (1, '1001', 'רונית כהן', 'מנהלת חשבונות', 'ronit@example.com', '03-1111113', NULL,"
            " '050-1111111', NULL, 'ראשי', 'הרצל 1', '', NULL, 1),"
            " (2, '1001', 'עזב', '', '', '', '', '', '', '', '', '', '', 0)"),
        QStringLiteral("INSERT INTO Items (ID, ItemKey, ItemName, SortGroup, Filter, ForignName,"
                       " SalesUnit, Weight, Volume, DefaultWarehouse, Localization, BarCode,"
                       " Quantity, Price, Currency, ExFile, PurchPrice, PurchCurrency) VALUES"
                       " (1, 'P100', 'כיסא משרדי', 2, '', 'Office chair', 'יחידה', 7.5, 0.25, 1,"
                       " 'A-3', '7290000000017', 12, 450, 'ש\"ח', 'chair.pdf', 300, 'ש\"ח'),"
                       " (2, 'P200', 'גלגל', 2, '', 'Wheel', 'יחידה', 0.2, 0.01, 1, 'B-1', NULL,"
                       " 100, 15, 'ש\"ח', NULL, 8, 'ש\"ח')"),
        QStringLiteral("INSERT INTO AlterKeys VALUES (1, 'P100', '1001', 'AV-CH-1', 1)"),
        QStringLiteral(
            "INSERT INTO PriceListNames VALUES (1, 'מחירון כללי'), (2, 'מחירון סיטונאי')"),
        QStringLiteral("INSERT INTO PriceLists VALUES (1, 1, 'P100', '2023-01-01', 420, 'ש\"ח'),"
                       " (2, 1, 'P100', '2024-01-01', 450, 'ש\"ח'),"
                       " (3, 2, 'P100', '2024-01-01', 390.5, 'ש\"ח')"),
        QStringLiteral("INSERT INTO SpecialPrices VALUES (1, '1001', 'P100', '2024-12-31')"),
        QStringLiteral("INSERT INTO SpecialPricesMoves VALUES (1, 1, 0, 399.9, 'ש\"ח'),"
                       " (2, 1, 10, 380, 'ש\"ח')"),
        QStringLiteral("INSERT INTO AlternativeItems VALUES (1, 'P100', 'P200', 2)"),
        QStringLiteral("INSERT INTO TreeTypes VALUES (1, 'הרכבה')"),
        QStringLiteral("INSERT INTO Trees VALUES (1, 1, 'P100', 'P200', 1, 1, 5)"),
        QStringLiteral("INSERT INTO DocumentsDef VALUES (1, 'חשבונית מס'), (3, 'קבלה'),"
                       " (5, 'הזמנה')"),
    };
}

// The second company: account 1001 again, with one journal line.
inline QStringList company2Rows() {
    return {
        QStringLiteral("INSERT INTO CompanyDefenitions (ID, CompanyName, ShortName, VatNum,"
                       " DeductNum, HiddenAccountsFilter) VALUES (1, 'חברה שניה', 'שניה', '',"
                       " NULL, '')"),
        QStringLiteral(
            "INSERT INTO Accounts (ID, AccountKey, FullName, Phone, Address, Details, Filter,"
            " Balance, Obligo, Delivery, City, Zip, Country, Agent, Dumi) VALUES"
            " (1, '1001', 'אבי כהן', '03-1111111', '', '', '', 999.99, 0, 0, '', '', '', 0, 0),"
            " (2, '6000', 'יתרות פתיחה', '', '', '', '', 0, 0, 0, '', '', '', 0, 0)"),
        QStringLiteral("INSERT INTO Currencies VALUES (1, 'ש\"ח')"),
        QStringLiteral(
            "INSERT INTO JurnalTrans (TransID, Type, Status, FixedID, ValueDate, DueDate, BatchNo,"
            " Referance, Ref2, Description, CostCode, TransType, CurrencyCode, TransDebID,"
            " TransCredID) VALUES (1, 0, 1, 0, '2024-05-05', '2024-05-05', 1, 9001, 0,"
            " 'יתרת פתיחה', 'C3', 'OB', 'ש\"ח', '1001', '6000')"),
        QStringLiteral("INSERT INTO JurnalTransMoves (ID, TransID, AccountKey, SuF, SuFDlr,"
                       " DebitCredit, FullMatch) VALUES (1, 1, '1001', 999.99, 0, 0, 0),"
                       " (2, 1, '6000', 999.99, 0, 1, 0)"),
        QStringLiteral("INSERT INTO DocumentsDef VALUES (1, 'חשבונית מס')"),
    };
}

// Writes dir/<database>.db for the three databases; throws Failure.
inline void buildSqliteCompanies(const QString& dir) {
    const auto write = [&](const QString& name, const QStringList& rows) {
        const QString path = QDir(dir).filePath(name + QStringLiteral(".db"));
        ardcard::demo::CreateCompanyFile(path);
        ardcard::demo::CompanyWriter writer(path);
        for (const QString& row : rows)
            writer.exec(row);
        writer.commit();
    };
    write(company1(), company1Rows());
    write(company2(), company2Rows());
    write(noAccounts(), {QStringLiteral("DROP TABLE Accounts")});
}

} // namespace pgfixture
