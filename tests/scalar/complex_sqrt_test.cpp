// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <algorithm>
#include <cmath>

#include "bits.hpp"
#include "complex_reference.hpp"
#include "scalar/complex/sqrt.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

template <typename R>
struct bodies;
template <>
struct bodies<float> {
  using sqrt = scalar::sqrt_c;
  static constexpr std::uint32_t large = 0x5effe000;  // 0x1.ffcp62
};
template <>
struct bodies<double> {
  using sqrt = scalar::sqrt_z;
  static constexpr std::uint64_t large = 0x43dffc0000000000;
};

template <typename R>
class ComplexSqrt : public ::testing::Test {};
using types = ::testing::Types<float, double>;
TYPED_TEST_SUITE(ComplexSqrt, types);

TYPED_TEST(ComplexSqrt, Specials) {
  using U = part_of<TypeParam>;
  using n = named<U>;
  using sqrt = typename bodies<TypeParam>::sqrt;
  const U inf = n::inf, minus = n::sign;
  // Zeros lose all signs.
  for (const U re : {U(0), minus}) {
    for (const U im : {U(0), minus}) expect_v11<sqrt>({re, im}, {0, 0});
  }
  for (const U other : notable_patterns<U>()) {
    expect_v11<sqrt>({other, inf}, {inf, inf});
    expect_v11<sqrt>({other, inf | minus}, {inf, inf | minus});
    const U magnitude = other & ~minus, sign = other & minus;
    if (magnitude > inf) {
      expect_v11<sqrt>({inf, other}, {inf, n::any_nan});
      expect_v11<sqrt>({inf | minus, other}, {n::any_nan, bodies<TypeParam>::large});
    } else if (magnitude < inf) {
      expect_v11<sqrt>({inf, other}, {inf, sign});
      expect_v11<sqrt>({inf | minus, other}, {0, inf | sign});
      // The larger pattern of the two, without its sign, made quiet.
      expect_v11<sqrt>({n::signalling | minus, other}, {n::nan | 1, n::nan | 1});
      expect_v11<sqrt>({other, n::nan | 5}, {n::nan | 5, n::nan | 5});
    }
  }
  expect_v11<sqrt>({n::nan | 3, n::nan | 5 | minus}, {n::nan | 5, n::nan | 5});
}

TYPED_TEST(ComplexSqrt, ExactResults) {
  using R = TypeParam;
  using U = part_of<R>;
  using sqrt = typename bodies<R>::sqrt;
  const int limit = std::numeric_limits<R>::max_exponent / 2 - 4;
  for (int e = -limit; e < limit; ++e) {
    const auto scaled = [](R x, int by) { return std::bit_cast<U>(std::ldexp(x, by)); };
    for (const auto& [a, b, x, y] : {std::array<R, 4>{3, 4, 2, 1},
                                     {-3, -4, 1, -2},
                                     {5, -12, 3, -2},
                                     {4, 0, 2, 0},
                                     {0, 2, 1, 1},
                                     {0, -8, 2, -2}}) {
      expect_v11<sqrt>({scaled(a, 2 * e), scaled(b, 2 * e)}, {scaled(x, e), scaled(y, e)});
    }
    // The negative axis, on either side of the cut.
    const U nine = scaled(-9, 2 * e), three = scaled(3, e), minus = named<U>::sign;
    expect_v11<sqrt>({nine, 0}, {0, three});
    expect_v11<sqrt>({nine, minus}, {0, three | minus});
    expect_v11<sqrt>({nine ^ minus, minus}, {three, minus});
    expect_v11<sqrt>({minus, scaled(2, 2 * e)}, {scaled(1, e), scaled(1, e)});
  }
}

/// The stated steps at float, one by one.
TEST(ComplexSqrtSteps, Float) {
  pattern_source<std::uint32_t> source(30);
  for (int i = 0; i < 200'000; ++i) {
    const std::uint32_t re = source.finite(),
                        im = i % 2 == 0 ? source.finite() : source.near(re, 9);
    const double x = std::bit_cast<float>(re), y = std::bit_cast<float>(im);
    if (x == 0 || y == 0) continue;
    const double w = std::sqrt((std::sqrt(std::fma(x, x, y * y)) + std::fabs(x)) * 0.5);
    const auto first = std::bit_cast<std::uint32_t>(static_cast<float>(w));
    const auto other = std::bit_cast<std::uint32_t>(static_cast<float>(std::fabs(y) * 0.5 / w));
    const std::uint32_t sign = im & 0x80000000;
    const std::array<std::uint32_t, 2> right = {first, other | sign}, left = {other, first | sign};
    ASSERT_TRUE(expect_v11<scalar::sqrt_c>({re, im}, x > 0 ? right : left));
  }
}

template <typename R>
struct error_of_sqrt {
  complex_reference exact;
  double largest = 0, largest_denormal = 0;

  void add(R re, R im) {
    const std::complex<R> z(re, im);
    exact.sqrt(z);
    const auto r = complex_result_of<typename bodies<R>::sqrt>(z);
    const auto is_denormal = [](R part) {
      return std::fabs(part) < std::numeric_limits<R>::min() && part != 0;
    };
    const double error = exact.ulps(r);
    double& bound = is_denormal(r.real()) || is_denormal(r.imag()) ? largest_denormal : largest;
    bound = std::max(bound, error);
  }
};

TYPED_TEST(ComplexSqrt, Error) {
  using R = TypeParam;
  using U = part_of<R>;
  pattern_source<U> source(31);
  error_of_sqrt<R> error;
  for (int i = 0; i < 60'000; ++i) {
    const U a = source.finite(), b = source.finite();
    error.add(std::bit_cast<R>(a), std::bit_cast<R>(b));
    error.add(std::bit_cast<R>(a), std::bit_cast<R>(source.near(a, i % 64)));
    const U small = named<U>::smallest_normal - 1;
    error.add(std::bit_cast<R>(a & (small | named<U>::sign)), std::bit_cast<R>(b & small));
  }
  EXPECT_LE(error.largest, sizeof(R) == 4 ? 0.5000001 : 0.5001);
  EXPECT_LE(error.largest_denormal, sizeof(R) == 4 ? 0.5000001 : 0.75);
  this->RecordProperty("largest_error_ulps", std::to_string(error.largest));
}

/// The exponents of the larger part, one by one: the scale is an even power of two.
TEST(ComplexSqrtScale, EveryExponent) {
  error_of_sqrt<double> error;
  for (int e = -1074; e < 1024; ++e) {
    const double x = std::ldexp(1.7, e);
    error.add(x, std::ldexp(1.3, e - 1));
    error.add(-x, std::ldexp(1.3, e - 40));
    error.add(std::ldexp(-1.1, e - 2), x);
    error.add(x, 0x1p-1074);
    error.add(-0x1p-1074, x);
  }
  EXPECT_LE(error.largest, 0.5001);
  EXPECT_LE(error.largest_denormal, 0.75);
}

}  // namespace
