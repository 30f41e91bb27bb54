-- The company database for SQLite.
--
-- The declared types are what the portal reads its fields as: INTEGER, REAL, MONEY (an amount with
-- up to four decimals), BIT, DATE and DATETIME (ISO text: 'yyyy-mm-dd', 'yyyy-mm-dd hh:mm:ss') and
-- NVARCHAR. ID is every table's key. A column IDX is the link X, and its REFERENCES clause says
-- where it leads. Texts that people search or log on by ignore case.

-- Companies, people and users

CREATE TABLE EREmployee (
    ID INTEGER PRIMARY KEY,
    Name NVARCHAR(100) NOT NULL COLLATE NOCASE,
    Phone NVARCHAR(30),
    Email NVARCHAR(100)
);

CREATE TABLE GRCompanyPriceCat (
    ID INTEGER PRIMARY KEY,
    Name NVARCHAR(50) NOT NULL COLLATE NOCASE UNIQUE
);

CREATE TABLE GRPriceList (
    ID INTEGER PRIMARY KEY,
    Name NVARCHAR(50) NOT NULL COLLATE NOCASE UNIQUE,
    Currency NVARCHAR(3) NOT NULL DEFAULT 'EUR',
    -- When set, the lines of that list count for this one, and its own lines do not.
    IDSrcPriceList INTEGER REFERENCES GRPriceList(ID) CHECK (IDSrcPriceList <> ID),
    -- The list of orders and customers that name none.
    IsDefault BIT NOT NULL DEFAULT 0
);

CREATE TABLE GRCompany (
    ID INTEGER PRIMARY KEY,
    Code NVARCHAR(20) NOT NULL COLLATE NOCASE UNIQUE,
    Name NVARCHAR(100) NOT NULL COLLATE NOCASE,
    RegCode NVARCHAR(20),
    TaxCode NVARCHAR(20),
    Address NVARCHAR(200),
    City NVARCHAR(60),
    PostCode NVARCHAR(10),
    Country NVARCHAR(2) NOT NULL DEFAULT 'EE',
    Phone NVARCHAR(30),
    Email NVARCHAR(100),
    -- Per cent on every price; negative is a discount.
    PriceCut REAL NOT NULL DEFAULT 0,
    OrdersAllowed BIT NOT NULL DEFAULT 1,
    -- Days from an invoice's date to its due date.
    PaymentDays INTEGER NOT NULL DEFAULT 14 CHECK (PaymentDays >= 0),
    IDGRPriceList INTEGER REFERENCES GRPriceList(ID),
    -- Who pays, when it is not the company itself.
    IDSettlCompany INTEGER REFERENCES GRCompany(ID),
    IDParent INTEGER REFERENCES GRCompany(ID),
    IDGRCompanyPriceCat INTEGER REFERENCES GRCompanyPriceCat(ID),
    IDEREmployee INTEGER REFERENCES EREmployee(ID)
);
CREATE INDEX GRCompany_Name ON GRCompany(Name);
CREATE INDEX GRCompany_Parent ON GRCompany(IDParent);
CREATE INDEX GRCompany_SettlCompany ON GRCompany(IDSettlCompany);

CREATE TABLE GRCompContPerson (
    ID INTEGER PRIMARY KEY,
    IDGRCompany INTEGER NOT NULL REFERENCES GRCompany(ID),
    Name NVARCHAR(100) NOT NULL COLLATE NOCASE,
    Position NVARCHAR(60),
    Phone NVARCHAR(30),
    Email NVARCHAR(100)
);
CREATE INDEX GRCompContPerson_Company ON GRCompContPerson(IDGRCompany);

CREATE TABLE SYUser (
    ID INTEGER PRIMARY KEY,
    Name NVARCHAR(50) NOT NULL COLLATE NOCASE UNIQUE,
    -- argon2id in its text form. NULL: nobody logs on by this name with a password.
    PasswordHash NVARCHAR(128),
    DisplayName NVARCHAR(100),
    IDPartner INTEGER REFERENCES GRCompany(ID),
    IDGRCompContPerson INTEGER REFERENCES GRCompContPerson(ID),
    Guest BIT NOT NULL DEFAULT 0,
    Disabled BIT NOT NULL DEFAULT 0
);
CREATE INDEX SYUser_Partner ON SYUser(IDPartner);

-- Articles and prices

