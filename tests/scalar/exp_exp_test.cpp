// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/exp/exp.hpp"

#include "exp_points.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::exp_d;
using scalar::exp_s;
using scalar::tier;

constexpr point_of<std::uint32_t> exp_s_points[] = {
    {0x00000000, 0x3f800000, none}, {0x80000000, 0x3f800000, none},  {0x00000001, 0x3f800000, none},
    {0x80000001, 0x3f800000, none}, {0x007fffff, 0x3f800000, none},  {0x33000000, 0x3f800000, none},
    {0xb3000000, 0x3f800000, none}, {0x3f800000, 0x402df854, none},  {0xbf800000, 0x3ebc5ab2, none},
    {0x3eb17218, 0x3fb504f3, none}, {0x3eb17219, 0x3fb504f4, none},  {0xbeb17219, 0x3f3504f3, none},
    {0x42b40000, 0x7f800000, none}, {0x43480000, 0x7f800000, over},  {0xc2c80000, 0x0000001b, none},
    {0xc2af0000, 0x006cb2bc, none}, {0xc2cfcccd, 0x00000001, none},  {0xc2d00000, 0x00000000, none},
    {0x42b17213, 0x7f7ffd84, none}, {0x42b175c3, 0x7f800000, none},  {0x42aeac4e, 0x7e7fff34, none},
    {0x42aeac4f, 0x7e7fffb4, none}, {0x42aeac50, 0x7e80001a, none},  {0x432eac4e, 0x7f800000, none},
    {0x432eac4f, 0x7f800000, none}, {0x432eac50, 0x7f800000, over},  {0xc2aeac4e, 0x00800066, none},
    {0xc2aeac4f, 0x00800026, none}, {0xc2aeac50, 0x007fffe6, none},  {0xc32eac4e, 0x00000000, none},
    {0xc32eac4f, 0x00000000, none}, {0xc32eac50, 0x00000000, under}, {0xc2387910, 0x1e30bcd5, none},
    {0x40f91958, 0x45162b05, none}, {0xc1b71a66, 0x2efc6ec3, none},  {0x419251c5, 0x4ca75b6e, none},
    {0x41b103a2, 0x4f728ee3, none}, {0xc298ef10, 0x084d4b8a, none},  {0xc2ab5d68, 0x01a74f48, none},
    {0x426d9407, 0x6a4e3f69, none}, {0xc2296a2f, 0x20ee488a, none},  {0xc23b07f0, 0x1dba791e, none},
    {0x42ae778c, 0x7e66ee8e, none}, {0xc0a779d6, 0x3baeca3c, none},
};

