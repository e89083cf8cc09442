// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/exp/exp2.hpp"

#include <cmath>

#include "exp_points.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::exp2_d;
using scalar::exp2_s;
using scalar::tier;

constexpr point_of<std::uint32_t> exp2_s_points[] = {
    {0x00000000, 0x3f800000, none},  {0x80000000, 0x3f800000, none},
    {0x00000001, 0x3f800000, none},  {0x80000001, 0x3f800000, none},
    {0x007fffff, 0x3f800000, none},  {0x33000000, 0x3f800000, none},
    {0xb3000000, 0x3f800000, none},  {0x3f800000, 0x40000000, none},
    {0xbf800000, 0x3f000000, none},  {0x3eb17218, 0x3fa2c1bb, none},
    {0x3eb17219, 0x3fa2c1bb, none},  {0xbeb17219, 0x3f4954c4, none},
    {0x3f000000, 0x3fb504f3, none},  {0xbf000000, 0x3f3504f3, none},
    {0x3fc00000, 0x403504f3, none},  {0x40200000, 0x40b504f3, none},
    {0x42fc0000, 0x7e800000, none},  {0x42fd0000, 0x7eb504f3, none},
    {0x42fe0000, 0x7f000000, none},  {0x42ff0000, 0x7f3504f3, none},
    {0x42ff8000, 0x7f5744fd, none},  {0x43000000, 0x7f800000, over},
    {0xc2fa0000, 0x01000000, none},  {0xc2fb0000, 0x00b504f3, none},
    {0xc2fc0000, 0x00800000, none},  {0xc2fd0000, 0x005a827a, under},
    {0xc2fe0000, 0x00400000, under}, {0xc3150000, 0x00000001, under},
    {0xc3160000, 0x00000000, under}, {0xc3168000, 0x00000000, under},
    {0xc3170000, 0x00000000, under}, {0x433f8000, 0x7f800000, over},
    {0x43400000, 0x7f800000, over},  {0x43410000, 0x7f800000, over},
    {0xc3410000, 0x00000000, under}, {0x4e6e6b28, 0x7f800000, over},
    {0xce6e6b28, 0x00000000, under}, {0x7f61b1e6, 0x7f800000, over},
    {0xff61b1e6, 0x00000000, under}, {0x42fcffff, 0x7eb504b4, none},
    {0x42fd0001, 0x7eb50532, none},  {0x42feffff, 0x7f3504b4, none},
    {0x42ff0001, 0x7f350532, none},  {0x42ffffff, 0x7f7fffa7, none},
    {0x43000001, 0x7f800000, over},  {0x41a9da03, 0x4a164621, none},
    {0x42cbb7bb, 0x726823ba, none},  {0x42377020, 0x56683e72, none},
    {0x42d83047, 0x7588a530, none},  {0x42b3a03a, 0x6c60de86, none},
    {0x42f77573, 0x7d54376c, none},  {0x422ca4cc, 0x550f1afc, none},
    {0xc2a9cc3c, 0x15094ac7, none},  {0x42b5c2e6, 0x6cebad0e, none},
    {0x42ea2ccd, 0x7a0800ef, none},  {0x42cbf77f, 0x727d11d6, none},
    {0x418b521b, 0x482aac46, none},
};

