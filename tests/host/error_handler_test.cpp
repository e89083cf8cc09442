// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "host/error_handler.hpp"

#include <gtest/gtest.h>

#include <array>
#include <cmath>
#include <vector>

#include "call/queue_store.hpp"
#include "host/classic_input.hpp"
#include "host/kernel_binding.hpp"
#include "host/kernels.hpp"

namespace {

using namespace arbor::lumen::vm::detail;
using arbor::lumen::vm::enums::status;
using var1 = classic::error_handler_typed_var1<double, double>;
using var2 = classic::error_handler_typed_var2<double, double>;

lumen_arr_error_record record_of(std::int32_t code, std::int32_t index, double argument) {
  lumen_arr_error_record record{};
  record.code = code;
  record.index = index;
  record.argument[0] = argument;
  record.result[0] = record.result[1] = 7;
  return record;
}

TEST(HostErrorHandler, IsMadeInactiveAndThenDoesNothing) {
  std::atomic<std::uint32_t> queue_status{0};
  var1 handler;
  EXPECT_FALSE(handler.active);
  handler.queue_status = &queue_status;
  handler.status_to_fix = 0xff;
  auto record = record_of(1, 0, -1);
  EXPECT_EQ(handler.handle(record), 0);
  EXPECT_EQ(record.result[0], 7);
  EXPECT_EQ(queue_status, 0u);
}

TEST(HostErrorHandler, CodesBecomeStatusBits) {
  std::atomic<std::uint32_t> queue_status{0};
  var1 handler;
  handler.active = true;
  handler.queue_status = &queue_status;
  for (const auto& [code, bit] : {std::pair{1, 1u}, {2, 2u}, {3, 4u}, {4, 8u}, {0, 0u}}) {
    queue_status = 0;
    auto record = record_of(code, 0, 1);
    handler.handle(record);
    EXPECT_EQ(queue_status, bit) << code;
  }
}

TEST(HostErrorHandler, AnArrayGetsEveryElementsStatusAndOneCellAllOfThem) {
  std::vector<status> cells(4, status::success);
  var1 handler;
  handler.active = true;
  handler.status_array = cells.data();
  handler.status_length = 4;
  auto first = record_of(1, 2, 1), second = record_of(3, 0, 1);
  handler.handle(first);
  handler.handle(second);
  EXPECT_EQ(cells, (std::vector<status>{status::overflow, status::success, status::errdom,
                                        status::success}));
  handler.status_length = 1;
  handler.handle(first);
  handler.handle(second);
  EXPECT_EQ(cells[0], status::errdom | status::overflow);
}

TEST(HostErrorHandler, ReplacesTheResultsOfTheMaskedStatuses) {
  var1 handler;
  handler.active = true;
  handler.replacement = 42;
  handler.status_to_fix = 1;
  auto other = record_of(2, 0, -1), masked = record_of(1, 0, -1);
  handler.handle(other);
  EXPECT_EQ(other.result[0], 7);
  handler.handle(masked);
  EXPECT_EQ(masked.result[0], 42);
  EXPECT_EQ(masked.result[1], 7);
  handler.with_sign = true;
  handler.handle(masked);
  EXPECT_EQ(masked.result[0], -42) << "with the argument's sign";
}

TEST(HostErrorHandler, TwoResultsHaveTwoReplacements) {
  var2 handler;
  handler.active = true;
  handler.replacement[0] = 1;
  handler.replacement[1] = 2;
  handler.status_to_fix = 1;
  handler.with_sign = true;
  auto record = record_of(1, 0, -0.0);
  handler.handle(record);
  EXPECT_EQ(record.result[0], -1);
  EXPECT_EQ(record.result[1], -2);
}

TEST(HostErrorHandler, ComplexReplacementsHaveTheSignsOfBothParts) {
  classic::error_handler_typed_var1<std::complex<double>, std::complex<double>> handler;
  handler.active = true;
  handler.replacement = {3, 4};
  handler.status_to_fix = 1;
  handler.with_sign = true;
  auto record = record_of(1, 0, 5);
  record.argument_imag[0] = -6;
  handler.handle(record);
  EXPECT_EQ(record.result[0], 3);
  EXPECT_EQ(record.result_imag[0], -4);
}

TEST(HostErrorHandler, AFunctionWithoutErrorsHasOneThatDoesNothing) {
  classic::error_handler_typed_var0<double, double> handler;
  handler.active = true;
  handler.status_to_fix = 0xff;
  auto record = record_of(1, 0, 1);
  EXPECT_EQ(handler.handle(record), 0);
  EXPECT_EQ(record.result[0], 7);
}

/// A call of ln at double over 4 elements, of which 0 and -1 have a status.
class HostInstalledHandler : public ::testing::Test {
 protected:
  using linear = classic::input::linear<shape::v11, double, double>;
  using strided = classic::input::strided<shape::v11, double, double>;
  static constexpr classic::input::host_entries<shape::v11, double, double> entries_{
      [](std::int64_t n, const auto& args, std::int64_t mode) {
        cpu::binding::vdLn(n, args.in[0], args.out[0], mode);
      },
      [](std::int64_t n, const auto& args, const auto& inc, std::int64_t mode) {
        cpu::binding::vdLnI(n, args.in[0], inc.in[0], args.out[0], inc.out[0], mode);
      }};
  std::array<double, 4> x_{1, 0, -1, std::exp(1)}, y_{};
  std::vector<status> cells_ = std::vector<status>(4, status::success);
  var1 handler_;

  HostInstalledHandler() {
    handler_.replacement = 42;
    handler_.status_to_fix = 2;
    handler_.status_array = cells_.data();
    handler_.status_length = 4;
  }
};

TEST_F(HostInstalledHandler, IsCalledForTheSpanOfACall) {
  handler_.active = true;
  linear call("ln", LUMEN_ARR_HA, 4, &handler_);
  call.in_pointers.push_back(x_.data());
  call.out_pointers.push_back(y_.data());
  call.run(entries_, {});
  EXPECT_EQ(y_[1], 42);
  EXPECT_TRUE(std::isnan(y_[2]));
  EXPECT_EQ(cells_[1], status::sing);
  EXPECT_EQ(cells_[2], status::errdom);
  EXPECT_EQ(queue_store::instance().active_handler(), nullptr);
  EXPECT_EQ(cpu::binding::arr_state().set_callback(nullptr), nullptr);
}

TEST_F(HostInstalledHandler, IsCalledForSlicesToo) {
  handler_.active = true;
  strided call("ln", LUMEN_ARR_HA, 2, &handler_);
  call.in_pointers.push_back(x_.data());
  call.out_pointers.push_back(y_.data());
  call.i_starts.push_back(1);
  call.i_strides.push_back(2);
  call.i_sizes.push_back(2);
  call.i_divisors.push_back(1);
  call.o_starts.push_back(0);
  call.o_strides.push_back(1);
  call.o_sizes.push_back(2);
  call.run(entries_, {});
  EXPECT_EQ(y_[0], 42);
  EXPECT_NEAR(y_[1], 1, 1e-15);
  EXPECT_EQ(cells_[0], status::sing);
}

TEST_F(HostInstalledHandler, InactiveItIsNotInstalled) {
  linear call("ln", LUMEN_ARR_HA, 4, &handler_);
  call.in_pointers.push_back(x_.data());
  call.out_pointers.push_back(y_.data());
  call.run(entries_, {});
  EXPECT_TRUE(std::isinf(y_[1]));
  EXPECT_EQ(cells_[1], status::success);
}

}  // namespace
