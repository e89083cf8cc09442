// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/root/hypot.hpp"

#include "quad.hpp"
#include "root_points.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::hypot_d;
using scalar::hypot_s;
using scalar::tier;

constexpr pair_point<std::uint32_t> hypot_s_ha_points[] = {
    {0x40400000, 0x40800000, 0x40a00000}, {0xc0a00000, 0x41400000, 0x41500000},
    {0x00000000, 0x3f800000, 0x3f800000}, {0x3f800000, 0x80000000, 0x3f800000},
    {0x3f800000, 0x3f800000, 0x3fb504f3}, {0x00000001, 0x00000001, 0x00000001},
    {0x007fffff, 0x00000001, 0x007fffff}, {0x00800000, 0x00800000, 0x00b504f3},
    {0x3fffffff, 0x3fffffff, 0x403504f2}, {0x40000000, 0x3fffffff, 0x403504f3},
    {0x40000000, 0x40000000, 0x403504f3}, {0x7f7fffff, 0x00000000, 0x7f7fffff},
    {0x7f7fffff, 0x73000000, 0x7f7fffff}, {0x7f000000, 0x7f000000, 0x7f3504f3},
    {0x7f7fffff, 0x7f7fffff, 0x7f800000}, {0x7f7fffff, 0x00000001, 0x7f7fffff},
    {0x00000003, 0x00000004, 0x00000005}, {0x39735a1c, 0x39f5353c, 0x3a08de58},
    {0x234f069b, 0x23d5e569, 0x23eda073}, {0x42899387, 0x410c539b, 0x428ab0a3},
    {0x6351d228, 0x635f33d2, 0x63992b82}, {0x162e3fe8, 0x14b5f36a, 0x162fba49},
    {0x19459799, 0x17d739c6, 0x19476a4f}, {0x5497c815, 0x5499ac50, 0x54d7fe43},
    {0x1c0c7408, 0x1d9e8c3a, 0x1d9f8451}, {0x3ecee4fc, 0x3d6d367e, 0x3ed1022b},
};
constexpr pair_point<std::uint32_t> hypot_s_la_points[] = {
    {0x40400000, 0x40800000, 0x40a00000}, {0xc0a00000, 0x41400000, 0x41500000},
    {0x00000000, 0x3f800000, 0x3f800000}, {0x3f800000, 0x80000000, 0x3f800000},
    {0x3f800000, 0x3f800000, 0x3fb504f3}, {0x00000001, 0x00000001, 0x00000001},
    {0x007fffff, 0x00000001, 0x007fffff}, {0x00800000, 0x00800000, 0x00b504f3},
    {0x3fffffff, 0x3fffffff, 0x403504f2}, {0x40000000, 0x3fffffff, 0x403504f3},
    {0x40000000, 0x40000000, 0x403504f3}, {0x7f7fffff, 0x00000000, 0x7f7fffff},
    {0x7f7fffff, 0x73000000, 0x7f7fffff}, {0x7f000000, 0x7f000000, 0x7f3504f3},
    {0x7f7fffff, 0x7f7fffff, 0x7f800000}, {0x7f7fffff, 0x00000001, 0x7f7fffff},
    {0x00000003, 0x00000004, 0x00000005}, {0x39735a1c, 0x39f5353c, 0x3a08de58},
    {0x234f069b, 0x23d5e569, 0x23eda073}, {0x42899387, 0x410c539b, 0x428ab0a3},
    {0x6351d228, 0x635f33d2, 0x63992b82}, {0x162e3fe8, 0x14b5f36a, 0x162fba49},
    {0x19459799, 0x17d739c6, 0x19476a50}, {0x5497c815, 0x5499ac50, 0x54d7fe43},
    {0x1c0c7408, 0x1d9e8c3a, 0x1d9f8451}, {0x3ecee4fc, 0x3d6d367e, 0x3ed1022b},
};
constexpr pair_point<std::uint64_t> hypot_d_main_points[] = {
    {0x4008000000000000, 0x4010000000000000, 0x4014000000000000},
    {0x3ff0000000000000, 0x3ff0000000000000, 0x3ff6a09e667f3bcd},
    {0x0000000000000000, 0x3ff0000000000000, 0x3ff0000000000000},
    {0xbff8000000000000, 0x4000000000000001, 0x4004000000000001},
    {0x3de6a09e667f3bcd, 0x0000000000000000, 0x3de6a09e667f3bcd},
    {0x4200000000000000, 0x0000000000000000, 0x4200000000000000},
    {0x4200000000000000, 0x3e00000000000000, 0x4200000000000000},
    {0x41ffffffffffffff, 0x3ff0000000000000, 0x41ffffffffffffff},
    {0x40a5c2cc39263059, 0x40b8510bcb60a3c2, 0x40baa3cc4d337d8f},
    {0x4074fd23a09f76b5, 0x405560e7fff4e8b8, 0x4075a89b6e44c5b4},
    {0x3e5f58c3f29d0da9, 0x3e6f990fa8e9f1cb, 0x3e71a2c1cf69f068},
    {0x4077982b93bd04cf, 0x408a1208a2ff0a83, 0x408c9d8c0f26e887},
    {0x3e52c78a658cda14, 0x3e358044e4a1df38, 0x3e538899caf31ddd},
    {0x3f026346f9ebdacc, 0x3f157f2867628b4a, 0x3f176158733bf1cd},
    {0x405a065c0becd7b0, 0x404c5df9831e86c0, 0x405da38ffc593717},
    {0x3ea85efadbc496cb, 0x3ea991f138554023, 0x3eb1a9748bad0ddf},
    {0x3fcd32c94a23d596, 0x3fadeade158049bd, 0x3fce241fc3818d0e},
    {0x4049a98f24ede6a4, 0x406aa383ec90d0c4, 0x406b66806cc68407},
    {0x40689d991e27a1c0, 0x4039d10db135106f, 0x4068d38513f45184},
    {0x405db4154ef8aa38, 0x40713439cdb89c3e, 0x4072bcfcb0c66f98},
    {0x40da5eead0eda82f, 0x40cc2a868baa954f, 0x40dde5497f85c5b0},
    {0x3e89876f2e44158b, 0x3e7d7321ca28d287, 0x3e8d78a2c3771672},
};

