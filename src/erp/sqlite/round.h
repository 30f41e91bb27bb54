#pragma once

namespace zebtell::erp::sqlite {

// `number` at `decimals` places (negative ones round to tens, hundreds, ...), half away from zero
// on its 15 significant decimal digits, so that 1.005 at 2 places is 1.01.
double RoundedHalfAway(double number, int decimals);

}  // namespace zebtell::erp::sqlite
