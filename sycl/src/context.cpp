// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "sycl/context.hpp"

#include <algorithm>
#include <mutex>
#include <utility>

#include "context_impl.hpp"
#include "native_objects.hpp"

namespace sycl {

namespace detail {

context_impl::context_impl(std::vector<std::shared_ptr<device_impl>> members,
                           async_handler errors_to, const property_list& context_properties,
                           std::shared_ptr<const context_impl> native)
    : devices(std::move(members)),
      handler(std::move(errors_to)),
      properties(context_properties),
      native_(std::move(native)) {}

context_impl::~context_impl() { native_objects::forget(this); }

bool context_impl::contains(const device_impl& dev) const noexcept {
  return std::any_of(devices.begin(), devices.end(),
                     [&](const auto& member) { return dev.is_part_of(*member); });
}

std::shared_ptr<context_impl> make_context_impl(std::vector<std::shared_ptr<device_impl>> devices,
                                                async_handler handler,
                                                const property_list& properties,
                                                std::shared_ptr<const context_impl> native) {
  if (devices.empty()) throw exception(errc::invalid, "a context needs a device");
  for (const std::shared_ptr<device_impl>& each : devices) {
    if (each->platform != devices.front()->platform) {
      throw exception(errc::invalid, "the devices of a context must be of one platform");
    }
  }
  auto impl = std::make_shared<context_impl>(std::move(devices), std::move(handler), properties,
                                             std::move(native));
  native_objects::remember(impl);
  return impl;
}

std::shared_ptr<context_impl> default_context(const platform_impl& platform) {
  const std::lock_guard lock(platform.default_context_mutex);
  if (platform.default_context == nullptr) {
    // It lives as long as the process, like the platform, so its handles count nothing.
    platform.default_context = {std::shared_ptr<void>(),
                                new context_impl(platform.devices, {}, {})};
  }
  return platform.default_context;
}

}  // namespace detail

namespace {

std::shared_ptr<detail::context_impl> make_impl(const std::vector<device>& devices,
                                                async_handler handler,
                                                const property_list& properties) {
  std::vector<std::shared_ptr<detail::device_impl>> members;
  members.reserve(devices.size());
  for (const device& each : devices) members.push_back(detail::handle_access::impl(each));
  return detail::make_context_impl(std::move(members), std::move(handler), properties);
}

}  // namespace

context::context(const property_list& properties) : context(device(), properties) {}
context::context(async_handler handler, const property_list& properties)
    : context(device(), std::move(handler), properties) {}
context::context(const device& dev, const property_list& properties)
    : context(dev, async_handler(), properties) {}
context::context(const device& dev, async_handler handler, const property_list& properties)
    : context(std::vector<device>{dev}, std::move(handler), properties) {}
context::context(const std::vector<device>& devices, const property_list& properties)
    : context(devices, async_handler(), properties) {}
context::context(const std::vector<device>& devices, async_handler handler,
                 const property_list& properties)
    : impl_(make_impl(devices, std::move(handler), properties)) {}

backend context::get_backend() const noexcept { return impl_->devices.front()->description.from; }
platform context::get_platform() const {
  return detail::handle_access::make<platform>(
      detail::find_platform(impl_->devices.front()->platform));
}
std::vector<device> context::get_devices() const {
  std::vector<device> result;
  for (const std::shared_ptr<detail::device_impl>& each : impl_->devices) {
    result.push_back(detail::handle_access::make<device>(each));
  }
  return result;
}
const property_list& context::properties() const noexcept { return impl_->properties; }

#define SYCL_DETAIL_CONTEXT(name, value)                                                         \
  template <>                                                                                    \
  ARBOR_LUMEN_SYCL_API info::context::name::return_type context::get_info<info::context::name>() \
      const {                                                                                    \
    return value;                                                                                \
  }
SYCL_DETAIL_CONTEXT(platform, get_platform())
SYCL_DETAIL_CONTEXT(devices, get_devices())
SYCL_DETAIL_CONTEXT(
    atomic_memory_order_capabilities,
    get_devices().front().get_info<info::device::atomic_memory_order_capabilities>())
SYCL_DETAIL_CONTEXT(atomic_fence_order_capabilities,
                    get_devices().front().get_info<info::device::atomic_fence_order_capabilities>())
SYCL_DETAIL_CONTEXT(
    atomic_memory_scope_capabilities,
    get_devices().front().get_info<info::device::atomic_memory_scope_capabilities>())
SYCL_DETAIL_CONTEXT(atomic_fence_scope_capabilities,
                    get_devices().front().get_info<info::device::atomic_fence_scope_capabilities>())
#undef SYCL_DETAIL_CONTEXT

}  // namespace sycl
