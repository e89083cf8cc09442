// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/trig/sincos.hpp"

#include "trig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::sincos_d;
using scalar::sincos_s;
using scalar::tier;

constexpr pair_of<std::uint32_t> sincos_s_la_points[] = {
    {0x3f000000, 0x3ef57743, 0x3f60a940}, {0x3f800000, 0x3f576aa5, 0x3f0a5141},
    {0xbf800000, 0xbf576aa5, 0x3f0a5141}, {0x3fc00000, 0x3f7f5bd5, 0x3d90deab},
    {0x40000000, 0x3f68c7b7, 0xbed51134}, {0x40400000, 0x3e1081c4, 0xbf7d7026},
    {0x40490000, 0x3a7daa20, 0xbf7ffff8}, {0x40980000, 0xbf7fd1a7, 0x3d1a04b7},
    {0xc0c80000, 0x3d07e6ef, 0x3f7fdbeb}, {0x41200000, 0xbf0b44f8, 0xbf56cd64},
    {0xc1b00000, 0x3c110515, 0xbf7ffd6f}, {0x42c90000, 0xbcfd9fc1, 0x3f7fe095},
    {0x43b18000, 0xb7fcde82, 0xbf800000}, {0xc49a5225, 0xbda16977, 0xbf7f3423},
    {0x46010000, 0xbdd7a684, 0x3f7e93ab}, {0x3c23d70a, 0x3c23d657, 0x3f7ffcb9},
    {0xba83126f, 0xba83126e, 0x3f7ffff8}, {0x461c4000, 0xbe9c797e, 0xbf73c074},
    {0x49f42400, 0xbf27dce5, 0x3f414847}, {0x4a371b00, 0xbf60e4ba, 0x3ef49d0a},
    {0xd01502f9, 0x3ef99a64, 0x3f5f84c5}, {0x60ad78ec, 0x3f281569, 0x3f411723},
    {0x7f61b1e6, 0x3f5ff9c4, 0xbef7f57c}};

constexpr pair_of<std::uint64_t> sincos_d_ha_points[] = {
    {0x3fe0000000000000, 0x3fdeaee8744b05f0, 0x3fec1528065b7d50},
    {0x3ff0000000000000, 0x3feaed548f090cee, 0x3fe14a280fb5068c},
    {0xbff0000000000000, 0xbfeaed548f090cee, 0x3fe14a280fb5068c},
    {0x3ff8000000000000, 0x3fefeb7a9b2c6d8b, 0x3fb21bd54fc5f9a7},
    {0x4000000000000000, 0x3fed18f6ead1b446, 0xbfdaa22657537205},
    {0x4008000000000000, 0x3fc210386db6d55b, 0xbfefae04be85e5d2},
    {0x4009200000000000, 0x3f4fb543efcc9d39, 0xbfefffff04a648d7},
    {0x4013000000000000, 0xbfeffa34def8e460, 0x3fa34096e1d37b74},
    {0xc019000000000000, 0x3fa0fcddc3f512bc, 0x3feffb7d58a8f975},
    {0x4024000000000000, 0xbfe1689ef5f34f52, 0xbfead9ac890c6b1f},
    {0xc036000000000000, 0x3f8220a29f6eb9f4, 0xbfefffadd8d4acda},
    {0x4059200000000000, 0xbf9fb3f833470ff1, 0x3feffc12adaecec2},
    {0x4076300000000000, 0xbeff9bd0307d1de3, 0xbfefffffffc18e4c},
    {0xc0934a449ba5e354, 0xbfb42e44755bce6c, 0xbfefe681a761293f},
    {0x40f0000000000000, 0x3fe62566735b8513, 0xbfe719453109288c},
    {0x3f50624dd2f1a9fc, 0x3f50624da5218a62, 0x3feffffef390876c},
    {0xbee4f8b588e368f1, 0xbee4f8b588e1e8a2, 0x3feffffffff920c8},
    {0x3e10000000000000, 0x3e10000000000000, 0x3ff0000000000000},
    {0x1eb67e9c127b6e74, 0x1eb67e9c127b6e74, 0x3ff0000000000000},
    {0x412000009999999a, 0x3fdce4e5d20ee085, 0x3fec8d9b233c81c4},
    {0x412fffffcccccccd, 0x3fce07fa13370afb, 0x3fef1b57557c0355}};