TEST(HypotFloat, Points) {
  expect_pairs<hypot_s<tier::ha>>(hypot_s_ha_points);
  expect_pairs<hypot_s<tier::la>>(hypot_s_la_points);
  expect_pairs<hypot_s<tier::ep>>(hypot_s_la_points);
}

template <typename F>
std::uint64_t float_digest() {
  return digest_of([](std::uint64_t k) {
    const std::uint64_t step = k * 1380001;
    const auto x = std::bit_cast<float>(static_cast<std::uint32_t>(0x00300000 + step));
    const auto y = std::bit_cast<float>(static_cast<std::uint32_t>(
        0x00100000 + step / 0x800000 * 0x800000 + k * 7654321 % 0x1000000));
    float r = 0;
    F::call(&x, &y, &r);
    return std::bit_cast<std::uint32_t>(r);
  });
}

TEST(HypotFloat, Digest) {
  EXPECT_EQ(float_digest<hypot_s<tier::ha>>(), 0xe204fcdca256e582u);
  EXPECT_EQ(float_digest<hypot_s<tier::la>>(), 0xe7685cb6c6a90d45u);
}

/// What `la` and `ep` leave to the device's root: for every fraction and either parity of the
/// exponent, one step of Newton from the reciprocal root gives the same float.
TEST(HypotFloat, StepOfNewtonIsTheRoundedRoot) {
  std::uint32_t different = 0;
  for (std::uint32_t b = 0x3e800000; b < 0x3f800000; ++b) {
    const float s = std::bit_cast<float>(b);
    const float r = 1.0f / std::sqrt(s);
    const float g = s * r;
    const float stepped = scalar::fma(r * 0.5f, scalar::fma(g, -g, s), g);
    different += stepped != std::sqrt(s);
  }
  EXPECT_EQ(different, 0u);
}

TEST(HypotDouble, MainPathPoints) {
  for (const auto& p : hypot_d_main_points) {
    EXPECT_EQ(hypot_d::main(std::bit_cast<double>(p.a), std::bit_cast<double>(p.b)).rare, 0u);
    expect_v21<hypot_d>(p.a, p.b, p.y);
  }
}

TEST(HypotDouble, MainPathDigest) {
  const std::uint64_t first = 0x3e20000000000000, step = (0x41d0000000000000 - first) / 1500;
  const auto result = [&](std::uint64_t k) {
    const auto x = std::bit_cast<double>(first + k * step);
    const auto y = std::bit_cast<double>(first + k * 12345 % 1500 * step);
    double r = 0;
    hypot_d::call(&x, &y, &r);
    return std::bit_cast<std::uint64_t>(r);
  };
  EXPECT_EQ(digest_of(result), 0x36dd889f8b78f391u);
}

/// The band ends with the high word of the sum of squares: 0x3bc00000 and 0x44100000 are inside.
TEST(HypotDouble, MainPathIsABandOfTheSumOfSquares) {
  const auto rare = [](double x) { return hypot_d::main(x, 0.0).rare != 0; };
  EXPECT_FALSE(rare(0x1.6a09e667f3bcdp-34));  // the square is just above 2^-67
  EXPECT_TRUE(rare(0x1.6a09e667f3bccp-34));
  EXPECT_FALSE(rare(0x1p33));
  EXPECT_FALSE(rare(0x1.000007ffp33));  // the square is just below (1 + 2^-20)·2^66
  EXPECT_TRUE(rare(0x1.0000080000000p33));
  EXPECT_TRUE(rare(0.0));
  EXPECT_TRUE(rare(1e300));
}

