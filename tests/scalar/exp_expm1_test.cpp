// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/exp/expm1.hpp"

#include <limits>

#include "exp_points.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::expm1_d;
using scalar::expm1_s;
using scalar::tier;

constexpr point_of<std::uint32_t> expm1_s_ha_points[] = {
    {0x00000000, 0x00000000, none}, {0x80000000, 0x80000000, none}, {0x00000001, 0x00000001, none},
    {0x80000001, 0x80000001, none}, {0x007fffff, 0x007fffff, none}, {0x33000000, 0x33000000, none},
    {0xb3000000, 0xb3000000, none}, {0x3f800000, 0x3fdbf0a9, none}, {0xbf800000, 0xbf21d2a7, none},
    {0x3eb17218, 0x3ed413cd, none}, {0x3eb17219, 0x3ed413ce, none}, {0xbeb17219, 0xbe95f61a, none},
    {0x3f19999a, 0x3f527661, none}, {0xbf19999a, 0xbee7022a, none}, {0x3f333333, 0x3f81c2a6, none},
    {0xbf333333, 0xbf00dfc9, none}, {0x38d1b717, 0x38d1b9c6, none}, {0xb8d1b717, 0xb8d1b468, none},
    {0xc1200000, 0xbf7ffd06, none}, {0xc1880000, 0xbf7fffff, none}, {0xc1a00000, 0xbf800000, none},
    {0x42adcccd, 0x7e2571ba, none}, {0x42af0000, 0x7e96bab3, none}, {0x42b10000, 0x7f4cdcc4, none},
    {0x42b170a4, 0x7f7f4648, none}, {0x42b175c3, 0x7f800000, over}, {0x42b20000, 0x7f800000, over},
    {0x42fe0000, 0x7f800000, over}, {0xc2b00000, 0xbf800000, none}, {0x42adffff, 0x7e36d7ad, none},
    {0x42ae0000, 0x7e36d809, none}, {0x42ae0001, 0x7e36d864, none}, {0x42ffffff, 0x7f800000, over},
    {0x43000000, 0x7f800000, over}, {0x43000001, 0x7f800000, over}, {0xc2adffff, 0xbf800000, none},
    {0xc2ae0000, 0xbf800000, none}, {0xc2ae0001, 0xbf800000, none}, {0xc2ffffff, 0xbf800000, none},
    {0xc3000000, 0xbf800000, none}, {0xc3000001, 0xbf800000, none}, {0x3f317217, 0x3f7ffffe, none},
    {0x3f317218, 0x3f800000, none}, {0x3f317219, 0x3f800001, none}, {0xc0f32dbb, 0xbf7fdf2e, none},
    {0xc1319366, 0xbf7fff02, none}, {0x41426fd9, 0x48391670, none}, {0xc1273c2f, 0xbf7ffe1b, none},
    {0xc1481150, 0xbf7fffc2, none}, {0xc025ccd6, 0xbf6cce92, none}, {0x40fd8666, 0x452c616f, none},
    {0xc17ed242, 0xbf7ffffe, none}, {0xc0e3e230, 0xbf7fcb12, none}, {0xc0d4cb9b, 0xbf7fab2f, none},
    {0x41557703, 0x4917fc65, none}, {0xc01d9e09, 0xbf6a306d, none},
};

