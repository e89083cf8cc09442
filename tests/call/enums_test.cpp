// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "arbor/lumen/vm/enums.hpp"

#include <gtest/gtest.h>

#include <bit>
#include <cstddef>
#include <cstdint>
#include <type_traits>

#include "arbor/lumen/slice.hpp"

namespace {

using namespace arbor::lumen::vm::enums;
using arbor::lumen::slice;

static_assert(std::is_same_v<std::underlying_type_t<mode>, std::uint32_t>);
static_assert(std::is_same_v<std::underlying_type_t<status>, std::uint32_t>);
// Plain enumerations: their values convert to integers by themselves.
static_assert(std::is_convertible_v<mode, std::uint32_t>);
static_assert(std::is_convertible_v<status, std::uint32_t>);
static_assert(std::is_same_v<decltype(ha | la), mode>);
static_assert(std::is_same_v<decltype(ha & la), mode>);
static_assert(std::is_same_v<decltype(~ha), mode>);
static_assert(std::is_same_v<decltype(errdom | sing), status>);
static_assert(std::is_same_v<decltype(errdom & sing), status>);
static_assert(std::is_same_v<decltype(~errdom), status>);

TEST(Enums, ModeValues) {
  EXPECT_EQ(0u, not_defined);
  EXPECT_EQ(4u, ha);
  EXPECT_EQ(12u, la);
  EXPECT_EQ(15u, ep);
  EXPECT_EQ(0x100u, global_status_report);
  EXPECT_EQ(0x200u, no_global_status_report);
  EXPECT_EQ(0x1000u, slice_normal);
  EXPECT_EQ(0x2000u, slice_minimum);
  EXPECT_EQ(0x4000u, slice_cyclic);
  EXPECT_EQ(0x10000u, badarg_exception);
  EXPECT_EQ(0x20000u, badarg_quiet);
  EXPECT_EQ(0x100000u, mode_host_fallback);
  EXPECT_EQ(0x400000u, mode_missing_throws);
  EXPECT_EQ(0x800000u, mode_relaxed_fallback);
  EXPECT_EQ(25235972u, default_mode);
}

TEST(Enums, StatusValues) {
  EXPECT_EQ(0u, success);
  EXPECT_EQ(1u, errdom);
  EXPECT_EQ(2u, sing);
  EXPECT_EQ(4u, overflow);
  EXPECT_EQ(8u, underflow);
  EXPECT_EQ(128u, accuracy_warning);
  EXPECT_EQ(256u, bad_argument);
}

TEST(Enums, DefaultModeNamesTheDefaultOfEachGroup) {
  EXPECT_EQ(default_mode, ha | no_global_status_report | slice_normal | badarg_exception |
                              mode_relaxed_fallback | static_cast<mode>(0x1000000));
}

TEST(Enums, OperatorsOfModesWorkOnTheBits) {
  EXPECT_EQ(0x20104u, ha | global_status_report | badarg_quiet);
  EXPECT_EQ(ha, (la | slice_cyclic) & ep & ha);
  EXPECT_EQ(0xFFFFFFFBu, ~ha);
  mode m = la;
  m |= slice_minimum;
  EXPECT_EQ(0x200Cu, m);
  m &= ~la;
  EXPECT_EQ(slice_minimum, m);
  EXPECT_EQ(&m, &(m |= la));
  EXPECT_EQ(&m, &(m &= la));
}

TEST(Enums, OperatorsOfStatusesWorkOnTheBits) {
  EXPECT_EQ(0x181u, errdom | accuracy_warning | bad_argument);
  EXPECT_EQ(success, (errdom | sing) & overflow);
  EXPECT_EQ(0xFFFFFFFEu, ~errdom);
  status s = underflow;
  s |= errdom;
  EXPECT_EQ(9u, s);
  s &= ~underflow;
  EXPECT_EQ(errdom, s);
  EXPECT_EQ(&s, &(s |= sing));
  EXPECT_EQ(&s, &(s &= sing));
}

TEST(Slice, IsThreeWordsInOrder) {
  static_assert(std::is_trivially_copyable_v<slice> && std::is_standard_layout_v<slice>);
  static_assert(sizeof(slice) == 24);
  static_assert(offsetof(slice, start) == 0 && offsetof(slice, size) == 8 &&
                offsetof(slice, stride) == 16);
  static_assert(std::is_same_v<decltype(slice::start), std::int64_t>);
  const slice s{2, 5, -1};
  EXPECT_EQ(2, s.start);
  EXPECT_EQ(5, s.size);
  EXPECT_EQ(-1, s.stride);
}

}  // namespace
