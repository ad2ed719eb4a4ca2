-- The tables of an Ardeco company database that the card and the information
-- pages read. Plain SQL that runs on SQLite as written; for PostgreSQL the
-- NOCASE collations are dropped (see schema.cpp). Keys compare without
-- regard to case, as they do in the host product's own databases, and every
-- date column is declared DATE so that readers turn its ISO text into a date.
-- A statement ends with a semicolon at the end of a line.

CREATE TABLE CompanyDefenitions (
    ID INTEGER PRIMARY KEY,
    CompanyName TEXT,
    ShortName TEXT,
    VatNum TEXT,
    DeductNum TEXT,
    HiddenAccountsFilter TEXT COLLATE NOCASE
);

CREATE TABLE AccSortNames (
    AccSortCode INTEGER PRIMARY KEY,
    SortCodeName TEXT
);

-- Sort 1 names the agents, Sort 2 the warehouses.
CREATE TABLE AgentWarehouseNames (
    NameID INTEGER NOT NULL,
    Sort INTEGER NOT NULL,
    Name TEXT,
    PRIMARY KEY (NameID, Sort)
);

CREATE TABLE Accounts (
    ID INTEGER PRIMARY KEY,
    AccountKey TEXT COLLATE NOCASE,
    FullName TEXT,
    Phone TEXT,
    Address TEXT,
    Details TEXT,
    Filter TEXT COLLATE NOCASE,
    Balance DOUBLE PRECISION,
    Obligo DOUBLE PRECISION,
    Delivery DOUBLE PRECISION,
    City TEXT,
    Zip TEXT,
    Country TEXT,
    Agent INTEGER,
    Dumi INTEGER DEFAULT 0,
    SortGroup INTEGER,
    Fax TEXT,
    WorF TEXT,
    ExFile TEXT,
    CustomerNote TEXT,
    Email TEXT
);
CREATE INDEX Accounts_AccountKey ON Accounts (AccountKey);

CREATE TABLE Currencies (
    ID INTEGER PRIMARY KEY,
    CurrencyCode TEXT COLLATE NOCASE
);
-- Journal lines find their currency by its code.
CREATE INDEX Currencies_CurrencyCode ON Currencies (CurrencyCode);

-- One row per journal transaction. TransDebID and TransCredID hold the keys
-- of its debit and credit accounts.
CREATE TABLE JurnalTrans (
    TransID INTEGER PRIMARY KEY,
    Type INTEGER DEFAULT 0,
    Status INTEGER DEFAULT 1,
    FixedID INTEGER DEFAULT 0,
    ValueDate DATE,
    DueDate DATE,
    BatchNo INTEGER,
    Referance INTEGER,
    Ref2 INTEGER,
    Description TEXT,
    CostCode TEXT,
    TransType TEXT,
    CurrencyCode TEXT COLLATE NOCASE,
    TransDebID TEXT COLLATE NOCASE,
    TransCredID TEXT COLLATE NOCASE
);

-- One row per account line of a transaction. SuF is the amount in shekels,
-- SuFDlr the amount in the transaction's currency; FullMatch is 0 while the
-- line is open and the match number once it is matched.
CREATE TABLE JurnalTransMoves (
    ID INTEGER PRIMARY KEY,
    TransID INTEGER,
    AccountKey TEXT COLLATE NOCASE,
    SuF DOUBLE PRECISION DEFAULT 0,
    SuFDlr DOUBLE PRECISION DEFAULT 0,
    DebitCredit INTEGER DEFAULT 0,
    FullMatch INTEGER DEFAULT 0
);
-- The journal read selects one account's lines and joins their transactions.
CREATE INDEX JurnalTransMoves_AccountKey ON JurnalTransMoves (AccountKey);
CREATE INDEX JurnalTransMoves_TransID ON JurnalTransMoves (TransID);

-- User-defined fields of accounts (ItemFlag 0) and items (ItemFlag 1); KeF
-- holds the account or item key.
CREATE TABLE ExtraNoteNames (
    NoteID INTEGER NOT NULL,
    ItemFlag INTEGER NOT NULL,
    NoteName TEXT,
    PRIMARY KEY (NoteID, ItemFlag)
);
CREATE TABLE ExtraNotes (
    ID INTEGER PRIMARY KEY,
    KeF TEXT COLLATE NOCASE,
    NoteID INTEGER NOT NULL,
    ItemFlag INTEGER NOT NULL,
    Note TEXT
);
CREATE TABLE ExtraSumNames (
    SuFID INTEGER NOT NULL,
    ItemFlag INTEGER NOT NULL,
    SuFName TEXT,
    PRIMARY KEY (SuFID, ItemFlag)
);
CREATE TABLE ExtraSums (
    ID INTEGER PRIMARY KEY,
    KeF TEXT COLLATE NOCASE,
    SuFID INTEGER NOT NULL,
    ItemFlag INTEGER NOT NULL,
    SuF DOUBLE PRECISION
);
CREATE TABLE ExtraDateNames (
    DatFID INTEGER NOT NULL,
    ItemFlag INTEGER NOT NULL,
    DatFName TEXT,
    PRIMARY KEY (DatFID, ItemFlag)
);
CREATE TABLE ExtraDates (
    ID INTEGER PRIMARY KEY,
    KeF TEXT COLLATE NOCASE,
    DatFID INTEGER NOT NULL,
    ItemFlag INTEGER NOT NULL,
    DatF DATE
);