constexpr point_of<std::uint64_t> exp_d_ha_points[] = {
    {0x0000000000000000, 0x3ff0000000000000, none},
    {0x8000000000000000, 0x3ff0000000000000, none},
    {0x0000000000000001, 0x3ff0000000000000, none},
    {0x8000000000000001, 0x3ff0000000000000, none},
    {0x3c80000000000000, 0x3ff0000000000000, none},
    {0xbc80000000000000, 0x3ff0000000000000, none},
    {0x3ff0000000000000, 0x4005bf0a8b145769, none},
    {0xbff0000000000000, 0x3fd78b56362cef38, none},
    {0x3fd62e42fefa39ef, 0x3ff6a09e667f3bcd, none},
    {0x3fe62e42fefa39f0, 0x4000000000000000, none},
    {0xc086800000000000, 0x0000000993b4dc95, under},
    {0x40862d999999999a, 0x7fed75ae7a50ee14, none},
    {0x40862f3333333333, 0x7ff0000000000000, over},
    {0xc08748cccccccccd, 0x0000000000000001, under},
    {0xc08749999999999a, 0x0000000000000000, under},
    {0xc089000000000000, 0x0000000000000000, under},
    {0x4089000000000000, 0x7ff0000000000000, over},
    {0x40862329ffffffff, 0x7fcff88af3a00e31, none},
    {0x4086232a00000000, 0x7fcff88af3a01230, none},
    {0x4086232a00000001, 0x7fcff88af3a0162f, none},
    {0x40879126ffffffff, 0x7ff0000000000000, over},
    {0x4087912700000000, 0x7ff0000000000000, over},
    {0x4087912700000001, 0x7ff0000000000000, over},
    {0xc0862329ffffffff, 0x001003bb64d4a18b, none},
    {0xc086232a00000000, 0x001003bb64d49f8a, none},
    {0xc086232a00000001, 0x001003bb64d49d8a, none},
    {0xc0879126ffffffff, 0x0000000000000000, under},
    {0xc087912700000000, 0x0000000000000000, under},
    {0xc087912700000001, 0x0000000000000000, under},
    {0x407d70bc8bd2f7a0, 0x6a67d8fe618bbd55, none},
    {0xc0408d8147c02f80, 0x3cf2e17c2717e3aa, none},
    {0x40685640b0b5b948, 0x517d9207cd001cf2, none},
    {0xc07e92312d969e50, 0x13d40904511244d8, none},
    {0x406799c1eaf115d4, 0x50f4efa75c5d2603, none},
    {0x40801a1b81302b6e, 0x6e64a6205d343e76, none},
    {0x40403a12a99e9520, 0x42dc4308d04556ef, none},
    {0x40751c0aa4ea692c, 0x5e6358b2e395771d, none},
    {0x406dff3bedc083a0, 0x559289497df462c5, none},
    {0xc08312d90f70d711, 0x08e5be13afa645a7, none},
    {0x4076985b8638fde4, 0x6087b1d980639c3d, none},
    {0x405fe285cb1f3cb0, 0x4b70015f34f00f6b, none},
};

constexpr point_of<std::uint64_t> exp_d_la_points[] = {
    {0x0000000000000000, 0x3ff0000000000000, none},
    {0x8000000000000000, 0x3ff0000000000000, none},
    {0x0000000000000001, 0x3ff0000000000000, none},
    {0x8000000000000001, 0x3ff0000000000000, none},
    {0x3c80000000000000, 0x3ff0000000000000, none},
    {0xbc80000000000000, 0x3ff0000000000000, none},
    {0x3ff0000000000000, 0x4005bf0a8b14576a, none},
    {0xbff0000000000000, 0x3fd78b56362cef38, none},
    {0x3fd62e42fefa39ef, 0x3ff6a09e667f3bcd, none},
    {0x3fe62e42fefa39f0, 0x4000000000000000, none},
    {0xc086800000000000, 0x0000000993b4dc95, under},
    {0x40862d999999999a, 0x7fed75ae7a50ee14, none},
    {0x40862f3333333333, 0x7ff0000000000000, over},
    {0xc08748cccccccccd, 0x0000000000000001, under},
    {0xc08749999999999a, 0x0000000000000000, under},
    {0xc089000000000000, 0x0000000000000000, under},
    {0x4089000000000000, 0x7ff0000000000000, over},
    {0x40862329ffffffff, 0x7fcff88af3a00e30, none},
    {0x4086232a00000000, 0x7fcff88af3a01230, none},
    {0x4086232a00000001, 0x7fcff88af3a0162f, none},
    {0x40879126ffffffff, 0x7ff0000000000000, over},
    {0x4087912700000000, 0x7ff0000000000000, over},
    {0x4087912700000001, 0x7ff0000000000000, over},
    {0xc0862329ffffffff, 0x001003bb64d4a18b, none},
    {0xc086232a00000000, 0x001003bb64d49f8a, none},
    {0xc086232a00000001, 0x001003bb64d49d8a, none},
    {0xc0879126ffffffff, 0x0000000000000000, under},
    {0xc087912700000000, 0x0000000000000000, under},
    {0xc087912700000001, 0x0000000000000000, under},
    {0xc071639abbb7c92c, 0x26d85944ac634864, none},
    {0xc08484ab1b2f0055, 0x04bae9713093cf66, none},
    {0x407ffbcf634268a0, 0x6e1374773984de9a, none},
    {0xc043135d01f59c70, 0x3c7f1c5d43f00329, none},
    {0x407325a7e9007042, 0x5b8f7167389598b1, none},
    {0x408092b40f96a6ea, 0x6fc1569895718774, none},
    {0x4072bc801c5eb46a, 0x5af6846d95ffd2f2, none},
    {0x40826c4e1985b576, 0x751700bd6781600d, none},
    {0xc06261a3b6527ea0, 0x32acd699ba7a966d, none},
    {0x407a545b419f58d8, 0x65eb3c586c016de8, none},
    {0xc05361f410922668, 0x38f1b7ac69b90d62, none},
    {0x40830e923f9bcf0a, 0x76eb9844e5edfa10, none},
};

