#pragma once

#include <sqlite3.h>

namespace zebtell::erp::sqlite {

// Makes the functions that translated statements call known to a connection; a null argument gives
// null.
//   erp_round(x, n)  n decimals, half away from zero on 15 significant decimal digits
//   erp_div(a, b)    a / b as numbers, null when b is 0
//   erp_like(t, p)   whether the whole text matches "%" (any run), "_" (one character), "\" (the
//                    next character itself); case is ignored, also of letters beyond ASCII
void RegisterFunctions(sqlite3* database);

}  // namespace zebtell::erp::sqlite
