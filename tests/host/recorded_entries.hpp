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
    cpu::increments<Shape> inc;
  };
  static inline std::vector<call> calls;
  /// What an entry does besides.
  static inline std::function<void(const call&)> act;

  static void reset() {
    calls.clear();
    act = [](const call&) {};
  }
  static void linear(std::int64_t n, const vm::detail::arguments<Shape, T, U>& args) {
    calls.push_back({true, n, args, {}});
    act(calls.back());
  }
  static void strided(std::int64_t n, const vm::detail::arguments<Shape, T, U>& args,
                      const cpu::increments<Shape>& inc) {
    calls.push_back({false, n, args, inc});
    act(calls.back());
  }

  static sycl::event execute(const vm::detail::input::vxx& record) {
    return cpu::execute<Shape, T, U>(record, {&linear, &strided});
  }
  /// The counts of the calls so far.
  static std::vector<std::int64_t> counts() {
    std::vector<std::int64_t> all;
    for (const call& each : calls) all.push_back(each.n);
    return all;
  }
};

}  // namespace arbor::lumen::tests
