// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/atrig/atan2.hpp"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <random>

#include "atrig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::atan2_d;
using scalar::atan2_s;
using scalar::tier;

constexpr long double pi = 3.14159265358979323846264338327950288L;

/// The octants, denormals, the ends of the range without scaling, and random pairs.
constexpr pair_of<std::uint32_t> atan2_s_la_pairs[] = {
    {0x3f800000, 0x3f800000, 0x3f490fda}, {0xbf800000, 0x3f800000, 0xbf490fda},
    {0x3f800000, 0xbf800000, 0x4016cbe4}, {0xbf800000, 0xbf800000, 0xc016cbe4},
    {0x3f800000, 0x3f800001, 0x3f490fd9}, {0x3f800001, 0x3f800000, 0x3f490fdd},
    {0x3f800000, 0xbf800001, 0x4016cbe5}, {0x00000000, 0x3f800000, 0x00000000},
    {0x80000000, 0xbf800000, 0xc0490fdb}, {0x3f800000, 0x00000000, 0x3fc90fdb},
    {0xbf800000, 0x80000000, 0xbfc90fdb}, {0x00000001, 0x00000001, 0x3f490fda},
    {0x00000001, 0x00000003, 0x3ea4bc7d}, {0x007fffff, 0x00800000, 0x3f490fd9},
    {0x00800000, 0x007fffff, 0x3f490fdd}, {0x807fffff, 0x007ffffe, 0xbf490fdd},
    {0x7e800000, 0x3f800000, 0x3fc90fdb}, {0x7e800001, 0x7e000000, 0x3f8db70d},
    {0x7f7fffff, 0xff7fffff, 0x4016cbe4}, {0x7f7fffff, 0x7f7ffffe, 0x3f490fdc},
    {0x3f800000, 0x7f7fffff, 0x00200000}, {0x00400000, 0x7f000000, 0x00000000},
    {0x00000001, 0x3f000000, 0x00000002}, {0x00000001, 0xbf000000, 0x40490fdb},
    {0x00ffffff, 0x80400000, 0x3fe86b51}, {0xbf3b349c, 0x3f31e2d6, 0xbf4f9863},
    {0x3f070d78, 0xbefacf2f, 0x40146d44}, {0xbc159544, 0xbdcee275, 0xc0434b1c},
    {0x3e9b3b30, 0x3f13d38c, 0x3ef78b11}, {0xbf4ff1a3, 0xbf717c71, 0xc01b906a},
    {0x3f2be967, 0xbe09b16b, 0x3fe25b9c}, {0x3f064993, 0xbf7eebf5, 0x402a083a},
    {0xbddfb1ad, 0x3ee2db64, 0xbe777f00}, {0xbf0adfae, 0x3f63fa85, 0xbf0c1032},
    {0x3f4d87e6, 0xbf705682, 0x401bc855}, {0xbf72f8c3, 0x3da9a020, 0xbfbdeb8c},
    {0x3f60d829, 0xbe734b31, 0x3feae0d8}, {0xbf1119e2, 0xbe1f8158, 0xbfeb641e},
    {0xbf712191, 0xbf0e7e6e, 0xc006b092}, {0xbdfe6994, 0xbc093977, 0xbfd1adcf},
    {0xbf08a928, 0xbf09cbdc, 0xc0170fae}, {0xbe3be92c, 0xb5434cd4, 0xbfc90ffc},
    {0x404eb5ce, 0x38452830, 0x3fc90f61}, {0x46a621ba, 0xbbf04468, 0x3fc90fde},
    {0x431aa8ba, 0x3dce3bdc, 0x3fc8fa85}, {0x42945b10, 0xc08eb1e9, 0x3fd0bf58},
    {0x46303bed, 0x3dff4574, 0x3fc90f7e}, {0xba42deda, 0x3d62738a, 0xbc5c48fa},
    {0xc021efa1, 0x424cf886, 0xbd4a1657},
};

