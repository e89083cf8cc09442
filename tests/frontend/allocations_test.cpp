// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// What calls that the host serves allocate: nothing, unless they have events to wait for.

#include <gtest/gtest.h>

#include <algorithm>
#include <arbor/lumen/vm.hpp>
#include <cstddef>
#include <cstdlib>
#include <new>
#include <span>
#include <sycl/sycl.hpp>
#include <vector>

namespace {

thread_local int allocations = 0;

void* allocate(std::size_t bytes, std::size_t alignment) {
  ++allocations;
  const std::size_t whole = (std::max<std::size_t>(bytes, 1) + alignment - 1) & ~(alignment - 1);
  void* const memory = std::aligned_alloc(alignment, whole);
  if (memory == nullptr) throw std::bad_alloc();
  return memory;
}

}  // namespace

void* operator new(std::size_t bytes) { return allocate(bytes, alignof(std::max_align_t)); }
void* operator new(std::size_t bytes, std::align_val_t alignment) {
  return allocate(bytes, static_cast<std::size_t>(alignment));
}
// Not inlined: where it is and its counterpart is not, GCC takes them for a mismatched pair.
[[gnu::noinline]] void operator delete(void* memory) noexcept { std::free(memory); }
void operator delete(void* memory, std::size_t) noexcept { operator delete(memory); }
void operator delete(void* memory, std::align_val_t) noexcept { operator delete(memory); }
void operator delete(void* memory, std::size_t, std::align_val_t) noexcept {
  operator delete(memory);
}

namespace {

namespace vm = arbor::lumen::vm;

class Allocations : public ::testing::Test {
 protected:
  /// Of one call, after a first one has found tables and kernels.
  template <typename Call>
  static int of(Call call) {
    call();
    const int before = allocations;
    call();
    return allocations - before;
  }

  sycl::queue queue_{sycl::cpu_selector_v};
  float a_[4] = {1, 2, 3, 4}, y_[4] = {}, z_[4] = {};
};

TEST_F(Allocations, AreCounted) {
  EXPECT_EQ(of([] { delete new int; }), 1);
  EXPECT_EQ(of([] { std::vector<sycl::event> two(2); }), 3);
}

TEST_F(Allocations, OfAPointerCallAreNone) {
  EXPECT_EQ(of([&] { vm::exp(queue_, 1, a_, y_).wait(); }), 0);
  EXPECT_EQ(of([&] { vm::add(queue_, 1, a_, a_, y_).wait(); }), 0);
  EXPECT_EQ(of([&] { vm::sincos(queue_, 1, a_, y_, z_).wait(); }), 0);
  EXPECT_EQ(of([&] { vm::powx(queue_, 1, a_, 2.0f, y_).wait(); }), 0);
  EXPECT_EQ(of([&] { vm::linearfrac(queue_, 1, a_, a_, 1.f, 2.f, 3.f, 4.f, y_).wait(); }), 0);
  EXPECT_EQ(of([&] { vm::exp(queue_, 4, a_, y_, {}, vm::enums::mode::la).wait(); }), 0);
}

TEST_F(Allocations, OfACallWithoutAHandlerAreNone) {
  EXPECT_EQ(of([&] { vm::abs(queue_, 1, a_, y_).wait(); }), 0);
}

TEST_F(Allocations, OfACallWithTheCallersHandlerAreNone) {
  const vm::error_handler<float> handler(9.0f, vm::enums::overflow);
  EXPECT_EQ(of([&] { vm::exp(queue_, 1, a_, y_, {}, {}, handler).wait(); }), 0);
}

TEST_F(Allocations, OfASpanCallAreNone) {
  const std::span<const float> a(a_);
  const std::span<float> y(y_);
  EXPECT_EQ(of([&] { vm::exp(queue_, a, y).wait(); }), 0);
  EXPECT_EQ(of([&] { vm::exp(queue_, a, {0, 2, 2}, y, {1, 2, 1}).wait(); }), 0);
}

TEST_F(Allocations, OfACallThatWaitsAreOne) {
  const std::vector<sycl::event> depends(2);
  EXPECT_EQ(of([&] { vm::exp(queue_, 1, a_, y_, depends).wait(); }), 1);
}

}  // namespace
