#pragma once

#include <locale>
#include <string>
#include <string_view>
#include <vector>

#include "markup/file_stamp.h"
#include "markup/template_folders.h"

namespace zebtell::markup {

// The translations of templates' texts into one language: gettext catalogues, as msgfmt makes them,
// in "translations/<language>.mo" of the template folders. The first that has a text counts.
class Catalogue {
  public:
    // A folder without a catalogue has no translations. `language` is "en" or the like.
    Catalogue(const TemplateFolders& folders, std::string_view language);

    // Null when there is none. Lives as long as the catalogue.
    const char* Find(const std::string& message) const;

    // Of all the files that were looked for.
    const std::vector<FileStamp>& files() const { return files_; }
    // Files that are there and are no catalogues.
    const std::vector<std::filesystem::path>& broken() const { return broken_; }

  private:
    void Add(const std::filesystem::path& file, std::string_view language);

    std::vector<std::locale> catalogues_;  // each with the facet of one file
    std::vector<FileStamp> files_;
    std::vector<std::filesystem::path> broken_;
};

}  // namespace zebtell::markup
