// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Special values of the complex functions: those of Annex G of C23, with its symmetries.

#include "library_special.hpp"

#include <numbers>
#include <vector>

#include "library/functions.hpp"

namespace arbor::lumen::tests::library {
namespace {

namespace lib = vm::detail::library;

/// f(re + i im) = y_re + i y_im. A part may have either sign where the standard leaves it open.
template <typename R>
struct row {
  R re, im, y_re, y_im;
  char open = ' ';  ///< 'r', 'i': this part has either sign
};

template <typename R>
class LibraryComplexSpecial : public ::testing::Test {
 protected:
  using C = std::complex<R>;
  static constexpr R inf = values<R>::inf;
  static constexpr R nan = values<R>::nan;
  static constexpr R pi = std::numbers::pi_v<R>;
  static constexpr R half_pi = pi / 2;
  static constexpr R quarter_pi = pi / 4;
  static constexpr R three_quarters_pi = static_cast<R>(3 * std::numbers::pi_v<long double> / 4);

  template <typename F>
  static void check(C z, C y, char open, location where) {
    C result = unwritten<C>();
    const std::uint32_t s = F::call(&z, &result);
    C compared = result;
    if (open == 'r') compared.real(std::copysign(result.real(), y.real()));
    if (open == 'i') compared.imag(std::copysign(result.imag(), y.imag()));
    expect_result(expected(y), 0, compared, s, where, functor_name<F>(), "result", z);
  }

  /// The rows, and with them f(conj z) = conj f(z); if f is odd or even, also f(-z).
  template <typename F>
  static void expect_rows(const std::vector<row<R>>& rows, char parity = ' ',
                          location where = location::current()) {
    for (const row<R>& r : rows) {
      const C z(r.re, r.im);
      const C y(r.y_re, r.y_im);
      check<F>(z, y, r.open, where);
      check<F>(std::conj(z), std::conj(y), r.open, where);
      if (parity == ' ') continue;
      const C image = parity == 'o' ? -y : y;
      check<F>(-z, image, r.open, where);
      check<F>(-std::conj(z), std::conj(image), r.open, where);
    }
  }

