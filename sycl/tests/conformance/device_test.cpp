// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <bit>
#include <string>
#include <type_traits>
#include <vector>

#include "support.hpp"

namespace {

using conformance::throws;
using sycl::aspect;
using sycl::device;
using sycl::errc;
namespace info = sycl::info;

static_assert(conformance::has_reference_semantics<device>);
static_assert(std::is_default_constructible_v<device>);
static_assert(noexcept(std::declval<const device&>().get_backend()));

int refuse(const device&) { return -1; }
int accept_any(const device&) { return 1; }
static_assert(std::is_constructible_v<device, int (*)(const device&)>);
static_assert(!std::is_convertible_v<int (*)(const device&), device>);

template <typename T>
bool contains(const std::vector<T>& values, const T& value) {
  return std::find(values.begin(), values.end(), value) != values.end();
}

TEST(ConformanceDevice, ReferenceSemantics) {
  const std::vector<device> devices = device::get_devices();
  ASSERT_FALSE(devices.empty());
  EXPECT_TRUE(device() == device());
  EXPECT_EQ(std::hash<device>()(device()), std::hash<device>()(device()));
  for (std::size_t i = 1; i < devices.size(); ++i) {
    conformance::expect_reference_semantics(devices[0], devices[i]);
  }
}

TEST(ConformanceDevice, RootDevicesAreTheSameObjectsEveryTime) {
  EXPECT_EQ(device::get_devices(), device::get_devices());
  EXPECT_TRUE(contains(device::get_devices(), device()));
  EXPECT_EQ(device(), device(sycl::default_selector_v));
}

TEST(ConformanceDevice, TypesPartitionTheDevices) {
  const std::vector<device> all = device::get_devices(info::device_type::all);
  std::size_t counted = 0;
  for (const auto type : {info::device_type::cpu, info::device_type::gpu,
                          info::device_type::accelerator, info::device_type::custom}) {
    for (const device& dev : device::get_devices(type)) {
      ++counted;
      EXPECT_TRUE(contains(all, dev));
      EXPECT_EQ(dev.get_info<info::device::device_type>(), type);
    }
  }
  EXPECT_EQ(counted, all.size());
}

TEST(ConformanceDevice, Selectors) {
  const std::vector<device> all = device::get_devices();
  EXPECT_TRUE(throws(errc::runtime, [] { device{refuse}; }));
  EXPECT_TRUE(contains(all, device(accept_any)));
  const device last([&](const device& candidate) { return candidate == all.back() ? 1000 : 1; });
  EXPECT_EQ(last, all.back());
  for (const aspect kind : {aspect::cpu, aspect::gpu, aspect::accelerator}) {
    const bool exists =
        std::any_of(all.begin(), all.end(), [&](const device& d) { return d.has(kind); });
    const auto select = [&] {
      return kind == aspect::cpu   ? device(sycl::cpu_selector_v)
             : kind == aspect::gpu ? device(sycl::gpu_selector_v)
                                   : device(sycl::accelerator_selector_v);
    };
    if (exists) {
      EXPECT_TRUE(select().has(kind));
    } else {
      EXPECT_TRUE(throws(errc::runtime, select));
    }
  }
}

TEST(ConformanceDevice, AspectSelectors) {
  const device with(sycl::aspect_selector(aspect::host_debuggable));
  EXPECT_TRUE(with.has(aspect::host_debuggable));
  EXPECT_TRUE(
      device(sycl::aspect_selector<aspect::queue_profiling>()).has(aspect::queue_profiling));
  EXPECT_TRUE(device(sycl::aspect_selector()) == device(sycl::aspect_selector()));
  const std::vector<aspect> none;
  EXPECT_TRUE(throws(errc::runtime, [&] {
    device{sycl::aspect_selector(none, {aspect::usm_host_allocations, aspect::host_debuggable})};
  }));
  EXPECT_TRUE(
      throws(errc::runtime, [] { device{sycl::aspect_selector(aspect::cpu, aspect::gpu)}; }));
}

TEST(ConformanceDevice, KindsAgree) {
  for (const device& dev : device::get_devices()) {
    EXPECT_EQ(dev.is_cpu(), dev.has(aspect::cpu));
    EXPECT_EQ(dev.is_gpu(), dev.has(aspect::gpu));
    EXPECT_EQ(dev.is_accelerator(), dev.has(aspect::accelerator));
    const auto type = dev.get_info<info::device::device_type>();
    EXPECT_EQ(dev.is_cpu(), type == info::device_type::cpu);
    EXPECT_EQ(dev.is_gpu(), type == info::device_type::gpu);
    EXPECT_EQ(dev.is_accelerator(), type == info::device_type::accelerator);
    EXPECT_EQ(dev.get_platform(), dev.get_info<info::device::platform>());
    EXPECT_TRUE(contains(dev.get_platform().get_devices(), dev));
    EXPECT_EQ(dev.get_backend(), dev.get_platform().get_backend());
  }
}

TEST(ConformanceDevice, AspectsAreListed) {
  for (const device& dev : device::get_devices()) {
    const std::vector<aspect> listed = dev.get_info<info::device::aspects>();
    for (const aspect asp :
         {aspect::cpu, aspect::gpu, aspect::accelerator, aspect::custom, aspect::emulated,
          aspect::host_debuggable, aspect::fp16, aspect::fp64, aspect::atomic64, aspect::image,
          aspect::online_compiler, aspect::online_linker, aspect::queue_profiling,
          aspect::usm_device_allocations, aspect::usm_host_allocations,
          aspect::usm_atomic_host_allocations, aspect::usm_shared_allocations,
          aspect::usm_atomic_shared_allocations, aspect::usm_system_allocations}) {
      EXPECT_EQ(contains(listed, asp), dev.has(asp)) << static_cast<int>(asp);
    }
  }
  static_assert(!sycl::all_devices_have_v<aspect::cpu> || sycl::any_device_has_v<aspect::cpu>);
  static_assert(std::is_base_of_v<std::bool_constant<sycl::any_device_has_v<aspect::fp64>>,
                                  sycl::any_device_has<aspect::fp64>>);
}

TEST(ConformanceDevice, LimitsReachTheMinima) {
  for (const device& dev : device::get_devices()) {
    EXPECT_GE(dev.get_info<info::device::max_compute_units>(), 1U);
    EXPECT_GE(dev.get_info<info::device::max_work_item_dimensions>(), 3U);
    EXPECT_GE(dev.get_info<info::device::max_work_group_size>(), 1U);
    EXPECT_GE(dev.get_info<info::device::max_work_item_sizes<1>>()[0], 1U);
    const auto sizes = dev.get_info<info::device::max_work_item_sizes<3>>();
    static_assert(std::is_same_v<decltype(sizes), const sycl::range<3>>);
    EXPECT_GE(sizes[0] * sizes[1] * sizes[2], 1U);
    EXPECT_GE(dev.get_info<info::device::max_parameter_size>(), 1024U);
    EXPECT_GT(dev.get_info<info::device::global_mem_size>(), 0U);
    EXPECT_GE(dev.get_info<info::device::max_mem_alloc_size>(),
              std::max<std::uint64_t>(dev.get_info<info::device::global_mem_size>() / 4,
                                      std::uint64_t{128} << 20));
    EXPECT_GE(dev.get_info<info::device::max_num_sub_groups>(), 1U);
    EXPECT_FALSE(dev.get_info<info::device::sub_group_sizes>().empty());
    EXPECT_EQ(dev.get_info<info::device::address_bits>(), 8 * sizeof(void*));
    EXPECT_EQ(dev.get_info<info::device::is_endian_little>(),
              std::endian::native == std::endian::little);
    EXPECT_TRUE(dev.get_info<info::device::is_available>());
    EXPECT_EQ(dev.get_info<info::device::image_support>(), dev.has(aspect::image));
    EXPECT_EQ(dev.get_info<info::device::is_compiler_available>(),
              dev.has(aspect::online_compiler));
    EXPECT_EQ(dev.get_info<info::device::queue_profiling>(), dev.has(aspect::queue_profiling));
    EXPECT_TRUE(contains(dev.get_info<info::device::execution_capabilities>(),
                         info::execution_capability::exec_kernel));
  }
}

TEST(ConformanceDevice, FloatingPointConfigurations) {
  for (const device& dev : device::get_devices()) {
    EXPECT_EQ(dev.get_info<info::device::half_fp_config>().empty(), !dev.has(aspect::fp16));
    EXPECT_EQ(dev.get_info<info::device::double_fp_config>().empty(), !dev.has(aspect::fp64));
    const auto single = dev.get_info<info::device::single_fp_config>();
    EXPECT_TRUE(contains(single, info::fp_config::round_to_nearest));
    EXPECT_TRUE(contains(single, info::fp_config::inf_nan));
    if (dev.has(aspect::fp64)) {
      const auto config = dev.get_info<info::device::double_fp_config>();
      for (const auto needed : {info::fp_config::fma, info::fp_config::round_to_nearest,
                                info::fp_config::inf_nan, info::fp_config::denorm}) {
        EXPECT_TRUE(contains(config, needed));
      }
    }
    EXPECT_EQ(dev.get_info<info::device::preferred_vector_width_double>() == 0,
              !dev.has(aspect::fp64));
    EXPECT_EQ(dev.get_info<info::device::native_vector_width_double>() == 0,
              !dev.has(aspect::fp64));
    EXPECT_EQ(dev.get_info<info::device::preferred_vector_width_half>() == 0,
              !dev.has(aspect::fp16));
    EXPECT_EQ(dev.get_info<info::device::native_vector_width_half>() == 0, !dev.has(aspect::fp16));
  }
}

TEST(ConformanceDevice, AtomicCapabilitiesIncludeTheRequired) {
  using sycl::memory_order;
  using sycl::memory_scope;
  for (const device& dev : device::get_devices()) {
    EXPECT_TRUE(contains(dev.get_info<info::device::atomic_memory_order_capabilities>(),
                         memory_order::relaxed));
    const auto fences = dev.get_info<info::device::atomic_fence_order_capabilities>();
    for (const auto order : {memory_order::relaxed, memory_order::acquire, memory_order::release,
                             memory_order::acq_rel}) {
      EXPECT_TRUE(contains(fences, order));
    }
    const auto scopes = dev.get_info<info::device::atomic_memory_scope_capabilities>();
    const auto fence_scopes = dev.get_info<info::device::atomic_fence_scope_capabilities>();
    for (const auto scope :
         {memory_scope::work_item, memory_scope::sub_group, memory_scope::work_group}) {
      EXPECT_TRUE(contains(scopes, scope));
      EXPECT_TRUE(contains(fence_scopes, scope));
    }
  }
}

TEST(ConformanceDevice, Names) {
  for (const device& dev : device::get_devices()) {
    EXPECT_FALSE(dev.get_info<info::device::name>().empty());
    EXPECT_FALSE(dev.get_info<info::device::version>().empty());
    static_assert(std::is_same_v<decltype(dev.get_info<info::device::vendor>()), std::string>);
    static_assert(std::is_same_v<decltype(dev.get_info<info::device::vendor_id>()), std::uint32_t>);
    EXPECT_NO_THROW(dev.get_info<info::device::vendor>());
    EXPECT_NO_THROW(dev.get_info<info::device::vendor_id>());
    EXPECT_NO_THROW(dev.get_info<info::device::driver_version>());
    EXPECT_NO_THROW(dev.get_info<info::device::extensions>());
  }
}

TEST(ConformanceDevice, RootDevicesHaveNoParent) {
  for (const device& dev : device::get_devices()) {
    EXPECT_TRUE(throws(errc::invalid, [&] { dev.get_info<info::device::parent_device>(); }));
    EXPECT_EQ(dev.get_info<info::device::partition_type_property>(),
              info::partition_property::no_partition);
    EXPECT_EQ(dev.get_info<info::device::partition_type_affinity_domain>(),
              info::partition_affinity_domain::not_applicable);
  }
}

using info::partition_property;

TEST(ConformanceDevice, PartitionEqually) {
  for (const device& dev : device::get_devices()) {
    const bool supported = contains(dev.get_info<info::device::partition_properties>(),
                                    partition_property::partition_equally);
    const std::size_t units = dev.get_info<info::device::max_compute_units>();
    const auto split = [&](std::size_t count) {
      return dev.create_sub_devices<partition_property::partition_equally>(count);
    };
    if (!supported) {
      EXPECT_TRUE(throws(errc::feature_not_supported, [&] { split(1); }));
      continue;
    }
    const std::vector<device> parts = split(1);
    EXPECT_EQ(parts.size(), units);
    for (const device& part : parts) {
      EXPECT_EQ(part.get_info<info::device::parent_device>(), dev);
      EXPECT_EQ(part.get_info<info::device::max_compute_units>(), 1U);
      EXPECT_EQ(part.get_info<info::device::partition_type_property>(),
                partition_property::partition_equally);
      EXPECT_EQ(part.get_platform(), dev.get_platform());
      EXPECT_NE(part, dev);
    }
    EXPECT_TRUE(throws(errc::invalid, [&] { split(units + 1); }));
  }
}

TEST(ConformanceDevice, PartitionByCounts) {
  for (const device& dev : device::get_devices()) {
    const bool supported = contains(dev.get_info<info::device::partition_properties>(),
                                    partition_property::partition_by_counts);
    const std::size_t units = dev.get_info<info::device::max_compute_units>();
    const auto split = [&](const std::vector<std::size_t>& counts) {
      return dev.create_sub_devices<partition_property::partition_by_counts>(counts);
    };
    if (!supported) {
      EXPECT_TRUE(throws(errc::feature_not_supported, [&] { split({1}); }));
      continue;
    }
    const std::vector<device> parts = split({1});
    ASSERT_EQ(parts.size(), 1U);
    EXPECT_EQ(parts[0].get_info<info::device::max_compute_units>(), 1U);
    EXPECT_EQ(parts[0].get_info<info::device::parent_device>(), dev);
    EXPECT_TRUE(throws(errc::invalid, [&] { split({units, 1}); }));
  }
}

TEST(ConformanceDevice, PartitionByAffinityDomain) {
  using domain = info::partition_affinity_domain;
  for (const device& dev : device::get_devices()) {
    const bool supported = contains(dev.get_info<info::device::partition_properties>(),
                                    partition_property::partition_by_affinity_domain);
    if (supported) continue;
    EXPECT_TRUE(throws(errc::feature_not_supported, [&] {
      dev.create_sub_devices<partition_property::partition_by_affinity_domain>(domain::numa);
    }));
  }
}

TEST(ConformanceDevice, SubDevicesRunKernels) {
  for (const device& dev : device::get_devices()) {
    if (!contains(dev.get_info<info::device::partition_properties>(),
                  partition_property::partition_equally)) {
      continue;
    }
    const device part = dev.create_sub_devices<partition_property::partition_equally>(1).front();
    sycl::queue q(part);
    EXPECT_EQ(q.get_device(), part);
    std::vector<int> data(100, 0);
    {
      sycl::buffer<int, 1> buf(data);
      q.submit([&](sycl::handler& cgh) {
        const sycl::accessor out(buf, cgh, sycl::write_only);
        cgh.parallel_for(sycl::range<1>(100), [=](sycl::id<1> i) { out[i] = 3; });
      });
    }
    EXPECT_EQ(data, std::vector<int>(100, 3));
  }
}

}  // namespace
