// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Bessel functions of integer order. The C library's have an absolute error in units of the
/// amplitude sqrt(2 / (pi a)): near a zero few digits of the result are left. Where that shows and
/// the argument is not large, the power series is summed instead.
#pragma once

#include <cmath>
#include <limits>

#include "library/bessel_series.hpp"
#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

/// The integer that an order is cut to; beyond the range of integers its last one.
template <typename T>
int order_of(T b) {
  constexpr int last = std::numeric_limits<int>::max();
  if (std::fabs(b) < T(last)) return static_cast<int>(b);
  return b < 0 ? -last : last;
}

/// Whether a result y of the C library at x has fewer digits left than `T` has: it is small against
/// the amplitude, and not because x is below the order, where no zeros are.
template <typename T>
bool near_zero(int n, long double x, long double y) {
  constexpr long double two_by_pi = 0.636619772367581343075535053490057448L;
  constexpr int spare = std::numeric_limits<long double>::digits - std::numeric_limits<T>::digits;
  constexpr int kept = spare > 6 ? spare - 5 : 1;
  return x > n && x <= series::largest_argument &&
         std::fabs(std::ldexp(y, kept)) < std::sqrt(two_by_pi / x);
}

/// J_n(x) for n >= 0, 0 < x.
template <typename T>
T first_kind_of_positive(int n, long double x) {
  // Below (x/2)^n / n!, which is no number of any element type: the recurrence is spared.
  if (n >= 2) {
    int sign;
    if (n * std::log(x / 2) - ::lgammal_r(n + 1.0L, &sign) < -760) return T(0);
  }
  const long double y = n == 0 ? ::j0l(x) : (n == 1 ? ::j1l(x) : ::jnl(n, x));
  if (near_zero<T>(n, x, y)) return static_cast<T>(series::first_kind(n, series::real(x)));
  return static_cast<T>(y);
}

/// J_n(x).
template <typename T>
T first_kind(int n, T x) {
  if (std::isnan(x)) return x + x;
  if (std::isinf(x)) return T(0);
  const int order = n < 0 ? -n : n;
  const bool negative = (order & 1) != 0 && std::signbit(x) != (n < 0);
  const T a = std::fabs(x);
  const T magnitude = a == 0 ? T(order == 0 ? 1 : 0) : first_kind_of_positive<T>(order, a);
  return negative ? -magnitude : magnitude;
}

/// Y_n(x).
template <typename T>
T second_kind(int n, T x) {
  if (std::isnan(x)) return x + x;
  if (x < 0) return std::numeric_limits<T>::quiet_NaN();
  if (std::isinf(x)) return T(0);
  const int order = n < 0 ? -n : n;
  T value = -std::numeric_limits<T>::infinity();
  if (x > 0) {
    const long double a = x;
    const long double y = order == 0 ? ::y0l(a) : (order == 1 ? ::y1l(a) : ::ynl(order, a));
    value = near_zero<T>(order, a, y) ? static_cast<T>(series::second_kind(order, series::real(a)))
                                      : static_cast<T>(y);
  }
  return n < 0 && (order & 1) != 0 ? -value : value;
}

}  // namespace arbor::lumen::vm::detail::library
