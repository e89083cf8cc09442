// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The rare paths of the powers: their errors, and results at both ends of the formats.

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

constexpr std::uint32_t over = 4, under = 8;

/// The C library's power in the widest format, within an ulp of it.
template <typename T>
long double reference(T x, T y) {
  return std::pow(static_cast<long double>(x), static_cast<long double>(y));
}

/// The distance in units in the last place that T has at `exact`, of its denormals too. An infinity
/// counts as the power of two that follows the largest number.
template <typename T>
double error_of(T result, long double exact) {
  using limits = std::numeric_limits<T>;
  const int exponent = std::max(std::ilogb(exact), limits::min_exponent - 1);
  const long double unit = std::ldexp(1.0L, exponent - limits::digits + 1);
  const long double number = std::isinf(result) ? std::ldexp(1.0L, limits::max_exponent)
                                                : static_cast<long double>(result);
  return static_cast<double>(std::fabs(number - exact) / unit);
}

/// Bases: any positive number, next to 1, denormal.
enum class bases { any, near_one, denormal };

template <typename T>
T base_of(bases kind, pattern_source<part_of<T>>& source) {
  using U = part_of<T>;
  using n = named<U>;
  constexpr int digits = std::numeric_limits<T>::digits;
  const U any = source.finite() & ~n::sign;
  if (kind == bases::near_one) {
    const int shift = static_cast<int>(source.below(static_cast<std::uint64_t>(digits - 1)));
    const U distance = (any & ((U(1) << (digits - 1)) - 1)) >> shift;
    return element<T>::value(source.below(2) == 0 ? n::one + distance : n::one - distance);
  }
  if (kind == bases::denormal) {
    const int shift = static_cast<int>(source.below(static_cast<std::uint64_t>(digits - 2)));
    return element<T>::value((any & ((U(1) << (digits - 1)) - 1)) >> shift);
  }
  return element<T>::value(any);
}

/// Exponents for which y·log2 x is anything in ±range, often close to either end or tiny.
template <typename T>
T exponent_of(T x, double range, pattern_source<part_of<T>>& source) {
  double p = range * (static_cast<double>(source.below(2'000'001)) * 1e-6 - 1);
  const std::uint64_t kind = source.below(4);
  if (kind == 0) p = std::copysign(range * 0.9 + std::fabs(p) * 0.1, p);
  if (kind == 1) p = std::ldexp(p, -static_cast<int>(source.below(40)));
  return static_cast<T>(p / std::log2(static_cast<double>(x)));
}

template <typename Path, typename T>
void expect_within(double limit, double range, std::uint64_t stream) {
  pattern_source<part_of<T>> source(stream);
  double worst = 0;
  T worst_x = 0, worst_y = 0;
  for (const bases kind : {bases::any, bases::near_one, bases::denormal}) {
    for (int i = 0; i < 40'000; ++i) {
      const T x = base_of<T>(kind, source);
      if (x == 0 || x == 1) continue;
      const T y = exponent_of(x, range, source);
      if (y == 0 || !std::isfinite(y)) continue;
      T r = unwritten<T>();
      const std::uint32_t status = Path::of(x, y, 0, &r);
      if constexpr (sizeof(T) == 4) {
        EXPECT_EQ(status, std::isinf(r) ? over : (r == 0 ? under : 0u)) << x << ' ' << y;
      } else {
        EXPECT_EQ(status, 0u) << x << ' ' << y;
      }
      const long double exact = reference(x, y);
      if (exact >= std::ldexp(1.0L, std::numeric_limits<T>::max_exponent)) {
        EXPECT_TRUE(std::isinf(r)) << x << ' ' << y;
        continue;
      }
      const double error = error_of(r, exact);
      if (!(error <= worst)) {
        worst = error;
        worst_x = x;
        worst_y = y;
      }
    }
  }
  EXPECT_LE(worst, limit) << std::hexfloat << worst_x << ' ' << worst_y;
  EXPECT_GT(worst, 0.45);
}

