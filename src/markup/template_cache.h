#pragma once

#include <memory>
#include <string_view>

#include "markup/template.h"
#include "markup/template_folders.h"

namespace zebtell::markup {

// Templates, read and parsed when first asked for and again when a file that they depend on has
// changed. <!--#include file="name"--> is replaced by that file, and a text that is marked as
// <ZEB:Text>...</ZEB:Text> by its translation. Text that is not UTF-8 is taken as windows-1257.
// Thread-safe.
class TemplateCache {
  public:
    explicit TemplateCache(TemplateFolders folders);
    ~TemplateCache();

    // In a language that the folders have a catalogue for; in any other, texts stay as they are.
    // RuntimeError 53 ("File not found: name") for a missing or unreadable file, a file outside of
    // the folders, and includes that include themselves.
    std::shared_ptr<const Template> Get(std::string_view file_name, std::string_view language = {});

  private:
    class Files;
    std::unique_ptr<Files> files_;
};

}  // namespace zebtell::markup
