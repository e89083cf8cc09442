// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/root/cbrt.hpp"

#include "root_points.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::cbrt_d;
using scalar::cbrt_s;
using scalar::tier;

/// Values alone, where the status is tested by itself.
template <typename F>
struct any_status : F {
  static std::uint32_t call(const typename F::input_type* x, typename F::output_type* y) {
    F::call(x, y);
    return 0;
  }
};

constexpr point_of<std::uint32_t> cbrt_s_ha_points[] = {
    {0x00000001, 0x26a14518}, {0x80000001, 0xa6a14518}, {0x007fffff, 0x2a7fffff},
    {0x00800000, 0x2a800000}, {0x00800001, 0x2a800000}, {0x3f400000, 0x3f689768},
    {0x3f3fffff, 0x3f689768}, {0x3f800000, 0x3f800000}, {0x3fbfffff, 0x3f9285ff},
    {0x3fc00000, 0x3f9285ff}, {0x3fc00001, 0x3f9285ff}, {0x40000000, 0x3fa14518},
    {0x40800000, 0x3fcb2ff5}, {0x41000000, 0x40000000}, {0xc1000000, 0xc0000000},
    {0x7f7fffff, 0x54cb2ff5}, {0xff7fffff, 0xd4cb2ff5}, {0xa9f35a1c, 0xb847c8d0},
    {0x13cf069b, 0x30ee81d7}, {0x53d1d228, 0x463e26c3}, {0x89c59799, 0xad93eeb0},
    {0x4517c815, 0x41571035}, {0xaf4ee4fc, 0xba1637e5}, {0x87ec823a, 0xacf954a6},
    {0x4173a77a, 0x401ea276}, {0x054ca86c, 0x2c15acd2},
};
constexpr point_of<std::uint32_t> cbrt_s_la_points[] = {
    {0x00000001, 0x26a14518}, {0x80000001, 0xa6a14518}, {0x007fffff, 0x2a7fffff},
    {0x00800000, 0x2a800000}, {0x00800001, 0x2a800000}, {0x3f400000, 0x3f689769},
    {0x3f3fffff, 0x3f689768}, {0x3f800000, 0x3f800000}, {0x3fbfffff, 0x3f9285ff},
    {0x3fc00000, 0x3f9285ff}, {0x3fc00001, 0x3f928600}, {0x40000000, 0x3fa14518},
    {0x40800000, 0x3fcb2ff5}, {0x41000000, 0x40000000}, {0xc1000000, 0xc0000000},
    {0x7f7fffff, 0x54cb2ff4}, {0xff7fffff, 0xd4cb2ff4}, {0x3801b3ad, 0x3d009096},
    {0x097105c7, 0x2d7ae828}, {0x8c1c7bec, 0xae594304}, {0x36d6a513, 0x3c981236},
    {0xea564a57, 0xcdbf7dfb}, {0x9058be11, 0xafc03841}, {0x9d13182c, 0xb406127b},
    {0xd0cfbb5a, 0xc53d84ab}, {0x79ce86d4, 0x52ee50bb},
};
constexpr point_of<std::uint32_t> cbrt_s_ep_points[] = {
    {0x00000001, 0x26a14673}, {0x80000001, 0xa6a14673}, {0x007fffff, 0x2a800113},
    {0x00800000, 0x2a800113}, {0x00800001, 0x2a800114}, {0x3f400000, 0x3f689c44},
    {0x3f3fffff, 0x3f689b42}, {0x3f800000, 0x3f800113}, {0x3fbfffff, 0x3f92886c},
    {0x3fc00000, 0x3f92890f}, {0x3fc00001, 0x3f92890f}, {0x40000000, 0x3fa14673},
    {0x40800000, 0x3fcb31aa}, {0x41000000, 0x40000113}, {0xc1000000, 0xc0000113},
    {0x7f7fffff, 0x54cb31aa}, {0xff7fffff, 0xd4cb31aa}, {0xca5e8267, 0xc319e51a},
    {0x33466d0a, 0x3b6b2861}, {0x7d75ed66, 0x541f2059}, {0x86766bd8, 0xac7cc44c},
    {0x6e624b65, 0x4f1ac38d}, {0x2591eacb, 0x36d44557}, {0x92f6f352, 0xb09f58e9},
    {0x8f93d0e0, 0xaf864c8f}, {0xa7fc551c, 0xb7a07fe0},
};
constexpr point_of<std::uint64_t> cbrt_d_ha_points[] = {
    {0x0000000000000001, 0x2990000000000000}, {0x8000000000000001, 0xa990000000000000},
    {0x000fffffffffffff, 0x2aa428a2f98d728a}, {0x0010000000000000, 0x2aa428a2f98d728b},
    {0x0010000000000001, 0x2aa428a2f98d728b}, {0x3fe8000000000000, 0x3fed12ed0af1a27f},
    {0x3fe7ffffffffffff, 0x3fed12ed0af1a27f}, {0x3ff0000000000000, 0x3ff0000000000000},
    {0x3ff7ffffffffffff, 0x3ff250bfe1b082f5}, {0x3ff8000000000000, 0x3ff250bfe1b082f5},
    {0x3fd0000000000000, 0x3fe428a2f98d728b}, {0xc07f400000000000, 0xc01fbf7e4e8cc9cc},
    {0xc020000000000000, 0xc000000000000000}, {0x7fefffffffffffff, 0x554428a2f98d728b},
    {0x6c35eea5d0eda82f, 0x4eb1c60758f075cf}, {0xe5c8efe41a61dbe2, 0xcc8d728f9aba78e2},
    {0x4c961431a38fd547, 0x4426716d5300c25a}, {0xe39e3eca18f135d2, 0xcbd3c88794dfd182},
    {0x64ae9c301012f037, 0x4c2f87a2d68cf3be}, {0x4dbe6d779e7769b1, 0x4488f9b44f5c4a16},
    {0x6297b458ae2eb154, 0x4b7cf4401c0e4b99}, {0x54aafcbbc6f87718, 0x46d7ff0830f5b464},
};
constexpr point_of<std::uint64_t> cbrt_d_la_points[] = {
    {0x0000000000000001, 0x2990000000000000}, {0x8000000000000001, 0xa990000000000000},
    {0x000fffffffffffff, 0x2aa428a2f98d728b}, {0x0010000000000000, 0x2aa428a2f98d728b},
    {0x0010000000000001, 0x2aa428a2f98d728b}, {0x3fe8000000000000, 0x3fed12ed0af1a27f},
    {0x3fe7ffffffffffff, 0x3fed12ed0af1a27f}, {0x3ff0000000000000, 0x3ff0000000000000},
    {0x3ff7ffffffffffff, 0x3ff250bfe1b082f5}, {0x3ff8000000000000, 0x3ff250bfe1b082f5},
    {0x3fd0000000000000, 0x3fe428a2f98d728b}, {0xc07f400000000000, 0xc01fbf7e4e8cc9cb},
    {0xc020000000000000, 0xc000000000000000}, {0x7fefffffffffffff, 0x554428a2f98d728b},
    {0x7ba9a9e195e761d1, 0x53d798e954555d44}, {0x53bf61eb5c90a958, 0x46893be65e78d7be},
    {0xcc114c66cb5c7427, 0xc3fa115344b464ab}, {0x502f46fec7a2ea20, 0x455934ace8e56408},
    {0xd3c74815930d6eaf, 0xc68cc7e8054b7254}, {0x789240b17ebff206, 0x52d0b7dae35088d0},
    {0x5d49b30ebabced20, 0x49b79bb8feeec7f5}, {0x7f4b2f4e9be4bcfc, 0x550e4e93329fc06b},
};
constexpr point_of<std::uint64_t> cbrt_d_ep_points[] = {
    {0x0000000000000001, 0x299000000000015c}, {0x8000000000000001, 0xa99000000000015c},
    {0x000fffffffffffff, 0x2aa428a2f98d7442}, {0x0010000000000000, 0x2aa428a2f98d7442},
    {0x0010000000000001, 0x2aa428a2f98d7442}, {0x3fe8000000000000, 0x3fed12ed0af1acf4},
    {0x3fe7ffffffffffff, 0x3fed12ed0af1aacc}, {0x3ff0000000000000, 0x3ff000000000015c},
    {0x3ff7ffffffffffff, 0x3ff250bfe1b0882f}, {0x3ff8000000000000, 0x3ff250bfe1b0898b},
    {0x3fd0000000000000, 0x3fe428a2f98d7442}, {0xc07f400000000000, 0xc01fbf7e4e8cc335},
    {0xc020000000000000, 0xc00000000000015c}, {0x7fefffffffffffff, 0x554428a2f98d7442},
    {0x615381ef1e398f10, 0x4b1117c47761b58a}, {0x7104ff3f2a3af4d4, 0x504bce91efaa4d32},
    {0x7c4ab2f826e87555, 0x540e2017544766df}, {0xc3125f256bf46c69, 0xc0fa9892c80b39f7},
    {0xc587bbe1ab1031d0, 0xc1ccf7512dedcb5d}, {0xe53c74fc8ede0d7a, 0xcc5ec5c32fc753fd},
    {0x74efe6b2e01f5057, 0x51995f4b3ef02004}, {0x6d0fb82357124242, 0x4ef952ed32970793},
};

