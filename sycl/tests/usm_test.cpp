// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <cstdint>
#include <cstdlib>
#include <memory>
#include <random>
#include <vector>

#include <gtest/gtest.h>
#include <sycl/detail/testing.hpp>
#include <sycl/sycl.hpp>

namespace {

using sycl::usm::alloc;

constexpr alloc kinds[] = {alloc::host, alloc::device, alloc::shared};

std::uintptr_t address(const void* p) { return reinterpret_cast<std::uintptr_t>(p); }

TEST(Usm, EveryKindKnowsItsPointers) {
  const sycl::queue q;
  const sycl::context ctx = q.get_context();
  const sycl::context other(q.get_device());
  for (const alloc kind : kinds) {
    char* const p = static_cast<char*>(sycl::malloc(1000, q, kind));
    ASSERT_NE(p, nullptr);
    EXPECT_EQ(sycl::get_pointer_type(p, ctx), kind);
    EXPECT_EQ(sycl::get_pointer_type(p + 1, ctx), kind);
    EXPECT_EQ(sycl::get_pointer_type(p + 999, ctx), kind);
    EXPECT_EQ(sycl::get_pointer_type(p + 1000, ctx), alloc::unknown);
    EXPECT_EQ(sycl::get_pointer_type(p - 1, ctx), alloc::unknown);
    EXPECT_EQ(sycl::get_pointer_type(p, other), alloc::unknown);
    EXPECT_EQ(sycl::get_pointer_device(p + 500, ctx), q.get_device());
    sycl::free(p, q);
    EXPECT_EQ(sycl::get_pointer_type(p, ctx), alloc::unknown);
  }
}

TEST(Usm, ForeignPointersAreUnknown) {
  const sycl::queue q;
  const int local = 0;
  static int global = 0;
  const std::unique_ptr<int> heap(new int);
  int* const usm = sycl::malloc_host<int>(4, q);
  for (const void* p : {static_cast<const void*>(&local), static_cast<const void*>(&global),
                        static_cast<const void*>(heap.get()), static_cast<const void*>(nullptr)}) {
    EXPECT_EQ(sycl::get_pointer_type(p, q.get_context()), alloc::unknown);
    try {
      sycl::get_pointer_device(p, q.get_context());
      FAIL();
    } catch (const sycl::exception& e) {
      EXPECT_EQ(e.code(), sycl::errc::invalid);
    }
  }
  sycl::free(usm, q);
}

TEST(Usm, ReusedMemoryKeepsSizesAlignmentsAndDistinctness) {
  const sycl::queue q;
  std::mt19937_64 random(20240917);
  struct block {
    unsigned char* start;
    std::size_t bytes;
    unsigned char mark;
  };
  std::vector<block> live;
  for (int step = 0; step < 4000; ++step) {
    if (live.size() < 20 && random() % 2 == 0) {
      const std::size_t bytes = 1 + random() % (std::size_t{1} << (6 + random() % 18));
      const std::size_t alignment = std::size_t{64} << (random() % 10);
      auto* const p = static_cast<unsigned char*>(
          sycl::aligned_alloc(alignment, bytes, q, kinds[random() % 3]));
      ASSERT_NE(p, nullptr);
      ASSERT_EQ(address(p) % alignment, 0u);
      const auto mark = static_cast<unsigned char>(step);
      p[0] = p[bytes / 2] = p[bytes - 1] = mark;
      live.push_back({p, bytes, mark});
    } else if (!live.empty()) {
      const std::size_t i = random() % live.size();
      const block b = live[i];
      ASSERT_EQ(b.start[0], b.mark);
      ASSERT_EQ(b.start[b.bytes / 2], b.mark);
      ASSERT_EQ(b.start[b.bytes - 1], b.mark);
      sycl::free(b.start, q);
      EXPECT_EQ(sycl::get_pointer_type(b.start, q.get_context()), alloc::unknown);
      live.erase(live.begin() + static_cast<std::ptrdiff_t>(i));
    }
  }
  for (const block& b : live) sycl::free(b.start, q);
}

TEST(Usm, AllocatesInEveryForm) {
  const sycl::queue q;
  const sycl::device d = q.get_device();
  const sycl::context c = q.get_context();
  const std::vector<void*> untyped{
      sycl::malloc_device(10, d, c),
      sycl::malloc_device(10, q),
      sycl::malloc_host(10, c),
      sycl::malloc_host(10, q),
      sycl::malloc_shared(10, d, c),
      sycl::malloc_shared(10, q),
      sycl::malloc(10, d, c, alloc::host),
      sycl::malloc(10, q, alloc::shared),
  };
  for (void* p : untyped) {
    EXPECT_NE(sycl::get_pointer_type(p, c), alloc::unknown);
    sycl::free(p, c);
  }
  const std::vector<void*> aligned{
      sycl::aligned_alloc_device(512, 10, d, c),
      sycl::aligned_alloc_device(512, 10, q),
      sycl::aligned_alloc_host(512, 10, c),
      sycl::aligned_alloc_host(512, 10, q),
      sycl::aligned_alloc_shared(512, 10, d, c),
      sycl::aligned_alloc_shared(512, 10, q),
      sycl::aligned_alloc(512, 10, d, c, alloc::device),
      sycl::aligned_alloc(512, 10, q, alloc::host),
  };
  for (void* p : aligned) {
    ASSERT_NE(p, nullptr);
    EXPECT_EQ(address(p) % 512, 0U);
    sycl::free(p, q);
  }
  const std::vector<double*> typed{
      sycl::malloc_device<double>(3, d, c),
      sycl::malloc_device<double>(3, q),
      sycl::malloc_host<double>(3, c),
      sycl::malloc_host<double>(3, q),
      sycl::malloc_shared<double>(3, d, c),
      sycl::malloc_shared<double>(3, q),
      sycl::malloc<double>(3, d, c, alloc::device),
      sycl::malloc<double>(3, q, alloc::host),
      sycl::aligned_alloc_device<double>(64, 3, d, c),
      sycl::aligned_alloc_device<double>(64, 3, q),
      sycl::aligned_alloc_host<double>(64, 3, c),
      sycl::aligned_alloc_host<double>(64, 3, q),
      sycl::aligned_alloc_shared<double>(64, 3, d, c),
      sycl::aligned_alloc_shared<double>(64, 3, q),
      sycl::aligned_alloc<double>(64, 3, d, c, alloc::device),
      sycl::aligned_alloc<double>(64, 3, q, alloc::host),
  };
  for (double* p : typed) {
    EXPECT_NE(sycl::get_pointer_type(p + 2, c), alloc::unknown);
    sycl::free(p, c);
  }
}

TEST(Usm, FailureIsNull) {
  const sycl::queue q;
  EXPECT_EQ(sycl::malloc_device<double>(~std::size_t{0} / 2, q), nullptr);
  EXPECT_EQ(sycl::malloc_host<double>(~std::size_t{0}, q), nullptr);
  EXPECT_EQ(sycl::malloc_shared(std::size_t{1} << 60, q), nullptr);
  EXPECT_EQ(sycl::aligned_alloc_device(3, 100, q), nullptr);
  EXPECT_EQ(sycl::malloc(10, q, alloc::unknown), nullptr);
}

TEST(Usm, FailsOnDemand) {
  const sycl::queue q;
  const auto allocated = [&](alloc kind) {
    void* const p = sycl::aligned_alloc(64, 100, q, kind);
    sycl::free(p, q);
    return p != nullptr;
  };
  for (const alloc kind : kinds) {
    sycl::detail::testing::fail_next_allocations(kind, 2);
    for (const alloc each : kinds) EXPECT_EQ(allocated(each), each != kind);
    EXPECT_FALSE(allocated(kind));
    EXPECT_TRUE(allocated(kind));
    sycl::detail::testing::fail_next_allocations(kind, 2);
    sycl::detail::testing::fail_next_allocations(kind, 0);
    EXPECT_TRUE(allocated(kind));
  }
}

TEST(Usm, FreeRefusesWhatItDoesNotKnow) {
  const sycl::queue q;
  sycl::free(nullptr, q);
  int local = 0;
  EXPECT_THROW(sycl::free(&local, q), sycl::exception);
  char* const p = static_cast<char*>(sycl::malloc_host(10, q));
  EXPECT_THROW(sycl::free(p + 1, q), sycl::exception);
  EXPECT_THROW(sycl::free(p, sycl::context(q.get_device())), sycl::exception);
  sycl::free(p, q);
}

TEST(Usm, AllocatorsServeContainers) {
  const sycl::queue q;
  using allocator = sycl::usm_allocator<int, alloc::shared, 256>;
  const allocator a(q);
  std::vector<int, allocator> v(100, 7, a);
  EXPECT_EQ(sycl::get_pointer_type(v.data(), q.get_context()), alloc::shared);
  EXPECT_EQ(address(v.data()) % 256, 0U);
  EXPECT_TRUE(a == v.get_allocator());
  const sycl::usm_allocator<double, alloc::shared, 256> rebound(a);
  EXPECT_TRUE(rebound == a);
  const sycl::usm_allocator<int, alloc::host> other(q.get_context(), q.get_device());
  EXPECT_FALSE(a == other);
  EXPECT_FALSE(a == allocator(sycl::context(q.get_device()), q.get_device()));
  sycl::detail::testing::fail_next_allocations(alloc::shared, 1);
  try {
    v.resize(1000);
    FAIL();
  } catch (const sycl::exception& e) {
    EXPECT_EQ(e.code(), sycl::errc::memory_allocation);
  }
}

}  // namespace
