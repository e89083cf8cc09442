// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <atomic>
#include <cstdio>
#include <memory>
#include <thread>
#include <vector>

#include <gtest/gtest.h>
#include <unistd.h>
#include <sycl/sycl.hpp>

namespace {

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
constexpr bool sanitized = true;
#elif defined(__has_feature)
#if __has_feature(address_sanitizer) || __has_feature(thread_sanitizer)
constexpr bool sanitized = true;
#else
constexpr bool sanitized = false;
#endif
#else
constexpr bool sanitized = false;
#endif

/// Resident memory in MiB; sanitizers keep freed memory, so that it says nothing there.
long resident() {
  long total = 0;
  long pages = 0;
  const std::unique_ptr<std::FILE, int (*)(std::FILE*)> file(std::fopen("/proc/self/statm", "r"),
                                                             &std::fclose);
  if (file == nullptr || std::fscanf(file.get(), "%ld %ld", &total, &pages) != 2) return 0;
  return pages * sysconf(_SC_PAGESIZE) / (1024 * 1024);
}

void expect_no_growth(long before, long allowance) {
  if (!sanitized) {
    EXPECT_LE(resident(), before + allowance);
  }
}

TEST(Stress, AThousandQueuesAndAMillionSubmissionsDoNotGrow) {
  constexpr int queues = sanitized ? 100 : 1000;
  constexpr int rounds = sanitized ? 20 : 1000;
  std::atomic<long> count{0};
  std::atomic<long>* const p = &count;
  std::vector<sycl::queue> all;
  for (int i = 0; i < queues; ++i) {
    if (i % 2 == 0) {
      all.emplace_back();
    } else {
      all.emplace_back(sycl::property_list{sycl::property::queue::in_order()});
    }
  }
  long before = 0;
  for (int round = 0; round < rounds; ++round) {
    for (sycl::queue& q : all) {
      q.single_task([=] { p->fetch_add(1, std::memory_order_relaxed); });
    }
    for (sycl::queue& q : all) q.wait();
    if (round == rounds / 10) before = resident();
  }
  EXPECT_EQ(count, long{queues} * rounds);
  expect_no_growth(before, 8);
}

TEST(Stress, QueuesComeAndGo) {
  constexpr int rounds = sanitized ? 500 : 20000;
  std::atomic<int> count{0};
  std::atomic<int>* const p = &count;
  long before = 0;
  for (int i = 0; i < rounds; ++i) {
    sycl::queue q;
    q.single_task([=] { ++*p; });
    if (i % 2 == 0) q.wait();
    if (i == rounds / 10) before = resident();
  }
  sycl::queue last;
  while (count != rounds) std::this_thread::yield();
  expect_no_growth(before, 8);
}

TEST(Stress, ALongChainRunsInOrder) {
  constexpr int length = sanitized ? 5000 : 200000;
  long value = 0;
  long* const p = &value;
  sycl::queue q{sycl::property::queue::in_order()};
  for (int i = 0; i < length; ++i) q.single_task([=] { *p = *p + 1; });
  q.wait();
  EXPECT_EQ(value, length);
}

TEST(Stress, ManyThreadsSubmitToOneQueue) {
  constexpr int rounds = sanitized ? 300 : 5000;
  sycl::queue q;
  sycl::queue ordered{sycl::property::queue::in_order()};
  std::atomic<int> count{0};
  std::atomic<int>* const p = &count;
  int sum = 0;
  int* const s = &sum;
  std::vector<std::thread> threads;
  for (int t = 0; t < 4; ++t) {
    threads.emplace_back([&] {
      for (int i = 0; i < rounds; ++i) {
        sycl::event e = q.parallel_for(10, [=](sycl::id<1>) { ++*p; });
        ordered.single_task(e, [=] { ++*s; });
        if (i % 16 == 0) e.wait();
        if (i % 64 == 0) q.wait();
      }
    });
  }
  for (std::thread& thread : threads) thread.join();
  ordered.wait();
  q.wait();
  EXPECT_EQ(count, 40 * rounds);
  EXPECT_EQ(sum, 4 * rounds);
}

TEST(Stress, BuffersComeAndGoWithCommandsPending) {
  constexpr int rounds = sanitized ? 200 : 5000;
  sycl::queue a;
  sycl::queue b;
  long before = 0;
  for (int i = 0; i < rounds; ++i) {
    std::vector<int> host(256, 0);
    {
      sycl::buffer<int> buf(host);
      for (sycl::queue* q : {&a, &b, &a}) {
        q->submit([&](sycl::handler& cgh) {
          const sycl::accessor acc(buf, cgh);
          cgh.parallel_for(256, [=](sycl::id<1> k) { acc[k] += 1; });
        });
      }
    }
    ASSERT_EQ(host[0], 3);
    ASSERT_EQ(host[255], 3);
    sycl::buffer<int> scratch(sycl::range<1>(4096));
    a.submit([&](sycl::handler& cgh) {
      const sycl::accessor acc(scratch, cgh, sycl::write_only, sycl::no_init);
      cgh.parallel_for(4096, [=](sycl::id<1> k) { acc[k] = 1; });
    });
    // Bounds what is pending at one time.
    if (i % 50 == 0) a.wait();
    if (i == rounds / 10) before = resident();
  }
  a.wait();
  b.wait();
  expect_no_growth(before, 16);
}

}  // namespace
