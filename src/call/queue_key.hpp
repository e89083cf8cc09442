// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <optional>
#include <sycl/sycl.hpp>

namespace arbor::lumen::vm::detail {

/// 64-bit FNV-1a of the eight bytes of `value`, lowest byte first.
constexpr std::uint64_t fnv(std::uint64_t value) {
  std::uint64_t hash = 0xcbf29ce484222325;
  for (int byte = 0; byte < 8; ++byte) {
    hash ^= (value >> (8 * byte)) & 0xff;
    hash *= 0x100000001b3;
  }
  return hash;
}

/// By what the store of queues knows a queue: its hash, its context and its device. Queues that
/// agree in all three share one entry, also one after the other. A null queue has key 0.
std::uint64_t queue_key(const sycl::queue* queue);

/// A caller's queue with its device and its key, which are worked out once.
class keyed_queue {
 public:
  keyed_queue() = default;
  keyed_queue(sycl::queue* queue);

  operator sycl::queue*() const { return queue_; }
  std::uint64_t key() const { return key_; }
  /// The device of a queue that is not null.
  const sycl::device& device() const { return *device_; }

 private:
  sycl::queue* queue_ = nullptr;
  std::uint64_t key_ = 0;
  std::optional<sycl::device> device_;
};

}  // namespace arbor::lumen::vm::detail
