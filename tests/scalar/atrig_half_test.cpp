// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The inverse trigonometric functions on halves: what the float bodies report reaches them, and
/// the exact results stay exact.

#include "atrig_cases.hpp"
#include "scalar/atrig/acos.hpp"
#include "scalar/atrig/acospi.hpp"
#include "scalar/atrig/asin.hpp"
#include "scalar/atrig/asinpi.hpp"
#include "scalar/atrig/atan.hpp"
#include "scalar/atrig/atan2.hpp"
#include "scalar/atrig/atan2pi.hpp"
#include "scalar/atrig/atanpi.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane::scalar;

constexpr std::uint16_t one = 0x3c00, minus_one = 0xbc00, two = 0x4000, half = 0x3800,
                        quarter = 0x3400, half_pi = 0x3e48, pi = 0x4248, infinity = 0x7c00,
                        nan = 0x7e00, minus_zero = 0x8000;

template <typename F>
void expect_half(std::uint16_t x, std::uint16_t y, std::uint32_t status = none) {
  const binary16 a{x};
  binary16 r{0x5aa5};
  EXPECT_EQ(F::call(&a, &r), status) << x;
  EXPECT_EQ(r.pattern, y) << x;
}
template <typename F>
void expect_half2(std::uint16_t y, std::uint16_t x, std::uint16_t angle) {
  const binary16 a{y}, b{x};
  binary16 r{0x5aa5};
  EXPECT_EQ(F::call(&a, &b, &r), 0u) << y << " " << x;
  EXPECT_EQ(r.pattern, angle) << y << " " << x;
}

TEST(AtrigHalf, Arcsines) {
  expect_half<asin_h>(one, half_pi);
  expect_half<asin_h>(minus_zero, minus_zero);
  expect_half<asin_h>(two, nan, domain);
  expect_half<asin_h>(nan, nan, domain);
  expect_half<acos_h>(one, 0);
  expect_half<acos_h>(minus_one, pi);
  expect_half<acos_h>(infinity, nan, domain);
  expect_half<asinpi_h>(one, half);
  expect_half<asinpi_h>(two, nan, domain);
  expect_half<asinpi_h>(nan, nan);
  expect_half<acospi_h>(minus_one, one);
  expect_half<acospi_h>(0, half);
  expect_half<acospi_h>(nan, nan);
}

TEST(AtrigHalf, Arctangents) {
  expect_half<atan_h>(infinity, half_pi);
  expect_half<atan_h>(nan, nan);
  expect_half<atanpi_h>(infinity, half);
  expect_half<atanpi_h>(one, quarter);
  expect_half2<atan2_h>(0, minus_one, pi);
  expect_half2<atan2_h>(minus_zero, one, minus_zero);
  expect_half2<atan2_h>(infinity, one, half_pi);
  expect_half2<atan2pi_h>(0, minus_zero, one);
  expect_half2<atan2pi_h>(one, one, quarter);
  expect_half2<atan2pi_h>(infinity, infinity, quarter);
}

}  // namespace
