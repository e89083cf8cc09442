// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/pow/pow3o2.hpp"

#include "quad.hpp"
#include "root_points.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::pow3o2_d;
using scalar::pow3o2_s;
using scalar::tier;

constexpr point_of<std::uint32_t> pow3o2_s_ha_points[] = {
    {0x00000001, 0x00000000}, {0x0cffffff, 0x00000000}, {0x0d000000, 0x00000000},
    {0x0d800000, 0x00000000}, {0x0d800001, 0x00000001}, {0x15555555, 0x00615f76},
    {0x15ffffff, 0x013504f2}, {0x16000000, 0x013504f3}, {0x1d7fffff, 0x0c7ffffe},
    {0x1d800000, 0x0c800000}, {0x3f800000, 0x3f800000}, {0x3f800001, 0x3f800002},
    {0x40000000, 0x403504f3}, {0x40800000, 0x41000000}, {0x69800000, 0x7e800000},
    {0x69800001, 0x7e800002}, {0x6a000000, 0x7f3504f3}, {0x6a214516, 0x7f7ffffc},
    {0x6a214517, 0x7f7ffffe}, {0x6a214518, 0x7f800000}, {0x7f7fffff, 0x7f800000},
    {0x36735a1c, 0x31ed43a8}, {0x204f069b, 0x10ba2c4b}, {0x3f899387, 0x3f8ea13c},
    {0x6051d228, 0x70bdf4c2}, {0x132e3fe8, 0x00011f85}, {0x16459799, 0x01ad980f},
    {0x5197c815, 0x5aa54800}, {0x190c7408, 0x05d011b4},
};
constexpr point_of<std::uint32_t> pow3o2_s_la_points[] = {
    {0x00000001, 0x00000000}, {0x0cffffff, 0x00000000}, {0x0d000000, 0x00000000},
    {0x0d800000, 0x00000000}, {0x0d800001, 0x00000001}, {0x15555555, 0x00615f76},
    {0x15ffffff, 0x013504f2}, {0x16000000, 0x013504f3}, {0x1d7fffff, 0x0c7ffffe},
    {0x1d800000, 0x0c800000}, {0x3f800000, 0x3f800000}, {0x3f800001, 0x3f800001},
    {0x40000000, 0x403504f3}, {0x40800000, 0x41000000}, {0x69800000, 0x7e800000},
    {0x69800001, 0x7e800002}, {0x6a000000, 0x7f3504f3}, {0x6a214516, 0x7f7ffffc},
    {0x6a214517, 0x7f7ffffe}, {0x6a214518, 0x7f800000}, {0x7f7fffff, 0x7f800000},
    {0x3bcee4fc, 0x3a0384da}, {0x5798cc2e, 0x63a6f18e}, {0x146c823a, 0x000e353b},
    {0x4df3a77a, 0x55281575}, {0x287b3ae6, 0x1cf8e0e8}, {0x11cca86c, 0x0000102d},
    {0x180051ad, 0x0435b252}, {0x4481b3ad, 0x47028fae},
};
constexpr point_of<std::uint32_t> pow3o2_s_ep_points[] = {
    {0x00000001, 0x00000000}, {0x0cffffff, 0x00000000}, {0x0d000000, 0x00000000},
    {0x0d800000, 0x00000000}, {0x0d800001, 0x00000001}, {0x15555555, 0x00615f76},
    {0x15ffffff, 0x013504f2}, {0x16000000, 0x013504f3}, {0x1d7fffff, 0x0c7ffffe},
    {0x1d800000, 0x0c800000}, {0x3f800000, 0x3f800000}, {0x3f800001, 0x3f800001},
    {0x40000000, 0x403504f3}, {0x40800000, 0x41000000}, {0x69800000, 0x7e800000},
    {0x69800001, 0x7e800002}, {0x6a000000, 0x7f3504f3}, {0x6a214516, 0x7f7ffffc},
    {0x6a214517, 0x7f7ffffe}, {0x6a214518, 0x7f800000}, {0x7f7fffff, 0x7f800000},
    {0x4286aa4d, 0x440a207d}, {0x15f105c7, 0x01255e38}, {0x2bce0b92, 0x2202b5c1},
    {0x189c7bec, 0x052d0585}, {0x5388b767, 0x5d8d4b75}, {0x4356a513, 0x45448b5d},
    {0x1490eedb, 0x0013471a}, {0x5560c967, 0x6052a33e},
};
constexpr point_of<std::uint64_t> pow3o2_d_ha_points[] = {
    {0x0000000000000001, 0x0000000000000000}, {0x131fffffffffffff, 0x0000000000000000},
    {0x1320000000000000, 0x0000000000000000}, {0x132428a2f98d728a, 0x0000000000000000},
    {0x132428a2f98d728b, 0x0000000000000000}, {0x1555555555555555, 0x000c511a2e602212},
    {0x157fffffffffffff, 0x0046a09e667f3bcc}, {0x1580000000000000, 0x0046a09e667f3bcd},
    {0x1a6fffffffffffff, 0x07affffffffffffe}, {0x1a70000000000000, 0x07b0000000000000},
    {0x3ff0000000000000, 0x3ff0000000000000}, {0x4010000000000000, 0x4020000000000000},
    {0x4000000000000000, 0x4006a09e667f3bcd}, {0x6a70000000000000, 0x7fb0000000000000},
    {0x6a70000000000001, 0x7fb0000000000001}, {0x6a90000000000000, 0x7fe0000000000000},
    {0x6a9965fea53d6e3b, 0x7feffffffffffffd}, {0x6a9965fea53d6e3c, 0x7fefffffffffffff},
    {0x6a9965fea53d6e3d, 0x7ff0000000000000}, {0x7fefffffffffffff, 0x7ff0000000000000},
    {0x63e8599c39263059, 0x75e53db0cd1c7e1a}, {0x5dcfa478a09f76b5, 0x6cbf77174c7edc0c},
    {0x1b1b1878f29d0da9, 0x08b1a156fb3b8200}, {0x5e23057a93bd04cf, 0x6d3d54989bea8e30},
    {0x1988f14e658cda14, 0x0656056252aefcf2}, {0x2f7c68c8f9ebdacc, 0x2742ed87511958a6},
    {0x5a70cb9f0becd7b0, 0x67b135326bfa42bb}, {0x243bdf56dbc496cb, 0x166264d1996c0a11},
};
constexpr point_of<std::uint64_t> pow3o2_d_la_points[] = {
    {0x0000000000000001, 0x0000000000000000}, {0x131fffffffffffff, 0x0000000000000000},
    {0x1320000000000000, 0x0000000000000000}, {0x132428a2f98d728a, 0x0000000000000000},
    {0x132428a2f98d728b, 0x0000000000000000}, {0x1555555555555555, 0x000c511a2e602212},
    {0x157fffffffffffff, 0x0046a09e667f3bcc}, {0x1580000000000000, 0x0046a09e667f3bcd},
    {0x1a6fffffffffffff, 0x07affffffffffffe}, {0x1a70000000000000, 0x07b0000000000000},
    {0x3ff0000000000000, 0x3ff0000000000000}, {0x4010000000000000, 0x4020000000000000},
    {0x4000000000000000, 0x4006a09e667f3bcd}, {0x6a70000000000000, 0x7fb0000000000000},
    {0x6a70000000000001, 0x7fb0000000000001}, {0x6a90000000000000, 0x7fe0000000000000},
    {0x6a9965fea53d6e3b, 0x7feffffffffffffd}, {0x6a9965fea53d6e3c, 0x7fefffffffffffff},
    {0x6a9965fea53d6e3d, 0x7ff0000000000000}, {0x7fefffffffffffff, 0x7ff0000000000000},
    {0x48d659214a23d596, 0x4d4a697ed0415cdf}, {0x586531f624ede6a4, 0x64a13fe8a38b76c0},
    {0x5c43b32c1e27a1c0, 0x6a6ee9e73c83a619}, {0x5ae682ac4ef8aa38, 0x6862e144f6bed0be},
    {0x6a7bdd4ad0eda82f, 0x7fc262cae3e7397d}, {0x2060edf12e44158b, 0x1098a0a192d01635},
    {0x5c4d39b494e3bf91, 0x6a7bedff8a9e65ce}, {0x2b3c2862a38fd547, 0x20e2ad4fb0b4af72},
};
constexpr point_of<std::uint64_t> pow3o2_d_ep_points[] = {
    {0x0000000000000001, 0x0000000000000000}, {0x131fffffffffffff, 0x0000000000000000},
    {0x1320000000000000, 0x0000000000000000}, {0x132428a2f98d728a, 0x0000000000000000},
    {0x132428a2f98d728b, 0x0000000000000000}, {0x1555555555555555, 0x000c511a2e602212},
    {0x157fffffffffffff, 0x0046a09e667f3bcc}, {0x1580000000000000, 0x0046a09e667f3bcd},
    {0x1a6fffffffffffff, 0x07affffffffffffe}, {0x1a70000000000000, 0x07b0000000000000},
    {0x3ff0000000000000, 0x3ff0000000000000}, {0x4010000000000000, 0x4020000000000000},
    {0x4000000000000000, 0x4006a09e667f3bcd}, {0x6a70000000000000, 0x7fb0000000000000},
    {0x6a70000000000001, 0x7fb0000000000001}, {0x6a90000000000000, 0x7fe0000000000000},
    {0x6a9965fea53d6e3b, 0x7feffffffffffffd}, {0x6a9965fea53d6e3c, 0x7fefffffffffffff},
    {0x6a9965fea53d6e3d, 0x7ff0000000000000}, {0x7fefffffffffffff, 0x7ff0000000000000},
    {0x1fa89ae95f557203, 0x0f85935bfe71864e}, {0x5b6d38611012f037, 0x692bec18dd34071b},
    {0x626bb4d80f4205b4, 0x73a9c7dfb8d42cec}, {0x52ba829234b9b5df, 0x5c210fd43faa6159},
    {0x573f68b1ae2eb154, 0x62e600e0be3c9b02}, {0x4ec8d788506bf2ef, 0x5635e3494a41fd8f},
    {0x417854ac7403e430, 0x423e00ec31977b57}, {0x32fc713b4cbd87ad, 0x2c82f5f8ee98bdbf},
};

