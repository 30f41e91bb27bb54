#pragma once

#include <unistd.h>

#include <atomic>
#include <filesystem>
#include <fstream>
#include <future>
#include <map>
#include <mutex>
#include <string>

#include "base/runtime_error.h"
#include "web/page_runtime.h"

namespace zebtell::web {

// What happened, in order, over all sessions.
class Journal {
  public:
    void Add(const std::string& line) {
        const std::lock_guard lock(mutex_);
        text_ += text_.empty() ? line : " " + line;
    }
    std::string Take() {
        const std::lock_guard lock(mutex_);
        return std::exchange(text_, {});
    }

  private:
    std::mutex mutex_;
    std::string text_;
};

// What a session of the small site below holds.
struct TestState {
    Journal& journal;
    int visits = 0;  // not atomic: one request of a session runs at a time
    bool logged_on = false;
    // For handlers that meet other sessions'.
    std::function<void()> meet = {};
};

inline void Esimene_Respond(TestState& state, Call& call) {
    ++state.visits;
    state.journal.Add("Esimene");
    call.WriteTemplate();
}
inline void Esimene_ProcessTag(TestState& state, Call& call, markup::Tag& tag) {
    if (tag.LowerName() == "zeb:page") tag.WriteEscaped(call.PageName());
    if (tag.LowerName() == "zeb:visits") tag.WriteEscaped(std::to_string(state.visits));
    if (tag.LowerName() == "zeb:link") tag.Write(call.URLFor("TEINE", "ID_7 &\"\xC3\xB5"));
    if (tag.LowerName() == "zeb:throw") throw base::RuntimeError(13);
}
inline void Esimene_UserEvent(TestState&, Call& call, std::string_view event) {
    if (event != "silent") call.response.Write("user:" + std::string(event));
}
inline void Esimene_Loe(TestState& state, Call& call) {
    ++state.visits;
    std::string fields;
    for (const Field& field : call.request.Form) fields += field.name + "=" + field.value + ";";
    call.response.Write(fields + call.request.Value("both"));
}
inline void Esimene_Vaikne(TestState&, Call&) {}
inline void Esimene_Edasi(TestState& state, Call& call) {
    state.journal.Add("Edasi");
    call.response.Write("from " + std::string(call.PageName()) + ", ");
    call.NextItem("teine");
}
inline void Esimene_Suuna(TestState&, Call& call) {
    call.response.Write("not shown");
    call.RedirectTo("teine", "x y");
}
inline void Esimene_Viga(TestState&, Call& call) {
    call.response.Write("half a page");
    call.response.Redirect("/somewhere");
    throw base::RuntimeError(13, "secret detail");
}
inline void Esimene_Number(TestState&, Call&) {
    throw 42;
}
inline void Esimene_Sisene(TestState& state, Call& call) {
    state.logged_on = true;
    call.RenewToken();
    call.response.Write("in");
}
inline void Esimene_Valju(TestState& state, Call& call) {
    state.logged_on = false;
    call.ReleaseInstance();
    call.response.Write("out");
}
inline void Esimene_Oota(TestState& state, Call& call) {
    ++state.visits;
    if (state.meet) state.meet();
    call.response.Write(std::to_string(state.visits));
}
inline void Teine_Respond(TestState& state, Call& call) {
    state.journal.Add("Teine");
    call.response.Write("second " + std::string(call.PageName()));
}
inline void Ring_Respond(TestState&, Call& call) {
    call.NextItem("Ring");
}
inline void Mujale_Respond(TestState&, Call& call) {
    call.NextItem("Nowhere");
}

inline std::vector<Page<TestState>> TestPages() {
    return {
        {"Esimene",
         "esimene.htm",
         Esimene_Respond,
         Esimene_ProcessTag,
         Esimene_UserEvent,
         {{"Loe", Esimene_Loe},
          {"Edasi", Esimene_Edasi},
          {"Suuna", Esimene_Suuna},
          {"Viga", Esimene_Viga},
          {"Number", Esimene_Number},
          {"Sisene", Esimene_Sisene, Work::kMayWait},
          {"Valju", Esimene_Valju},
          {"Oota", Esimene_Oota, Work::kMayWait},
          {"Logi", Esimene_Oota, Work::kLogOn}}},
        {"Teine", "teine.htm", Teine_Respond, nullptr, nullptr, {}},
        {"Mall",
         "teine.htm",
         nullptr,
         nullptr,
         Esimene_UserEvent,
         {{"Vaikne", Esimene_Vaikne}, {"Vaata", Esimene_Loe, Work::kQuick, Effect::kShows}}},
        {"Ring", "teine.htm", Ring_Respond, nullptr, nullptr, {}},
        {"Mujale", "teine.htm", Mujale_Respond, nullptr, nullptr, {}},
        {"Teeb", "teine.htm", Teine_Respond, nullptr, nullptr, {}, {.respond = Effect::kChanges}},
        {"Puudu", "missing.htm", nullptr, nullptr, nullptr, {}},
        {"Halb", "halb.htm", nullptr, Esimene_ProcessTag, nullptr, {}},
    };
}

inline WebClass<TestState> TestHooks() {
    return {
        .BeginRequest = [](TestState& state, Call&) { state.journal.Add("begin"); },
        .Start =
            [](TestState& state, Call& call) {
                state.journal.Add("start");
                call.NextItem("Esimene");
            },
        .EndRequest = [](TestState& state, Call&) { state.journal.Add("end"); },
        .FatalErrorResponse =
            [](TestState& state, Call& call, const std::exception& error, bool& SendDefault) {
                state.journal.Add(std::string("fatal(") + error.what() + ")");
                if (call.request.Value("own").empty()) return;
                call.response.Write("own error page");
                SendDefault = false;
            },
        .Terminate = [](TestState& state) { state.journal.Add("terminate"); },
        .StandingOf =
            [](const TestState& state) {
                return state.logged_on ? Standing::kUser : Standing::kAnonymous;
            },
    };
}

// A runtime of the small site over a template folder of its own, with a clock that tests move.
class TestSite {
  public:
    explicit TestSite(RuntimeOptions options = {}) : templates_({folder_}) {
        Put("esimene.htm", "<p><ZEB:Page/> <ZEB:Visits/> <ZEB:Link/></p>");
        Put("teine.htm", "second template <ZEB:Page>kept</ZEB:Page>");
        Put("halb.htm", "so far <ZEB:Throw/>");
        options.clock = [this] { return now_.load(); };
        runtime_.emplace(
            TestPages(),
            TestHooks(),
            [this] {
                journal_.Add("initialize");
                return std::unique_ptr<TestState>(new TestState{journal_, 0, false, meet});
            },
            templates_,
            std::move(options));
    }
    ~TestSite() {
        runtime_.reset();
        std::filesystem::remove_all(folder_);
    }

