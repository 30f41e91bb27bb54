#include "app/page_vocabulary.h"

#include <algorithm>

#include "app/pages.h"
#include "catalogue/kaubainfo_tags.h"
#include "catalogue/kinfo.h"
#include "documents/recent_orders.h"
#include "orders/kinnitus.h"
#include "orders/koostamine.h"
#include "orders/lisamine.h"
#include "tags/order_view.h"
#include "tags/page_tags.h"
#include "tags/reference.h"

namespace zebtell::app {
namespace {

// What a page's handlers understand beyond what the page table says.
struct Words {
    std::string_view page;
    const tags::TagTable& (*own_tags)();
    std::vector<std::string_view> event_patterns;  // of its UserEvent
};

const std::vector<Words>& PageWords() {
    static const std::vector<Words> kWords = {
        {"Kaubainfo", catalogue::KaubainfoTagTable, {"ID_*", "*Page"}},
        {"KInfo", catalogue::KInfoTagTable, {"*"}},
        {"Kinnitatud", tags::OrderViewTagTable, {"*"}},
        {"Kinnitus", orders::KinnitusTagTable, {"New", "ID_*", "COPY_*"}},
        {"Koostamine", orders::KoostamineTagTable, {"DEL_*"}},
        {"Lisamine", orders::LisamineTagTable, {"ID_*"}},
        {"Raamistik", documents::RaamistikTagTable, {}},
        {"Tellimus", tags::OrderViewTagTable, {"ID_*"}},
    };
    return kWords;
}

check::CheckedPage Vocabulary(const host::Page& page) {
    check::CheckedPage checked{page.name, page.template_file};
    for (const auto& event : page.events) checked.events.push_back(event.name);
    const auto& words = PageWords();
    const auto own = std::find_if(
        words.begin(), words.end(), [&](const Words& each) { return each.page == page.name; });
    if (own != words.end()) {
        checked.event_patterns = own->event_patterns;
        checked.own_tags = &own->own_tags();
    }
    return checked;
}

}  // namespace

std::vector<check::CheckedPage> PageVocabulary() {
    std::vector<check::CheckedPage> vocabulary;
    for (const host::Page& page : PortalPages()) vocabulary.push_back(Vocabulary(page));
    return vocabulary;
}

void PrintTags(std::ostream& out) {
    tags::PrintReference(out, "Common tags", tags::CommonTagTable());
    tags::PrintReference(out << "\n", "Order summary tags", tags::OrderSummaryTagTable());
    for (const Words& words : PageWords()) {
        tags::PrintReference(out << "\n", words.page, words.own_tags());
    }
}

}  // namespace zebtell::app