TEST(PowRare, Errors) {
  expect_within<scalar::fixed_point_power, float>(0.514, 160, 81);
  expect_within<scalar::two_stage_power, float>(0.55, 160, 82);
  expect_within<scalar::careful_power_s, float>(0.501, 160, 83);
  expect_within<scalar::careful_power_d, double>(0.53, 1090, 84);
}

/// Powers of 2 and 1/2 over all exponents of the results, whole and halfway between two denormals,
/// which are exact.
TEST(PowRare, PowersOfTwo) {
  for (int k = -1080; k <= 1030; ++k) {
    const double y = k;
    const double exact = std::ldexp(1.0, k);
    expect_number<scalar::pow_d<tier::ha>>(2.0, y, exact, 0);
    expect_number<scalar::pow_d<tier::la>>(2.0, y, exact, 0);
    expect_number<scalar::pow_d<tier::ha>>(0.5, -y, exact, 0);
    expect_number<scalar::pow_d<tier::ha>>(-2.0, y, k % 2 == 0 ? exact : -exact, 0);
    double r = unwritten<double>();
    EXPECT_EQ(scalar::careful_power_d::of(2.0, k == 0 ? 1e-30 : y, 0, &r), 0u);
    EXPECT_EQ(r, exact) << k;
  }
  for (int k = -152; k <= 130; ++k) {
    const auto y = static_cast<float>(k);
    const float exact = std::ldexp(1.0f, k);
    const std::uint32_t status = k >= 128 ? over : (k < -149 ? under : 0);
    // Half of the smallest denormal is a tie, which the integer path rounds away from zero.
    const bool tie = k == -150;
    const std::uint32_t bits_ha = tie ? 1 : std::bit_cast<std::uint32_t>(exact);
    expect_v21<scalar::pow_s<tier::ha>>(0x40000000, std::bit_cast<std::uint32_t>(y), bits_ha,
                                        tie ? 0 : status);
    expect_v21<scalar::pow_s<tier::ha>>(0xc0000000, std::bit_cast<std::uint32_t>(y),
                                        bits_ha | (k % 2 == 0 ? 0 : named<std::uint32_t>::sign),
                                        tie ? 0 : status);
    if (k == 0) continue;
    for (const auto path : {scalar::two_stage_power::of, scalar::careful_power_s::of}) {
      float r = unwritten<float>();
      EXPECT_EQ(path(2.0f, y, 0, &r), status) << k;
      EXPECT_EQ(r, exact) << k;
    }
  }
}

/// The last finite results, the first infinite ones, and how far those have no status at double.
TEST(PowRare, Overflow) {
  const double inf = std::numeric_limits<double>::infinity();
  using d = scalar::pow_d<tier::ha>;
  const double below = std::nextafter(1024.0, 0.0);
  for (const double y : {1023.5, 1023.996, 1023.9999, 1024 - 0x1p-30, below}) {
    double r;
    const double x = 2;
    EXPECT_EQ(d::call(&x, &y, &r), 0u);
    EXPECT_TRUE(std::isfinite(r)) << y;
    EXPECT_LE(error_of(r, reference(x, y)), 0.53) << y;
  }
  expect_number<d>(2.0, 1024.0, inf, 0);
  expect_number<d>(2.0, std::nextafter(2048.0, 0.0), inf, 0);
  expect_number<d>(2.0, 2048.0, inf, over);
  expect_number<d>(-2.0, 2049.0, -inf, over);
  expect_number<d>(2.0, -2048.0, 0.0, 0);
  expect_number<d>(-2.0, -2049.0, -0.0, 0);
  expect_number<d>(0.5, -2048.0, inf, over);
  expect_number<d>(2.0, 1e300, inf, over);
  expect_number<d>(1 + 0x1p-52, 1e300, inf, over);
  expect_number<d>(1 - 0x1p-53, 1e300, 0.0, 0);
  expect_number<d>(1.7976931348623157e308, 2.0, inf, over);
  expect_number<d>(1.7976931348623157e308, 1.0, 1.7976931348623157e308, 0);

  const float infinity = std::numeric_limits<float>::infinity();
  const float largest = std::numeric_limits<float>::max();
  using s = scalar::pow_s<tier::ha>;
  expect_number<s>(2.0f, 128.0f, infinity, over);
  expect_number<s>(2.0f, std::nextafter(128.0f, 0.0f), 0x1.ffff4ep127f, 0);
  expect_number<s>(largest, 1.0f, largest, 0);
  expect_number<s>(-largest, 1.0f, -largest, 0);
  expect_number<s>(largest, 1.0000001f, infinity, over);
  expect_number<s>(-2.0f, 129.0f, -infinity, over);
  expect_number<s>(1.0000001f, 3e38f, infinity, over);
  expect_number<s>(0.99999994f, 3e38f, 0.0f, under);
}

