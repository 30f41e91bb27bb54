-- The tables of the company database for SQL Server 2016 and later, to be run first. Each statement
-- ends with a semicolon at the end of its line and is a batch of its own.
--
-- Amounts are decimal, which the portal reads exactly; quantities and percentages are numeric, which
-- it reads as numbers. Columns and links are those of the SQLite schema. Texts compare by the
-- database's collation, which must ignore case. Documents (SDOrder, SDConsignmD, SDInvoice) take the
-- key of their GDocument.

-- Companies, people and users

CREATE TABLE EREmployee (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    Name nvarchar(100) NOT NULL,
    Phone nvarchar(30) NULL,
    Email nvarchar(100) NULL
);

CREATE TABLE GRCompanyPriceCat (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    Name nvarchar(50) NOT NULL UNIQUE
);

CREATE TABLE GRPriceList (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    Name nvarchar(50) NOT NULL UNIQUE,
    Currency nvarchar(3) NOT NULL DEFAULT N'EUR',
    -- When set, the lines of that list count for this one, and its own lines do not.
    IDSrcPriceList int NULL,
    -- The list of orders and customers that name none.
    IsDefault bit NOT NULL DEFAULT 0,
    CHECK (IDSrcPriceList <> ID)
);

CREATE TABLE GRCompany (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    Code nvarchar(20) NOT NULL UNIQUE,
    Name nvarchar(100) NOT NULL,
    RegCode nvarchar(20) NULL,
    TaxCode nvarchar(20) NULL,
    Address nvarchar(200) NULL,
    City nvarchar(60) NULL,
    PostCode nvarchar(10) NULL,
    Country nvarchar(2) NOT NULL DEFAULT N'EE',
    Phone nvarchar(30) NULL,
    Email nvarchar(100) NULL,
    -- Per cent on every price; negative is a discount.
    PriceCut numeric(9, 4) NOT NULL DEFAULT 0,
    OrdersAllowed bit NOT NULL DEFAULT 1,
    -- Days from an invoice's date to its due date.
    PaymentDays int NOT NULL DEFAULT 14 CHECK (PaymentDays >= 0),
    IDGRPriceList int NULL,
    -- Who pays, when it is not the company itself.
    IDSettlCompany int NULL,
    IDParent int NULL,
    IDGRCompanyPriceCat int NULL,
    IDEREmployee int NULL
);

CREATE TABLE GRCompContPerson (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    IDGRCompany int NOT NULL,
    Name nvarchar(100) NOT NULL,
    Position nvarchar(60) NULL,
    Phone nvarchar(30) NULL,
    Email nvarchar(100) NULL
);

CREATE TABLE SYUser (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    Name nvarchar(50) NOT NULL UNIQUE,
    -- argon2id in its text form. NULL: nobody logs on by this name with a password.
    PasswordHash nvarchar(128) NULL,
    DisplayName nvarchar(100) NULL,
    IDPartner int NULL,
    IDGRCompContPerson int NULL,
    Guest bit NOT NULL DEFAULT 0,
    Disabled bit NOT NULL DEFAULT 0
);

-- Articles and prices

CREATE TABLE GRTax (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    Name nvarchar(50) NOT NULL,
    TaxPercent numeric(9, 4) NOT NULL CHECK (TaxPercent >= 0)
);

CREATE TABLE GRArticlePriceCat (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    Name nvarchar(50) NOT NULL UNIQUE
);

CREATE TABLE GRArticle (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    Code nvarchar(40) NOT NULL UNIQUE,
    Name nvarchar(150) NOT NULL,
    Unit nvarchar(10) NOT NULL DEFAULT N'tk',
    PackQuantity numeric(18, 4) NOT NULL DEFAULT 1 CHECK (PackQuantity > 0),
    Barcode nvarchar(20) NULL,
    Explanation nvarchar(1000) NULL,
    Stock numeric(18, 4) NOT NULL DEFAULT 0,
    IDGRTax int NOT NULL,
    IDGRArticlePriceCat int NULL
);

