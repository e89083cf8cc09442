// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The factor that a power 2^n·b^r at half is scaled with twice, as s·(s·b^r) with s = 2^(n/2): so
/// a result below the normal halves rounds once, in the final product, and overflow comes out of it
/// by itself. A NaN x, which the clamp turned into a number, comes back as this factor.
LUMEN_MAIN float scale_or_nan(float s, float x) { return select(is_nan(x), x, s); }

/// b^x at half for the base b of `Base`. Straight-line code for every argument, status 0.
///
/// x, clamped to where the result is an infinity or zero, is n/log2(b) + r with an even integer n:
/// the shifter has the unit 2. `la` and `ep` have a polynomial in half, within 1.7 ulp; `ha` has
/// its reduction and polynomial in float, within 0.84 ulp.
template <typename Base, tier t>
struct half_range_power : half_v11<half_range_power<Base, t>> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float below = select(x < Base::highest, x, Base::highest);
    const float c = select(below > Base::lowest, below, Base::lowest);
    const float shifter = 3102.0f;
    const float shifted = half_fma(c, half_value(Base::half_log2), shifter);
    const float n = shifted - shifter;                                    // exact
    const float s = half_value((half_pattern(shifted) << 10) & 0xffffu);  // 2^(n/2)
    return {power_of_rest(c, n, s) * scale_or_nan(s, x)};
  }

 private:
  /// 2^(n/2)·b^r.
  LUMEN_MAIN float power_of_rest(float c, float n, float s) {
    if constexpr (t == tier::ha) {
      const float r = fma(c, value(Base::float_log2), -n);
      const float p = horner(r, 0x3c220cecu, 0x3d6a40e5u, 0x3e75dca0u, 0x3f31565bu, 0x3f800052u);
      return half_fma(rounded_to_half(p), s, 0.0f);
    } else {
      float r = half_fma(c, half_value(Base::half_log2), -n);
      r = half_fma(c, half_value(Base::half_log2_low), r);
      float p = half_fma(half_value(0x2110), r, half_value(0x2b52));
      p = half_fma(p, r, half_value(0x33af));
      p = half_fma(p, r, half_value(0x398b));
      p = half_fma(p, r, 0.0f);
      return half_fma(p, s, s);
    }
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
