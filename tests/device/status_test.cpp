// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <gtest/gtest.h>

#include <limits>
#include <numeric>
#include <thread>

#include "call/queue_store.hpp"
#include "functors.hpp"
#include "gate.hpp"
#include "memory.hpp"
#include "queues.hpp"
#include "recorded_kernels.hpp"
#include "records.hpp"
#include "scalar/generated/fmod.hpp"
#include "scalar/generated/nextafter.hpp"

namespace {

using namespace arbor::lumen::tests;
namespace scalar = norvane::scalar;
using arbor::lumen::vm::detail::queue_key;
using arbor::lumen::vm::detail::queue_store;

using statuses = std::vector<enums::status>;

constexpr enums::status none = enums::success;
constexpr enums::status untouched = enums::accuracy_warning;
constexpr float infinity = std::numeric_limits<float>::infinity();

/// Sets the status of a queue and returns what it was.
std::uint32_t exchange_status(sycl::queue& queue, std::uint32_t status = 0) {
  return queue_store::instance().status_word(queue_key(&queue)).exchange(status);
}

template <typename Functor, typename Record>
sycl::event run(const Record& record) {
  return norvane::launcher<shape::v11, Functor>(record, {1});
}

/// Copies, with the element as its status; on memory of one kind.
class StatusReport : public ::testing::TestWithParam<memory> {
 protected:
  sycl::queue queue_ = gpu_queue();
  using echo = echo_status<float>;
};

INSTANTIATE_TEST_SUITE_P(Memories, StatusReport, ::testing::ValuesIn(all_memories),
                         [](const auto& tested) { return name_of(tested.param); });

TEST_P(StatusReport, OneCellGetsTheOrOfAllElements) {
  std::vector<float> values(3000, 0.0f);
  values[7] = 1;
  values[1500] = 8;
  values[2999] = 1;
  array<float> a(queue_, GetParam(), values);
  array<enums::status> status(queue_, GetParam(), 1, enums::overflow);
  auto record = linear_call<shape::v11, float>(queue_, 3000, {a}, {a});
  record.handler = arbor::lumen::vm::error_handler<float>(status.data(), 1);
  run<echo>(record).wait();
  EXPECT_EQ(status.read()[0], enums::errdom | enums::underflow | enums::overflow);
}

TEST_P(StatusReport, MoreCellsGetTheStatusOfTheirElements) {
  array<float> a(queue_, GetParam(), {0, 1, 2, 0, 4, 8});
  array<enums::status> status(queue_, GetParam(), 6, untouched);
  auto record = linear_call<shape::v11, float>(queue_, 6, {a}, {a});
  record.handler = arbor::lumen::vm::error_handler<float>(status.data(), 6);
  run<echo>(record).wait();
  EXPECT_EQ(status.read(), (statuses{untouched, enums::errdom, enums::sing, untouched,
                                     enums::overflow, enums::underflow}))
      << "a status replaces what was there; a success leaves it";
}

TEST_P(StatusReport, CellsOfASliceAreThoseOfTheOutput) {
  array<float> a(queue_, GetParam(), {1, 2, 4});
  array<float> y(queue_, GetParam(), 8, 0.0f);
  array<enums::status> status(queue_, GetParam(), 8, untouched);
  auto record = strided_call<shape::v11, float>(queue_, {{a, {0, 3, 1}}}, {{y, {7, 3, -3}}});
  record.handler = arbor::lumen::vm::error_handler<float>(status.data(), 8);
  run<echo>(record).wait();
  EXPECT_EQ(status.read(), (statuses{untouched, enums::overflow, untouched, untouched, enums::sing,
                                     untouched, untouched, enums::errdom}));
  EXPECT_EQ(y.read(), (std::vector<float>{0, 4, 0, 0, 2, 0, 0, 1}));
}

TEST_P(StatusReport, ALengthOfZeroReportsNothing) {
  array<float> a(queue_, GetParam(), {1, 2, 4});
  array<enums::status> status(queue_, GetParam(), 3, untouched);
  auto record = linear_call<shape::v11, float>(queue_, 3, {a}, {a});
  record.handler = arbor::lumen::vm::error_handler<float>(status.data(), 0);
  run<echo>(record).wait();
  EXPECT_EQ(status.read(), statuses(3, untouched));
}

TEST_P(StatusReport, AHandlerThatIsNotEnabledDoesNothing) {
  for (const std::int64_t length : {0, 1, 3}) {
    array<float> a(queue_, GetParam(), {1, 2, 4});
    array<enums::status> status(queue_, GetParam(), 3, untouched);
    auto whole = linear_call<shape::v11, float>(queue_, 3, {a}, {a});
    auto sliced = strided_call<shape::v11, float>(queue_, {{a, {0, 3, 1}}}, {{a, {0, 3, 1}}});
    const auto disable = [&](auto& record) {
      record.handler = arbor::lumen::vm::error_handler<float>(
          status.data(), length, enums::errdom | enums::sing | enums::overflow, -1.0f);
      record.handler.enabled = false;
    };
    disable(whole);
    disable(sliced);
    run<echo>(whole).wait();
    run<echo>(sliced).wait();
    whole.mode = mode_with(enums::global_status_report);
    run<echo>(whole).wait();
    EXPECT_EQ(a.read(), (std::vector<float>{1, 2, 4}));
    EXPECT_EQ(status.read(), statuses(3, untouched));
  }
  exchange_status(queue_);
}

TEST_P(StatusReport, TheQueueGetsTheOrUnderAGlobalReport) {
  array<float> a(queue_, GetParam(), {0, 1, 0, 8});
  auto record = linear_call<shape::v11, float>(queue_, 4, {a}, {a});
  exchange_status(queue_, enums::sing);
  run<echo>(record).wait();
  EXPECT_EQ(exchange_status(queue_, enums::sing), enums::sing);

  record.mode = mode_with(enums::global_status_report);
  run<echo>(record);
  EXPECT_EQ(exchange_status(queue_), enums::sing | enums::errdom | enums::underflow);

  a.write({0, 0, 0, 0});
  run<echo>(record);
  EXPECT_EQ(exchange_status(queue_), enums::success);
}

TEST_P(StatusReport, QueueAndHandlerAreServedByOneCall) {
  array<float> a(queue_, GetParam(), {0, 1, 2});
  array<enums::status> status(queue_, GetParam(), 3, none);
  auto record = linear_call<shape::v11, float>(queue_, 3, {a}, {a});
  record.mode = mode_with(enums::global_status_report);
  record.handler = arbor::lumen::vm::error_handler<float>(status.data(), 3, enums::sing, -7.0f);
  exchange_status(queue_);
  run<echo>(record);
  EXPECT_EQ(exchange_status(queue_), enums::errdom | enums::sing);
  EXPECT_EQ(status.read(), (statuses{none, enums::errdom, enums::sing}));
  EXPECT_EQ(a.read(), (std::vector<float>{0, 1, -7}));
}

TEST_P(StatusReport, OfFunctionsWithStatus) {
  array<float> a(queue_, GetParam(), {5, 1, infinity, 1e-45f, 3.4028235e38f, 7});
  array<float> b(queue_, GetParam(), {3, 0, 2, 0, infinity, 4});
  array<float> y(queue_, GetParam(), 6, 0.0f);
  array<enums::status> status(queue_, GetParam(), 6, none);
  auto record = linear_call<shape::v21, float>(queue_, 6, {a, b}, {y});
  record.handler = arbor::lumen::vm::error_handler<float>(status.data(), 6, enums::sing, -9.0f);
  norvane::launcher<shape::v21, scalar::fmod_s_ha_gen>(record, {1}).wait();
  EXPECT_EQ(status.read(), (statuses{none, enums::sing, enums::sing, enums::sing, none, none}));
  EXPECT_EQ(y.read(), (std::vector<float>{2, -9, -9, -9, 3.4028235e38f, 3}));

  status.write(statuses(6, none));
  norvane::launcher<shape::v21, scalar::nextafter_s_la_gen>(record, {1}).wait();
  EXPECT_EQ(status.read(), (statuses{none, none, none, enums::underflow, enums::overflow, none}));
}

/// The replacement of results; shared memory throughout.
class Fixup : public ::testing::Test {
 protected:
  sycl::queue queue_ = gpu_queue();

