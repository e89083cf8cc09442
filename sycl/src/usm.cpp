// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "sycl/usm.hpp"

#include <algorithm>
#include <atomic>
#include <bit>
#include <utility>

#include "processor.hpp"
#include "sycl/detail/testing.hpp"
#include "usm_blocks.hpp"
#include "usm_registry.hpp"

namespace sycl {

namespace {

constexpr std::size_t cache_line = 64;

/// Of each kind, how many allocations are still to fail.
std::atomic<std::size_t> failures[3];

bool fails(usm::alloc kind) noexcept {
  std::atomic<std::size_t>& left = failures[static_cast<int>(kind)];
  std::size_t count = left.load(std::memory_order_relaxed);
  while (count != 0) {
    if (left.compare_exchange_weak(count, count - 1, std::memory_order_relaxed)) return true;
  }
  return false;
}

/// An alignment of 0 leaves the choice to the runtime.
void* allocate(std::size_t alignment, std::size_t bytes, usm::alloc kind,
               std::shared_ptr<detail::device_impl> dev, const context& ctx) {
  const detail::context_impl& owner = *detail::handle_access::impl(ctx);
  if (dev != nullptr && !owner.contains(*dev)) {
    throw exception(errc::invalid, "the device does not belong to the context");
  }
  if (alignment == 0) alignment = cache_line;
  if (bytes == 0 || !std::has_single_bit(alignment) || bytes > detail::physical_memory() ||
      fails(kind)) {
    return nullptr;
  }
  void* const memory = detail::usm_blocks::take(bytes, std::max(alignment, cache_line));
  if (memory == nullptr) return nullptr;
  detail::usm_registry::insert(memory, {bytes, kind, owner.identity(), std::move(dev)});
  return memory;
}

}  // namespace

void* aligned_alloc_device(std::size_t alignment, std::size_t bytes, const device& dev,
                           const context& ctx, const property_list&) {
  return allocate(alignment, bytes, usm::alloc::device, detail::handle_access::impl(dev), ctx);
}
void* aligned_alloc_device(std::size_t alignment, std::size_t bytes, const queue& q,
                           const property_list& properties) {
  return aligned_alloc_device(alignment, bytes, q.get_device(), q.get_context(), properties);
}
void* malloc_device(std::size_t bytes, const device& dev, const context& ctx,
                    const property_list& properties) {
  return aligned_alloc_device(0, bytes, dev, ctx, properties);
}
void* malloc_device(std::size_t bytes, const queue& q, const property_list& properties) {
  return aligned_alloc_device(0, bytes, q, properties);
}

void* aligned_alloc_host(std::size_t alignment, std::size_t bytes, const context& ctx,
                         const property_list&) {
  return allocate(alignment, bytes, usm::alloc::host, nullptr, ctx);
}
void* aligned_alloc_host(std::size_t alignment, std::size_t bytes, const queue& q,
                         const property_list& properties) {
  return aligned_alloc_host(alignment, bytes, q.get_context(), properties);
}
void* malloc_host(std::size_t bytes, const context& ctx, const property_list& properties) {
  return aligned_alloc_host(0, bytes, ctx, properties);
}
void* malloc_host(std::size_t bytes, const queue& q, const property_list& properties) {
  return aligned_alloc_host(0, bytes, q, properties);
}

void* aligned_alloc_shared(std::size_t alignment, std::size_t bytes, const device& dev,
                           const context& ctx, const property_list&) {
  return allocate(alignment, bytes, usm::alloc::shared, detail::handle_access::impl(dev), ctx);
}
void* aligned_alloc_shared(std::size_t alignment, std::size_t bytes, const queue& q,
                           const property_list& properties) {
  return aligned_alloc_shared(alignment, bytes, q.get_device(), q.get_context(), properties);
}
void* malloc_shared(std::size_t bytes, const device& dev, const context& ctx,
                    const property_list& properties) {
  return aligned_alloc_shared(0, bytes, dev, ctx, properties);
}
void* malloc_shared(std::size_t bytes, const queue& q, const property_list& properties) {
  return aligned_alloc_shared(0, bytes, q, properties);
}

void* aligned_alloc(std::size_t alignment, std::size_t bytes, const device& dev, const context& ctx,
                    usm::alloc kind, const property_list& properties) {
  switch (kind) {
    case usm::alloc::host:
      return aligned_alloc_host(alignment, bytes, ctx, properties);
    case usm::alloc::device:
      return aligned_alloc_device(alignment, bytes, dev, ctx, properties);
    case usm::alloc::shared:
      return aligned_alloc_shared(alignment, bytes, dev, ctx, properties);
    case usm::alloc::unknown:
      break;
  }
  return nullptr;
}
void* aligned_alloc(std::size_t alignment, std::size_t bytes, const queue& q, usm::alloc kind,
                    const property_list& properties) {
  return aligned_alloc(alignment, bytes, q.get_device(), q.get_context(), kind, properties);
}
void* malloc(std::size_t bytes, const device& dev, const context& ctx, usm::alloc kind,
             const property_list& properties) {
  return aligned_alloc(0, bytes, dev, ctx, kind, properties);
}
void* malloc(std::size_t bytes, const queue& q, usm::alloc kind, const property_list& properties) {
  return aligned_alloc(0, bytes, q, kind, properties);
}

void free(void* ptr, const context& ctx) {
  if (ptr == nullptr) return;
  const std::size_t bytes =
      detail::usm_registry::erase(ptr, detail::handle_access::impl(ctx)->identity());
  if (bytes == 0) {
    throw exception(errc::invalid, "the pointer is no allocation of the context");
  }
  detail::usm_blocks::give_back(ptr, bytes);
}
void free(void* ptr, const queue& q) { free(ptr, q.get_context()); }

usm::alloc get_pointer_type(const void* ptr, const context& ctx) {
  const auto found = detail::usm_registry::find(ptr);
  if (!found || found->ctx != detail::handle_access::impl(ctx)->identity()) {
    return usm::alloc::unknown;
  }
  return found->kind;
}

device get_pointer_device(const void* ptr, const context& ctx) {
  const auto found = detail::usm_registry::find(ptr);
  if (!found || found->ctx != detail::handle_access::impl(ctx)->identity()) {
    throw exception(errc::invalid, "the pointer is into no allocation of the context");
  }
  if (found->dev == nullptr) return ctx.get_devices().front();
  return detail::handle_access::make<device>(found->dev);
}

namespace detail::testing {
void fail_next_allocations(usm::alloc kind, std::size_t count) noexcept {
  if (kind != usm::alloc::unknown) {
    failures[static_cast<int>(kind)].store(count, std::memory_order_relaxed);
  }
}
}  // namespace detail::testing

}  // namespace sycl
