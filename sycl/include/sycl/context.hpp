// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <memory>
#include <utility>
#include <vector>

#include "backend.hpp"
#include "detail/export.hpp"
#include "detail/handle.hpp"
#include "device.hpp"
#include "exception.hpp"
#include "info.hpp"
#include "platform.hpp"
#include "property.hpp"

namespace sycl {

/// A set of devices of one platform that share their allocations.
class ARBOR_LUMEN_SYCL_API context {
 public:
  explicit context(const property_list& properties = {});
  explicit context(async_handler handler, const property_list& properties = {});
  explicit context(const device& dev, const property_list& properties = {});
  explicit context(const device& dev, async_handler handler, const property_list& properties = {});
  explicit context(const std::vector<device>& devices, const property_list& properties = {});
  explicit context(const std::vector<device>& devices, async_handler handler,
                   const property_list& properties = {});

  backend get_backend() const noexcept;
  platform get_platform() const;
  std::vector<device> get_devices() const;
  template <typename Param>
  typename Param::return_type get_info() const;

  template <typename Property>
  bool has_property() const noexcept {
    return properties().has_property<Property>();
  }
  template <typename Property>
  Property get_property() const {
    return properties().get_property<Property>();
  }

  friend bool operator==(const context& a, const context& b) noexcept { return a.impl_ == b.impl_; }

 private:
  friend struct detail::handle_access;
  explicit context(std::shared_ptr<detail::context_impl> impl) noexcept : impl_(std::move(impl)) {}

  const property_list& properties() const noexcept;

  std::shared_ptr<detail::context_impl> impl_;
};

}  // namespace sycl

template <>
struct std::hash<sycl::context> : sycl::detail::handle_hash<sycl::context> {};
