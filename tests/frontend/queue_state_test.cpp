// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include <arbor/lumen/vm.hpp>
#include <cstdint>
#include <deque>
#include <sycl/sycl.hpp>
#include <type_traits>
#include <vector>

namespace {

using namespace arbor::lumen;
namespace enums = vm::enums;
using vm::clear_status;
using vm::get_mode;
using vm::get_status;
using vm::set_mode;
using vm::set_status;

static_assert(std::is_same_v<decltype(get_mode(std::declval<sycl::queue&>())), enums::mode>);
static_assert(std::is_same_v<decltype(get_status(std::declval<sycl::queue&>())), enums::status>);

constexpr enums::mode no_mode = enums::not_defined;

/// A queue without a history. It is kept: a later one in its place would meet its state.
sycl::queue& new_queue() {
  static std::deque<sycl::queue> queues;
  return queues.emplace_back();
}

TEST(QueueMode, OfAFreshQueueIsTheDefault) {
  sycl::queue& queue = new_queue();
  EXPECT_EQ(0x1811204u, get_mode(queue));
  EXPECT_EQ(enums::default_mode, get_mode(queue));
  EXPECT_EQ(0x1811204u, get_mode(queue)) << "reading stores nothing";
  EXPECT_EQ(no_mode, set_mode(queue, enums::la));
}

TEST(QueueMode, SettingReturnsTheWordBefore) {
  sycl::queue& queue = new_queue();
  EXPECT_EQ(0u, set_mode(queue, enums::la));
  EXPECT_EQ(0x181120Cu, set_mode(queue, enums::ep | enums::slice_minimum));
  EXPECT_EQ(0x181220Fu, set_mode(queue, enums::badarg_quiet));
  EXPECT_EQ(0x182220Fu, get_mode(queue));
}

TEST(QueueMode, SettingOneGroupLeavesTheOthers) {
  sycl::queue& queue = new_queue();
  set_mode(queue, enums::la);
  EXPECT_EQ(0x181120Cu, get_mode(queue));
  set_mode(queue, enums::global_status_report);
  EXPECT_EQ(0x181110Cu, get_mode(queue));
  set_mode(queue, enums::slice_cyclic);
  EXPECT_EQ(0x181410Cu, get_mode(queue));
  set_mode(queue, enums::mode_missing_throws);
  EXPECT_EQ(0x141410Cu, get_mode(queue));
  set_mode(queue, enums::ha | enums::no_global_status_report | enums::slice_normal |
                      enums::mode_relaxed_fallback);
  EXPECT_EQ(0x1811204u, get_mode(queue));
}

TEST(QueueMode, NotDefinedChangesNothing) {
  sycl::queue& fresh = new_queue();
  EXPECT_EQ(0u, set_mode(fresh, no_mode));
  EXPECT_EQ(0x1811204u, get_mode(fresh));
  sycl::queue& queue = new_queue();
  set_mode(queue, enums::ep | enums::badarg_quiet);
  const enums::mode before = get_mode(queue);
  EXPECT_EQ(before, set_mode(queue, no_mode));
  EXPECT_EQ(before, get_mode(queue));
}

TEST(QueueMode, KeepsGroupsThatNothingReads) {
  sycl::queue& queue = new_queue();
  set_mode(queue, static_cast<enums::mode>(0x2200000));
  EXPECT_EQ(0x2211204u, get_mode(queue));
}

TEST(QueueMode, IsSharedByCopiesOfAQueue) {
  sycl::queue &queue = new_queue(), &other = new_queue();
  sycl::queue copy = queue;
  set_mode(queue, enums::la);
  EXPECT_EQ(0x181120Cu, get_mode(copy));
  EXPECT_EQ(0x1811204u, get_mode(other));
}

TEST(QueueMode, ReachesCallsThatNameNone) {
  sycl::queue& queue = new_queue();
  set_mode(queue, enums::badarg_quiet);
  const float a[1] = {-1};
  float y[1] = {7};
  vm::abs(queue, -1, a, y).wait();
  EXPECT_EQ(enums::bad_argument, clear_status(queue));
  EXPECT_THROW(vm::abs(queue, -1, a, y, {}, enums::badarg_exception), invalid_argument);
  EXPECT_EQ(enums::success, get_status(queue));
  vm::abs(queue, -1, a, y).wait();
  EXPECT_EQ(enums::bad_argument, get_status(queue)) << "the mode of a call is for that call";
  EXPECT_EQ(7, y[0]);
}

TEST(QueueStatus, StartsAsSuccess) {
  sycl::queue& queue = new_queue();
  EXPECT_EQ(enums::success, get_status(queue));
}

TEST(QueueStatus, SettingReturnsTheStatusBefore) {
  sycl::queue& queue = new_queue();
  EXPECT_EQ(enums::success, set_status(queue, enums::sing | enums::overflow));
  EXPECT_EQ(enums::sing | enums::overflow, get_status(queue));
  EXPECT_EQ(enums::sing | enums::overflow, set_status(queue, enums::accuracy_warning));
  EXPECT_EQ(enums::accuracy_warning, get_status(queue));
}

TEST(QueueStatus, ClearingReturnsWhatItCleared) {
  sycl::queue& queue = new_queue();
  EXPECT_EQ(enums::success, clear_status(queue));
  set_status(queue, enums::errdom | enums::bad_argument);
  EXPECT_EQ(enums::errdom | enums::bad_argument, clear_status(queue));
  EXPECT_EQ(enums::success, clear_status(queue));
}

TEST(QueueStatus, IsSharedByCopiesOfAQueue) {
  sycl::queue &queue = new_queue(), &other = new_queue();
  sycl::queue copy = queue;
  set_status(queue, enums::underflow);
  EXPECT_EQ(enums::underflow, get_status(copy));
  EXPECT_EQ(enums::success, get_status(other));
}

}  // namespace
