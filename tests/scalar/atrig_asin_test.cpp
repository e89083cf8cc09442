// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/atrig/asin.hpp"

#include "atrig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::asin_d;
using scalar::asin_s;
using scalar::tier;

/// Zeros, denormals, both sides of 1/2, 1 and the numbers before it, and random arguments.
constexpr point_of<std::uint32_t> asin_s_points[] = {
    {0x00000000, 0x00000000}, {0x80000000, 0x80000000}, {0x00000001, 0x00000001},
    {0x80000003, 0x80000003}, {0x3effffff, 0x3f060a91}, {0x3f000000, 0x3f060a92},
    {0x3f000001, 0x3f060a92}, {0xbf000001, 0xbf060a92}, {0xbf000000, 0xbf060a92},
    {0x3f800000, 0x3fc90fdb}, {0xbf800000, 0xbfc90fdb}, {0x3f7fffff, 0x3fc9048b},
    {0xbf7fffff, 0xbfc9048b}, {0x3f7ffffe, 0x3fc8ffdb}, {0x32800000, 0x32800000},
    {0x3a83126f, 0x3a831270}, {0xbf3b349c, 0xbf51f798}, {0x3f31e2d6, 0x3f44ab18},
    {0x3f070d78, 0x3f0e4338}, {0xbefacf2f, 0xbf030df0}, {0xbc159544, 0xbc1595cd},
    {0xbdcee275, 0xbdcf3cf3}, {0x3e9b3b30, 0x3e9db6a8}, {0x3f13d38c, 0x3f1d97d2},
    {0xbf4ff1a3, 0xbf72b389}, {0xbf717c71, 0xbf9dc0f2}, {0x3f28c108, 0x3f38416d},
    {0x3f7e5178, 0x3fba61c8}, {0x3f4dc62e, 0x3f6f04a2}, {0x3f800000, 0x3fc90fdb},
    {0xb87f9255, 0xb87f9255}, {0xbca31f7b, 0xbca3223d},
};

constexpr point_of<std::uint32_t> asin_s_ha_points[] = {
    {0x00000000, 0x00000000}, {0x80000000, 0x80000000}, {0x00000001, 0x00000001},
    {0x80000003, 0x80000003}, {0x3effffff, 0x3f060a91}, {0x3f000000, 0x3f060a92},
    {0x3f000001, 0x3f060a93}, {0xbf000001, 0xbf060a93}, {0xbf000000, 0xbf060a92},
    {0x3f800000, 0x3fc90fdb}, {0xbf800000, 0xbfc90fdb}, {0x3f7fffff, 0x3fc9048a},
    {0xbf7fffff, 0xbfc9048a}, {0x3f7ffffe, 0x3fc8ffdb}, {0x32800000, 0x32800000},
    {0x3a83126f, 0x3a831270}, {0x3f697d53, 0x3f92fb86}, {0x3f6549a5, 0x3f8e1142},
    {0xbf630bb3, 0xbf8b9849}, {0xbf548ba8, 0xbf7ac4e4}, {0x3f2bc682, 0x3f3c4d3e},
    {0x3ef1a21e, 0x3efba492}, {0x3eadcdce, 0x3eb153f2}, {0xbec477e0, 0xbec9a3f4},
    {0x3e58f941, 0x3e5aa184}, {0x3e5abade, 0x3e5c6daa}, {0x3f7621e5, 0x3fa56846},
    {0x3f7ffef7, 0x3fc857ae}, {0x3f7e5dd6, 0x3fba9835}, {0x3f7f0c94, 0x3fbe06b8},
    {0xbca72961, 0xbca72c59}, {0xbf708809, 0xbf9c5678},
};