constexpr point_of<std::uint64_t> exp2_d_ha_points[] = {
    {0x0000000000000000, 0x3ff0000000000000, none},
    {0x8000000000000000, 0x3ff0000000000000, none},
    {0x0000000000000001, 0x3ff0000000000000, none},
    {0x8000000000000001, 0x3ff0000000000000, none},
    {0x3c80000000000000, 0x3ff0000000000000, none},
    {0xbc80000000000000, 0x3ff0000000000000, none},
    {0x3ff0000000000000, 0x4000000000000000, none},
    {0xbff0000000000000, 0x3fe0000000000000, none},
    {0x3fd62e42fefa39ef, 0x3ff45837513c59e1, none},
    {0x3fe62e42fefa39f0, 0x3ff9de70ac53b8aa, none},
    {0x3fe0000000000000, 0x3ff6a09e667f3bcd, none},
    {0xbfe0000000000000, 0x3fe6a09e667f3bcc, none},
    {0x3ff8000000000000, 0x4006a09e667f3bcc, none},
    {0x4004000000000000, 0x4016a09e667f3bcd, none},
    {0x408fec0000000000, 0x7fc6a09e667f3bcc, none},
    {0x408ff00000000000, 0x7fd0000000000000, none},
    {0x408ff40000000000, 0x7fd6a09e667f3bcd, none},
    {0x408ff80000000000, 0x7fe0000000000000, none},
    {0x408ffc0000000000, 0x7fe6a09e667f3bcc, none},
    {0x408ffe0000000000, 0x7feae89f995ad3ad, none},
    {0x4090000000000000, 0x7ff0000000000000, over},
    {0xc08ff00000000000, 0x0010000000000000, none},
    {0xc08ff40000000000, 0x000b504f333f9de6, under},
    {0xc08ff80000000000, 0x0008000000000000, under},
    {0xc08ffc0000000000, 0x0005a827999fcef3, under},
    {0xc090690000000000, 0x0000000000d744fd, under},
    {0xc090c80000000000, 0x0000000000000001, under},
    {0xc090ca0000000000, 0x0000000000000001, under},
    {0xc090cc0000000000, 0x0000000000000000, under},
    {0xc090ce0000000000, 0x0000000000000000, under},
    {0x4097fe0000000000, 0x7ff0000000000000, over},
    {0x4098000000000000, 0x7ff0000000000000, over},
    {0x4098040000000000, 0x7ff0000000000000, over},
    {0xc098040000000000, 0x0000000000000000, under},
    {0x43abc16d674ec800, 0x7ff0000000000000, over},
    {0xc3abc16d674ec800, 0x0000000000000000, under},
    {0x7fee42d130773b76, 0x7ff0000000000000, over},
    {0xffee42d130773b76, 0x0000000000000000, under},
    {0x408fefffffffffff, 0x7fcffffffffffd3a, none},
    {0x408ff00000000001, 0x7fd0000000000163, none},
    {0xc08fefffffffffff, 0x0010000000000163, none},
    {0xc08ff00000000001, 0x000ffffffffffe9d, under},
    {0x408fffffffffffff, 0x7feffffffffffd3a, none},
    {0x4090000000000001, 0x7ff0000000000000, over},
    {0x407aba25077e0b74, 0x5aa8d49a740c8591, none},
    {0xc0820e00111e0c58, 0x1bd306e1d211f6e2, none},
    {0x4084b9ba151824e0, 0x696295147568bda4, none},
    {0x406262120f98ade0, 0x4920bbe310fe0c36, none},
    {0xc07ae15c78ae42bc, 0x250e2ae248e1cf17, none},
    {0xc08b48a179dbff47, 0x095e4c4eba34ab23, none},
    {0x40861f146ebd8452, 0x6c2d8c39fafb1b9c, none},
    {0x408e9ce56fe7047a, 0x7d28745c171cb545, none},
    {0xc089b7b5e3ffd6f1, 0x0c8068096546c4e4, none},
    {0x4082c9866f953958, 0x658242a64ca0fd90, none},
    {0xc06662716bb73b10, 0x34be59c31261cca8, none},
    {0xc085d3c106b7bfd3, 0x14471d67a90f0c4e, none},
};

