// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <algorithm>
#include <cmath>

#include "bits.hpp"
#include "quad.hpp"
#include "scalar/complex/div.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

constexpr std::uint32_t overflow = 4;

template <typename R>
struct bodies;
template <>
struct bodies<float> {
  using div = scalar::div_c;
  using div_ep = scalar::div_c_ep;
};
template <>
struct bodies<double> {
  using div = scalar::div_z;
  using div_ep = scalar::div_z_ep;
};

/// Each part within 2^-110 of itself: the numerators are rounded once.
template <typename R>
struct quotient {
  quad re, im;
  quotient(std::complex<R> x, std::complex<R> y) {
    const quad a = x.real(), b = x.imag(), c = y.real(), d = y.imag();
    const quad n = c * c + d * d;
    re = (a * c + b * d) / n;
    im = (b * c - a * d) / n;
  }
};

/// The result for finite operands and a divisor other than 0: each part the rounding of the exact
/// one, but for the last 1e-7 of a unit; code 3 where it overflows. A part that is 0 is +0.
template <typename R>
bool expect_rounded_quotient(std::complex<R> x, std::complex<R> y) {
  std::complex<R> r = unwritten<std::complex<R>>();
  const std::uint32_t status = bodies<R>::div::call(&x, &y, &r);
  const quotient<R> exact(x, y);
  const R re = static_cast<R>(exact.re), im = static_cast<R>(exact.im);
  const auto good_part = [](R part, R rounded, quad of) {
    if (std::isinf(rounded)) return part == rounded;
    if (of == 0) return part == 0 && !std::signbit(part);
    return std::signbit(part) == std::signbit(rounded) && ulps(part, of) <= 0.5000001;
  };
  const std::uint32_t expected = std::isinf(re) || std::isinf(im) ? overflow : 0;
  if (good_part(r.real(), re, exact.re) && good_part(r.imag(), im, exact.im) && status == expected)
    return true;
  ADD_FAILURE() << hex(element<std::complex<R>>::parts(x)) << " over "
                << hex(element<std::complex<R>>::parts(y)) << "\n is "
                << hex(element<std::complex<R>>::parts(r)) << " status " << status << "\n expected "
                << hex(element<std::complex<R>>::parts(std::complex<R>(re, im))) << " status "
                << expected;
  return false;
}

template <typename R>
class ComplexDiv : public ::testing::Test {};
using types = ::testing::Types<float, double>;
TYPED_TEST_SUITE(ComplexDiv, types);

TYPED_TEST(ComplexDiv, SmallNumbers) {
  using R = TypeParam;
  using complex = std::complex<R>;
  const complex x(31, 1), y(5, -7);
  for (const complex p : {complex(0, 0), complex(1, 0), complex(0, 1), x, y}) {
    for (const complex q : {complex(-1, 0), complex(0, -1), complex(3, 0), x, y}) {
      expect_rounded_quotient(p, q);
    }
  }
  complex r;
  EXPECT_EQ(bodies<R>::div::call(&x, &y, &r), 0u);
  EXPECT_EQ(r, complex(2, 3));
  EXPECT_EQ(bodies<R>::div_ep::call(&x, &y, &r), 0u);
  EXPECT_LE(std::abs(r - complex(2, 3)), 8 * std::numeric_limits<R>::epsilon());
}

/// The stated steps at float, one by one.
TEST(ComplexDivSteps, Float) {
  pattern_source<std::uint32_t> source(20);
  for (int i = 0; i < 200'000; ++i) {
    const std::uint32_t e = source.near(named<std::uint32_t>::one, 20);
    const std::array<std::uint32_t, 2> x = {e, source.near(e, 5)};
    const std::array<std::uint32_t, 2> y = {source.near(e, 15), source.near(e, 15)};
    const double a = std::bit_cast<float>(x[0]), b = std::bit_cast<float>(x[1]);
    const double c = std::bit_cast<float>(y[0]), d = std::bit_cast<float>(y[1]);
    const double n = std::fma(c, c, d * d);
    const double re = std::fma(a, c, b * d), im = std::fma(b, c, -(a * d));
    const auto pattern = [](double part) {
      return std::bit_cast<std::uint32_t>(static_cast<float>(part));
    };
    const double q = 1.0 / n;
    ASSERT_TRUE(expect_v21<scalar::div_c>(x, y, {pattern(re * q), pattern(im * q)}));
    const double q_ep = 1.0f / static_cast<float>(n);
    ASSERT_TRUE(expect_v21<scalar::div_c_ep>(x, y, {pattern(re * q_ep), pattern(im * q_ep)}));
  }
}

