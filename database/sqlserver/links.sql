-- Foreign keys and indexes, to be run behind schema.sql; a database that is being filled gets them
-- last. A column IDX is the link X, and its foreign key says where it leads.

-- Foreign keys

ALTER TABLE GRPriceList
    ADD CONSTRAINT FK_GRPriceList_IDSrcPriceList FOREIGN KEY (IDSrcPriceList)
        REFERENCES GRPriceList (ID);
ALTER TABLE GRCompany
    ADD CONSTRAINT FK_GRCompany_IDGRPriceList FOREIGN KEY (IDGRPriceList)
        REFERENCES GRPriceList (ID);
ALTER TABLE GRCompany
    ADD CONSTRAINT FK_GRCompany_IDSettlCompany FOREIGN KEY (IDSettlCompany)
        REFERENCES GRCompany (ID);
ALTER TABLE GRCompany
    ADD CONSTRAINT FK_GRCompany_IDParent FOREIGN KEY (IDParent) REFERENCES GRCompany (ID);
ALTER TABLE GRCompany
    ADD CONSTRAINT FK_GRCompany_IDGRCompanyPriceCat FOREIGN KEY (IDGRCompanyPriceCat)
        REFERENCES GRCompanyPriceCat (ID);
ALTER TABLE GRCompany
    ADD CONSTRAINT FK_GRCompany_IDEREmployee FOREIGN KEY (IDEREmployee) REFERENCES EREmployee (ID);
ALTER TABLE GRCompContPerson
    ADD CONSTRAINT FK_GRCompContPerson_IDGRCompany FOREIGN KEY (IDGRCompany)
        REFERENCES GRCompany (ID);
ALTER TABLE SYUser
    ADD CONSTRAINT FK_SYUser_IDPartner FOREIGN KEY (IDPartner) REFERENCES GRCompany (ID);
ALTER TABLE SYUser
    ADD CONSTRAINT FK_SYUser_IDGRCompContPerson FOREIGN KEY (IDGRCompContPerson)
        REFERENCES GRCompContPerson (ID);
ALTER TABLE GRArticle
    ADD CONSTRAINT FK_GRArticle_IDGRTax FOREIGN KEY (IDGRTax) REFERENCES GRTax (ID);
ALTER TABLE GRArticle
    ADD CONSTRAINT FK_GRArticle_IDGRArticlePriceCat FOREIGN KEY (IDGRArticlePriceCat)
        REFERENCES GRArticlePriceCat (ID);
ALTER TABLE GRArticleCatRel
    ADD CONSTRAINT FK_GRArticleCatRel_IDGRArticle FOREIGN KEY (IDGRArticle)
        REFERENCES GRArticle (ID);
ALTER TABLE GRArticleCatRel
    ADD CONSTRAINT FK_GRArticleCatRel_IDGRArticleCat FOREIGN KEY (IDGRArticleCat)
        REFERENCES GRArticleCat (ID);
ALTER TABLE GRPriceListRel
    ADD CONSTRAINT FK_GRPriceListRel_IDGRPriceList FOREIGN KEY (IDGRPriceList)
        REFERENCES GRPriceList (ID);
ALTER TABLE GRPriceListRel
    ADD CONSTRAINT FK_GRPriceListRel_IDGRArticle FOREIGN KEY (IDGRArticle)
        REFERENCES GRArticle (ID);
ALTER TABLE GRPriceCatRel
    ADD CONSTRAINT FK_GRPriceCatRel_IDGRCompanyPriceCat FOREIGN KEY (IDGRCompanyPriceCat)
        REFERENCES GRCompanyPriceCat (ID);
ALTER TABLE GRPriceCatRel
    ADD CONSTRAINT FK_GRPriceCatRel_IDGRArticlePriceCat FOREIGN KEY (IDGRArticlePriceCat)
        REFERENCES GRArticlePriceCat (ID);
