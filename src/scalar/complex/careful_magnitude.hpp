// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/complex/double_double.hpp"
#include "scalar/complex/scaled_double.hpp"
#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// sum·4^exponent, the sum normalized, high part in [1, 8).
struct scaled_sum {
  double_double sum;
  int exponent;
};

/// a² + b² of finite numbers that are not both zero, of any size: the exponent of the larger is
/// taken out of both, and their squares are summed without error.
LUMEN_DEVICE inline scaled_sum scaled_sum_of_squares(double a, double b) {
  const scaled_double sa = scaled_double::of(fabs(a));
  const scaled_double sb = scaled_double::of(fabs(b));
  const bool a_larger = sa.exponent >= sb.exponent;
  const scaled_double larger = a_larger ? sa : sb;
  const scaled_double smaller = a_larger ? sb : sa;
  // Further down the smaller counts as a sticky bit only.
  constexpr int furthest = 200;
  const int distance = larger.exponent - smaller.exponent;
  const double n = smaller.significand * power_of_two(-(distance < furthest ? distance : furthest));
  const double_double mm = two_product(larger.significand, larger.significand);
  const double_double nn = two_product(n, n);
  const double_double raw = sum_of_products(mm, nn);
  return {fast_two_sum(raw.high, raw.low), larger.exponent};
}

/// sqrt(a² + b²) of finite numbers that are not both zero, of any size: within 0.5000001 ulp, and
/// the correctly rounded denormal where the result is one.
///
/// The root s of the rounded sum is corrected by half the rest over s: the next term of the series
/// is below 2^-106 of the result.
LUMEN_DEVICE inline double careful_magnitude(double a, double b) {
  const scaled_sum squares = scaled_sum_of_squares(a, b);
  const double_double sum = squares.sum;
  const double root = sqrt(sum.high);
  const double rest = fma(-root, root, sum.high) + sum.low;
  return scaled_back(fast_two_sum(root, divide(rest, 2 * root)), squares.exponent);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
