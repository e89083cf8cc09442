// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/trig/tan.hpp"

#include "trig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::tan_d;
using scalar::tan_s;
using scalar::tier;

constexpr point_of<std::uint32_t> tan_s_la_points[] = {
    {0x3f000000, 0x3f0bda7a}, {0x3f800000, 0x3fc75924}, {0xbf800000, 0xbfc75924},
    {0x3fc00000, 0x41619f6b}, {0x40000000, 0xc00bd7b2}, {0x40400000, 0xbe11f7b9},
    {0x40490000, 0xba7daa27}, {0x40980000, 0xc1d49a74}, {0xc0c80000, 0x3d07fa19},
    {0x41200000, 0x3f25faf9}, {0xc1b00000, 0xbc110689}, {0x42c90000, 0xbcfdbee5},
    {0x43b18000, 0x37fcde81}, {0xc49a5225, 0x3da1ea67}, {0x46010000, 0xbdd8db25},
    {0x3c23d70a, 0x3c23d86f}, {0xba83126f, 0xba831272}, {0x37fba882, 0x37fba882}};

constexpr point_of<std::uint32_t> tan_s_ep_points[] = {
    {0x3f000000, 0x3f0bda7b}, {0x3f800000, 0x3fc75924}, {0xbf800000, 0xbfc75924},
    {0x3fc00000, 0x41619f6a}, {0x40000000, 0xc00bd7b3}, {0x40400000, 0xbe11f7b9},
    {0x40490000, 0xba7daa28}, {0x40980000, 0xc1d49a74}, {0xc0c80000, 0x3d07fa18},
    {0x41200000, 0x3f25faf8}, {0xc1b00000, 0xbc110689}, {0x42c90000, 0xbcfdbee5},
    {0x43b18000, 0x37fcde81}, {0xc49a5225, 0x3da1ea68}, {0x46010000, 0xbdd8db25},
    {0x3c23d70a, 0x3c23d86f}, {0xba83126f, 0xba831272}, {0x37fba882, 0x37fba882}};

constexpr point_of<std::uint64_t> tan_d_ha_points[] = {
    {0x3fe0000000000000, 0x3fe17b4f5bf3474a}, {0x3ff0000000000000, 0x3ff8eb245cbee3a6},
    {0xbff0000000000000, 0xbff8eb245cbee3a6}, {0x3ff8000000000000, 0x402c33ed50b88777},
    {0x4000000000000000, 0xc0017af62e0950f8}, {0x4008000000000000, 0xbfc23ef71254b86f},
    {0x4009200000000000, 0xbf4fb544e8db5760}, {0x4013000000000000, 0xc03a934e58d7cc85},
    {0xc019000000000000, 0x3fa0ff43123a338e}, {0x4024000000000000, 0x3fe4bf5f34be3782},
    {0xc036000000000000, 0xbf8220d129b73ef8}, {0x4059200000000000, 0xbf9fb7dcab49130d},
    {0x4076300000000000, 0x3eff9bd030bacc16}, {0xc0934a449ba5e354, 0x3fb43e65221cbd3d},
    {0x40f0000000000000, 0xbfeeae2708cf5425}, {0x3f50624dd2f1a9fc, 0x3f50624e2e91ebe4},
    {0xbee4f8b588e368f1, 0xbee4f8b588e6698e}, {0x3e10000000000000, 0x3e10000000000000},
    {0x1eb67e9c127b6e74, 0x1eb67e9c127b6e74}};

constexpr point_of<std::uint64_t> tan_d_la_points[] = {
    {0x3fe0000000000000, 0x3fe17b4f5bf3474a}, {0x3ff0000000000000, 0x3ff8eb245cbee3a4},
    {0xbff0000000000000, 0xbff8eb245cbee3a4}, {0x3ff8000000000000, 0x402c33ed50b88779},
    {0x4000000000000000, 0xc0017af62e0950f8}, {0x4008000000000000, 0xbfc23ef71254b86f},
    {0x4009200000000000, 0xbf4fb544e8db5761}, {0x4013000000000000, 0xc03a934e58d7cc85},
    {0xc019000000000000, 0x3fa0ff43123a338e}, {0x4024000000000000, 0x3fe4bf5f34be3782},
    {0xc036000000000000, 0xbf8220d129b73ef8}, {0x4059200000000000, 0xbf9fb7dcab49130c},
    {0x4076300000000000, 0x3eff9bd030bacc17}, {0xc0934a449ba5e354, 0x3fb43e65221cbd3e},
    {0x40f0000000000000, 0xbfeeae2708cf5425}, {0x3f50624dd2f1a9fc, 0x3f50624e2e91ebe3},
    {0xbee4f8b588e368f1, 0xbee4f8b588e6698e}, {0x3e10000000000000, 0x3e10000000000000},
    {0x1eb67e9c127b6e74, 0x1eb67e9c127b6e74}, {0x412000009999999a, 0x3fe030ea27760426},
    {0x412fffffcccccccd, 0x3fcee4ba9a33f247}};

