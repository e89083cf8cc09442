// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
// Each suite runs in a process of its own under the environment that CMakeLists.txt gives it.

#include <array>
#include <atomic>
#include <chrono>
#include <cstdlib>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>
#include <sycl/sycl.hpp>

#include "gate.hpp"

namespace {

namespace info = sycl::info;
using sycl::aspect;
using sycl::device;
using sycl::errc;
using sycl::ext::norvane::info::device::device_id;

template <typename Action>
errc code_of(Action&& act) {
  try {
    act();
  } catch (const sycl::exception& e) {
    return static_cast<errc>(e.code().value());
  }
  return errc::success;
}

struct needs_double {
  static constexpr auto required_aspects = std::array{aspect::fp64};
  double* p;
  void operator()(sycl::id<1> i) const { p[i] = 2; }
};

TEST(Simulated, DevicesAreAsListed) {
  const std::vector<device> all = device::get_devices();
  ASSERT_EQ(all.size(), 4U);
  EXPECT_TRUE(all[0].is_cpu());
  EXPECT_EQ(device::get_devices(info::device_type::gpu).size(), 2U);
  EXPECT_EQ(device::get_devices(info::device_type::accelerator).size(), 1U);

  const device big(
      [](const device& d) { return d.get_info<info::device::name>() == "Big" ? 1 : -1; });
  EXPECT_TRUE(big.is_gpu());
  EXPECT_EQ(big.get_info<info::device::vendor_id>(), 0x51A7U);
  EXPECT_TRUE(big.has(aspect::ext_norvane_device_id));
  EXPECT_EQ(big.get_info<device_id>(), 0x1D30U);
  EXPECT_EQ(big.get_backend(), sycl::backend::stratum);
  EXPECT_TRUE(big.has(aspect::emulated));
  EXPECT_FALSE(big.has(aspect::usm_system_allocations));
  EXPECT_EQ(device(sycl::default_selector_v).get_info<info::device::device_type>(),
            info::device_type::gpu);
}

TEST(Simulated, PlatformsAreOfOneBackendAndVendor) {
  const auto platforms = sycl::platform::get_platforms();
  ASSERT_EQ(platforms.size(), 3U);
  EXPECT_EQ(platforms[0].get_backend(), sycl::backend::host);
  EXPECT_EQ(platforms[0].get_devices().size(), 2U);
  EXPECT_EQ(platforms[0].get_devices(info::device_type::gpu).size(), 1U);
  EXPECT_EQ(platforms[1].get_backend(), sycl::backend::stratum);
  EXPECT_EQ(platforms[2].get_backend(), sycl::backend::opencl);
  const std::vector<device> mixed{platforms[0].get_devices()[0], platforms[1].get_devices()[0]};
  EXPECT_EQ(code_of([&] { sycl::context c(mixed); }), errc::invalid);
}

TEST(Simulated, WithoutDoubleRefusesKernelsThatNeedIt) {
  const device single(sycl::aspect_selector({aspect::gpu}, {aspect::fp64}));
  EXPECT_TRUE(single.get_info<info::device::double_fp_config>().empty());
  EXPECT_EQ(single.get_info<info::device::native_vector_width_double>(), 0U);
  std::vector<double> v(4);
  sycl::queue q(single);
  EXPECT_EQ(code_of([&] { q.parallel_for(4, needs_double{v.data()}); }),
            errc::kernel_not_supported);
  EXPECT_EQ(code_of([&] {
              q.submit([&](sycl::handler& cgh) { cgh.parallel_for(4, needs_double{v.data()}); });
            }),
            errc::kernel_not_supported);
  EXPECT_EQ(v[0], 0);
  q.wait();
  sycl::queue(sycl::cpu_selector_v).parallel_for(4, needs_double{v.data()}).wait();
  EXPECT_EQ(v[3], 2);

  const device no_half(sycl::accelerator_selector_v);
  EXPECT_FALSE(no_half.has(aspect::fp16));
  EXPECT_TRUE(no_half.get_info<info::device::half_fp_config>().empty());
  EXPECT_EQ(code_of([&] { (void)no_half.get_info<device_id>(); }), errc::feature_not_supported);
}

TEST(Simulated, ComputesOnTheProcessor) {
  for (const device& d : device::get_devices()) {
    sycl::queue q(d);
    int* const p = sycl::malloc_device<int>(1000, q);
    EXPECT_EQ(sycl::get_pointer_device(p, q.get_context()), d);
    q.parallel_for(1000, [=](sycl::id<1> i) { p[i] = static_cast<int>(i[0]); }).wait();
    std::vector<int> out(1000);
    q.memcpy(out.data(), p, 4000).wait();
    EXPECT_EQ(out[999], 999);
    sycl::free(p, q);
  }
}

TEST(Simulated, DeviceMemoryOfAnotherDeviceIsForeign) {
  const std::vector<device> on_host = sycl::platform::get_platforms()[0].get_devices();
  sycl::queue cpu(on_host[0]);
  sycl::queue gpu(on_host[1]);
  ASSERT_EQ(cpu.get_context(), gpu.get_context());
  int* const p = sycl::malloc_device<int>(4, gpu);
  std::vector<int> out(4);
  EXPECT_EQ(code_of([&] { cpu.memcpy(out.data(), p, 16); }), errc::invalid);
  EXPECT_EQ(code_of([&] { cpu.memset(p, 0, 16); }), errc::invalid);
  EXPECT_EQ(code_of([&] { cpu.fill(p, 1, 4); }), errc::invalid);
  EXPECT_EQ(code_of([&] { gpu.fill(p, 1, 4).wait(); }), errc::success);
  sycl::free(p, gpu);
}

TEST(Simulated, SubDevicesFollowTheAffinityDomain) {
  const device big(sycl::aspect_selector({aspect::ext_norvane_device_id}));
  constexpr auto by_domain = info::partition_property::partition_by_affinity_domain;
  using info::partition_affinity_domain;
  const auto parts =
      big.create_sub_devices<by_domain>(partition_affinity_domain::next_partitionable);
  ASSERT_EQ(parts.size(), 2U);
  for (const device& part : parts) {
    EXPECT_EQ(part.get_info<info::device::parent_device>(), big);
    EXPECT_EQ(part.get_info<info::device::partition_type_property>(), by_domain);
    EXPECT_EQ(part.get_info<device_id>(), 0x1D30U);
    EXPECT_EQ(part.get_platform(), big.get_platform());
    sycl::queue q(sycl::context(big), part);
    int value = 0;
    int* const p = &value;
    q.single_task([=] { *p = 1; }).wait();
    EXPECT_EQ(value, 1);
  }
  EXPECT_FALSE(parts[0] == parts[1]);
  EXPECT_EQ(
      code_of([&] { big.create_sub_devices<by_domain>(partition_affinity_domain::L1_cache); }),
      errc::feature_not_supported);
  const device other(sycl::accelerator_selector_v);
  EXPECT_EQ(code_of([&] { sycl::queue q(sycl::context(big), other); }), errc::invalid);
}

TEST(Simulated, HandlesBelongToTheirBackend) {
  const device big(sycl::aspect_selector({aspect::ext_norvane_device_id}));
  sycl::queue q(big);
  using sycl::backend;
  const auto handle = sycl::get_native<backend::stratum>(q);
  EXPECT_EQ(code_of([&] { sycl::get_native<backend::host>(q); }), errc::backend_mismatch);
  EXPECT_EQ(code_of([&] { sycl::get_native<backend::opencl>(big); }), errc::backend_mismatch);
  EXPECT_EQ(sycl::make_queue<backend::stratum>(handle, q.get_context()), q);
  EXPECT_EQ(code_of([&] { sycl::make_queue<backend::host>(handle, q.get_context()); }),
            errc::backend_mismatch);
}

TEST(NoCpu, SelectorsSaySo) {
  EXPECT_TRUE(device().is_gpu());
  EXPECT_EQ(code_of([] { device d(sycl::cpu_selector_v); }), errc::runtime);
  EXPECT_EQ(code_of([] { sycl::queue q(sycl::cpu_selector_v); }), errc::runtime);
}

TEST(Plain, AnEmptyListIsNone) {
  ASSERT_EQ(device::get_devices().size(), 1U);
  EXPECT_TRUE(device().is_cpu());
}

TEST(MalformedDevices, ThrowAtFirstUse) {
  for (int attempt = 0; attempt < 2; ++attempt) {
    try {
      sycl::queue q;
      FAIL();
    } catch (const sycl::exception& e) {
      EXPECT_EQ(e.code(), errc::runtime);
      EXPECT_NE(std::string(e.what()).find("'fp64=2'"), std::string::npos) << e.what();
    }
  }
}

TEST(MalformedThreads, ThrowAtFirstSubmission) {
  sycl::queue q;
  EXPECT_EQ(code_of([&] { q.single_task([] {}); }), errc::runtime);
  q.wait();
  sycl::buffer<int> buf(sycl::range<1>(1));
  EXPECT_EQ(code_of([&] { buf.get_host_access(); }), errc::runtime);
}

TEST(Threads, RunEverythingWhateverTheirNumber) {
  sycl::queue q;
  std::vector<gate> gates(20);
  for (gate& g : gates) g.close(q);
  std::vector<int> v(1 << 20, 1);
  int* const p = v.data();
  for (int i = 0; i < 10; ++i) {
    q.parallel_for(v.size(), [=](sycl::id<1> k) { p[k] *= 2; }).wait();
  }
  EXPECT_EQ(v, std::vector<int>(1 << 20, 1024));
  std::atomic<int> count{0};
  std::atomic<int>* const c = &count;
  std::vector<sycl::event> events;
  for (int i = 0; i < 5000; ++i) events.push_back(q.single_task([=] { ++*c; }));
  sycl::event::wait(events);
  EXPECT_EQ(count, 5000);
}

int* results() {
  static int values[3];
  return values;
}

/// Uses the runtime after main has returned.
struct late_user {
  ~late_user() {
    int* const p = results();
    if (p[0] != 1 || p[1] != 1) std::_Exit(3);
    sycl::queue q;
    q.submit([&](sycl::handler& cgh) {
      cgh.depends_on(q.single_task([=] { p[2] = 1; }));
      cgh.host_task([=] { p[2] += 1; });
    });
    q.wait();
    if (p[2] != 2) std::_Exit(4);
  }
};

TEST(Exit, PendingWorkFinishesAndLateWorkRuns) {
  results();
  static const late_user late;
  sycl::queue q{sycl::property::queue::in_order()};
  int* const p = results();
  q.submit([&](sycl::handler& cgh) {
    cgh.host_task([=] {
      std::this_thread::sleep_for(std::chrono::milliseconds(100));
      p[0] = 1;
    });
  });
  q.single_task([=] { p[1] = p[0]; });
  EXPECT_EQ(p[1], 0);
}

}  // namespace
