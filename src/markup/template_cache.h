#pragma once

#include <filesystem>
#include <memory>
#include <string_view>

#include "markup/template.h"

namespace zebtell::markup {

// The templates of one folder, read and parsed when first asked for and again when their file or
// a file that they include has changed. <!--#include file="name"--> is replaced by that file of
// the same folder. Text that is not UTF-8 is taken as windows-1257. Thread-safe.
class TemplateCache {
  public:
    explicit TemplateCache(std::filesystem::path folder);
    ~TemplateCache();

    // RuntimeError 53 ("File not found: name") for a missing or unreadable file, a file outside of
    // the folder, and includes that include themselves.
    std::shared_ptr<const Template> Get(std::string_view file_name);

  private:
    class Files;
    std::unique_ptr<Files> files_;
};

}  // namespace zebtell::markup
