// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "processor.hpp"

#include <unistd.h>

#include <algorithm>
#include <cstdio>
#include <fstream>

namespace sycl::detail {

std::string processor_field(const std::string& heading) {
  std::ifstream file("/proc/cpuinfo");
  for (std::string line; std::getline(file, line);) {
    if (line.compare(0, heading.size(), heading) != 0) continue;
    const std::size_t colon = line.find(':');
    const std::size_t gap = line.find_first_not_of(" \t", heading.size());
    if (colon == std::string::npos || gap != colon) continue;
    const std::size_t begin = line.find_first_not_of(" \t", colon + 1);
    return begin == std::string::npos ? std::string() : line.substr(begin);
  }
  return {};
}

std::uint32_t vector_bytes() noexcept {
#if defined(__x86_64__)
  if (__builtin_cpu_supports("avx512f")) return 64;
  if (__builtin_cpu_supports("avx2")) return 32;
#endif
  return 16;
}

namespace {

std::uint64_t system_value(int name) noexcept {
  return static_cast<std::uint64_t>(std::max(0L, sysconf(name)));
}

}  // namespace

std::uint64_t physical_memory() noexcept {
  return system_value(_SC_PHYS_PAGES) * system_value(_SC_PAGESIZE);
}

std::uint32_t cache_line_size() noexcept {
  return static_cast<std::uint32_t>(system_value(_SC_LEVEL1_DCACHE_LINESIZE));
}

std::uint64_t cache_size() noexcept {
  return std::max({system_value(_SC_LEVEL3_CACHE_SIZE), system_value(_SC_LEVEL2_CACHE_SIZE),
                   system_value(_SC_LEVEL1_DCACHE_SIZE)});
}

std::string vendor_text(const device_description& description) {
  if (description.vendor) {
    char text[24];
    std::snprintf(text, sizeof text, "Vendor 0x%04x", *description.vendor);
    return text;
  }
  if (description.type == info::device_type::cpu) {
    const std::string vendor = processor_field("vendor_id");
    if (!vendor.empty()) return vendor;
  }
  return "Arbor Lumen";
}

std::string name_text(const device_description& description) {
  if (description.name) return *description.name;
  if (description.type == info::device_type::cpu) {
    const std::string model = processor_field("model name");
    return model.empty() ? "CPU" : model;
  }
  return description.type == info::device_type::gpu ? "Simulated GPU" : "Simulated accelerator";
}

}  // namespace sycl::detail
