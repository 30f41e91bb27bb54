#include "web/site.h"

#include <set>
#include <stdexcept>
#include <utility>

namespace zebtell::web {
namespace {

void CheckEvents(const SitePage& page) {
    std::set<std::string> names;
    for (const SiteEvent& event : page.events) {
        if (event.name.empty() || !event.handle || !names.insert(base::Lower(event.name)).second)
            throw std::logic_error("Page " + page.name + ": bad or repeated event " + event.name);
    }
}

}  // namespace

const SiteEvent* SitePage::FindEvent(std::string_view event) const {
    for (const SiteEvent& candidate : events)
        if (base::EqualNoCase(candidate.name, event)) return &candidate;
    return nullptr;
}

Effect SitePage::EffectOf(std::string_view event) const {
    if (event.empty()) return rules.respond;
    const SiteEvent* custom = FindEvent(event);
    return custom == nullptr ? rules.user_event : custom->effect;
}

Site::Site(std::vector<SitePage> pages, SiteHooks hooks)
    : pages_(std::move(pages)), hooks_(std::move(hooks)) {
    for (const SitePage& page : pages_) {
        if (page.name.empty() || !by_name_.emplace(page.name, &page).second)
            throw std::logic_error("Page without a name or twice in the table: " + page.name);
        CheckEvents(page);
    }
}

const SitePage* Site::Find(std::string_view page) const {
    const auto found = by_name_.find(page);
    return found == by_name_.end() ? nullptr : found->second;
}

}  // namespace zebtell::web
