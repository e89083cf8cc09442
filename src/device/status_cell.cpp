// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "device/status_cell.hpp"

#include "arbor/lumen/exception.hpp"
#include "call/queue_store.hpp"

namespace arbor::lumen::vm::detail::device {

status_cell::status_cell(sycl::queue& queue, bool wanted) : queue_(queue) {
  if (!wanted) return;
  word_ = sycl::malloc_device<std::uint32_t>(1, queue);
  if (word_ == nullptr)
    throw invalid_argument("VM", "core::status_cell", "nullptr on device malloc");
  const std::uint32_t zero = 0;
  try {
    queue.memcpy(word_, &zero, sizeof zero).wait_and_throw();
  } catch (...) {
    sycl::free(word_, queue);
    throw;
  }
}

status_cell::~status_cell() {
  if (word_ != nullptr) sycl::free(word_, queue_);
}

void status_cell::collect(sycl::event& kernel) {
  if (word_ == nullptr) return;
  kernel.wait_and_throw();
  std::uint32_t collected = 0;
  queue_.memcpy(&collected, word_, sizeof collected).wait_and_throw();
  queue_store::instance().status_word(queue_key(&queue_)).fetch_or(collected);
  sycl::free(word_, queue_);
  word_ = nullptr;
}

}  // namespace arbor::lumen::vm::detail::device
