#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace zebtell::catalogue {

// What the price list is asked for. Texts go into the criterion as they are: the data-access
// runtime parses the whole and shows nobody more than his own rows.
struct ListRequest {
    std::int32_t PriceListId = 0;  // 0: the customer has none
    std::string category;          // IDs of categories; empty: all
    std::string find;              // search text as typed; empty: none
    std::string SearchCodeColumn;
    std::string SearchNameColumn;
    std::string FilterText;  // the template's extra condition; in braces it is SQL
};

struct SearchPatterns {
    std::string name;  // holds the words in this order
    std::string code;  // begins with them
};
SearchPatterns PatternsFor(std::string_view find);

// `favourites` is the template's condition with the partner's ID already in it.
std::string FavouritesCriterion(std::int32_t price_list, std::string_view favourites);

// The list of a category, or of all, with a search where there is one; priced lines only.
std::string CategoryCriterion(const ListRequest& request);

// A search over everything, lines without a price included.
std::string SearchCriterion(const ListRequest& request);

}  // namespace zebtell::catalogue
