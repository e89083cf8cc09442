// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/log/log2.hpp"

#include "log_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::log2_d;
using scalar::log2_d_nolut;
using scalar::log2_s;
using scalar::tier;

constexpr point_of<std::uint32_t> log2_s_ha_points[] = {
    {0x3f800000, 0x00000000}, {0x3f7fffff, 0xb3b8aa3b}, {0x3f800001, 0x3438aa3a},
    {0x3f2aaaaa, 0xbf15c01c}, {0x3f2aaaab, 0xbf15c019}, {0x3f2aaaac, 0xbf15c017},
    {0x3faaaaaa, 0x3ed47fc9}, {0x3faaaaab, 0x3ed47fcd}, {0x3f400000, 0xbed47fcb},
    {0x3f3fffff, 0xbed47fcf}, {0x3fbfffff, 0x3f15c018}, {0x3fc00000, 0x3f15c01a},
    {0x00800000, 0xc2fc0000}, {0x00800001, 0xc2fc0000}, {0x7f7fffff, 0x43000000},
    {0x7f000000, 0x42fe0000}, {0x40000000, 0x3f800000}, {0x3f000000, 0xbf800000},
    {0x41200000, 0x40549a78}, {0x447a0000, 0x411f73da}, {0x503b3e22, 0x420631f0},
    {0x21326c1c, 0xc2721559}, {0x5f72e04c, 0x427fb241}, {0x2e647dde, 0xc208a7f0},
    {0x6648e71b, 0x429b4cfb}, {0x58e08fef, 0x424b3e6f}, {0x3f0ed9c5, 0xbf577576},
    {0x3fee6617, 0x3f65b111}, {0x3f7f83d4, 0xbb334fe4}, {0x3f1a8c82, 0xbf3a6381},
    {0x3f504ed1, 0xbe984846}, {0x3f39f621, 0xbeec1a95},
};

constexpr point_of<std::uint32_t> log2_s_la_points[] = {
    {0x3f800000, 0x00000000}, {0x3f7fffff, 0xb3b8aa3b}, {0x3f800001, 0x3438aa3a},
    {0x3f2aaaaa, 0xbf15c01c}, {0x3f2aaaab, 0xbf15c019}, {0x3f2aaaac, 0xbf15c017},
    {0x3faaaaaa, 0x3ed47fc9}, {0x3faaaaab, 0x3ed47fcd}, {0x3f400000, 0xbed47fcb},
    {0x3f3fffff, 0xbed47fce}, {0x3fbfffff, 0x3f15c019}, {0x3fc00000, 0x3f15c01a},
    {0x00800000, 0xc2fc0000}, {0x00800001, 0xc2fc0000}, {0x7f7fffff, 0x43000000},
    {0x7f000000, 0x42fe0000}, {0x40000000, 0x3f800000}, {0x3f000000, 0xbf800000},
    {0x41200000, 0x40549a78}, {0x447a0000, 0x411f73da}, {0x3016ecbf, 0xc1f61938},
    {0x3c8a7451, 0xc0bc601f}, {0x6fa93880, 0x42c0ce37}, {0x200fb2d4, 0xc27b5518},
    {0x313cace7, 0xc1e3859b}, {0x4619f4b4, 0x41544310}, {0x3f3435fd, 0xbf01a734},
    {0x3f7fa846, 0xbafd4b7f}, {0x3f06b6e7, 0xbf6d1e01}, {0x3f6ef735, 0xbdcb730d},
    {0x3fd0f92c, 0x3f35096c}, {0x3f8f1850, 0x3e24b066},
};

