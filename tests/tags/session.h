#pragma once

#include <filesystem>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "host/session_state.h"
#include "markup/template.h"
#include "tags/page_tags.h"
#include "tests/support/fake_data.h"
#include "tests/support/tag_for_test.h"

namespace zebtell::tags {

// One tag's output and whether later handlers were told to leave it alone.
struct Answer {
    std::string output;
    bool handled = false;

    friend bool operator==(const Answer&, const Answer&) = default;
    friend void PrintTo(const Answer& answer, std::ostream* out) {
        *out << '"' << answer.output << "\" " << (answer.handled ? "handled" : "passed on");
    }
};

// A logged-on session of customer 42 on the page "Kaubainfo", Estonian, over a database in memory.
class Session {
  public:
    explicit Session(web::Request posted = {}) : request(std::move(posted)) {
        auto owned = std::make_unique<fake::Application>();
        application = owned.get();
        state.logon.Application = std::move(owned);
        state.logon.LoggedOn = true;
        state.company.CustomerKey = 42;
    }

    Answer Ask(bool (*handler)(TagCall&), const std::string& name, std::string contents = {}) {
        markup::TagForTest tag(name, std::move(contents));
        TagCall tag_call{state, call, tag.tag(), "Kaubainfo", row_key};
        const bool handled = handler(tag_call);
        return {tag.TagContents(), handled};
    }

    std::string Page(const std::string& text, const TagTable* own = nullptr) {
        std::string out;
        markup::Expand(
            *markup::Template::Parse("page.htm", text),
            [&](markup::Tag& tag) {
                ProcessPageTag(state, call, tag, "Kaubainfo_ProcessTag", "Kaubainfo", own, row_key);
            },
            out);
        return out;
    }

    // A basket of rows with these status bits, "Code" A1, A2, ...
    void MakeBasket(const std::vector<int>& row_status) {
        auto document = std::make_shared<fake::Document>();
        for (const int status : row_status) {
            const std::string code = "A" + std::to_string(document->rows->rows.size() + 1);
            document->rows->rows.push_back(fake::MakeRecord({{"Code", code}}, status));
        }
        state.basket.Basket = document;
        state.basket.BasketRows = document->rows;
    }

    host::SettingsStore settings{std::filesystem::path()};
    host::Services services{settings, {}, [] { return base::DateTime(); }};
    host::SessionState state{services};
    fake::Application* application = nullptr;
    web::Request request;
    web::Response response;
    web::Call::Runtime runtime;
    web::Call call{request, response, runtime, "1"};
    std::int32_t row_key = 0;
};

}  // namespace zebtell::tags
