#include "check/template_check.h"

#include <iterator>
#include <map>
#include <set>

#include "base/runtime_error.h"
#include "check/page_walk.h"
#include "check/translation_check.h"
#include "host/settings.h"

namespace zebtell::check {
namespace {

struct Language {
    host::UserLanguage language;
    std::string_view name;
};
constexpr Language kLanguages[] = {
    {host::UserLanguage::kEstonian, "Estonian"},
    {host::UserLanguage::kEnglish, "English"},
    {host::UserLanguage::kLatvian, "Latvian"},
};

using Names = std::set<std::string>;

std::string Joined(const Names& names) {
    std::string text;
    for (const std::string& name : names) text += (text.empty() ? "" : ", ") + name;
    return text;
}

class TemplateCheck {
  public:
    TemplateCheck(const markup::TemplateFolders& folders,
                  std::span<const CheckedPage> pages,
                  const Tables& tables)
        : folders_(folders), pages_(pages), tables_(tables) {}

    std::vector<Finding> Run() {
        for (const Language& language : kLanguages) ReadAll(language);
        std::vector<Finding> findings;
        for (const auto& [finding, where] : findings_) {
            findings.push_back(finding);
            findings.back().text += WhereText(finding.file, where);
        }
        return findings;
    }

  private:
    // Where a finding is one.
    struct Where {
        Names pages;
        Names languages;
    };

    void ReadAll(const Language& language) {
        language_ = language.name;
        const markup::Catalogue catalogue(folders_, host::LanguageCode(language.language));
        for (const auto& file : catalogue.broken()) {
            Add({file.filename().string(), 0, "the catalogue can't be read"}, {});
        }
        for (const CheckedPage& page : pages_) Read(page, catalogue);
    }

    void Read(const CheckedPage& page, const markup::Catalogue& catalogue) {
        try {
            ReadSource(page, markup::ReadTemplateSource(folders_, page.template_file, catalogue));
        } catch (const base::RuntimeError&) {
            Add({std::string(page.template_file), 0, "the template can't be read"}, page.name);
        }
    }

    void ReadSource(const CheckedPage& page, const markup::TemplateSource& source) {
        for (const auto& piece : source.pieces) readers_[piece.file].emplace(page.name);
        for (const auto& fault : source.faults) {
            const std::string text = "the include " + fault.include + " " + std::string(fault.why);
            Add({fault.place.file, fault.place.line, text}, page.name);
        }
        const bool is_source_language = language_ == kLanguages[0].name;
        PageReading reading{page, source, tables_};
        if (!is_source_language) CheckTranslations(reading);
        WalkPage(reading, pages_);
        for (Finding& finding : reading.findings) Add(std::move(finding), page.name);
    }

    void Add(Finding finding, std::string_view page) {
        Where& where = findings_[std::move(finding)];
        if (!page.empty()) where.pages.emplace(page);
        where.languages.emplace(language_);
    }

    // Pages and languages that do not have the fault go without saying when there are none.
    std::string WhereText(const std::string& file, const Where& where) {
        std::string text;
        if (where.pages.size() < readers_[file].size()) text = "on page " + Joined(where.pages);
        if (where.languages.size() < std::size(kLanguages)) {
            text += (text.empty() ? "in " : ", in ") + Joined(where.languages);
        }
        return text.empty() ? text : " (" + text + ")";
    }

    const markup::TemplateFolders& folders_;
    std::span<const CheckedPage> pages_;
    const Tables& tables_;
    std::string_view language_;  // being read
    std::map<Finding, Where> findings_;
    std::map<std::string, Names> readers_;  // pages of each file
};

}  // namespace

std::vector<Finding> TemplateFaults(const markup::TemplateFolders& folders,
                                    std::span<const CheckedPage> pages,
                                    const Tables& tables) {
    return TemplateCheck(folders, pages, tables).Run();
}

}  // namespace zebtell::check
