// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The logarithms at half.

#include "scalar/log/ln.hpp"
#include "scalar/log/log10.hpp"
#include "scalar/log/log1p.hpp"
#include "scalar/log/log2.hpp"
#include "scalar/log/logb.hpp"

#include "log_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::binary16;
using scalar::tier;
using scalar::widen;

struct half_point {
  std::uint16_t x;
  std::uint16_t y;
};

constexpr half_point ln_h_points[] = {
    {0x0001, 0xcc29}, {0x0002, 0xcbf9}, {0x0003, 0xcbc5}, {0x0200, 0xc933}, {0x03ff, 0xc8da},
    {0x0400, 0xc8da}, {0x0401, 0xc8da}, {0x3800, 0xb98c}, {0x3a00, 0xb49a}, {0x39ff, 0xb49d},
    {0x3bff, 0x9000}, {0x3c00, 0x0000}, {0x3c01, 0x13ff}, {0x3dff, 0x367a}, {0x3e00, 0x367d},
    {0x3e01, 0x3680}, {0x4000, 0x398c}, {0x4900, 0x409b}, {0x4170, 0x3c00}, {0x70e2, 0x489b},
    {0x7bff, 0x498c}, {0x4fbc, 0x42dd}, {0x20b3, 0xc4b1}, {0x5ef3, 0x4619}, {0x2de5, 0xc0c5},
    {0x65c9, 0x474d}, {0x5861, 0x44f1}, {0x78a3, 0x4946}, {0x6bb7, 0x4824}, {0x5eb5, 0x4610},
    {0x5376, 0x4417}, {0x760f, 0x490f},
};

constexpr half_point log2_h_points[] = {
    {0x0001, 0xce00}, {0x0002, 0xcdc0}, {0x0003, 0xcd9b}, {0x0200, 0xcb80}, {0x03ff, 0xcb00},
    {0x0400, 0xcb00}, {0x0401, 0xcb00}, {0x3800, 0xbc00}, {0x3a00, 0xb6a4}, {0x39ff, 0xb6a8},
    {0x3bff, 0x91c6}, {0x3c00, 0x0000}, {0x3c01, 0x15c5}, {0x3dff, 0x38ac}, {0x3e00, 0x38ae},
    {0x3e01, 0x38b0}, {0x4000, 0x3c00}, {0x4900, 0x42a5}, {0x4170, 0x3dc6}, {0x70e2, 0x4aa5},
    {0x7bff, 0x4c00}, {0x4fbc, 0x44f4}, {0x20b3, 0xc6c4}, {0x5ef3, 0x4866}, {0x2de5, 0xc2e2},
    {0x65c9, 0x4944}, {0x5861, 0x4721}, {0x78a3, 0x4b9b}, {0x6bb7, 0x49f9}, {0x5eb5, 0x485f},
    {0x5376, 0x45e6}, {0x760f, 0x4b4d},
};

constexpr half_point log10_h_points[] = {
    {0x0001, 0xc73a}, {0x0002, 0xc6ec}, {0x0003, 0xc6bf}, {0x0200, 0xc484}, {0x03ff, 0xc437},
    {0x0400, 0xc437}, {0x0401, 0xc437}, {0x3800, 0xb4d1}, {0x3a00, 0xafff}, {0x39ff, 0xb002},
    {0x3bff, 0x8af3}, {0x3c00, 0x0000}, {0x3c01, 0x0ef2}, {0x3dff, 0x31a0}, {0x3e00, 0x31a3},
    {0x3e01, 0x31a5}, {0x4000, 0x34d1}, {0x4900, 0x3c00}, {0x4170, 0x36f3}, {0x70e2, 0x4400},
    {0x7bff, 0x44d1}, {0x4fbc, 0x3df6}, {0x20b3, 0xc013}, {0x5ef3, 0x414c}, {0x2de5, 0xbc25},
    {0x65c9, 0x4257}, {0x5861, 0x404b}, {0x78a3, 0x4494}, {0x6bb7, 0x4331}, {0x5eb5, 0x4144},
    {0x5376, 0x3f1b}, {0x760f, 0x4465},
};

struct outcome {
  std::uint32_t pattern;
  std::uint32_t status;
};

template <typename F>
outcome run(std::uint32_t x) {
  const binary16 a{static_cast<std::uint16_t>(x)};
  binary16 y{0x5aa5};
  const std::uint32_t status = F::call(&a, &y);
  return {y.pattern, status};
}

bool is_half_nan(std::uint32_t p) { return (p & 0x7fff) > 0x7c00; }
bool is_quiet_half_nan(std::uint32_t p) { return (p & 0x7e00) == 0x7e00; }

