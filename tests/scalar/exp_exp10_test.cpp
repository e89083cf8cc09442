// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/exp/exp10.hpp"

#include <limits>

#include "exp_points.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::exp10_d;
using scalar::exp10_s;
using scalar::tier;

constexpr point_of<std::uint32_t> exp10_s_points[] = {
    {0x00000000, 0x3f800000, none}, {0x80000000, 0x3f800000, none}, {0x00000001, 0x3f800000, none},
    {0x80000001, 0x3f800000, none}, {0x007fffff, 0x3f800000, none}, {0x33000000, 0x3f800001, none},
    {0xb3000000, 0x3f7fffff, none}, {0x3f800000, 0x41200000, none}, {0xbf800000, 0x3dcccccd, none},
    {0x3eb17218, 0x400e26f6, none}, {0x3eb17219, 0x400e26f7, none}, {0xbeb17219, 0x3ee68374, none},
    {0x40000000, 0x42c80000, none}, {0x40a00000, 0x47c35000, none}, {0x41200000, 0x501502f9, none},
    {0x421a0000, 0x7f6de741, none}, {0x421a6666, 0x7f800000, none}, {0xc217cccd, 0x007a2d41, none},
    {0xc2180000, 0x006ce3ee, none}, {0xc2300000, 0x00000007, none}, {0xc2346666, 0x00000001, none},
    {0x4234999a, 0x7f800000, none}, {0x42c80000, 0x7f800000, over}, {0xc2c80000, 0x00000000, under},
    {0x4217b817, 0x7e7fff5d, none}, {0x4217b818, 0x7e7ffff1, none}, {0x4217b819, 0x7e800042, none},
    {0x42349e34, 0x7f800000, none}, {0x42349e35, 0x7f800000, none}, {0x42349e36, 0x7f800000, over},
    {0xc217b817, 0x00800051, none}, {0xc217b818, 0x00800008, none}, {0xc217b819, 0x007fffbe, none},
    {0xc2349e34, 0x00000001, none}, {0xc2349e35, 0x00000001, none}, {0xc2349e36, 0x00000000, under},
    {0x41efe656, 0x7144345f, none}, {0xc113d37e, 0x301e7dd4, none}, {0xc03f8dd5, 0x3a853128, none},
    {0x3fc23e05, 0x4203b292, none}, {0x412e0c3c, 0x518ca484, none}, {0x40e765a6, 0x4b81e966, none},
    {0x408f5d47, 0x46ec0202, none}, {0x41114df9, 0x4e8fd438, none}, {0x42053e6e, 0x76c9c78a, none},
    {0x3f07fe83, 0x40597956, none}, {0xc0a6761e, 0x36d2c7ea, none}, {0x41853e87, 0x5b20ba54, none},
};

constexpr point_of<std::uint64_t> exp10_d_ha_points[] = {
    {0x0000000000000000, 0x3ff0000000000000, none},
    {0x8000000000000000, 0x3ff0000000000000, none},
    {0x0000000000000001, 0x3ff0000000000000, none},
    {0x8000000000000001, 0x3ff0000000000000, none},
    {0x3c80000000000000, 0x3ff0000000000000, none},
    {0xbc80000000000000, 0x3fefffffffffffff, none},
    {0x3ff0000000000000, 0x4024000000000000, none},
    {0xbff0000000000000, 0x3fb999999999999a, none},
    {0x3fd62e42fefa39ef, 0x4001c4dec40a0ca3, none},
    {0x3fe62e42fefa39f0, 0x4013bbcfbe75da8a, none},
    {0x4000000000000000, 0x4059000000000000, none},
    {0x4024000000000000, 0x4202a05f20000000, none},
    {0x4036000000000000, 0x4480f0cf064dd592, none},
    {0x4072c00000000000, 0x7e37e43c8800759c, none},
    {0xc072c00000000000, 0x01a56e1fc2f8f359, none},
    {0x4073400000000000, 0x7fe1ccf385ebc8a0, none},
    {0x4073440000000000, 0x7fefa788589d81d3, none},
    {0x4073480000000000, 0x7ff0000000000000, over},
    {0xc0733b3333333333, 0x000e58f44875ba97, under},
    {0xc073400000000000, 0x000730d67819e8d2, under},
    {0xc073600000000000, 0x000012688b70e62b, under},
    {0xc073800000000000, 0x0000002f201d49fb, under},
    {0xc073b00000000000, 0x000000000c1069cd, under},
    {0xc074000000000000, 0x00000000000007e8, under},
    {0xc074380000000000, 0x0000000000000001, under},
    {0xc074400000000000, 0x0000000000000000, under},
    {0x40733a70fffffffe, 0x7fcffeb937a1a071, none},
    {0x40733a70ffffffff, 0x7fcffeb937a1a50c, none},
    {0x40733a7100000000, 0x7fcffeb937a1a9a7, none},
    {0xc0733a70fffffffe, 0x001000a36ab3fe0e, none},
    {0xc0733a70ffffffff, 0x001000a36ab3fbc0, none},
    {0xc0733a7100000000, 0x001000a36ab3f973, none},
    {0x40734413509f79fd, 0x7feffffffffff706, none},
    {0x40734413509f79fe, 0x7feffffffffffba1, none},
    {0x40734413509f79ff, 0x7ff0000000000000, over},
    {0xc0733a7146f72a40, 0x001000000000047e, none},
    {0xc0733a7146f72a41, 0x0010000000000231, none},
    {0xc0733a7146f72a42, 0x000fffffffffffe3, under},
    {0xc07439b746e36b51, 0x0000000000000001, under},
    {0xc07439b746e36b52, 0x0000000000000001, under},
    {0xc07439b746e36b53, 0x0000000000000000, under},
    {0xc06422ef73041d0b, 0x1e7d237855eea418, none},
    {0xc05e887d9ebb443a, 0x26937b5cd690405c, none},
    {0x407255e17e851c26, 0x7cd75bef62c8f3df, none},
    {0x4029f1beb4026b00, 0x42a10f73e3646173, none},
    {0x403dbc7ea042dd90, 0x461b8282cf7082b9, none},
    {0xc072bf71103bd961, 0x01a739246c61bb74, none},
    {0xc04a07c9e59b3ba8, 0x3520a6da357d9b61, none},
    {0x40488ca046f55880, 0x4a212c8c90cf349b, none},
    {0xc0726b001a95a33f, 0x02c0c958a57bc5e9, none},
    {0x4051c66559ce2a70, 0x4eb23cece5f02b9d, none},
    {0x40544a2a939e9d4c, 0x50c85101944e9f1c, none},
    {0xc070e1c4e15a058d, 0x07da361bec285ce5, none},
};