constexpr point_of<std::uint32_t> expm1_s_la_points[] = {
    {0x00000000, 0x00000000, none}, {0x80000000, 0x80000000, none}, {0x00000001, 0x00000001, none},
    {0x80000001, 0x80000001, none}, {0x007fffff, 0x007fffff, none}, {0x33000000, 0x33000000, none},
    {0xb3000000, 0xb3000000, none}, {0x3f800000, 0x3fdbf0a8, none}, {0xbf800000, 0xbf21d2a7, none},
    {0x3eb17218, 0x3ed413cd, none}, {0x3eb17219, 0x3ed413ce, none}, {0xbeb17219, 0xbe95f61a, none},
    {0x3f19999a, 0x3f527662, none}, {0xbf19999a, 0xbee70229, none}, {0x3f333333, 0x3f81c2a6, none},
    {0xbf333333, 0xbf00dfc9, none}, {0x38d1b717, 0x38d1b9c6, none}, {0xb8d1b717, 0xb8d1b468, none},
    {0xc1200000, 0xbf7ffd06, none}, {0xc1880000, 0xbf7fffff, none}, {0xc1a00000, 0xbf800000, none},
    {0x42adcccd, 0x7e2571ba, none}, {0x42af0000, 0x7e96bab4, none}, {0x42b10000, 0x7f4cdcc4, none},
    {0x42b170a4, 0x7f7f4648, none}, {0x42b175c3, 0x7f800000, over}, {0x42b20000, 0x7f800000, over},
    {0x42fe0000, 0x7f800000, over}, {0xc2b00000, 0xbf800000, none}, {0x42adffff, 0x7e36d7ad, none},
    {0x42ae0000, 0x7e36d809, none}, {0x42ae0001, 0x7e36d864, none}, {0x42ffffff, 0x7f800000, over},
    {0x43000000, 0x7f800000, over}, {0x43000001, 0x7f800000, over}, {0xc2adffff, 0xbf800000, none},
    {0xc2ae0000, 0xbf800000, none}, {0xc2ae0001, 0xbf800000, none}, {0xc2ffffff, 0xbf800000, none},
    {0xc3000000, 0xbf800000, none}, {0xc3000001, 0xbf800000, none}, {0x3f317217, 0x3f7ffffe, none},
    {0x3f317218, 0x3f800000, none}, {0x3f317219, 0x3f800001, none}, {0x41638ae3, 0x49b72f3c, none},
    {0xc153a879, 0xbf7fffe2, none}, {0xc0d102ca, 0xbf7fa089, none}, {0x40c04c25, 0x43cb191b, none},
    {0x417655bc, 0x4a94394b, none}, {0xbffa5b58, 0xbf5bcae5, none}, {0xc12ffb70, 0xbf7ffee7, none},
    {0xc1729c94, 0xbf7ffffc, none}, {0x3f97b186, 0x40115890, none}, {0xc145e2b4, 0xbf7fffb9, none},
    {0x41445662, 0x48506e9a, none}, {0x41589ff8, 0x49392c24, none},
};

constexpr point_of<std::uint32_t> expm1_s_ep_points[] = {
    {0x00000000, 0x00000000, none}, {0x80000000, 0x80000000, none}, {0x00000001, 0x00000001, none},
    {0x80000001, 0x80000001, none}, {0x007fffff, 0x0080000b, none}, {0x33000000, 0x3300000c, none},
    {0xb3000000, 0xb300000c, none}, {0x3f800000, 0x3fdbf06e, none}, {0xbf800000, 0xbf21d2c0, none},
    {0x3eb17218, 0x3ed4136f, none}, {0x3eb17219, 0x3ed41370, none}, {0xbeb17219, 0xbe95f660, none},
    {0x3f19999a, 0x3f5276e0, none}, {0xbf19999a, 0xbee7013a, none}, {0x3f333333, 0x3f81c2a6, none},
    {0xbf333333, 0xbf00dfc9, none}, {0x38d1b717, 0x38d1b9d9, none}, {0xb8d1b717, 0xb8d1b47b, none},
    {0xc1200000, 0xbf7ffd06, none}, {0xc1880000, 0xbf7fffff, none}, {0xc1a00000, 0xbf800000, none},
    {0x42adcccd, 0x7e25719a, none}, {0x42af0000, 0x7e96baa0, none}, {0x42b10000, 0x7f4cdcdc, none},
    {0x42b170a4, 0x7f7f45fa, none}, {0x42b175c3, 0x7f800000, over}, {0x42b20000, 0x7f800000, over},
    {0x42fe0000, 0x7f800000, over}, {0xc2b00000, 0xbf800000, none}, {0x42adffff, 0x7e36d795, none},
    {0x42ae0000, 0x7e36d7f1, none}, {0x42ae0001, 0x7e36d84c, none}, {0x42ffffff, 0x7f800000, over},
    {0x43000000, 0x7f800000, over}, {0x43000001, 0x7f800000, over}, {0xc2adffff, 0xbf800000, none},
    {0xc2ae0000, 0xbf800000, none}, {0xc2ae0001, 0xbf800000, none}, {0xc2ffffff, 0xbf800000, none},
    {0xc3000000, 0xbf800000, none}, {0xc3000001, 0xbf800000, none}, {0x3f317217, 0x3f7fff59, none},
    {0x3f317218, 0x3f800000, none}, {0x3f317219, 0x3f800001, none}, {0xc14a8138, 0xbf7fffcb, none},
    {0xc10db377, 0xbf7ff6aa, none}, {0x41449ffa, 0x48543628, none}, {0x40b5ae00, 0x43919b7d, none},
    {0x41440149, 0x484c2590, none}, {0xc0c609bb, 0xbf7f797c, none}, {0xc16cffbb, 0xbf7ffffa, none},
    {0xc1052814, 0xbf7ff012, none}, {0x413c1256, 0x47f8ac98, none}, {0xc11272c5, 0xbf7ff90f, none},
    {0xc0c4aaa1, 0xbf7f7398, none}, {0xc054b8af, 0xbf76c794, none},
};

