// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/atrig/arcsine_over_pi.hpp"
#include "scalar/atrig/out_of_domain.hpp"
#include "scalar/half.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// asinpi: base + v Q/pi for v = |x| and base 0 in the direct case, v = -2√y and base 1/2
/// otherwise.
template <typename T, tier t>
LUMEN_MAIN T asinpi_value(T x) {
  const auto r = half_angle<T>::of(x);
  const T v = select(r.direct, r.a, r.root);
  const T base = select(r.direct, T(0), T(0.5));
  return or_sign(base_and_arcsine_over_pi<t>(base, v, r), x);
}

/// asinpi, float; largest error 0.8, 4.4 and 4.4 ulp for `ha`, `la`, `ep`, the last two of which
/// are one body. ±1 has exactly ±1/2. Code 1 for |x| > 1; a NaN has code 0.
template <tier t>
struct asinpi_s : scalar_v11<asinpi_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    return {asinpi_value<float, t>(x), flag_if<float>(fabs(x) >= 1.0f)};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    if (fabs(x) > 1.0f) return out_of_domain(x, y);
    *y = or_sign(0.5f, x);
    return mask(code::none);
  }
};

/// asinpi, double; largest error 0.8, 2.9 and 4.1e7 ulp for `ha`, `la`, `ep`. Code 1 for |x| > 1
/// and for every NaN.
template <tier t>
struct asinpi_d : scalar_v11<asinpi_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const double y = fma(-0.5, fabs(x), 0.5);
    return {asinpi_value<double, t>(x), flag_if<double>(is_outside_unit_interval(y))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) { return out_of_domain(x, y); }
};

/// asinpi, half: the float body of `ep` in every tier.
using asinpi_h = half_v11<asinpi_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
