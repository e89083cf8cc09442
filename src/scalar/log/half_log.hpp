// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The logarithm at half to the base of `Base`; one body for all tiers, within 0.61 ulp.
/// Straight-line code for every argument, status 0 also for zeros and negative numbers.
///
/// Every half is a normal number as a float: 2^e·m with m in [3/4, 3/2), and log2 m has a
/// polynomial of degree 5 in float, narrowed once.
template <typename Base>
struct half_log : half_v11<half_log<Base>> {
  LUMEN_MAIN main_result<float> main(float x) {
    const std::uint32_t b = bits(x);
    const std::uint32_t e = (((b >> 22) + 1) >> 1) - 127;
    const float r = value(b - (e << 23)) - 1.0f;
    const float p = horner(r, 0x3e51367bu, 0xbebfd356u, 0x3ef9e953u, 0xbf389f48u, 0x3fb8a7e4u);
    const float log2 = fma(p, r, static_cast<float>(static_cast<std::int32_t>(e)));
    const float infinity = value(format<float>::special);
    // +infinity, and NaN for negative numbers and NaN.
    const float other = fma(x, infinity, infinity);
    const float result = select(b >= format<float>::special, other, Base::of_log2(log2));
    return {select(x == 0.0f, -infinity, result)};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
