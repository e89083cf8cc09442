// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <cmath>

#include "bits.hpp"
#include "scalar/exact/ceil.hpp"
#include "scalar/exact/floor.hpp"
#include "scalar/exact/frac.hpp"
#include "scalar/exact/modf.hpp"
#include "scalar/exact/nearbyint.hpp"
#include "scalar/exact/rint.hpp"
#include "scalar/exact/round.hpp"
#include "scalar/exact/trunc.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

template <typename T>
struct bodies;
template <>
struct bodies<float> {
  using floor = scalar::floor_s;
  using ceil = scalar::ceil_s;
  using trunc = scalar::trunc_s;
  using round = scalar::round_s;
  using rint = scalar::rint_s;
  using nearbyint = scalar::nearbyint_s;
  using frac = scalar::frac_s;
  using modf = scalar::modf_s;
};
template <>
struct bodies<double> {
  using floor = scalar::floor_d;
  using ceil = scalar::ceil_d;
  using trunc = scalar::trunc_d;
  using round = scalar::round_d;
  using rint = scalar::rint_d;
  using nearbyint = scalar::nearbyint_d;
  using frac = scalar::frac_d;
  using modf = scalar::modf_d;
};

template <typename T>
part_of<T> expected(T x) {
  return std::isnan(x) ? named<part_of<T>>::any_nan : std::bit_cast<part_of<T>>(x);
}

/// All functions at one pattern against the C library's. Where that leaves the sign of a zero to
/// the sign of x, so do the bodies.
template <typename T>
bool expect_as_in_c(part_of<T> p) {
  using body = bodies<T>;
  using U = part_of<T>;
  const T x = std::bit_cast<T>(p);
  bool good = expect_v11<typename body::floor>(p, expected(std::floor(x)));
  good &= expect_v11<typename body::ceil>(p, expected(std::ceil(x)));
  good &= expect_v11<typename body::trunc>(p, expected(std::trunc(x)));
  good &= expect_v11<typename body::round>(p, expected(std::round(x)));
  good &= expect_v11<typename body::rint>(p, expected(std::nearbyint(x)));
  good &= expect_v11<typename body::nearbyint>(p, expected(std::nearbyint(x)));
  T integer = 0;
  const T fraction = std::modf(x, &integer);
  if (std::isinf(x)) {
    const U modf_zero = sizeof(T) == 4 ? (p & named<U>::sign) : 0;
    good &= expect_v12<typename body::modf>(p, p, modf_zero);
    good &= expect_v11<typename body::frac>(p, 0);
  } else {
    good &= expect_v12<typename body::modf>(p, expected(integer), expected(fraction));
    good &= expect_v11<typename body::frac>(p, expected(fraction));
  }
  return good;
}

template <typename T>
class ExactRounding : public ::testing::Test {};
using types = ::testing::Types<float, double>;
TYPED_TEST_SUITE(ExactRounding, types);

TYPED_TEST(ExactRounding, HalvesAndSigns) {
  using T = TypeParam;
  using body = bodies<T>;
  struct row {
    T x, floor, ceil, trunc, round, rint, frac;
  };
  const row rows[] = {
      {0.0, 0.0, 0.0, 0.0, 0.0, 0.0, 0.0},        {-0.0, -0.0, -0.0, -0.0, -0.0, -0.0, -0.0},
      {0.25, 0.0, 1.0, 0.0, 0.0, 0.0, 0.25},      {-0.25, -1.0, -0.0, -0.0, -0.0, -0.0, -0.25},
      {0.5, 0.0, 1.0, 0.0, 1.0, 0.0, 0.5},        {-0.5, -1.0, -0.0, -0.0, -1.0, -0.0, -0.5},
      {0.75, 0.0, 1.0, 0.0, 1.0, 1.0, 0.75},      {-0.75, -1.0, -0.0, -0.0, -1.0, -1.0, -0.75},
      {1.0, 1.0, 1.0, 1.0, 1.0, 1.0, 0.0},        {-1.0, -1.0, -1.0, -1.0, -1.0, -1.0, -0.0},
      {1.5, 1.0, 2.0, 1.0, 2.0, 2.0, 0.5},        {-1.5, -2.0, -1.0, -1.0, -2.0, -2.0, -0.5},
      {2.5, 2.0, 3.0, 2.0, 3.0, 2.0, 0.5},        {-2.5, -3.0, -2.0, -2.0, -3.0, -2.0, -0.5},
      {-3.5, -4.0, -3.0, -3.0, -4.0, -4.0, -0.5},
  };
  for (const row& r : rows) {
    expect_number<typename body::floor>(r.x, r.floor);
    expect_number<typename body::ceil>(r.x, r.ceil);
    expect_number<typename body::trunc>(r.x, r.trunc);
    expect_number<typename body::round>(r.x, r.round);
    expect_number<typename body::rint>(r.x, r.rint);
    expect_number<typename body::nearbyint>(r.x, r.rint);
    expect_number<typename body::frac>(r.x, r.frac);
    using U = part_of<T>;
    expect_v12<typename body::modf>(std::bit_cast<U>(r.x), std::bit_cast<U>(r.trunc),
                                    std::bit_cast<U>(r.frac));
  }
}

