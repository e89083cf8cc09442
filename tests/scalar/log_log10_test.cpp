// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/log/log10.hpp"

#include "log_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::log10_d;
using scalar::log10_d_nolut;
using scalar::log10_s;
using scalar::tier;

constexpr point_of<std::uint32_t> log10_s_ha_points[] = {
    {0x3f800000, 0x00000000}, {0x3f7fffff, 0xb2de5bd9}, {0x3f800001, 0x335e5bd8},
    {0x3f2aaaaa, 0xbe345146}, {0x3f2aaaab, 0xbe345143}, {0x3f2aaaac, 0xbe345141},
    {0x3faaaaaa, 0x3dffdfde}, {0x3faaaaab, 0x3dffdfe3}, {0x3f400000, 0xbdffdfe1},
    {0x3f3fffff, 0xbdffdfe6}, {0x3fbfffff, 0x3e345142}, {0x3fc00000, 0x3e345144},
    {0x00800000, 0xc217b818}, {0x00800001, 0xc217b818}, {0x7f7fffff, 0x421a209b},
    {0x7f000000, 0x4218ec59}, {0x40000000, 0x3e9a209b}, {0x3f000000, 0xbe9a209b},
    {0x41200000, 0x3f800000}, {0x447a0000, 0x40400000}, {0x503b3e22, 0x41219643},
    {0x21326c1c, 0xc191bfac}, {0x5f72e04c, 0x4199f1cc}, {0x2e647dde, 0xc1248cdc},
    {0x6648e71b, 0x41bb002d}, {0x58e08fef, 0x4174bae3}, {0x3f0ed9c5, 0xbe81b81a},
    {0x3fee6617, 0x3e8a49c5}, {0x3f7f83d4, 0xba57e9cb}, {0x3f1a8c82, 0xbe606f31},
    {0x3f504ed1, 0xbdb75dbf}, {0x3f39f621, 0xbe0e260f},
};

constexpr point_of<std::uint32_t> log10_s_la_points[] = {
    {0x3f800000, 0x00000000}, {0x3f7fffff, 0xb2de5bd9}, {0x3f800001, 0x335e5bd8},
    {0x3f2aaaaa, 0xbe345146}, {0x3f2aaaab, 0xbe345143}, {0x3f2aaaac, 0xbe345141},
    {0x3faaaaaa, 0x3dffdfdf}, {0x3faaaaab, 0x3dffdfe4}, {0x3f400000, 0xbdffdfe1},
    {0x3f3fffff, 0xbdffdfe6}, {0x3fbfffff, 0x3e345142}, {0x3fc00000, 0x3e345144},
    {0x00800000, 0xc217b818}, {0x00800001, 0xc217b818}, {0x7f7fffff, 0x421a209b},
    {0x7f000000, 0x4218ec59}, {0x40000000, 0x3e9a209b}, {0x3f000000, 0xbe9a209b},
    {0x41200000, 0x3f800000}, {0x447a0000, 0x40400000}, {0x3016ecbf, 0xc1142a83},
    {0x3c8a7451, 0xbfe2d3a0}, {0x6fa93880, 0x41e82936}, {0x200fb2d4, 0xc1975133},
    {0x313cace7, 0xc108fb59}, {0x4619f4b4, 0x407f96c1}, {0x3f3435fd, 0xbe1c1e32},
    {0x3f7fa846, 0xba187fad}, {0x3f06b6e7, 0xbe8ec23f}, {0x3f6ef735, 0xbcf4fa3f},
    {0x3fd0f92c, 0x3e59fd72}, {0x3f8f1850, 0x3d464e2d},
};

