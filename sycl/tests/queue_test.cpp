// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <atomic>
#include <vector>

#include <gtest/gtest.h>
#include <sycl/sycl.hpp>

namespace {

using sycl::property::queue::enable_profiling;
using sycl::property::queue::in_order;

static_assert(sycl::is_property_v<in_order>);
static_assert(sycl::is_property_of_v<in_order, sycl::queue>);
static_assert(sycl::is_property_of_v<enable_profiling, sycl::queue>);
static_assert(!sycl::is_property_of_v<sycl::property::buffer::use_host_ptr, sycl::queue>);
static_assert(!sycl::is_property_v<int>);
static_assert(!std::is_convertible_v<sycl::device, sycl::queue>);

TEST(Queue, HasAllConstructors) {
  const sycl::device dev;
  const sycl::context ctx(dev);
  const sycl::async_handler handler = [](const sycl::exception_list&) {};
  const auto custom = [](const sycl::device&) { return 1; };
  const std::vector<sycl::queue> all{
      sycl::queue(),
      sycl::queue(in_order()),
      sycl::queue(handler),
      sycl::queue(handler, {in_order()}),
      sycl::queue(sycl::default_selector_v),
      sycl::queue(sycl::cpu_selector_v, {in_order()}),
      sycl::queue(custom, handler),
      sycl::queue(dev),
      sycl::queue(dev, {in_order(), enable_profiling()}),
      sycl::queue(dev, handler),
      sycl::queue(ctx, sycl::default_selector_v),
      sycl::queue(ctx, custom, handler),
      sycl::queue(ctx, dev),
      sycl::queue(ctx, dev, {in_order()}),
      sycl::queue(ctx, dev, handler, {in_order()}),
  };
  for (sycl::queue q : all) {
    EXPECT_EQ(q.get_device(), dev);
    EXPECT_EQ(q.get_info<sycl::info::queue::device>(), dev);
    EXPECT_EQ(q.get_info<sycl::info::queue::context>(), q.get_context());
    EXPECT_EQ(q.get_backend(), dev.get_backend());
    EXPECT_EQ(q.is_in_order(), q.has_property<in_order>());
    std::atomic<int> ran{0};
    std::atomic<int>* const p = &ran;
    q.single_task([=] { ++*p; });
    q.wait_and_throw();
    EXPECT_EQ(ran, 1);
  }
  EXPECT_EQ(all.back().get_context(), ctx);
  EXPECT_TRUE(all[8].has_property<enable_profiling>());
  EXPECT_NO_THROW(all[8].get_property<enable_profiling>());
}

TEST(Queue, LacksPropertiesItWasNotGiven) {
  const sycl::queue q;
  EXPECT_FALSE(q.has_property<in_order>());
  try {
    q.get_property<in_order>();
    FAIL();
  } catch (const sycl::exception& e) {
    EXPECT_EQ(e.code(), sycl::errc::invalid);
  }
}

TEST(Queue, ShortcutsTakeOneDependencyOrSeveral) {
  sycl::queue q;
  int* const p = sycl::malloc_shared<int>(4, q);
  sycl::event e = q.fill(p, 1, 4);
  e = q.memset(p, 0, 4, e);
  e = q.parallel_for(4, e, [=](sycl::id<1> i) { p[i] += 1; });
  e = q.parallel_for({2, 2}, {e}, [=](sycl::id<2> i) { p[2 * i[0] + i[1]] *= 3; });
  e = q.parallel_for({1, 2, 2}, std::vector{e}, [=](sycl::id<3> i) { p[2 * i[1] + i[2]] += 1; });
  e = q.memcpy(p + 2, p, 2 * sizeof(int), e);
  e = q.copy(p, p + 1, 1, e);
  e = q.fill(p + 3, 50, 1, std::vector{e});
  e = q.prefetch(p, 4, e);
  e = q.mem_advise(p, 4, 0, std::vector{e});
  q.single_task(e, [=] { p[0] += 100; }).wait();
  EXPECT_EQ(p[0], 104);
  EXPECT_EQ(p[1], 4);
  EXPECT_EQ(p[2], 4);
  EXPECT_EQ(p[3], 50);
  sycl::free(p, q);
}

TEST(Queue, MayBeDestroyedBeforeItsCommandsEnd) {
  std::atomic<int> ran{0};
  std::atomic<int>* const p = &ran;
  sycl::event last;
  {
    sycl::queue q{in_order()};
    for (int i = 0; i < 1000; ++i) last = q.single_task([=] { ++*p; });
  }
  last.wait();
  EXPECT_EQ(ran, 1000);
}

TEST(Queue, TheSecondaryQueueTakesWhatTheFirstRefuses) {
  sycl::queue first;
  sycl::queue second;
  int attempts = 0;
  int value = 0;
  int* const p = &value;
  sycl::event e = first.submit(
      [&](sycl::handler& cgh) {
        if (++attempts == 1) throw sycl::exception(sycl::errc::kernel_not_supported);
        cgh.single_task([=] { *p = 1; });
      },
      second);
  e.wait();
  EXPECT_EQ(attempts, 2);
  EXPECT_EQ(value, 1);
}

TEST(HostTask, SeesTheQueueItRunsFor) {
  sycl::queue q;
  bool checked = false;
  q.submit([&](sycl::handler& cgh) {
     cgh.host_task([&](const sycl::interop_handle& ih) {
       checked =
           ih.get_backend() == sycl::backend::host &&
           ih.get_native_queue<sycl::backend::host>() == sycl::get_native<sycl::backend::host>(q) &&
           ih.get_native_context<sycl::backend::host>() ==
               sycl::get_native<sycl::backend::host>(q.get_context()) &&
           ih.get_native_device<sycl::backend::host>() ==
               sycl::get_native<sycl::backend::host>(q.get_device());
     });
   }).wait();
  EXPECT_TRUE(checked);
}

}  // namespace
