// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstdint>
#include <string>

#include "device_impl.hpp"

namespace sycl::detail {

/// What /proc/cpuinfo says under a heading of the first processor; empty if nothing.
std::string processor_field(const std::string& heading);
/// Bytes of a vector register.
std::uint32_t vector_bytes() noexcept;
std::uint64_t physical_memory() noexcept;
std::uint32_t cache_line_size() noexcept;
std::uint64_t cache_size() noexcept;

/// Of the device: what the list of devices says, else what the processor says, else the runtime's.
std::string vendor_text(const device_description& description);
std::string name_text(const device_description& description);

}  // namespace sycl::detail
