// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/functors.hpp"

#include <gtest/gtest.h>

#include <array>
#include <bit>
#include <complex>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <type_traits>
#include <vector>

#include "scalar/bits.hpp"
#include "scalar/quad.hpp"
#include "utilities/product_reference.hpp"

namespace {

using namespace arbor::lumen::tests;
namespace scalar = arbor::lumen::vm::detail::gpu::norvane::scalar;
template <typename T>
using limits = std::numeric_limits<T>;
template <typename T>
constexpr bool is_real = std::is_floating_point_v<T>;

/// The patterns that matter, at complex elements in many pairs.
template <typename T>
std::vector<T> notable_elements() {
  const auto list = notable_patterns<part_of<T>>();
  std::vector<T> elements;
  for (std::size_t i = 0; i < list.size(); ++i) {
    if constexpr (is_real<T>) {
      elements.push_back(element<T>::value(list[i]));
    } else {
      for (std::size_t j = 1; j < 12; j += 2)
        elements.push_back(element<T>::value({list[i], list[(i * 5 + j * 7) % list.size()]}));
    }
  }
  return elements;
}

template <typename T>
bool same_bits(const T& a, const T& b) {
  return element<T>::parts(a) == element<T>::parts(b);
}

template <typename F>
class Copies : public testing::Test {};
using copy_functors =
    testing::Types<scalar::copy1_s, scalar::copy1_d, scalar::copy1_c, scalar::copy1_z>;
TYPED_TEST_SUITE(Copies, copy_functors);
TYPED_TEST(Copies, KeepEveryBit) {
  using T = typename TypeParam::input_type;
  for (const T a : notable_elements<T>()) {
    T y = unwritten<T>();
    EXPECT_EQ(0u, TypeParam::call(&a, &y));
    EXPECT_TRUE(same_bits(a, y)) << a;
    EXPECT_EQ(0u, TypeParam::call(&y, &y));
    EXPECT_TRUE(same_bits(a, y)) << a;
  }
}

template <typename F>
class Copies2 : public testing::Test {};
using copy2_functors =
    testing::Types<scalar::copy2_s, scalar::copy2_d, scalar::copy2_c, scalar::copy2_z>;
TYPED_TEST_SUITE(Copies2, copy2_functors);
TYPED_TEST(Copies2, KeepEveryBitInBothOutputs) {
  using T = typename TypeParam::input_type;
  for (const T a : notable_elements<T>()) {
    T y1 = unwritten<T>(), y2 = unwritten<T>(), in_place = a;
    EXPECT_EQ(0u, TypeParam::call(&a, &y1, &y2));
    EXPECT_TRUE(same_bits(a, y1) && same_bits(a, y2)) << a;
    EXPECT_EQ(0u, TypeParam::call(&in_place, &in_place, &y1));
    EXPECT_TRUE(same_bits(a, in_place) && same_bits(a, y1)) << a;
  }
}

template <typename F>
class Assignments : public testing::Test {};
using assign_functors =
    testing::Types<scalar::assign_s, scalar::assign_d, scalar::assign_c, scalar::assign_z>;
TYPED_TEST_SUITE(Assignments, assign_functors);
TYPED_TEST(Assignments, StoreTheConstant) {
  using T = typename TypeParam::input_type;
  for (const T c : notable_elements<T>()) {
    T y = unwritten<T>();
    EXPECT_EQ(0u, TypeParam::call(c, &y));
    EXPECT_TRUE(same_bits(c, y)) << c;
  }
}

template <typename F>
class Assignments2 : public testing::Test {};
using assign2_functors =
    testing::Types<scalar::assign2_s, scalar::assign2_d, scalar::assign2_c, scalar::assign2_z>;
TYPED_TEST_SUITE(Assignments2, assign2_functors);
TYPED_TEST(Assignments2, StoreTheConstantTwice) {
  using T = typename TypeParam::input_type;
  for (const T c : notable_elements<T>()) {
    T y1 = unwritten<T>(), y2 = unwritten<T>();
    EXPECT_EQ(0u, TypeParam::call(c, &y1, &y2));
    EXPECT_TRUE(same_bits(c, y1) && same_bits(c, y2)) << c;
  }
}

/// The relations by the order of patterns: magnitudes, negated below zero.
template <typename U>
int expected_relations(U a, U b) {
  constexpr int unordered = 1, less = 1 + 2 + 4, equal = 4 + 8 + 16, greater = 1 + 16 + 32;
  const auto magnitude = [](U p) { return p & ~named<U>::sign; };
  if (magnitude(a) > named<U>::inf || magnitude(b) > named<U>::inf) return unordered;
  using S = std::make_signed_t<U>;
  const auto rank = [&](U p) {
    const auto m = static_cast<S>(magnitude(p));
    return p == magnitude(p) ? m : -m;
  };
  return rank(a) < rank(b) ? less : rank(a) == rank(b) ? equal : greater;
}

template <typename T>
T expected_mask(T a, T b) {
  const auto p = element<T>::parts(a), q = element<T>::parts(b);
  if constexpr (is_real<T>) {
    return static_cast<T>(expected_relations(p[0], q[0]));
  } else {
    using R = typename T::value_type;
    return {static_cast<R>(expected_relations(p[0], q[0])),
            static_cast<R>(expected_relations(p[1], q[1]))};
  }
}

template <typename F>
class Comparisons : public testing::Test {};
using compare_functors = testing::Types<std::pair<scalar::compare_s, scalar::compare2_s>,
                                        std::pair<scalar::compare_d, scalar::compare2_d>,
                                        std::pair<scalar::compare_c, scalar::compare2_c>,
                                        std::pair<scalar::compare_z, scalar::compare2_z>>;
TYPED_TEST_SUITE(Comparisons, compare_functors);
TYPED_TEST(Comparisons, TellTheRelations) {
  using Constant = typename TypeParam::first_type;
  using Arrays = typename TypeParam::second_type;
  using T = typename Constant::input_type;
  const std::vector<T> list = notable_elements<T>();
  for (const T& a : list) {
    for (const T& b : list) {
      const T expected = expected_mask(a, b);
      T y = unwritten<T>(), in_place = b;
      EXPECT_EQ(0u, Constant::call(&a, b, &y));
      EXPECT_TRUE(same_bits(expected, y)) << a << " with the constant " << b << ": " << y;
      y = unwritten<T>();
      EXPECT_EQ(0u, Arrays::call(&a, &b, &y));
      EXPECT_TRUE(same_bits(expected, y)) << a << " with " << b << ": " << y;
      EXPECT_EQ(0u, Arrays::call(&a, &in_place, &in_place));
      EXPECT_TRUE(same_bits(expected, in_place)) << a << " with " << b << ", in its place";
    }
  }
}

TEST(Relations, OfFewNumbers) {
  const auto relations = [](float a, float b) {
    float y = -1;
    scalar::compare2_s::call(&a, &b, &y);
    return y;
  };
  EXPECT_EQ(7.0f, relations(1, 2));
  EXPECT_EQ(28.0f, relations(2, 2));
  EXPECT_EQ(28.0f, relations(-0.0f, 0));
  EXPECT_EQ(49.0f, relations(2, 1));
  EXPECT_EQ(1.0f, relations(limits<float>::quiet_NaN(), 1));
  EXPECT_EQ(1.0f, relations(1, limits<float>::quiet_NaN()));
  const std::complex<double> a(1, 5), b(2, 5);
  std::complex<double> y;
  scalar::compare_z::call(&a, b, &y);
  EXPECT_EQ(std::complex<double>(7, 28), y);
}

/// The status of fma(a, b, c). The output is not written.
template <typename F>
std::uint32_t fma_status(typename F::input_type a, typename F::input_type b,
                         typename F::input_type c) {
  using T = typename F::input_type;
  T y = unwritten<T>();
  const std::uint32_t status = F::call(&a, &b, &c, &y);
  EXPECT_TRUE(same_bits(unwritten<T>(), y)) << a << ", " << b << ", " << c;
  return status;
}

template <typename F>
class MultiplyAdd : public testing::Test {};
using real_fma = testing::Types<scalar::fma_s, scalar::fma_d>;
TYPED_TEST_SUITE(MultiplyAdd, real_fma);
TYPED_TEST(MultiplyAdd, WritesNothingAndReportsNaNs) {
  using T = typename TypeParam::input_type;
  const T inf = limits<T>::infinity(), nan = limits<T>::quiet_NaN(), large = limits<T>::max();
  const auto status = [](T a, T b, T c) { return fma_status<TypeParam>(a, b, c); };
  EXPECT_EQ(0u, status(2, 3, 4));
  EXPECT_EQ(0u, status(0, 0, 0));
  EXPECT_EQ(0u, status(large, large, large));
  EXPECT_EQ(0u, status(inf, 2, 1));
  EXPECT_EQ(0u, status(inf, -2, -inf));
  EXPECT_EQ(1u, status(inf, 0, 1));
  EXPECT_EQ(1u, status(inf, 2, -inf));
  EXPECT_EQ(1u, status(nan, 1, 1));
  EXPECT_EQ(1u, status(1, nan, 1));
  EXPECT_EQ(1u, status(1, 1, nan));
  // The product alone would overflow and meet the opposite infinity.
  EXPECT_EQ(0u, status(large, large, -inf));
}

template <typename F>
class ComplexMultiplyAdd : public testing::Test {};
using complex_fma = testing::Types<scalar::fma_c, scalar::fma_z>;
TYPED_TEST_SUITE(ComplexMultiplyAdd, complex_fma);
TYPED_TEST(ComplexMultiplyAdd, WritesNothingAndReportsNaNsOfEitherPart) {
  using T = typename TypeParam::input_type;
  using R = typename T::value_type;
  const R nan = limits<R>::quiet_NaN(), inf = limits<R>::infinity();
  const auto status = [](T a, T b, T c) { return fma_status<TypeParam>(a, b, c); };
  EXPECT_EQ(0u, status({1, 2}, {3, 4}, {5, 6}));
  EXPECT_EQ(0u, status({1, 0}, {1, 0}, {inf, -inf}));
  EXPECT_EQ(1u, status({1, 2}, {3, 4}, {nan, 6}));
  EXPECT_EQ(1u, status({1, 2}, {3, 4}, {5, nan}));
  EXPECT_EQ(1u, status({nan, 2}, {3, 4}, {5, 6}));
  EXPECT_EQ(1u, status({1, 2}, {3, inf}, {inf, 6}));
}

float sum_s(float a, float b, float c) {
  float y = unwritten<float>();
  EXPECT_EQ(0u, scalar::faa_s::call(&a, &b, &c, &y));
  return y;
}
double sum_d(double a, double b, double c) {
  double y = unwritten<double>();
  EXPECT_EQ(0u, scalar::faa_d::call(&a, &b, &c, &y));
  return y;
}

TEST(SumOfThree, OfFloatsIsRoundedFromDouble) {
  const float large = limits<float>::max(), unit = 0x1p-24f;
  EXPECT_EQ(1 + 2 * unit, sum_s(1, unit, unit));
  EXPECT_EQ(1 + 2 * unit, sum_s(unit, unit, 1));
  EXPECT_EQ(large, sum_s(large, large, -large));
  EXPECT_EQ(limits<float>::infinity(), sum_s(large, large, large));
  EXPECT_EQ(1.0f, sum_s(0x1p52f, 1, -0x1p52f));
  // In that order, in double.
  EXPECT_EQ(0.0f, sum_s(0x1p60f, 1, -0x1p60f));
  EXPECT_EQ(1.0f, sum_s(0x1p60f, -0x1p60f, 1));
  EXPECT_EQ(0x80000000u, std::bit_cast<std::uint32_t>(sum_s(-0.0f, -0.0f, -0.0f)));
  EXPECT_EQ(0u, std::bit_cast<std::uint32_t>(sum_s(1, -1, -0.0f)));
}

TEST(SumOfThree, OfDoublesIsRoundedTwice) {
  const double large = limits<double>::max(), unit = 0x1p-53;
  EXPECT_EQ(1.0, sum_d(1, unit, unit));
  EXPECT_EQ(1 + 2 * unit, sum_d(unit, unit, 1));
  EXPECT_EQ(limits<double>::infinity(), sum_d(large, large, -large));
  EXPECT_EQ(large, sum_d(large, -large, large));
}

TEST(SumOfThree, IsThatOfWideArithmetic) {
  pattern_source<std::uint32_t> floats(311);
  pattern_source<std::uint64_t> doubles(312);
  const auto round = [](quad x) { return static_cast<double>(x); };
  for (int i = 0; i < 500'000 && !HasFailure(); ++i) {
    const std::uint32_t p = floats.near(0x3f800000, 60);
    const float a = std::bit_cast<float>(p), b = std::bit_cast<float>(floats.near(p, 20)),
                c = std::bit_cast<float>(floats.near(p, 20));
    const double wide = round(static_cast<quad>(a) + static_cast<quad>(b));
    EXPECT_EQ(static_cast<float>(round(static_cast<quad>(wide) + static_cast<quad>(c))),
              sum_s(a, b, c));
    const std::uint64_t q = doubles.near(named<std::uint64_t>::one, 500);
    const double d = std::bit_cast<double>(q), e = std::bit_cast<double>(doubles.near(q, 25)),
                 f = std::bit_cast<double>(doubles.near(q, 25));
    const double first = round(static_cast<quad>(d) + static_cast<quad>(e));
    EXPECT_EQ(round(static_cast<quad>(first) + static_cast<quad>(f)), sum_d(d, e, f));
  }
}

TEST(SumOfThree, OfComplexNumbersIsThatOfTheirParts) {
  const std::complex<float> a(1, 0x1p60f), b(0x1p-24f, 1), c(0x1p-24f, -0x1p60f);
  std::complex<float> y;
  EXPECT_EQ(0u, scalar::faa_c::call(&a, &b, &c, &y));
  EXPECT_EQ(std::complex<float>(1 + 0x1p-23f, 0), y);
  const std::complex<double> d(1, 3), e(0x1p-53, 4), f(0x1p-53, -9);
  std::complex<double> z;
  EXPECT_EQ(0u, scalar::faa_z::call(&d, &e, &f, &z));
  EXPECT_EQ(std::complex<double>(1, -2), z);
}

template <typename F>
bool expect_fmm(pattern_of<typename F::input_type> a, pattern_of<typename F::input_type> b,
                pattern_of<typename F::input_type> c, pattern_of<typename F::input_type> expected,
                std::uint32_t code, location where = location::current()) {
  using T = typename F::input_type;
  const T x = element<T>::value(a), y = element<T>::value(b), z = element<T>::value(c);
  T r = unwritten<T>();
  const std::uint32_t status = F::call(&x, &y, &z, &r);
  return expect_result<T>(expected, code, r, status, where, functor_name<F>(), "product", x, y, z);
}

TEST(ProductOfThree, OfDoublesIsThatOfTheirPatterns) {
  pattern_source<std::uint64_t> source(313);
  for (int i = 0; i < 300'000 && !HasFailure(); ++i) {
    const std::uint64_t a = source.near(named<std::uint64_t>::one, 600);
    const std::uint64_t b = source.near(a, 300), c = source.any();
    const product_of_three expected = rounded_product(a, b, c);
    expect_fmm<scalar::fmm_d>(a, b, c, expected.pattern, expected.code);
  }
}

TEST(ProductOfThree, OfFloatsIsNarrowedFromDouble) {
  pattern_source<std::uint32_t> source(314);
  const auto wide = [](std::uint32_t p) {
    return std::bit_cast<std::uint64_t>(static_cast<double>(std::bit_cast<float>(p)));
  };
  for (int i = 0; i < 1'000'000 && !HasFailure(); ++i) {
    const std::uint32_t a = source.any(), b = source.any(), c = source.any();
    const product_of_three product = rounded_product(wide(a), wide(b), wide(c));
    const auto narrow = static_cast<float>(std::bit_cast<double>(product.pattern));
    expect_fmm<scalar::fmm_s>(a, b, c, std::bit_cast<std::uint32_t>(narrow), product.code);
  }
}

TEST(ProductOfThree, OfFloatsLooksForNoSpecials) {
  constexpr std::uint32_t inf = 0x7f800000, nan = 0x7fc00000, one = 0x3f800000;
  constexpr std::uint32_t large = 0x7f7fffff, quarter = 0x3e800000, sign = 0x80000000;
  using fmm = scalar::fmm_s;
  // Out of the range of float alone, there is no code.
  expect_fmm<fmm>(large, large, large, inf, 0);
  expect_fmm<fmm>(1, 1, sign | 1, sign, 0);
  expect_fmm<fmm>(1, one, one, 1, 0);
  // Zero is 2^-1023 in double, infinity 2^1024, a NaN 1.5 times that.
  expect_fmm<fmm>(0, one, large, 0, 0);
  expect_fmm<fmm>(0, 0, sign | one, sign, 2);
  expect_fmm<fmm>(0, inf, one, 0x40000000, 0);
  expect_fmm<fmm>(0, nan, one, 0x40400000, 0);
  expect_fmm<fmm>(inf, one, one, inf, 1);
  expect_fmm<fmm>(inf, quarter, sign | one, sign | inf, 0);
  expect_fmm<fmm>(nan, one, one, inf, 1);
}

template <typename F>
class ComplexProduct : public testing::Test {};
using complex_products = testing::Types<std::pair<scalar::fmm_c, scalar::mul_c_ha_gen>,
                                        std::pair<scalar::fmm_z, scalar::mul_z_ha_gen>>;
TYPED_TEST_SUITE(ComplexProduct, complex_products);

TYPED_TEST(ComplexProduct, OfGaussianIntegersIsExact) {
  using F = typename TypeParam::first_type;
  using T = typename F::input_type;
  using R = typename T::value_type;
  for (int p = -3; p < 4; ++p) {
    for (int q = -3; q < 4; ++q) {
      for (int r = -3; r < 4; ++r) {
        const std::array<int, 2> a{p, q}, b{2 * q + 1, r}, c{r - 2, p + 1};
        const std::array<int, 2> ab{a[0] * b[0] - a[1] * b[1], a[0] * b[1] + a[1] * b[0]};
        const auto number = [](int re, int im) {
          return T(static_cast<R>(re), static_cast<R>(im));
        };
        const T x = number(a[0], a[1]), y = number(b[0], b[1]), z = number(c[0], c[1]);
        T product = unwritten<T>();
        EXPECT_EQ(0u, F::call(&x, &y, &z, &product));
        EXPECT_EQ(number(ab[0] * c[0] - ab[1] * c[1], ab[0] * c[1] + ab[1] * c[0]), product);
      }
    }
  }
}

TYPED_TEST(ComplexProduct, IsTwoProductsWithoutStatus) {
  using F = typename TypeParam::first_type;
  using Multiply = typename TypeParam::second_type;
  using T = typename F::input_type;
  const std::vector<T> list = notable_elements<T>();
  for (std::size_t i = 0; i < list.size(); ++i) {
    for (std::size_t j = 0; j < list.size(); j += 3) {
      const T a = list[i], b = list[j], c = list[(3 * i + 5 * j) % list.size()];
      T ab, expected, product = unwritten<T>(), in_place = c;
      Multiply::call(&a, &b, &ab);
      Multiply::call(&ab, &c, &expected);
      EXPECT_EQ(0u, F::call(&a, &b, &c, &product));
      EXPECT_TRUE(same_bits(expected, product)) << a << b << c;
      EXPECT_EQ(0u, F::call(&a, &b, &in_place, &in_place));
      EXPECT_TRUE(same_bits(expected, in_place)) << a << b << c << ", in place";
    }
  }
}

template <typename F>
class RealIota : public testing::Test {};
using real_iota = testing::Types<scalar::iota_s, scalar::iota_d>;
TYPED_TEST_SUITE(RealIota, real_iota);
TYPED_TEST(RealIota, StoresZeros) {
  using T = typename TypeParam::input_type;
  for (const T constant : notable_elements<T>()) {
    for (const std::size_t i : {0u, 1u, 7u, 2147483647u}) {
      T y = unwritten<T>();
      EXPECT_EQ(0u, TypeParam::call(constant, T(1), i, &y));
      EXPECT_TRUE(same_bits(T(0), y)) << constant << " at " << i;
      y = unwritten<T>();
      EXPECT_EQ(0u, TypeParam::call(T(1), constant, i, &y));
      EXPECT_TRUE(same_bits(T(0), y)) << constant << " at " << i;
    }
  }
}

template <typename F>
typename F::output_type iota(typename F::input_type start, typename F::input_type step,
                             std::size_t i) {
  auto y = unwritten<typename F::output_type>();
  EXPECT_EQ(0u, F::call(start, step, i, &y));
  return y;
}

TEST(ComplexIota, EntersTheIndexWithEqualParts) {
  using c = std::complex<float>;
  using z = std::complex<double>;
  // (2 + 3i)(5 + 5i) + (7 + 11i)
  EXPECT_EQ(c(2, 36), iota<scalar::iota_c>({2, 3}, {7, 11}, 5));
  EXPECT_EQ(z(2, 36), iota<scalar::iota_z>({2, 3}, {7, 11}, 5));
  EXPECT_EQ(c(7, 11), iota<scalar::iota_c>({2, 3}, {7, 11}, 0));
  EXPECT_EQ(z(3, 3), iota<scalar::iota_z>({1, 0}, {0, 0}, 3));
}

TEST(ComplexIota, RoundsTheIndexToFloat) {
  using z = std::complex<double>;
  EXPECT_EQ(z(16777216, 16777216), iota<scalar::iota_z>({1, 0}, {0, 0}, 16777217));
  EXPECT_EQ(z(16777220, 16777220), iota<scalar::iota_z>({1, 0}, {0, 0}, 16777219));
  EXPECT_EQ(z(0x1p31, 0x1p31), iota<scalar::iota_z>({1, 0}, {0, 0}, 2147483647));
}

// Within these ranges double is exact before the last rounding.
TEST(ComplexIota, OfFloatsIsRoundedOnceFromDouble) {
  pattern_source<std::uint32_t> source(315);
  const auto part = [&] { return std::bit_cast<float>(source.near(0x3f800000, 1)); };
  for (int round = 0; round < 200'000 && !HasFailure(); ++round) {
    const std::complex<float> start(part(), part()), step(part(), part());
    const std::size_t i = source.below(1 << 24);
    const auto t = static_cast<quad>(static_cast<double>(i));
    const quad p = static_cast<quad>(start.real()), q = static_cast<quad>(start.imag());
    const std::complex<float> expected(
        static_cast<float>(static_cast<double>(p * t - q * t + static_cast<quad>(step.real()))),
        static_cast<float>(static_cast<double>(p * t + q * t + static_cast<quad>(step.imag()))));
    EXPECT_EQ(expected, iota<scalar::iota_c>(start, step, i)) << start << step << i;
  }
}

TEST(ComplexIota, OfDoublesRoundsEachOperation) {
  pattern_source<std::uint64_t> source(316);
  const auto part = [&] {
    return std::bit_cast<double>(source.near(named<std::uint64_t>::one, 3));
  };
  const auto round = [](quad x) { return static_cast<quad>(static_cast<double>(x)); };
  for (int n = 0; n < 200'000 && !HasFailure(); ++n) {
    const std::complex<double> start(part(), part()), step(part(), part());
    const std::size_t i = source.below(1 << 24);
    const auto t = static_cast<quad>(static_cast<double>(i));
    const quad p = round(static_cast<quad>(start.real()) * t);
    const quad q = round(static_cast<quad>(start.imag()) * t);
    const std::complex<double> expected(
        static_cast<double>(round(p - q) + static_cast<quad>(step.real())),
        static_cast<double>(round(p + q) + static_cast<quad>(step.imag())));
    EXPECT_EQ(expected, iota<scalar::iota_z>(start, step, i)) << start << step << i;
  }
}

}  // namespace
