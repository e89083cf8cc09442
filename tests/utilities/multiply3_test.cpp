// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/utility/multiply3_156.hpp"

#include <gtest/gtest.h>

#include <bit>
#include <cmath>
#include <cstdint>
#include <vector>

#include "scalar/bits.hpp"
#include "scalar/quad.hpp"
#include "utilities/product_reference.hpp"

namespace {

using namespace arbor::lumen::tests;
using arbor::lumen::vm::detail::gpu::norvane::scalar::special::impl::multiply3_156;
using std::bit_cast;
using pattern = std::uint64_t;
using patterns = pattern_source<pattern>;

constexpr pattern sign = named<pattern>::sign, one = named<pattern>::one;
constexpr pattern fraction = 0xfffffffffffff, implicit_bit = 0x10000000000000;
constexpr pattern ceiling = 0x7fe0000000000000;

pattern power_of_two(int exponent) { return static_cast<pattern>(exponent + 1023) << 52; }
pattern of(double x) { return bit_cast<pattern>(x); }

bool expect_product(pattern a, pattern b, pattern c, pattern expected, std::uint32_t code,
                    location where = location::current()) {
  const auto got = multiply3_156(a, b, c);
  const auto number = [](pattern p) { return bit_cast<double>(p); };
  return expect_result<double>(expected, code, number(got.pattern), got.code, where,
                               "multiply3_156", "product", number(a), number(b), number(c));
}

/// Against the exact product; stops after a few differences.
void expect_exact(pattern a, pattern b, pattern c, location where = location::current()) {
  if (testing::Test::HasFailure()) return;
  const product_of_three expected = rounded_product(a, b, c);
  expect_product(a, b, c, expected.pattern, expected.code, where);
}

/// Three exponents whose sum is `sum`, none of them beyond that of a number.
void expect_exact_at(patterns& source, int sum, location where = location::current()) {
  const auto below = [&](int n) {
    return static_cast<int>(source.below(static_cast<std::uint64_t>(n)));
  };
  int first, second, third;
  do {
    first = below(2046) - 1022;
    second = below(2046) - 1022;
    third = sum - first - second;
  } while (third < -1022 || third > 1023);
  const auto with = [&](int exponent) {
    return (source.any() & (sign | fraction)) | power_of_two(exponent);
  };
  expect_exact(with(first), with(second), with(third), where);
}

TEST(Multiply3, OfSmallIntegersIsExact) {
  for (int a = 1; a < 40; ++a) {
    for (int b = 1; b < 40; ++b) {
      for (int c = -20; c < 20; ++c) {
        if (c != 0) expect_product(of(a), of(b), of(c), of(a * b * c), 0);
      }
    }
  }
  expect_product(of(131071), of(131071), of(524287), of(131071.0 * 131071 * 524287), 0);
  expect_product(of(0.1), of(1), of(1), of(0.1), 0);
}

TEST(Multiply3, HasTheSignOfTheProduct) {
  for (int signs = 0; signs < 8; ++signs) {
    const auto number = [&](double x, int bit) { return (signs >> bit & 1) != 0 ? -x : x; };
    const double a = number(1.5, 0), b = number(3, 1), c = number(0.75, 2);
    expect_product(of(a), of(b), of(c), of(a * b * c), 0);
    const pattern s = of(a * b * c) & sign;
    expect_product(of(std::ldexp(a, 1000)), of(std::ldexp(b, 1000)), of(c), s | ceiling, 1);
    expect_product(of(std::ldexp(a, -1000)), of(std::ldexp(b, -1000)), of(c), s, 2);
  }
}

TEST(Multiply3, IsTheExactProductRoundedOnce) {
  patterns source(301);
  for (int i = 0; i < 3'000'000; ++i)
    expect_exact_at(source, static_cast<int>(source.below(2046)) - 1024);
}

TEST(Multiply3, OfAnyPatternsIsThatOfTheirFields) {
  patterns source(302);
  for (int i = 0; i < 1'000'000; ++i) expect_exact(source.any(), source.any(), source.any());
  const std::vector<pattern> notable = notable_patterns<pattern>();
  for (const pattern a : notable) {
    for (const pattern b : notable) {
      for (const pattern c : notable) expect_exact(a, b, c);
    }
  }
}

// Significands with a run of ones or zeros at their end drive carries through all the limbs.
TEST(Multiply3, CarriesThroughTheLimbs) {
  patterns source(303);
  const auto with_run = [&] {
    const pattern run = fraction >> source.below(53);
    const pattern p = source.any() & fraction;
    return one | (source.below(2) == 0 ? p | run : p & ~run);
  };
  for (int i = 0; i < 1'000'000; ++i) expect_exact(with_run(), with_run(), with_run());
  for (int i = 0; i <= 52; ++i) {
    for (int j = 0; j <= 52; ++j) {
      for (int k = 0; k <= 52; ++k) {
        expect_exact(one | fraction >> i, one | fraction >> j, one | fraction >> k);
        expect_exact(one | pattern{1} << i >> 1, one | pattern{1} << j >> 1,
                     one | pattern{1} << k >> 1);
      }
    }
  }
}

// Products of significands of 18 bits have at most 54: a half of the last place is common there.
TEST(Multiply3, RoundsTiesToEven) {
  patterns source(304);
  int ties = 0;
  for (int i = 0; i < 1'000'000 && !HasFailure(); ++i) {
    const auto integer = [&] { return static_cast<double>((source.any() & 0x3ffff) | 0x20001); };
    const double a = integer(), b = integer(), c = integer();
    const quad exact = static_cast<quad>(a) * static_cast<quad>(b) * static_cast<quad>(c);
    const auto rounded = static_cast<double>(exact);
    const quad error = static_cast<quad>(rounded) - exact;
    if (error != 0) {
      ++ties;
      EXPECT_TRUE(error == 1 || error == -1);
      EXPECT_EQ(0, of(rounded) & 1) << rounded;
    }
    expect_product(of(a), of(b), of(c), of(rounded), 0);
  }
  EXPECT_GT(ties, 100'000);
}

/// x = w·2^m with w³ of 54 bits, w = 1 modulo 4: x³ lies half-way between two numbers of 53 bits,
/// the lower one even. x³ + 1 = (x + 1)(x² - x + 1), the last a product of two.
struct above_tie {
  int m;
  std::uint64_t w, b, c;
};
// The 1 stands in limb 4, 3, 2, 1 and 0 of the product, and nothing stands between it and the tie.
constexpr above_tie above_ties[] = {
    {5, 253133, 0x1, 0x3bacfb750a61},
    {11, 249661, 0x25, 0x191a4822b253ad},
    {17, 210613, 0xb75fbe1, 0x39ac4b18821},
    {24, 231437, 0x7ab5cb71, 0x1a0479a70f9591},
    {32, 244157, 0x8629d9995197, 0x1a7be9bf6e3e27},
};

TEST(Multiply3, SeesAUnitAboveATieInEveryLimb) {
  for (const above_tie& t : above_ties) {
    const std::uint64_t x = t.w << t.m, cube = t.w * t.w * t.w;
    const auto wide_x = static_cast<unsigned __int128>(x);
    ASSERT_TRUE(wide_x * x - x + 1 == static_cast<unsigned __int128>(t.b) * t.c);
    ASSERT_EQ(1u, cube % 4);
    const auto number = [](std::uint64_t n) { return of(static_cast<double>(n)); };
    const auto scaled = [&](std::uint64_t n) {
      return of(std::ldexp(static_cast<double>(n), 3 * t.m));
    };
    expect_product(number(x), number(x), number(x), scaled(cube - 1), 0);
    expect_product(number(x + 1), number(t.b), number(t.c), scaled(cube + 1), 0);
    expect_product(number(t.c), number(x + 1), number(t.b), scaled(cube + 1), 0);
    expect_product(number(t.b), number(t.c), number(x + 1), scaled(cube + 1), 0);
  }
}

TEST(Multiply3, RoundingUpCarriesIntoTheExponent) {
  // (2 - 2u)(1 + 2u)(1 - u) with u = 2^-53 is 2 - 8u² and less.
  const pattern below_two = one | fraction, below_one = of(1 - 0x1p-53);
  for (const int exponent : {-1022, -500, 0, 500, 1021}) {
    const pattern scaled = below_two - one + power_of_two(exponent);
    expect_product(scaled, one | 1, below_one, power_of_two(exponent + 1), 0);
  }
  patterns source(305);
  int carried = 0;
  for (int i = 0; i < 1'000'000; ++i) {
    // Close to a power of two: b is the reciprocal of a, rounded.
    const pattern a = (source.any() & fraction) | one;
    const pattern b = of(1 / bit_cast<double>(a));
    const pattern c = power_of_two(static_cast<int>(source.below(2000)) - 1000);
    expect_exact(a, b, c);
    carried += (rounded_product(a, b, c).pattern & fraction) == 0;
  }
  EXPECT_GT(carried, 10'000);
}

TEST(Multiply3, EndsAboveExponent1022) {
  const pattern large = power_of_two(1022), two = of(2);
  expect_product(large, one, one, large, 0);
  expect_product(large | fraction, one, one, large | fraction, 0);
  // The largest number and already 2^1023 are beyond; the pattern is that of 2^1023.
  expect_product(large, two, one, ceiling, 1);
  expect_product(named<pattern>::largest, one, one, ceiling, 1);
  expect_product(named<pattern>::largest, named<pattern>::largest, named<pattern>::largest | sign,
                 sign | ceiling, 1);
  // The position of the leading bit counts: 1.5·1.5·2^1022 and 1.99·1.99·1.99·2^1020.
  expect_product(large | of(1.5), of(1.5), one, ceiling, 1);
  expect_product(
      power_of_two(1020) | fraction, one | fraction, one | fraction,
      rounded_product(power_of_two(1020) | fraction, one | fraction, one | fraction).pattern, 0);
  expect_product(power_of_two(1021) | fraction, one | fraction, one | fraction, ceiling, 1);
  expect_product(large | fraction, one | 1, one, ceiling, 1);
  // A product below 2^1023 that rounds up to it gives the same pattern without the code.
  expect_product(large | fraction, one | 1, of(1 - 0x1p-53), ceiling, 0);
  patterns source(306);
  for (int sum = 1018; sum < 1027; ++sum) {
    for (int i = 0; i < 50'000; ++i) expect_exact_at(source, sum);
  }
}

TEST(Multiply3, EndsBelowExponentMinus1023) {
  const pattern smallest = named<pattern>::smallest_normal, half = of(0.5);
  expect_product(smallest, one, one, smallest, 0);
  // The exponent -1023 has the field 0: the fraction stands there without its implicit bit.
  expect_product(smallest, half, one, 0, 0);
  expect_product(smallest | 12345, half, one, 12345, 0);
  expect_product(smallest | 12345, half, one | sign, sign | 12345, 0);
  expect_product(smallest, half, half, 0, 2);
  expect_product(smallest | fraction, half, half, 0, 2);
  expect_product(smallest | fraction, half, half | sign, sign, 2);
  expect_product(smallest, smallest, smallest, 0, 2);
  // The position of the leading bit counts: 1.5·2^-1022 · 1.5·2^-1 · 2^-1 is within.
  expect_product(of(0x1.8p-1022), of(0.75), half, of(2.25) & fraction, 0);
  // A product below 2^-1022 that rounds up to it gives the smallest normal number.
  expect_product(of(0x1.fffffffffffffp-1000), one | 1, of(0x1.fffffffffffffp-24), smallest, 0);
  patterns source(307);
  for (int sum = -1030; sum < -1018; ++sum) {
    for (int i = 0; i < 50'000; ++i) expect_exact_at(source, sum);
  }
}

// Their fields are taken for those of numbers: an exponent field of 0 for 2^-1023 with an implicit
// bit, one of 2047 for 2^1024.
TEST(Multiply3, TakesSpecialPatternsForNumbers) {
  const pattern inf = named<pattern>::inf, nan = named<pattern>::nan;
  expect_product(0, one, one, 0, 0);
  expect_product(sign, one, one, sign, 0);
  expect_product(0, of(2), one, power_of_two(-1022), 0);
  expect_product(0, of(0x1p1000), of(8), power_of_two(-20), 0);
  expect_product(0, 0, one, 0, 2);
  expect_product(0, sign, one, sign, 2);
  expect_product(0, inf, one, of(2), 0);
  expect_product(1, one, one, 1, 0);
  expect_product(fraction, one, one | sign, sign | fraction, 0);
  expect_product(1, of(2), one, implicit_bit | 1, 0);
  expect_product(inf, one, one, ceiling, 1);
  expect_product(inf, of(-0.25), one, sign | power_of_two(1022), 0);
  expect_product(nan, one, one, ceiling, 1);
  expect_product(nan, of(0.25), one, power_of_two(1022) | (nan & fraction), 0);
  expect_product(inf, inf, inf, ceiling, 1);
  expect_product(inf, 0, 0, of(0x1p-1022), 0);
}

}  // namespace
