#include <gtest/gtest.h>

#include <random>

#include "markup/template.h"
#include "tests/markup/naive_engine.h"

namespace zebtell::markup {
namespace {

// A page with state, so that tags raised in another order or another number give another output.
class Handler {
  public:
    void operator()(Tag& tag) {
        ++raised_;
        const std::string name(tag.LowerName());
        if (name == "zeb:row" || name == "zeb:rows.row") Row(tag);
        if (name == "zeb:hide" || name == "zeb:hidden") tag.Hide();
        if (name == "zeb:number") tag.Write("#" + std::to_string(raised_));
        if (name == "zeb:typed") tag.WriteEscaped("<ZEB:Number/> & 'more'");
        if (name == "zeb:text")
            tag.Write("(" + tag.TagContents() + "<zeb:NUMBER/><ZEB:Show>t</ZEB:Show>)");
        if (name == "zeb:send") tag.SendTags = true;
        if (name == "zeb:next") tag.Continue("ZEB:Shown");
        if (name == "zeb:part") tag.Repeat("ZEB:Hidden", "|");
        if (name == "zeb:odd") tag.Repeat("no tag", "<ZEB:Number/>");
        if (name == "zeb:sendrow") {
            tag.SendTags = true;
            Row(tag);
        }
    }

  private:
    void Row(Tag& tag) {
        if (++row_ % 4 == 0 || raised_ > kEnough) return;
        if (row_ % 4 == 3) return tag.Continue(tag.TagName());
        const bool textual = row_ % 8 > 4;
        if (!textual) return tag.Repeat(tag.TagName(), "\r\n");
        const std::string again(tag.TagName());
        const std::string contents(tag.TemplateContents());
        tag.Write(contents + "\r\n<" + again + ">" + contents + "</" + again + ">");
    }

    static constexpr int kEnough = 300;

    int raised_ = 0;
    int row_ = 0;
};

class Generator {
  public:
    explicit Generator(unsigned seed) : random_(seed) {}

    // Tags within tags; what is unclosed or stray here has a name of its own, so that a block
    // means the same wherever it is copied to.
    std::string Blocks(int depth) {
        static constexpr const char* kNames[] = {"ZEB:Row",
                                                 "zeb:Rows.Row",
                                                 "ZEB:Hide",
                                                 "ZEB:Show",
                                                 "ZEB:Text",
                                                 "ZEB:SEND",
                                                 "ZEB:Next",
                                                 "ZEB:Part",
                                                 "Zeb:Other",
                                                 "ZEB:Odd",
                                                 "ZEB:SendRow"};
        std::string text;
        for (int i = Below(4); i >= 0; --i) {
            const std::string name = kNames[Below(std::size(kNames))];
            text += Piece();
            if (depth > 0) text += "<" + name + ">" + Blocks(depth - 1) + "</" + name + ">";
        }
        return text;
    }

    // Starts and ends anyhow.
    std::string Soup() {
        static constexpr const char* kPieces[] = {"<ZEB:Show>",
                                                  "</ZEB:Show>",
                                                  "<ZEB:Send>",
                                                  "</zeb:send>",
                                                  "<ZEB:Text>",
                                                  "</ZEB:Text>",
                                                  "<ZEB:Hide>",
                                                  "</ZEB:Hide>",
                                                  "<zeb:next>",
                                                  "</ZEB:Next>",
                                                  "x",
                                                  "<",
                                                  ">",
                                                  "/"};
        std::string text;
        for (int i = Below(40); i > 0; --i) text += kPieces[Below(std::size(kPieces))];
        return text;
    }

  private:
    std::string Piece() {
        static constexpr const char* kPieces[] = {"plain ",
                                                  "<b class=\"<ZEB:Number/>\">",
                                                  "<ZEB:Open>",
                                                  "</ZEB:Stray>",
                                                  "<ZEB:",
                                                  "<ZEB:>",
                                                  "<ZEB:a b>",
                                                  "<ZEB:Typed/>",
                                                  "<ZEB:Number>gone</ZEB:number>",
                                                  "</ZEB:>",
                                                  "&amp;",
                                                  "<<",
                                                  "<zeb :x>",
                                                  "\r\n",
                                                  "</ZEB:Stray/>",
                                                  ""};
        return kPieces[Below(std::size(kPieces))];
    }

    int Below(std::size_t limit) { return static_cast<int>(random_() % limit); }

    std::mt19937 random_;
};

void ExpectSame(const std::string& text) {
    std::string out;
    Handler handler;
    Expand(
        *Template::Parse("test", text), [&](Tag& tag) { handler(tag); }, out);
    Handler naive_handler;
    const NaiveEngine naive([&](Tag& tag) { naive_handler(tag); });
    ASSERT_EQ(out, naive.Expand(text)) << "template: " << text;
}

TEST(Expand, EqualsTheNaiveEngineOnNestedBlocks) {
    for (unsigned seed = 0; seed < 600; ++seed) {
        const std::string text = Generator(seed).Blocks(seed % 4);
        ExpectSame(text);
        if (HasFatalFailure()) return;
    }
}

TEST(Expand, EqualsTheNaiveEngineOnUnbalancedTags) {
    for (unsigned seed = 0; seed < 2000; ++seed) {
        ExpectSame(Generator(seed).Soup());
        if (HasFatalFailure()) return;
    }
}

}  // namespace
}  // namespace zebtell::markup