CREATE TABLE GRArticleCat (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    Name nvarchar(80) NOT NULL,
    -- The group of categories, which option lists may be limited to.
    Category nvarchar(30) NULL
);

CREATE TABLE GRArticleCatRel (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    IDGRArticle int NOT NULL,
    IDGRArticleCat int NOT NULL
);

CREATE TABLE GRPriceListRel (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    IDGRPriceList int NOT NULL,
    IDGRArticle int NOT NULL,
    -- 0: not priced.
    Price decimal(19, 4) NOT NULL CHECK (Price >= 0)
);

-- What a company price category pays for an article price category, in per cent on the list price.
CREATE TABLE GRPriceCatRel (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    IDGRCompanyPriceCat int NOT NULL,
    IDGRArticlePriceCat int NOT NULL,
    -- The list where the price lines stand.
    IDGRPriceList int NOT NULL,
    PriceCut numeric(9, 4) NOT NULL CHECK (PriceCut >= -100)
);

-- Documents. An order, a delivery note and an invoice share the key of their GDocument.

CREATE TABLE GDocument (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    -- The table of the document: SDOrder, SDConsignmD or SDInvoice.
    Kind nvarchar(20) NOT NULL,
    -- Made with the document before it is stored, so that storing it again is noticed.
    DocKey nvarchar(32) NOT NULL
        DEFAULT (lower(replace(convert(nvarchar(36), newid()), N'-', N''))) UNIQUE,
    Created datetime2(0) NOT NULL DEFAULT (sysdatetime())
);

-- IDGDocument follows from IDSrcGDocument: a delivery note from its order.
CREATE TABLE GDocRel (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    IDGDocument int NOT NULL,
    IDSrcGDocument int NOT NULL
);

CREATE TABLE GDTax (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    IDGDocument int NOT NULL,
    TaxPercent numeric(9, 4) NOT NULL,
    Base decimal(19, 4) NOT NULL,
    Amount decimal(19, 4) NOT NULL
);

-- State of an order: 0 new, 1 being processed, 2 partly delivered, 3 delivered.
CREATE TABLE SDOrder (
    ID int NOT NULL PRIMARY KEY,
    Number int NOT NULL UNIQUE,
    DocDate date NOT NULL,
    WantedDate date NULL,
    State int NOT NULL DEFAULT 0 CHECK (State >= 0),
    IDGRCompany int NOT NULL,
    IDGRCompContPerson int NULL,
    IDGRPriceList int NULL,
    -- Who the order is for, when it is not the company itself.
    CompanyName nvarchar(100) NULL,
    CompanyAddr nvarchar(200) NULL,
    Explanation nvarchar(2000) NULL,
    Amount decimal(19, 4) NOT NULL DEFAULT 0,
    TaxAmount decimal(19, 4) NOT NULL DEFAULT 0,
    AmountWTax decimal(19, 4) NOT NULL DEFAULT 0,
    -- A row has a ReviewPrice. Staff look at such orders in the view SDOrderReview.
    NeedsReview bit NOT NULL DEFAULT 0
);

CREATE TABLE SDOrderRow (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    IDSDOrder int NOT NULL,
    RowNo int NOT NULL,
    IDGRArticle int NOT NULL,
    Quantity numeric(18, 4) NOT NULL DEFAULT 0 CHECK (Quantity >= 0),
    -- What the customer pays for one, without tax: Amount counts with Price, and UnitPrice is what
    -- the documents show.
    Price decimal(19, 4) NOT NULL DEFAULT 0 CHECK (Price >= 0),
    UnitPrice decimal(19, 4) NOT NULL DEFAULT 0 CHECK (UnitPrice >= 0),
    PriceCut numeric(9, 4) NOT NULL DEFAULT 0,
    Amount decimal(19, 4) NOT NULL DEFAULT 0 CHECK (Amount >= 0),
    TaxPercent numeric(9, 4) NOT NULL DEFAULT 0,
    Explanation nvarchar(500) NULL,
    DeliveredQuantity numeric(18, 4) NOT NULL DEFAULT 0 CHECK (DeliveredQuantity >= 0),
    -- What one would have cost by the customer's price list, where he ordered for less; 0: he has no
    -- price for the article. NULL: nothing to look at.
    ReviewPrice decimal(19, 4) NULL CHECK (ReviewPrice >= 0),
    -- Bits. 4: the ERP made the row (transport, packaging), the customer leaves it alone.
    Status int NOT NULL DEFAULT 0
);

