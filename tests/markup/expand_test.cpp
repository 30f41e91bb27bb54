#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "markup/node.h"
#include "markup/template.h"
#include "tests/support/tag_for_test.h"

namespace zebtell::markup {
namespace {

using testing::AllOf;
using testing::HasSubstr;

std::string Expanded(std::string text,
                     const std::function<void(Tag&)>& handler,
                     const ExpandLimits& limits = {}) {
    std::string out;
    Expand(*Template::Parse("page.htm", std::move(text)), handler, out, limits);
    return out;
}

// Shows what was raised: [name|contents], contents expanded in turn.
void Bracket(Tag& tag) {
    tag.Write("[" + std::string(tag.LowerName()).substr(4) + "|" + tag.TagContents() + "]");
}

TEST(Template, Grammar) {
    const struct {
        const char* label;
        const char* text;
        const char* expected;
    } rows[] = {
        {"plain text", "a <b> & \"c\"", "a <b> & \"c\""},
        {"contents", "a<ZEB:X>b</ZEB:X>c", "a[x|b]c"},
        {"empty forms", "<ZEB:X/>-<ZEB:X></ZEB:X>", "[x|]-[x|]"},
        {"case", "<zeb:Name>b</ZEB:NAME>", "[name|b]"},
        {"name characters", "<ZEB:a.b-c_9>x</ZEB:a.b-c_9>", "[a.b-c_9|x]"},
        {"letters beyond ASCII", "<ZEB:K\xC3\x9Csi>x</ZEB:k\xC3\xBCsi>", "[k\xC3\xBCsi|x]"},
        {"attribute value", "<a href=\"<ZEB:L>x</ZEB:L>\">", "<a href=\"[l|x]\">"},
        {"same name nests", "<ZEB:X>1<ZEB:X>2</ZEB:X>3</ZEB:X>4", "[x|1[x|2]3]4"},
        {"start without end", "a<ZEB:X>b", "a[x|]b"},
        {"start without end, then a pair", "<ZEB:X><ZEB:X>a</ZEB:X>", "[x|][x|a]"},
        {"overlap", "<ZEB:A><ZEB:B></ZEB:A>t</ZEB:B>", "[a|[b|]]t</ZEB:B>"},
        {"end without start", "a</ZEB:X>b", "a</ZEB:X>b"},
        {"malformed", "<ZEB:><ZEB:a b><ZEB:/><ZEB:a/b><ZEB", "<ZEB:><ZEB:a b><ZEB:/><ZEB:a/b><ZEB"},
        {"colon is a colon", "<ZEB\x1Aq>", "<ZEB\x1Aq>"},
    };
    for (const auto& row : rows) EXPECT_EQ(Expanded(row.text, Bracket), row.expected) << row.label;
}

TEST(Template, TellsTheCheckerWhatIsUnbalanced) {
    const auto page = Template::Parse("p", "</ZEB:S><ZEB:A><ZEB:B></ZEB:A>");
    ASSERT_EQ(page->tree().strays.size(), 1U);
    EXPECT_EQ(page->tree().strays[0].data() - page->text().data(), 0);
    const Node* a = page->root().ChildrenBegin()->Next();
    EXPECT_EQ(a->name, "ZEB:A");
    EXPECT_TRUE(a->is_complete);
    EXPECT_FALSE(a->ChildrenBegin()->is_complete);
}

TEST(Expand, UnhandledTagsLeaveTheirContentsAndTypedTextNeverBecomesATag) {
    EXPECT_EQ(Expanded("<ZEB:A>x<ZEB:B>y</ZEB:B></ZEB:A>", [](Tag&) {}), "xy");
    EXPECT_EQ(Expanded("<ZEB:A/>", [](Tag& tag) { tag.WriteEscaped("<ZEB:A/>"); }),
              "&lt;ZEB:A/&gt;");
}

TEST(Expand, NamesThatHandlersChangeAndSend) {
    std::string seen;
    const auto out = Expanded("<ZEB:List.Row>x</ZEB:List.Row>", [&](Tag& tag) {
        tag.ShortenName(4);
        seen = std::string(tag.TagName()) + " " + std::string(tag.LowerName());
        tag.SendTags = true;
    });
    EXPECT_EQ(seen, "ZEB:List zeb:list");
    EXPECT_EQ(out, "<ZEB:List.Row>x</ZEB:List.Row>");
}

TEST(Tag, ContentsAreWhatWouldBeWritten) {
    TagForTest made("ZEB:Q.Row", "c");
    Tag& tag = made.tag();
    EXPECT_EQ(made.TagContents(), "c");
    tag.Repeat("ZEB:Q.Row", "\r\n");
    EXPECT_EQ(made.TagContents(), "c\r\n<ZEB:Q.Row>c</ZEB:Q.Row>");
    tag.Continue("ZEB:Next");
    EXPECT_EQ(made.TagContents(), "<ZEB:Next>c</ZEB:Next>");
    tag.Hide();
    EXPECT_EQ(made.TagContents(), "");
    tag.Show();
    EXPECT_EQ(made.TagContents(), "c");
    tag.Write("t");
    EXPECT_EQ(made.TagContents(), "t");
    EXPECT_EQ(tag.TemplateContents(), "c");
    EXPECT_THROW(tag.ShortenName(100), base::RuntimeError);
}

// Rows as handlers make them: structurally, and as text.
TEST(Expand, ManyRowsTakeNoStackAndNoDepth) {
    constexpr int kRows = 100'000;
    for (const bool textual : {false, true}) {
        int row = 0;
        const auto out = Expanded("<ZEB:R><ZEB:N/>,</ZEB:R>", [&](Tag& tag) {
            if (tag.LowerName() == "zeb:n") return tag.Write(std::to_string(row % 10));
            if (++row == kRows) return;
            if (!textual) return tag.Repeat("ZEB:R");
            tag.Write("<ZEB:N/>,<ZEB:R><ZEB:N/>,</ZEB:R>");
        });
        EXPECT_EQ(row, kRows);
        ASSERT_EQ(out.size(), 2U * kRows);
        EXPECT_EQ(out.substr(0, 8), "1,2,3,4,");
    }
}

TEST(Expand, HostileSizesTakeLinearTimeAndNoStack) {
    constexpr int kTags = 100'000;
    std::string unclosed, starts, ends;
    for (int i = 0; i < kTags; ++i) {
        unclosed += "<ZEB:X>";
        starts += "<ZEB:X" + std::to_string(i % 7) + ">";
        ends += "</ZEB:X" + std::to_string((kTags - 1 - i) % 7) + ">";
    }
    int raised = 0;
    const auto count = [&](Tag&) { ++raised; };
    EXPECT_EQ(Expanded(unclosed, count), "");
    EXPECT_EQ(raised, kTags);
    raised = 0;
    EXPECT_EQ(Expanded(starts + "x" + ends, count), "x");
    EXPECT_EQ(raised, kTags);
}

TEST(Expand, RunawayTemplatesEndWithTheirNames) {
    const struct {
        const char* label;
        ExpandLimits limits;
        std::function<void(Tag&)> handler;
    } rows[] = {
        {"repeats", {.tags = 50'000}, [](Tag& tag) { tag.Repeat("ZEB:Loop"); }},
        {"continues", {.tags = 50'000}, [](Tag& tag) { tag.Continue("ZEB:Loop"); }},
        {"writes itself", {.tags = 50'000}, [](Tag& tag) { tag.Write("<ZEB:Loop/>"); }},
        {"nests itself", {}, [](Tag& tag) { tag.Write("<ZEB:Loop/>."); }},
        {"bytes", {.bytes = 1000}, [](Tag& tag) { tag.Repeat("ZEB:Loop", "0123456789"); }},
    };
    for (const auto& row : rows) {
        try {
            Expanded("<ZEB:Loop/>", row.handler, row.limits);
            ADD_FAILURE() << row.label << " did not end";
        } catch (const base::RuntimeError& error) {
            EXPECT_EQ(error.number(), base::errors::kInvalidCall) << row.label;
            EXPECT_THAT(error.description(), AllOf(HasSubstr("page.htm"), HasSubstr("ZEB:Loop")))
                << row.label;
        }
    }
}

TEST(Expand, AHandlersErrorPassesThrough) {
    EXPECT_THROW(Expanded("<ZEB:X/>", [](Tag&) { throw base::RuntimeError(13); }),
                 base::RuntimeError);
}

}  // namespace
}  // namespace zebtell::markup
