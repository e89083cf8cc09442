// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <utility>

#include "call/shape.hpp"

namespace arbor::lumen::vm::detail {

/// The operands of a call as a kernel on plain memory sees them.
template <typename Shape, typename T, typename U>
struct arguments {
  std::array<const T*, Shape::inputs> in;
  std::array<T, Shape::constants> constants;
  std::array<U*, Shape::outputs> out;
};

/// Distances between the elements of each operand, in elements.
template <typename Shape>
struct increments {
  std::array<std::int64_t, Shape::inputs> in;
  std::array<std::int64_t, Shape::outputs> out;

  /// Those of whole arrays.
  static constexpr increments units() {
    increments inc;
    inc.in.fill(1);
    inc.out.fill(1);
    return inc;
  }
};

template <typename Shape>
using input_indices = std::make_index_sequence<static_cast<std::size_t>(Shape::inputs)>;
template <typename Shape>
using constant_indices = std::make_index_sequence<static_cast<std::size_t>(Shape::constants)>;
template <typename Shape>
using output_indices = std::make_index_sequence<static_cast<std::size_t>(Shape::outputs)>;

/// Runs a functor on the elements of one index: pointers to its inputs, constants by value,
/// pointers to its outputs.
template <typename Shape, typename Functor, typename T, typename U, std::size_t... I,
          std::size_t... C, std::size_t... O>
inline std::uint32_t call_functor(const std::array<const T*, Shape::inputs>& a, const T* constants,
                                  std::size_t index, const std::array<U*, Shape::outputs>& y,
                                  std::index_sequence<I...>, std::index_sequence<C...>,
                                  std::index_sequence<O...>) {
  if constexpr (shape::is_indexed<Shape>)
    return Functor::call(a[I]..., constants[C]..., index, y[O]...);
  else
    return Functor::call(a[I]..., constants[C]..., y[O]...);
}

template <typename Shape, typename Functor, typename T, typename U>
inline std::uint32_t call_functor(const std::array<const T*, Shape::inputs>& a, const T* constants,
                                  std::size_t index, const std::array<U*, Shape::outputs>& y) {
  return call_functor<Shape, Functor, T, U>(a, constants, index, y, input_indices<Shape>{},
                                            constant_indices<Shape>{}, output_indices<Shape>{});
}

}  // namespace arbor::lumen::vm::detail
