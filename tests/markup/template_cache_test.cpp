#include "markup/template_cache.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <thread>

#include "base/runtime_error.h"
#include "markup/escape.h"

namespace zebtell::markup {
namespace {

namespace fs = std::filesystem;

class TemplateCacheTest : public testing::Test {
  protected:
    TemplateCacheTest() {
        fs::create_directories(root_ / "pages" / "parts");
        Put("../outside.htm", "secret");
    }
    ~TemplateCacheTest() override { fs::remove_all(root_); }

    void Put(const std::string& name, std::string_view text) const {
        std::ofstream(root_ / "pages" / name, std::ios::binary) << text;
    }
    std::string Text(std::string_view name) { return cache().Get(name)->text(); }
    std::string ErrorOf(std::string_view name) {
        try {
            cache().Get(name);
        } catch (const base::RuntimeError& error) {
            return std::to_string(error.number()) + " " + error.description();
        }
        return "none";
    }
    TemplateCache& cache() { return cache_; }
    const fs::path& root() const { return root_; }

  private:
    static fs::path MakeFolder() {
        std::string pattern = (fs::temp_directory_path() / "zebtell-XXXXXX").string();
        return mkdtemp(pattern.data());
    }

    const fs::path root_ = MakeFolder();
    TemplateCache cache_{TemplateFolders{root_ / "pages"}};
};

TEST_F(TemplateCacheTest, EncodingsAndIncludes) {
    Put("utf8.htm", "\xEF\xBB\xBFH\xC3\xB5lm");
    EXPECT_EQ(Text("utf8.htm"), "H\xC3\xB5lm");
    Put("ansi.htm", "H\xF5lm");
    EXPECT_EQ(Text("ansi.htm"), "H\xC3\xB5lm");
    Put("parts/head.inc", "<ZEB:X>");
    Put("page.htm",
        "a<!--#include file=\"parts/head.inc\"-->b<!-- #include --><!--#INCLUDE  FILE = "
        "\"utf8.htm\" -->");
    EXPECT_EQ(Text("page.htm"), "a<ZEB:X>b<!-- #include -->H\xC3\xB5lm");
    Put("odd.htm", "<!--#include virtual=\"x\"--><!--#include file=\"x");
    EXPECT_EQ(Text("odd.htm"), "<!--#include virtual=\"x\"--><!--#include file=\"x");
}

TEST_F(TemplateCacheTest, RefusesWhatIsMissingOutsideOrEndless) {
    fs::create_symlink(root() / "outside.htm", root() / "pages" / "link.htm");
    fs::create_directory_symlink(root(), root() / "pages" / "up");
    Put("cycle.htm", "<!--#include file=\"cycle2.htm\"-->");
    Put("cycle2.htm", "<!--#include file=\"cycle.htm\"-->");
    Put("broken.htm", "<!--#include file=\"none.inc\"-->");
    Put("climb.htm", "<!--#include file=\"../outside.htm\"-->");
    for (int i = 0; i < 30; ++i) {
        Put("deep" + std::to_string(i),
            "<!--#include file=\"deep" + std::to_string(i + 1) + "\"-->");
    }
    Put("deep30", "end");
    const std::string absolute = (root() / "outside.htm").string();
    const struct {
        std::string name;
        std::string missing;
    } rows[] = {
        {"none.htm", "none.htm"},
        {"", ""},
        {"../outside.htm", "../outside.htm"},
        {"parts/../../outside.htm", "parts/../../outside.htm"},
        {absolute, absolute},
        {"link.htm", "link.htm"},
        {"up/outside.htm", "up/outside.htm"},
        {"parts", "parts"},
        {"cycle.htm", "cycle.htm"},
        {"broken.htm", "none.inc"},
        {"climb.htm", "../outside.htm"},
        {"deep0", "deep21"},
    };
    for (const auto& row : rows)
        EXPECT_EQ(ErrorOf(row.name), "53 File not found: " + row.missing) << row.name;
    EXPECT_EQ(Text("deep10"), "end");
}

TEST_F(TemplateCacheTest, NoticesChangesOfTheFileAndOfItsIncludes) {
    Put("part.inc", "one");
    Put("page.htm", "[<!--#include file=\"part.inc\"-->]");
    const auto first = cache().Get("page.htm");
    EXPECT_EQ(cache().Get("page.htm"), first) << "an unchanged template is parsed once";
    Put("part.inc", "longer");
    std::this_thread::sleep_for(std::chrono::milliseconds(1100));
    EXPECT_EQ(Text("page.htm"), "[longer]");
    EXPECT_EQ(first->text(), "[one]") << "who expands the old one keeps it";
    fs::remove(root() / "pages" / "part.inc");
    std::this_thread::sleep_for(std::chrono::milliseconds(1100));
    EXPECT_EQ(ErrorOf("page.htm"), "53 File not found: part.inc");
    Put("part.inc", "back");
    EXPECT_EQ(Text("page.htm"), "[back]");
}

TEST_F(TemplateCacheTest, ManyThreadsReadWhileTheFileChanges) {
    Put("page.htm", "text");
    std::atomic<bool> stop = false;
    std::atomic<int> wrong = 0;
    std::vector<std::jthread> readers;
    for (int i = 0; i < 4; ++i) {
        readers.emplace_back([&] {
            while (!stop) {
                const std::string text = cache().Get("page.htm")->text();
                if (text != "text" && text != "TEXT2") ++wrong;
            }
        });
    }
    std::this_thread::sleep_for(std::chrono::milliseconds(300));
    Put("new.htm", "TEXT2");
    fs::rename(root() / "pages" / "new.htm", root() / "pages" / "page.htm");
    std::this_thread::sleep_for(std::chrono::milliseconds(1200));
    stop = true;
    readers.clear();
    EXPECT_EQ(wrong, 0);
    EXPECT_EQ(Text("page.htm"), "TEXT2");
}

TEST(Escape, EscapesForContentsAndAttributes) {
    using namespace std::string_view_literals;
    EXPECT_EQ(Escaped("<a href='x'>\"Q\" & \xC3\xB5</a>"),
              "&lt;a href=&#39;x&#39;&gt;&quot;Q&quot; &amp; \xC3\xB5&lt;/a&gt;");
    EXPECT_EQ(Escaped("a\0b"sv),
              "a\xEF\xBF\xBD"
              "b");
    EXPECT_EQ(Escaped(""), "");
}

}  // namespace
}  // namespace zebtell::markup
