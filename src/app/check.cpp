#include <iostream>

#include "app/commands.h"
#include "app/page_vocabulary.h"
#include "check/check_portal.h"

namespace zebtell::app {

int Check(const std::filesystem::path& folder,
          const std::filesystem::path& templates,
          const std::filesystem::path& default_templates) {
    const auto pages = PageVocabulary();
    const auto findings = check::CheckPortal({folder, templates, default_templates}, pages);
    for (const check::Finding& finding : findings) std::cout << finding << "\n";
    if (!findings.empty()) return 1;
    std::cout << "Settings, database and the templates of " << pages.size() << " pages are right\n";
    return 0;
}

}  // namespace zebtell::app
