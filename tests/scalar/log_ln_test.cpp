// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/log/ln.hpp"

#include "log_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::ln_d;
using scalar::ln_s;
using scalar::tier;

constexpr point_of<std::uint32_t> ln_s_ha_points[] = {
    {0x3f800000, 0x00000000}, {0x3f7fffff, 0xb3800000}, {0x3f800001, 0x33ffffff},
    {0x3f2aaaaa, 0xbecf9921}, {0x3f2aaaab, 0xbecf991e}, {0x3f2aaaac, 0xbecf991b},
    {0x3faaaaaa, 0x3e934b0f}, {0x3faaaaab, 0x3e934b12}, {0x3f400000, 0xbe934b10},
    {0x3f3fffff, 0xbe934b13}, {0x3fbfffff, 0x3ecf991d}, {0x3fc00000, 0x3ecf9920},
    {0x00800000, 0xc2aeac50}, {0x00800001, 0xc2aeac50}, {0x7f7fffff, 0x42b17218},
    {0x7f000000, 0x42b00f34}, {0x40000000, 0x3f317218}, {0x3f000000, 0xbf317218},
    {0x41200000, 0x40135d8e}, {0x447a0000, 0x40dd0c55}, {0x503b3e22, 0x41ba08ab},
    {0x21326c1c, 0xc227cca7}, {0x5f72e04c, 0x42313c34}, {0x2e647dde, 0xc1bd7209},
    {0x6648e71b, 0x42574ae1}, {0x58e08fef, 0x420ce0c0}, {0x3f0ed9c5, 0xbf15583d},
    {0x3fee6617, 0x3f1f35cb}, {0x3f7f83d4, 0xbaf8944e}, {0x3f1a8c82, 0xbf0131de},
    {0x3f504ed1, 0xbe531bae}, {0x3f39f621, 0xbea3a79b},
};

constexpr point_of<std::uint32_t> ln_s_la_points[] = {
    {0x3f800000, 0x00000000}, {0x3f7fffff, 0xb3800000}, {0x3f800001, 0x33ffffff},
    {0x3f2aaaaa, 0xbecf9921}, {0x3f2aaaab, 0xbecf991e}, {0x3f2aaaac, 0xbecf991b},
    {0x3faaaaaa, 0x3e934b0f}, {0x3faaaaab, 0x3e934b12}, {0x3f400000, 0xbe934b10},
    {0x3f3fffff, 0xbe934b13}, {0x3fbfffff, 0x3ecf991d}, {0x3fc00000, 0x3ecf9920},
    {0x00800000, 0xc2aeac50}, {0x00800001, 0xc2aeac50}, {0x7f7fffff, 0x42b17218},
    {0x7f000000, 0x42b00f34}, {0x40000000, 0x3f317218}, {0x3f000000, 0xbf317218},
    {0x41200000, 0x40135d8e}, {0x447a0000, 0x40dd0c55}, {0x3016ecbf, 0xc1aa951e},
    {0x3c8a7451, 0xc082926a}, {0x6fa93880, 0x4285a482}, {0x200fb2d4, 0xc22e35d9},
    {0x313cace7, 0xc19db4c7}, {0x4619f4b4, 0x411320f8}, {0x3f3435fd, 0xbeb3bcc8},
    {0x3f7fa846, 0xbaaf9217}, {0x3f06b6e7, 0xbf245b6c}, {0x3f6ef735, 0xbd8d0539},
    {0x3fd0f92c, 0x3efaf866}, {0x3f8f1850, 0x3de44eb9},
};

