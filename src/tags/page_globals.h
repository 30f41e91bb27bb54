#pragma once

#include <string>

namespace zebtell::tags {

// What the templates of a thread's current page have declared, and the log-on method that they
// offer. A thread serves one page at a time and many sessions in turn.
extern thread_local std::string PageLanguage;  // "ZEB:WEBLanguage"; "" until the page says it
extern thread_local bool IDCardLogon;          // ID card instead of password

// Before a page is written, so that nothing of another session's page is left on the thread.
void ResetPageGlobals();

}  // namespace zebtell::tags
