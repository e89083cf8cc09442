// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <array>
#include <atomic>
#include <thread>
#include <vector>

#include <gtest/gtest.h>
#include <sycl/sycl.hpp>

#include "gate.hpp"

namespace {

TEST(Ordering, SubmissionReturnsBeforeTheCommandRuns) {
  sycl::queue q;
  gate g;
  const sycl::event e = g.close(q);
  EXPECT_FALSE(is_complete(e));
  g.open();
  q.wait();
  EXPECT_TRUE(is_complete(e));
}

TEST(Ordering, IndependentCommandsOfAnOutOfOrderQueueOvertake) {
  sycl::queue q;
  gate g;
  const sycl::event blocked = g.close(q);
  sycl::event free_one = q.single_task([] {});
  free_one.wait();
  EXPECT_FALSE(is_complete(blocked));
}

TEST(Ordering, AnInOrderQueueKeepsItsOrder) {
  sycl::queue q{sycl::property::queue::in_order()};
  gate g;
  g.close(q);
  std::vector<int> order;
  std::vector<int>* const p = &order;
  sycl::event last;
  for (int i = 0; i < 100; ++i) last = q.single_task([=] { p->push_back(i); });
  EXPECT_FALSE(is_complete(last));
  g.open();
  q.wait();
  ASSERT_EQ(order.size(), 100U);
  for (int i = 0; i < 100; ++i) EXPECT_EQ(order[static_cast<std::size_t>(i)], i);
}

TEST(Ordering, QueuesDoNotWaitForEachOther) {
  sycl::queue a{sycl::property::queue::in_order()};
  sycl::queue b{sycl::property::queue::in_order()};
  gate g;
  const sycl::event blocked = g.close(a);
  b.single_task([] {});
  b.wait();
  EXPECT_FALSE(is_complete(blocked));
}

TEST(Ordering, ManyBlockedHostTasksDoNotHoldUpKernels) {
  sycl::queue q;
  std::vector<gate> gates(64);
  for (gate& g : gates) g.close(q);
  q.single_task([] {}).wait();
}

TEST(Ordering, DependsOnMakesChains) {
  sycl::queue q;
  gate g;
  sycl::event previous = g.close(q);
  int value = 0;
  int* const p = &value;
  for (int i = 1; i <= 1000; ++i) {
    previous = q.submit([&](sycl::handler& cgh) {
      cgh.depends_on(previous);
      cgh.single_task([=] { *p = *p == i - 1 ? i : -1; });
    });
  }
  EXPECT_FALSE(is_complete(previous));
  g.open();
  previous.wait();
  EXPECT_EQ(value, 1000);
}

TEST(Ordering, DependsOnMakesDiamonds) {
  sycl::queue q;
  sycl::queue other;
  for (int round = 0; round < 200; ++round) {
    std::array<int, 6> a{};
    int* const p = a.data();
    const sycl::event top = q.single_task([=] { p[0] = 1; });
    std::vector<sycl::event> sides;
    for (int i = 1; i <= 4; ++i) {
      sides.push_back((i % 2 == 0 ? q : other).single_task(top, [=] { p[i] = p[0] + i; }));
    }
    q.single_task(sides, [=] { p[5] = p[1] + p[2] + p[3] + p[4]; }).wait();
    ASSERT_EQ(a[5], 14);
  }
}

TEST(Ordering, HostTasksAndKernelsOrderEachOther) {
  sycl::queue q;
  int value = 0;
  int* const p = &value;
  const sycl::event first = q.single_task([=] { *p = 1; });
  const sycl::event second = q.submit([&](sycl::handler& cgh) {
    cgh.depends_on(first);
    cgh.host_task([=] { *p = *p * 10 + 2; });
  });
  q.single_task(second, [=] { *p = *p * 10 + 3; }).wait();
  EXPECT_EQ(value, 123);
}

TEST(Ordering, AnEmptyCommandGroupWaitsForItsDependencies) {
  sycl::queue q;
  gate g;
  const sycl::event blocked = g.close(q);
  sycl::event joined = q.submit([&](sycl::handler& cgh) { cgh.depends_on(blocked); });
  EXPECT_FALSE(is_complete(joined));
  g.open();
  joined.wait();
  EXPECT_TRUE(is_complete(blocked));
}

TEST(Ordering, AHostTaskMaySubmitAndWait) {
  sycl::queue q;
  std::atomic<int> inner{0};
  std::atomic<int>* const p = &inner;
  std::vector<sycl::event> outer;
  for (int i = 0; i < 16; ++i) {
    outer.push_back(q.submit([&](sycl::handler& cgh) {
      cgh.host_task([=] {
        sycl::queue nested;
        nested.parallel_for(1000, [=](sycl::id<1>) { p->fetch_add(1); }).wait();
      });
    }));
  }
  sycl::event::wait(outer);
  EXPECT_EQ(inner, 16000);
}

TEST(Ordering, BuffersOrderReadsAfterWritesAcrossQueues) {
  sycl::queue a;
  sycl::queue b;
  gate g;
  sycl::buffer<int> buf(sycl::range<1>(100));
  g.passes(a.submit([&](sycl::handler& cgh) {
    const sycl::accessor acc(buf, cgh, sycl::write_only_host_task, sycl::no_init);
    cgh.host_task([=, &g] {
      g.hold();
      for (int& element : acc) element = 7;
    });
  }));
  int sum = 0;
  int* const p = &sum;
  sycl::event reading = b.submit([&](sycl::handler& cgh) {
    const sycl::accessor acc(buf, cgh, sycl::read_only);
    cgh.single_task([=] {
      for (const int element : acc) *p += element;
    });
  });
  EXPECT_FALSE(is_complete(reading));
  g.open();
  reading.wait();
  EXPECT_EQ(sum, 700);
}

TEST(Ordering, BuffersOrderWritesAfterReadsAndWrites) {
  sycl::queue a;
  sycl::queue b;
  std::vector<int> contents(10, 1);
  sycl::buffer<int> buf(contents.begin(), contents.end());
  gate reading;
  int seen = 0;
  int* const p = &seen;
  reading.passes(a.submit([&](sycl::handler& cgh) {
    const sycl::accessor acc(buf, cgh, sycl::read_only_host_task);
    cgh.host_task([=, &reading] {
      reading.hold();
      *p = acc[3];
    });
  }));
  const auto set = [&](sycl::queue& q, int value) {
    return q.submit([&](sycl::handler& cgh) {
      const sycl::accessor acc(buf, cgh, sycl::write_only);
      cgh.parallel_for(10, [=](sycl::id<1> i) { acc[i] = value; });
    });
  };
  const sycl::event first = set(b, 2);
  const sycl::event second = set(a, 3);
  EXPECT_FALSE(is_complete(first));
  EXPECT_FALSE(is_complete(second));
  reading.open();
  EXPECT_EQ(sycl::host_accessor(buf, sycl::read_only)[3], 3);
  EXPECT_EQ(seen, 1);
}

TEST(Ordering, ReadersRunTogether) {
  sycl::queue q;
  sycl::buffer<int> buf(sycl::range<1>(4));
  gate g;
  g.passes(q.submit([&](sycl::handler& cgh) {
    const sycl::accessor acc(buf, cgh, sycl::read_only_host_task);
    cgh.host_task([=, &g] { g.hold(); });
  }));
  q.submit([&](sycl::handler& cgh) {
     const sycl::accessor acc(buf, cgh, sycl::read_only);
     cgh.single_task([=] {});
   }).wait();
  const sycl::host_accessor host(buf, sycl::read_only);
  EXPECT_EQ(host.size(), 4U);
}

TEST(Ordering, SubBuffersOrderWhereTheyOverlap) {
  sycl::queue q;
  sycl::buffer<int> whole(sycl::range<1>(96));
  sycl::buffer<int> low(whole, sycl::id<1>(0), sycl::range<1>(48));
  sycl::buffer<int> middle(whole, sycl::id<1>(32), sycl::range<1>(32));
  sycl::buffer<int> high(whole, sycl::id<1>(48), sycl::range<1>(48));
  gate g;
  g.passes(q.submit([&](sycl::handler& cgh) {
    const sycl::accessor acc(low, cgh, sycl::write_only_host_task);
    cgh.host_task([=, &g] {
      g.hold();
      for (int& element : acc) element = 1;
    });
  }));
  const auto set = [&](sycl::buffer<int>& part, int value) {
    return q.submit([&](sycl::handler& cgh) {
      const sycl::accessor acc(part, cgh, sycl::write_only);
      cgh.parallel_for(part.get_range(), [=](sycl::id<1> i) { acc[i] = value; });
    });
  };
  set(high, 3).wait();
  const sycl::event overlapping = set(middle, 2);
  EXPECT_FALSE(is_complete(overlapping));
  g.open();
  const sycl::host_accessor all(whole, sycl::read_only);
  EXPECT_EQ(all[0], 1);
  EXPECT_EQ(all[31], 1);
  EXPECT_EQ(all[32], 2);
  EXPECT_EQ(all[63], 2);
  EXPECT_EQ(all[64], 3);
  EXPECT_EQ(all[95], 3);
}

TEST(Ordering, CommandsWaitForHostAccessors) {
  sycl::queue q;
  sycl::buffer<int> buf(sycl::range<1>(1));
  sycl::event writing;
  {
    sycl::host_accessor host(buf);
    writing = q.submit([&](sycl::handler& cgh) {
      const sycl::accessor acc(buf, cgh, sycl::write_only);
      cgh.single_task([=] { acc[0] = 2; });
    });
    host[0] = 1;
    EXPECT_FALSE(is_complete(writing));
    const sycl::host_accessor copy = host;
    host = {};
    EXPECT_FALSE(is_complete(writing));
    EXPECT_EQ(copy[0], 1);
  }
  writing.wait();
  EXPECT_EQ(sycl::host_accessor(buf)[0], 2);
}

TEST(Ordering, ConcurrentSubmissionsWithCrossedBuffersNeverLock) {
  sycl::queue shared{sycl::property::queue::in_order()};
  sycl::buffer<int> x(sycl::range<1>(1));
  sycl::buffer<int> y(sycl::range<1>(1));
  x.get_host_access()[0] = 0;
  y.get_host_access()[0] = 0;
  constexpr int rounds = 500;
  const auto work = [&](sycl::buffer<int>& first, sycl::buffer<int>& second) {
    sycl::queue own;
    for (int i = 0; i < rounds; ++i) {
      (i % 2 == 0 ? own : shared).submit([&](sycl::handler& cgh) {
        const sycl::accessor a(first, cgh);
        const sycl::accessor b(second, cgh);
        cgh.single_task([=] {
          ++a[0];
          ++b[0];
        });
      });
    }
    own.wait();
  };
  std::thread other([&] { work(y, x); });
  work(x, y);
  other.join();
  EXPECT_EQ(sycl::host_accessor(x)[0], 2 * rounds);
  EXPECT_EQ(sycl::host_accessor(y)[0], 2 * rounds);
}

}  // namespace