/// All of the leading bits of bc and ad cancel.
TEST(ComplexDivCancellation, KeepsTheLastBit) {
  const double e = 0x1p-52;
  // ((1 + e) + i)/(1 + (1 - e)i): bc - ad is 1 - (1 + e)(1 - e) = e².
  const std::complex<double> x(1 + e, 1), y(1, 1 - e);
  expect_rounded_quotient(x, y);
  expect_rounded_quotient(x * 0x1p1000, y * 0x1p900);
  expect_rounded_quotient(x * 0x1p-1000, y * 0x1p-700);
  std::complex<double> r;
  EXPECT_EQ(scalar::div_z::call(&x, &y, &r), 0u);
  EXPECT_GT(r.imag(), 0x1p-106);
  EXPECT_LT(r.imag(), 0x1.1p-105);
}

TYPED_TEST(ComplexDiv, OverflowAndZeroDivisors) {
  using R = TypeParam;
  using U = part_of<R>;
  using n = named<U>;
  using div = typename bodies<R>::div;
  using div_ep = typename bodies<R>::div_ep;
  const U one = n::one, inf = n::inf, minus = n::sign, any_nan = n::any_nan;
  // Over zero: each part over the real part of the divisor.
  expect_v21<div>({one, 0}, {0, 0}, {inf, any_nan}, overflow);
  expect_v21<div>({one, one | minus}, {0, 0}, {inf, inf | minus}, overflow);
  expect_v21<div>({one, one | minus}, {minus, 0}, {inf | minus, inf}, overflow);
  expect_v21<div>({0, 0}, {0, minus}, {any_nan, any_nan});
  expect_v21<div>({inf, one}, {0, 0}, {inf, inf}, 0);
  expect_v21<div>({n::nan, one}, {0, 0}, {any_nan, inf}, overflow);
  expect_v21<div>({n::largest, 0}, {1, 0}, {inf, 0}, overflow);
  expect_v21<div>({n::largest, n::largest}, {one / 2, one / 2}, {inf, 0}, overflow);
  // Squares of the divisor that leave the range, quotients that do not.
  expect_v21<div>({n::largest, 0}, {n::largest, 0}, {one, 0});
  expect_v21<div>({1, 1}, {1, 1}, {one, 0});
  expect_rounded_quotient<R>({1, 2},
                             {std::numeric_limits<R>::max(), std::numeric_limits<R>::max()});
  // ep reports nothing.
  expect_v21<div_ep>({one, one | minus}, {0, 0}, {inf, inf | minus}, 0);
  expect_v21<div_ep>({n::largest, 0}, {1, 0}, {inf, 0}, 0);
}

/// ep at float does not scale the square of the divisor: it overflows from |y| = 2^64 on, and its
/// reciprocal does below 2^-64, where the quotient is repaired.
TEST(ComplexDivEp, SquareOutOfRange) {
  constexpr std::uint32_t one = 0x3f800000;
  const auto power = [](int e) { return static_cast<std::uint32_t>(127 + e) << 23; };
  expect_v21<scalar::div_c_ep>({power(64), power(63)}, {power(64), 0}, {0, 0});
  expect_v21<scalar::div_c_ep>({power(63), 0}, {power(63), 0}, {one, 0});
  expect_v21<scalar::div_c_ep>({power(-64), 0}, {power(-64), 0}, {one, 0});
  expect_v21<scalar::div_c_ep>({power(-70), power(-69)}, {power(-70), 0}, {one, power(1)});
  expect_v21<scalar::div_c_ep>({power(-100), power(-99)}, {0, power(-100)},
                               {power(1), one | 0x80000000});
}

TYPED_TEST(ComplexDiv, SpecialOperands) {
  using U = part_of<TypeParam>;
  using n = named<U>;
  const U one = n::one, inf = n::inf, minus = n::sign, nan = n::nan, any_nan = n::any_nan;
  const U two = one + n::smallest_normal;
  const auto both = [](std::array<U, 2> x, std::array<U, 2> y, std::array<U, 2> r,
                       location where = location::current()) {
    expect_v21<typename bodies<TypeParam>::div>(x, y, r, 0, where);
    expect_v21<typename bodies<TypeParam>::div_ep>(x, y, r, 0, where);
  };
  both({inf, 0}, {one, 0}, {inf, any_nan});
  both({inf, 0}, {one, two}, {inf, inf | minus});
  both({one, inf | minus}, {two, one}, {inf | minus, inf | minus});
  both({inf, nan}, {two, one}, {inf, inf | minus});
  both({one, two}, {inf, 0}, {0, 0});
  both({one, two}, {inf | minus, one}, {minus, minus});
  both({one, two}, {nan, inf}, {0, minus});
  // Parts that would overflow beside the boxed divisor.
  both({n::largest, n::largest}, {inf, inf}, {0, 0});
  both({inf, 0}, {inf, 0}, {any_nan, any_nan});
  both({inf, 0}, {one, nan}, {any_nan, any_nan});
  both({nan, one}, {inf, one}, {any_nan, any_nan});
  both({nan, one}, {two, one}, {any_nan, any_nan});
  both({one, one}, {nan, 0}, {any_nan, any_nan});
  both({0, 0}, {nan, nan}, {any_nan, any_nan});
}