constexpr point_of<std::uint32_t> ln_s_ep_points[] = {
    {0x3f800000, 0x00000000}, {0x3f7fffff, 0xb3800000}, {0x3f800001, 0x33ffffff},
    {0x3f2aaaaa, 0xbecf955b}, {0x3f2aaaab, 0xbecf93cc}, {0x3f2aaaac, 0xbecf93c9},
    {0x3faaaaaa, 0x3e934ed5}, {0x3faaaaab, 0x3e935064}, {0x3f400000, 0xbe934ed4},
    {0x3f3fffff, 0xbe934ed6}, {0x3fbfffff, 0x3ecf955a}, {0x3fc00000, 0x3ecf955c},
    {0x00800000, 0xc2aeac50}, {0x00800001, 0xc2aeac50}, {0x7f7fffff, 0x42b17218},
    {0x7f000000, 0x42b00f34}, {0x40000000, 0x3f317218}, {0x3f000000, 0xbf317218},
    {0x41200000, 0x40135d32}, {0x447a0000, 0x40dd0c55}, {0x17ce4158, 0xc25be61a},
    {0x75cace10, 0x4296a3e3}, {0x6f88e64e, 0x428537fc}, {0x62834aa2, 0x42422eca},
    {0x325914f8, 0xc1917e70}, {0x14ede92f, 0xc26bf692}, {0x3f24d43c, 0xbee16ccc},
    {0x3f470c85, 0xbe80d857}, {0x3fe3c180, 0x3f138499}, {0x3f40deb8, 0xbe90fe34},
    {0x3f43b512, 0xbe8983d1}, {0x3f00e8a2, 0xbf2fa279},
};

constexpr point_of<std::uint32_t> ln_s_rare_points[] = {
    {0x3f813fff, 0x3c1f38cc}, {0x3f814000, 0x3c1f394b}, {0x3f814001, 0x3c1f39ca},
    {0x3f7d7fff, 0xbc20c990}, {0x3f7d8000, 0xbc20c950}, {0x3f7d8001, 0xbc20c90f},
    {0x3f800000, 0x00000000}, {0x3f800001, 0x33ffffff}, {0x3f7fffff, 0xb3800000},
    {0x3f80624e, 0x3b4450a7}, {0x3f7f5c29, 0xbb240b84}, {0x3fa80000, 0x3e8b3ae5},
    {0x3fffffff, 0x3f317217}, {0x3fff0000, 0x3f307198}, {0x3ffeffff, 0x3f307197},
    {0x3faaaaaa, 0x3e934b0f}, {0x7c815c33, 0x42a92628}, {0x1b3729c6, 0xc248f731},
    {0x7b2a7591, 0x42a58abe}, {0x702a9eba, 0x42870b9d}, {0x25d04b74, 0xc20e3a17},
    {0x7bb2ea69, 0x42a7066c}, {0x45b46c6e, 0x410a93a2}, {0x17b266aa, 0xc25c7aa5},
    {0x00800000, 0xc2aeac50}, {0x7f7fffff, 0x42b17218}, {0x00000001, 0xc2ce8ed0},
    {0x00000002, 0xc2cd2bec}, {0x00000003, 0xc2cc5c53}, {0x00400000, 0xc2b00f34},
    {0x007fffff, 0xc2aeac50}, {0x007ffffe, 0xc2aeac50}, {0x00000800, 0xc2bf4f02},
    {0x007bb862, 0xc2aebdb9}, {0x007b8848, 0xc2aebe80}, {0x00726621, 0xc2aee5d4},
    {0x00310d78, 0xc2b09764}, {0x00263eb7, 0xc2b116d1}, {0x0002c2d1, 0xc2b65891},
};

constexpr point_of<std::uint32_t> ln_s_denormal_points[] = {
    {0x00000001, 0xc2ce8ed0}, {0x00000002, 0xc2cd2bec}, {0x00000003, 0xc2cc5c53},
    {0x00400000, 0xc2b00f34}, {0x007fffff, 0xc2aeac50}, {0x007ffffe, 0xc2aeac50},
    {0x00000800, 0xc2bf4f02}, {0x002e3b79, 0xc2b0b5b5}, {0x00351baa, 0xc2b06eb8},
    {0x00153e0d, 0xc2b243e1}, {0x0077c80e, 0xc2aece4a}, {0x0012a65d, 0xc2b28685},
    {0x0021c497, 0xc2b1568f},
};