CREATE TABLE GRTax (
    ID INTEGER PRIMARY KEY,
    Name NVARCHAR(50) NOT NULL,
    TaxPercent REAL NOT NULL CHECK (TaxPercent >= 0)
);

CREATE TABLE GRArticlePriceCat (
    ID INTEGER PRIMARY KEY,
    Name NVARCHAR(50) NOT NULL COLLATE NOCASE UNIQUE
);

CREATE TABLE GRArticle (
    ID INTEGER PRIMARY KEY,
    Code NVARCHAR(40) NOT NULL COLLATE NOCASE UNIQUE,
    Name NVARCHAR(150) NOT NULL COLLATE NOCASE,
    Unit NVARCHAR(10) NOT NULL DEFAULT 'tk',
    PackQuantity REAL NOT NULL DEFAULT 1 CHECK (PackQuantity > 0),
    Barcode NVARCHAR(20) COLLATE NOCASE,
    Explanation NVARCHAR(1000),
    Stock REAL NOT NULL DEFAULT 0,
    IDGRTax INTEGER NOT NULL REFERENCES GRTax(ID),
    IDGRArticlePriceCat INTEGER REFERENCES GRArticlePriceCat(ID)
);
CREATE INDEX GRArticle_Name ON GRArticle(Name);
CREATE INDEX GRArticle_Barcode ON GRArticle(Barcode);
CREATE INDEX GRArticle_PriceCat ON GRArticle(IDGRArticlePriceCat);

CREATE TABLE GRArticleCat (
    ID INTEGER PRIMARY KEY,
    Name NVARCHAR(80) NOT NULL COLLATE NOCASE,
    -- The group of categories, which option lists may be limited to.
    Category NVARCHAR(30) COLLATE NOCASE
);

CREATE TABLE GRArticleCatRel (
    ID INTEGER PRIMARY KEY,
    IDGRArticle INTEGER NOT NULL REFERENCES GRArticle(ID),
    IDGRArticleCat INTEGER NOT NULL REFERENCES GRArticleCat(ID)
);
CREATE UNIQUE INDEX GRArticleCatRel_Cat ON GRArticleCatRel(IDGRArticleCat, IDGRArticle);
CREATE INDEX GRArticleCatRel_Article ON GRArticleCatRel(IDGRArticle, IDGRArticleCat);

CREATE TABLE GRPriceListRel (
    ID INTEGER PRIMARY KEY,
    IDGRPriceList INTEGER NOT NULL REFERENCES GRPriceList(ID),
    IDGRArticle INTEGER NOT NULL REFERENCES GRArticle(ID),
    -- 0: not priced.
    Price MONEY NOT NULL CHECK (Price >= 0)
);
CREATE UNIQUE INDEX GRPriceListRel_List ON GRPriceListRel(IDGRPriceList, IDGRArticle);
-- With the price, so that the prices of some articles are read without the lines themselves.
CREATE INDEX GRPriceListRel_Article ON GRPriceListRel(IDGRArticle, IDGRPriceList, Price);

-- What a company price category pays for an article price category, in per cent on the list price.
CREATE TABLE GRPriceCatRel (
    ID INTEGER PRIMARY KEY,
    IDGRCompanyPriceCat INTEGER NOT NULL REFERENCES GRCompanyPriceCat(ID),
    IDGRArticlePriceCat INTEGER NOT NULL REFERENCES GRArticlePriceCat(ID),
    -- The list where the price lines stand.
    IDGRPriceList INTEGER NOT NULL REFERENCES GRPriceList(ID),
    PriceCut REAL NOT NULL CHECK (PriceCut >= -100)
);
CREATE UNIQUE INDEX GRPriceCatRel_Cats
    ON GRPriceCatRel(IDGRCompanyPriceCat, IDGRArticlePriceCat, IDGRPriceList);

-- Documents. An order, a delivery note and an invoice share the key of their GDocument.

CREATE TABLE GDocument (
    ID INTEGER PRIMARY KEY,
    -- The table of the document: SDOrder, SDConsignmD or SDInvoice.
    Kind NVARCHAR(20) NOT NULL,
    -- Made with the document before it is stored, so that storing it again is noticed.
    DocKey NVARCHAR(32) NOT NULL UNIQUE DEFAULT (lower(hex(randomblob(16)))),
    Created DATETIME NOT NULL DEFAULT (datetime('now', 'localtime'))
);

