// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <cmath>

#include "bits.hpp"
#include "scalar/exact/abs.hpp"
#include "scalar/exact/add.hpp"
#include "scalar/exact/copysign.hpp"
#include "scalar/exact/mul.hpp"
#include "scalar/exact/sub.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

template <typename T>
struct bodies;
template <>
struct bodies<float> {
  using add = scalar::add_s;
  using sub = scalar::sub_s;
  using mul = scalar::mul_s;
  using abs = scalar::abs_s;
  using copysign = scalar::copysign_s;
};
template <>
struct bodies<double> {
  using add = scalar::add_d;
  using sub = scalar::sub_d;
  using mul = scalar::mul_d;
  using abs = scalar::abs_d;
  using copysign = scalar::copysign_d;
};

template <typename T>
part_of<T> expected(T x) {
  return std::isnan(x) ? named<part_of<T>>::any_nan : std::bit_cast<part_of<T>>(x);
}

template <typename T>
bool expect_all(part_of<T> p, part_of<T> q) {
  using U = part_of<T>;
  using body = bodies<T>;
  const T x = std::bit_cast<T>(p);
  const T y = std::bit_cast<T>(q);
  bool good = expect_v21<typename body::add>(p, q, expected(x + y));
  good &= expect_v21<typename body::sub>(p, q, expected(x - y));
  const bool exact_zero = (x == 0 && std::isfinite(y)) || (y == 0 && std::isfinite(x));
  good &= expect_v21<typename body::mul>(p, q, exact_zero ? U(0) : expected(x * y));
  good &= expect_v11<typename body::abs>(p, p & ~named<U>::sign);
  good &= expect_v21<typename body::copysign>(p, q, (p & ~named<U>::sign) | (q & named<U>::sign));
  return good;
}

template <typename T>
class ExactArithmetic : public ::testing::Test {};
using types = ::testing::Types<float, double>;
TYPED_TEST_SUITE(ExactArithmetic, types);

TYPED_TEST(ExactArithmetic, SignsOfZero) {
  using U = part_of<TypeParam>;
  using n = named<U>;
  using body = bodies<TypeParam>;
  expect_v21<typename body::mul>(n::one | n::sign, 0, 0);
  expect_v21<typename body::mul>(0, n::one | n::sign, 0);
  expect_v21<typename body::mul>(n::sign, n::one, 0);
  // A product that underflows is no exact zero.
  expect_v21<typename body::mul>(1 | n::sign, 1, n::sign);
  expect_v21<typename body::sub>(n::sign, 0, n::sign);
  expect_v21<typename body::sub>(n::one, n::one, 0);
  expect_v21<typename body::add>(n::sign, n::sign, n::sign);
  expect_v21<typename body::add>(n::sign, 0, 0);
}

TYPED_TEST(ExactArithmetic, SpecialsWithoutStatus) {
  using U = part_of<TypeParam>;
  using n = named<U>;
  using body = bodies<TypeParam>;
  expect_v21<typename body::add>(n::largest, n::largest, n::inf, 0);
  expect_v21<typename body::sub>(n::inf, n::inf, n::any_nan, 0);
  expect_v21<typename body::mul>(n::inf, 0, n::any_nan, 0);
  expect_v21<typename body::mul>(n::largest, n::largest | n::sign, n::inf | n::sign, 0);
  expect_v21<typename body::add>(n::signalling, n::one, n::any_nan, 0);
  expect_v11<typename body::abs>(n::nan | n::sign, n::nan);
  expect_v11<typename body::abs>(n::signalling | n::sign, n::signalling);
  expect_v21<typename body::copysign>(n::nan, n::one | n::sign, n::nan | n::sign);
  expect_v21<typename body::copysign>(n::signalling | n::sign, n::one, n::signalling);
  expect_v21<typename body::copysign>(n::one, n::nan | n::sign, n::one | n::sign);
}

TYPED_TEST(ExactArithmetic, NotablePairs) {
  const auto list = notable_patterns<part_of<TypeParam>>();
  for (const auto x : list) {
    for (const auto y : list) expect_all<TypeParam>(x, y);
  }
}

TYPED_TEST(ExactArithmetic, RandomPairs) {
  pattern_source<part_of<TypeParam>> source(4);
  for (int i = 0; i < 300'000; ++i) {
    const auto x = source.any();
    ASSERT_TRUE(expect_all<TypeParam>(x, source.any()));
    ASSERT_TRUE(expect_all<TypeParam>(x, source.near(x, 30)));
  }
}

}  // namespace
