// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <atomic>
#include <numeric>
#include <stdexcept>
#include <thread>
#include <type_traits>
#include <vector>

#include "support.hpp"

namespace {

using conformance::gate;
using conformance::is_complete;
using conformance::throws;
using sycl::context;
using sycl::device;
using sycl::errc;
using sycl::event;
using sycl::property_list;
using sycl::queue;
namespace info = sycl::info;
namespace property = sycl::property;

static_assert(conformance::has_reference_semantics<queue>);
static_assert(std::is_default_constructible_v<queue>);

int accept_any(const device&) { return 1; }
int refuse(const device&) { return -1; }
using selector = int (*)(const device&);
using handler = sycl::async_handler;
static_assert(std::is_constructible_v<queue, property_list>);
static_assert(std::is_constructible_v<queue, handler, property_list>);
static_assert(std::is_constructible_v<queue, selector, property_list>);
static_assert(std::is_constructible_v<queue, selector, handler, property_list>);
static_assert(std::is_constructible_v<queue, device, property_list>);
static_assert(std::is_constructible_v<queue, device, handler, property_list>);
static_assert(std::is_constructible_v<queue, context, selector, property_list>);
static_assert(std::is_constructible_v<queue, context, selector, handler, property_list>);
static_assert(std::is_constructible_v<queue, context, device, property_list>);
static_assert(std::is_constructible_v<queue, context, device, handler, property_list>);
static_assert(!std::is_convertible_v<device, queue>);
static_assert(!std::is_convertible_v<selector, queue>);
static_assert(!std::is_convertible_v<property_list, queue>);
static_assert(!std::is_convertible_v<handler, queue>);
static_assert(noexcept(std::declval<const queue&>().get_backend()));
static_assert(noexcept(std::declval<const queue&>().has_property<property::queue::in_order>()));
static_assert(sycl::is_property_of_v<property::queue::in_order, queue>);
static_assert(sycl::is_property_of_v<property::queue::enable_profiling, queue>);
static_assert(!sycl::is_property_of_v<property::buffer::use_host_ptr, queue>);
static_assert(std::is_same_v<info::queue::context::return_type, context>);
static_assert(std::is_same_v<info::queue::device::return_type, device>);

TEST(ConformanceQueue, ReferenceSemantics) {
  conformance::expect_reference_semantics(queue(), queue());
  const device dev;
  const context ctx(dev);
  conformance::expect_reference_semantics(queue(ctx, dev), queue(ctx, dev));
}

TEST(ConformanceQueue, KnowsDeviceAndContext) {
  EXPECT_EQ(queue().get_device(), device());
  for (const device& dev : device::get_devices()) {
    const queue q(dev);
    EXPECT_EQ(q.get_device(), dev);
    EXPECT_EQ(q.get_info<info::queue::device>(), dev);
    EXPECT_EQ(q.get_info<info::queue::context>(), q.get_context());
    EXPECT_EQ(q.get_backend(), dev.get_backend());
    const std::vector<device> devices = q.get_context().get_devices();
    EXPECT_NE(std::find(devices.begin(), devices.end(), dev), devices.end());
    const context ctx(dev);
    EXPECT_EQ(queue(ctx, dev).get_context(), ctx);
    EXPECT_EQ(queue(ctx, [&](const device& d) { return d == dev ? 1 : -1; }).get_device(), dev);
  }
  EXPECT_EQ(queue(sycl::default_selector_v).get_device(), device());
  EXPECT_NO_THROW(queue{accept_any});
  EXPECT_TRUE(throws(errc::runtime, [] { queue{refuse}; }));
}

TEST(ConformanceQueue, DeviceMustBelongToTheContext) {
  const std::vector<device> devices = device::get_devices();
  for (std::size_t i = 1; i < devices.size(); ++i) {
    const context ctx(devices[0]);
    EXPECT_TRUE(throws(errc::invalid, [&] { queue(ctx, devices[i]); }));
    EXPECT_TRUE(throws(errc::invalid, [&] {
      queue(ctx, [&](const device& d) { return d == devices[i] ? 1 : -1; });
    }));
  }
}

TEST(ConformanceQueue, Properties) {
  const queue plain;
  EXPECT_FALSE(plain.is_in_order());
  EXPECT_FALSE(plain.has_property<property::queue::in_order>());
  EXPECT_TRUE(throws(errc::invalid, [&] { plain.get_property<property::queue::in_order>(); }));
  const queue ordered{property::queue::in_order()};
  EXPECT_TRUE(ordered.is_in_order());
  EXPECT_TRUE(ordered.has_property<property::queue::in_order>());
  EXPECT_FALSE(ordered.has_property<property::queue::enable_profiling>());
  EXPECT_NO_THROW(ordered.get_property<property::queue::in_order>());
  const queue both{{property::queue::enable_profiling(), property::queue::in_order()}};
  EXPECT_TRUE(both.has_property<property::queue::enable_profiling>());
  EXPECT_TRUE(both.has_property<property::queue::in_order>());
}

TEST(ConformanceQueue, InOrderQueueKeepsTheOrder) {
  queue q{property::queue::in_order()};
  std::vector<int> order;
  for (int i = 0; i < 200; ++i) {
    q.submit([&, i](sycl::handler& cgh) { cgh.host_task([&order, i] { order.push_back(i); }); });
  }
  q.wait();
  std::vector<int> expected(200);
  std::iota(expected.begin(), expected.end(), 0);
  EXPECT_EQ(order, expected);
}

TEST(ConformanceQueue, InOrderQueueMixesKernelsAndHostTasks) {
  queue q{property::queue::in_order()};
  int* value = sycl::malloc_shared<int>(1, q);
  *value = 0;
  for (int i = 0; i < 50; ++i) {
    q.single_task([=] { *value = *value * 2 + 1; });
    q.submit([&](sycl::handler& cgh) { cgh.host_task([=] { *value %= 1000; }); });
  }
  q.wait();
  int expected = 0;
  for (int i = 0; i < 50; ++i) expected = (expected * 2 + 1) % 1000;
  EXPECT_EQ(*value, expected);
  sycl::free(value, q);
}

TEST(ConformanceQueue, OutOfOrderQueueDoesNotWaitForTheUnrelated) {
  queue q;
  gate closed(q);
  event other = q.single_task([] {});
  other.wait();
  EXPECT_TRUE(is_complete(other));
  EXPECT_FALSE(is_complete(closed.event()));
  closed.open();
  q.wait();
}

TEST(ConformanceQueue, WaitWaitsForEverything) {
  queue q;
  std::atomic<int> done = 0;
  for (int i = 0; i < 100; ++i) {
    q.submit([&](sycl::handler& cgh) { cgh.host_task([&] { ++done; }); });
  }
  q.wait();
  EXPECT_EQ(done.load(), 100);
}

TEST(ConformanceQueue, SubmitReturnsTheCommandsEvent) {
  queue q;
  gate closed(q);
  event e = q.submit([&](sycl::handler& cgh) {
    cgh.depends_on(closed.event());
    cgh.single_task([] {});
  });
  EXPECT_FALSE(is_complete(e));
  EXPECT_EQ(e.get_backend(), q.get_backend());
  closed.open();
  e.wait();
  EXPECT_TRUE(is_complete(e));
}

TEST(ConformanceQueue, CommandGroupsRunInTheCallingThread) {
  queue q;
  bool ran = false;
  q.submit([&](sycl::handler&) { ran = true; }).wait();
  EXPECT_TRUE(ran);
}

TEST(ConformanceQueue, ExceptionsOfCommandGroupsAreSynchronous) {
  queue q;
  EXPECT_THROW(q.submit([](sycl::handler&) { throw std::runtime_error("from the group"); }),
               std::runtime_error);
  EXPECT_TRUE(throws(errc::nd_range, [&] {
    q.submit([](sycl::handler&) { throw sycl::exception(errc::nd_range, "x"); });
  }));
  q.wait_and_throw();
}

TEST(ConformanceQueue, ShortcutsOfKernels) {
  queue q;
  int* data = sycl::malloc_shared<int>(24, q);
  const event first =
      q.parallel_for(sycl::range<1>(24), [=](sycl::id<1> i) { data[i] = static_cast<int>(i[0]); });
  const event second = q.parallel_for(sycl::range<2>(4, 6), first,
                                      [=](sycl::item<2> i) { data[i.get_linear_id()] += 100; });
  const event third = q.parallel_for(sycl::range<3>(2, 3, 4), std::vector<event>{first, second},
                                     [=](sycl::item<3> i) { data[i.get_linear_id()] *= 2; });
  const event fourth = q.single_task(third, [=] { data[0] = -1; });
  q.single_task(std::vector<event>{fourth}, [=] { data[1] = data[0]; }).wait();
  EXPECT_EQ(data[0], -1);
  EXPECT_EQ(data[1], -1);
  for (int i = 2; i < 24; ++i) EXPECT_EQ(data[i], 2 * (i + 100));
  sycl::free(data, q);
}

class named_kernel;

TEST(ConformanceQueue, KernelsMayBeNamed) {
  queue q;
  int* value = sycl::malloc_shared<int>(1, q);
  q.single_task<named_kernel>([=] { *value = 1; }).wait();
  EXPECT_EQ(*value, 1);
  q.parallel_for<class other_named_kernel>(sycl::range<1>(1), [=](sycl::id<1>) {
     *value = 2;
   }).wait();
  EXPECT_EQ(*value, 2);
  sycl::free(value, q);
}

TEST(ConformanceQueue, ShortcutsOfMemoryOperations) {
  queue q;
  int* a = sycl::malloc_device<int>(64, q);
  int* b = sycl::malloc_device<int>(64, q);
  std::vector<int> host(64);
  const event filled = q.fill(a, 7, 64);
  const event copied = q.memcpy(b, a, 64 * sizeof(int), filled);
  const event zeroed = q.memset(b, 0, 32 * sizeof(int), std::vector<event>{copied});
  q.prefetch(b, 64 * sizeof(int), zeroed).wait();
  q.mem_advise(b, 64 * sizeof(int), 0, zeroed).wait();
  q.copy(b, host.data(), 64, zeroed).wait();
  for (std::size_t i = 0; i < 64; ++i) EXPECT_EQ(host[i], i < 32 ? 0 : 7);
  q.fill(a, 3, 64, std::vector<event>{zeroed}).wait();
  q.copy(a, host.data(), 64).wait();
  EXPECT_EQ(host, std::vector<int>(64, 3));
  sycl::free(a, q);
  sycl::free(b, q);
}

TEST(ConformanceQueue, ShortcutsOfAccessors) {
  queue q;
  std::vector<int> data(16, 1);
  std::vector<int> out(16, 0);
  sycl::buffer<int, 1> buf(data.data(), sycl::range<1>(16));
  sycl::buffer<int, 1> other(sycl::range<1>(16));
  const sycl::accessor all(buf);
  const sycl::accessor others(other);
  q.fill(all, 4).wait();
  q.copy(all, others).wait();
  q.copy(others, out.data()).wait();
  EXPECT_EQ(out, std::vector<int>(16, 4));
  const std::vector<int> source(16, 9);
  q.copy(source.data(), all).wait();
  q.update_host(all).wait();
  EXPECT_EQ(data, std::vector<int>(16, 9));
}

TEST(ConformanceQueue, UnhandledAsynchronousErrorsTerminate) {
  ::testing::FLAGS_gtest_death_test_style = "threadsafe";
  EXPECT_DEATH(
      {
        queue q;
        q.submit([](sycl::handler& cgh) {
          cgh.host_task([] { throw sycl::exception(errc::runtime, "unhandled"); });
        });
        q.wait_and_throw();
      },
      "");
}

TEST(ConformanceQueue, SecondaryQueueTakesWhatTheFirstRefuses) {
  queue first;
  queue second;
  int attempts = 0;
  int value = 0;
  first
      .submit(
          [&](sycl::handler& cgh) {
            if (++attempts == 1) throw sycl::exception(errc::feature_not_supported, "not here");
            cgh.host_task([&] { value = 3; });
          },
          second)
      .wait();
  EXPECT_EQ(attempts, 2);
  EXPECT_EQ(value, 3);
}

TEST(ConformanceQueue, ThreadsMaySubmitTogether) {
  queue q;
  std::atomic<int> done = 0;
  {
    std::vector<std::jthread> threads;
    for (int t = 0; t < 4; ++t) {
      threads.emplace_back([&] {
        for (int i = 0; i < 100; ++i) {
          q.submit([&](sycl::handler& cgh) { cgh.host_task([&] { ++done; }); });
        }
      });
    }
  }
  q.wait();
  EXPECT_EQ(done.load(), 400);
}

}  // namespace
