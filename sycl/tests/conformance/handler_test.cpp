// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <cstdint>
#include <memory>
#include <numeric>
#include <type_traits>
#include <vector>

#include "support.hpp"

namespace {

using conformance::gate;
using conformance::is_complete;
using sycl::event;
using sycl::handler;
using sycl::id;
using sycl::item;
using sycl::range;

static_assert(!std::is_default_constructible_v<handler>);
static_assert(!std::is_copy_constructible_v<handler> && !std::is_copy_assignable_v<handler>);
static_assert(!std::is_move_constructible_v<handler> && !std::is_move_assignable_v<handler>);

class ConformanceHandler : public ::testing::Test {
 protected:
  void SetUp() override { data_ = sycl::malloc_shared<int>(count, q_); }
  void TearDown() override {
    q_.wait();
    sycl::free(data_, q_);
  }

  static constexpr std::size_t count = 60;
  sycl::queue q_;
  int* data_ = nullptr;
};

TEST_F(ConformanceHandler, KernelsTakeIdsItemsAndIntegers) {
  int* data = data_;
  q_.submit([&](handler& cgh) {
      cgh.parallel_for(range<1>(count), [=](id<1> i) { data[i] = 1; });
    }).wait();
  q_.submit([&](handler& cgh) {
      cgh.parallel_for(range<1>(count), [=](item<1> i) { data[i.get_id(0)] += 2; });
    }).wait();
  q_.submit([&](handler& cgh) {
      cgh.parallel_for(range<1>(count), [=](item<1, false> i) { data[i] += 4; });
    }).wait();
  q_.submit([&](handler& cgh) {
      cgh.parallel_for(range<1>(count), [=](std::size_t i) { data[i] += 8; });
    }).wait();
  q_.submit([&](handler& cgh) {
      cgh.parallel_for(range<1>(count), [=](auto i) { data[i] += 16; });
    }).wait();
  for (std::size_t i = 0; i < count; ++i) ASSERT_EQ(data[i], 31);
}

TEST_F(ConformanceHandler, EveryWorkItemRunsOnce) {
  int* data = data_;
  q_.fill(data, 0, count).wait();
  q_.submit([&](handler& cgh) {
      cgh.parallel_for(range<2>(6, 10), [=](item<2> i) {
        data[i[0] * 10 + i[1]] += static_cast<int>(i.get_linear_id()) + 1;
      });
    }).wait();
  q_.submit([&](handler& cgh) {
      cgh.parallel_for(range<3>(3, 4, 5),
                       [=](id<3> i) { data[(i[0] * 4 + i[1]) * 5 + i[2]] *= 2; });
    }).wait();
  q_.submit([&](handler& cgh) {
      cgh.parallel_for(range<3>(3, 4, 5), [=](auto i) {
        if (i.get_range() == range<3>(3, 4, 5)) data[i.get_linear_id()] += 1;
      });
    }).wait();
  for (std::size_t i = 0; i < count; ++i) ASSERT_EQ(data[i], 2 * (static_cast<int>(i) + 1) + 1);
}

TEST_F(ConformanceHandler, LargeRangesAreCoveredExactly) {
  constexpr std::size_t large = 1'000'003;
  auto* hits = sycl::malloc_shared<std::uint8_t>(large, q_);
  q_.memset(hits, 0, large).wait();
  q_.submit([&](handler& cgh) {
      cgh.parallel_for(range<1>(large), [=](id<1> i) { ++hits[i]; });
    }).wait();
  std::size_t once = 0;
  for (std::size_t i = 0; i < large; ++i) once += hits[i] == 1 ? 1 : 0;
  EXPECT_EQ(once, large);
  sycl::free(hits, q_);
}

TEST_F(ConformanceHandler, EmptyRangesRunNothing) {
  int* data = data_;
  data[0] = 5;
  event e =
      q_.submit([&](handler& cgh) { cgh.parallel_for(range<1>(0), [=](id<1>) { data[0] = 6; }); });
  e.wait();
  q_.submit([&](handler& cgh) {
      cgh.parallel_for(range<3>(4, 0, 4), [=](id<3>) { data[0] = 7; });
    }).wait();
  EXPECT_EQ(data[0], 5);
  EXPECT_TRUE(is_complete(e));
}

TEST_F(ConformanceHandler, GroupWithoutCommandCompletes) {
  gate closed(q_);
  event e = q_.submit([&](handler& cgh) { cgh.depends_on(closed.event()); });
  closed.open();
  e.wait();
  EXPECT_TRUE(is_complete(e));
}

TEST_F(ConformanceHandler, KernelsAreCopied) {
  // What a kernel captured by value does not change after the submission.
  int* data = data_;
  gate closed(q_);
  {
    std::vector<int> captured(3, 4);
    const auto shared = std::make_shared<int>(9);
    q_.submit([&](handler& cgh) {
      cgh.depends_on(closed.event());
      cgh.host_task([=] { data[0] = captured[2] + *shared; });
    });
    captured.assign(3, 0);
  }
  closed.open();
  q_.wait();
  EXPECT_EQ(data[0], 13);
}

TEST_F(ConformanceHandler, DependsOnOrdersCommands) {
  int* data = data_;
  data[0] = 0;
  gate closed(q_);
  const event first = q_.submit([&](handler& cgh) {
    cgh.depends_on(closed.event());
    cgh.single_task([=] { data[0] = 10; });
  });
  const event second = q_.submit([&](handler& cgh) {
    cgh.depends_on({first});
    cgh.single_task([=] { data[0] *= 3; });
  });
  sycl::queue other(q_.get_context(), q_.get_device());
  other.submit([&](handler& cgh) {
    cgh.depends_on(std::vector<event>{first, second, event()});
    cgh.single_task([=] { data[0] += 1; });
  });
  EXPECT_EQ(data[0], 0);
  closed.open();
  other.wait();
  EXPECT_EQ(data[0], 31);
}

TEST_F(ConformanceHandler, HostTasksKnowTheirQueue) {
  bool plain = false;
  bool with_handle = false;
  sycl::backend seen{};
  q_.submit([&](handler& cgh) { cgh.host_task([&] { plain = true; }); });
  q_.submit([&](handler& cgh) {
    cgh.host_task([&](sycl::interop_handle ih) {
      with_handle = true;
      seen = ih.get_backend();
    });
  });
  q_.wait();
  EXPECT_TRUE(plain && with_handle);
  EXPECT_EQ(seen, q_.get_backend());
}

TEST_F(ConformanceHandler, HostTasksMayUseTheRuntime) {
  int* data = data_;
  data[0] = 1;
  sycl::queue inner(q_.get_context(), q_.get_device());
  q_.submit([&](handler& cgh) {
      cgh.host_task([=]() mutable {
        inner.single_task([=] { data[0] += 1; }).wait();
        data[0] *= 10;
      });
    }).wait();
  EXPECT_EQ(data[0], 20);
}

TEST_F(ConformanceHandler, ManyBlockedHostTasksDoNotStopKernels) {
  std::vector<std::unique_ptr<gate>> gates;
  for (int i = 0; i < 16; ++i) gates.push_back(std::make_unique<gate>(q_));
  int* data = data_;
  q_.single_task([=] { data[0] = 77; }).wait();
  EXPECT_EQ(data[0], 77);
  gates.clear();
}

TEST_F(ConformanceHandler, MemoryOperations) {
  int* data = data_;
  std::vector<int> host(count);
  std::iota(host.begin(), host.end(), 0);
  q_.submit([&](handler& cgh) { cgh.memcpy(data, host.data(), count * sizeof(int)); }).wait();
  EXPECT_EQ(std::vector<int>(data, data + count), host);
  q_.submit([&](handler& cgh) { cgh.memset(data, 0xFF, 4 * sizeof(int)); }).wait();
  for (std::size_t i = 0; i < count; ++i) {
    EXPECT_EQ(data[i], i < 4 ? -1 : static_cast<int>(i));
  }
  q_.submit([&](handler& cgh) { cgh.fill(data + 1, 42, 3); }).wait();
  EXPECT_EQ(data[0], -1);
  EXPECT_EQ(data[1], 42);
  EXPECT_EQ(data[3], 42);
  EXPECT_EQ(data[4], 4);
  std::vector<int> out(5);
  q_.submit([&](handler& cgh) { cgh.copy(data, out.data(), 5); }).wait();
  EXPECT_EQ(out, (std::vector<int>{-1, 42, 42, 42, 4}));
  q_.submit([&](handler& cgh) { cgh.prefetch(data, count * sizeof(int)); }).wait();
  q_.submit([&](handler& cgh) { cgh.mem_advise(data, count * sizeof(int), 0); }).wait();
}

struct triple {
  double a;
  int b;
  char c;
};

TEST_F(ConformanceHandler, FillsWithStructures) {
  auto* memory = sycl::malloc_shared<triple>(17, q_);
  q_.submit([&](handler& cgh) { cgh.fill(memory, triple{0.5, 3, 'x'}, 17); }).wait();
  for (int i = 0; i < 17; ++i) {
    EXPECT_EQ(memory[i].a, 0.5);
    EXPECT_EQ(memory[i].b, 3);
    EXPECT_EQ(memory[i].c, 'x');
  }
  sycl::free(memory, q_);
}

TEST_F(ConformanceHandler, ExplicitOperationsOnAccessors) {
  std::vector<int> data(12);
  std::iota(data.begin(), data.end(), 0);
  sycl::buffer<int, 2> buf(data.data(), range<2>(3, 4));
  sycl::buffer<int> line(range<1>(4));
  std::vector<int> out(4, -1);
  const std::shared_ptr<int[]> shared(new int[4]());
  q_.submit([&](handler& cgh) {
    const sycl::accessor from(buf, cgh, range<2>(2, 2), id<2>(1, 1), sycl::read_only);
    const sycl::accessor to(line, cgh, sycl::write_only);
    cgh.copy(from, to);
  });
  q_.submit(
      [&](handler& cgh) { cgh.copy(sycl::accessor(line, cgh, sycl::read_only), out.data()); });
  q_.submit([&](handler& cgh) {
    cgh.copy(sycl::accessor(line, cgh, range<1>(2), id<1>(2), sycl::read_only), shared);
  });
  q_.wait();
  EXPECT_EQ(out, (std::vector<int>{5, 6, 9, 10}));
  EXPECT_EQ(shared[0], 9);
  EXPECT_EQ(shared[1], 10);
  EXPECT_EQ(shared[2], 0);

  const std::vector<int> source = {100, 101};
  const std::shared_ptr<const int[]> shared_source(new int[2]{200, 201});
  q_.submit([&](handler& cgh) {
    cgh.copy(source.data(), sycl::accessor(line, cgh, range<1>(2), id<1>(0), sycl::write_only));
  });
  q_.submit([&](handler& cgh) {
    cgh.copy(shared_source, sycl::accessor(line, cgh, range<1>(2), id<1>(2), sycl::write_only));
  });
  q_.submit([&](handler& cgh) {
      cgh.copy(sycl::accessor(line, cgh, sycl::read_only), out.data());
    }).wait();
  EXPECT_EQ(out, (std::vector<int>{100, 101, 200, 201}));

  q_.submit([&](handler& cgh) {
    cgh.fill(sycl::accessor(buf, cgh, range<2>(1, 2), id<2>(0, 2), sycl::write_only), -5);
  });
  q_.submit([&](handler& cgh) {
      cgh.update_host(sycl::accessor(buf, cgh, sycl::read_only));
    }).wait();
  EXPECT_EQ(data, (std::vector<int>{0, 1, -5, -5, 4, 5, 6, 7, 8, 9, 10, 11}));
}

/// A function object whose call operator is const, as kernels' must be.
struct scale {
  int* data;
  int factor;
  void operator()(item<1> i) const { data[i.get_linear_id()] *= factor; }
};

TEST_F(ConformanceHandler, FunctionObjectsAreKernels) {
  q_.fill(data_, 3, count).wait();
  q_.submit([&](handler& cgh) { cgh.parallel_for(range<1>(count), scale{data_, 5}); }).wait();
  for (std::size_t i = 0; i < count; ++i) ASSERT_EQ(data_[i], 15);
}

TEST_F(ConformanceHandler, SubmissionDoesNotBlock) {
  gate closed(q_);
  std::vector<event> events;
  int* data = data_;
  data[0] = 0;
  for (int i = 0; i < 1000; ++i) {
    const event before = events.empty() ? closed.event() : events.back();
    events.push_back(q_.single_task(before, [=] { data[0] += 1; }));
  }
  EXPECT_EQ(data[0], 0);
  closed.open();
  events.back().wait();
  EXPECT_EQ(data[0], 1000);
}

}  // namespace
