// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// What the bodies by thirds and halves of the exponent share: the exponent field divided by three,
/// and the mantissa in one of 32 intervals of [1, 2).
#pragma once

#include <cstdint>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// e = 3q + k, k = 0..2, for 0 <= e < 2048.
template <typename U>
struct thirds {
  U q;
  U k;

  LUMEN_MAIN thirds of(U e) {
    const U q = (e * 0x1556u) >> 14;
    return {q, e - 3 * q};
  }
};

/// The i-th of 32 intervals of [1, 2) holds the mantissa m of x; `less` is its middle less m, exact
/// and at most 1/64 in magnitude.
template <typename T>
struct thirty_second {
  std::int32_t i;
  T less;

  LUMEN_MAIN thirty_second of(T x) {
    using U = uint_of<T>;
    constexpr int shift = format<T>::fraction_bits - 5;
    constexpr U half_interval = U{1} << (shift - 1);
    constexpr U index_bits = U{31} << shift;
    constexpr U minus_one = format<T>::one | format<T>::sign;
    const U fraction = bits(x) & format<T>::fraction;
    const T minus_m = value(fraction | minus_one);
    const T minus_middle = value((fraction & index_bits) | minus_one | half_interval);
    return {static_cast<std::int32_t>(fraction >> shift), minus_m - minus_middle};
  }
};

/// Not a normal number, of either sign.
LUMEN_MAIN bool not_normal(float x) {
  return static_cast<std::int32_t>((bits(x) & 0x7fffffffu) + 0x7f800000u) > -0x01000001;
}
LUMEN_MAIN bool not_normal(double x) {
  const std::uint64_t shifted = (bits(x) & format<double>::magnitude) + 0x7ff0000000000000u;
  return static_cast<std::int64_t>(shifted) > -0x0020000000000001;
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
