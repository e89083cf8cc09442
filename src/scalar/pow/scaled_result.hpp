// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Where the two words of a result are scaled below the normal numbers: a power of two that keeps
/// every such result normal, the bits that the high part of a word lacks, and the exponents down to
/// which that high part is exact as a denormal, and down to which a result can be other than zero.
template <typename T>
struct denormal_scaling;
template <>
struct denormal_scaling<float> {
  static constexpr int up = 100;
  static constexpr std::uint32_t low_bits = 0xfff;
  static constexpr int lowest_exact = -138;
  static constexpr int lowest = -151;
};
template <>
struct denormal_scaling<double> {
  static constexpr int up = 200;
  static constexpr std::uint64_t low_bits = 0x7ffffff;
  static constexpr int lowest_exact = -1032;
  static constexpr int lowest = -1085;
};

template <typename T>
LUMEN_DEVICE constexpr T power_of_two_as(int exponent) {
  return value(static_cast<uint_of<T>>(exponent + format<T>::bias) << format<T>::fraction_bits);
}

/// ±2^e·(high + low) for high next to [1, 2) and low below its last bit: rounded once down to where
/// few bits are left, and then twice, which matters by less than 2^-11 ulp.
template <typename T>
LUMEN_DEVICE inline T scaled_result(T high, T low, int e, uint_of<T> sign) {
  using f = format<T>;
  using d = denormal_scaling<T>;
  const T rounded = high + low;
  const T rest = low - (rounded - high);
  const int own = static_cast<int>(bits(rounded) >> f::fraction_bits) - f::bias;
  const int exponent = e + own;
  if (exponent > f::bias) return value(sign | f::special);
  if (exponent > -f::bias) {
    const auto field = static_cast<uint_of<T>>(e) << f::fraction_bits;
    return value(sign | (bits(rounded) + field));
  }
  if (exponent < d::lowest) return value(sign);
  const T scale = power_of_two_as<T>(e + d::up);
  const T back = power_of_two_as<T>(-d::up);
  T result = (rounded * scale) * back;
  if (exponent >= d::lowest_exact) {
    const T leading = value(bits(rounded) & ~uint_of<T>{d::low_bits});
    const T others = (rounded - leading) + rest;
    result = (leading * scale) * back + (others * scale) * back;
  }
  return value(sign | bits(result));
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
