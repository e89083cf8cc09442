// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Results and status at single arguments, compared by bits.
#pragma once

#include <bit>
#include <cmath>
#include <complex>
#include <cstdint>
#include <limits>

#include "scalar/bits.hpp"

namespace arbor::lumen::tests::library {

/// The pattern that a result has to match; a NaN stands for any quiet one.
template <typename R>
part_of<R> expected(R y) {
  return std::isnan(y) ? named<part_of<R>>::any_nan : std::bit_cast<part_of<R>>(y);
}
template <typename R>
pattern_of<std::complex<R>> expected(std::complex<R> y) {
  return {expected(y.real()), expected(y.imag())};
}

template <typename F, typename T = typename F::input_type>
bool expect(T x, typename F::output_type y, std::uint32_t status = 0,
            location where = location::current()) {
  auto result = unwritten<typename F::output_type>();
  const std::uint32_t s = F::call(&x, &result);
  return expect_result(expected(y), status, result, s, where, functor_name<F>(), "result", x);
}

/// The functor in place: the result overwrites the argument.
template <typename F, typename T = typename F::input_type>
bool expect_in_place(T x, location where = location::current()) {
  T apart = unwritten<T>();
  const std::uint32_t status = F::call(&x, &apart);
  T together = x;
  const std::uint32_t s = F::call(&together, &together);
  return expect_result(expected(apart), status, together, s, where, functor_name<F>(), "in place",
                       x);
}

template <typename T>
struct values {
  static constexpr T inf = std::numeric_limits<T>::infinity();
  static constexpr T nan = std::numeric_limits<T>::quiet_NaN();
  static constexpr T largest = std::numeric_limits<T>::max();
  static constexpr T smallest = std::numeric_limits<T>::denorm_min();
  static constexpr T normal = std::numeric_limits<T>::min();
};

inline constexpr std::uint32_t domain = 1, pole = 2, overflow = 4, underflow = 8;

}  // namespace arbor::lumen::tests::library