constexpr point_of<std::uint64_t> exp10_d_la_points[] = {
    {0x0000000000000000, 0x3ff0000000000000, none},
    {0x8000000000000000, 0x3ff0000000000000, none},
    {0x0000000000000001, 0x3ff0000000000000, none},
    {0x8000000000000001, 0x3ff0000000000000, none},
    {0x3c80000000000000, 0x3ff0000000000000, none},
    {0xbc80000000000000, 0x3fefffffffffffff, none},
    {0x3ff0000000000000, 0x4024000000000000, none},
    {0xbff0000000000000, 0x3fb999999999999a, none},
    {0x3fd62e42fefa39ef, 0x4001c4dec40a0ca3, none},
    {0x3fe62e42fefa39f0, 0x4013bbcfbe75da8a, none},
    {0x4000000000000000, 0x4059000000000000, none},
    {0x4024000000000000, 0x4202a05f20000000, none},
    {0x4036000000000000, 0x4480f0cf064dd592, none},
    {0x4072c00000000000, 0x7e37e43c8800759c, none},
    {0xc072c00000000000, 0x01a56e1fc2f8f358, none},
    {0x4073400000000000, 0x7fe1ccf385ebc8a0, none},
    {0x4073440000000000, 0x7fefa788589d81d3, none},
    {0x4073480000000000, 0x7ff0000000000000, over},
    {0xc0733b3333333333, 0x000e58f44875ba97, under},
    {0xc073400000000000, 0x000730d67819e8d2, under},
    {0xc073600000000000, 0x000012688b70e62b, under},
    {0xc073800000000000, 0x0000002f201d49fb, under},
    {0xc073b00000000000, 0x000000000c1069cd, under},
    {0xc074000000000000, 0x00000000000007e8, under},
    {0xc074380000000000, 0x0000000000000001, under},
    {0xc074400000000000, 0x0000000000000000, under},
    {0x40733a70fffffffe, 0x7fcffeb937a1a071, none},
    {0x40733a70ffffffff, 0x7fcffeb937a1a50c, none},
    {0x40733a7100000000, 0x7fcffeb937a1a9a7, none},
    {0xc0733a70fffffffe, 0x001000a36ab3fe0e, none},
    {0xc0733a70ffffffff, 0x001000a36ab3fbc0, none},
    {0xc0733a7100000000, 0x001000a36ab3f973, none},
    {0x40734413509f79fd, 0x7feffffffffff706, none},
    {0x40734413509f79fe, 0x7feffffffffffba1, none},
    {0x40734413509f79ff, 0x7ff0000000000000, over},
    {0xc0733a7146f72a40, 0x001000000000047e, none},
    {0xc0733a7146f72a41, 0x0010000000000231, none},
    {0xc0733a7146f72a42, 0x000fffffffffffe3, under},
    {0xc07439b746e36b51, 0x0000000000000001, under},
    {0xc07439b746e36b52, 0x0000000000000001, under},
    {0xc07439b746e36b53, 0x0000000000000000, under},
    {0x40538bff0840ffa0, 0x502a9831fd6c84a5, none},
    {0xc034b8e47829e8d0, 0x3ba1e775dc1fa316, none},
    {0x405b850ab489f798, 0x56c9862994cf963e, none},
    {0xc056a122872142b0, 0x2d23c9e541e932e6, none},
    {0x405fc45126da13a0, 0x5a5141479313c17e, none},
    {0x406244e5d0aa3812, 0x5e46c8a57d547db4, none},
    {0xc0725614552c3ebf, 0x03054d13dfdb4178, none},
    {0xc070dce4bb2b7489, 0x07ea6f6cfb72a9bd, none},
    {0x405b04e4e2886480, 0x56603fb205b0835d, none},
    {0x4071c78396ed559c, 0x7affba237ddfc2aa, none},
    {0xc06319f31101b512, 0x2034b8e45cade150, none},
    {0xc03ad308c25464f0, 0x3a5dae233a045f0a, none},
};

