#include "catalogue/criteria.h"

#include "base/text.h"

namespace zebtell::catalogue {
namespace {

using data::Filter;
using data::Typed;

constexpr std::string_view kLinesOfList =
    "GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 inner join GRArticle on "
    "P5.IDGRArticle=GRArticle.ID";

bool IsSql(std::string_view filter) {
    return filter.starts_with('{');
}

std::string_view WithoutBraces(std::string_view filter) {
    if (!IsSql(filter)) return filter;
    filter.remove_prefix(1);
    if (filter.ends_with('}')) filter.remove_suffix(1);
    return filter;
}

std::string FilterPart(const ListRequest& request) {
    if (request.FilterText.empty()) return {};
    return " AND " + std::string(WithoutBraces(request.FilterText));
}

// "(GRArticle.code like 'M6*' or GRArticle.name like '*M6*')"
Filter SearchCondition(const ListRequest& request) {
    const SearchPatterns patterns = PatternsFor(request.find);
    return "(GRArticle." + Filter(request.SearchCodeColumn) + " like '" + Typed{patterns.code} +
           "' or GRArticle." + request.SearchNameColumn + " like '" + Typed{patterns.name} + "')";
}

// For customers without a price list: the runtime's own syntax, unless the template's condition is
// SQL, which makes the whole SQL.
Filter RuntimeFilter(const ListRequest& request, const Filter& condition) {
    if (request.FilterText.empty()) return condition;
    const Filter both = Filter(WithoutBraces(request.FilterText)) + " and " + condition;
    return IsSql(request.FilterText) ? "{" + both + "}" : both;
}

Filter SearchedLines(const ListRequest& request, std::string_view opening) {
    const SearchPatterns patterns = PatternsFor(request.find);
    return Filter(opening) + kLinesOfList + " where (GRArticle." + request.SearchNameColumn +
           " LIKE '" + Typed{patterns.name} + "' OR GRArticle." + request.SearchCodeColumn +
           " LIKE '" + Typed{patterns.code} + "')" + FilterPart(request) +
           " AND (IDGRPriceList=" + std::to_string(request.PriceListId) + "))}";
}

}  // namespace

SearchPatterns PatternsFor(std::string_view find) {
    if (find.empty()) return {"*", "*"};
    if (find.find_first_of("*?") != std::string_view::npos) {
        return {std::string(find), std::string(find)};
    }
    const std::string words = base::Replaced(find, " ", "*");
    return {"*" + words + "*", words + "*"};
}

Filter FavouritesCriterion(std::int32_t price_list, std::string_view favourites) {
    if (price_list == 0) return favourites;
    Filter criterion =
        "{" + Filter(kLinesOfList) + " where IDGRPriceList=" + std::to_string(price_list) + ")";
    if (!favourites.empty()) criterion += " AND " + Filter(favourites);
    return criterion + "}";
}

Filter CategoryCriterion(const ListRequest& request) {
    if (request.category.empty()) {
        return request.PriceListId == 0 ? RuntimeFilter(request, SearchCondition(request))
                                        : SearchedLines(request, "{GRPriceListRel.Price<>0 AND ");
    }
    const Filter search = request.find.empty() ? "" : " and " + SearchCondition(request);
    if (request.PriceListId == 0) {
        return RuntimeFilter(request,
                             "GRArticle.GRArticleCatRel.IDGRArticleCat IN (" +
                                 Filter(Typed{request.category}) + ")" + search);
    }
    return "{GRPriceListRel.Price<>0 AND GRPriceListRel.ID IN (select ID from SQCatPriceList5 "
           "where (IDGRArticleCat IN (" +
           Filter(Typed{request.category}) +
           ")) AND (IDGRPriceList=" + std::to_string(request.PriceListId) + "))" + search +
           FilterPart(request) + "}";
}

Filter SearchCriterion(const ListRequest& request) {
    return request.PriceListId == 0 ? RuntimeFilter(request, SearchCondition(request))
                                    : SearchedLines(request, "{");
}

}  // namespace zebtell::catalogue
