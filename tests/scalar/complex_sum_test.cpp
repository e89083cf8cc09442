// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <cmath>

#include "bits.hpp"
#include "scalar/complex/add.hpp"
#include "scalar/complex/conj.hpp"
#include "scalar/complex/sub.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

constexpr std::uint32_t overflow = 4;

template <typename R>
struct bodies;
template <>
struct bodies<float> {
  using add = scalar::add_c;
  using add_ep = scalar::add_c_ep;
  using sub = scalar::sub_c;
  using sub_ep = scalar::sub_c_ep;
  using conj = scalar::conj_c;
};
template <>
struct bodies<double> {
  using add = scalar::add_z;
  using add_ep = scalar::add_z_ep;
  using sub = scalar::sub_z;
  using sub_ep = scalar::sub_z_ep;
  using conj = scalar::conj_z;
};

template <typename R>
part_of<R> expected(R x) {
  return std::isnan(x) ? named<part_of<R>>::any_nan : std::bit_cast<part_of<R>>(x);
}

template <typename U>
bool is_infinity(U p) {
  return (p & ~named<U>::sign) == named<U>::inf;
}

template <typename R>
bool expect_all(part_of<R> a, part_of<R> b, part_of<R> c, part_of<R> d) {
  using U = part_of<R>;
  using body = bodies<R>;
  const auto number = [](U p) { return std::bit_cast<R>(p); };
  const std::array<U, 2> sum = {expected(number(a) + number(c)), expected(number(b) + number(d))};
  const std::array<U, 2> difference = {expected(number(a) - number(c)),
                                       expected(number(b) - number(d))};
  const bool operands = is_infinity(a) || is_infinity(b) || is_infinity(c) || is_infinity(d);
  const auto status = [operands](const std::array<U, 2>& r) {
    return !operands && (is_infinity(r[0]) || is_infinity(r[1])) ? overflow : 0;
  };
  bool good = expect_v21<typename body::add>({a, b}, {c, d}, sum, status(sum));
  good &= expect_v21<typename body::sub>({a, b}, {c, d}, difference, status(difference));
  good &= expect_v21<typename body::add_ep>({a, b}, {c, d}, sum, 0);
  good &= expect_v21<typename body::sub_ep>({a, b}, {c, d}, difference, 0);
  return good;
}

template <typename R>
class ComplexSum : public ::testing::Test {};
using types = ::testing::Types<float, double>;
TYPED_TEST_SUITE(ComplexSum, types);

TYPED_TEST(ComplexSum, OverflowIsThatOfFiniteOperandsOnly) {
  using n = named<part_of<TypeParam>>;
  using body = bodies<TypeParam>;
  const auto minus = n::sign;
  expect_v21<typename body::add>({n::largest, n::one}, {n::largest, n::one},
                                 {n::inf, n::one + n::smallest_normal}, overflow);
  expect_v21<typename body::add>({0, n::largest | minus}, {0, n::largest | minus},
                                 {0, n::inf | minus}, overflow);
  expect_v21<typename body::add>({n::inf, 0}, {n::one, 0}, {n::inf, 0}, 0);
  expect_v21<typename body::add>({n::inf, n::largest}, {n::one, n::largest}, {n::inf, n::inf}, 0);
  // A NaN beside it does not hide an overflow.
  expect_v21<typename body::add>({n::nan, n::largest}, {0, n::largest}, {n::nan, n::inf}, overflow);
  expect_v21<typename body::sub>({n::largest, 0}, {n::largest | minus, 0}, {n::inf, 0}, overflow);
  expect_v21<typename body::sub>({n::one, 0}, {0, n::inf}, {n::one, n::inf | minus}, 0);
  expect_v21<typename body::sub>({n::inf, 0}, {n::inf, 0}, {n::any_nan, 0}, 0);
  expect_v21<typename body::add_ep>({n::largest, 0}, {n::largest, 0}, {n::inf, 0}, 0);
  expect_v21<typename body::sub_ep>({0, n::largest}, {0, n::largest | minus}, {0, n::inf}, 0);
}

TYPED_TEST(ComplexSum, NotableParts) {
  using U = part_of<TypeParam>;
  const auto list = notable_patterns<U>();
  for (const U a : list) {
    for (const U d : list) expect_all<TypeParam>(a, d ^ named<U>::sign, d, a);
  }
}

TYPED_TEST(ComplexSum, RandomParts) {
  pattern_source<part_of<TypeParam>> source(9);
  for (int i = 0; i < 200'000; ++i) {
    const auto a = source.any(), b = source.any();
    ASSERT_TRUE(expect_all<TypeParam>(a, b, source.any(), source.any()));
    ASSERT_TRUE(expect_all<TypeParam>(a, b, source.near(a, 3), source.near(b, 3)));
  }
}

TYPED_TEST(ComplexSum, Conjugate) {
  using U = part_of<TypeParam>;
  using n = named<U>;
  using body = bodies<TypeParam>;
  for (const U re : notable_patterns<U>()) {
    for (const U im : notable_patterns<U>()) {
      const bool nan = (im & ~n::sign) > n::inf;
      expect_v11<typename body::conj>({re, im}, {re, nan ? im : im ^ n::sign});
    }
  }
}

}  // namespace
