#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <unordered_map>
#include <unordered_set>

#include "base/text.h"
#include "data/record.h"

namespace zebtell::host {

// What became of the last form with quantities, for the one page that is shown next.
struct FormOutcome {
    int AddedRows = 0;
    // What was typed but refused, by the fields' names.
    std::unordered_map<std::string, std::string, base::NoCaseHash, base::NoCaseEqual> Refused;
};

// How the pages show and edit the basket; its contents are data::BasketValues.
struct BasketFormState {
    std::int16_t RowIndex = 1;  // the row that the order summary tags show
    std::string ReturnPage;     // where the confirmation page's drop button leads
    bool ShowRowExplanations = false;
    // Names of extra row fields that the template made editable.
    std::unordered_set<std::string, base::NoCaseHash, base::NoCaseEqual> EditableRowFields;
    std::int16_t QuantityDecimals = 0;

    FormOutcome LastForm;

    std::int16_t BasketRowCursor = 1;  // the next row of Koostamine and Kinnitus
    std::shared_ptr<data::Record> CurrentBasketRow;
    std::shared_ptr<data::Record> AddedRow;
    std::shared_ptr<data::Record> RowToAdd;  // the price line chosen for the page Lisamine
};

}  // namespace zebtell::host