constexpr point_of<std::uint64_t> expm1_d_ha_points[] = {
    {0x0000000000000000, 0x0000000000000000, none}, {0x8000000000000000, 0x0000000000000000, none},
    {0x0000000000000001, 0x0000000000000001, none}, {0x8000000000000001, 0x8000000000000001, none},
    {0x3c80000000000000, 0x3c80000000000000, none}, {0xbc80000000000000, 0xbc80000000000000, none},
    {0x3ff0000000000000, 0x3ffb7e151628aed3, none}, {0xbff0000000000000, 0xbfe43a54e4e98864, none},
    {0x3fd62e42fefa39ef, 0x3fda827999fcef32, none}, {0x3fe62e42fefa39f0, 0x3ff0000000000001, none},
    {0x3fe3333333333333, 0x3fea4ecc162353de, none}, {0xbfe3333333333333, 0xbfdce04528d3f639, none},
    {0x3fe6666666666666, 0x3ff03854c24d130d, none}, {0xbfe6666666666666, 0xbfe01bf92311555f, none},
    {0x3f1a36e2eb1c432d, 0x3f1a3738d2137388, none}, {0xbf1a36e2eb1c432d, 0xbf1a368d059c5f9d, none},
    {0x01a56e1fc2f8f359, 0x01a56e1fc2f8f359, none}, {0x81a56e1fc2f8f359, 0x81a56e1fc2f8f359, none},
    {0xc024000000000000, 0xbfefffa0ca192a6e, none}, {0xc042000000000000, 0xbfeffffffffffffe, none},
    {0xc044000000000000, 0xbff0000000000000, none}, {0xc085e00000000000, 0xbff0000000000000, none},
    {0x4086180000000000, 0x7fafad7b30b5865e, none}, {0x4086240000000000, 0x7fd1bf058bc994ad, none},
    {0x40862c0000000000, 0x7fe81e9b4b52d0c9, none}, {0x40862e0000000000, 0x7feef85a11e73f2d, none},
    {0x40862e6666666666, 0x7ff0000000000000, over}, {0x408f400000000000, 0x7ff0000000000000, over},
    {0xc08f400000000000, 0xbff0000000000000, none}, {0x7e37e43c8800759c, 0x7ff0000000000000, over},
    {0xfe37e43c8800759c, 0xbff0000000000000, none}, {0x4086200000000000, 0x7fc586f6bf260cf1, none},
    {0x408620000fffffff, 0x7fc58721cd3e9696, none}, {0x4086200010000000, 0x7fc58721cd3e9947, none},
    {0x4086200010000001, 0x7fc58721cd3e9bf8, none}, {0x408fffffefffffff, 0x7ff0000000000000, over},
    {0x408ffffff0000000, 0x7ff0000000000000, over}, {0x4090000000000000, 0x7ff0000000000000, over},
    {0xc086200000000000, 0xbff0000000000000, none}, {0xc08620000fffffff, 0xbff0000000000000, none},
    {0xc086200010000000, 0xbff0000000000000, none}, {0xc086200010000001, 0xbff0000000000000, none},
    {0xc08fffffefffffff, 0xbff0000000000000, none}, {0xc08ffffff0000000, 0xbff0000000000000, none},
    {0xc090000000000000, 0xbff0000000000000, none}, {0xc019ac5839444718, 0xbfeff2a2aac62625, none},
    {0xc01cf3f2be9406e0, 0xbfeffa1d06352c4b, none}, {0x4040d3122010fae2, 0x42f7591bae15c2a3, none},
    {0xc03b8529f201191c, 0xbfefffffffffd8b1, none}, {0xc043d043629cfd21, 0xbff0000000000000, none},
    {0x4041bb100929a692, 0x4321e07c87e1b7b9, none}, {0x403e65f4603a02c4, 0x42acf2d41e8f0912, none},
    {0x404379feee8cfaea, 0x437258b4749e5e13, none}, {0xc01501dbc9a527e8, 0xbfefd5171c9ff65a, none},
    {0x404201a67cedc59c, 0x432f07d97d31128d, none}, {0x40411857b9961756, 0x43040e77c0b03a00, none},
    {0xc0363b94ebad43fb, 0xbfefffffffe19f57, none},
};