constexpr point_of<std::uint64_t> ln_d_ha_points[] = {
    {0x3ff0000000000000, 0x0000000000000000}, {0x3fefffffffffffff, 0xbca0000000000000},
    {0x3ff0000000000001, 0x3cafffffffffffff}, {0x3fe5555555555555, 0xbfd9f323ecbf984d},
    {0x3fe5555555555556, 0xbfd9f323ecbf984a}, {0x3ff5555555555555, 0x3fd269621134db91},
    {0x3ff5555555555556, 0x3fd269621134db94}, {0x0010000000000000, 0xc086232bdd7abcd2},
    {0x0010000000000001, 0xc086232bdd7abcd2}, {0x7fefffffffffffff, 0x40862e42fefa39ef},
    {0x7fe0000000000000, 0x408628b76e3a7b61}, {0x4000000000000000, 0x3fe62e42fefa39ef},
    {0x3fe0000000000000, 0xbfe62e42fefa39ef}, {0x4024000000000000, 0x40026bb1bbb55516},
    {0x408f400000000000, 0x401ba18a998fffa0}, {0x3ff00000000fffff, 0x3deffffdfff00002},
    {0x3feffe0000000000, 0xbf30008005559558}, {0x2a8a353410acff00, 0xc06da831436d7176},
    {0x68b092c24d25deb3, 0x407c3f79819673a8}, {0x4b16ad479a656aaf, 0x405eeea7331359b8},
    {0x4c5909cb00ddb74d, 0x4061361c539c56b9}, {0x5aa521d5ad8d194a, 0x407284086982169f},
    {0x08836c73568068b9, 0xc08335056bed2e4b}, {0x3ff6be134f596727, 0x3fd6815ddc825757},
    {0x3ff3968ed18a669a, 0x3fc9e617b9a6f1cf}, {0x3febd35350d7d13f, 0xbfc1e46c18e1274d},
    {0x3ffe3e117b3120df, 0x3fe45f8090d08cee}, {0x3feb458db4653252, 0xbfc4772a11fe8a50},
    {0x3ff065480e979cf3, 0x3f99032bd210d927}, {0x3ff69d3d82a250b9, 0x3fd624b400f63624},
    {0x3ff69d3d19e61493, 0x3fd624b2d88d7deb}, {0x3ff6a209b0928c65, 0x3fd63246685aa5ad},
    {0x3ff69a0b834443aa, 0x3fd61ba85e393efe},
};

constexpr point_of<std::uint64_t> ln_d_la_points[] = {
    {0x3ff0000000000000, 0x0000000000000000}, {0x3fefffffffffffff, 0xbca0000000000000},
    {0x3ff0000000000001, 0x3cafffffffffffff}, {0x3fe5555555555555, 0xbfd9f323ecbf984d},
    {0x3fe5555555555556, 0xbfd9f323ecbf984a}, {0x3ff5555555555555, 0x3fd269621134db91},
    {0x3ff5555555555556, 0x3fd269621134db94}, {0x0010000000000000, 0xc086232bdd7abcd2},
    {0x0010000000000001, 0xc086232bdd7abcd2}, {0x7fefffffffffffff, 0x40862e42fefa39ef},
    {0x7fe0000000000000, 0x408628b76e3a7b61}, {0x4000000000000000, 0x3fe62e42fefa39ef},
    {0x3fe0000000000000, 0xbfe62e42fefa39ef}, {0x4024000000000000, 0x40026bb1bbb55515},
    {0x408f400000000000, 0x401ba18a998fffa0}, {0x3ff00000000fffff, 0x3deffffdfff00002},
    {0x3feffe0000000000, 0xbf30008005559558}, {0x784189fff9a01fe8, 0x408384f08a666000},
    {0x79900e7705da8467, 0x4083f8ae8ad4419b}, {0x2dd747d9bff29101, 0xc06914679c70d734},
    {0x33cfe89cd84a1d3a, 0xc060cf2630f1603f}, {0x4657caf704a012e8, 0x4051c6427ca84f27},
    {0x35ac2184c9a937a6, 0xc05c73852e6e057e}, {0x3ff8165e5dbe4409, 0x3fda2eae8120b0e4},
    {0x3ffcfb0a0252f615, 0x3fe3025d5cda7ab2}, {0x3fe79e08324f3e81, 0xbfd370bc7ca4f42c},
    {0x3fefbfe2c177f113, 0xbf801773d7aeddc7}, {0x3ffd94c5f129c8c6, 0x3fe3aa618574e58a},
    {0x3ff00ea58652dbd0, 0x3f6d3dac7353a075}, {0x3ff69d3d82a250b9, 0x3fd624b400f63624},
    {0x3ff69d3d19e61493, 0x3fd624b2d88d7dea}, {0x3ff6a209b0928c65, 0x3fd63246685aa5ac},
    {0x3ff69a0b834443aa, 0x3fd61ba85e393efd}, {0x0000000000000001, 0xc0874385446d71c3},
    {0x0000000000000003, 0xc0873abb4f301b42}, {0x0008000000000000, 0xc08628b76e3a7b61},
    {0x000fffffffffffff, 0xc086232bdd7abcd2}, {0x000000121ba95a55, 0xc0867ae76f5f435c},
    {0x000000006e0a76ac, 0xc08698d45a39a343}, {0x00000000002582c0, 0xc086cdccfbd1bb74},
    {0x00000007f21ff5ec, 0xc086817e6656c59e},
};

