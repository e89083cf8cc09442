// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/trig/fixed_turn.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Sine and cosine of every float, in fixed point: the whole function at `ha`, the rare path at
/// `la` and `ep`. The nearest half turn is removed, the cosine having a quarter turn more; then
/// sin(pi u) for |u| <= 1/2, degree 11, with the terms of degree 1 and 3 in two words.
struct half_turn_sine {
  /// |x| in the range of `fixed_turn`.
  LUMEN_MAIN float sine(float x) { return of_place(fixed_turn(x), sign_bit(x)); }
  LUMEN_MAIN float cosine(float x) { return of_place(fixed_turn(x) + quarter, 0); }

  LUMEN_DEVICE static std::uint32_t any_sine(float x, float* y) {
    if (is_special(x)) return of_special(x, y);
    *y = finite_sine(x).value;
    return mask(code::none);
  }
  LUMEN_DEVICE static std::uint32_t any_cosine(float x, float* y) {
    if (is_special(x)) return of_special(x, y);
    *y = finite_cosine(x).value;
    return mask(code::none);
  }

  /// Without a branch, flagged unless x is finite.
  LUMEN_MAIN main_result<float> finite_sine(float x) {
    const float y = of_place(any_place(x), sign_bit(x));
    return {select(is_below_fixed_turn(x), x, y), flag_if<float>(is_special(x))};
  }
  LUMEN_MAIN main_result<float> finite_cosine(float x) {
    const float y = of_place(any_place(x) + quarter, 0);
    return {select(is_below_fixed_turn(x), 1.0f, y), flag_if<float>(is_special(x))};
  }

 private:
  static constexpr std::uint64_t quarter = 0x4000000000000000;

  LUMEN_MAIN std::uint64_t any_place(float x) {
    return select(is_above_fixed_turn(x), fixed_turn_by_table(x), fixed_turn(x));
  }

  LUMEN_MAIN float of_place(std::uint64_t place, std::uint32_t sign) {
    const auto half_turns = static_cast<std::uint32_t>(place >> 32) + 0x40000000u;
    const turn_rest a = rest_of_turn<1>(place);
    const float_float v = square(a);
    const float p = horner(v.high, 0xbbe61a2du, 0x3da807fcu, 0xbf196889u, 0x402335e0u);
    const float_float c2 = horner_step({p, 0.0f}, v, value(0xc0a55de7u), value(0xb39e345au));
    const float_float c1 = horner_step(c2, v, value(0x40490fdbu), value(0xb3bbe1b6u));
    const float error = fma(c1.high, a.low, c1.low * a.u);
    return value(bits(fma(c1.high, a.u, error)) ^ ((half_turns ^ sign) & 0x80000000u));
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