constexpr point_of<std::uint64_t> expm1_d_la_points[] = {
    {0x0000000000000000, 0x0000000000000000, none}, {0x8000000000000000, 0x0000000000000000, none},
    {0x0000000000000001, 0x0000000000000001, none}, {0x8000000000000001, 0x8000000000000001, none},
    {0x3c80000000000000, 0x3c80000000000000, none}, {0xbc80000000000000, 0xbc80000000000000, none},
    {0x3ff0000000000000, 0x3ffb7e151628aed3, none}, {0xbff0000000000000, 0xbfe43a54e4e98864, none},
    {0x3fd62e42fefa39ef, 0x3fda827999fcef32, none}, {0x3fe62e42fefa39f0, 0x3ff0000000000001, none},
    {0x3fe3333333333333, 0x3fea4ecc162353de, none}, {0xbfe3333333333333, 0xbfdce04528d3f639, none},
    {0x3fe6666666666666, 0x3ff03854c24d130d, none}, {0xbfe6666666666666, 0xbfe01bf92311555f, none},
    {0x3f1a36e2eb1c432d, 0x3f1a3738d2137389, none}, {0xbf1a36e2eb1c432d, 0xbf1a368d059c5f9c, none},
    {0x01a56e1fc2f8f359, 0x01a56e1fc2f8f359, none}, {0x81a56e1fc2f8f359, 0x81a56e1fc2f8f359, none},
    {0xc024000000000000, 0xbfefffa0ca192a6e, none}, {0xc042000000000000, 0xbfeffffffffffffe, none},
    {0xc044000000000000, 0xbff0000000000000, none}, {0xc085e00000000000, 0xbff0000000000000, none},
    {0x4086180000000000, 0x7fafad7b30b5865e, none}, {0x4086240000000000, 0x7fd1bf058bc994ad, none},
    {0x40862c0000000000, 0x7fe81e9b4b52d0c9, none}, {0x40862e0000000000, 0x7feef85a11e73f2d, none},
    {0x40862e6666666666, 0x7ff0000000000000, over}, {0x408f400000000000, 0x7ff0000000000000, over},
    {0xc08f400000000000, 0xbff0000000000000, none}, {0x7e37e43c8800759c, 0x7ff0000000000000, over},
    {0xfe37e43c8800759c, 0xbff0000000000000, none}, {0x4086200000000000, 0x7fc586f6bf260cf1, none},
    {0x408620000fffffff, 0x7fc58721cd3e9696, none}, {0x4086200010000000, 0x7fc58721cd3e9947, none},
    {0x4086200010000001, 0x7fc58721cd3e9bf8, none}, {0x408fffffefffffff, 0x7ff0000000000000, over},
    {0x408ffffff0000000, 0x7ff0000000000000, over}, {0x4090000000000000, 0x7ff0000000000000, over},
    {0xc086200000000000, 0xbff0000000000000, none}, {0xc08620000fffffff, 0xbff0000000000000, none},
    {0xc086200010000000, 0xbff0000000000000, none}, {0xc086200010000001, 0xbff0000000000000, none},
    {0xc08fffffefffffff, 0xbff0000000000000, none}, {0xc08ffffff0000000, 0xbff0000000000000, none},
    {0xc090000000000000, 0xbff0000000000000, none}, {0x4033a44fac911410, 0x41b4366fe56ca8f3, none},
    {0x403aef96c588a768, 0x425d0bd897ebe311, none}, {0x402a13f4aaf5d578, 0x411c137176bebc45, none},
    {0x3ff856d3da237980, 0x400c9f24a41ad1d5, none}, {0xc030e06c568fb73a, 0xbfefffffe6db29b1, none},
    {0xc0296dd35234b708, 0xbfeffff9b1864b90, none}, {0xc035cd7d4b627af6, 0xbfefffffffd14cb3, none},
    {0xc04146fcceb5c8c2, 0xbfeffffffffffff7, none}, {0x401c607a8ed6ac38, 0x4092cfea9f8e3d70, none},
    {0xc0310a02d6cccf38, 0xbfefffffeaa0537c, none}, {0x4038d0bacc7201c4, 0x422be0690877357f, none},
    {0xc0423269d8d303dc, 0xbfefffffffffffff, none},
};

