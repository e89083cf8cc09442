// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "sycl/platform.hpp"

#include <algorithm>

#include "device_impl.hpp"
#include "sycl/selector.hpp"

namespace sycl {

platform::platform() : platform(default_selector_v) {}

backend platform::get_backend() const noexcept { return impl_->from; }

std::vector<device> platform::get_devices(info::device_type type) const {
  std::vector<device> result;
  for (const std::shared_ptr<detail::device_impl>& each : impl_->devices) {
    // The default device of a platform is its first.
    if (type == info::device_type::all || type == info::device_type::automatic ||
        type == each->description.type) {
      result.push_back(detail::handle_access::make<device>(each));
      if (type == info::device_type::automatic) break;
    }
  }
  return result;
}

bool platform::has(aspect asp) const {
  return std::all_of(impl_->devices.begin(), impl_->devices.end(),
                     [asp](const auto& each) { return each->has(asp); });
}

std::vector<platform> platform::get_platforms() {
  std::vector<platform> result;
  for (const std::shared_ptr<detail::platform_impl>& each : detail::all_platforms()) {
    result.push_back(detail::handle_access::make<platform>(each));
  }
  return result;
}

namespace {

const char* backend_text(backend from) {
  switch (from) {
    case backend::host:
      return "host";
    case backend::opencl:
      return "simulated opencl";
    case backend::stratum:
      return "simulated stratum";
  }
  return "";
}

}  // namespace

template <>
ARBOR_LUMEN_SYCL_API std::string platform::get_info<info::platform::profile>() const {
  return "FULL_PROFILE";
}
template <>
ARBOR_LUMEN_SYCL_API std::string platform::get_info<info::platform::version>() const {
  return ARBOR_LUMEN_SYCL_VERSION;
}
template <>
ARBOR_LUMEN_SYCL_API std::string platform::get_info<info::platform::name>() const {
  return std::string("Arbor Lumen SYCL, ") + backend_text(impl_->from);
}
template <>
ARBOR_LUMEN_SYCL_API std::string platform::get_info<info::platform::vendor>() const {
  return impl_->vendor_name;
}
template <>
ARBOR_LUMEN_SYCL_API std::vector<std::string> platform::get_info<info::platform::extensions>()
    const {
  return {};
}

}  // namespace sycl
