// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/trig/cos.hpp"

#include "trig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::cos_d;
using scalar::cos_s;
using scalar::tier;

constexpr point_of<std::uint32_t> cos_s_la_points[] = {
    {0x3f000000, 0x3f60a940}, {0x3f800000, 0x3f0a5140}, {0xbf800000, 0x3f0a5140},
    {0x3fc00000, 0x3d90deaa}, {0x40000000, 0xbed51132}, {0x40400000, 0xbf7d7025},
    {0x40490000, 0xbf7ffff8}, {0x40980000, 0x3d1a04b7}, {0xc0c80000, 0x3f7fdbea},
    {0x41200000, 0xbf56cd64}, {0xc1b00000, 0xbf7ffd6d}, {0x42c90000, 0x3f7fe095},
    {0x43b18000, 0xbf800000}, {0xc49a5225, 0xbf7f3422}, {0x46010000, 0x3f7e93aa},
    {0x3c23d70a, 0x3f7ffcb9}, {0xba83126f, 0x3f7ffff7}, {0x37fba882, 0x3f7fffff}};

constexpr point_of<std::uint32_t> cos_s_ep_points[] = {
    {0x3f000000, 0x3f60ac08}, {0x3f800000, 0x3f0a534c}, {0xbf800000, 0x3f0a534c},
    {0x3fc00000, 0x3d90da8c}, {0x40000000, 0xbed51118}, {0x40400000, 0xbf7d6646},
    {0x40490000, 0xbf7fffa5}, {0x40980000, 0x3d1a003b}, {0xc0c80000, 0x3f7fd776},
    {0x41200000, 0xbf56d20d}, {0xc1b00000, 0xbf7ffbf4}, {0x42c90000, 0x3f7fdc5e},
    {0x43b18000, 0xbf7fffd2}, {0xc49a5225, 0xbf7f2c0c}, {0x46010000, 0x3f7e8a6d},
    {0x3c23d70a, 0x3f7ffb18}, {0xba83126f, 0x3f7fffa3}, {0x37fba882, 0x3f7fffd2}};

constexpr point_of<std::uint64_t> cos_d_ha_points[] = {
    {0x3fe0000000000000, 0x3fec1528065b7d50}, {0x3ff0000000000000, 0x3fe14a280fb5068c},
    {0xbff0000000000000, 0x3fe14a280fb5068c}, {0x3ff8000000000000, 0x3fb21bd54fc5f9a7},
    {0x4000000000000000, 0xbfdaa22657537205}, {0x4008000000000000, 0xbfefae04be85e5d2},
    {0x4009200000000000, 0xbfefffff04a648d7}, {0x4013000000000000, 0x3fa34096e1d37b74},
    {0xc019000000000000, 0x3feffb7d58a8f975}, {0x4024000000000000, 0xbfead9ac890c6b1f},
    {0xc036000000000000, 0xbfefffadd8d4acda}, {0x4059200000000000, 0x3feffc12adaecec2},
    {0x4076300000000000, 0xbfefffffffc18e4c}, {0xc0934a449ba5e354, 0xbfefe681a761293f},
    {0x40f0000000000000, 0xbfe719453109288c}, {0x3f50624dd2f1a9fc, 0x3feffffef390876c},
    {0xbee4f8b588e368f1, 0x3feffffffff920c8}, {0x3e10000000000000, 0x3ff0000000000000},
    {0x1eb67e9c127b6e74, 0x3ff0000000000000}, {0x412000009999999a, 0x3fec8d9b233c81c4},
    {0x412fffffcccccccd, 0x3fef1b57557c0355}};

constexpr point_of<std::uint64_t> cos_d_la_points[] = {
    {0x3fe0000000000000, 0x3fec1528065b7d4e}, {0x3ff0000000000000, 0x3fe14a280fb5068b},
    {0xbff0000000000000, 0x3fe14a280fb5068b}, {0x3ff8000000000000, 0x3fb21bd54fc5f9a7},
    {0x4000000000000000, 0xbfdaa22657537205}, {0x4008000000000000, 0xbfefae04be85e5d2},
    {0x4009200000000000, 0xbfefffff04a648d7}, {0x4013000000000000, 0x3fa34096e1d37b75},
    {0xc019000000000000, 0x3feffb7d58a8f977}, {0x4024000000000000, 0xbfead9ac890c6b1f},
    {0xc036000000000000, 0xbfefffadd8d4acdb}, {0x4059200000000000, 0x3feffc12adaecec3},
    {0x4076300000000000, 0xbfefffffffc18e4c}, {0xc0934a449ba5e354, 0xbfefe681a761293e},
    {0x40f0000000000000, 0xbfe719453109288c}, {0x3f50624dd2f1a9fc, 0x3feffffef390876c},
    {0xbee4f8b588e368f1, 0x3feffffffff920c8}, {0x3e10000000000000, 0x3ff0000000000000},
    {0x1eb67e9c127b6e74, 0x3ff0000000000000}, {0x412000009999999a, 0x3fec8d9b233c81c3},
    {0x412fffffcccccccd, 0x3fef1b57557c0356}};

