// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "unserved.hpp"

#include <memory>

#include "arbor/lumen/exception.hpp"
#include "arbor/lumen/vm/queue_state.hpp"
#include "call/input.hpp"
#include "dispatch/dispatch_call.hpp"
#include "element_types.hpp"
#include "words.hpp"

namespace arbor::lumen::vm::tool {
namespace {

std::unique_ptr<detail::input::vxx> empty_record(const chosen_call& call, sycl::queue& queue) {
  auto record = with_types(call.in, call.out,
                           []<typename T, typename U>() -> std::unique_ptr<detail::input::vxx> {
                             return std::make_unique<detail::input::typed_vxx<T, U>>();
                           });
  record->name = call.family.name;
  record->queue = &queue;
  record->mode = call.mode;
  return record;
}

}  // namespace

std::string end_of_unserved(const chosen_call& call, sycl::queue& queue) {
  const auto record = empty_record(call, queue);
  clear_status(queue);
  try {
    detail::dispatch_call(*record, call.family.table());
  } catch (const unimplemented& error) {
    return error.what();
  }
  const std::uint32_t status = get_status(queue);
  return "the call does nothing: no output is written, and the queue's status becomes " +
         std::to_string(status) + " (" + status_words(status) + ")";
}

}  // namespace arbor::lumen::vm::tool
