#include "base/ignore_errors.h"
#include "tags/basket_boxes.h"
#include "tags/custom_func.h"
#include "tags/field_text.h"
#include "tags/orders_enable.h"
#include "tags/page_tags.h"
#include "tags/row_loop.h"

namespace zebtell::tags {

namespace {

// A tag's function with errors ignored: the output stays as it was when one struck.
template <void (*Work)(TagCall&), bool Handled>
bool Tolerant(TagCall& call) {
    base::IgnoreErrors([&] { Work(call); });
    return Handled;
}

constexpr bool kHandled = true;
// The output stands, but the page's own handlers are asked too; they do not know these tags.
constexpr bool kPassedOn = false;

void TellSumma(TagCall& call) {
    WriteByPicture(call, call.state.basket.BasketTotal);
}
void TellKogus(TagCall& call) {
    WriteByPicture(call, call.state.basket.BasketQuantity);
}
void TellRidu(TagCall& call) {
    WriteByPicture(call, int{call.state.basket.BasketRowCount});
}

void Tellimus(TagCall& call) {
    const auto& basket = call.state.basket.Basket;
    WriteReference(call, basket ? basket->Header().get() : nullptr, Reference(call));
}

void TellimusExists(TagCall& call) {
    ShowIf(call, call.state.basket.Basket != nullptr);
}
void TellimusNotExists(TagCall& call) {
    ShowIf(call, call.state.basket.Basket == nullptr);
}

void TellimusRida(TagCall& call) {
    call.tag.Hide();
    const std::string reference = Reference(call);
    const std::int16_t row = call.state.basket_form.RowIndex;
    if (!call.state.basket.Basket) return;
    if (reference == "#") {
        call.tag.Write(std::to_string(row));
    } else {
        WriteReference(call, call.state.basket.BasketRows->Item(row).get(), reference);
    }
}

void MuudaKogus(TagCall& call) {
    call.tag.Write("Row_" + std::to_string(call.state.basket_form.RowIndex));
}

void MuudaKogusRefused(TagCall& call) {
    ShowIfRefused(call, "Row_" + std::to_string(call.state.basket_form.RowIndex));
}

void ParentExists(TagCall& call) {
    ShowIf(call, call.state.company.ParentLoaded);
}
void ContactExists(TagCall& call) {
    ShowIf(call, call.state.company.ContactLoaded);
}

void Parent(TagCall& call) {
    const auto& company = call.state.company;
    WriteReference(
        call, company.ParentLoaded ? company.ParentRecord.get() : nullptr, Reference(call));
}

void Contact(TagCall& call) {
    const auto& company = call.state.company;
    WriteReference(
        call, company.ContactLoaded ? company.ContactRecord.get() : nullptr, Reference(call));
}

void PriceQuery(TagCall& call) {
    call.state.templates.PriceQueryText = CleanPriceQueryText(call.tag.TemplateContents());
    call.tag.Hide();
}

// The sales employee of the customer's company; nothing when there is none.
void Employee(TagCall& call) {
    call.tag.Hide();
    const auto& company = call.state.company.CompanyRecord;
    if (!company) return;
    WriteReference(call, company->Children("EREmployee")->Item(1).get(), Reference(call));
}

}  // namespace

const TagTable& OrderSummaryTagTable() {
    static const TagTable table = {
        {"ZEB:TellSumma", Tolerant<TellSumma, kHandled>, "Basket's sum, by a format picture"},
        {"ZEB:TellKogus", Tolerant<TellKogus, kHandled>, "Basket's quantity, by a format picture"},
        {"ZEB:TellRidu", Tolerant<TellRidu, kHandled>, "Basket's rows, by a format picture"},
        {"ZEB:Orders.Enable",
         Tolerant<EnableOrders, kPassedOn>,
         "Whether the customer may order: a company field, or query.field"},
        {"ZEB:Tellimus", Tolerant<Tellimus, kHandled>, "Field of the basket's header"},
        {"ZEB:Tellimus.Exists", Tolerant<TellimusExists, kHandled>, "Contents with a basket"},
        {"ZEB:Tellimus.NotExists",
         Tolerant<TellimusNotExists, kHandled>,
         "Contents without a basket"},
        {"ZEB:Tellimus.Read", Tolerant<ReadRows, kPassedOn>, "Contents for each basket row"},
        {"ZEB:Tellimus.Read.Next",
         Tolerant<ReadNextRow, kPassedOn>,
         "Goes on with the basket rows (made by ZEB:Tellimus.Read)"},
        {"ZEB:Tellimus.Rida",
         Tolerant<TellimusRida, kPassedOn>,
         "Field of the basket row; # is its number"},
        {"ZEB:MuudaKogus", Tolerant<MuudaKogus, kPassedOn>, "Name of the row's quantity field"},
        {"ZEB:MuudaKogus.Refused",
         Tolerant<MuudaKogusRefused, kHandled>,
         "Contents, with what was typed in place of \"Typed\", when that field was refused"},
        {"ZEB:Parent.Exists", Tolerant<ParentExists, kPassedOn>, "Contents with a parent company"},
        {"ZEB:Parent", Tolerant<Parent, kPassedOn>, "Field of the parent company"},
        {"ZEB:Contact.Exists",
         Tolerant<ContactExists, kPassedOn>,
         "Contents with a contact person"},
        {"ZEB:Contact", Tolerant<Contact, kPassedOn>, "Field of the contact person"},
        {"ZEB:GrCompContPerson", Tolerant<Contact, kPassedOn>, "The same as ZEB:Contact"},
        {"ZEB:PriceQuery", Tolerant<PriceQuery, kPassedOn>, "Replaces the customer price query"},
        {"ZEB:Employee", Tolerant<Employee, kHandled>, "Field of the sales employee"},
        {"ZEB:EREmployee", Tolerant<Employee, kHandled>, "The same as ZEB:Employee"},
    };
    return table;
}

bool OrderSummaryTags(TagCall& call) {
    return OrderSummaryTagTable().Offer(call);
}

}  // namespace zebtell::tags
