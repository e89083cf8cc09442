// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <algorithm>
#include <cmath>

#include "bits.hpp"
#include "complex_reference.hpp"
#include "scalar/complex/exp.hpp"
#include "scalar/trig/sincos.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::tier;

constexpr std::uint32_t overflow = 4;

template <typename R>
struct bodies;
template <>
struct bodies<float> {
  template <tier t>
  using exp = scalar::exp_c<t>;
};
template <>
struct bodies<double> {
  template <tier t>
  using exp = scalar::exp_z<t>;
};

/// The same result from every tier, the status from la and ha alone.
template <typename R, typename U = part_of<R>>
void expect_all_tiers(std::array<U, 2> z, std::array<U, 2> r, std::uint32_t status = 0,
                      location where = location::current()) {
  using b = bodies<R>;
  expect_v11<typename b::template exp<tier::ha>>(z, r, status, where);
  expect_v11<typename b::template exp<tier::la>>(z, r, status, where);
  expect_v11<typename b::template exp<tier::ep>>(z, r, 0, where);
}

template <typename R>
class ComplexExp : public ::testing::Test {};
using types = ::testing::Types<float, double>;
TYPED_TEST_SUITE(ComplexExp, types);

TYPED_TEST(ComplexExp, Specials) {
  using R = TypeParam;
  using U = part_of<R>;
  using n = named<U>;
  const U inf = n::inf, minus = n::sign, nan = n::any_nan, quiet = n::nan, one = n::one;
  const auto pattern = [](R x) { return std::bit_cast<U>(x); };
  // On the real axis the imaginary part stays, also its sign.
  for (const U im : {U(0), minus}) {
    expect_all_tiers<R>({0, im}, {one, im});
    expect_all_tiers<R>({minus, im}, {one, im});
    expect_all_tiers<R>({inf, im}, {inf, im});
    expect_all_tiers<R>({inf | minus, im}, {0, im});
    expect_all_tiers<R>({quiet, im}, {nan, im});
    expect_all_tiers<R>({pattern(-2000), im}, {0, im});
  }
  // No number for an angle.
  for (const U im : {inf, U(inf | minus), quiet, n::signalling}) {
    expect_all_tiers<R>({0, im}, {nan, nan});
    expect_all_tiers<R>({one, im}, {nan, nan});
    expect_all_tiers<R>({n::largest | minus, im}, {nan, nan});
    expect_all_tiers<R>({quiet, im}, {nan, nan});
    expect_all_tiers<R>({inf, im}, {inf, nan});
    expect_all_tiers<R>({inf | minus, im}, {0, 0});
  }
  // A NaN beside a finite angle.
  expect_all_tiers<R>({quiet, one}, {minus, minus});
  expect_all_tiers<R>({quiet, one | minus}, {0, 0});
  expect_all_tiers<R>({n::signalling, n::largest}, {minus, minus});
  // Infinities and zeros by the quadrant: of 1, 2, 4 and 5.
  const U q1 = pattern(1), q2 = pattern(2), q3 = pattern(4), q4 = pattern(5);
  for (const U re : {inf, U(inf | minus)}) {
    const U r = re == inf ? inf : U(0);
    expect_all_tiers<R>({re, q1}, {r, r});
    expect_all_tiers<R>({re, q2}, {r | minus, r});
    expect_all_tiers<R>({re, q3}, {r | minus, r | minus});
    expect_all_tiers<R>({re, q4}, {r, r | minus});
    expect_all_tiers<R>({re, q1 | minus}, {r, r | minus});
    expect_all_tiers<R>({re, q2 | minus}, {r | minus, r | minus});
  }
}

TYPED_TEST(ComplexExp, OverflowAndUnderflow) {
  using R = TypeParam;
  using U = part_of<R>;
  const U inf = named<U>::inf;
  const auto pattern = [](R x) { return std::bit_cast<U>(x); };
  const auto sign = [](double x) { return std::signbit(x) ? named<U>::sign : U(0); };
  // Up to 1064 the main path at double, beyond the rare one, far beyond a clamped one.
  for (const R x : {R(800), R(1063), R(1065), R(3000), R(1e30)}) {
    for (const double y : {1.0, -2.0, 0x1p30, -0x1p100}) {
      const U re = sign(std::cos(y)), im = sign(std::sin(y)), angle = pattern(static_cast<R>(y));
      expect_all_tiers<R>({pattern(x), angle}, {inf | re, inf | im}, overflow);
      expect_all_tiers<R>({pattern(-x), angle}, {re, im});
    }
  }
}

