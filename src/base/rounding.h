#pragma once

#include <cstdint>

namespace zebtell::base {

// Half to even on the decimal digits that the number is written with, so that 2.675 gives 2.68 and
// 0.125 gives 0.12. `decimals` is 0 to 15. Infinities and NaN throw RuntimeError 6.
double Rounded(double number, int decimals);

// The whole number nearest, half to even; RuntimeError 6 outside the range.
std::int16_t ToInteger16(double number);
std::int32_t ToInteger32(double number);
std::int64_t ToInteger64(double number);

}  // namespace zebtell::base
