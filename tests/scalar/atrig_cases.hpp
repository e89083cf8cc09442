// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// What the tests of the inverse trigonometric functions share.
#pragma once

#include <cmath>
#include <limits>

#include "exp_points.hpp"

namespace arbor::lumen::tests {

inline constexpr std::uint32_t domain = 1;

/// The distance of two finite patterns in numbers of the format; 0 and -0 are different.
template <typename U>
std::uint64_t distance(U a, U b) {
  if (((a ^ b) & named<U>::sign) != 0) return std::numeric_limits<std::uint64_t>::max();
  return a > b ? a - b : b - a;
}

/// Points whose second pattern is the number nearest to the exact result: the result is at most
/// `steps` numbers away, with status 0.
template <typename F, typename U, std::size_t N>
void expect_near_points(const point_of<U> (&points)[N], std::uint64_t steps,
                        location where = location::current()) {
  using T = typename F::input_type;
  for (const auto& p : points) {
    const T x = element<T>::value(p.x);
    T y = unwritten<T>();
    const std::uint32_t status = F::call(&x, &y);
    if (status != none || distance(std::bit_cast<U>(y), p.y) > steps)
      ADD_FAILURE_AT(where.file, where.line) << functor_name<F>() << " at " << x << ": " << y
                                             << " instead of " << element<T>::value(p.y);
  }
}

/// Numbers beyond the unit interval have the quiet NaN with their sign, NaNs themselves quietened;
/// infinities and every NaN are outside the domain.
template <typename F>
void expect_domain_of_unit_interval(location where = location::current()) {
  using U = part_of<typename F::input_type>;
  using n = named<U>;
  for (const U sign : {U(0), n::sign}) {
    if (F::main(element<typename F::input_type>::value(n::one | sign)).rare != 0)
      ADD_FAILURE_AT(where.file, where.line) << functor_name<F>() << " leaves its main path at 1";
    for (const U x : {U(n::one + 1), U(n::one + (n::smallest_normal >> 1)), n::largest, n::inf})
      expect_v11<F>(x | sign, n::nan | sign, domain, where);
    for (const U x : {n::nan, n::signalling, U(n::nan + 5), n::any_nan})
      expect_v11<F>(x | sign, x | sign | n::nan, domain, where);
  }
}

}  // namespace arbor::lumen::tests
