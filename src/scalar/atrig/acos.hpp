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

/// What all tiers of acos share: base - v Q with v = x and base pi/2 in the direct case, otherwise
/// v = -2√y with base 0 for positive x, and v = 2√y with base pi for negative x. Code 1 for |x| > 1
/// and for every NaN. A `Body` gives arccos x.
template <typename Body, typename T>
struct acos_paths : scalar_v11<Body, T> {
  LUMEN_MAIN main_result<T> main(T x) {
    const auto r = half_angle<T>::of(x);
    return {Body::angle(x, r), r.outside};
  }

  LUMEN_RARE std::uint32_t rare(T x, T* y) { return out_of_domain(x, y); }

 protected:
  /// For half of pi, or a word of it, all of which two are a word of pi.
  LUMEN_MAIN T base(T x, const half_angle<T>& r, uint_of<T> half) {
    const T none_or_twice = value(half) - value(half ^ sign_bit(x));
    return select(!r.direct, none_or_twice, value(half));
  }

  LUMEN_MAIN T one_word(T x, const half_angle<T>& r, T factor) {
    const T v = select(!r.direct, r.root_unlike(x), x);
    return fma(-factor, v, base(x, r, pi_words<T>::half));
  }

  /// The head is the rounded base - v; beside it stand its rounding error, that of the root, the
  /// second word of the base and the product with the polynomial's rest.
  LUMEN_MAIN T two_words(T x, const half_angle<T>& r) {
    const T b = base(x, r, pi_words<T>::half);
    const T low = base(x, r, pi_words<T>::half_low);
    const T v = select(!r.direct, r.root_like(x), -x);
    const T t = b + v;
    const T u = t - b;
    const T rest = select(r.direct, (v - u) + low, r.rest_of_root(u, low));
    return t + fma(arcsine_rest(r.z), u, rest);
  }
};

/// acos, float; largest error 0.70 ulp at `ha`, 3.3 in the one body of `la` and `ep`.
template <tier t>
struct acos_s : acos_paths<acos_s<t>, float> {
  LUMEN_MAIN float angle(float x, const half_angle<float>& r) {
    if constexpr (t == tier::ha) {
      return acos_s::two_words(x, r);
    } else {
      return acos_s::one_word(x, r, arcsine_factor(r.z));
    }
  }
};

/// acos, double. The polynomial has degree 12, at `ep` 5. Largest error 0.74, 2.4 and 4.1e7 ulp
/// for `ha`, `la`, `ep`.
template <tier t>
struct acos_d : acos_paths<acos_d<t>, double> {
  LUMEN_MAIN double angle(double x, const half_angle<double>& r) {
    if constexpr (t == tier::ha) {
      return acos_d::two_words(x, r);
    } else {
      return acos_d::one_word(x, r, t == tier::ep ? arcsine_factor_ep(r.z) : arcsine_factor(r.z));
    }
  }
};

/// acos, half: the float body of `ep` in every tier.
using acos_h = half_v11<acos_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
