// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/root/invcbrt.hpp"

#include "quad.hpp"
#include "root_points.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::invcbrt_d;
using scalar::invcbrt_s;
using scalar::tier;

constexpr point_of<std::uint32_t> invcbrt_s_ha_points[] = {
    {0x00000001, 0x584b2ff5}, {0x80000001, 0xd84b2ff5}, {0x007fffff, 0x54800000},
    {0x00800000, 0x54800000}, {0x3f7fffff, 0x3f800000}, {0x3f800000, 0x3f800000},
    {0x3faaaaaa, 0x3f689769}, {0x3faaaaab, 0x3f689768}, {0x3faaaaac, 0x3f689768},
    {0x402aaaaa, 0x3f389ba2}, {0x402aaaab, 0x3f389ba2}, {0x40aaaaaa, 0x3f1285ff},
    {0x40aaaaab, 0x3f1285ff}, {0x41000000, 0x3f000000}, {0xc1000000, 0xbf000000},
    {0x3e000000, 0x40000000}, {0x7f7fffff, 0x2a214518}, {0xff7fffff, 0xaa214518},
    {0xa9f35a1c, 0xc6a4044d}, {0x13cf069b, 0x4e09634d}, {0x53d1d228, 0x38ac5369},
    {0x89c59799, 0xd15d81b2}, {0x4517c815, 0x3d985d4c}, {0xaf4ee4fc, 0xc4da22c5},
    {0x87ec823a, 0xd2036c83}, {0x4173a77a, 0x3ece9010}, {0x054ca86c, 0x52daed75},
};
constexpr point_of<std::uint32_t> invcbrt_s_la_points[] = {
    {0x00000001, 0x584b2ff5}, {0x80000001, 0xd84b2ff5}, {0x007fffff, 0x54800000},
    {0x00800000, 0x54800000}, {0x3f7fffff, 0x3f800000}, {0x3f800000, 0x3f800000},
    {0x3faaaaaa, 0x3f689769}, {0x3faaaaab, 0x3f689768}, {0x3faaaaac, 0x3f689767},
    {0x402aaaaa, 0x3f389ba3}, {0x402aaaab, 0x3f389ba2}, {0x40aaaaaa, 0x3f1285ff},
    {0x40aaaaab, 0x3f1285ff}, {0x41000000, 0x3f000000}, {0xc1000000, 0xbf000000},
    {0x3e000000, 0x40000000}, {0x7f7fffff, 0x2a214518}, {0xff7fffff, 0xaa214518},
    {0x3801b3ad, 0x41fee019}, {0x097105c7, 0x51829927}, {0x8c1c7bec, 0xd096d29a},
    {0x36d6a513, 0x42577a66}, {0xea564a57, 0xb12b1e8c}, {0x9058be11, 0xcf2a78b9},
    {0x9d13182c, 0xcaf467d8}, {0xd0cfbb5a, 0xb9ace6cd}, {0x79ce86d4, 0x2c097f9d},
};
constexpr point_of<std::uint64_t> invcbrt_d_ha_points[] = {
    {0x0000000000000001, 0x5650000000000000}, {0x8000000000000001, 0xd650000000000000},
    {0x000fffffffffffff, 0x553965fea53d6e3d}, {0x0010000000000000, 0x553965fea53d6e3d},
    {0x0010000000000001, 0x553965fea53d6e3c}, {0x3ff0000000000000, 0x3ff0000000000000},
    {0xbff0000000000000, 0xbff0000000000000}, {0x3ff07fffffffffff, 0x3fefac66ff1c35cc},
    {0x3ff0800000000000, 0x3fefac66ff1c35cb}, {0x3fffffffffffffff, 0x3fe965fea53d6e3d},
    {0x4000000000000000, 0x3fe965fea53d6e3d}, {0x4010000000000000, 0x3fe428a2f98d728b},
    {0x4020000000000000, 0x3fe0000000000000}, {0xc020000000000000, 0xbfe0000000000000},
    {0x7fefffffffffffff, 0x2a9965fea53d6e3d}, {0x4b03057a93bd04cf, 0x3c3e3504f6f2ec48},
    {0x7d05ed660cb1e29c, 0x2b922605bd325873}, {0xc750cb9f0becd7b0, 0xbd78fdb0a49cce13},
    {0x2521eacb2217bead, 0x48ded0b9d182e066}, {0x454531f624ede6a4, 0x3e2720436a433b4d},
    {0xa78c551c92276658, 0xc810a99dd3e8a83e}, {0x575bdd4ad0eda82f, 0x3820c15e146111c1},
    {0xca81dfc81a61dbe2, 0xbc687a4df5a3c5c2}, {0x00030185a38fd548, 0x55462c44adfa20b6},
    {0x8008c38f18f135d3, 0xd53f0ab612597a00}, {0x000907a71012f038, 0x553ebbe78481ee68},
    {0x00034b9b9e7769b2, 0x554580fcf74b35b7},
};
constexpr point_of<std::uint64_t> invcbrt_d_la_points[] = {
    {0x0000000000000001, 0x5650000000000000}, {0x8000000000000001, 0xd650000000000000},
    {0x000fffffffffffff, 0x553965fea53d6e3d}, {0x0010000000000000, 0x553965fea53d6e3b},
    {0x0010000000000001, 0x553965fea53d6e3a}, {0x3ff0000000000000, 0x3feffffffffffffd},
    {0xbff0000000000000, 0xbfeffffffffffffd}, {0x3ff07fffffffffff, 0x3fefac66ff1c35c9},
    {0x3ff0800000000000, 0x3fefac66ff1c35c9}, {0x3fffffffffffffff, 0x3fe965fea53d6e3d},
    {0x4000000000000000, 0x3fe965fea53d6e3b}, {0x4010000000000000, 0x3fe428a2f98d728a},
    {0x4020000000000000, 0x3fdffffffffffffd}, {0xc020000000000000, 0xbfdffffffffffffd},
    {0x7fefffffffffffff, 0x2a9965fea53d6e3d}, {0x441f68b1ae2eb154, 0x3e898e867cd8149e},
    {0x2845f977c6f87718, 0x47d222b28994ddb8}, {0x764353c395e761d1, 0x2dd2edaadc450d20},
    {0x266ec3d65c90a958, 0x487036177368b6b3}, {0x971298cdcb5c7427, 0xcd8e6f6af7f4f9ec},
    {0x1f4e8dfdc7a2ea20, 0x4ad03f97c296472b}, {0xa67e902a930d6eaf, 0xc869ca548289ace8},
    {0x701481637ebff206, 0x2fe28f05924354e5}, {0x00072e6cbabced21, 0x55409614007a6606},
    {0x000faecb9be4bcfd, 0x5539918a258b6210}, {0x000830e01e398f11, 0x553fbfd9c4c4901d},
    {0x000c1d3f2a3af4d5, 0x553bddcdbebdbe2d},
};

