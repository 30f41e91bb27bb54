#include "markup/catalogue.h"

#include <boost/locale/gnu_gettext.hpp>
#include <boost/locale/message.hpp>
#include <fstream>
#include <iterator>

#include "base/ignore_errors.h"

namespace zebtell::markup {
namespace {

namespace fs = std::filesystem;
namespace gettext = boost::locale::gnu_gettext;

using Messages = boost::locale::message_format<char>;

std::vector<char> ReadBytes(const fs::path& file) {
    std::ifstream in(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

}  // namespace

Catalogue::Catalogue(const TemplateFolders& folders, std::string_view language) {
    for (const fs::path& folder : folders) {
        const fs::path file = folder / "translations" / (std::string(language) + ".mo");
        files_.push_back(FileStamp::Of(file));
        if (files_.back().size == 0) continue;
        // A broken catalogue costs its translations and not the page; the check tells of it.
        if (!base::IgnoreErrors([&] { Add(file, language); })) broken_.push_back(file);
    }
}

void Catalogue::Add(const fs::path& file, std::string_view language) {
    gettext::messages_info info;
    info.language = language;
    info.encoding = "UTF-8";
    info.domains = {gettext::messages_info::domain("zebtell")};
    info.paths = {"."};
    // The library asks for several names of the same catalogue; any of them is this file.
    info.callback = [&](const std::string&, const std::string&) { return ReadBytes(file); };
    catalogues_.emplace_back(std::locale::classic(), gettext::create_messages_facet<char>(info));
}

const char* Catalogue::Find(const std::string& message) const {
    // The empty message is a catalogue's own head.
    if (message.empty()) return nullptr;
    for (const std::locale& catalogue : catalogues_) {
        const auto& messages = std::use_facet<Messages>(catalogue);
        if (const char* found = messages.get(0, nullptr, message.c_str())) return found;
    }
    return nullptr;
}

}  // namespace zebtell::markup
