// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "sycl/handler.hpp"

#include <string>
#include <utility>

#include "buffer_storage.hpp"
#include "command.hpp"
#include "memory_kernels.hpp"
#include "native_objects.hpp"
#include "queue_impl.hpp"
#include "usm_registry.hpp"

namespace sycl {

namespace {

/// Bytes that one thread gets through in some microseconds.
constexpr std::size_t first_bytes = 128 * 1024;

}  // namespace

handler::handler(const std::shared_ptr<detail::queue_impl>& owner)
    : command_(std::make_shared<detail::command>()), owner_(owner) {
  command_->from = owner->dev->description.from;
}

handler::~handler() = default;

void handler::depends_on(const event& dependency) {
  command_->add_dependency(detail::handle_access::impl(dependency));
}

void handler::depends_on(const std::vector<event>& dependencies) {
  for (const event& dependency : dependencies) depends_on(dependency);
}

void handler::begin_action() {
  if (has_action_) {
    throw exception(errc::runtime,
                    "Attempt to set multiple actions for the command group. Command group must "
                    "consist of a single kernel or explicit memory operation.");
  }
  has_action_ = true;
}

void handler::check_aspect(aspect needed) const {
  if (!owner_->dev->has(needed)) {
    throw exception(errc::kernel_not_supported,
                    "the kernel needs an aspect that the device lacks: " +
                        std::to_string(static_cast<int>(needed)));
  }
}

void handler::check_memory(const void* ptr, std::size_t bytes) const {
  if (bytes == 0) return;
  if (ptr == nullptr) throw exception(errc::invalid, "null pointer given to a memory operation");
  detail::check_device_access(ptr, *owner_->ctx, *owner_->dev);
}

void* handler::reserve(std::size_t size, std::size_t alignment) {
  return command_->reserve_closure(size, alignment);
}

void handler::commit(void (*destroy)(void*) noexcept) noexcept { command_->destroy = destroy; }

void handler::set_kernel(detail::kernel_function function, int dimensions,
                         const std::size_t* shape) noexcept {
  detail::command& c = *command_;
  c.what = detail::action::kernel;
  c.function = function;
  for (int d = 0; d < dimensions; ++d) {
    c.extents[d] = shape[d];
    c.total *= shape[d];
  }
  // Few work-items may be long ones, each worth a thread.
  c.grain = c.total < 1024 ? 1 : 16;
}

void handler::set_host_task(void (*function)(void* closure, const interop_handle& ih)) noexcept {
  command_->what = detail::action::host_task;
  command_->host_function = function;
}

void handler::set_nothing() { command_->what = detail::action::nothing; }

void handler::memcpy(void* dest, const void* src, std::size_t bytes) {
  check_memory(dest, bytes);
  check_memory(src, bytes);
  begin_action();
  ::new (reserve(sizeof(detail::copy_closure), alignof(detail::copy_closure))) detail::copy_closure{
      static_cast<unsigned char*>(dest), static_cast<const unsigned char*>(src)};
  set_kernel(detail::copy_kernel(bytes), 1, &bytes);
  command_->grain = first_bytes;
}

void handler::memset(void* ptr, int value, std::size_t bytes) {
  check_memory(ptr, bytes);
  begin_action();
  ::new (reserve(sizeof(detail::set_closure), alignof(detail::set_closure)))
      detail::set_closure{static_cast<unsigned char*>(ptr), value};
  set_kernel(detail::set_kernel(), 1, &bytes);
  command_->grain = first_bytes;
}

void handler::prefetch(void* ptr, std::size_t bytes) {
  check_memory(ptr, bytes);
  begin_action();
  set_nothing();
}

void handler::mem_advise(void* ptr, std::size_t bytes, int) { prefetch(ptr, bytes); }

event handler::submit() {
  owner_->submit(command_);
  return detail::handle_access::make<event>(std::move(command_));
}

namespace detail {

void require_region(handler& cgh, const region& bytes, access_mode mode) {
  if (bytes.storage == nullptr) {
    throw exception(errc::invalid, "the accessor belongs to no buffer");
  }
  // The storage starts on the boundary; a sub-buffer may not.
  if (bytes.begin % (mem_base_addr_align_bits / 8) != 0) {
    throw exception(errc::invalid, "the sub-buffer starts " + std::to_string(bytes.begin) +
                                       " bytes into its buffer, no multiple of the device's " +
                                       std::to_string(mem_base_addr_align_bits / 8) +
                                       " (info::device::mem_base_addr_align)");
  }
  buffer_storage& storage = *bytes.storage;
  if (storage.properties().has_property<property::buffer::context_bound>()) {
    const context bound =
        storage.properties().get_property<property::buffer::context_bound>().get_context();
    if (handle_access::impl(bound)->identity() != cgh.owner_->ctx->identity()) {
      throw exception(errc::invalid, "the buffer is bound to another context");
    }
  }
  const bool write = mode != access_mode::read;
  storage.note_access(write);
  cgh.command_->add_access(storage.self(), bytes.begin, bytes.end, write);
}

}  // namespace detail

}  // namespace sycl