constexpr point_of<std::uint32_t> log10_s_ep_points[] = {
    {0x3f800000, 0x00000000}, {0x3f7fffff, 0xb2de5cae}, {0x3f800001, 0x335e5cad},
    {0x3f2aaaaa, 0xbe344f58}, {0x3f2aaaab, 0xbe344f53}, {0x3f2aaaac, 0xbe344f51},
    {0x3faaaaaa, 0x3dffe3bc}, {0x3faaaaab, 0x3dffe3c5}, {0x3f400000, 0xbdffe21e},
    {0x3f3fffff, 0xbdffe223}, {0x3fbfffff, 0x3e345025}, {0x3fc00000, 0x3e345027},
    {0x00800000, 0xc217b819}, {0x00800001, 0xc217b819}, {0x7f7fffff, 0x421a209b},
    {0x7f000000, 0x4218ec5a}, {0x40000000, 0x3e9a209b}, {0x3f000000, 0xbe9a209b},
    {0x41200000, 0x3f7fffa7}, {0x447a0000, 0x40400001}, {0x17ce4158, 0xc1bf006b},
    {0x75cace10, 0x4202d82d}, {0x6f88e64e, 0x41e76cb2}, {0x62834aa2, 0x41a8aa3f},
    {0x325914f8, 0xc0fcbfa4}, {0x14ede92f, 0xc1ccf47b}, {0x3f24d43c, 0xbe43cced},
    {0x3f470c85, 0xbddfcef9}, {0x3fe3c180, 0x3e802258}, {0x3f40deb8, 0xbdfbdc87},
    {0x3f43b512, 0xbdeedeab}, {0x3f00e8a2, 0xbe988de7},
};

constexpr point_of<std::uint32_t> log10_s_rare_points[] = {
    {0x3f80bfff, 0x3b264800}, {0x3f80c000, 0x3b264900}, {0x3f80c001, 0x3b264900},
    {0x3f7e7fff, 0xbb274200}, {0x3f7e8000, 0xbb274300}, {0x3f7e8001, 0xbb274200},
    {0x3f800000, 0x00000000}, {0x3f800001, 0x335e5c00}, {0x3f7fffff, 0xb2de5c00},
    {0x3f80624e, 0x3aaa8500}, {0x3f7f5c29, 0xba8e7d00}, {0x3fa80000, 0x3df1de10},
    {0x3fffffff, 0x3e9a209a}, {0x3fff0000, 0x3e9941cf}, {0x3ffeffff, 0x3e9941d0},
    {0x3faaaaaa, 0x3dffdfde}, {0x7c815c33, 0x4212ebc7}, {0x1b3729c6, 0xc1ae8e76},
    {0x7b2a7591, 0x420fc9b5}, {0x702a9eba, 0x41ea990c}, {0x25d04b74, 0xc17712ce},
    {0x7bb2ea69, 0x4211137f}, {0x45b46c6e, 0x4070bb7c}, {0x17b266aa, 0xc1bf8175},
    {0x00800000, 0xc217b818}, {0x7f7fffff, 0x421a209b}, {0x00000001, 0xc23369f4},
    {0x00000002, 0xc23235b3}, {0x00000003, 0xc2318161}, {0x00400000, 0xc218ec59},
    {0x007fffff, 0xc217b818}, {0x007ffffe, 0xc217b818}, {0x00000800, 0xc2262b27},
    {0x007bb862, 0xc217c738}, {0x007b8848, 0xc217c7e5}, {0x00726621, 0xc217ea0e},
    {0x00310d78, 0xc21962a4}, {0x00263eb7, 0xc219d152}, {0x0002c2d1, 0xc21e623a},
};

constexpr point_of<std::uint32_t> log10_s_ha_denormal_points[] = {
    {0x00000001, 0xc23369f4}, {0x00000002, 0xc23235b3}, {0x00000003, 0xc2318161},
    {0x00400000, 0xc218ec59}, {0x007fffff, 0xc217b818}, {0x007ffffe, 0xc217b818},
    {0x00000800, 0xc2262b27}, {0x002e3b79, 0xc2197cf9}, {0x00351baa, 0xc2193f50},
    {0x00153e0d, 0xc21ad6d2}, {0x0077c80e, 0xc217d59b}, {0x0012a65d, 0xc21b10b5},
    {0x0021c497, 0xc21a08b0},
};

constexpr point_of<std::uint32_t> log10_s_denormal_points[] = {
    {0x00000001, 0xc23369f4}, {0x00000002, 0xc23235b3}, {0x00000003, 0xc2318161},
    {0x00400000, 0xc218ec59}, {0x007fffff, 0xc217b818}, {0x007ffffe, 0xc217b818},
    {0x00000800, 0xc2262b27}, {0x00085680, 0xc21c76b7}, {0x002a7a36, 0xc219a2a5},
    {0x002692f0, 0xc219cd83}, {0x0068a093, 0xc21811c3}, {0x004d32b6, 0xc21898f8},
    {0x004b06ae, 0xc218a5a9},
};

