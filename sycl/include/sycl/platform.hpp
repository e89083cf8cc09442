// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <memory>
#include <type_traits>
#include <utility>
#include <vector>

#include "aspect.hpp"
#include "backend.hpp"
#include "detail/export.hpp"
#include "detail/handle.hpp"
#include "device.hpp"
#include "info.hpp"

namespace sycl {

/// The devices of one backend and vendor.
class ARBOR_LUMEN_SYCL_API platform {
 public:
  /// The platform of the device that default_selector_v selects.
  platform();
  template <detail::device_selector Selector>
  requires(!std::is_base_of_v<platform, Selector>) explicit platform(const Selector& selector)
      : platform(device(selector).get_platform()) {}

  backend get_backend() const noexcept;
  std::vector<device> get_devices(info::device_type type = info::device_type::all) const;
  template <typename Param>
  typename Param::return_type get_info() const;
  /// Whether all devices of the platform have the aspect.
  bool has(aspect asp) const;

  static std::vector<platform> get_platforms();

  friend bool operator==(const platform& a, const platform& b) noexcept {
    return a.impl_ == b.impl_;
  }

 private:
  friend struct detail::handle_access;
  explicit platform(std::shared_ptr<detail::platform_impl> impl) noexcept
      : impl_(std::move(impl)) {}

  std::shared_ptr<detail::platform_impl> impl_;
};

}  // namespace sycl

template <>
struct std::hash<sycl::platform> : sycl::detail::handle_hash<sycl::platform> {};
