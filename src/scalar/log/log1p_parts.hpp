// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/log/breakpoint.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dlog1p.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// 1 + x rounded, and the rounding error: exact, by a fast two-sum whose larger term is first.
template <typename T>
struct one_plus_x {
  T sum;
  T error;

  LUMEN_MAIN one_plus_x of(T x) {
    const T larger = select(x < T(1), T(1), x);
    const T smaller = select(x > T(1), T(1), x);
    const T sum = larger + smaller;
    return {sum, (larger - sum) + smaller};
  }
};

/// The rare path of log1p at float, of 1 + x: as that of ln, with the errors of its sums kept.
struct log1p_path_s : natural_path<float, natural_constants_s> {
  static constexpr std::uint32_t denormal_scale = 0x53800000;  // 2^40
  static constexpr int denormal_exponent = 40;

  LUMEN_DEVICE static float from_row(const breakpoint<float>& p) {
    const float h = p.k * value(p.was_denormal ? 0x3f317218u : ln2_high);
    const float sum = h + value(p.row[1]);
    const float l = (p.k * value(p.was_denormal ? 0u : ln2_low) + value(p.row[2])) +
                    (value(p.row[1]) - (sum - h));
    const float u_high = mad(value(p.row[0]), p.high, -1.0f);
    const float u_low = value(p.row[0]) * p.low;
    const float t = u_high + u_low;
    const float q = (polynomial(t) * t) * t;
    const float h2 = sum + u_high;
    const float l2 = l + u_low;
    const float e3 = (u_low - (l2 - l)) + q;
    const float s2 = h2 + l2;
    const float e4 = l2 - (s2 - h2);
    return s2 + (e4 + e3);
  }
};

template <tier t>
LUMEN_DEVICE constexpr const std::uint64_t* log1p_rare_table() {
  if constexpr (t == tier::ha) return __dlog1p_ha_CoutTab;
  if constexpr (t == tier::la) return __dlog1p_la_CoutTab;
  if constexpr (t == tier::ep) return __dlog1p_ep_CoutTab;
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
