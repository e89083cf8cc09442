// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "usm_registry.hpp"

#include <atomic>
#include <cstdint>
#include <map>
#include <mutex>
#include <shared_mutex>
#include <utility>

namespace sycl::detail {

namespace usm_registry {

namespace {

struct registry {
  std::shared_mutex mutex;
  std::map<std::uintptr_t, usm_record> records;
  /// Spares the look-up where there are no allocations.
  std::atomic<std::size_t> count{0};
};

/// Never destroyed: static objects may free memory.
registry& allocations() {
  static registry& instance = *new registry;
  return instance;
}

std::uintptr_t address(const void* ptr) noexcept { return reinterpret_cast<std::uintptr_t>(ptr); }

}  // namespace

void insert(const void* base, usm_record record) {
  registry& all = allocations();
  const std::unique_lock lock(all.mutex);
  all.records.insert_or_assign(address(base), std::move(record));
  all.count.store(all.records.size(), std::memory_order_relaxed);
}

std::size_t erase(const void* base, const void* ctx) {
  registry& all = allocations();
  const std::unique_lock lock(all.mutex);
  const auto found = all.records.find(address(base));
  if (found == all.records.end() || found->second.ctx != ctx) return 0;
  const std::size_t bytes = found->second.bytes;
  all.records.erase(found);
  all.count.store(all.records.size(), std::memory_order_relaxed);
  return bytes;
}

std::optional<usm_record> find(const void* ptr) {
  registry& all = allocations();
  if (all.count.load(std::memory_order_relaxed) == 0) return std::nullopt;
  const std::shared_lock lock(all.mutex);
  auto next = all.records.upper_bound(address(ptr));
  if (next == all.records.begin()) return std::nullopt;
  --next;
  if (address(ptr) - next->first >= next->second.bytes) return std::nullopt;
  return next->second;
}

}  // namespace usm_registry

void check_device_access(const void* ptr, const context_impl& ctx, const device_impl& dev) {
  const std::optional<usm_record> found = usm_registry::find(ptr);
  if (!found || found->kind != usm::alloc::device) return;
  if (found->ctx != ctx.identity() || &found->dev->root() != &dev.root()) {
    throw exception(errc::invalid, "the device has no access to this device memory");
  }
}

}  // namespace sycl::detail