constexpr point_of<std::uint64_t> expm1_d_ep_points[] = {
    {0x0000000000000000, 0x0000000000000000, none}, {0x8000000000000000, 0x0000000000000000, none},
    {0x0000000000000001, 0x0000000000000001, none}, {0x8000000000000001, 0x8000000000000001, none},
    {0x3c80000000000000, 0x3c7fffffff60cb31, none}, {0xbc80000000000000, 0xbc7fffffff60cb31, none},
    {0x3ff0000000000000, 0x3ffb7e15165477b4, none}, {0xbff0000000000000, 0xbfe43a54e4fde5ff, none},
    {0x3fd62e42fefa39ef, 0x3fda82799a39f6bc, none}, {0x3fe62e42fefa39f0, 0x3ff0000000000001, none},
    {0x3fe3333333333333, 0x3fea4ecc162f9001, none}, {0xbfe3333333333333, 0xbfdce04528dbdff3, none},
    {0x3fe6666666666666, 0x3ff03854c24bfb19, none}, {0xbfe6666666666666, 0xbfe01bf92310caec, none},
    {0x3f1a36e2eb1c432d, 0x3f1a3738d19104e8, none}, {0xbf1a36e2eb1c432d, 0xbf1a368d0519f654, none},
    {0x01a56e1fc2f8f359, 0x01a56e1fc28e54ce, none}, {0x81a56e1fc2f8f359, 0x81a56e1fc28e54ce, none},
    {0xc024000000000000, 0xbfefffa0ca192b18, none}, {0xc042000000000000, 0xbfeffffffffffffe, none},
    {0xc044000000000000, 0xbff0000000000000, none}, {0xc085e00000000000, 0xbff0000000000000, none},
    {0x4086180000000000, 0x7fafad7b30b71dac, none}, {0x4086240000000000, 0x7fd1bf058bc610c1, none},
    {0x40862c0000000000, 0x7fe81e9b4b277afc, none}, {0x40862e0000000000, 0x7feef85a11ebf54a, none},
    {0x40862e6666666666, 0x7ff0000000000000, over}, {0x408f400000000000, 0x7ff0000000000000, over},
    {0xc08f400000000000, 0xbff0000000000000, none}, {0x7e37e43c8800759c, 0x7ff0000000000000, over},
    {0xfe37e43c8800759c, 0xbff0000000000000, none}, {0x4086200000000000, 0x7fc586f6bf3c6bbc, none},
    {0x408620000fffffff, 0x7fc58721cd54f532, none}, {0x4086200010000000, 0x7fc58721cd54f7e2, none},
    {0x4086200010000001, 0x7fc58721cd54fa93, none}, {0x408fffffefffffff, 0x7ff0000000000000, over},
    {0x408ffffff0000000, 0x7ff0000000000000, over}, {0x4090000000000000, 0x7ff0000000000000, over},
    {0xc086200000000000, 0xbff0000000000000, none}, {0xc08620000fffffff, 0xbff0000000000000, none},
    {0xc086200010000000, 0xbff0000000000000, none}, {0xc086200010000001, 0xbff0000000000000, none},
    {0xc08fffffefffffff, 0xbff0000000000000, none}, {0xc08ffffff0000000, 0xbff0000000000000, none},
    {0xc090000000000000, 0xbff0000000000000, none}, {0x404024f58403c7dc, 0x42d7f6d5ab80d305, none},
    {0x402efe2e823ef6ec, 0x41547cb797450a38, none}, {0x4040f445ecfe0a22, 0x42fe43309e02cd91, none},
    {0x403fb9b20ed5e9fc, 0x42cb48f8ca7fb51a, none}, {0x403ff957344c8290, 0x42d17e3a676986d3, none},
    {0x4018a005d9f96a00, 0x407d6aaa47d9bbea, none}, {0xc04379667d984240, 0xbff0000000000000, none},
    {0x40339fb5613548a0, 0x41b3da3c467a6b6c, none}, {0xc03a411804f7d745, 0xbfefffffffff7499, none},
    {0xc030024ad79c0aae, 0xbfefffffc41f2970, none}, {0x402a103974659b50, 0x411bdf40eb5ea24d, none},
    {0x3ffff43f75eb5ee0, 0x401978b71ee75167, none},
};

