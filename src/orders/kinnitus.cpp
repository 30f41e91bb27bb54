#include "orders/kinnitus.h"

#include "base/runtime_error.h"
#include "base/text.h"
#include "host/errors.h"
#include "orders/basket_rows.h"
#include "orders/header_fields.h"
#include "orders/refusals.h"
#include "orders/row_block.h"
#include "tags/basket_boxes.h"
#include "tags/field_text.h"
#include "tags/order_view.h"
#include "tags/page_tags.h"

namespace zebtell::orders {
namespace {

using host::SessionState;
using tags::TagCall;

constexpr std::string_view kRowNumbers[] = {"Amount", "Quantity", "UnitPrice"};
constexpr std::string_view kHeaderNumbers[] = {"Amount"};

bool KinnitRida(TagCall& c) {
    const auto& rows = c.state.basket.BasketRows;
    return BasketRowBlock(c, "ZEB:KinnitRida", rows ? rows->Count() : 0);
}

bool OrderRow(TagCall& c) {
    tags::WriteField(c, c.state.basket_form.CurrentBasketRow.get(), kRowNumbers);
    return true;
}

bool Order(TagCall& c) {
    data::Document* basket = c.state.basket.Basket.get();
    if (basket != nullptr && base::EqualNoCase(tags::Reference(c), "Explanation")) {
        tags::WritePlainField(c, *basket->Header(), "Explanation");
        return true;
    }
    tags::WriteField(c, basket == nullptr ? nullptr : basket->Header().get(), kHeaderNumbers);
    return true;
}

// A guest's name and address stand for a shop's, so he is shown only what he has typed himself.
bool Recipient(TagCall& c) {
    c.tag.Hide();
    data::Document* basket = c.state.basket.Basket.get();
    if (basket == nullptr) return true;
    const auto& company = c.state.company.CompanyRecord;
    const bool is_own = company && basket->GetField("CompanyName").ToPlainText() ==
                                       company->GetField("Name").ToPlainText();
    if (!c.state.logon.IsGuest || !is_own) {
        tags::WriteReference(c, basket->Header().get(), tags::Reference(c));
    }
    return true;
}

bool Refused(TagCall& c) {
    tags::ShowIfRefused(c, std::string(c.NameFrom(std::string_view("ZEB:Refused.").size())));
    return true;
}

bool DocKey(TagCall& c) {
    data::Document* basket = c.state.basket.Basket.get();
    c.tag.WriteEscaped(basket == nullptr ? "" : basket->Key());
    return true;
}

// Reserved: the contents stand as they are.
bool MaksuRida(TagCall& c) {
    c.tag.Show();
    return true;
}

void NewBasket(SessionState& state) {
    data::DiscardBasket(state.basket);
    EnsureBasket(state);
}

void OpenStoredOrder(SessionState& state, std::string_view id) {
    state.confirmation.ShownOrderFilter = "ID=" + std::string(id);
    state.basket_form.ReturnPage = "Kaubainfo";
    data::LoadOrderAsBasket(state.application(), state.confirmation.ShownOrderFilter, state.basket);
}

void CopyRow(SessionState& state, data::Record& row, Refusals& refusals) {
    if (row.Status(data::kFixedRow)) return;
    const double quantity = row.GetField("Quantity").ToDouble();
    const auto add = [&] {
        AddBasketRow(state.basket, row.GetField("IDGRArticle").ToInteger64(), quantity, {});
    };
    const auto refuse = [&] {
        const auto settings = state.settings();
        refusals.Add(row.GetField("GRArticle.Code").ToPlainText(),
                     base::Value(quantity).ToText(settings->region()));
    };
    host::Guarded(state, "Kinnitus_UserEvent", add, refuse);
}

void CopyStoredOrder(SessionState& state, std::string_view id) {
    data::ShownDocument stored;
    data::LoadShownOrder(state.application(), "ID=" + std::string(id), stored);
    NewBasket(state);
    state.basket_form.ReturnPage = "Kaubainfo";
    Refusals refusals;
    for (std::int64_t n = 1; n <= stored.Rows->Count(); ++n) {
        CopyRow(state, *stored.Rows->Item(n), refusals);
    }
    refusals.Tell(state);
}

}  // namespace

void Kinnitus_Respond(SessionState& state, web::Call& call) {
    state.basket_form.BasketRowCursor = 1;
    state.basket_form.CurrentBasketRow.reset();
    host::ShowPage(state, call);
    state.basket_form.LastForm = {};
}

void Kinnitus_ProcessTag(SessionState& state, web::Call& call, markup::Tag& tag) {
    tags::ProcessPageTag(state, call, tag, "Kinnitus_ProcessTag", "Kinnitus", &KinnitusTagTable());
}

void Kinnitus_UserEvent(SessionState& state, web::Call& call, std::string_view event) {
    const auto work = [&] {
        if (base::EqualNoCase(event, "New")) {
            NewBasket(state);
        } else if (base::StartsWithNoCase(event, "ID_")) {
            OpenStoredOrder(state, event.substr(3));
        } else if (base::StartsWithNoCase(event, "COPY_")) {
            CopyStoredOrder(state, event.substr(5));
        }
    };
    host::Guarded(state, "Kinnitus_UserEvent", work, [&] {
        state.Message = "Probleem andmete lugemisel, proovige uuesti!";
    });
    // By a redirect: going back to the page must not open the order once more.
    call.RedirectTo("Kinnitus");
}

void Kinnitatud_Respond(SessionState& state, web::Call& call) {
    host::Guarded(state, "Kinnitatud_Respond", [&] { tags::ReadShownOrder(state); });
    tags::RewindOrderView(state);
    host::ShowPage(state, call);
}

void Kinnitatud_ProcessTag(SessionState& state, web::Call& call, markup::Tag& tag) {
    tags::ProcessPageTag(
        state, call, tag, "Kinnitatud_ProcessTag", "Kinnitatud", &tags::OrderViewTagTable());
}

void Kinnitatud_UserEvent(SessionState& state, web::Call& call, std::string_view) {
    Kinnitatud_Respond(state, call);
}

const tags::TagTable& KinnitusTagTable() {
    static const tags::TagTable kTable{
        {"ZEB:KinnitRida", KinnitRida, "contents once for each row of the basket"},
        {"ZEB:SDOrderRow", OrderRow, "a field of the row; prices and sums with two decimals"},
        {"ZEB:SDOrder", Order, "a field of the order; Explanation as plain text"},
        {"ZEB:DocKey", DocKey, "key of the order, for the form's hidden field ZEB_DocKey"},
        {"ZEB:MaksuRida", MaksuRida, "contents as they are"},
        {"ZEB:Recipient",
         Recipient,
         "CompanyName or CompanyAddr of the order; of a guest's only what he has typed"},
        {"ZEB:Refused.*",
         Refused,
         "contents, with what was typed in place of \"Typed\", when the field behind the dot was "
         "refused"},
    };
    return kTable;
}

}  // namespace zebtell::orders
