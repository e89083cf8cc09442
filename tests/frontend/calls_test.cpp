// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include <arbor/lumen/vm.hpp>
#include <atomic>
#include <chrono>
#include <complex>
#include <cstdint>
#include <functional>
#include <future>
#include <span>
#include <string>
#include <sycl/sycl.hpp>
#include <thread>
#include <vector>

#include "dispatch/simulated_devices.hpp"

namespace {

using namespace arbor::lumen;
using arbor::lumen::tests::device_named;
namespace enums = vm::enums;
using floats = std::vector<float>;

floats counting(std::size_t n) {
  floats values(n);
  for (std::size_t i = 0; i < n; ++i) values[i] = -static_cast<float>(i) - 1;
  return values;
}

bool is_complete(const sycl::event& event) {
  return event.get_info<sycl::info::event::command_execution_status>() ==
         sycl::info::event_command_status::complete;
}

template <typename Error>
void expect_thrown(const char* text, const std::function<void()>& action) {
  try {
    action();
    ADD_FAILURE() << "nothing was thrown, expected: " << text;
  } catch (const Error& error) {
    EXPECT_STREQ(text, error.what());
  }
}

/// Every call on a device whose host rows serve it and on one with kernels.
class Calls : public testing::TestWithParam<const char*> {
 protected:
  // A later queue in the place of this one would meet its status.
  void TearDown() override { vm::clear_status(queue_); }
  sycl::queue queue_{device_named(GetParam())};
};
INSTANTIATE_TEST_SUITE_P(Devices, Calls, testing::Values("cpu", "jasper", "foreign_nofp64"),
                         [](const auto& param_info) { return std::string(param_info.param); });

TEST_P(Calls, SpansOfDifferentLengthsGiveTheShortest) {
  const floats a = counting(5), b = counting(7);
  floats y(9, 3.0f);
  vm::abs(queue_, b, std::span<float>(y).first(5)).wait();
  EXPECT_EQ((floats{1, 2, 3, 4, 5, 3, 3, 3, 3}), y);
  vm::add(queue_, a, b, y).wait();
  EXPECT_EQ((floats{-2, -4, -6, -8, -10, 3, 3, 3, 3}), y);
  vm::add(queue_, b, a, y).wait();
  EXPECT_EQ((floats{-2, -4, -6, -8, -10, 3, 3, 3, 3}), y);
}

TEST_P(Calls, AbsOfComplexWritesReals) {
  const std::vector<std::complex<float>> a{{3, 4}, {-5, 12}, {0, -1}};
  floats y(3);
  vm::abs(queue_, a, y).wait();
  EXPECT_EQ((floats{5, 13, 1}), y);
  const std::vector<std::complex<double>> z{{8, -15}};
  double r = 0;
  vm::abs(queue_, 1, z.data(), &r).wait();
  EXPECT_EQ(17, r);
}

TEST_P(Calls, MayWorkInPlace) {
  floats y = counting(100);
  const floats before = y;
  vm::abs(queue_, y, y).wait();
  for (std::size_t i = 0; i < y.size(); ++i) EXPECT_EQ(-before[i], y[i]);
}

TEST_P(Calls, OfNoElementsDoNothing) {
  const float a[1] = {-1};
  float y[1] = {7};
  vm::abs(queue_, 0, a, y).wait();
  vm::abs(queue_, std::span<const float>(), std::span<float>()).wait();
  EXPECT_EQ(7, y[0]);
  EXPECT_EQ(enums::success, vm::get_status(queue_));
}

TEST_P(Calls, RejectBuffersThatAreTooShort) {
  sycl::buffer<float, 1> a{sycl::range<1>(8)}, b{sycl::range<1>(12)}, y{sycl::range<1>(8)};
  {
    sycl::host_accessor cells(y);
    for (std::size_t i = 0; i < 8; ++i) cells[i] = 7;
  }
  const char* text = "arbor::lumen::vm::add: invalid argument: insufficient length of arguments";
  expect_thrown<invalid_argument>(text, [&] { vm::add(queue_, 10, a, b, y); });
  expect_thrown<invalid_argument>(text, [&] { vm::add(queue_, 9, b, b, y); });
  EXPECT_EQ(enums::success, vm::get_status(queue_));
  EXPECT_TRUE(is_complete(vm::add(queue_, 10, a, b, y, enums::badarg_quiet)));
  EXPECT_EQ(enums::bad_argument, vm::clear_status(queue_));
  sycl::host_accessor cells(y);
  for (std::size_t i = 0; i < 8; ++i) EXPECT_EQ(7, cells[i]);
}

TEST_P(Calls, RejectNegativeCounts) {
  const float a[1] = {-1};
  float y[1] = {7};
  sycl::buffer<float, 1> in{sycl::range<1>(8)}, out{sycl::range<1>(8)};
  const char* text = "arbor::lumen::vm::abs: invalid argument: negative length";
  expect_thrown<invalid_argument>(text, [&] { vm::abs(queue_, -1, a, y); });
  expect_thrown<invalid_argument>(text, [&] { vm::abs(queue_, -8, in, out); });
  EXPECT_EQ(enums::success, vm::get_status(queue_));
  EXPECT_TRUE(is_complete(vm::abs(queue_, -1, a, y, {}, enums::badarg_quiet)));
  EXPECT_EQ(enums::bad_argument, vm::clear_status(queue_));
  vm::abs(queue_, -1, in, out, enums::badarg_quiet);
  EXPECT_EQ(enums::bad_argument, vm::clear_status(queue_));
  EXPECT_EQ(7, y[0]);
}

// Neither function has a row for half on any device.
TEST_P(Calls, WithoutAnyRowLeaveTheOutput) {
  const std::vector<sycl::half> a(3, sycl::half(1));
  std::vector<sycl::half> y(3, sycl::half(7));
  const sycl::half c(2);
  EXPECT_TRUE(is_complete(vm::expint1(queue_, a, y)));
  EXPECT_EQ(enums::bad_argument, vm::clear_status(queue_));
  EXPECT_TRUE(is_complete(vm::linearfrac(queue_, a, a, c, c, c, c, y)));
  EXPECT_EQ(enums::bad_argument, vm::clear_status(queue_));
  for (const sycl::half& element : y) EXPECT_EQ(7.0f, static_cast<float>(element));
}

TEST_P(Calls, WithoutAnyRowThrowUnderMissingThrows) {
  const std::vector<sycl::half> a(3, sycl::half(1));
  std::vector<sycl::half> y(3, sycl::half(7));
  const std::string device = GetParam();
  const std::string words = device == "jasper"           ? "discrete;norvane;"
                            : device == "foreign_nofp64" ? "nofp64;beryl;discrete;"
                                                         : "";
  const std::string text =
      "arbor::lumen::vector_math::expint1: unimplemented functionality: mode: acc: la; slice: "
      "normal; badarg: exception; precision: precision: h/half; ; architecture: " +
      words;
  expect_thrown<unimplemented>(
      text.c_str(), [&] { vm::expint1(queue_, a, y, {}, enums::la | enums::mode_missing_throws); });
  EXPECT_EQ(enums::success, vm::get_status(queue_));
}

// A call without the fallbacks is served only where the device has a kernel.
TEST_P(Calls, NeedAKernelWithoutFallback) {
  const floats a{-1, -2};
  floats y(2);
  // Of the fallback group, a value that admits neither the host nor another accuracy.
  const auto strict = static_cast<enums::mode>(0x200000);
  vm::abs(queue_, a, y, {}, strict).wait();
  const bool has_kernel = std::string(GetParam()) == "jasper";
  EXPECT_EQ(has_kernel ? enums::success : enums::bad_argument, vm::get_status(queue_));
  EXPECT_EQ(has_kernel ? (floats{1, 2}) : (floats{0, 0}), y);
}

/// A command that does not finish before it is told to.
class held_command {
 public:
  explicit held_command(const sycl::device& device) : queue_(device) {
    event_ = queue_.submit([&](sycl::handler& group) {
      group.host_task([gate = gate_.get_future().share()] { gate.wait(); });
    });
  }
  ~held_command() { release(); }
  void release() {
    if (!released_) gate_.set_value();
    released_ = true;
    event_.wait();
  }
  const sycl::event& event() const { return event_; }

