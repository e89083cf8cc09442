// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/protocol.hpp"
#include "scalar/root/quotient.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// What the bodies of div at float share: divisors whose reciprocal may not be normal are left to
/// the division, with code 2 for zeros only. 0/0 is a NaN with code 2 too. A `Body` gives the
/// quotient for the other divisors.
template <typename Body>
struct div_s_paths : scalar_v21<Body, float> {
  LUMEN_MAIN main_result<float> main(float x, float y) {
    return {Body::quotient(x, y), flag_if<float>(is_extreme(y))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float y, float* q) {
    return quotient_by_division(x, y, q);
  }

 private:
  /// Exponent field 0, 253, 254 or 255.
  LUMEN_MAIN bool is_extreme(float y) { return ((0x007fffffu - bits(y)) & 0x7e000000u) == 0; }
};

/// div, float, by a float reciprocal, at `la` improved by one step of Newton's method; within 1.45
/// ulp.
template <tier t>
struct div_s : div_s_paths<div_s<t>> {
  LUMEN_MAIN float quotient(float x, float y) {
    float r = divide(1.0f, y);
    if constexpr (t == tier::la) r = fma(fma(-y, r, 1.0f), r, r);
    return fma(x, r, 0.0f);
  }
};

/// `ha`, with double arithmetic: the float reciprocal r becomes r(2 - yr). Within 0.51 ulp.
template <>
struct div_s<tier::ha> : div_s_paths<div_s<tier::ha>> {
  LUMEN_MAIN float quotient(float x, float y) {
    const auto r = static_cast<double>(divide(1.0f, y));
    const double a = fma(static_cast<double>(y), r, 0.0);
    const double b = fma(a, r, 0.0);
    const double c = (r + r) - b;
    return static_cast<float>(fma(static_cast<double>(x), c, 0.0));
  }
};

/// div, double; the division in every tier. Code 2 for every division by zero, 0/0 included.
struct div_d : scalar_v21<div_d, double> {
  LUMEN_MAIN main_result<double> main(double x, double y) {
    return {divide(x, y), flag_if<double>(y == 0)};
  }

  LUMEN_RARE std::uint32_t rare(double x, double y, double* q) {
    return quotient_by_division(x, y, q);
  }
};

/// div, half: the float body of `ep` in every tier.
using div_h = half_v21<div_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