constexpr pair_of<std::uint64_t> sincos_d_la_points[] = {
    {0x3fe0000000000000, 0x3fdeaee8744b05f0, 0x3fec1528065b7d50},
    {0x3ff0000000000000, 0x3feaed548f090cee, 0x3fe14a280fb5068c},
    {0xbff0000000000000, 0xbfeaed548f090cee, 0x3fe14a280fb5068c},
    {0x3ff8000000000000, 0x3fefeb7a9b2c6d8b, 0x3fb21bd54fc5f9a7},
    {0x4000000000000000, 0x3fed18f6ead1b446, 0xbfdaa22657537205},
    {0x4008000000000000, 0x3fc210386db6d55b, 0xbfefae04be85e5d2},
    {0x4009200000000000, 0x3f4fb543efcc9d3a, 0xbfefffff04a648d7},
    {0x4013000000000000, 0xbfeffa34def8e460, 0x3fa34096e1d37b75},
    {0xc019000000000000, 0x3fa0fcddc3f512bc, 0x3feffb7d58a8f975},
    {0x4024000000000000, 0xbfe1689ef5f34f53, 0xbfead9ac890c6b1f},
    {0xc036000000000000, 0x3f8220a29f6eb9f4, 0xbfefffadd8d4acda},
    {0x4059200000000000, 0xbf9fb3f833470ff1, 0x3feffc12adaecec2},
    {0x4076300000000000, 0xbeff9bd0307d1de3, 0xbfefffffffc18e4c},
    {0xc0934a449ba5e354, 0xbfb42e44755bce6c, 0xbfefe681a761293f},
    {0x40f0000000000000, 0x3fe62566735b8513, 0xbfe719453109288b},
    {0x3f50624dd2f1a9fc, 0x3f50624da5218a62, 0x3feffffef390876c},
    {0xbee4f8b588e368f1, 0xbee4f8b588e1e8a2, 0x3feffffffff920c8},
    {0x3e10000000000000, 0x3e10000000000000, 0x3ff0000000000000},
    {0x1eb67e9c127b6e74, 0x1eb67e9c127b6e74, 0x3ff0000000000000},
    {0x412000009999999a, 0x3fdce4e5d20ee084, 0x3fec8d9b233c81c4},
    {0x412fffffcccccccd, 0x3fce07fa13370afb, 0x3fef1b57557c0355}};

constexpr pair_of<std::uint64_t> sincos_d_ep_points[] = {
    {0x3fe0000000000000, 0x3fdeaee87318b2ae, 0x3fec15280656302b},
    {0x3ff0000000000000, 0x3feaed548f0ae0b2, 0x3fe14a280eca28a4},
    {0xbff0000000000000, 0xbfeaed548f0ae0b2, 0x3fe14a280eca28a4},
    {0x3ff8000000000000, 0x3fefeb7a9b2864dd, 0x3fb21bd54f128327},
    {0x4000000000000000, 0x3fed18f6eacbfc4f, 0xbfdaa226577214a4},
    {0x4008000000000000, 0x3fc210386d9a4823, 0xbfefae04be8776b7},
    {0x4009200000000000, 0x3f4fb543ee2a0c50, 0xbfefffff049fc53f},
    {0x4013000000000000, 0xbfeffa34def31c90, 0x3fa34096e0e7bc44},
    {0xc019000000000000, 0x3fa0fcddc3217d76, 0x3feffb7d58a308a0},
    {0x4024000000000000, 0xbfe1689ef50ac269, 0xbfead9ac890ec10c},
    {0xc036000000000000, 0x3f8220a29e80641f, 0xbfefffadd8ce33b8},
    {0x4059200000000000, 0xbf9fb3f831b929f6, 0x3feffc12ada8cb29},
    {0x4076300000000000, 0xbeff9bd02edbd7c8, 0xbfefffffffbb0a93},
    {0xc0934a449ba5e354, 0xbfb42e4474a319c3, 0xbfefe681a75dade7},
    {0x40f0000000000000, 0x3fe6256673b61bd0, 0xbfe719453104b95c},
    {0x3f50624dd2f1a9fc, 0x3f50624da449432c, 0x3feffffef38a03d6},
    {0xbee4f8b588e368f1, 0xbee4f8b587cd0eed, 0x3feffffffff29d0f},
    {0x3e10000000000000, 0x3e0ffffffe598f4d, 0x3feffffffff97c47},
    {0x1eb67e9c127b6e74, 0x1eb67e9c11527991, 0x3feffffffff97c47},
    {0x412000009999999a, 0x3fdce4e5d173e47c, 0x3fec8d9b233607f9},
    {0x412fffffcccccccd, 0x3fce07fa146bcb72, 0x3fef1b5755828217}};

TEST(SincosFloat, Points) {
  expect_pairs<sincos_s<tier::la>>(sincos_s_la_points);
  expect_pairs<sincos_s<tier::ep>>(sincos_s_la_points);
}

TEST(SincosDouble, Points) {
  expect_pairs<sincos_d<tier::ha>>(sincos_d_ha_points);
  expect_pairs<sincos_d<tier::la>>(sincos_d_la_points);
  expect_pairs<sincos_d<tier::ep>>(sincos_d_ep_points);
}

