// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/root/invsqrt.hpp"

#include "quad.hpp"
#include "root_points.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::invsqrt_d;
using scalar::invsqrt_s;
using scalar::tier;

constexpr point_of<std::uint32_t> invsqrt_s_ha_points[] = {
    {0x00000001, 0x64b504f3}, {0x00000002, 0x64800000}, {0x007fffff, 0x5f000001},
    {0x00400000, 0x5f3504f3}, {0x00800000, 0x5f000000}, {0x00800001, 0x5effffff},
    {0x3f800000, 0x3f800000}, {0x3f7fffff, 0x3f800000}, {0x3f800001, 0x3f7fffff},
    {0x3fffffff, 0x3f3504f4}, {0x40000000, 0x3f3504f3}, {0x40800000, 0x3f000000},
    {0x7f7fffff, 0x1f800000}, {0x7f000000, 0x1fb504f3}, {0x29f35a1c, 0x4a39a9f6},
    {0x79d3a6f2, 0x2247152f}, {0x13cf069b, 0x55494b7d}, {0x33099387, 0x45ae9b09},
    {0x53d1d228, 0x3547f319}, {0x06ae3fe8, 0x5bdb694c}, {0x09c59799, 0x5a4e0b47},
    {0x699f8412, 0x2a65520f}, {0x4517c815, 0x3ca63bf6},
};
constexpr point_of<std::uint32_t> invsqrt_s_la_points[] = {
    {0x00000001, 0x64b504f3}, {0x00000002, 0x64800000}, {0x007fffff, 0x5f000001},
    {0x00400000, 0x5f3504f3}, {0x00800000, 0x5f000000}, {0x00800001, 0x5effffff},
    {0x3f800000, 0x3f800000}, {0x3f7fffff, 0x3f800000}, {0x3f800001, 0x3f7fffff},
    {0x3fffffff, 0x3f3504f3}, {0x40000000, 0x3f3504f3}, {0x40800000, 0x3f000000},
    {0x7f7fffff, 0x1f800000}, {0x7f000000, 0x1fb504f3}, {0x0c8c7408, 0x58f46336},
    {0x2f4ee4fc, 0x478e61d4}, {0x4b18cc2e, 0x39a5ae3d}, {0x07ec823a, 0x5b3c54b0},
    {0x74f12eca, 0x24ba7f3a}, {0x4173a77a, 0x3e8333e8}, {0x1bfb3ae6, 0x5136bace},
    {0x054ca86c, 0x5c8f2874}, {0x0b8051ad, 0x597fae7a},
};
constexpr point_of<std::uint64_t> invsqrt_d_ha_points[] = {
    {0x0000000000000001, 0x6180000000000000}, {0x0000000000000003, 0x617279a74590331c},
    {0x000fffffffffffff, 0x5fe0000000000001}, {0x0010000000000000, 0x5fe0000000000000},
    {0x002fffffffffffff, 0x5fd0000000000000}, {0x0030000000000000, 0x5fd0000000000000},
    {0x034fffffffffffff, 0x5e40000000000000}, {0x0350000000000000, 0x5e40000000000000},
    {0x3ff0000000000000, 0x3ff0000000000000}, {0x3fefffffffffffff, 0x3ff0000000000000},
    {0x3ff0000000000001, 0x3fefffffffffffff}, {0x4000000000000000, 0x3fe6a09e667f3bcd},
    {0x400fffffffffffff, 0x3fe0000000000000}, {0x4010000000000000, 0x3fe0000000000000},
    {0x7fcfffffffffffff, 0x2000000000000000}, {0x7fd0000000000000, 0x2000000000000000},
    {0x7fefffffffffffff, 0x1ff0000000000000}, {0x3596aa4d6f03675a, 0x451ae2df671296b1},
    {0x1ede0b9211e20b8f, 0x50775a16e065abc0}, {0x4698b7671738f7d9, 0x3c99bf16cc9fd37e},
    {0x07a0eedb6cad4a26, 0x5c15fec43fce7de6}, {0x4870c967d3ac94af, 0x3baf3dbaeaad90b0},
    {0x7956082e1fb17c23, 0x233b4517d4770cc5}, {0x50c8599c39263059, 0x37825789009d6aed},
    {0x4aafa478a09f76b5, 0x3a90171364488a47},
};
constexpr point_of<std::uint64_t> invsqrt_d_la_points[] = {
    {0x0000000000000001, 0x6180000000000000}, {0x0000000000000003, 0x617279a74590331c},
    {0x000fffffffffffff, 0x5fe0000000000001}, {0x0010000000000000, 0x5fe0000000000000},
    {0x002fffffffffffff, 0x5fd0000000000000}, {0x0030000000000000, 0x5fd0000000000000},
    {0x034fffffffffffff, 0x5e40000000000001}, {0x0350000000000000, 0x5e40000000000000},
    {0x3ff0000000000000, 0x3ff0000000000000}, {0x3fefffffffffffff, 0x3ff0000000000001},
    {0x3ff0000000000001, 0x3fefffffffffffff}, {0x4000000000000000, 0x3fe6a09e667f3bcd},
    {0x400fffffffffffff, 0x3fe0000000000001}, {0x4010000000000000, 0x3fe0000000000000},
    {0x7fcfffffffffffff, 0x2000000000000001}, {0x7fd0000000000000, 0x2000000000000000},
    {0x7fefffffffffffff, 0x1ff0000000000000}, {0x07fb1878f29d0da9, 0x5be89711ff6dd335},
    {0x4b03057a93bd04cf, 0x3a64c0ae25cc5870}, {0x0668f14e658cda14, 0x5cb21f6c8402aec3},
    {0x1c5c68c8f9ebdacc, 0x51b803cc1d16abc3}, {0x4750cb9f0becd7b0, 0x3c3f3bab4e43562b},
    {0x111bdf56dbc496cb, 0x57583eb9f6cbedcb}, {0x35b659214a23d596, 0x450b1387465b30fc},
    {0x454531f624ede6a4, 0x3d43a8e140467252},
};
constexpr point_of<std::uint64_t> invsqrt_d_ep_points[] = {
    {0x0000000000000001, 0x6180000000000000}, {0x0000000000000003, 0x617279a74590331c},
    {0x000fffffffffffff, 0x5fe0000000000001}, {0x0010000000000000, 0x5fe0000000000000},
    {0x002fffffffffffff, 0x5fd0000000000000}, {0x0030000000000000, 0x5fcfffffffffff4f},
    {0x034fffffffffffff, 0x5e3ffffffffffe42}, {0x0350000000000000, 0x5e3fffffffffff4f},
    {0x3ff0000000000000, 0x3fefffffffffff4f}, {0x3fefffffffffffff, 0x3feffffffffffe42},
    {0x3ff0000000000001, 0x3fefffffffffff4e}, {0x4000000000000000, 0x3fe6a09e667f3b6b},
    {0x400fffffffffffff, 0x3fdffffffffffe42}, {0x4010000000000000, 0x3fdfffffffffff4f},
    {0x7fcfffffffffffff, 0x1ffffffffffffe42}, {0x7fd0000000000000, 0x2000000000000000},
    {0x7fefffffffffffff, 0x1ff0000000000000}, {0x4923b32c1e27a1c0, 0x3b5464640b26880a},
    {0x47c682ac4ef8aa38, 0x3c0313a1c918b74e}, {0x575bdd4ad0eda82f, 0x34383f9def21d434},
    {0x0d40edf12e44158b, 0x5945ff5c68af7613}, {0x492d39b494e3bf91, 0x3b50be063188a886},
    {0x181c2862a38fd547, 0x53d81f32cfbf328d}, {0x0c889ae95f557203, 0x59a23f21dab6afa4},
    {0x5b3672118c38fb29, 0x324b04786596ce22},
};
constexpr point_of<std::uint64_t> inverse_root_points[] = {
    {0x3ff0000000000000, 0x3ff0000000000000}, {0x3ff03fffffffffff, 0x3fefc0bd88a0f1da},
    {0x3ff0400000000000, 0x3fefc0bd88a0f1d9}, {0x3ff0400000000001, 0x3fefc0bd88a0f1d8},
    {0x3fffbfffffffffff, 0x3fe6b7612ec892f7}, {0x3fffc00000000001, 0x3fe6b7612ec892f6},
    {0x3fffffffffffffff, 0x3fe6a09e667f3bcd}, {0x4000000000000000, 0x3fe6a09e667f3bcd},
    {0x400fffffffffffff, 0x3fe0000000000000}, {0x000907a71012f038, 0x5fe54c493fc4503d},
    {0x0009e7760f4205b5, 0x5fe45616543e16e5}, {0x0007f15034b9b5e0, 0x5fe6b580526ef7ec},
    {0x000881edae2eb155, 0x5fe5f12d586af528}, {0x000c6f876d76b07f, 0x5fe2261148294424},
    {0x0007731a506bf2f0, 0x5fe772c940965b51}, {0x764353c395e761d1, 0x24c4967bb16b587e},
    {0x2e5854ac7403e430, 0x48b9f31ed84e2d4b}, {0x1fdc713b4cbd87ad, 0x4ff8003afc797dfb},
    {0x171298cdcb5c7427, 0x545dae88873497de}, {0x63e17510b2f14c94, 0x2df5a9932aa05dc3},
    {0x0a8a399f3e7d1bfb, 0x5aa1ac8fb0b744e5}, {0x267e902a930d6eaf, 0x4ca72737bd5d0161},
    {0x3f6ff90386734721, 0x403001bf67a68dbf}, {0x2c0702e6e00902c7, 0x49e2de301a8e7290},
    {0x3983661dbabced20, 0x43248cbc5787c1a1}, {0x4e025e7e49b64a08, 0x38e51e2f1d946a80},
    {0x096ea567faecbd38, 0x5b30597fa5c0cc8a},
};