/// On the real axis an overflow is reported up to 1064 at double, where the main path ends; at
/// float everywhere.
TEST(ComplexExpOverflow, OnTheRealAxis) {
  const auto wide = [](double x) { return std::bit_cast<std::uint64_t>(x); };
  const std::uint64_t inf = named<std::uint64_t>::inf;
  expect_all_tiers<double>({wide(709.0), 0}, {0x7fdd422d2be5dc9b, 0});
  expect_all_tiers<double>({wide(710.0), 0}, {inf, 0}, overflow);
  expect_all_tiers<double>({wide(1063.0), wide(-0.0)}, {inf, wide(-0.0)}, overflow);
  expect_all_tiers<double>({wide(1064.0), 0}, {inf, 0}, 0);
  expect_all_tiers<double>({wide(1e300), wide(-0.0)}, {inf, wide(-0.0)}, 0);
  const auto narrow = [](float x) { return std::bit_cast<std::uint32_t>(x); };
  expect_all_tiers<float>({narrow(89), 0}, {0x7f800000, 0}, overflow);
  expect_all_tiers<float>({narrow(1e30f), 0}, {0x7f800000, 0}, overflow);
}

/// The real part overflows and the imaginary one does not, and is right.
TEST(ComplexExpOverflow, OfOnePart) {
  for (const double x : {715.0, 1000.0, 1063.9, 1070.0, 1400.0}) {
    const std::complex<double> z(x, std::exp(std::min(700 - x, 0.0)));
    complex_reference exact;
    exact.exp(z);
    for (const auto r : {complex_result_of<scalar::exp_z<tier::la>>(z),
                         complex_result_of<scalar::exp_z<tier::ha>>(z)}) {
      EXPECT_TRUE(std::isinf(r.real()));
      EXPECT_LT(r.imag(), 1e308);
      EXPECT_LE(exact.ulps(r), 2.7) << z;
    }
  }
}

/// The stated steps at la, one by one, from the sine and the cosine of sincos.
TEST(ComplexExpSteps, DoubleLa) {
  pattern_source<std::uint64_t> source(40);
  const auto number = [](std::uint64_t p) { return std::bit_cast<double>(p); };
  for (int i = 0; i < 200'000; ++i) {
    const double x = (static_cast<double>(source.below(1u << 30)) / (1 << 30)) * 1770 - 708;
    const double y = number(source.near(named<std::uint64_t>::one, i % 2 == 0 ? 3 : 19));
    const double a = std::fabs(y);
    double sine, cosine;
    scalar::sincos_d<tier::ha>::call(&a, &sine, &cosine);
    const double s = std::fma(x, number(0x3ff71547652b82fe), number(0x43280000000007fe));
    const double n = s - number(0x43280000000007fe);
    const double r =
        std::fma(number(0xbc7abc9e3b39803f), n, std::fma(number(0xbfe62e42fefa39ef), n, x));
    const auto low = static_cast<std::uint32_t>(std::bit_cast<std::uint64_t>(s));
    const std::uint32_t k = ((low + 2) >> 3) & 0x1ffffe00;
    std::uint64_t h = std::uint64_t{(low << 19) - (k << 20)} << 32;
    if ((low & 1) != 0) h ^= 0x000ea09e667f3bcd;
    double p = number(0x3ec722bccc270959);
    for (const std::uint64_t c :
         {0x3efa072e44b58159u, 0x3f2a019f7560fba3u, 0x3f56c16b8144bd5bu, 0x3f811111111ac486u,
          0x3fa55555556228ceu, 0x3fc5555555555462u, 0x3fdffffffffffe76u, 0x3ff0000000000000u}) {
      p = std::fma(p, r, number(c));
    }
    p *= r;
    const double power = number(std::uint64_t{k + 1023} << 52);
    const auto part = [&](double f) {
      const double product = number(h) * f;
      return std::bit_cast<std::uint64_t>(std::fma(product, p, product) * power);
    };
    const std::uint64_t re = part(cosine),
                        im = part(sine) ^ (y < 0 ? named<std::uint64_t>::sign : 0);
    const bool infinite = std::isinf(number(re)) || std::isinf(number(im));
    const std::array<std::uint64_t, 2> z = {std::bit_cast<std::uint64_t>(x),
                                            std::bit_cast<std::uint64_t>(y)};
    ASSERT_TRUE(expect_v11<scalar::exp_z<tier::la>>(z, {re, im}, infinite ? overflow : 0));
    ASSERT_TRUE(expect_v11<scalar::exp_z<tier::ep>>(z, {re, im}, 0));
  }
}

