// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/atrig/acos.hpp"

#include "atrig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::acos_d;
using scalar::acos_s;
using scalar::tier;

/// Zeros, denormals, both sides of 1/2, 1 and the numbers before it, and random arguments.
constexpr point_of<std::uint32_t> acos_s_points[] = {
    {0x00000000, 0x3fc90fdb}, {0x80000000, 0x3fc90fdb}, {0x00000001, 0x3fc90fdb},
    {0x80000003, 0x3fc90fdb}, {0x3effffff, 0x3f860a92}, {0x3f000000, 0x3f860a92},
    {0x3f000001, 0x3f860a92}, {0xbf000001, 0x40060a92}, {0xbf000000, 0x40060a92},
    {0x3f800000, 0x00000000}, {0xbf800000, 0x40490fdb}, {0x3f7fffff, 0x39b504f3},
    {0xbf7fffff, 0x40490a33}, {0x3f7ffffe, 0x3a000000}, {0x32800000, 0x3fc90fdb},
    {0x3a83126f, 0x3fc8ef16}, {0xbf3b349c, 0x401905d4}, {0x3f31e2d6, 0x3f4d749e},
    {0x3f070d78, 0x3f81ee3f}, {0xbefacf2f, 0x40054b69}, {0xbc159544, 0x3fca3b07},
    {0xbdcee275, 0x3fd603aa}, {0x3e9b3b30, 0x3fa1a231}, {0x3f13d38c, 0x3f7487e4},
    {0xbf4ff1a3, 0x402134d0}, {0xbf717c71, 0x40336866}, {0x3f28c108, 0x3f59de49},
    {0x3f7e5178, 0x3deae130}, {0x3f4dc62e, 0x3f231b14}, {0x3f800000, 0x00000000},
    {0xb87f9255, 0x3fc911da}, {0xbca31f7b, 0x3fcb9c64},
};

constexpr point_of<std::uint64_t> acos_d_la_points[] = {
    {0x0000000000000000, 0x3ff921fb54442d18}, {0x8000000000000000, 0x3ff921fb54442d18},
    {0x0000000000000001, 0x3ff921fb54442d18}, {0x8000000000000003, 0x3ff921fb54442d18},
    {0x3fdfffffffffffff, 0x3ff0c152382d7366}, {0x3fe0000000000000, 0x3ff0c152382d7366},
    {0x3fe0000000000001, 0x3ff0c152382d7364}, {0xbfe0000000000001, 0x4000c152382d7366},
    {0xbfe0000000000000, 0x4000c152382d7365}, {0x3ff0000000000000, 0x0000000000000000},
    {0xbff0000000000000, 0x400921fb54442d18}, {0x3fefffffffffffff, 0x3e50000000000000},
    {0xbfefffffffffffff, 0x400921fb52442d18}, {0x3feffffffffffffe, 0x3e56a09e667f3bcd},
    {0x3e50000000000000, 0x3ff921fb50442d18}, {0x3f50624dd2f1a9fc, 0x3ff91de2c0c3fca5},
    {0xbfe0c5300342457c, 0x4000fab753f01ed1}, {0x3fb6a5368858d8d0, 0x3ff7b72e86a8630d},
    {0xbfd0a54f21584a44, 0x3ffd57b3789b1aee}, {0x3fca9a80ef2b7250, 0x3ff5c86adac813e5},
    {0x3fd0179a594b2b8c, 0x3ff510e873285ca8}, {0xbfebce600b27bb70, 0x4004fda8f87a8337},
    {0xbfef284170babd6c, 0x40074aeb9ec8cb52}, {0x3fe59917ebc0fce2, 0x3fea8eaace053eac},
    {0xbfdecd7cd72ffc74, 0x400095595d20dd74}, {0xbfe100b8b6774ee0, 0x40010c3cef33034a},
    {0x3f9a77ee17628920, 0x3ff8b818970806bb}, {0x3fefa7663254fcb0, 0x3fc2d7b525889629},
    {0x3fe50a249d0fc4a0, 0x3feb4e5dac924211}, {0x3fefa049d57dec88, 0x3fc395e7495632b5},
    {0xbf7301ee429b4005, 0x3ff934fd46ff527b}, {0xbde2bb527aebd043, 0x3ff921fb544d8ac1},
};