constexpr point_of<std::uint64_t> ln_d_ep_points[] = {
    {0x3ff0000000000000, 0x0000000000000000}, {0x3fefffffffffffff, 0xbca00000010eba0d},
    {0x3ff0000000000001, 0x3cb00000010eba0c}, {0x3fe5555555555555, 0xbfd9f323ee3adb6f},
    {0x3fe5555555555556, 0xbfd9f323eb445527}, {0x3ff5555555555555, 0x3fd269620fb9986f},
    {0x3ff5555555555556, 0x3fd2696212b01eb7}, {0x0010000000000000, 0xc086232bdd7abcd2},
    {0x0010000000000001, 0xc086232bdd7abcd2}, {0x7fefffffffffffff, 0x40862e42fefa39ef},
    {0x7fe0000000000000, 0x408628b76e3a7b61}, {0x4000000000000000, 0x3fe62e42fefa39ef},
    {0x3fe0000000000000, 0xbfe62e42fefa39ef}, {0x4024000000000000, 0x40026bb1bb9b8860},
    {0x408f400000000000, 0x401ba18a998e74db}, {0x3ff00000000fffff, 0x3deffffe020d73fa},
    {0x3feffe0000000000, 0xbf3000800664f065}, {0x1abf957a1757905e, 0xc079c6f877b123f7},
    {0x41b60db4573ac59a, 0x4033baa014dc7d76}, {0x2e7a830e9c5f319e, 0xc06832704368920d},
    {0x13081314eb07c30d, 0xc07f1f6d988462d4}, {0x23595d0157079670, 0xc073d002d7d27e9a},
    {0x59ff047cec983704, 0x4072102dd691cb32}, {0x3fe5e4878b8e8f4e, 0xbfd84b16586652b7},
    {0x3ff3984e5119cdcc, 0x3fc9f1836da0c4c8}, {0x3ff3cba1b06dbee0, 0x3fcb3f1594c8d502},
    {0x3ffef67aff297d0e, 0x3fe5205805f94e6b}, {0x3fe52e6b0c6dea3d, 0xbfda684dc3b16bd3},
    {0x3fe2097167e84707, 0xbfe2589cdad0ec9a}, {0x3ff69d3d82a250b9, 0x3fd624b4017be193},
    {0x3ff69d3d19e61493, 0x3fd624b2d9132861}, {0x3ff6a209b0928c65, 0x3fd6324668eb89e9},
    {0x3ff69a0b834443aa, 0x3fd61ba85eb74344}, {0x0000000000000001, 0xc0874385446d71c3},
    {0x0000000000000003, 0xc0873abb4f300db1}, {0x0008000000000000, 0xc08628b76e3a7b61},
    {0x000fffffffffffff, 0xc086232bdd7abcd2}, {0x00000000005eca9f, 0xc086c662616fd70f},
    {0x000034e258056ed1, 0xc08645f7f9462dd0}, {0x000000000074a678, 0xc086c4b96b5265dc},
    {0x00004a8f6bf84915, 0xc08643387a719087},
};

