// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/trig/sin.hpp"

#include "trig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::sin_d;
using scalar::sin_s;
using scalar::tier;

constexpr point_of<std::uint32_t> sin_s_la_points[] = {
    {0x3f000000, 0x3ef57744}, {0x3f800000, 0x3f576aa4}, {0xbf800000, 0xbf576aa4},
    {0x3fc00000, 0x3f7f5bd4}, {0x40000000, 0x3f68c7b7}, {0x40400000, 0x3e1081c3},
    {0x40490000, 0x3a7daa1f}, {0x40980000, 0xbf7fd1a6}, {0xc0c80000, 0x3d07e6ee},
    {0x41200000, 0xbf0b44f7}, {0xc1b00000, 0x3c110515}, {0x42c90000, 0xbcfd9fc2},
    {0x43b18000, 0xb7fcde81}, {0xc49a5225, 0xbda16977}, {0x46010000, 0xbdd7a684},
    {0x3c23d70a, 0x3c23d657}, {0xba83126f, 0xba83126e}, {0x37fba882, 0x37fba882}};

constexpr point_of<std::uint32_t> sin_s_ep_points[] = {
    {0x3f000000, 0x3ef57912}, {0x3f800000, 0x3f576f3a}, {0xbf800000, 0xbf576f3a},
    {0x3fc00000, 0x3f7f5445}, {0x40000000, 0x3f68c7f5}, {0x40400000, 0x3e107e0c},
    {0x40490000, 0x3a7da2ad}, {0x40980000, 0xbf7fccca}, {0xc0c80000, 0x3d07e2f7},
    {0x41200000, 0xbf0b4717}, {0xc1b00000, 0x3c1100d3}, {0x42c90000, 0xbcfd985b},
    {0x43b18000, 0xb7fcd715}, {0xc49a5225, 0xbda164ea}, {0x46010000, 0xbdd7a0a0},
    {0x3c23d70a, 0x3c23d189}, {0xba83126f, 0xba830e95}, {0x37fba882, 0x37fba11f}};

constexpr point_of<std::uint64_t> sin_d_ha_points[] = {
    {0x3fe0000000000000, 0x3fdeaee8744b05f0}, {0x3ff0000000000000, 0x3feaed548f090cee},
    {0xbff0000000000000, 0xbfeaed548f090cee}, {0x3ff8000000000000, 0x3fefeb7a9b2c6d8b},
    {0x4000000000000000, 0x3fed18f6ead1b446}, {0x4008000000000000, 0x3fc210386db6d55b},
    {0x4009200000000000, 0x3f4fb543efcc9d39}, {0x4013000000000000, 0xbfeffa34def8e460},
    {0xc019000000000000, 0x3fa0fcddc3f512bc}, {0x4024000000000000, 0xbfe1689ef5f34f52},
    {0xc036000000000000, 0x3f8220a29f6eb9f4}, {0x4059200000000000, 0xbf9fb3f833470ff1},
    {0x4076300000000000, 0xbeff9bd0307d1de3}, {0xc0934a449ba5e354, 0xbfb42e44755bce6c},
    {0x40f0000000000000, 0x3fe62566735b8513}, {0x3f50624dd2f1a9fc, 0x3f50624da5218a62},
    {0xbee4f8b588e368f1, 0xbee4f8b588e1e8a2}, {0x3e10000000000000, 0x3e10000000000000},
    {0x1eb67e9c127b6e74, 0x1eb67e9c127b6e74}, {0x412000009999999a, 0x3fdce4e5d20ee085},
    {0x412fffffcccccccd, 0x3fce07fa13370afb}};

constexpr point_of<std::uint64_t> sin_d_la_points[] = {
    {0x3fe0000000000000, 0x3fdeaee8744b05ef}, {0x3ff0000000000000, 0x3feaed548f090cee},
    {0xbff0000000000000, 0xbfeaed548f090cee}, {0x3ff8000000000000, 0x3fefeb7a9b2c6d8c},
    {0x4000000000000000, 0x3fed18f6ead1b445}, {0x4008000000000000, 0x3fc210386db6d55b},
    {0x4009200000000000, 0x3f4fb543efcc9d3a}, {0x4013000000000000, 0xbfeffa34def8e461},
    {0xc019000000000000, 0x3fa0fcddc3f512bc}, {0x4024000000000000, 0xbfe1689ef5f34f52},
    {0xc036000000000000, 0x3f8220a29f6eb9f4}, {0x4059200000000000, 0xbf9fb3f833470ff1},
    {0x4076300000000000, 0xbeff9bd0307d1de3}, {0xc0934a449ba5e354, 0xbfb42e44755bce6c},
    {0x40f0000000000000, 0x3fe62566735b8513}, {0x3f50624dd2f1a9fc, 0x3f50624da5218a62},
    {0xbee4f8b588e368f1, 0xbee4f8b588e1e8a2}, {0x3e10000000000000, 0x3e10000000000000},
    {0x1eb67e9c127b6e74, 0x1eb67e9c127b6e74}, {0x412000009999999a, 0x3fdce4e5d20ee084},
    {0x412fffffcccccccd, 0x3fce07fa13370afc}};