/// Where the result is next to 1 whatever the base, and where it is the base itself.
TEST(PowRare, TinyExponents) {
  for (const double x : {0x1p-1074, 0x1p-1060, 3e-310}) {
    expect_number<scalar::pow_d<tier::ha>>(x, 1e-300, 1.0, 0);
    expect_number<scalar::pow_d<tier::la>>(x, -0x1p-1074, 1.0, 0);
    expect_number<scalar::pow_d<tier::ha>>(x, 1.0, x, 0);
    expect_number<scalar::pow_d<tier::ha>>(-x, 1.0, -x, 0);
    expect_number<scalar::powr_d<tier::ha>>(x, 1.0, x, 0);
  }
  for (const float x : {0x1p-149f, 0x1p-140f, 0x1.123p-130f}) {
    expect_number<scalar::pow_s<tier::ha>>(x, 1e-40f, 1.0f, 0);
    expect_number<scalar::pow_s<tier::ha>>(x, -0x1p-149f, 1.0f, 0);
    expect_number<scalar::pow_s<tier::ep>>(x, 1e-40f, 1.0f, 0);
    expect_number<scalar::pow_s<tier::ha>>(x, 1.0f, x, 0);
    expect_number<scalar::pow_s<tier::la>>(-x, 1.0f, -x, 0);
    expect_number<scalar::pow_s<tier::ep>>(x, 1.0f, x, 0);
    expect_number<scalar::powr_s_nolut>(x, 1.0f, x, 0);
  }
  float r = unwritten<float>();
  EXPECT_EQ(scalar::fixed_point_power::of(1.0f, 3e38f, 0, &r), 0u);
  EXPECT_EQ(r, 1.0f);
}

/// Denormal results of double have no status, to the last one, and are rounded once.
TEST(PowRare, DenormalResults) {
  pattern_source<std::uint64_t> source(85);
  double worst = 0;
  for (int i = 0; i < 20'000; ++i) {
    const double x = base_of<double>(bases::any, source);
    const double p = -1022 - static_cast<double>(source.below(53'000)) * 1e-3;
    const double y = p / std::log2(x);
    double r = unwritten<double>();
    EXPECT_EQ((scalar::pow_d<tier::la>::call(&x, &y, &r)), 0u);
    worst = std::max(worst, error_of(r, reference(x, y)));
  }
  EXPECT_LE(worst, 0.53);
}

/// The band of the table-free float body in which the scale comes in two factors: its own values
/// and no status, from the last normal ones on.
TEST(PowRare, BandOfTheTableFreeBody) {
  using f = scalar::pow_s_nolut;
  int denormal = 0;
  for (float p = 126.0f; p < 126.75f; p += 0x1p-10f) {
    for (const float y : {p, -p}) {
      const float x = 2.0f;
      float r = unwritten<float>();
      EXPECT_EQ(f::call(&x, &y, &r), 0u) << y;
      EXPECT_LE(error_of(r, reference(x, y)), 1.3) << y;
      denormal += std::fpclassify(r) == FP_SUBNORMAL ? 1 : 0;
    }
  }
  EXPECT_GT(denormal, 700);
}

}  // namespace
