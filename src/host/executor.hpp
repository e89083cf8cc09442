// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <sycl/sycl.hpp>

#include "call/input.hpp"
#include "host/classic_input.hpp"

/// Runs calls on the host, on the calling thread: the work is done when the executor returns, and
/// nothing is submitted to the queue. It serves CPU queues, and GPU queues where no kernel does.
/// Only the accuracy of the mode has an effect here: a host call reports no status.
namespace arbor::lumen::vm::detail::cpu::norvane {

using classic::input::host_entries;

/// What errors a function can report, and of how many results.
enum class error_kind { none, one_result, two_results };

/// What the entries are called with besides the operands.
struct call_kind {
  std::int64_t mode;  ///< of the array-math layer: 1 la, 2 ha, 3 ep, 0 for entries without tiers
  error_kind errors = error_kind::none;
};

/// Gets host-visible memory for the operands of a call and runs the entries on it.
/// @returns the default event, complete
/// @throws std::runtime_error if the record is not of this shape and these element types
template <typename Shape, typename T, typename U>
sycl::event execute(const input::vxx& record, const host_entries<Shape, T, U>& entries,
                    call_kind kind);

}  // namespace arbor::lumen::vm::detail::cpu::norvane
