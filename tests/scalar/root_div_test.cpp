// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/root/div.hpp"

#include "root_points.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::div_d;
using scalar::div_s;
using scalar::tier;

constexpr pair_point<std::uint32_t> div_s_ha_points[] = {
    {0x3f800000, 0x3f800000, 0x3f800000}, {0x3f800000, 0x40400000, 0x3eaaaaab},
    {0x3f800000, 0x00800000, 0x7e800000}, {0x3f800000, 0x007fffff, 0x7e800001},
    {0x3f800000, 0x00000001, 0x7f800000}, {0x3f800000, 0x7e7fffff, 0x00800000},
    {0x3f800000, 0x7e800000, 0x00800000}, {0x3f800000, 0x7e000000, 0x01000000},
    {0x3f800000, 0x7dffffff, 0x01000000}, {0x3f800000, 0xfe800001, 0x807fffff},
    {0x3f800000, 0x7f7fffff, 0x00200000}, {0x3f800000, 0x40e00000, 0x3e124925},
    {0x3f800000, 0xc1200000, 0xbdcccccd}, {0xbfa5cd68, 0x3f800000, 0xbfa5cd68},
    {0x3f4d3c1a, 0x40400000, 0x3e88d2bc}, {0x3f18b8ff, 0x00800000, 0x7e18b8ff},
    {0x3f3031d0, 0x007fffff, 0x7e3031d1}, {0xbf1db208, 0x00000001, 0xff800000},
    {0x3f6deceb, 0x7e7fffff, 0x0076f676}, {0x3f2c0146, 0x7e800000, 0x005600a3},
    {0x3fd61aa9, 0x7e000000, 0x01561aa9}, {0x3f7b382e, 0x7dffffff, 0x00fb382f},
    {0x3fd95a94, 0xfe800001, 0x80d95a92}, {0xbf3f62f8, 0x7f7fffff, 0x8017ec5f},
    {0xbf724c60, 0x40e00000, 0xbe0a74c9}, {0xbf1fac61, 0xc1200000, 0x3d7f7a35},
    {0x7f7fffff, 0x3f000000, 0x7f800000}, {0x00000001, 0x40400000, 0x00000000},
    {0x80000003, 0x40000000, 0x80000002}, {0x7f7fffff, 0x7f7fffff, 0x3f800000},
    {0x49633685, 0xb63c4d74, 0xd29a731b}, {0x3e263464, 0xb404bc0d, 0xc9a046b6},
    {0x3885efab, 0xb3d0816d, 0xc42471e2}, {0x4ad32c90, 0x3d2e6d77, 0x4d1af733},
    {0xb789e870, 0xcb5dac1f, 0x2b9f4399}, {0xc3be2a8e, 0x441afcbb, 0xbf1d0dae},
    {0x3b910562, 0x4d00f90c, 0x2e0fed59}, {0x3c061431, 0x432f61eb, 0x3843b5e2},
};
constexpr pair_point<std::uint32_t> div_s_la_points[] = {
    {0x3f800000, 0x3f800000, 0x3f800000}, {0x3f800000, 0x40400000, 0x3eaaaaab},
    {0x3f800000, 0x00800000, 0x7e800000}, {0x3f800000, 0x007fffff, 0x7e800001},
    {0x3f800000, 0x00000001, 0x7f800000}, {0x3f800000, 0x7e7fffff, 0x00800001},
    {0x3f800000, 0x7e800000, 0x00800000}, {0x3f800000, 0x7e000000, 0x01000000},
    {0x3f800000, 0x7dffffff, 0x01000001}, {0x3f800000, 0xfe800001, 0x807fffff},
    {0x3f800000, 0x7f7fffff, 0x00200000}, {0x3f800000, 0x40e00000, 0x3e124925},
    {0x3f800000, 0xc1200000, 0xbdcccccd}, {0xbfa5cd68, 0x3f800000, 0xbfa5cd68},
    {0x3f4d3c1a, 0x40400000, 0x3e88d2bc}, {0x3f18b8ff, 0x00800000, 0x7e18b8ff},
    {0x3f3031d0, 0x007fffff, 0x7e3031d1}, {0xbf1db208, 0x00000001, 0xff800000},
    {0x3f6deceb, 0x7e7fffff, 0x0076f676}, {0x3f2c0146, 0x7e800000, 0x005600a3},
    {0x3fd61aa9, 0x7e000000, 0x01561aa9}, {0x3f7b382e, 0x7dffffff, 0x00fb3830},
    {0x3fd95a94, 0xfe800001, 0x80d95a92}, {0xbf3f62f8, 0x7f7fffff, 0x8017ec5f},
    {0xbf724c60, 0x40e00000, 0xbe0a74ca}, {0xbf1fac61, 0xc1200000, 0x3d7f7a35},
    {0x7f7fffff, 0x3f000000, 0x7f800000}, {0x00000001, 0x40400000, 0x00000000},
    {0x80000003, 0x40000000, 0x80000002}, {0x7f7fffff, 0x7f7fffff, 0x3f800000},
    {0x49633685, 0xb63c4d74, 0xd29a731b}, {0x3e263464, 0xb404bc0d, 0xc9a046b6},
    {0x3885efab, 0xb3d0816d, 0xc42471e2}, {0x4ad32c90, 0x3d2e6d77, 0x4d1af733},
    {0xb789e870, 0xcb5dac1f, 0x2b9f4399}, {0xc3be2a8e, 0x441afcbb, 0xbf1d0dae},
    {0x3b910562, 0x4d00f90c, 0x2e0fed59}, {0x3c061431, 0x432f61eb, 0x3843b5e2},
};
constexpr pair_point<std::uint32_t> div_s_ep_points[] = {
    {0x3f800000, 0x3f800000, 0x3f800000}, {0x3f800000, 0x40400000, 0x3eaaaaab},
    {0x3f800000, 0x00800000, 0x7e800000}, {0x3f800000, 0x007fffff, 0x7e800001},
    {0x3f800000, 0x00000001, 0x7f800000}, {0x3f800000, 0x7e7fffff, 0x00800001},
    {0x3f800000, 0x7e800000, 0x00800000}, {0x3f800000, 0x7e000000, 0x01000000},
    {0x3f800000, 0x7dffffff, 0x01000001}, {0x3f800000, 0xfe800001, 0x807fffff},
    {0x3f800000, 0x7f7fffff, 0x00200000}, {0x3f800000, 0x40e00000, 0x3e124925},
    {0x3f800000, 0xc1200000, 0xbdcccccd}, {0xbfa5cd68, 0x3f800000, 0xbfa5cd68},
    {0x3f4d3c1a, 0x40400000, 0x3e88d2bc}, {0x3f18b8ff, 0x00800000, 0x7e18b8ff},
    {0x3f3031d0, 0x007fffff, 0x7e3031d1}, {0xbf1db208, 0x00000001, 0xff800000},
    {0x3f6deceb, 0x7e7fffff, 0x0076f676}, {0x3f2c0146, 0x7e800000, 0x005600a3},
    {0x3fd61aa9, 0x7e000000, 0x01561aa9}, {0x3f7b382e, 0x7dffffff, 0x00fb3830},
    {0x3fd95a94, 0xfe800001, 0x80d95a92}, {0xbf3f62f8, 0x7f7fffff, 0x8017ec5f},
    {0xbf724c60, 0x40e00000, 0xbe0a74ca}, {0xbf1fac61, 0xc1200000, 0x3d7f7a35},
    {0x7f7fffff, 0x3f000000, 0x7f800000}, {0x00000001, 0x40400000, 0x00000000},
    {0x80000003, 0x40000000, 0x80000002}, {0x7f7fffff, 0x7f7fffff, 0x3f800000},
    {0x49633685, 0xb63c4d74, 0xd29a731b}, {0x3e263464, 0xb404bc0d, 0xc9a046b6},
    {0x3885efab, 0xb3d0816d, 0xc42471e2}, {0x4ad32c90, 0x3d2e6d77, 0x4d1af733},
    {0xb789e870, 0xcb5dac1f, 0x2b9f4399}, {0xc3be2a8e, 0x441afcbb, 0xbf1d0dae},
    {0x3b910562, 0x4d00f90c, 0x2e0fed59}, {0x3c061431, 0x432f61eb, 0x3843b5e2},
};