constexpr point_of<std::uint64_t> exp2_d_la_points[] = {
    {0x0000000000000000, 0x3ff0000000000000, none},
    {0x8000000000000000, 0x3ff0000000000000, none},
    {0x0000000000000001, 0x3ff0000000000000, none},
    {0x8000000000000001, 0x3ff0000000000000, none},
    {0x3c80000000000000, 0x3ff0000000000000, none},
    {0xbc80000000000000, 0x3ff0000000000000, none},
    {0x3ff0000000000000, 0x4000000000000000, none},
    {0xbff0000000000000, 0x3fe0000000000000, none},
    {0x3fd62e42fefa39ef, 0x3ff45837513c59e1, none},
    {0x3fe62e42fefa39f0, 0x3ff9de70ac53b8aa, none},
    {0x3fe0000000000000, 0x3ff6a09e667f3bcd, none},
    {0xbfe0000000000000, 0x3fe6a09e667f3bcc, none},
    {0x3ff8000000000000, 0x4006a09e667f3bcc, none},
    {0x4004000000000000, 0x4016a09e667f3bcd, none},
    {0x408fec0000000000, 0x7fc6a09e667f3bcc, none},
    {0x408ff00000000000, 0x7fd0000000000000, none},
    {0x408ff40000000000, 0x7fd6a09e667f3bcd, none},
    {0x408ff80000000000, 0x7fe0000000000000, none},
    {0x408ffc0000000000, 0x7fe6a09e667f3bcc, none},
    {0x408ffe0000000000, 0x7feae89f995ad3ad, none},
    {0x4090000000000000, 0x7ff0000000000000, over},
    {0xc08ff00000000000, 0x0010000000000000, none},
    {0xc08ff40000000000, 0x000b504f333f9de6, under},
    {0xc08ff80000000000, 0x0008000000000000, under},
    {0xc08ffc0000000000, 0x0005a827999fcef3, under},
    {0xc090690000000000, 0x0000000000d744fd, under},
    {0xc090c80000000000, 0x0000000000000001, under},
    {0xc090ca0000000000, 0x0000000000000001, under},
    {0xc090cc0000000000, 0x0000000000000000, under},
    {0xc090ce0000000000, 0x0000000000000000, under},
    {0x4097fe0000000000, 0x7ff0000000000000, over},
    {0x4098000000000000, 0x7ff0000000000000, over},
    {0x4098040000000000, 0x7ff0000000000000, over},
    {0xc098040000000000, 0x0000000000000000, under},
    {0x43abc16d674ec800, 0x7ff0000000000000, over},
    {0xc3abc16d674ec800, 0x0000000000000000, under},
    {0x7fee42d130773b76, 0x7ff0000000000000, over},
    {0xffee42d130773b76, 0x0000000000000000, under},
    {0x408fefffffffffff, 0x7fcffffffffffd3a, none},
    {0x408ff00000000001, 0x7fd0000000000163, none},
    {0xc08fefffffffffff, 0x0010000000000163, none},
    {0xc08ff00000000001, 0x000ffffffffffe9d, under},
    {0x408fffffffffffff, 0x7feffffffffffd3a, none},
    {0x4090000000000001, 0x7ff0000000000000, over},
    {0xc079c37ae7f36ed8, 0x262b8589134ac1ea, none},
    {0x4080ccab91fe6504, 0x6187faf167336d52, none},
    {0x40874c45bb9dd59e, 0x6e872af50e01ba06, none},
    {0xc08c7cf5827605ed, 0x06f4d2bf7ac770c8, none},
    {0x406ca214f28d1380, 0x4e40bceef2ea3c8a, none},
    {0xc08c70f4c33c63f7, 0x070d74b8e404f610, none},
    {0x407b4e1864298018, 0x5b3d772b14c6fff6, none},
    {0xc0752177a2c49822, 0x2ace0776ca1f9ca0, none},
    {0x4087ce7c2373c3c0, 0x6f8c1036a32d5fd1, none},
    {0x408e0a2c0f5e25a0, 0x7c03502c717b6970, none},
    {0x4025ae766df9cc40, 0x409ca7d8219e9d71, none},
    {0x408f2824a3e80692, 0x7e40331c45aaae94, none},
};

