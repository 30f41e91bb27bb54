#include "catalogue/price_list.h"

#include <algorithm>

#include "base/rounding.h"
#include "base/text.h"
#include "tags/price_query.h"

namespace zebtell::catalogue {
namespace {

using host::CatalogueState;
using host::SessionState;

constexpr std::string_view kUsualOrder = "GRArticle.Code";
// Prices read at once where the list is not cut into pages.
constexpr std::int64_t kUnpagedPrices = 200;

std::int16_t PagesOf(const CatalogueState& catalogue) {
    if (catalogue.PageLength <= 0) return 1;
    return static_cast<std::int16_t>((catalogue.RowCount + catalogue.PageLength - 1) /
                                     catalogue.PageLength);
}

// The customer's prices are asked for as the rows are shown, a page at a time: a list of 30,000
// lines costs the prices of the 20 that are seen.
void ReadPrices(SessionState& state, std::int64_t row) {
    CatalogueState& catalogue = state.catalogue;
    if (row >= catalogue.PricesFrom && row <= catalogue.PricesTo) return;
    const std::int64_t length = catalogue.PageLength > 0 ? catalogue.PageLength : kUnpagedPrices;
    const std::int64_t to = std::min<std::int64_t>(row + length - 1, catalogue.RowCount);
    catalogue.PriceQuery = tags::OpenCustomerPrices(
        state, JoinFieldValues(*catalogue.ListQuery, "IDGRArticle", row, to));
    catalogue.PricesFrom = row;
    catalogue.PricesTo = to;
}

}  // namespace

void OpenList(SessionState& state, const data::Filter& criterion) {
    CatalogueState& catalogue = state.catalogue;
    const std::string_view order =
        catalogue.OrderText.empty() ? kUsualOrder : std::string_view(catalogue.OrderText);
    auto list = state.application().OpenList("GRPriceListRel", criterion, order);
    catalogue.RowCount = base::ToInteger16(static_cast<double>(list->Count()));
    catalogue.ListQuery = std::move(list);
    catalogue.CurrentRow.reset();
    catalogue.PriceRow.reset();
    catalogue.PriceQuery.reset();
    catalogue.PageNumber = 1;
    catalogue.PageCount = PagesOf(catalogue);
    if (catalogue.PageLength > 0) catalogue.ListFresh = true;
    RewindPage(catalogue);
}

void TurnPage(CatalogueState& catalogue, std::string_view command) {
    if (!catalogue.ListQuery || catalogue.PageCount <= 1) return;
    if (base::EqualNoCase(command, "FirstPage")) {
        catalogue.PageNumber = 1;
    } else if (base::EqualNoCase(command, "PrevPage")) {
        if (catalogue.PageNumber >= 2) --catalogue.PageNumber;
    } else if (base::EqualNoCase(command, "NextPage")) {
        if (catalogue.PageNumber < catalogue.PageCount) ++catalogue.PageNumber;
    } else if (base::EqualNoCase(command, "LastPage")) {
        catalogue.PageNumber = catalogue.PageCount;
    }
    RewindPage(catalogue);
    catalogue.ListFresh = true;
}

void RewindPage(CatalogueState& catalogue) {
    // The prices are those of the moment, also on a page that was shown before.
    catalogue.PricesFrom = catalogue.PricesTo = 0;
    catalogue.BasketQuantities.reset();
    catalogue.RowCursor =
        base::ToInteger16(static_cast<double>(catalogue.PageNumber - 1) * catalogue.PageLength + 1);
}

void ReadRow(SessionState& state) {
    CatalogueState& catalogue = state.catalogue;
    catalogue.CurrentRow = catalogue.ListQuery->Item(catalogue.RowCursor);
    catalogue.PriceRow.reset();
    ReadPrices(state, catalogue.RowCursor);
    catalogue.PriceRow = catalogue.PriceQuery->Find(
        "idgrarticle=" + catalogue.CurrentRow->GetField("idgrarticle").ToPlainText());
}

std::string JoinFieldValues(data::RecordList& list,
                            std::string_view field,
                            std::int64_t from,
                            std::int64_t to) {
    std::string joined;
    for (std::int64_t row = from; row <= to; ++row) {
        if (!joined.empty()) joined += ',';
        joined += list.Item(row)->GetField(field).ToPlainText();
    }
    return joined;
}

}  // namespace zebtell::catalogue
