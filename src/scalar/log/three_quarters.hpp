// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// A positive normal float as 2^k·(1 + r) with 1 + r in [3/4, 3/2); r is exact.
struct three_quarters {
  float k;
  float r;

  LUMEN_MAIN three_quarters of(float x) {
    const std::uint32_t i = bits(x) + 0xc0c00000u;
    const float m = value(bits(x) - (i & 0xff800000u));
    return {static_cast<float>(static_cast<std::int32_t>(i) >> 23), m - 1.0f};
  }
};

/// The rare path of the float logarithms on this reduction; `Body` has the logarithm. Zeros have
/// code 2; negative numbers, and every NaN whatever its sign, give their own pattern as a quiet NaN
/// with code 1.
template <typename Body>
LUMEN_DEVICE inline std::uint32_t rare_of_three_quarters(float x, float* y) {
  if (x == 0) {
    *y = value(0xff800000u);
    return mask(code::pole);
  }
  if (bits(x) > 0x7f7fffffu) {
    const bool infinity = bits(x) == format<float>::special;
    *y = infinity ? x : value(bits(x) | 0x7fc00000u);
    return mask(infinity ? code::none : code::domain);
  }
  three_quarters a = three_quarters::of(x * value(0x4f800000u));  // 2^32
  a.k -= 32.0f;
  *y = Body::logarithm(a);
  return mask(code::none);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