constexpr point_of<std::uint32_t> log2_s_ep_points[] = {
    {0x3f800000, 0x00000000}, {0x3f7fffff, 0xb3b8aaed}, {0x3f800001, 0x3438aaec},
    {0x3f2aaaaa, 0xbf15be80}, {0x3f2aaaab, 0xbf15be7e}, {0x3f2aaaac, 0xbf15be7c},
    {0x3faaaaaa, 0x3ed48301}, {0x3faaaaab, 0x3ed48304}, {0x3f400000, 0xbed481a8},
    {0x3f3fffff, 0xbed481ab}, {0x3fbfffff, 0x3f15bf2a}, {0x3fc00000, 0x3f15bf2c},
    {0x00800000, 0xc2fc0000}, {0x00800001, 0xc2fc0000}, {0x7f7fffff, 0x43000000},
    {0x7f000000, 0x42fe0000}, {0x40000000, 0x3f800000}, {0x3f000000, 0xbf800000},
    {0x41200000, 0x40549a2e}, {0x447a0000, 0x411f73da}, {0x17ce4158, 0xc29e9f98},
    {0x75cace10, 0x42d953f1}, {0x6f88e64e, 0x42c031a7}, {0x62834aa2, 0x428c12c1},
    {0x325914f8, 0xc1d1e735}, {0x14ede92f, 0xc2aa3621}, {0x3f24d43c, 0xbf229bd8},
    {0x3f470c85, 0xbeb9de72}, {0x3fe3c180, 0x3f54d382}, {0x3f40deb8, 0xbed12a99},
    {0x3f43b512, 0xbec66089}, {0x3f00e8a2, 0xbf7d631f},
};

constexpr point_of<std::uint32_t> log2_s_rare_points[] = {
    {0x3f80bfff, 0x3c0a1800}, {0x3f80c000, 0x3c0a1800}, {0x3f80c001, 0x3c0a1900},
    {0x3f7e7fff, 0xbc0ae800}, {0x3f7e8000, 0xbc0ae800}, {0x3f7e8001, 0xbc0ae800},
    {0x3f800000, 0x00000000}, {0x3f800001, 0x3438aa00}, {0x3f7fffff, 0xb3b8aa00},
    {0x3f80624e, 0x3b8d9d00}, {0x3f7f5c29, 0xbb6cab00}, {0x3fa80000, 0x3ec8ddd6},
    {0x3fffffff, 0x3f7ffffe}, {0x3fff0000, 0x3f7e8df2}, {0x3ffeffff, 0x3f7e8df2},
    {0x3faaaaaa, 0x3ed47fc8}, {0x7c815c33, 0x42f407cf}, {0x1b3729c6, 0xc290f74e},
    {0x7b2a7591, 0x42eed39a}, {0x702a9eba, 0x42c2d44c}, {0x25d04b74, 0xc24d30a8},
    {0x7bb2ea69, 0x42f0f75e}, {0x45b46c6e, 0x4147ec85}, {0x17b266aa, 0xc29f0ac3},
    {0x00800000, 0xc2fc0000}, {0x7f7fffff, 0x43000000}, {0x00000001, 0xc3150000},
    {0x00000002, 0xc3140000}, {0x00000003, 0xc3136a40}, {0x00400000, 0xc2fe0000},
    {0x007fffff, 0xc2fc0000}, {0x007ffffe, 0xc2fc0000}, {0x00000800, 0xc30a0000},
    {0x007bb862, 0xc2fc191f}, {0x007b8848, 0xc2fc1a3e}, {0x00726621, 0xc2fc52fb},
    {0x00310d78, 0xc2fec47a}, {0x00263eb7, 0xc2ff7c50}, {0x0002c2d1, 0xc30388e9},
};

constexpr point_of<std::uint32_t> log2_s_ha_denormal_points[] = {
    {0x00000001, 0xc3150000}, {0x00000002, 0xc3140000}, {0x00000003, 0xc3136a40},
    {0x00400000, 0xc2fe0000}, {0x007fffff, 0xc2fc0000}, {0x007ffffe, 0xc2fc0000},
    {0x00000800, 0xc30a0000}, {0x002e3b79, 0xc2fef037}, {0x00351baa, 0xc2fe89cd},
    {0x00153e0d, 0xc3009754}, {0x0077c80e, 0xc2fc3105}, {0x0012a65d, 0xc300c766},
    {0x0021c497, 0xc2ffd847},
};

constexpr point_of<std::uint32_t> log2_s_denormal_points[] = {
    {0x00000001, 0xc3150000}, {0x00000002, 0xc3140000}, {0x00000003, 0xc3136a40},
    {0x00400000, 0xc2fe0000}, {0x007fffff, 0xc2fc0000}, {0x007ffffe, 0xc2fc0000},
    {0x00000800, 0xc30a0000}, {0x00085680, 0xc301f0b9}, {0x002a7a36, 0xc2ff2ec9},
    {0x002692f0, 0xc2ff75fd}, {0x0068a093, 0xc2fc94ef}, {0x004d32b6, 0xc2fd7582},
    {0x004b06ae, 0xc2fd8a96},
};

