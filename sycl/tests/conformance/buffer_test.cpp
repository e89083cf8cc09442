// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <array>
#include <cstdint>
#include <list>
#include <memory>
#include <mutex>
#include <numeric>
#include <type_traits>
#include <vector>

#include "support.hpp"

namespace {

using conformance::throws;
using sycl::buffer;
using sycl::errc;
using sycl::id;
using sycl::property_list;
using sycl::range;
namespace property = sycl::property;

static_assert(conformance::has_reference_semantics<buffer<int, 1>>);
static_assert(conformance::has_reference_semantics<buffer<double, 3>>);
static_assert(!std::is_default_constructible_v<buffer<int, 1>>);
static_assert(std::is_same_v<buffer<int>, buffer<int, 1>>);
static_assert(std::is_same_v<buffer<int, 2>::value_type, int>);
static_assert(std::is_same_v<buffer<int, 2>::reference, int&>);
static_assert(std::is_same_v<buffer<int, 2>::const_reference, const int&>);
static_assert(
    std::is_same_v<buffer<int, 1, std::allocator<int>>::allocator_type, std::allocator<int>>);
static_assert(std::is_same_v<buffer<int>::allocator_type, sycl::buffer_allocator<int>>);
static_assert(std::is_same_v<buffer<const int>::allocator_type, sycl::buffer_allocator<int>>);
static_assert(sycl::is_property_of_v<property::buffer::use_host_ptr, buffer<int>>);
static_assert(sycl::is_property_of_v<property::buffer::use_mutex, buffer<int, 2>>);
static_assert(sycl::is_property_of_v<property::buffer::context_bound, buffer<int, 3>>);
static_assert(!sycl::is_property_of_v<property::queue::in_order, buffer<int>>);
static_assert(noexcept(std::declval<const buffer<int>&>().size()));
static_assert(noexcept(std::declval<const buffer<int>&>().byte_size()));
static_assert(
    noexcept(std::declval<const buffer<int>&>().has_property<property::buffer::use_mutex>()));

using allocator = std::allocator<int>;
using plain = buffer<int, 1, allocator>;
static_assert(std::is_constructible_v<plain, range<1>, property_list>);
static_assert(std::is_constructible_v<plain, range<1>, allocator, property_list>);
static_assert(std::is_constructible_v<plain, int*, range<1>, property_list>);
static_assert(std::is_constructible_v<plain, int*, range<1>, allocator, property_list>);
static_assert(std::is_constructible_v<plain, const int*, range<1>, property_list>);
static_assert(std::is_constructible_v<plain, const int*, range<1>, allocator, property_list>);
static_assert(std::is_constructible_v<plain, std::vector<int>&, property_list>);
static_assert(std::is_constructible_v<plain, std::vector<int>&, allocator, property_list>);
static_assert(std::is_constructible_v<plain, std::shared_ptr<int>, range<1>, property_list>);
static_assert(
    std::is_constructible_v<plain, std::shared_ptr<int>, range<1>, allocator, property_list>);
static_assert(std::is_constructible_v<plain, std::shared_ptr<int[]>, range<1>, property_list>);
static_assert(std::is_constructible_v<plain, std::list<int>::iterator, std::list<int>::iterator,
                                      property_list>);
static_assert(std::is_constructible_v<plain, std::list<int>::iterator, std::list<int>::iterator,
                                      allocator, property_list>);
static_assert(std::is_constructible_v<plain, plain&, id<1>, range<1>>);

static_assert(
    std::is_same_v<decltype(buffer(std::declval<int*>(), range<2>(1, 1))), buffer<int, 2>>);
static_assert(
    std::is_same_v<decltype(buffer(std::declval<const int*>(), range<1>(1))), buffer<int, 1>>);
static_assert(
    std::is_same_v<decltype(buffer(std::declval<std::vector<float>&>())), buffer<float, 1>>);
static_assert(std::is_same_v<decltype(buffer(std::declval<std::list<float>::iterator>(),
                                             std::declval<std::list<float>::iterator>())),
                             buffer<float, 1>>);
static_assert(
    std::is_same_v<decltype(buffer(std::declval<std::vector<float>&>(), std::allocator<float>())),
                   buffer<float, 1, std::allocator<float>>>);

/// Adds 1 to each element in a kernel.
template <typename Buffer>
void increment(Buffer& buf) {
  sycl::queue q;
  q.submit([&](sycl::handler& cgh) {
    const sycl::accessor acc(buf, cgh, sycl::read_write);
    cgh.parallel_for(buf.get_range(), [=](auto i) { acc[i] += 1; });
  });
}

std::vector<int> iota(std::size_t count) {
  std::vector<int> values(count);
  std::iota(values.begin(), values.end(), 0);
  return values;
}
std::vector<int> iota_plus_one(std::size_t count) {
  std::vector<int> values(count);
  std::iota(values.begin(), values.end(), 1);
  return values;
}
template <typename Buffer>
std::vector<int> contents(Buffer& buf) {
  const sycl::host_accessor acc(buf, sycl::read_only);
  return std::vector<int>(acc.begin(), acc.end());
}

TEST(ConformanceBuffer, ReferenceSemantics) {
  conformance::expect_reference_semantics(buffer<int>(range<1>(3)), buffer<int>(range<1>(3)));
  std::vector<int> data(3);
  conformance::expect_reference_semantics(buffer<int>(data), buffer<int>(range<1>(3)));
}

TEST(ConformanceBuffer, Sizes) {
  const buffer<double, 3> buf(range<3>(2, 3, 4));
  EXPECT_EQ(buf.get_range(), range<3>(2, 3, 4));
  EXPECT_EQ(buf.size(), 24U);
  EXPECT_EQ(buf.byte_size(), 24 * sizeof(double));
  EXPECT_FALSE(buf.is_sub_buffer());
}

TEST(ConformanceBuffer, CopiesShareTheContents) {
  buffer<int> buf(range<1>(4));
  buffer<int> copy = buf;
  {
    const sycl::host_accessor acc(buf, sycl::write_only);
    for (int& x : acc) x = 5;
  }
  EXPECT_EQ(contents(copy), std::vector<int>(4, 5));
}

TEST(ConformanceBuffer, PointerIsWrittenBackWhenTheLastCopyGoes) {
  std::vector<int> data = iota(100);
  {
    std::unique_ptr<buffer<int>> copy;
    {
      buffer<int> buf(data.data(), range<1>(100));
      copy = std::make_unique<buffer<int>>(buf);
      increment(buf);
    }
    copy.reset();
    EXPECT_EQ(data, iota_plus_one(100));
  }
}

TEST(ConformanceBuffer, ContainerIsWrittenBack) {
  std::vector<int> data = iota(100);
  std::array<int, 3> small = {0, 1, 2};
  {
    buffer<int> buf(data);
    buffer<int> other(small);
    increment(buf);
    increment(other);
  }
  EXPECT_EQ(data, iota_plus_one(100));
  EXPECT_EQ(small, (std::array<int, 3>{1, 2, 3}));
}

TEST(ConformanceBuffer, ConstDataIsNeverWritten) {
  const std::vector<int> data = iota(100);
  {
    buffer<int> buf(data.data(), range<1>(100));
    buffer<int> from_container(data);
    increment(buf);
    increment(from_container);
    EXPECT_EQ(contents(buf), iota_plus_one(100));
    EXPECT_EQ(contents(from_container), iota_plus_one(100));
  }
  EXPECT_EQ(data, iota(100));
}

TEST(ConformanceBuffer, ConstDataMayHaveAnotherDestination) {
  const std::vector<int> data = iota(100);
  std::vector<int> out(100);
  {
    buffer<int> buf(data.data(), range<1>(100));
    buf.set_final_data(out.begin());
    increment(buf);
  }
  EXPECT_EQ(data, iota(100));
  EXPECT_EQ(out, iota_plus_one(100));
}

TEST(ConformanceBuffer, IteratorsAreCopiedAndNotWrittenBack) {
  std::vector<int> data = iota(50);
  const std::list<int> list(data.begin(), data.end());
  {
    buffer<int> buf(data.begin(), data.end());
    buffer<int> from_list(list.begin(), list.end());
    increment(buf);
    increment(from_list);
    EXPECT_EQ(contents(buf), iota_plus_one(50));
    EXPECT_EQ(contents(from_list), iota_plus_one(50));
  }
  EXPECT_EQ(data, iota(50));
  EXPECT_TRUE(std::equal(list.begin(), list.end(), data.begin()));
}

TEST(ConformanceBuffer, SharedPointerIsWrittenBack) {
  const std::shared_ptr<int[]> data(new int[10]());
  std::weak_ptr<int[]> watcher = data;
  {
    buffer<int> buf(data, range<1>(10));
    increment(buf);
  }
  for (int i = 0; i < 10; ++i) EXPECT_EQ(data[i], 1);
  EXPECT_EQ(watcher.use_count(), 1) << "the buffer lets go of the memory";
}

TEST(ConformanceBuffer, SharedPointerIsKeptAlive) {
  std::shared_ptr<int> data(new int[4]{1, 2, 3, 4}, std::default_delete<int[]>());
  buffer<int> buf(data, range<1>(4));
  data.reset();
  increment(buf);
  EXPECT_EQ(contents(buf), (std::vector<int>{2, 3, 4, 5}));
}

TEST(ConformanceBuffer, NullFinalDataStopsTheWriteBack) {
  std::vector<int> data = iota(10);
  std::vector<int> other = iota(10);
  {
    buffer<int> buf(data.data(), range<1>(10));
    buf.set_final_data(nullptr);
    increment(buf);
    buffer<int> second(other);
    second.set_final_data();
    increment(second);
    EXPECT_EQ(contents(buf), iota_plus_one(10));
  }
  EXPECT_EQ(data, iota(10));
  EXPECT_EQ(other, iota(10));
}

TEST(ConformanceBuffer, WriteBackMayBeDisabledAndEnabled) {
  std::vector<int> data = iota(10);
  {
    buffer<int> buf(data.data(), range<1>(10));
    buf.set_write_back(false);
    increment(buf);
  }
  EXPECT_EQ(data, iota(10));
  {
    buffer<int> buf(data.data(), range<1>(10));
    buf.set_write_back(false);
    buf.set_write_back();
    increment(buf);
  }
  EXPECT_EQ(data, iota_plus_one(10));
}

TEST(ConformanceBuffer, FinalDataGoesToIteratorsPointersAndWeakPointers) {
  std::vector<int> out(10);
  std::list<int> list(10);
  std::vector<int> original = iota(10);
  const std::shared_ptr<int> shared(new int[10](), std::default_delete<int[]>());
  {
    buffer<int> to_pointer(original.data(), range<1>(10));
    to_pointer.set_final_data(out.data());
    buffer<int> to_list(range<1>(10));
    to_list.set_final_data(list.begin());
    buffer<int> to_weak(range<1>(10));
    to_weak.set_final_data(std::weak_ptr<int>(shared));
    {
      const sycl::host_accessor a(to_list);
      const sycl::host_accessor b(to_weak);
      for (std::size_t i = 0; i < 10; ++i) a[i] = b[i] = static_cast<int>(i);
    }
    increment(to_pointer);
    increment(to_list);
    increment(to_weak);
  }
  EXPECT_EQ(out, iota_plus_one(10));
  EXPECT_EQ(original, iota(10)) << "the destination replaces the original";
  EXPECT_EQ(std::vector<int>(list.begin(), list.end()), iota_plus_one(10));
  EXPECT_EQ(std::vector<int>(shared.get(), shared.get() + 10), iota_plus_one(10));
}

TEST(ConformanceBuffer, ExpiredWeakDestinationIsSkipped) {
  std::shared_ptr<int> shared(new int[10](), std::default_delete<int[]>());
  {
    buffer<int> buf(range<1>(10));
    buf.set_final_data(std::weak_ptr<int>(shared));
    shared.reset();
    increment(buf);
  }
  SUCCEED();
}

TEST(ConformanceBuffer, DestructionWaitsForTheCommands) {
  std::vector<int> data(1, 0);
  sycl::queue q;
  {
    buffer<int> buf(data);
    for (int i = 0; i < 100; ++i) {
      q.submit([&](sycl::handler& cgh) {
        const sycl::accessor acc(buf, cgh, sycl::read_write);
        cgh.single_task([=] { acc[0] += 1; });
      });
    }
  }
  EXPECT_EQ(data[0], 100);
}

TEST(ConformanceBuffer, UseHostPointerWorksInPlace) {
  std::vector<int> data = iota(10);
  buffer<int> buf(data.data(), range<1>(10), {property::buffer::use_host_ptr()});
  EXPECT_TRUE(buf.has_property<property::buffer::use_host_ptr>());
  EXPECT_FALSE(buf.has_property<property::buffer::use_mutex>());
  EXPECT_NO_THROW(buf.get_property<property::buffer::use_host_ptr>());
  EXPECT_TRUE(throws(errc::invalid, [&] { buf.get_property<property::buffer::use_mutex>(); }));
  const sycl::host_accessor acc(buf);
  EXPECT_EQ(&acc[0], data.data());
}

TEST(ConformanceBuffer, MutexAndContextProperties) {
  std::mutex mutex;
  const sycl::context ctx;
  std::vector<int> data = iota(10);
  {
    buffer<int> buf(data.data(), range<1>(10),
                    {property::buffer::use_mutex(mutex), property::buffer::context_bound(ctx)});
    EXPECT_EQ(buf.get_property<property::buffer::use_mutex>().get_mutex_ptr(), &mutex);
    EXPECT_EQ(buf.get_property<property::buffer::context_bound>().get_context(), ctx);
  }
  EXPECT_TRUE(mutex.try_lock()) << "the buffer holds the mutex no longer";
  mutex.unlock();
}

std::size_t live_allocations = 0;

template <typename T>
struct counting_allocator {
  using value_type = T;
  counting_allocator() = default;
  template <typename U>
  counting_allocator(const counting_allocator<U>&) {}
  T* allocate(std::size_t count) {
    ++live_allocations;
    return std::allocator<T>().allocate(count);
  }
  void deallocate(T* memory, std::size_t count) {
    --live_allocations;
    std::allocator<T>().deallocate(memory, count);
  }
  friend bool operator==(const counting_allocator&, const counting_allocator&) { return true; }
};

TEST(ConformanceBuffer, AllocatorProvidesTheMemory) {
  {
    buffer<int, 1, counting_allocator<int>> buf(range<1>(10));
    static_assert(std::is_same_v<decltype(buf.get_allocator()), counting_allocator<int>>);
    const sycl::host_accessor acc(buf, sycl::write_only);
    acc[0] = 1;
  }
  EXPECT_EQ(live_allocations, 0U);
}

/// The least number of ints between a buffer's beginning and that of a part that the default
/// device may access; the alignment is given in bits.
std::size_t part_alignment() {
  const auto bits = sycl::device().get_info<sycl::info::device::mem_base_addr_align>();
  return std::max<std::size_t>(bits / (8 * sizeof(int)), 1);
}

TEST(ConformanceBuffer, SubBuffersShareTheContents) {
  const std::size_t first = part_alignment();
  const std::size_t count = 2 * first + 5;
  std::vector<int> data = iota(count);
  {
    buffer<int> buf(data);
    buffer<int> part(buf, id<1>(first), range<1>(3));
    EXPECT_TRUE(part.is_sub_buffer());
    EXPECT_FALSE(buf.is_sub_buffer());
    EXPECT_EQ(part.get_range(), range<1>(3));
    EXPECT_EQ(part.byte_size(), 3 * sizeof(int));
    const int start = static_cast<int>(first);
    EXPECT_EQ(contents(part), (std::vector<int>{start, start + 1, start + 2}));
    EXPECT_TRUE(part != buf);
    increment(part);
    EXPECT_EQ(contents(buf)[first + 1], start + 2);
    buffer<int> whole(buf, id<1>(0), range<1>(count));
    EXPECT_EQ(whole.size(), count);
  }
  std::vector<int> expected = iota(count);
  for (std::size_t i = first; i < first + 3; ++i) ++expected[i];
  EXPECT_EQ(data, expected);
}

TEST(ConformanceBuffer, DisjointSubBuffersAreWrittenIndependently) {
  const std::size_t step = part_alignment();
  std::vector<int> data(4 * step, 0);
  {
    buffer<int> buf(data);
    sycl::queue q;
    for (std::size_t p = 0; p < 4; ++p) {
      buffer<int> part(buf, id<1>(p * step), range<1>(step));
      q.submit([&](sycl::handler& cgh) {
        const sycl::accessor acc(part, cgh, sycl::write_only);
        cgh.parallel_for(range<1>(step), [=](id<1> i) { acc[i] = static_cast<int>(p) + 1; });
      });
    }
    increment(buf);
  }
  for (std::size_t i = 0; i < data.size(); ++i) {
    ASSERT_EQ(data[i], static_cast<int>(i / step) + 2) << i;
  }
}

TEST(ConformanceBuffer, DevicesNeedAlignedSubBuffers) {
  const std::size_t step = part_alignment();
  if (step == 1) GTEST_SKIP() << "every int is aligned enough";
  buffer<int> buf(range<1>(2 * step));
  buffer<int> part(buf, id<1>(1), range<1>(step));
  sycl::queue q;
  EXPECT_TRUE(throws(errc::invalid, [&] {
    q.submit([&](sycl::handler& cgh) {
      const sycl::accessor acc(part, cgh, sycl::read_write);
      cgh.single_task([=] { acc[0] = 1; });
    });
  }));
}

TEST(ConformanceBuffer, SubBufferRanges) {
  buffer<int> line(range<1>(12));
  EXPECT_TRUE(throws(errc::invalid, [&] { buffer<int>(line, id<1>(4), range<1>(9)); }));
  EXPECT_TRUE(throws(errc::invalid, [&] { buffer<int>(line, id<1>(13), range<1>(1)); }));
  EXPECT_TRUE(throws(errc::invalid,
                     [&] { buffer<int>(line, id<1>(static_cast<std::size_t>(-1)), range<1>(2)); }));
  buffer<int> part(line, id<1>(2), range<1>(4));
  EXPECT_TRUE(throws(errc::invalid, [&] { buffer<int>(part, id<1>(0), range<1>(2)); }));

  buffer<int, 2> plane(range<2>(4, 6));
  EXPECT_NO_THROW((buffer<int, 2>(plane, id<2>(1, 0), range<2>(2, 6))));
  EXPECT_NO_THROW((buffer<int, 2>(plane, id<2>(1, 2), range<2>(1, 3))));
  EXPECT_TRUE(throws(errc::invalid, [&] { buffer<int, 2>(plane, id<2>(0, 0), range<2>(2, 3)); }));
  EXPECT_TRUE(throws(errc::invalid, [&] { buffer<int, 2>(plane, id<2>(3, 0), range<2>(2, 6)); }));

  buffer<int, 3> box(range<3>(2, 3, 4));
  EXPECT_NO_THROW((buffer<int, 3>(box, id<3>(1, 1, 0), range<3>(1, 2, 4))));
  EXPECT_TRUE(
      throws(errc::invalid, [&] { buffer<int, 3>(box, id<3>(0, 0, 0), range<3>(2, 2, 4)); }));
}

TEST(ConformanceBuffer, Reinterpretation) {
  std::vector<std::uint32_t> data(8, 0x01010101U);
  buffer<std::uint32_t> buf(data);
  auto bytes = buf.reinterpret<unsigned char, 1>();
  static_assert(std::is_same_v<decltype(bytes)::value_type, unsigned char>);
  EXPECT_EQ(bytes.size(), 32U);
  auto plane = buf.reinterpret<std::int32_t, 2>(range<2>(2, 4));
  EXPECT_EQ(plane.get_range(), range<2>(2, 4));
  {
    const sycl::host_accessor acc(plane);
    EXPECT_EQ(acc[id<2>(1, 3)], 0x01010101);
    acc[id<2>(1, 3)] = 5;
  }
  {
    const sycl::host_accessor acc(buf, sycl::read_only);
    EXPECT_EQ(acc[7], 5U);
  }
  auto same = buf.reinterpret<float>();
  EXPECT_EQ(same.get_range(), range<1>(8));
  EXPECT_TRUE(throws(errc::invalid, [&] { buf.reinterpret<std::uint64_t, 1>(range<1>(5)); }));
  buffer<unsigned char> odd(range<1>(7));
  EXPECT_TRUE(throws(errc::invalid, [&] { odd.reinterpret<std::uint16_t, 1>(); }));
}

TEST(ConformanceBuffer, TwoDimensionsAreRowMajor) {
  std::vector<int> data = iota(24);
  buffer<int, 2> buf(data.data(), range<2>(4, 6));
  const sycl::host_accessor acc(buf, sycl::read_only);
  EXPECT_EQ((acc[id<2>(2, 3)]), 2 * 6 + 3);
  EXPECT_EQ(acc[2][3], 2 * 6 + 3);
}

}  // namespace
