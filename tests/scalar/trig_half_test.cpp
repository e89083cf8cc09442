// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <cmath>

#include "scalar/half.hpp"
#include "scalar/trig/cos.hpp"
#include "scalar/trig/sin.hpp"
#include "scalar/trig/sincos.hpp"
#include "scalar/trig/tan.hpp"
#include "trig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::binary16;
using scalar::narrow;
using scalar::tier;
using scalar::widen;

struct outcome {
  std::uint16_t pattern;
  std::uint32_t status;
};

template <typename F>
outcome run(std::uint32_t x) {
  const binary16 in{static_cast<std::uint16_t>(x)};
  binary16 out{0x5aa5};
  const std::uint32_t status = F::call(&in, &out);
  return {out.pattern, status};
}

/// A normal half in units of its own last place, a smaller number in those of denormals.
double unit_of_half(double x) { return std::ldexp(1.0, std::max(std::ilogb(x), -14) - 10); }

/// Every finite half against the double function, whose error does not count.
template <typename F>
void expect_every_half_within(double (*exact)(double), double limit) {
  double largest = 0;
  for (std::uint32_t p = 0; p < 0x10000; ++p) {
    if ((p & 0x7fff) >= 0x7c00) continue;
    const outcome y = run<F>(p);
    ASSERT_EQ(y.status, none);
    const double expected = exact(static_cast<double>(widen({static_cast<std::uint16_t>(p)})));
    const double error = std::fabs(static_cast<double>(widen({y.pattern})) - expected);
    if (expected == 0) {
      ASSERT_EQ(y.pattern, p);
    } else {
      largest = std::max(largest, error / unit_of_half(expected));
    }
  }
  EXPECT_LE(largest, limit) << functor_name<F>();
}

TEST(TrigHalf, EveryHalf) {
  expect_every_half_within<scalar::sin_h>(std::sin, 0.51);
  expect_every_half_within<scalar::cos_h>(std::cos, 0.51);
}

TEST(TrigHalf, Points) {
  EXPECT_EQ(run<scalar::sin_h>(0x0000).pattern, 0x0000);
  EXPECT_EQ(run<scalar::sin_h>(0x8000).pattern, 0x8000);
  EXPECT_EQ(run<scalar::sin_h>(0x0001).pattern, 0x0001);
  EXPECT_EQ(run<scalar::cos_h>(0x0000).pattern, 0x3c00);
  EXPECT_EQ(run<scalar::cos_h>(0x8000).pattern, 0x3c00);
  EXPECT_EQ(run<scalar::sin_h>(0x3c00).pattern, 0x3abb);  // sin 1 = 0.84147
  EXPECT_EQ(run<scalar::cos_h>(0x3c00).pattern, 0x3853);  // cos 1 = 0.54030
  EXPECT_EQ(run<scalar::sin_h>(0xc248).pattern, 0x93ed);  // sin -3.140625 = -0.00096765
}

template <typename F>
void expect_own_pattern(std::uint32_t p, std::uint32_t status) {
  EXPECT_EQ(run<F>(p).pattern, p | 0x0200) << p;
  EXPECT_EQ(run<F>(p).status, status) << p;
}

TEST(TrigHalf, InfinitiesAndNans) {
  for (const std::uint32_t sign : {0x0000u, 0x8000u}) {
    expect_own_pattern<scalar::sin_h>(0x7c00 | sign, domain);
    expect_own_pattern<scalar::cos_h>(0x7c00 | sign, domain);
    for (const std::uint32_t nan : {0x7e00u, 0x7c01u, 0x7e05u, 0x7fffu}) {
      expect_own_pattern<scalar::sin_h>(nan | sign, none);
      expect_own_pattern<scalar::cos_h>(nan | sign, none);
    }
  }
}

TEST(TrigHalf, TangentAndPairAreTheFloatBodiesBetweenConversions) {
  for (std::uint32_t p = 0; p < 0x10000; ++p) {
    const binary16 in{static_cast<std::uint16_t>(p)};
    const float x = widen(in);
    float first = 0, second = 0;
    const std::uint32_t tangent_status = scalar::tan_s<tier::ep>::call(&x, &first);
    const outcome tangent = run<scalar::tan_h>(p);
    ASSERT_EQ(tangent.pattern, narrow(first).pattern) << p;
    ASSERT_EQ(tangent.status, tangent_status) << p;

    const std::uint32_t pair_status = scalar::sincos_s<tier::ep>::call(&x, &first, &second);
    binary16 sine{}, cosine{};
    ASSERT_EQ(scalar::sincos_h::call(&in, &sine, &cosine), pair_status) << p;
    ASSERT_EQ(sine.pattern, narrow(first).pattern) << p;
    ASSERT_EQ(cosine.pattern, narrow(second).pattern) << p;
  }
}

}  // namespace
