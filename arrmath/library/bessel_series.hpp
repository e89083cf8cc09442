// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Bessel functions by their power series, in so many digits that the cancellation of the terms and
/// of a zero nearby leave more of them than any element type has.
#pragma once

#include <boost/math/constants/constants.hpp>
#include <boost/multiprecision/cpp_bin_float.hpp>

namespace arbor::lumen::vm::detail::library::series {

/// The series is summed for arguments up to this one, where its largest term is below 2^56.
inline constexpr int largest_argument = 40;

using real = boost::multiprecision::number<
    boost::multiprecision::cpp_bin_float<256, boost::multiprecision::digit_base_2>,
    boost::multiprecision::et_off>;

/// Ends a series: the term no longer counts beside 1, and from k on they only fall.
inline bool ends(const real& term, int k, const real& x) {
  return k > x && (term == 0 || ilogb(term) < -240);
}

/// J_n(x) = sum of (-1)^k (x/2)^(2k + n) / (k! (n + k)!)
inline real first_kind(int n, const real& x) {
  const real square = x * x / 4;
  real term = 1;
  for (int k = 1; k <= n; ++k) term *= x / (2 * k);
  real sum = term;
  for (int k = 1; !ends(term, k, x); ++k) {
    term *= -square / (real(k) * (n + k));
    sum += term;
  }
  return sum;
}

/// Y_0(x) = 2/pi ((ln(x/2) + gamma) J_0(x) - sum of (-1)^k H_k (x/2)^(2k) / (k!)^2), and upwards
/// from it by the recurrence; Y_1 from the Wronskian J_1 Y_0 - J_0 Y_1 = 2 / (pi x).
inline real second_kind(int n, const real& x) {
  const real two_by_pi = 2 / boost::math::constants::pi<real>();
  const real square = x * x / 4;
  const real j0 = first_kind(0, x);
  real sum = (log(x / 2) + boost::math::constants::euler<real>()) * j0;
  real term = 1;
  real harmonic = 0;
  for (int k = 1; !ends(term, k, x); ++k) {
    term *= -square / (real(k) * k);
    harmonic += 1 / real(k);
    sum -= harmonic * term;
  }
  real below = two_by_pi * sum;
  if (n == 0) return below;
  real value = (first_kind(1, x) * below - two_by_pi / x) / j0;
  for (int k = 1; k < n; ++k) {
    const real above = 2 * k * value / x - below;
    below = value;
    value = above;
  }
  return value;
}

}  // namespace arbor::lumen::vm::detail::library::series
