// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/atrig/arcsine_over_pi.hpp"
#include "scalar/atrig/out_of_domain.hpp"
#include "scalar/half.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// acospi: base + v Q/pi for v = -x and base 1/2 in the direct case; otherwise v = 2√y and base 0
/// for positive x, v = -2√y and base 1 for negative x.
template <typename T, tier t>
LUMEN_MAIN T acospi_value(T x) {
  const auto r = half_angle<T>::of(x);
  const T v = select(!r.direct, r.root_like(x), -x);
  const T zero_or_one = T(0.5) - or_sign(T(0.5), x);
  return base_and_arcsine_over_pi<t>(select(!r.direct, zero_or_one, T(0.5)), v, r);
}

/// acospi, float; largest error 0.64 ulp at `ha`, 3.5 in the one body of `la` and `ep`. 1 has
/// exactly 0 and -1 exactly 1. Code 1 for |x| > 1; a NaN has code 0.
template <tier t>
struct acospi_s : scalar_v11<acospi_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    return {acospi_value<float, t>(x), flag_if<float>(bits(fabs(x)) >= format<float>::one)};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    if (fabs(x) > 1.0f) return out_of_domain(x, y);
    const float number = x > 0 ? 0.0f : 1.0f;
    *y = is_nan(x) ? nan_of(x) : number;
    return mask(code::none);
  }

 private:
  /// A NaN itself, quietened; in one word without its sign.
  LUMEN_DEVICE static float nan_of(float x) { return t == tier::ha ? x + x : fabs(x) + fabs(x); }
};

/// acospi, double; largest error 0.69, 2.6 and 4.1e7 ulp for `ha`, `la`, `ep`. Code 1 for |x| > 1
/// and for every NaN.
template <tier t>
struct acospi_d : scalar_v11<acospi_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const double y = fma(-0.5, fabs(x), 0.5);
    return {acospi_value<double, t>(x), flag_if<double>(is_outside_unit_interval(y))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) { return out_of_domain(x, y); }
};

/// acospi, half: the float body of `ep` in every tier.
using acospi_h = half_v11<acospi_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