ALTER TABLE GRPriceCatRel
    ADD CONSTRAINT FK_GRPriceCatRel_IDGRPriceList FOREIGN KEY (IDGRPriceList)
        REFERENCES GRPriceList (ID);
ALTER TABLE GDocRel
    ADD CONSTRAINT FK_GDocRel_IDGDocument FOREIGN KEY (IDGDocument) REFERENCES GDocument (ID);
ALTER TABLE GDocRel
    ADD CONSTRAINT FK_GDocRel_IDSrcGDocument FOREIGN KEY (IDSrcGDocument) REFERENCES GDocument (ID);
ALTER TABLE GDTax
    ADD CONSTRAINT FK_GDTax_IDGDocument FOREIGN KEY (IDGDocument) REFERENCES GDocument (ID);
ALTER TABLE SDOrder
    ADD CONSTRAINT FK_SDOrder_ID FOREIGN KEY (ID) REFERENCES GDocument (ID);
ALTER TABLE SDOrder
    ADD CONSTRAINT FK_SDOrder_IDGRCompany FOREIGN KEY (IDGRCompany) REFERENCES GRCompany (ID);
ALTER TABLE SDOrder
    ADD CONSTRAINT FK_SDOrder_IDGRCompContPerson FOREIGN KEY (IDGRCompContPerson)
        REFERENCES GRCompContPerson (ID);
ALTER TABLE SDOrder
    ADD CONSTRAINT FK_SDOrder_IDGRPriceList FOREIGN KEY (IDGRPriceList) REFERENCES GRPriceList (ID);
ALTER TABLE SDOrderRow
    ADD CONSTRAINT FK_SDOrderRow_IDSDOrder FOREIGN KEY (IDSDOrder) REFERENCES SDOrder (ID);
ALTER TABLE SDOrderRow
    ADD CONSTRAINT FK_SDOrderRow_IDGRArticle FOREIGN KEY (IDGRArticle) REFERENCES GRArticle (ID);
ALTER TABLE SDConsignmD
    ADD CONSTRAINT FK_SDConsignmD_ID FOREIGN KEY (ID) REFERENCES GDocument (ID);
ALTER TABLE SDConsignmD
    ADD CONSTRAINT FK_SDConsignmD_IDGRCompany FOREIGN KEY (IDGRCompany) REFERENCES GRCompany (ID);
ALTER TABLE SDConsignmD
    ADD CONSTRAINT FK_SDConsignmD_IDGRCompContPerson FOREIGN KEY (IDGRCompContPerson)
        REFERENCES GRCompContPerson (ID);
ALTER TABLE SDConsignmD
    ADD CONSTRAINT FK_SDConsignmD_IDGRPriceList FOREIGN KEY (IDGRPriceList)
        REFERENCES GRPriceList (ID);
ALTER TABLE DDStoreDRow
    ADD CONSTRAINT FK_DDStoreDRow_IDSDConsignmD FOREIGN KEY (IDSDConsignmD)
        REFERENCES SDConsignmD (ID);
ALTER TABLE DDStoreDRow
    ADD CONSTRAINT FK_DDStoreDRow_IDSDOrderRow FOREIGN KEY (IDSDOrderRow)
        REFERENCES SDOrderRow (ID);
ALTER TABLE DDStoreDRow
    ADD CONSTRAINT FK_DDStoreDRow_IDGRArticle FOREIGN KEY (IDGRArticle) REFERENCES GRArticle (ID);
ALTER TABLE SDInvoice
    ADD CONSTRAINT FK_SDInvoice_ID FOREIGN KEY (ID) REFERENCES GDocument (ID);
ALTER TABLE SDInvoice
    ADD CONSTRAINT FK_SDInvoice_IDGRCompany FOREIGN KEY (IDGRCompany) REFERENCES GRCompany (ID);
ALTER TABLE SDInvoice
    ADD CONSTRAINT FK_SDInvoice_IDGRCompContPerson FOREIGN KEY (IDGRCompContPerson)
        REFERENCES GRCompContPerson (ID);