template <typename F, std::size_t N>
void expect_half_points(const half_point (&points)[N]) {
  for (const half_point& p : points) {
    const outcome actual = run<F>(p.x);
    EXPECT_EQ(actual.pattern, p.y) << p.x;
    EXPECT_EQ(actual.status, 0u) << p.x;
  }
}

TEST(LnHalf, Points) { expect_half_points<scalar::ln_h>(ln_h_points); }
TEST(Log2Half, Points) { expect_half_points<scalar::log2_h>(log2_h_points); }
TEST(Log10Half, Points) { expect_half_points<scalar::log10_h>(log10_h_points); }

/// The error of the positive finite half `p` in units in the last place of the result.
double error_of(std::uint32_t p, std::uint32_t result, double exact) {
  const double y = widen({static_cast<std::uint16_t>(result)});
  if (exact == 0) return y == 0 ? 0 : std::numeric_limits<double>::infinity();
  const int exponent = std::max(std::ilogb(exact), -14);
  EXPECT_FALSE(is_half_nan(result)) << p;
  return std::fabs(y - exact) / std::ldexp(1.0, exponent - 10);
}

template <typename F>
void expect_error_below(double limit, double (*function)(double)) {
  double largest = 0;
  for (std::uint32_t p = 1; p < 0x7c00; ++p) {
    const double exact = function(widen({static_cast<std::uint16_t>(p)}));
    const outcome actual = run<F>(p);
    EXPECT_EQ(actual.status, 0u) << p;
    largest = std::max(largest, error_of(p, actual.pattern, exact));
  }
  EXPECT_LT(largest, limit);
}

/// Every positive half.
TEST(LogHalf, Error) {
  expect_error_below<scalar::ln_h>(0.61, std::log);
  expect_error_below<scalar::log2_h>(0.61, std::log2);
  expect_error_below<scalar::log10_h>(0.61, std::log10);
}

template <typename Body>
class LogHalf : public ::testing::Test {};
using bodies = ::testing::Types<scalar::ln_h, scalar::log2_h, scalar::log10_h>;
TYPED_TEST_SUITE(LogHalf, bodies);

TYPED_TEST(LogHalf, ZerosNegativeNumbersAndSpecials) {
  for (std::uint32_t p = 0; p < 0x10000; ++p) {
    if (p > 0 && p < 0x7c00) continue;
    const outcome actual = run<TypeParam>(p);
    EXPECT_EQ(actual.status, 0u) << p;
    if ((p & 0x7fff) == 0)
      EXPECT_EQ(actual.pattern, 0xfc00u) << p;
    else if (p == 0x7c00)
      EXPECT_EQ(actual.pattern, 0x7c00u) << p;
    else
      EXPECT_TRUE(is_quiet_half_nan(actual.pattern)) << p;
  }
}

TEST(LogbHalf, EveryHalf) {
  for (std::uint32_t p = 0; p < 0x10000; ++p) {
    const outcome actual = run<scalar::logb_h>(p);
    const std::uint32_t magnitude = p & 0x7fff;
    if (magnitude == 0) {
      EXPECT_EQ(actual.pattern, 0xfc00u);
      EXPECT_EQ(actual.status, domain);
    } else if (magnitude >= 0x7c00) {
      EXPECT_EQ(actual.pattern, magnitude == 0x7c00 ? 0x7c00u : (magnitude | 0x0200u));
      EXPECT_EQ(actual.status, 0u);
    } else {
      const float x = widen({static_cast<std::uint16_t>(p)});
      EXPECT_EQ(widen({static_cast<std::uint16_t>(actual.pattern)}), std::logb(x)) << p;
      EXPECT_EQ(actual.status, 0u);
    }
  }
}

/// At half log1p is the float body of `ep` between the conversions, with its status.
TEST(Log1pHalf, IsTheFloatBodyBetweenConversions) {
  using cast = scalar::half_v11<scalar::log1p_s<tier::ep>>;
  for (std::uint32_t p = 0; p < 0x10000; ++p) {
    const float x = widen({static_cast<std::uint16_t>(p)});
    float y = 0;
    const std::uint32_t status = scalar::log1p_s<tier::ep>::call(&x, &y);
    const outcome actual = run<cast>(p);
    EXPECT_EQ(actual.status, status) << p;
    EXPECT_EQ(actual.pattern, scalar::narrow(y).pattern) << p;
  }
  EXPECT_EQ(run<cast>(0xbc00).status, pole);
  EXPECT_EQ(run<cast>(0xc000).status, domain);
}

}  // namespace