constexpr point_of<std::uint64_t> exp2_d_ep_points[] = {
    {0x0000000000000000, 0x3ff0000000000000, none},
    {0x8000000000000000, 0x3ff0000000000000, none},
    {0x0000000000000001, 0x3ff0000000000000, none},
    {0x8000000000000001, 0x3ff0000000000000, none},
    {0x3c80000000000000, 0x3ff0000000000000, none},
    {0xbc80000000000000, 0x3ff0000000000000, none},
    {0x3ff0000000000000, 0x4000000000000000, none},
    {0xbff0000000000000, 0x3fe0000000000000, none},
    {0x3fd62e42fefa39ef, 0x3ff45837513c56b3, none},
    {0x3fe62e42fefa39f0, 0x3ff9de70ac53b6dc, none},
    {0x3fe0000000000000, 0x3ff6a09e667e5064, none},
    {0xbfe0000000000000, 0x3fe6a09e667ebe70, none},
    {0x3ff8000000000000, 0x4006a09e667ebe70, none},
    {0x4004000000000000, 0x4016a09e667e5064, none},
    {0x408fec0000000000, 0x7fc6a09e667ebe70, none},
    {0x408ff00000000000, 0x7fd0000000000000, none},
    {0x408ff40000000000, 0x7fd6a09e667e5064, none},
    {0x408ff80000000000, 0x7fe0000000000000, none},
    {0x408ffc0000000000, 0x7fe6a09e667ebe70, none},
    {0x408ffe0000000000, 0x7feae89f995ad372, none},
    {0x4090000000000000, 0x7ff0000000000000, over},
    {0xc08ff00000000000, 0x0010000000000000, none},
    {0xc08ff40000000000, 0x000b504f333f5f38, under},
    {0xc08ff80000000000, 0x0008000000000000, under},
    {0xc08ffc0000000000, 0x0005a827999f9419, under},
    {0xc090690000000000, 0x0000000000d744fd, under},
    {0xc090c80000000000, 0x0000000000000001, under},
    {0xc090ca0000000000, 0x0000000000000001, under},
    {0xc090cc0000000000, 0x0000000000000000, under},
    {0xc090ce0000000000, 0x0000000000000000, under},
    {0x4097fe0000000000, 0x7ff0000000000000, over},
    {0x4098000000000000, 0x7ff0000000000000, over},
    {0x4098040000000000, 0x7ff0000000000000, over},
    {0xc098040000000000, 0x0000000000000000, under},
    {0x43abc16d674ec800, 0x7ff0000000000000, over},
    {0xc3abc16d674ec800, 0x0000000000000000, under},
    {0x7fee42d130773b76, 0x7ff0000000000000, over},
    {0xffee42d130773b76, 0x0000000000000000, under},
    {0x408fefffffffffff, 0x7fcffffffffffd3a, none},
    {0x408ff00000000001, 0x7fd0000000000163, none},
    {0xc08fefffffffffff, 0x0010000000000163, none},
    {0xc08ff00000000001, 0x000ffffffffffe9d, under},
    {0x408fffffffffffff, 0x7feffffffffffd3a, none},
    {0x4090000000000001, 0x7ff0000000000000, over},
    {0xc077ca8eec0311b0, 0x282440ec62347e32, none},
    {0xc08a7077fe57c2ec, 0x0b0eb9f8efe9bd18, none},
    {0x4068f0d1dbfca010, 0x4c67086542c5aae6, none},
    {0xc08d49f4afa63583, 0x055b030d451c1410, none},
    {0xc082e9d7a0c92488, 0x1a1b47651cedba21, none},
    {0xc06704165aa319d4, 0x346d49e6e2ae384f, none},
    {0x406b9de557bafc50, 0x4dbe9303100a2fc9, none},
    {0xc0857cd0eecc88aa, 0x14f515265c3e655a, none},
    {0xc08c9906dca83a3c, 0x06bd46abc9db9a0c, none},
    {0x4086fc76ec47a0ac, 0x6de78e865d2e1e8b, none},
    {0xc077456c617f36b4, 0x28a94caf52eed1ee, none},
    {0x408caa8d02b4a6ee, 0x7943f51904b64e75, none},
};

TEST(Exp2Float, Points) { expect_points<exp2_s>(exp2_s_points); }

TEST(Exp2Float, Digest) { EXPECT_EQ(digest<exp2_s>(0x1.99999998p-7), 0x12002be235b89d2fu); }

TEST(Exp2Float, IntegersAreExact) {
  for (int n = -149; n <= 127; ++n)
    expect_number<exp2_s>(static_cast<float>(n), std::ldexp(1.0f, n), n < -126 ? under : none);
}

TEST(Exp2Float, Specials) {
  expect_v11<exp2_s>(0x7f800000, 0x7f800000, none);
  expect_v11<exp2_s>(0xff800000, 0x00000000, none);
  expect_v11<exp2_s>(0x7f7fffff, 0x7f800000, over);
  expect_v11<exp2_s>(0xff7fffff, 0x00000000, under);
  expect_quiet_nans<exp2_s>();
}