constexpr point_of<std::uint64_t> log10_d_ha_points[] = {
    {0x3ff0000000000000, 0x0000000000000000}, {0x3fefffffffffffff, 0xbc8bcb7b1526e50f},
    {0x3ff0000000000001, 0x3c9bcb7b1526e50d}, {0x3fe5555555555555, 0xbfc68a288b60b7fd},
    {0x3fe5555555555556, 0xbfc68a288b60b7fa}, {0x3ff5555555555555, 0x3fbffbfc2bbc7802},
    {0x3ff5555555555556, 0x3fbffbfc2bbc7807}, {0x0010000000000000, 0xc0733a7146f72a42},
    {0x0010000000000001, 0xc0733a7146f72a42}, {0x7fefffffffffffff, 0x40734413509f79ff},
    {0x7fe0000000000000, 0x40733f424bcb5220}, {0x4000000000000000, 0x3fd34413509f79ff},
    {0x3fe0000000000000, 0xbfd34413509f79ff}, {0x4024000000000000, 0x3ff0000000000000},
    {0x408f400000000000, 0x4008000000000000}, {0x3ff00000000fffff, 0x3ddbcb7958614e00},
    {0x3feffe0000000000, 0xbf1bcc597a43d12b}, {0x4c5909cb00ddb74d, 0x404de632bb3740bd},
    {0x5aa521d5ad8d194a, 0x40601523e62090ba}, {0x08836c73568068b9, 0xc070aedecdf3c286},
    {0x2d8c27354f596727, 0xc05623bd81d455d8}, {0x273d1d13d18a669a, 0xc05dbcaa6fa92bb3},
    {0x593448c87b121dc5, 0x405e6e06b14fc638}, {0x3febd35350d7d13f, 0xbfaf1502291de6be},
    {0x3ffe3e117b3120df, 0x3fd1b220ae543e24}, {0x3feb458db4653252, 0xbfb1c6ae29a1b437},
    {0x3ff065480e979cf3, 0x3f85b9b94bf3bd1b}, {0x3ff6e3a3bff29101, 0x3fc3e7c87da264c7},
    {0x3ff9dff4d84a1d3a, 0x3fcab890fe305d1a}, {0x3ff69d3d82a250b9, 0x3fc33bc5e26cbb7f},
    {0x3ff69d3d19e61493, 0x3fc33bc4e0f793a8}, {0x3ff6a209b0928c65, 0x3fc3478fb69d14bb},
    {0x3ff69a0b834443aa, 0x3fc333ea8c82380f},
};

constexpr point_of<std::uint64_t> log10_d_la_points[] = {
    {0x3ff0000000000000, 0x0000000000000000}, {0x3fefffffffffffff, 0xbc8bcb7b1526e50e},
    {0x3ff0000000000001, 0x3c9bcb7b1526e50d}, {0x3fe5555555555555, 0xbfc68a288b60b7fe},
    {0x3fe5555555555556, 0xbfc68a288b60b7fb}, {0x3ff5555555555555, 0x3fbffbfc2bbc7801},
    {0x3ff5555555555556, 0x3fbffbfc2bbc7806}, {0x0010000000000000, 0xc0733a7146f72a42},
    {0x0010000000000001, 0xc0733a7146f72a42}, {0x7fefffffffffffff, 0x40734413509f79ff},
    {0x7fe0000000000000, 0x40733f424bcb5221}, {0x4000000000000000, 0x3fd34413509f79ff},
    {0x3fe0000000000000, 0xbfd34413509f79ff}, {0x4024000000000000, 0x3ff0000000000000},
    {0x408f400000000000, 0x4008000000000000}, {0x3ff00000000fffff, 0x3ddbcb7958614e00},
    {0x3feffe0000000000, 0xbf1bcc597a43d12a}, {0x4657caf704a012e8, 0x403ee09c598827e3},
    {0x35ac2184c9a937a6, 0xc048b662a2e1ad48}, {0x303cbdee5dbe4409, 0xc052e6bafe2b0c43},
    {0x6bbd8f129419cf4d, 0x406a5f9a21bd12a3}, {0x3a0614680252f615, 0xc03c753ded0cb2c7},
    {0x5aa7d29e0bf64ef7, 0x406016ce456bcd3d}, {0x3fe79e08324f3e81, 0xbfc0e2bcfb100045},
    {0x3fefbfe2c177f113, 0xbf6bf438d3480109}, {0x3ffd94c5f129c8c6, 0x3fd114cec727cf4e},
    {0x3ff00ea58652dbd0, 0x3f5965f937ad08e5}, {0x3ffd9f54c68deb5d, 0x3fd11eb8a0e0fd30},
    {0x3ff781cccc170c31, 0x3fc562ce2e169cb8}, {0x3ff69d3d82a250b9, 0x3fc33bc5e26cbb80},
    {0x3ff69d3d19e61493, 0x3fc33bc4e0f793a8}, {0x3ff6a209b0928c65, 0x3fc3478fb69d14bb},
    {0x3ff69a0b834443aa, 0x3fc333ea8c823810},
};

