// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <string>
#include <type_traits>
#include <vector>

#include "support.hpp"

namespace {

using conformance::throws;
using sycl::device;
using sycl::errc;
using sycl::platform;
namespace info = sycl::info;

static_assert(conformance::has_reference_semantics<platform>);
static_assert(noexcept(std::declval<const platform&>().get_backend()));
static_assert(std::is_same_v<info::platform::name::return_type, std::string>);
static_assert(std::is_same_v<info::platform::extensions::return_type, std::vector<std::string>>);

int refuse(const device&) { return -1; }
static_assert(std::is_constructible_v<platform, int (*)(const device&)>);
static_assert(!std::is_convertible_v<int (*)(const device&), platform>);

TEST(ConformancePlatform, ReferenceSemantics) {
  const std::vector<platform> platforms = platform::get_platforms();
  ASSERT_FALSE(platforms.empty());
  EXPECT_TRUE(platform() == platform());
  EXPECT_EQ(std::hash<platform>()(platform()), std::hash<platform>()(platform()));
  for (std::size_t i = 1; i < platforms.size(); ++i) {
    conformance::expect_reference_semantics(platforms[0], platforms[i]);
  }
}

TEST(ConformancePlatform, DevicesBelongToOnePlatformEach) {
  std::size_t counted = 0;
  for (const platform& p : platform::get_platforms()) {
    const std::vector<device> devices = p.get_devices();
    EXPECT_FALSE(devices.empty());
    for (const device& dev : devices) {
      ++counted;
      EXPECT_EQ(dev.get_platform(), p);
    }
    std::size_t typed = 0;
    for (const auto type : {info::device_type::cpu, info::device_type::gpu,
                            info::device_type::accelerator, info::device_type::custom}) {
      for (const device& dev : p.get_devices(type)) {
        ++typed;
        EXPECT_EQ(dev.get_info<info::device::device_type>(), type);
      }
    }
    EXPECT_EQ(typed, devices.size());
  }
  EXPECT_EQ(counted, device::get_devices().size());
}

TEST(ConformancePlatform, Selection) {
  EXPECT_EQ(platform(), device().get_platform());
  for (const device& wanted : device::get_devices()) {
    const platform p([&](const device& candidate) { return candidate == wanted ? 1 : -1; });
    EXPECT_EQ(p, wanted.get_platform());
  }
  EXPECT_TRUE(throws(errc::runtime, [] { platform{refuse}; }));
}

TEST(ConformancePlatform, HasTheAspectsOfAllItsDevices) {
  for (const platform& p : platform::get_platforms()) {
    const std::vector<device> devices = p.get_devices();
    for (const auto asp : {sycl::aspect::cpu, sycl::aspect::gpu, sycl::aspect::fp64,
                           sycl::aspect::usm_host_allocations, sycl::aspect::image}) {
      EXPECT_EQ(p.has(asp), std::all_of(devices.begin(), devices.end(),
                                        [&](const device& d) { return d.has(asp); }));
    }
  }
}

TEST(ConformancePlatform, Information) {
  for (const platform& p : platform::get_platforms()) {
    EXPECT_FALSE(p.get_info<info::platform::name>().empty());
    EXPECT_FALSE(p.get_info<info::platform::vendor>().empty());
    EXPECT_FALSE(p.get_info<info::platform::version>().empty());
    EXPECT_NO_THROW(p.get_info<info::platform::extensions>());
  }
}

}  // namespace
