// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The errors of the complex functions against MPC, each part in units of its own last place,
/// and the whole in units of the larger part.

#include <gtest/gtest.h>
#include <mpc.h>

#include <complex>

#include "library/functions.hpp"
#include "library_errors.hpp"

namespace arbor::lumen::tests::library {
namespace {

namespace lib = vm::detail::library;

/// A complex number of MPC that frees itself.
class complex_number {
 public:
  complex_number() { mpc_init2(value_, 250); }
  explicit complex_number(std::complex<double> z) : complex_number() {
    mpc_set_d_d(value_, z.real(), z.imag(), MPC_RNDNN);
  }
  ~complex_number() { mpc_clear(value_); }
  complex_number(const complex_number&) = delete;
  complex_number& operator=(const complex_number&) = delete;
  mpc_ptr get() { return value_; }
  mpfr_srcptr real() const { return mpc_realref(value_); }
  mpfr_srcptr imag() const { return mpc_imagref(value_); }

 private:
  mpc_t value_;
};

using complex_function = int (*)(mpc_ptr, mpc_srcptr, mpc_rnd_t);

/// The largest error of either part, and of the whole in units of the larger part.
template <typename T>
struct complex_errors {
  largest_error<T> part;
  largest_error<T> whole;
};

template <typename R>
std::ostream& print(std::ostream& out, const largest_error<std::complex<R>>& e) {
  return out << e.ulp << " ulp at (" << std::hexfloat << e.at.real() << ", " << e.at.imag() << ") "
             << std::defaultfloat << e.at;
}

template <typename T>
void meet(complex_errors<T>& all, const complex_number& exact, T result, T at) {
  using R = typename T::value_type;
  accuracy::ulp_error error_of(format_of<R>());
  const double re = error_of(result.real(), exact.real());
  const double im = error_of(result.imag(), exact.imag());
  all.part.meet(re, at);
  all.part.meet(im, at);
  const auto binade = [](mpfr_srcptr x) {
    return mpfr_zero_p(x) ? -std::numeric_limits<R>::max_exponent
                          : std::max<long>(mpfr_get_exp(x), std::numeric_limits<R>::min_exponent);
  };
  const long e_re = binade(exact.real());
  const long e_im = binade(exact.imag());
  const long top = std::max(e_re, e_im);
  all.whole.meet(std::ldexp(re, static_cast<int>(e_re - top)), at);
  all.whole.meet(std::ldexp(im, static_cast<int>(e_im - top)), at);
}

/// Arguments with parts up to `limit`: by value, by pattern, close to the axes, to the unit circle
/// and to the branch points ±1, ±i.
template <typename R>
std::vector<std::complex<R>> complex_arguments(double limit, int count) {
  const accuracy::number_format& format = format_of<R>();
  std::mt19937_64 engine(20240917);
  std::uniform_real_distribution<double> values(-1, 1);
  const std::int64_t top = format.rank(format.pattern(limit));
  std::uniform_int_distribution<std::int64_t> ranks(-top, top);
  const auto by_pattern = [&] {
    return static_cast<R>(format.value(format.at_rank(ranks(engine))));
  };
  const auto by_value = [&](double scale) { return static_cast<R>(scale * values(engine)); };
  std::vector<std::complex<R>> list;
  for (int i = 0; i < count; ++i) {
    list.emplace_back(by_value(limit), by_value(limit));
    list.emplace_back(by_value(4), by_value(4));
    list.emplace_back(by_pattern(), by_pattern());
    list.emplace_back(by_pattern(), by_value(2));
    list.emplace_back(by_value(2), by_pattern());
    const double angle = 4 * values(engine);
    list.emplace_back(static_cast<R>(std::cos(angle)), static_cast<R>(std::sin(angle)));
    const double distance = std::ldexp(1.0, -static_cast<int>(engine() % 30));
    const R off = static_cast<R>(1 + distance * values(engine));
    const R aside = by_value(distance);
    list.emplace_back(off, aside);
    list.emplace_back(-off, aside);
    list.emplace_back(aside, off);
    list.emplace_back(aside, -off);
  }
  return list;
}

template <typename T>
void expect_complex(double limit, double whole_limit, const complex_errors<T>& e,
                    const std::string& what) {
  std::ostringstream part, whole;
  print(part << what << ", part: ", e.part);
  print(whole << what << ", whole: ", e.whole);
  EXPECT_LE(e.part.ulp, limit) << part.str();
  EXPECT_LE(e.whole.ulp, whole_limit) << whole.str();
  if (std::getenv("LUMEN_TEST_VERBOSE") != nullptr)
    std::cout << part.str() << '\n' << whole.str() << '\n';
}

template <typename F>
void expect_type(const std::string& name, complex_function exact, double domain, double limit) {
  using T = typename F::input_type;
  complex_errors<T> all;
  complex_number y;
  for (const T z : complex_arguments<typename T::value_type>(domain, 150)) {
    exact(y.get(), complex_number(z).get(), MPC_RNDNN);
    T result;
    F::call(&z, &result);
    meet(all, y, result, z);
  }
  expect_complex(limit, 1.0, all, name + (sizeof(T) == 8 ? ", complex float" : ", complex double"));
}

template <template <typename> typename F>
void expect_function(const std::string& name, complex_function exact, double float_domain,
                     double double_domain) {
  expect_type<F<std::complex<float>>>(name, exact, float_domain, 1.0);
  expect_type<F<std::complex<double>>>(name, exact, double_domain, 1.0);
}

TEST(LibraryComplexErrors, TrigonometricFunctions) {
  expect_function<lib::sin>("sin", mpc_sin, 92, 714);
  expect_function<lib::cos>("cos", mpc_cos, 92, 714);
  expect_function<lib::tan>("tan", mpc_tan, 92, 714);
}

TEST(LibraryComplexErrors, HyperbolicFunctions) {
  expect_function<lib::sinh>("sinh", mpc_sinh, 92, 714);
  expect_function<lib::cosh>("cosh", mpc_cosh, 92, 714);
  expect_function<lib::tanh>("tanh", mpc_tanh, 92, 714);
}

TEST(LibraryComplexErrors, InverseTrigonometricFunctions) {
  expect_function<lib::asin>("asin", mpc_asin, 1e30, 1e300);
  expect_function<lib::acos>("acos", mpc_acos, 1e30, 1e300);
  expect_function<lib::atan>("atan", mpc_atan, 1e30, 1e300);
}

TEST(LibraryComplexErrors, InverseHyperbolicFunctions) {
  expect_function<lib::asinh>("asinh", mpc_asinh, 1e30, 1e300);
  expect_function<lib::acosh>("acosh", mpc_acosh, 1e30, 1e300);
  expect_function<lib::atanh>("atanh", mpc_atanh, 1e30, 1e300);
}

TEST(LibraryComplexErrors, Logarithm) {
  expect_function<lib::log10>("log10", mpc_log10, 1e38, 1e308);
}

template <typename R>
void expect_arg_and_cis(const std::string& type) {
  using T = std::complex<R>;
  accuracy::ulp_error error_of(format_of<R>());
  largest_error<T> arg;
  number angle;
  for (const T z : complex_arguments<R>(1e38, 300)) {
    mpc_arg(angle, complex_number(z).get(), MPFR_RNDN);
    R result;
    lib::arg<T>::call(&z, &result);
    arg.meet(error_of(result, angle), z);
  }
  std::ostringstream text;
  print(text, arg);
  EXPECT_LE(arg.ulp, 1.0) << "arg, " << type << ": " << text.str();

  largest_error<R> cis;
  for (const R x : arguments<R>({{-1e30, 1e30}, {-7, 7}}, 1000)) {
    T result;
    lib::cis<R>::call(&x, &result);
    mpfr_cos(angle, number(x), MPFR_RNDN);
    cis.meet(error_of(result.real(), angle), x);
    mpfr_sin(angle, number(x), MPFR_RNDN);
    cis.meet(error_of(result.imag(), angle), x);
  }
  expect_within(1.0, cis, "cis, " + type);
}

TEST(LibraryComplexErrors, ArgumentAndPointOfTheCircle) {
  expect_arg_and_cis<float>("complex float");
  expect_arg_and_cis<double>("complex double");
}

/// Pairs of factors; in every other one the products nearly cancel in a part.
template <typename R>
void expect_mulbyconj(const std::string& type) {
  using T = std::complex<R>;
  const std::vector<T> list = complex_arguments<R>(1e15, 300);
  complex_errors<T> all;
  complex_number y;
  for (std::size_t i = 0; i + 1 < list.size(); ++i) {
    const T a = list[i];
    const R spread = std::nextafter(R(1), R(2));
    const T b = i % 2 == 0 ? list[i + 1] : T(a.imag() * R(1.3), -a.real() * R(1.3) * spread);
    mpc_conj(y.get(), complex_number(b).get(), MPC_RNDNN);
    mpc_mul(y.get(), y.get(), complex_number(a).get(), MPC_RNDNN);
    T result;
    lib::mulbyconj<T>::call(&a, &b, &result);
    meet(all, y, result, a);
  }
  expect_complex(1.0, 1.0, all, "mulbyconj, " + type);
}

TEST(LibraryComplexErrors, ProductWithTheConjugate) {
  expect_mulbyconj<float>("complex float");
  expect_mulbyconj<double>("complex double");
}

/// Only the whole has a bound: where the angle comes close to a multiple of pi/2, the small part is
/// as inexact as the angle.
template <typename R>
void expect_pow(const std::string& type) {
  using T = std::complex<R>;
  const std::vector<T> list = complex_arguments<R>(100, 600);
  complex_errors<T> all;
  complex_number y;
  for (std::size_t i = 0; i + 7 < list.size(); ++i) {
    const T a = list[i];
    const T b = list[i + 7];
    mpc_pow(y.get(), complex_number(a).get(), complex_number(b).get(), MPC_RNDNN);
    T result;
    lib::pow<T>::call(&a, &b, &result);
    meet(all, y, result, a);
  }
  expect_complex(std::numeric_limits<double>::infinity(), 1.0, all, "pow, " + type);
}

TEST(LibraryComplexErrors, Power) {
  expect_pow<float>("complex float");
  expect_pow<double>("complex double");
}

}  // namespace
}  // namespace arbor::lumen::tests::library
