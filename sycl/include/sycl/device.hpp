// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <concepts>
#include <memory>
#include <string>
#include <type_traits>
#include <utility>
#include <vector>

#include "aspect.hpp"
#include "backend.hpp"
#include "detail/export.hpp"
#include "detail/handle.hpp"
#include "exception.hpp"
#include "info.hpp"

namespace sycl {

class platform;
class device;

namespace detail {

/// A device selector, called through one pointer.
struct selector_ref {
  const void* object;
  int (*score)(const void* object, const device& candidate);
};

template <typename T>
concept device_selector = requires(const T& selector, const device& candidate) {
  { selector(candidate) } -> std::convertible_to<int>;
};

template <typename Selector>
selector_ref make_selector_ref(const Selector& selector) noexcept {
  if constexpr (std::is_function_v<Selector>) {
    return {reinterpret_cast<const void*>(&selector), [](const void* object, const device& d) {
              return static_cast<int>(reinterpret_cast<Selector*>(const_cast<void*>(object))(d));
            }};
  } else {
    return {std::addressof(selector), [](const void* object, const device& d) {
              return static_cast<int>((*static_cast<const Selector*>(object))(d));
            }};
  }
}

/// The device with the greatest score; errc::runtime if no score is at least 0.
ARBOR_LUMEN_SYCL_API device select_device(selector_ref selector);

}  // namespace detail

/// Where kernels run: the processor, or one of its simulated companions, or a part of either.
class ARBOR_LUMEN_SYCL_API device {
 public:
  /// The device that default_selector_v selects.
  device();
  template <detail::device_selector Selector>
  requires(!std::is_base_of_v<device, Selector>) explicit device(const Selector& selector)
      : device(detail::select_device(detail::make_selector_ref(selector))) {}

  backend get_backend() const noexcept;
  bool is_cpu() const;
  bool is_gpu() const;
  bool is_accelerator() const;
  platform get_platform() const;
  bool has(aspect asp) const;

  template <typename Param>
  typename Param::return_type get_info() const;

  template <info::partition_property Property>
  requires(Property == info::partition_property::partition_equally)
      std::vector<device> create_sub_devices(std::size_t count)
  const { return partition_equally(count); }
  template <info::partition_property Property>
  requires(Property == info::partition_property::partition_by_counts)
      std::vector<device> create_sub_devices(const std::vector<std::size_t>& counts)
  const { return partition_by_counts(counts); }
  template <info::partition_property Property>
  requires(Property == info::partition_property::partition_by_affinity_domain)
      std::vector<device> create_sub_devices(info::partition_affinity_domain domain)
  const { return partition_by_affinity_domain(domain); }

  static std::vector<device> get_devices(info::device_type type = info::device_type::all);

  friend bool operator==(const device& a, const device& b) noexcept { return a.impl_ == b.impl_; }

 private:
  friend struct detail::handle_access;
  explicit device(std::shared_ptr<detail::device_impl> impl) noexcept : impl_(std::move(impl)) {}

  std::vector<device> partition_equally(std::size_t count) const;
  std::vector<device> partition_by_counts(const std::vector<std::size_t>& counts) const;
  std::vector<device> partition_by_affinity_domain(info::partition_affinity_domain domain) const;

  std::shared_ptr<detail::device_impl> impl_;
};

}  // namespace sycl

template <>
struct std::hash<sycl::device> : sycl::detail::handle_hash<sycl::device> {};
