// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "device/strided_args.hpp"

#include <gtest/gtest.h>

#include <initializer_list>
#include <limits>
#include <stdexcept>

#include "arbor/lumen/exception.hpp"
#include "records.hpp"

namespace {

using namespace arbor::lumen::tests;
using arbor::lumen::vm::detail::device::describe;
using arbor::lumen::vm::detail::device::strided_args;

constexpr std::int64_t largest = std::numeric_limits<std::int64_t>::max();
constexpr std::int64_t smallest = std::numeric_limits<std::int64_t>::min();

/// A record that has nothing but what a descriptor is made of.
class call final : public input::typed_vxx<float, float> {
 public:
  explicit call(std::uint32_t words = 0) {
    name = "name";
    mode = mode_with(words);
  }
  call& in(slice s) {
    in_slices.push_back(s);
    return *this;
  }
  call& out(slice s) {
    out_slices.push_back(s);
    return *this;
  }
  call& count(std::int64_t count) {
    n = count;
    return *this;
  }
};

template <int NI, int NO>
std::string rejection(const call& record) {
  return message_of<arbor::lumen::invalid_argument>([&] { describe<NI, NO>(record); });
}

constexpr const char* empty = "arbor::lumen::VM::name: invalid argument: slice(s) is/are empty";
constexpr const char* differ =
    "arbor::lumen::VM::name: invalid argument: different slice sizes in slice_normal mode";
constexpr const char* negative =
    "arbor::lumen::VM::name: invalid argument: negative number of computations";

TEST(StridedArgs, WithoutSlicesStridesAreOne) {
  const auto args = describe<2, 1>(call().count(7));
  EXPECT_FALSE(args.cyclic);
  EXPECT_EQ(args.count, 7);
  for (int k = 0; k < 2; ++k) {
    EXPECT_EQ(args.divisor[k], 1);
    EXPECT_EQ(args.in_size[k], 7);
    EXPECT_EQ(args.in_start[k], 0);
    EXPECT_EQ(args.in_stride[k], 1);
    EXPECT_EQ(args.in_extent[k], 7);
  }
  EXPECT_EQ(args.out_start[0], 0);
  EXPECT_EQ(args.out_stride[0], 1);
  EXPECT_EQ(args.out_extent[0], 7);
}

TEST(StridedArgs, WithoutSlicesTheModeHasNoSay) {
  for (const auto mode : {enums::slice_minimum, enums::slice_cyclic}) {
    const auto args = describe<1, 2>(call(mode).count(3));
    EXPECT_FALSE(args.cyclic);
    EXPECT_EQ(args.count, 3);
    EXPECT_EQ(args.out_extent[1], 3);
  }
}

TEST(StridedArgs, WithoutACountTheShortestLengthIsTheCount) {
  call record;
  record.in_lengths = {5, 9};
  record.out_lengths = {7};
  EXPECT_EQ((describe<2, 1>(record).count), 5);
  EXPECT_EQ((describe<2, 1>(call()).count), 0);
  EXPECT_EQ((describe<2, 1>(call().count(-4)).count), 0) << "clamped before the descriptor";
}

TEST(StridedArgs, ANegativeCountIsRejectedOrNothing) {
  call record;
  record.in_lengths = {-5};
  EXPECT_EQ((rejection<1, 1>(record)), negative);
  record.mode = mode_with(enums::badarg_quiet);
  const auto args = describe<1, 1>(record);
  EXPECT_EQ(args.count, 0);
  EXPECT_EQ(args.in_extent[0], 0);
}

TEST(StridedArgs, EqualUnitSlices) {
  const auto args = describe<1, 1>(call().in({0, 4, 1}).out({0, 4, 1}));
  EXPECT_EQ(args.count, 4);
  EXPECT_EQ(args.divisor[0], 1);
  EXPECT_EQ(args.in_size[0], 4);
  EXPECT_EQ(args.in_stride[0], 1);
  EXPECT_EQ(args.in_extent[0], 4);
  EXPECT_EQ(args.out_extent[0], 4);
}

TEST(StridedArgs, FieldsAreThoseOfTheSlices) {
  const auto args = describe<2, 1>(call().in({1, 4, 2}).in({30, 4, -5}).out({6, 4, 3}));
  EXPECT_EQ(args.count, 4);
  EXPECT_EQ(args.in_start[0], 1);
  EXPECT_EQ(args.in_stride[0], 2);
  EXPECT_EQ(args.in_extent[0], 8);
  EXPECT_EQ(args.in_start[1], 30);
  EXPECT_EQ(args.in_size[1], 4);
  EXPECT_EQ(args.in_stride[1], -5);
  EXPECT_EQ(args.in_extent[1], 31) << "the first element is the highest";
  EXPECT_EQ(args.out_start[0], 6);
  EXPECT_EQ(args.out_stride[0], 3);
  EXPECT_EQ(args.out_extent[0], 16);
  const auto two = describe<1, 2>(call().in({0, 4, 0}).out({6, 4, -2}).out({9, 4, 0}));
  EXPECT_EQ(two.in_extent[0], 1) << "a stride of 0 stays at the start";
  EXPECT_EQ(two.out_extent[0], 7);
  EXPECT_EQ(two.out_stride[1], 0);
  EXPECT_EQ(two.out_extent[1], 10);
}

TEST(StridedArgs, ShapesWithoutInputsFillTheOutputs) {
  const auto args = describe<0, 2>(call().out({1, 3, 2}).out({0, 3, 1}));
  EXPECT_EQ(args.count, 3);
  EXPECT_EQ(args.out_extent[0], 6);
  EXPECT_EQ(args.out_extent[1], 3);
  EXPECT_EQ(args.divisor[0], 0);
  EXPECT_EQ(args.in_size[0], 0);
}

TEST(StridedArgs, TheNumberOfSlicesMustBeThatOfTheShape) {
  const std::string text = "ArborLumen::VM::name: slice number different from template";
  const slice s{0, 4, 1};
  const auto refusal = [](const call& record) {
    return message_of<std::logic_error>([&] { describe<2, 1>(record); });
  };
  for (const std::uint32_t mode : {0u, static_cast<unsigned>(enums::badarg_quiet)}) {
    EXPECT_EQ(refusal(call(mode).in(s).out(s)), text);
    EXPECT_EQ(refusal(call(mode).in(s).in(s).in(s).out(s)), text);
    EXPECT_EQ(refusal(call(mode).in(s).in(s)), text);
    EXPECT_EQ(refusal(call(mode).in(s).in(s).out(s).out(s)), text);
    EXPECT_EQ(refusal(call(mode).out(s)), text);
    EXPECT_EQ(refusal(call(mode).in(s).out({0, 0, 1})), text) << "before empty slices";
  }
}

TEST(StridedArgs, EmptySlicesAreRejectedUnderAnyPolicy) {
  const slice full{0, 4, 1};
  for (const auto policy : {enums::slice_normal, enums::slice_minimum, enums::slice_cyclic}) {
    for (const slice none : {slice{0, 0, 1}, slice{2, 4, -1}, slice{-1, 1, 1}, slice{5, 0, -3}}) {
      EXPECT_EQ((rejection<2, 1>(call(policy).in(none).in(full).out(full))), empty);
      EXPECT_EQ((rejection<2, 1>(call(policy).in(full).in(none).out(full))), empty);
      EXPECT_EQ((rejection<2, 1>(call(policy).in(full).in(full).out(none))), empty);
      EXPECT_EQ((rejection<1, 2>(call(policy).in(full).out(full).out(none))), empty);
      const auto args =
          describe<2, 1>(call(policy | enums::badarg_quiet).in(none).in(full).out(full));
      EXPECT_EQ(args.count, 0);
      EXPECT_FALSE(args.cyclic);
      EXPECT_EQ(args.in_extent[0], 1) << "an empty slice";
    }
  }
}

TEST(StridedArgs, ASliceDownToItsFirstElementIsNotEmpty) {
  EXPECT_EQ((describe<1, 1>(call().in({3, 4, -1}).out({6, 4, -2})).count), 4);
  EXPECT_EQ((describe<1, 1>(call().in({0, 1, -9}).out({0, 1, 1})).count), 1);
}

TEST(StridedArgs, DifferentSizesUnderTheNormalPolicy) {
  const slice three{0, 3, 1}, five{0, 5, 1};
  EXPECT_EQ((rejection<1, 1>(call().in(three).out(five))), differ);
  EXPECT_EQ((rejection<1, 1>(call().in(five).out(three))), differ);
  EXPECT_EQ((rejection<2, 1>(call().in(three).in(five).out(three))), differ);
  EXPECT_EQ((rejection<1, 2>(call().in(three).out(three).out(five))), differ);
  const auto args = describe<1, 1>(call(enums::badarg_quiet).in(three).out(five));
  EXPECT_EQ(args.count, 0);
  EXPECT_EQ(args.in_extent[0], 0);
  EXPECT_EQ(args.out_extent[0], 0);
}

TEST(StridedArgs, AnEmptySliceIsNamedBeforeDifferentSizes) {
  EXPECT_EQ((rejection<2, 1>(call().in({0, 3, 1}).in({0, 0, 1}).out({0, 5, 1}))), empty);
}

TEST(StridedArgs, TheMinimumPolicyTakesTheSmallestSize) {
  const auto args =
      describe<2, 1>(call(enums::slice_minimum).in({0, 3, 2}).in({1, 5, 1}).out({0, 4, 3}));
  EXPECT_EQ(args.count, 3);
  EXPECT_FALSE(args.cyclic);
  EXPECT_EQ(args.divisor[0], 1);
  EXPECT_EQ(args.divisor[1], 1);
  EXPECT_EQ(args.in_size[1], 5);
  EXPECT_EQ(args.in_extent[0], 5);
  EXPECT_EQ(args.in_extent[1], 4) << "as far as the count goes";
  EXPECT_EQ(args.out_extent[0], 7);
}

TEST(StridedArgs, CyclicDivisorsAreProductsOfLaterSizes) {
  const auto args = describe<3, 1>(
      call(enums::slice_cyclic).in({0, 2, 1}).in({0, 3, 1}).in({4, 5, 2}).out({0, 60, 1}));
  EXPECT_TRUE(args.cyclic);
  EXPECT_EQ(args.count, 60);
  EXPECT_EQ(args.divisor[0], 15);
  EXPECT_EQ(args.divisor[1], 5);
  EXPECT_EQ(args.divisor[2], 1);
  EXPECT_EQ(args.in_size[0], 2);
  EXPECT_EQ(args.in_extent[2], 13);
  EXPECT_EQ(args.out_extent[0], 60);
}

TEST(StridedArgs, ACyclicCountIsTheFirstOutputsSize) {
  // The smallest size, on which the other policies build, has no say beyond not being 0.
  EXPECT_EQ((describe<1, 1>(call(enums::slice_cyclic).in({0, 9, 1}).out({0, 4, 1})).count), 4);
  const auto args =
      describe<1, 2>(call(enums::slice_cyclic).in({0, 3, 1}).out({0, 7, 1}).out({0, 8, 2}));
  EXPECT_EQ(args.count, 7);
  EXPECT_EQ(args.divisor[0], 1);
  EXPECT_EQ(args.out_extent[0], 7);
  EXPECT_EQ(args.out_extent[1], 13);
}

TEST(StridedArgs, CyclicCombinationsThatOverflow) {
  const auto refusal = [](const call& record) {
    return message_of<std::runtime_error>([&] { describe<3, 1>(record); });
  };
  constexpr std::int64_t big = std::int64_t{1} << 32;
  const auto cyclic = [](std::uint32_t quiet, std::int64_t a, std::int64_t b, std::int64_t c) {
    return call(enums::slice_cyclic | quiet)
        .in({0, a, 0})
        .in({0, b, 0})
        .in({0, c, 0})
        .out({0, 6, 1});
  };
  for (const std::uint32_t quiet : {0u, static_cast<unsigned>(enums::badarg_quiet)}) {
    EXPECT_EQ(refusal(cyclic(quiet, 1, big, big)), "overflow on divisor calculation");
    EXPECT_EQ(refusal(cyclic(quiet, big, 1, big)), "overflow on divisor calculation")
        << "the product of all sizes is tested too";
    EXPECT_EQ(refusal(cyclic(quiet, 2, largest, 1)), "overflow on divisor calculation");
  }
  const auto args = describe<3, 1>(cyclic(0, 1, big / 2, big - 1));
  EXPECT_EQ(args.divisor[0], big / 2 * (big - 1));
  EXPECT_EQ(args.divisor[1], big - 1);
}

TEST(StridedArgs, CountsAreNotLimitedHere) {
  const slice s{0, std::int64_t{1} << 40, 1};
  EXPECT_EQ((describe<1, 1>(call().in(s).out(s)).count), s.size);
}

TEST(StridedArgs, SlicesBeyondAllMemoryWrapAround) {
  // Whatever comes out, it is a descriptor or one of the rejections.
  for (const std::int64_t start : {std::int64_t{0}, largest, smallest})
    for (const std::int64_t size : {std::int64_t{1}, largest, smallest, std::int64_t{-3}})
      for (const std::int64_t stride : {std::int64_t{0}, largest, smallest, std::int64_t{-1}})
        for (const auto policy : {enums::slice_normal, enums::slice_minimum, enums::slice_cyclic}) {
          const slice s{start, size, stride};
          try {
            const auto args = describe<1, 1>(call(policy).in(s).out(s));
            EXPECT_GE(args.in_extent[0], 0);
            EXPECT_GE(args.out_extent[0], 0);
            EXPECT_NE(args.count, 0);
          } catch (const arbor::lumen::invalid_argument& rejected) {
            EXPECT_STREQ(rejected.what(), empty);
          }
        }
}

}  // namespace
