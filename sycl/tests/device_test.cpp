// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <vector>

#include <gtest/gtest.h>
#include <sycl/sycl.hpp>

namespace {

namespace info = sycl::info;
using sycl::aspect;
using sycl::device;

template <typename Action>
sycl::errc code_of(Action&& act) {
  try {
    act();
  } catch (const sycl::exception& e) {
    return static_cast<sycl::errc>(e.code().value());
  }
  return sycl::errc::success;
}

TEST(Device, WithoutAListThereIsTheProcessorAlone) {
  const std::vector<device> all = device::get_devices();
  ASSERT_EQ(all.size(), 1U);
  EXPECT_TRUE(all[0].is_cpu());
  EXPECT_FALSE(all[0].is_gpu());
  EXPECT_FALSE(all[0].is_accelerator());
  EXPECT_EQ(all[0], device());
  EXPECT_EQ(all[0].get_backend(), sycl::backend::host);
  EXPECT_FALSE(all[0].has(aspect::ext_norvane_device_id));
  EXPECT_FALSE(all[0].has(aspect::emulated));
  EXPECT_TRUE(all[0].has(aspect::fp64));
  EXPECT_TRUE(all[0].has(aspect::usm_system_allocations));
  EXPECT_EQ(device::get_devices(info::device_type::cpu), all);
  EXPECT_TRUE(device::get_devices(info::device_type::gpu).empty());
  EXPECT_EQ(sycl::platform::get_platforms().size(), 1U);
}

TEST(Device, AnswersQueries) {
  const device d;
  EXPECT_EQ(d.get_info<info::device::device_type>(), info::device_type::cpu);
  EXPECT_FALSE(d.get_info<info::device::name>().empty());
  EXPECT_FALSE(d.get_info<info::device::vendor>().empty());
  EXPECT_FALSE(d.get_info<info::device::driver_version>().empty());
  EXPECT_FALSE(d.get_info<info::device::version>().empty());
  EXPECT_GE(d.get_info<info::device::max_compute_units>(), 1U);
  EXPECT_GE(d.get_info<info::device::max_work_group_size>(), 1U);
  EXPECT_GT(d.get_info<info::device::global_mem_size>(), 1U << 20);
  EXPECT_GT(d.get_info<info::device::max_mem_alloc_size>(), 1U << 20);
  EXPECT_EQ(d.get_info<info::device::max_work_item_sizes<2>>().size(), std::size_t{1024} * 1024);
  const auto fp64 = d.get_info<info::device::double_fp_config>();
  EXPECT_NE(std::find(fp64.begin(), fp64.end(), info::fp_config::fma), fp64.end());
  const auto aspects = d.get_info<info::device::aspects>();
  EXPECT_NE(std::find(aspects.begin(), aspects.end(), aspect::cpu), aspects.end());
  for (const aspect each : aspects) EXPECT_TRUE(d.has(each));
  EXPECT_EQ(d.get_info<info::device::platform>(), d.get_platform());
  EXPECT_EQ(d.get_info<info::device::mem_base_addr_align>() % 8, 0U);
  EXPECT_EQ(d.get_info<info::device::partition_type_property>(),
            info::partition_property::no_partition);
}

TEST(Device, AsksForAnIdentifierOnlyWhereThereIsOne) {
  EXPECT_EQ(static_cast<int>(aspect::ext_norvane_device_id), 37);
  EXPECT_EQ(code_of([] { (void)device().get_info<sycl::ext::norvane::info::device::device_id>(); }),
            sycl::errc::feature_not_supported);
}

TEST(Selector, ChoosesByScore) {
  EXPECT_EQ(device(sycl::default_selector_v), device(sycl::cpu_selector_v));
  EXPECT_EQ(device(sycl::aspect_selector(aspect::cpu)), device());
  EXPECT_EQ(device(sycl::aspect_selector<aspect::cpu, aspect::fp64>()), device());
  EXPECT_EQ(device(sycl::aspect_selector({aspect::cpu}, {aspect::gpu})), device());
  EXPECT_EQ(device([](const device&) { return 0; }), device());
  const sycl::platform p(sycl::cpu_selector_v);
  EXPECT_EQ(p, device().get_platform());
}

int refuse(const device&) { return -1; }

TEST(Selector, WithoutADeviceThrows) {
  using sycl::errc;
  EXPECT_EQ(code_of([] { device d(sycl::gpu_selector_v); }), errc::runtime);
  EXPECT_EQ(code_of([] { sycl::queue q(sycl::accelerator_selector_v); }), errc::runtime);
  EXPECT_EQ(code_of([] { sycl::platform p(sycl::gpu_selector_v); }), errc::runtime);
  EXPECT_EQ(code_of([] { device d(sycl::aspect_selector({}, {aspect::cpu})); }), errc::runtime);
  EXPECT_EQ(code_of([] { device d(refuse); }), errc::runtime);
}

TEST(SubDevices, PartitionTheComputeUnits) {
  const device whole;
  const auto units = whole.get_info<info::device::max_compute_units>();
  if (units == 1) GTEST_SKIP() << "one compute unit cannot be partitioned";
  EXPECT_EQ(whole.get_info<info::device::partition_max_sub_devices>(), units);
  constexpr auto equally = info::partition_property::partition_equally;
  constexpr auto by_counts = info::partition_property::partition_by_counts;
  constexpr auto by_domain = info::partition_property::partition_by_affinity_domain;

  const auto singles = whole.create_sub_devices<equally>(1);
  EXPECT_EQ(singles.size(), units);
  for (const device& part : singles) {
    EXPECT_EQ(part.get_info<info::device::max_compute_units>(), 1U);
    EXPECT_EQ(part.get_info<info::device::parent_device>(), whole);
    EXPECT_EQ(part.get_info<info::device::partition_type_property>(), equally);
    EXPECT_TRUE(part.is_cpu());
    EXPECT_EQ(code_of([&] { part.create_sub_devices<equally>(1); }),
              sycl::errc::feature_not_supported);
  }
  const auto counted = whole.create_sub_devices<by_counts>({1, units - 1});
  ASSERT_EQ(counted.size(), 2U);
  EXPECT_EQ(counted[1].get_info<info::device::max_compute_units>(), units - 1);

  using sycl::errc;
  EXPECT_EQ(code_of([&] { whole.create_sub_devices<equally>(0); }), errc::invalid);
  EXPECT_EQ(code_of([&] { whole.create_sub_devices<equally>(units + 1); }), errc::invalid);
  EXPECT_EQ(code_of([&] { whole.create_sub_devices<by_counts>({units, 1}); }), errc::invalid);
  EXPECT_EQ(
      code_of([&] {
        whole.create_sub_devices<by_domain>(info::partition_affinity_domain::next_partitionable);
      }),
      errc::feature_not_supported);
  EXPECT_EQ(static_cast<int>(info::partition_affinity_domain::next_partitionable), 32);
  EXPECT_EQ(code_of([&] { (void)whole.get_info<info::device::parent_device>(); }), errc::invalid);

  sycl::queue q(singles[0]);
  int* const p = sycl::malloc_device<int>(10, q);
  EXPECT_EQ(sycl::get_pointer_device(p, q.get_context()), singles[0]);
  q.fill(p, 3, 10).wait();
  EXPECT_EQ(p[9], 3);
  sycl::free(p, q);
}

TEST(Platform, HoldsItsDevices) {
  const sycl::platform p;
  EXPECT_EQ(p.get_devices(), device::get_devices());
  EXPECT_TRUE(p.has(aspect::cpu));
  EXPECT_FALSE(p.has(aspect::gpu));
  EXPECT_FALSE(p.get_info<info::platform::name>().empty());
  EXPECT_FALSE(p.get_info<info::platform::vendor>().empty());
  EXPECT_FALSE(p.get_info<info::platform::version>().empty());
  EXPECT_FALSE(p.get_info<info::platform::profile>().empty());
  EXPECT_TRUE(p.get_info<info::platform::extensions>().empty());
}

TEST(Context, HoldsItsDevices) {
  const device d;
  const sycl::context c(std::vector<device>{d});
  EXPECT_EQ(c.get_devices(), std::vector<device>{d});
  EXPECT_EQ(c.get_info<info::context::devices>(), std::vector<device>{d});
  EXPECT_EQ(c.get_info<info::context::platform>(), d.get_platform());
  EXPECT_EQ(c.get_backend(), d.get_backend());
  EXPECT_EQ(code_of([] { sycl::context empty(std::vector<device>{}); }), sycl::errc::invalid);
  EXPECT_EQ(sycl::queue().get_context(), sycl::queue().get_context());
}

}  // namespace
