// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <cmath>

#include "bits.hpp"
#include "scalar/exact/fmod.hpp"
#include "scalar/exact/remainder.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

constexpr std::uint32_t domain = 1;
constexpr std::uint32_t pole = 2;

template <typename T>
using fmod_body = scalar::fmod_body<T>;
template <typename T>
using remainder_body = scalar::remainder_body<T>;

/// Both functions: finite operands against the C library, whose remainders are exact too; the
/// others by the rules for them.
template <typename T>
bool expect_both(part_of<T> p, part_of<T> q) {
  using U = part_of<T>;
  using n = named<U>;
  const T x = std::bit_cast<T>(p);
  const T y = std::bit_cast<T>(q);
  if (std::isnan(x) || std::isnan(y)) {
    const bool good = expect_v21<fmod_body<T>>(p, q, n::any_nan, 0);
    return expect_v21<remainder_body<T>>(p, q, n::any_nan, 0) && good;
  }
  if (y == 0 || std::isinf(x)) {
    const bool good = expect_v21<fmod_body<T>>(p, q, n::nan, pole);
    return expect_v21<remainder_body<T>>(p, q, n::nan, y == 0 ? domain : 0) && good;
  }
  const bool good = expect_v21<fmod_body<T>>(p, q, std::bit_cast<U>(std::fmod(x, y)), 0);
  return expect_v21<remainder_body<T>>(p, q, std::bit_cast<U>(std::remainder(x, y)), 0) && good;
}

template <typename T>
class ExactDivision : public ::testing::Test {};
using types = ::testing::Types<float, double>;
TYPED_TEST_SUITE(ExactDivision, types);

TYPED_TEST(ExactDivision, SmallNumbers) {
  using T = TypeParam;
  struct row {
    T x, y, fmod, remainder;
  };
  const row rows[] = {
      {5, 3, 2, -1},         {-5, 3, -2, 1},        {5, -3, 2, -1},         {-5, -3, -2, 1},
      {3, 2, 1, -1},         {1, 2, 1, 1},          {5, 2, 1, 1},           {7, 2, 1, -1},
      {-3, 2, -1, 1},        {-5, 2, -1, -1},       {6, 3, 0, 0},           {-6, 3, -0.0, -0.0},
      {2, 3, 2, -1},         {1.25, 3, 1.25, 1.25}, {3, 3, 0, 0},           {-3, 3, -0.0, -0.0},
      {0, 3, 0, 0},          {-0.0, 3, -0.0, -0.0}, {5.75, 1, 0.75, -0.25}, {-5.75, 1, -0.75, 0.25},
      {-0.5, 1, -0.5, -0.5}, {-1, -1, -0.0, -0.0},  {4, 1, 0, 0},
  };
  for (const row& r : rows) {
    expect_number<fmod_body<T>>(r.x, r.y, r.fmod, 0);
    expect_number<remainder_body<T>>(r.x, r.y, r.remainder, 0);
  }
}

TYPED_TEST(ExactDivision, SpecialOperands) {
  using T = TypeParam;
  using n = named<part_of<T>>;
  const auto minus = n::sign;
  expect_v21<fmod_body<T>>(n::one, 0, n::nan, pole);
  expect_v21<fmod_body<T>>(n::one | minus, minus, n::nan, pole);
  expect_v21<fmod_body<T>>(0, 0, n::nan, pole);
  expect_v21<fmod_body<T>>(n::inf, 0, n::nan, pole);
  expect_v21<fmod_body<T>>(n::inf, n::one, n::nan, pole);
  expect_v21<fmod_body<T>>(n::inf | minus, n::inf, n::nan, pole);
  // A large divisor does not bring an infinite x into the range of the quotient.
  expect_v21<fmod_body<T>>(n::inf, n::largest, n::nan, pole);
  expect_v21<fmod_body<T>>(n::inf | minus, n::largest - n::smallest_normal, n::nan, pole);
  expect_v21<fmod_body<T>>(n::one, n::inf, n::one, 0);
  expect_v21<fmod_body<T>>(minus, n::inf | minus, minus, 0);
  expect_v21<fmod_body<T>>(n::largest, n::inf, n::largest, 0);

  expect_v21<remainder_body<T>>(n::one, 0, n::nan, domain);
  expect_v21<remainder_body<T>>(0, minus, n::nan, domain);
  expect_v21<remainder_body<T>>(n::inf, 0, n::nan, domain);
  expect_v21<remainder_body<T>>(n::inf, n::one, n::nan, 0);
  expect_v21<remainder_body<T>>(n::inf | minus, n::inf, n::nan, 0);
  expect_v21<remainder_body<T>>(n::inf, n::largest, n::nan, 0);
  expect_v21<remainder_body<T>>(n::one, n::inf | minus, n::one, 0);
  expect_v21<remainder_body<T>>(minus, n::inf, minus, 0);
}