CREATE TABLE SDConsignmD (
    ID int NOT NULL PRIMARY KEY,
    Number int NOT NULL UNIQUE,
    DocDate date NOT NULL,
    State int NOT NULL DEFAULT 0 CHECK (State >= 0),
    IDGRCompany int NOT NULL,
    IDGRCompContPerson int NULL,
    IDGRPriceList int NULL,
    CompanyName nvarchar(100) NULL,
    CompanyAddr nvarchar(200) NULL,
    Explanation nvarchar(2000) NULL,
    Amount decimal(19, 4) NOT NULL DEFAULT 0,
    TaxAmount decimal(19, 4) NOT NULL DEFAULT 0,
    AmountWTax decimal(19, 4) NOT NULL DEFAULT 0
);

CREATE TABLE DDStoreDRow (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    IDSDConsignmD int NOT NULL,
    RowNo int NOT NULL,
    -- The order row that this delivers.
    IDSDOrderRow int NULL,
    IDGRArticle int NOT NULL,
    Quantity numeric(18, 4) NOT NULL DEFAULT 0,
    Price decimal(19, 4) NOT NULL DEFAULT 0,
    UnitPrice decimal(19, 4) NOT NULL DEFAULT 0,
    PriceCut numeric(9, 4) NOT NULL DEFAULT 0,
    Amount decimal(19, 4) NOT NULL DEFAULT 0,
    TaxPercent numeric(9, 4) NOT NULL DEFAULT 0,
    Explanation nvarchar(500) NULL,
    Status int NOT NULL DEFAULT 0
);

-- State of an invoice: 1 open, 2 paid.
CREATE TABLE SDInvoice (
    ID int NOT NULL PRIMARY KEY,
    Number int NOT NULL UNIQUE,
    DocDate date NOT NULL,
    DueDate date NOT NULL,
    State int NOT NULL DEFAULT 0 CHECK (State >= 0),
    IDGRCompany int NOT NULL,
    IDGRCompContPerson int NULL,
    IDGRPriceList int NULL,
    CompanyName nvarchar(100) NULL,
    CompanyAddr nvarchar(200) NULL,
    Explanation nvarchar(2000) NULL,
    Amount decimal(19, 4) NOT NULL DEFAULT 0,
    TaxAmount decimal(19, 4) NOT NULL DEFAULT 0,
    AmountWTax decimal(19, 4) NOT NULL DEFAULT 0,
    PaidAmount decimal(19, 4) NOT NULL DEFAULT 0
);

CREATE TABLE SDInvoiceRow (
    ID int IDENTITY(1, 1) NOT NULL PRIMARY KEY,
    IDSDInvoice int NOT NULL,
    RowNo int NOT NULL,
    -- The delivery note's row that this bills.
    IDDDStoreDRow int NULL,
    IDGRArticle int NOT NULL,
    Quantity numeric(18, 4) NOT NULL DEFAULT 0,
    Price decimal(19, 4) NOT NULL DEFAULT 0,
    UnitPrice decimal(19, 4) NOT NULL DEFAULT 0,
    PriceCut numeric(9, 4) NOT NULL DEFAULT 0,
    Amount decimal(19, 4) NOT NULL DEFAULT 0,
    TaxPercent numeric(9, 4) NOT NULL DEFAULT 0,
    Explanation nvarchar(500) NULL,
    Status int NOT NULL DEFAULT 0
);
