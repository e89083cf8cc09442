// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/atrig/asinpi.hpp"

#include "atrig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::asinpi_d;
using scalar::asinpi_s;
using scalar::tier;

/// Zeros, denormals, both sides of 1/2, 1 and the numbers before it, and random arguments: of the
/// steps of la, and the numbers next to the exact results.
constexpr point_of<std::uint32_t> asinpi_s_la_points[] = {
    {0x00000000, 0x00000000}, {0x80000000, 0x80000000}, {0x00000001, 0x00000000},
    {0x80000003, 0x80000001}, {0x3effffff, 0x3e2aaaa9}, {0x3f000000, 0x3e2aaaaa},
    {0x3f000001, 0x3e2aaaac}, {0xbf000001, 0xbe2aaaac}, {0xbf000000, 0xbe2aaaaa},
    {0x3f800000, 0x3f000000}, {0xbf800000, 0xbf000000}, {0x3f7fffff, 0x3efff198},
    {0xbf7fffff, 0xbefff198}, {0x3f7ffffe, 0x3effeba1}, {0x32800000, 0x31a2f983},
    {0x3a83126f, 0x39a6e2d6}, {0xbf3b349c, 0xbe85ab54}, {0x3f31e2d6, 0x3e7a67ea},
    {0x3f070d78, 0x3e352263}, {0xbefacf2f, 0xbe26dd1b}, {0xbc159544, 0xbb3e752d},
    {0xbdcee275, 0xbd03ee8e}, {0x3e9b3b30, 0x3dc8ce9c}, {0x3f13d38c, 0x3e48a758},
    {0xbf4ff1a3, 0xbe9a822a}, {0xbf717c71, 0xbec8dbb5}, {0x3f28c108, 0x3e6a99fa},
    {0x3f7e5178, 0x3eed4f13}, {0x3f4dc62e, 0x3e9829e4}, {0x3f800000, 0x3f000000},
    {0xb87f9255, 0xb7a2b3b2}, {0xbca31f7b, 0xbbcfb556},
};

constexpr point_of<std::uint32_t> asinpi_s_nearest[] = {
    {0x00000000, 0x00000000}, {0x80000000, 0x80000000}, {0x00000001, 0x00000000},
    {0x80000003, 0x80000001}, {0x3effffff, 0x3e2aaaaa}, {0x3f000000, 0x3e2aaaab},
    {0x3f000001, 0x3e2aaaac}, {0xbf000001, 0xbe2aaaac}, {0xbf000000, 0xbe2aaaab},
    {0x3f800000, 0x3f000000}, {0xbf800000, 0xbf000000}, {0x3f7fffff, 0x3efff198},
    {0xbf7fffff, 0xbefff198}, {0x3f7ffffe, 0x3effeba1}, {0x32800000, 0x31a2f983},
    {0x3a83126f, 0x39a6e2d7}, {0x3f697d53, 0x3ebb24da}, {0x3f6549a5, 0x3eb4e2c7},
    {0xbf630bb3, 0xbeb1bcda}, {0xbf548ba8, 0xbe9fa502}, {0x3f2bc682, 0x3e6fc0d2},
    {0x3ef1a21e, 0x3e203368}, {0x3eadcdce, 0x3de1c7ea}, {0xbec477e0, 0xbe005e48},
    {0x3e58f941, 0x3d8b2f4d}, {0x3e5abade, 0x3d8c543d}, {0x3f7621e5, 0x3ed29a67},
    {0x3f7ffef7, 0x3eff1581}, {0x3f7e5dd6, 0x3eed945f}, {0x3f7f0c94, 0x3ef1f2ed},
    {0xbca72961, 0xbbd4da01}, {0xbf708809, 0xbec70e31},
};

