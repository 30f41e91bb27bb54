#include "data/document_loaders.h"

#include <algorithm>

#include "base/rounding.h"

namespace zebtell::data {

namespace {

constexpr std::size_t kPrefixLength = 3;  // "ID=" or "ID_"

Filter IdFilter(std::string_view filter) {
    return "ID=" + Filter(Typed{filter.substr(std::min(kPrefixLength, filter.size()))});
}

std::int16_t CountOf(RecordList& list) {
    return base::ToInteger16(static_cast<double>(list.Count()));
}

void LoadShown(DataApplication& application,
               std::string_view table,
               std::string_view rows_table,
               std::string_view filter,
               ShownDocument& shown) {
    ShownDocument loaded;
    loaded.Header = application.OpenList(table, IdFilter(filter), "")->Item(1);
    loaded.Rows = loaded.Header->Children(rows_table);
    loaded.RowCount = CountOf(*loaded.Rows);
    loaded.Taxes = loaded.Header->Children("GDTax");
    loaded.TaxCount = CountOf(*loaded.Taxes);
    shown = std::move(loaded);
}

}  // namespace

void LoadShownOrder(DataApplication& application, std::string_view filter, ShownDocument& shown) {
    LoadShown(application, "SDOrder", "SDOrderRow", filter, shown);
}

void LoadConsignment(DataApplication& application, std::string_view filter, ShownDocument& shown) {
    LoadShown(application, "SDConsignmD", "DDStoreDRow", filter, shown);
}

void LoadInvoice(DataApplication& application, std::string_view filter, ShownDocument& shown) {
    LoadShown(application, "SDInvoice", "SDInvoiceRow", filter, shown);
}

void LoadOrderAsBasket(DataApplication& application,
                       std::string_view filter,
                       BasketValues& basket) {
    BasketValues loaded;
    loaded.Basket = application.OpenTable("SDOrder", IdFilter(filter))->First();
    loaded.BasketRows = loaded.Basket->Rows();
    loaded.BasketRowCount = CountOf(*loaded.BasketRows);
    for (std::int64_t index = 1; index <= loaded.BasketRowCount; ++index) {
        const auto row = loaded.BasketRows->Item(index);
        loaded.BasketQuantity += row->GetField("Quantity").ToDouble();
        loaded.BasketTotal += row->GetField("Amount").ToCurrency();
    }
    basket = std::move(loaded);
}

}  // namespace zebtell::data
