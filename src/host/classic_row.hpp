// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <cstdint>
#include <utility>

#include "device/tuning_info.hpp"
#include "host/executor.hpp"
#include "host/kernels.hpp"

/// Host rows on the kernels of the array-math module.
namespace arbor::lumen::vm::detail::cpu::norvane {

/// Two wrappers of the binding as the entries of an executor.
template <typename Shape, typename T, typename U, auto Linear, auto Strided>
struct wrapped {
  static void linear(std::int64_t n, const arguments<Shape, T, U>& args, std::int64_t mode) {
    linear(n, args, mode, input_indices<Shape>{}, constant_indices<Shape>{},
           output_indices<Shape>{});
  }
  static void strided(std::int64_t n, const arguments<Shape, T, U>& args,
                      const increments<Shape>& inc, std::int64_t mode) {
    if constexpr (Shape::inputs == 1 && Shape::constants == 0 && Shape::outputs == 1)
      Strided(n, args.in[0], inc.in[0], args.out[0], inc.out[0], mode);
    else if constexpr (Shape::inputs == 1 && Shape::constants == 0 && Shape::outputs == 2)
      Strided(n, args.in[0], inc.in[0], args.out[0], inc.out[0], args.out[1], inc.out[1], mode);
    else if constexpr (Shape::inputs == 1 && Shape::constants == 1)
      Strided(n, args.in[0], inc.in[0], args.constants[0], args.out[0], inc.out[0], mode);
    else if constexpr (Shape::inputs == 2 && Shape::constants == 0)
      Strided(n, args.in[0], inc.in[0], args.in[1], inc.in[1], args.out[0], inc.out[0], mode);
    else
      Strided(n, args.in[0], inc.in[0], args.in[1], inc.in[1], args.constants[0], args.constants[1],
              args.constants[2], args.constants[3], args.out[0], inc.out[0], mode);
  }

 private:
  template <std::size_t... I, std::size_t... C, std::size_t... O>
  static void linear(std::int64_t n, const arguments<Shape, T, U>& args, std::int64_t mode,
                     std::index_sequence<I...>, std::index_sequence<C...>,
                     std::index_sequence<O...>) {
    Linear(n, args.in[I]..., args.constants[C]..., args.out[O]..., mode);
  }
};

/// Two kernels in a row as one of two results. The one that would overwrite the input comes last.
template <typename T, auto First, auto Second>
void both(std::int64_t n, const T* a, T* y, T* z, std::int64_t mode) {
  if (a != y) First(n, a, y, mode);
  Second(n, a, z, mode);
  if (a == y) First(n, a, y, mode);
}
template <typename T, auto First, auto Second>
void both_strided(std::int64_t n, const T* a, std::int64_t inca, T* y, std::int64_t incy, T* z,
                  std::int64_t incz, std::int64_t mode) {
  if (a != y) First(n, a, inca, y, incy, mode);
  Second(n, a, inca, z, incz, mode);
  if (a == y) First(n, a, inca, y, incy, mode);
}

/// The launcher of a host row, as family tables hold it.
template <typename Shape, typename T, typename U, auto Linear, auto Strided, std::int64_t Mode,
          error_kind Errors>
sycl::event classic_launcher(const input::vxx& record, TuningInfo) {
  using entries = wrapped<Shape, T, U, Linear, Strided>;
  return execute<Shape, T, U>(record, {&entries::linear, &entries::strided}, {Mode, Errors});
}

}  // namespace arbor::lumen::vm::detail::cpu::norvane