constexpr point_of<std::uint64_t> asin_d_la_points[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000001}, {0x8000000000000003, 0x8000000000000003},
    {0x3fdfffffffffffff, 0x3fe0c152382d7364}, {0x3fe0000000000000, 0x3fe0c152382d7365},
    {0x3fe0000000000001, 0x3fe0c152382d7367}, {0xbfe0000000000001, 0xbfe0c152382d7367},
    {0xbfe0000000000000, 0xbfe0c152382d7365}, {0x3ff0000000000000, 0x3ff921fb54442d18},
    {0xbff0000000000000, 0xbff921fb54442d18}, {0x3fefffffffffffff, 0x3ff921fb50442d18},
    {0xbfefffffffffffff, 0xbff921fb50442d18}, {0x3feffffffffffffe, 0x3ff921fb4e9c057e},
    {0x3e50000000000000, 0x3e50000000000000}, {0x3f50624dd2f1a9fc, 0x3f50624e00c1cb17},
    {0xbfe0c5300342457c, 0xbfe1a6e6a7382112}, {0x3fb6a5368858d8d0, 0x3fb6acccd9bca0b5},
    {0xbfd0a54f21584a44, 0xbfd0d6e0915bb756}, {0x3fca9a80ef2b7250, 0x3fcacc83cbe0c998},
    {0x3fd0179a594b2b8c, 0x3fd0444b846f41be}, {0xbfebce600b27bb70, 0xbff0d9569cb0d955},
    {0xbfef284170babd6c, 0xbff573dbe94d698c}, {0x3fe59917ebc0fce2, 0x3fe7b54bda831b84},
    {0xbfdecd7cd72ffc74, 0xbfe0116ecbfb1b9f}, {0xbfe100b8b6774ee0, 0xbfe1ecfd1443b2f7},
    {0x3f9a77ee17628920, 0x3f9a78af4f099756}, {0x3fefa7663254fcb0, 0x3ff6c704af931a53},
    {0x3fe50a249d0fc4a0, 0x3fe6f598fbf6181f}, {0x3fefa049d57dec88, 0x3ff6af3e6b1966c1},
    {0xbf7301ee429b4005, 0xbf7301f2bb2562ef}, {0xbde2bb527aebd043, 0xbde2bb527aebd043},
};

constexpr point_of<std::uint64_t> asin_d_ep_points[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000001}, {0x8000000000000003, 0x8000000000000003},
    {0x3fdfffffffffffff, 0x3fe0c15236f6b53b}, {0x3fe0000000000000, 0x3fe0c15236f6b53c},
    {0x3fe0000000000001, 0x3fe0c1523a9aefb9}, {0xbfe0000000000001, 0xbfe0c1523a9aefb9},
    {0xbfe0000000000000, 0xbfe0c15236f6b53c}, {0x3ff0000000000000, 0x3ff921fb54442d18},
    {0xbff0000000000000, 0xbff921fb54442d18}, {0x3fefffffffffffff, 0x3ff921fb50442d18},
    {0xbfefffffffffffff, 0xbff921fb50442d18}, {0x3feffffffffffffe, 0x3ff921fb4e9c057f},
    {0x3e50000000000000, 0x3e4ffffffd9283ad}, {0x3f50624dd2f1a9fc, 0x3f50624dff83ae56},
    {0xbfe0e4968d92d832, 0xbfe1cbd24abf5adc}, {0xbfe965ba4a3af2a2, 0xbfed568bff640c2c},
    {0xbfca9bed50ad0738, 0xbfcacdf84f9fbea8}, {0xbfe614ef2f477986, 0xbfe85ebefa6e14d6},
    {0xbfebbe3777d76a18, 0xbff0c91208b0ea4c}, {0xbfc93154ce6b4cd8, 0xbfc95bb66c2c1db1},
    {0x3feabfc68250a43a, 0x3fefac5999e25245}, {0x3fe33a9c7feb9222, 0x3fe4a0d446aaf754},
    {0x3fe0f86c907884ce, 0x3fe1e332a1fa554e}, {0xbfe1cbedc3d6585e, 0xbfe2df231ba43a94},
    {0x3fef3c423ab4c6a8, 0x3ff5a0c7dc276887}, {0x3feffc5325d5f060, 0x3ff8a748ae60447e},
    {0x3fefffc86dcefe7e, 0x3ff90429cd5028c5}, {0x3feffffcfe80bcbf, 0x3ff91b0bfb262448},
    {0xbe44428a32cef32e, 0xbe44428a3145792e}, {0xbfd9ee3205f97542, 0xbfdab2b517bcb8c7},
};

