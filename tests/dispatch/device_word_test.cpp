// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "dispatch/device_word.hpp"

#include <gtest/gtest.h>

#include <atomic>
#include <cstdint>
#include <sycl/sycl.hpp>
#include <thread>
#include <vector>

#include "dispatch/simulated_devices.hpp"

namespace {

using namespace arbor::lumen::tests;
namespace device_word = arbor::lumen::vm::detail::device_word;

class DeviceWord : public testing::TestWithParam<simulated_device> {};

TEST_P(DeviceWord, DescribesTheDevice) {
  const sycl::device device = device_named(GetParam().name);
  EXPECT_EQ(GetParam().word, device_word::classify(device)) << GetParam().description;
  sycl::queue queue(device);
  EXPECT_EQ(GetParam().word, device_word::of_queue(&queue));
  EXPECT_EQ(GetParam().word, device_word::of_queue(&queue)) << "classified a second time";
}

INSTANTIATE_TEST_SUITE_P(Simulated, DeviceWord, testing::ValuesIn(simulated_devices),
                         [](const auto& param_info) { return std::string(param_info.param.name); });

TEST(DeviceWordBits, AreTheDocumentedOnes) {
  EXPECT_EQ(1ull << 1, device_word::garnet);
  EXPECT_EQ(1ull << 2, device_word::topaz);
  EXPECT_EQ(1ull << 3, device_word::onyx);
  EXPECT_EQ(1ull << 4, device_word::jasper);
  EXPECT_EQ(1ull << 5, device_word::beryl);
  EXPECT_EQ(1ull << 32, device_word::discrete);
  EXPECT_EQ(1ull << 33, device_word::integrated);
  EXPECT_EQ(1ull << 34, device_word::nofp64);
  EXPECT_EQ(1ull << 35, device_word::fp64);
  EXPECT_EQ(1ull << 48, device_word::cpu);
  EXPECT_EQ(1ull << 49, device_word::gpu);
  EXPECT_EQ(1ull << 50, device_word::accelerator);
  EXPECT_EQ(1ull << 63, device_word::norvane);
}

TEST(DeviceWordOfManyThreads, IsTheSame) {
  sycl::queue queue(device_named("jasper"));
  std::atomic<int> right{0};
  std::vector<std::thread> threads;
  for (int t = 0; t < 8; ++t) {
    threads.emplace_back([&] {
      for (int i = 0; i < 100; ++i) right += device_word::of_queue(&queue) == 0x8002000900000010;
    });
  }
  for (std::thread& thread : threads) thread.join();
  EXPECT_EQ(800, right.load());
}

}  // namespace
