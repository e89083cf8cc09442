// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <algorithm>
#include <cmath>

#include "bits.hpp"
#include "quad.hpp"
#include "scalar/complex/mul.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

constexpr std::uint32_t overflow = 4;

template <typename R>
struct bodies;
template <>
struct bodies<float> {
  using mul = scalar::mul_c;
  using mul_ep = scalar::mul_c_ep;
};
template <>
struct bodies<double> {
  using mul = scalar::mul_z;
  using mul_ep = scalar::mul_z_ep;
};

template <typename R>
struct product {
  quad re, im;
  product(std::complex<R> x, std::complex<R> y) {
    const quad a = x.real(), b = x.imag(), c = y.real(), d = y.imag();
    re = a * c - b * d;
    im = b * c + a * d;
  }
};

/// The result for finite operands: each part the rounding of the exact one, but for the last 1e-7
/// of a unit; code 3 where it overflows.
template <typename R>
bool expect_rounded_product(std::complex<R> x, std::complex<R> y) {
  std::complex<R> r = unwritten<std::complex<R>>();
  const std::uint32_t status = bodies<R>::mul::call(&x, &y, &r);
  const product<R> exact(x, y);
  const R re = static_cast<R>(exact.re), im = static_cast<R>(exact.im);
  const auto good_part = [](R part, R rounded, quad of) {
    if (std::isinf(rounded)) return part == rounded;
    if (of == 0) return part == 0;
    return std::signbit(part) == std::signbit(rounded) && ulps(part, of) <= 0.5000001;
  };
  const std::uint32_t expected = std::isinf(re) || std::isinf(im) ? overflow : 0;
  if (good_part(r.real(), re, exact.re) && good_part(r.imag(), im, exact.im) && status == expected)
    return true;
  ADD_FAILURE() << hex(element<std::complex<R>>::parts(x)) << " times "
                << hex(element<std::complex<R>>::parts(y)) << "\n is "
                << hex(element<std::complex<R>>::parts(r)) << " status " << status << "\n expected "
                << hex(element<std::complex<R>>::parts(std::complex<R>(re, im))) << " status "
                << expected;
  return false;
}

template <typename R>
class ComplexMul : public ::testing::Test {};
using types = ::testing::Types<float, double>;
TYPED_TEST_SUITE(ComplexMul, types);

TYPED_TEST(ComplexMul, SmallNumbers) {
  using R = TypeParam;
  using complex = std::complex<R>;
  const complex x(2, 3), y(5, -7);
  for (const complex p : {complex(0, 0), complex(1, 0), complex(0, 1), x, y}) {
    for (const complex q : {complex(0, 0), complex(-1, 0), complex(0, -1), x, y}) {
      expect_rounded_product(p, q);
    }
  }
  complex r;
  EXPECT_EQ(bodies<R>::mul::call(&x, &y, &r), 0u);
  EXPECT_EQ(r, complex(31, 1));
  EXPECT_EQ(bodies<R>::mul_ep::call(&x, &y, &r), 0u);
  EXPECT_EQ(r, complex(31, 1));
}

/// Zeros: at double a part that is exactly zero is +0; at float the subtracted product is one, so
/// the real part may be -0.
TEST(ComplexMulZeros, Signs) {
  constexpr std::uint32_t one = 0x3f800000, minus = 0x80000000;
  expect_v21<scalar::mul_c>({one | minus, 0}, {0, 0}, {minus, 0});
  expect_v21<scalar::mul_c>({one, 0}, {0, 0}, {0, 0});
  expect_v21<scalar::mul_c>({one, one}, {one, one}, {0, 0x40000000});
  constexpr std::uint64_t wide_one = 0x3ff0000000000000, wide_minus = 0x8000000000000000;
  expect_v21<scalar::mul_z>({wide_one | wide_minus, 0}, {0, 0}, {0, 0});
  expect_v21<scalar::mul_z>({wide_one, wide_minus}, {wide_minus, wide_one}, {0, wide_one});
  expect_v21<scalar::mul_z>({wide_one, wide_one}, {wide_one, wide_one}, {0, 0x4000000000000000});
  // A part that underflows keeps its sign.
  expect_v21<scalar::mul_z>({1 | wide_minus, 0}, {1, 0}, {wide_minus, 0});
}

