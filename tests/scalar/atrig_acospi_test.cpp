// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/atrig/acospi.hpp"

#include "atrig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::acospi_d;
using scalar::acospi_s;
using scalar::tier;

/// Zeros, denormals, both sides of 1/2, 1 and the numbers before it, and random arguments: of the
/// steps of la, and the numbers next to the exact results.
constexpr point_of<std::uint32_t> acospi_s_la_points[] = {
    {0x00000000, 0x3f000000}, {0x80000000, 0x3f000000}, {0x00000001, 0x3f000000},
    {0x80000003, 0x3f000000}, {0x3effffff, 0x3eaaaaab}, {0x3f000000, 0x3eaaaaaa},
    {0x3f000001, 0x3eaaaaaa}, {0xbf000001, 0x3f2aaaaa}, {0xbf000000, 0x3f2aaaab},
    {0x3f800000, 0x00000000}, {0xbf800000, 0x3f800000}, {0x3f7fffff, 0x38e67b20},
    {0xbf7fffff, 0x3f7ff8cc}, {0x3f7ffffe, 0x3922f983}, {0x32800000, 0x3f000000},
    {0x3a83126f, 0x3effd647}, {0xbf3b349c, 0x3f42d5aa}, {0x3f31e2d6, 0x3e82cc0c},
    {0x3f070d78, 0x3ea56ecf}, {0xbefacf2f, 0x3f29b747}, {0xbc159544, 0x3f00be75},
    {0xbdcee275, 0x3f083ee9}, {0x3e9b3b30, 0x3ecdcc59}, {0x3f13d38c, 0x3e9bac54},
    {0xbf4ff1a3, 0x3f4d4115}, {0xbf717c71, 0x3f646ddb}, {0x3f28c108, 0x3e8ab303},
    {0x3f7e5178, 0x3d15876e}, {0x3f4dc62e, 0x3e4fac38}, {0x3f800000, 0x00000000},
    {0xb87f9255, 0x3f000145}, {0xbca31f7b, 0x3f019f6b},
};

constexpr point_of<std::uint32_t> acospi_s_nearest[] = {
    {0x00000000, 0x3f000000}, {0x80000000, 0x3f000000}, {0x00000001, 0x3f000000},
    {0x80000003, 0x3f000000}, {0x3effffff, 0x3eaaaaab}, {0x3f000000, 0x3eaaaaab},
    {0x3f000001, 0x3eaaaaaa}, {0xbf000001, 0x3f2aaaab}, {0xbf000000, 0x3f2aaaab},
    {0x3f800000, 0x00000000}, {0xbf800000, 0x3f800000}, {0x3f7fffff, 0x38e67b21},
    {0xbf7fffff, 0x3f7ff8cc}, {0x3f7ffffe, 0x3922f984}, {0x32800000, 0x3f000000},
    {0x3a83126f, 0x3effd647}, {0x3f697d53, 0x3e09b64d}, {0x3f6549a5, 0x3e163a71},
    {0xbf630bb3, 0x3f58de6d}, {0xbf548ba8, 0x3f4fd281}, {0x3f2bc682, 0x3e881f97},
    {0x3ef1a21e, 0x3eafe64c}, {0x3eadcdce, 0x3ec78e05}, {0xbec477e0, 0x3f201792},
    {0x3e58f941, 0x3edd342d}, {0x3e5abade, 0x3edceaf1}, {0x3f7621e5, 0x3db59663},
    {0x3f7ffef7, 0x3aea7f6a}, {0x3f7e5dd6, 0x3d135d08}, {0x3f7f0c94, 0x3ce0d130},
    {0xbca72961, 0x3f01a9b4}, {0xbf708809, 0x3f638719},
};

constexpr point_of<std::uint64_t> acospi_d_la_points[] = {
    {0x0000000000000000, 0x3fe0000000000000}, {0x8000000000000000, 0x3fe0000000000000},
    {0x0000000000000001, 0x3fe0000000000000}, {0x8000000000000003, 0x3fe0000000000000},
    {0x3fdfffffffffffff, 0x3fd5555555555556}, {0x3fe0000000000000, 0x3fd5555555555555},
    {0x3fe0000000000001, 0x3fd5555555555554}, {0xbfe0000000000001, 0x3fe5555555555556},
    {0xbfe0000000000000, 0x3fe5555555555556}, {0x3ff0000000000000, 0x0000000000000000},
    {0xbff0000000000000, 0x3ff0000000000000}, {0x3fefffffffffffff, 0x3e345f306dc9c883},
    {0xbfefffffffffffff, 0x3feffffffd7419f2}, {0x3feffffffffffffe, 0x3e3ccf6429be6622},
    {0x3e50000000000000, 0x3fdffffffae833e5}, {0x3f50624dd2f1a9fc, 0x3fdffac8e94e24bb},
    {0xbfe766938372453e, 0x3fe85ab53f043f3a}, {0x3fe63c5ab66b09f0, 0x3fd059818a4f38c2},
    {0x3fe0e1aef0813e26, 0x3fd4add9dbb33f72}, {0xbfdf59e5ee1d0148, 0x3fe536e8d70b8e2b},
    {0xbf82b2a87a632180, 0x3fe017cea5a6919b}, {0xbfb9dc4ea1c6bbf0, 0x3fe107dd1d410292},
    {0x3fd367660612e768, 0x3fd9b98b1c8c0b7f}, {0x3fe27a7181adfcc8, 0x3fd3758a796d1a65},
    {0xbfe9fe345c18de9c, 0x3fe9a8229ba95476}, {0xbfee2f8e10da7c9a, 0x3fec8dbb40d98b93},
    {0x3fe5182106669978, 0x3fd15660595cde68}, {0x3fefca2efc189989, 0x3fa2b0ee6a5288a5},
    {0x3fe9b8c5bd11c3b2, 0x3fc9f5870fdc3633}, {0x3fefffffffffffff, 0x3e345f306dc9c883},
    {0xbf0ff24aa8c26dfe, 0x3fe00028aceca0bf}, {0xbf9463ef605a40d7, 0x3fe033ed558599bf},
};

