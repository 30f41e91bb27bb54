#pragma once

#include <exception>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "base/text.h"
#include "markup/tag.h"
#include "web/call.h"
#include "web/page.h"

namespace zebtell::web {

// What a session holds, whatever it is; the page table's State is in it.
class SessionInstance {
  public:
    SessionInstance() = default;
    virtual ~SessionInstance() = default;
    SessionInstance(const SessionInstance&) = delete;
    SessionInstance& operator=(const SessionInstance&) = delete;
};

// The page table and its hooks without the type of their state, so that the runtime is compiled
// once. A function that is empty stands for a handler that the table leaves out.
struct SiteEvent {
    std::string name;
    std::function<void(SessionInstance&, Call&)> handle;
    Work work = Work::kQuick;
    Effect effect = Effect::kChanges;
};

struct SitePage {
    std::string name;
    std::string template_file;
    std::function<void(SessionInstance&, Call&)> respond;
    std::function<void(SessionInstance&, Call&, markup::Tag&)> process_tag;
    std::function<void(SessionInstance&, Call&, std::string_view event)> user_event;
    std::vector<SiteEvent> events;
    PageRules rules = {};

    const SiteEvent* FindEvent(std::string_view event) const;
    Effect EffectOf(std::string_view event) const;  // "": of Respond
};

struct SiteHooks {
    std::function<std::unique_ptr<SessionInstance>()> make_instance;
    std::function<void(SessionInstance&, Call&)> begin_request;
    std::function<void(SessionInstance&, Call&)> start;
    std::function<void(SessionInstance&, Call&)> end_request;
    std::function<void(SessionInstance&, Call&, const std::exception&, bool& send_default)> fatal;
    std::function<Standing(const SessionInstance&)> standing_of;
    std::function<bool(SessionInstance&, Call&)> check_logon;
    std::function<std::string_view(const SessionInstance&)> language;
};

class Site {
  public:
    // Throws std::logic_error when a page, or an event of a page, stands twice or has no name.
    Site(std::vector<SitePage> pages, SiteHooks hooks);

    Site(Site&&) = default;
    Site(const Site&) = delete;

    const SitePage* Find(std::string_view page) const;  // null: there is none
    const SiteHooks& hooks() const { return hooks_; }

  private:
    std::vector<SitePage> pages_;
    SiteHooks hooks_;
    // Of the pages where they lie, which moving the site does not change.
    std::unordered_map<std::string_view, const SitePage*, base::NoCaseHash, base::NoCaseEqual>
        by_name_;
};

}  // namespace zebtell::web
