// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <cstdint>
#include <sycl/sycl.hpp>
#include <vector>

#include "arbor/lumen/vm/queue_state.hpp"
#include "call/input.hpp"
#include "choice.hpp"
#include "dispatch/dispatch_call.hpp"
#include "element_types.hpp"

namespace arbor::lumen::vm::tool {

/// The operands of a call, array by array.
template <typename T, typename U>
struct block {
  std::vector<std::vector<T>> inputs;
  std::vector<T> constants;
  std::vector<std::vector<U>> outputs;
  std::vector<enums::status> statuses;  ///< of each element, where the call reports one

  std::size_t size() const { return inputs.front().size(); }
};

/// Runs a call on a block, its argument record made as an exported overload for pointers makes it.
/// Outputs and statuses get the size of the inputs.
/// @throws std::runtime_error if nothing served the call
template <typename T, typename U>
void evaluate(const chosen_call& call, sycl::queue& queue, block<T, U>& operands) {
  const std::size_t n = operands.size();
  operands.statuses.assign(n, enums::success);
  with_shape(call.family.shape, [&]<typename Shape>() {
    detail::input::usm::linear<Shape, T, U> record;
    record.name = call.family.name;
    record.queue = &queue;
    record.n = static_cast<std::int64_t>(n);
    record.mode = call.mode;
    if (call.family.handler)
      record.handler =
          detail::error_handler<U>(operands.statuses.data(), static_cast<std::int64_t>(n));
    for (const auto& input : operands.inputs) record.in_pointers.push_back(input.data());
    record.constants = operands.constants;
    for (auto& output : operands.outputs) {
      output.resize(n);
      record.out_pointers.push_back(output.data());
    }
    clear_status(queue);
    detail::dispatch_call(record, call.family.table()).wait();
    queue.wait_and_throw();
  });
  if ((get_status(queue) & enums::bad_argument) != 0)
    throw std::runtime_error(std::string(call.family.name) + ": the call was declined");
}

}  // namespace arbor::lumen::vm::tool