constexpr point_of<std::uint64_t> asinpi_d_la_points[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000000}, {0x8000000000000003, 0x8000000000000001},
    {0x3fdfffffffffffff, 0x3fc5555555555554}, {0x3fe0000000000000, 0x3fc5555555555556},
    {0x3fe0000000000001, 0x3fc5555555555557}, {0xbfe0000000000001, 0xbfc5555555555557},
    {0xbfe0000000000000, 0xbfc5555555555556}, {0x3ff0000000000000, 0x3fe0000000000000},
    {0xbff0000000000000, 0xbfe0000000000000}, {0x3fefffffffffffff, 0x3fdffffffae833e5},
    {0xbfefffffffffffff, 0xbfdffffffae833e5}, {0x3feffffffffffffe, 0x3fdffffff8cc26f6},
    {0x3e50000000000000, 0x3e345f306dc9c883}, {0x3f50624dd2f1a9fc, 0x3f34dc5ac76d1273},
    {0xbfe766938372453e, 0xbfd0b56a7e087e74}, {0x3fe63c5ab66b09f0, 0x3fcf4cfceb618e7c},
    {0x3fe0e1aef0813e26, 0x3fc6a44c4899811c}, {0xbfdf59e5ee1d0148, 0xbfc4dba35c2e38ad},
    {0xbf82b2a87a632180, 0xbf67cea5a6919aad}, {0xbfb9dc4ea1c6bbf0, 0xbfa07dd1d4102919},
    {0x3fd367660612e768, 0x3fb919d38dcfd202}, {0x3fe27a7181adfcc8, 0x3fc914eb0d25cb37},
    {0xbfe9fe345c18de9c, 0xbfd350453752a8ed}, {0xbfee2f8e10da7c9a, 0xbfd91b7681b31726},
    {0x3fe5182106669978, 0x3fcd533f4d464331}, {0x3fefca2efc189989, 0x3fdda9e232b5aeeb},
    {0x3fe9b8c5bd11c3b2, 0x3fd3053c7811e4e6}, {0x3fefffffffffffff, 0x3fdffffffae833e5},
    {0xbf0ff24aa8c26dfe, 0xbef45676505f50f3}, {0xbf9463ef605a40d7, 0xbf79f6aac2ccdf5b},
};

constexpr point_of<std::uint64_t> asinpi_d_nearest[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000000}, {0x8000000000000003, 0x8000000000000001},
    {0x3fdfffffffffffff, 0x3fc5555555555555}, {0x3fe0000000000000, 0x3fc5555555555555},
    {0x3fe0000000000001, 0x3fc5555555555557}, {0xbfe0000000000001, 0xbfc5555555555557},
    {0xbfe0000000000000, 0xbfc5555555555555}, {0x3ff0000000000000, 0x3fe0000000000000},
    {0xbff0000000000000, 0xbfe0000000000000}, {0x3fefffffffffffff, 0x3fdffffffae833e5},
    {0xbfefffffffffffff, 0xbfdffffffae833e5}, {0x3feffffffffffffe, 0x3fdffffff8cc26f6},
    {0x3e50000000000000, 0x3e345f306dc9c883}, {0x3f50624dd2f1a9fc, 0x3f34dc5ac76d1273},
    {0x3fed2faa5ee7a5dc, 0x3fd7649b2f5ba7a6}, {0x3feca9349ecadd7e, 0x3fd69c58ed030854},
    {0xbfec61765f446f32, 0xbfd6379b4379d0c1}, {0xbfea91750d1c8de8, 0xbfd3f4a0589d28c7},
    {0x3fe578d0495a4882, 0x3fcdf81a4b2899ef}, {0x3fde3443bcf1822c, 0x3fc4066d0860adb3},
    {0x3fd5b9b9cda94e3c, 0x3fbc38fd5819f69a}, {0xbfd88efc0bf983cc, 0xbfc00bc90c75554a},
    {0x3fcb1f2826ca7f18, 0x3fb165e99f50ec2d}, {0x3fcb575bc124bc88, 0x3fb18a87a68b7e73},
    {0x3feec43c9b70ccfc, 0x3fda534cdf4c6bff}, {0x3fefffdee566cc8f, 0x3fdfe2b276a62654},
    {0x3fefcbbac9b3d8ad, 0x3fddb28c159a2fc2}, {0x3fefe1928282cd92, 0x3fde3e5db21f78f9},
    {0xbf94e52c1067dcf7, 0xbf7a9b400e5cb8a6}, {0xbfee11012f4feab5, 0xbfd8e1c64449d203},
};

