// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "host/classic_input.hpp"

#include <gtest/gtest.h>

#include <stdexcept>
#include <string>

#include "arbor/lumen/exception.hpp"

namespace {

using namespace arbor::lumen::vm::detail;
using linear = classic::input::linear<shape::v11, float, float>;
using strided = classic::input::strided<shape::v11, float, float>;

template <typename Error, typename Action>
std::string message_of(Action action) {
  try {
    action();
  } catch (const Error& error) {
    return error.what();
  }
  return "no error";
}

TEST(HostClassicInput, ANegativeCountIsRejectedLoudlyOrQuietly) {
  const linear call("abs", 2, -1, nullptr);
  EXPECT_FALSE(call.check(false));
  EXPECT_EQ(message_of<arbor::lumen::invalid_argument>([&] { call.check(true); }),
            "arbor::lumen::VM::abs: invalid argument: negative length for classic call");
  EXPECT_TRUE(linear("abs", 2, 0, nullptr).check(true));
}

TEST(HostClassicInput, ANegativeCountIsRunAsNone) {
  linear call("abs", 2, -7, nullptr);
  static float x = 0;
  call.in_pointers.push_back(&x);
  call.out_pointers.push_back(&x);
  static std::int64_t seen = -1;
  call.run({[](std::int64_t n, const auto&, std::int64_t) { seen = n; }, nullptr}, {});
  EXPECT_EQ(seen, 0);
}

TEST(HostClassicInput, SlicesAreWhatTheirListsSay) {
  EXPECT_FALSE(linear("abs", 2, 1, nullptr).has_slices());
  strided call("abs", 2, 1, nullptr);
  EXPECT_FALSE(call.has_slices());
  call.o_sizes.push_back(3);
  EXPECT_TRUE(call.has_slices());
  EXPECT_EQ(call.o_size(0), 3);
}

TEST(HostClassicInput, OperandsThatACallDoesNotHaveAreALogicError) {
  const strided call("abs", 2, 1, nullptr);
  const auto error_of = [](auto access) { return message_of<std::logic_error>(access); };
  EXPECT_NE(error_of([&] { call.ptr_out(0); }).find("ptr_out: index of output is too large"),
            std::string::npos);
  EXPECT_NE(error_of([&] { call.o_size(1); }).find("o_size: index of input is too large"),
            std::string::npos);
  EXPECT_NE(error_of([&] { call.ptr_in(0); }).find("ptr_in: index of input is too large"),
            std::string::npos);
}

}  // namespace
