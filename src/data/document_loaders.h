#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

#include "data/basket.h"
#include "data/data_application.h"

namespace zebtell::data {

// A stored document as its page shows it, row by row.
struct ShownDocument {
    std::shared_ptr<Record> Header;  // none: nothing loaded
    std::shared_ptr<RecordList> Rows;
    std::int16_t RowCount = 0;
    std::shared_ptr<RecordList> Taxes;
    std::int16_t TaxCount = 0;
    std::int16_t RowCursor = 1;
    std::shared_ptr<Record> CurrentRow;  // the row and the tax line being shown
    std::int16_t TaxCursor = 1;
    std::shared_ptr<Record> CurrentTax;
};

// Each loads the document that `filter` names: any three characters ("ID=", "ID_"), then its ID.
// RuntimeError 9 when there is none that this user may see; nothing is replaced then.
void LoadShownOrder(DataApplication& application, std::string_view filter, ShownDocument& shown);
void LoadConsignment(DataApplication& application, std::string_view filter, ShownDocument& shown);
void LoadInvoice(DataApplication& application, std::string_view filter, ShownDocument& shown);

// A stored order as the basket, to change or repeat it.
void LoadOrderAsBasket(DataApplication& application, std::string_view filter, BasketValues& basket);

}  // namespace zebtell::data
