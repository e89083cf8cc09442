// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// What the tests of the inverse trigonometric functions share.
#pragma once

#include <cmath>
#include <limits>
#include <optional>

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

/// Two operands and the result, status 0.
template <typename U>
struct pair_of {
  U y;
  U x;
  U angle;
};

template <typename F, typename U, std::size_t N>
void expect_pairs(const pair_of<U> (&pairs)[N], location where = location::current()) {
  for (const auto& p : pairs) expect_v21<F>(p.y, p.x, p.angle, none, where);
}

/// FNV-1a over the result patterns of 10,000 pairs that fill the square [-1, 1]².
template <typename F>
std::uint64_t pair_digest() {
  using T = typename F::input_type;
  std::uint64_t hash = 0xcbf29ce484222325;
  for (int k = 0; k < 10'000; ++k) {
    const T y = static_cast<T>(std::fmod(k * 0.6180339887498949, 2.0) - 1.0);
    const T x = static_cast<T>(std::fmod(k * 0.4142135623730951, 2.0) - 1.0);
    T r = unwritten<T>();
    F::call(&y, &x, &r);
    hash = (hash ^ std::bit_cast<part_of<T>>(r)) * 0x100000001b3;
  }
  return hash;
}

/// The angle of the point (x, y) where a coordinate is a zero or an infinity, in eighths of a full
/// turn without the sign of y; nothing elsewhere.
template <typename T>
std::optional<int> eighths(T y, T x) {
  const bool left = std::signbit(x);
  if (std::isinf(y)) return std::isinf(x) ? (left ? 3 : 1) : 2;
  if (std::isinf(x) || y == 0) return left ? 4 : 0;
  if (x == 0) return 2;
  return {};
}

/// One pair against the C library's extended arithmetic: exact on the axes and at infinity,
/// elsewhere at most `steps` numbers away from the nearest one; status 0, a quiet NaN for a NaN.
/// `half_turn` is the angle of the negative axis.
template <typename F, typename T>
bool expect_angle(T y, T x, long double half_turn, std::uint64_t steps, location where) {
  using U = part_of<T>;
  constexpr long double pi = 3.14159265358979323846264338327950288L;
  T r = unwritten<T>();
  const std::uint32_t status = F::call(&y, &x, &r);
  bool good = status == 0;
  T expected = std::numeric_limits<T>::quiet_NaN();
  if (std::isnan(y) || std::isnan(x)) {
    good = good && is_quiet_nan(std::bit_cast<U>(r));
  } else if (const auto special = eighths(y, x)) {
    expected = std::copysign(static_cast<T>(half_turn * *special / 4), y);
    good = good && std::bit_cast<U>(r) == std::bit_cast<U>(expected);
  } else {
    const long double angle = std::atan2(static_cast<long double>(y), static_cast<long double>(x));
    expected = static_cast<T>(angle * (half_turn / pi));
    good = good && distance(std::bit_cast<U>(r), std::bit_cast<U>(expected)) <= steps;
  }
  if (!good)
    ADD_FAILURE_AT(where.file, where.line)
        << functor_name<F>() << "\n  operands " << hex(element<T>::parts(y)) << " "
        << hex(element<T>::parts(x)) << "\n  expected " << hex(element<T>::parts(expected))
        << "\n  is       " << hex(element<T>::parts(r)) << " status " << status;
  return good;
}

/// All pairs of notable numbers, then random pairs: of any two numbers, and of numbers of about one
/// size, denormals and the largest included.
template <typename F>
void expect_angles(long double half_turn, std::uint64_t steps,
                   location where = location::current()) {
  using T = typename F::input_type;
  using U = part_of<T>;
  const auto check = [=](U y, U x) {
    return expect_angle<F>(element<T>::value(y), element<T>::value(x), half_turn, steps, where);
  };
  const auto patterns = notable_patterns<U>();
  for (const U y : patterns) {
    for (const U x : patterns) {
      if (!check(y, x)) return;
    }
  }
  pattern_source<U> source(77);
  for (int i = 0; i < 20'000; ++i) {
    const U y = source.any();
    if (!check(y, source.any()) || !check(y, source.near(y, 3))) return;
    const U tiny = y % (4 * named<U>::smallest_normal);
    if (!check(tiny, source.near(tiny, 3)) || !check(tiny, source.near(tiny, 60))) return;
    const U large = named<U>::inf - 1 - tiny;
    if (!check(large, source.near(large, 3)) || !check(large, tiny)) return;
  }
}

}  // namespace arbor::lumen::tests
