#include <algorithm>
#include <map>
#include <optional>
#include <set>

#include "app/page_vocabulary.h"
#include "base/like.h"
#include "markup/tag_scan.h"
#include "tags/page_tags.h"
#include "tests/portal/portal_fixture.h"

namespace zebtell {
namespace {

// An example of the templates' manual and what it says that comes out.
struct Example {
    std::string text;
    std::string output;
    std::size_t line = 0;
    std::vector<std::string> pages;  // that its section is about; empty: all
};

constexpr std::string_view kFence = "```";

// White space as HTML takes it.
std::string Folded(std::string_view text) {
    std::string folded;
    for (const char c : text) {
        const bool is_blank = c == ' ' || c == '\n' || c == '\r';
        if (!is_blank) folded += c;
        if (is_blank && !folded.empty() && folded.back() != ' ') folded += ' ';
    }
    return std::string(base::Trimmed(folded));
}

// Reads `example` → `output` within a line, and fenced examples that a fenced output follows behind
// the word "gives".
class Manual {
  public:
    explicit Manual(const std::string& text) {
        for (std::string_view line : base::Split(text, '\n')) {
            ++line_;
            ReadLine(line);
        }
    }

    std::vector<Example> examples;

  private:
    void ReadLine(std::string_view line) {
        if (line.starts_with(kFence)) return ReadFence();
        if (is_fenced_) {
            block_.append(line) += '\n';
        } else if (line.starts_with("## ")) {
            ReadPages(line);
        } else if (line == "gives") {
            given_ = last_block_;
        } else {
            ReadInline(line);
        }
    }

    void ReadFence() {
        is_fenced_ = !is_fenced_;
        if (is_fenced_) return block_.clear();
        if (given_) examples.push_back({*given_, block_, line_, pages_});
        given_.reset();
        last_block_ = block_;
    }

    void ReadPages(std::string_view heading) {
        pages_.clear();
        const auto words = base::Split(heading, '`');
        for (std::size_t i = 1; i < words.size(); i += 2) pages_.emplace_back(words[i]);
    }

    void ReadInline(std::string_view line) {
        constexpr std::string_view kArrow = "` → ";
        for (auto at = line.find(kArrow); at != line.npos; at = line.find(kArrow, at + 1)) {
            const auto begin = line.rfind('`', at - 1) + 1;
            const auto behind = line.substr(at + kArrow.size());
            const bool is_nothing = behind.starts_with("nothing");
            if (!is_nothing && !behind.starts_with('`')) continue;
            const auto output = is_nothing ? "" : behind.substr(1, behind.find('`', 1) - 1);
            // In tables the mark between columns is escaped.
            const auto text = base::Replaced(line.substr(begin, at - begin), "\\|", "|");
            examples.push_back({text, base::Replaced(output, "\\|", "|"), line_, pages_});
        }
    }

    std::size_t line_ = 0;
    bool is_fenced_ = false;
    std::string block_;
    std::string last_block_;
    std::optional<std::string> given_;
    std::vector<std::string> pages_;
};

std::vector<std::string> TagsIn(std::string_view text) {
    std::vector<std::string> names;
    for (auto mark = markup::FindTag(text, 0); mark; mark = markup::FindTag(text, mark->end)) {
        if (mark->kind != markup::TagMark::Kind::kEnd) {
            names.push_back(base::LowerAscii(std::string(mark->name)));
        }
    }
    return names;
}

// The tables whose tags a page knows.
std::vector<const tags::TagTable*> TablesOf(const check::CheckedPage& page) {
    std::vector<const tags::TagTable*> tables = {&tags::CommonTagTable(),
                                                 &tags::OrderSummaryTagTable()};
    if (page.own_tags != nullptr) tables.push_back(page.own_tags);
    return tables;
}

bool Knows(const check::CheckedPage& page, const Example& example) {
    const auto tables = TablesOf(page);
    const auto names = TagsIn(example.text);
    return std::all_of(names.begin(), names.end(), [&](const std::string& name) {
        const std::string query = "<zeb:query>" + name.substr(4) + ";";
        return base::FindNoCase(example.text, query) != std::string::npos ||
               std::any_of(tables.begin(), tables.end(), [&](const tags::TagTable* table) {
                   return table->Find(name) != nullptr;
               });
    });
}

// What comes out of the manual's examples in a portal on which the small company's Mari has a
// basket, has ordered, and has just made a mistake.
class ManualTest : public PortalTest {
  protected:
    void SetUp() override {
        PortalTest::SetUp();
        company().Run(
            "UPDATE GRArticle SET Unit = 'tk', Stock = 25, PackQuantity = 10 WHERE ID < 104;"
            "UPDATE GRArticle SET Explanation = 'Tsingitud' WHERE ID = 101;"
            "UPDATE GRCompany SET RegCode = '10001234', Email = 'pood@example.com' WHERE ID = 1;"
            "UPDATE EREmployee SET Phone = '+372 600 0000' WHERE ID = 1;");
        portal.reset();
        company().Run("VACUUM INTO '" + (folder.path() / "before.db").string() + "'");
    }