-- Contact persons of an account; CStatus 1 marks the active ones.
CREATE TABLE CRMContact (
    ID INTEGER PRIMARY KEY,
    AccountKey TEXT COLLATE NOCASE,
    CName TEXT,
    CTitle TEXT,
    CMail TEXT,
    CPhone TEXT,
    C2Phone TEXT,
    CCelular TEXT,
    CFax TEXT,
    Branch TEXT,
    Address TEXT,
    Remark TEXT,
    SecRemark TEXT,
    CStatus INTEGER DEFAULT 1
);

CREATE TABLE Items (
    ID INTEGER PRIMARY KEY,
    ItemKey TEXT COLLATE NOCASE,
    ItemName TEXT,
    SortGroup INTEGER,
    Filter TEXT COLLATE NOCASE,
    ForignName TEXT,
    SalesUnit TEXT,
    Weight DOUBLE PRECISION,
    Volume DOUBLE PRECISION,
    DefaultWarehouse INTEGER,
    Localization TEXT,
    BarCode TEXT,
    Quantity DOUBLE PRECISION,
    Price DOUBLE PRECISION,
    Currency TEXT COLLATE NOCASE,
    ExFile TEXT,
    PurchPrice DOUBLE PRECISION,
    PurchCurrency TEXT COLLATE NOCASE
);
CREATE INDEX Items_ItemKey ON Items (ItemKey);

-- The key an account uses for one of our items; Def 1 marks its default.
CREATE TABLE AlterKeys (
    ID INTEGER PRIMARY KEY,
    ItemKey TEXT COLLATE NOCASE,
    AccountKey TEXT COLLATE NOCASE,
    AlterKey TEXT COLLATE NOCASE,
    Def INTEGER
);

CREATE TABLE PriceListNames (
    PriceListID INTEGER PRIMARY KEY,
    PriceListName TEXT
);

-- Every price an item was given in a price list, by the date it took effect.
CREATE TABLE PriceLists (
    ID INTEGER PRIMARY KEY,
    PriceListNumber INTEGER,
    ItemKey TEXT COLLATE NOCASE,
    PriceDate DATE,
    Price DOUBLE PRECISION,
    CurrencyCode TEXT COLLATE NOCASE
);
CREATE INDEX PriceLists_ItemKey ON PriceLists (ItemKey, PriceListNumber);

-- The price in force in each list for each item: the one of the latest date.
CREATE VIEW PriceListsLastDateWithSub AS
SELECT P.PriceListNumber, P.ItemKey, P.PriceDate, P.Price, P.CurrencyCode
FROM PriceLists P
WHERE P.PriceDate = (SELECT Max(L.PriceDate) FROM PriceLists L
                     WHERE L.PriceListNumber = P.PriceListNumber AND L.ItemKey = P.ItemKey);

-- A special price of an item for an account, with one price per minimum
-- quantity in SpecialPricesMoves.
CREATE TABLE SpecialPrices (
    ID INTEGER PRIMARY KEY,
    AccountKey TEXT COLLATE NOCASE,
    ItemKey TEXT COLLATE NOCASE,
    ValidDate DATE
);
CREATE TABLE SpecialPricesMoves (
    ID INTEGER PRIMARY KEY,
    SPID INTEGER,
    MinQuantity DOUBLE PRECISION DEFAULT 0,
    Price DOUBLE PRECISION,
    CurrencyCode TEXT COLLATE NOCASE
);

CREATE TABLE AlternativeItems (
    ID INTEGER PRIMARY KEY,
    ItemKey TEXT COLLATE NOCASE,
    AlterItem TEXT COLLATE NOCASE,
    Priority INTEGER
);

-- Bills of materials: the components (ItemKey) of a parent item, LeveF 1 for
-- the first level.
CREATE TABLE TreeTypes (
    TreeType INTEGER PRIMARY KEY,
    TreeTypeName TEXT
);
CREATE TABLE Trees (
    ID INTEGER PRIMARY KEY,
    TreeType INTEGER,
    ParentKey TEXT COLLATE NOCASE,
    ItemKey TEXT COLLATE NOCASE,
    LeveF INTEGER DEFAULT 1,
    Quantity DOUBLE PRECISION,
    SonQuant DOUBLE PRECISION
);

CREATE TABLE DocumentsDef (
    DocumentID INTEGER PRIMARY KEY,
    DocName TEXT
);