 private:
  std::promise<void> gate_;
  bool released_ = false;
  sycl::queue queue_;
  sycl::event event_;
};

constexpr auto long_enough = std::chrono::seconds(20);
constexpr auto a_moment = std::chrono::milliseconds(50);

TEST_P(Calls, OnSpansDoNotWaitForEvents) {
  const floats a = counting(6);
  floats y(6), z(6);
  held_command held(queue_.get_device());
  auto done = std::async(std::launch::async, [&] {
    vm::abs(queue_, a, y, {held.event()}).wait();
    const slice all{0, 6, 1};
    vm::abs(queue_, a, all, z, all, {held.event()}).wait();
  });
  const bool finished = done.wait_for(long_enough) == std::future_status::ready;
  EXPECT_TRUE(finished);
  EXPECT_FALSE(is_complete(held.event()));
  held.release();
  done.get();
  EXPECT_EQ((floats{1, 2, 3, 4, 5, 6}), y);
  EXPECT_EQ(y, z);
}

TEST_P(Calls, OnPointersWaitForEvents) {
  const floats a = counting(6);
  floats y(6), z(6);
  held_command held(queue_.get_device());
  std::atomic<int> finished{0};
  const slice all{0, 6, 1};
  const auto whole = [&] {
    vm::abs(queue_, 6, a.data(), y.data(), {held.event()}).wait();
    ++finished;
  };
  const auto sliced = [&] {
    vm::abs(queue_, a.data(), all, z.data(), all, {held.event()}).wait();
    ++finished;
  };
  auto first = std::async(std::launch::async, whole);
  auto second = std::async(std::launch::async, sliced);
  std::this_thread::sleep_for(a_moment);
  EXPECT_EQ(0, finished.load());
  held.release();
  first.get();
  second.get();
  EXPECT_EQ((floats{1, 2, 3, 4, 5, 6}), y);
  EXPECT_EQ(y, z);
}

TEST_P(Calls, WaitForAllTheirEvents) {
  const floats a = counting(6);
  floats y(6);
  held_command first(queue_.get_device()), second(queue_.get_device());
  std::atomic<bool> finished{false};
  auto call = std::async(std::launch::async, [&] {
    vm::abs(queue_, 6, a.data(), y.data(), {first.event(), second.event()}).wait();
    finished = true;
  });
  first.release();
  std::this_thread::sleep_for(a_moment);
  EXPECT_FALSE(finished);
  second.release();
  call.get();
  EXPECT_EQ((floats{1, 2, 3, 4, 5, 6}), y);
}

TEST_P(Calls, OnBuffersAreOrderedByTheBuffers) {
  sycl::buffer<float, 1> a{sycl::range<1>(64)}, y{sycl::range<1>(64)};
  {
    sycl::host_accessor cells(a);
    for (std::size_t i = 0; i < 64; ++i) cells[i] = -static_cast<float>(i);
  }
  vm::abs(queue_, 64, a, y);
  for (int i = 0; i < 10; ++i) vm::add(queue_, 64, y, a, y);
  sycl::host_accessor cells(y);
  for (std::size_t i = 0; i < 64; ++i) EXPECT_EQ(-9 * static_cast<float>(i), cells[i]);
}

}  // namespace
