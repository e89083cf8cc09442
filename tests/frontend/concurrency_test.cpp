// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include <arbor/lumen/vm.hpp>
#include <atomic>
#include <cstdint>
#include <deque>
#include <functional>
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

constexpr int threads_at_once = 8;
constexpr int rounds = 40;
constexpr std::size_t count = 257;

/// Runs `work(thread number)` on all threads at one moment.
void at_once(const std::function<void(int)>& work) {
  std::atomic<int> ready{0};
  std::vector<std::thread> threads;
  for (int t = 0; t < threads_at_once; ++t) {
    threads.emplace_back([&, t] {
      for (++ready; ready < threads_at_once;) std::this_thread::yield();
      work(t);
    });
  }
  for (std::thread& thread : threads) thread.join();
}

/// Calls of all three kinds of memory; true if all the results are right.
bool call_and_compare(sycl::queue& queue, int seed) {
  floats a(count), b(count), y(count), z(count);
  for (std::size_t i = 0; i < count; ++i) {
    a[i] = -static_cast<float>(i) - static_cast<float>(seed);
    b[i] = static_cast<float>(i % 7);
  }
  sycl::event of_spans = vm::add(queue, a, b, y);
  sycl::event of_pointers = vm::fmax(queue, count, a.data(), b.data(), z.data());
  floats w(count);
  {
    sycl::buffer<float, 1> in(a.data(), sycl::range<1>(count));
    sycl::buffer<float, 1> out(w.data(), sycl::range<1>(count));
    vm::abs(queue, count, in, out);
  }
  of_spans.wait();
  of_pointers.wait();
  bool right = true;
  for (std::size_t i = 0; i < count; ++i) {
    right = right && y[i] == a[i] + b[i];
    right = right && z[i] == (a[i] < b[i] ? b[i] : a[i]);
    right = right && w[i] == -a[i];
  }
  return right;
}

class Concurrency : public testing::TestWithParam<const char*> {
 protected:
  /// One queue per case, kept: a later one in its place would meet its mode and its status.
  static sycl::queue& new_queue() {
    static std::deque<sycl::queue> queues;
    return queues.emplace_back(device_named(GetParam()));
  }
};
INSTANTIATE_TEST_SUITE_P(Devices, Concurrency, testing::Values("cpu", "jasper"),
                         [](const auto& param_info) { return std::string(param_info.param); });

TEST_P(Concurrency, CallsShareAQueue) {
  sycl::queue& queue = new_queue();
  std::atomic<int> right{0};
  at_once([&](int t) {
    for (int i = 0; i < rounds; ++i) right += call_and_compare(queue, t * rounds + i);
  });
  EXPECT_EQ(threads_at_once * rounds, right.load());
  EXPECT_EQ(enums::success, vm::get_status(queue));
}

TEST_P(Concurrency, CallsOnOwnQueues) {
  std::atomic<int> right{0};
  at_once([&](int t) {
    for (int i = 0; i < rounds / 4; ++i) {
      sycl::queue queue(device_named(GetParam()));
      for (int j = 0; j < 4; ++j) right += call_and_compare(queue, t * rounds + i + j);
    }
  });
  EXPECT_EQ(threads_at_once * (rounds / 4) * 4, right.load());
}

TEST_P(Concurrency, ModesAndStatusesOfOneQueue) {
  sycl::queue& queue = new_queue();
  std::atomic<int> strange_modes{0};
  at_once([&](int t) {
    const enums::mode own = t % 2 == 0 ? enums::la : enums::ep;
    for (int i = 0; i < 5 * rounds; ++i) {
      vm::set_mode(queue, own);
      const std::uint32_t mode = vm::get_mode(queue);
      strange_modes += mode != 0x181120C && mode != 0x181120F;
      vm::get_status(queue);
      if (t == 0) vm::set_status(queue, enums::underflow);
    }
  });
  EXPECT_EQ(0, strange_modes.load());
  EXPECT_EQ(enums::underflow, vm::clear_status(queue));
}

// Each rejected call sets the one bit, also beside calls that succeed and others that clear it.
TEST_P(Concurrency, RejectedCallsBesideServedOnes) {
  sycl::queue& queue = new_queue();
  std::atomic<int> right{0};
  std::atomic<std::uint32_t> seen{0};
  at_once([&](int t) {
    const float a[1] = {};
    float y[1] = {};
    for (int i = 0; i < rounds; ++i) {
      if (t % 2 == 0)
        right += call_and_compare(queue, i);
      else
        vm::abs(queue, -1, a, y, {}, enums::badarg_quiet);
      if (t == 1) seen |= vm::clear_status(queue);
    }
  });
  EXPECT_EQ(threads_at_once / 2 * rounds, right.load());
  EXPECT_EQ(256u, seen.load());
}

TEST_P(Concurrency, DefaultEventIsWaitedForByAll) {
  sycl::queue& queue = new_queue();
  at_once([&](int) {
    const float a[1] = {};
    float y[1] = {};
    for (int i = 0; i < rounds; ++i)
      vm::abs(queue, -1, a, y, {}, enums::badarg_quiet).wait_and_throw();
  });
  EXPECT_EQ(enums::bad_argument, vm::get_status(queue));
}

}  // namespace
