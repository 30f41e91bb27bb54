#pragma once

#include "check/page_reading.h"

namespace zebtell::check {

// Reports texts without a translation, and translations whose tags are not those of the text.
void CheckTranslations(PageReading& reading);

}  // namespace zebtell::check
