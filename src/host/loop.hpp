// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <cstdint>
#include <utility>

#include "device/tuning_info.hpp"
#include "host/executor.hpp"

/// Host entries made of a scalar functor: plain element loops. They serve the internal utilities.
namespace arbor::lumen::vm::detail::cpu::norvane {

template <typename Shape, typename Functor>
struct loop {
  using T = typename Functor::input_type;
  using U = typename Functor::output_type;

  static void linear(std::int64_t n, const arguments<Shape, T, U>& args, std::int64_t) {
    run(n, args, increments<Shape>::units(), input_indices<Shape>{}, output_indices<Shape>{});
  }
  static void strided(std::int64_t n, const arguments<Shape, T, U>& args,
                      const increments<Shape>& inc, std::int64_t) {
    run(n, args, inc, input_indices<Shape>{}, output_indices<Shape>{});
  }

 private:
  template <std::size_t... I, std::size_t... O>
  static inline void run(std::int64_t n, const arguments<Shape, T, U> args,
                         const increments<Shape> inc, std::index_sequence<I...>,
                         std::index_sequence<O...>) {
    for (std::int64_t i = 0; i < n; ++i) {
      call_functor<Shape, Functor, T, U>({&args.in[I][i * inc.in[I]]...}, args.constants.data(),
                                         static_cast<std::size_t>(i),
                                         {&args.out[O][i * inc.out[O]]...});
    }
  }
};

/// The launcher of a host row, as family tables hold it.
template <typename Shape, typename Functor>
sycl::event loop_launcher(const input::vxx& record, TuningInfo) {
  using entry = loop<Shape, Functor>;
  return execute<Shape, typename entry::T, typename entry::U>(
      record, {&entry::linear, &entry::strided}, {.mode = 0});
}

}  // namespace arbor::lumen::vm::detail::cpu::norvane
