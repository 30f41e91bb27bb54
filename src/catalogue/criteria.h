#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "data/filter.h"

namespace zebtell::catalogue {

// What the price list is asked for. Texts go into the criterion as they are, those that people
// type marked as typed: the data-access runtime takes them for values and for nothing else.
struct ListRequest {
    std::int32_t PriceListId = 0;  // 0: the customer has none
    std::string category;          // IDs of categories as posted; empty: all
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
data::Filter FavouritesCriterion(std::int32_t price_list, std::string_view favourites);

// The list of a category, or of all, with a search where there is one; priced lines only.
data::Filter CategoryCriterion(const ListRequest& request);

// A search over everything, lines without a price included.
data::Filter SearchCriterion(const ListRequest& request);

}  // namespace zebtell::catalogue
