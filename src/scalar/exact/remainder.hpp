// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/integer_part.hpp"
#include "scalar/exact/long_division.hpp"
#include "scalar/exact/quotient_screen.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// remainder(x, y) = x - y·n, n the integer nearest to x/y, ties to even; exact in every tier, a
/// zero result with the sign of x. Code 1 for a zero y; an infinite x gives a NaN and code 0.
///
/// Where the quotient is small, n comes from the rounded quotient. Where that rounding crossed a
/// half, n is wrong by one and the magnitude of x - yn exceeds |y|/2; it is representable all the
/// same. A true half is exact in the quotient, and so is then decided by the rounding to even.
template <typename T>
struct remainder_body : scalar_v21<remainder_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x, T y) {
    const T n = nearest_integer_part(divide(x, y));
    const T r = fma(-n, y, x);
    const T half = fma(fabs(y), T(0.5), T(0));
    const T corrected = select(fabs(r) > half, r - or_sign(fabs(y), r), r);
    const T remainder = select(corrected == 0, or_sign(T(0), x), corrected);
    return {remainder, needs_long_division(x, y)};
  }

  LUMEN_RARE std::uint32_t rare(T x, T y, T* r) {
    if (is_nan(x) || is_nan(y)) {
      // Any factor but 1 serves to quieten a NaN.
      *r = (is_nan(x) ? x : y) * T(1.7);
      return mask(code::none);
    }
    if (y == 0 || is_infinite(x)) {
      *r = value(format<T>::nan);
      return mask(y == 0 ? code::domain : code::none);
    }
    if (x == 0 || is_infinite(y)) {
      *r = x;
      return mask(code::none);
    }
    const T nearest = of_magnitudes(fabs(x), fabs(y));
    *r = nearest == 0 ? x * 0 : (sign_bit(x) != 0 ? -nearest : nearest);
    return mask(code::none);
  }

 private:
  /// The remainder of finite magnitudes a and b > 0. Where doubling overflows, it is certainly
  /// above b.
  LUMEN_DEVICE static T of_magnitudes(T a, T b) {
    if (a == b) return 0;
    if (a < b) return 2 * a > b ? a - b : a;
    const division<T> d = long_division<T>(bits(a), bits(b));
    const T twice = 2 * d.remainder;
    if (twice == b) return d.odd ? -d.remainder : d.remainder;
    return twice > b ? d.remainder - b : d.remainder;
  }
};

using remainder_s = remainder_body<float>;
using remainder_d = remainder_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