constexpr point_of<std::uint64_t> log10_d_ep_points[] = {
    {0x3ff0000000000000, 0x0000000000000000}, {0x3fefffffffffffff, 0xbc8bcb7b1526e50e},
    {0x3ff0000000000001, 0x3c9bcb7b1526e50d}, {0x3fe5555555555555, 0xbfc68a288b60b7fe},
    {0x3fe5555555555556, 0xbfc68a288b60b7fb}, {0x3ff5555555555555, 0x3fbffbfc2bbc7801},
    {0x3ff5555555555556, 0x3fbffbfc2bbc7806}, {0x0010000000000000, 0xc0733a7146f72a42},
    {0x0010000000000001, 0xc0733a7146f72a42}, {0x7fefffffffffffff, 0x40734413509f79ff},
    {0x7fe0000000000000, 0x40733f424bcb5221}, {0x4000000000000000, 0x3fd34413509f79ff},
    {0x3fe0000000000000, 0xbfd34413509f79ff}, {0x4024000000000000, 0x3ff0000000000002},
    {0x408f400000000000, 0x4008000000000017}, {0x3ff00000000fffff, 0x3ddbcb7958614e00},
    {0x3feffe0000000000, 0xbf1bcc597a4361f7}, {0x25eedd80dc14ed57, 0xc05f4fa04a9963b8},
    {0x377bc7ae0960afe9, 0xc04459a8e87024c6}, {0x7d4a4b49f21ff5eb, 0x4072786b2af82819},
    {0x1abf957a1757905e, 0xc06663cb0309b2cb}, {0x41b60db4573ac59a, 0x402122eadb83da53},
    {0x2e7a830e9c5f319e, 0xc055046bc2e9bf73}, {0x3fe97c09eb07c30d, 0xbfb94fc497f88438},
    {0x3ff1a4ae57079670, 0x3fa5bd3f791c69b4}, {0x3fe5e4878b8e8f4e, 0xbfc519d49fd3d96e},
    {0x3ff3984e5119cdcc, 0x3fb688bec74938f7}, {0x3ff3cba1b06dbee0, 0x3fb7aa7b33684afd},
    {0x3ffef67aff297d0e, 0x3fd259a0b5c6286a}, {0x3ff69d3d82a250b9, 0x3fc33bc5e26cbef7},
    {0x3ff69d3d19e61493, 0x3fc33bc4e0f7971e}, {0x3ff6a209b0928c65, 0x3fc3478fb69d14bc},
    {0x3ff69a0b834443aa, 0x3fc333ea8c823811},
};

