-- The company file of the information-page tests: one account with every
-- section, one with none, one whose key and texts hold markup and
-- apostrophes; items with and without price lists; document types.
CREATE TABLE Accounts (ID INTEGER, AccountKey TEXT COLLATE NOCASE, FullName TEXT, Filter TEXT,
  SortGroup INTEGER, Agent INTEGER, Address TEXT, City TEXT, Zip TEXT, Country TEXT, Phone TEXT,
  Fax TEXT, WorF TEXT, ExFile TEXT, Details TEXT, CustomerNote TEXT, Email TEXT);
INSERT INTO Accounts VALUES (1, '1001', 'משה כהן', 'א', 100, 7, 'הרצל 5', 'תל אביב', '61000',
  'ישראל', '03-5551234', '03-5551235', 'מסחר', 'C:\docs\1001.pdf', 'לקוח ותיק', '',
  'moshe@example.com');
INSERT INTO Accounts VALUES (2, '2002', 'חנות הפינה', NULL, 200, NULL, NULL, 'חיפה', NULL, NULL,
  '04-8000000', NULL, NULL, '', NULL, NULL, NULL);
INSERT INTO Accounts VALUES (3, '3003', 'יעל ברק', NULL, NULL, NULL, NULL, NULL, NULL, NULL,
  NULL, NULL, NULL, NULL, NULL, NULL, NULL);
INSERT INTO Accounts VALUES (4, 'AB''12', '<b>x</b> & y', NULL, NULL, NULL, NULL, NULL, NULL,
  NULL, NULL, NULL, NULL, 'C:\a''b\"c.txt', 'O''Brien', NULL, NULL);
CREATE TABLE AccSortNames (AccSortCode INTEGER, SortCodeName TEXT);
INSERT INTO AccSortNames VALUES (100, 'לקוחות');
CREATE TABLE AgentWarehouseNames (NameID INTEGER, Sort INTEGER, Name TEXT);
INSERT INTO AgentWarehouseNames VALUES (7, 2, 'מחסן ראשי');
INSERT INTO AgentWarehouseNames VALUES (7, 1, 'דוד');
CREATE TABLE ExtraNoteNames (NoteID INTEGER, NoteName TEXT, ItemFlag INTEGER);
INSERT INTO ExtraNoteNames VALUES (1, 'הערת גבייה', 0);
INSERT INTO ExtraNoteNames VALUES (2, 'איש מכירות', 0);
INSERT INTO ExtraNoteNames VALUES (3, 'צבע', 1);
INSERT INTO ExtraNoteNames VALUES (6, '<u>הערה</u>', 0);
CREATE TABLE ExtraNotes (NoteID INTEGER, KeF TEXT, Note TEXT, ItemFlag INTEGER);
INSERT INTO ExtraNotes VALUES (1, '1001', 'לשלם בשיקים', 0);
INSERT INTO ExtraNotes VALUES (2, '1001', 'יוסי', 0);
INSERT INTO ExtraNotes VALUES (3, 'A100', 'שחור', 1);
INSERT INTO ExtraNotes VALUES (1, 'A100', 'של חשבון', 0);
INSERT INTO ExtraNotes VALUES (6, 'AB''12', 'a & b', 0);
CREATE TABLE ExtraSumNames (SuFID INTEGER, SuFName TEXT, ItemFlag INTEGER);
INSERT INTO ExtraSumNames VALUES (1, 'מסגרת אשראי', 0);
INSERT INTO ExtraSumNames VALUES (4, 'עמלה', 1);
CREATE TABLE ExtraSums (SuFID INTEGER, KeF TEXT, SuF REAL, ItemFlag INTEGER);
INSERT INTO ExtraSums VALUES (1, '1001', 5000, 0);
INSERT INTO ExtraSums VALUES (4, 'A100', 2.5, 1);
CREATE TABLE ExtraDateNames (DatFID INTEGER, DatFName TEXT, ItemFlag INTEGER);
INSERT INTO ExtraDateNames VALUES (1, 'תאריך פתיחה', 0);
INSERT INTO ExtraDateNames VALUES (2, 'תאריך סגירה', 0);
INSERT INTO ExtraDateNames VALUES (5, 'תאריך קליטה', 1);
CREATE TABLE ExtraDates (DatFID INTEGER, KeF TEXT, DatF DATE, ItemFlag INTEGER);
INSERT INTO ExtraDates VALUES (1, '1001', '2019-02-03', 0);
INSERT INTO ExtraDates VALUES (2, '1001', NULL, 0);
INSERT INTO ExtraDates VALUES (5, 'A100', '2023-12-31', 1);
CREATE TABLE CRMContact (ID INTEGER, AccountKey TEXT, CName TEXT, CTitle TEXT, CMail TEXT,
  CPhone TEXT, C2Phone TEXT, CCelular TEXT, CFax TEXT, Branch TEXT, Address TEXT, Remark TEXT,
  SecRemark TEXT, CStatus INTEGER);
INSERT INTO CRMContact VALUES (3, '1001', 'אבי', NULL, NULL, '03-2222222', NULL, NULL, NULL,
  NULL, NULL, NULL, NULL, 1);
INSERT INTO CRMContact VALUES (1, '1001', 'רינה לוי', 'מנהלת חשבונות', 'rina@example.com',
  '03-1111111', NULL, '050-1234567', '', 'מרכז', 'הרצל 5', 'בימים א-ה', NULL, 1);
INSERT INTO CRMContact VALUES (2, '1001', 'עזב', NULL, NULL, NULL, NULL, NULL, NULL, NULL, NULL,
  NULL, NULL, 0);
INSERT INTO CRMContact VALUES (5, '2002', 'לשעבר', NULL, NULL, NULL, NULL, NULL, NULL, NULL,
  NULL, NULL, NULL, 2);