/// All of the leading bits of ac and bd cancel.
TEST(ComplexMulCancellation, KeepsTheLastBit) {
  const double e = 0x1p-52;
  // (1 + e)(1 - e) - 1·1 = -e², below the rounding error of either product.
  const std::complex<double> x(1 + e, 1), y(1 - e, 1);
  std::complex<double> r;
  EXPECT_EQ(scalar::mul_z::call(&x, &y, &r), 0u);
  EXPECT_EQ(r.real(), -0x1p-104);
  EXPECT_EQ(r.imag(), 2.0);
  // The same where the operands must be scaled.
  const std::complex<double> big(x * 0x1p1000), small(y * 0x1p-1000);
  EXPECT_EQ(scalar::mul_z::call(&big, &small, &r), 0u);
  EXPECT_EQ(r.real(), -0x1p-104);
  EXPECT_EQ(r.imag(), 2.0);
}

TYPED_TEST(ComplexMul, Overflow) {
  using R = TypeParam;
  using U = part_of<R>;
  using n = named<U>;
  using body = bodies<R>;
  const U big = n::largest;
  const U minus = n::sign;
  expect_v21<typename body::mul>({big, 0}, {big, 0}, {n::inf, 0}, overflow);
  expect_v21<typename body::mul>({0, big}, {0, big}, {n::inf | minus, 0}, overflow);
  // ac and bd overflow, their difference is zero.
  expect_v21<typename body::mul>({big, big}, {big, big}, {0, n::inf}, overflow);
  // ac and bd overflow, their difference is small.
  const R a = std::bit_cast<R>(big), b = std::bit_cast<R>(big - 1);
  expect_rounded_product<R>({a, a}, {a, b});
  expect_rounded_product<R>({a, a}, {2, 2});
  expect_rounded_product<R>({a, a}, {R(0.5), R(0.5)});
  // ep repairs what overflows on the way, and reports nothing.
  expect_v21<typename body::mul_ep>({big, big}, {big, big}, {0, n::inf}, 0);
  expect_v21<typename body::mul_ep>({big, 0}, {big, 0}, {n::inf, 0}, 0);
  expect_v21<typename body::mul_ep>({big, big}, {n::one + n::smallest_normal, n::one},
                                    {big, n::inf}, 0);
}

TYPED_TEST(ComplexMul, InfiniteOperands) {
  using U = part_of<TypeParam>;
  using n = named<U>;
  const U one = n::one, inf = n::inf, minus = n::sign, nan = n::nan, two = one + n::smallest_normal;
  const U any_nan = n::any_nan;
  const auto both = [](std::array<U, 2> x, std::array<U, 2> y, std::array<U, 2> r,
                       location where = location::current()) {
    using body = bodies<TypeParam>;
    expect_v21<typename body::mul>(x, y, r, 0, where);
    expect_v21<typename body::mul>(y, x, r, 0, where);
    expect_v21<typename body::mul_ep>(x, y, r, 0, where);
    expect_v21<typename body::mul_ep>(y, x, r, 0, where);
  };
  both({inf, 0}, {one, 0}, {inf, any_nan});
  both({inf, 0}, {one, two}, {inf, inf});
  both({inf, 0}, {one | minus, two}, {inf | minus, inf});
  both({0, inf}, {one, two}, {inf | minus, inf});
  both({inf, inf}, {one, one | minus}, {inf, any_nan});
  both({inf, inf | minus}, {two, one}, {inf, inf | minus});
  // An infinity beside a NaN is infinite, and so is its product with a number.
  both({inf, nan}, {one, two}, {inf, inf});
  both({nan, inf | minus}, {one, two}, {inf, inf | minus});
  both({inf, one}, {two, nan}, {inf, any_nan});
  both({inf, nan}, {two, nan}, {inf, any_nan});
  // Two infinities: directions 1 and i, and 1 + i twice.
  both({inf, one}, {one, inf}, {any_nan, inf});
  both({inf, inf}, {inf, inf}, {any_nan, inf});
  both({inf, nan}, {nan, inf}, {any_nan, inf});
  // Infinity times zero, or times what may be zero.
  both({inf, 0}, {0, minus}, {any_nan, any_nan});
  both({inf, inf}, {0, 0}, {any_nan, any_nan});
  both({inf, one}, {nan, 0}, {any_nan, any_nan});
  both({inf, one}, {nan, nan}, {any_nan, any_nan});
  both({inf, nan}, {0, 0}, {any_nan, any_nan});
  both({inf, 0}, {nan + 3, 0}, {nan + 3, nan + 3});
  // NaNs and no infinity.
  both({nan, one}, {one, two}, {nan, nan});
  both({nan, n::largest}, {one, n::largest}, {any_nan, any_nan});
  both({nan, 0}, {0, 0}, {nan, nan});
}

