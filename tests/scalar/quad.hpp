// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// A reference arithmetic of 113 bits and a wide exponent: products of doubles are exact in it and
/// neither overflow nor underflow, sums of products are rounded once.
#pragma once

#include <algorithm>
#include <cfloat>
#include <cmath>
#include <limits>

namespace arbor::lumen::tests {

#if LDBL_MANT_DIG == 113
using quad = long double;
#else
using quad = __float128;
#endif

/// The unit in the last place of the finite number `x`, in its own format.
template <typename T>
quad unit_in_last_place(T x) {
  const int lowest = std::numeric_limits<T>::min_exponent - 1;
  const int exponent = x == 0 ? lowest : std::max(std::ilogb(x), lowest);
  return static_cast<quad>(std::ldexp(1.0L, exponent - std::numeric_limits<T>::digits + 1));
}

/// The distance of the finite result `x` from `exact`, in units in the last place of `x`.
template <typename T>
double ulps(T x, quad exact) {
  const quad distance = static_cast<quad>(x) - exact;
  return static_cast<double>((distance < 0 ? -distance : distance) / unit_in_last_place(x));
}

/// The same for x as the square root of `square`.
template <typename T>
double root_ulps(T x, quad square) {
  const quad wide = static_cast<quad>(x);
  if (x == 0) return square == 0 ? 0 : std::numeric_limits<double>::infinity();
  const quad distance = (wide * wide - square) / (2 * wide);
  return static_cast<double>((distance < 0 ? -distance : distance) / unit_in_last_place(x));
}

}  // namespace arbor::lumen::tests
