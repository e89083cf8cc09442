// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/atrig/arcsine_polynomial.hpp"
#include "scalar/atrig/half_angle.hpp"
#include "scalar/atrig/out_of_domain.hpp"
#include "scalar/half.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// What all tiers of asin share: code 1 for |x| > 1 and for every NaN. A `Body` gives arcsin |x|.
template <typename Body, typename T>
struct asin_paths : scalar_v11<Body, T> {
  LUMEN_MAIN main_result<T> main(T x) {
    const auto r = half_angle<T>::of(x);
    return {or_sign(Body::magnitude(x, r), x), r.outside};
  }

  LUMEN_RARE std::uint32_t rare(T x, T* y) { return out_of_domain(x, y); }

 protected:
  /// pi/2 + s·factor for a root s, x·factor in the direct case.
  LUMEN_MAIN T one_word(T x, const half_angle<T>& r, T factor) {
    const T beyond_half = fma(factor, r.root, value(pi_words<T>::half));
    return select(r.direct, factor * x, beyond_half);
  }

  /// The sum is a head, |x| or the rounded pi/2 - 2√y, and small terms: the head's product with the
  /// polynomial's rest, the rounding error of the head and the second word of pi/2.
  LUMEN_MAIN T two_words(const half_angle<T>& r) {
    const T half_pi = value(pi_words<T>::half);
    const T t = r.root + half_pi;
    const T u = t - half_pi;
    const T low = r.rest_of_root(u, value(pi_words<T>::half_low));
    const T head = select(r.direct, r.a, t);
    const T factor = select(r.direct, r.a, u);
    return head + fma(arcsine_rest(r.z), factor, select(r.direct, T(0), low));
  }
};

/// asin, float; largest error 0.72 ulp at `ha`, 3.94 in the one body of `la` and `ep`.
template <tier t>
struct asin_s : asin_paths<asin_s<t>, float> {
  LUMEN_MAIN float magnitude(float x, const half_angle<float>& r) {
    if constexpr (t == tier::ha) {
      return asin_s::two_words(r);
    } else {
      return asin_s::one_word(x, r, arcsine_factor(r.z));
    }
  }
};

/// asin, double. The polynomial has degree 12, at `ep` 5. Largest error 0.74, 2.8 and 4.1e7 ulp
/// for `ha`, `la`, `ep`.
template <tier t>
struct asin_d : asin_paths<asin_d<t>, double> {
  LUMEN_MAIN double magnitude(double x, const half_angle<double>& r) {
    if constexpr (t == tier::ha) {
      return asin_d::two_words(r);
    } else {
      return asin_d::one_word(x, r, t == tier::ep ? arcsine_factor_ep(r.z) : arcsine_factor(r.z));
    }
  }
};

/// asin, half: the float body of `ep` in every tier.
using asin_h = half_v11<asin_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
