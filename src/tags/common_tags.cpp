#include <utility>

#include "base/text.h"
#include "markup/escape.h"
#include "tags/combo.h"
#include "tags/custom_func.h"
#include "tags/field_text.h"
#include "tags/page_globals.h"
#include "tags/page_tags.h"
#include "tags/query_tags.h"

namespace zebtell::tags {

namespace {

constexpr bool kHandled = true;

bool WEBGuest(TagCall& call) {
    ShowIf(call, call.state.logon.IsGuest);
    return kHandled;
}

bool WEBUser(TagCall& call) {
    ShowIf(call, !call.state.logon.IsGuest);
    return kHandled;
}

bool WEBMessage(TagCall& call) {
    const std::string message = std::exchange(call.state.Message, {});
    if (message.empty()) {
        call.tag.Hide();
    } else {
        call.tag.Write(
            base::ReplacedNoCase(call.tag.TemplateContents(), "Message", markup::Escaped(message)));
    }
    return kHandled;
}

bool WEBLanguage(TagCall& call) {
    PageLanguage = base::Trimmed(call.tag.TemplateContents());
    call.tag.Hide();
    return kHandled;
}

bool Interrupted(TagCall& call) {
    auto& logon = call.state.logon;
    ShowIf(call, logon.LoggedOn && std::exchange(logon.LostForm, false));
    return kHandled;
}

bool Lang(TagCall& call) {
    call.tag.Write(std::string(host::LanguageCode(call.state.settings()->language())));
    return kHandled;
}

// Texts are translated as templates are read; this is one that a tag has put on the page.
bool Text(TagCall& call) {
    call.tag.Show();
    return kHandled;
}

// In a file's address, so that browsers keep it until it changes.
bool FileVersion(TagCall& call) {
    const auto& version = call.state.services.file_version;
    const std::string name(base::Trimmed(call.tag.TemplateContents()));
    call.tag.Write(version ? version(name) : std::string());
    return kHandled;
}

bool LogonPWD(TagCall& call) {
    ShowIf(call, !IDCardLogon);
    return kHandled;
}

bool LogonEID(TagCall& call) {
    ShowIf(call, IDCardLogon);
    return kHandled;
}

bool CreateCombo(TagCall& call) {
    call.tag.Hide();  // an error on the way leaves no definition on the page
    call.tag.Write(ComboOptions(call.state.application(),
                                call.tag.TemplateContents(),
                                call.state.company.CustomerKey,
                                RegionOf(call.state)));
    return kHandled;
}

bool SetStoreID(TagCall& call) {
    const auto number = base::Value(Reference(call));
    call.tag.Hide();
    if (number.IsNumeric()) call.state.templates.StoreID = number.ToInteger32();
    return kHandled;
}

bool OrdersAllowed(TagCall& call) {
    ShowIf(call, call.state.templates.OrdersAllowed == true);
    return kHandled;
}

bool OrdersBlocked(TagCall& call) {
    ShowIf(call, call.state.templates.OrdersAllowed != true);
    return kHandled;
}

bool SaveValue(TagCall& call) {
    call.tag.Hide();
    const auto& saved = call.state.templates.SavedValues;
    if (!saved) return kHandled;
    if (const auto found = saved->find(Reference(call)); found != saved->end()) {
        call.tag.WriteEscaped(found->second);
    }
    return kHandled;
}

bool RoundQuantity(TagCall& call) {
    const auto number = base::Value(Reference(call));
    call.tag.Hide();
    if (number.IsNumeric()) call.state.basket_form.QuantityDecimals = number.ToInteger16();
    return kHandled;
}

// So that a navigation that all pages share can mark the one that is shown.
bool OnPage(TagCall& call) {
    ShowIf(call,
           base::EqualNoCase(call.NameFrom(std::string_view("ZEB:Page.").size()),
                             call.call.PageName()));
    return kHandled;
}

// Not handled in spite of its output, as templates know it; no later handler has this tag.
bool Company(TagCall& call) {
    const auto& company = call.state.company;
    WriteReference(call,
                   company.CompanyLoaded ? company.CompanyRecord.get() : nullptr,
                   call.tag.TemplateContents());
    return !kHandled;
}

}  // namespace

const TagTable& CommonTagTable() {
    static const TagTable table = {
        {"ZEB:WEBGuest", WEBGuest, "Contents for the guest only"},
        {"ZEB:WEBUser", WEBUser, "Contents for named users only"},
        {"ZEB:WEBMessage", WEBMessage, "Once: contents with the message in place of \"Message\""},
        {"ZEB:Interrupted",
         Interrupted,
         "Once behind a log-on: contents when a form was lost with the session before"},
        {"ZEB:WEBLanguage", WEBLanguage, "Sets the page's language"},
        {"ZEB:Lang", Lang, "Code of the language that the page is in: et, en, lv"},
        {"ZEB:Text", Text, "Contents in the language of the page"},
        {"ZEB:FileVersion",
         FileVersion,
         "What changes with the static file named, for its address"},
        {"ZEB:LogonPWD", LogonPWD, "Contents when users log on with a password"},
        {"ZEB:LogonEID", LogonEID, "Contents when users log on with an ID card"},
        {"ZEB:CreateCombo",
         CreateCombo,
         "Options: table;value;text;order[;attributes with #V[;more[;criteria with #F]]]"},
        {"ZEB:Query", DefineQuery, "Defines a query: name;column;master;mode[;order[;masterq]]"},
        {"ZEB:Query.Reset", ResetQuery, "Back to the first record of the query named"},
        {"ZEB:Query.Requery", RequeryQuery, "Reads the query named again"},
        {"ZEB:Query.Advance", AdvanceQuery, "On to the next record of the query named"},
        {"ZEB:SetStoreID", SetStoreID, "Sets the store by its ID"},
        {"ZEB:Orders.Allowed", OrdersAllowed, "Contents when the customer may order"},
        {"ZEB:Orders.Blocked", OrdersBlocked, "Contents when the customer may not order"},
        {"ZEB:SaveValue", SaveValue, "The posted value of the field named (save_...)"},
        {"ZEB:RoundQuantity", RoundQuantity, "Sets the decimals of typed quantities"},
        {"ZEB:Company", Company, "Field of the customer's company"},
        {"ZEB:Page.*", OnPage, "Contents on the page named behind the dot"},
        {"*.Row", QueryRow, "Contents for each record of the query named"},
    };
    return table;
}

bool CommonTags(TagCall& call) {
    return CommonTagTable().Offer(call);
}

}  // namespace zebtell::tags
