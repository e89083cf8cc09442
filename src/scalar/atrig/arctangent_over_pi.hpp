// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Polynomials for arctan(t)/pi = t P(t²).
#pragma once

#include <cstdint>

#include "scalar/atrig/arctangent_over_pi_constants.hpp"
#include "scalar/atrig/half_angle.hpp"
#include "scalar/horner.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The pattern of 1/2: a quarter turn.
template <typename T>
inline constexpr uint_of<T> one_half = format<T>::one - (uint_of<T>{1} << format<T>::fraction_bits);

/// P(z) on [0, 1], degree 21.
LUMEN_MAIN double arctangent_factor_over_pi(double z) {
  return horner(z, 0xbec435d571d7fb69u, 0x3efee969b7db1149u, 0xbf26798a20dc9977u,
                0x3f44c3c0c907686fu, 0xbf5b8ddb0f1cd2c5u, 0x3f6c3a72776ac84du, 0xbf778ac56b6fecf2u,
                0x3f80bad5cf20a9edu, 0xbf85278cbef8b02eu, 0x3f88ca8ee19b9723u, 0xbf8be48c140df0c8u,
                0x3f8eea5306d0465fu, 0xbf9124120821ba9du, 0x3f932bc4f824f7c6u, 0xbf95bac83a460e3eu,
                0x3f9912af904b4dd1u, 0xbf9da1baa68634ecu, 0x3fa21bb94433ed0au, 0xbfa7483758df91cfu,
                0x3fb04c26be3af8d5u, 0xbfbb2995e7b7b5eeu, pi_words<double>::inverse);
}

/// P(z) on [0, 1], degree 8, float.
LUMEN_MAIN float arctangent_factor_over_pi(float z) {
  return horner(z, 0x3a62dbf5u, 0xbba26edau, 0x3c5ab246u, 0xbcc21ebeu, 0x3d0a6574u, 0xbd391b64u,
                0x3d8253bau, 0xbdd94c33u, pi_words<float>::inverse);
}

/// P(z) on [0, 1] for float results: degree 10, the odd and the even coefficients apart.
LUMEN_MAIN double arctangent_factor_over_pi_short(double z) {
  const auto* c = arctangent_over_pi_coefficients;
  const double z2 = z * z;
  const double even = horner(z2, c[10], c[8], c[6], c[4], c[2], c[0]);
  const double odd = horner(z2, c[9], c[7], c[5], c[3], c[1]);
  return fma(odd, z, even);
}

/// base + (t + rest)/pi, rounded nearly once, for a rest that is small beside t. The base comes in
/// two words and is 0 or larger than t/pi.
LUMEN_MAIN double base_and_arctangent_over_pi(double base, double base_low, double t, double rest) {
  const double inverse = value(pi_words<double>::inverse);
  const double product = t * inverse;
  const double product_low =
      fma(t, value(pi_words<double>::inverse_low), fma(t, inverse, -product));
  const double sum = base + product;
  const double error = product - (sum - base);
  return sum + (error + (fma(rest, inverse, product_low) + base_low));
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
