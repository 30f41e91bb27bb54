#include <gtest/gtest.h>

#include <random>

#include "tests/markup/counting_page.h"
#include "tests/markup/naive_engine.h"

namespace zebtell::markup {
namespace {

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
    CountingPage page;
    Expand(
        *Template::Parse("test", text), [&](Tag& tag) { page(tag); }, out);
    CountingPage naive_page;
    const NaiveEngine naive([&](Tag& tag) { naive_page(tag); });
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