TEST(DivFloat, Points) {
  expect_pairs<div_s<tier::ha>>(div_s_ha_points);
  expect_pairs<div_s<tier::la>>(div_s_la_points);
  expect_pairs<div_s<tier::ep>>(div_s_ep_points);
}

template <typename F>
std::uint64_t quotient_digest() {
  return digest_of([](std::uint64_t k) {
    const auto x = std::bit_cast<float>(static_cast<std::uint32_t>(0x30000000 + k * 700001));
    const auto y = std::bit_cast<float>(
        static_cast<std::uint32_t>(0x2fffffff + ((k * 40503) & 0x1fffff) * 139));
    float q = 0;
    F::call(&x, &y, &q);
    return std::bit_cast<std::uint32_t>(q);
  });
}

TEST(DivFloat, Digest) {
  EXPECT_EQ(quotient_digest<div_s<tier::ha>>(), 0x65abd006d6ae6681u);
  EXPECT_EQ(quotient_digest<div_s<tier::la>>(), 0x24422e6d0bf9860du);
  EXPECT_EQ(quotient_digest<div_s<tier::ep>>(), 0x24422e6d0bf9860du);
}

TEST(DivFloat, DivisionForExponentFields0And253To255) {
  for (std::uint32_t field = 0; field < 256; ++field) {
    const bool rare = field == 0 || field >= 253;
    for (const std::uint32_t rest :
         {0x00000000u, 0x80000000u, 0x007fffffu, 0x807fffffu, 0x00012345u}) {
      const auto y = std::bit_cast<float>((field << 23) | rest);
      EXPECT_EQ(div_s<tier::la>::main(1.0f, y).rare != 0, rare) << field;
      EXPECT_EQ(div_s<tier::ha>::main(1.0f, y).rare != 0, rare) << field;
    }
  }
}