TEST(Pow3o2Float, Points) {
  expect_points<pow3o2_s<tier::ha>>(pow3o2_s_ha_points);
  expect_points<pow3o2_s<tier::la>>(pow3o2_s_la_points);
  expect_points<pow3o2_s<tier::ep>>(pow3o2_s_ep_points);
}

template <tier t>
std::uint64_t float_digest() {
  return pattern_digest<pow3o2_s<t>>(0x0d800001, (0x6a214517 - 0x0d800001) / 1500);
}
template <tier t>
std::uint64_t double_digest() {
  return pattern_digest<pow3o2_d<t>>(0x1330000000000001,
                                     (0x6a9965fea53d6e3c - 0x1330000000000001) / 1500);
}

TEST(Pow3o2Float, Digest) {
  EXPECT_EQ(float_digest<tier::ha>(), 0x1a421a76c4c6ddf9u);
  EXPECT_EQ(float_digest<tier::la>(), 0x624acb57cb188f4du);
  EXPECT_EQ(float_digest<tier::ep>(), 0x478a384821583512u);
}

TEST(Pow3o2Double, Points) {
  expect_points<pow3o2_d<tier::ha>>(pow3o2_d_ha_points);
  expect_points<pow3o2_d<tier::la>>(pow3o2_d_la_points);
  expect_points<pow3o2_d<tier::ep>>(pow3o2_d_ep_points);
}

