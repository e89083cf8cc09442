// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <array>
#include <climits>
#include <cstddef>
#include <sycl/atomic_ref.hpp>
#include <thread>
#include <type_traits>
#include <vector>

namespace {

using sycl::memory_order;
using sycl::memory_scope;
using sycl::access::address_space;

template <typename T, memory_order Order = memory_order::relaxed>
using reference = sycl::atomic_ref<T, Order, memory_scope::device, address_space::global_space>;

using relaxed_int = reference<int>;
using ordered_int = reference<int, memory_order::acq_rel>;
using sequential_int = reference<int, memory_order::seq_cst>;

static_assert(relaxed_int::default_read_order == memory_order::relaxed);
static_assert(relaxed_int::default_write_order == memory_order::relaxed);
static_assert(ordered_int::default_read_order == memory_order::acquire);
static_assert(ordered_int::default_write_order == memory_order::release);
static_assert(ordered_int::default_read_modify_write_order == memory_order::acq_rel);
static_assert(sequential_int::default_read_order == memory_order::seq_cst);
static_assert(sequential_int::default_write_order == memory_order::seq_cst);
static_assert(relaxed_int::default_scope == memory_scope::device);
static_assert(relaxed_int::required_alignment >= alignof(int));
static_assert(sycl::memory_order_acq_rel == memory_order::acq_rel);
static_assert(sycl::memory_scope_system == memory_scope::system);

static_assert(std::is_copy_constructible_v<relaxed_int>);
static_assert(std::is_nothrow_constructible_v<relaxed_int, int&>);
static_assert(!std::is_convertible_v<int&, relaxed_int>);
static_assert(!std::is_copy_assignable_v<relaxed_int>);
static_assert(!std::is_default_constructible_v<relaxed_int>);
static_assert(std::is_same_v<relaxed_int::value_type, int>);
static_assert(std::is_same_v<reference<float>::difference_type, float>);
static_assert(std::is_same_v<reference<char*>::difference_type, std::ptrdiff_t>);
static_assert(std::is_same_v<sycl::atomic_ref<int, memory_order::relaxed, memory_scope::device>,
                             sycl::atomic_ref<int, memory_order::relaxed, memory_scope::device,
                                              address_space::generic_space>>);

template <typename Ref>
concept has_bits = requires(Ref r, typename Ref::value_type v) {
  r.fetch_and(v);
  r |= v;
};
template <typename Ref>
concept has_steps = requires(Ref r) {
  ++r;
  r--;
};
template <typename Ref>
concept has_extrema = requires(Ref r, typename Ref::value_type v) {
  r.fetch_min(v);
  r.fetch_max(v);
};
static_assert(has_bits<reference<long>> && !has_bits<reference<float>> &&
              !has_bits<reference<int*>>);
static_assert(has_steps<reference<unsigned>> && has_steps<reference<int*>> &&
              !has_steps<reference<double>>);
static_assert(has_extrema<reference<int>> && has_extrema<reference<double>> &&
              !has_extrema<reference<int*>>);

template <typename T>
class AtomicNumber : public ::testing::Test {};
using Numbers = ::testing::Types<int, unsigned, long, unsigned long, long long, unsigned long long,
                                 float, double>;
TYPED_TEST_SUITE(AtomicNumber, Numbers);

TYPED_TEST(AtomicNumber, LoadStoreExchange) {
  using T = TypeParam;
  T object = 5;
  const reference<T, memory_order::seq_cst> ref(object);
  EXPECT_EQ(ref.load(), T{5});
  EXPECT_EQ(static_cast<T>(ref), T{5});
  ref.store(7);
  EXPECT_EQ(ref.load(memory_order::acquire, memory_scope::system), T{7});
  EXPECT_EQ((ref = 8), T{8});
  EXPECT_EQ(ref.exchange(9), T{8});
  const auto other = ref;
  EXPECT_EQ(other.load(), T{9});
  EXPECT_TRUE(ref.is_lock_free());
}

TYPED_TEST(AtomicNumber, CompareExchange) {
  using T = TypeParam;
  T object = 1;
  const reference<T, memory_order::acq_rel> ref(object);
  T expected = 2;
  EXPECT_FALSE(ref.compare_exchange_strong(expected, 3));
  EXPECT_EQ(expected, T{1});
  EXPECT_TRUE(ref.compare_exchange_strong(expected, 3));
  EXPECT_EQ(ref.load(), T{3});
  expected = 3;
  EXPECT_TRUE(ref.compare_exchange_strong(expected, 4, memory_order::release, memory_order::relaxed,
                                          memory_scope::work_group));
  expected = 0;
  EXPECT_FALSE(ref.compare_exchange_weak(expected, 5, memory_order::release));
  EXPECT_EQ(expected, T{4});
  while (!ref.compare_exchange_weak(expected, 6)) {
  }
  EXPECT_EQ(ref.load(), T{6});
  EXPECT_FALSE(
      ref.compare_exchange_weak(expected = 0, 5, memory_order::seq_cst, memory_order::acquire));
}

TYPED_TEST(AtomicNumber, Arithmetic) {
  using T = TypeParam;
  T object = 10;
  const reference<T> ref(object);
  EXPECT_EQ(ref.fetch_add(5), T{10});
  EXPECT_EQ(ref.fetch_sub(3), T{15});
  EXPECT_EQ(ref += 8, T{20});
  EXPECT_EQ(ref -= 5, T{15});
  EXPECT_EQ(ref.fetch_min(20), T{15});
  EXPECT_EQ(ref.fetch_min(12), T{15});
  EXPECT_EQ(ref.fetch_max(11), T{12});
  EXPECT_EQ(ref.fetch_max(30, memory_order::acq_rel, memory_scope::system), T{12});
  EXPECT_EQ(object, T{30});
  if constexpr (std::is_integral_v<T>) {
    EXPECT_EQ(ref++, T{30});
    EXPECT_EQ(++ref, T{32});
    EXPECT_EQ(ref--, T{32});
    EXPECT_EQ(--ref, T{30});
    EXPECT_EQ(ref.fetch_and(28), T{30});
    EXPECT_EQ(ref.fetch_or(3), T{28});
    EXPECT_EQ(ref.fetch_xor(1), T{31});
    EXPECT_EQ(ref &= 12, T{12});
    EXPECT_EQ(ref |= 1, T{13});
    EXPECT_EQ(ref ^= 15, T{2});
  }
}

TYPED_TEST(AtomicNumber, ConcurrentUpdatesAreNotLost) {
  using T = TypeParam;
  constexpr int threads = 4;
  constexpr int updates = 5000;
  T sum = 0;
  T least = 1000;
  T greatest = 0;
  {
    std::vector<std::jthread> workers;
    for (int t = 0; t < threads; ++t) {
      workers.emplace_back([&, t] {
        for (int i = 0; i < updates; ++i) {
          reference<T>(sum).fetch_add(1);
          reference<T>(least).fetch_min(static_cast<T>(500 + (i * threads + t) % 400));
          reference<T>(greatest).fetch_max(static_cast<T>(500 + (i * threads + t) % 400));
        }
      });
    }
  }
  EXPECT_EQ(sum, static_cast<T>(threads * updates));
  EXPECT_EQ(least, T{500});
  EXPECT_EQ(greatest, T{899});
}

TEST(AtomicRef, IntegersWrapAround) {
  int object = INT_MAX;
  const relaxed_int ref(object);
  EXPECT_EQ(ref += 1, INT_MIN);
  EXPECT_EQ(--ref, INT_MAX);
  EXPECT_EQ(object, INT_MAX);
}

TEST(AtomicRef, Pointers) {
  std::array<int, 8> data = {};
  int* object = data.data();
  const reference<int*> ref(object);
  EXPECT_EQ(ref.fetch_add(3), &data[0]);
  EXPECT_EQ(ref.fetch_sub(1), &data[3]);
  EXPECT_EQ(ref++, &data[2]);
  EXPECT_EQ(++ref, &data[4]);
  EXPECT_EQ(ref--, &data[4]);
  EXPECT_EQ(--ref, &data[2]);
  EXPECT_EQ(ref += 4, &data[6]);
  EXPECT_EQ(ref -= 6, &data[0]);
  EXPECT_EQ(ref.exchange(&data[5]), &data[0]);
  int* expected = &data[5];
  EXPECT_TRUE(ref.compare_exchange_strong(expected, nullptr));
  EXPECT_EQ(ref.load(), nullptr);
}

TEST(AtomicRef, ReleasePublishesToAcquire) {
  for (int round = 0; round < 200; ++round) {
    int payload = 0;
    int ready = 0;
    std::jthread writer([&] {
      payload = 42;
      ordered_int(ready).store(1);
    });
    while (ordered_int(ready).load() == 0) {
    }
    EXPECT_EQ(payload, 42);
  }
}

TEST(AtomicRef, FencePublishesAcrossRelaxedAccesses) {
  // Store buffering: with sequentially consistent fences, one thread at least sees the other.
  for (int round = 0; round < 200; ++round) {
    int x = 0;
    int y = 0;
    int seen_x = -1;
    int seen_y = -1;
    {
      std::jthread first([&] {
        relaxed_int(x).store(1);
        sycl::atomic_fence(memory_order::seq_cst, memory_scope::device);
        seen_y = relaxed_int(y).load();
      });
      std::jthread second([&] {
        relaxed_int(y).store(1);
        sycl::atomic_fence(memory_order::seq_cst, memory_scope::device);
        seen_x = relaxed_int(x).load();
      });
    }
    EXPECT_EQ(seen_x | seen_y, 1);
  }
}

}  // namespace
