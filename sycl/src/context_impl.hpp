// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <memory>
#include <vector>

#include "device_impl.hpp"
#include "sycl/exception.hpp"
#include "sycl/property.hpp"

namespace sycl::detail {

class context_impl {
 public:
  context_impl(std::vector<std::shared_ptr<device_impl>> devices, async_handler handler,
               const property_list& properties,
               std::shared_ptr<const context_impl> native = nullptr);
  ~context_impl();

  /// Whether the device, or one that it is part of, belongs to the context.
  bool contains(const device_impl& dev) const noexcept;
  /// Contexts made from one native handle have one identity; allocations belong to it.
  const void* identity() const noexcept { return native_ ? native_->identity() : this; }

  const std::vector<std::shared_ptr<device_impl>> devices;
  const async_handler handler;
  const property_list properties;

 private:
  const std::shared_ptr<const context_impl> native_;
};

/// errc::invalid if there are no devices or if they are of several platforms.
std::shared_ptr<context_impl> make_context_impl(
    std::vector<std::shared_ptr<device_impl>> devices, async_handler handler,
    const property_list& properties, std::shared_ptr<const context_impl> native = nullptr);

/// The context that queues on devices of the platform have if they are not given another.
std::shared_ptr<context_impl> default_context(const platform_impl& platform);

}  // namespace sycl::detail