constexpr point_of<std::uint64_t> log2_d_ha_points[] = {
    {0x3ff0000000000000, 0x0000000000000000}, {0x3fefffffffffffff, 0xbca71547652b82fe},
    {0x3ff0000000000001, 0x3cb71547652b82fd}, {0x3fe5555555555555, 0xbfe2b803473f7ad2},
    {0x3fe5555555555556, 0xbfe2b803473f7ad0}, {0x3ff5555555555555, 0x3fda8ff971810a5d},
    {0x3ff5555555555556, 0x3fda8ff971810a61}, {0x0010000000000000, 0xc08ff00000000000},
    {0x0010000000000001, 0xc08ff00000000000}, {0x7fefffffffffffff, 0x4090000000000000},
    {0x7fe0000000000000, 0x408ff80000000000}, {0x4000000000000000, 0x3ff0000000000000},
    {0x3fe0000000000000, 0xbff0000000000000}, {0x4024000000000000, 0x400a934f0979a371},
    {0x408f400000000000, 0x4023ee7b471b3a95}, {0x3ff00000000fffff, 0x3df71545f3cb8209},
    {0x3feffe0000000000, 0xbf3716001718cb2b}, {0x4c5909cb00ddb74d, 0x4068d4ac8a508e06},
    {0x5aa521d5ad8d194a, 0x407ab66c01ae9efc}, {0x08836c73568068b9, 0xc08bb5c316fd96bd},
    {0x2d8c27354f596727, 0xc07262f4d6d2fb33}, {0x273d1d13d18a669a, 0xc078b22e9c3d4182},
    {0x593448c87b121dc5, 0x4079457a07727a98}, {0x3febd35350d7d13f, 0xbfc9d02708669125},
    {0x3ffe3e117b3120df, 0x3fed64611186a1f3}, {0x3feb458db4653252, 0xbfcd868433481621},
    {0x3ff065480e979cf3, 0x3fa20ae961db362d}, {0x3ff6e3a3bff29101, 0x3fe087f4d130e486},
    {0x3ff9dff4d84a1d3a, 0x3fe630f7a826687f}, {0x3ff69d3d82a250b9, 0x3fdff235bc85dd73},
    {0x3ff69d3d19e61493, 0x3fdff23410e5208c}, {0x3ff6a209b0928c65, 0x3fe002e51eeeb6be},
    {0x3ff69a0b834443aa, 0x3fdfe528faf3cdf4},
};

constexpr point_of<std::uint64_t> log2_d_la_points[] = {
    {0x3ff0000000000000, 0x0000000000000000}, {0x3fefffffffffffff, 0xbca71547652b82fe},
    {0x3ff0000000000001, 0x3cb71547652b82fd}, {0x3fe5555555555555, 0xbfe2b803473f7ad2},
    {0x3fe5555555555556, 0xbfe2b803473f7ad0}, {0x3ff5555555555555, 0x3fda8ff971810a5d},
    {0x3ff5555555555556, 0x3fda8ff971810a61}, {0x0010000000000000, 0xc08ff00000000000},
    {0x0010000000000001, 0xc08ff00000000000}, {0x7fefffffffffffff, 0x4090000000000000},
    {0x7fe0000000000000, 0x408ff80000000000}, {0x4000000000000000, 0x3ff0000000000000},
    {0x3fe0000000000000, 0xbff0000000000000}, {0x4024000000000000, 0x400a934f0979a371},
    {0x408f400000000000, 0x4023ee7b471b3a95}, {0x3ff00000000fffff, 0x3df71545f3cb8209},
    {0x3feffe0000000000, 0xbf3716001718cb2b}, {0x4657caf704a012e8, 0x4059a4a31aa071e6},
    {0x35ac2184c9a937a6, 0xc06485f303085737}, {0x303cbdee5dbe4409, 0xc06f64f51171e18c},
    {0x6bbd8f129419cf4d, 0x4085e7158b484289}, {0x3a0614680252f615, 0xc057a2432ef14ae5},
    {0x5aa7d29e0bf64ef7, 0x407ab930320e978e}, {0x3fe79e08324f3e81, 0xbfdc0be9a9c1a492},
    {0x3fefbfe2c177f113, 0xbf87371d1be84f6f}, {0x3ffd94c5f129c8c6, 0x3fec5f139040f61c},
    {0x3ff00ea58652dbd0, 0x3f7517c5a958d4f6}, {0x3ffd9f54c68deb5d, 0x3fec6f8ad786b7eb},
    {0x3ff781cccc170c31, 0x3fe1c2ba3ad82dd1}, {0x3ff69d3d82a250b9, 0x3fdff235bc85dd74},
    {0x3ff69d3d19e61493, 0x3fdff23410e5208c}, {0x3ff6a209b0928c65, 0x3fe002e51eeeb6be},
    {0x3ff69a0b834443aa, 0x3fdfe528faf3cdf4},
};

