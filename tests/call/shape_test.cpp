// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "call/shape.hpp"

#include <gtest/gtest.h>

#include <array>
#include <string>

#include "call/arguments.hpp"

namespace {

namespace shape = arbor::lumen::vm::detail::shape;

template <typename Shape>
std::array<int, 3> operands() {
  return {Shape::inputs, Shape::constants, Shape::outputs};
}

TEST(Shape, CountsArraysConstantsAndOutputs) {
  using counts = std::array<int, 3>;
  EXPECT_EQ((counts{1, 0, 1}), operands<shape::v11>());
  EXPECT_EQ((counts{1, 0, 2}), operands<shape::v12>());
  EXPECT_EQ((counts{2, 0, 1}), operands<shape::v21>());
  EXPECT_EQ((counts{1, 1, 1}), operands<shape::v21c>());
  EXPECT_EQ((counts{3, 0, 1}), operands<shape::v31>());
  EXPECT_EQ((counts{2, 4, 1}), operands<shape::v61>());
  EXPECT_EQ((counts{0, 1, 1}), operands<shape::vc1>());
  EXPECT_EQ((counts{0, 1, 2}), operands<shape::vc2>());
  EXPECT_EQ((counts{0, 2, 1}), operands<shape::vi2c1>());
}

TEST(Shape, NamesAreThoseOfMessages) {
  EXPECT_STREQ("v11", shape::v11::name);
  EXPECT_STREQ("v12", shape::v12::name);
  EXPECT_STREQ("v21", shape::v21::name);
  EXPECT_STREQ("v21c", shape::v21c::name);
  EXPECT_STREQ("v31", shape::v31::name);
  EXPECT_STREQ("v61", shape::v61::name);
  EXPECT_STREQ("vc1", shape::vc1::name);
  EXPECT_STREQ("vc2", shape::vc2::name);
  EXPECT_STREQ("vi2c1", shape::vi2c1::name);
}

TEST(Shape, ArgumentsHoldOneSlotPerOperand) {
  const arbor::lumen::vm::detail::arguments<shape::v61, float, double> args{};
  EXPECT_EQ(2u, args.in.size());
  EXPECT_EQ(4u, args.constants.size());
  EXPECT_EQ(1u, args.out.size());
}

}  // namespace