TEST(Expm1Float, Points) {
  expect_points<expm1_s<tier::ha>>(expm1_s_ha_points);
  expect_points<expm1_s<tier::la>>(expm1_s_la_points);
  expect_points<expm1_s<tier::ep>>(expm1_s_ep_points);
}

TEST(Expm1Float, Digest) {
  EXPECT_EQ(digest<expm1_s<tier::ha>>(0x1.89374bc8p-9), 0xd81b56c25acdef72u);
  EXPECT_EQ(digest<expm1_s<tier::la>>(0x1.89374bc8p-9), 0x0c7ecd8969eee883u);
  EXPECT_EQ(digest<expm1_s<tier::ep>>(0x1.89374bc8p-9), 0xab85c2bb24fdc82cu);
}

TEST(Expm1Double, Points) {
  expect_points<expm1_d<tier::ha>>(expm1_d_ha_points);
  expect_points<expm1_d<tier::la>>(expm1_d_la_points);
  expect_points<expm1_d<tier::ep>>(expm1_d_ep_points);
}

TEST(Expm1Double, Digest) {
  EXPECT_EQ(digest<expm1_d<tier::ha>>(0x1.26e978d8p-8), 0x092a7aa19a475b63u);
  EXPECT_EQ(digest<expm1_d<tier::la>>(0x1.26e978d8p-8), 0x431dce9692815475u);
  EXPECT_EQ(digest<expm1_d<tier::ep>>(0x1.26e978d8p-8), 0x99fb66077b2f2847u);
}

template <typename Body>
class Expm1 : public ::testing::Test {};
using all_bodies = ::testing::Types<expm1_s<tier::ha>, expm1_s<tier::la>, expm1_s<tier::ep>,
                                    expm1_d<tier::ha>, expm1_d<tier::la>, expm1_d<tier::ep>>;
TYPED_TEST_SUITE(Expm1, all_bodies);

TYPED_TEST(Expm1, Specials) {
  using n = named<part_of<typename TypeParam::input_type>>;
  expect_v11<TypeParam>(n::inf, n::inf, over);
  expect_v11<TypeParam>(n::largest, n::inf, over);
  expect_v11<TypeParam>(n::inf | n::sign, n::one | n::sign, none);
  expect_v11<TypeParam>(n::largest | n::sign, n::one | n::sign, none);
  expect_quiet_nans<TypeParam>();
}

TYPED_TEST(Expm1, SignOfZero) {
  using n = named<part_of<typename TypeParam::input_type>>;
  constexpr bool is_float = sizeof(typename TypeParam::input_type) == 4;
  expect_v11<TypeParam>(0, 0, none);
  expect_v11<TypeParam>(n::sign, is_float ? n::sign : 0, none);
}

/// Arguments below the reach of the square, denormals among them. At `ep` the polynomial has a
/// constant term of its own, as large as the error of the tier.
template <typename Body>
void expect_identity_of_tiny_arguments() {
  using n = named<part_of<typename Body::input_type>>;
  for (const auto x : {n::smallest_normal, n::smallest_normal - 1, n::smallest_normal / 2}) {
    expect_v11<Body>(x, x, none);
    expect_v11<Body>(x | n::sign, x | n::sign, none);
  }
}

TEST(Expm1Float, TinyArgumentsAreReturned) {
  expect_identity_of_tiny_arguments<expm1_s<tier::ha>>();
  expect_identity_of_tiny_arguments<expm1_s<tier::la>>();
}

TEST(Expm1Double, TinyArgumentsAreReturned) {
  expect_identity_of_tiny_arguments<expm1_d<tier::ha>>();
  expect_identity_of_tiny_arguments<expm1_d<tier::la>>();
}

TYPED_TEST(Expm1, StatusFollowsTheResult) {
  using T = typename TypeParam::input_type;
  constexpr bool is_float = sizeof(T) == 4;
  const T below = is_float ? T(88.7) : T(709.7);
  const T above = is_float ? T(88.8) : T(709.9);
  T y = 0;
  EXPECT_EQ(TypeParam::call(&below, &y), none);
  EXPECT_LE(y, std::numeric_limits<T>::max());
  EXPECT_GE(y, std::numeric_limits<T>::max() / 2);
  EXPECT_EQ(TypeParam::call(&above, &y), over);
  EXPECT_EQ(y, std::numeric_limits<T>::infinity());
}

}  // namespace
