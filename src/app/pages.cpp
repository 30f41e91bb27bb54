#include "app/pages.h"

#include "account/kasutaja.h"
#include "catalogue/kaubainfo.h"
#include "catalogue/kinfo.h"
#include "documents/recent_orders.h"
#include "documents/tellimus.h"
#include "host/logon.h"
#include "host/plain_pages.h"
#include "orders/add_articles.h"
#include "orders/basket_form.h"
#include "orders/kinnitus.h"
#include "orders/koostamine.h"
#include "orders/lisamine.h"
#include "tags/page_tags.h"

namespace zebtell::app {
namespace {

using host::SessionState;
using web::Effect;
using web::Visitors;
using web::Work;

constexpr web::PageRules kEventsShow{.user_event = Effect::kShows};
// Pages that stand open to everybody show a customer's data only inside tags that are empty for
// nobody.
constexpr web::PageRules kOpen{.visitors = Visitors::kEverybody};
constexpr web::PageRules kOpenAndChanges{.visitors = Visitors::kEverybody,
                                         .respond = Effect::kChanges};

// For pages without tags of their own.
void Shared_ProcessTag(SessionState& state, web::Call& call, markup::Tag& tag) {
    const std::string handler = std::string(call.PageName()) + "_ProcessTag";
    tags::ProcessPageTag(state, call, tag, handler, call.PageName(), nullptr);
}

}  // namespace

// clang-format off
std::vector<host::Page> PortalPages() {
    using namespace account;
    using namespace catalogue;
    using namespace documents;
    using namespace host;
    using namespace orders;
    return {
        {"Kaubainfo", "zebtell_kaubad.htm", Kaubainfo_Respond, Kaubainfo_ProcessTag, Kaubainfo_UserEvent,
         {{"Favorites", Kaubainfo_Favorites, Work::kMayWait, Effect::kShows},
          {"Hinnakiri", Kaubainfo_Hinnakiri, Work::kMayWait, Effect::kShows},
          {"Lisamine", Kaubainfo_Lisamine, Work::kMayWait},
          {"MuudaRead", Kaubainfo_MuudaRead},
          {"Navigate", Kaubainfo_Navigate, Work::kQuick, Effect::kShows},
          {"Otsing", Kaubainfo_Otsing, Work::kMayWait, Effect::kShows},
          {"Tellimus", Kaubainfo_Tellimus},
          {"UusTellimus", Kaubainfo_UusTellimus}}, kEventsShow},
        {"Kasutaja", "zebtell_kasutaja.htm", Kasutaja_Respond, Kasutaja_ProcessTag, nullptr, {}, kOpen},
        {"KInfo", "zebtell_info.htm", KInfo_Respond, KInfo_ProcessTag, KInfo_UserEvent, {}, kEventsShow},
        {"Kinnitatud", "zebtell_kinnitatud.htm", Kinnitatud_Respond, Kinnitatud_ProcessTag, Kinnitatud_UserEvent, {}, kEventsShow},
        {"Kinnitus", "zebtell_koost2.htm", Kinnitus_Respond, Kinnitus_ProcessTag, Kinnitus_UserEvent,
         {{"LisaTellimus", Kinnitus_LisaTellimus, Work::kMayWait}}},
        {"Koostamine", "zebtell_koost1.htm", Koostamine_Respond, Koostamine_ProcessTag, Koostamine_UserEvent,
         {{"Vormista", Koostamine_Vormista}}},
        {"Lisamine", "zebtell_lisarida.htm", Lisamine_Respond, Lisamine_ProcessTag, Lisamine_UserEvent,
         {{"Lisamine", Lisamine_Lisamine}}, kEventsShow},
        {"Lisatud", "zebtell_lisatud.htm", Lisatud_Respond, Shared_ProcessTag, nullptr, {}, kOpen},
        {"Logon", "zebtell_logon.htm", Logon_Respond, Shared_ProcessTag, nullptr,
         {{"Logon", Logon_Logon, Work::kLogOn}}, kOpen},
        {"Logout", "zebtell_logout.htm", Logout_Respond, Shared_ProcessTag, nullptr,
         {{"Hyperlink2", Logout_Hyperlink2, Work::kQuick, Effect::kShows}}, kOpenAndChanges},
        {"Raamistik", "zebtell_frame.htm", Raamistik_Respond, Raamistik_ProcessTag, nullptr, {}, kOpen},
        {"Tellimus", "zebtell_tellimus.htm", Tellimus_Respond, Tellimus_ProcessTag, Tellimus_UserEvent, {}, kEventsShow},
        {"Vasak", "zebtell_vasak.htm", Vasak_Respond, Shared_ProcessTag, nullptr,
         {{"Body1", Vasak_Body1, Work::kQuick, Effect::kShows}}, kOpen},
        {"Yld", "zebtell_yld.htm", Yld_Respond, Shared_ProcessTag, nullptr, {}},
    };
}
// clang-format on

}  // namespace zebtell::app
