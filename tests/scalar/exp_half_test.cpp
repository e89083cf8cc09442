// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/half.hpp"

#include <cmath>
#include <limits>

#include "exp_points.hpp"
#include "quad.hpp"
#include "scalar/exact/modf.hpp"
#include "scalar/exact/mul.hpp"
#include "scalar/exp/exp.hpp"
#include "scalar/exp/exp10.hpp"
#include "scalar/exp/exp2.hpp"
#include "scalar/exp/expm1.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::binary16;
using scalar::narrow;
using scalar::tier;
using scalar::widen;

/// The value of a half by its fields.
double value_by_fields(std::uint32_t p) {
  const int e = static_cast<int>((p >> 10) & 0x1f);
  const double fraction = p & 0x3ff;
  const double magnitude = e == 0 ? std::ldexp(fraction, -24) : std::ldexp(1024 + fraction, e - 25);
  return (p & 0x8000) != 0 ? -magnitude : magnitude;
}

bool is_half_nan(std::uint32_t p) { return (p & 0x7fff) > 0x7c00; }

/// The half nearest to a finite `x` that wider arithmetic holds exactly, by bisection.
std::uint32_t nearest_half(quad x) {
  const std::uint32_t sign = x < 0 ? 0x8000 : 0;
  const quad m = x < 0 ? -x : x;
  std::uint32_t below = 0, above = 0x7c00;  // infinity stands for 2^16
  while (above - below > 1) {
    const std::uint32_t middle = (below + above) / 2;
    (static_cast<quad>(value_by_fields(middle)) <= m ? below : above) = middle;
  }
  const quad low = static_cast<quad>(value_by_fields(below));
  const quad high = above == 0x7c00 ? quad(65536) : static_cast<quad>(value_by_fields(above));
  const bool up = m - low > high - m || (m - low == high - m && (below & 1) != 0);
  return sign | (up ? above : below);
}

TEST(Half, EveryHalfSurvivesWidening) {
  for (std::uint32_t p = 0; p < 0x10000; ++p) {
    const auto h = static_cast<std::uint16_t>(p);
    const float x = widen({h});
    if (is_half_nan(p)) {
      EXPECT_TRUE(std::isnan(x)) << p;
      EXPECT_EQ(narrow(x).pattern, h | 0x0200);
    } else {
      if ((p & 0x7fff) < 0x7c00) {
        EXPECT_EQ(x, value_by_fields(p)) << p;
      }
      EXPECT_EQ(narrow(x).pattern, h);
      EXPECT_EQ(std::signbit(x), (p & 0x8000) != 0);
    }
  }
  EXPECT_EQ(widen({0x7c00}), std::numeric_limits<float>::infinity());
}

