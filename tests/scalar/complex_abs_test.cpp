// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <algorithm>
#include <cmath>

#include "bits.hpp"
#include "quad.hpp"
#include "scalar/complex/abs.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

template <typename R>
struct bodies;
template <>
struct bodies<float> {
  using abs = scalar::abs_c;
};
template <>
struct bodies<double> {
  using abs = scalar::abs_z;
};

/// The largest error so far in units in the last place, for finite operands. An infinite result
/// must come from a true overflow.
template <typename R>
struct error_of_abs {
  double largest = 0;

  bool add(R a, R b) {
    const std::complex<R> z(a, b);
    R r = unwritten<R>();
    const std::uint32_t status = bodies<R>::abs::call(&z, &r);
    const quad wide_a = a, wide_b = b;
    const quad square = wide_a * wide_a + wide_b * wide_b;
    EXPECT_EQ(status, 0u);
    EXPECT_FALSE(std::signbit(r)) << z;
    if (std::isinf(r)) {
      const quad limit = static_cast<quad>(std::numeric_limits<R>::max()) *
                         (1 + static_cast<quad>(std::numeric_limits<R>::epsilon()) / 8);
      EXPECT_TRUE(square >= limit * limit) << z;
      return square >= limit * limit;
    }
    const double error = root_ulps(r, square);
    largest = std::max(largest, error);
    return true;
  }
};

template <typename R>
class ComplexAbs : public ::testing::Test {};
using types = ::testing::Types<float, double>;
TYPED_TEST_SUITE(ComplexAbs, types);

TYPED_TEST(ComplexAbs, Specials) {
  using n = named<part_of<TypeParam>>;
  using abs = typename bodies<TypeParam>::abs;
  const auto minus = n::sign;
  for (const auto other : notable_patterns<part_of<TypeParam>>()) {
    expect_v11<abs>({n::inf, other}, n::inf);
    expect_v11<abs>({other, n::inf | minus}, n::inf);
  }
  expect_v11<abs>({n::nan, n::one}, n::any_nan);
  expect_v11<abs>({n::one, n::signalling}, n::any_nan);
  expect_v11<abs>({n::nan, n::nan}, n::any_nan);
  expect_v11<abs>({0, 0}, 0);
  expect_v11<abs>({minus, 0}, 0);
  expect_v11<abs>({minus, minus}, 0);
}

TYPED_TEST(ComplexAbs, ExactResults) {
  using R = TypeParam;
  using U = part_of<R>;
  using n = named<U>;
  using abs = typename bodies<R>::abs;
  const int lowest = std::numeric_limits<R>::min_exponent - std::numeric_limits<R>::digits;
  for (int e = lowest; e < std::numeric_limits<R>::max_exponent - 4; ++e) {
    for (const auto& [a, b, c] : {std::array<R, 3>{3, 4, 5}, {-5, 12, 13}, {0, -1, 1}, {1, 0, 1}}) {
      const U x = std::bit_cast<U>(std::ldexp(a, e)), y = std::bit_cast<U>(std::ldexp(b, e));
      const U r = std::bit_cast<U>(std::ldexp(c, e));
      expect_v11<abs>({x, y}, r);
      expect_v11<abs>({y, x}, r);
    }
  }
  expect_v11<abs>({n::largest, 0}, n::largest);
  expect_v11<abs>({1, n::largest | n::sign}, n::largest);
  // An overflow without a status.
  expect_v11<abs>({n::largest, n::largest}, n::inf, 0);
  expect_v11<abs>({1, 0}, 1);
  expect_v11<abs>({1, 1}, 1);  // 1.41 units
  expect_v11<abs>({3, 3}, 4);  // 4.24 units
}

TEST(ComplexAbsError, FloatInOneUnit) {
  pattern_source<std::uint32_t> source(12);
  error_of_abs<float> error;
  for (int i = 0; i < 1'000'000; ++i) {
    const std::uint32_t a = source.finite();
    ASSERT_TRUE(error.add(std::bit_cast<float>(a), std::bit_cast<float>(source.near(a, 14))));
  }
  EXPECT_LE(error.largest, 0.95);
  RecordProperty("largest_error_ulps", std::to_string(error.largest));
}

TEST(ComplexAbsError, DoubleInTheBand) {
  pattern_source<std::uint64_t> source(13);
  error_of_abs<double> error;
  for (int i = 0; i < 1'000'000; ++i) {
    const std::uint64_t a = source.near(named<std::uint64_t>::one, 31);
    double x = std::bit_cast<double>(a);
    if (x < 0x1p-33 && x > -0x1p-33) continue;
    ASSERT_TRUE(error.add(x, std::bit_cast<double>(source.near(a, i % 32))));
  }
  EXPECT_LE(error.largest, 1.21);
  RecordProperty("largest_error_ulps", std::to_string(error.largest));
}

/// Outside the band the careful path: correctly rounded but for the last 1e-7 of a unit.
TEST(ComplexAbsError, DoubleOutsideTheBand) {
  pattern_source<std::uint64_t> source(14);
  error_of_abs<double> error;
  for (int i = 0; i < 400'000; ++i) {
    const std::uint64_t a = source.finite();
    const double x = std::bit_cast<double>(a);
    const double y = std::bit_cast<double>(source.near(a, i % 64));
    const double m = std::max(std::fabs(x), std::fabs(y));
    if (m > 0x1p-35 && m < 0x1p34) continue;
    ASSERT_TRUE(error.add(x, y));
  }
  // Denormal results.
  for (int i = 0; i < 100'000; ++i) {
    const std::uint64_t fraction = named<std::uint64_t>::smallest_normal - 1;
    const std::uint64_t a = source.any() & fraction, b = source.any() & fraction;
    const auto bits_off = source.below(52);
    ASSERT_TRUE(
        error.add(std::bit_cast<double>(a >> bits_off), std::bit_cast<double>(b >> bits_off)));
  }
  EXPECT_LE(error.largest, 0.5000001);
  RecordProperty("largest_error_ulps", std::to_string(error.largest));
}

/// The two sides of each bound of the band on the sum of squares: S in [2^-67, 2^66], the last with
/// all patterns of the same high word.
TEST(ComplexAbsError, EdgesOfTheBand) {
  error_of_abs<double> error;
  for (const double edge :
       {0x1p-34, 0x1p-33, 0x1p33, 0x1.6a09e667f3bcdp32, 0x1.6a09e667f3bcdp-34}) {
    for (int step = -1000; step <= 1000; ++step) {
      const double x = edge * (1 + step * 0x1p-30);
      ASSERT_TRUE(error.add(x, 0));
      ASSERT_TRUE(error.add(x, x));
      ASSERT_TRUE(error.add(x * 0x1p-20, -x));
    }
  }
  EXPECT_LE(error.largest, 1.21);
}

}  // namespace