constexpr pair_of<std::uint64_t> atan2_d_la_pairs[] = {
    {0x3ff0000000000000, 0x3ff0000000000000, 0x3fe921fb54442d18},
    {0xbff0000000000000, 0x3ff0000000000000, 0xbfe921fb54442d18},
    {0x3ff0000000000000, 0xbff0000000000000, 0x4002d97c7f3321d2},
    {0xbff0000000000000, 0xbff0000000000000, 0xc002d97c7f3321d2},
    {0x3ff0000000000000, 0x3ff0000000000001, 0x3fe921fb54442d17},
    {0x3ff0000000000001, 0x3ff0000000000000, 0x3fe921fb54442d19},
    {0x3ff0000000000000, 0xbff0000000000001, 0x4002d97c7f3321d2},
    {0x0000000000000000, 0x3ff0000000000000, 0x0000000000000000},
    {0x8000000000000000, 0xbff0000000000000, 0xc00921fb54442d18},
    {0x3ff0000000000000, 0x0000000000000000, 0x3ff921fb54442d18},
    {0xbff0000000000000, 0x8000000000000000, 0xbff921fb54442d18},
    {0x3fed2faa5ee7a5dc, 0x3feca9349ecadd7e, 0x3fe96c5c4beb8455},
    {0xbfec61765f446f32, 0xbfea91750d1c8de8, 0xc00295f4d5807353},
    {0x3fe578d0495a4882, 0x3fde3443bcf1822c, 0x3feea68efc0d2b9c},
    {0x3fd5b9b9cda94e3c, 0xbfd88efc0bf983cc, 0x400356b024232502},
    {0x3fcb1f2826ca7f18, 0x3fcb575bc124bc88, 0x3fe900f5dc7d1a62},
    {0x3fc4c9c955ccc4c8, 0xbfe5dd0e18009370, 0x4007440857a9c3a5},
    {0xbfc1bfa26b91a490, 0xbfcb417fa6485708, 0xc00483dc9f61ef0c},
    {0x3fdc8ba8edc38f50, 0x3fefab1fac1291f4, 0x3fdb197d0dd0e6ce},
    {0x3fecc2e53af9fabe, 0x3fb69e5fbbe2b340, 0x3ff7909efead330c},
    {0xbfbc3c125fde2130, 0xbfddaa499194a724, 0xc007439170c93cfa},
    {0xbfedb36a71081fde, 0xbfee3e57ed167f9c, 0xc002ec06d51987bc},
    {0xbfb1f96e845ca050, 0xbfd73c88e179db08, 0xc0079ac222db0471},
    {0xbfceb7579271c770, 0x3fe9131417129070, 0xbfd304fe68050aa3},
    {0x3faa5eef150df4e0, 0x3fbefb36cb5b1e50, 0x3fd9c078eb8b438e},
    {0xbfe0e35aa627b9ca, 0xbfee791bf69613d6, 0xc0051592201781ec},
    {0xbfd661b76d38fb00, 0xbfe7405993eb2dba, 0xc0058b4cddeaa2c6},
    {0x45d172161c4c77ed, 0x3bdcd62d1668a429, 0x3ff921fb54442d18},
    {0x43a01303ea41001a, 0x44f2b5eab0671086, 0x3e9b7dbe52ff66dd},
    {0x43803f0986c11d75, 0xc5d56db18f7fcef9, 0x400921fb5443fc92},
    {0x3bb16b408848a9b9, 0x4290999372496444, 0x3910ca193e3111f6},
    {0xc014c233e0f2a032, 0xc4e3fb1b0dc9a9c1, 0xc00921fb54442d18},
    {0x438105d80c08ebd9, 0xc49bc2be25554617, 0x400921f8e059def7},
    {0x3f6d6f2bd535034e, 0x4502251ae90486e3, 0x3a59f46d4844e2df},
    {0x3fb1e62e30fb0043, 0xbdb1005f18356336, 0x3ff921fb54535fab},
};

TEST(Atan2Float, Points) { expect_pairs<atan2_s<tier::la>>(atan2_s_la_pairs); }
TEST(Atan2Double, Points) {
  expect_pairs<atan2_d<tier::la>>(atan2_d_la_pairs);
  expect_pairs<atan2_d<tier::ep>>(atan2_d_la_pairs);
}

TEST(Atan2Float, Digest) { EXPECT_EQ(pair_digest<atan2_s<tier::la>>(), 0x74c61f6351c403d3u); }
TEST(Atan2Double, Digest) { EXPECT_EQ(pair_digest<atan2_d<tier::la>>(), 0x0eddacc263d67d35u); }

TEST(Atan2Float, Angles) {
  expect_angles<atan2_s<tier::ha>>(pi, 1);
  expect_angles<atan2_s<tier::la>>(pi, 3);
  expect_angles<atan2_s<tier::ep>>(pi, 2300);
}

TEST(Atan2Double, Angles) {
  expect_angles<atan2_d<tier::ha>>(pi, 1);
  expect_angles<atan2_d<tier::la>>(pi, 3);
  expect_angles<atan2_d<tier::ep>>(pi, 3);
}

/// A NaN operand is returned quietened, the abscissa before the ordinate.
TEST(Atan2Float, WhichNan) {
  expect_v21<atan2_s<tier::la>>(0x7f800005, 0x3f800000, 0x7fc00005);
  expect_v21<atan2_s<tier::la>>(0x3f800000, 0xff800007, 0xffc00007);
  expect_v21<atan2_s<tier::la>>(0x7f800005, 0xff800007, 0xffc00007);
}