constexpr point_of<std::uint64_t> sin_d_ep_points[] = {
    {0x3fe0000000000000, 0x3fdeaee877a76846}, {0x3ff0000000000000, 0x3feaed548c46e026},
    {0xbff0000000000000, 0xbfeaed548c46e026}, {0x3ff8000000000000, 0x3fefeb7a97b4af77},
    {0x4000000000000000, 0x3fed18f6eb05ec09}, {0x4008000000000000, 0x3fc210386e2838c1},
    {0x4009200000000000, 0x3f4fb543efcc9fc8}, {0x4013000000000000, 0xbfeffa34db97cca9},
    {0xc019000000000000, 0x3fa0fcddc3fb5694}, {0x4024000000000000, 0xbfe1689ef76e3380},
    {0xc036000000000000, 0x3f8220a29f6f3426}, {0x4059200000000000, 0xbf9fb3f833513f3f},
    {0x4076300000000000, 0xbeff9bd0307d1de3}, {0xc0934a449ba5e354, 0xbfb42e44758523d6},
    {0x40f0000000000000, 0x3fe62566727bb9c4}, {0x3f50624dd2f1a9fc, 0x3f50624da5218bcb},
    {0xbee4f8b588e368f1, 0xbee4f8b588e1e8a2}, {0x3e10000000000000, 0x3e10000000000000},
    {0x1eb67e9c127b6e74, 0x1eb67e9c127b6e74}, {0x412000009999999a, 0x3fdce4e5d5583dd7},
    {0x412fffffcccccccd, 0x3fce07fa15049ea1}};

/// Behind the rows of tables, where the patterns follow from the rows.
constexpr point_of<std::uint64_t> sin_d_la_large_points[] = {
    {0x4170000010000000, 0x3fbb17d7d79c02c7}, {0xc197d78400000000, 0xbfedcffca623a20b},
    {0x4202a05f20000000, 0xbfdf334c7896a4e3}, {0x432550f7dca70000, 0x3fa77f46d55870ef},
    {0xc480f0cf064dd592, 0x3feb453ab76bf397}, {0x483d6329f1c35ca5, 0x3fe4b27597db33ce},
    {0x54b249ad2594c37d, 0xbfd85c5e5b929359}, {0x7fe0000000000000, 0x3fe205248cbdb760},
    {0xffefffffffffffff, 0xbf7452fc98b34e97}};

TEST(SinFloat, Points) {
  expect_points<sin_s<tier::la>>(sin_s_la_points);
  expect_points<sin_s<tier::ep>>(sin_s_ep_points);
}

TEST(SinDouble, Points) {
  expect_points<sin_d<tier::ha>>(sin_d_ha_points);
  expect_points<sin_d<tier::la>>(sin_d_la_points);
  expect_points<sin_d<tier::ep>>(sin_d_ep_points);
  expect_points<sin_d<tier::la>>(sin_d_la_large_points);
}

TEST(SinFloat, InfinitiesAndNans) {
  expect_own_pattern_of_infinity<sin_s<tier::ha>>();
  expect_own_pattern_of_infinity<sin_s<tier::la>>();
  expect_own_pattern_of_infinity<sin_s<tier::ep>>();
  expect_v11<sin_s<tier::la>>(0xff800000, 0xffc00000, domain);
}

TEST(SinDouble, InfinitiesAndNans) {
  expect_negative_nan_of_infinity<sin_d<tier::ha>>();
  expect_any_nan_of_infinity<sin_d<tier::la>>();
  expect_any_nan_of_infinity<sin_d<tier::ep>>();
}

