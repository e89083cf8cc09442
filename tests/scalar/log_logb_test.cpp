// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/log/logb.hpp"

#include "log_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

template <typename Body>
class Logb : public ::testing::Test {};
using bodies = ::testing::Types<scalar::logb_s, scalar::logb_d>;
TYPED_TEST_SUITE(Logb, bodies);

/// Each power of two, its neighbours and a number in between, with both signs.
TYPED_TEST(Logb, EveryExponent) {
  using T = typename TypeParam::input_type;
  using limits = std::numeric_limits<T>;
  const T infinity = limits::infinity();
  for (int k = limits::min_exponent - limits::digits; k < limits::max_exponent; ++k) {
    const T power = std::ldexp(T(1), k);
    for (const T sign : {T(1), T(-1)}) {
      expect_number<TypeParam>(sign * power, static_cast<T>(k));
      if (k == limits::min_exponent - limits::digits) continue;
      expect_number<TypeParam>(sign * std::nextafter(power, T(0)), static_cast<T>(k - 1));
      if (k < limits::min_exponent - limits::digits + 1) continue;
      expect_number<TypeParam>(sign * std::nextafter(power, infinity), static_cast<T>(k));
      expect_number<TypeParam>(sign * (power + power / 2), static_cast<T>(k));
    }
  }
}

TYPED_TEST(Logb, RandomNumbers) {
  using T = typename TypeParam::input_type;
  using U = part_of<T>;
  pattern_source<U> source(41);
  for (int i = 0; i < 100'000; ++i) {
    const T x = std::bit_cast<T>(source.finite());
    if (x == 0) continue;
    ASSERT_TRUE(expect_number<TypeParam>(x, std::logb(x)));
  }
}

/// A zero reports a domain error, not a pole. Infinities and NaNs lose their sign bit and nothing
/// else.
TYPED_TEST(Logb, Specials) {
  using U = part_of<typename TypeParam::input_type>;
  using n = named<U>;
  expect_v11<TypeParam>(0, n::inf | n::sign, domain);
  expect_v11<TypeParam>(n::sign, n::inf | n::sign, domain);
  for (const U x : {n::inf, n::nan, n::signalling, U(n::nan + 5)}) {
    expect_v11<TypeParam>(x, x, none);
    expect_v11<TypeParam>(x | n::sign, x, none);
  }
}

}  // namespace
