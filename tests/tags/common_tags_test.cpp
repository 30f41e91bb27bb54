#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>

#include "base/runtime_error.h"
#include "tags/combo.h"
#include "tags/form_values.h"
#include "tags/page_globals.h"
#include "tests/tags/session.h"

namespace zebtell::tags {
namespace {

using base::Value;
using testing::ElementsAre;

web::Request Asked(std::vector<web::Field> query_string) {
    web::Request request;
    request.QueryString = web::FieldList(std::move(query_string));
    return request;
}

TEST(CommonTags, ShowHideAndSettings) {
    struct Row {
        const char* label;
        void (*prepare)(Session&);
        const char* tag;
        const char* contents;
        Answer expected;
    };
    const auto nothing = [](Session&) {};
    const Row rows[] = {
        {"guest", [](Session& s) { s.state.logon.IsGuest = true; }, "ZEB:WEBGuest", "x", {"x", 1}},
        {"no guest", nothing, "ZEB:WEBGuest", "x", {"", 1}},
        {"user", nothing, "zeb:webuser", "x", {"x", 1}},
        {"guest is no user",
         [](Session& s) { s.state.logon.IsGuest = true; },
         "ZEB:WEBUser",
         "x",
         {"", 1}},
        {"password", nothing, "ZEB:LogonPWD", "x", {"x", 1}},
        {"no ID card", nothing, "ZEB:LogonEID", "x", {"", 1}},
        {"message",
         [](Session& s) { s.state.Message = "<ZEB:X> \"Message\" & 'b'"; },
         "ZEB:WEBMessage",
         "<b>Message</b> message",
         {"<b>&lt;ZEB:X&gt; &quot;Message&quot; &amp; &#39;b&#39;</b> "
          "&lt;ZEB:X&gt; &quot;Message&quot; &amp; &#39;b&#39;",
          1}},
        {"no message", nothing, "ZEB:WEBMessage", "<b>Message</b>", {"", 1}},
        {"allowed",
         [](Session& s) { s.state.templates.OrdersAllowed = true; },
         "ZEB:Orders.Allowed",
         "x",
         {"x", 1}},
        {"not allowed", nothing, "ZEB:Orders.Allowed", "x", {"", 1}},
        {"blocked", nothing, "ZEB:Orders.Blocked", "x", {"x", 1}},
        {"nothing saved yet", nothing, "ZEB:SaveValue", "save_a", {"", 1}},
        {"saved",
         [](Session& s) { s.state.templates.SavedValues.emplace()["save_a"] = "<b>\"1\""; },
         "ZEB:SaveValue",
         " SAVE_A ",
         {"&lt;b&gt;&quot;1&quot;", 1}},
        {"another key saved",
         [](Session& s) { s.state.templates.SavedValues.emplace()["save_a"] = "1"; },
         "ZEB:SaveValue",
         "save_b",
         {"", 1}},
        {"no company", nothing, "ZEB:Company", "Name", {"", 0}},
        {"company, passed on",
         [](Session& s) {
             s.state.company.CompanyLoaded = true;
             s.state.company.CompanyRecord = fake::MakeRecord({{"Name", "<Mets>"}});
         },
         "ZEB:Company",
         "Name",
         {"&lt;Mets&gt;", 0}},
        {"unknown", nothing, "ZEB:HKRida", "x", {"x", 0}},
    };
    for (const auto& row : rows) {
        Session session;
        row.prepare(session);
        EXPECT_EQ(session.Ask(CommonTags, row.tag, row.contents), row.expected) << row.label;
    }
}

TEST(CommonTags, MessageIsShownOnce) {
    Session session;
    session.state.Message = "Saved";
    EXPECT_EQ(session.Page("<ZEB:WEBMessage>Message!</ZEB:WEBMessage>"
                           "<ZEB:WEBMessage>Message!</ZEB:WEBMessage>"),
              "Saved!");
}

TEST(CommonTags, NumbersThatTemplatesSet) {
    const struct {
        const char* contents;
        std::int32_t store;
        int decimals;
    } rows[] = {
        {"3", 3, 3}, {" 2,5 ", 2, 2}, {"-1", -1, -1}, {"", 7, 7}, {"x", 7, 7}, {"1x", 7, 7}};
    for (const auto& row : rows) {
        Session session;
        session.state.templates.StoreID = 7;
        session.state.basket_form.QuantityDecimals = 7;
        EXPECT_EQ(session.Ask(CommonTags, "ZEB:SetStoreID", row.contents), (Answer{"", true}));
        EXPECT_EQ(session.Ask(CommonTags, "ZEB:RoundQuantity", row.contents), (Answer{"", true}));
        EXPECT_EQ(session.state.templates.StoreID, row.store) << row.contents;
        EXPECT_EQ(session.state.basket_form.QuantityDecimals, row.decimals) << row.contents;
    }
    Session session;
    EXPECT_THROW(session.Ask(CommonTags, "ZEB:RoundQuantity", "40000"), base::RuntimeError);
    EXPECT_EQ(session.state.basket_form.QuantityDecimals, 0);
}

TEST(CommonTags, PageGlobals) {
    Session session;
    EXPECT_EQ(session.Ask(CommonTags, "ZEB:WEBLanguage", " EN "), (Answer{"", true}));
    EXPECT_EQ(PageLanguage, "EN");
    host::Settings settings;
    settings.ESTEID.IsOn = true;
    ResetPageGlobals(settings);
    EXPECT_EQ(PageLanguage, "");
    EXPECT_EQ(session.Ask(CommonTags, "ZEB:LogonEID", "x"), (Answer{"x", true}));
    EXPECT_EQ(session.Ask(CommonTags, "ZEB:LogonPWD", "x"), (Answer{"", true}));

    session.Ask(CommonTags, "ZEB:WEBLanguage", "EN");
    WebClassHooks().BeginRequest(session.state, session.call);
    EXPECT_EQ(PageLanguage, "");
    EXPECT_EQ(session.state.SessionID, "1");
    EXPECT_EQ(session.Ask(CommonTags, "ZEB:LogonPWD", "x"), (Answer{"x", true}));
}

TEST(CreateCombo, Options) {
    const struct {
        const char* label;
        const char* definition;
        const char* expected;
        const char* asked;
    } rows[] = {
        {"four fields",
         "GRStore;ID;Name;Name",
         "<option value=1>Ladu 1</option>\r\n<option value=2>L\u00E4ti</option>\r\n",
         "OpenList GRStore||Name"},
        {"attributes",
         "GRStore;ID;Name;;id=\"s#V\" class=#V",
         "<option value=1 id=\"s1\" class=1>Ladu 1</option>\r\n"
         "<option value=2 id=\"s2\" class=2>L\u00E4ti</option>\r\n",
         "OpenList GRStore||"},
        {"more",
         "GRStore;ID;Name;;x;y=#V",
         "<option value=1 x;y=#V>Ladu 1</option>\r\n<option value=2 x;y=#V>L\u00E4ti</option>\r\n",
         "OpenList GRStore||"},
        {"criteria",
         "GRStore;ID;Name;Name desc;; ;{IDGRCompany=#F or ID=#F}",
         "<option value=1 >Ladu 1</option>\r\n<option value=2 >L\u00E4ti</option>\r\n",
         "OpenList GRStore|{IDGRCompany=42 or ID=42}|Name desc"},
        {"three fields", "GRStore;ID;Name", "", nullptr},
        {"nothing", "", "", nullptr},
    };
    for (const auto& row : rows) {
        Session session;
        session.application->lists["GRStore"] =
            fake::MakeList({{{"ID", 1}, {"Name", "Ladu 1"}}, {{"ID", 2}, {"Name", "L\u00E4ti"}}});
        EXPECT_EQ(session.Ask(CommonTags, "ZEB:CreateCombo", row.definition),
                  (Answer{row.expected, true}))
            << row.label;
        if (row.asked == nullptr) {
            EXPECT_TRUE(session.application->asked.empty()) << row.label;
        } else {
            EXPECT_THAT(session.application->asked, ElementsAre(row.asked)) << row.label;
        }
    }
}

TEST(CreateCombo, HostileTextStaysText) {
    Session session;
    session.application->lists["T"] =
        fake::MakeList({{{"V", "a b><ZEB:X>"}, {"N", "</option><ZEB:X> \"&'"}},
                        {{"V", Value::Null()}, {"N", Value::Null()}}});
    EXPECT_EQ(session.Page("<ZEB:CreateCombo>T;V;N;;title=\"#V\"</ZEB:CreateCombo>"),
              "<option value=a&#32;b&#62;&#60;ZEB:X&#62; title=\"a&#32;b&#62;&#60;ZEB:X&#62;\">"
              "&lt;/option&gt;&lt;ZEB:X&gt; &quot;&amp;&#39;</option>\r\n"
              "<option value= title=\"\"></option>\r\n");
    EXPECT_EQ(BareAttribute("K-1_2.5/\u00E4,+(x)"), "K-1_2.5/\u00E4,+(x)");
    EXPECT_EQ(BareAttribute("'\"`=&\t\r\n"), "&#39;&#34;&#96;&#61;&#38;&#9;&#13;&#10;");
}

TEST(CreateCombo, ErrorLeavesNoDefinitionOnThePage) {
    Session session;
    EXPECT_EQ(session.Page("a<ZEB:CreateCombo>Unknown;ID;Name;</ZEB:CreateCombo>b"), "ab");
}

// "criteria|master|mode|order|masterq|context"
std::string Defined(Session& session, const char* name) {
    const data::clsQuery& query = GetQuery(session.state, name, "Kaubainfo");
    return query.Criteria + "|" + query.Master + "|" + query.Mode + "|" + query.Order() + "|" +
           query.MasterQ + "|" + query.Context;
}

TEST(Query, Definition) {
    const struct {
        const char* label;
        const char* contents;
        const char* expected;
    } rows[] = {
        {"four fields", "Q;IDGRCompany;M;list", "IDGRCompany|M|list|||Kaubainfo"},
        {"cleaned", "Q; ID\u00A0;\u00A0M ; list ; Name ; X ", "ID|M|list|Name|X|Kaubainfo"},
        {"order of the link", "Q;ID;;;#Sort;X", "ID|||Price|X|Kaubainfo"},
        {"order of a link without one", "Q;ID;;;#Other", "ID|||||Kaubainfo"},
    };
    for (const auto& row : rows) {
        Session session(Asked({{"sort", " Price-- "}}));
        EXPECT_EQ(session.Ask(CommonTags, "ZEB:Query", row.contents), (Answer{"", true}));
        EXPECT_EQ(Defined(session, "Q"), row.expected) << row.label;
    }
    Session session;
    EXPECT_EQ(session.Ask(CommonTags, "ZEB:Query", "Q;ID;M"), (Answer{"", true}));
    EXPECT_FALSE(QueryExists(session.state, "Q", "Kaubainfo"));
}

TEST(Query, KeepsItsRecordsUntilTheOrderChanges) {
    Session session;
    session.Ask(CommonTags, "ZEB:Query", "Q;ID;M;;Name");
    data::clsQuery& query = GetQuery(session.state, "Q", "Kaubainfo");
    query.Records(Value(1));
    session.Ask(CommonTags, "ZEB:Query.Advance", "q");
    session.Ask(CommonTags, "ZEB:Query", "Q;Other;M;;NAME");
    EXPECT_EQ(Defined(session, "Q"), "ID|M||Name||Kaubainfo");
    EXPECT_EQ(query.RecNo, 2);
    EXPECT_FALSE(query.notCreated());

    session.Ask(CommonTags, "ZEB:Query", "Q;Other;M;;Code");
    EXPECT_EQ(Defined(session, "Q"), "Other|M||Code||Kaubainfo");
    EXPECT_TRUE(query.notCreated());
}

TEST(Query, Commands) {
    Session session;
    for (const char* tag : {"ZEB:Query.Reset", "ZEB:Query.Requery", "ZEB:Query.Advance"}) {
        EXPECT_EQ(session.Ask(CommonTags, tag, "Q"), (Answer{"", true})) << tag;
    }
    EXPECT_FALSE(QueryExists(session.state, "Q", "Kaubainfo"));

    data::clsQuery& query = GetQuery(session.state, "Q", "Kaubainfo");
    query.Records();
    session.Ask(CommonTags, "ZEB:Query.Advance", " Q ");
    session.Ask(CommonTags, "ZEB:Query.Advance", "Q");
    EXPECT_EQ(query.RecNo, 3);
    session.Ask(CommonTags, "ZEB:Query.Reset", "Q");
    EXPECT_EQ(query.RecNo, 1);
    EXPECT_FALSE(query.notCreated());
    query.RecNo = 2;
    session.Ask(CommonTags, "ZEB:Query.Requery", "Q");
    EXPECT_EQ(query.RecNo, 1);
    EXPECT_TRUE(query.notCreated());

    query.RecNo = std::numeric_limits<int>::max();
    EXPECT_THROW(session.Ask(CommonTags, "ZEB:Query.Advance", "Q"), base::RuntimeError);
}

TEST(QueryRow, Output) {
    Session session;
    session.application->any_query = fake::MakeList({{{"Name", "a"}}, {{"Name", "b"}}});

    markup::TagForTest unknown("zeb:List.ROW", "C");
    TagCall call{session.state, session.call, unknown.tag(), "Kaubainfo"};
    EXPECT_FALSE(CommonTags(call));
    EXPECT_EQ(unknown.TagContents(), "C");
    EXPECT_EQ(unknown.tag().TagName(), "zeb:List");

    data::clsQuery& query = GetQuery(session.state, "List", "Kaubainfo");
    EXPECT_EQ(session.Ask(CommonTags, "ZEB:List.Row", "C"),
              (Answer{"C\r\n<ZEB:List.Row>C</ZEB:List.Row>", true}));
    query.RecNo = 2;
    EXPECT_EQ(session.Ask(CommonTags, "ZEB:List.Row", "C"),
              (Answer{"C\r\n<ZEB:List.Row>C</ZEB:List.Row>", true}));
    query.RecNo = 3;
    EXPECT_EQ(session.Ask(CommonTags, "ZEB:List.Row", "C"), (Answer{"", true}));
}

TEST(QueryRow, KeyOfTheRows) {
    Session session;
    GetQuery(session.state, "List", "Kaubainfo").Criteria = "IDX";
    session.Ask(CommonTags, "ZEB:List.Row", "C");
    session.row_key = 17;
    session.Ask(CommonTags, "ZEB:List.Row", "C");
    EXPECT_THAT(session.application->asked,
                ElementsAre("OpenQuery SELECT * FROM List WHERE IDX=42",
                            "OpenQuery SELECT * FROM List WHERE IDX=17"));
}

}  // namespace
}  // namespace zebtell::tags
