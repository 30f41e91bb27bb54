#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "data/cls_query.h"
#include "host/session_state.h"

namespace zebtell::tags {

// Named queries of a page.
bool QueryExists(const host::SessionState& state, std::string_view name, std::string_view page);
data::clsQuery& GetQuery(host::SessionState& state, std::string_view name, std::string_view page);

// Keeps every posted field whose name begins with "save_". Always true.
bool SaveFormValues(host::SessionState& state, const web::Request& request);

// A quantity as people type it, rounded to QuantityDecimals; false, and `result` unchanged, when
// it is empty, no number, or too large for one.
bool ParseQuantity(const host::SessionState& state, std::string_view text, double& result);

// Whether the form has something in field name + "_unique".
bool IsUniqueField(const web::Request& request, std::string_view name);

// The form's field name + "_f" + row, cleaned; "" when it is absent.
std::string ReadRowField(const web::Request& request, std::string_view name, std::int16_t row);

}  // namespace zebtell::tags