    // The pages that an example belongs to, as far as they are visited here: the first that knows
    // its tags.
    std::string PageFor(const Example& example) const {
        for (const std::string& name : example.pages.empty() ? kVisited : example.pages) {
            const auto page = std::find_if(
                pages_.begin(), pages_.end(), [&](const auto& each) { return each.name == name; });
            if (page != pages_.end() && Knows(*page, example)) return name;
        }
        return {};
    }

    static std::string Begin(std::size_t number) { return "{#" + std::to_string(number) + "#}"; }
    static constexpr std::string_view kEnd = "{##}";

    // A page shows a row block once, so examples with the same one take turns.
    std::vector<std::size_t> Turns(const std::vector<Example>& examples) const {
        std::map<std::string, std::size_t> taken;
        std::vector<std::size_t> turns;
        for (const Example& example : examples) {
            std::size_t turn = 0;
            for (const std::string& name : TagsIn(example.text)) {
                const auto& blocks = kRowBlocks;
                if (std::find(blocks.begin(), blocks.end(), name) == blocks.end()) continue;
                turn = taken[PageFor(example) + name]++;
                break;
            }
            turns.push_back(turn);
        }
        return turns;
    }

    // The templates consist of their pages' examples.
    void WriteTemplates(const std::vector<Example>& examples,
                        const std::vector<std::size_t>& turns,
                        std::size_t turn) {
        std::map<std::string, std::string> texts;
        for (std::size_t i = 0; i < examples.size(); ++i) {
            if (turns[i] != turn) continue;
            texts[PageFor(examples[i])] += Begin(i) + examples[i].text + std::string(kEnd) + "\n";
        }
        for (const auto& page : pages_) {
            folder.Write("templates/" + std::string(page.template_file),
                         texts[std::string(page.name)]);
        }
    }

    void Visit() {
        Browser mari = NewBrowser();
        const auto keep = [this](const std::string& page) { seen_ += page; };
        mari.Post("Kaubainfo&event=Tellimus", {{"Row_1", "1"}});
        mari.LogOn("mari", "mari-sala");
        mari.Get("Kaubainfo");
        mari.Post("Kaubainfo&event=Hinnakiri",
                  {{"ZEBInText", "R"}, {"Combo_GRArticleCat", "0"}, {"save_project", "Sild"}});
        keep(mari.Post("Kaubainfo&event=Lisamine",
                       {{"ID_1101", "2"}, {"ID_1102", "x"}, {"QuickEntry", "OR-1 3\nXX 1"}}));
        keep(mari.Get("KInfo&event=Kaup&ID=101"));
        keep(mari.Get("Koostamine"));
        keep(mari.Get("Lisamine&event=ID_1101"));
        keep(mari.Post("Kinnitus&event=LisaTellimus",
                       {{"ZEB_Komment", "Helistada"},
                        {"SDOrder.WantedDate", "01.01.2020"},
                        {"ZEB_But_Vormista", "x"}}));
        mari.Ask("/?page=Kaubainfo&event=Tellimus",
                 "POST",
                 Browser::Encoded({{"Row_2", "palju"},
                                   {"SDOrder.Explanation", "Helistada enne"},
                                   {"Change_Quant", "x"}}));
        keep(mari.Get("Yld"));
        keep(mari.Post("Kinnitus&event=LisaTellimus",
                       {{"ZEB_Komment", "Helistada"},
                        {"SDOrder.WantedDate", "01.12.2030"},
                        {"ZEB_But_Vormista", "x"}}));
        keep(mari.Get("Raamistik"));
    }

