// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The powers at fixed points, and where their main paths end.

#include "pow_points.hpp"

#include <cmath>
#include <limits>

#include "bits.hpp"
#include "scalar/pow/pow.hpp"
#include "scalar/pow/powr.hpp"
#include "scalar/pow/powx.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::tier;

template <typename F, typename U, std::size_t N>
void expect_points(const operands_of<U> (&points)[N], location where = location::current()) {
  for (const auto& p : points) expect_v21<F>(p.x, p.y, p.r, p.status, where);
}

TEST(PowPoints, Float) {
  expect_points<scalar::pow_s<tier::ha>>(row_power_s_ha_points);
  expect_points<scalar::pow_s<tier::la>>(row_power_s_la_points);
  expect_points<scalar::pow_s<tier::ep>>(quick_power_s_points);
  expect_points<scalar::pow_s_nolut>(artanh_power_s_points);
}

TEST(PowPoints, Double) {
  expect_points<scalar::pow_d<tier::ha>>(word_power_d_points);
  expect_points<scalar::pow_d<tier::la>>(row_power_d_points);
  expect_points<scalar::pow_d<tier::ep>>(quick_power_d_points);
  expect_points<scalar::pow_d_nolut<tier::ha>>(nolut_power_d_ha_points);
  expect_points<scalar::pow_d_nolut<tier::la>>(nolut_power_d_la_points);
  expect_points<scalar::pow_d_nolut<tier::ep>>(nolut_power_d_la_points);
}

TEST(PowrPoints, All) {
  expect_points<scalar::powr_s<tier::ha>>(row_power_s_ha_points);
  expect_points<scalar::powr_s<tier::la>>(artanh_power_s_points);
  expect_points<scalar::powr_s<tier::ep>>(quick_power_s_points);
  expect_points<scalar::powr_s_nolut>(wide_power_s_points);
  expect_points<scalar::powr_d<tier::ha>>(word_power_d_points);
  expect_points<scalar::powr_d<tier::la>>(word_power_d_points);
  expect_points<scalar::powr_d<tier::ep>>(quick_power_d_points);
}

template <typename F, typename U, std::size_t N>
void expect_constant_points(const operands_of<U> (&points)[N],
                            location where = location::current()) {
  using T = typename F::input_type;
  for (const auto& p : points) {
    const T x = element<T>::value(p.x);
    T r = unwritten<T>();
    const std::uint32_t status = F::call(&x, element<T>::value(p.y), &r);
    expect_result(p.r, p.status, r, status, where, functor_name<F>(), "result", x,
                  element<T>::value(p.y));
  }
}

TEST(PowxPoints, All) {
  expect_constant_points<scalar::powx_s<tier::ha>>(row_power_s_ha_points);
  expect_constant_points<scalar::powx_s<tier::la>>(artanh_power_s_points);
  expect_constant_points<scalar::powx_s<tier::ep>>(quick_power_s_points);
  expect_constant_points<scalar::powx_s_nolut>(wide_power_s_points);
  expect_constant_points<scalar::powx_d<tier::ha>>(word_power_d_points);
  expect_constant_points<scalar::powx_d<tier::la>>(word_power_d_points);
  expect_constant_points<scalar::powx_d<tier::ep>>(quick_power_d_points);
}

/// The integer path, with both signs of the result.
TEST(PowPoints, IntegerPath) {
  for (const auto& p : fixed_point_power_points) {
    for (const std::uint32_t sign : {0u, 0x80000000u}) {
      for (const std::uint32_t base_sign : {0u, 0x80000000u}) {
        const float x = std::bit_cast<float>(p.x | base_sign);
        const float y = std::bit_cast<float>(p.y);
        float r = unwritten<float>();
        const std::uint32_t status = scalar::fixed_point_power::of(x, y, sign, &r);
        expect_result(p.r | sign, p.status, r, status, location::current(), "fixed_point_power",
                      "result", x, y);
      }
    }
  }
}

/// At `la` the main path singles out no argument, and its power of zero is 1 + 2^-23. Elsewhere
/// powers of 1, to 0, and small integer ones are exact.
TEST(PowPoints, ExactResults) {
  expect_number<scalar::pow_s<tier::la>>(2.0f, 3.0f, 8.0f + 0x1p-20f, 0);
  expect_number<scalar::pow_s<tier::la>>(7.0f, 0.0f, 1.0f + 0x1p-23f, 0);
  expect_number<scalar::pow_s<tier::la>>(1.0f, 9.0f, 1.0f + 0x1p-23f, 0);
  expect_number<scalar::pow_s<tier::ha>>(2.0f, 3.0f, 8.0f, 0);
  expect_number<scalar::pow_s<tier::ha>>(7.0f, 0.0f, 1.0f, 0);
  expect_number<scalar::pow_s<tier::ha>>(1.0f, 9.0f, 1.0f, 0);
  expect_number<scalar::pow_d<tier::ha>>(2.0, 3.0, 8.0, 0);
  expect_number<scalar::pow_d<tier::la>>(2.0, 3.0, 8.0, 0);
  expect_number<scalar::powr_s<tier::la>>(7.0f, 0.0f, 1.0f, 0);
}

