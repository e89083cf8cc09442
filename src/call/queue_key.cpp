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

}  // namespace

std::uint64_t queue_key(const sycl::queue* queue) {
  if (queue == nullptr) return 0;
  const sycl::context context = queue->get_context();
  const sycl::device device = queue->get_device();
  return 0x428a2f98d728ae22 * static_cast<std::uint64_t>(std::hash<sycl::queue>{}(*queue)) ^
         0x2427114e873b90dd * fnv(identity(context)) ^ 0x504f4fa00fc9fb57 * fnv(identity(device));
}

}  // namespace arbor::lumen::vm::detail
