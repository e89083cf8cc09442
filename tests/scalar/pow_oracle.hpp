// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// What the powers of special operands are, written anew from their tables, and a grid of such
/// operands.
#pragma once

#include <cmath>
#include <limits>
#include <optional>
#include <vector>

#include "bits.hpp"

namespace arbor::lumen::tests {

/// A pattern, or `any_nan`, and the status mask.
template <typename U>
struct expected_power {
  U pattern;
  std::uint32_t status;
};

template <typename T>
bool is_integer(T y) {
  return std::isfinite(y) && std::trunc(y) == y;
}
template <typename T>
bool is_odd(T y) {
  return std::isfinite(y) && std::fabs(std::fmod(y, T(2))) == 1;
}

/// pow at float: rows in their order; nothing where the result is an ordinary power.
inline std::optional<expected_power<std::uint32_t>> special_pow(float x, float y) {
  using e = expected_power<std::uint32_t>;
  constexpr std::uint32_t inf = 0x7f800000, one = 0x3f800000, minus = 0x80000000, nan = 0xffc00000;
  const float ax = std::fabs(x);
  const std::uint32_t odd_sign = std::signbit(x) && is_odd(y) ? minus : 0;
  if (y == 0) return e{one, 0};
  if (std::isnan(y)) return e{x == 1 ? one : nan, 0};
  if (std::isinf(y) && std::isnan(x)) return e{nan, 0};
  if (std::isinf(y) && ax == 1) return e{one, 0};
  if (std::isinf(y) && (y > 0 ? ax > 1 : ax < 1)) return e{inf, x == 0 ? 1u : 0u};
  if (std::isinf(y)) return e{0, 0};
  if (std::isinf(x) && x > 0) return e{y < 0 ? 0 : inf, 0};
  if (std::isnan(x)) return e{nan, 0};
  if (x == 0 && y < 0) return e{inf | odd_sign, 1};
  if (x == 0) return e{0, 0};
  if (std::isinf(x)) return e{(y < 0 ? 0 : inf) | odd_sign, 0};
  if (x < 0 && !is_integer(y)) return e{nan, 1};
  if (x == -1) return e{one | odd_sign, 0};
  return {};
}

/// pow at double.
inline std::optional<expected_power<std::uint64_t>> special_pow(double x, double y) {
  using e = expected_power<std::uint64_t>;
  using n = named<std::uint64_t>;
  const std::uint64_t sign = std::signbit(x) && is_odd(y) ? n::sign : 0;
  if (x == 1 || y == 0) return e{n::one, 0};
  if (std::isnan(x) || std::isnan(y)) return e{n::any_nan, 0};
  if (x == 0 && y < 0) return e{n::inf | sign, 1};
  if (x == 0) return e{sign, 0};
  if (x == -1 && (is_integer(y) || std::isinf(y))) return e{n::one | sign, 0};
  if ((std::isinf(x) || std::isinf(y)) && std::fabs(x) < 1) return e{y > 0 ? 0 : n::inf, 0};
  if (std::isinf(x) || std::isinf(y)) return e{y > 0 ? n::inf | sign : 0, 0};
  if (x < 0 && !is_integer(y)) return e{n::any_nan, 1};
  return {};
}

/// powr.
template <typename T>
std::optional<expected_power<part_of<T>>> special_powr(T x, T y) {
  using U = part_of<T>;
  using n = named<U>;
  using e = expected_power<U>;
  const U px = std::bit_cast<U>(x);
  const U py = std::bit_cast<U>(y);
  const bool y_up = y > 0;
  if (px > n::sign) return e{n::nan, 1};
  if (y == 0 && x == 0) return e{U((px ^ py) | n::any_nan), 1};
  if (y == 0 && std::isnan(x)) return e{n::any_nan, 0};
  if (y == 0) return e{n::one, 0};
  if (std::isnan(y)) return e{U(py & ~n::sign), 0};
  if (std::isnan(x)) return e{U(n::sign | n::nan), 0};
  if (x == 1) return e{n::one, 0};
  if (std::isinf(y) && (x > 1) == y_up) return e{n::inf, x == 0 ? 1u : 0u};
  if (std::isinf(y)) return e{0, 0};
  if (std::isinf(x)) return e{y_up ? n::inf : U(0), 0};
  if (x == 0) return y_up ? e{0, 0} : e{n::inf, 1};
  return {};
}

/// Zeros, denormals, next to 1, integers and halves of them small and at the end of what the format
/// can tell apart, the largest numbers, infinities, NaNs; with both signs.
template <typename T>
std::vector<T> power_operands() {
  using limits = std::numeric_limits<T>;
  const T unit_from = std::ldexp(T(1), limits::digits - 1);  // from here on all are integers
  const T infinity = limits::infinity();
  std::vector<T> list = {T(0),
                         limits::denorm_min(),
                         3 * limits::denorm_min(),
                         std::nextafter(limits::min(), T(0)),
                         limits::min(),
                         T(1) / 3,
                         T(0.5),
                         std::nextafter(T(1), T(0)),
                         T(1),
                         std::nextafter(T(1), T(2)),
                         T(1.5),
                         T(2),
                         T(2.5),
                         T(3),
                         T(4),
                         T(5),
                         T(12.5),
                         T(63),
                         T(64),
                         unit_from / 2 - T(0.5),
                         unit_from / 2,
                         unit_from / 2 + T(0.5),
                         unit_from / 2 + 1,
                         unit_from - T(0.5),
                         unit_from - 1,
                         unit_from,
                         unit_from + 1,
                         unit_from + 2,
                         2 * unit_from - 1,
                         2 * unit_from,
                         2 * unit_from + 2,
                         std::ldexp(T(1), limits::max_exponent - 4),
                         limits::max(),
                         infinity};
  using n = named<part_of<T>>;
  for (const auto p : {n::nan, part_of<T>(n::nan + 5), n::signalling})
    list.push_back(std::bit_cast<T>(p));
  const std::size_t positive = list.size();
  for (std::size_t i = 0; i < positive; ++i)
    list.push_back(std::bit_cast<T>(std::bit_cast<part_of<T>>(list[i]) | n::sign));
  return list;
}

}  // namespace arbor::lumen::tests
