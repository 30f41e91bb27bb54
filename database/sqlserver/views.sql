-- The views, to be run behind schema.sql.

-- The price lines that count for each price list: its own, or those of its source list.
-- IDSrcPriceList is the list where the line stands, the list itself when the line is its own.
CREATE VIEW SQPriceList5 AS
SELECT rel.ID AS ID,
       list.ID AS IDGRPriceList,
       rel.IDGRPriceList AS IDSrcPriceList,
       rel.IDGRArticle AS IDGRArticle,
       rel.Price AS Price
FROM GRPriceList list
INNER JOIN GRPriceListRel rel ON rel.IDGRPriceList = isnull(list.IDSrcPriceList, list.ID);

-- The same by article category: a line of an article in two categories stands here twice.
CREATE VIEW SQCatPriceList5 AS
SELECT rel.ID AS ID,
       list.ID AS IDGRPriceList,
       rel.IDGRPriceList AS IDSrcPriceList,
       rel.IDGRArticle AS IDGRArticle,
       rel.Price AS Price,
       cat.IDGRArticleCat AS IDGRArticleCat
FROM GRPriceList list
INNER JOIN GRPriceListRel rel ON rel.IDGRPriceList = isnull(list.IDSrcPriceList, list.ID)
INNER JOIN GRArticleCatRel cat ON cat.IDGRArticle = rel.IDGRArticle;

-- For staff: the rows that customers ordered below their own price, until the order's NeedsReview is
-- set back to 0. Missing is what the row's amount falls short of.
CREATE VIEW SDOrderReview AS
SELECT r.ID AS ID,
       o.ID AS IDSDOrder,
       o.Number AS Number,
       o.DocDate AS DocDate,
       c.Code AS CompanyCode,
       c.Name AS CompanyName,
       r.RowNo AS RowNo,
       a.Code AS ArticleCode,
       a.Name AS ArticleName,
       r.Quantity AS Quantity,
       r.Price AS Price,
       r.UnitPrice AS UnitPrice,
       r.Amount AS Amount,
       r.ReviewPrice AS ReviewPrice,
       cast(round(r.ReviewPrice * r.Quantity - r.Amount, 2) AS decimal(19, 4)) AS Missing
FROM SDOrder o
INNER JOIN GRCompany c ON c.ID = o.IDGRCompany
INNER JOIN SDOrderRow r ON r.IDSDOrder = o.ID
INNER JOIN GRArticle a ON a.ID = r.IDGRArticle
WHERE o.NeedsReview = 1 AND r.ReviewPrice IS NOT NULL;