TEST(AsinpiFloat, Points) {
  expect_near_points<asinpi_s<tier::ha>>(asinpi_s_nearest, 1);
  expect_points<asinpi_s<tier::la>>(asinpi_s_la_points);
  expect_points<asinpi_s<tier::ep>>(asinpi_s_la_points);
}

TEST(AsinpiDouble, Points) {
  expect_near_points<asinpi_d<tier::ha>>(asinpi_d_nearest, 1);
  expect_points<asinpi_d<tier::la>>(asinpi_d_la_points);
  expect_near_points<asinpi_d<tier::ep>>(asinpi_d_nearest, 60'000'000);
}

TEST(AsinpiFloat, Digest) { EXPECT_EQ(digest<asinpi_s<tier::la>>(1e-4), 0xf48069180364e4e3u); }
TEST(AsinpiDouble, Digest) { EXPECT_EQ(digest<asinpi_d<tier::la>>(1e-4), 0x7d88e58aa4624967u); }

template <typename Body>
class Asinpi : public ::testing::Test {};
using all_bodies = ::testing::Types<asinpi_s<tier::ha>, asinpi_s<tier::la>, asinpi_s<tier::ep>,
                                    asinpi_d<tier::ha>, asinpi_d<tier::la>, asinpi_d<tier::ep>>;
TYPED_TEST_SUITE(Asinpi, all_bodies);

TYPED_TEST(Asinpi, Ends) {
  using T = typename TypeParam::input_type;
  expect_number<TypeParam>(T(1), T(0.5));
  expect_number<TypeParam>(T(-1), T(-0.5));
  expect_number<TypeParam>(T(0), T(0));
  expect_number<TypeParam>(-T(0), -T(0));
}

/// At ha the result of a tiny argument is x/pi, correctly rounded also where it is denormal.
TEST(AsinpiFloat, TinyHa) {
  pattern_source<std::uint32_t> source(79);
  for (int i = 0; i < 10'000; ++i) {
    const float x = element<float>::value(static_cast<std::uint32_t>(source.below(0x12800000)));
    float y = 0;
    EXPECT_EQ(asinpi_s<tier::ha>::call(&x, &y), 0u);
    EXPECT_EQ(y, static_cast<float>(x / 3.14159265358979323846264338327950288L)) << x;
  }
}
TEST(AsinpiDouble, TinyHa) {
  pattern_source<std::uint64_t> source(80);
  for (int i = 0; i < 10'000; ++i) {
    const double x = element<double>::value(source.below(0x0060000000000000));
    double y = 0;
    EXPECT_EQ(asinpi_d<tier::ha>::call(&x, &y), 0u);
    // x/pi with the exponent raised by 200, in 64 bits: within 0.501 ulp of the format.
    const long double exact = std::ldexp(x / 3.14159265358979323846264338327950288L, 200);
    const int unit = std::max(std::ilogb(y), -1022) - 52;
    EXPECT_LE(std::fabs(std::ldexp(static_cast<long double>(y), 200) - exact),
              0.501L * std::ldexp(1.0L, unit + 200))
        << x;
  }
}

/// At double every NaN is outside the domain, at float none is.
template <typename Body>
void expect_domain_but_nans() {
  using n = named<std::uint32_t>;
  for (const std::uint32_t sign : {0u, n::sign}) {
    for (const std::uint32_t x : {n::one + 1, n::one + 0x00400000, n::largest, n::inf})
      expect_v11<Body>(x | sign, n::nan | sign, domain);
  }
  expect_quiet_nans<Body>();
}
TEST(AsinpiFloat, Domain) {
  expect_domain_but_nans<asinpi_s<tier::ha>>();
  expect_domain_but_nans<asinpi_s<tier::la>>();
  expect_domain_but_nans<asinpi_s<tier::ep>>();
}
TEST(AsinpiDouble, Domain) {
  expect_domain_of_unit_interval<asinpi_d<tier::ha>>();
  expect_domain_of_unit_interval<asinpi_d<tier::la>>();
  expect_domain_of_unit_interval<asinpi_d<tier::ep>>();
}

}  // namespace