    PageRuntime<TestState>& runtime() { return *runtime_; }
    Journal& journal() { return journal_; }
    void Pass(std::chrono::minutes time) { now_ = now_.load() + time; }

    std::function<void()> meet;  // set before the sessions are made

  private:
    static std::filesystem::path MakeFolder() {
        std::string pattern = (std::filesystem::temp_directory_path() / "zebtell-XXXXXX").string();
        return mkdtemp(pattern.data());
    }
    void Put(const std::string& name, std::string_view text) const {
        std::ofstream(folder_ / name, std::ios::binary) << text;
    }

    const std::filesystem::path folder_ = MakeFolder();
    Journal journal_;
    std::atomic<std::chrono::steady_clock::time_point> now_ = std::chrono::steady_clock::now();
    markup::TemplateCache templates_;
    std::optional<PageRuntime<TestState>> runtime_;
};

// A browser with its cookie.
class Browser {
  public:
    explicit Browser(TestSite& site) : site_(site) {}

    http::Response Send(http::Request request) {
        request.headers.emplace_back("Host", "shop.example:8080");
        if (!cookie.empty()) request.headers.emplace_back("Cookie", "other=1; ZEBTell=" + cookie);
        // Shared with the responder, which may still be running when the answer is here.
        auto answer = std::make_shared<std::promise<http::Response>>();
        auto future = answer->get_future();
        site_.runtime()(std::move(request),
                        [answer](http::Response response) { answer->set_value(response); });
        http::Response response = future.get();
        for (const auto& [name, value] : response.headers) {
            if (name == "Set-Cookie") cookie = value.substr(8, value.find(';') - 8);
        }
        return response;
    }
    http::Response Get(const std::string& target, std::vector<http::Header> headers = {}) {
        return Send({.method = "GET",
                     .target = target,
                     .headers = std::move(headers),
                     .body = {},
                     .remote_address = "10.0.0.9"});
    }
    http::Response Post(const std::string& target,
                        const std::string& body,
                        std::vector<http::Header> headers = {}) {
        headers.emplace_back("Content-Type", "application/x-www-form-urlencoded");
        return Send({.method = "POST",
                     .target = target,
                     .headers = std::move(headers),
                     .body = body,
                     .remote_address = "10.0.0.9"});
    }

    std::string cookie;

  private:
    TestSite& site_;
};

inline std::string HeaderOf(const http::Response& response, std::string_view name) {
    for (const auto& [header, value] : response.headers)
        if (header == name) return value;
    return "(none)";
}

}  // namespace zebtell::web
