#pragma once

#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

#include "base/runtime_error.h"
#include "markup/file_stamp.h"

namespace zebtell::markup {

// The folders that templates come from. A file of the first folder takes the place of the one of
// the same name in those behind it.
using TemplateFolders = std::vector<std::filesystem::path>;

// RuntimeError 53, in the same words for all faults since visitors see them. Who checks templates
// reads the reason too.
class TemplateFileError : public base::RuntimeError {
  public:
    TemplateFileError(std::string_view name, std::string_view why);

    std::string_view why() const { return why_; }  // "is not there"

  private:
    std::string_view why_;  // lives as long as the process
};

// The real file behind a name. Links that lead out of their folder are refused like all that lies
// outside. `looked_at` gets a stamp of every file that could stand for the name: one that is put
// into an earlier folder later is a change.
std::filesystem::path FindTemplateFile(const TemplateFolders& folders,
                                       std::string_view name,
                                       std::vector<FileStamp>& looked_at);

// The file's text as UTF-8.
std::string ReadTemplateFile(const std::filesystem::path& path, std::string_view name);

}  // namespace zebtell::markup