TEST(InvcbrtFloat, Points) {
  expect_points<invcbrt_s<tier::ha>>(invcbrt_s_ha_points);
  expect_points<invcbrt_s<tier::la>>(invcbrt_s_la_points);
  expect_points<invcbrt_s<tier::ep>>(invcbrt_s_ha_points);
}

TEST(InvcbrtFloat, Digest) {
  EXPECT_EQ(positive_digest<invcbrt_s<tier::ha>>(), 0xa170c5b2004c6648u);
  EXPECT_EQ(positive_digest<invcbrt_s<tier::la>>(), 0x278cb2ac61517c75u);
}

TEST(InvcbrtDouble, Points) {
  expect_points<invcbrt_d<tier::ha>>(invcbrt_d_ha_points);
  expect_points<invcbrt_d<tier::la>>(invcbrt_d_la_points);
  expect_points<invcbrt_d<tier::ep>>(invcbrt_d_la_points);
}

TEST(InvcbrtDouble, Digest) {
  EXPECT_EQ(positive_digest<invcbrt_d<tier::ha>>(), 0xa1d15380d85647b6u);
  EXPECT_EQ(positive_digest<invcbrt_d<tier::la>>(), 0x358dafe95422a126u);
}

TEST(InvcbrtDouble, RarePathServesEveryNumber) {
  pattern_source<std::uint64_t> source(6);
  for (int i = 0; i < 5000; ++i) {
    const auto x = std::bit_cast<double>(source.finite());
    if (x == 0) continue;
    double y = 0;
    EXPECT_EQ(invcbrt_d<tier::la>::rare(x, &y), 0u);
    const quad wide = y;
    // 1 - xy³ is three times the relative error.
    const double rest = static_cast<double>(1 - x * wide * wide * wide) / 3;
    EXPECT_LT(std::fabs(rest), 0.51 * 0x1p-52) << x;
  }
}

template <typename Body>
class InvcbrtOfAnyTier : public ::testing::Test {};
using bodies = ::testing::Types<invcbrt_s<tier::ha>, invcbrt_s<tier::la>, invcbrt_s<tier::ep>,
                                invcbrt_d<tier::ha>, invcbrt_d<tier::la>, invcbrt_d<tier::ep>>;
TYPED_TEST_SUITE(InvcbrtOfAnyTier, bodies);

TYPED_TEST(InvcbrtOfAnyTier, Specials) {
  expect_reciprocal_of_zeros_and_infinities<TypeParam>();
  expect_quiet_nans<TypeParam>();
}

TYPED_TEST(InvcbrtOfAnyTier, IsOdd) { expect_symmetry<TypeParam>(true); }

TEST(InvcbrtDouble, MainPathIsThatOfNormalNumbers) {
  expect_main_path_of_magnitudes<invcbrt_d<tier::ha>>(0x0010000000000000, 0x7fefffffffffffff);
  expect_main_path_of_magnitudes<invcbrt_d<tier::la>>(0x0010000000000000, 0x7fefffffffffffff);
}

TEST(Invcbrt, PowersOfTwoAreExactAtHa) {
  expect_exact_powers<invcbrt_s<tier::ha>>(3, -1);
  expect_exact_powers<invcbrt_d<tier::ha>>(3, -1);
}

}  // namespace
