// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <algorithm>
#include <cmath>

#include "bits.hpp"
#include "complex_reference.hpp"
#include "scalar/complex/ln.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::tier;

template <typename F>
class ComplexLn : public ::testing::Test {};
using bodies = ::testing::Types<scalar::ln_c, scalar::ln_z<tier::la>, scalar::ln_z<tier::ha>>;
TYPED_TEST_SUITE(ComplexLn, bodies);

template <typename R>
struct angles;
template <>
struct angles<float> {
  static constexpr std::uint32_t quarter = 0x3f490fdb, half = 0x3fc90fdb,
                                 three_quarters = 0x4016cbe4, whole = 0x40490fdb;
};
template <>
struct angles<double> {
  static constexpr std::uint64_t quarter = 0x3fe921fb54442d18, half = 0x3ff921fb54442d18,
                                 three_quarters = 0x4002d97c7f3321d2, whole = 0x400921fb54442d18;
};

template <typename F>
using real_of = typename F::input_type::value_type;

TYPED_TEST(ComplexLn, Specials) {
  using F = TypeParam;
  using R = real_of<F>;
  using U = part_of<R>;
  using n = named<U>;
  using angle = angles<R>;
  const U inf = n::inf, minus = n::sign, nan = n::any_nan;
  for (const U sign : {U(0), minus}) {
    // Zeros have a logarithm without a status.
    expect_v11<F>({0, sign}, {inf | minus, sign});
    expect_v11<F>({minus, sign}, {inf | minus, angle::whole | sign});
    expect_v11<F>({inf, inf | sign}, {inf, angle::quarter | sign});
    expect_v11<F>({inf | minus, inf | sign}, {inf, angle::three_quarters | sign});
    for (const U other : notable_patterns<U>()) {
      const U magnitude = other & ~minus;
      if (magnitude < inf) {
        expect_v11<F>({other, inf | sign}, {inf, angle::half | sign});
        expect_v11<F>({inf, other}, {inf, other & minus});
        expect_v11<F>({inf | minus, other}, {inf, angle::whole | (other & minus)});
        expect_v11<F>({other, n::nan | sign}, {nan, nan});
        expect_v11<F>({n::nan | sign, other}, {nan, nan});
      } else if (magnitude > inf) {
        expect_v11<F>({inf | sign, other}, {inf, nan});
        expect_v11<F>({other, inf | sign}, {inf, nan});
        expect_v11<F>({other, other}, {nan, nan});
      }
    }
  }
}

TYPED_TEST(ComplexLn, Axes) {
  using F = TypeParam;
  using R = real_of<F>;
  using U = part_of<R>;
  using n = named<U>;
  using angle = angles<R>;
  const U one = n::one, minus = n::sign;
  const U ln2 = sizeof(R) == 4 ? static_cast<U>(0x3f317218) : static_cast<U>(0x3fe62e42fefa39ef);
  for (const U sign : {U(0), minus}) {
    expect_v11<F>({one, sign}, {0, sign});
    expect_v11<F>({one | minus, sign}, {0, angle::whole | sign});
    expect_v11<F>({0, one | sign}, {0, angle::half | sign});
    expect_v11<F>({minus, one | sign}, {0, angle::half | sign});
    expect_v11<F>({one + n::smallest_normal, sign}, {ln2, sign});
    expect_v11<F>({0, (one - n::smallest_normal) | sign}, {ln2 | minus, angle::half | sign});
    // The diagonals.
    const R y = std::bit_cast<R>(one | sign);
    const auto right = complex_result_of<F>({1, y}), left = complex_result_of<F>({-1, y});
    EXPECT_EQ(std::bit_cast<U>(right.imag()), angle::quarter | sign);
    EXPECT_EQ(std::bit_cast<U>(left.imag()), angle::three_quarters | sign);
    EXPECT_EQ(right.real(), left.real());
  }
}

template <typename F>
struct error_of_ln {
  using R = real_of<F>;
  complex_reference exact;
  double largest = 0;
  std::complex<R> worst;

  void add(R re, R im) {
    const std::complex<R> z(re, im);
    if (re == 0 && im == 0) return;
    exact.ln(z);
    const double error = exact.ulps(complex_result_of<F>(z));
    if (error > largest) {
      largest = error;
      worst = z;
    }
  }
};

template <typename F>
constexpr double limit = std::is_same_v<F, scalar::ln_c>             ? 0.55
                         : std::is_same_v<F, scalar::ln_z<tier::la>> ? 3
                                                                     : 0.8;

TYPED_TEST(ComplexLn, Error) {
  using F = TypeParam;
  using R = real_of<F>;
  using U = part_of<R>;
  pattern_source<U> source(50);
  error_of_ln<F> error;
  const U small = named<U>::smallest_normal - 1, sign = named<U>::sign;
  for (int i = 0; i < 10'000; ++i) {
    const U a = source.finite(), b = source.near(named<U>::one, 2);
    error.add(std::bit_cast<R>(a), std::bit_cast<R>(source.finite()));
    error.add(std::bit_cast<R>(a), std::bit_cast<R>(source.near(a, i % 32)));
    error.add(std::bit_cast<R>(b), std::bit_cast<R>(source.near(b, 2)));
    error.add(std::bit_cast<R>(a & (small | sign)),
              std::bit_cast<R>(source.any() & (small | sign)));
    error.add(std::bit_cast<R>(b), std::bit_cast<R>(source.any() & (small | sign)));
  }
  EXPECT_LE(error.largest, limit<F>) << error.worst;
  this->RecordProperty("largest_error_ulps", std::to_string(error.largest));
}

