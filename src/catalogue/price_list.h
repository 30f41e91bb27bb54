#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "host/session_state.h"

namespace zebtell::catalogue {

// Opens the customer's price lines for a criterion, sorted as the catalogue is, and starts at its
// first page. When that fails the list that was there stays.
void OpenList(host::SessionState& state, const data::Filter& criterion);

// "FirstPage", "PrevPage", "NextPage", "LastPage"; other commands and lists of one page leave the
// page as it is.
void TurnPage(host::CatalogueState& catalogue, std::string_view command);

// Rows are written from the first row of the page on.
void RewindPage(host::CatalogueState& catalogue);

// Makes the row at RowCursor the current one, with its prices.
void ReadRow(host::SessionState& state);

// The values of a field over the rows `from` to `to`, separated by commas.
std::string JoinFieldValues(data::RecordList& list,
                            std::string_view field,
                            std::int64_t from,
                            std::int64_t to);

}  // namespace zebtell::catalogue