-- IDGDocument follows from IDSrcGDocument: a delivery note from its order.
CREATE TABLE GDocRel (
    ID INTEGER PRIMARY KEY,
    IDGDocument INTEGER NOT NULL REFERENCES GDocument(ID),
    IDSrcGDocument INTEGER NOT NULL REFERENCES GDocument(ID)
);
CREATE UNIQUE INDEX GDocRel_Document ON GDocRel(IDGDocument, IDSrcGDocument);
CREATE INDEX GDocRel_Source ON GDocRel(IDSrcGDocument, IDGDocument);

CREATE TABLE GDTax (
    ID INTEGER PRIMARY KEY,
    IDGDocument INTEGER NOT NULL REFERENCES GDocument(ID),
    TaxPercent REAL NOT NULL,
    Base MONEY NOT NULL,
    Amount MONEY NOT NULL
);
CREATE UNIQUE INDEX GDTax_Document ON GDTax(IDGDocument, TaxPercent);

-- State of an order: 0 new, 1 being processed, 2 partly delivered, 3 delivered.
CREATE TABLE SDOrder (
    ID INTEGER PRIMARY KEY REFERENCES GDocument(ID),
    Number INTEGER NOT NULL UNIQUE,
    DocDate DATE NOT NULL,
    WantedDate DATE,
    State INTEGER NOT NULL DEFAULT 0 CHECK (State >= 0),
    IDGRCompany INTEGER NOT NULL REFERENCES GRCompany(ID),
    IDGRCompContPerson INTEGER REFERENCES GRCompContPerson(ID),
    IDGRPriceList INTEGER REFERENCES GRPriceList(ID),
    -- Who the order is for, when it is not the company itself.
    CompanyName NVARCHAR(100),
    CompanyAddr NVARCHAR(200),
    Explanation NVARCHAR(2000),
    Amount MONEY NOT NULL DEFAULT 0,
    TaxAmount MONEY NOT NULL DEFAULT 0,
    AmountWTax MONEY NOT NULL DEFAULT 0,
    -- A row has a ReviewPrice. Staff look at such orders in the view SDOrderReview.
    NeedsReview BIT NOT NULL DEFAULT 0
);
CREATE INDEX SDOrder_Company ON SDOrder(IDGRCompany, DocDate);
CREATE INDEX SDOrder_Date ON SDOrder(DocDate);

CREATE TABLE SDOrderRow (
    ID INTEGER PRIMARY KEY,
    IDSDOrder INTEGER NOT NULL REFERENCES SDOrder(ID),
    RowNo INTEGER NOT NULL,
    IDGRArticle INTEGER NOT NULL REFERENCES GRArticle(ID),
    Quantity REAL NOT NULL DEFAULT 0 CHECK (Quantity >= 0),
    -- What the customer pays for one, without tax: Amount counts with Price, and UnitPrice is what
    -- the documents show.
    Price MONEY NOT NULL DEFAULT 0 CHECK (Price >= 0),
    UnitPrice MONEY NOT NULL DEFAULT 0 CHECK (UnitPrice >= 0),
    PriceCut REAL NOT NULL DEFAULT 0,
    Amount MONEY NOT NULL DEFAULT 0 CHECK (Amount >= 0),
    TaxPercent REAL NOT NULL DEFAULT 0,
    Explanation NVARCHAR(500),
    DeliveredQuantity REAL NOT NULL DEFAULT 0 CHECK (DeliveredQuantity >= 0),
    -- What one would have cost by the customer's price list, where he ordered for less; 0: he has no
    -- price for the article. NULL: nothing to look at.
    ReviewPrice MONEY CHECK (ReviewPrice >= 0),
    -- Bits. 4: the ERP made the row (transport, packaging), the customer leaves it alone.
    Status INTEGER NOT NULL DEFAULT 0
);
-- With the article, since what a company has bought is asked by article.
CREATE INDEX SDOrderRow_Order ON SDOrderRow(IDSDOrder, IDGRArticle);
CREATE INDEX SDOrderRow_Article ON SDOrderRow(IDGRArticle);

