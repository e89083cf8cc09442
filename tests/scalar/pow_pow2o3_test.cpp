// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/pow/pow2o3.hpp"

#include "quad.hpp"
#include "root_points.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::pow2o3_d;
using scalar::pow2o3_s;
using scalar::tier;

constexpr point_of<std::uint32_t> pow2o3_s_ha_points[] = {
    {0x00000001, 0x0dcb2ff5}, {0x80000001, 0x0dcb2ff5}, {0x007fffff, 0x157fffff},
    {0x00800000, 0x15800000}, {0x00800001, 0x15800001}, {0x3f7fffff, 0x3f7fffff},
    {0x3f800000, 0x3f800000}, {0xbf800000, 0x3f800000}, {0x3f81ffff, 0x3f815473},
    {0x3f820000, 0x3f815473}, {0x3f820001, 0x3f815474}, {0x3fffffff, 0x3fcb2ff5},
    {0x40000000, 0x3fcb2ff5}, {0x40800000, 0x40214518}, {0x41000000, 0x40800000},
    {0xc1000000, 0x40800000}, {0x7f7fffff, 0x6a214517}, {0xa9f35a1c, 0x311be9d0},
    {0x13cf069b, 0x225e35ae}, {0x53d1d228, 0x4d0d3d90}, {0x89c59799, 0x1baaf7fa},
    {0x4517c815, 0x4334ac3a}, {0xaf4ee4fc, 0x34b04b18}, {0x87ec823a, 0x1a72d5c7},
    {0x4173a77a, 0x40c499e1}, {0x0004cca9, 0x13e56e36}, {0x003781b4, 0x1512aa8b},
    {0x0008f106, 0x142dafd2},
};
constexpr point_of<std::uint32_t> pow2o3_s_la_points[] = {
    {0x00000001, 0x0dcb2ff5}, {0x80000001, 0x0dcb2ff5}, {0x007fffff, 0x157fffff},
    {0x00800000, 0x15800000}, {0x00800001, 0x15800001}, {0x3f7fffff, 0x3f7fffff},
    {0x3f800000, 0x3f800000}, {0xbf800000, 0x3f800000}, {0x3f81ffff, 0x3f815473},
    {0x3f820000, 0x3f815473}, {0x3f820001, 0x3f815474}, {0x3fffffff, 0x3fcb2ff4},
    {0x40000000, 0x3fcb2ff5}, {0x40800000, 0x40214518}, {0x41000000, 0x40800000},
    {0xc1000000, 0x40800000}, {0x7f7fffff, 0x6a214517}, {0x8c1c7bec, 0x1d3862b0},
    {0x36d6a513, 0x39b4ab42}, {0xea564a57, 0x5c0f3d39}, {0x9058be11, 0x2010546d},
    {0x9d13182c, 0x288c6eb5}, {0xd0cfbb5a, 0x4b0c4d29}, {0x79ce86d4, 0x665dda35},
    {0xca5e8267, 0x46b90e3b}, {0x0032c66e, 0x150a354f}, {0x007cf5ee, 0x157bee6c},
    {0x8005f66c, 0x14049245},
};
constexpr point_of<std::uint32_t> pow2o3_s_ep_points[] = {
    {0x00000001, 0x0dcb2ff5}, {0x80000001, 0x0dcb2ff5}, {0x007fffff, 0x157fffff},
    {0x00800000, 0x158001bb}, {0x00800001, 0x158001bb}, {0x3f7fffff, 0x3f8001a0},
    {0x3f800000, 0x3f8001bb}, {0xbf800000, 0x3f8001bb}, {0x3f81ffff, 0x3f815535},
    {0x3f820000, 0x3f815536}, {0x3f820001, 0x3f815537}, {0x3fffffff, 0x3fcb328a},
    {0x40000000, 0x3fcb32b4}, {0x40800000, 0x40214746}, {0x41000000, 0x408001bb},
    {0xc1000000, 0x408001bb}, {0x7f7fffff, 0x6a214724}, {0x6e624b65, 0x5ebb23e5},
    {0x2591eacb, 0x2e2ffadf}, {0x92f6f352, 0x21c65dce}, {0x8f93d0e0, 0x1f8ce28b},
    {0xa7fc551c, 0x2fc93ecc}, {0xe8f6d417, 0x5b1d643e}, {0x17a20ac5, 0x24edc7e2},
    {0xcaf1dfc8, 0x471b467a}, {0x0051c7eb, 0x153de77d}, {0x002faaba, 0x1504823e},
    {0x80461c7e, 0x152b6121},
};
constexpr point_of<std::uint64_t> pow2o3_d_ha_points[] = {
    {0x0000000000000001, 0x1330000000000000}, {0x8000000000000001, 0x1330000000000000},
    {0x000fffffffffffff, 0x155965fea53d6e3b}, {0x0010000000000000, 0x155965fea53d6e3d},
    {0x3ff0000000000000, 0x3ff0000000000000}, {0xbff0000000000000, 0x3ff0000000000000},
    {0x3ff07fffffffffff, 0x3ff054e51b8a8bbc}, {0x3ff0800000000000, 0x3ff054e51b8a8bbd},
    {0x3fffffffffffffff, 0x3ff965fea53d6e3c}, {0x4000000000000000, 0x3ff965fea53d6e3d},
    {0x4010000000000000, 0x400428a2f98d728b}, {0x4020000000000000, 0x4010000000000000},
    {0xc020000000000000, 0x4010000000000000}, {0x7fefffffffffffff, 0x6a9965fea53d6e3c},
    {0x484d38611012f037, 0x4582f94589fcef90}, {0x1a6cdaef9e7769b1, 0x26edde17a4564e0e},
    {0x441f68b1ae2eb154, 0x42b915af657b3a8e}, {0x2845f977c6f87718, 0x3028e84e12a76133},
    {0x764353c395e761d1, 0x6426dd532dd20481}, {0x266ec3d65c90a958, 0x2eef2bd867762399},
    {0x971298cdcb5c7427, 0x24b1b00122c39a13}, {0x1f4e8dfdc7a2ea20, 0x2a2f076eae88a7d3},
    {0x8004cdd2930d6eb0, 0x1546c6d8b6e5a9dc}, {0x000e00907ebff207, 0x15573cd2329950cb},
    {0x00072e6cbabced21, 0x154dc723c149c610},
};
constexpr point_of<std::uint64_t> pow2o3_d_la_points[] = {
    {0x0000000000000001, 0x1330000000000000}, {0x8000000000000001, 0x1330000000000000},
    {0x000fffffffffffff, 0x155965fea53d6e3b}, {0x0010000000000000, 0x155965fea53d6e3c},
    {0x3ff0000000000000, 0x3ff0000000000000}, {0xbff0000000000000, 0x3ff0000000000000},
    {0x3ff07fffffffffff, 0x3ff054e51b8a8bbc}, {0x3ff0800000000000, 0x3ff054e51b8a8bbd},
    {0x3fffffffffffffff, 0x3ff965fea53d6e3b}, {0x4000000000000000, 0x3ff965fea53d6e3c},
    {0x4010000000000000, 0x400428a2f98d728b}, {0x4020000000000000, 0x4010000000000000},
    {0xc020000000000000, 0x4010000000000000}, {0x7fefffffffffffff, 0x6a9965fea53d6e3b},
    {0x7d865e9c9be4bcfc, 0x68ffc1a632e41a68}, {0x419703de1e398f10, 0x4109b00d8f92deae},
    {0x60f9fe7f2a3af4d4, 0x55f61c9cea138ea6}, {0x778565f126e87555, 0x64fed49119b19f4e},
    {0x8514be4b6bf46c69, 0x18b30609da7aac1b}, {0x89ff77c3ab1031d0, 0x1bf91db4df2b0f0d},
    {0xc968e9f98ede0d7a, 0x46410f7d441ed6b8}, {0x68cfcd65e01f5057, 0x5b2fde3b006acc86},
    {0x000b1fee57124243, 0x1553ef022bc10312}, {0x8007f26198289fce, 0x154fdba49574561d},
    {0x00074c9dcc011cde, 0x154e1a5fba771f92},
};

