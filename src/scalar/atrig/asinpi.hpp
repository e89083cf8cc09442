// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/atrig/arcsine_over_pi.hpp"
#include "scalar/atrig/careful_angle.hpp"
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

/// Below this, arcsin x = x; at `ha` the product with 1/pi in two words may not underflow.
template <typename T>
LUMEN_MAIN bool is_tiny_arcsine(T x) {
  return fabs(x) < T(0x1p-90);
}

/// asinpi, float; largest error 0.80 ulp at `ha`, 3.99 in the one body of `la` and `ep`. ±1 has
/// exactly ±1/2. Code 1 for |x| > 1; a NaN has code 0.
template <tier t>
struct asinpi_s : scalar_v11<asinpi_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    return {asinpi_value<float, t>(x), flag_if<float>(bits(fabs(x)) >= format<float>::one,
                                                      t == tier::ha && is_tiny_arcsine(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    if (fabs(x) > 1.0f) return out_of_domain(x, y);
    if (fabs(x) == 1.0f) {
      *y = or_sign(0.5f, x);
    } else if (is_nan(x)) {
      *y = x + x;
    } else {
      *y = static_cast<float>(static_cast<double>(x) * value(pi_words<double>::inverse));
    }
    return mask(code::none);
  }
};

/// asinpi, double; largest error 0.85, 3.1 and 5.2e7 ulp for `ha`, `la`, `ep`. Code 1 for |x| > 1
/// and for every NaN.
template <tier t>
struct asinpi_d : scalar_v11<asinpi_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const double y = fma(-0.5, fabs(x), 0.5);
    return {asinpi_value<double, t>(x),
            flag_if<double>(is_outside_unit_interval(y), t == tier::ha && is_tiny_arcsine(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    if (!is_tiny_arcsine(x)) return out_of_domain(x, y);
    *y = careful_angle<half_turns>(x, 1.0);
    return mask(code::none);
  }
};

/// asinpi, half: the float body of `ep` in every tier.
using asinpi_h = half_v11<asinpi_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
