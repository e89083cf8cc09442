// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The simulated devices of a test program, each with the device word that it must get.
///
/// The runtime reads their list from the environment at its first use, so a program that includes
/// this header has them from its start.
#pragma once

#include <cstdint>
#include <cstdlib>
#include <stdexcept>
#include <string>
#include <sycl/sycl.hpp>

namespace arbor::lumen::tests {

struct simulated_device {
  const char* name;
  const char* description;  ///< in the runtime's notation, without the name
  std::uint64_t word;
};

inline constexpr simulated_device simulated_devices[] = {
    {"cpu", "cpu", 0x0001000000000000},
    {"cpu_norvane", "cpu,vendor=51a7", 0x8001000000000000},
    {"cpu_with_gpu_traits", "cpu,vendor=51a7,id=1300,fp64=0", 0x8001000000000000},
    {"accelerator", "accelerator", 0x0004000000000000},
    {"accelerator_norvane", "accelerator,vendor=51a7,id=1500,fp64=0", 0x8004000000000000},
    // Families, from the first identifier to the last one.
    {"garnet", "gpu,vendor=51a7,id=1300", 0x8002000A00000002},
    {"garnet_last", "gpu,vendor=51a7,id=13ff", 0x8002000A00000002},
    {"garnet_next", "gpu,vendor=51a7,id=1400", 0x8002000900000020},
    {"topaz", "gpu,vendor=51a7,id=1534", 0x8002000900000004},
    {"onyx", "gpu,vendor=51a7,id=1700", 0x8002000900000008},
    {"onyx_integrated", "gpu,vendor=51a7,id=1901", 0x8002000A00000008},
    {"onyx_second_family", "gpu,vendor=51a7,id=1b00", 0x8002000900000008},
    {"jasper", "gpu,vendor=51a7,id=1d30", 0x8002000900000010},
    {"jasper_last", "gpu,vendor=51a7,id=1d3f", 0x8002000900000010},
    {"before_jasper", "gpu,vendor=51a7,id=1d2f", 0x8002000900000020},
    {"after_jasper", "gpu,vendor=51a7,id=1d40", 0x8002000900000020},
    {"unknown_family", "gpu,vendor=51a7,id=1f00", 0x8002000900000020},
    {"identifier_zero", "gpu,vendor=51a7,id=0", 0x8002000900000020},
    // Bits above the lowest sixteen are no part of a family.
    {"garnet_high_bits", "gpu,vendor=51a7,id=21300", 0x8002000A00000002},
    {"jasper_high_bits", "gpu,vendor=51a7,id=21d35", 0x8002000900000010},
    {"without_identifier", "gpu,vendor=51a7", 0x8002000900000020},
    // Without double.
    {"garnet_nofp64", "gpu,vendor=51a7,id=1300,fp64=0", 0x8002000600000002},
    {"topaz_nofp64", "gpu,vendor=51a7,id=1500,fp64=0", 0x8002000500000004},
    {"jasper_nofp64", "gpu,vendor=51a7,id=1d31,fp64=0", 0x8002000500000010},
    {"without_identifier_nofp64", "gpu,vendor=51a7,fp64=0", 0x8002000500000020},
    // Other vendors: the same families, another top bit.
    {"foreign_garnet", "gpu,vendor=1234,id=1300", 0x0002000A00000002},
    {"foreign", "gpu,vendor=1234", 0x0002000900000020},
    {"foreign_nofp64", "gpu,vendor=1234,fp64=0", 0x0002000500000020},
    {"foreign_near_vendor", "gpu,vendor=151a7", 0x0002000900000020},
};

inline const bool simulated_devices_are_listed = [] {
  std::string list;
  for (const simulated_device& device : simulated_devices)
    list.append(list.empty() ? "" : ";")
        .append(device.description)
        .append(",name=")
        .append(device.name);
  return setenv("LUMEN_SYCL_DEVICES", list.c_str(), 1) == 0;
}();

/// The device of a name in the list above.
inline sycl::device device_named(const std::string& name) {
  for (const sycl::device& device : sycl::device::get_devices()) {
    if (device.get_info<sycl::info::device::name>() == name) return device;
  }
  throw std::runtime_error("no simulated device \"" + name + "\"");
}

}  // namespace arbor::lumen::tests
