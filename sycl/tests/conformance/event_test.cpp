// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <chrono>
#include <thread>
#include <type_traits>
#include <vector>

#include "support.hpp"

namespace {

using conformance::gate;
using conformance::is_complete;
using conformance::throws;
using sycl::errc;
using sycl::event;
namespace info = sycl::info;

static_assert(conformance::has_reference_semantics<event>);
static_assert(std::is_default_constructible_v<event>);
static_assert(noexcept(std::declval<const event&>().get_backend()));
static_assert(
    std::is_same_v<info::event::command_execution_status::return_type, info::event_command_status>);
static_assert(std::is_same_v<info::event_profiling::command_submit::return_type, std::uint64_t>);
static_assert(std::is_same_v<info::event_profiling::command_start::return_type, std::uint64_t>);
static_assert(std::is_same_v<info::event_profiling::command_end::return_type, std::uint64_t>);

TEST(ConformanceEvent, ReferenceSemantics) {
  conformance::expect_reference_semantics(event(), event());
  sycl::queue q;
  conformance::expect_reference_semantics(q.single_task([] {}), q.single_task([] {}));
  q.wait();
}

TEST(ConformanceEvent, DefaultIsComplete) {
  event e;
  EXPECT_TRUE(is_complete(e));
  EXPECT_TRUE(e.get_wait_list().empty());
  e.wait();
  e.wait_and_throw();
  event::wait({e, event()});
  event::wait_and_throw({});
  EXPECT_TRUE(
      throws(errc::invalid, [&] { e.get_profiling_info<info::event_profiling::command_end>(); }));
  sycl::queue q;
  EXPECT_NO_THROW(q.single_task(e, [] {}).wait());
}

TEST(ConformanceEvent, StatusFollowsTheCommand) {
  sycl::queue q;
  gate closed(q);
  event e = closed.event();
  EXPECT_FALSE(is_complete(e));
  closed.open();
  e.wait();
  EXPECT_TRUE(is_complete(e));
  EXPECT_TRUE(is_complete(closed.event()));
}

TEST(ConformanceEvent, WaitListHoldsTheDependencies) {
  sycl::queue q;
  gate first(q);
  gate second(q);
  event last = q.submit([&](sycl::handler& cgh) {
    cgh.depends_on(first.event());
    cgh.depends_on(std::vector<event>{second.event()});
    cgh.host_task([] {});
  });
  const std::vector<event> list = last.get_wait_list();
  EXPECT_EQ(list.size(), 2U);
  EXPECT_NE(std::find(list.begin(), list.end(), first.event()), list.end());
  EXPECT_NE(std::find(list.begin(), list.end(), second.event()), list.end());
  EXPECT_FALSE(is_complete(last));
  first.open();
  second.open();
  last.wait();
  EXPECT_TRUE(is_complete(last));
}

TEST(ConformanceEvent, WaitListIncludesDependenciesThroughBuffers) {
  sycl::queue q;
  gate closed(q);
  sycl::buffer<int, 1> buf(sycl::range<1>(4));
  event writer = q.submit([&](sycl::handler& cgh) {
    const sycl::accessor acc(buf, cgh, sycl::write_only);
    cgh.depends_on(closed.event());
    cgh.parallel_for(sycl::range<1>(4), [=](sycl::id<1> i) { acc[i] = 1; });
  });
  event reader = q.submit([&](sycl::handler& cgh) {
    const sycl::accessor acc(buf, cgh, sycl::read_only);
    cgh.single_task([=] { static_cast<void>(acc[0]); });
  });
  const std::vector<event> list = reader.get_wait_list();
  EXPECT_NE(std::find(list.begin(), list.end(), writer), list.end());
  closed.open();
  q.wait();
}

TEST(ConformanceEvent, WaitBlocksUntilCompletion) {
  sycl::queue q;
  bool done = false;
  std::vector<event> events;
  events.push_back(q.submit([&](sycl::handler& cgh) {
    cgh.host_task([&] {
      std::this_thread::sleep_for(std::chrono::milliseconds(30));
      done = true;
    });
  }));
  events.push_back(q.single_task([] {}));
  event::wait(events);
  EXPECT_TRUE(done);
  for (const event& e : events) EXPECT_TRUE(is_complete(e));
}

TEST(ConformanceEvent, OutlivesItsQueue) {
  event e;
  int value = 0;
  {
    sycl::queue q;
    e = q.submit([&](sycl::handler& cgh) { cgh.host_task([&] { value = 5; }); });
  }
  e.wait();
  EXPECT_EQ(value, 5);
}

TEST(ConformanceEvent, WaitAndThrowDeliversErrors) {
  std::size_t errors = 0;
  sycl::queue q([&](sycl::exception_list list) { errors += list.size(); });
  const auto fail = [](sycl::handler& cgh) {
    cgh.host_task([] { throw sycl::exception(errc::runtime, "failed"); });
  };
  event e = q.submit(fail);
  e.wait();
  EXPECT_EQ(errors, 0U);
  e.wait_and_throw();
  EXPECT_EQ(errors, 1U);
  event::wait_and_throw({q.submit(fail)});
  EXPECT_EQ(errors, 2U);
  EXPECT_TRUE(is_complete(e));
}

TEST(ConformanceEvent, ProfilingTimesAreOrdered) {
  sycl::queue q{sycl::property::queue::enable_profiling()};
  event e = q.parallel_for(sycl::range<1>(1000), [](sycl::id<1>) {});
  e.wait();
  const auto submit = e.get_profiling_info<info::event_profiling::command_submit>();
  const auto start = e.get_profiling_info<info::event_profiling::command_start>();
  const auto end = e.get_profiling_info<info::event_profiling::command_end>();
  EXPECT_LE(submit, start);
  EXPECT_LE(start, end);
  event later = q.single_task([] {});
  EXPECT_GE(later.get_profiling_info<info::event_profiling::command_submit>(), submit);
  EXPECT_GE(later.get_profiling_info<info::event_profiling::command_end>(), end)
      << "the end is waited for";
}

TEST(ConformanceEvent, ProfilingNeedsTheProperty) {
  sycl::queue q;
  event e = q.single_task([] {});
  e.wait();
  EXPECT_TRUE(throws(errc::invalid,
                     [&] { e.get_profiling_info<info::event_profiling::command_submit>(); }));
}

}  // namespace
