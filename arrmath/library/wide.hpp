// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// What the functions of this folder share: the wider type that one computes in, and the status.
#pragma once

#include <cmath>
#include <complex>
#include <cstdint>
#include <limits>
#include <type_traits>

namespace arbor::lumen::vm::detail::library {

/// The status mask of one element.
inline constexpr std::uint32_t success = 0;
inline constexpr std::uint32_t domain = 1;
inline constexpr std::uint32_t pole = 2;
inline constexpr std::uint32_t overflow = 4;
inline constexpr std::uint32_t underflow = 8;

template <typename T>
inline constexpr bool is_real = std::is_floating_point_v<T>;

template <typename T>
struct wider;
template <>
struct wider<float> {
  using type = double;
};
template <>
struct wider<double> {
  using type = long double;
};
template <typename R>
struct wider<std::complex<R>> {
  using type = std::complex<typename wider<R>::type>;
};

/// The type in which a function of elements `T` is computed.
template <typename T>
using wide = typename wider<T>::type;

template <typename T>
wide<T> widen(T x) {
  return wide<T>(x);
}

/// Rounds to an element, each part by itself.
template <typename T, typename W>
T narrow(W x) {
  if constexpr (is_real<T>)
    return static_cast<T>(x);
  else
    return {narrow<typename T::value_type>(x.real()), narrow<typename T::value_type>(x.imag())};
}

/// The status of an argument whose result may have overflowed.
template <typename T>
std::uint32_t overflow_from(T x, T y) {
  return std::isinf(y) && !std::isinf(x) ? overflow : success;
}

}  // namespace arbor::lumen::vm::detail::library