/// The larger magnitudes that are served without scaling, and zeros that are not.
TEST(Atan2Float, RangeOfTheMainPath) {
  const auto stands = []<tier t>(std::uint32_t y, std::uint32_t x) {
    return atan2_s<t>::main(element<float>::value(y), element<float>::value(x)).rare == 0;
  };
  const auto la = [&](std::uint32_t y, std::uint32_t x) {
    return stands.template operator()<tier::la>(y, x);
  };
  const auto ha = [&](std::uint32_t y, std::uint32_t x) {
    return stands.template operator()<tier::ha>(y, x);
  };
  EXPECT_TRUE(la(0x00800000, 1));
  EXPECT_FALSE(la(0x007fffff, 1));
  EXPECT_TRUE(la(1, 0xfe800000));
  EXPECT_FALSE(la(1, 0xfe800001));
  EXPECT_FALSE(la(0x3f800000, 0));
  EXPECT_FALSE(la(0x80000000, 0x3f800000));
  EXPECT_TRUE(ha(0x0c800000, 0x0c800000));
  EXPECT_FALSE(ha(0x20000000, 0x0c7fffff));
  EXPECT_TRUE(ha(0x7e800000, 0x0c800000));
  EXPECT_FALSE(ha(0x7e800001, 0x0c800000));
}

/// Where the error of an unscaled quotient would underflow.
TEST(Atan2Float, SmallMagnitudes) {
  const auto expect_within_one_ulp = [](std::uint32_t y_bits, std::uint32_t x_bits) {
    const float y = element<float>::value(y_bits), x = element<float>::value(x_bits);
    float r;
    EXPECT_EQ(atan2_s<tier::ha>::call(&y, &x, &r), 0u);
    const long double exact = std::atan2(static_cast<long double>(y), static_cast<long double>(x));
    const int exponent = std::max(std::ilogb(exact) - 23, -149);
    EXPECT_LE(std::fabs(static_cast<long double>(r) - exact), std::ldexp(1.0L, exponent))
        << std::hex << y_bits << ", " << x_bits;
  };
  expect_within_one_ulp(0x80a6e058, 0x2aa81d20);
  std::mt19937 engine(102);
  for (int i = 0; i < 200'000; ++i) {
    // One magnitude below 2^-100, the other one from there to 2^127, any signs, either order.
    const std::uint32_t small = engine() % 0x0d800000u + 1;
    const std::uint32_t large = small + engine() % (0x7f7fffffu - small);
    const std::uint32_t signs = engine();
    const std::uint32_t a = small | (signs & 0x80000000u), b = large | ((signs << 1) & 0x80000000u);
    if (i % 4 == 0)
      expect_within_one_ulp(b, a);
    else
      expect_within_one_ulp(a, b);
  }
}

/// A zero beside any number stays on the main path of la, whose quotient is then 0.
TEST(Atan2Double, RangeOfTheMainPath) {
  const auto stands = [](std::uint64_t y, std::uint64_t x) {
    return atan2_d<tier::la>::main(element<double>::value(y), element<double>::value(x)).rare == 0;
  };
  constexpr std::uint64_t one = 0x3ff0000000000000, smallest = 0x0030000000000000;
  EXPECT_TRUE(stands(smallest, one));
  EXPECT_FALSE(stands(smallest - 1, one));
  EXPECT_TRUE(stands(one, 0x7dffffffffffffff));
  EXPECT_FALSE(stands(one, 0x7e00000000000000));
  EXPECT_TRUE(stands(0, one));
  EXPECT_TRUE(stands(0, 0xfff0000000000000));
  EXPECT_TRUE(stands(1, 0x8000000000000000));
  EXPECT_FALSE(stands(0, 0));
  EXPECT_FALSE(stands(0, 0x7ff8000000000000));
  EXPECT_FALSE(stands(0x7ff8000000000000, 0));
}

/// The careful routine serves any pair: also those of the main path.
TEST(Atan2Double, CarefulRoutine) {
  pattern_source<std::uint64_t> source(78);
  for (int i = 0; i < 20'000; ++i) {
    const double y = element<double>::value(source.finite());
    const double x = element<double>::value(source.near(std::bit_cast<std::uint64_t>(y), 8));
    if (y == 0 || x == 0) continue;
    const double angle = scalar::careful_angle<scalar::radians>(y, x);
    const long double exact = std::atan2(static_cast<long double>(y), static_cast<long double>(x));
    ASSERT_LE(std::fabs(static_cast<long double>(angle) - exact),
              0.501L * std::ldexp(1.0L, std::max(std::ilogb(angle), -1022) - 52))
        << y << " " << x;
  }
}

}  // namespace