/// The division that the compiler's run-time library does for C99, as a reference for what is
/// infinite, zero or a NaN, and for the signs. C99 recovers only where both parts are NaNs, the
/// bodies also where one is infinite: there the other part may be a NaN in one of the two.
TYPED_TEST(ComplexDiv, SpecialsAsInC99) {
  using R = TypeParam;
  using complex = std::complex<R>;
  const R inf = std::numeric_limits<R>::infinity(), nan = std::numeric_limits<R>::quiet_NaN();
  const R parts[] = {0, -R(0), 1, -2, inf, -inf, nan, -nan};
  const auto is_infinite = [](complex z) { return std::isinf(z.real()) || std::isinf(z.imag()); };
  const auto is_finite = [](complex z) {
    return std::isfinite(z.real()) && std::isfinite(z.imag());
  };
  for (const R a : parts) {
    for (const R b : parts) {
      for (const R c : parts) {
        for (const R d : parts) {
          const complex x(a, b), y(c, d);
          const complex reference = x / y;
          complex r, ep;
          const std::uint32_t status = bodies<R>::div::call(&x, &y, &r);
          EXPECT_EQ(bodies<R>::div_ep::call(&x, &y, &ep), 0u);
          EXPECT_EQ(status, is_infinite(r) && !is_infinite(x) ? overflow : 0u) << x << y;
          ASSERT_EQ(is_infinite(r), is_infinite(reference)) << x << y << r << reference;
          for (int part = 0; part < 2; ++part) {
            const R p = part == 0 ? r.real() : r.imag();
            const R of = part == 0 ? reference.real() : reference.imag();
            const R q = part == 0 ? ep.real() : ep.imag();
            if (is_infinite(r)) {
              ASSERT_TRUE(std::isnan(p) || std::isnan(of) || p == of) << x << y << r << reference;
              ASSERT_TRUE(std::isnan(p) ? std::isnan(q) : p == q) << x << y << r << ep;
            } else if (std::isnan(of)) {
              ASSERT_TRUE(std::isnan(p) && std::isnan(q)) << x << y << r << ep;
            } else {
              ASSERT_NEAR(p, of, std::numeric_limits<R>::epsilon());
              ASSERT_NEAR(q, of, 2 * std::numeric_limits<R>::epsilon());
              // Zeros by the sign of the product with the boxed divisor.
              const R c_box = std::isinf(c) ? std::copysign(R(1), c) : R(0);
              const R d_box = std::isinf(d) ? std::copysign(R(1), d) : R(0);
              const R product = part == 0 ? a * c_box + b * d_box : b * c_box - a * d_box;
              if (is_finite(x) && is_infinite(y) && product != 0) {
                ASSERT_EQ(std::signbit(p), product < 0) << x << y << r;
                ASSERT_EQ(std::signbit(p), std::signbit(of)) << x << y << r << reference;
              }
            }
          }
        }
      }
    }
  }
}

template <typename R>
std::complex<R> number(part_of<R> re, part_of<R> im) {
  return {std::bit_cast<R>(re), std::bit_cast<R>(im)};
}

template <typename R>
void expect_random_quotients(int count) {
  using U = part_of<R>;
  pattern_source<U> source(21);
  const U one = named<U>::one;
  const int middle = sizeof(R) == 4 ? 40 : 400;
  for (int i = 0; i < count; ++i) {
    const U a = source.finite(), b = source.finite(), c = source.finite(), d = source.finite();
    ASSERT_TRUE(expect_rounded_quotient(number<R>(a, b), number<R>(c, d)));
    // Parts of like size.
    const U e = source.near(one, middle), f = source.near(e, 2);
    const U g = source.near(one, middle), h = source.near(g, 2);
    ASSERT_TRUE(expect_rounded_quotient(number<R>(e, f), number<R>(g, h)));
    // Cancellation in either part: bd is -ac, or bc is ad, but for a few units in the last place.
    const U k = static_cast<U>(source.below(5)) - 2;
    ASSERT_TRUE(expect_rounded_quotient(number<R>(e, g + k), number<R>(g, e ^ named<U>::sign)));
    ASSERT_TRUE(expect_rounded_quotient(number<R>(e, g + k), number<R>(e, g)));
    // Quotients at the lower edge: denormal results.
    const U p = source.near(named<U>::smallest_normal, 60), q = source.near(one, 40);
    ASSERT_TRUE(expect_rounded_quotient(number<R>(p, 0), number<R>(q, 0)));
    ASSERT_TRUE(expect_rounded_quotient(number<R>(p, source.near(p, 3)), number<R>(q, h)));
  }
}

