// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <array>
#include <atomic>
#include <cstdint>
#include <cstring>
#include <numeric>
#include <vector>

#include <gtest/gtest.h>
#include <sycl/sycl.hpp>

namespace {

TEST(ParallelFor, RunsEveryWorkItemOnceWhateverTheRange) {
  sycl::queue q;
  for (const std::size_t n : {0U, 1U, 2U, 15U, 16U, 17U, 1000U, 1023U, 1024U, 4097U, 100003U}) {
    std::vector<int> counts(n + 1);
    int* const p = counts.data();
    q.parallel_for(n, [=](sycl::id<1> i) { ++p[i]; }).wait();
    counts.pop_back();
    EXPECT_EQ(std::count(counts.begin(), counts.end(), 1), static_cast<std::ptrdiff_t>(n)) << n;
  }
}

TEST(ParallelFor, SharesLongKernelsAmongThreadsCorrectly) {
  sycl::queue q;
  constexpr std::size_t n = 300;
  std::vector<int> counts(n);
  int* const p = counts.data();
  q.parallel_for(n, [=](sycl::id<1> i) {
     double x = 1;
     for (int k = 0; k < 20000; ++k) x = x * 0.999 + 0.5;
     p[i] += x > 0 ? 1 : 2;
   }).wait();
  EXPECT_EQ(std::count(counts.begin(), counts.end(), 1), static_cast<std::ptrdiff_t>(n));
}

TEST(ParallelFor, TakesItemsIdsAndIntegersInOneDimension) {
  sycl::queue q;
  std::array<std::size_t, 5> a{};
  std::size_t* const p = a.data();
  q.parallel_for(5, [=](sycl::item<1> i) { p[i.get_linear_id()] += i.get_range(0); }).wait();
  q.parallel_for(sycl::range<1>(5), [=](sycl::id<1> i) { p[i[0]] += 10; }).wait();
  q.parallel_for(sycl::range(5), [=](std::size_t i) { p[i] += 100; }).wait();
  q.parallel_for(5, [=](int i) { p[i] += 1000; }).wait();
  q.parallel_for(5, [=](auto i) { p[i] += 10000; }).wait();
  for (const std::size_t value : a) EXPECT_EQ(value, 11115U);
}

TEST(ParallelFor, CountsInRowMajorOrderInTwoAndThreeDimensions) {
  sycl::queue q;
  std::vector<std::size_t> a(7 * 301);
  std::size_t* const p = a.data();
  q.parallel_for({7, 301}, [=](sycl::item<2> i) {
     p[i.get_id(0) * 301 + i.get_id(1)] += i.get_linear_id() + 1;
   }).wait();
  std::vector<std::size_t> b(5 * 33 * 17);
  std::size_t* const r = b.data();
  q.parallel_for(sycl::range<3>(5, 33, 17), [=](sycl::id<3> i) {
     const std::size_t linear = (i[0] * 33 + i[1]) * 17 + i[2];
     r[linear] += linear + 1;
   }).wait();
  std::vector<std::size_t> expected(b.size());
  std::iota(expected.begin(), expected.end(), 1);
  EXPECT_EQ(b, expected);
  expected.resize(a.size());
  std::iota(expected.begin(), expected.end(), 1);
  EXPECT_EQ(a, expected);
}

TEST(ParallelFor, AnEmptyRangeOfSeveralDimensionsCompletes) {
  sycl::queue q;
  q.parallel_for({0, 5}, [](sycl::id<2>) { FAIL(); }).wait();
  q.parallel_for({5, 0}, [](sycl::id<2>) { FAIL(); }).wait();
  q.parallel_for({5, 3, 0}, [](sycl::id<3>) { FAIL(); }).wait();
}

TEST(Kernel, MayHaveANameAndBeAFunctionObject) {
  class named;
  struct object {
    int* p;
    void operator()(sycl::item<1> i) const { p[i] = static_cast<int>(i.get_id(0)); }
  };
  sycl::queue q;
  std::array<int, 4> a{};
  int* const p = a.data();
  q.parallel_for<named>(4, object{p}).wait();
  EXPECT_EQ(a, (std::array{0, 1, 2, 3}));
  q.single_task<named>([=] { p[0] = 9; }).wait();
  EXPECT_EQ(a[0], 9);
}

TEST(Kernel, OwnsACopyOfWhatItCaptures) {
  struct counted {
    explicit counted(std::atomic<int>* n) : alive(n) { ++*alive; }
    counted(const counted& other) : alive(other.alive) { ++*alive; }
    ~counted() { --*alive; }
    std::atomic<int>* alive;
  };
  std::atomic<int> alive{0};
  sycl::queue q;
  {
    const counted c(&alive);
    sycl::event e = q.single_task([c] { EXPECT_GE(*c.alive, 1); });
    e.wait();
    EXPECT_EQ(alive, 1) << "the complete command still holds its copy";
  }
  EXPECT_EQ(alive, 0);
}

TEST(Kernel, MayBeLargeAndOveraligned) {
  struct alignas(128) block {
    std::array<double, 100> values{};
  };
  block b;
  b.values[99] = 42;
  double result = 0;
  double* const p = &result;
  sycl::queue q;
  q.single_task([=] {
     EXPECT_EQ(reinterpret_cast<std::uintptr_t>(&b) % 128, 0U);
     *p = b.values[99];
   }).wait();
  EXPECT_EQ(result, 42);
}

TEST(Kernel, AddsUpAtomicallyAcrossThreads) {
  sycl::queue q;
  int* const sum = sycl::malloc_shared<int>(1, q);
  *sum = 0;
  q.parallel_for(200000, [=](sycl::id<1>) {
     sycl::atomic_ref<int, sycl::memory_order::relaxed, sycl::memory_scope::device>(*sum).fetch_add(
         1);
   }).wait();
  EXPECT_EQ(*sum, 200000);
  sycl::free(sum, q);
}

TEST(MemoryOperations, LargeCopiesOfAnyAlignment) {
  sycl::queue q;
  constexpr std::size_t n = (std::size_t{17} << 20) + 13;
  std::vector<unsigned char> source(n);
  for (std::size_t i = 0; i < n; ++i) source[i] = static_cast<unsigned char>(i * 7 + i / 251);
  std::vector<unsigned char> target(n);
  for (const std::size_t from : {0U, 3U}) {
    for (const std::size_t to : {0U, 1U, 63U}) {
      std::fill(target.begin(), target.end(), std::uint8_t{0});
      const std::size_t count = n - std::max(from, to);
      q.memcpy(target.data() + to, source.data() + from, count).wait();
      ASSERT_EQ(std::memcmp(target.data() + to, source.data() + from, count), 0);
      for (std::size_t i = 0; i < to; ++i) ASSERT_EQ(target[i], 0);
      for (std::size_t i = to + count; i < n; ++i) ASSERT_EQ(target[i], 0);
    }
  }
}

TEST(MemoryOperations, CopySetAndFill) {
  sycl::queue q;
  constexpr std::size_t n = 3'000'001;
  std::vector<char> source(n);
  for (std::size_t i = 0; i < n; ++i) source[i] = static_cast<char>(i * 7);
  std::vector<char> target(n);
  q.memcpy(target.data(), source.data(), n).wait();
  EXPECT_EQ(source, target);
  q.memset(target.data() + 1, 5, n - 2).wait();
  EXPECT_EQ(target.front(), source.front());
  EXPECT_EQ(target.back(), source.back());
  EXPECT_EQ(std::count(target.begin() + 1, target.end() - 1, 5), static_cast<int>(n - 2));

  std::vector<double> numbers(1000);
  q.fill(numbers.data() + 1, 2.5, 998).wait();
  EXPECT_EQ(numbers.front(), 0);
  EXPECT_EQ(numbers.back(), 0);
  EXPECT_EQ(std::count(numbers.begin(), numbers.end(), 2.5), 998);
  std::vector<double> copy(1000);
  q.copy(numbers.data(), copy.data(), 1000, std::vector<sycl::event>{}).wait();
  EXPECT_EQ(copy, numbers);
  q.memcpy(nullptr, nullptr, 0).wait();
  q.prefetch(copy.data(), 8).wait();
  q.mem_advise(copy.data(), 8, 0).wait();
}

}  // namespace