  template <typename T>
  array<T> values(const std::vector<T>& contents) {
    return array<T>(queue_, memory::shared, contents);
  }
};

TEST_F(Fixup, OnlyStatusesOfTheMaskAreReplaced) {
  array<float> a = values<float>({0, 1, 2, 4, 8, 3});
  array<float> y = values(std::vector<float>(6));
  auto record = linear_call<shape::v11, float>(queue_, 6, {a}, {y});
  record.handler = arbor::lumen::vm::error_handler<float>(-5.0f, enums::sing | enums::overflow);
  run<echo_status<float>>(record).wait();
  EXPECT_EQ(y.read(), (std::vector<float>{0, 1, -5, -5, 8, -5}));
  record.handler.status_to_fix = 0;
  run<echo_status<float>>(record).wait();
  EXPECT_EQ(y.read(), (std::vector<float>{0, 1, 2, 4, 8, 3}));
}

/// Reports an error for every element and writes the negated input.
template <typename T>
struct always : test_functor<T> {
  static std::uint32_t call(const T* a, T* y) {
    *y = -*a;
    return enums::errdom;
  }
};

TEST_F(Fixup, TheSignMayComeFromTheInput) {
  const float nan = std::numeric_limits<float>::quiet_NaN();
  const std::vector<float> inputs{2, -2, 0.0f, -0.0f, infinity, -infinity, nan, -nan};
  array<float> a = values(inputs);
  array<float> y = values(std::vector<float>(8));
  for (const float value : {3.0f, -3.0f, nan, -0.0f}) {
    auto record = linear_call<shape::v11, float>(queue_, 8, {a}, {y});
    record.handler = arbor::lumen::vm::error_handler<float>(value, enums::errdom, true);
    run<always<float>>(record).wait();
    const std::vector<float> results = y.read();
    for (std::size_t i = 0; i < 8; ++i)
      EXPECT_EQ(std::bit_cast<std::uint32_t>(results[i]),
                std::bit_cast<std::uint32_t>(std::copysign(value, inputs[i])));
    record.handler.copy_sign = false;
    run<always<float>>(record).wait();
    for (const float result : y.read())
      EXPECT_EQ(std::bit_cast<std::uint32_t>(result), std::bit_cast<std::uint32_t>(value));
  }
}

TEST_F(Fixup, TheSignOfHalf) {
  const std::vector<sycl::half> inputs{sycl::half(2.0f), sycl::half(-2.0f), sycl::half(-0.0f)};
  array<sycl::half> a = values(inputs);
  array<sycl::half> y = values(std::vector<sycl::half>(3));
  auto record = linear_call<shape::v11, sycl::half>(queue_, 3, {a}, {y});
  record.handler =
      arbor::lumen::vm::error_handler<sycl::half>(sycl::half(-1.5f), enums::errdom, true);
  run<always<sycl::half>>(record).wait();
  EXPECT_EQ(static_cast<float>(y.read()[0]), 1.5f);
  EXPECT_EQ(static_cast<float>(y.read()[1]), -1.5f);
  EXPECT_EQ(static_cast<float>(y.read()[2]), -1.5f);
}

TEST_F(Fixup, EachPartOfAComplexResultHasItsSign) {
  using complex = std::complex<double>;
  const std::vector<complex> inputs{{2, 3}, {-2, 3}, {2, -0.0}, {-0.0, -3}};
  array<complex> a = values(inputs);
  array<complex> y = values(std::vector<complex>(4));
  auto record = linear_call<shape::v11, complex>(queue_, 4, {a}, {y});
  record.handler = arbor::lumen::vm::error_handler<complex>(complex(-5, 6), enums::errdom, true);
  run<always<complex>>(record).wait();
  EXPECT_EQ(y.read(), (std::vector<complex>{{5, 6}, {-5, 6}, {5, -6}, {-5, -6}}));
  record.handler.copy_sign = false;
  run<always<complex>>(record).wait();
  EXPECT_EQ(y.read(), std::vector<complex>(4, complex(-5, 6)));
}

TEST_F(Fixup, TheSignIsThatOfTheFirstInput) {
  array<float> a = values<float>({5, -5});
  array<float> b = values<float>({-0.0f, 0.0f});
  array<float> y = values(std::vector<float>(2));
  auto record = linear_call<shape::v21, float>(queue_, 2, {a, b}, {y});
  record.handler = arbor::lumen::vm::error_handler<float>(7.0f, enums::sing, true);
  norvane::launcher<shape::v21, scalar::fmod_s_ha_gen>(record, {1}).wait();
  EXPECT_EQ(y.read(), (std::vector<float>{7, -7}));
}

TEST_F(Fixup, TheSignInPlaceIsThatOfTheInputTheCallFound) {
  array<float> a = values<float>({5, -5});
  auto record = linear_call<shape::v11, float>(queue_, 2, {a}, {a});
  record.handler = arbor::lumen::vm::error_handler<float>(7.0f, enums::errdom, true);
  run<always<float>>(record).wait();
  EXPECT_EQ(a.read(), (std::vector<float>{7, -7}));
}

/// Two results with an error.
template <typename T>
struct always_two : test_functor<T> {
  static std::uint32_t call(const T*, T* y1, T* y2) {
    *y1 = 100;
    *y2 = 200;
    return enums::errdom;
  }
};

TEST_F(Fixup, ASecondResultCompletesTheFirstToTheUnitCircle) {
  array<float> a = values<float>({1, -1});
  array<float> y = values(std::vector<float>(2));
  array<float> z = values(std::vector<float>(2));
  auto record = linear_call<shape::v12, float>(queue_, 2, {a}, {y, z});
  for (const bool copy_sign : {false, true}) {
    for (const float value : {0.6f, 0.0f, 1.0f, -0.25f, 1e-30f}) {
      record.handler = arbor::lumen::vm::error_handler<float>(value, enums::errdom, copy_sign);
      norvane::launcher<shape::v12, always_two<float>>(record, {1}).wait();
      EXPECT_EQ(y.read()[1], copy_sign ? -std::fabs(value) : value);
      const double square = static_cast<double>(value) * static_cast<double>(value);
      EXPECT_EQ(z.read(), std::vector<float>(2, static_cast<float>(std::sqrt(1.0 - square))));
    }
  }
  record.handler = arbor::lumen::vm::error_handler<float>(1.5f, enums::errdom);
  norvane::launcher<shape::v12, always_two<float>>(record, {1}).wait();
  EXPECT_EQ(y.read()[0], 1.5f);
  EXPECT_TRUE(std::isnan(z.read()[0]));
  record.handler.status_to_fix = enums::sing;
  norvane::launcher<shape::v12, always_two<float>>(record, {1}).wait();
  EXPECT_EQ(y.read()[0], 100);
  EXPECT_EQ(z.read()[0], 200);
}

TEST_F(Fixup, AReplacedElementIsReportedToo) {
  array<float> a = values<float>({1, 2});
  array<float> y = values(std::vector<float>(2));
  array<enums::status> status = values(statuses(2, none));
  auto record = linear_call<shape::v11, float>(queue_, 2, {a}, {y});
  record.handler = arbor::lumen::vm::error_handler<float>(status.data(), 2, enums::sing, -1.0f);
  run<echo_status<float>>(record).wait();
  EXPECT_EQ(y.read(), (std::vector<float>{1, -1}));
  EXPECT_EQ(status.read(), (statuses{enums::errdom, enums::sing}));
}

TEST(StatusOfManyThreads, HandlersAndReportsOnOneQueue) {
  sycl::queue queue = gpu_queue();
  exchange_status(queue);
  constexpr int threads = 4, calls = 200;
  std::vector<std::thread> pool;
  for (int t = 0; t < threads; ++t) {
    pool.emplace_back([&queue, t] {
      const float own = static_cast<float>(1 << t);
      for (int i = 0; i < calls; ++i) {
        const memory kind = all_memories[(t + i) % 4];
        array<float> a(queue, kind, {0, own, 0, own});
        array<float> y(queue, kind, 4, 50.0f);
        const std::int64_t length = i % 3 == 0 ? 1 : 4;
        array<enums::status> status(queue, kind, 4, none);
        auto record = linear_call<shape::v11, float>(queue, 4, {a}, {y});
        record.handler = arbor::lumen::vm::error_handler<float>(
            status.data(), length, static_cast<enums::status>(1u << t), -own);
        if (i % 2 == 0) record.mode = mode_with(enums::global_status_report);
        run<echo_status<float>>(record).wait();
        const auto mine = static_cast<enums::status>(1u << t);
        EXPECT_EQ(status.read(), length == 1 ? (statuses{mine, none, none, none})
                                             : (statuses{none, mine, none, mine}));
        EXPECT_EQ(y.read(), (std::vector<float>{0, -own, 0, -own}));
      }
    });
  }
  for (std::thread& thread : pool) thread.join();
  EXPECT_EQ(exchange_status(queue), (1u << threads) - 1);
}

TEST(StatusOfQueues, EachHasItsOwn) {
  sycl::queue first = gpu_queue(), second = gpu_queue();
  exchange_status(first);
  exchange_status(second);
  array<float> a(first, memory::shared, {1});
  auto record = linear_call<shape::v11, float>(first, 1, {a}, {a});
  record.mode = mode_with(enums::global_status_report);
  run<echo_status<float>>(record);
  EXPECT_EQ(exchange_status(second), enums::success);
  sycl::queue copy = first;
  EXPECT_EQ(exchange_status(copy), enums::errdom);
}

}  // namespace
