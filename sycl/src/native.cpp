// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "sycl/native.hpp"

#include <algorithm>
#include <utility>

#include "context_impl.hpp"
#include "device_impl.hpp"
#include "native_objects.hpp"
#include "queue_impl.hpp"

namespace sycl::detail {

namespace {

void check_backend(backend actual, backend expected) {
  if (actual != expected) {
    throw exception(errc::backend_mismatch, "the object belongs to another backend");
  }
}

[[noreturn]] void bad_handle() {
  throw exception(errc::invalid, "the native handle is that of no object of this kind");
}

const void* address(native_handle handle) noexcept {
  return reinterpret_cast<const void*>(handle);  // NOLINT: that is what a native handle is
}

template <typename SyclObject>
native_handle native_of(const SyclObject& object, backend expected) {
  check_backend(object.get_backend(), expected);
  return reinterpret_cast<native_handle>(handle_access::impl(object).get());
}

}  // namespace

native_handle get_native(const platform& object, backend expected) {
  return native_of(object, expected);
}
native_handle get_native(const device& object, backend expected) {
  return native_of(object, expected);
}
native_handle get_native(const context& object, backend expected) {
  return native_of(object, expected);
}
native_handle get_native(const queue& object, backend expected) {
  return native_of(object, expected);
}

platform make_platform(native_handle handle, backend expected) {
  for (const std::shared_ptr<platform_impl>& candidate : all_platforms()) {
    if (candidate.get() != address(handle)) continue;
    check_backend(candidate->from, expected);
    return handle_access::make<platform>(candidate);
  }
  bad_handle();
}

device make_device(native_handle handle, backend expected) {
  for (const std::shared_ptr<device_impl>& candidate : all_devices()) {
    if (candidate.get() != address(handle)) continue;
    check_backend(candidate->description.from, expected);
    return handle_access::make<device>(candidate);
  }
  bad_handle();
}

context make_context(native_handle handle, const async_handler& handler, backend expected, bool,
                     const std::vector<device>& devices) {
  std::shared_ptr<context_impl> native = native_objects::find_context(address(handle));
  if (native == nullptr) bad_handle();
  check_backend(native->devices.front()->description.from, expected);
  std::vector<std::shared_ptr<device_impl>> chosen;
  for (const device& dev : devices) {
    chosen.push_back(handle_access::impl(dev));
    if (!native->contains(*chosen.back())) {
      throw exception(errc::invalid, "a device does not belong to the native context");
    }
  }
  if (!handler && (chosen.empty() || chosen == native->devices)) {
    return handle_access::make<context>(std::move(native));
  }
  if (chosen.empty()) chosen = native->devices;
  const property_list properties = native->properties;
  return handle_access::make<context>(
      make_context_impl(std::move(chosen), handler, properties, std::move(native)));
}

queue make_queue(native_handle handle, bool, const context& ctx, const device* dev, bool,
                 const property_list& properties, const async_handler& handler, backend expected) {
  std::shared_ptr<queue_impl> native = native_objects::find_queue(address(handle));
  if (native == nullptr) bad_handle();
  check_backend(native->dev->description.from, expected);
  const std::shared_ptr<context_impl>& ctx_impl = handle_access::impl(ctx);
  if (ctx_impl->identity() != native->ctx->identity()) {
    throw exception(errc::invalid, "the context is not that of the native queue");
  }
  if (dev != nullptr && handle_access::impl(*dev) != native->dev) {
    throw exception(errc::invalid, "the device is not that of the native queue");
  }
  const bool profiled = properties.has_property<property::queue::enable_profiling>();
  const bool in_order = properties.has_property<property::queue::in_order>();
  if (in_order && !native->stream->in_order) {
    throw exception(errc::invalid, "the native queue is out-of-order");
  }
  if (!handler && ctx_impl == native->ctx && profiled == native->profiled) {
    return handle_access::make<queue>(std::move(native));
  }
  auto impl =
      std::make_shared<queue_impl>(ctx_impl, native->dev, handler, properties, native->stream);
  native_objects::remember(impl);
  return handle_access::make<queue>(std::move(impl));
}

}  // namespace sycl::detail