TEST(ExactRoundingSpecials, ModfOfInfinity) {
  expect_v12<scalar::modf_s>(0x7f800000, 0x7f800000, 0x00000000);
  expect_v12<scalar::modf_s>(0xff800000, 0xff800000, 0x80000000);
  expect_v12<scalar::modf_d>(0x7ff0000000000000, 0x7ff0000000000000, 0);
  expect_v12<scalar::modf_d>(0xfff0000000000000, 0xfff0000000000000, 0);
}

TEST(ExactRoundingSpecials, FracOfInfinity) {
  expect_v11<scalar::frac_s>(0x7f800000, 0);
  expect_v11<scalar::frac_s>(0xff800000, 0);
  expect_v11<scalar::frac_d>(0x7ff0000000000000, 0);
  expect_v11<scalar::frac_d>(0xfff0000000000000, 0);
}

TEST(ExactRoundingSpecials, NansKeepTheirPayload) {
  expect_v12<scalar::modf_s>(0x7f800003, 0x7fc00003, 0x7fc00003);
  expect_v12<scalar::modf_s>(0xffc00007, 0xffc00007, 0xffc00007);
  expect_v12<scalar::modf_d>(0x7ff0000000000003, 0x7ff8000000000003, 0x7ff8000000000003);
  expect_v12<scalar::modf_d>(0xfff8000000000007, 0xfff8000000000007, 0xfff8000000000007);
  expect_v11<scalar::frac_s>(0xff800003, 0xffc00003);
  expect_v11<scalar::frac_d>(0x7ff0000000000003, 0x7ff8000000000003);
  expect_v11<scalar::floor_d>(0x7ff0000000000003, 0x7ff8000000000003);
  expect_v11<scalar::ceil_d>(0xfff0000000000003, 0xfff8000000000003);
  expect_v11<scalar::trunc_d>(0xfff0000000000003, 0xfff8000000000003);
  expect_v11<scalar::round_d>(0xfff0000000000003, 0xfff8000000000003);
  expect_v11<scalar::rint_d>(0xfff0000000000003, 0xfff8000000000003);
}

/// Beyond 2^52 a double is an integer; there the big-number addition would lose bits.
TEST(ExactRoundingSpecials, AroundTheBigNumber) {
  for (const double x : {0x1p51 - 0.5, 0x1p51 + 0.5, 0x1p52 - 1.5, 0x1p52 - 0.5, 0x1p52, 0x1p52 + 1,
                         0x1p53 - 1, 0x1p53 + 2, 0x1.fffffffffffffp1023}) {
    expect_as_in_c<double>(std::bit_cast<std::uint64_t>(x));
    expect_as_in_c<double>(std::bit_cast<std::uint64_t>(-x));
  }
}

TYPED_TEST(ExactRounding, NotablePatterns) {
  for (const auto p : notable_patterns<part_of<TypeParam>>()) expect_as_in_c<TypeParam>(p);
}

TYPED_TEST(ExactRounding, RandomPatterns) {
  using U = part_of<TypeParam>;
  pattern_source<U> source(1);
  for (int i = 0; i < 200'000; ++i) {
    ASSERT_TRUE(expect_as_in_c<TypeParam>(source.any()));
    // Where fractions and integers meet.
    ASSERT_TRUE(expect_as_in_c<TypeParam>(source.near(named<U>::one, sizeof(U) == 4 ? 26 : 56)));
  }
}

/// Integers plus one half and the neighbours of that: all ties, up to where there is no half.
TYPED_TEST(ExactRounding, TiesAndNeighbours) {
  using U = part_of<TypeParam>;
  pattern_source<U> source(2);
  const int places = sizeof(U) == 4 ? 23 : 52;
  for (int i = 0; i < 100'000; ++i) {
    const std::uint64_t mask =
        (std::uint64_t{1} << source.below(static_cast<unsigned>(places))) - 1;
    const TypeParam tie = static_cast<TypeParam>(source.any() & mask) + TypeParam(0.5);
    const U p = std::bit_cast<U>(tie) | (i % 2 == 0 ? named<U>::sign : 0);
    ASSERT_TRUE(expect_as_in_c<TypeParam>(p - 1));
    ASSERT_TRUE(expect_as_in_c<TypeParam>(p));
    ASSERT_TRUE(expect_as_in_c<TypeParam>(p + 1));
  }
}

TEST(SlowExactRounding, AllFloats) {
  std::uint32_t p = 0;
  do {
    ASSERT_TRUE(expect_as_in_c<float>(p));
  } while (++p != 0);
}

}  // namespace
