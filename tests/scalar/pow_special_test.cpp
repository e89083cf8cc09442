// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Special operands of the powers: every pair of a grid, against the tables; and the status and
/// sign of what is no special case.

#include <cmath>
#include <cstring>

#include "pow_oracle.hpp"
#include "scalar/half.hpp"
#include "scalar/pow/pow.hpp"
#include "scalar/pow/powr.hpp"
#include "scalar/pow/powx.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::tier;

/// One result, in either form of a call.
template <typename F, typename T>
std::uint32_t call(T x, T y, T* r) {
  if constexpr (requires { F::call(&x, &y, r); }) {
    return F::call(&x, &y, r);
  } else {
    return F::call(&x, y, r);
  }
}

constexpr std::uint32_t over = 4, under = 8;

/// The status of an ordinary power, with the exact value to more bits and a wider range.
std::uint32_t status_of(float, float, long double exact) {
  if (std::fabs(exact) >= 0x1.ffffffp127L) return over;
  return std::fabs(exact) < 0x1p-150L ? under : 0u;
}
std::uint32_t status_of(double x, double y, long double) {
  const double l = std::log2(std::fabs(x));
  const bool far = std::ilogb(l) + std::ilogb(y) >= 11;
  return far && (l < 0) == (y < 0) ? over : 0u;
}

/// Every pair; those that are not special have the right sign, size and status.
template <typename F, typename Oracle>
void expect_grid(Oracle oracle, double ulps, location where = location::current()) {
  using T = typename F::input_type;
  using U = part_of<T>;
  for (const T x : power_operands<T>()) {
    for (const T y : power_operands<T>()) {
      T r = unwritten<T>();
      const std::uint32_t status = call<F>(x, y, &r);
      if (const auto e = oracle(x, y)) {
        // A signalling NaN that passes by its pattern is no quiet one.
        if (e->pattern == (named<U>::signalling)) {
          EXPECT_EQ(std::bit_cast<U>(r), e->pattern);
          EXPECT_EQ(status, e->status);
          continue;
        }
        expect_result(e->pattern, e->status, r, status, where, functor_name<F>(), "result", x, y);
        continue;
      }
      const long double exact = std::pow(static_cast<long double>(x), static_cast<long double>(y));
      const long double bound = static_cast<long double>(std::numeric_limits<T>::epsilon()) * ulps;
      const bool good = std::isinf(r)
                            ? std::fabs(exact) * (1 + bound) >= std::numeric_limits<T>::max() &&
                                  std::signbit(r) == std::signbit(exact)
                            : std::fabs(r - exact) <=
                                  std::fabs(exact) * bound + std::numeric_limits<T>::denorm_min();
      if (!good || std::signbit(r) != std::signbit(exact) || status != status_of(x, y, exact))
        ADD_FAILURE_AT(where.file, where.line)
            << functor_name<F>() << "\n  " << x << " to the power " << y << " is " << r
            << " status " << status << ", exactly " << exact;
    }
  }
}

/// The main path of `la` singles out no argument: y = 0 and x = 1 have the status of a power, and
/// 1 + 2^-23.
std::optional<expected_power<std::uint32_t>> special_pow_la(float x, float y) {
  const bool served = std::isnormal(x) && x > 0 && std::isfinite(y);
  if (served && (y == 0 || x == 1)) return expected_power<std::uint32_t>{0x3f800001, 0};
  return special_pow(x, y);
}

constexpr auto pow_oracle = [](auto x, auto y) { return special_pow(x, y); };
constexpr auto powr_oracle = [](auto x, auto y) { return special_powr(x, y); };

TEST(PowSpecial, Float) {
  expect_grid<scalar::pow_s<tier::ha>>(pow_oracle, 1);
  expect_grid<scalar::pow_s<tier::la>>(special_pow_la, 4);
  expect_grid<scalar::pow_s<tier::ep>>(pow_oracle, 0x1p12);
  expect_grid<scalar::pow_s_nolut>(pow_oracle, 4);
}

TEST(PowSpecial, Double) {
  expect_grid<scalar::pow_d<tier::ha>>(pow_oracle, 1);
  expect_grid<scalar::pow_d<tier::la>>(pow_oracle, 4);
  expect_grid<scalar::pow_d<tier::ep>>(pow_oracle, 0x1p26);
  expect_grid<scalar::pow_d_nolut<tier::ha>>(pow_oracle, 1);
  expect_grid<scalar::pow_d_nolut<tier::la>>(pow_oracle, 4);
  expect_grid<scalar::pow_d_nolut<tier::ep>>(pow_oracle, 4);
}

TEST(PowrSpecial, Float) {
  expect_grid<scalar::powr_s<tier::ha>>(powr_oracle, 1);
  expect_grid<scalar::powr_s<tier::la>>(powr_oracle, 4);
  expect_grid<scalar::powr_s<tier::ep>>(powr_oracle, 0x1p12);
  expect_grid<scalar::powr_s_nolut>(powr_oracle, 1);
}

TEST(PowrSpecial, Double) {
  expect_grid<scalar::powr_d<tier::ha>>(powr_oracle, 1);
  expect_grid<scalar::powr_d<tier::la>>(powr_oracle, 4);
  expect_grid<scalar::powr_d<tier::ep>>(powr_oracle, 0x1p26);
  expect_grid<scalar::powr_d_nolut<tier::ha>>(powr_oracle, 1);
  expect_grid<scalar::powr_d_nolut<tier::la>>(powr_oracle, 4);
}

