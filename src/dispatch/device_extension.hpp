// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <optional>
#include <sycl/sycl.hpp>

/// What a vendor adds to SYCL and dispatch makes use of; absent where the implementation lacks it.
namespace arbor::lumen::vm::detail {

/// The device's model identifier, if the device can tell it.
inline std::optional<std::uint32_t> device_identifier(const sycl::device& device) {
#if defined(ARBORLUMEN_SYCL_EMBEDDED)
  if (device.has(static_cast<sycl::aspect>(37)))
    return device.get_info<sycl::ext::norvane::info::device::device_id>();
#else
  static_cast<void>(device);
#endif
  return std::nullopt;
}

}  // namespace arbor::lumen::vm::detail
