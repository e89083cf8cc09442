// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Fixed points of the exponentials. The expected patterns are those of the bodies' steps carried
/// out in exact rational arithmetic with one rounding per operation, so they hold wherever the
/// arithmetic is correctly rounded.
#pragma once

#include <cstdint>

#include "bits.hpp"

namespace arbor::lumen::tests {

enum status_mask : std::uint32_t { none = 0, over = 4, under = 8 };

template <typename U>
struct point_of {
  U x;
  U y;
  status_mask status = none;
};

template <typename F, typename U, std::size_t N>
void expect_points(const point_of<U> (&points)[N], location where = location::current()) {
  for (const auto& p : points) expect_v11<F>(p.x, p.y, p.status, where);
}

/// NaNs of both signs, quiet and signalling, have status 0 and give a quiet NaN.
template <typename F>
void expect_quiet_nans(location where = location::current()) {
  using n = named<part_of<typename F::input_type>>;
  for (const auto x : {n::nan, n::signalling, n::any_nan}) {
    expect_v11<F>(x, n::any_nan, none, where);
    expect_v11<F>(x | n::sign, n::any_nan, none, where);
  }
}

/// The rare path by itself, for what no argument of a call reaches.
template <typename F, typename U>
void expect_rare(U x, U y, std::uint32_t status, location where = location::current()) {
  const auto a = element<typename F::input_type>::value(x);
  auto result = unwritten<typename F::output_type>();
  const std::uint32_t s = F::rare(a, &result);
  expect_result(y, status, result, s, where, functor_name<F>(), "result of the rare path", a);
}

/// FNV-1a over the result patterns at the 20,000 odd multiples of step/2 next to zero, rounded to
/// the type: holds the last bits of constants that single points do not show.
template <typename F>
std::uint64_t digest(double step) {
  using T = typename F::input_type;
  std::uint64_t hash = 0xcbf29ce484222325;
  for (int k = -10'000; k < 10'000; ++k) {
    const T x = static_cast<T>((2 * k + 1) * (step / 2));
    T y = unwritten<T>();
    F::call(&x, &y);
    hash = (hash ^ std::bit_cast<part_of<T>>(y)) * 0x100000001b3;
  }
  return hash;
}

}  // namespace arbor::lumen::tests