TEST(Sin, ZerosAndDenormals) {
  expect_odd_zero<sin_s<tier::ha>>();
  expect_odd_zero<sin_s<tier::la>>();
  expect_odd_zero<sin_d<tier::ha>>();
  expect_odd_zero<sin_d<tier::la>>();
  for (const std::uint32_t zero : {0x00000000u, 0x80000000u})
    expect_v11<sin_s<tier::ep>>(zero, zero);
  for (const std::uint64_t zero : {std::uint64_t{0}, std::uint64_t{0x8000000000000000}})
    expect_v11<sin_d<tier::ep>>(zero, zero);
}

TEST(SinFloat, MainPath) {
  expect_main_path_up_to<sin_s<tier::ha>>(0x49ffffffu);  // below 2^21
  expect_main_path_up_to<sin_s<tier::la>>(0x461c4000u);  // 10000
  expect_main_path_up_to<sin_s<tier::ep>>(0x461c4000u);
}

TEST(SinDouble, MainPath) {
  expect_main_path_up_to<sin_d<tier::ha>>(std::uint64_t{0x412fffffffffffff});  // below 2^20
  expect_main_path_up_to<sin_d<tier::la>>(std::uint64_t{0x4170000000000000});  // 2^24
  expect_main_path_up_to<sin_d<tier::ep>>(std::uint64_t{0x4170000000000000});
}

/// Below 2^-12 the argument, from there the fixed point, which differs from it.
TEST(SinFloat, IdentityOfSmallArguments) {
  expect_v11<sin_s<tier::ha>>(0x397fffff, 0x397fffff);
  expect_v11<sin_s<tier::ha>>(0xb97fffff, 0xb97fffff);
  expect_v11<sin_s<tier::ha>>(0x38d1b717, 0x38d1b717);  // 0.0001
  expect_v11<sin_s<tier::ha>>(0x39ffffff, 0x39fffffe);
  expect_within<sin_s<tier::ha>>(trig::sine, around(0x39800000u), 0.6);
  expect_within<sin_s<tier::ha>>(trig::sine, around(0x3a000000u), 0.6);
}

TEST(SinFloat, Accuracy) {
  const auto all = every_binade(0x00800000u, 0x7f7fffffu, 40);
  const auto main = joined(joined(evenly(10'000.0f, 20'000), around(0x461c4000u)),
                           every_binade(0x30000000u, 0x461c4000u, 40));
  const auto fixed_point = joined(evenly(2e6f, 10'000), around(0x4a000000u));
  const std::vector hard(std::begin(hard_floats), std::end(hard_floats));
  expect_within<sin_s<tier::ha>>(trig::sine, joined(joined(all, fixed_point), hard), 0.6);
  expect_within<sin_s<tier::la>>(trig::sine, joined(main, hard), 2.5);
  expect_within<sin_s<tier::la>>(trig::sine, every_binade(0x461c4001u, 0x7f7fffffu, 40), 0.6);
  expect_within<sin_s<tier::ep>>(trig::sine, joined(main, hard), 2540);
  expect_within<sin_s<tier::ep>>(trig::sine, every_binade(0x461c4001u, 0x7f7fffffu, 40), 0.6);
}

TEST(SinDouble, Accuracy) {
  constexpr std::uint64_t largest = 0x7fefffffffffffff, tiny = 0x3d00000000000000,
                          up_to_20 = 0x412fffffffffffff, up_to_24 = 0x4170000000000000;
  const auto beyond_20 = joined(every_binade(up_to_20 + 1, largest, 4), around(up_to_20));
  const auto beyond_24 = every_binade(up_to_24 + 1, largest, 4);
  const auto beyond_30 = around(std::uint64_t{0x41d0000000000000});
  const auto main = joined(evenly(0x1p20, 20'000), every_binade(tiny, up_to_20, 40));
  const std::vector hard(std::begin(hard_doubles), std::end(hard_doubles));
  const auto hard_beyond_24 = between(hard_doubles, up_to_24, largest);
  expect_within<sin_d<tier::ha>>(trig::sine, joined(main, beyond_20), 0.88);
  expect_within<sin_d<tier::ha>>(trig::sine, hard, 0.505);
  expect_within<sin_d<tier::la>>(trig::sine, joined(joined(main, hard), around(up_to_24)), 3.5);
  expect_within<sin_d<tier::la>>(trig::sine, joined(beyond_24, hard_beyond_24), 0.501);
  expect_within<sin_d<tier::ep>>(trig::sine, joined(joined(main, hard), around(up_to_24)), 6.2e7);
  expect_within<sin_d<tier::ep>>(trig::sine, joined(beyond_24, joined(beyond_30, hard_beyond_24)),
                                 1.3);
}

}  // namespace