constexpr point_of<std::uint64_t> acospi_d_nearest[] = {
    {0x0000000000000000, 0x3fe0000000000000}, {0x8000000000000000, 0x3fe0000000000000},
    {0x0000000000000001, 0x3fe0000000000000}, {0x8000000000000003, 0x3fe0000000000000},
    {0x3fdfffffffffffff, 0x3fd5555555555556}, {0x3fe0000000000000, 0x3fd5555555555555},
    {0x3fe0000000000001, 0x3fd5555555555555}, {0xbfe0000000000001, 0x3fe5555555555556},
    {0xbfe0000000000000, 0x3fe5555555555555}, {0x3ff0000000000000, 0x0000000000000000},
    {0xbff0000000000000, 0x3ff0000000000000}, {0x3fefffffffffffff, 0x3e345f306dc9c883},
    {0xbfefffffffffffff, 0x3feffffffd7419f2}, {0x3feffffffffffffe, 0x3e3ccf6429be6621},
    {0x3e50000000000000, 0x3fdffffffae833e5}, {0x3f50624dd2f1a9fc, 0x3fdffac8e94e24bb},
    {0x3fed2faa5ee7a5dc, 0x3fc136c9a148b0b4}, {0x3feca9349ecadd7e, 0x3fc2c74e25f9ef58},
    {0xbfec61765f446f32, 0x3feb1bcda1bce861}, {0xbfea91750d1c8de8, 0x3fe9fa502c4e9463},
    {0x3fe578d0495a4882, 0x3fd103f2da6bb308}, {0x3fde3443bcf1822c, 0x3fd5fcc97bcfa926},
    {0x3fd5b9b9cda94e3c, 0x3fd8f1c0a9f98259}, {0xbfd88efc0bf983cc, 0x3fe402f2431d5552},
    {0x3fcb1f2826ca7f18, 0x3fdba685982bc4f5}, {0x3fcb575bc124bc88, 0x3fdb9d5e165d2063},
    {0x3feec43c9b70ccfc, 0x3fb6b2cc82ce5003}, {0x3fefffdee566cc8f, 0x3f5d4d8959d9ab9e},
    {0x3fefcbbac9b3d8ad, 0x3fa26b9f532e81ef}, {0x3fefe1928282cd92, 0x3f9c1a24de087074},
    {0xbf94e52c1067dcf7, 0x3fe03536801cb971}, {0xbfee11012f4feab5, 0x3fec70e32224e902},
};

TEST(AcospiFloat, Points) {
  expect_near_points<acospi_s<tier::ha>>(acospi_s_nearest, 1);
  expect_points<acospi_s<tier::la>>(acospi_s_la_points);
  expect_points<acospi_s<tier::ep>>(acospi_s_la_points);
}

TEST(AcospiDouble, Points) {
  expect_near_points<acospi_d<tier::ha>>(acospi_d_nearest, 1);
  expect_points<acospi_d<tier::la>>(acospi_d_la_points);
  expect_near_points<acospi_d<tier::ep>>(acospi_d_nearest, 60'000'000);
}

TEST(AcospiFloat, Digest) { EXPECT_EQ(digest<acospi_s<tier::la>>(1e-4), 0x634838d74960b5fbu); }
TEST(AcospiDouble, Digest) { EXPECT_EQ(digest<acospi_d<tier::la>>(1e-4), 0x72da3d53ec90acb8u); }

template <typename Body>
class Acospi : public ::testing::Test {};
using all_bodies = ::testing::Types<acospi_s<tier::ha>, acospi_s<tier::la>, acospi_s<tier::ep>,
                                    acospi_d<tier::ha>, acospi_d<tier::la>, acospi_d<tier::ep>>;
TYPED_TEST_SUITE(Acospi, all_bodies);

TYPED_TEST(Acospi, EndsAndMiddle) {
  using T = typename TypeParam::input_type;
  expect_number<TypeParam>(T(1), T(0));
  expect_number<TypeParam>(T(-1), T(1));
  expect_number<TypeParam>(T(0), T(0.5));
  expect_number<TypeParam>(-T(0), T(0.5));
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
TEST(AcospiFloat, Domain) {
  expect_domain_but_nans<acospi_s<tier::ha>>();
  expect_domain_but_nans<acospi_s<tier::la>>();
  expect_domain_but_nans<acospi_s<tier::ep>>();
}
TEST(AcospiDouble, Domain) {
  expect_domain_of_unit_interval<acospi_d<tier::ha>>();
  expect_domain_of_unit_interval<acospi_d<tier::la>>();
  expect_domain_of_unit_interval<acospi_d<tier::ep>>();
}

}  // namespace