constexpr point_of<std::uint64_t> tan_d_ep_points[] = {
    {0x3fe0000000000000, 0x3fe17b4f5d282bf2}, {0x3ff0000000000000, 0x3ff8eb245d4563c1},
    {0xbff0000000000000, 0xbff8eb245d4563c1}, {0x3ff8000000000000, 0x402c33ed4f6248aa},
    {0x4000000000000000, 0xc0017af62cd144b0}, {0x4008000000000000, 0xbfc23ef71203302f},
    {0x4009200000000000, 0xbf4fb544eb42e4a4}, {0x4013000000000000, 0xc03a934e570cfeaa},
    {0xc019000000000000, 0x3fa0ff431367a06e}, {0x4024000000000000, 0x3fe4bf5f342a2b08},
    {0xc036000000000000, 0xbf8220d12b15003c}, {0x4059200000000000, 0xbf9fb7dcad825fb7},
    {0x4076300000000000, 0x3eff9bd0332076e1}, {0xc0934a449ba5e354, 0x3fb43e6522f17f9f},
    {0x40f0000000000000, 0xbfeeae270ad46bea}, {0x3f50624dd2f1a9fc, 0x3f50624e2fcffbe5},
    {0xbee4f8b588e368f1, 0xbee4f8b58a7d908e}, {0x3e10000000000000, 0x3e1000000136a1f1},
    {0x1eb67e9c127b6e74, 0x1eb67e9c14302731}, {0x412000009999999a, 0x3fe030ea28c893d9},
    {0x412fffffcccccccd, 0x3fcee4ba97d38ee4}};

TEST(TanFloat, Points) {
  expect_points<tan_s<tier::la>>(tan_s_la_points);
  expect_points<tan_s<tier::ep>>(tan_s_ep_points);
}

TEST(TanDouble, Points) {
  expect_points<tan_d<tier::ha>>(tan_d_ha_points);
  expect_points<tan_d<tier::la>>(tan_d_la_points);
  expect_points<tan_d<tier::ep>>(tan_d_ep_points);
}

TEST(Tan, ZerosAndDenormals) {
  expect_odd_zero<tan_s<tier::ha>>();
  expect_odd_zero<tan_d<tier::la>>();
  expect_odd_zero<tan_d<tier::ha>>();  // -0 beside the table's -0 for the tangent of 0
  for (const std::uint32_t zero : {0x00000000u, 0x80000000u}) {
    expect_v11<tan_s<tier::la>>(zero, zero);
    expect_v11<tan_s<tier::ep>>(zero, zero);
  }
  for (const std::uint64_t zero : {std::uint64_t{0}, std::uint64_t{0x8000000000000000}})
    expect_v11<tan_d<tier::ep>>(zero, zero);
}

TEST(TanFloat, InfinitiesAndNans) {
  expect_own_pattern_of_infinity<tan_s<tier::ha>>();
  expect_any_nan_of_infinity<tan_s<tier::la>>();
  expect_any_nan_of_infinity<tan_s<tier::ep>>();
}

TEST(TanDouble, InfinitiesAndNans) {
  expect_any_nan_of_infinity<tan_d<tier::ha>>();
  expect_negative_nan_of_infinity<tan_d<tier::la>>();
  expect_negative_nan_of_infinity<tan_d<tier::ep>>();
}

TEST(TanFloat, MainPath) {
  expect_main_path_up_to<tan_s<tier::ha>>(0x49ffffffu);  // below 2^21
  expect_main_path_up_to<tan_s<tier::la>>(0x46010000u);  // 8256
  expect_main_path_up_to<tan_s<tier::ep>>(0x46010000u);
}

TEST(TanDouble, MainPath) {
  expect_main_path_up_to<tan_d<tier::ha>>(std::uint64_t{0x40f000000e4db24c});  // 65536.003
  expect_main_path_up_to<tan_d<tier::la>>(std::uint64_t{0x412fffffffffffff});  // below 2^20
  expect_main_path_up_to<tan_d<tier::ep>>(std::uint64_t{0x412fffffffffffff});
}