constexpr point_of<std::uint64_t> log2_d_ep_points[] = {
    {0x3ff0000000000000, 0x0000000000000000}, {0x3fefffffffffffff, 0xbca71547652b82fe},
    {0x3ff0000000000001, 0x3cb71547652b82fd}, {0x3fe5555555555555, 0xbfe2b803473f7ad2},
    {0x3fe5555555555556, 0xbfe2b803473f7ad0}, {0x3ff5555555555555, 0x3fda8ff971810a5d},
    {0x3ff5555555555556, 0x3fda8ff971810a61}, {0x0010000000000000, 0xc08ff00000000000},
    {0x0010000000000001, 0xc08ff00000000000}, {0x7fefffffffffffff, 0x4090000000000000},
    {0x7fe0000000000000, 0x408ff80000000000}, {0x4000000000000000, 0x3ff0000000000000},
    {0x3fe0000000000000, 0xbff0000000000000}, {0x4024000000000000, 0x400a934f0979a374},
    {0x408f400000000000, 0x4023ee7b471b3aa8}, {0x3ff00000000fffff, 0x3df71545f3cb8209},
    {0x3feffe0000000000, 0xbf37160017186ed1}, {0x25eedd80dc14ed57, 0xc07a00d55acc73eb},
    {0x377bc7ae0960afe9, 0xc060e68760267158}, {0x7d4a4b49f21ff5eb, 0x408eadbbbbef54e2},
    {0x1abf957a1757905e, 0xc0829826ac0c321e}, {0x41b60db4573ac59a, 0x403c768319049540},
    {0x2e7a830e9c5f319e, 0xc0717457c68878e5}, {0x3fe97c09eb07c30d, 0xbfd50554af00066d},
    {0x3ff1a4ae57079670, 0x3fc20dd69f9fffe1}, {0x3fe5e4878b8e8f4e, 0xbfe1861f889eb9aa},
    {0x3ff3984e5119cdcc, 0x3fd2b6d6d6921075}, {0x3ff3cba1b06dbee0, 0x3fd3a775b39af318},
    {0x3ffef67aff297d0e, 0x3fee7a97414f7b6a}, {0x3ff69d3d82a250b9, 0x3fdff235bc85e334},
    {0x3ff69d3d19e61493, 0x3fdff23410e5264b}, {0x3ff6a209b0928c65, 0x3fe002e51eeeb6c0},
    {0x3ff69a0b834443aa, 0x3fdfe528faf3cdf6},
};

