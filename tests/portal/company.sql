-- A small company with prices that are easy to follow, and a second customer whose data is nobody
-- else's business.
INSERT INTO EREmployee (ID, Name) VALUES (1, 'Müügi Meelis'), (2, 'Teise Toomas');
INSERT INTO GRCompanyPriceCat (ID, Name) VALUES (1, 'Kuld'), (2, 'Hõbe');
INSERT INTO GRPriceList (ID, Name, IDSrcPriceList, IsDefault) VALUES (1, 'Põhi', NULL, 1), (2, 'Salajane', NULL, 0);
INSERT INTO GRCompany (ID, Code, Name, Address, PriceCut, OrdersAllowed, IDGRPriceList, IDParent, IDGRCompanyPriceCat, IDEREmployee) VALUES
    (3, 'EMA', 'Ema AS', NULL, 0, 1, NULL, NULL, NULL, NULL),
    (1, 'OMA', 'Oma Äri OÜ', 'Pikk 1, Tallinn', -10, 1, 1, 3, 1, 1),
    (2, 'TEINE', 'Teine Firma', 'Lai 2', 0, 1, 2, NULL, 2, 2),
    (4, 'JAE', 'Jaeklient', NULL, 0, 1, NULL, NULL, NULL, NULL),
    (5, 'BLOKK', 'Blokeeritud', NULL, 0, 0, 1, NULL, NULL, NULL);
INSERT INTO GRCompContPerson (ID, IDGRCompany, Name) VALUES (1, 1, 'Mari Maasikas'), (2, 2, 'Salajane Isik');
INSERT INTO GRTax (ID, Name, TaxPercent) VALUES (1, '24%', 24), (2, '9%', 9);
INSERT INTO GRArticlePriceCat (ID, Name) VALUES (1, 'Kinnitid'), (2, 'Tihendid');
INSERT INTO GRPriceCatRel (IDGRCompanyPriceCat, IDGRArticlePriceCat, IDGRPriceList, PriceCut) VALUES
    (1, 1, 1, -15), (1, 2, 1, -12.5), (2, 1, 2, -50);
INSERT INTO GRArticle (ID, Code, Name, Barcode, IDGRTax, IDGRArticlePriceCat) VALUES
    (101, 'KR-1', 'Kruvi M6 pikk', '4740000000011', 1, 1),
    (102, 'KR-2', 'Kruvi M8', '4740000000028', 1, NULL),
    (103, 'OR-1', 'O''Ring <5> & "7"', NULL, 2, 2),
    (104, 'HI-1', 'Hinnata kaup', NULL, 1, NULL),
    (105, 'SA-1', 'Salajane kaup', NULL, 1, NULL);
INSERT INTO GRPriceListRel (ID, IDGRPriceList, IDGRArticle, Price) VALUES
    (1101, 1, 101, 10), (1102, 1, 102, 0.33), (1103, 1, 103, 1.15), (1104, 1, 104, 0),
    (2101, 2, 101, 7.77), (2105, 2, 105, 99);
-- 45 articles more, so that the list has pages.
WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 45)
INSERT INTO GRArticle (ID, Code, Name, IDGRTax) SELECT 200 + i, printf('L-%02d', i), 'Lisa ' || i, 1 FROM n;
INSERT INTO GRPriceListRel (ID, IDGRPriceList, IDGRArticle, Price)
    SELECT 1000 + ID, 1, ID, ID - 200 FROM GRArticle WHERE ID > 200;
INSERT INTO GRArticleCat (ID, Name, Category) VALUES (1, 'Kinnitid', 'A'), (2, 'Tihendid & muu', 'B');
INSERT INTO GRArticleCatRel (IDGRArticle, IDGRArticleCat) VALUES (101, 1), (102, 1), (103, 2);
INSERT INTO SYUser (ID, Name, IDPartner, IDGRCompContPerson, Guest, Disabled) VALUES
    (1, 'mari', 1, 1, 0, 0), (2, 'teine', 2, 2, 0, 0), (3, 'WebGuest', 4, NULL, 1, 0),
    (4, 'blokk', 5, NULL, 0, 0), (5, 'endine', 1, 1, 0, 1);
-- Orders of both customers.
INSERT INTO GDocument (ID, Kind, DocKey) VALUES (501, 'SDOrder', 'a1'), (502, 'SDOrder', 'a2'), (503, 'SDOrder', 'a3');
INSERT INTO SDOrder (ID, Number, DocDate, State, IDGRCompany, IDGRPriceList, Explanation, Amount, TaxAmount, AmountWTax) VALUES
    (501, 7001, '2026-10-01', 0, 1, 1, 'minu vana', 17, 4.08, 21.08),
    (502, 7002, '2026-10-02', 0, 2, 2, 'SALADUS', 99, 23.76, 122.76),
    (503, 7003, '2026-10-03', 1, 1, 1, 'töös', 8.5, 2.04, 10.54);
INSERT INTO SDOrderRow (ID, IDSDOrder, RowNo, IDGRArticle, Quantity, Price, UnitPrice, Amount, TaxPercent, Status) VALUES
    (5011, 501, 1, 101, 2, 8.5, 8.5, 17, 24, 0), (5021, 502, 1, 105, 1, 99, 99, 99, 24, 0),
    (5031, 503, 1, 101, 1, 8.5, 8.5, 8.5, 24, 0), (5032, 503, 2, 102, 1, 0, 0, 0, 24, 4);
INSERT INTO GDTax (IDGDocument, TaxPercent, Base, Amount) VALUES (501, 24, 17, 4.08), (502, 24, 99, 23.76), (503, 24, 8.5, 2.04);
