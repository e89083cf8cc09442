// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The utilities as types, so that templates can be written over them, each with its own rule for
/// what one element becomes.
#pragma once

#include <arbor/lumen/vm/utilities.hpp>
#include <array>
#include <bit>
#include <cmath>
#include <complex>
#include <cstddef>
#include <cstdint>
#include <type_traits>
#include <utility>

#include "call/shape.hpp"
#include "utilities/product_reference.hpp"

namespace arbor::lumen::tests::utilities {

namespace shape = vm::detail::shape;

template <typename T>
inline constexpr bool is_complex = false;
template <typename R>
inline constexpr bool is_complex<std::complex<R>> = true;

/// The operands of one element.
template <typename Shape, typename T>
struct one_element {
  std::size_t index;
  std::array<T, Shape::inputs> in;
  std::array<T, Shape::constants> constants;
  std::array<T, Shape::outputs> out;
};

#define LUMEN_CALLS(function, shape_name)                                                  \
  using shape = utilities::shape::shape_name;                                              \
  static constexpr const char* name = #function;                                           \
  template <typename... A>                                                                 \
  auto operator()(A&&... arguments)                                                        \
      const->decltype(arbor::lumen::vm::detail::function(std::forward<A>(arguments)...)) { \
    return arbor::lumen::vm::detail::function(std::forward<A>(arguments)...);              \
  }

struct assign {
  LUMEN_CALLS(assign, vc1)
  template <typename T>
  static void compute(one_element<shape, T>& e) {
    e.out = {e.constants[0]};
  }
};

struct assign2 {
  LUMEN_CALLS(assign2, vc2)
  template <typename T>
  static void compute(one_element<shape, T>& e) {
    e.out = {e.constants[0], e.constants[0]};
  }
};

template <typename R>
R relations(R a, R b) {
  if (std::isunordered(a, b)) return 1;
  return a < b ? R(7) : a == b ? R(28) : R(49);
}
template <typename R>
std::complex<R> relations(std::complex<R> a, std::complex<R> b) {
  return {relations(a.real(), b.real()), relations(a.imag(), b.imag())};
}

struct compare {
  LUMEN_CALLS(compare, v21c)
  template <typename T>
  static void compute(one_element<shape, T>& e) {
    e.out = {relations(e.in[0], e.constants[0])};
  }
};

struct compare2 {
  LUMEN_CALLS(compare2, v21)
  template <typename T>
  static void compute(one_element<shape, T>& e) {
    e.out = {relations(e.in[0], e.in[1])};
  }
};

struct copy1 {
  LUMEN_CALLS(copy1, v11)
  template <typename T>
  static void compute(one_element<shape, T>& e) {
    e.out = {e.in[0]};
  }
};

struct copy2 {
  LUMEN_CALLS(copy2, v12)
  template <typename T>
  static void compute(one_element<shape, T>& e) {
    e.out = {e.in[0], e.in[0]};
  }
};

struct faa {
  LUMEN_CALLS(faa, v31)
  template <typename T>
  static void compute(one_element<shape, T>& e) {
    e.out = {sum(e.in[0], e.in[1], e.in[2])};
  }

 private:
  template <typename T>
  static T sum(T a, T b, T c) {
    if constexpr (std::is_same_v<T, float>)
      return static_cast<float>(static_cast<double>(a) + b + c);
    else if constexpr (is_complex<T>)
      return {sum(a.real(), b.real(), c.real()), sum(a.imag(), b.imag(), c.imag())};
    else
      return a + b + c;
  }
};

/// Leaves the output as it was.
struct fma {
  LUMEN_CALLS(fma, v31)
  template <typename T>
  static void compute(one_element<shape, T>&) {}
};

struct fmm {
  LUMEN_CALLS(fmm, v31)
  template <typename T>
  static void compute(one_element<shape, T>& e) {
    const auto& [a, b, c] = e.in;
    if constexpr (is_complex<T>)
      e.out = {product(product(a, b), c)};
    else
      e.out = {static_cast<T>(
          std::bit_cast<double>(rounded_product(pattern(a), pattern(b), pattern(c)).pattern))};
  }

 private:
  static std::uint64_t pattern(double x) { return std::bit_cast<std::uint64_t>(x); }
  /// For parts so small that nothing is rounded.
  template <typename T>
  static T product(T x, T y) {
    return {x.real() * y.real() - x.imag() * y.imag(), x.real() * y.imag() + x.imag() * y.real()};
  }
};

struct iota {
  LUMEN_CALLS(iota, vi2c1)
  template <typename T>
  static void compute(one_element<shape, T>& e) {
    if constexpr (is_complex<T>) {
      using R = typename T::value_type;
      const auto& [start, step] = e.constants;
      const auto t = static_cast<R>(e.index);
      e.out = {T((start.real() - start.imag()) * t + step.real(),
                 (start.real() + start.imag()) * t + step.imag())};
    } else {
      e.out = {T(0)};
    }
  }
};
#undef LUMEN_CALLS

/// M(utility) for each of them.
#define LUMEN_UTILITIES(M) \
  M(assign) M(assign2) M(compare) M(compare2) M(copy1) M(copy2) M(faa) M(fma) M(fmm) M(iota)

}  // namespace arbor::lumen::tests::utilities