TEST(HypotDouble, MainPathIsWithinItsBound) {
  pattern_source<std::uint64_t> source(7);
  double largest = 0;
  for (int i = 0; i < 200'000; ++i) {
    const std::uint64_t p = 0x3fe0000000000000 + source.below(0x0020000000000000);
    const auto x = std::bit_cast<double>(p);
    const auto y = std::bit_cast<double>(source.near(p, 2));
    const quad wide_x = x, wide_y = y;
    double r = 0;
    EXPECT_EQ(hypot_d::call(&x, &y, &r), 0u);
    largest = std::max(largest, root_ulps(r, wide_x * wide_x + wide_y * wide_y));
  }
  EXPECT_LT(largest, 1.21);
}

TEST(HypotDouble, RarePathServesEverySize) {
  pattern_source<std::uint64_t> source(8);
  double largest = 0;
  for (int i = 0; i < 100'000; ++i) {
    const std::uint64_t p = source.finite() & ~named<std::uint64_t>::sign;
    const auto x = std::bit_cast<double>(p);
    const auto y = std::bit_cast<double>(source.near(p, 30));
    const quad wide_x = x, wide_y = y;
    double r = 0;
    EXPECT_EQ(hypot_d::rare(x, y, &r), 0u);
    if (!std::isinf(r))
      largest = std::max(largest, root_ulps(r, wide_x * wide_x + wide_y * wide_y));
  }
  EXPECT_LT(largest, 0.51);
}

TEST(HypotDouble, ExactResultsOfEverySize) {
  const auto expect = [](double a, double b, double c) {
    double r = 0;
    EXPECT_EQ(hypot_d::call(&a, &b, &r), 0u);
    EXPECT_EQ(r, c) << a << " " << b;
  };
  for (int e = -1074; e <= 1020; ++e) {
    expect(std::ldexp(3, e), std::ldexp(-4, e), std::ldexp(5, e));
    expect(std::ldexp(12, e), std::ldexp(5, e), std::ldexp(13, e));
    expect(std::ldexp(1, e), 0.0, std::ldexp(1, e));
  }
  expect(0x1p-1074, 0x1p-1074, 0x1p-1074);
  expect(0x1p-1073, 0x1p-1074, 0x1p-1073);
  expect(0x1.fffffffffffffp1023, 1.0, 0x1.fffffffffffffp1023);
  expect(0x1.fffffffffffffp1023, 0x1p969, 0x1.fffffffffffffp1023);
}

TEST(HypotDouble, OverflowHasNoStatus) {
  expect_number<hypot_d>(0x1p1023, 0x1.8p1023, 0x1.cd82b446159f3p1023, 0);
  using n = named<std::uint64_t>;
  expect_v21<hypot_d>(n::largest, n::largest, n::inf);
  expect_v21<hypot_d>(n::largest, 0x7fe0000000000000, n::inf);
}

template <typename Body>
class HypotOfAnyTier : public ::testing::Test {};
using bodies = ::testing::Types<hypot_s<tier::ha>, hypot_s<tier::la>, hypot_s<tier::ep>, hypot_d>;
TYPED_TEST_SUITE(HypotOfAnyTier, bodies);

TYPED_TEST(HypotOfAnyTier, Specials) {
  using U = part_of<typename TypeParam::input_type>;
  using n = named<U>;
  for (const U sign : {U(0), n::sign}) {
    for (const U other : {U(0), U(1), n::one, n::largest, n::inf, n::nan, n::signalling}) {
      for (const U other_sign : {U(0), n::sign}) {
        expect_v21<TypeParam>(n::inf | sign, other | other_sign, n::inf);
        expect_v21<TypeParam>(other | other_sign, n::inf | sign, n::inf);
      }
    }
    for (const U nan : {n::nan, n::signalling}) {
      for (const U other : {U(0), U(1), n::one, n::largest, n::nan}) {
        expect_v21<TypeParam>(nan | sign, other, n::any_nan);
        expect_v21<TypeParam>(other, nan | sign, n::any_nan);
      }
    }
    expect_v21<TypeParam>(sign, 0, 0);
    expect_v21<TypeParam>(sign, n::sign, 0);
    for (const U x : {U(1), n::smallest_normal, n::one, n::largest}) {
      expect_v21<TypeParam>(x | sign, n::sign, x);
      expect_v21<TypeParam>(0, x | sign, x);
    }
  }
  expect_v21<TypeParam>(n::largest, n::largest, n::inf);
}

}  // namespace
