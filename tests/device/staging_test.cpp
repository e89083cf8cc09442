// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include <unistd.h>
#include <cstdint>
#include <fstream>
#include <memory>
#include <numeric>

#include "arbor/lumen/exception.hpp"
#include "device/usm_wrapper.hpp"
#include "functors.hpp"
#include "gate.hpp"
#include "memory.hpp"
#include "queues.hpp"
#include "recorded_kernels.hpp"
#include "records.hpp"
#include "sycl/detail/testing.hpp"

namespace {

using namespace arbor::lumen::tests;
using arbor::lumen::vm::detail::device::usm_wrapper;
using sycl::detail::testing::fail_next_allocations;

constexpr const char* no_memory =
    "arbor::lumen::VM::core::usm_wrapper: invalid argument: nullptr on device malloc";

std::vector<float> numbers(std::size_t count, float first) {
  std::vector<float> values(count);
  std::iota(values.begin(), values.end(), first);
  return values;
}

/// A v21 call whose submission records the pointers that a kernel would get.
class Staging : public ::testing::TestWithParam<memory> {
 public:
  using kernels = recorded_kernels<shape::v21, float>;
  Staging() { kernels::reset(); }

 protected:
  sycl::queue queue_ = gpu_queue();
};

INSTANTIATE_TEST_SUITE_P(Memories, Staging, ::testing::ValuesIn(all_memories),
                         [](const auto& tested) { return name_of(tested.param); });

TEST_P(Staging, OnlyHostMemoryIsReplaced) {
  array<float> a(queue_, GetParam(), numbers(5, 10));
  array<float> b(queue_, GetParam(), numbers(5, 20));
  array<float> y(queue_, GetParam(), numbers(5, 30));
  kernels::act = [&] {
    const auto& [in, constants, out] = kernels::args;
    EXPECT_EQ(in[0] == a.data(), !is_staged(GetParam()));
    EXPECT_EQ(in[1] == b.data(), !is_staged(GetParam()));
    EXPECT_EQ(out[0] == y.data(), !is_staged(GetParam()));
    for (const float* given : {in[0], in[1], static_cast<const float*>(out[0])}) {
      const sycl::usm::alloc kind = pointer_type(given, queue_);
      EXPECT_TRUE(kind == sycl::usm::alloc::device || kind == sycl::usm::alloc::shared);
    }
    std::vector<float> seen(15);
    for (int i = 0; i < 3; ++i) {
      const float* from = i < 2 ? in[static_cast<std::size_t>(i)] : out[0];
      queue_.memcpy(seen.data() + 5 * i, from, 5 * sizeof(float)).wait();
    }
    EXPECT_EQ(seen[0], 10);
    EXPECT_EQ(seen[9], 24);
    EXPECT_EQ(seen[10], 30) << "outputs are copied in as well";
    return sycl::event();
  };
  kernels::launch(linear_call<shape::v21, float>(queue_, 5, {a, b}, {y}));
  EXPECT_EQ(kernels::path, "fast");
  if (is_staged(GetParam())) {
    for (const float* copy : kernels::args.in)
      EXPECT_EQ(pointer_type(copy, queue_), sycl::usm::alloc::unknown) << "not freed";
    EXPECT_EQ(pointer_type(kernels::args.out[0], queue_), sycl::usm::alloc::unknown);
  }
}

TEST_P(Staging, OnlyOutputsAreCopiedBack) {
  array<float> a(queue_, GetParam(), numbers(5, 10));
  array<float> b(queue_, GetParam(), numbers(5, 20));
  array<float> y(queue_, GetParam(), numbers(7, 30));
  kernels::act = [&] {
    const auto& [in, constants, out] = kernels::args;
    if (is_staged(GetParam())) {
      // Scribbles over the copies of the inputs too.
      queue_.fill(const_cast<float*>(in[0]), -1.0f, 5).wait();
      queue_.fill(const_cast<float*>(in[1]), -1.0f, 5).wait();
    }
    return queue_.fill(out[0] + 1, -2.0f, 3);
  };
  kernels::launch(linear_call<shape::v21, float>(queue_, 5, {a, b}, {y}));
  queue_.wait();
  EXPECT_EQ(a.read(), numbers(5, 10));
  EXPECT_EQ(b.read(), numbers(5, 20));
  EXPECT_EQ(y.read(), (std::vector<float>{30, -2, -2, -2, 34, 35, 36}));
}

TEST_P(Staging, AnElementThatTheKernelDoesNotWriteKeepsItsValue) {
  // tag_v11 leaves the results of 6 and 13 unwritten.
  array<float> a(queue_, GetParam(), numbers(16, 0));
  array<float> y(queue_, GetParam(), std::vector<float>(16, -5));
  norvane::launcher<shape::v11, tag_v11<float>>(
      linear_call<shape::v11, float>(queue_, 16, {a}, {y}), {1})
      .wait();
  for (std::size_t i = 0; const float value : y.read()) {
    EXPECT_EQ(value, i == 6 || i == 13 ? -5.0f : 2.0f * static_cast<float>(i) + 1);
    ++i;
  }
}

TEST_P(Staging, TheStatusArrayIsWrappedOnEveryPath) {
  array<float> a(queue_, memory::device, numbers(4, 1));
  array<float> y(queue_, memory::device, numbers(4, 1));
  for (const bool enabled : {false, true}) {
    array<enums::status> status(queue_, GetParam(), 3, enums::accuracy_warning);
    auto record = linear_call<shape::v21, float>(queue_, 4, {a, a}, {y});
    record.handler.enabled = enabled;
    record.handler.status_array = status;
    record.handler.length = 3;
    kernels::act = [&] {
      if (enabled) {
        EXPECT_EQ(kernels::storage == status.data(), !is_staged(GetParam()));
        queue_.fill(kernels::storage + 1, enums::sing, 1).wait();
      }
      // What the caller's memory gets meanwhile, the copy-back overwrites.
      queue_.fill(status.data() + 2, enums::errdom, 1).wait();
      return sycl::event();
    };
    kernels::launch(record);
    EXPECT_EQ(kernels::path, enabled ? "strided" : "fast");
    const enums::status middle = enabled ? enums::sing : enums::accuracy_warning;
    const enums::status last = is_staged(GetParam()) ? enums::accuracy_warning : enums::errdom;
    EXPECT_EQ(status.read(), (std::vector<enums::status>{enums::accuracy_warning, middle, last}));
    if (enabled && is_staged(GetParam())) {
      EXPECT_EQ(pointer_type(kernels::storage, queue_), sycl::usm::alloc::unknown);
    }
  }
}

TEST_P(Staging, ACountOfZeroReachesTheKernel) {
  array<float> a(queue_, GetParam(), numbers(3, 1));
  array<float> y(queue_, GetParam(), numbers(3, 5));
  array<enums::status> status(queue_, GetParam(), 3, enums::sing);
  for (const bool enabled : {false, true}) {
    auto record = linear_call<shape::v21, float>(queue_, 0, {a, a}, {y});
    record.handler.enabled = enabled;
    record.handler.status_array = status;
    kernels::launch(record);
    EXPECT_EQ(kernels::path, enabled ? "strided" : "fast");
    EXPECT_EQ(kernels::count, 0);
    norvane::launcher<shape::v21, tag_v21<float>>(record, {1}).wait();
  }
  EXPECT_EQ(y.read(), numbers(3, 5));
  EXPECT_EQ(status.read(), std::vector<enums::status>(3, enums::sing));
}

class StagingOfHostMemory : public Staging {};
INSTANTIATE_TEST_SUITE_P(Memories, StagingOfHostMemory,
                         ::testing::Values(memory::host, memory::plain),
                         [](const auto& tested) { return name_of(tested.param); });

TEST_P(StagingOfHostMemory, ASecondAttemptServesWhereTheFirstFails) {
  array<float> a(queue_, GetParam(), numbers(5, 0));
  array<float> y(queue_, GetParam(), numbers(5, 0));
  fail_next_allocations(sycl::usm::alloc::device, 1);
  norvane::launcher<shape::v11, tag_v11<float>>(linear_call<shape::v11, float>(queue_, 5, {a}, {y}),
                                                {1});
  EXPECT_EQ(y.read(), (std::vector<float>{1, 3, 5, 7, 9}));
}

TEST_P(StagingOfHostMemory, WithoutMemoryTheCallFailsAndTouchesNothing) {
  array<float> a(queue_, GetParam(), numbers(5, 0));
  array<float> y(queue_, GetParam(), numbers(5, 50));
  for (const std::int64_t n : {5, 0}) {
    fail_next_allocations(sycl::usm::alloc::device, 2);
    EXPECT_EQ(message_of<arbor::lumen::invalid_argument>([&] {
                kernels::launch(linear_call<shape::v21, float>(queue_, n, {a, a}, {y}));
              }),
              no_memory);
    EXPECT_EQ(kernels::path, "none");
  }
  EXPECT_EQ(y.read(), numbers(5, 50));
}

TEST_P(StagingOfHostMemory, AStatusArrayWithoutMemoryFailsTheCall) {
  array<float> a(queue_, memory::device, numbers(5, 0));
  array<float> y(queue_, memory::device, numbers(5, 50));
  array<enums::status> status(queue_, GetParam(), 5, enums::sing);
  for (const bool enabled : {false, true}) {
    auto record = linear_call<shape::v21, float>(queue_, 5, {a, a}, {y});
    record.handler.enabled = enabled;
    record.handler.status_array = status;
    record.handler.length = 5;
    fail_next_allocations(sycl::usm::alloc::device, 2);
    EXPECT_EQ(message_of<arbor::lumen::invalid_argument>([&] { kernels::launch(record); }),
              no_memory);
    EXPECT_EQ(kernels::path, "none");
  }
  EXPECT_EQ(status.read(), std::vector<enums::status>(5, enums::sing));
}

TEST_P(StagingOfHostMemory, CopiesAboveAPageStartOnOne) {
  constexpr std::size_t copies = 16;
  std::size_t on_a_page = 0;
  for (const std::size_t count : {1024u, 1025u}) {
    array<float> values(queue_, GetParam(), numbers(count, 0));
    usm_wrapper<float> wrappers[copies];
    on_a_page = 0;
    for (auto& wrapper : wrappers) {
      const float* copy =
          wrapper.wrap(queue_, values.data(), static_cast<std::int64_t>(count), false);
      EXPECT_EQ(reinterpret_cast<std::uintptr_t>(copy) % 8, 0u);
      if (reinterpret_cast<std::uintptr_t>(copy) % 4096 == 0) ++on_a_page;
    }
#if !defined(__SANITIZE_THREAD__)  // its allocator puts 4096 bytes on a page by itself
    if (count == 1024) {
      EXPECT_LT(on_a_page, copies) << "4096 bytes need no page";
    }
#endif
  }
  EXPECT_EQ(on_a_page, copies);
}

TEST_P(StagingOfHostMemory, ASizeThatOverflowsIsNoMemory) {
  array<float> values(queue_, GetParam(), numbers(2, 0));
  for (const std::int64_t count : {INT64_MAX, INT64_MAX / 4, (INT64_MAX / 4 + 1) * 2, INT64_MIN}) {
    EXPECT_EQ(message_of<arbor::lumen::invalid_argument>([&] {
                usm_wrapper<float> wrapper;
                wrapper.wrap(queue_, values.data(), count, true);
              }),
              no_memory)
        << count;
  }
  EXPECT_EQ(values.read(), numbers(2, 0));
}

TEST(StagingOrder, NullStaysNull) {
  sycl::queue queue = gpu_queue();
  using kernels = recorded_kernels<shape::v21, float>;
  kernels::reset();
  fail_next_allocations(sycl::usm::alloc::device, 1);
  kernels::launch(linear_call<shape::v21, float>(queue, 5, {nullptr, nullptr}, {nullptr}));
  fail_next_allocations(sycl::usm::alloc::device, 0);
  EXPECT_EQ(kernels::path, "fast");
  EXPECT_EQ(kernels::args.in[0], nullptr);
  EXPECT_EQ(kernels::args.in[1], nullptr);
  EXPECT_EQ(kernels::args.out[0], nullptr);
}

TEST(StagingOrder, CopiesLiveUntilTheKernelHasEnded) {
  sycl::queue queue = gpu_queue();
  using kernels = recorded_kernels<shape::v21, float>;
  for (const bool handler : {false, true}) {
    kernels::reset();
    gate kernel(queue);
    std::promise<void> submitted;
    kernels::act = [&] {
      submitted.set_value();
      return kernel.event();
    };
    std::vector<float> a = numbers(5, 0), b = numbers(5, 10), y = numbers(5, 20);
    std::vector<enums::status> status(5);
    auto record = linear_call<shape::v21, float>(queue, 5, {a.data(), b.data()}, {y.data()});
    record.handler.enabled = handler;
    if (handler) {
      record.handler.status_array = status.data();
      record.handler.length = 5;
    }
    background call([&] { return kernels::launch(record); });
    submitted.get_future().wait();
    EXPECT_TRUE(call.blocks());
    std::vector<const void*> copies{kernels::args.in[0], kernels::args.in[1], kernels::args.out[0]};
    if (handler) copies.push_back(kernels::storage);
    for (const void* copy : copies) EXPECT_EQ(pointer_type(copy, queue), sycl::usm::alloc::device);
    kernel.open();
    call.get();
    for (const void* copy : copies) EXPECT_EQ(pointer_type(copy, queue), sycl::usm::alloc::unknown);
  }
}

TEST(StagingOrder, OutputsComeBackAfterTheStatusArray) {
  // Status and output share memory, so that the contents tell which was copied back last.
  sycl::queue queue = gpu_queue();
  using kernels = recorded_kernels<shape::v11, float>;
  kernels::reset();
  std::vector<float> y(2, 1.5f);
  auto record = linear_call<shape::v11, float>(queue, 2, {y.data()}, {y.data()});
  record.handler.enabled = true;
  record.handler.status_array = reinterpret_cast<enums::status*>(y.data());
  record.handler.length = 2;
  kernels::act = [&] {
    queue.fill(kernels::storage, enums::overflow, 2).wait();
    return queue.fill(kernels::args.out[0], 8.0f, 2);
  };
  kernels::launch(record);
  EXPECT_EQ(y, std::vector<float>(2, 8.0f));
}

TEST(StagingOrder, HostInputsServeAKernelWithDeviceOutput) {
  // Nothing waits for the kernel here: the copies of the inputs outlive the call.
  sycl::queue queue = gpu_queue();
  array<float> y(queue, memory::device, 1000, 0.0f);
  sycl::event event;
  {
    gate before(queue);
    const std::vector<float> a = numbers(1000, 0), b(1000, 3);
    auto record = linear_call<shape::v21, float>(queue, 1000, {a.data(), b.data()}, {y});
    record.depends = {before.event()};
    background call([&] { return norvane::launcher<shape::v21, tag_v21<float>>(record, {1}); });
    ASSERT_TRUE(call.returns());
    event = call.get();
    EXPECT_FALSE(is_complete(event));
  }
  event.wait();
  for (int i = 0; const float value : y.read()) {
    EXPECT_EQ(value, i % 7 == 6 ? 0 : 1000 * i + 3);
    ++i;
  }
}

/// Pages of the process that are in memory.
std::int64_t resident_bytes() {
  std::ifstream file("/proc/self/statm");
  std::int64_t all = 0, resident = 0;
  file >> all >> resident;
  return resident * sysconf(_SC_PAGESIZE);
}

TEST(StagingOrder, FailingCallsLeakNothing) {
  sycl::queue queue = gpu_queue();
  const std::size_t size = 1 << 18;
  const std::vector<float> a = numbers(size, 0);
  std::vector<float> y = numbers(size, 7);
  std::vector<enums::status> status(2, enums::sing);
  auto record = linear_call<shape::v11, float>(queue, static_cast<std::int64_t>(size), {a.data()},
                                               {y.data()});
  // Input and output are staged before it turns out that there is no memory for this.
  record.handler.status_array = status.data();
  record.handler.length = std::int64_t{1} << 50;
  const std::int64_t before = resident_bytes();
  for (int i = 0; i < 600; ++i) {
    record.handler.enabled = i % 2 != 0;
    record.mode = i % 4 < 2 ? mode_with(0) : mode_with(enums::global_status_report);
    EXPECT_EQ(message_of<arbor::lumen::invalid_argument>(
                  [&] { norvane::launcher<shape::v11, tag_v11<float>>(record, {1}); }),
              no_memory);
  }
  // Leaked copies would be 1200 MiB; a sanitizer holds freed memory back, but less than half.
  EXPECT_LT(resident_bytes() - before, std::int64_t{600} << 20);
  EXPECT_EQ(y, numbers(size, 7));
  EXPECT_EQ(status[0], enums::sing);
}

}  // namespace