TEST(InvsqrtFloat, Points) {
  expect_points<invsqrt_s<tier::ha>>(invsqrt_s_ha_points);
  expect_points<invsqrt_s<tier::la>>(invsqrt_s_la_points);
  expect_points<invsqrt_s<tier::ep>>(invsqrt_s_la_points);
}

TEST(InvsqrtFloat, Digest) {
  EXPECT_EQ(positive_digest<invsqrt_s<tier::ha>>(), 0x2723c69e604ffd7eu);
  EXPECT_EQ(positive_digest<invsqrt_s<tier::la>>(), 0xc73b23c4069c528cu);
  EXPECT_EQ(positive_digest<invsqrt_s<tier::ep>>(), 0xc73b23c4069c528cu);
}

TEST(InvsqrtDouble, Points) {
  expect_points<invsqrt_d<tier::ha>>(invsqrt_d_ha_points);
  expect_points<invsqrt_d<tier::la>>(invsqrt_d_la_points);
  expect_points<invsqrt_d<tier::ep>>(invsqrt_d_ep_points);
}

TEST(InvsqrtDouble, Digest) {
  EXPECT_EQ(positive_digest<invsqrt_d<tier::ha>>(), 0xec588c7a30a871b7u);
  EXPECT_EQ(positive_digest<invsqrt_d<tier::la>>(), 0xbb33876e68e4da36u);
  EXPECT_EQ(positive_digest<invsqrt_d<tier::ep>>(), 0xb92d9633164209d4u);
}