template <typename Main, typename T>
bool stands(T x, T y) {
  return Main::main(x, y).rare == 0;
}

/// Bases of all main paths: the positive normal numbers.
template <typename Main, typename T>
void expect_bases(T largest = std::numeric_limits<T>::max()) {
  const T infinity = std::numeric_limits<T>::infinity();
  const T least = std::numeric_limits<T>::min();
  const T y = T(0.25);
  EXPECT_TRUE(stands<Main>(least, y));
  EXPECT_FALSE(stands<Main>(std::nextafter(least, T(0)), y));
  EXPECT_TRUE(stands<Main>(largest, y));
  EXPECT_FALSE(stands<Main>(std::nextafter(largest, infinity), y));
  for (const T x : {infinity, -infinity, T(0), -T(0), T(-1), -least, -largest,
                    std::numeric_limits<T>::quiet_NaN(), -std::numeric_limits<T>::quiet_NaN()})
    EXPECT_FALSE(stands<Main>(x, y)) << x;
  for (const T x : {T(1), T(2), T(0.5), largest, least}) {
    EXPECT_FALSE(stands<Main>(x, infinity)) << x;
    EXPECT_FALSE(stands<Main>(x, -infinity)) << x;
    EXPECT_FALSE(stands<Main>(x, std::numeric_limits<T>::quiet_NaN())) << x;
    EXPECT_TRUE(stands<Main>(x, T(0))) << x;
    EXPECT_TRUE(stands<Main>(x, std::numeric_limits<T>::denorm_min())) << x;
  }
}

TEST(PowMainPaths, Bases) {
  expect_bases<scalar::row_power_s<tier::ha>, float>();
  expect_bases<scalar::row_power_s<tier::la>, float>();
  expect_bases<scalar::quick_power_s, float>(std::bit_cast<float>(0x7f7ffffeu));
  expect_bases<scalar::artanh_power_s, float>();
  expect_bases<scalar::wide_power_s, float>();
  expect_bases<scalar::row_power_d, double>();
  expect_bases<scalar::word_power_d, double>();
  expect_bases<scalar::quick_power_d, double>();
  expect_bases<scalar::nolut_power_d<tier::ha>, double>();
  expect_bases<scalar::nolut_power_d<tier::la>, double>();
}

/// The last exponent of 2 of the main path, whose logarithm to base 2 is exactly 1.
template <typename Main, typename T>
void expect_last_exponent(T y) {
  const T infinity = std::numeric_limits<T>::infinity();
  EXPECT_TRUE(stands<Main>(T(2), y));
  EXPECT_TRUE(stands<Main>(T(2), -y));
  EXPECT_FALSE(stands<Main>(T(2), std::nextafter(y, infinity)));
  EXPECT_FALSE(stands<Main>(T(2), -std::nextafter(y, infinity)));
}

/// The same where the product with ln 2, rounded, is compared with `limit`.
template <typename Main, typename T>
void expect_last_product(T ln2, T limit) {
  T y = limit / ln2;
  for (int k = 0; k < 4; ++k) y = std::nextafter(y, T(0));
  for (int k = 0; k < 8; ++k, y = std::nextafter(y, std::numeric_limits<T>::infinity())) {
    EXPECT_EQ((stands<Main>(T(2), y)), ln2 * y <= limit) << y;
    EXPECT_EQ((stands<Main>(T(2), -y)), ln2 * y <= limit) << y;
  }
}

TEST(PowMainPaths, Exponents) {
  expect_last_exponent<scalar::row_power_s<tier::ha>>(std::bit_cast<float>(0x42fb7fffu));
  expect_last_exponent<scalar::row_power_s<tier::la>>(std::bit_cast<float>(0x42fb7fffu));
  expect_last_exponent<scalar::row_power_d>(1021.5);
  expect_last_exponent<scalar::word_power_d>(std::bit_cast<double>(0x408f3ffeffffffffu));
  const float ln2_s = std::bit_cast<float>(0x3f317218u);
  const double ln2_d = std::bit_cast<double>(0x3fe62e42fefa39efu);
  expect_last_product<scalar::quick_power_s>(ln2_s, std::bit_cast<float>(0x42ae9a00u));
  expect_last_product<scalar::quick_power_d>(ln2_d, std::bit_cast<double>(0x4086232affffffffu));
  expect_last_product<scalar::nolut_power_d<tier::la>>(ln2_d,
                                                       std::bit_cast<double>(0x4086232affffffffu));
  expect_last_product<scalar::artanh_power_s>(ln2_s, std::bit_cast<float>(0x42aeac4fu));
  // Exponents of 2^1017 and more are left to the rare path whatever the product.
  EXPECT_TRUE(stands<scalar::word_power_d>(1.0, std::nextafter(0x1p1017, 0.0)));
  EXPECT_FALSE(stands<scalar::word_power_d>(1.0, 0x1p1017));
  EXPECT_TRUE(stands<scalar::quick_power_d>(1.0, std::nextafter(0x1p1017, 0.0)));
  EXPECT_FALSE(stands<scalar::quick_power_d>(1.0, 0x1p1017));
}

}  // namespace