TEST(Half, NarrowingRoundsToNearestEven) {
  const auto expect_nearest = [](std::uint32_t pattern) {
    const float x = std::bit_cast<float>(pattern);
    if (!(std::fabs(x) <= std::numeric_limits<float>::max())) return;
    std::uint32_t expected = nearest_half(x);
    if (x == 0 || (expected & 0x7fff) == 0) expected = pattern >> 31 << 15;
    ASSERT_EQ(narrow(x).pattern, expected) << x;
  };
  // Every half, every tie and both neighbours of each.
  for (std::uint32_t p = 0; p < 0x7c00; ++p) {
    const float low = widen({static_cast<std::uint16_t>(p)});
    const double next = p + 1 == 0x7c00 ? 65536.0 : value_by_fields(p + 1);
    const auto tie = std::bit_cast<std::uint32_t>(static_cast<float>((low + next) / 2));
    for (std::uint32_t base : {std::bit_cast<std::uint32_t>(low), tie}) {
      for (std::uint32_t q : {base - (base > 0), base, base + 1}) {
        expect_nearest(q);
        expect_nearest(q | 0x80000000u);
      }
    }
  }
  pattern_source<std::uint32_t> source(24);
  for (int i = 0; i < 200'000; ++i) expect_nearest(source.any());
  EXPECT_EQ(narrow(std::numeric_limits<float>::infinity()).pattern, 0x7c00);
  EXPECT_EQ(narrow(-std::numeric_limits<float>::infinity()).pattern, 0xfc00);
  EXPECT_EQ(narrow(std::bit_cast<float>(0x7f800001u)).pattern, 0x7e00);
  EXPECT_EQ(narrow(std::bit_cast<float>(0xffc02000u)).pattern, 0xfe01);
}

TEST(Half, FusedMultiplyAddRoundsOnce) {
  pattern_source<std::uint32_t> source(25);
  const auto expect_fma = [](std::uint32_t a, std::uint32_t b, std::uint32_t c) {
    const quad exact =
        static_cast<quad>(value_by_fields(a)) * value_by_fields(b) + value_by_fields(c);
    const float r = scalar::half_fma(widen({static_cast<std::uint16_t>(a)}),
                                     widen({static_cast<std::uint16_t>(b)}),
                                     widen({static_cast<std::uint16_t>(c)}));
    const std::uint32_t expected = nearest_half(exact);
    if (exact == 0) {
      ASSERT_EQ(r, 0.0f);
    } else {
      ASSERT_EQ(narrow(r).pattern, expected) << std::hex << a << " " << b << " " << c;
    }
  };
  for (int i = 0; i < 300'000; ++i) {
    const std::uint32_t bits = source.any();
    const std::uint32_t a = bits & 0xfbff, b = (bits >> 16) & 0xfbff;
    expect_fma(a, b, source.any() & 0xfbff);
    // An addend next to a tie of the product, so that what a float sum drops decides.
    const double p = value_by_fields(a) * value_by_fields(b);
    if (std::fabs(p) < 60000)
      expect_fma(a, b, narrow(static_cast<float>(-p)).pattern ^ (source.any() & 1));
    expect_fma(a, b, nearest_half(std::ldexp(1.0, static_cast<int>(source.below(39)) - 24)));
  }
}

TEST(Half, FusedMultiplyAddOfSpecials) {
  const float inf = std::numeric_limits<float>::infinity();
  EXPECT_EQ(scalar::half_fma(inf, 1.0f, 1.0f), inf);
  EXPECT_EQ(scalar::half_fma(1.0f, 1.0f, -inf), -inf);
  EXPECT_TRUE(std::isnan(scalar::half_fma(inf, 0.0f, 1.0f)));
  EXPECT_TRUE(std::isnan(scalar::half_fma(inf, 1.0f, -inf)));
  EXPECT_EQ(scalar::half_fma(60000.0f, 2.0f, 0.0f), inf);
}

struct half_point {
  std::uint16_t x;
  std::uint16_t y;
};

constexpr half_point exp_h_ha_points[] = {
    {0x0000, 0x3c00}, {0x8000, 0x3c00}, {0x0001, 0x3c00}, {0x8001, 0x3c00}, {0x03ff, 0x3c00},
    {0x0400, 0x3c00}, {0x3c00, 0x4170}, {0xbc00, 0x35e3}, {0x3800, 0x3e98}, {0xb800, 0x38da},
    {0x4000, 0x4764}, {0x4d00, 0x7c00}, {0x4a00, 0x7c00}, {0x49ff, 0x7c00}, {0x4a01, 0x7c00},
    {0x498b, 0x7bf7}, {0x498c, 0x7c00}, {0xcc80, 0x0000}, {0xcc7f, 0x0000}, {0xcc81, 0x0000},
    {0xcbff, 0x0002}, {0xcc55, 0x0001}, {0xcc56, 0x0000}, {0x4600, 0x5e4e}, {0x45ff, 0x5e47},
    {0x44d1, 0x57b8}, {0x44d2, 0x57c0}, {0xc800, 0x0d7f}, {0xc7ff, 0x0d84}, {0xc79a, 0x1018},
    {0x4c00, 0x7c00}, {0x4bff, 0x7c00}, {0xce80, 0x0000}, {0xce40, 0x0000}, {0xce3f, 0x0000},
    {0xcb80, 0x0005}, {0x4b80, 0x7c00}, {0x7bff, 0x7c00}, {0xfbff, 0x0000}, {0x7c00, 0x7c00},
    {0xfc00, 0x0000}, {0x3555, 0x3d95}, {0xb555, 0x39bc}, {0x4248, 0x4dc8}, {0xc248, 0x2989},
};

constexpr half_point exp_h_la_points[] = {
    {0x0000, 0x3c00}, {0x8000, 0x3c00}, {0x0001, 0x3c00}, {0x8001, 0x3c00}, {0x03ff, 0x3c00},
    {0x0400, 0x3c00}, {0x3c00, 0x4170}, {0xbc00, 0x35e3}, {0x3800, 0x3e98}, {0xb800, 0x38da},
    {0x4000, 0x4764}, {0x4d00, 0x7c00}, {0x4a00, 0x7c00}, {0x49ff, 0x7c00}, {0x4a01, 0x7c00},
    {0x498b, 0x7bf7}, {0x498c, 0x7c00}, {0xcc80, 0x0000}, {0xcc7f, 0x0000}, {0xcc81, 0x0000},
    {0xcbff, 0x0002}, {0xcc55, 0x0001}, {0xcc56, 0x0000}, {0x4600, 0x5e4e}, {0x45ff, 0x5e48},
    {0x44d1, 0x57b8}, {0x44d2, 0x57c0}, {0xc800, 0x0d7f}, {0xc7ff, 0x0d84}, {0xc79a, 0x1018},
    {0x4c00, 0x7c00}, {0x4bff, 0x7c00}, {0xce80, 0x0000}, {0xce40, 0x0000}, {0xce3f, 0x0000},
    {0xcb80, 0x0005}, {0x4b80, 0x7c00}, {0x7bff, 0x7c00}, {0xfbff, 0x0000}, {0x7c00, 0x7c00},
    {0xfc00, 0x0000}, {0x3555, 0x3d95}, {0xb555, 0x39bc}, {0x4248, 0x4dc8}, {0xc248, 0x298a},
};

constexpr half_point exp2_h_ha_points[] = {
    {0x0000, 0x3c00}, {0x8000, 0x3c00}, {0x0001, 0x3c00}, {0x8001, 0x3c00}, {0x03ff, 0x3c00},
    {0x0400, 0x3c00}, {0x3c00, 0x4000}, {0xbc00, 0x3800}, {0x3800, 0x3da8}, {0xb800, 0x39a8},
    {0x4000, 0x4400}, {0x4d00, 0x7c00}, {0x4a00, 0x6c00}, {0x49ff, 0x6bf5}, {0x4a01, 0x6c06},
    {0x498b, 0x683f}, {0x498c, 0x6844}, {0xcc80, 0x0040}, {0xcc7f, 0x0041}, {0xcc81, 0x003f},
    {0xcbff, 0x0102}, {0xcc55, 0x0066}, {0xcc56, 0x0065}, {0x4600, 0x5400}, {0x45ff, 0x53fa},
    {0x44d1, 0x4f0c}, {0x44d2, 0x4f10}, {0xc800, 0x1c00}, {0xc7ff, 0x1c03}, {0xc79a, 0x1d46},
    {0x4c00, 0x7c00}, {0x4bff, 0x7bf5}, {0xce80, 0x0000}, {0xce40, 0x0000}, {0xce3f, 0x0001},
    {0xcb80, 0x0200}, {0x4b80, 0x7800}, {0x7bff, 0x7c00}, {0xfbff, 0x0000}, {0x7c00, 0x7c00},
    {0xfc00, 0x0000}, {0x3555, 0x3d0a}, {0xb555, 0x3a5a}, {0x4248, 0x4869}, {0xc248, 0x2f42},
};

constexpr half_point exp2_h_la_points[] = {
    {0x0000, 0x3c00}, {0x8000, 0x3c00}, {0x0001, 0x3c00}, {0x8001, 0x3c00}, {0x03ff, 0x3c00},
    {0x0400, 0x3c00}, {0x3c00, 0x4000}, {0xbc00, 0x3800}, {0x3800, 0x3da8}, {0xb800, 0x39a8},
    {0x4000, 0x4400}, {0x4d00, 0x7c00}, {0x4a00, 0x6c00}, {0x49ff, 0x6bf5}, {0x4a01, 0x6c06},
    {0x498b, 0x683e}, {0x498c, 0x6845}, {0xcc80, 0x0040}, {0xcc7f, 0x0041}, {0xcc81, 0x003f},
    {0xcbff, 0x0102}, {0xcc55, 0x0066}, {0xcc56, 0x0065}, {0x4600, 0x5400}, {0x45ff, 0x53fa},
    {0x44d1, 0x4f0c}, {0x44d2, 0x4f10}, {0xc800, 0x1c00}, {0xc7ff, 0x1c03}, {0xc79a, 0x1d46},
    {0x4c00, 0x7c00}, {0x4bff, 0x7bf5}, {0xce80, 0x0000}, {0xce40, 0x0000}, {0xce3f, 0x0001},
    {0xcb80, 0x0200}, {0x4b80, 0x7800}, {0x7bff, 0x7c00}, {0xfbff, 0x0000}, {0x7c00, 0x7c00},
    {0xfc00, 0x0000}, {0x3555, 0x3d0a}, {0xb555, 0x3a5a}, {0x4248, 0x4868}, {0xc248, 0x2f42},
};

constexpr half_point exp10_h_ha_points[] = {
    {0x0000, 0x3c00}, {0x8000, 0x3c00}, {0x0001, 0x3c00}, {0x8001, 0x3c00}, {0x03ff, 0x3c00},
    {0x0400, 0x3c00}, {0x3c00, 0x4900}, {0xbc00, 0x2e66}, {0x3800, 0x4253}, {0xb800, 0x350f},
    {0x4000, 0x5640}, {0x4d00, 0x7c00}, {0x4a00, 0x7c00}, {0x49ff, 0x7c00}, {0x4a01, 0x7c00},
    {0x498b, 0x7c00}, {0x498c, 0x7c00}, {0xcc80, 0x0000}, {0xcc7f, 0x0000}, {0xcc81, 0x0000},
    {0xcbff, 0x0000}, {0xcc55, 0x0000}, {0xcc56, 0x0000}, {0x4600, 0x7c00}, {0x45ff, 0x7c00},
    {0x44d1, 0x7c00}, {0x44d2, 0x7c00}, {0xc800, 0x0000}, {0xc7ff, 0x0000}, {0xc79a, 0x0000},
    {0x4c00, 0x7c00}, {0x4bff, 0x7c00}, {0xce80, 0x0000}, {0xce40, 0x0000}, {0xce3f, 0x0000},
    {0xcb80, 0x0000}, {0x4b80, 0x7c00}, {0x7bff, 0x7c00}, {0xfbff, 0x0000}, {0x7c00, 0x7c00},
    {0xfc00, 0x0000}, {0x3555, 0x404f}, {0xb555, 0x376e}, {0x4248, 0x6566}, {0xc248, 0x11ed},
};

constexpr half_point exp10_h_la_points[] = {
    {0x0000, 0x3c00}, {0x8000, 0x3c00}, {0x0001, 0x3c00}, {0x8001, 0x3c00}, {0x03ff, 0x3c00},
    {0x0400, 0x3c00}, {0x3c00, 0x4900}, {0xbc00, 0x2e67}, {0x3800, 0x4253}, {0xb800, 0x350f},
    {0x4000, 0x5640}, {0x4d00, 0x7c00}, {0x4a00, 0x7c00}, {0x49ff, 0x7c00}, {0x4a01, 0x7c00},
    {0x498b, 0x7c00}, {0x498c, 0x7c00}, {0xcc80, 0x0000}, {0xcc7f, 0x0000}, {0xcc81, 0x0000},
    {0xcbff, 0x0000}, {0xcc55, 0x0000}, {0xcc56, 0x0000}, {0x4600, 0x7c00}, {0x45ff, 0x7c00},
    {0x44d1, 0x7c00}, {0x44d2, 0x7c00}, {0xc800, 0x0000}, {0xc7ff, 0x0000}, {0xc79a, 0x0000},
    {0x4c00, 0x7c00}, {0x4bff, 0x7c00}, {0xce80, 0x0000}, {0xce40, 0x0000}, {0xce3f, 0x0000},
    {0xcb80, 0x0000}, {0x4b80, 0x7c00}, {0x7bff, 0x7c00}, {0xfbff, 0x0000}, {0x7c00, 0x7c00},
    {0xfc00, 0x0000}, {0x3555, 0x404e}, {0xb555, 0x376e}, {0x4248, 0x6566}, {0xc248, 0x11ed},
};

/// Both as a functor on the scalar layer's own halves and on those of a runtime.
struct other_half {
  std::uint16_t storage;
};

template <typename F>
std::uint32_t run(std::uint16_t x, std::uint16_t* y) {
  const binary16 a{x};
  binary16 r{0x5aa5};
  const std::uint32_t status = F::call(&a, &r);
  *y = r.pattern;
  const other_half b{x};
  other_half s{0x5aa5};
  EXPECT_EQ(F::call(&b, &s), status);
  EXPECT_EQ(s.storage, r.pattern);
  return status;
}

template <typename F, std::size_t N>
void expect_points(const half_point (&points)[N]) {
  for (const half_point& p : points) {
    std::uint16_t y = 0;
    EXPECT_EQ(run<F>(p.x, &y), 0u);
    EXPECT_EQ(y, p.y) << std::hex << p.x;
  }
}

TEST(ExpHalf, Points) {
  expect_points<scalar::exp_h<tier::ha>>(exp_h_ha_points);
  expect_points<scalar::exp_h<tier::la>>(exp_h_la_points);
  expect_points<scalar::exp_h<tier::ep>>(exp_h_la_points);
}
TEST(Exp2Half, Points) {
  expect_points<scalar::exp2_h<tier::ha>>(exp2_h_ha_points);
  expect_points<scalar::exp2_h<tier::la>>(exp2_h_la_points);
  expect_points<scalar::exp2_h<tier::ep>>(exp2_h_la_points);
}
TEST(Exp10Half, Points) {
  expect_points<scalar::exp10_h<tier::ha>>(exp10_h_ha_points);
  expect_points<scalar::exp10_h<tier::la>>(exp10_h_la_points);
  expect_points<scalar::exp10_h<tier::ep>>(exp10_h_la_points);
}

template <typename F>
class PowerHalf : public ::testing::Test {};
using powers =
    ::testing::Types<scalar::exp_h<tier::ha>, scalar::exp_h<tier::la>, scalar::exp_h<tier::ep>,
                     scalar::exp2_h<tier::ha>, scalar::exp2_h<tier::la>, scalar::exp2_h<tier::ep>,
                     scalar::exp10_h<tier::ha>, scalar::exp10_h<tier::la>,
                     scalar::exp10_h<tier::ep>>;
TYPED_TEST_SUITE(PowerHalf, powers);

TYPED_TEST(PowerHalf, StatusIsNoneForEveryArgument) {
  for (std::uint32_t p = 0; p < 0x10000; ++p) {
    std::uint16_t y = 0;
    ASSERT_EQ(run<TypeParam>(static_cast<std::uint16_t>(p), &y), 0u);
    if (is_half_nan(p)) {
      ASSERT_TRUE(is_half_nan(y) && (y & 0x0200) != 0) << std::hex << p;
    } else {
      ASSERT_LE(y, 0x7c00) << std::hex << p;
    }
  }
}

TYPED_TEST(PowerHalf, EndsOfTheRange) {
  const std::pair<std::uint16_t, std::uint16_t> ends[] = {
      {0x0000, 0x3c00}, {0x8000, 0x3c00}, {0x4d00, 0x7c00}, {0x7bff, 0x7c00},
      {0x7c00, 0x7c00}, {0xfbff, 0x0000}, {0xfc00, 0x0000}};
  for (const auto& [x, expected] : ends) {
    std::uint16_t y = 0;
    run<TypeParam>(x, &y);
    EXPECT_EQ(y, expected) << std::hex << x;
  }
}

/// Through float: the float body between two conversions, with its status.
using scalar::expm1_h;

TEST(Expm1Half, IsTheFloatBodyBetweenConversions) {
  for (std::uint32_t p = 0; p < 0x10000; ++p) {
    const float x = widen({static_cast<std::uint16_t>(p)});
    float wide = 0;
    const std::uint32_t status = scalar::expm1_s<tier::ep>::call(&x, &wide);
    std::uint16_t y = 0;
    ASSERT_EQ(run<expm1_h>(static_cast<std::uint16_t>(p), &y), status) << std::hex << p;
    ASSERT_EQ(y, narrow(wide).pattern) << std::hex << p;
  }
}

TEST(Expm1Half, OverflowOfTheConversionHasNoStatus) {
  std::uint16_t y = 0;
  EXPECT_EQ(run<expm1_h>(0x4a00, &y), 0u);  // 12: 162754 at float
  EXPECT_EQ(y, 0x7c00);
  EXPECT_EQ(run<expm1_h>(0x5a00, &y), 4u);  // 192: infinite at float
  EXPECT_EQ(y, 0x7c00);
  EXPECT_EQ(run<expm1_h>(0x8000, &y), 0u);
  EXPECT_EQ(y, 0x8000);
}

TEST(HalfThroughFloat, TwoOperandsAndTwoResults) {
  const binary16 three{0x4200}, minus_half{0xb800};
  binary16 y{}, z{};
  EXPECT_EQ(scalar::half_v21<scalar::mul_s>::call(&three, &minus_half, &y), 0u);
  EXPECT_EQ(y.pattern, 0xbe00);
  EXPECT_EQ(scalar::half_v21c<scalar::mul_s>::call(&three, minus_half, &y), 0u);
  EXPECT_EQ(y.pattern, 0xbe00);
  EXPECT_EQ(scalar::half_v12<scalar::modf_s>::call(&y, &y, &z), 0u);  // -1.5
  EXPECT_EQ(y.pattern, 0xbc00);
  EXPECT_EQ(z.pattern, 0xb800);
  const binary16 infinity{0xfc00};
  EXPECT_EQ(scalar::half_v12<scalar::modf_s>::call(&infinity, &y, &z), 0u);
  EXPECT_EQ(y.pattern, 0xfc00);
  EXPECT_EQ(z.pattern, 0x8000);
}

}  // namespace