constexpr point_of<std::uint64_t> exp10_d_ep_points[] = {
    {0x0000000000000000, 0x3ff0000000000000, none},
    {0x8000000000000000, 0x3ff0000000000000, none},
    {0x0000000000000001, 0x3ff0000000000000, none},
    {0x8000000000000001, 0x3ff0000000000000, none},
    {0x3c80000000000000, 0x3ff0000000000000, none},
    {0xbc80000000000000, 0x3fefffffffffffff, none},
    {0x3ff0000000000000, 0x4023ffffffb5fa99, none},
    {0xbff0000000000000, 0x3fb999999a42ff94, none},
    {0x3fd62e42fefa39ef, 0x4001c4dec3ea6e74, none},
    {0x3fe62e42fefa39f0, 0x4013bbcfbe0635d8, none},
    {0x4000000000000000, 0x40590000000e7bab, none},
    {0x4024000000000000, 0x4202a05f1f8c75c6, none},
    {0x4036000000000000, 0x4480f0cf06609b08, none},
    {0x4072c00000000000, 0x7e37e43c869fa10f, none},
    {0xc072c00000000000, 0x01a56e1fc3ee4d58, none},
    {0x4073400000000000, 0x7fe1ccf385ebc8a0, none},
    {0x4073440000000000, 0x7fefa788589d81d3, none},
    {0x4073480000000000, 0x7ff0000000000000, over},
    {0xc0733b3333333333, 0x000e58f44875ba97, under},
    {0xc073400000000000, 0x000730d67819e8d2, under},
    {0xc073600000000000, 0x000012688b70e62b, under},
    {0xc073800000000000, 0x0000002f201d49fb, under},
    {0xc073b00000000000, 0x000000000c1069cd, under},
    {0xc074000000000000, 0x00000000000007e8, under},
    {0xc074380000000000, 0x0000000000000001, under},
    {0xc074400000000000, 0x0000000000000000, under},
    {0x40733a70fffffffe, 0x7fcffeb937a164e8, none},
    {0x40733a70ffffffff, 0x7fcffeb937a16983, none},
    {0x40733a7100000000, 0x7fcffeb937a1a9a7, none},
    {0xc0733a70fffffffe, 0x001000a36ab41bce, none},
    {0xc0733a70ffffffff, 0x001000a36ab41981, none},
    {0xc0733a7100000000, 0x001000a36ab3f973, none},
    {0x40734413509f79fd, 0x7feffffffffff706, none},
    {0x40734413509f79fe, 0x7feffffffffffba1, none},
    {0x40734413509f79ff, 0x7ff0000000000000, over},
    {0xc0733a7146f72a40, 0x001000000000047e, none},
    {0xc0733a7146f72a41, 0x0010000000000231, none},
    {0xc0733a7146f72a42, 0x000fffffffffffe3, under},
    {0xc07439b746e36b51, 0x0000000000000001, under},
    {0xc07439b746e36b52, 0x0000000000000001, under},
    {0xc07439b746e36b53, 0x0000000000000000, under},
    {0x404c73449f14b0c8, 0x4bc037aa8b1830a8, none},
    {0xc05ba0484e18820a, 0x28fe1cc5a26e4576, none},
    {0xc054e20553c2124c, 0x2e96d990bb0fd96f, none},
    {0xc05cc14b2fc42d84, 0x280e168b99c35fb1, none},
    {0xc05415b9b2ff0da4, 0x2f415d632a07ee43, none},
    {0x404d5b15dc02e260, 0x4c2066b48c837a7b, none},
    {0xc05ea3535184c5e4, 0x267dacecbd1da253, none},
    {0xc052db1b733cdec0, 0x3045d50e41731754, none},
    {0x4064e5a0c51cde1c, 0x62a457000db547c9, none},
    {0xc0722786ad4f26f1, 0x03a0e465d7692604, none},
    {0x4045431ff95cfdd0, 0x48c3333ad64f8ec6, none},
    {0x40620caec3b2c4fa, 0x5de9883423634f71, none},
};

