// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include "device/pointer_arena.hpp"
#include "device/queues.hpp"
#include "host/loop.hpp"
#include "recorded_entries.hpp"

namespace {

using namespace arbor::lumen::tests;

template <typename Shape>
class HostRandomCalls : public ::testing::Test {};
using shapes = ::testing::Types<shape::v11, shape::v12, shape::v21, shape::v21c>;
TYPED_TEST_SUITE(HostRandomCalls, shapes);

TYPED_TEST(HostRandomCalls, DoWhatTheDeviceDoes) {
  const std::uint32_t seed = std::random_device{}();
  this->RecordProperty("seed", std::to_string(seed));
  std::cout << "seed " << seed << '\n';
  random_calls calls(seed);
  pointer_arena cpu_arena(cpu_queue()), gpu_arena(gpu_queue());
  for (int i = 0; i < 15'000 / calls_divisor; ++i) {
    pointer_arena& arena = i % 2 == 0 ? cpu_arena : gpu_arena;
    random_call call = calls.next<TypeParam>();
    expect_as_the_loop<TypeParam>(call, false, arena, [&](const random_call& given) {
      outcome result;
      try {
        if (given.sliced)
          cpu::loop_launcher<TypeParam, tag<TypeParam, float>>(arena.strided<TypeParam>(given),
                                                               {1});
        else
          cpu::loop_launcher<TypeParam, tag<TypeParam, float>>(arena.linear<TypeParam>(given), {1});
      } catch (const std::exception& thrown) {
        result.error = thrown.what();
      }
      return result;
    });
    if (this->HasFatalFailure()) return;
  }
}

}  // namespace