constexpr point_of<std::uint64_t> log10_d_nolut_points[] = {
    {0x3ff0000000000000, 0x0000000000000000}, {0x3fefffffffffffff, 0xbc8bcb7b1526e50e},
    {0x3ff0000000000001, 0x3c9bcb7b1526e50d}, {0x3fe5555555555555, 0xbfc68a288b60b7fe},
    {0x3fe5555555555556, 0xbfc68a288b60b7fa}, {0x3ff5555555555555, 0x3fbffbfc2bbc7801},
    {0x3ff5555555555556, 0x3fbffbfc2bbc7808}, {0x0010000000000000, 0xc0733a7146f72a42},
    {0x0010000000000001, 0xc0733a7146f72a42}, {0x7fefffffffffffff, 0x40734413509f79ff},
    {0x7fe0000000000000, 0x40733f424bcb5221}, {0x4000000000000000, 0x3fd34413509f79ff},
    {0x3fe0000000000000, 0xbfd34413509f79ff}, {0x4024000000000000, 0x3ff0000000000000},
    {0x408f400000000000, 0x4008000000000000}, {0x3ff00000000fffff, 0x3ddbcb7958614e00},
    {0x3feffe0000000000, 0xbf1bcc597a43d12b}, {0x5c3d2e692959fea3, 0x40610a73096a81e1},
    {0x0a6cd6da0c6dea3d, 0xc0701ba1252a4b5a}, {0x4cf212c5fc985000, 0x404f556569b9c84a},
    {0x7648bf8a8895787f, 0x40705c8d4562d642}, {0x0422e3e667e84707, 0xc0720037a88f152b},
    {0x5eda9ee13cc21779, 0x40629dc1df6f54ee}, {0x3ff6015b980dc6ff, 0x3fc1b75550f9349e},
    {0x3ff0036cd3881a50, 0x3f37ca44635e7ad2}, {0x3fe951fc6bf84914, 0xbfba07d26b15016f},
    {0x3ff5634a7e5a3930, 0x3fc0225107c45118}, {0x3fed4078d6a34d3e, 0xbfa3f7613064098e},
    {0x3fe87f6bf325ffbe, 0xbfbdb3beb6e69140}, {0x3ff69d3d82a250b9, 0x3fc33bc5e26cbb80},
    {0x3ff69d3d19e61493, 0x3fc33bc4e0f793a8}, {0x3ff6a209b0928c65, 0x3fc3478fb69d14bb},
    {0x3ff69a0b834443aa, 0x3fc333ea8c82380f}, {0x0000000000000001, 0xc07434e6420f4374},
    {0x0000000000000003, 0xc0742d43f829af7e}, {0x0008000000000000, 0xc0733f424bcb5221},
    {0x000fffffffffffff, 0xc0733a7146f72a42}, {0x0000c9bae580c35f, 0xc0734f5d29bebbb9},
    {0x000000001b4c24c3, 0xc073aa537342611e}, {0x000000015f7cc5d9, 0xc0739891c24ddcd1},
    {0x00000000000006c3, 0xc074011631792f55},
};

constexpr point_of<std::uint64_t> log10_d_rare_points[] = {
    {0x3ff017ffffffffff, 0x3f64c9096b94be20}, {0x3ff0180000000000, 0x3f64c9096b94befd},
    {0x3ff0180000000001, 0x3f64c9096b94bfda}, {0x3fefcfffffffffff, 0xbf64e84e793a47ba},
    {0x3fefd00000000000, 0xbf64e84e793a474a}, {0x3fefd00000000001, 0xbf64e84e793a46db},
    {0x3ff0000000000000, 0x0000000000000000}, {0x3ff0000000000001, 0x3c9bcb7b1526e50d},
    {0x3fefffffffffffff, 0xbc8bcb7b1526e50f}, {0x3ff00c49ba5e353f, 0x3f55508231ba1336},
    {0x3fefeb851eb851ec, 0xbf51cf9c0e814053}, {0x3ff5000000000000, 0x3fbe3bc1ab0e19fe},
    {0x3fffffffffffffff, 0x3fd34413509f79fe}, {0x3fffe00000000000, 0x3fd32839e681fc62},
    {0x3fffdfffffffffff, 0x3fd32839e681fc61}, {0x3ff5555555555555, 0x3fbffbfc2bbc7802},
    {0x35e484ba4b78dc3d, 0xc0482dcc88867c09}, {0x3a1e836685ae8770, 0xc03c04361be19869},
    {0x7afa2a9dbac0d757, 0x4071c62cd085af26}, {0x3d69500e46273141, 0xc0284938bdcb457a},
    {0x3c339a18258170f9, 0xc031f93f3798e29a}, {0x305ffa73efe8b3b5, 0xc052bd3b9b498231},
    {0x6f25c38b56a68b41, 0x406c6d290fb14e03}, {0x0b78b6c37deaab64, 0xc06f95a4dc8bb446},
    {0x0010000000000000, 0xc0733a7146f72a42}, {0x7fefffffffffffff, 0x40734413509f79ff},
    {0x0000000000000001, 0xc07434e6420f4374}, {0x0000000000000003, 0xc0742d43f829af7e},
    {0x0008000000000000, 0xc0733f424bcb5220}, {0x000fffffffffffff, 0xc0733a7146f72a42},
    {0x0000008cc832652f, 0xc07378653485d0cc}, {0x000000105c7fe059, 0xc0738759da968d9f},
    {0x000000002c7445ee, 0xc073a6eff470ba91}, {0x00000119a9fd1cea, 0xc07373938e04a16f},
};