template <typename Body>
class DivOfAnyTier : public ::testing::Test {};
using bodies = ::testing::Types<div_s<tier::ha>, div_s<tier::la>, div_s<tier::ep>, div_d>;
TYPED_TEST_SUITE(DivOfAnyTier, bodies);

TYPED_TEST(DivOfAnyTier, EveryDivisionByZeroIsAPole) {
  using U = part_of<typename TypeParam::input_type>;
  using n = named<U>;
  for (const U x : {U(1), n::smallest_normal, n::one, n::largest, n::inf}) {
    expect_v21<TypeParam>(x, 0, n::inf, pole);
    expect_v21<TypeParam>(x | n::sign, 0, n::inf | n::sign, pole);
    expect_v21<TypeParam>(x, n::sign, n::inf | n::sign, pole);
    expect_v21<TypeParam>(x | n::sign, n::sign, n::inf, pole);
  }
  for (const U x : {U(0), n::nan, n::signalling}) {
    for (const U sign : {U(0), n::sign}) {
      expect_v21<TypeParam>(x, sign, n::any_nan, pole);
      expect_v21<TypeParam>(x | n::sign, sign, n::any_nan, pole);
    }
  }
}

TYPED_TEST(DivOfAnyTier, Specials) {
  using U = part_of<typename TypeParam::input_type>;
  using n = named<U>;
  expect_v21<TypeParam>(n::inf, n::inf, n::any_nan);
  expect_v21<TypeParam>(n::one, n::inf, 0);
  expect_v21<TypeParam>(n::one, n::inf | n::sign, n::sign);
  expect_v21<TypeParam>(n::inf, n::one | n::sign, n::inf | n::sign);
  for (const U x : {n::nan, n::signalling}) {
    expect_v21<TypeParam>(n::one, x, n::any_nan);
    expect_v21<TypeParam>(x, n::one + n::quiet_bit, n::any_nan);  // 3/2
    expect_v21<TypeParam>(n::inf, x | n::sign, n::any_nan);
    expect_v21<TypeParam>(x, n::inf, n::any_nan);
  }
  expect_v21<TypeParam>(n::largest, n::smallest_normal, n::inf);
}

TEST(DivDouble, IsTheDivision) {
  pattern_source<std::uint64_t> source(5);
  for (int i = 0; i < 5000; ++i) {
    const auto x = std::bit_cast<double>(source.finite());
    const auto y = std::bit_cast<double>(source.finite());
    if (y != 0) expect_number<div_d>(x, y, x / y, none);
  }
}

}  // namespace