constexpr point_of<std::uint64_t> asin_d_ha_points[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000001}, {0x8000000000000003, 0x8000000000000003},
    {0x3fdfffffffffffff, 0x3fe0c152382d7365}, {0x3fe0000000000000, 0x3fe0c152382d7365},
    {0x3fe0000000000001, 0x3fe0c152382d7367}, {0xbfe0000000000001, 0xbfe0c152382d7367},
    {0xbfe0000000000000, 0xbfe0c152382d7365}, {0x3ff0000000000000, 0x3ff921fb54442d18},
    {0xbff0000000000000, 0xbff921fb54442d18}, {0x3fefffffffffffff, 0x3ff921fb50442d18},
    {0xbfefffffffffffff, 0xbff921fb50442d18}, {0x3feffffffffffffe, 0x3ff921fb4e9c057f},
    {0x3e50000000000000, 0x3e50000000000000}, {0x3f50624dd2f1a9fc, 0x3f50624e00c1cb16},
    {0x3fcf767c482c9b00, 0x3fcfc9e192edea7b}, {0x3fdef2e045bc8fb8, 0x3fe026c65d45d9d3},
    {0x3fe2e4738d8608fe, 0x3fe4359005a5b9be}, {0x3fec511afebb6a18, 0x3ff16167a75ffb7a},
    {0x3fdeb4ff1a6eb8c8, 0x3fe003782366ff7b}, {0x3feb075f6c3d8588, 0x3ff018362249b015},
    {0xbfee24c74146f792, 0xbff3a7f97b7d0bff}, {0xbfb199e84e56b1f0, 0xbfb19d770f620a23},
    {0x3fec5ff4d9fe0f50, 0x3ff1716809aaf934}, {0x3fd3119920d46410, 0x3fd35cdf3c4cc67f},
    {0x3fddc877e9c4934c, 0x3fdefa8b445e5be6}, {0x3feffffb95fb24fe, 0x3ff91993eba4df7d},
    {0x3fefa8bdad4de110, 0x3ff6cb9c00d895a7}, {0x3feffe28b223da50, 0x3ff8cb2457f1e785},
    {0xbf45e51fb90dcdcb, 0xbf45e51fd46354b9}, {0xbf54eed028a1cdfb, 0xbf54eed0882db8e9},
};

TEST(AsinFloat, Points) {
  expect_points<asin_s<tier::ha>>(asin_s_ha_points);
  expect_points<asin_s<tier::la>>(asin_s_points);
  expect_points<asin_s<tier::ep>>(asin_s_points);
}

TEST(AsinDouble, Points) {
  expect_points<asin_d<tier::ha>>(asin_d_ha_points);
  expect_points<asin_d<tier::la>>(asin_d_la_points);
  expect_points<asin_d<tier::ep>>(asin_d_ep_points);
}

TEST(AsinFloat, Digest) {
  EXPECT_EQ(digest<asin_s<tier::ha>>(1e-4), 0x53bf607c66f3504bu);
  EXPECT_EQ(digest<asin_s<tier::la>>(1e-4), 0xb6d7876f4e9070e9u);
}

TEST(AsinDouble, Digest) {
  EXPECT_EQ(digest<asin_d<tier::ha>>(1e-4), 0x2b32adfb5049c325u);
  EXPECT_EQ(digest<asin_d<tier::la>>(1e-4), 0x107f13ee5fccdb9du);
  EXPECT_EQ(digest<asin_d<tier::ep>>(1e-4), 0x84d969aaf96c39fdu);
}

template <typename Body>
class Asin : public ::testing::Test {};
using all_bodies = ::testing::Types<asin_s<tier::ha>, asin_s<tier::la>, asin_s<tier::ep>,
                                    asin_d<tier::ha>, asin_d<tier::la>, asin_d<tier::ep>>;
TYPED_TEST_SUITE(Asin, all_bodies);

TYPED_TEST(Asin, Domain) { expect_domain_of_unit_interval<TypeParam>(); }

/// The reciprocal of the root stays finite at 1, and the root is 0.
TYPED_TEST(Asin, OneIsHalfPi) {
  using T = typename TypeParam::input_type;
  expect_number<TypeParam>(T(1), T(1.57079632679489661923));
  expect_number<TypeParam>(T(-1), -T(1.57079632679489661923));
}

/// 1/2 itself is direct; the next number takes the root. The two meet.
TYPED_TEST(Asin, Half) {
  using T = typename TypeParam::input_type;
  using U = part_of<T>;
  const T half = T(0.5);
  const T next = std::nextafter(half, T(1));
  EXPECT_TRUE(scalar::half_angle<T>::of(half).direct);
  EXPECT_FALSE(scalar::half_angle<T>::of(next).direct);
  if (std::is_same_v<TypeParam, asin_d<tier::ep>>) return;
  T y = 0, z = 0;
  TypeParam::call(&half, &y);
  TypeParam::call(&next, &z);
  EXPECT_LE(distance(std::bit_cast<U>(y), std::bit_cast<U>(z)), 4u);
}

TYPED_TEST(Asin, SignOfZero) {
  using n = named<part_of<typename TypeParam::input_type>>;
  expect_v11<TypeParam>(0, 0);
  expect_v11<TypeParam>(n::sign, n::sign);
}

}  // namespace
