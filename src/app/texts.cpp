#include <algorithm>
#include <iostream>
#include <map>
#include <set>

#include "app/commands.h"
#include "base/text.h"
#include "markup/template_source.h"

namespace zebtell::app {
namespace {

namespace fs = std::filesystem;

// As gettext's tools want it of a file without translations.
constexpr std::string_view kHead =
    "msgid \"\"\n"
    "msgstr \"\"\n"
    "\"MIME-Version: 1.0\\n\"\n"
    "\"Content-Type: text/plain; charset=UTF-8\\n\"\n"
    "\"Content-Transfer-Encoding: 8bit\\n\"\n";

using Places = std::set<std::pair<std::string, std::size_t>>;  // file and line

std::map<std::string, Places> TextsOf(const fs::path& folder) {
    const markup::TemplateFolders folders{folder};
    const markup::Catalogue no_translations({}, {});
    std::map<std::string, Places> texts;
    for (const auto& entry : fs::recursive_directory_iterator(folder)) {
        if (entry.path().extension() != ".htm") continue;
        const std::string file = fs::relative(entry.path(), folder).string();
        for (auto& text : markup::ReadTemplateSource(folders, file, no_translations).texts) {
            texts[text.message].emplace(std::move(text.place.file), text.place.line);
        }
    }
    return texts;
}

std::string Quoted(std::string_view text) {
    return '"' + base::Replaced(base::Replaced(text, "\\", "\\\\"), "\"", "\\\"") + '"';
}

}  // namespace

int PrintTexts(const fs::path& templates) {
    const auto texts = TextsOf(templates);
    // In the order of the files, as translators read them.
    std::vector<std::pair<Places, std::string_view>> in_order;
    in_order.reserve(texts.size());
    for (const auto& [message, places] : texts) in_order.emplace_back(places, message);
    std::sort(in_order.begin(), in_order.end());
    std::cout << kHead;
    for (const auto& [places, message] : in_order) {
        std::cout << '\n';
        for (const auto& [file, line] : places) std::cout << "#: " << file << ':' << line << '\n';
        std::cout << "msgid " << Quoted(message) << "\nmsgstr \"\"\n";
    }
    return 0;
}

}  // namespace zebtell::app