TEST(CbrtFloat, Points) {
  expect_points<cbrt_s<tier::ha>>(cbrt_s_ha_points);
  expect_points<cbrt_s<tier::la>>(cbrt_s_la_points);
  expect_points<cbrt_s<tier::ep>>(cbrt_s_ep_points);
}

TEST(CbrtFloat, Digest) {
  EXPECT_EQ(positive_digest<cbrt_s<tier::ha>>(), 0xa9645137bc816225u);
  EXPECT_EQ(positive_digest<cbrt_s<tier::la>>(), 0x742c890aa1148089u);
  EXPECT_EQ(positive_digest<cbrt_s<tier::ep>>(), 0x3929734ac4493393u);
}

TEST(CbrtDouble, Points) {
  for (const auto& p : cbrt_d_ha_points) expect_v11<any_status<cbrt_d<tier::ha>>>(p.x, p.y);
  expect_points<cbrt_d<tier::la>>(cbrt_d_la_points);
  expect_points<cbrt_d<tier::ep>>(cbrt_d_ep_points);
}

TEST(CbrtDouble, Digest) {
  EXPECT_EQ(positive_digest<cbrt_d<tier::ha>>(), 0x80961d5619e448f1u);
  EXPECT_EQ(positive_digest<cbrt_d<tier::la>>(), 0xcb699e118fd281beu);
  EXPECT_EQ(positive_digest<cbrt_d<tier::ep>>(), 0x237aa040d613ed88u);
}