constexpr point_of<std::uint64_t> acos_d_ep_points[] = {
    {0x0000000000000000, 0x3ff921fb54442d18}, {0x8000000000000000, 0x3ff921fb54442d18},
    {0x0000000000000001, 0x3ff921fb54442d18}, {0x8000000000000003, 0x3ff921fb54442d18},
    {0x3fdfffffffffffff, 0x3ff0c15238c8d27a}, {0x3fe0000000000000, 0x3ff0c15238c8d27a},
    {0x3fe0000000000001, 0x3ff0c15236f6b53b}, {0xbfe0000000000001, 0x4000c15238c8d27a},
    {0xbfe0000000000000, 0x4000c15237dfc3db}, {0x3ff0000000000000, 0x0000000000000000},
    {0xbff0000000000000, 0x400921fb54442d18}, {0x3fefffffffffffff, 0x3e4ffffffd9283ad},
    {0xbfefffffffffffff, 0x400921fb52442d18}, {0x3feffffffffffffe, 0x3e56a09e64c7c6e2},
    {0x3e50000000000000, 0x3ff921fb50442d18}, {0x3f50624dd2f1a9fc, 0x3ff91de2c0c44c2c},
    {0xbfe0e4968d92d832, 0x400103f23cd1ed43}, {0xbfe965ba4a3af2a2, 0x4003e6a0a9fb1997},
    {0xbfca9bed50ad0738, 0x3ffc7bba5e3824ed}, {0xbfe614ef2f477986, 0x4002a8ad68bd9bc1},
    {0xbfebbe3777d76a18, 0x4004f586ae7a8bb2}, {0xbfc93154ce6b4cd8, 0x3ffc4d7221c9b0ce},
    {0x3feabfc68250a43a, 0x3fe2979d0ea607eb}, {0x3fe33a9c7feb9222, 0x3feda32261dd62dc},
    {0x3fe0f86c907884ce, 0x3ff0306203470271}, {0xbfe1cbedc3d6585e, 0x400148c6710b2531},
    {0x3fef3c423ab4c6a8, 0x3fcc099bc0e6248b}, {0x3feffc5325d5f060, 0x3f9eaca978fa266f},
    {0x3fefffc86dcefe7e, 0x3f7dd186f404537c}, {0x3feffffcfe80bcbf, 0x3f5bbd6478234123},
    {0xbe44428a32cef32e, 0x3ff921fb56cc7e5e}, {0xbfd9ee3205f97542, 0x3fffcea89a335b4a},
};

constexpr point_of<std::uint32_t> acos_s_nearest[] = {
    {0x00000000, 0x3fc90fdb}, {0x80000000, 0x3fc90fdb}, {0x00000001, 0x3fc90fdb},
    {0x80000003, 0x3fc90fdb}, {0x3effffff, 0x3f860a92}, {0x3f000000, 0x3f860a92},
    {0x3f000001, 0x3f860a91}, {0xbf000001, 0x40060a92}, {0xbf000000, 0x40060a92},
    {0x3f800000, 0x00000000}, {0xbf800000, 0x40490fdb}, {0x3f7fffff, 0x39b504f3},
    {0xbf7fffff, 0x40490a32}, {0x3f7ffffe, 0x3a000000}, {0x32800000, 0x3fc90fdb},
    {0x3a83126f, 0x3fc8ef16}, {0x3f1630ac, 0x3f719fb3}, {0x3f24d729, 0x3f5f0708},
    {0xbcf53152, 0x3fcce4c5}, {0xbef4197f, 0x40045626}, {0xbf7fc4cb, 0x4046575d},
    {0x3ea6b9e9, 0x3f9e9b2f}, {0xbd73ad58, 0x3fd0ae6c}, {0x3f04fb6a, 0x3f83254e},
    {0xbe81e23f, 0x3fe9e442}, {0x3f0a4fc5, 0x3f8000e1}, {0x3f7fe50d, 0x3ceaf015},
    {0x3f3bebd7, 0x3f3f1ae3}, {0x3f59506e, 0x3f0e92c2}, {0x3f7eb5fe, 0x3dcd9ccd},
    {0xba1b3267, 0x3fc92341}, {0xbc260bb7, 0x3fca5bf4},
};

