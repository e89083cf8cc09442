// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "sycl/queue.hpp"

#include <utility>

#include "native_objects.hpp"
#include "queue_impl.hpp"

namespace sycl {

namespace {

std::shared_ptr<detail::queue_impl> make_impl(std::shared_ptr<detail::context_impl> ctx,
                                              std::shared_ptr<detail::device_impl> dev,
                                              const async_handler& handler,
                                              const property_list& properties) {
  if (ctx == nullptr) ctx = detail::default_context(*dev->platform);
  if (!ctx->contains(*dev)) {
    throw exception(errc::invalid, "the queue's device does not belong to its context");
  }
  auto impl =
      std::make_shared<detail::queue_impl>(std::move(ctx), std::move(dev), handler, properties);
  detail::native_objects::remember(impl);
  return impl;
}

template <typename Dependencies, typename Action>
event submit_with(queue& q, const Dependencies& dependencies, const Action& act) {
  return q.submit([&](handler& cgh) {
    cgh.depends_on(dependencies);
    act(cgh);
  });
}

}  // namespace

queue::queue(const property_list& properties) : queue(device(), properties) {}
queue::queue(const async_handler& handler, const property_list& properties)
    : queue(device(), handler, properties) {}
queue::queue(const device& dev, const property_list& properties)
    : queue(dev, async_handler(), properties) {}
queue::queue(const device& dev, const async_handler& handler, const property_list& properties)
    : impl_(make_impl(nullptr, detail::handle_access::impl(dev), handler, properties)) {}
queue::queue(const context& ctx, const device& dev, const property_list& properties)
    : queue(ctx, dev, async_handler(), properties) {}
queue::queue(const context& ctx, const device& dev, const async_handler& handler,
             const property_list& properties)
    : impl_(make_impl(detail::handle_access::impl(ctx), detail::handle_access::impl(dev), handler,
                      properties)) {}

backend queue::get_backend() const noexcept { return impl_->dev->description.from; }
context queue::get_context() const { return detail::handle_access::make<context>(impl_->ctx); }
device queue::get_device() const { return detail::handle_access::make<device>(impl_->dev); }
bool queue::is_in_order() const { return impl_->stream->in_order; }
const property_list& queue::properties() const noexcept { return impl_->properties; }

template <>
ARBOR_LUMEN_SYCL_API context queue::get_info<info::queue::context>() const {
  return get_context();
}
template <>
ARBOR_LUMEN_SYCL_API device queue::get_info<info::queue::device>() const {
  return get_device();
}

void queue::wait() { impl_->stream->wait(); }
void queue::throw_asynchronous() { impl_->report_errors(); }
void queue::wait_and_throw() {
  wait();
  throw_asynchronous();
}

event queue::memcpy(void* dest, const void* src, std::size_t bytes) {
  return submit([&](handler& cgh) { cgh.memcpy(dest, src, bytes); });
}
event queue::memcpy(void* dest, const void* src, std::size_t bytes, const event& dependency) {
  return submit_with(*this, dependency, [&](handler& cgh) { cgh.memcpy(dest, src, bytes); });
}
event queue::memcpy(void* dest, const void* src, std::size_t bytes,
                    const std::vector<event>& dependencies) {
  return submit_with(*this, dependencies, [&](handler& cgh) { cgh.memcpy(dest, src, bytes); });
}
event queue::memset(void* ptr, int value, std::size_t bytes) {
  return submit([&](handler& cgh) { cgh.memset(ptr, value, bytes); });
}
event queue::memset(void* ptr, int value, std::size_t bytes, const event& dependency) {
  return submit_with(*this, dependency, [&](handler& cgh) { cgh.memset(ptr, value, bytes); });
}
event queue::memset(void* ptr, int value, std::size_t bytes,
                    const std::vector<event>& dependencies) {
  return submit_with(*this, dependencies, [&](handler& cgh) { cgh.memset(ptr, value, bytes); });
}
event queue::prefetch(void* ptr, std::size_t bytes) {
  return submit([&](handler& cgh) { cgh.prefetch(ptr, bytes); });
}
event queue::prefetch(void* ptr, std::size_t bytes, const event& dependency) {
  return submit_with(*this, dependency, [&](handler& cgh) { cgh.prefetch(ptr, bytes); });
}
event queue::prefetch(void* ptr, std::size_t bytes, const std::vector<event>& dependencies) {
  return submit_with(*this, dependencies, [&](handler& cgh) { cgh.prefetch(ptr, bytes); });
}
event queue::mem_advise(void* ptr, std::size_t bytes, int advice) {
  return submit([&](handler& cgh) { cgh.mem_advise(ptr, bytes, advice); });
}
event queue::mem_advise(void* ptr, std::size_t bytes, int advice, const event& dependency) {
  return submit_with(*this, dependency, [&](handler& cgh) { cgh.mem_advise(ptr, bytes, advice); });
}
event queue::mem_advise(void* ptr, std::size_t bytes, int advice,
                        const std::vector<event>& dependencies) {
  return submit_with(*this, dependencies,
                     [&](handler& cgh) { cgh.mem_advise(ptr, bytes, advice); });
}

}  // namespace sycl
