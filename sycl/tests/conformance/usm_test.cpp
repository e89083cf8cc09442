// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <cstdint>
#include <memory>
#include <type_traits>
#include <vector>

#include "support.hpp"

namespace {

using conformance::throws;
using sycl::context;
using sycl::device;
using sycl::errc;
using sycl::queue;
namespace usm = sycl::usm;

bool is_aligned(const void* pointer, std::size_t alignment) {
  return reinterpret_cast<std::uintptr_t>(pointer) % alignment == 0;
}

TEST(ConformanceUsm, KindsAreTold) {
  const queue q;
  const context ctx = q.get_context();
  const device dev = q.get_device();
  struct {
    void* memory;
    usm::alloc kind;
  } const allocations[] = {
      {sycl::malloc_device(64, q), usm::alloc::device},
      {sycl::malloc_device(64, dev, ctx), usm::alloc::device},
      {sycl::malloc_device<int>(16, q), usm::alloc::device},
      {sycl::malloc_device<int>(16, dev, ctx), usm::alloc::device},
      {sycl::malloc_host(64, q), usm::alloc::host},
      {sycl::malloc_host(64, ctx), usm::alloc::host},
      {sycl::malloc_host<int>(16, q), usm::alloc::host},
      {sycl::malloc_host<int>(16, ctx), usm::alloc::host},
      {sycl::malloc_shared(64, q), usm::alloc::shared},
      {sycl::malloc_shared(64, dev, ctx), usm::alloc::shared},
      {sycl::malloc_shared<int>(16, q), usm::alloc::shared},
      {sycl::malloc_shared<int>(16, dev, ctx), usm::alloc::shared},
      {sycl::malloc(64, q, usm::alloc::host), usm::alloc::host},
      {sycl::malloc(64, dev, ctx, usm::alloc::device), usm::alloc::device},
      {sycl::malloc<int>(16, q, usm::alloc::shared), usm::alloc::shared},
      {sycl::malloc<int>(16, dev, ctx, usm::alloc::shared), usm::alloc::shared},
  };
  for (const auto& [memory, kind] : allocations) {
    ASSERT_NE(memory, nullptr);
    EXPECT_EQ(sycl::get_pointer_type(memory, ctx), kind);
    EXPECT_EQ(sycl::get_pointer_type(static_cast<char*>(memory) + 63, ctx), kind);
    // Host memory belongs to all devices of the context and reports the first.
    EXPECT_EQ(sycl::get_pointer_device(memory, ctx),
              kind == usm::alloc::host ? ctx.get_devices().front() : dev);
  }
  for (const auto& [memory, kind] : allocations) {
    sycl::free(memory, q);
    EXPECT_EQ(sycl::get_pointer_type(memory, ctx), usm::alloc::unknown);
  }
}

TEST(ConformanceUsm, AlignedAllocations) {
  const queue q;
  const context ctx = q.get_context();
  const device dev = q.get_device();
  for (const std::size_t alignment : {1U, 8U, 64U, 256U, 4096U}) {
    void* const memory[] = {
        sycl::aligned_alloc_device(alignment, 8192, q),
        sycl::aligned_alloc_device(alignment, 8192, dev, ctx),
        sycl::aligned_alloc_device<double>(alignment, 1024, q),
        sycl::aligned_alloc_host(alignment, 8192, q),
        sycl::aligned_alloc_host(alignment, 8192, ctx),
        sycl::aligned_alloc_host<double>(alignment, 1024, ctx),
        sycl::aligned_alloc_shared(alignment, 8192, q),
        sycl::aligned_alloc_shared(alignment, 8192, dev, ctx),
        sycl::aligned_alloc_shared<double>(alignment, 1024, q),
        sycl::aligned_alloc(alignment, 8192, q, usm::alloc::shared),
        sycl::aligned_alloc(alignment, 8192, dev, ctx, usm::alloc::device),
        sycl::aligned_alloc<double>(alignment, 1024, q, usm::alloc::host),
    };
    for (void* pointer : memory) {
      ASSERT_NE(pointer, nullptr);
      EXPECT_TRUE(is_aligned(pointer, alignment));
      sycl::free(pointer, ctx);
    }
  }
}

struct alignas(128) wide {
  int value;
};

TEST(ConformanceUsm, TypedAllocationsSuitTheType) {
  const queue q;
  wide* const memory[] = {sycl::malloc_device<wide>(3, q), sycl::malloc_host<wide>(3, q),
                          sycl::malloc_shared<wide>(3, q)};
  for (wide* pointer : memory) {
    ASSERT_NE(pointer, nullptr);
    EXPECT_TRUE(is_aligned(pointer, alignof(wide)));
    sycl::free(pointer, q);
  }
}

TEST(ConformanceUsm, ImpossibleAllocationsAreNull) {
  const queue q;
  constexpr std::size_t huge = static_cast<std::size_t>(-1) / 4;
  EXPECT_EQ(sycl::malloc_device(huge, q), nullptr);
  EXPECT_EQ(sycl::malloc_host(huge, q), nullptr);
  EXPECT_EQ(sycl::malloc_shared(huge, q), nullptr);
  EXPECT_EQ(sycl::malloc_shared<double>(huge, q), nullptr) << "the product must not wrap";
}

TEST(ConformanceUsm, OtherPointersAreUnknown) {
  const queue q;
  const context ctx = q.get_context();
  int local = 0;
  const std::vector<int> heap(10);
  EXPECT_EQ(sycl::get_pointer_type(&local, ctx), usm::alloc::unknown);
  EXPECT_EQ(sycl::get_pointer_type(heap.data(), ctx), usm::alloc::unknown);
  EXPECT_EQ(sycl::get_pointer_type(nullptr, ctx), usm::alloc::unknown);
  EXPECT_TRUE(throws(errc::invalid, [&] { sycl::get_pointer_device(&local, ctx); }));
  EXPECT_TRUE(throws(errc::invalid, [&] { sycl::get_pointer_device(nullptr, ctx); }));
}

TEST(ConformanceUsm, OtherContextsDoNotKnowTheAllocation) {
  const device dev;
  const context one(dev);
  const context two(dev);
  int* memory = sycl::malloc_device<int>(4, dev, one);
  EXPECT_EQ(sycl::get_pointer_type(memory, one), usm::alloc::device);
  EXPECT_EQ(sycl::get_pointer_type(memory, two), usm::alloc::unknown);
  EXPECT_TRUE(throws(errc::invalid, [&] { sycl::get_pointer_device(memory, two); }));
  sycl::free(memory, one);
}

TEST(ConformanceUsm, FreeingNullDoesNothing) {
  const queue q;
  EXPECT_NO_THROW(sycl::free(nullptr, q));
  EXPECT_NO_THROW(sycl::free(nullptr, q.get_context()));
}

TEST(ConformanceUsm, HostAndSharedMemoryServeBothSides) {
  queue q;
  int* host = sycl::malloc_host<int>(100, q);
  int* shared = sycl::malloc_shared<int>(100, q);
  int* on_device = sycl::malloc_device<int>(100, q);
  for (int i = 0; i < 100; ++i) host[i] = i;
  const sycl::event first =
      q.parallel_for(sycl::range<1>(100), [=](sycl::id<1> i) { on_device[i] = host[i] * 2; });
  q.parallel_for(sycl::range<1>(100), first, [=](sycl::id<1> i) {
     shared[i] = on_device[i] + 1;
   }).wait();
  for (int i = 0; i < 100; ++i) EXPECT_EQ(shared[i], 2 * i + 1);
  for (int* memory : {host, shared, on_device}) sycl::free(memory, q);
}

template <typename T>
using shared_allocator = sycl::usm_allocator<T, usm::alloc::shared>;
static_assert(std::is_same_v<shared_allocator<int>::value_type, int>);
static_assert(std::is_same_v<std::allocator_traits<shared_allocator<int>>::rebind_alloc<double>,
                             shared_allocator<double>>);
static_assert(!std::is_default_constructible_v<shared_allocator<int>>);
static_assert(std::is_copy_constructible_v<shared_allocator<int>>);
static_assert(
    std::allocator_traits<shared_allocator<int>>::propagate_on_container_copy_assignment::value);
static_assert(
    std::allocator_traits<shared_allocator<int>>::propagate_on_container_move_assignment::value);
static_assert(std::allocator_traits<shared_allocator<int>>::propagate_on_container_swap::value);

TEST(ConformanceUsm, AllocatorServesContainers) {
  queue q;
  std::vector<int, shared_allocator<int>> values(10, 4, shared_allocator<int>(q));
  EXPECT_EQ(sycl::get_pointer_type(values.data(), q.get_context()), usm::alloc::shared);
  int* data = values.data();
  q.parallel_for(sycl::range<1>(10), [=](sycl::id<1> i) { data[i] *= 3; }).wait();
  for (const int value : values) EXPECT_EQ(value, 12);
  for (int i = 0; i < 100; ++i) values.push_back(i);
  EXPECT_EQ(values.size(), 110U);
  EXPECT_EQ(values[9], 12);
}

TEST(ConformanceUsm, AllocatorsOfOnePlaceAreEqual) {
  const queue q;
  const shared_allocator<int> one(q);
  const shared_allocator<int> two(q.get_context(), q.get_device());
  const shared_allocator<double> rebound(one);
  const sycl::usm_allocator<int, usm::alloc::host> host(q);
  EXPECT_TRUE(one == two);
  EXPECT_TRUE(one == rebound);
  EXPECT_TRUE(one != host);
  const queue other{context(q.get_device()), q.get_device()};
  EXPECT_TRUE(one != shared_allocator<int>(other));
}

TEST(ConformanceUsm, AllocatorAligns) {
  const queue q;
  sycl::usm_allocator<int, usm::alloc::host, 512> allocator(q);
  int* memory = allocator.allocate(3);
  EXPECT_TRUE(is_aligned(memory, 512));
  allocator.deallocate(memory, 3);
}

TEST(ConformanceUsm, AllocatorThrowsForTheImpossible) {
  const queue q;
  shared_allocator<int> allocator(q);
  EXPECT_TRUE(throws(errc::memory_allocation,
                     [&] { static_cast<void>(allocator.allocate(std::size_t{1} << 60)); }));
}

}  // namespace