TEST(Exp10Float, Points) { expect_points<exp10_s>(exp10_s_points); }

TEST(Exp10Float, Digest) { EXPECT_EQ(digest<exp10_s>(0x1.f0c34c18p-9), 0x81f78ca9d4f334aeu); }

TEST(Exp10Float, MiddleBandReportsNothing) {
  expect_v11<exp10_s>(0x42200000, 0x7f800000, none);  // 40: infinite
  expect_v11<exp10_s>(0xc2340000, 0x00000001, none);  // -45: denormal
}

TEST(Exp10Float, ReportsBeyondTheMiddleBand) {
  expect_v11<exp10_s>(0x42380000, 0x7f800000, over);   // 46
  expect_v11<exp10_s>(0xc2380000, 0x00000000, under);  // -46
  expect_v11<exp10_s>(0x7f800000, 0x7f800000, over);
  expect_v11<exp10_s>(0xff800000, 0x00000000, under);
  expect_quiet_nans<exp10_s>();
}

TEST(Exp10Double, Points) {
  expect_points<exp10_d<tier::ha>>(exp10_d_ha_points);
  expect_points<exp10_d<tier::la>>(exp10_d_la_points);
  expect_points<exp10_d<tier::ep>>(exp10_d_ep_points);
}

TEST(Exp10Double, Digest) {
  EXPECT_EQ(digest<exp10_d<tier::ha>>(0x1.f6fd21f8p-6), 0x7ae6435696b4c516u);
  EXPECT_EQ(digest<exp10_d<tier::la>>(0x1.f6fd21f8p-6), 0x5412fe106a97334du);
  EXPECT_EQ(digest<exp10_d<tier::ep>>(0x1.f6fd21f8p-6), 0x89754ffb58639d01u);
}

template <typename Body>
class Exp10DoubleTier : public ::testing::Test {};
using double_tiers = ::testing::Types<exp10_d<tier::ha>, exp10_d<tier::la>, exp10_d<tier::ep>>;
TYPED_TEST_SUITE(Exp10DoubleTier, double_tiers);

TYPED_TEST(Exp10DoubleTier, SpecialsReportNothing) {
  expect_v11<TypeParam>(0x7ff0000000000000, 0x7ff0000000000000, none);
  expect_v11<TypeParam>(0xfff0000000000000, 0x0000000000000000, none);
  expect_quiet_nans<TypeParam>();
}

TYPED_TEST(Exp10DoubleTier, FarOutOfRange) {
  expect_v11<TypeParam>(0x7fefffffffffffff, 0x7ff0000000000000, over);
  expect_v11<TypeParam>(0xffefffffffffffff, 0x0000000000000000, under);
  expect_number<TypeParam>(-324, 0.0, under);
  expect_number<TypeParam>(309, std::numeric_limits<double>::infinity(), over);
}

/// The smallest denormal, and where the scale drops below that of denormals by its exponent alone.
TYPED_TEST(Exp10DoubleTier, Denormals) {
  expect_number<TypeParam>(-323.5, 0x1p-1074, under);
  expect_number<TypeParam>(-323.3, 0x1p-1074, under);
  expect_number<TypeParam>(-323, 0x2p-1074, under);
  const auto run = [](double x, double* y) { return TypeParam::call(&x, y); };
  double y = 0;
  EXPECT_EQ(run(-307.6526555685887, &y), none);
  EXPECT_GE(y, 0x1p-1022);
  EXPECT_EQ(run(-307.65265556858876, &y), under);
}

/// All tiers have one rare path.
TYPED_TEST(Exp10DoubleTier, RarePath) {
  expect_rare<TypeParam>(std::uint64_t{0}, named<std::uint64_t>::one, none);
  // Just below 2^-52, where 1 + x is the result.
  expect_rare<TypeParam>(std::uint64_t{0x3cafffffffffffff}, std::uint64_t{0x3ff0000000000001},
                         none);
  expect_rare<TypeParam>(std::uint64_t{0xbcafffffffffffff}, std::uint64_t{0x3feffffffffffffe},
                         none);
  pattern_source<std::uint64_t> source(23);
  for (int i = 0; i < 100'000; ++i) {
    const double x =
        -323.6 + static_cast<double>(source.below(1'000'000'000)) * (323.6 + 308.2) / 1e9;
    double expected = 0, y = 0;
    const std::uint32_t status = exp10_d<tier::ha>::rare(x, &expected);
    ASSERT_EQ(TypeParam::rare(x, &y), status);
    ASSERT_EQ(y, expected);
  }
}

}  // namespace