TEST(InvsqrtDouble, RarePathServesEveryPositiveNumber) {
  expect_rare_points<invsqrt_d<tier::la>>(inverse_root_points);
  for (const auto& p : inverse_root_points) {
    const double x = std::bit_cast<double>(p.x);
    const quad y = std::bit_cast<double>(p.y);
    // 1 - xy² is twice the relative error.
    const double rest = static_cast<double>(1 - x * y * y) / 2;
    EXPECT_LT(std::fabs(rest), 0.51 * 0x1p-52);
  }
}

TEST(Invsqrt, MainPaths) {
  expect_main_path_between<invsqrt_s<tier::ha>>(0x00800000, 0x7f7fffff);
  expect_main_path_between<invsqrt_s<tier::la>>(0x00800000, 0x7f7fffff);
  expect_main_path_between<invsqrt_d<tier::ha>>(0x0350000000000000, 0x7fcfffffffffffff);
  expect_main_path_between<invsqrt_d<tier::la>>(0x0030000000000000, 0x7fcfffffffffffff);
  expect_main_path_between<invsqrt_d<tier::ep>>(0x0030000000000000, 0x7fcfffffffffffff);
}

template <typename Body>
class InvsqrtOfAnyTier : public ::testing::Test {};
using bodies = ::testing::Types<invsqrt_s<tier::ha>, invsqrt_s<tier::la>, invsqrt_s<tier::ep>,
                                invsqrt_d<tier::ha>, invsqrt_d<tier::la>, invsqrt_d<tier::ep>>;
TYPED_TEST_SUITE(InvsqrtOfAnyTier, bodies);

TYPED_TEST(InvsqrtOfAnyTier, Specials) {
  using U = part_of<typename TypeParam::input_type>;
  using n = named<U>;
  expect_v11<TypeParam>(0, n::inf, pole);
  expect_v11<TypeParam>(n::sign, n::inf | n::sign, pole);
  expect_v11<TypeParam>(n::inf, 0);
  for (const U x : negative_patterns<U>()) expect_v11<TypeParam>(x, n::any_nan, domain);
  expect_quiet_nans<TypeParam>();
}

TEST(Invsqrt, PowersOfTwoAreExactAtHa) {
  expect_exact_powers<invsqrt_s<tier::ha>>(2, -1);
  expect_exact_powers<invsqrt_d<tier::ha>>(2, -1);
}

}  // namespace
