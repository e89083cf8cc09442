// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Half functors: the float body of `ep` between two conversions, with its status.

#include "bits.hpp"
#include "scalar/pow/pow2o3.hpp"
#include "scalar/pow/pow3o2.hpp"
#include "scalar/root/cbrt.hpp"
#include "scalar/root/div.hpp"
#include "scalar/root/hypot.hpp"
#include "scalar/root/inv.hpp"
#include "scalar/root/invcbrt.hpp"
#include "scalar/root/invsqrt.hpp"
#include "scalar/root/sqr.hpp"
#include "scalar/root/sqrt.hpp"

namespace {

using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::binary16;

constexpr std::uint16_t any_nan = 0x7fff;

bool same(std::uint16_t expected, std::uint16_t actual) {
  return expected == any_nan ? (actual & 0x7e00) == 0x7e00 && (actual & 0x7fff) > 0x7c00
                             : expected == actual;
}

template <typename F>
void expect(std::uint16_t x, std::uint16_t y, std::uint32_t status = 0) {
  const binary16 a{x};
  binary16 r{0x5aa5};
  EXPECT_EQ(F::call(&a, &r), status) << std::hex << x;
  EXPECT_TRUE(same(y, r.pattern)) << std::hex << x << " " << r.pattern;
}
template <typename F>
void expect(std::uint16_t x, std::uint16_t y, std::uint16_t z, std::uint32_t status) {
  const binary16 a{x}, b{y};
  binary16 r{0x5aa5};
  EXPECT_EQ(F::call(&a, &b, &r), status) << std::hex << x << " " << y;
  EXPECT_TRUE(same(z, r.pattern)) << std::hex << x << " " << y << " " << r.pattern;
}

TEST(RootHalf, StatusIsThatOfTheFloatBody) {
  expect<scalar::sqrt_h>(0xbc00, any_nan, 1);
  expect<scalar::sqrt_h>(0xfe00, any_nan, 1);
  expect<scalar::sqrt_h>(0x8000, 0x8000);
  expect<scalar::sqrt_h>(0x4400, 0x4000);
  expect<scalar::inv_h>(0x8000, 0xfc00, 2);
  expect<scalar::inv_h>(0x0001, 0x7c00);  // 2^24, too large only for half
  expect<scalar::invsqrt_h>(0x0000, 0x7c00, 2);
  expect<scalar::invsqrt_h>(0xfc00, any_nan, 1);
  expect<scalar::invsqrt_h>(0x0001, 0x6c00);  // 2^12
  expect<scalar::invcbrt_h>(0x8000, 0xfc00, 2);
  expect<scalar::invcbrt_h>(0x4800, 0x3800);
  expect<scalar::cbrt_h>(0xc800, 0xc000);
  expect<scalar::sqr_h>(0x5c00, 0x7c00);  // 2^16
  expect<scalar::pow2o3_h>(0xc800, 0x4400);
  expect<scalar::pow3o2_h>(0x4400, 0x4800);
  expect<scalar::pow3o2_h>(0xbc00, any_nan, 1);
}

TEST(RootHalf, TwoOperands) {
  expect<scalar::div_h>(0x0000, 0x0000, any_nan, 2);
  expect<scalar::div_h>(0x3c00, 0x8000, 0xfc00, 2);
  expect<scalar::div_h>(0x4600, 0x4000, 0x4200, 0);
  expect<scalar::hypot_h>(0x4200, 0xc400, 0x4500, 0);
  expect<scalar::hypot_h>(0x7e00, 0xfc00, 0x7c00, 0);
  expect<scalar::hypot_h>(0x7bff, 0x7bff, 0x7c00, 0);
}

}  // namespace
