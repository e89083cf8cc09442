// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/complex/double_double.hpp"
#include "scalar/complex/scaled_double.hpp"
#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// sum·2^exponent, the sum normalized.
struct scaled_double_double {
  double_double sum;
  int exponent;
};

/// pq + rs for finite numbers of any size: its rounding is that of the exact value, but for the
/// last 2^-50 ulp, whatever cancels.
LUMEN_DEVICE inline scaled_double_double scaled_sum_of_products(double p, double q, double r,
                                                                double s) {
  const scaled_double sp = scaled_double::of(p), sq = scaled_double::of(q);
  const scaled_double sr = scaled_double::of(r), ss = scaled_double::of(s);
  const int pq_exponent = sp.exponent + sq.exponent;
  const int rs_exponent = sr.exponent + ss.exponent;
  double_double larger = two_product(sp.significand, sq.significand);
  double_double smaller = two_product(sr.significand, ss.significand);
  int exponent = pq_exponent;
  int distance = pq_exponent - rs_exponent;
  if (distance < 0) {
    const double_double swapped = larger;
    larger = smaller;
    smaller = swapped;
    exponent = rs_exponent;
    distance = -distance;
  }
  // The smaller product counts as a sticky bit beyond the reach of a double-double.
  constexpr int furthest = 400;
  const double scale = power_of_two(-(distance < furthest ? distance : furthest));
  const double_double sum = sum_of_products(larger, {smaller.high * scale, smaller.low * scale});
  return {fast_two_sum(sum.high, sum.low), exponent};
}

/// pq + rs with one rounding for finite numbers of any size.
LUMEN_DEVICE inline double rounded_sum_of_products(double p, double q, double r, double s) {
  const scaled_double_double sum = scaled_sum_of_products(p, q, r, s);
  return scaled_back(sum.sum, sum.exponent);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
