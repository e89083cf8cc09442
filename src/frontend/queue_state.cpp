// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "arbor/lumen/vm/queue_state.hpp"

#include "call/mode_word.hpp"
#include "call/queue_store.hpp"
#include "frontend/call.hpp"

namespace arbor::lumen::vm {

namespace {

std::uint32_t mode_in_force(std::uint64_t key) {
  return detail::mode_word::in_force(detail::queue_store::instance().stored_mode(key));
}

}  // namespace

enums::mode get_mode(sycl::queue& queue) {
  return static_cast<enums::mode>(mode_in_force(detail::queue_key(&queue)));
}

enums::mode set_mode(sycl::queue& queue, enums::mode mode) {
  return static_cast<enums::mode>(
      detail::queue_store::instance().merge_mode(detail::queue_key(&queue), mode));
}

enums::status get_status(sycl::queue& queue) {
  return static_cast<enums::status>(
      detail::queue_store::instance().status_word(detail::queue_key(&queue)).load());
}

enums::status set_status(sycl::queue& queue, enums::status status) {
  return static_cast<enums::status>(
      detail::queue_store::instance().status_word(detail::queue_key(&queue)).exchange(status));
}

enums::status clear_status(sycl::queue& queue) { return set_status(queue, enums::success); }

namespace detail {

std::uint32_t effective_mode(const keyed_queue& queue, enums::mode mode) {
  return mode_word::merge(mode_in_force(queue.key()), mode);
}

}  // namespace detail
}  // namespace arbor::lumen::vm
