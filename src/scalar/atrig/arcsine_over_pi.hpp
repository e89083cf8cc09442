// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/atrig/arcsine_polynomial.hpp"
#include "scalar/atrig/half_angle.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Q(z)/pi for Q(z) = arcsin(√z)/√z on [0, 1/4]; at float what is beside 1/pi, over z.
LUMEN_MAIN float arcsine_rest_over_pi(float z) {
  const float z2 = z * z;
  const float p3 = fma(value(0x3bf87e20u), z, value(0x3c6d978cu));
  const float p1 = fma(value(0x3cc36c37u), z, value(0x3d594d1bu));
  return fma(fma(value(0x3c5ea355u), z2, p3), z2, p1);
}
LUMEN_MAIN double arcsine_factor_over_pi(double z) {
  return horner(z, 0x3f84f45239939e37u, 0xbf759ee4331f54b9u, 0x3f79c78adbe84367u,
                0x3f60c57df93896dau, 0x3f6fcba465f52565u, 0x3f7219262af154f1u, 0x3f76a256c10640a7u,
                0x3f7d2b0ea197bf84u, 0x3f83ce53573ad3bcu, 0x3f8d1a452b1c8f59u, 0x3f98723a1d5e7f21u,
                0x3fab2995e7b7b28cu, pi_words<double>::inverse);
}

/// base + v Q(z)/pi, for |v| the argument of the arcsine or twice the root. Where the argument is 1
/// the root is 0 and the base is the result.
///
/// `ha` multiplies the arcsine by 1/pi in two words: v itself, and in one word what is small beside
/// it, v(Q - 1) and the error of the root.
template <tier t, typename T>
LUMEN_MAIN T base_and_arcsine_over_pi(T base, T v, const half_angle<T>& r) {
  const T inverse = value(pi_words<T>::inverse);
  if constexpr (t == tier::ha) {
    const T rest = select(r.direct, T(0), r.rest_of_root(v, T(0)));
    const T small = fma(arcsine_rest(r.z), v, rest);
    const T product = v * inverse;
    const T product_low = fma(v, value(pi_words<T>::inverse_low), fma(v, inverse, -product));
    const T sum = base + product;
    const T error = product - (sum - base);
    return sum + (error + fma(small, inverse, product_low));
  } else if constexpr (t == tier::ep && sizeof(T) == 8) {
    return fma(arcsine_factor_ep(r.z) * v, inverse, base);
  } else if constexpr (sizeof(T) == 4) {
    return fma(arcsine_rest_over_pi(r.z), r.z * v, fma(v, inverse, base));
  } else {
    return fma(arcsine_factor_over_pi(r.z), v, base);
  }
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
