// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <cmath>

#include "bits.hpp"
#include "scalar/exact/fdim.hpp"
#include "scalar/exact/fmax.hpp"
#include "scalar/exact/fmin.hpp"
#include "scalar/exact/maxmag.hpp"
#include "scalar/exact/minmag.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

template <typename T>
struct bodies;
template <>
struct bodies<float> {
  using fmax = scalar::fmax_s;
  using fmin = scalar::fmin_s;
  using fdim = scalar::fdim_s;
  using maxmag = scalar::maxmag_s;
  using minmag = scalar::minmag_s;
};
template <>
struct bodies<double> {
  using fmax = scalar::fmax_d;
  using fmin = scalar::fmin_d;
  using fdim = scalar::fdim_d;
  using maxmag = scalar::maxmag_d;
  using minmag = scalar::minmag_d;
};

/// A pattern as an integer in the order of the numbers, both zeros equal.
template <typename U>
std::int64_t rank(U p) {
  const auto magnitude = static_cast<std::int64_t>(p & ~named<U>::sign);
  return (p & named<U>::sign) != 0 ? -magnitude : magnitude;
}

template <typename U>
bool is_nan(U p) {
  return (p & ~named<U>::sign) > named<U>::inf;
}

/// All five functions at one pair against a reference in integers; only the difference is taken
/// from the machine.
template <typename T>
bool expect_all(part_of<T> x, part_of<T> y) {
  using U = part_of<T>;
  using body = bodies<T>;
  U larger, smaller, difference, larger_magnitude, smaller_magnitude;
  if (is_nan(x)) {
    larger = smaller = difference = larger_magnitude = smaller_magnitude = y;
  } else if (is_nan(y)) {
    larger = smaller = difference = larger_magnitude = smaller_magnitude = x;
  } else {
    const std::int64_t rx = rank(x), ry = rank(y);
    const U ax = x & ~named<U>::sign, ay = y & ~named<U>::sign;
    larger = rx > ry ? x : y;
    smaller = rx < ry ? x : y;
    difference = rx > ry ? std::bit_cast<U>(std::bit_cast<T>(x) - std::bit_cast<T>(y)) : 0;
    larger_magnitude = ax > ay ? x : (ax < ay ? y : (ry > rx ? y : x));
    smaller_magnitude = ax < ay ? x : (ax > ay ? y : (ry < rx ? y : x));
  }
  bool good = expect_v21<typename body::fmax>(x, y, larger);
  good &= expect_v21<typename body::fmin>(x, y, smaller);
  good &= expect_v21<typename body::fdim>(x, y, difference);
  good &= expect_v21<typename body::maxmag>(x, y, larger_magnitude);
  good &= expect_v21<typename body::minmag>(x, y, smaller_magnitude);
  return good;
}

template <typename T>
class ExactMinMax : public ::testing::Test {};
using types = ::testing::Types<float, double>;
TYPED_TEST_SUITE(ExactMinMax, types);

TYPED_TEST(ExactMinMax, FixedPoints) {
  using U = part_of<TypeParam>;
  using n = named<U>;
  using body = bodies<TypeParam>;
  const U two = n::one + (n::smallest_normal);
  const U minus_two = two | n::sign;
  const U other_nan = n::nan + 9;
  expect_v21<typename body::fmax>(n::nan, n::one, n::one);
  expect_v21<typename body::fmax>(n::one, n::nan, n::one);
  expect_v21<typename body::fmax>(n::nan, other_nan, other_nan);
  expect_v21<typename body::fmax>(other_nan, n::nan, n::nan);
  expect_v21<typename body::fmax>(0, n::sign, n::sign);
  expect_v21<typename body::fmax>(n::sign, 0, 0);
  expect_v21<typename body::fmin>(0, n::sign, n::sign);
  expect_v21<typename body::fmin>(n::sign, 0, 0);
  expect_v21<typename body::fmin>(n::inf | n::sign, n::nan, n::inf | n::sign);
  expect_v21<typename body::maxmag>(minus_two, two, two);
  expect_v21<typename body::maxmag>(two, minus_two, two);
  expect_v21<typename body::minmag>(minus_two, two, minus_two);
  expect_v21<typename body::minmag>(two, minus_two, minus_two);
  expect_v21<typename body::maxmag>(0, n::sign, 0);
  expect_v21<typename body::minmag>(n::sign, 0, n::sign);
  expect_v21<typename body::maxmag>(n::inf | n::sign, n::inf, n::inf);
  expect_v21<typename body::fdim>(two, n::one, n::one);
  expect_v21<typename body::fdim>(n::one, two, 0);
  expect_v21<typename body::fdim>(n::sign, n::sign, 0);
  expect_v21<typename body::fdim>(n::inf, n::inf, 0);
  expect_v21<typename body::fdim>(n::nan, n::one, n::one);
  expect_v21<typename body::fdim>(n::one, n::signalling, n::one);
  // An overflow without a status.
  expect_v21<typename body::fdim>(n::largest, n::largest | n::sign, n::inf, 0);
}

TYPED_TEST(ExactMinMax, NotablePairs) {
  const auto list = notable_patterns<part_of<TypeParam>>();
  for (const auto x : list) {
    for (const auto y : list) expect_all<TypeParam>(x, y);
  }
}

TYPED_TEST(ExactMinMax, RandomPairs) {
  pattern_source<part_of<TypeParam>> source(3);
  for (int i = 0; i < 300'000; ++i) {
    const auto x = source.any();
    ASSERT_TRUE(expect_all<TypeParam>(x, source.any()));
    ASSERT_TRUE(expect_all<TypeParam>(x, x ^ named<part_of<TypeParam>>::sign));
    ASSERT_TRUE(expect_all<TypeParam>(x, x + 1));
  }
}

}  // namespace
