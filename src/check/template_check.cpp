#include "check/template_check.h"

#include <map>
#include <set>

#include "base/runtime_error.h"
#include "check/page_walk.h"

namespace zebtell::check {
namespace {

using Pages = std::set<std::string>;

class TemplateCheck {
  public:
    TemplateCheck(const std::filesystem::path& folder,
                  std::span<const CheckedPage> pages,
                  const Tables& tables)
        : folder_(folder), pages_(pages), tables_(tables) {}

    std::vector<Finding> Run() {
        for (const CheckedPage& page : pages_) Read(page);
        std::vector<Finding> findings;
        for (const auto& [finding, pages] : findings_) {
            findings.push_back(finding);
            findings.back().text += PagesText(finding.file, pages);
        }
        return findings;
    }

  private:
    void Read(const CheckedPage& page) {
        const std::string name(page.name);
        try {
            ReadSource(page, markup::ReadTemplateSource(folder_, page.template_file));
        } catch (const base::RuntimeError&) {
            findings_[{std::string(page.template_file), 0, "the template can't be read"}].insert(
                name);
        }
    }

    void ReadSource(const CheckedPage& page, const markup::TemplateSource& source) {
        const std::string name(page.name);
        for (const auto& piece : source.pieces) readers_[piece.file].insert(name);
        for (const auto& fault : source.faults) {
            const std::string text = "the include " + fault.include + " " + std::string(fault.why);
            findings_[{fault.place.file, fault.place.line, text}].insert(name);
        }
        PageReading reading{page, source, tables_};
        WalkPage(reading, pages_);
        for (Finding& finding : reading.findings) findings_[std::move(finding)].insert(name);
    }

    // For which pages a finding is one, when others read the file without it.
    std::string PagesText(const std::string& file, const Pages& pages) {
        if (pages.size() >= readers_[file].size()) return {};
        std::string text;
        for (const std::string& page : pages) text += (text.empty() ? "" : ", ") + page;
        return " (on page " + text + ")";
    }

    const std::filesystem::path& folder_;
    std::span<const CheckedPage> pages_;
    const Tables& tables_;
    std::map<Finding, Pages> findings_;
    std::map<std::string, Pages> readers_;  // of each file
};

}  // namespace

std::vector<Finding> TemplateFaults(const std::filesystem::path& folder,
                                    std::span<const CheckedPage> pages,
                                    const Tables& tables) {
    return TemplateCheck(folder, pages, tables).Run();
}

}  // namespace zebtell::check