/// On the unit circle and beside it the real part is far below the rounding errors of the squares.
TYPED_TEST(ComplexLn, ErrorAtTheUnitCircle) {
  using F = TypeParam;
  using R = real_of<F>;
  using U = part_of<R>;
  pattern_source<U> source(51);
  error_of_ln<F> error;
  for (int i = 0; i < 15'000; ++i) {
    const double angle = static_cast<double>(source.below(1u << 30)) * 0x1p-27;
    const double radius =
        i % 2 == 0 ? 1 : 1 + static_cast<double>(source.below(2001)) * 1e-9 - 1e-6;
    error.add(static_cast<R>(radius * std::cos(angle)), static_cast<R>(radius * std::sin(angle)));
    const U tiny = source.near(static_cast<U>(named<U>::one / 2 + 1), sizeof(R) == 4 ? 40 : 400);
    const U one = named<U>::one + static_cast<U>(source.below(9)) - 4;
    error.add(std::bit_cast<R>(one), std::bit_cast<R>(tiny));
    error.add(std::bit_cast<R>(tiny), std::bit_cast<R>(one | named<U>::sign));
  }
  EXPECT_LE(error.largest, limit<F>) << error.worst;
}

/// The ends of the main path, and the larger parts whose ratio to the smaller one is denormal.
TYPED_TEST(ComplexLn, ErrorAtTheEdges) {
  using F = TypeParam;
  using R = real_of<F>;
  using U = part_of<R>;
  error_of_ln<F> error;
  std::vector<U> edges = notable_patterns<U>();
  if constexpr (sizeof(R) == 8) {
    for (const std::uint64_t edge : {0x7fd0000000000000u, 0x7fc0000000000000u, 0x0010000000000000u,
                                     0x07b0000000000000u, 0x40a0000000000000u}) {
      edges.insert(edges.end(), {edge - 1, edge, edge + 1});
    }
  }
  for (const U a : edges) {
    for (const U b : edges) {
      if ((a & ~named<U>::sign) >= named<U>::inf || (b & ~named<U>::sign) >= named<U>::inf)
        continue;
      error.add(std::bit_cast<R>(a), std::bit_cast<R>(b));
    }
  }
  EXPECT_LE(error.largest, limit<F>) << error.worst;
}

/// The stated steps of the angle at la, one by one.
TEST(ComplexLnSteps, AngleAtLa) {
  pattern_source<std::uint64_t> source(52);
  const auto number = [](std::uint64_t p) { return std::bit_cast<double>(p); };
  for (int i = 0; i < 100'000; ++i) {
    const std::uint64_t re = source.near(named<std::uint64_t>::one, 300);
    const std::uint64_t im = source.near(re, i % 60);
    const double x = number(re), y = number(im);
    const bool swapped = std::fabs(x) < std::fabs(y);
    double b =
        (swapped ? number(0x3ff921fb54442d18) : 0) - (x < 0 ? number(0x400921fb54442d18) : 0);
    if (swapped) b = -b;
    int e;
    const double m = 2 * std::frexp(std::max(std::fabs(x), std::fabs(y)), &e);
    const double smaller = std::ldexp(std::min(std::fabs(x), std::fabs(y)), 1 - e);
    const double r0 = 1.0f / static_cast<float>(m);
    const double c = std::fma(-m, r0, 1.0);
    const double q = std::fma(smaller, r0, (smaller * r0) * std::fma(c, c, c));
    const double z = q * q;
    double p = number(0xbef569394e296094);
    for (const std::uint64_t k :
         {0x3f2d6c9e8bb2574au, 0xbf532c3371b8654bu, 0x3f6fb727ba0e2b22u, 0xbf82dd4cbf264d6du,
          0x3f916b3381f008acu, 0xbf9a79f3da7a18b1u, 0x3fa173db1d2d182au, 0xbfa4f587a1285370u,
          0x3fa7eeaa84db2a13u, 0xbfaad343d329f13eu, 0x3fae1783d68e7b15u, 0xbfb1108994449af6u,
          0x3fb3b12b10aa6c1eu, 0xbfb745d01d48a5edu, 0x3fbc71c7093d8e06u, 0xbfc2492491f4cbc4u,
          0x3fc99999999810dau, 0xbfd55555555553eau, 0xbc7bf826fb4d7dfau}) {
      p = std::fma(p, z, number(k));
    }
    double angle = std::fma(p, q, q) + b;
    if (x < 0) angle = -angle;
    if (swapped) angle = -angle;
    if (y < 0) angle = -angle;
    const auto r = complex_result_of<scalar::ln_z<tier::la>>({x, y});
    ASSERT_EQ(r.imag(), angle) << hex(std::array{re, im});
  }
}

/// The coefficients that are given: of the lowest powers of (ln(1 + t)/2 - t/2)/t.
TEST(ComplexLnConstants, GivenCoefficients) {
  EXPECT_EQ(scalar::half_log1p_low[7], 0xbfc0000000006621u);
  EXPECT_EQ(scalar::half_log1p_low[8], 0x3fc5555555555896u);
  EXPECT_EQ(scalar::half_log1p_low[9], 0xbfcfffffffffffb0u);
  EXPECT_EQ(scalar::half_log1p_low[10], 0xbc7c6f043d7aa41fu);
}

}  // namespace
