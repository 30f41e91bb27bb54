#pragma once

#include <ostream>
#include <vector>

#include "check/checked_page.h"

namespace zebtell::app {

// The pages as their templates see them: events, event names made at run time, own tags.
std::vector<check::CheckedPage> PageVocabulary();

// Every tag with its line of help, the common ones first.
void PrintTags(std::ostream& out);

}  // namespace zebtell::app
