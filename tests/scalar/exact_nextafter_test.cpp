// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <cmath>
#include <cstdlib>

#include "bits.hpp"
#include "scalar/exact/nextafter.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

constexpr std::uint32_t overflow = 4;
constexpr std::uint32_t underflow = 8;

template <typename T>
using body = scalar::nextafter_body<T>;

/// Against the C library; the status by the class of its result.
template <typename T>
bool expect_as_in_c(part_of<T> p, part_of<T> q) {
  using U = part_of<T>;
  const T x = std::bit_cast<T>(p);
  const T y = std::bit_cast<T>(q);
  if (std::isnan(x) || std::isnan(y)) return expect_v21<body<T>>(p, q, named<U>::any_nan, 0);
  if (x == y) return expect_v21<body<T>>(p, q, q, 0);
  const T next = std::nextafter(x, y);
  std::uint32_t status = 0;
  if (std::isinf(next)) status = overflow;
  if (next == 0 || std::fpclassify(next) == FP_SUBNORMAL) status = underflow;
  return expect_v21<body<T>>(p, q, std::bit_cast<U>(next), status);
}

template <typename T>
class ExactNextafter : public ::testing::Test {};
using types = ::testing::Types<float, double>;
TYPED_TEST_SUITE(ExactNextafter, types);

TYPED_TEST(ExactNextafter, FixedPoints) {
  using T = TypeParam;
  using U = part_of<T>;
  using n = named<U>;
  const U minus = n::sign;
  expect_v21<body<T>>(n::one, n::inf, n::one + 1, 0);
  expect_v21<body<T>>(n::one, 0, n::one - 1, 0);
  expect_v21<body<T>>(n::one | minus, n::inf, (n::one | minus) - 1, 0);
  expect_v21<body<T>>(n::one | minus, n::inf | minus, (n::one | minus) + 1, 0);
  // Equal operands.
  expect_v21<body<T>>(n::one, n::one, n::one, 0);
  expect_v21<body<T>>(0, 0, 0, 0);
  expect_v21<body<T>>(0, minus, minus, 0);
  expect_v21<body<T>>(minus, 0, 0, 0);
  expect_v21<body<T>>(n::inf, n::inf, n::inf, 0);
  expect_v21<body<T>>(3, 3, 3, 0);
  // From zero.
  expect_v21<body<T>>(0, n::one, 1, underflow);
  expect_v21<body<T>>(0, n::one | minus, 1 | minus, underflow);
  expect_v21<body<T>>(minus, n::one, 1, underflow);
  expect_v21<body<T>>(minus, 1 | minus, 1 | minus, underflow);
  // Denormals, and to zero.
  expect_v21<body<T>>(1, 0, 0, underflow);
  expect_v21<body<T>>(1 | minus, 0, minus, underflow);
  expect_v21<body<T>>(1, n::one | minus, 0, underflow);
  expect_v21<body<T>>(5, n::one, 6, underflow);
  expect_v21<body<T>>(n::smallest_normal, 0, n::smallest_normal - 1, underflow);
  expect_v21<body<T>>(n::smallest_normal - 1, n::one, n::smallest_normal, 0);
  expect_v21<body<T>>(n::smallest_normal, n::one, n::smallest_normal + 1, 0);
  // The largest numbers.
  expect_v21<body<T>>(n::largest, n::inf, n::inf, overflow);
  expect_v21<body<T>>(n::largest | minus, n::inf | minus, n::inf | minus, overflow);
  expect_v21<body<T>>(n::largest - 1, n::inf, n::largest, 0);
  expect_v21<body<T>>(n::inf, 0, n::largest, 0);
  expect_v21<body<T>>(n::inf | minus, n::inf, n::largest | minus, 0);
  // NaNs.
  expect_v21<body<T>>(n::nan, n::one, n::nan, 0);
  expect_v21<body<T>>(0, n::nan + 1, n::nan + 1, 0);
  expect_v21<body<T>>(n::signalling, 0, n::any_nan, 0);
}

TYPED_TEST(ExactNextafter, NotablePairs) {
  const auto list = notable_patterns<part_of<TypeParam>>();
  for (const auto x : list) {
    for (const auto y : list) expect_as_in_c<TypeParam>(x, y);
  }
}

TYPED_TEST(ExactNextafter, RandomPairs) {
  using U = part_of<TypeParam>;
  pattern_source<U> source(5);
  for (int i = 0; i < 500'000; ++i) {
    const U x = source.any();
    ASSERT_TRUE(expect_as_in_c<TypeParam>(x, source.any()));
    ASSERT_TRUE(expect_as_in_c<TypeParam>(x, x + static_cast<U>(source.below(5)) - 2));
    const U denormal = x & (named<U>::sign | (named<U>::smallest_normal - 1));
    ASSERT_TRUE(expect_as_in_c<TypeParam>(denormal, source.any()));
  }
}

/// Where a half stands among all of them, from -infinity to +infinity, both zeros in one place.
int place_of(std::uint16_t p) { return (p & 0x8000) != 0 ? -(p & 0x7fff) : p; }

/// The neighbour by its place, for numbers and infinities.
void expect_next_half(std::uint16_t x, std::uint16_t y) {
  const scalar::binary16 a{x}, b{y};
  scalar::binary16 r{0x5aa5};
  const std::uint32_t status = scalar::nextafter_h::call(&a, &b, &r);
  const int from = place_of(x), to = place_of(y);
  if (from == to) {
    ASSERT_EQ(r.pattern, y);
    ASSERT_EQ(status, 0u);
    return;
  }
  const int next = from < to ? from + 1 : from - 1;
  ASSERT_EQ(place_of(r.pattern), next) << x << " " << y;
  if (next == 0) {
    ASSERT_EQ(r.pattern & 0x8000, x & 0x8000);
  }
  const int magnitude = std::abs(next);
  ASSERT_EQ(status, magnitude < 0x0400 ? underflow : (magnitude == 0x7c00 ? overflow : 0u));
}

TEST(ExactNextafterHalf, EveryHalfTowardsNotableOnes) {
  const std::uint16_t targets[] = {0x0000, 0x8000, 0x0001, 0x8001, 0x0400, 0x3c00,
                                   0xbc00, 0x7bff, 0xfbff, 0x7c00, 0xfc00};
  for (std::uint32_t p = 0; p < 0x10000; ++p) {
    if ((p & 0x7fff) > 0x7c00) continue;
    const auto x = static_cast<std::uint16_t>(p);
    for (const std::uint16_t y : targets) ASSERT_NO_FATAL_FAILURE(expect_next_half(x, y));
    for (const int near : {-1, 0, 1}) {
      const auto y = static_cast<std::uint16_t>(p + static_cast<std::uint32_t>(near));
      if ((y & 0x7fff) <= 0x7c00) {
        ASSERT_NO_FATAL_FAILURE(expect_next_half(x, y));
      }
    }
  }
}

TEST(ExactNextafterHalf, NaNs) {
  const auto next = [](std::uint16_t x, std::uint16_t y) {
    const scalar::binary16 a{x}, b{y};
    scalar::binary16 r{0x5aa5};
    EXPECT_EQ(scalar::nextafter_h::call(&a, &b, &r), 0u);
    return r.pattern;
  };
  EXPECT_EQ(next(0x7e00, 0x3c00), 0x7e00);
  EXPECT_EQ(next(0x3c00, 0x7e01), 0x7e01);
  EXPECT_EQ(next(0x7c01, 0x0000) & 0x7e00, 0x7e00);
  EXPECT_EQ(next(0x7c00, 0xfe00) & 0x7e00, 0x7e00);
}

}  // namespace
