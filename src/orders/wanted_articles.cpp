#include "orders/wanted_articles.h"

#include <limits>
#include <unordered_map>

#include "base/text.h"
#include "orders/quick_entry.h"
#include "tags/custom_func.h"
#include "tags/form_values.h"
#include "tags/price_query.h"

namespace zebtell::orders {
namespace {

using base::Currency;
using data::Record;
using host::SessionState;

// Lines of the quick entry that are taken at once; the others come back in it.
constexpr std::size_t kMostLines = 500;

// What `text` says of each item, separated by commas.
template <class Items, class Text>
std::string Joined(const Items& items, Text&& text) {
    std::string joined;
    for (const auto& item : items) {
        if (!joined.empty()) joined += ',';
        joined += text(item);
    }
    return joined;
}

Currency PostedPrice(const web::Request& request, const std::string& field) {
    const auto number = base::ParseNumber(tags::CleanFormValue(request.Form[field]));
    return number ? Currency::FromDouble(*number) : Currency();
}

bool IsRowID(std::string_view text) {
    constexpr std::size_t kLongestID = 18;
    return !text.empty() && text.size() <= kLongestID &&
           text.find_first_not_of("0123456789") == std::string_view::npos;
}

// A wish before its article is known: by the price line's ID, or by code or barcode.
struct Wish {
    WantedArticle wanted;
    std::string row_id;
};

// False when the box is empty or 0; a quantity that is none goes to the refusals.
bool TakeQuantity(SessionState& state, WantedArticle& wanted, Refusals& refusals) {
    if (wanted.typed.empty()) return false;
    const bool is_number = tags::ParseQuantity(state, wanted.typed, wanted.quantity);
    if (is_number && wanted.quantity > 0 && wanted.quantity <= kMostQuantity) return true;
    if (!is_number || wanted.quantity != 0) refusals.Add(wanted.name, wanted.typed, wanted.box);
    return false;
}

std::vector<Wish> RowWishes(const web::Request& request) {
    std::vector<Wish> wishes;
    for (const web::Field& field : request.Form) {
        const std::string name = tags::CleanFormValue(field.name);
        if (!base::StartsWithNoCase(name, "ID_") || !IsRowID(name.substr(3))) continue;
        Wish wish;
        wish.row_id = name.substr(3);
        wish.wanted.typed = tags::CleanFormValue(field.value);
        if (wish.wanted.typed.empty()) continue;
        wish.wanted.box = name;
        wish.wanted.asked = {PostedPrice(request, "Price_" + wish.row_id),
                             PostedPrice(request, "UPrice_" + wish.row_id)};
        wishes.push_back(std::move(wish));
    }
    return wishes;
}

void AddCodeWish(std::vector<Wish>& wishes, std::string code, std::string quantity) {
    if (code.empty()) return;
    Wish& wish = wishes.emplace_back();
    wish.wanted.name = std::move(code);
    wish.wanted.typed = std::move(quantity);
    wish.wanted.box = kQuickEntryBox;
}

std::vector<Wish> CodeWishes(const web::Request& request, Refusals& refusals) {
    std::vector<Wish> wishes;
    for (std::int16_t n = 1; n < std::numeric_limits<std::int16_t>::max(); ++n) {
        if (!request.Form.Has("Code_f" + std::to_string(n))) break;
        AddCodeWish(wishes,
                    tags::ReadRowField(request, "Code", n),
                    tags::ReadRowField(request, "Quantity", n));
    }
    std::size_t taken = 0;
    for (QuickEntryLine& line : ReadQuickEntry(request.Form[kQuickEntryBox])) {
        if (taken++ < kMostLines) {
            AddCodeWish(wishes, std::move(line.code), std::move(line.quantity));
        } else {
            refusals.Add(line.code, line.quantity, kQuickEntryBox);
        }
    }
    return wishes;
}

void TakeRow(Wish& wish, Record& row) {
    wish.wanted.article = row.GetField("IDGRArticle").ToInteger64();
    wish.wanted.name = row.GetField("GRArticle.Code").ToPlainText();
}

void FindRows(SessionState& state, std::vector<Wish>& wishes) {
    if (wishes.empty()) return;
    const std::string ids = Joined(wishes, [](const Wish& wish) { return wish.row_id; });
    const auto rows = state.application().OpenList("GRPriceListRel", "ID in (" + ids + ")", "");
    for (Wish& wish : wishes) {
        if (const auto row = rows->Find("ID=" + wish.row_id)) TakeRow(wish, *row);
    }
}

void FindCodes(SessionState& state, std::vector<Wish>& wishes) {
    if (wishes.empty()) return;
    data::Filter list;
    for (const Wish& wish : wishes) {
        list += (list.empty() ? "'" : ",'") + data::Filter(data::Typed{wish.wanted.name}) + "'";
    }
    const auto rows = state.application().OpenList(
        "GRPriceListRel",
        "{GRPriceListRel.ID in (select P5.ID from SQPriceList5 P5 inner join GRArticle on "
        "P5.IDGRArticle=GRArticle.ID where IDGRPriceList=" +
            data::Filter(std::to_string(state.company.PriceListId)) + " and (GRArticle.Code in (" +
            list + ") or GRArticle.Barcode in (" + list + ")))}",
        "");
    std::unordered_map<std::string, std::shared_ptr<Record>, base::NoCaseHash, base::NoCaseEqual>
        by_code;
    // An article's own code comes before the same text as another's barcode.
    for (const char* field : {"GRArticle.Code", "GRArticle.Barcode"}) {
        for (std::int64_t i = 1; i <= rows->Count(); ++i) {
            const auto row = rows->Item(i);
            by_code.emplace(row->GetField(field).ToPlainText(), row);
        }
    }
    for (Wish& wish : wishes) {
        const auto found = by_code.find(wish.wanted.name);
        if (found != by_code.end()) TakeRow(wish, *found->second);
    }
}

// The customer's own price of each article that no price was asked for.
void TakePrices(SessionState& state, std::vector<WantedArticle>& wanted) {
    if (wanted.empty()) return;
    const auto prices = tags::OpenCustomerPrices(
        state,
        Joined(wanted, [](const WantedArticle& each) { return std::to_string(each.article); }));
    for (WantedArticle& each : wanted) {
        if (each.asked.price != Currency()) continue;
        const auto row = prices->Find("idgrarticle=" + std::to_string(each.article));
        const base::Value price = row ? row->GetField("FinalPrice") : base::Value();
        if (!price.IsBlank()) each.asked.price = price.ToCurrency();
    }
}

}  // namespace

std::vector<WantedArticle> ReadWantedArticles(SessionState& state,
                                              const web::Request& request,
                                              Refusals& refusals) {
    std::vector<Wish> rows = RowWishes(request);
    std::vector<Wish> codes = CodeWishes(request, refusals);
    FindRows(state, rows);
    FindCodes(state, codes);
    std::vector<WantedArticle> wanted;
    for (auto* wishes : {&rows, &codes}) {
        for (Wish& wish : *wishes) {
            if (!TakeQuantity(state, wish.wanted, refusals)) continue;
            if (wish.wanted.article == 0) {
                refusals.Add(wish.wanted.name, wish.wanted.typed, wish.wanted.box);
            } else {
                wanted.push_back(std::move(wish.wanted));
            }
        }
    }
    TakePrices(state, wanted);
    return wanted;
}

}  // namespace zebtell::orders