/// The multiplication that the compiler's run-time library does for C99, as a reference for what is
/// infinite and with which signs. C99 recovers only where both parts are NaNs, the bodies also
/// where one is infinite: there the other part may be a NaN in one of the two and not in the other.
TYPED_TEST(ComplexMul, InfinitiesAsInC99) {
  using R = TypeParam;
  using complex = std::complex<R>;
  const R inf = std::numeric_limits<R>::infinity(), nan = std::numeric_limits<R>::quiet_NaN();
  const R parts[] = {0, -R(0), 1, -2, inf, -inf, nan, -nan};
  for (const R a : parts) {
    for (const R b : parts) {
      for (const R c : parts) {
        for (const R d : parts) {
          const complex x(a, b), y(c, d);
          const complex reference = x * y;
          complex r;
          EXPECT_EQ(bodies<R>::mul::call(&x, &y, &r), 0u);
          const bool infinite = std::isinf(r.real()) || std::isinf(r.imag());
          const bool expected = std::isinf(reference.real()) || std::isinf(reference.imag());
          ASSERT_EQ(infinite, expected) << x << y << r << reference;
          const auto agrees = [](R part, R of) {
            return std::isnan(part) || std::isnan(of) || part == of;
          };
          if (infinite) {
            ASSERT_TRUE(agrees(r.real(), reference.real()) && agrees(r.imag(), reference.imag()))
                << x << y << r << reference;
          } else if (std::isnan(reference.real()) || std::isnan(reference.imag())) {
            ASSERT_TRUE(std::isnan(r.real()) == std::isnan(reference.real()) &&
                        std::isnan(r.imag()) == std::isnan(reference.imag()))
                << x << y << r << reference;
          } else {
            ASSERT_EQ(r, reference);
          }
          complex ep;
          EXPECT_EQ(bodies<R>::mul_ep::call(&x, &y, &ep), 0u);
          ASSERT_TRUE(std::isinf(ep.real()) == std::isinf(r.real()) &&
                      std::isinf(ep.imag()) == std::isinf(r.imag()))
              << x << y << r << ep;
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
void expect_random_products(int count) {
  using U = part_of<R>;
  pattern_source<U> source(10);
  const U one = named<U>::one;
  const int middle = sizeof(R) == 4 ? 40 : 400;
  for (int i = 0; i < count; ++i) {
    const U a = source.finite(), b = source.finite(), c = source.finite(), d = source.finite();
    ASSERT_TRUE(expect_rounded_product(number<R>(a, b), number<R>(c, d)));
    // Operands whose parts are of like size, products that mostly stay in range.
    const U e = source.near(one, middle), f = source.near(e, 2);
    const U g = source.near(one, middle), h = source.near(g, 2);
    ASSERT_TRUE(expect_rounded_product(number<R>(e, f), number<R>(g, h)));
    // Cancellation: bd is ac but for a few units in the last place.
    const U k = static_cast<U>(source.below(5)) - 2;
    ASSERT_TRUE(expect_rounded_product(number<R>(e, g + k), number<R>(g, e)));
    ASSERT_TRUE(expect_rounded_product(number<R>(e, g + k), number<R>(e, g ^ named<U>::sign)));
    // Products at the lower edge: denormal results, from operands of opposite size too.
    const quad target = unit_in_last_place(R(0)) * static_cast<quad>(source.below(1u << 20));
    const R p = std::bit_cast<R>(a), q = std::bit_cast<R>(e);
    if (p == 0) continue;
    const R partner = static_cast<R>(target / static_cast<quad>(p));
    if (std::isfinite(partner)) {
      ASSERT_TRUE(expect_rounded_product<R>({p, 0}, {partner, 0}));
      ASSERT_TRUE(expect_rounded_product<R>({p, q}, {partner, 0}));
      ASSERT_TRUE(expect_rounded_product<R>({p, partner}, {partner, p}));
      ASSERT_TRUE(expect_rounded_product<R>({p, p}, {partner, -partner * R(0.75)}));
    }
  }
}

TYPED_TEST(ComplexMul, RandomProducts) { expect_random_products<TypeParam>(30'000); }

/// The screen's bounds and their neighbours, and the edges of the exponent range.
TEST(ComplexMulScreen, Bounds) {
  std::vector<double> list;
  for (const std::uint64_t edge :
       {std::uint64_t{0x2340000000000000}, std::uint64_t{0x5fd6a09d00000000},
        std::uint64_t{0x5fd6a09e00000000}, std::uint64_t{0x0010000000000000}}) {
    for (int step = -2; step <= 2; ++step) {
      list.push_back(std::bit_cast<double>(edge + static_cast<std::uint64_t>(step)));
    }
  }
  list.insert(list.end(), {0.0, 0x1p-1074, 0x1.fffffffffffffp1023, 1.0, -0x1.8p300});
  for (const double a : list) {
    for (const double b : list) {
      for (const double c : list) {
        for (const double d : list) {
          ASSERT_TRUE(expect_rounded_product<double>({a, b}, {c, d}));
        }
      }
    }
  }
}

/// The denormal results of a product that is nearly halfway between two of them.
TEST(ComplexMulScreen, DenormalTies) {
  const double u = 0x1p-1074;
  struct row {
    std::complex<double> x, y;
    double re;
  };
  const row rows[] = {
      {{u, 0}, {0.5, 0}, 0},
      {{3 * u, 0}, {0.5, 0}, 2 * u},
      {{-u, 0}, {0.5, 0}, -0.0},
      // 1/2 + 2^-100 and 1/2 - 2^-100 of a unit.
      {{u, 0x1p-600}, {0.5, -0x1p-574}, u},
      {{u, 0x1p-600}, {0.5, 0x1p-574}, 0},
      // 3/2 of a unit, less and more.
      {{3 * u, 0x1p-600}, {0.5, 0x1p-574}, u},
      {{3 * u, 0x1p-600}, {0.5, -0x1p-574}, 2 * u},
      {{0x1.fffffffffffffp-1022, 0}, {0.5, 0}, 0x1p-1022},
      {{0x1p-1022, 0}, {1 - 0x1p-53, 0}, 0x1p-1022},
      {{0x1p-1022, 0}, {1 - 0x1p-52, 0}, 0x1p-1022 - u},
  };
  for (const row& r : rows) {
    std::complex<double> result;
    EXPECT_EQ(scalar::mul_z::call(&r.x, &r.y, &result), 0u);
    EXPECT_EQ(std::bit_cast<std::uint64_t>(result.real()), std::bit_cast<std::uint64_t>(r.re))
        << r.x << r.y << result;
  }
}

/// ep: near in the sense of the whole number, |error| below 2^-22 or 2^-51 of the product.
TYPED_TEST(ComplexMul, EpIsNearByNorm) {
  using R = TypeParam;
  using U = part_of<R>;
  pattern_source<U> source(11);
  const U one = named<U>::one;
  const double bound = std::ldexp(1.0, sizeof(R) == 4 ? -22 : -51);
  for (int i = 0; i < 100'000; ++i) {
    const U e = source.near(one, 20), g = source.near(one, 20);
    const auto x = number<R>(e, source.near(e, 4)), y = number<R>(g, source.near(g, 4));
    std::complex<R> r;
    ASSERT_EQ(bodies<R>::mul_ep::call(&x, &y, &r), 0u);
    const product<R> exact(x, y);
    const auto wide = [](quad v) { return static_cast<double>(v); };
    const double error = std::hypot(wide(static_cast<quad>(r.real()) - exact.re),
                                    wide(static_cast<quad>(r.imag()) - exact.im));
    ASSERT_LE(error, bound * std::hypot(wide(exact.re), wide(exact.im))) << x << y << r;
  }
}

template <typename R>
class SlowComplexMul : public ::testing::Test {};
TYPED_TEST_SUITE(SlowComplexMul, types);

TYPED_TEST(SlowComplexMul, RandomProducts) { expect_random_products<TypeParam>(3'000'000); }

}  // namespace