constexpr point_of<std::uint64_t> cos_d_ep_points[] = {
    {0x3fe0000000000000, 0x3fec152804b30b96}, {0x3ff0000000000000, 0x3fe14a281136211b},
    {0xbff0000000000000, 0x3fe14a281136211b}, {0x3ff8000000000000, 0x3fb21bd54fe3f4af},
    {0x4000000000000000, 0xbfdaa2265a5d4d1c}, {0x4008000000000000, 0xbfefae04be46165b},
    {0x4009200000000000, 0xbfefffff047fdcd0}, {0x4013000000000000, 0x3fa34096e1dc97af},
    {0xc019000000000000, 0x3feffb7d55752d6a}, {0x4024000000000000, 0xbfead9ac8640978f},
    {0xc036000000000000, 0xbfefffadd799be6e}, {0x4059200000000000, 0x3feffc12aa967a77},
    {0x4076300000000000, 0xbfefffffffc057de}, {0xc0934a449ba5e354, 0xbfefe681a4224cf3},
    {0x40f0000000000000, 0xbfe719452f77b7da}, {0x3f50624dd2f1a9fc, 0x3feffffef368d71a},
    {0xbee4f8b588e368f1, 0x3feffffffff8b9bb}, {0x3e10000000000000, 0x3fefffffffffffec},
    {0x1eb67e9c127b6e74, 0x3ff0000000000000}, {0x412000009999999a, 0x3fec8d9b2256f888},
    {0x412fffffcccccccd, 0x3fef1b5758bfd2ff}};

/// Behind the rows of tables, where the patterns follow from the rows.
constexpr point_of<std::uint64_t> cos_d_la_large_points[] = {
    {0x4170000010000000, 0x3fefd1fe5195a1a2}, {0xc197d78400000000, 0xbfd741b388a8c029},
    {0x4202a05f20000000, 0x3febf098901c931a}, {0x432550f7dca70000, 0x3feff75e5df884a4},
    {0xc480f0cf064dd592, 0x3fe0be2cef01c8f4}, {0x483d6329f1c35ca5, 0xbfe867d0a5330fd0},
    {0x54b249ad2594c37d, 0x3fed9757496841f5}, {0x7fe0000000000000, 0xbfea719f26c232bf},
    {0xffefffffffffffff, 0xbfefffe62ecfab75}};

TEST(CosFloat, Points) {
  expect_points<cos_s<tier::la>>(cos_s_la_points);
  expect_points<cos_s<tier::ep>>(cos_s_ep_points);
}

TEST(CosDouble, Points) {
  expect_points<cos_d<tier::ha>>(cos_d_ha_points);
  expect_points<cos_d<tier::la>>(cos_d_la_points);
  expect_points<cos_d<tier::ep>>(cos_d_ep_points);
  expect_points<cos_d<tier::la>>(cos_d_la_large_points);
}

TEST(CosFloat, InfinitiesAndNans) {
  expect_own_pattern_of_infinity<cos_s<tier::ha>>();
  expect_own_pattern_of_infinity<cos_s<tier::la>>();
  expect_own_pattern_of_infinity<cos_s<tier::ep>>();
  expect_v11<cos_s<tier::la>>(0xff800000, 0xffc00000, domain);
}

TEST(CosDouble, InfinitiesAndNans) {
  expect_negative_nan_of_infinity<cos_d<tier::ha>>();
  expect_any_nan_of_infinity<cos_d<tier::la>>();
  expect_any_nan_of_infinity<cos_d<tier::ep>>();
}

/// Exactly 1 where pi/2 hides the argument, at every tier; behind it by the polynomial, which at
/// `ep` is rough.
TEST(Cos, OneOfTinyArguments) {
  for (const std::uint32_t p : {0u, 1u, 0x00800000u, 0x20000000u, 0x337fffffu}) {
    for (const std::uint32_t sign : {0u, 0x80000000u}) {
      expect_v11<cos_s<tier::ha>>(p | sign, 0x3f800000);
      expect_v11<cos_s<tier::la>>(p | sign, 0x3f800000);
      expect_v11<cos_s<tier::ep>>(p | sign, 0x3f800000);
    }
  }
  expect_v11<cos_s<tier::la>>(0x33800000, 0x3f800000);
  expect_v11<cos_s<tier::ep>>(0x33800000, 0x3f7fffd3);
  for (const std::uint64_t p :
       {std::uint64_t{0}, std::uint64_t{1}, std::uint64_t{0x3ca0000000000000}}) {
    for (const std::uint64_t sign : {std::uint64_t{0}, std::uint64_t{0x8000000000000000}}) {
      expect_v11<cos_d<tier::ha>>(p | sign, 0x3ff0000000000000);
      expect_v11<cos_d<tier::la>>(p | sign, 0x3ff0000000000000);
      expect_v11<cos_d<tier::ep>>(p | sign, 0x3ff0000000000000);
    }
  }
  expect_v11<cos_d<tier::ep>>(0x3ca0000000000001, 0x3feffffffffffff0);
}

