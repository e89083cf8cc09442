// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

enum class parity { fraction, even, odd };

/// What kind of number an exponent of a power is. Infinities count as even, as do all numbers
/// beyond the unit 1 of the format; NaNs mean nothing.
template <typename T>
LUMEN_DEVICE constexpr parity parity_of(T y) {
  using f = format<T>;
  const uint_of<T> magnitude = bits(y) & f::magnitude;
  const int exponent = static_cast<int>(magnitude >> f::fraction_bits) - f::bias;
  if (magnitude == 0) return parity::even;
  if (exponent < 0) return parity::fraction;
  if (exponent > f::fraction_bits) return parity::even;
  const uint_of<T> hidden = uint_of<T>{1} << f::fraction_bits;
  const uint_of<T> mantissa = (magnitude & f::fraction) | hidden;
  const int below_one = f::fraction_bits - exponent;
  const uint_of<T> integer = mantissa >> below_one;
  if ((integer << below_one) != mantissa) return parity::fraction;
  return (integer & 1u) != 0 ? parity::odd : parity::even;
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
