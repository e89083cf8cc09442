// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include <cstdint>

#include "arbor/lumen/exception.hpp"
#include "device/functors.hpp"
#include "device/memory.hpp"
#include "device/queues.hpp"
#include "device/records.hpp"
#include "host/loop.hpp"
#include "host/usm_wrapper.hpp"
#include "recorded_entries.hpp"
#include "sycl/detail/testing.hpp"

namespace {

using namespace arbor::lumen::tests;
using sycl::detail::testing::fail_next_allocations;
using values = std::vector<float>;

constexpr const char* no_memory =
    "arbor::lumen::VM::core::usm_wrapper: invalid argument: nullptr on cpu malloc";

class HostStaging : public ::testing::TestWithParam<memory> {
 public:
  using entries = recorded_entries<shape::v11, float>;
  HostStaging() { entries::reset(); }
  ~HostStaging() override { fail_next_allocations(sycl::usm::alloc::host, 0); }

 protected:
  sycl::queue gpu_ = gpu_queue();
  sycl::queue cpu_ = cpu_queue();
};
INSTANTIATE_TEST_SUITE_P(Memories, HostStaging, ::testing::ValuesIn(all_memories),
                         [](const auto& tested) { return name_of(tested.param); });

TEST_P(HostStaging, OnlyDeviceMemoryOfAGpuIsCopied) {
  for (sycl::queue* const queue : {&gpu_, &cpu_}) {
    array<float> a(*queue, GetParam(), {1, 2, 3}), y(*queue, GetParam(), {10, 20, 30});
    entries::reset();
    entries::act = [&](const entries::call& call) {
      const bool copied = queue == &gpu_ && GetParam() == memory::device;
      EXPECT_EQ(call.args.in[0] == a.data(), !copied);
      EXPECT_EQ(call.args.out[0] == y.data(), !copied);
      if (copied) {
        for (const float* copy : {call.args.in[0], static_cast<const float*>(call.args.out[0])}) {
          EXPECT_EQ(pointer_type(copy, *queue), sycl::usm::alloc::host);
          EXPECT_EQ(reinterpret_cast<std::uintptr_t>(copy) % 4096, 0u);
        }
      }
      EXPECT_EQ(call.args.in[0][2], 3);
      EXPECT_EQ(call.args.out[0][0], 10) << "outputs are copied in as well";
      call.args.out[0][1] = 99;
      if (copied) const_cast<float&>(call.args.in[0][1]) = -1;
    };
    entries::execute(linear_call<shape::v11, float>(*queue, 3, {a}, {y}));
    ASSERT_EQ(entries::calls.size(), 1u);
    EXPECT_EQ(a.read(), (values{1, 2, 3})) << "inputs are not copied back";
    EXPECT_EQ(y.read(), (values{10, 99, 30}));
    if (entries::calls[0].args.in[0] != a.data()) {
      EXPECT_EQ(pointer_type(entries::calls[0].args.in[0], *queue), sycl::usm::alloc::unknown);
      EXPECT_EQ(pointer_type(entries::calls[0].args.out[0], *queue), sycl::usm::alloc::unknown);
    }
  }
}

TEST_P(HostStaging, SlicesAreStagedByTheirExtent) {
  array<float> a(gpu_, GetParam(), {1, 2, 3, 4, 5}), y(gpu_, GetParam(), values(6, 50));
  cpu::loop_launcher<shape::v11, tag_v11<float>>(
      strided_call<shape::v11, float>(gpu_, {{a, {4, 3, -2}}}, {{y, {1, 3, 2}}}), {1});
  EXPECT_EQ(y.read(), (values{50, 11, 50, 7, 50, 3}));
}

TEST_P(HostStaging, ALengthOfZeroAsksForMemoryAndCallsTheEntry) {
  for (sycl::queue* const queue : {&gpu_, &cpu_}) {
    array<float> a(*queue, GetParam(), {1, 2}), y(*queue, GetParam(), {10, 20});
    const auto record = linear_call<shape::v11, float>(*queue, 0, {a}, {y});
    entries::reset();
    entries::execute(record);
    EXPECT_EQ(entries::counts(), std::vector<std::int64_t>{0});
    EXPECT_NE(entries::calls[0].args.in[0], a.data()) << "on any queue";
    EXPECT_NE(entries::calls[0].args.in[0], nullptr);

    fail_next_allocations(sycl::usm::alloc::host, 2);
    EXPECT_EQ(message_of<arbor::lumen::invalid_argument>([&] { entries::execute(record); }),
              no_memory);
    EXPECT_EQ(entries::calls.size(), 1u);
    EXPECT_EQ(y.read(), (values{10, 20}));
  }
}

TEST_F(HostStaging, NullStaysNull) {
  fail_next_allocations(sycl::usm::alloc::host, 2);
  for (const std::int64_t n : {0, 5}) {
    entries::reset();
    entries::execute(linear_call<shape::v11, float>(gpu_, n, {nullptr}, {nullptr}));
    EXPECT_EQ(entries::counts(), std::vector<std::int64_t>{n});
    EXPECT_EQ(entries::calls[0].args.in[0], nullptr);
    EXPECT_EQ(entries::calls[0].args.out[0], nullptr);
  }
}

TEST_F(HostStaging, WithoutMemoryTheCallFailsAndTouchesNothing) {
  array<float> a(gpu_, memory::device, {1, 2}), y(gpu_, memory::device, {10, 20});
  const auto linear = linear_call<shape::v11, float>(gpu_, 2, {a}, {y});
  const auto strided = strided_call<shape::v11, float>(gpu_, {{a, {0, 2, 1}}}, {{y, {0, 2, 1}}});
  for (const input::vxx* record :
       {static_cast<const input::vxx*>(&linear), static_cast<const input::vxx*>(&strided)}) {
    fail_next_allocations(sycl::usm::alloc::host, 2);
    EXPECT_EQ(message_of<arbor::lumen::invalid_argument>([&] { entries::execute(*record); }),
              no_memory);
    EXPECT_TRUE(entries::calls.empty());
    EXPECT_EQ(y.read(), (values{10, 20}));
  }
}

TEST_F(HostStaging, ASecondAttemptServes) {
  array<float> a(gpu_, memory::device, {1, 2}), y(gpu_, memory::device, {10, 20});
  fail_next_allocations(sycl::usm::alloc::host, 1);
  cpu::loop_launcher<shape::v11, tag_v11<float>>(linear_call<shape::v11, float>(gpu_, 2, {a}, {y}),
                                                 {1});
  EXPECT_EQ(y.read(), (values{3, 5}));
}

TEST_F(HostStaging, EarlierCopiesGoWhereALaterOneFails) {
  array<float> a(gpu_, memory::device, {1, 2, 3});
  const void* first = nullptr;
  EXPECT_EQ(message_of<arbor::lumen::invalid_argument>([&] {
              namespace host = arbor::lumen::vm::detail::host;
              const host::staging_queue on(&gpu_);
              host::usm_wrapper<float> one, other;
              float* const copy = one.wrap(on, a.data(), 3, true);
              first = copy;
              copy[1] = 7;
              other.wrap(on, a.data(), std::int64_t{1} << 60, false);
            }),
            no_memory);
  EXPECT_EQ(pointer_type(first, gpu_), sycl::usm::alloc::unknown);
  EXPECT_EQ(a.read(), (values{1, 7, 3})) << "an output comes back whatever happens";
}

TEST_F(HostStaging, MixedMemoryInOneCall) {
  array<float> a(gpu_, memory::device, {1, 2}), b(gpu_, memory::shared, {3, 4});
  values y{0, 0};
  cpu::loop_launcher<shape::v21, tag_v21<float>>(
      linear_call<shape::v21, float>(gpu_, 2, {a, b}, {y.data()}), {1});
  EXPECT_EQ(y, (values{1003, 2004}));
  cpu::loop_launcher<shape::v21, tag_v21<float>>(
      linear_call<shape::v21, float>(gpu_, 2, {a, y.data()}, {a}), {1});
  EXPECT_EQ(a.read(), (values{2003, 4004}));
}

}  // namespace