TEST(Pow3o2Double, Digest) {
  EXPECT_EQ(double_digest<tier::ha>(), 0x5f4be7aa7443277cu);
  EXPECT_EQ(double_digest<tier::la>(), 0x49da2438558da9b6u);
  EXPECT_EQ(double_digest<tier::ep>(), 0xbf5a4f16c6e4267au);
}

template <typename Body>
class Pow3o2OfAnyTier : public ::testing::Test {};
using bodies = ::testing::Types<pow3o2_s<tier::ha>, pow3o2_s<tier::la>, pow3o2_s<tier::ep>,
                                pow3o2_d<tier::ha>, pow3o2_d<tier::la>, pow3o2_d<tier::ep>>;
TYPED_TEST_SUITE(Pow3o2OfAnyTier, bodies);

TYPED_TEST(Pow3o2OfAnyTier, Specials) {
  using U = part_of<typename TypeParam::input_type>;
  using n = named<U>;
  expect_v11<TypeParam>(0, 0);
  expect_v11<TypeParam>(n::sign, 0);
  expect_v11<TypeParam>(n::inf, n::inf);
  expect_v11<TypeParam>(n::largest, n::inf);
  expect_v11<TypeParam>(1, 0);
  for (const U x : negative_patterns<U>()) expect_v11<TypeParam>(x, n::any_nan, domain);
  expect_quiet_nans<TypeParam>();
}

TYPED_TEST(Pow3o2OfAnyTier, MainPath) {
  if constexpr (sizeof(typename TypeParam::input_type) == 4) {
    expect_main_path_between<TypeParam>(0x1d800000, 0x69800000);
  } else {
    expect_main_path_between<TypeParam>(0x1a70000000000000, 0x6a70000000000000);
  }
}

/// y² against x³: twice the relative error.
TEST(Pow3o2Double, RarePathServesEveryNormalResult) {
  pattern_source<std::uint64_t> source(10);
  for (int i = 0; i < 5000; ++i) {
    const std::uint64_t p =
        0x1570000000000000 + source.below(0x6a9965fea53d6e3d - 0x1570000000000000);
    const auto x = std::bit_cast<double>(p);
    double y = 0;
    EXPECT_EQ(pow3o2_d<tier::la>::rare(x, &y), 0u);
    const quad wide_x = x, wide_y = y;
    const double rest = static_cast<double>(wide_y / wide_x * (wide_y / wide_x) / wide_x - 1) / 2;
    EXPECT_LT(std::fabs(rest), 0.55 * 0x1p-52) << x;
  }
}

TEST(Pow3o2, PowersOfTwoAreExactAtHa) {
  expect_exact_powers<pow3o2_s<tier::ha>>(2, 3);
  expect_exact_powers<pow3o2_d<tier::ha>>(2, 3);
}

}  // namespace
