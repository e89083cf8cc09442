// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Rounding of doubles to integers by the big number 2^52, above which every double is an integer
/// and at which the unit in the last place is 1: adding it to a = |x| and subtracting it again
/// rounds a to the nearest integer, ties to even. It needs nothing but additions and a select, so
/// that it vectorises on machines without a rounding instruction as well.
static constexpr double big_number = 0x1p52;

/// The argument is an integer beyond the reach of the trick, or an infinity; false for a NaN, which
/// the additions then quieten.
LUMEN_DEVICE inline bool is_big(double x) { return fabs(x) > big_number; }

/// a rounded to the nearest integer, for 0 <= a <= 2^52.
LUMEN_DEVICE inline double nearest_integer(double a) { return (a + big_number) - big_number; }

/// The integers nearest to x (ties to even), and next to it towards zero; the sign of a zero is
/// that of x.
LUMEN_DEVICE inline double big_number_rint(double x) {
  return select(is_big(x), x, or_sign(nearest_integer(fabs(x)), x));
}
LUMEN_DEVICE inline double big_number_trunc(double x) {
  const double a = fabs(x);
  const double t = nearest_integer(a);
  return select(is_big(x), x, or_sign(t - select(t > a, 1.0, 0.0), x));
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
