// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/root/thirds.hpp"
#include "scalar/tables/pow3o2.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Where the paths of pow3o2 part, as patterns. The main path holds from `first_of_main` to
/// `last_of_main`. Results above `last_finite` overflow, as x² does; below `first_nonzero` they
/// round to zero, as x² does. From there to below `first_unscaled` they are denormal or close to
/// it.
template <typename T>
struct pow3o2_bounds;
template <>
struct pow3o2_bounds<float> {
  static constexpr std::uint32_t first_of_main = 0x1d800000;   // 2^-68
  static constexpr std::uint32_t last_of_main = 0x69800000;    // 2^84
  static constexpr std::uint32_t last_finite = 0x6a214517;     // 2^(256/3)
  static constexpr std::uint32_t first_nonzero = 0x0d000000;   // 2^-101
  static constexpr std::uint32_t first_unscaled = 0x16000000;  // 2^-83
  static constexpr std::uint32_t up = 0x5d800000;              // 2^60
  static constexpr std::uint32_t down = 0x12800000;            // 2^-90
};
template <>
struct pow3o2_bounds<double> {
  static constexpr std::uint64_t first_of_main = 0x1a70000000000000;   // 2^-600
  static constexpr std::uint64_t last_of_main = 0x6a70000000000000;    // 2^680
  static constexpr std::uint64_t last_finite = 0x6a9965fea53d6e3c;     // 2^(2048/3)
  static constexpr std::uint64_t first_nonzero = 0x1320000000000000;   // 2^-717
  static constexpr std::uint64_t first_unscaled = 0x1580000000000000;  // 2^-679
  static constexpr std::uint64_t up = 0x43b0000000000000;              // 2^60
  static constexpr std::uint64_t down = 0x3a50000000000000;            // 2^-90
};

/// x^(3/2) for positive normal x whose power is normal: x = m·2^(2q + k), a row of (2^k·c)^(3/2) in
/// two words for the middle c of one of 32 intervals of [1, 2), and (1 + g)^(3/2) - 1 for
/// g = m/c - 1 to degree 5 at float, 8 at double. Within 0.56 ulp.
template <typename T>
LUMEN_DEVICE inline T three_halves_power_by_row(T x) {
  using U = uint_of<T>;
  constexpr int shift = format<T>::fraction_bits;
  const U v = (bits(x) >> shift) - 1;
  const auto m = thirty_second<T>::of(x);
  const auto row = (static_cast<std::int32_t>(v & 1) << 5) | m.i;
  if constexpr (sizeof(T) == 4) {
    const T g = m.less * value(_arrsPow3o2SHATab[5 + m.i]);
    T p = value(_arrsPow3o2SHATab[0]);
    for (int j = 1; j < 5; ++j) p = mad(g, p, value(_arrsPow3o2SHATab[j]));
    p = g * p;
    const T high = value(_arrsPow3o2SHATab[0x25 + 2 * row]);
    const T low = value(_arrsPow3o2SHATab[0x26 + 2 * row]);
    return (high + mad(high, p, low)) * value((v >> 1) * 0x01800000u + 0xe1000000u);
  } else {
    const T g = m.less * value(_arrsPow3o2HATab[8 + m.i]);
    T p = value(_arrsPow3o2HATab[0]);
    for (int j = 1; j < 8; ++j) p = mad(g, p, value(_arrsPow3o2HATab[j]));
    p = g * p;
    const T high = value(_arrsPow3o2HATab[40 + 2 * row]);
    const T low = value(_arrsPow3o2HATab[41 + 2 * row]);
    return (high + mad(high, p, low)) * value((v >> 1) * 0x0030000000000000u + 0xe020000000000000u);
  }
}

/// pow3o2, float and double. Code 1 for negative numbers and -infinity; code 0 otherwise, also
/// where the result overflows or underflows.
///
/// x·sqrt(x) from the root s: `ep` multiplies, within 1.3 ulp; `la` takes one step of Newton's
/// method from x/s, within 1.67 ulp; `ha` adds the term that s leaves out of the root, within 0.51
/// ulp. Beyond the main path by rows of a table, within 0.56 ulp; denormal results, rounded twice,
/// within 0.76 ulp.
template <typename T, tier t>
struct pow3o2_body : scalar_v11<pow3o2_body<T, t>, T> {
  using bounds = pow3o2_bounds<T>;

  LUMEN_MAIN main_result<T> main(T x) {
    const auto shifted = bits(x) - bounds::first_of_main;
    return {power(x), flag_if<T>(shifted > bounds::last_of_main - bounds::first_of_main)};
  }

  LUMEN_RARE std::uint32_t rare(T x, T* y) {
    if (is_nan(x)) {
      *y = x + T(0);
    } else if (bits(x) == format<T>::special) {
      *y = x;
    } else if (x == 0) {
      *y = T(0);
    } else if (x < 0) {
      *y = value(format<T>::nan);
      return mask(code::domain);
    } else if (bits(x) > bounds::last_finite || bits(x) < bounds::first_nonzero) {
      *y = x * x;
    } else if (bits(x) < bounds::first_unscaled) {
      *y = three_halves_power_by_row(x * value(bounds::up)) * value(bounds::down);
    } else {
      *y = three_halves_power_by_row(x);
    }
    return mask(code::none);
  }

 private:
  LUMEN_MAIN T power(T x) {
    const T s = sqrt(x);
    if constexpr (t == tier::ep) return fma(s, x, T(0));
    const T r = divide(T(1), s);
    const T h = fma(T(0.5), r, T(0));
    if constexpr (t == tier::ha) {
      const T tail = fma(fma(-s, s, x), h, T(0));
      return fma(s, x, fma(tail, x, T(0)));
    } else {
      const T a = fma(x, r, T(0));
      const T e = fma(-a, h, T(0.5));
      return fma(fma(a, e, a), x, T(0));
    }
  }
};
template <tier t>
using pow3o2_s = pow3o2_body<float, t>;
template <tier t>
using pow3o2_d = pow3o2_body<double, t>;

/// pow3o2, half: the float body of `ep` in every tier.
using pow3o2_h = half_v11<pow3o2_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