TEST(CosFloat, MainPath) {
  expect_main_path_up_to<cos_s<tier::ha>>(0x49ffffffu);  // below 2^21
  expect_main_path_up_to<cos_s<tier::la>>(0x461c4000u);  // 10000
  expect_main_path_up_to<cos_s<tier::ep>>(0x461c4000u);
}

TEST(CosDouble, MainPath) {
  expect_main_path_up_to<cos_d<tier::ha>>(std::uint64_t{0x412fffffffffffff});  // below 2^20
  // pi/2 - a rounds to -2^23.
  expect_main_path_up_to<cos_d<tier::la>>(std::uint64_t{0x416000003243f6a9});
  expect_main_path_up_to<cos_d<tier::ep>>(std::uint64_t{0x416000003243f6a9});
}

/// Below 2^-12 the result is 1.
TEST(CosFloat, OneOfSmallArguments) {
  expect_v11<cos_s<tier::ha>>(0x397fffff, 0x3f800000);
  expect_v11<cos_s<tier::ha>>(0x39ffffff, 0x3f7ffffe);
  expect_within<cos_s<tier::ha>>(trig::cosine, around(0x39800000u), 0.6);
  expect_within<cos_s<tier::ha>>(trig::cosine, around(0x3a000000u), 0.6);
}

TEST(CosFloat, Accuracy) {
  const auto all = every_binade(0x00800000u, 0x7f7fffffu, 40);
  const auto main = joined(joined(evenly(10'000.0f, 20'000), around(0x461c4000u)),
                           every_binade(0x30000000u, 0x461c4000u, 40));
  const auto fixed_point = joined(evenly(2e6f, 10'000), around(0x4a000000u));
  const std::vector hard(std::begin(hard_floats), std::end(hard_floats));
  expect_within<cos_s<tier::ha>>(trig::cosine, joined(joined(all, fixed_point), hard), 0.6);
  expect_within<cos_s<tier::la>>(trig::cosine, joined(main, hard), 2.5);
  expect_within<cos_s<tier::la>>(trig::cosine, every_binade(0x461c4001u, 0x7f7fffffu, 40), 0.6);
  expect_within<cos_s<tier::ep>>(trig::cosine, joined(main, hard), 2540);
  expect_within<cos_s<tier::ep>>(trig::cosine, every_binade(0x461c4001u, 0x7f7fffffu, 40), 0.6);
}

TEST(CosDouble, Accuracy) {
  constexpr std::uint64_t largest = 0x7fefffffffffffff, tiny = 0x3d00000000000000,
                          up_to_20 = 0x412fffffffffffff, up_to_23 = 0x416000003243f6a9;
  const auto beyond_20 = joined(every_binade(up_to_20 + 1, largest, 4), around(up_to_20));
  const auto beyond_23 = every_binade(up_to_23 + 1, largest, 4);
  const auto beyond_30 = around(std::uint64_t{0x41d0000000000000});
  const auto main = joined(evenly(0x1p20, 20'000), every_binade(tiny, up_to_20, 40));
  const std::vector hard(std::begin(hard_doubles), std::end(hard_doubles));
  const auto hard_beyond_23 = between(hard_doubles, up_to_23, largest);
  expect_within<cos_d<tier::ha>>(trig::cosine, joined(main, beyond_20), 0.88);
  expect_within<cos_d<tier::ha>>(trig::cosine, hard, 0.505);
  expect_within<cos_d<tier::la>>(trig::cosine, joined(joined(main, hard), around(up_to_23)), 3.5);
  expect_within<cos_d<tier::la>>(trig::cosine, joined(beyond_23, hard_beyond_23), 0.501);
  expect_within<cos_d<tier::ep>>(trig::cosine, joined(joined(main, hard), around(up_to_23)), 6.2e7);
  expect_within<cos_d<tier::ep>>(trig::cosine, joined(beyond_23, joined(beyond_30, hard_beyond_23)),
                                 1.3);
}

}  // namespace
