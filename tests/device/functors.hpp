// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cmath>
#include <cstdint>
#include <stdexcept>
#include <type_traits>

#include "call/shape.hpp"

/// Scalar functors whose values are exact and tell which elements they were computed from, so that
/// any mistake in the arithmetic of indices shows.
namespace arbor::lumen::tests {

/// The status of an element: none for multiples of 5, then each of the four in turn.
template <typename T>
std::uint32_t status_of(T a) {
  const int residue = static_cast<int>(std::fabs(a)) % 5;
  return residue == 0 ? 0 : 1u << (residue - 1);
}

/// Some functors of the library leave results of some arguments unwritten.
template <typename T>
bool writes(T a) {
  return static_cast<int>(std::fabs(a)) % 7 != 6;
}

template <typename T, typename U = T>
struct test_functor {
  using input_type = T;
  using output_type = U;
  static constexpr bool needs_fp64 = std::is_same_v<T, double>;
};

/// y = 2a + 1
template <typename T>
struct tag_v11 : test_functor<T> {
  static std::uint32_t call(const T* a, T* y) {
    const T x = *a;
    if (writes(x)) *y = 2 * x + 1;
    return status_of(x);
  }
};

/// y1 = 3a, y2 = -a
template <typename T>
struct tag_v12 : test_functor<T> {
  static std::uint32_t call(const T* a, T* y1, T* y2) {
    const T x = *a;
    if (writes(x)) *y1 = 3 * x;
    *y2 = -x;
    return status_of(x);
  }
};

/// y = 1000a + b
template <typename T>
struct tag_v21 : test_functor<T> {
  static std::uint32_t call(const T* a, const T* b, T* y) {
    const T p = *a;
    const T q = *b;
    if (writes(p)) *y = 1000 * p + q;
    return status_of(p + q);
  }
};

/// y = 1000a + c
template <typename T>
struct tag_v21c : test_functor<T> {
  static std::uint32_t call(const T* a, T c, T* y) {
    const T p = *a;
    if (writes(p)) *y = 1000 * p + c;
    return status_of(p + c);
  }
};

/// The functor of a shape.
template <typename Shape, typename T>
struct tag;
template <typename T>
struct tag<vm::detail::shape::v11, T> : tag_v11<T> {};
template <typename T>
struct tag<vm::detail::shape::v12, T> : tag_v12<T> {};
template <typename T>
struct tag<vm::detail::shape::v21, T> : tag_v21<T> {};
template <typename T>
struct tag<vm::detail::shape::v21c, T> : tag_v21c<T> {};

/// Copies, and returns the argument itself as the status.
template <typename T>
struct echo_status : test_functor<T> {
  static std::uint32_t call(const T* a, T* y) {
    *y = *a;
    return static_cast<std::uint32_t>(*a);
  }
};

/// A kernel that fails.
struct failing : test_functor<float> {
  static std::uint32_t call(const float*, float*) { throw std::domain_error("a failing kernel"); }
};

/// Needs double, though its elements are float.
struct double_inside : tag_v11<float> {
  static constexpr bool needs_fp64 = true;
};

}  // namespace arbor::lumen::tests