template <typename F>
struct error_of_exp {
  using R = typename F::input_type::value_type;
  complex_reference exact;
  double largest = 0;
  std::complex<R> worst;

  void add(R re, R im) {
    const std::complex<R> z(re, im);
    exact.exp(z);
    const double error = exact.ulps(complex_result_of<F>(z));
    if (error > largest) {
      largest = error;
      worst = z;
    }
  }
};

/// Results of all sizes, denormal and infinite ones too, for angles of all sizes.
template <typename F>
void expect_exp_within(double limit, int count) {
  using R = typename F::input_type::value_type;
  using U = part_of<R>;
  pattern_source<U> source(41);
  error_of_exp<F> error;
  const double range = sizeof(R) == 4 ? 110 : 760;
  const auto uniform = [&source](double bound) {
    return static_cast<R>((static_cast<double>(source.below(1u << 30)) / (1 << 29) - 1) * bound);
  };
  for (int i = 0; i < count; ++i) {
    error.add(uniform(range), uniform(100));
    error.add(uniform(1), std::bit_cast<R>(source.near(named<U>::one, 24)));
    error.add(uniform(range), std::bit_cast<R>(source.finite()));
    error.add(std::bit_cast<R>(source.finite()), std::bit_cast<R>(source.finite()));
    // Near multiples of pi/2, where a part is small.
    const double turn = static_cast<double>(source.below(10'000'000)) * 1.5707963267948966;
    error.add(uniform(range), static_cast<R>(turn));
  }
  // Tiny angles beside overflow.
  for (int e = -1074; e < 0; ++e)
    error.add(static_cast<R>(-0.69 * e), static_cast<R>(std::ldexp(1.3, e)));
  // The ends of the main path.
  for (const double x : {-708.3955078125, -708.395507812499, -708.39551, 1063.9999, 1064.0}) {
    for (const double y : {0x1.fffffffffffffp23, 0x1p24, 1.0, 0x1p-1074, -0x1p24})
      error.add(static_cast<R>(x), static_cast<R>(y));
  }
  EXPECT_LE(error.largest, limit) << error.worst;
  ::testing::Test::RecordProperty("largest_error_ulps", std::to_string(error.largest));
}

TEST(ComplexExpError, Float) { expect_exp_within<scalar::exp_c<tier::la>>(0.61, 30'000); }
TEST(ComplexExpError, DoubleLa) { expect_exp_within<scalar::exp_z<tier::la>>(2.7, 15'000); }
TEST(ComplexExpError, DoubleHa) { expect_exp_within<scalar::exp_z<tier::ha>>(0.9, 15'000); }

/// At float the tiers are one body.
TEST(ComplexExpError, FloatTiersAgree) {
  pattern_source<std::uint32_t> source(42);
  for (int i = 0; i < 100'000; ++i) {
    const std::array<std::uint32_t, 2> z = {source.near(named<std::uint32_t>::one, 8),
                                            source.any()};
    const auto x = element<std::complex<float>>::value(z);
    const auto r =
        element<std::complex<float>>::parts(complex_result_of<scalar::exp_c<tier::la>>(x));
    const auto expected = [](std::uint32_t p) {
      return (p & 0x7fffffff) > 0x7f800000 ? named<std::uint32_t>::any_nan : p;
    };
    const std::array<std::uint32_t, 2> e = {expected(r[0]), expected(r[1])};
    const bool infinite = std::isfinite(x.imag()) && (e[0] == 0x7f800000 || e[0] == 0xff800000 ||
                                                      e[1] == 0x7f800000 || e[1] == 0xff800000);
    ASSERT_TRUE(expect_v11<scalar::exp_c<tier::ha>>(z, e, infinite ? overflow : 0));
    ASSERT_TRUE(expect_v11<scalar::exp_c<tier::ep>>(z, e, 0));
  }
}

}  // namespace