template <typename Body>
class CbrtOfAnyTier : public ::testing::Test {};
using bodies = ::testing::Types<cbrt_s<tier::ha>, cbrt_s<tier::la>, cbrt_s<tier::ep>,
                                any_status<cbrt_d<tier::ha>>, cbrt_d<tier::la>, cbrt_d<tier::ep>>;
TYPED_TEST_SUITE(CbrtOfAnyTier, bodies);

TYPED_TEST(CbrtOfAnyTier, Specials) {
  using n = named<part_of<typename TypeParam::input_type>>;
  for (const auto x : {decltype(n::inf){0}, n::inf}) {
    expect_v11<TypeParam>(x, x);
    expect_v11<TypeParam>(x | n::sign, x | n::sign);
  }
  expect_quiet_nans<TypeParam>();
}

TYPED_TEST(CbrtOfAnyTier, IsOdd) { expect_symmetry<TypeParam>(true); }

TEST(CbrtDouble, StatusAtHaIsThatOfTheResultAsAnInteger) {
  using cbrt_ha = cbrt_d<tier::ha>;
  const auto status = [](double x) {
    double y = 0;
    return cbrt_ha::call(&x, &y);
  };
  for (int i = 1; i <= 8; ++i) {
    EXPECT_EQ(status(i * i * i), 1u << (i - 1)) << i;
    const double inside = i + 0.5;
    EXPECT_EQ(status(inside * inside * inside), 1u << (i - 1)) << i;
  }
  expect_number<cbrt_ha>(8.0, 2.0, 2);
  expect_number<cbrt_ha>(0.125, 0.5, 0);
  expect_number<cbrt_ha>(-8.0, -2.0, 0);
  expect_v11<cbrt_ha>(0x3ff0000000000000, 0x3ff0000000000000, 1);
  expect_v11<cbrt_ha>(0x3feffffffffffffb, 0x3feffffffffffffe, 0);
  expect_v11<cbrt_ha>(0x4086c7fffffffffc, 0x4022000000000000 - 1, 128);
  for (const double x : {729.0, 1e3, 32768.0, 35937.0, 1e6, 1e300, -1.0, -1e3, -29791.0, 0.0})
    EXPECT_EQ(status(x), 0u) << x;
  expect_v11<cbrt_ha>(0x7ff0000000000000, 0x7ff0000000000000, 0);
  expect_quiet_nans<cbrt_ha>();
}

TEST(CbrtDouble, OtherTiersHaveNoStatus) {
  for (const double x : {1.0, 8.0, 27.0, 512.0, 1e6}) {
    double y = 0;
    EXPECT_EQ(cbrt_d<tier::la>::call(&x, &y), 0u);
    EXPECT_EQ(cbrt_d<tier::ep>::call(&x, &y), 0u);
  }
}

TEST(Cbrt, PowersOfTwoAreExactAtHa) {
  expect_exact_powers<cbrt_s<tier::ha>>(3, 1);
  expect_exact_powers<any_status<cbrt_d<tier::ha>>>(3, 1);
}

}  // namespace