ALTER TABLE SDInvoice
    ADD CONSTRAINT FK_SDInvoice_IDGRPriceList FOREIGN KEY (IDGRPriceList)
        REFERENCES GRPriceList (ID);
ALTER TABLE SDInvoiceRow
    ADD CONSTRAINT FK_SDInvoiceRow_IDSDInvoice FOREIGN KEY (IDSDInvoice) REFERENCES SDInvoice (ID);
ALTER TABLE SDInvoiceRow
    ADD CONSTRAINT FK_SDInvoiceRow_IDDDStoreDRow FOREIGN KEY (IDDDStoreDRow)
        REFERENCES DDStoreDRow (ID);
ALTER TABLE SDInvoiceRow
    ADD CONSTRAINT FK_SDInvoiceRow_IDGRArticle FOREIGN KEY (IDGRArticle) REFERENCES GRArticle (ID);

-- Indexes

CREATE INDEX GRCompany_Name ON GRCompany (Name);
CREATE INDEX GRCompany_Parent ON GRCompany (IDParent);
CREATE INDEX GRCompany_SettlCompany ON GRCompany (IDSettlCompany);
CREATE INDEX GRCompContPerson_Company ON GRCompContPerson (IDGRCompany);
CREATE INDEX SYUser_Partner ON SYUser (IDPartner);
CREATE INDEX GRArticle_Name ON GRArticle (Name);
CREATE INDEX GRArticle_Barcode ON GRArticle (Barcode);
CREATE INDEX GRArticle_PriceCat ON GRArticle (IDGRArticlePriceCat);
CREATE UNIQUE INDEX GRArticleCatRel_Cat ON GRArticleCatRel (IDGRArticleCat, IDGRArticle);
CREATE INDEX GRArticleCatRel_Article ON GRArticleCatRel (IDGRArticle, IDGRArticleCat);
CREATE UNIQUE INDEX GRPriceListRel_List ON GRPriceListRel (IDGRPriceList, IDGRArticle);
-- With the price, so that the prices of some articles are read without the lines themselves.
CREATE INDEX GRPriceListRel_Article ON GRPriceListRel (IDGRArticle, IDGRPriceList) INCLUDE (Price);
CREATE UNIQUE INDEX GRPriceCatRel_Cats
    ON GRPriceCatRel (IDGRCompanyPriceCat, IDGRArticlePriceCat, IDGRPriceList);
CREATE UNIQUE INDEX GDocRel_Document ON GDocRel (IDGDocument, IDSrcGDocument);
CREATE INDEX GDocRel_Source ON GDocRel (IDSrcGDocument, IDGDocument);
CREATE UNIQUE INDEX GDTax_Document ON GDTax (IDGDocument, TaxPercent);
CREATE INDEX SDOrder_Company ON SDOrder (IDGRCompany, DocDate);
CREATE INDEX SDOrder_Date ON SDOrder (DocDate);
-- With the article, since what a company has bought is asked by article.
CREATE INDEX SDOrderRow_Order ON SDOrderRow (IDSDOrder, IDGRArticle);
CREATE INDEX SDOrderRow_Article ON SDOrderRow (IDGRArticle);
CREATE INDEX SDConsignmD_Company ON SDConsignmD (IDGRCompany, DocDate);
CREATE INDEX DDStoreDRow_Document ON DDStoreDRow (IDSDConsignmD);
CREATE INDEX DDStoreDRow_OrderRow ON DDStoreDRow (IDSDOrderRow);
CREATE INDEX DDStoreDRow_Article ON DDStoreDRow (IDGRArticle);
CREATE INDEX SDInvoice_Company ON SDInvoice (IDGRCompany, DocDate);
CREATE INDEX SDInvoiceRow_Document ON SDInvoiceRow (IDSDInvoice);
CREATE INDEX SDInvoiceRow_StoreRow ON SDInvoiceRow (IDDDStoreDRow);
CREATE INDEX SDInvoiceRow_Article ON SDInvoiceRow (IDGRArticle);
