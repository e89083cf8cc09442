// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <array>
#include <cstdint>
#include <sycl/sycl.hpp>

#include "call/arguments.hpp"
#include "call/input.hpp"

/// Runs calls on the host, on the calling thread: the work is done when the executor returns, and
/// nothing is submitted to the queue. It serves CPU queues, and GPU queues where no kernel does.
/// Only the accuracy of the mode has an effect here: a host call reports no status.
namespace arbor::lumen::vm::detail::cpu::norvane {

/// Distances between the elements of each operand, in elements.
template <typename Shape>
struct increments {
  std::array<std::int64_t, Shape::inputs> in;
  std::array<std::int64_t, Shape::outputs> out;
};

/// What computes `n` elements, whole arrays or with increments.
template <typename Shape, typename T, typename U>
struct host_entries {
  void (*linear)(std::int64_t n, const arguments<Shape, T, U>&);
  void (*strided)(std::int64_t n, const arguments<Shape, T, U>&, const increments<Shape>&);
};

/// Gets host-visible memory for the operands of a call and runs the entries on it.
/// @returns the default event, complete
/// @throws std::runtime_error if the record is not of this shape and these element types
template <typename Shape, typename T, typename U>
sycl::event execute(const input::vxx& record, const host_entries<Shape, T, U>& entries);

}  // namespace arbor::lumen::vm::detail::cpu::norvane