TEST(SincosFloat, InfinitiesAndNans) {
  expect_own_pattern_of_infinity<sincos_s<tier::ha>>();
  expect_own_pattern_of_infinity<sincos_s<tier::la>>();
  expect_own_pattern_of_infinity<sincos_s<tier::ep>>();
}

TEST(SincosDouble, InfinitiesAndNans) {
  expect_negative_nan_of_infinity<sincos_d<tier::ha>>();
  expect_negative_nan_of_infinity<sincos_d<tier::la>>();
  expect_negative_nan_of_infinity<sincos_d<tier::ep>>();
}

TEST(SincosFloat, ZerosAndSmallArguments) {
  for (const std::uint32_t sign : {0x00000000u, 0x80000000u}) {
    for (const std::uint32_t p : {0u, 1u, 0x007fffffu, 0x38d1b717u, 0x397fffffu}) {
      expect_v12<sincos_s<tier::ha>>(p | sign, p | sign, 0x3f800000);
      expect_v12<sincos_s<tier::la>>(p | sign, p | sign, 0x3f800000);
      expect_v12<sincos_s<tier::ep>>(p | sign, p | sign, 0x3f800000);
    }
    expect_v12<sincos_s<tier::ha>>(0x39ffffff | sign, 0x39fffffe | sign, 0x3f7ffffe);
  }
}

TEST(SincosDouble, ZerosAndSmallArguments) {
  for (const std::uint64_t sign : {std::uint64_t{0}, std::uint64_t{0x8000000000000000}}) {
    for (const std::uint64_t p :
         {std::uint64_t{0}, std::uint64_t{1}, std::uint64_t{0x2000} << 48}) {
      expect_v12<sincos_d<tier::ha>>(p | sign, p | sign, 0x3ff0000000000000);
      expect_v12<sincos_d<tier::la>>(p | sign, p | sign, 0x3ff0000000000000);
    }
    expect_v12<sincos_d<tier::ep>>(sign, sign, 0x3feffffffff97c47);
  }
}

TEST(SincosFloat, MainPath) {
  expect_main_path_up_to<sincos_s<tier::ha>>(0x49ffffffu);  // below 2^21
  expect_main_path_up_to<sincos_s<tier::la>>(0x49ffffffu);
  expect_main_path_up_to<sincos_s<tier::ep>>(0x49ffffffu);
}

TEST(SincosDouble, MainPath) {
  expect_main_path_up_to<sincos_d<tier::ha>>(std::uint64_t{0x412fffffffffffff});  // below 2^20
  expect_main_path_up_to<sincos_d<tier::la>>(std::uint64_t{0x412fffffffffffff});
  expect_main_path_up_to<sincos_d<tier::ep>>(std::uint64_t{0x412fffffffffffff});
}

template <typename F, typename U>
void expect_both_within(const std::vector<U>& arguments, double limit,
                        location where = location::current()) {
  expect_within<F, 0>(trig::sine, arguments, limit, where);
  expect_within<F, 1>(trig::cosine, arguments, limit, where);
}

TEST(SincosFloat, Accuracy) {
  auto arguments = joined(every_binade(0x00800000u, 0x7f7fffffu, 40), evenly(2e6f, 20'000));
  arguments = joined(arguments, around(0x39800000u));
  arguments = joined(arguments, around(0x4a000000u));
  arguments = joined(arguments, {std::begin(hard_floats), std::end(hard_floats)});
  expect_both_within<sincos_s<tier::ha>>(arguments, 0.68);
  expect_both_within<sincos_s<tier::la>>(arguments, 2.5);
  expect_both_within<sincos_s<tier::ep>>(arguments, 2.5);
}

TEST(SincosDouble, Accuracy) {
  constexpr std::uint64_t largest = 0x7fefffffffffffff, tiny = 0x3d00000000000000,
                          up_to_20 = 0x412fffffffffffff;
  const auto main = joined(evenly(0x1p20, 20'000), every_binade(tiny, up_to_20, 40));
  const auto beyond = joined(every_binade(up_to_20 + 1, largest, 4), around(up_to_20));
  const std::vector hard(std::begin(hard_doubles), std::end(hard_doubles));
  const auto hard_beyond = between(hard_doubles, up_to_20, largest);
  expect_both_within<sincos_d<tier::ha>>(joined(main, beyond), 0.88);
  expect_both_within<sincos_d<tier::ha>>(hard, 0.505);
  expect_both_within<sincos_d<tier::la>>(joined(joined(main, beyond), hard), 1.5);
  // Beside multiples of pi/2 the two parts of pi are too few below 2^20.
  expect_both_within<sincos_d<tier::ep>>(joined(main, beyond), 2.8e7);
  expect_both_within<sincos_d<tier::ep>>(hard_beyond, 2.8e7);
}

}  // namespace