CREATE TABLE SDConsignmD (
    ID INTEGER PRIMARY KEY REFERENCES GDocument(ID),
    Number INTEGER NOT NULL UNIQUE,
    DocDate DATE NOT NULL,
    State INTEGER NOT NULL DEFAULT 0 CHECK (State >= 0),
    IDGRCompany INTEGER NOT NULL REFERENCES GRCompany(ID),
    IDGRCompContPerson INTEGER REFERENCES GRCompContPerson(ID),
    IDGRPriceList INTEGER REFERENCES GRPriceList(ID),
    CompanyName NVARCHAR(100),
    CompanyAddr NVARCHAR(200),
    Explanation NVARCHAR(2000),
    Amount MONEY NOT NULL DEFAULT 0,
    TaxAmount MONEY NOT NULL DEFAULT 0,
    AmountWTax MONEY NOT NULL DEFAULT 0
);
CREATE INDEX SDConsignmD_Company ON SDConsignmD(IDGRCompany, DocDate);

CREATE TABLE DDStoreDRow (
    ID INTEGER PRIMARY KEY,
    IDSDConsignmD INTEGER NOT NULL REFERENCES SDConsignmD(ID),
    RowNo INTEGER NOT NULL,
    -- The order row that this delivers.
    IDSDOrderRow INTEGER REFERENCES SDOrderRow(ID),
    IDGRArticle INTEGER NOT NULL REFERENCES GRArticle(ID),
    Quantity REAL NOT NULL DEFAULT 0,
    Price MONEY NOT NULL DEFAULT 0,
    UnitPrice MONEY NOT NULL DEFAULT 0,
    PriceCut REAL NOT NULL DEFAULT 0,
    Amount MONEY NOT NULL DEFAULT 0,
    TaxPercent REAL NOT NULL DEFAULT 0,
    Explanation NVARCHAR(500),
    Status INTEGER NOT NULL DEFAULT 0
);
CREATE INDEX DDStoreDRow_Document ON DDStoreDRow(IDSDConsignmD);
CREATE INDEX DDStoreDRow_OrderRow ON DDStoreDRow(IDSDOrderRow);
CREATE INDEX DDStoreDRow_Article ON DDStoreDRow(IDGRArticle);

-- State of an invoice: 1 open, 2 paid.
CREATE TABLE SDInvoice (
    ID INTEGER PRIMARY KEY REFERENCES GDocument(ID),
    Number INTEGER NOT NULL UNIQUE,
    DocDate DATE NOT NULL,
    DueDate DATE NOT NULL,
    State INTEGER NOT NULL DEFAULT 0 CHECK (State >= 0),
    IDGRCompany INTEGER NOT NULL REFERENCES GRCompany(ID),
    IDGRCompContPerson INTEGER REFERENCES GRCompContPerson(ID),
    IDGRPriceList INTEGER REFERENCES GRPriceList(ID),
    CompanyName NVARCHAR(100),
    CompanyAddr NVARCHAR(200),
    Explanation NVARCHAR(2000),
    Amount MONEY NOT NULL DEFAULT 0,
    TaxAmount MONEY NOT NULL DEFAULT 0,
    AmountWTax MONEY NOT NULL DEFAULT 0,
    PaidAmount MONEY NOT NULL DEFAULT 0
);
CREATE INDEX SDInvoice_Company ON SDInvoice(IDGRCompany, DocDate);

CREATE TABLE SDInvoiceRow (
    ID INTEGER PRIMARY KEY,
    IDSDInvoice INTEGER NOT NULL REFERENCES SDInvoice(ID),
    RowNo INTEGER NOT NULL,
    -- The delivery note's row that this bills.
    IDDDStoreDRow INTEGER REFERENCES DDStoreDRow(ID),
    IDGRArticle INTEGER NOT NULL REFERENCES GRArticle(ID),
    Quantity REAL NOT NULL DEFAULT 0,
    Price MONEY NOT NULL DEFAULT 0,
    UnitPrice MONEY NOT NULL DEFAULT 0,
    PriceCut REAL NOT NULL DEFAULT 0,
    Amount MONEY NOT NULL DEFAULT 0,
    TaxPercent REAL NOT NULL DEFAULT 0,
    Explanation NVARCHAR(500),
    Status INTEGER NOT NULL DEFAULT 0
);
CREATE INDEX SDInvoiceRow_Document ON SDInvoiceRow(IDSDInvoice);
CREATE INDEX SDInvoiceRow_StoreRow ON SDInvoiceRow(IDDDStoreDRow);
CREATE INDEX SDInvoiceRow_Article ON SDInvoiceRow(IDGRArticle);
