// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Kernels of the array-math module, made of functors: blocks of a vectorised main path with the
/// rare path apart where a functor has such parts, else element by element.
#pragma once

#include <algorithm>
#include <bit>
#include <complex>
#include <cstddef>
#include <cstdint>
#include <type_traits>
#include <utility>

#include "call/arguments.hpp"
#include "module/state.hpp"
#include "scalar/block_loop.hpp"

namespace arbor::lumen::arr {

namespace shape = vm::detail::shape;
using vm::detail::arguments;
using vm::detail::increments;

/// One functor over arrays. Every function returns the status masks of the elements, ored.
template <typename Shape, typename Functor>
class array_loop {
 public:
  using T = typename Functor::input_type;
  using U = typename Functor::output_type;
  using operands = arguments<Shape, T, U>;

  static std::uint32_t linear(std::int32_t n, const operands& args) {
    if constexpr (std::is_void_v<block_loop>)
      return element_by_element(n, args, increments<Shape>::units());
    else if constexpr (Shape::constants == 1)
      return with_constant(n, args, increments<Shape>::units());
    else
      return linear(n, args, vm::detail::input_indices<Shape>{},
                    vm::detail::output_indices<Shape>{});
  }

  static std::uint32_t strided(std::int32_t n, const operands& args,
                               const increments<Shape>& inc) {
    if constexpr (std::is_void_v<block_loop>)
      return element_by_element(n, args, inc);
    else if constexpr (Shape::constants == 1)
      return with_constant(n, args, inc);
    else
      return strided(n, args, inc, vm::detail::input_indices<Shape>{},
                     vm::detail::output_indices<Shape>{});
  }

  /// With a call of the thread's callback for each element that has a status.
  static std::uint32_t reported(std::int32_t n, const operands& args,
                                const increments<Shape>& inc) {
    std::uint32_t status = 0;
    for (std::int32_t i = 0; i < n; ++i) {
      operands element = at(i, args, inc);
      // The callback is told the arguments, which an in-place call overwrites.
      T copies[std::max(Shape::inputs, 1)] = {};
      for (std::size_t k = 0; k < Shape::inputs; ++k) {
        copies[k] = *element.in[k];
        element.in[k] = &copies[k];
      }
      const std::uint32_t mask = call(element);
      if (mask != 0) report(mask, i, element);
      status |= mask;
    }
    return status;
  }

 private:
  using block_loop = vm::detail::gpu::norvane::scalar::block_loop_of<Functor>;

  template <std::size_t... I, std::size_t... O>
  static std::uint32_t linear(std::int32_t n, const operands& args, std::index_sequence<I...>,
                              std::index_sequence<O...>) {
    return block_loop::run(n, {args.in[I]...}, {args.out[O]...});
  }
  template <std::size_t... I, std::size_t... O>
  static std::uint32_t strided(std::int32_t n, const operands& args, const increments<Shape>& inc,
                               std::index_sequence<I...>, std::index_sequence<O...>) {
    return block_loop::run_strided(n, {args.in[I]...}, inc.in.data(), {args.out[O]...},
                                   inc.out.data());
  }

  /// A constant is the second array of a loop over two, with an increment of 0.
  static std::uint32_t with_constant(std::int32_t n, const operands& args,
                                     const increments<Shape>& inc) {
    constexpr std::int64_t length = block_loop::length;
    T constants[length];
    std::fill_n(constants, length, args.constants[0]);
    std::uint32_t status = 0;
    for (std::int64_t first = 0; first < n; first += length) {
      const operands rest = at(first, args, inc);
      const std::int64_t count = std::min(length, n - first);
      const std::int64_t in_increments[] = {inc.in[0], 1};
      if (inc.in[0] == 1 && inc.out[0] == 1)
        status |= block_loop::run(count, {rest.in[0], constants}, {rest.out[0]});
      else
        status |= block_loop::run_strided(count, {rest.in[0], constants}, in_increments,
                                          {rest.out[0]}, inc.out.data());
    }
    return status;
  }

  static std::uint32_t element_by_element(std::int32_t n, const operands& args,
                                          const increments<Shape>& inc) {
    std::uint32_t status = 0;
    for (std::int32_t i = 0; i < n; ++i) status |= call(at(i, args, inc));
    return status;
  }

