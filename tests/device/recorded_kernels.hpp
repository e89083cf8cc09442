// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <sycl/sycl.hpp>

#include "device/launch.hpp"

namespace arbor::lumen::tests {

namespace norvane = arbor::lumen::vm::detail::gpu::norvane;
namespace enums = arbor::lumen::vm::enums;

/// Submissions that submit nothing and note what a launcher hands them.
template <typename Shape, typename T, typename U = T>
struct recorded_kernels {
  static inline std::string path;
  static inline vm::detail::arguments<Shape, T, U> args;
  static inline std::int64_t count;
  static inline std::size_t depends;
  static inline enums::status* storage;
  static inline norvane::strided_context<Shape, U> context;
  /// What the submission does in place of its kernel.
  static inline std::function<sycl::event()> act;

  static void reset() {
    path = "none";
    args = {};
    count = -1;
    depends = 0;
    storage = nullptr;
    context = {};
    act = [] { return sycl::event(); };
  }

  static sycl::event linear(sycl::queue&, const norvane::events& events,
                            const vm::detail::arguments<Shape, T, U>& given, std::int64_t n) {
    path = "fast";
    args = given;
    count = n;
    depends = events.size();
    return act();
  }
  static sycl::event strided(sycl::queue&, const norvane::events& events,
                             const vm::detail::arguments<Shape, T, U>& given,
                             enums::status* status_storage,
                             const norvane::strided_context<Shape, U>& given_context) {
    path = "strided";
    args = given;
    storage = status_storage;
    context = given_context;
    count = given_context.stride.count;
    depends = events.size();
    return act();
  }
  static sycl::event buffer(sycl::queue&, const norvane::buffer_call<Shape, T, U>& call) {
    path = "buffer";
    args.constants = call.constants;
    context = call.context;
    count = call.context.stride.count;
    return act();
  }

  static constexpr norvane::kernel_set<Shape, T, U> kernels{&linear, &strided, &buffer};

  static sycl::event launch(const vm::detail::input::vxx& record) {
    return norvane::launch<Shape, T, U>(record, kernels);
  }
};

}  // namespace arbor::lumen::tests