/// Every argument far out of range takes the rare path, whatever integer the shifter makes of it.
TEST(Exp2Float, LargeArguments) {
  pattern_source<std::uint32_t> source(21);
  for (int i = 0; i < 100'000; ++i) {
    const std::uint32_t magnitude =
        0x43400000u + static_cast<std::uint32_t>(source.below(0x7f800000u - 0x43400000u));
    ASSERT_TRUE(expect_v11<exp2_s>(magnitude, 0x7f800000, over));
    ASSERT_TRUE(expect_v11<exp2_s>(magnitude | 0x80000000u, 0x00000000, under));
  }
}

TEST(Exp2Double, Points) {
  expect_points<exp2_d<tier::ha>>(exp2_d_ha_points);
  expect_points<exp2_d<tier::la>>(exp2_d_la_points);
  expect_points<exp2_d<tier::ep>>(exp2_d_ep_points);
}

TEST(Exp2Double, Digest) {
  EXPECT_EQ(digest<exp2_d<tier::ha>>(0x1.a2339c08p-4), 0xa4d8910078224086u);
  EXPECT_EQ(digest<exp2_d<tier::la>>(0x1.a2339c08p-4), 0xd431e0e8de32b936u);
  EXPECT_EQ(digest<exp2_d<tier::ep>>(0x1.a2339c08p-4), 0x4f1a6d3125a7c710u);
}

template <typename Body>
class Exp2DoubleTier : public ::testing::Test {};
using double_tiers = ::testing::Types<exp2_d<tier::ha>, exp2_d<tier::la>, exp2_d<tier::ep>>;
TYPED_TEST_SUITE(Exp2DoubleTier, double_tiers);

TYPED_TEST(Exp2DoubleTier, IntegersAreExact) {
  for (int n = -1074; n <= 1023; ++n)
    expect_number<TypeParam>(n, std::ldexp(1.0, n), n < -1022 ? under : none);
}

/// Halfway between integers the rare path must go the way that the reduction went.
TYPED_TEST(Exp2DoubleTier, HalvesOnTheRarePath) {
  const auto run = [](double x) {
    double y = 0;
    TypeParam::call(&x, &y);
    return y;
  };
  const double root = run(0.5);
  const double inverse_root = run(-0.5);
  for (int n = 1022; n < 1024; ++n) {
    const double y = std::ldexp(run(n + 0.5), -n);
    EXPECT_TRUE(y == root || y == 2 * inverse_root) << n;
  }
  for (int n = -1050; n < -1022; ++n) {
    const double y = run(n + 0.5);
    EXPECT_TRUE(y == std::ldexp(root, n) || y == std::ldexp(inverse_root, n + 1)) << n;
  }
}

TYPED_TEST(Exp2DoubleTier, Specials) {
  expect_v11<TypeParam>(0x7ff0000000000000, 0x7ff0000000000000, none);
  expect_v11<TypeParam>(0xfff0000000000000, 0x0000000000000000, none);
  expect_v11<TypeParam>(0x7fefffffffffffff, 0x7ff0000000000000, over);
  expect_v11<TypeParam>(0xffefffffffffffff, 0x0000000000000000, under);
  expect_quiet_nans<TypeParam>();
}

/// From 2^51 on the shifter's sum is rounded, and the fraction that is left means nothing.
TYPED_TEST(Exp2DoubleTier, LargeArguments) {
  pattern_source<std::uint64_t> source(22);
  for (int i = 0; i < 100'000; ++i) {
    const std::uint64_t magnitude =
        0x4098000000000000u + source.below(0x7ff0000000000000u - 0x4098000000000000u);
    ASSERT_TRUE(expect_v11<TypeParam>(magnitude, 0x7ff0000000000000, over));
    ASSERT_TRUE(expect_v11<TypeParam>(magnitude | 0x8000000000000000u, 0, under));
  }
  for (std::uint64_t magnitude = 0x4320000000000000u; magnitude < 0x4360000000000000u;
       magnitude += 0x0000123456789abdu) {
    ASSERT_TRUE(expect_v11<TypeParam>(magnitude, 0x7ff0000000000000, over));
    ASSERT_TRUE(expect_v11<TypeParam>(magnitude | 0x8000000000000000u, 0, under));
  }
}

}  // namespace
