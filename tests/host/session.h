#pragma once

#include <memory>
#include <string>

#include "host/web_class.h"
#include "tests/support/fake_data.h"
#include "tests/support/temp_folder.h"

namespace zebtell::host {

// A session over a company database in memory, with a clock that the test sets and a log that it
// reads.
class TestSession {
  public:
    explicit TestSession(const std::string& ini = "") {
        folder.Write("ZEBTell.ini", ini);
        state = NewSession(services);
    }

    // One request to `handler`; the response is left in `response`.
    template <class Handler>
    void Ask(Handler handler, web::FieldList form = {}) {
        request.Form = std::move(form);
        request.remote_address = "10.1.2.3";
        response = {};
        call = std::make_unique<web::Call>(request, response, runtime, "77");
        handler(*state, *call);
    }

    std::string Log() const { return folder.Read("ZEBTell.log"); }

    TempFolder folder;
    base::DateTime now = *base::DateTime::FromIso("2026-11-21 14:05:09");
    // What the next log-on finds.
    std::function<std::unique_ptr<fake::Application>()> database = [] {
        auto application = std::make_unique<fake::Application>();
        application->user_name = "mari";
        application->user_password = "Sala";
        application->user->fields = {{"IDPartner", 5},
                                     {"Partner.PriceCut", -10.0},
                                     {"Partner.IDGRPriceList", base::Value::Null()},
                                     {"Partner.IDSettlCompany", base::Value::Null()},
                                     {"IDGRCompContPerson", 8}};
        application->lists["GRCompany"] =
            fake::MakeList({{{"ID", 5}, {"IDParent", base::Value::Null()}}});
        application->lists["GRCompContPerson"] = fake::MakeList({{{"ID", 8}, {"Name", "Mari"}}});
        application->default_link = 3;
        return application;
    };
    SettingsStore settings{folder.path()};
    Services services{settings, [this] { return database(); }, [this] { return now; }};
    std::unique_ptr<SessionState> state;
    web::Request request;
    web::Response response;
    int templates_written = 0;
    web::Call::Runtime runtime{
        [this](web::Call&) { ++templates_written; },
        [](std::string_view page, std::string_view) { return "?page=" + std::string(page); }};
    std::unique_ptr<web::Call> call;
};

}  // namespace zebtell::host