/// A NaN is quietened with its sign and payload, and reported by no status, whatever stands beside
/// it.
TYPED_TEST(ExactDivision, NansPass) {
  using T = TypeParam;
  using n = named<part_of<T>>;
  const auto payload = n::nan + 3;
  const auto signalling = n::signalling + 2;  // the same payload
  for (const auto other : {decltype(n::one)(0), n::one, n::inf, n::largest, n::sign}) {
    for (const auto nan : {payload, signalling}) {
      expect_v21<fmod_body<T>>(nan, other, payload, 0);
      expect_v21<fmod_body<T>>(other, nan, payload, 0);
      expect_v21<remainder_body<T>>(nan, other, payload, 0);
      expect_v21<remainder_body<T>>(other, nan, payload, 0);
    }
  }
  // By 1 as well, which a factor 1 would not quieten.
  expect_v21<fmod_body<T>>(signalling | n::sign, n::one, payload | n::sign, 0);
  expect_v21<remainder_body<T>>(signalling | n::sign, n::one, payload | n::sign, 0);
  // Of two NaNs remainder takes x.
  expect_v21<remainder_body<T>>(payload, n::nan | n::sign, payload, 0);
}

/// fmod by 1 takes the fraction.
TYPED_TEST(ExactDivision, FmodByOne) {
  using T = TypeParam;
  using U = part_of<T>;
  for (const U p : notable_patterns<U>()) {
    const T x = std::bit_cast<T>(p);
    if (!std::isfinite(x)) continue;
    T integer;
    const U fraction = std::bit_cast<U>(std::modf(x, &integer));
    expect_v21<fmod_body<T>>(p, named<U>::one, fraction, 0);
    expect_v21<fmod_body<T>>(p, named<U>::one | named<U>::sign, fraction, 0);
  }
}

/// The edges of the window in which the quotient serves: divisor and distance of the exponents.
TYPED_TEST(ExactDivision, EdgesOfTheQuotientRange) {
  using T = TypeParam;
  using U = part_of<T>;
  using range = scalar::quotient_range<T>;
  using n = named<U>;
  const U unit = n::smallest_normal;
  const U distance = static_cast<U>(range::distance) * unit;
  pattern_source<U> source(6);
  for (const U edge : {range::smallest_divisor, range::largest_divisor, n::one, n::one + 1}) {
    for (int step = -2; step <= 2; ++step) {
      const U y = edge + static_cast<U>(step);
      for (int i = 0; i < 2000; ++i) {
        U x = y + distance + static_cast<U>(source.below(5)) * unit - 2 * unit;
        x = (x & ~(unit - 1)) | (source.any() & (unit - 1));
        ASSERT_TRUE(expect_both<T>(x & ~n::sign, y));
        ASSERT_TRUE(expect_both<T>(x | n::sign, y | (source.any() & n::sign)));
      }
    }
  }
}

