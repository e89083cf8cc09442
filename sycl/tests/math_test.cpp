// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <algorithm>
#include <climits>
#include <cmath>
#include <cstdint>
#include <limits>
#include <numbers>
#include <random>
#include <sycl/math.hpp>
#include <type_traits>

namespace {

using sycl::bit_cast;
using sycl::half;

constexpr half from_bits(unsigned pattern) {
  return bit_cast<half>(static_cast<std::uint16_t>(pattern));
}
unsigned to_bits(half h) { return bit_cast<std::uint16_t>(h); }

template <typename T>
constexpr T infinity = std::numeric_limits<T>::infinity();
template <typename T>
constexpr T nan_of = std::numeric_limits<T>::quiet_NaN();

/// Equal in value and in sign of zero, or both NaN.
template <typename T>
::testing::AssertionResult same(T actual, T expected) {
  const auto a = static_cast<double>(actual);
  const auto e = static_cast<double>(expected);
  const bool equal = std::isnan(e) ? std::isnan(a) : a == e && std::signbit(a) == std::signbit(e);
  if (equal) return ::testing::AssertionSuccess();
  return ::testing::AssertionFailure() << std::hexfloat << a << " instead of " << e;
}

/// The distance of a result from the reference in units of the result type's last place.
template <typename T>
double ulps(T actual, long double reference) {
  const auto a = static_cast<long double>(static_cast<double>(actual));
  if (std::isnan(reference)) return std::isnan(a) ? 0 : infinity<double>;
  const auto rounded = static_cast<double>(static_cast<T>(reference));
  if (std::isinf(rounded) || std::isinf(a)) return a == rounded ? 0 : infinity<double>;
  const int exponent = std::max(reference == 0 ? INT_MIN / 2 : std::ilogb(reference),
                                std::numeric_limits<T>::min_exponent - 1);
  const long double unit = std::ldexp(1.0L, exponent - (std::numeric_limits<T>::digits - 1));
  return static_cast<double>(std::fabs(a - reference) / unit);
}

// Overloads: the argument's own type, and plain conversions as for any function.
static_assert(std::is_same_v<decltype(sycl::exp(1.0F)), float>);
static_assert(std::is_same_v<decltype(sycl::exp(1.0)), double>);
static_assert(std::is_same_v<decltype(sycl::exp(half(1.0F))), half>);
static_assert(std::is_same_v<decltype(sycl::pow(2.0F, 2)), float>);
static_assert(std::is_same_v<decltype(sycl::clamp(2.0, 0, 1)), double>);
static_assert(std::is_same_v<decltype(sycl::fma(half(), half(), half())), half>);
static_assert(std::is_same_v<decltype(sycl::ilogb(half())), int>);
static_assert(std::is_same_v<decltype(sycl::isnan(half())), bool>);
static_assert(std::is_same_v<decltype(sycl::max(1, 2)), int>);
static_assert(std::is_same_v<decltype(sycl::clz(std::uint8_t{1})), std::uint8_t>);
static_assert(std::is_same_v<decltype(sycl::ldexp(1.0F, 3)), float>);
static_assert(std::is_same_v<decltype(sycl::nan(1U)), float>);
static_assert(std::is_same_v<decltype(sycl::select(1.0F, 2.0F, 1)), float>);

template <typename T>
concept has_abs = requires(T x) {
  sycl::abs(x);
};
static_assert(has_abs<int> && has_abs<std::int64_t> && !has_abs<float> && !has_abs<bool>);
template <typename T>
concept has_popcount = requires(T x) {
  sycl::popcount(x);
};
static_assert(has_popcount<unsigned char> && !has_popcount<double>);

struct interval {
  double low;
  double high;
};

/// One function at one type against a wider reference, with the error that the standard allows
/// at float and double or less.
template <typename T>
void expect_accurate(const char* name, T (*function)(T), long double (*reference)(long double),
                     interval domain, double bound) {
  std::mt19937 engine(1234);
  std::uniform_real_distribution<double> points(domain.low, domain.high);
  double worst = 0;
  T worst_at = 0;
  for (int i = 0; i < 4000; ++i) {
    const T x = static_cast<T>(points(engine));
    const double error =
        ulps(function(x), reference(static_cast<long double>(static_cast<double>(x))));
    if (error > worst) {
      worst = error;
      worst_at = x;
    }
  }
  EXPECT_LE(worst, bound) << name << " at " << std::hexfloat << static_cast<double>(worst_at);
}

#define EXPECT_ACCURATE(name, reference, low, high, bound)                         \
  do {                                                                             \
    const auto exact = [](long double x) -> long double { return reference; };     \
    expect_accurate<float>(                                                        \
        #name, [](float x) { return sycl::name(x); }, exact, {low, high}, bound);  \
    expect_accurate<double>(                                                       \
        #name, [](double x) { return sycl::name(x); }, exact, {low, high}, bound); \
    expect_accurate<half>(                                                         \
        #name, [](half x) { return sycl::name(x); }, exact, {low, high}, 0.51);    \
  } while (false)

constexpr long double pi = std::numbers::pi_v<long double>;

TEST(MathAccuracy, ExponentialsAndLogarithms) {
  EXPECT_ACCURATE(exp, std::exp(x), -10, 10, 1);
  EXPECT_ACCURATE(exp2, std::exp2(x), -14, 14, 1);
  EXPECT_ACCURATE(exp10, std::pow(10.0L, x), -4, 4, 1);
  EXPECT_ACCURATE(expm1, std::expm1(x), -8, 8, 1.5);
  EXPECT_ACCURATE(log, std::log(x), 1e-3, 1000, 1);
  EXPECT_ACCURATE(log2, std::log2(x), 1e-3, 1000, 1);
  EXPECT_ACCURATE(log10, std::log10(x), 1e-3, 1000, 2);
  EXPECT_ACCURATE(log1p, std::log1p(x), -0.9, 100, 1.5);
}

TEST(MathAccuracy, Roots) {
  EXPECT_ACCURATE(sqrt, std::sqrt(x), 0, 60000, 0.5);
  EXPECT_ACCURATE(cbrt, std::cbrt(x), -60000, 60000, 1);
  expect_accurate<double>(
      "cbrt", [](double x) { return sycl::cbrt(x); }, [](long double x) { return std::cbrt(x); },
      {-0x1p-1030, 0x1p-1030}, 1);
  EXPECT_EQ(sycl::cbrt(std::numeric_limits<double>::max()),
            static_cast<double>(std::cbrt(std::numeric_limits<double>::max() * 1.0L)));
  EXPECT_ACCURATE(rsqrt, 1 / std::sqrt(x), 1e-4, 60000, 1.5);
}

TEST(MathAccuracy, Trigonometric) {
  EXPECT_ACCURATE(sin, std::sin(x), -100, 100, 1);
  EXPECT_ACCURATE(cos, std::cos(x), -100, 100, 1);
  EXPECT_ACCURATE(tan, std::tan(x), -100, 100, 1.5);
  EXPECT_ACCURATE(asin, std::asin(x), -1, 1, 1);
  EXPECT_ACCURATE(acos, std::acos(x), -1, 1, 1);
  EXPECT_ACCURATE(atan, std::atan(x), -100, 100, 1);
  EXPECT_ACCURATE(asinpi, std::asin(x) / pi, -1, 1, 2.5);
  EXPECT_ACCURATE(acospi, std::acos(x) / pi, -1, 1, 2.5);
  EXPECT_ACCURATE(atanpi, std::atan(x) / pi, -100, 100, 2.5);
  // The reference is taken where its own reduction is exact.
  EXPECT_ACCURATE(sinpi, std::sin(pi * x), -0.5, 0.5, 2);
  EXPECT_ACCURATE(cospi, std::cos(pi * x), -0.4, 0.4, 2);
  EXPECT_ACCURATE(tanpi, std::tan(pi * x), -0.4, 0.4, 4);
  EXPECT_ACCURATE(sinpi, -std::sin(pi * (x - 17)), 16.5, 17.5, 2);
  EXPECT_ACCURATE(cospi, std::cos(pi * (x - 20)), 19.6, 20.4, 2);
}

TEST(MathAccuracy, HyperbolicAndSpecial) {
  EXPECT_ACCURATE(sinh, std::sinh(x), -10, 10, 2.5);
  EXPECT_ACCURATE(cosh, std::cosh(x), -10, 10, 2.5);
  EXPECT_ACCURATE(tanh, std::tanh(x), -5, 5, 2.5);
  EXPECT_ACCURATE(asinh, std::asinh(x), -100, 100, 2.5);
  EXPECT_ACCURATE(acosh, std::acosh(x), 1, 100, 2.5);
  EXPECT_ACCURATE(atanh, std::atanh(x), -0.99, 0.99, 2.5);
  EXPECT_ACCURATE(erf, std::erf(x), -3, 3, 1.5);
  EXPECT_ACCURATE(erfc, std::erfc(x), -3, 3, 4);
  EXPECT_ACCURATE(tgamma, std::tgamma(x), 0.1, 8, 8);
  EXPECT_ACCURATE(lgamma, std::lgamma(x), 3, 100, 4);
}

/// Functions whose results are halves or round as one operation: every half, exactly.
TEST(MathHalf, ExactFunctionsAtEveryValue) {
  for (unsigned pattern = 0; pattern < 0x10000U; ++pattern) {
    const half h = from_bits(pattern);
    const double x = h;
    ASSERT_EQ(sycl::isnan(h), std::isnan(x));
    ASSERT_EQ(sycl::isinf(h), std::isinf(x));
    ASSERT_EQ(sycl::isfinite(h), std::isfinite(x));
    ASSERT_EQ(sycl::isnormal(h), std::isfinite(x) && std::fabs(x) >= 0x1p-14) << pattern;
    ASSERT_EQ(sycl::signbit(h), pattern >= 0x8000U);
    ASSERT_EQ(to_bits(sycl::fabs(h)), pattern & 0x7FFFU);
    ASSERT_EQ(to_bits(sycl::copysign(h, half(-1))), pattern | 0x8000U);
    ASSERT_TRUE(same(sycl::ceil(h), half(std::ceil(x))));
    ASSERT_TRUE(same(sycl::floor(h), half(std::floor(x))));
    ASSERT_TRUE(same(sycl::trunc(h), half(std::trunc(x))));
    ASSERT_TRUE(same(sycl::round(h), half(std::round(x))));
    ASSERT_TRUE(same(sycl::rint(h), half(std::nearbyint(x))));
    ASSERT_TRUE(same(sycl::sqrt(h), half(std::sqrt(x))));
    ASSERT_TRUE(same(sycl::logb(h), half(std::logb(x))));
    ASSERT_EQ(sycl::ilogb(h), std::ilogb(x));
    ASSERT_TRUE(same(sycl::fmod(h, half(0.3F)), half(std::fmod(x, double{half(0.3F)}))));
    ASSERT_TRUE(same(sycl::remainder(half(7.0F), h), half(std::remainder(7.0, x))));
    double integral = 0;
    half half_integral = 0;
    ASSERT_TRUE(same(sycl::modf(h, &half_integral), half(std::modf(x, &integral))));
    ASSERT_TRUE(same(half_integral, half(integral)));
    for (const int k : {-30, -10, -1, 0, 3, 29, INT_MAX, INT_MIN}) {
      ASSERT_TRUE(same(sycl::ldexp(h, k), half(std::ldexp(x, k)))) << pattern << ' ' << k;
    }
    if (std::isfinite(x)) {
      int exponent = 0;
      const half fraction = sycl::frexp(h, &exponent);
      ASSERT_EQ(std::ldexp(double{fraction}, exponent), x);
      ASSERT_TRUE(x == 0 ||
                  (std::fabs(double{fraction}) >= 0.5 && std::fabs(double{fraction}) < 1));
    }
  }
}

TEST(MathHalf, NextafterWalksThroughAllValues) {
  half x = -infinity<half>;
  int steps = 0;
  double before = x;
  while (x != infinity<half>) {
    x = sycl::nextafter(x, infinity<half>);
    ASSERT_LT(before, double{x});
    before = x;
    ++steps;
  }
  // 2 * 0x7C00 nonzero values below infinity and one zero lie between the infinities.
  EXPECT_EQ(steps, 2 * 0x7C00);
  EXPECT_EQ(to_bits(sycl::nextafter(half(0.0F), half(-1))), 0x8001U);
  EXPECT_TRUE(same(sycl::nextafter(half(0.0F), half(-0.0F)), half(-0.0F)));
  EXPECT_EQ(to_bits(sycl::nextafter(half(1), half(0))), 0x3BFFU);
  EXPECT_EQ(to_bits(sycl::nextafter(half(-1), half(0))), 0xBBFFU);
  EXPECT_TRUE(sycl::isnan(sycl::nextafter(nan_of<half>, half(0))));
}

__extension__ typedef __int128 int128;

/// Finite halves as multiples of 2^-24.
std::int64_t in_units(half h) { return static_cast<std::int64_t>(std::ldexp(double{h}, 24)); }

/// a * b + c from integers: the exact sum in units of 2^-48, rounded to nearest even.
half exact_fma(half a, half b, half c) {
  const int128 sum = static_cast<int128>(in_units(a)) * in_units(b) +
                     static_cast<int128>(in_units(c)) * (int128{1} << 24);
  const bool negative = sum < 0;
  const int128 magnitude = negative ? -sum : sum;
  int shift = 24;  // the least unit of a half is 2^-24
  while ((magnitude >> shift) >= 2048) ++shift;
  int128 kept = magnitude >> shift;
  const int128 rest = magnitude - (kept << shift);
  const int128 tie = int128{1} << (shift - 1);
  if (rest > tie || (rest == tie && (kept & 1) != 0)) ++kept;
  const double value = std::ldexp(static_cast<double>(kept), shift - 48);
  return half(negative ? -value : value);
}

TEST(MathHalf, FmaRoundsOnce) {
  std::mt19937 engine(5);
  std::uniform_int_distribution<unsigned> patterns(0, 0xFFFFU);
  int tested = 0;
  while (tested < 400'000) {
    half a = from_bits(patterns(engine));
    half b = from_bits(patterns(engine));
    half c = from_bits(patterns(engine));
    if (!sycl::isfinite(a) || !sycl::isfinite(b) || !sycl::isfinite(c)) continue;
    // Every second time, an addend that nearly cancels the product, or one far below it.
    if (tested % 4 == 1) c = half(-(a * b));
    if (tested % 4 == 3) c = from_bits((to_bits(c) & 0x83FFU));
    if (!sycl::isfinite(c)) continue;
    const half expected = exact_fma(a, b, c);
    ASSERT_EQ(double{sycl::fma(a, b, c)}, double{expected})
        << std::hex << to_bits(a) << ' ' << to_bits(b) << ' ' << to_bits(c);
    ASSERT_EQ(to_bits(sycl::mad(a, b, c)), to_bits(sycl::fma(a, b, c)));
    ++tested;
  }
}

TEST(MathHalf, FmaTieBrokenByATinyAddend) {
  // Products in the middle between two halves; the least denormal decides, which a sum formed in
  // float loses.
  int decided = 0;
  for (unsigned p = 0x7000U; p < 0x7400U; p += 3) {
    for (unsigned q = 0x4000U; q < 0x4400U; q += 7) {
      const half a = from_bits(p);
      const half b = from_bits(q);
      for (const unsigned tiny : {0x0001U, 0x8001U}) {
        const half c = from_bits(tiny);
        const half expected = exact_fma(a, b, c);
        ASSERT_EQ(to_bits(sycl::fma(a, b, c)), to_bits(expected));
        const float in_float = std::fma(float{a}, float{b}, float{c});
        decided += to_bits(half(in_float)) != to_bits(expected) ? 1 : 0;
      }
    }
  }
  EXPECT_GT(decided, 0);
}

TEST(MathFma, IsFusedAtEveryType) {
  const float f = 1.0F + 0x1p-23F;
  EXPECT_EQ(sycl::fma(f, f, -1.0F), 0x1p-22F + 0x1p-46F);
  EXPECT_EQ(sycl::mad(f, f, -1.0F), 0x1p-22F + 0x1p-46F);
  const double d = 1.0 + 0x1p-52;
  EXPECT_EQ(sycl::fma(d, d, -1.0), 0x1p-51 + 0x1p-104);
  EXPECT_EQ(sycl::mad(d, d, -1.0), 0x1p-51 + 0x1p-104);
}

template <typename T>
class MathFloat : public ::testing::Test {};
using Floats = ::testing::Types<float, double, half>;
TYPED_TEST_SUITE(MathFloat, Floats);

TYPED_TEST(MathFloat, PiFunctionsAreExactAtQuarters) {
  using T = TypeParam;
  for (int n = -9; n <= 9; ++n) {
    const T whole = static_cast<T>(n);
    const T zero = static_cast<T>(n < 0 ? -0.0 : 0.0);
    const bool odd = n % 2 != 0;
    EXPECT_TRUE(same(sycl::sinpi(whole), zero)) << n;
    EXPECT_TRUE(same(sycl::cospi(whole), static_cast<T>(odd ? -1 : 1))) << n;
    EXPECT_TRUE(same(sycl::tanpi(whole), odd ? -zero : zero)) << n;
    const T between = static_cast<T>(n + 0.5);
    EXPECT_TRUE(same(sycl::sinpi(between), static_cast<T>(odd ? -1 : 1))) << n;
    EXPECT_TRUE(same(sycl::cospi(between), static_cast<T>(0))) << n;
    EXPECT_TRUE(same(sycl::tanpi(between), odd ? -infinity<T> : infinity<T>)) << n;
  }
  EXPECT_TRUE(same(sycl::sinpi(static_cast<T>(-0.0)), static_cast<T>(-0.0)));
  EXPECT_TRUE(same(sycl::sinpi(infinity<T>), nan_of<T>));
  EXPECT_TRUE(same(sycl::cospi(-infinity<T>), nan_of<T>));
  EXPECT_TRUE(same(sycl::tanpi(nan_of<T>), nan_of<T>));
}

TYPED_TEST(MathFloat, Powers) {
  using T = TypeParam;
  const T zero = 0;
  const T one = 1;
  const T two = 2;
  EXPECT_TRUE(same(sycl::pow(two, T(10)), T(1024)));
  EXPECT_TRUE(same(sycl::pow(T(-2), T(3)), T(-8)));
  EXPECT_TRUE(same(sycl::pow(nan_of<T>, zero), one));
  EXPECT_TRUE(same(sycl::pown(T(-2), 3), T(-8)));
  EXPECT_TRUE(same(sycl::pown(T(-0.0F), -3), -infinity<T>));
  EXPECT_TRUE(same(sycl::pown(T(-0.0F), -2), infinity<T>));
  EXPECT_TRUE(same(sycl::pown(nan_of<T>, 0), one));
  EXPECT_TRUE(same(sycl::powr(two, T(-2)), T(0.25F)));
  EXPECT_TRUE(same(sycl::powr(T(-2), two), nan_of<T>));
  EXPECT_TRUE(same(sycl::powr(zero, zero), nan_of<T>));
  EXPECT_TRUE(same(sycl::powr(infinity<T>, zero), nan_of<T>));
  EXPECT_TRUE(same(sycl::powr(one, infinity<T>), nan_of<T>));
  EXPECT_TRUE(same(sycl::powr(nan_of<T>, zero), nan_of<T>));
  EXPECT_TRUE(same(sycl::powr(one, nan_of<T>), nan_of<T>));
  EXPECT_TRUE(same(sycl::powr(T(-0.0F), T(-1)), infinity<T>));
  EXPECT_TRUE(same(sycl::powr(T(-0.0F), one), zero));
  EXPECT_TRUE(same(sycl::powr(T(3), zero), one));
  EXPECT_TRUE(same(sycl::rootn(T(8), 3), two));
  EXPECT_TRUE(same(sycl::rootn(T(-8), 3), -two));
  EXPECT_TRUE(same(sycl::rootn(T(16), -4), T(0.5F)));
  EXPECT_TRUE(same(sycl::rootn(T(-4), 2), nan_of<T>));
  EXPECT_TRUE(same(sycl::rootn(T(4), 0), nan_of<T>));
  EXPECT_TRUE(same(sycl::rootn(T(-0.0F), 3), T(-0.0F)));
  EXPECT_TRUE(same(sycl::rootn(T(-0.0F), 2), zero));
  EXPECT_TRUE(same(sycl::rootn(T(-0.0F), -3), -infinity<T>));
  EXPECT_TRUE(same(sycl::hypot(T(3), T(-4)), T(5)));
  EXPECT_TRUE(same(sycl::hypot(infinity<T>, nan_of<T>), infinity<T>));
}

TYPED_TEST(MathFloat, CubeRootSpecials) {
  using T = TypeParam;
  EXPECT_TRUE(same(sycl::cbrt(T(-0.0F)), T(-0.0F)));
  EXPECT_TRUE(same(sycl::cbrt(-infinity<T>), -infinity<T>));
  EXPECT_TRUE(same(sycl::cbrt(nan_of<T>), nan_of<T>));
  EXPECT_TRUE(same(sycl::cbrt(T(-27)), T(-3)));
}

TYPED_TEST(MathFloat, RootsOfLargeArguments) {
  using T = TypeParam;
  const double large = double{std::numeric_limits<T>::max()};
  for (const int n : {2, 3, 4, 5, 7, -2, -5}) {
    const T x = static_cast<T>(large * 0.7);
    EXPECT_LE(ulps(sycl::rootn(x, n), std::pow(static_cast<long double>(double{x}), 1.0L / n)),
              1.0);
  }
}

TYPED_TEST(MathFloat, DifferencesAndExtrema) {
  using T = TypeParam;
  const T one = 1;
  const T two = 2;
  EXPECT_TRUE(same(sycl::fmin(one, nan_of<T>), one));
  EXPECT_TRUE(same(sycl::fmax(nan_of<T>, two), two));
  EXPECT_TRUE(same(sycl::fmin(one, two), one));
  EXPECT_TRUE(same(sycl::fmax(one, two), two));
  EXPECT_TRUE(same(sycl::fdim(two, one), one));
  EXPECT_TRUE(same(sycl::fdim(one, two), T(0)));
  EXPECT_TRUE(same(sycl::maxmag(T(-3), two), T(-3)));
  EXPECT_TRUE(same(sycl::minmag(T(-3), two), two));
  EXPECT_TRUE(same(sycl::maxmag(T(-2), two), two));
  EXPECT_TRUE(same(sycl::fmod(T(-7), two), T(-1)));
  EXPECT_TRUE(same(sycl::remainder(T(7), two), T(-1)));
  int quotient = 0;
  EXPECT_TRUE(same(sycl::remquo(T(7), two, &quotient), T(-1)));
  EXPECT_EQ(quotient & 7, 4);
  EXPECT_TRUE(same(sycl::nextafter(infinity<T>, T(0)), std::numeric_limits<T>::max()));
}

TYPED_TEST(MathFloat, Parts) {
  using T = TypeParam;
  T integral = 0;
  EXPECT_TRUE(same(sycl::modf(T(-2.75F), &integral), T(-0.75F)));
  EXPECT_TRUE(same(integral, T(-2)));
  EXPECT_TRUE(same(sycl::fract(T(-2.75F), &integral), T(0.25F)));
  EXPECT_TRUE(same(integral, T(-3)));
  const T tiny = -std::numeric_limits<T>::denorm_min();
  EXPECT_TRUE(same(sycl::fract(tiny, &integral), sycl::nextafter(T(1), T(0))));
  EXPECT_TRUE(same(sycl::fract(T(-0.0F), &integral), T(-0.0F)));
  EXPECT_TRUE(same(sycl::fract(-infinity<T>, &integral), T(-0.0F)));
  EXPECT_TRUE(same(integral, -infinity<T>));
  EXPECT_TRUE(same(sycl::fract(nan_of<T>, &integral), nan_of<T>));
  EXPECT_EQ(sycl::ilogb(T(10)), 3);
  EXPECT_TRUE(same(sycl::logb(T(0.3F)), T(-2)));
  EXPECT_TRUE(same(sycl::ldexp(T(3), -2), T(0.75F)));
  T cosine = 0;
  EXPECT_TRUE(same(sycl::sincos(T(0.5F), &cosine), sycl::sin(T(0.5F))));
  EXPECT_TRUE(same(cosine, sycl::cos(T(0.5F))));
  int sign = 0;
  const T gamma = sycl::lgamma_r(T(-0.5F), &sign);
  EXPECT_EQ(sign, -1);
  EXPECT_TRUE(same(gamma, sycl::lgamma(T(-0.5F))));
}

TYPED_TEST(MathFloat, Common) {
  using T = TypeParam;
  EXPECT_TRUE(same(sycl::clamp(T(5), T(0), T(1)), T(1)));
  EXPECT_TRUE(same(sycl::clamp(T(-5), T(0), T(1)), T(0)));
  EXPECT_TRUE(same(sycl::min(T(1), T(2)), T(1)));
  EXPECT_TRUE(same(sycl::max(T(1), T(2)), T(2)));
  EXPECT_TRUE(same(sycl::step(T(1), T(0.5F)), T(0)));
  EXPECT_TRUE(same(sycl::step(T(1), T(1)), T(1)));
  EXPECT_TRUE(same(sycl::mix(T(2), T(4), T(0.25F)), T(2.5F)));
  EXPECT_TRUE(same(sycl::smoothstep(T(0), T(2), T(1)), T(0.5F)));
  EXPECT_TRUE(same(sycl::smoothstep(T(0), T(2), T(-1)), T(0)));
  EXPECT_TRUE(same(sycl::smoothstep(T(0), T(2), T(3)), T(1)));
  EXPECT_TRUE(same(sycl::sign(T(-3)), T(-1)));
  EXPECT_TRUE(same(sycl::sign(T(-0.0F)), T(-0.0F)));
  EXPECT_TRUE(same(sycl::sign(nan_of<T>), T(0)));
  EXPECT_LE(ulps(sycl::degrees(T(1)), 180 / pi), 2.0);
  EXPECT_LE(ulps(sycl::radians(T(50)), 50 * pi / 180), 2.0);
}

TYPED_TEST(MathFloat, Relations) {
  using T = TypeParam;
  const T one = 1;
  const T n = nan_of<T>;
  EXPECT_TRUE(sycl::isequal(one, one) && !sycl::isequal(n, n));
  EXPECT_TRUE(sycl::isnotequal(n, n) && !sycl::isnotequal(one, one));
  EXPECT_TRUE(sycl::isgreater(T(2), one) && !sycl::isgreater(n, one));
  EXPECT_TRUE(sycl::isgreaterequal(one, one) && sycl::isless(one, T(2)));
  EXPECT_TRUE(sycl::islessequal(one, one) && sycl::islessgreater(one, T(2)));
  EXPECT_TRUE(!sycl::islessgreater(one, n) && !sycl::islessgreater(one, one));
  EXPECT_TRUE(sycl::isordered(one, one) && sycl::isunordered(one, n));
  EXPECT_TRUE(sycl::isnan(n) && sycl::isinf(-infinity<T>) && !sycl::isfinite(n));
  EXPECT_TRUE(sycl::isnormal(one) && !sycl::isnormal(std::numeric_limits<T>::denorm_min()));
  EXPECT_TRUE(sycl::signbit(T(-0.0F)) && !sycl::signbit(T(0)));
}

TYPED_TEST(MathFloat, Selection) {
  using T = TypeParam;
  EXPECT_TRUE(same(sycl::select(T(1), T(2), 0), T(1)));
  EXPECT_TRUE(same(sycl::select(T(1), T(2), true), T(2)));
  EXPECT_TRUE(same(sycl::select(T(1), T(2), std::uint64_t{1} << 40), T(2)));
  EXPECT_TRUE(same(sycl::bitselect(T(1), T(-2), T(-0.0F)), T(-1)));
}

TEST(Math, NanCarriesItsCode) {
  EXPECT_EQ(bit_cast<std::uint32_t>(sycl::nan(std::uint32_t{5})), 0x7FC00005U);
  EXPECT_EQ(bit_cast<std::uint64_t>(sycl::nan(std::uint64_t{5})), 0x7FF8000000000005U);
  EXPECT_EQ(to_bits(sycl::nan(std::uint16_t{5})), 0x7E05U);
}

TEST(Math, NativeAndHalfPrecision) {
  EXPECT_EQ(sycl::native::sin(0.5F), sycl::sin(0.5F));
  EXPECT_EQ(sycl::native::divide(1.0F, 4.0F), 0.25F);
  EXPECT_EQ(sycl::native::recip(8.0F), 0.125F);
  EXPECT_EQ(sycl::half_precision::exp2(3.0F), 8.0F);
  EXPECT_EQ(sycl::half_precision::powr(2.0F, 3.0F), 8.0F);
}

/// Every pair of 8-bit integers against int arithmetic.
template <typename T>
void expect_integer_functions_match() {
  constexpr int low = std::numeric_limits<T>::min();
  constexpr int high = std::numeric_limits<T>::max();
  const auto saturated = [](int x) { return x < low ? low : (x > high ? high : x); };
  const auto floor_half = [](int x) { return x >= 0 ? x / 2 : -((1 - x) / 2); };
  for (int i = low; i <= high; ++i) {
    const T x = static_cast<T>(i);
    unsigned ones = 0;
    for (unsigned bits = static_cast<std::uint8_t>(x); bits != 0; bits &= bits - 1) ++ones;
    ASSERT_EQ(sycl::popcount(x), static_cast<T>(ones));
    int leading = 0;
    while (leading < 8 && (static_cast<std::uint8_t>(x) & (0x80U >> leading)) == 0) ++leading;
    ASSERT_EQ(sycl::clz(x), leading);
    int trailing = 0;
    while (trailing < 8 && (static_cast<std::uint8_t>(x) & (1U << trailing)) == 0) ++trailing;
    ASSERT_EQ(sycl::ctz(x), trailing);
    for (int j = low; j <= high; ++j) {
      const T y = static_cast<T>(j);
      ASSERT_EQ(sycl::add_sat(x, y), saturated(i + j));
      ASSERT_EQ(sycl::sub_sat(x, y), saturated(i - j));
      ASSERT_EQ(sycl::hadd(x, y), floor_half(i + j));
      ASSERT_EQ(sycl::rhadd(x, y), floor_half(i + j + 1));
      ASSERT_EQ(sycl::mul_hi(x, y), (i * j) >> 8);
      ASSERT_EQ(sycl::mad_hi(x, y, T{100}), static_cast<T>(((i * j) >> 8) + 100));
      ASSERT_EQ(sycl::mad_sat(x, y, T{100}), saturated(i * j + 100));
      ASSERT_EQ(sycl::min(x, y), i < j ? i : j);
      ASSERT_EQ(sycl::max(x, y), i > j ? i : j);
      ASSERT_EQ(sycl::abs_diff(x, y), static_cast<T>(i > j ? i - j : j - i));
      const unsigned count = static_cast<unsigned>(j) & 7U;
      const unsigned u = static_cast<std::uint8_t>(x);
      ASSERT_EQ(sycl::rotate(x, y), static_cast<T>((u << count) | (u >> (8 - count))));
      ASSERT_EQ(sycl::bitselect(x, y, T{0x55}), static_cast<T>((i & ~0x55) | (j & 0x55)));
    }
  }
}

TEST(MathInteger, EveryPairOfSigned8BitIntegers) { expect_integer_functions_match<std::int8_t>(); }
TEST(MathInteger, EveryPairOfUnsigned8BitIntegers) {
  expect_integer_functions_match<std::uint8_t>();
}

TEST(MathInteger, WideProducts) {
  EXPECT_EQ(sycl::mul_hi(INT64_MIN, INT64_MIN), std::int64_t{1} << 62);
  EXPECT_EQ(sycl::mul_hi(INT64_MIN, INT64_MAX), -(std::int64_t{1} << 62));
  EXPECT_EQ(sycl::mul_hi(UINT64_MAX, UINT64_MAX), UINT64_MAX - 1);
  EXPECT_EQ(sycl::mul_hi(0x80000000U, 6U), 3U);
  EXPECT_EQ(sycl::mul_hi(INT_MIN, 3), -2);
  EXPECT_EQ(sycl::mad_hi(UINT64_MAX, UINT64_MAX, std::uint64_t{5}), 3U);
  EXPECT_EQ(sycl::mad_sat(INT_MAX, INT_MAX, INT_MAX), INT_MAX);
  EXPECT_EQ(sycl::mad_sat(INT64_MIN, INT64_MAX, INT64_MIN), INT64_MIN);
  EXPECT_EQ(sycl::mad_sat(UINT64_MAX, UINT64_MAX, UINT64_MAX), UINT64_MAX);
  EXPECT_EQ(sycl::mad_sat(std::int64_t{3}, std::int64_t{4}, std::int64_t{5}), 17);
}

TEST(MathInteger, WideEdges) {
  EXPECT_EQ(sycl::add_sat(INT64_MAX, std::int64_t{1}), INT64_MAX);
  EXPECT_EQ(sycl::sub_sat(INT64_MIN, std::int64_t{1}), INT64_MIN);
  EXPECT_EQ(sycl::sub_sat(0U, 1U), 0U);
  EXPECT_EQ(sycl::hadd(INT_MAX, INT_MAX), INT_MAX);
  EXPECT_EQ(sycl::rhadd(UINT64_MAX, UINT64_MAX - 1), UINT64_MAX);
  EXPECT_EQ(sycl::clz(std::int64_t{0}), 64);
  EXPECT_EQ(sycl::ctz(0), 32);
  EXPECT_EQ(sycl::clz(-1), 0);
  EXPECT_EQ(sycl::abs(-7), 7);
  EXPECT_EQ(sycl::abs(7U), 7U);
  EXPECT_EQ(sycl::rotate(0x80000001U, 33U), 3U);
  EXPECT_EQ(sycl::rotate(1, -1), INT_MIN);
  EXPECT_EQ(sycl::clamp(7, 1, 5), 5);
  EXPECT_EQ(sycl::clamp(std::uint64_t{0}, std::uint64_t{1}, std::uint64_t{5}), 1U);
  static_assert(sycl::mul_hi(0xFFFFFFFFU, 0xFFFFFFFFU) == 0xFFFFFFFEU);
}

}  // namespace
