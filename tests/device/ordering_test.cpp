// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include <stdexcept>

#include "functors.hpp"
#include "gate.hpp"
#include "memory.hpp"
#include "queues.hpp"
#include "recorded_kernels.hpp"
#include "records.hpp"

namespace {

using namespace arbor::lumen::tests;

template <typename Record>
sycl::event run(const Record& record) {
  return norvane::launcher<shape::v11, tag_v11<float>>(record, {1});
}

/// The three ways into a pointer kernel: fast, strided for its status, strided for its slices.
enum class way { fast, handler, slices };

class Ordering : public ::testing::TestWithParam<way> {
 protected:
  sycl::queue queue_ = gpu_queue();

  /// Calls on three elements after `depends`.
  sycl::event call(const float* a, float* y, const std::vector<sycl::event>& depends,
                   std::uint32_t mode = 0) {
    if (GetParam() == way::slices) {
      auto record = strided_call<shape::v11, float>(queue_, {{a, {0, 3, 1}}}, {{y, {0, 3, 1}}});
      record.depends = depends;
      record.mode = mode_with(mode);
      return run(record);
    }
    auto record = linear_call<shape::v11, float>(queue_, 3, {a}, {y});
    record.depends = depends;
    record.mode = mode_with(mode);
    record.handler.enabled = GetParam() == way::handler;
    return run(record);
  }
};

const char* name_of_way(const ::testing::TestParamInfo<way>& tested) {
  constexpr const char* names[] = {"fast", "handler", "slices"};
  return names[static_cast<int>(tested.param)];
}
INSTANTIATE_TEST_SUITE_P(Ways, Ordering, ::testing::Values(way::fast, way::handler, way::slices),
                         name_of_way);

TEST_P(Ordering, DeviceAndSharedMemoryDoNotBlock) {
  for (const memory kind : {memory::device, memory::shared}) {
    array<float> a(queue_, kind, {1, 2, 3});
    array<float> y(queue_, kind, {0, 0, 0});
    sycl::event event;
    {
      gate before(queue_);
      background launched([&] { return call(a, y, {before.event()}); });
      ASSERT_TRUE(launched.returns());
      event = launched.get();
      EXPECT_FALSE(is_complete(event));
      EXPECT_EQ(y.read(), (std::vector<float>{0, 0, 0}));
    }
    event.wait();
    EXPECT_EQ(y.read(), (std::vector<float>{3, 5, 7}));
  }
}

TEST_P(Ordering, HostOutputsBlock) {
  for (const memory kind : {memory::host, memory::plain}) {
    array<float> a(queue_, memory::device, {1, 2, 3});
    array<float> y(queue_, kind, {0, 0, 0});
    gate before(queue_);
    background launched([&] { return call(a, y, {before.event()}); });
    EXPECT_TRUE(launched.blocks());
    before.open();
    EXPECT_TRUE(is_complete(launched.get()));
    EXPECT_EQ(y.data()[0], 3);
    EXPECT_EQ(y.data()[2], 7);
  }
}

TEST_P(Ordering, AGlobalReportBlocks) {
  if (GetParam() == way::fast) return;
  array<float> a(queue_, memory::device, {1, 2, 3});
  array<float> y(queue_, memory::device, {0, 0, 0});
  gate before(queue_);
  background launched([&] { return call(a, y, {before.event()}, enums::global_status_report); });
  EXPECT_TRUE(launched.blocks());
  before.open();
  EXPECT_TRUE(is_complete(launched.get()));
  EXPECT_EQ(y.read(), (std::vector<float>{3, 5, 7}));
}

TEST_P(Ordering, EveryDependencyIsWaitedFor) {
  sycl::queue other = cpu_queue();
  array<float> a(queue_, memory::device, {0, 0, 0});
  array<float> b(queue_, memory::device, {0, 0, 0});
  array<float> y(queue_, memory::device, {0, 0, 0});
  gate first(queue_), second(queue_), third(other);
  const sycl::event filled = queue_.fill(a.data(), 5.0f, 3, first.event());
  const sycl::event event = call(a, y, {second.event(), filled, third.event()});
  third.open();
  second.open();
  other.wait();
  EXPECT_FALSE(is_complete(event));
  first.open();
  sycl::event(event).wait();
  EXPECT_EQ(y.read(), (std::vector<float>{11, 11, 11}));
}

TEST_P(Ordering, ACallMayDependOnACall) {
  array<float> a(queue_, memory::device, {1, 2, 3});
  array<float> b(queue_, memory::device, {0, 0, 0});
  array<float> y(queue_, memory::plain, {0, 0, 0});
  gate before(queue_);
  const sycl::event event = call(a, b, {before.event()});
  before.open();
  call(b, y, {event});
  EXPECT_EQ(y.read(), (std::vector<float>{7, 11, 15}));
}

TEST_P(Ordering, CallsWithoutDependenciesRunAtOnce) {
  array<float> a(queue_, memory::device, {1, 2, 3});
  array<float> y(queue_, memory::device, {0, 0, 0});
  const gate unrelated(queue_);
  call(a, y, {}).wait();
  EXPECT_EQ(y.read(), (std::vector<float>{3, 5, 7}));
}

TEST(RuntimeFailures, AKernelThatTheDeviceRefuses) {
  sycl::queue queue = gpu_queue_without_double();
  std::vector<float> a(3, 1.0f), y(3, 50.0f);
  sycl::buffer<float, 1> from{a}, to{sycl::range<1>(3)};
  auto linear = linear_call<shape::v11, float>(queue, 3, {a.data()}, {y.data()});
  auto strided =
      strided_call<shape::v11, float>(queue, {{a.data(), {0, 3, 1}}}, {{y.data(), {0, 3, 1}}});
  auto report = linear;
  report.mode = mode_with(enums::global_status_report);
  const auto buffers = buffer_call<shape::v11, float>(queue, 3, {&from}, {&to});
  const input::vxx* const records[] = {&linear, &strided, &report, &buffers};
  for (const input::vxx* record : records) {
    try {
      norvane::launcher<shape::v11, double_inside>(*record, {1});
      ADD_FAILURE() << "no exception";
    } catch (const sycl::exception& thrown) {
      EXPECT_EQ(thrown.code(), sycl::errc::kernel_not_supported);
    }
  }
  EXPECT_EQ(y, std::vector<float>(3, 50.0f));
  sycl::queue able = gpu_queue();
  linear.queue = &able;
  norvane::launcher<shape::v11, double_inside>(linear, {1});
  EXPECT_EQ(y, std::vector<float>(3, 3.0f));
}

TEST(RuntimeFailures, AKernelThatFails) {
  const sycl::device device = gpu_queue().get_device();
  int heard = 0;
  sycl::queue queue(device, [&heard](sycl::exception_list errors) {
    heard += static_cast<int>(errors.size());
    std::rethrow_exception(*errors.begin());
  });
  array<float> a(queue, memory::device, {1, 2, 3});
  auto record = linear_call<shape::v11, float>(queue, 3, {a}, {a});
  norvane::launcher<shape::v11, failing>(record, {1}).wait();
  EXPECT_EQ(heard, 0) << "the caller's to fetch";
  EXPECT_THROW(queue.wait_and_throw(), std::domain_error);
  EXPECT_EQ(heard, 1);

  record.mode = mode_with(enums::global_status_report);
  EXPECT_THROW((norvane::launcher<shape::v11, failing>(record, {1})), std::domain_error);
  EXPECT_EQ(heard, 2) << "a global report waits, and throws what the kernel raised";
}

TEST(RuntimeFailures, MemoryOfAnotherDevice) {
  // A device allocation of another context is none of this queue's, and so is treated as memory
  // of the host; the copy into it is the runtime's to refuse.
  sycl::queue queue = gpu_queue();
  sycl::queue other = gpu_queue_without_double();
  if (other.get_context() == queue.get_context()) other = cpu_queue();
  array<float> foreign(other, memory::device, {1, 2, 3});
  array<float> y(queue, memory::device, {0, 0, 0});
  EXPECT_THROW(run(linear_call<shape::v11, float>(queue, 3, {foreign}, {y})), sycl::exception);
  queue.wait_and_throw();
  EXPECT_EQ(y.read(), (std::vector<float>{0, 0, 0}));
}

}  // namespace
