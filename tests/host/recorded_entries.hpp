// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <functional>
#include <sycl/sycl.hpp>
#include <vector>

#include "host/executor.hpp"

namespace arbor::lumen::tests {

namespace cpu = arbor::lumen::vm::detail::cpu::norvane;

/// Entries that note what an executor calls them with.
template <typename Shape, typename T, typename U = T>
struct recorded_entries {
  struct call {
    bool linear;
    std::int64_t n;
    vm::detail::arguments<Shape, T, U> args;
    vm::detail::increments<Shape> inc;
    std::int64_t mode;
  };
  static inline std::vector<call> calls;
  /// What an entry does besides.
  static inline std::function<void(const call&)> act;

  static void reset() {
    calls.clear();
    act = [](const call&) {};
  }
  static void linear(std::int64_t n, const vm::detail::arguments<Shape, T, U>& args,
                     std::int64_t mode) {
    calls.push_back({true, n, args, {}, mode});
    act(calls.back());
  }
  static void strided(std::int64_t n, const vm::detail::arguments<Shape, T, U>& args,
                      const vm::detail::increments<Shape>& inc, std::int64_t mode) {
    calls.push_back({false, n, args, inc, mode});
    act(calls.back());
  }

  /// Through an executor, with a mode of the array-math layer.
  static sycl::event execute(const vm::detail::input::vxx& record, std::int64_t mode = 2) {
    return cpu::execute<Shape, T, U>(record, {&linear, &strided}, {.mode = mode});
  }
  /// The counts of the calls so far.
  static std::vector<std::int64_t> counts() {
    std::vector<std::int64_t> all;
    for (const call& each : calls) all.push_back(each.n);
    return all;
  }
};

}  // namespace arbor::lumen::tests