  static operands at(std::int64_t i, const operands& args, const increments<Shape>& inc) {
    operands element = args;
    for (std::size_t k = 0; k < Shape::inputs; ++k) element.in[k] += i * inc.in[k];
    for (std::size_t j = 0; j < Shape::outputs; ++j) element.out[j] += i * inc.out[j];
    return element;
  }

  static std::uint32_t call(const operands& element) {
    return vm::detail::call_functor<Shape, Functor, T, U>(element.in, element.constants.data(), 0,
                                                          element.out);
  }

  static void report(std::uint32_t mask, std::int32_t index, const operands& element) {
    lumen_arr_error_record record{};
    record.code = std::countr_zero(mask) + 1;
    record.index = index;
    constexpr std::size_t arguments_told = Shape::inputs < 2 ? Shape::inputs : 2;
    for (std::size_t k = 0; k < arguments_told; ++k)
      note(*element.in[k], record.argument[k], record.argument_imag[k]);
    for (std::size_t j = 0; j < Shape::outputs; ++j)
      note(*element.out[j], record.result[j], record.result_imag[j]);
    state().callback(&record);
    for (std::size_t j = 0; j < Shape::outputs; ++j)
      take(record.result[j], record.result_imag[j], *element.out[j]);
  }

  template <typename R>
  static void note(R value, double& real, double&) {
    real = static_cast<double>(value);
  }
  template <typename R>
  static void note(std::complex<R> value, double& real, double& imag) {
    real = static_cast<double>(value.real());
    imag = static_cast<double>(value.imag());
  }
  template <typename R>
  static void take(double real, double, R& value) {
    value = static_cast<R>(real);
  }
  template <typename R>
  static void take(double real, double imag, std::complex<R>& value) {
    value = {static_cast<R>(real), static_cast<R>(imag)};
  }
};

/// A kernel: a functor for each accuracy, chosen by the mode of the thread.
template <typename Shape, typename Ha, typename La, typename Ep>
class kernel {
  using T = typename Ha::input_type;
  using U = typename Ha::output_type;

 public:
  static void linear(std::int32_t n, const arguments<Shape, T, U>& args) {
    if (reports_errors()) return strided(n, args, increments<Shape>::units());
    switch (state().mode & LUMEN_ARR_ACCURACY) {
      case LUMEN_ARR_LA: return keep(array_loop<Shape, La>::linear(n, args));
      case LUMEN_ARR_EP: return keep(array_loop<Shape, Ep>::linear(n, args));
      default: return keep(array_loop<Shape, Ha>::linear(n, args));
    }
  }

  static void strided(std::int32_t n, const arguments<Shape, T, U>& args,
                      const increments<Shape>& inc) {
    switch (state().mode & LUMEN_ARR_ACCURACY) {
      case LUMEN_ARR_LA: return strided_of<La>(n, args, inc);
      case LUMEN_ARR_EP: return strided_of<Ep>(n, args, inc);
      default: return strided_of<Ha>(n, args, inc);
    }
  }

 private:
  static bool reports_errors() {
    return (state().mode & LUMEN_ARR_CALLBACK) != 0 && state().callback != nullptr;
  }
  template <typename Functor>
  static void strided_of(std::int32_t n, const arguments<Shape, T, U>& args,
                         const increments<Shape>& inc) {
    using loop = array_loop<Shape, Functor>;
    keep(reports_errors() ? loop::reported(n, args, inc) : loop::strided(n, args, inc));
  }
  static void keep(std::uint32_t status) {
    if (status != 0) state().status |= static_cast<std::int32_t>(status);
  }
};

}  // namespace arbor::lumen::arr

/// The name of a kernel for the class of processors of the compilation, lumen_arr_avx2_sExp.
#define LUMEN_ARR_JOIN_(class_name, kernel_name) lumen_arr_##class_name##_##kernel_name
#define LUMEN_ARR_JOIN(class_name, kernel_name) LUMEN_ARR_JOIN_(class_name, kernel_name)
#define LUMEN_ARR_KERNEL(name) LUMEN_ARR_JOIN(LUMEN_ARR_CLASS, name)
