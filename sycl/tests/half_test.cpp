// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <functional>
#include <limits>
#include <random>
#include <sstream>
#include <sycl/half.hpp>
#include <type_traits>
#include <unordered_set>
#include <vector>

namespace {

using sycl::bit_cast;
using sycl::half;
using limits = std::numeric_limits<half>;

constexpr half from_bits(unsigned pattern) {
  return bit_cast<half>(static_cast<std::uint16_t>(pattern));
}
constexpr unsigned to_bits(half h) { return bit_cast<std::uint16_t>(h); }

/// The value of a finite pattern from the definition of the format; 2^16 for infinity's, as if
/// the exponents went on.
double value_of(unsigned magnitude) {
  const int exponent = static_cast<int>(magnitude >> 10);
  const int fraction = static_cast<int>(magnitude & 0x3FFU);
  return exponent == 0 ? std::ldexp(fraction, -24) : std::ldexp(1024 + fraction, exponent - 25);
}

/// Rounding by search among all halves: nearest, ties to the even pattern.
template <typename Float>
unsigned nearest_half(Float x) {
  const unsigned sign = std::signbit(x) ? 0x8000U : 0U;
  const Float magnitude = std::fabs(x);
  if (std::isnan(x)) return 0xFFFFU;  // callers compare NaNs by class
  if (magnitude >= 65536) return sign | 0x7C00U;
  unsigned low = 0;
  unsigned high = 0x7C00U;
  while (high - low > 1) {
    const unsigned middle = (low + high) / 2;
    (static_cast<Float>(value_of(middle)) <= magnitude ? low : high) = middle;
  }
  const Float midpoint = static_cast<Float>((value_of(low) + value_of(high)) / 2);
  if (magnitude < midpoint) return sign | low;
  if (magnitude > midpoint) return sign | high;
  return sign | (low % 2 == 0 ? low : high);
}

bool is_nan(half h) { return (to_bits(h) & 0x7FFFU) > 0x7C00U; }

template <typename Float>
::testing::AssertionResult rounds_correctly(Float x) {
  const half h = x;
  if (std::isnan(x) ? is_nan(h) : to_bits(h) == nearest_half(x)) {
    return ::testing::AssertionSuccess();
  }
  return ::testing::AssertionFailure() << std::hexfloat << x << " became pattern " << std::hex
                                       << to_bits(h) << ", not " << nearest_half(x);
}

static_assert(std::is_trivially_copyable_v<half> &&
              std::is_trivially_default_constructible_v<half>);
static_assert(std::is_standard_layout_v<half> && sizeof(half) == 2 && alignof(half) == 2);

// Conversions are available at compile time.
static_assert(to_bits(half(1.0F)) == 0x3C00 && to_bits(half(-2.0)) == 0xC000);
static_assert(to_bits(half(65504)) == 0x7BFF && to_bits(half(65520)) == 0x7C00);
static_assert(to_bits(half(0x1p-24F)) == 1 && to_bits(half(0x1p-25F)) == 0);
static_assert(to_bits(half(0x1.000002p-25F)) == 1 && to_bits(half(-0.0F)) == 0x8000);
static_assert(static_cast<float>(from_bits(0x0001)) == 0x1p-24F);
static_assert(static_cast<float>(from_bits(0xFBFF)) == -65504.0F);
static_assert(half(1.5F) * half(2.0F) + 1 == 4.0F);
static_assert(to_bits(-half(0.0F)) == 0x8000);

// Types of mixed expressions are those of the usual arithmetic conversions.
static_assert(std::is_same_v<decltype(half() + half()), half>);
static_assert(std::is_same_v<decltype(half() - 1), half>);
static_assert(std::is_same_v<decltype(2ULL * half()), half>);
static_assert(std::is_same_v<decltype(half() / 2.0F), float>);
static_assert(std::is_same_v<decltype(2.0 * half()), double>);
static_assert(std::is_same_v<decltype(half() + 1.0L), long double>);
static_assert(std::is_same_v<decltype(+half()), half> && std::is_same_v<decltype(-half()), half>);
static_assert(std::is_convertible_v<float, half> && std::is_convertible_v<double, half> &&
              std::is_convertible_v<int, half> && std::is_convertible_v<half, float> &&
              std::is_convertible_v<half, double> && std::is_convertible_v<half, int>);

TEST(HalfConversion, EveryPatternToFloatAndBack) {
  for (unsigned pattern = 0; pattern < 0x10000U; ++pattern) {
    const half h = from_bits(pattern);
    const float f = h;
    const unsigned magnitude = pattern & 0x7FFFU;
    ASSERT_EQ(std::signbit(f), pattern >= 0x8000U) << pattern;
    if (magnitude > 0x7C00U) {
      // Quieted, payload kept, in both directions.
      ASSERT_EQ(bit_cast<std::uint32_t>(f),
                (pattern >> 15 << 31) | 0x7FC00000U | ((magnitude & 0x3FFU) << 13));
      ASSERT_EQ(to_bits(half(f)), pattern | 0x0200U);
    } else if (magnitude == 0x7C00U) {
      ASSERT_TRUE(std::isinf(f));
      ASSERT_EQ(to_bits(half(f)), pattern);
    } else {
      ASSERT_EQ(std::fabs(static_cast<double>(f)), value_of(magnitude)) << pattern;
      ASSERT_EQ(to_bits(half(f)), pattern);
      ASSERT_EQ(to_bits(half(static_cast<double>(h))), pattern);
      ASSERT_EQ(to_bits(half(static_cast<long double>(h))), pattern);
    }
    ASSERT_EQ(bit_cast<std::uint32_t>(f),
              sycl::detail::widen_half(static_cast<std::uint16_t>(pattern)));
  }
}

TEST(HalfConversion, NanPayloadsFromWiderTypes) {
  EXPECT_EQ(to_bits(half(bit_cast<float>(0x7F800001U))), 0x7E00U);
  EXPECT_EQ(to_bits(half(bit_cast<float>(0xFFA02000U))), 0xFF01U);
  EXPECT_EQ(to_bits(half(bit_cast<float>(0x7FC00000U))), 0x7E00U);
  EXPECT_EQ(to_bits(half(bit_cast<double>(0x7FF0000000000001U))), 0x7E00U);
  EXPECT_EQ(to_bits(half(bit_cast<double>(0xFFF0040000000000U))), 0xFE01U);
  EXPECT_TRUE(is_nan(half(std::numeric_limits<long double>::quiet_NaN())));
}

/// Each half and each midpoint between halves, and what lies beside them in the wider type.
template <typename Float>
void expect_boundaries_round_correctly() {
  const Float infinity = std::numeric_limits<Float>::infinity();
  for (unsigned pattern = 0; pattern < 0x7C00U; ++pattern) {
    const auto value = static_cast<Float>(value_of(pattern));
    const auto midpoint = static_cast<Float>((value_of(pattern) + value_of(pattern + 1)) / 2);
    for (const Float centre : {value, midpoint}) {
      for (const Float sign : {Float{1}, Float{-1}}) {
        Float below = centre;
        Float above = centre;
        for (int step = 0; step < 3; ++step) {
          ASSERT_TRUE(rounds_correctly(sign * below));
          ASSERT_TRUE(rounds_correctly(sign * above));
          below = std::nextafter(below, -infinity);
          above = std::nextafter(above, infinity);
        }
      }
    }
  }
}

TEST(HalfConversion, FloatBoundaries) { expect_boundaries_round_correctly<float>(); }
TEST(HalfConversion, DoubleBoundaries) { expect_boundaries_round_correctly<double>(); }
TEST(HalfConversion, LongDoubleBoundaries) { expect_boundaries_round_correctly<long double>(); }

TEST(HalfConversion, AMillionFloatPatterns) {
  std::mt19937 engine(20240);
  for (int i = 0; i < 1'000'000; ++i) {
    // Half of them within the exponents that matter.
    std::uint32_t pattern = static_cast<std::uint32_t>(engine());
    if (i % 2 == 0) {
      pattern =
          (pattern & 0x807FFFFFU) | ((100U + static_cast<std::uint32_t>(engine()) % 45U) << 23);
    }
    const float x = bit_cast<float>(pattern);
    ASSERT_TRUE(rounds_correctly(x));
    ASSERT_EQ(to_bits(half(x)), (sycl::detail::round_to_half<std::uint32_t, 23>(pattern)));
#ifdef __FLT16_MAX__
    ASSERT_EQ(to_bits(half(x)), bit_cast<std::uint16_t>(static_cast<_Float16>(x)));
#endif
  }
}

TEST(HalfConversion, DoublePatterns) {
  std::mt19937_64 engine(77);
  for (int i = 0; i < 300'000; ++i) {
    std::uint64_t pattern = engine();
    if (i % 4 != 0) {
      pattern = (pattern & 0x800FFFFFFFFFFFFFU) | ((996U + engine() % 45U) << 52);
    }
    ASSERT_TRUE(rounds_correctly(bit_cast<double>(pattern)));
  }
}

TEST(HalfConversion, DoubleRoundsOnce) {
  // Just off a midpoint, by less than float can tell: rounding to float first would tie.
  for (unsigned pattern = 0; pattern < 0x7C00U; ++pattern) {
    const double low = value_of(pattern);
    const double high = value_of(pattern + 1);
    const double midpoint = (low + high) / 2;
    const double below = midpoint - (high - low) * 0x1p-20;
    const double above = midpoint + (high - low) * 0x1p-20;
    ASSERT_EQ(to_bits(half(below)), pattern);
    ASSERT_EQ(to_bits(half(above)), pattern + 1);
    ASSERT_EQ(to_bits(half(-above)), 0x8000U | (pattern + 1));
  }
  EXPECT_EQ(to_bits(half(1.0 + 0x1p-11 + 0x1p-40)), 0x3C01U);
  EXPECT_EQ(to_bits(half(static_cast<float>(1.0 + 0x1p-11 + 0x1p-40))), 0x3C00U);
  EXPECT_EQ(to_bits(half(1.0L + 0x1p-11L + 0x1p-60L)), 0x3C01U);
  EXPECT_EQ(to_bits(half(1.0L + 0x3p-11L - 0x1p-60L)), 0x3C01U);
  EXPECT_EQ(to_bits(half(-1.0L - 0x3p-11L + 0x1p-60L)), 0xBC01U);
}

TEST(HalfConversion, Integers) {
  for (int i = -70000; i <= 70000; ++i) {
    ASSERT_EQ(to_bits(half(i)), nearest_half(static_cast<double>(i))) << i;
  }
  EXPECT_EQ(half(std::numeric_limits<std::uint64_t>::max()), limits::infinity());
  EXPECT_EQ(half(std::numeric_limits<std::int64_t>::min()), -limits::infinity());
  EXPECT_EQ(half(true), half(1.0F));
  EXPECT_EQ(static_cast<int>(half(-3.75F)), -3);
  EXPECT_TRUE(static_cast<bool>(half(0.5F)));
  EXPECT_FALSE(static_cast<bool>(half(-0.0F)));
}

/// Edge patterns and a spread of others, of both signs.
std::vector<half> grid() {
  std::vector<half> values;
  for (unsigned pattern = 0; pattern < 0x10000U; pattern += 173)
    values.push_back(from_bits(pattern));
  for (const unsigned pattern :
       {0x0000U, 0x0001U, 0x0002U, 0x03FFU, 0x0400U, 0x0401U, 0x0800U, 0x1400U, 0x3800U, 0x3BFFU,
        0x3C00U, 0x3C01U, 0x4000U, 0x7800U, 0x7BFFU, 0x7C00U, 0x7C01U, 0x7E00U}) {
    values.push_back(from_bits(pattern));
    values.push_back(from_bits(pattern | 0x8000U));
  }
  return values;
}

::testing::AssertionResult is_rounded(half result, double exact, half a, half b) {
  if (std::isnan(exact) ? is_nan(result) : to_bits(result) == nearest_half(exact)) {
    return ::testing::AssertionSuccess();
  }
  return ::testing::AssertionFailure()
         << std::hex << to_bits(a) << ", " << to_bits(b) << " gave " << to_bits(result);
}

TEST(HalfArithmetic, GridOfPairsIsCorrectlyRounded) {
  // In double, sums and products of halves are exact, and quotients are never close enough to a
  // midpoint for the double's own rounding to matter.
  const std::vector<half> values = grid();
  for (const half a : values) {
    for (const half b : values) {
      const double x = static_cast<float>(a);
      const double y = static_cast<float>(b);
      ASSERT_TRUE(is_rounded(a + b, x + y, a, b)) << "+";
      ASSERT_TRUE(is_rounded(a - b, x - y, a, b)) << "-";
      ASSERT_TRUE(is_rounded(a * b, x * y, a, b)) << "*";
      ASSERT_TRUE(is_rounded(a / b, x / y, a, b)) << "/";
      ASSERT_EQ(a == b, x == y);
      ASSERT_EQ(a != b, x != y);
      ASSERT_EQ(a < b, x < y);
      ASSERT_EQ(a <= b, x <= y);
      ASSERT_EQ(a > b, x > y);
      ASSERT_EQ(a >= b, x >= y);
    }
  }
}

TEST(HalfArithmetic, UnaryAndSteps) {
  for (unsigned pattern = 0; pattern < 0x10000U; ++pattern) {
    const half h = from_bits(pattern);
    ASSERT_EQ(to_bits(-h), pattern ^ 0x8000U);
    ASSERT_EQ(to_bits(+h), pattern);
    if (is_nan(h)) continue;
    half x = h;
    ASSERT_EQ(&++x, &x);
    ASSERT_EQ(to_bits(x), nearest_half(static_cast<double>(h) + 1.0));
    x = h;
    ASSERT_EQ(to_bits(x--), pattern);
    ASSERT_EQ(to_bits(x), nearest_half(static_cast<double>(h) - 1.0));
    x = h;
    ASSERT_EQ(to_bits(--x), nearest_half(static_cast<double>(h) - 1.0));
    x = h;
    ASSERT_EQ(to_bits(x++), pattern);
  }
}

TEST(HalfArithmetic, CompoundAssignment) {
  half h = 3.0F;
  EXPECT_EQ(&(h += half(2.0F)), &h);
  EXPECT_EQ(h, 5);
  EXPECT_EQ(h -= 1, 4);
  EXPECT_EQ(h *= 0.5F, 2);
  EXPECT_EQ(h /= 8.0, 0.25);
  // The sum is formed in double and rounded once.
  h = 1.0F;
  h += 0x1p-11 + 0x1p-40;
  EXPECT_EQ(to_bits(h), 0x3C01U);
  float f = 1.5F;
  f += half(0.25F);
  EXPECT_EQ(f, 1.75F);
}

TEST(HalfArithmetic, MixedOperands) {
  const half h = from_bits(0x3C01);  // 1 + 2^-10
  EXPECT_EQ(h + 0x1p-20F, 0x1.00401p0F);
  EXPECT_EQ(1.0 / half(3.0F), 1.0 / 3.0);
  EXPECT_EQ(2 * h, 0x1.004p1F);
  EXPECT_EQ(to_bits(half(2048.0F) + 1), 0x6800U);
  EXPECT_TRUE(h > 1 && h < 1.25 && 1.0F <= h && h != 1 && !(h == 1.0));
  EXPECT_TRUE(half(0.1F) != 0.1F);
  EXPECT_TRUE(half(0.5F) == 0.5L);
  EXPECT_FALSE(limits::quiet_NaN() == 1.0F);
  EXPECT_TRUE(limits::quiet_NaN() != limits::quiet_NaN());
}

TEST(Half, NumericLimits) {
  EXPECT_TRUE(limits::is_specialized && limits::is_iec559 && limits::has_infinity);
  EXPECT_EQ(limits::max(), 65504.0F);
  EXPECT_EQ(limits::lowest(), -65504.0F);
  EXPECT_EQ(limits::min(), std::ldexp(1.0F, limits::min_exponent - 1));
  EXPECT_EQ(limits::epsilon(), std::ldexp(1.0F, 1 - limits::digits));
  EXPECT_EQ(limits::denorm_min(), std::ldexp(1.0F, limits::min_exponent - limits::digits));
  EXPECT_EQ(limits::round_error(), 0.5F);
  EXPECT_TRUE(std::isinf(static_cast<float>(limits::infinity())));
  EXPECT_TRUE(is_nan(limits::quiet_NaN()) && is_nan(limits::signaling_NaN()));
  EXPECT_EQ(limits::max_exponent, 16);
  EXPECT_EQ(limits::digits10, 3);
  EXPECT_EQ(limits::max_digits10, 5);
  EXPECT_EQ(std::numeric_limits<const half>::max(), limits::max());
}

TEST(Half, Hash) {
  EXPECT_EQ(std::hash<half>()(half(0.0F)), std::hash<half>()(half(-0.0F)));
  const std::unordered_set<half> set = {half(1.0F), half(2.0F), half(1.0F)};
  EXPECT_EQ(set.size(), 2U);
  EXPECT_TRUE(set.contains(half(2.0F)));
}

TEST(Half, StreamsAsFloat) {
  std::ostringstream out;
  out << half(0.5F) << ' ' << half(-1.25F);
  EXPECT_EQ(out.str(), "0.5 -1.25");
}

}  // namespace
