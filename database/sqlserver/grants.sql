-- The least rights of the login that the settings name: the database user "zebtell". To be run by an
-- owner of the database when its tables and views are there.

CREATE USER zebtell FOR LOGIN zebtell;

-- What pages show, and what the portal looks up to serve them.
GRANT SELECT ON EREmployee TO zebtell;
GRANT SELECT ON GDocRel TO zebtell;
GRANT SELECT ON GDocument TO zebtell;
GRANT SELECT ON GDTax TO zebtell;
GRANT SELECT ON GRArticle TO zebtell;
GRANT SELECT ON GRArticleCat TO zebtell;
GRANT SELECT ON GRArticleCatRel TO zebtell;
GRANT SELECT ON GRArticlePriceCat TO zebtell;
GRANT SELECT ON GRCompany TO zebtell;
GRANT SELECT ON GRCompanyPriceCat TO zebtell;
GRANT SELECT ON GRCompContPerson TO zebtell;
GRANT SELECT ON GRPriceCatRel TO zebtell;
GRANT SELECT ON GRPriceList TO zebtell;
GRANT SELECT ON GRPriceListRel TO zebtell;
GRANT SELECT ON GRTax TO zebtell;
GRANT SELECT ON SDConsignmD TO zebtell;
GRANT SELECT ON DDStoreDRow TO zebtell;
GRANT SELECT ON SDInvoice TO zebtell;
GRANT SELECT ON SDInvoiceRow TO zebtell;
GRANT SELECT ON SDOrder TO zebtell;
GRANT SELECT ON SDOrderRow TO zebtell;
GRANT SELECT ON SQCatPriceList5 TO zebtell;
GRANT SELECT ON SQPriceList5 TO zebtell;
GRANT SELECT ON SYUser TO zebtell;

-- What storing an order writes.
GRANT INSERT ON GDocument TO zebtell;
GRANT INSERT ON SDOrder TO zebtell;
GRANT UPDATE ON SDOrder TO zebtell;
GRANT INSERT ON SDOrderRow TO zebtell;
GRANT UPDATE ON SDOrderRow TO zebtell;
GRANT DELETE ON SDOrderRow TO zebtell;
GRANT INSERT ON GDTax TO zebtell;
GRANT DELETE ON GDTax TO zebtell;
