// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <atomic>
#include <chrono>
#include <cstdint>
#include <memory>
#include <mutex>
#include <numeric>
#include <thread>
#include <vector>

#include <gtest/gtest.h>
#include <sycl/sycl.hpp>

#include "gate.hpp"

namespace {

using sycl::buffer;
using sycl::id;
using sycl::range;

static_assert(std::is_same_v<buffer<int>, buffer<int, 1>>);
static_assert(std::is_same_v<buffer<int>::value_type, int>);
static_assert(std::is_same_v<buffer<int>::reference, int&>);
static_assert(std::is_same_v<buffer<int>::const_reference, const int&>);
static_assert(std::is_same_v<buffer<int, 2>::allocator_type, sycl::buffer_allocator<int>>);

template <typename T, int D, typename A>
void add_one(buffer<T, D, A>& buf) {
  sycl::queue().submit([&](sycl::handler& cgh) {
    const sycl::accessor acc(buf, cgh);
    cgh.parallel_for(buf.get_range(), [=](id<D> i) { acc[i] += 1; });
  });
}

TEST(Buffer, KnowsItsShape) {
  buffer<float, 3> buf(range<3>(2, 3, 4));
  EXPECT_EQ(buf.get_range(), range<3>(2, 3, 4));
  EXPECT_EQ(buf.size(), 24U);
  EXPECT_EQ(buf.byte_size(), 96U);
  EXPECT_FALSE(buf.is_sub_buffer());
}

TEST(Buffer, WritesBackToTheCallersMemory) {
  std::vector<int> v(1000, 1);
  {
    buffer<int> buf(v.data(), range<1>(v.size()));
    add_one(buf);
  }
  EXPECT_EQ(v, std::vector<int>(1000, 2));
  {
    buffer buf(v);
    add_one(buf);
    add_one(buf);
  }
  EXPECT_EQ(v, std::vector<int>(1000, 4));
}

TEST(Buffer, DestructionWaitsForTheCommands) {
  std::vector<int> v(8, 1);
  sycl::queue q;
  std::atomic<bool> done{false};
  {
    buffer<int> buf(v.data(), range<1>(8));
    q.submit([&](sycl::handler& cgh) {
      const sycl::accessor acc(buf, cgh, sycl::read_write_host_task);
      cgh.host_task([=, &done] {
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
        acc[0] = 5;
        done = true;
      });
    });
  }
  EXPECT_TRUE(done);
  EXPECT_EQ(v[0], 5);
}

TEST(Buffer, WithoutHostMemoryDestructionDoesNotWait) {
  sycl::queue q;
  gate g;
  int result = 0;
  sycl::event e;
  {
    buffer<int> buf(range<1>(8));
    e = q.submit([&](sycl::handler& cgh) {
      const sycl::accessor acc(buf, cgh, sycl::read_write_host_task);
      cgh.host_task([=, &g, &result] {
        g.hold();
        acc[7] = 5;
        result = acc[7];
      });
    });
    g.passes(e);
  }
  EXPECT_FALSE(is_complete(e));
  g.open();
  e.wait();
  EXPECT_EQ(result, 5);
}

TEST(Buffer, LeavesConstantMemoryAndIteratorRangesAlone) {
  const std::vector<int> constant(16, 1);
  std::vector<int> iterated(16, 1);
  {
    buffer<int> a(constant.data(), range<1>(16));
    buffer<int> b(constant);
    buffer<int> c(iterated.begin(), iterated.end());
    add_one(a);
    add_one(b);
    add_one(c);
    EXPECT_EQ(sycl::host_accessor(a)[3], 2);
    EXPECT_EQ(sycl::host_accessor(b)[3], 2);
    EXPECT_EQ(sycl::host_accessor(c)[3], 2);
  }
  EXPECT_EQ(constant, std::vector<int>(16, 1));
  EXPECT_EQ(iterated, std::vector<int>(16, 1));
}

TEST(Buffer, OfBoolFromIterators) {
  const std::vector<bool> bits{true, false, true};
  buffer<bool> buf(bits.begin(), bits.end());
  const sycl::host_accessor acc(buf, sycl::read_only);
  EXPECT_TRUE(acc[0]);
  EXPECT_FALSE(acc[1]);
  EXPECT_TRUE(acc[2]);
}

TEST(Buffer, SharesOwnershipOfASharedPointer) {
  auto single = std::make_shared<int>(1);
  std::shared_ptr<int[]> array(new int[4]{1, 1, 1, 1});
  const std::weak_ptr<int> watched = single;
  {
    buffer<int> a(single, range<1>(1));
    buffer<int> b(array, range<1>(4));
    single.reset();
    EXPECT_FALSE(watched.expired());
    add_one(a);
    add_one(b);
  }
  EXPECT_TRUE(watched.expired());
  EXPECT_EQ(array[3], 2);
}

TEST(Buffer, FinalDataGoesWhereItIsTold) {
  std::vector<int> source(6, 1);
  std::vector<int> pointer_target(6);
  std::vector<long> iterator_target(6);
  {
    buffer<int> a(source.data(), range<1>(6));
    a.set_final_data(pointer_target.data());
    add_one(a);
  }
  EXPECT_EQ(source, std::vector<int>(6, 1));
  EXPECT_EQ(pointer_target, std::vector<int>(6, 2));
  {
    buffer<int> a(source.data(), range<1>(6));
    a.set_final_data(iterator_target.begin());
  }
  EXPECT_EQ(iterator_target, std::vector<long>(6, 1));
  {
    buffer<int> a(source.data(), range<1>(6));
    a.set_final_data(nullptr);
    add_one(a);
  }
  EXPECT_EQ(source, std::vector<int>(6, 1));
}

TEST(Buffer, FinalDataMayExpire) {
  std::shared_ptr<int> alive(new int[4]{}, std::default_delete<int[]>());
  std::shared_ptr<int> dying(new int[4]{}, std::default_delete<int[]>());
  {
    buffer<int> a(range<1>(4));
    buffer<int> b(range<1>(4));
    a.get_host_access()[2] = 3;
    a.set_final_data(std::weak_ptr<int>(alive));
    b.set_final_data(std::weak_ptr<int>(dying));
    dying.reset();
  }
  EXPECT_EQ(alive.get()[2], 3);
}

TEST(Buffer, WriteBackCanBeTurnedOffAndOn) {
  std::vector<int> v(6, 1);
  {
    buffer<int> buf(v.data(), range<1>(6));
    buf.set_write_back(false);
    add_one(buf);
  }
  EXPECT_EQ(v, std::vector<int>(6, 1));
  {
    buffer<int> buf(v.data(), range<1>(6));
    buf.set_write_back(false);
    add_one(buf);
    buf.set_write_back(true);
  }
  EXPECT_EQ(v, std::vector<int>(6, 2));
}

TEST(Buffer, ForcedWriteBackNeedsMemoryThatMayBeWrittenTo) {
  const std::vector<int> constant(6, 1);
  {
    buffer<int> copied(constant.data(), range<1>(6)), plain(range<1>(6));
    for (buffer<int>* buf : {&copied, &plain}) {
      add_one(*buf);
      buf->set_write_back(true);
    }
  }
  EXPECT_EQ(constant, std::vector<int>(6, 1));
}

TEST(Buffer, HoldsTheMutexWhileItTouchesTheCallersMemory) {
  std::vector<int> v(6, 1);
  std::mutex m;
  {
    buffer<int> buf(v.data(), range<1>(6), {sycl::property::buffer::use_mutex(m)});
    EXPECT_EQ(buf.get_property<sycl::property::buffer::use_mutex>().get_mutex_ptr(), &m);
    add_one(buf);
    const sycl::host_accessor acc(buf);
    const std::lock_guard lock(m);
    EXPECT_EQ(v[0], 1);
    EXPECT_EQ(acc[0], 2);
  }
  EXPECT_EQ(v, std::vector<int>(6, 2));
  EXPECT_TRUE(m.try_lock());
  m.unlock();
}

TEST(Buffer, UseHostPointerWorksInPlace) {
  std::vector<int> v(6, 1);
  buffer<int> buf(v.data(), range<1>(6), {sycl::property::buffer::use_host_ptr()});
  EXPECT_TRUE(buf.has_property<sycl::property::buffer::use_host_ptr>());
  EXPECT_FALSE(buf.has_property<sycl::property::buffer::use_mutex>());
  EXPECT_EQ(sycl::host_accessor(buf).get_pointer(), v.data());
}

TEST(Buffer, UsesItsAllocator) {
  using allocator = std::allocator<int>;
  const allocator a;
  buffer<int, 1, allocator> buf(range<1>(8), a);
  static_assert(std::is_same_v<decltype(buf.get_allocator()), allocator>);
  add_one(buf);
  sycl::buffer<int, 2> aligned(range<2>(3, 5));
  const auto address = reinterpret_cast<std::uintptr_t>(sycl::host_accessor(aligned).get_pointer());
  EXPECT_EQ(address % 64, 0U);
}

TEST(Buffer, CopiesAreTheSameBufferAndOthersAreNot) {
  buffer<int> a(range<1>(4));
  const buffer<int> same = a;
  const buffer<int> other(range<1>(4));
  EXPECT_TRUE(a == same);
  EXPECT_TRUE(a != other);
  EXPECT_EQ(std::hash<buffer<int>>()(a), std::hash<buffer<int>>()(same));
  EXPECT_NE(std::hash<buffer<int>>()(a), std::hash<buffer<int>>()(other));
  a.get_host_access()[1] = 9;
  buffer<int> third = same;
  EXPECT_EQ(sycl::host_accessor(third)[1], 9);
}

int& element(buffer<int>& buf, std::size_t i) {
  const sycl::host_accessor elements(buf);
  return elements[i];
}

TEST(Buffer, SharesAStorageThatIsMadeLater) {
  buffer<int> untouched(range<1>(1)), other(range<1>(1));
  EXPECT_EQ(untouched, untouched);
  EXPECT_NE(untouched, other);
  buffer<int> copy = untouched;
  EXPECT_EQ(untouched, copy);
  EXPECT_NE(copy, other);
  EXPECT_EQ(std::hash<buffer<int>>()(untouched), std::hash<buffer<int>>()(copy));
  element(copy, 0) = 7;
  EXPECT_EQ(element(untouched, 0), 7);
  copy = other;
  EXPECT_EQ(copy, other);
  buffer<int> moved = std::move(other);
  EXPECT_EQ(copy, moved);
  moved = buffer<int>(range<1>(2));
  EXPECT_NE(copy, moved);
  EXPECT_EQ(moved.size(), 2U);
  element(moved, 1) = 3;
  EXPECT_EQ(element(moved, 1), 3);
}

TEST(Buffer, CopiesMadeAtTheSameTimeShareAStorage) {
  for (int round = 0; round < 200; ++round) {
    const buffer<int> original(range<1>(1));
    std::atomic<int> ready{0};
    std::vector<buffer<int>> copies(2, buffer<int>(range<1>(1)));
    const auto copy = [&](int i) {
      for (++ready; ready < 2;) {
      }
      copies[i] = original;
    };
    std::thread first(copy, 0), second(copy, 1);
    first.join();
    second.join();
    ASSERT_EQ(copies[0], original);
    ASSERT_EQ(copies[1], original);
  }
}

TEST(Buffer, ReinterpretsItsBytes) {
  buffer<std::uint32_t> buf(range<1>(6));
  { buf.get_host_access()[1] = 0x01020304; }
  auto bytes = buf.reinterpret<std::uint8_t>();
  static_assert(std::is_same_v<decltype(bytes)::value_type, std::uint8_t>);
  EXPECT_EQ(bytes.size(), 24U);
  EXPECT_EQ(sycl::host_accessor(bytes)[4], 4);
  auto shaped = buf.reinterpret<float, 2>(range<2>(2, 3));
  EXPECT_EQ(shaped.get_range(), range<2>(2, 3));
  add_one(bytes);
  EXPECT_EQ(sycl::host_accessor(buf)[1], 0x02030405U);
  EXPECT_THROW((buf.reinterpret<float, 2>(range<2>(2, 4))), sycl::exception);
  buffer<char> odd(range<1>(7));
  EXPECT_THROW(odd.reinterpret<int>(), sycl::exception);
}

TEST(SubBuffer, IsAWindowOnItsBuffer) {
  std::vector<int> v(64);
  std::iota(v.begin(), v.end(), 0);
  {
    buffer<int> whole(v);
    buffer<int> part(whole, id<1>(16), range<1>(32));
    EXPECT_TRUE(part.is_sub_buffer());
    EXPECT_EQ(part.size(), 32U);
    EXPECT_FALSE(part == whole);
    add_one(part);
    const auto bytes = part.reinterpret<char>();
    EXPECT_TRUE(bytes.is_sub_buffer());
    EXPECT_EQ(bytes.size(), 128U);
  }
  for (int i = 0; i < 64; ++i) {
    EXPECT_EQ(v[static_cast<std::size_t>(i)], i + (i >= 16 && i < 48 ? 1 : 0));
  }
}

TEST(SubBuffer, OfSeveralDimensionsIsContiguous) {
  buffer<int, 2> whole(range<2>(16, 16));
  {
    const sycl::host_accessor acc(whole);
    std::iota(acc.begin(), acc.end(), 0);
  }
  buffer<int, 2> rows(whole, id<2>(4, 0), range<2>(3, 16));
  EXPECT_EQ((sycl::host_accessor(rows)[id<2>(2, 5)]), 6 * 16 + 5);
  buffer<int, 2> line(whole, id<2>(4, 3), range<2>(1, 7));
  EXPECT_EQ((sycl::host_accessor(line)[id<2>(0, 6)]), 4 * 16 + 9);
  EXPECT_THROW((buffer<int, 2>(whole, id<2>(0, 0), range<2>(2, 15))), sycl::exception);
}

TEST(SubBuffer, RefusesWhatTheStandardForbids) {
  const auto code = [](auto&& make) {
    try {
      make();
    } catch (const sycl::exception& e) {
      return static_cast<sycl::errc>(e.code().value());
    }
    return sycl::errc::success;
  };
  buffer<int> whole(range<1>(64));
  buffer<int> part(whole, id<1>(16), range<1>(32));
  using sycl::errc;
  EXPECT_EQ(code([&] { buffer<int>(part, id<1>(0), range<1>(4)); }), errc::invalid);
  EXPECT_EQ(code([&] { buffer<int>(whole, id<1>(60), range<1>(5)); }), errc::invalid);
  EXPECT_EQ(code([&] { buffer<int>(whole, id<1>(65), range<1>(0)); }), errc::invalid);

  sycl::queue q;
  buffer<int> misaligned(whole, id<1>(1), range<1>(4));
  EXPECT_EQ(code([&] {
              q.submit([&](sycl::handler& cgh) {
                const sycl::accessor acc(misaligned, cgh);
                cgh.single_task([=] { acc[0] = 1; });
              });
            }),
            errc::invalid);
  EXPECT_EQ(code([&] {
              const sycl::accessor placeholder(misaligned);
              q.submit([&](sycl::handler& cgh) { cgh.require(placeholder); });
            }),
            errc::invalid);
}

TEST(SubBuffer, WritesItsOwnFinalData) {
  std::vector<int> target(16);
  buffer<int> whole(range<1>(64));
  {
    buffer<int> part(whole, id<1>(16), range<1>(16));
    part.set_final_data(target.data());
    sycl::queue().submit([&](sycl::handler& cgh) {
      const sycl::accessor acc(part, cgh, sycl::write_only, sycl::no_init);
      cgh.parallel_for(16, [=](id<1> i) { acc[i] = static_cast<int>(i[0]); });
    });
  }
  EXPECT_EQ(target[15], 15);
}

TEST(Buffer, BoundToAContextRefusesOthers) {
  const sycl::context own;
  const sycl::context other;
  buffer<int> buf(range<1>(4), {sycl::property::buffer::context_bound(own)});
  EXPECT_EQ(buf.get_property<sycl::property::buffer::context_bound>().get_context(), own);
  sycl::queue good(own, sycl::device());
  sycl::queue bad(other, sycl::device());
  const auto use = [&](sycl::queue& q) {
    q.submit([&](sycl::handler& cgh) {
       const sycl::accessor acc(buf, cgh);
       cgh.single_task([=] { acc[0] = 1; });
     }).wait();
  };
  EXPECT_NO_THROW(use(good));
  EXPECT_THROW(use(bad), sycl::exception);
}

}  // namespace