constexpr point_of<std::uint64_t> acos_d_nearest[] = {
    {0x0000000000000000, 0x3ff921fb54442d18}, {0x8000000000000000, 0x3ff921fb54442d18},
    {0x0000000000000001, 0x3ff921fb54442d18}, {0x8000000000000003, 0x3ff921fb54442d18},
    {0x3fdfffffffffffff, 0x3ff0c152382d7366}, {0x3fe0000000000000, 0x3ff0c152382d7366},
    {0x3fe0000000000001, 0x3ff0c152382d7365}, {0xbfe0000000000001, 0x4000c152382d7366},
    {0xbfe0000000000000, 0x4000c152382d7366}, {0x3ff0000000000000, 0x0000000000000000},
    {0xbff0000000000000, 0x400921fb54442d18}, {0x3fefffffffffffff, 0x3e50000000000000},
    {0xbfefffffffffffff, 0x400921fb52442d18}, {0x3feffffffffffffe, 0x3e56a09e667f3bcd},
    {0x3e50000000000000, 0x3ff921fb50442d18}, {0x3f50624dd2f1a9fc, 0x3ff91de2c0c3fca6},
    {0xbfd68ca5e0d58b24, 0x3ffee4ce2ded5aff}, {0xbfe6587cb4d766c8, 0x4002c023dfb2ff04},
    {0x3fd351d220c5c7fc, 0x3ff439eeeecfa5f2}, {0xbfeb5d34316e07c0, 0x4004c5d281afc506},
    {0x3fb25f2046063a00, 0x3ff7fbc89247a478}, {0xbfd1311b06ace67c, 0x3ffd7bf0827bf21f},
    {0xbfec49bee0b8ed14, 0x40053dc011278297}, {0x3f8e74ee6deceb80, 0x3ff8e510e43f10c3},
    {0xbfed99abcf4ffae6, 0x400603cc6f8376dc}, {0xbfc0fc98b29e5570, 0x3ffb432a250a447d},
    {0x3fefffffc19dca4a, 0x3f3f97e417d27e27}, {0x3feffffed4d9e07d, 0x3f514bc19907b10b},
    {0x3fefd00d373f9f91, 0x3fbbb620886c60ed}, {0x3fe5c61378fa4d39, 0x3fea517eca76fbc1},
    {0xbdac81efbeb28b10, 0x3ff921fb54451128}, {0xbe5072f29163b330, 0x3ff921fb5860e9bd},
};

TEST(AcosFloat, Points) {
  expect_points<acos_s<tier::la>>(acos_s_points);
  expect_points<acos_s<tier::ep>>(acos_s_points);
  expect_near_points<acos_s<tier::ha>>(acos_s_nearest, 1);
}

TEST(AcosDouble, Points) {
  expect_near_points<acos_d<tier::ha>>(acos_d_nearest, 1);
  expect_points<acos_d<tier::la>>(acos_d_la_points);
  expect_points<acos_d<tier::ep>>(acos_d_ep_points);
}

TEST(AcosFloat, Digest) { EXPECT_EQ(digest<acos_s<tier::la>>(1e-4), 0x287176223718bc25u); }

TEST(AcosDouble, Digest) {
  EXPECT_EQ(digest<acos_d<tier::la>>(1e-4), 0xe37001bbc0d2732eu);
  EXPECT_EQ(digest<acos_d<tier::ep>>(1e-4), 0xf9e2c6c7b58ff531u);
}

template <typename Body>
class Acos : public ::testing::Test {};
using all_bodies = ::testing::Types<acos_s<tier::ha>, acos_s<tier::la>, acos_s<tier::ep>,
                                    acos_d<tier::ha>, acos_d<tier::la>, acos_d<tier::ep>>;
TYPED_TEST_SUITE(Acos, all_bodies);

TYPED_TEST(Acos, Domain) { expect_domain_of_unit_interval<TypeParam>(); }

TYPED_TEST(Acos, EndsAndMiddle) {
  using T = typename TypeParam::input_type;
  expect_number<TypeParam>(T(1), T(0));
  expect_number<TypeParam>(T(-1), T(3.14159265358979323846));
  expect_number<TypeParam>(T(0), T(1.57079632679489661923));
  expect_number<TypeParam>(-T(0), T(1.57079632679489661923));
}

}  // namespace