TEST(Log10Float, Points) {
  expect_points<log10_s<tier::ha>>(log10_s_ha_points);
  expect_points<log10_s<tier::ha>>(log10_s_ha_denormal_points);
  expect_points<log10_s<tier::la>>(log10_s_la_points);
  expect_points<log10_s<tier::ep>>(log10_s_ep_points);
}

TEST(Log10Double, Points) {
  expect_points<log10_d<tier::ha>>(log10_d_ha_points);
  expect_points<log10_d<tier::la>>(log10_d_la_points);
  expect_points<log10_d<tier::ep>>(log10_d_ep_points);
  expect_points<log10_d_nolut>(log10_d_nolut_points);
}

template <typename Body>
class Log10FloatTier : public ::testing::Test {};
using float_tiers = ::testing::Types<log10_s<tier::la>, log10_s<tier::ep>>;
TYPED_TEST_SUITE(Log10FloatTier, float_tiers);

TYPED_TEST(Log10FloatTier, RareAndDenormals) {
  expect_rare_points<TypeParam>(log10_s_rare_points);
  expect_points<TypeParam>(log10_s_denormal_points);
}

TYPED_TEST(Log10FloatTier, Specials) {
  expect_poles_and_domain<TypeParam>();
  expect_quiet_nans<TypeParam>();
}

TEST(Log10Float, SpecialsHa) { expect_every_nan_is_flagged<log10_s<tier::ha>>(); }

template <typename Body>
class Log10DoubleTier : public ::testing::Test {};
using double_tiers = ::testing::Types<log10_d<tier::ha>, log10_d<tier::la>, log10_d<tier::ep>>;
TYPED_TEST_SUITE(Log10DoubleTier, double_tiers);

TYPED_TEST(Log10DoubleTier, Rare) { expect_rare_points<TypeParam>(log10_d_rare_points); }

TYPED_TEST(Log10DoubleTier, Specials) {
  expect_poles_and_domain<TypeParam>();
  expect_quiet_nans<TypeParam>();
}

TEST(Log10Double, SpecialsWithoutTable) { expect_negative_keeps_its_pattern<log10_d_nolut>(); }

/// The exact powers of ten have exact logarithms where the sum is in two words.
TEST(Log10Double, PowersOfTen) {
  double x = 1;
  for (int k = 0; k <= 22; ++k, x *= 10) expect_number<log10_d<tier::ha>>(x, k);
}

TYPED_TEST(Log10FloatTier, MainPath) {
  expect_main_path_between<TypeParam>(0x00800000, 0x7f7fffff);
}

TEST(Log10Float, MainPathHa) {
  expect_main_path_between<log10_s<tier::ha>>(0x00800000, 0x7f7fffff);
}

TYPED_TEST(Log10DoubleTier, MainPath) {
  expect_main_path_between<TypeParam>(0x0010000000000000, 0x7fefffffffffffff);
}

TEST(Log10Double, MainPathWithoutTable) {
  expect_main_path_between<log10_d_nolut>(1, 0x7fefffffffffffff);
}

}  // namespace
