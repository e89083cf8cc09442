// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Special values and status of the real functions.

#include "library_special.hpp"

#include "library/functions.hpp"

namespace arbor::lumen::tests::library {
namespace {

namespace lib = vm::detail::library;

template <typename T>
constexpr T inf = values<T>::inf;
template <typename T>
constexpr T nan = values<T>::nan;
template <typename T>
constexpr T largest = values<T>::largest;
template <typename T>
constexpr T smallest = values<T>::smallest;
template <typename T>
constexpr bool is_float = sizeof(T) == 4;

template <typename T>
T above(T x) {
  return std::nextafter(x, inf<T>);
}
template <typename T>
T below(T x) {
  return std::nextafter(x, -inf<T>);
}

template <typename T>
class LibrarySpecial : public ::testing::Test {};
using types = ::testing::Types<float, double>;
TYPED_TEST_SUITE(LibrarySpecial, types);

/// f(±x) = ±y.
template <typename F, typename T = typename F::input_type>
void expect_odd(T x, T y, std::uint32_t status = 0, location where = location::current()) {
  expect<F>(x, y, status, where);
  expect<F>(-x, -y, status, where);
}
template <typename F, typename T = typename F::input_type>
void expect_even(T x, T y, std::uint32_t status = 0, location where = location::current()) {
  expect<F>(x, y, status, where);
  expect<F>(-x, y, status, where);
}

TYPED_TEST(LibrarySpecial, HyperbolicFunctions) {
  using T = TypeParam;
  for (const T x : {T(0), inf<T>, smallest<T>}) {
    expect_odd<lib::asinh<T>>(x, x);
    expect_odd<lib::sinh<T>>(x, x);
  }
  expect_odd<lib::sinh<T>>(largest<T>, inf<T>, overflow);
  expect_odd<lib::sinh<T>>(is_float<T> ? T(90) : T(711), inf<T>, overflow);
  expect_even<lib::cosh<T>>(T(0), T(1));
  expect_even<lib::cosh<T>>(inf<T>, inf<T>);
  expect_even<lib::cosh<T>>(largest<T>, inf<T>, overflow);
  expect_even<lib::cosh<T>>(is_float<T> ? T(90) : T(711), inf<T>, overflow);
  expect_odd<lib::tanh<T>>(T(0), T(0));
  expect_odd<lib::tanh<T>>(inf<T>, T(1));
  expect<lib::asinh<T>>(nan<T>, nan<T>);
  expect<lib::sinh<T>>(nan<T>, nan<T>);
  expect<lib::cosh<T>>(nan<T>, nan<T>);
  expect<lib::tanh<T>>(nan<T>, nan<T>);

  expect<lib::acosh<T>>(T(1), T(0));
  expect<lib::acosh<T>>(inf<T>, inf<T>);
  expect<lib::acosh<T>>(nan<T>, nan<T>);
  for (const T x : {below(T(1)), T(0), T(-1), -largest<T>, -inf<T>})
    expect<lib::acosh<T>>(x, nan<T>, domain);

  expect_odd<lib::atanh<T>>(T(0), T(0));
  expect_odd<lib::atanh<T>>(T(1), inf<T>, pole);
  for (const T x : {above(T(1)), largest<T>, inf<T>}) expect_odd<lib::atanh<T>>(x, nan<T>, domain);
  expect<lib::atanh<T>>(nan<T>, nan<T>);
}

TYPED_TEST(LibrarySpecial, TrigonometryInDegrees) {
  using T = TypeParam;
  constexpr T turn = T(360) * T(1024);
  for (const T n : {T(0), turn}) {
    expect_odd<lib::sind<T>>(n, T(0));
    expect_odd<lib::sind<T>>(n + 90, T(1));
    expect_odd<lib::sind<T>>(n + 180, T(0));
    expect_odd<lib::sind<T>>(n + 270, T(-1));
    expect_odd<lib::sind<T>>(n + 30, T(0.5));
    expect_even<lib::cosd<T>>(n, T(1));
    expect_even<lib::cosd<T>>(n + 90, T(0));
    expect_even<lib::cosd<T>>(n + 180, T(-1));
    expect_even<lib::cosd<T>>(n + 270, T(0));
    expect_even<lib::cosd<T>>(n + 60, T(0.5));
    expect_odd<lib::tand<T>>(n, T(0));
    expect_odd<lib::tand<T>>(n + 45, T(1));
    expect_odd<lib::tand<T>>(n + 90, inf<T>);
    expect_odd<lib::tand<T>>(n + 180, T(-0.0));
    expect_odd<lib::tand<T>>(n + 270, -inf<T>);
  }
  for (const T x : {inf<T>, -inf<T>}) {
    expect<lib::sind<T>>(x, nan<T>, domain);
    expect<lib::cosd<T>>(x, nan<T>, domain);
    expect<lib::tand<T>>(x, nan<T>, domain);
  }
  expect<lib::sind<T>>(nan<T>, nan<T>);
  expect<lib::cosd<T>>(nan<T>, nan<T>);
  expect<lib::tand<T>>(nan<T>, nan<T>);
}

TYPED_TEST(LibrarySpecial, TrigonometryInMultiplesOfPi) {
  using T = TypeParam;
  for (const T n : {T(0), T(2), T(1024), largest<T>}) {
    expect_odd<lib::sinpi<T>>(n, T(0));
    expect_even<lib::cospi<T>>(n, T(1));
    expect_odd<lib::tanpi<T>>(n, T(0));
  }
  for (const T n : {T(1), T(1025)}) {
    expect_odd<lib::sinpi<T>>(n, T(0));
    expect_even<lib::cospi<T>>(n, T(-1));
    expect_odd<lib::tanpi<T>>(n, T(-0.0));
  }
  for (const T n : {T(0), T(64)}) {
    expect_odd<lib::sinpi<T>>(n + T(0.5), T(1));
    expect_odd<lib::sinpi<T>>(n + T(1.5), T(-1));
    expect_even<lib::cospi<T>>(n + T(0.5), T(0));
    expect_even<lib::cospi<T>>(n + T(1.5), T(0));
    expect_odd<lib::tanpi<T>>(n + T(0.5), inf<T>);
    expect_odd<lib::tanpi<T>>(n + T(1.5), -inf<T>);
    expect_odd<lib::tanpi<T>>(n + T(0.25), T(1));
  }
  // The last odd integer, and above it the even ones.
  const T last = is_float<T> ? T(0x1.fffffep23) : T(0x1.fffffffffffffp52);
  expect_odd<lib::tanpi<T>>(last, T(-0.0));
  expect_odd<lib::tanpi<T>>(last + 1, T(0));
  for (const T x : {inf<T>, -inf<T>}) {
    expect<lib::sinpi<T>>(x, nan<T>, domain);
    expect<lib::cospi<T>>(x, nan<T>, domain);
    expect<lib::tanpi<T>>(x, nan<T>, domain);
  }
  expect<lib::sinpi<T>>(nan<T>, nan<T>);
  expect<lib::cospi<T>>(nan<T>, nan<T>);
  expect<lib::tanpi<T>>(nan<T>, nan<T>);
}

TYPED_TEST(LibrarySpecial, ErrorFunctions) {
  using T = TypeParam;
  expect_odd<lib::erf<T>>(T(0), T(0));
  expect_odd<lib::erf<T>>(inf<T>, T(1));
  expect_odd<lib::erf<T>>(largest<T>, T(1));
  expect<lib::erf<T>>(nan<T>, nan<T>);

  const T erfc_bound = is_float<T> ? T(std::bit_cast<float>(0x4120ddfb))
                                   : T(std::bit_cast<double>(0x403b39dc41e48bfd));
  expect<lib::erfc<T>>(-inf<T>, T(2));
  expect<lib::erfc<T>>(T(-30), T(2));
  expect<lib::erfc<T>>(T(0), T(1));
  expect<lib::erfc<T>>(inf<T>, T(0));
  expect<lib::erfc<T>>(erfc_bound, T(0), underflow);
  expect<lib::erfc<T>>(largest<T>, T(0), underflow);
  expect<lib::erfc<T>>(below(erfc_bound), smallest<T>);
  expect<lib::erfc<T>>(nan<T>, nan<T>);

  const T cdf_bound = is_float<T> ? T(std::bit_cast<float>(0xc162b914))
                                  : T(std::bit_cast<double>(0xc0433e21dc3f3bd7));
  expect<lib::cdfnorm<T>>(-inf<T>, T(0));
  expect<lib::cdfnorm<T>>(inf<T>, T(1));
  expect<lib::cdfnorm<T>>(T(0), T(0.5));
  expect<lib::cdfnorm<T>>(T(-0.0), T(0.5));
  expect<lib::cdfnorm<T>>(cdf_bound, T(0), underflow);
  expect<lib::cdfnorm<T>>(-largest<T>, T(0), underflow);
  expect<lib::cdfnorm<T>>(above(cdf_bound), smallest<T>);
  expect<lib::cdfnorm<T>>(nan<T>, nan<T>);

  // The last argument with a finite result.
  const T erfcx_bound = is_float<T> ? T(-std::bit_cast<float>(0x41161e5e))
                                    : T(-std::bit_cast<double>(0x403aa0f4d2e063ce));
  expect<lib::erfcx<T>>(inf<T>, T(0));
  expect<lib::erfcx<T>>(T(0), T(1));
  expect<lib::erfcx<T>>(below(erfcx_bound), inf<T>);
  expect<lib::erfcx<T>>(-largest<T>, inf<T>);
  expect<lib::erfcx<T>>(-inf<T>, inf<T>);
  expect<lib::erfcx<T>>(nan<T>, nan<T>);
  T y;
  lib::erfcx<T>::call(&erfcx_bound, &y);
  EXPECT_TRUE(std::isfinite(y));
}

TYPED_TEST(LibrarySpecial, InverseErrorFunctions) {
  using T = TypeParam;
  expect_odd<lib::erfinv<T>>(T(0), T(0));
  expect_odd<lib::erfinv<T>>(T(1), inf<T>, pole);
  expect<lib::erfcinv<T>>(T(0), inf<T>, pole);
  expect<lib::erfcinv<T>>(T(-0.0), inf<T>, pole);
  expect<lib::erfcinv<T>>(T(2), -inf<T>, pole);
  expect<lib::erfcinv<T>>(T(1), T(0));
  expect<lib::cdfnorminv<T>>(T(0), -inf<T>, pole);
  expect<lib::cdfnorminv<T>>(T(-0.0), -inf<T>, pole);
  expect<lib::cdfnorminv<T>>(T(1), inf<T>, pole);
  expect<lib::cdfnorminv<T>>(T(0.5), T(0));
  for (const T x : {-smallest<T>, above(T(2)), largest<T>, inf<T>, -inf<T>}) {
    expect<lib::erfcinv<T>>(x, nan<T>, domain);
    expect<lib::cdfnorminv<T>>(x, nan<T>, domain);
  }
  expect<lib::cdfnorminv<T>>(above(T(1)), nan<T>, domain);
  for (const T x : {above(T(1)), largest<T>, inf<T>}) expect_odd<lib::erfinv<T>>(x, nan<T>, domain);
  expect<lib::erfinv<T>>(nan<T>, nan<T>);
  expect<lib::erfcinv<T>>(nan<T>, nan<T>, is_float<T> ? domain : 0);
  expect<lib::cdfnorminv<T>>(nan<T>, nan<T>);
}

TYPED_TEST(LibrarySpecial, GammaAndExponentialIntegral) {
  using T = TypeParam;
  expect_odd<lib::tgamma<T>>(T(0), inf<T>, pole);
  expect_odd<lib::tgamma<T>>(smallest<T>, inf<T>, overflow);
  for (const T x : {T(-1), T(-2), T(-1000), -largest<T>, -inf<T>})
    expect<lib::tgamma<T>>(x, nan<T>, domain);
  expect<lib::tgamma<T>>(T(1), T(1));
  expect<lib::tgamma<T>>(T(5), T(24));
  expect<lib::tgamma<T>>(inf<T>, inf<T>);
  expect<lib::tgamma<T>>(T(172), inf<T>, overflow);
  expect<lib::tgamma<T>>(largest<T>, inf<T>, overflow);
  // Gamma is negative between -191 and -190, positive between -192 and -191.
  expect<lib::tgamma<T>>(T(-190.5), T(-0.0), underflow);
  expect<lib::tgamma<T>>(T(-191.5), T(0), underflow);
  expect<lib::tgamma<T>>(nan<T>, nan<T>);

  for (const T x : {T(0), T(-0.0), T(-1), T(-17), -largest<T>})
    expect<lib::lgamma<T>>(x, inf<T>, pole);
  expect<lib::lgamma<T>>(T(1), T(0));
  expect<lib::lgamma<T>>(T(2), T(0));
  expect<lib::lgamma<T>>(inf<T>, inf<T>);
  expect<lib::lgamma<T>>(-inf<T>, inf<T>);
  expect<lib::lgamma<T>>(largest<T>, inf<T>, overflow);
  expect<lib::lgamma<T>>(nan<T>, nan<T>);

  expect<lib::expint1<T>>(T(0), inf<T>, pole);
  expect<lib::expint1<T>>(T(-0.0), inf<T>, pole);
  for (const T x : {-smallest<T>, T(-1), -largest<T>, -inf<T>})
    expect<lib::expint1<T>>(x, nan<T>, domain);
  expect<lib::expint1<T>>(inf<T>, T(0));
  expect<lib::expint1<T>>(largest<T>, T(0));
  expect<lib::expint1<T>>(nan<T>, nan<T>);
}

TYPED_TEST(LibrarySpecial, ModifiedBesselFunctions) {
  using T = TypeParam;
  expect_even<lib::i0<T>>(T(0), T(1));
  expect_even<lib::i0<T>>(inf<T>, inf<T>);
  expect_even<lib::i0<T>>(largest<T>, inf<T>, overflow);
  if (is_float<T>) {
    expect_even<lib::i0<T>>(T(92), inf<T>);
    expect_even<lib::i0<T>>(above(T(92)), inf<T>, overflow);
  } else {
    expect_even<lib::i0<T>>(T(714), inf<T>, overflow);
  }
  expect<lib::i0<T>>(nan<T>, nan<T>);
  expect_odd<lib::i1<T>>(T(0), T(0));
  expect_odd<lib::i1<T>>(inf<T>, inf<T>);
  expect_odd<lib::i1<T>>(largest<T>, inf<T>, overflow);
  expect_odd<lib::i1<T>>(is_float<T> ? T(92) : T(714), inf<T>, overflow);
  expect<lib::i1<T>>(nan<T>, nan<T>);
}

TYPED_TEST(LibrarySpecial, BesselFunctions) {
  using T = TypeParam;
  expect_even<lib::j0<T>>(T(0), T(1));
  expect_even<lib::j0<T>>(inf<T>, T(0));
  expect<lib::j0<T>>(nan<T>, nan<T>);
  expect_odd<lib::j1<T>>(T(0), T(0));
  expect_even<lib::j1<T>>(inf<T>, T(0));
  expect<lib::j1<T>>(nan<T>, nan<T>);
  for (const T x : {T(0), T(-0.0)}) {
    expect<lib::y0<T>>(x, -inf<T>);
    expect<lib::y1<T>>(x, -inf<T>);
  }
  for (const T x : {-smallest<T>, T(-1), -inf<T>, nan<T>}) {
    expect<lib::y0<T>>(x, nan<T>);
    expect<lib::y1<T>>(x, nan<T>);
  }
  expect<lib::y0<T>>(inf<T>, T(0));
  expect<lib::y1<T>>(inf<T>, T(0));
}

/// The functors of an order, with the order as the constant.
template <typename F, typename T = typename F::input_type>
void expect_of_order(T order, T x, T y, location where = location::current()) {
  T result = unwritten<T>();
  const std::uint32_t s = F::call(&x, order, &result);
  expect_result(expected(y), 0, result, s, where, functor_name<F>(), "result", x, order);
}

TYPED_TEST(LibrarySpecial, BesselFunctionsOfAnOrder) {
  using T = TypeParam;
  using J = lib::jn<T>;
  using Y = lib::yn<T>;
  for (const T zero : {T(0), T(-0.0)}) {
    expect_of_order<J>(T(0), zero, T(1));
    expect_of_order<J>(T(2), zero, T(0));
    expect_of_order<J>(T(-4), zero, T(0));
    expect_of_order<Y>(T(0), zero, -inf<T>);
    expect_of_order<Y>(T(3), zero, -inf<T>);
    expect_of_order<Y>(T(-2), zero, -inf<T>);
    expect_of_order<Y>(T(-3), zero, inf<T>);
  }
  // A zero of odd order has the sign of the argument, of the opposite order the other.
  expect_of_order<J>(T(3), T(-0.0), T(-0.0));
  expect_of_order<J>(T(-3), T(0), T(-0.0));
  expect_of_order<J>(T(2000), T(1), T(0));
  expect_of_order<J>(T(2001), T(-1), T(-0.0));
  expect_of_order<J>(T(1e30), T(1000), T(0));
  expect_of_order<Y>(T(2000), T(1), -inf<T>);
  expect_of_order<Y>(T(-2001), T(1), inf<T>);
  for (const T order : {T(0), T(1), T(-7), T(100)}) {
    expect_of_order<J>(order, inf<T>, T(0));
    expect_of_order<J>(order, -inf<T>, T(0));
    expect_of_order<J>(order, nan<T>, nan<T>);
    expect_of_order<Y>(order, inf<T>, T(0));
    expect_of_order<Y>(order, T(-1), nan<T>);
    expect_of_order<Y>(order, -inf<T>, nan<T>);
    expect_of_order<Y>(order, nan<T>, nan<T>);
  }
  // Orders are cut to integers.
  for (const T x : {T(0.5), T(3), T(77)}) {
    T y;
    lib::j1<T>::call(&x, &y);
    expect_of_order<J>(T(1.9), x, y);
    expect_of_order<J>(T(-1.9), x, -y);
    lib::y0<T>::call(&x, &y);
    expect_of_order<Y>(T(-0.9), x, y);
  }
}

TYPED_TEST(LibrarySpecial, LinearFraction) {
  using T = TypeParam;
  const auto call = [](T a, T b, T scalea, T shifta, T scaleb, T shiftb) {
    T y = unwritten<T>();
    EXPECT_EQ(lib::linearfrac<T>::call(&a, &b, scalea, shifta, scaleb, shiftb, &y), 0u);
    return y;
  };
  EXPECT_EQ(call(3, 5, 2, 1, 3, -1), T(0.5));
  EXPECT_EQ(call(3, 1, 2, 1, 1, -1), inf<T>);
  EXPECT_EQ(call(-3, 1, 2, 1, 1, -1), -inf<T>);
  EXPECT_TRUE(std::isnan(call(0, 1, 2, 0, 1, -1)));
  for (int i = 0; i < 6; ++i) {
    std::array<T, 6> v = {1, 1, 1, 1, 1, 1};
    v[static_cast<std::size_t>(i)] = nan<T>;
    EXPECT_TRUE(std::isnan(call(v[0], v[1], v[2], v[3], v[4], v[5]))) << i;
  }
  // (1 + e)^2 - (1 + 2e) = e^2: what rounding the product would lose.
  const T e = std::numeric_limits<T>::epsilon();
  EXPECT_EQ(call(1 + e, 1, 1 + e, -(1 + 2 * e), 1, 0), e * e);
}

TYPED_TEST(LibrarySpecial, ResultsMayOverwriteArguments) {
  using T = TypeParam;
  for (const T x : {T(0.25), T(1), T(-1), inf<T>, T(0)}) {
    expect_in_place<lib::acosh<T>>(x);
    expect_in_place<lib::atanh<T>>(x);
    expect_in_place<lib::sinh<T>>(x);
    expect_in_place<lib::sind<T>>(x);
    expect_in_place<lib::tanpi<T>>(x);
    expect_in_place<lib::erfc<T>>(x);
    expect_in_place<lib::erfinv<T>>(x);
    expect_in_place<lib::erfcinv<T>>(x);
    expect_in_place<lib::cdfnorminv<T>>(x);
    expect_in_place<lib::expint1<T>>(x);
    expect_in_place<lib::lgamma<T>>(x);
    expect_in_place<lib::tgamma<T>>(x);
    expect_in_place<lib::i0<T>>(x);
    expect_in_place<lib::i1<T>>(x);
    expect_in_place<lib::j1<T>>(x);
  }
}

}  // namespace
}  // namespace arbor::lumen::tests::library