constexpr point_of<std::uint64_t> log2_d_nolut_points[] = {
    {0x3ff0000000000000, 0x0000000000000000}, {0x3fefffffffffffff, 0xbca71547652b82fe},
    {0x3ff0000000000001, 0x3cb71547652b82fd}, {0x3fe5555555555555, 0xbfe2b803473f7ad2},
    {0x3fe5555555555556, 0xbfe2b803473f7acf}, {0x3ff5555555555555, 0x3fda8ff971810a5c},
    {0x3ff5555555555556, 0x3fda8ff971810a61}, {0x0010000000000000, 0xc08ff00000000000},
    {0x0010000000000001, 0xc08ff00000000000}, {0x7fefffffffffffff, 0x4090000000000000},
    {0x7fe0000000000000, 0x408ff80000000000}, {0x4000000000000000, 0x3ff0000000000000},
    {0x3fe0000000000000, 0xbff0000000000000}, {0x4024000000000000, 0x400a934f0979a371},
    {0x408f400000000000, 0x4023ee7b471b3a95}, {0x3ff00000000fffff, 0x3df71545f3cb8209},
    {0x3feffe0000000000, 0xbf3716001718cb2c}, {0x5c3d2e692959fea3, 0x407c4ddf1de301e4},
    {0x0a6cd6da0c6dea3d, 0xc08ac13346dfd6ab}, {0x4cf212c5fc985000, 0x406a05a013de1ca6},
    {0x7648bf8a8895787f, 0x408b2d08b558115a}, {0x0422e3e667e84707, 0xc08de6155d00ee10},
    {0x5eda9ee13cc21779, 0x407eebc0663d3c57}, {0x3ff6015b980dc6ff, 0x3fdd6d06871ff64e},
    {0x3ff0036cd3881a50, 0x3f53c1db7d4964b2}, {0x3fe951fc6bf84914, 0xbfd59e2f30a197ba},
    {0x3ff5634a7e5a3930, 0x3fdacc4ea8146bb2}, {0x3fed4078d6a34d3e, 0xbfc094e8ae68fb7f},
    {0x3fe87f6bf325ffbe, 0xbfd8aac6053dd1ba}, {0x3ff69d3d82a250b9, 0x3fdff235bc85dd74},
    {0x3ff69d3d19e61493, 0x3fdff23410e5208c}, {0x3ff6a209b0928c65, 0x3fe002e51eeeb6be},
    {0x3ff69a0b834443aa, 0x3fdfe528faf3cdf4}, {0x0000000000000001, 0xc090c80000000000},
    {0x0000000000000003, 0xc090c1a8ff971811}, {0x0008000000000000, 0xc08ff80000000000},
    {0x000fffffffffffff, 0xc08ff00000000000}, {0x0000c9bae580c35f, 0xc090095ff78874b0},
    {0x000000001b4c24c3, 0xc09054eacf501458}, {0x000000015f7cc5d9, 0xc090462bb1e916c5},
    {0x00000000000006c3, 0xc0909cf86ec0ddd0},
};

constexpr point_of<std::uint64_t> log2_d_rare_points[] = {
    {0x3fef7fffffffffff, 0xbf9743ee861f3585}, {0x3fef800000000000, 0xbf9743ee861f3556},
    {0x3fef800000000001, 0xbf9743ee861f3527}, {0x3ff04fffffffffff, 0x3f9c9363ba850f2c},
    {0x3ff0500000000000, 0x3f9c9363ba850f86}, {0x3ff0500000000001, 0x3f9c9363ba850fe1},
    {0x3fefffefffffffff, 0xbee7154d2a80ba0f}, {0x3feffff000000000, 0xbee7154d2a7f48ba},
    {0x3feffff000000001, 0xbee7154d2a7dd765}, {0x3ff00007ffffffff, 0x3ee715419fd8b37c},
    {0x3ff0000800000000, 0x3ee715419fdb9623}, {0x3ff0000800000001, 0x3ee715419fde78cb},
    {0x3feffffffffe0000, 0xbdb71547652c3ba8}, {0x3fefffffffffffff, 0xbca71547652b82fe},
    {0x3ff0000000000000, 0x0000000000000000}, {0x3ff0000000000001, 0x3cb71547652b82fd},
    {0x3fefffffffd00000, 0xbe014ff58bed9e37}, {0x3fefffffffbfffff, 0xbe071547c197b5db},
    {0x3fefffffffc00000, 0xbe07154765429845}, {0x3ff00000001fffff, 0x3e071546ac6a328f},
    {0x3ff0000000200000, 0x3e07154765146db7}, {0x3ff0300000000123, 0x3f91363117a9e2ca},
    {0x3feff00012345678, 0xbf671af45393e0be}, {0x3feff00000000000, 0xbf671b0ea42e5fda},
    {0x3ff5000000000000, 0x3fd91bba891f1709}, {0x3fffffffffffffff, 0x3fefffffffffffff},
    {0x3fffe00000000000, 0x3fefd1be4c7f2af9}, {0x3fffdfffffffffff, 0x3fefd1be4c7f2af8},
    {0x3ff5555555555555, 0x3fda8ff971810a5d}, {0x35e484ba4b78dc3d, 0xc06414844aba29cf},
    {0x3a1e836685ae8770, 0xc057446481e8a33c}, {0x7afa2a9dbac0d757, 0x408d85ad5b98e7e3},
    {0x3d69500e46273141, 0xc0442b4a72d203a7}, {0x3c339a18258170f9, 0xc04dda8178743777},
    {0x305ffa73efe8b3b5, 0xc06f200801695dae}, {0x6f25c38b56a68b41, 0x40879b8d0748461f},
    {0x0b78b6c37deaab64, 0xc08a3afb634fca3d}, {0x0010000000000000, 0xc08ff00000000000},
    {0x7fefffffffffffff, 0x4090000000000000}, {0x0000000000000001, 0xc090c80000000000},
    {0x0000000000000003, 0xc090c1a8ff971811}, {0x0008000000000000, 0xc08ff80000000000},
    {0x000fffffffffffff, 0xc08ff00000000000}, {0x0000008cc832652f, 0xc0902b736293b92f},
    {0x000000105c7fe059, 0xc09037df024c971f}, {0x000000002c7445ee, 0xc090521a5ed887fd},
    {0x00000119a9fd1cea, 0xc0902772dc4ee0eb},
};