  /// G(z) = -i F(iz) for an F with these rows: of the hyperbolic functions the trigonometric ones.
  template <typename G>
  static void expect_turned_rows(const std::vector<row<R>>& rows,
                                 location where = location::current()) {
    std::vector<row<R>> turned;
    for (const row<R>& r : rows) {
      const char open = r.open == 'r' ? 'i' : (r.open == 'i' ? 'r' : ' ');
      turned.push_back({r.im, -r.re, r.y_im, -r.y_re, open});
    }
    expect_rows<G>(turned, 'o', where);
  }
};
using types = ::testing::Types<float, double>;
TYPED_TEST_SUITE(LibraryComplexSpecial, types);

TYPED_TEST(LibraryComplexSpecial, Acos) {
  using R = TypeParam;
  using f = LibraryComplexSpecial<R>;
  this->template expect_rows<lib::acos<std::complex<R>>>({
      {0, 0, f::half_pi, R(-0.0)},
      {R(-0.0), 0, f::half_pi, R(-0.0)},
      {0, f::nan, f::half_pi, f::nan},
      {1, f::inf, f::half_pi, -f::inf},
      {1, f::nan, f::nan, f::nan},
      {-f::inf, 1, f::pi, -f::inf},
      {f::inf, 1, 0, -f::inf},
      {-f::inf, f::inf, f::three_quarters_pi, -f::inf},
      {f::inf, f::inf, f::quarter_pi, -f::inf},
      {f::inf, f::nan, f::nan, f::inf, 'i'},
      {-f::inf, f::nan, f::nan, f::inf, 'i'},
      {f::nan, 1, f::nan, f::nan},
      {f::nan, f::inf, f::nan, -f::inf},
      {f::nan, f::nan, f::nan, f::nan},
  });
}

TYPED_TEST(LibraryComplexSpecial, Acosh) {
  using R = TypeParam;
  using f = LibraryComplexSpecial<R>;
  this->template expect_rows<lib::acosh<std::complex<R>>>({
      {0, 0, 0, f::half_pi},
      {R(-0.0), 0, 0, f::half_pi},
      {1, f::inf, f::inf, f::half_pi},
      {0, f::nan, f::nan, f::half_pi, 'i'},
      {1, f::nan, f::nan, f::nan},
      {-f::inf, 1, f::inf, f::pi},
      {f::inf, 1, f::inf, 0},
      {-f::inf, f::inf, f::inf, f::three_quarters_pi},
      {f::inf, f::inf, f::inf, f::quarter_pi},
      {f::inf, f::nan, f::inf, f::nan},
      {-f::inf, f::nan, f::inf, f::nan},
      {f::nan, 1, f::nan, f::nan},
      {f::nan, f::inf, f::inf, f::nan},
      {f::nan, f::nan, f::nan, f::nan},
  });
}

TYPED_TEST(LibraryComplexSpecial, AsinhAndAsin) {
  using R = TypeParam;
  using f = LibraryComplexSpecial<R>;
  const std::vector<row<R>> rows = {
      {0, 0, 0, 0},
      {1, f::inf, f::inf, f::half_pi},
      {1, f::nan, f::nan, f::nan},
      {f::inf, 1, f::inf, 0},
      {f::inf, f::inf, f::inf, f::quarter_pi},
      {f::inf, f::nan, f::inf, f::nan},
      {f::nan, 0, f::nan, 0},
      {f::nan, 1, f::nan, f::nan},
      {f::nan, f::inf, f::inf, f::nan, 'r'},
      {f::nan, f::nan, f::nan, f::nan},
  };
  this->template expect_rows<lib::asinh<std::complex<R>>>(rows, 'o');
  this->template expect_turned_rows<lib::asin<std::complex<R>>>(rows);
}

TYPED_TEST(LibraryComplexSpecial, AtanhAndAtan) {
  using R = TypeParam;
  using f = LibraryComplexSpecial<R>;
  const std::vector<row<R>> rows = {
      {0, 0, 0, 0},
      {0, f::nan, 0, f::nan},
      {1, 0, f::inf, 0},
      {1, f::inf, 0, f::half_pi},
      {1, f::nan, f::nan, f::nan},
      {f::inf, 1, 0, f::half_pi},
      {f::inf, f::inf, 0, f::half_pi},
      {f::inf, f::nan, 0, f::nan},
      {f::nan, 1, f::nan, f::nan},
      {f::nan, f::inf, 0, f::half_pi, 'r'},
      {f::nan, f::nan, f::nan, f::nan},
  };
  this->template expect_rows<lib::atanh<std::complex<R>>>(rows, 'o');
  this->template expect_turned_rows<lib::atan<std::complex<R>>>(rows);
}

TYPED_TEST(LibraryComplexSpecial, CoshAndCos) {
  using R = TypeParam;
  using f = LibraryComplexSpecial<R>;
  const std::vector<row<R>> rows = {
      {0, 0, 1, 0},
      {0, f::inf, f::nan, 0, 'i'},
      {0, f::nan, f::nan, 0, 'i'},
      {1, f::inf, f::nan, f::nan},
      {1, f::nan, f::nan, f::nan},
      {f::inf, 0, f::inf, 0},
      {f::inf, 1, f::inf, f::inf},
      {f::inf, 2, -f::inf, f::inf},
      {f::inf, f::inf, f::inf, f::nan, 'r'},
      {f::inf, f::nan, f::inf, f::nan},
      {f::nan, 0, f::nan, 0, 'i'},
      {f::nan, 1, f::nan, f::nan},
      {f::nan, f::nan, f::nan, f::nan},
  };
  this->template expect_rows<lib::cosh<std::complex<R>>>(rows, 'e');
  // cos(z) = cosh(iz)
  std::vector<row<R>> turned;
  for (const row<R>& r : rows) turned.push_back({r.im, -r.re, r.y_re, r.y_im, r.open});
  this->template expect_rows<lib::cos<std::complex<R>>>(turned, 'e');
}

TYPED_TEST(LibraryComplexSpecial, SinhAndSin) {
  using R = TypeParam;
  using f = LibraryComplexSpecial<R>;
  const std::vector<row<R>> rows = {
      {0, 0, 0, 0},
      {0, f::inf, 0, f::nan, 'r'},
      {0, f::nan, 0, f::nan, 'r'},
      {1, f::inf, f::nan, f::nan},
      {1, f::nan, f::nan, f::nan},
      {f::inf, 0, f::inf, 0},
      {f::inf, 1, f::inf, f::inf},
      {f::inf, 2, -f::inf, f::inf},
      {f::inf, f::inf, f::inf, f::nan, 'r'},
      {f::inf, f::nan, f::inf, f::nan, 'r'},
      {f::nan, 0, f::nan, 0},
      {f::nan, 1, f::nan, f::nan},
      {f::nan, f::nan, f::nan, f::nan},
  };
  this->template expect_rows<lib::sinh<std::complex<R>>>(rows, 'o');
  this->template expect_turned_rows<lib::sin<std::complex<R>>>(rows);
}

TYPED_TEST(LibraryComplexSpecial, TanhAndTan) {
  using R = TypeParam;
  using f = LibraryComplexSpecial<R>;
  const std::vector<row<R>> rows = {
      {0, 0, 0, 0},
      {0, f::inf, 0, f::nan},
      {0, f::nan, 0, f::nan},
      {1, f::inf, f::nan, f::nan},
      {1, f::nan, f::nan, f::nan},
      {f::inf, 1, 1, 0},
      {f::inf, 2, 1, R(-0.0)},
      {f::inf, f::inf, 1, 0, 'i'},
      {f::inf, f::nan, 1, 0, 'i'},
      {f::nan, 0, f::nan, 0},
      {f::nan, 1, f::nan, f::nan},
      {f::nan, f::nan, f::nan, f::nan},
  };
  this->template expect_rows<lib::tanh<std::complex<R>>>(rows, 'o');
  this->template expect_turned_rows<lib::tan<std::complex<R>>>(rows);
}

TYPED_TEST(LibraryComplexSpecial, Log10) {
  using R = TypeParam;
  using f = LibraryComplexSpecial<R>;
  const auto by_ln_10 = [](long double x) {
    return static_cast<R>(x / std::numbers::ln10_v<long double>);
  };
  const R log_half_pi = by_ln_10(std::numbers::pi_v<long double> / 2);
  const R log_pi = by_ln_10(std::numbers::pi_v<long double>);
  const R log_quarter_pi = by_ln_10(std::numbers::pi_v<long double> / 4);
  const R log_three_quarters_pi = by_ln_10(3 * std::numbers::pi_v<long double> / 4);
  this->template expect_rows<lib::log10<std::complex<R>>>({
      {R(-0.0), 0, -f::inf, log_pi},
      {0, 0, -f::inf, 0},
      {100, 0, 2, 0},
      {1, f::inf, f::inf, log_half_pi},
      {1, f::nan, f::nan, f::nan},
      {-f::inf, 1, f::inf, log_pi},
      {f::inf, 1, f::inf, 0},
      {-f::inf, f::inf, f::inf, log_three_quarters_pi},
      {f::inf, f::inf, f::inf, log_quarter_pi},
      {f::inf, f::nan, f::inf, f::nan},
      {-f::inf, f::nan, f::inf, f::nan},
      {f::nan, 1, f::nan, f::nan},
      {f::nan, f::inf, f::inf, f::nan},
      {f::nan, f::nan, f::nan, f::nan},
  });
}

TYPED_TEST(LibraryComplexSpecial, Arg) {
  using R = TypeParam;
  using f = LibraryComplexSpecial<R>;
  using T = std::complex<R>;
  using F = lib::arg<T>;
  for (const R sign : {R(1), R(-1)}) {
    expect<F>(T(0, sign * R(0.0)), sign * R(0.0));
    expect<F>(T(R(-0.0), sign * R(0.0)), sign * f::pi);
    expect<F>(T(0, sign), sign * f::half_pi);
    expect<F>(T(f::inf, sign * f::inf), sign * f::quarter_pi);
    expect<F>(T(-f::inf, sign * f::inf), sign * f::three_quarters_pi);
    expect<F>(T(1, sign * f::inf), sign * f::half_pi);
    expect<F>(T(-f::inf, sign), sign * f::pi);
  }
  expect<F>(T(f::nan, 1), f::nan);
  expect<F>(T(1, f::nan), f::nan);
  expect<F>(T(f::nan, f::inf), f::nan);
}

TYPED_TEST(LibraryComplexSpecial, Cis) {
  using R = TypeParam;
  using f = LibraryComplexSpecial<R>;
  using T = std::complex<R>;
  using F = lib::cis<R>;
  expect<F>(R(0), T(1, 0));
  expect<F>(R(-0.0), T(1, R(-0.0)));
  for (const R x : {f::inf, -f::inf, f::nan}) expect<F>(x, T(f::nan, f::nan));
}

TYPED_TEST(LibraryComplexSpecial, MulByConj) {
  using R = TypeParam;
  using f = LibraryComplexSpecial<R>;
  using T = std::complex<R>;
  const auto call = [](T a, T b, std::uint32_t status) {
    T y = unwritten<T>();
    EXPECT_EQ((lib::mulbyconj<T>::call(&a, &b, &y)), status) << a << b;
    return y;
  };
  EXPECT_EQ(call({1, 2}, {3, 4}, 0), T(11, 2));
  const R big = values<R>::largest;
  EXPECT_EQ(call({big, 0}, {2, 0}, overflow).real(), f::inf);
  EXPECT_EQ(call({big, big}, {big, big}, overflow).real(), f::inf);
  const auto infinite = [](T z) { return std::isinf(z.real()) || std::isinf(z.imag()); };
  for (const R part : {R(0), R(1), f::inf, f::nan}) {
    EXPECT_TRUE(infinite(call({f::inf, part}, {1, 1}, 0))) << part;
    EXPECT_TRUE(infinite(call({part, f::inf}, {1, 1}, 0))) << part;
    EXPECT_TRUE(infinite(call({1, 1}, {f::inf, part}, 0))) << part;
    EXPECT_TRUE(infinite(call({f::inf, part}, {part, -f::inf}, 0))) << part;
    EXPECT_TRUE(infinite(call({f::inf, f::nan}, {part, 1}, 0))) << part;
    const T by_zero = call({f::inf, part}, {0, 0}, 0);
    EXPECT_TRUE(std::isnan(by_zero.real()) && std::isnan(by_zero.imag())) << part;
  }
  EXPECT_TRUE(std::isnan(call({f::nan, 1}, {1, 1}, 0).real()));
}

TYPED_TEST(LibraryComplexSpecial, PowAndPowx) {
  using R = TypeParam;
  using f = LibraryComplexSpecial<R>;
  using T = std::complex<R>;
  const std::vector<T> list = {{0, 0},      {2, 0},      {1, 1},           {-3, R(0.5)},
                               {0, f::inf}, {f::nan, 0}, {R(-0.0), f::inf}};
  for (const T a : list) {
    for (const T b : list) {
      T one, two;
      EXPECT_EQ((lib::pow<T>::call(&a, &b, &one)), 0u);
      EXPECT_EQ((lib::powx<T>::call(&a, b, &two)), 0u);
      EXPECT_TRUE(matches(element<T>::parts(expected(one)), element<T>::parts(two))) << a << b;
    }
  }
  const T two(2, 0), three(3, 0), zero(0, 0);
  T y;
  lib::pow<T>::call(&two, &three, &y);
  EXPECT_EQ(y, T(8, 0));
  lib::pow<T>::call(&zero, &two, &y);
  EXPECT_EQ(y, T(0, 0));
}

}  // namespace
}  // namespace arbor::lumen::tests::library
