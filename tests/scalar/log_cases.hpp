// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// What the tests of the logarithms share.
#pragma once

#include <cmath>
#include <limits>

#include "exp_points.hpp"

namespace arbor::lumen::tests {

inline constexpr std::uint32_t domain = 1;
inline constexpr std::uint32_t pole = 2;

template <typename F, typename U, std::size_t N>
void expect_rare_points(const point_of<U> (&points)[N], location where = location::current()) {
  for (const auto& p : points) expect_rare<F>(p.x, p.y, p.status, where);
}

/// Where the main path's value stands: the numbers from `lowest` to `highest`, and no NaN.
template <typename F>
void expect_main_path_between(part_of<typename F::input_type> lowest,
                              part_of<typename F::input_type> highest,
                              location where = location::current()) {
  using T = typename F::input_type;
  const auto expect = [where](T x, bool stands) {
    if ((F::main(x).rare == 0) != stands)
      ADD_FAILURE_AT(where.file, where.line) << functor_name<F>() << " main path at " << x;
  };
  const T infinity = std::numeric_limits<T>::infinity();
  const T first = element<T>::value(lowest);
  const T last = element<T>::value(highest);
  expect(first, true);
  expect(std::nextafter(first, -infinity), false);
  expect(last, true);
  expect(std::nextafter(last, infinity), false);
  expect(T(1), true);
  expect(infinity, false);
  expect(-infinity, false);
  expect(std::numeric_limits<T>::quiet_NaN(), false);
  expect(-std::numeric_limits<T>::quiet_NaN(), false);
}

/// Numbers below zero, from the smallest to -infinity.
template <typename U>
std::vector<U> negative_patterns() {
  using n = named<U>;
  return {U(n::sign | 1),
          U(n::sign | (n::smallest_normal - 1)),
          U(n::sign | n::smallest_normal),
          U(n::sign | n::one),
          U(n::sign | n::largest),
          U(n::sign | n::inf)};
}

/// Zeros and +infinity of every logarithm.
template <typename F>
void expect_poles_and_infinity(location where = location::current()) {
  using n = named<part_of<typename F::input_type>>;
  expect_v11<F>(0, n::inf | n::sign, pole, where);
  expect_v11<F>(n::sign, n::inf | n::sign, pole, where);
  expect_v11<F>(n::inf, n::inf, none, where);
}

/// Of negative numbers the positive quiet NaN with an empty payload.
template <typename F>
void expect_poles_and_domain(location where = location::current()) {
  using n = named<part_of<typename F::input_type>>;
  expect_poles_and_infinity<F>(where);
  for (const auto x : negative_patterns<part_of<typename F::input_type>>())
    expect_v11<F>(x, n::nan, domain, where);
}

/// Of negative numbers, and of NaNs with their sign bit set, the own pattern as a quiet NaN.
template <typename F>
void expect_negative_keeps_its_pattern(location where = location::current()) {
  using U = part_of<typename F::input_type>;
  using n = named<U>;
  expect_poles_and_infinity<F>(where);
  for (const auto x : negative_patterns<U>()) expect_v11<F>(x, x | n::nan, domain, where);
  for (const U x : {n::nan, n::signalling, n::any_nan, U(n::nan + 5)}) {
    expect_v11<F>(x, n::any_nan, none, where);
    expect_v11<F>(x | n::sign, x | n::sign | n::nan, domain, where);
  }
}

/// The same, with positive NaNs flagged too.
template <typename F>
void expect_every_nan_is_flagged(location where = location::current()) {
  using U = part_of<typename F::input_type>;
  using n = named<U>;
  expect_poles_and_infinity<F>(where);
  for (const auto x : negative_patterns<U>()) expect_v11<F>(x, x | n::nan, domain, where);
  for (const U x : {n::nan, n::signalling, U(n::nan + 5)}) {
    expect_v11<F>(x, x | n::nan, domain, where);
    expect_v11<F>(x | n::sign, x | n::sign | n::nan, domain, where);
  }
}

}  // namespace arbor::lumen::tests