TEST(Log2Float, Points) {
  expect_points<log2_s<tier::ha>>(log2_s_ha_points);
  expect_points<log2_s<tier::ha>>(log2_s_ha_denormal_points);
  expect_points<log2_s<tier::la>>(log2_s_la_points);
  expect_points<log2_s<tier::ep>>(log2_s_ep_points);
}

TEST(Log2Double, Points) {
  expect_points<log2_d<tier::ha>>(log2_d_ha_points);
  expect_points<log2_d<tier::la>>(log2_d_la_points);
  expect_points<log2_d<tier::ep>>(log2_d_ep_points);
  expect_points<log2_d_nolut>(log2_d_nolut_points);
}

template <typename Body>
class Log2FloatTier : public ::testing::Test {};
using float_tiers = ::testing::Types<log2_s<tier::la>, log2_s<tier::ep>>;
TYPED_TEST_SUITE(Log2FloatTier, float_tiers);

TYPED_TEST(Log2FloatTier, RareAndDenormals) {
  expect_rare_points<TypeParam>(log2_s_rare_points);
  expect_points<TypeParam>(log2_s_denormal_points);
}

TYPED_TEST(Log2FloatTier, Specials) {
  expect_poles_and_domain<TypeParam>();
  expect_quiet_nans<TypeParam>();
}

TEST(Log2Float, SpecialsHa) { expect_every_nan_is_flagged<log2_s<tier::ha>>(); }

template <typename Body>
class Log2DoubleTier : public ::testing::Test {};
using double_tiers = ::testing::Types<log2_d<tier::ha>, log2_d<tier::la>, log2_d<tier::ep>>;
TYPED_TEST_SUITE(Log2DoubleTier, double_tiers);

TYPED_TEST(Log2DoubleTier, Rare) { expect_rare_points<TypeParam>(log2_d_rare_points); }

TYPED_TEST(Log2DoubleTier, Specials) {
  expect_poles_and_domain<TypeParam>();
  expect_quiet_nans<TypeParam>();
  expect_rare<TypeParam>(named<std::uint64_t>::one, std::uint64_t{0}, none);
}

TEST(Log2Double, SpecialsWithoutTable) { expect_negative_keeps_its_pattern<log2_d_nolut>(); }

template <typename Body>
class Log2 : public ::testing::Test {};
using bodies = ::testing::Types<log2_s<tier::ha>, log2_s<tier::la>, log2_s<tier::ep>,
                                log2_d<tier::ha>, log2_d<tier::la>, log2_d<tier::ep>, log2_d_nolut>;
TYPED_TEST_SUITE(Log2, bodies);

/// Powers of two, the denormal ones included, are exact in every tier.
TYPED_TEST(Log2, PowersOfTwo) {
  using T = typename TypeParam::input_type;
  using limits = std::numeric_limits<T>;
  for (int k = limits::min_exponent - limits::digits; k < limits::max_exponent; ++k)
    expect_number<TypeParam>(std::ldexp(T(1), k), static_cast<T>(k));
}

TYPED_TEST(Log2FloatTier, MainPath) { expect_main_path_between<TypeParam>(0x00800000, 0x7f7fffff); }

TEST(Log2Float, MainPathHa) { expect_main_path_between<log2_s<tier::ha>>(0x00800000, 0x7f7fffff); }

TYPED_TEST(Log2DoubleTier, MainPath) {
  expect_main_path_between<TypeParam>(0x0010000000000000, 0x7fefffffffffffff);
}

TEST(Log2Double, MainPathWithoutTable) {
  expect_main_path_between<log2_d_nolut>(1, 0x7fefffffffffffff);
}

}  // namespace
