-- The price lines that count for each price list: its own, or those of its source list.
-- IDSrcPriceList is the list where the line stands, the list itself when the line is its own.
CREATE VIEW SQPriceList5 AS
SELECT rel.ID AS ID,
       list.ID AS IDGRPriceList,
       rel.IDGRPriceList AS IDSrcPriceList,
       rel.IDGRArticle AS IDGRArticle,
       rel.Price AS Price
FROM GRPriceList list
INNER JOIN GRPriceListRel rel ON rel.IDGRPriceList = ifnull(list.IDSrcPriceList, list.ID);

-- The same by article category: a line of an article in two categories stands here twice.
CREATE VIEW SQCatPriceList5 AS
SELECT rel.ID AS ID,
       list.ID AS IDGRPriceList,
       rel.IDGRPriceList AS IDSrcPriceList,
       rel.IDGRArticle AS IDGRArticle,
       rel.Price AS Price,
       cat.IDGRArticleCat AS IDGRArticleCat
FROM GRPriceList list
INNER JOIN GRPriceListRel rel ON rel.IDGRPriceList = ifnull(list.IDSrcPriceList, list.ID)
INNER JOIN GRArticleCatRel cat ON cat.IDGRArticle = rel.IDGRArticle;