TEST(Pow2o3Float, Points) {
  expect_points<pow2o3_s<tier::ha>>(pow2o3_s_ha_points);
  expect_points<pow2o3_s<tier::la>>(pow2o3_s_la_points);
  expect_points<pow2o3_s<tier::ep>>(pow2o3_s_ep_points);
}

TEST(Pow2o3Float, Digest) {
  EXPECT_EQ(positive_digest<pow2o3_s<tier::ha>>(), 0xb409b5fc0d656d09u);
  EXPECT_EQ(positive_digest<pow2o3_s<tier::la>>(), 0x9ccf63277f93820eu);
  EXPECT_EQ(positive_digest<pow2o3_s<tier::ep>>(), 0x97d6f4f0379d574cu);
}

TEST(Pow2o3Double, Points) {
  expect_points<pow2o3_d<tier::ha>>(pow2o3_d_ha_points);
  expect_points<pow2o3_d<tier::la>>(pow2o3_d_la_points);
  expect_points<pow2o3_d<tier::ep>>(pow2o3_d_la_points);
}

TEST(Pow2o3Double, Digest) {
  EXPECT_EQ(positive_digest<pow2o3_d<tier::ha>>(), 0x8c5b2de6648ac7b0u);
  EXPECT_EQ(positive_digest<pow2o3_d<tier::la>>(), 0xf0a4c3b8c07e052eu);
}

