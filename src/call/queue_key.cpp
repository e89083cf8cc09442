// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "call/queue_key.hpp"

#include <cstring>
#include <functional>

namespace arbor::lumen::vm::detail {
namespace {

/// What a SYCL handle is a handle of: its first machine word, the implementation pointer.
template <typename Handle>
std::uint64_t identity(const Handle& handle) {
  static_assert(sizeof(Handle) >= sizeof(std::uint64_t));
  std::uint64_t word;
  std::memcpy(&word, static_cast<const void*>(&handle), sizeof word);
  return word;
}

std::uint64_t key_of(const sycl::queue& queue, const sycl::device& device) {
  const sycl::context context = queue.get_context();
  return 0x428a2f98d728ae22 * static_cast<std::uint64_t>(std::hash<sycl::queue>{}(queue)) ^
         0x2427114e873b90dd * fnv(identity(context)) ^ 0x504f4fa00fc9fb57 * fnv(identity(device));
}

}  // namespace

std::uint64_t queue_key(const sycl::queue* queue) {
  return queue == nullptr ? 0 : key_of(*queue, queue->get_device());
}

keyed_queue::keyed_queue(sycl::queue* queue) : queue_(queue) {
  if (queue == nullptr) return;
  device_ = queue->get_device();
  key_ = key_of(*queue, *device_);
}

}  // namespace arbor::lumen::vm::detail