/// Below 2^-12 the argument, from there the fixed point, which differs from it.
TEST(TanFloat, IdentityOfSmallArguments) {
  expect_v11<tan_s<tier::ha>>(0x397fffff, 0x397fffff);
  expect_v11<tan_s<tier::ha>>(0xb97fffff, 0xb97fffff);
  expect_v11<tan_s<tier::ha>>(0x39ffffff, 0x3a000000);
  expect_within<tan_s<tier::ha>>(trig::tangent, around(0x39800000u), 0.6);
  expect_within<tan_s<tier::ha>>(trig::tangent, around(0x3a000000u), 0.6);
}

TEST(TanFloat, Accuracy) {
  const auto all = every_binade(0x00800000u, 0x7f7fffffu, 40);
  const auto main = joined(joined(evenly(8256.0f, 20'000), around(0x46010000u)),
                           every_binade(0x30000000u, 0x46010000u, 40));
  const auto fixed_point = joined(evenly(2e6f, 10'000), around(0x4a000000u));
  const auto rows = joined(every_binade(0x46010001u, 0x7f7fffffu, 100),
                           between(hard_floats, 0x46010001u, 0x7f7fffffu));
  const std::vector hard(std::begin(hard_floats), std::end(hard_floats));
  expect_within<tan_s<tier::ha>>(trig::tangent, joined(joined(all, fixed_point), hard), 0.6);
  expect_within<tan_s<tier::la>>(trig::tangent, joined(main, hard), 3.7);
  expect_within<tan_s<tier::la>>(trig::tangent, rows, 1.6);
  expect_within<tan_s<tier::ep>>(trig::tangent, joined(main, hard), 990);
  expect_within<tan_s<tier::ep>>(trig::tangent, rows, 1.6);
}

TEST(TanDouble, Accuracy) {
  constexpr std::uint64_t largest = 0x7fefffffffffffff, tiny = 0x3d00000000000000,
                          up_to_16 = 0x40f000000e4db24c, up_to_20 = 0x412fffffffffffff;
  const auto main = joined(evenly(0x1p20, 20'000), every_binade(tiny, up_to_20, 40));
  const auto beyond_16 = joined(every_binade(up_to_16 + 1, largest, 4), around(up_to_16));
  const auto beyond_20 =
      joined(every_binade(up_to_20 + 1, largest, 4), between(hard_doubles, up_to_20, largest));
  const std::vector hard(std::begin(hard_doubles), std::end(hard_doubles));
  expect_within<tan_d<tier::ha>>(trig::tangent, joined(evenly(65536.0, 20'000), main), 0.53);
  expect_within<tan_d<tier::ha>>(trig::tangent, joined(beyond_16, hard), 0.53);
  expect_within<tan_d<tier::la>>(trig::tangent, joined(main, hard), 2.9);
  expect_within<tan_d<tier::la>>(trig::tangent, beyond_20, 2.3);
  // Beside multiples of pi/2 the two parts of pi/2 are too few.
  expect_within<tan_d<tier::ep>>(trig::tangent, main, 5.3e7);
  expect_within<tan_d<tier::ep>>(trig::tangent, joined(beyond_20, around(up_to_20)), 5.3e7);
  expect_within<tan_d<tier::ep>>(trig::tangent, beyond_20, 2.3);
}

/// Beside odd multiples of pi/2, where the table has the pole: the negative reciprocal, of either
/// sign.
TEST(TanDouble, PoleOfTheTable) {
  for (const double n : {1.0, 3.0, 5.0, -1.0, 20'001.0}) {
    for (const double rest : {1e-9, 1e-3, 0.09}) {
      for (const double side : {-1.0, 1.0}) {
        const double x = n * 1.5707963267948966 + side * rest;
        const double y = result_of<tan_d<tier::ha>>(x);
        EXPECT_EQ(y<0, side> 0) << x;
        expect_within<tan_d<tier::ha>>(trig::tangent, std::vector{std::bit_cast<std::uint64_t>(x)},
                                       0.53);
      }
    }
  }
}

/// The rows of 512 steps beyond the main path: next to each sixteenth of pi and to the middle
/// between two of them, where the step goes to one side or the other.
TEST(TanDouble, SixteenthsBehindTheRows) {
  std::vector<std::uint64_t> arguments;
  for (int k = 0; k < 64; ++k) {
    const double x = (700'000 + k) * 0.09817477042468103;  // pi/32
    for (const double rest : {-0.006, -1e-7, 0.0, 1e-7, 0.006})
      arguments.push_back(std::bit_cast<std::uint64_t>(x + rest));
  }
  expect_within<tan_d<tier::ha>>(trig::tangent, arguments, 0.53);
}

}  // namespace
