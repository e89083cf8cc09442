// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/integer_part.hpp"
#include "scalar/exact/long_division.hpp"
#include "scalar/exact/quotient_screen.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// fmod(x, y) = x - y·trunc(x/y), exact in every tier, with the sign of x also where it is zero.
/// Code 2 for a zero y or an infinite x.
///
/// Where the quotient is small, its integer part t comes from the rounded quotient. It is at most
/// one too large, |x| - t|y| is representable in both cases, and so is the sum that corrects it.
template <typename T>
struct fmod_body : scalar_v21<fmod_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x, T y) {
    const T t = integer_part(divide(fabs(x), fabs(y)));
    const T r = fma(-t, fabs(y), fabs(x));
    const T remainder = select(r < 0, r + fabs(y), r);
    return {or_sign(remainder, x), needs_long_division(x, y)};
  }

  LUMEN_RARE std::uint32_t rare(T x, T y, T* r) {
    const auto ax = bits(fabs(x));
    const auto ay = bits(fabs(y));
    if (is_nan(x) || is_nan(y)) {
      *r = is_nan(x) ? x * y : y * x;
      return mask(code::none);
    }
    if (y == 0 || is_infinite(x)) {
      *r = value(format<T>::nan);
      return mask(code::pole);
    }
    if (x == 0 || is_infinite(y) || ax < ay) {
      *r = x;
    } else if (ax == ay || (ay == format<T>::one && ax >= first_integer)) {
      *r = x * 0;
    } else {
      const T remainder = long_division<T>(ax, ay).remainder;
      *r = sign_bit(x) != 0 ? -remainder : remainder;
    }
    return mask(code::none);
  }

 private:
  /// From here on every number is an integer.
  static constexpr uint_of<T> first_integer =
      static_cast<uint_of<T>>(format<T>::bias + format<T>::fraction_bits)
      << format<T>::fraction_bits;
};

using fmod_s = fmod_body<float>;
using fmod_d = fmod_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
