#include "catalogue/criteria.h"

#include <gtest/gtest.h>

namespace zebtell::catalogue {
namespace {

ListRequest Request(std::int32_t price_list,
                    std::string category,
                    std::string find,
                    std::string filter = {}) {
    return {.PriceListId = price_list,
            .category = std::move(category),
            .find = std::move(find),
            .SearchCodeColumn = "code",
            .SearchNameColumn = "name",
            .FilterText = std::move(filter)};
}

TEST(Criteria, SearchPatterns) {
    struct Case {
        const char* label;
        const char* find;
        const char* name;
        const char* code;
    };
    const Case cases[] = {
        {"nothing typed", "", "*", "*"},
        {"one word", "kruvi", "*kruvi*", "kruvi*"},
        {"words in this order", "kruvi M6", "*kruvi*M6*", "kruvi*M6*"},
        {"two blanks are two wildcards", "a  b", "*a**b*", "a**b*"},
        {"own question mark", "AB?1", "AB?1", "AB?1"},
        {"own asterisk, blanks stay", "a b*", "a b*", "a b*"},
        {"quotes stay as typed", "5'", "*5'*", "5'*"},
    };
    for (const Case& c : cases) {
        const SearchPatterns patterns = PatternsFor(c.find);
        EXPECT_EQ(patterns.name, c.name) << c.label;
        EXPECT_EQ(patterns.code, c.code) << c.label;
    }
}

TEST(Criteria, Favourites) {
    struct Case {
        const char* label;
        std::int32_t price_list;
        const char* favourites;
        const char* criterion;
    };
    const Case cases[] = {
        {"condition behind the list",
         7,
         "GRPriceListRel.IDGRArticle in (select 1)",
         "{GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 inner join GRArticle on "
         "P5.IDGRArticle=GRArticle.ID where IDGRPriceList=7) AND "
         "GRPriceListRel.IDGRArticle in (select 1)}"},
        {"no condition: the whole list",
         7,
         "",
         "{GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 inner join GRArticle on "
         "P5.IDGRArticle=GRArticle.ID where IDGRPriceList=7)}"},
        {"no price list: the text itself", 0, "Price > 0", "Price > 0"},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(FavouritesCriterion(c.price_list, c.favourites).text(), c.criterion) << c.label;
    }
}

TEST(Criteria, CategoryList) {
    struct Case {
        const char* label;
        ListRequest request;
        const char* criterion;
    };
    const Case cases[] = {
        {"all of the list",
         Request(7, "", ""),
         "{GRPriceListRel.Price<>0 AND GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 "
         "inner join GRArticle on P5.IDGRArticle=GRArticle.ID where (GRArticle.name LIKE '*' OR "
         "GRArticle.code LIKE '*') AND (IDGRPriceList=7))}"},
        {"searched, with a filter in braces",
         Request(7, "", "kruvi M6", "{GRArticle.Stock>0}"),
         "{GRPriceListRel.Price<>0 AND GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 "
         "inner join GRArticle on P5.IDGRArticle=GRArticle.ID where (GRArticle.name LIKE "
         "'*kruvi*M6*' OR GRArticle.code LIKE 'kruvi*M6*') AND GRArticle.Stock>0 AND "
         "(IDGRPriceList=7))}"},
        {"a category",
         Request(7, "3,4", ""),
         "{GRPriceListRel.Price<>0 AND GRPriceListRel.ID IN (select ID from SQCatPriceList5 where "
         "(IDGRArticleCat IN (3,4)) AND (IDGRPriceList=7))}"},
        {"a category, searched",
         Request(7, "3", "AB?1"),
         "{GRPriceListRel.Price<>0 AND GRPriceListRel.ID IN (select ID from SQCatPriceList5 where "
         "(IDGRArticleCat IN (3)) AND (IDGRPriceList=7)) and (GRArticle.code like 'AB?1' or "
         "GRArticle.name like 'AB?1')}"},
        {"a category with a filter",
         Request(7, "3", "", "{GRArticle.Stock>0}"),
         "{GRPriceListRel.Price<>0 AND GRPriceListRel.ID IN (select ID from SQCatPriceList5 where "
         "(IDGRArticleCat IN (3)) AND (IDGRPriceList=7)) AND GRArticle.Stock>0}"},
        {"no price list: the runtime's syntax",
         Request(0, "", "x"),
         "(GRArticle.code like 'x*' or GRArticle.name like '*x*')"},
        {"no price list, filter first",
         Request(0, "", "x", "GRArticle.Stock > 0"),
         "GRArticle.Stock > 0 and (GRArticle.code like 'x*' or GRArticle.name like '*x*')"},
        {"no price list, filter in SQL makes it SQL",
         Request(0, "", "x", "{GRArticle.Stock>0}"),
         "{GRArticle.Stock>0 and (GRArticle.code like 'x*' or GRArticle.name like '*x*')}"},
        {"no price list, a category",
         Request(0, "3", ""),
         "GRArticle.GRArticleCatRel.IDGRArticleCat IN (3)"},
        {"no price list, a category searched",
         Request(0, "3", "x"),
         "GRArticle.GRArticleCatRel.IDGRArticleCat IN (3) and (GRArticle.code like 'x*' or "
         "GRArticle.name like '*x*')"},
    };
    for (const Case& c : cases)
        EXPECT_EQ(CategoryCriterion(c.request).text(), c.criterion) << c.label;
}

TEST(Criteria, PlainSearchFindsLinesWithoutAPrice) {
    ListRequest request = Request(7, "", "x");
    request.SearchCodeColumn = "Barcode";
    EXPECT_EQ(SearchCriterion(request).text(),
              "{GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 inner join GRArticle on "
              "P5.IDGRArticle=GRArticle.ID where (GRArticle.name LIKE '*x*' OR GRArticle.Barcode "
              "LIKE 'x*') AND (IDGRPriceList=7))}");
    request.PriceListId = 0;
    EXPECT_EQ(SearchCriterion(request).text(),
              "(GRArticle.Barcode like 'x*' or GRArticle.name like '*x*')");
}

}  // namespace
}  // namespace zebtell::catalogue
