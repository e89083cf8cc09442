// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/ops.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// An unevaluated sum of two doubles.
struct double_double {
  double high;
  double low;
};

/// a + b without error, for any order of magnitudes.
LUMEN_DEVICE inline double_double two_sum(double a, double b) {
  const double s = a + b;
  const double b_part = s - a;
  return {s, (a - (s - b_part)) + (b - b_part)};
}

/// a + b without error, for |a| >= |b| or a = 0.
LUMEN_DEVICE inline double_double fast_two_sum(double a, double b) {
  const double s = a + b;
  return {s, b - (s - a)};
}

/// ab without error, unless the error underflows. A product that is exactly zero is +0.
LUMEN_DEVICE inline double_double two_product(double a, double b) {
  const double p = fma(a, b, 0.0);
  return {p, fma(a, b, -p)};
}

/// p + q for two exact products, the parts not normalized: their sum, once rounded, is within
/// 2^-50 ulp of the rounding of p + q, whatever cancels. The high parts cancel only without an
/// error of their own, and if the low parts then cancel what is left, that is exact as well.
LUMEN_DEVICE inline double_double sum_of_products(double_double p, double_double q) {
  const double_double high = two_sum(p.high, q.high);
  const double_double low = two_sum(p.low, q.low);
  const double_double sum = two_sum(high.high, low.high);
  return {sum.high, sum.low + (high.low + low.low)};
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
