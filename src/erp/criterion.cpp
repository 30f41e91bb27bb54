#include "erp/criterion.h"

#include <charconv>

#include "base/runtime_error.h"
#include "base/text.h"

namespace zebtell::erp {

Criterion ParseCriterion(std::string_view text) {
    const std::size_t mark = text.find('=');
    if (mark != std::string_view::npos) {
        Criterion criterion{std::string(base::Trimmed(text.substr(0, mark)))};
        const std::string_view number = base::Trimmed(text.substr(mark + 1));
        const char* const end = number.data() + number.size();
        const auto read = std::from_chars(number.data(), end, criterion.number);
        if (!criterion.field.empty() && read.ec == std::errc() && read.ptr == end) {
            return criterion;
        }
    }
    throw base::RuntimeError(base::errors::kInvalidCall,
                             "Records are found by a field, \"=\" and a whole number");
}

}  // namespace zebtell::erp