constexpr point_of<std::uint64_t> ln_d_ha_rare_points[] = {
    {0x3ff027ffffffffff, 0x3f83e7295d25a75a}, {0x3ff0280000000000, 0x3f83e7295d25a7d9},
    {0x3ff0280000000001, 0x3f83e7295d25a858}, {0x3fefafffffffffff, 0xbf841929f9683330},
    {0x3fefb00000000000, 0xbf841929f96832f0}, {0x3fefb00000000001, 0xbf841929f96832af},
    {0x3ff0000000000000, 0x0000000000000000}, {0x3ff0000000000001, 0x3cafffffffffffff},
    {0x3fefffffffffffff, 0xbca0000000000000}, {0x3ff00c49ba5e353f, 0x3f688a09a34ca9d6},
    {0x3fefeb851eb851ec, 0xbf648171cd951467}, {0x3ff5000000000000, 0x3fd1675cababa60e},
    {0x3fffffffffffffff, 0x3fe62e42fefa39ee}, {0x3fffe00000000000, 0x3fe60e32f44788d9},
    {0x3fffdfffffffffff, 0x3fe60e32f44788d8}, {0x3ff5555555555555, 0x3fd269621134db91},
    {0x07310c0da36939ef, 0xc083aa839546091c}, {0x66aab1a57e5a3930, 0x407ad91e864d2c23},
    {0x6b642da43501e088, 0x407e1f824a088105}, {0x7da43fb5f325ffbe, 0x408562f966793c24},
    {0x50c3698469f0441e, 0x406754cc022e5b53}, {0x15abef986f3f0240, 0xc07d4b40c8f7218f},
    {0x13296f1b6baf71d7, 0xc07f085e548ab9b6}, {0x12256ad2da2d3b3d, 0xc07fbc907b7a1d3c},
    {0x0010000000000000, 0xc086232bdd7abcd2}, {0x7fefffffffffffff, 0x40862e42fefa39ef},
    {0x0000000000000001, 0xc0874385446d71c3}, {0x0000000000000003, 0xc0873abb4f301b42},
    {0x0008000000000000, 0xc08628b76e3a7b61}, {0x000fffffffffffff, 0xc086232bdd7abcd2},
    {0x000001eb741b324e, 0xc086607ef718862c}, {0x0000005db057c163, 0xc0866dc14be9e5a0},
    {0x0000000007aa286b, 0xc086ae24b1a10015}, {0x00000000009500eb, 0xc086c2c416d349d2},
};

TEST(LnFloat, Points) {
  expect_points<ln_s<tier::ha>>(ln_s_ha_points);
  expect_points<ln_s<tier::la>>(ln_s_la_points);
  expect_points<ln_s<tier::ep>>(ln_s_ep_points);
}

TEST(LnDouble, Points) {
  expect_points<ln_d<tier::ha>>(ln_d_ha_points);
  expect_points<ln_d<tier::la>>(ln_d_la_points);
  expect_points<ln_d<tier::ep>>(ln_d_ep_points);
}

TEST(LnDouble, RareHa) { expect_rare_points<ln_d<tier::ha>>(ln_d_ha_rare_points); }

template <typename Body>
class LnFloatTier : public ::testing::Test {};
using float_tiers = ::testing::Types<ln_s<tier::ha>, ln_s<tier::la>, ln_s<tier::ep>>;
TYPED_TEST_SUITE(LnFloatTier, float_tiers);

TYPED_TEST(LnFloatTier, RareAndDenormals) {
  expect_rare_points<TypeParam>(ln_s_rare_points);
  expect_points<TypeParam>(ln_s_denormal_points);
}

TYPED_TEST(LnFloatTier, Specials) {
  expect_poles_and_domain<TypeParam>();
  expect_quiet_nans<TypeParam>();
}

TEST(LnDouble, SpecialsHa) {
  expect_poles_and_domain<ln_d<tier::ha>>();
  expect_quiet_nans<ln_d<tier::ha>>();
}

TEST(LnDouble, SpecialsWithoutTable) {
  expect_negative_keeps_its_pattern<ln_d<tier::la>>();
  expect_negative_keeps_its_pattern<ln_d<tier::ep>>();
}

/// Of the same NaN the tiers report differently.
TEST(LnDouble, NegativeNan) {
  expect_v11<ln_d<tier::ha>>(0xfff8000000000005, 0xfff8000000000005, none);
  expect_v11<ln_d<tier::la>>(0xfff8000000000005, 0xfff8000000000005, domain);
  expect_v11<ln_d<tier::ep>>(0xfff8000000000005, 0xfff8000000000005, domain);
}

TYPED_TEST(LnFloatTier, MainPath) { expect_main_path_between<TypeParam>(0x00800000, 0x7f7fffff); }

TEST(LnDouble, MainPath) {
  expect_main_path_between<ln_d<tier::ha>>(0x0010000000000000, 0x7fefffffffffffff);
  expect_main_path_between<ln_d<tier::la>>(1, 0x7fefffffffffffff);
  expect_main_path_between<ln_d<tier::ep>>(1, 0x7fefffffffffffff);
}

}  // namespace
