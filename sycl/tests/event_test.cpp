// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <cstdint>
#include <memory>
#include <thread>
#include <vector>

#include <gtest/gtest.h>
#include <sycl/sycl.hpp>

#include "gate.hpp"

namespace {

using status = sycl::info::event_command_status;

TEST(Event, ByDefaultIsComplete) {
  sycl::event e;
  EXPECT_EQ(e.get_info<sycl::info::event::command_execution_status>(), status::complete);
  EXPECT_TRUE(e.get_wait_list().empty());
  e.wait();
  e.wait_and_throw();
  sycl::event::wait({e, sycl::event()});
}

TEST(Event, GoesFromSubmittedToComplete) {
  sycl::queue q;
  gate g;
  const sycl::event running = g.close(q);
  sycl::event waiting = q.single_task(running, [] {});
  EXPECT_EQ(waiting.get_info<sycl::info::event::command_execution_status>(), status::submitted);
  while (running.get_info<sycl::info::event::command_execution_status>() == status::submitted) {
    std::this_thread::yield();
  }
  EXPECT_EQ(running.get_info<sycl::info::event::command_execution_status>(), status::running);
  g.open();
  waiting.wait();
  EXPECT_EQ(waiting.get_info<sycl::info::event::command_execution_status>(), status::complete);
}

TEST(Event, ListsWhatItWaitsFor) {
  sycl::queue q;
  gate a;
  gate b;
  const std::vector<sycl::event> before{a.close(q), b.close(q)};
  sycl::event e = q.single_task(before, [] {});
  EXPECT_EQ(e.get_wait_list(), before);
  a.open();
  b.open();
  e.wait();
  EXPECT_TRUE(e.get_wait_list().empty());
}

TEST(Event, OfACompleteCommandReleasesWhatItHeld) {
  struct token {
    std::shared_ptr<int> held;
    void operator()() const {}
  };
  const auto held = std::make_shared<int>(0);
  sycl::queue q;
  const sycl::event first = q.single_task(token{held});
  sycl::event second = q.submit([&](sycl::handler& cgh) {
    cgh.depends_on(first);
    cgh.host_task(token{held});
  });
  second.wait();
  EXPECT_EQ(held.use_count(), 1);
}

TEST(Event, TakesTimesWhereTheQueueDoes) {
  sycl::queue q{sycl::property::queue::enable_profiling()};
  const auto check = [](sycl::event e) {
    using namespace sycl::info::event_profiling;
    const std::uint64_t end = e.get_profiling_info<command_end>();
    const std::uint64_t start = e.get_profiling_info<command_start>();
    const std::uint64_t submit = e.get_profiling_info<command_submit>();
    EXPECT_GT(submit, 0U);
    EXPECT_LE(submit, start);
    EXPECT_LE(start, end);
  };
  check(q.single_task([] {}));
  check(q.parallel_for(100000, [](sycl::id<1>) {}));
  check(q.submit([](sycl::handler& cgh) { cgh.host_task([] {}); }));
  sycl::queue plain;
  try {
    plain.single_task([] {}).get_profiling_info<sycl::info::event_profiling::command_end>();
    FAIL();
  } catch (const sycl::exception& e) {
    EXPECT_EQ(e.code(), sycl::errc::invalid);
  }
}

TEST(Event, SubmitTimeIsKnownBeforeTheCommandRuns) {
  sycl::queue q{sycl::property::queue::enable_profiling()};
  gate g;
  const sycl::event e = g.close(q);
  EXPECT_GT(e.get_profiling_info<sycl::info::event_profiling::command_submit>(), 0U);
}

TEST(Event, KnowsItsBackend) {
  sycl::queue q;
  EXPECT_EQ(q.single_task([] {}).get_backend(), q.get_backend());
}

}  // namespace