TYPED_TEST(ExactDivision, ExtremeExponentDistances) {
  using T = TypeParam;
  using U = part_of<T>;
  using n = named<U>;
  for (const U x : {n::largest, n::largest - 1, n::largest - n::smallest_normal + 1, n::one}) {
    for (const U y : {U(1), U(2), U(3), U(7), n::smallest_normal - 1, n::smallest_normal,
                      n::smallest_normal + 1, n::smallest_normal * 3 + 12345}) {
      expect_both<T>(x, y);
      expect_both<T>(x | n::sign, y);
      expect_both<T>(x, y | n::sign);
    }
  }
}

/// x = (k + 1/2)y and its neighbours, with k even and odd: ties of the remainder.
TYPED_TEST(ExactDivision, TiesOfTheRemainder) {
  using T = TypeParam;
  using U = part_of<T>;
  pattern_source<U> source(7);
  constexpr U unit = named<U>::smallest_normal;
  for (int i = 0; i < 200'000; ++i) {
    // A divisor of few bits at any exponent, so that (k + 1/2)y is exact; denormals too.
    const U y = (source.finite() & ~(unit / 256 - 1)) | (i % 3 == 0 ? 2 * unit : 0);
    if ((y & ~named<U>::sign) >= named<U>::inf) continue;
    const T k = static_cast<T>(source.below(1024)) + T(0.5);
    const T x = k * std::bit_cast<T>(y);
    if (!std::isfinite(x) || x == 0) continue;
    const U p = std::bit_cast<U>(x);
    ASSERT_TRUE(expect_both<T>(p - 1, y));
    ASSERT_TRUE(expect_both<T>(p, y));
    ASSERT_TRUE(expect_both<T>(p + 1, y));
    // Multiplied by a power of two the quotient is an integer of many bits.
    const T far = std::ldexp(x, static_cast<int>(source.below(40)));
    if (std::isfinite(far)) {
      ASSERT_TRUE(expect_both<T>(std::bit_cast<U>(far), y));
      ASSERT_TRUE(expect_both<T>(std::bit_cast<U>(far) + 1, y));
    }
  }
}

TYPED_TEST(ExactDivision, NotablePairs) {
  const auto list = notable_patterns<part_of<TypeParam>>();
  for (const auto x : list) {
    for (const auto y : list) expect_both<TypeParam>(x, y);
  }
}

template <typename T>
void expect_random_pairs(int count) {
  using U = part_of<T>;
  constexpr U fraction = named<U>::smallest_normal - 1;
  pattern_source<U> source(8);
  for (int i = 0; i < count; ++i) {
    const U x = source.any();
    ASSERT_TRUE(expect_both<T>(x, source.any()));
    // Close exponents, equal exponents, equal magnitudes, denormals on either side.
    const U y = source.near(x, 30);
    ASSERT_TRUE(expect_both<T>(x, y));
    ASSERT_TRUE(expect_both<T>(x, (x & ~fraction) | (y & fraction)));
    ASSERT_TRUE(expect_both<T>(x & (fraction | named<U>::sign), y & fraction));
    ASSERT_TRUE(expect_both<T>(x, y & (fraction | named<U>::sign)));
    if (i % 16 == 0) {
      ASSERT_TRUE(expect_both<T>(x, x));
      ASSERT_TRUE(expect_both<T>(x, x ^ named<U>::sign));
    }
    // Multiples of y up to rounding, where the integer part of the quotient is hard to get right.
    const T product = std::bit_cast<T>(y) * static_cast<T>(source.below(1u << (i % 28)));
    if (std::isfinite(product)) {
      const U p = std::bit_cast<U>(product);
      ASSERT_TRUE(expect_both<T>(p, y));
      ASSERT_TRUE(expect_both<T>(p ^ 1, y));
    }
  }
}

TYPED_TEST(ExactDivision, RandomPairs) { expect_random_pairs<TypeParam>(50'000); }

template <typename T>
class SlowExactDivision : public ::testing::Test {};
TYPED_TEST_SUITE(SlowExactDivision, types);

TYPED_TEST(SlowExactDivision, RandomPairs) { expect_random_pairs<TypeParam>(4'000'000); }

}  // namespace
