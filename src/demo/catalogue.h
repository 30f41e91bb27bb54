#pragma once

#include <array>
#include <cstdint>
#include <vector>

#include "base/currency.h"
#include "demo/article_kinds.h"
#include "demo/company_store.h"

namespace zebtell::demo {

// The price lists by GRPriceList.ID. Project customers buy from the lines of the base list.
inline constexpr std::int64_t kBaseList = 1;
inline constexpr std::int64_t kExportList = 2;
inline constexpr std::int64_t kProjectList = 3;
inline constexpr int kOwnLineLists = 2;  // the lists that have lines of their own

// The list where the lines of a list stand.
constexpr std::int64_t SourceList(std::int64_t list) {
    return list == kProjectList ? kBaseList : list;
}

// What documents need to know of an article.
struct Article {
    std::int64_t id = 0;
    double tax_percent = 0;
    PriceGroup price_group = PriceGroup::kNet;
    bool is_measured = false;  // by metre, kilogram or litre, so halves too
    // The price in each list with lines of its own, by list ID - 1; 0 when it has none there.
    std::array<base::Currency, kOwnLineLists> prices;

    base::Currency PriceIn(std::int64_t list) const {
        return prices[static_cast<std::size_t>(SourceList(list) - 1)];
    }
};

struct Catalogue {
    std::vector<Article> articles;  // what customers buy, by ID - 1
    Article transport;              // the service that the ERP adds to small orders
};

// Stores the articles, their categories and taxes and the price lists, and returns them.
Catalogue WriteCatalogue(CompanyStore& store, int articles);

}  // namespace zebtell::demo
