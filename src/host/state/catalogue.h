#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <unordered_map>

#include "data/record_list.h"

namespace zebtell::host {

// The catalogue's list and how it is shown; paging depends on its surviving between requests.
struct CatalogueState {
    std::shared_ptr<data::RecordList> ListQuery;
    std::shared_ptr<data::Record> CurrentRow;  // the row being rendered
    std::shared_ptr<data::Record> PriceRow;    // the customer's prices of its article
    // The customer price query's result for the articles from PricesFrom to PricesTo of the list;
    // read when the first of them is shown, dropped with the list.
    std::shared_ptr<data::RecordList> PriceQuery;
    std::int64_t PricesFrom = 0;
    std::int64_t PricesTo = 0;
    // The basket's quantities by article; counted when the page's first row asks.
    std::optional<std::unordered_map<std::int64_t, double>> BasketQuantities;
    std::int16_t RowCursor = 1;
    std::int16_t RowCount = 0;
    std::int16_t PageLength = 0;  // 0: no paging
    std::int16_t PageNumber = 1;
    std::int16_t PageCount = 0;
    bool ListFresh = false;
    std::int32_t CategoryId = 0;  // -1: favourites; 0: all

    // Declared by the template's tags.
    std::string GroupQueryText;
    std::string FilterText;
    std::string OrderText;
    std::string FavoritesText;
    std::string EmptyGroupText;
    std::string FavouritesGroupText;
    std::string LastFind;
    std::string SearchCodeColumn;
    std::string SearchNameColumn;

    // The category entries of each group's option list, by group and condition; built once.
    std::unordered_map<std::string, std::string> CategoryOptions;
};

}  // namespace zebtell::host