constexpr point_of<std::uint64_t> exp_d_ep_points[] = {
    {0x0000000000000000, 0x3feffffffff4e06d, none},
    {0x8000000000000000, 0x3feffffffff4e06d, none},
    {0x0000000000000001, 0x3feffffffff4e06d, none},
    {0x8000000000000001, 0x3feffffffff4e06d, none},
    {0x3c80000000000000, 0x3feffffffff4e06d, none},
    {0xbc80000000000000, 0x3feffffffff4e06c, none},
    {0x3ff0000000000000, 0x4005bf0a8b906931, none},
    {0xbff0000000000000, 0x3fd78b5635324e7a, none},
    {0x3fd62e42fefa39ef, 0x3ff6a09e65febe3c, none},
    {0x3fe62e42fefa39f0, 0x3ffffffffff4e06e, none},
    {0xc086800000000000, 0x0000000993b4dc6f, under},
    {0x40862d999999999a, 0x7fed75ae795326ea, none},
    {0x40862f3333333333, 0x7ff0000000000000, over},
    {0xc08748cccccccccd, 0x0000000000000001, under},
    {0xc08749999999999a, 0x0000000000000000, under},
    {0xc089000000000000, 0x0000000000000000, under},
    {0x4089000000000000, 0x7ff0000000000000, over},
    {0x40862329ffffffff, 0x7fcff88af3903725, none},
    {0x4086232a00000000, 0x7fcff88af3903b24, none},
    {0x4086232a00000001, 0x7fcff88af3903f23, none},
    {0x40879126ffffffff, 0x7ff0000000000000, over},
    {0x4087912700000000, 0x7ff0000000000000, over},
    {0x4087912700000001, 0x7ff0000000000000, over},
    {0x4086232b8fffffff, 0x7fcffeca1add8154, none},
    {0x4086232b90000000, 0x7fcffeca1add8554, none},
    {0x4086232b90000001, 0x7fcffeca1add8954, none},
    {0xc0862329ffffffff, 0x001003bb64d16dfb, none},
    {0xc086232a00000000, 0x001003bb64d16bfa, none},
    {0xc086232a00000001, 0x001003bb64d169fa, none},
    {0xc0879126ffffffff, 0x0000000000000000, under},
    {0xc087912700000000, 0x0000000000000000, under},
    {0xc087912700000001, 0x0000000000000000, under},
    {0xc086232b8fffffff, 0x0010009af862e3e2, none},
    {0xc086232b90000000, 0x0010009af862e1e2, none},
    {0xc086232b90000001, 0x0010009af862dfe2, none},
    {0x4080934e7d0fba3e, 0x6fc2b239e25fa566, none},
    {0xc0819c8300cdc23b, 0x0d1ee3cc8a183aa8, none},
    {0xc07fda4c2b065394, 0x11fab7ac87f2c88a, none},
    {0xc078c37e158da711, 0x1c34ca5ae80b8edd, none},
    {0x40845d60a77cdb92, 0x7ab1ede3532116fb, none},
    {0xc05657e5916b81d0, 0x37e0b241fb5f011f, none},
    {0x406629d7eb154364, 0x4febdf88a5099008, none},
    {0xc07169035e24c8c0, 0x26d15d55cdcaff03, none},
    {0x402447c553b78c80, 0x40d8bf3d7a7c4a6b, none},
    {0xc063f9310cf17904, 0x3186400b622c5768, none},
    {0xc06a1735c95105d2, 0x2d1d4dce259fadff, none},
    {0x405dc6a3d894d980, 0x4aac735e2e5e697e, none},
};

