// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/protocol.hpp"
#include "scalar/root/quotient.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// inv, float; the division in every tier, correctly rounded. Code 2 for zeros.
struct inv_s : scalar_v11<inv_s, float> {
  LUMEN_MAIN main_result<float> main(float x) { return {divide(1.0f, x), flag_if<float>(x == 0)}; }

  LUMEN_RARE std::uint32_t rare(float x, float* y) { return quotient_by_division(1.0f, x, y); }
};

/// inv, double. Code 2 for zeros.
///
/// `la` and `ep`: the reciprocal of the leading 20 bits of the mantissa, taken in float and cut to
/// 20 bits, is off by a factor 1 - e, |e| < 2^-18; it is multiplied by e^4 + e^3 + e^2 + e + 1 at
/// `la` and by e^2 + e + 1 at `ep`. Largest error 0.51 ulp. Where the seed or the result would not
/// be normal, the division.
template <tier t>
struct inv_d : scalar_v11<inv_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const auto high = static_cast<std::uint32_t>(bits(x) >> 32);
    const float m = value(((high << 3) & 0x007ffff8u) | 0x3f800000u);
    const std::uint32_t reciprocal = bits(divide(1.0f, m));
    const std::uint32_t seed = (reciprocal >> 3) + 0x77f00000u - (high & 0xfff00000u);
    const double y = value(std::uint64_t{seed} << 32);
    const double e = fma(-x, y, 1.0);
    double s = fma(e, e, e);
    if constexpr (t == tier::la) s = fma(fma(s, e, e), e, e);
    return {fma(s, y, y), flag_if<double>(is_extreme(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) { return quotient_by_division(1.0, x, y); }

 private:
  /// Not a magnitude from 2^-1021 to below 2^1022.
  LUMEN_MAIN bool is_extreme(double x) {
    const std::uint64_t shifted = (bits(x) & format<double>::magnitude) + 0x7fe0000000000000u;
    return static_cast<std::int64_t>(shifted) > -0x0050000000000001;
  }
};

/// `ha`: the division.
template <>
struct inv_d<tier::ha> : scalar_v11<inv_d<tier::ha>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    return {divide(1.0, x), flag_if<double>(x == 0)};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) { return quotient_by_division(1.0, x, y); }
};

/// inv, half, through float.
using inv_h = half_v11<inv_s>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