TYPED_TEST(ComplexDiv, RandomQuotients) { expect_random_quotients<TypeParam>(20'000); }

/// The screen's bounds and their neighbours, and the edges of the exponent range.
TEST(ComplexDivScreen, Bounds) {
  std::vector<double> list;
  for (const std::uint64_t edge :
       {std::uint64_t{0x2340000000000000}, std::uint64_t{0x5d6306fd00000000},
        std::uint64_t{0x5d6306fe00000000}, std::uint64_t{0x0010000000000000}}) {
    for (int step = -2; step <= 2; ++step) {
      list.push_back(std::bit_cast<double>(edge + static_cast<std::uint64_t>(step)));
    }
  }
  list.insert(list.end(), {0.0, 0x1p-1074, 0x1.fffffffffffffp1023, 1.0, -0x1.8p300});
  for (const double a : list) {
    for (const double b : list) {
      for (const double c : list) {
        for (const double d : list) {
          if (c == 0 && d == 0) continue;
          ASSERT_TRUE(expect_rounded_quotient<double>({a, b}, {c, d}));
        }
      }
    }
  }
}

/// ep: near in the sense of the whole number, within 2^-22 or 2^-50.5 of it; at double for operands
/// of every size, at float where the square of the divisor has a normal reciprocal.
TYPED_TEST(ComplexDiv, EpIsNearByNorm) {
  using R = TypeParam;
  using U = part_of<R>;
  pattern_source<U> source(22);
  const double bound = sizeof(R) == 4 ? 0x1p-22 : 0x1.6ap-51;
  const int span = sizeof(R) == 4 ? 60 : 1000;
  double largest = 0;
  for (int i = 0; i < 100'000; ++i) {
    const U e = source.near(named<U>::one, span), g = source.near(named<U>::one, span);
    const auto x = number<R>(e, source.near(e, 4)), y = number<R>(g, source.near(g, 2));
    const quotient<R> exact(x, y);
    const quad re = exact.re < 0 ? -exact.re : exact.re;
    const quad im = exact.im < 0 ? -exact.im : exact.im;
    const quad norm = std::max(re, im);
    const int limit = std::numeric_limits<R>::max_exponent - 2;
    if (norm > std::ldexp(1.0L, limit) || norm < std::ldexp(1.0L, 60 - limit)) continue;
    std::complex<R> r;
    ASSERT_EQ(bodies<R>::div_ep::call(&x, &y, &r), 0u);
    const double error = std::hypot(static_cast<double>((r.real() - exact.re) / norm),
                                    static_cast<double>((r.imag() - exact.im) / norm));
    const double of = std::hypot(static_cast<double>(re / norm), static_cast<double>(im / norm));
    largest = std::max(largest, error / of);
    ASSERT_LE(error, bound * of) << x << y << r;
  }
  this->RecordProperty("largest_error_epsilons",
                       std::to_string(largest / std::numeric_limits<R>::epsilon()));
}

/// At float each part of ep is near, also where it cancels.
TEST(ComplexDivEp, FloatPartsAreNear) {
  pattern_source<std::uint32_t> source(23);
  double largest = 0;
  for (int i = 0; i < 200'000; ++i) {
    const std::uint32_t e = source.near(named<std::uint32_t>::one, 20);
    const std::uint32_t g = source.near(named<std::uint32_t>::one, 20);
    const auto y = number<float>(g, source.near(g, 2));
    const auto x = number<float>(e, source.near(e, 4));
    const quotient<float> exact(x, y);
    std::complex<float> r;
    ASSERT_EQ(scalar::div_c_ep::call(&x, &y, &r), 0u);
    largest = std::max({largest, ulps(r.real(), exact.re), ulps(r.imag(), exact.im)});
  }
  EXPECT_LE(largest, 2.5);
  EXPECT_GE(largest, 1.0);
  RecordProperty("largest_error_ulps", std::to_string(largest));
}

template <typename R>
class SlowComplexDiv : public ::testing::Test {};
TYPED_TEST_SUITE(SlowComplexDiv, types);

TYPED_TEST(SlowComplexDiv, RandomQuotients) { expect_random_quotients<TypeParam>(1'000'000); }

}  // namespace