TEST(PowxSpecial, Float) {
  expect_grid<scalar::powx_s<tier::ha>>(pow_oracle, 1);
  expect_grid<scalar::powx_s<tier::la>>(pow_oracle, 4);
  expect_grid<scalar::powx_s<tier::ep>>(pow_oracle, 0x1p12);
  expect_grid<scalar::powx_s_nolut>(pow_oracle, 1);
}

TEST(PowxSpecial, Double) {
  expect_grid<scalar::powx_d<tier::ha>>(pow_oracle, 1);
  expect_grid<scalar::powx_d<tier::la>>(pow_oracle, 4);
  expect_grid<scalar::powx_d<tier::ep>>(pow_oracle, 0x1p26);
  expect_grid<scalar::powx_d_nolut<tier::ha>>(pow_oracle, 1);
  expect_grid<scalar::powx_d_nolut<tier::la>>(pow_oracle, 4);
}

/// Where the tables are surprising.
TEST(PowSpecial, Peculiar) {
  using s = scalar::pow_s<tier::ha>;
  const float inf = std::numeric_limits<float>::infinity();
  expect_number<s>(-0.0f, 3.0f, 0.0f, 0);
  expect_number<s>(-0.0f, -3.0f, -inf, 1);
  expect_number<s>(-0.0f, -2.0f, inf, 1);
  expect_number<s>(0.0f, -inf, inf, 1);
  expect_number<s>(-inf, -3.0f, -0.0f, 0);
  expect_v21<s>(0x3f800000, 0x7fc00000, 0x3f800000, 0);
  expect_v21<s>(0x7fc00000, 0x00000000, 0x3f800000, 0);
  expect_v21<s>(0xc0000000, 0x3f000000, 0xffc00000, 1);
  using d = scalar::pow_d<tier::ha>;
  const double infinity = std::numeric_limits<double>::infinity();
  expect_number<d>(-0.0, 3.0, -0.0, 0);
  expect_number<d>(-0.0, -3.0, -infinity, 1);
  expect_number<d>(-infinity, -3.0, 0.0, 0);
  expect_number<d>(-infinity, 3.0, -infinity, 0);
  using r = scalar::powr_s<tier::la>;
  expect_v21<r>(0x00000000, 0x00000000, 0x7fffffff, 1);
  expect_v21<r>(0x80000000, 0x00000000, 0xffffffff, 1);
  expect_v21<r>(0x80000000, 0x80000000, 0x7fffffff, 1);
  expect_v21<r>(0xbf800000, 0x40000000, 0x7fc00000, 1);
  expect_v21<r>(0xffc00000, 0x00000000, 0x7fc00000, 1);
  expect_v21<r>(0x80000000, 0xc0400000, 0x7f800000, 1);
}

/// Parity where the unit of the format is 1/2, 1 and 2.
TEST(PowSpecial, ParityOfLargeExponents) {
  using scalar::parity;
  using scalar::parity_of;
  for (int k = 0; k < 60; ++k) {
    const double power = std::ldexp(1.0, k);
    EXPECT_EQ(parity_of(power), k == 0 ? parity::odd : parity::even);
    EXPECT_EQ(parity_of(-power), k == 0 ? parity::odd : parity::even);
    if (k > 0 && k < 53) {
      EXPECT_EQ(parity_of(power + 1), parity::odd) << k;
    }
    if (k > 1 && k < 52) {
      EXPECT_EQ(parity_of(power + 0.5), parity::fraction) << k;
      EXPECT_EQ(parity_of(-power - 1.5), parity::fraction) << k;
    }
    if (k > 0 && k < 24) {
      EXPECT_EQ(parity_of(static_cast<float>(power) + 1), parity::odd) << k;
    }
  }
  pattern_source<std::uint64_t> source(71);
  for (int i = 0; i < 20'000; ++i) {
    const double y = std::bit_cast<double>(source.near(0x4180000000000000, 40));
    const parity expected =
        !is_integer(y) ? parity::fraction : (is_odd(y) ? parity::odd : parity::even);
    EXPECT_EQ(parity_of(y), expected) << y;
    const auto narrow = static_cast<float>(y);
    const parity expected_s =
        !is_integer(narrow) ? parity::fraction : (is_odd(narrow) ? parity::odd : parity::even);
    EXPECT_EQ(parity_of(narrow), expected_s) << narrow;
  }
}

/// At half: the float body of `ep` between two conversions, in every tier.
template <typename F, typename Body>
void expect_half() {
  pattern_source<std::uint32_t> source(72);
  for (int i = 0; i < 50'000; ++i) {
    const scalar::binary16 x{static_cast<std::uint16_t>(source.any())};
    const scalar::binary16 y{static_cast<std::uint16_t>(source.any())};
    scalar::binary16 r{0x5aa5};
    std::uint32_t status;
    if constexpr (requires { F::call(&x, &y, &r); }) {
      status = F::call(&x, &y, &r);
    } else {
      status = F::call(&x, y, &r);
    }
    float wide;
    const std::uint32_t expected = call<Body>(scalar::widen(x), scalar::widen(y), &wide);
    EXPECT_EQ(r.pattern, scalar::narrow(wide).pattern) << scalar::widen(x) << scalar::widen(y);
    EXPECT_EQ(status, expected);
  }
}

TEST(PowSpecial, Half) {
  expect_half<scalar::pow_h, scalar::pow_s<tier::ep>>();
  expect_half<scalar::powr_h, scalar::powr_s<tier::ep>>();
  expect_half<scalar::powx_h, scalar::powx_s<tier::ep>>();
}

}  // namespace