TEST(ExpFloat, Points) { expect_points<exp_s>(exp_s_points); }

TEST(ExpFloat, Digest) { EXPECT_EQ(digest<exp_s>(0x1.1d14e3b8p-7), 0xe79e1c36e178950fu); }

TEST(ExpFloat, MiddleBandReportsNothing) {
  expect_v11<exp_s>(0x42b40000, 0x7f800000, none);  // 90: infinite
  expect_v11<exp_s>(0xc2c80000, 0x0000001b, none);  // -100: denormal
  expect_v11<exp_s>(0xc3200000, 0x00000000, none);  // -160: zero
}

TEST(ExpFloat, ReportsBeyondTheMiddleBand) {
  expect_v11<exp_s>(0x43480000, 0x7f800000, over);   // 200
  expect_v11<exp_s>(0xc3480000, 0x00000000, under);  // -200
  expect_v11<exp_s>(0x7f800000, 0x7f800000, over);
  expect_v11<exp_s>(0xff800000, 0x00000000, under);
  expect_v11<exp_s>(0x7f7fffff, 0x7f800000, over);
  expect_v11<exp_s>(0xff7fffff, 0x00000000, under);
}

TEST(ExpFloat, NaNs) { expect_quiet_nans<exp_s>(); }

TEST(ExpDouble, Points) {
  expect_points<exp_d<tier::ha>>(exp_d_ha_points);
  expect_points<exp_d<tier::la>>(exp_d_la_points);
  expect_points<exp_d<tier::ep>>(exp_d_ep_points);
}

TEST(ExpDouble, Digest) {
  EXPECT_EQ(digest<exp_d<tier::ha>>(0x1.21ff2e48p-4), 0x57d9b6c5a17df268u);
  EXPECT_EQ(digest<exp_d<tier::la>>(0x1.21ff2e48p-4), 0x068ac08e2aa14186u);
  EXPECT_EQ(digest<exp_d<tier::ep>>(0x1.21ff2e48p-4), 0x32e0c8f4bf0cd9c3u);
}

template <typename Body>
class ExpDoubleTier : public ::testing::Test {};
using double_tiers = ::testing::Types<exp_d<tier::ha>, exp_d<tier::la>, exp_d<tier::ep>>;
TYPED_TEST_SUITE(ExpDoubleTier, double_tiers);

TYPED_TEST(ExpDoubleTier, InfinitiesAreOverflowAndUnderflow) {
  expect_v11<TypeParam>(0x7ff0000000000000, 0x7ff0000000000000, over);
  expect_v11<TypeParam>(0xfff0000000000000, 0x0000000000000000, under);
  expect_v11<TypeParam>(0x7fefffffffffffff, 0x7ff0000000000000, over);
  expect_v11<TypeParam>(0xffefffffffffffff, 0x0000000000000000, under);
}

TYPED_TEST(ExpDoubleTier, StatusFollowsTheResult) {
  const auto run = [](double x, double* y) { return TypeParam::call(&x, y); };
  double y = 0;
  EXPECT_EQ(run(-720, &y), under);  // denormal
  EXPECT_GT(y, 0);
  EXPECT_LT(y, 0x1p-1022);
  EXPECT_EQ(run(-708.3963, &y), none);  // on the rare path, but normal
  EXPECT_GE(y, 0x1p-1022);
  EXPECT_EQ(run(709.7, &y), none);
  EXPECT_LE(y, 0x1.fffffffffffffp1023);
  EXPECT_EQ(run(710, &y), over);
}

TYPED_TEST(ExpDoubleTier, NaNs) {
  expect_quiet_nans<TypeParam>();
  expect_rare<TypeParam>(std::uint64_t{0xfff0000000000001}, named<std::uint64_t>::any_nan, none);
}

}  // namespace
