#include "tags/page_globals.h"

namespace zebtell::tags {

thread_local std::string PageLanguage;
thread_local bool IDCardLogon = false;

void ResetPageGlobals() {
    PageLanguage.clear();
    IDCardLogon = false;
}

}  // namespace zebtell::tags