INSERT INTO CRMContact VALUES (4, 'AB''12', '<i>דנה</i>', NULL, NULL, NULL, NULL, NULL, NULL,
  NULL, NULL, NULL, NULL, 1);
CREATE TABLE Items (ID INTEGER, ItemKey TEXT, ItemName TEXT, SortGroup INTEGER, Filter TEXT,
  ForignName TEXT, SalesUnit TEXT, Weight REAL, Volume REAL, DefaultWarehouse INTEGER,
  Localization TEXT, BarCode TEXT, Quantity REAL, Price REAL, Currency TEXT, ExFile TEXT,
  PurchPrice REAL, PurchCurrency TEXT);
INSERT INTO Items VALUES (501, 'A100', 'כיסא משרדי', 10, 'ריהוט', 'Office chair', 'יח', 7.5,
  0.25, 1, 'מדף 3', '7290000000017', 42, 1234.5, 'ש"ח', '', 800, '$');
INSERT INTO Items VALUES (502, 'B200', 'שולחן', NULL, NULL, NULL, NULL, NULL, NULL, NULL, NULL,
  NULL, NULL, NULL, NULL, NULL, NULL, NULL);
INSERT INTO Items VALUES (503, 'C300', 'כיסא אורח', NULL, NULL, NULL, NULL, NULL, NULL, NULL,
  NULL, NULL, NULL, NULL, NULL, NULL, NULL, NULL);
INSERT INTO Items (ID, ItemKey, ItemName) VALUES (511, 'P1', 'רגל');
INSERT INTO Items (ID, ItemKey, ItemName) VALUES (512, 'P2', 'מושב');
INSERT INTO Items (ID, ItemKey, ItemName) VALUES (513, 'P3', 'קרטון');
INSERT INTO Items (ID, ItemKey, ItemName) VALUES (514, 'P4', 'בורג');
CREATE TABLE AlterKeys (ItemKey TEXT, AccountKey TEXT, AlterKey TEXT, Def INTEGER);
INSERT INTO AlterKeys VALUES ('B200', '1001', 'TB-2', 0);
INSERT INTO AlterKeys VALUES ('A100', '1001', 'CH-1', 1);
INSERT INTO AlterKeys VALUES ('B200', '1001', NULL, 1);
INSERT INTO AlterKeys VALUES ('A100', '3003', 'Y-77', NULL);
CREATE TABLE SpecialPrices (ID INTEGER, AccountKey TEXT, ItemKey TEXT, ValidDate DATE);
INSERT INTO SpecialPrices VALUES (1, '1001', 'A100', '2024-01-01');
INSERT INTO SpecialPrices VALUES (2, '1001', 'B200', '2024-01-01');
INSERT INTO SpecialPrices VALUES (3, '3003', 'A100', NULL);
CREATE TABLE SpecialPricesMoves (SPID INTEGER, MinQuantity REAL, Price REAL, CurrencyCode TEXT);
INSERT INTO SpecialPricesMoves VALUES (1, 0, 99, 'ש"ח');
INSERT INTO SpecialPricesMoves VALUES (1, 10, 90, 'ש"ח');
INSERT INTO SpecialPricesMoves VALUES (2, 0, 1234.5, '$');
INSERT INTO SpecialPricesMoves VALUES (3, 0, 95.5, 'ש"ח');
CREATE TABLE PriceListNames (PriceListID INTEGER, PriceListName TEXT);
INSERT INTO PriceListNames VALUES (1, 'מחירון לקוחות');
INSERT INTO PriceListNames VALUES (2, 'מחירון סיטונאי');
INSERT INTO PriceListNames VALUES (3, 'ישן');
CREATE TABLE PriceListsLastDateWithSub (PriceListNumber INTEGER, ItemKey TEXT, Price REAL,
  CurrencyCode TEXT);
INSERT INTO PriceListsLastDateWithSub VALUES (2, 'A100', 1100, 'ש"ח');
INSERT INTO PriceListsLastDateWithSub VALUES (1, 'A100', 1234.5, 'ש"ח');
INSERT INTO PriceListsLastDateWithSub VALUES (2, 'A100', 1100, 'ש"ח');
INSERT INTO PriceListsLastDateWithSub VALUES (3, 'A100', NULL, 'ש"ח');
CREATE TABLE AlternativeItems (ItemKey TEXT, AlterItem TEXT, Priority INTEGER);
INSERT INTO AlternativeItems VALUES ('A100', 'C300', 5);
INSERT INTO AlternativeItems VALUES ('A100', 'B200', 1);
CREATE TABLE TreeTypes (TreeType INTEGER, TreeTypeName TEXT);
INSERT INTO TreeTypes VALUES (2, 'הרכבה');
INSERT INTO TreeTypes VALUES (3, 'אריזה');
CREATE TABLE Trees (ParentKey TEXT, ItemKey TEXT, LeveF INTEGER, TreeType INTEGER, Quantity REAL,
  SonQuant REAL);
INSERT INTO Trees VALUES ('A100', 'P3', 1, 3, 1, NULL);
INSERT INTO Trees VALUES ('A100', 'P1', 1, 2, 1, 4);
INSERT INTO Trees VALUES ('A100', 'P4', 2, 2, 1, 1);
INSERT INTO Trees VALUES ('A100', 'P2', 1, 2, 1, 2);
CREATE TABLE DocumentsDef (DocumentID INTEGER, DocName TEXT);
INSERT INTO DocumentsDef VALUES (1, 'חשבונית מס');
INSERT INTO DocumentsDef VALUES (0, 'פנימי');
INSERT INTO DocumentsDef VALUES (5, NULL);
INSERT INTO DocumentsDef VALUES (12, 'קבלה');