    // So that each turn finds the same company.
    void ForgetNewOrder() {
        portal.reset();
        std::filesystem::copy_file(folder.path() / "before.db",
                                   folder.path() / "company.db",
                                   std::filesystem::copy_options::overwrite_existing);
    }

    std::string OutputOf(std::size_t number) const {
        const auto begin = seen_.find(Begin(number));
        if (begin == std::string::npos) return "(was on no page)";
        const auto from = begin + Begin(number).size();
        return Folded(seen_.substr(from, seen_.find(kEnd, from) - from));
    }

    // Whether an output is as the manual says; "…" stands for what differs each time.
    static bool IsAsSaid(const std::string& output, const std::string& said) {
        constexpr std::string_view kAnything = "…";
        const auto gap = said.find(kAnything);
        if (gap == std::string::npos) return output == said;
        return output.size() >= said.size() && output.starts_with(said.substr(0, gap)) &&
               output.ends_with(said.substr(gap + kAnything.size()));
    }

    const std::vector<std::string> kVisited = {
        "Yld", "Kaubainfo", "KInfo", "Koostamine", "Lisamine", "Kinnitus", "Tellimus", "Raamistik"};
    const std::vector<std::string> kRowBlocks = {"zeb:hkrida",
                                                 "zeb:tellrida",
                                                 "zeb:tlkrida",
                                                 "zeb:kinnitrida",
                                                 "zeb:maksurida",
                                                 "zeb:recentorder",
                                                 "zeb:tellimus.read"};
    const std::vector<check::CheckedPage> pages_ = app::PageVocabulary();
    std::string seen_;  // what came out on all pages
};

TEST_F(ManualTest, ExamplesGiveWhatStandsBesideThem) {
    const Manual manual(ReadFile(SourceFolder() / "docs/templates.md"));
    const auto turns = Turns(manual.examples);
    const auto last = *std::max_element(turns.begin(), turns.end());
    for (std::size_t turn = 0; turn <= last; ++turn) {
        WriteTemplates(manual.examples, turns, turn);
        Start(kUsualSettings);
        Visit();
        ForgetNewOrder();
    }
    for (std::size_t i = 0; i < manual.examples.size(); ++i) {
        const Example& example = manual.examples[i];
        EXPECT_TRUE(IsAsSaid(OutputOf(i), Folded(example.output)))
            << "line " << example.line << ": " << example.text << "\ngives " << OutputOf(i)
            << "\nand not " << example.output;
    }
}

TEST_F(ManualTest, EveryTagHasAnExample) {
    const Manual manual(ReadFile(SourceFolder() / "docs/templates.md"));
    std::set<const tags::TagRow*> shown;
    for (const Example& example : manual.examples) {
        for (const auto& page : pages_) {
            if (page.name != PageFor(example)) continue;
            for (const std::string& name : TagsIn(example.text)) {
                for (const auto* table : TablesOf(page)) shown.insert(table->Find(name));
            }
        }
    }
    for (const auto& page : pages_) {
        for (const auto* table : TablesOf(page)) {
            for (const tags::TagRow& row : table->rows()) {
                EXPECT_TRUE(!shown.insert(&row).second) << page.name << ": " << row.name;
            }
        }
    }
}

}  // namespace
}  // namespace zebtell