template <typename Body>
class Pow2o3OfAnyTier : public ::testing::Test {};
using bodies = ::testing::Types<pow2o3_s<tier::ha>, pow2o3_s<tier::la>, pow2o3_s<tier::ep>,
                                pow2o3_d<tier::ha>, pow2o3_d<tier::la>, pow2o3_d<tier::ep>>;
TYPED_TEST_SUITE(Pow2o3OfAnyTier, bodies);

TYPED_TEST(Pow2o3OfAnyTier, Specials) {
  using n = named<part_of<typename TypeParam::input_type>>;
  for (const auto sign : {decltype(n::inf){0}, n::sign}) {
    expect_v11<TypeParam>(sign, 0);
    expect_v11<TypeParam>(n::inf | sign, n::inf);
  }
  expect_quiet_nans<TypeParam>();
}

TYPED_TEST(Pow2o3OfAnyTier, IsEven) { expect_symmetry<TypeParam>(false); }

TYPED_TEST(Pow2o3OfAnyTier, MainPathIsThatOfNormalNumbers) {
  using n = named<part_of<typename TypeParam::input_type>>;
  expect_main_path_of_magnitudes<TypeParam>(n::smallest_normal, n::largest);
}

TEST(Pow2o3Float, RarePathIsThatOfRowsInEveryTier) {
  pattern_source<std::uint32_t> source(9);
  for (int i = 0; i < 3000; ++i) {
    const std::uint32_t p = static_cast<std::uint32_t>(1 + source.below(0x007fffff));
    const auto x = std::bit_cast<float>(p);
    float y = 0;
    EXPECT_EQ(pow2o3_s<tier::ha>::call(&x, &y), 0u);
    // y³ against x²: three times the relative error.
    const quad wide = y, square = quad(x) * x;
    EXPECT_LT(std::fabs(static_cast<double>((wide * wide * wide - square) / square)) / 3,
              0.53 * 0x1p-23);
    expect_number<pow2o3_s<tier::la>>(x, y);
    expect_number<pow2o3_s<tier::ep>>(x, y);
  }
}

TEST(Pow2o3, PowersOfTwoAreExactAtHa) {
  expect_exact_powers<pow2o3_s<tier::ha>>(3, 2);
  expect_exact_powers<pow2o3_d<tier::ha>>(3, 2);
}

}  // namespace
