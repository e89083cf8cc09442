// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The errors of the Bessel functions. For arguments up to 40, the neighbours of the zeros
/// included, in units of the result; beyond, in units of the amplitude sqrt(2 / (pi a)).

#include <gtest/gtest.h>

#include "library/functions.hpp"
#include "library_errors.hpp"

namespace arbor::lumen::tests::library {
namespace {

namespace lib = vm::detail::library;

/// The order that the tests below have under way, for jn and yn.
int order = 0;

void exact_j(mpfr_ptr y, mpfr_srcptr x) {
  mpfr_jn(y, std::abs(order), x, MPFR_RNDN);
  if (order < 0 && order % 2 != 0) mpfr_neg(y, y, MPFR_RNDN);
}

/// Upwards by the recurrence, which is stable in this direction.
void exact_y(mpfr_ptr y, mpfr_srcptr x) {
  const int n = std::abs(order);
  if (n < 2) {
    mpfr_yn(y, n, x, MPFR_RNDN);
    return;
  }
  number below, value, above;
  mpfr_y0(below, x, MPFR_RNDN);
  mpfr_y1(value, x, MPFR_RNDN);
  for (int k = 1; k < n; ++k) {
    mpfr_mul_ui(above, value, 2 * static_cast<unsigned long>(k), MPFR_RNDN);
    mpfr_div(above, above, x, MPFR_RNDN);
    mpfr_sub(above, above, below, MPFR_RNDN);
    mpfr_swap(below, value);
    mpfr_swap(value, above);
  }
  mpfr_set(y, value, MPFR_RNDN);
  if (order < 0 && order % 2 != 0) mpfr_neg(y, y, MPFR_RNDN);
}

template <template <typename> typename F, typename T>
struct of_order {
  using input_type = T;
  static std::uint32_t call(const T* x, T* y) { return F<T>::call(x, static_cast<T>(order), y); }
};

/// The error in units of the last place of the amplitude, where the result is smaller than that.
template <typename F, typename T>
largest_error<T> errors_by_amplitude(exact_function exact, const std::vector<T>& list) {
  accuracy::ulp_error error_of(format_of<T>());
  largest_error<T> largest;
  number y;
  for (const T x : list) {
    exact(y, number(x));
    T result = std::numeric_limits<T>::quiet_NaN();
    F::call(&x, &result);
    const double value = std::fabs(mpfr_get_d(y, MPFR_RNDN));
    const double amplitude = std::sqrt(0.6366197723675814 / std::fabs(double{x}));
    const int binades = value < amplitude ? std::ilogb(amplitude) - std::ilogb(value) : 0;
    largest.meet(std::ldexp(error_of(result, y), -binades), x);
  }
  return largest;
}

template <typename F>
void expect_bessel(const std::string& function, exact_function exact, double from, int count) {
  using T = typename F::input_type;
  const std::string name = function + (sizeof(T) == 4 ? ", float" : ", double");
  expect_within(1.0, errors<F>(exact, arguments<T>({{from, 40}, {1, 40}}, count)), name);
  const double largest = std::sqrt(std::numeric_limits<T>::max());
  const std::vector<T> near = about_zeros<T>(exact, std::abs(order) + 0.5, 40, 200);
  EXPECT_GT(near.size(), 20u);
  expect_within(1.0, errors<F>(exact, near), name + ", near zeros up to 40");
  expect_within(1.0,
                errors_by_amplitude<F>(exact, arguments<T>({{40, 1000}, {40, largest}}, count / 4)),
                name + ", beyond 40 by amplitude");
  expect_within(1.0, errors_by_amplitude<F>(exact, about_zeros<T>(exact, 40, 60, 100)),
                name + ", near zeros beyond 40 by amplitude");
}

template <typename T>
void expect_orders_0_and_1() {
  const double smallest = std::numeric_limits<T>::denorm_min();
  order = 0;
  expect_bessel<lib::j0<T>>("j0", exact_j, -40, 250);
  expect_bessel<lib::y0<T>>("y0", exact_y, smallest, 250);
  order = 1;
  expect_bessel<lib::j1<T>>("j1", exact_j, -40, 250);
  expect_bessel<lib::y1<T>>("y1", exact_y, smallest, 250);
}

TEST(LibraryBessel, Orders0And1) {
  expect_orders_0_and_1<float>();
  expect_orders_0_and_1<double>();
}

template <typename T>
void expect_other_orders() {
  const double smallest = std::numeric_limits<T>::denorm_min();
  for (const int n : {2, 20, -5}) {
    order = n;
    const std::string name = std::to_string(n);
    expect_bessel<of_order<lib::jn, T>>("jn of order " + name, exact_j, -40, 40);
    expect_bessel<of_order<lib::yn, T>>("yn of order " + name, exact_y, smallest, 40);
  }
}

TEST(LibraryBessel, OtherOrders) {
  expect_other_orders<float>();
  expect_other_orders<double>();
}

}  // namespace
}  // namespace arbor::lumen::tests::library
