// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Complex functions of finite numbers in 300 bits, and the errors of parts against them.
#pragma once

#include <mpfr.h>

#include <algorithm>
#include <cmath>
#include <complex>
#include <limits>

#include "bits.hpp"

namespace arbor::lumen::tests {

class complex_reference {
 public:
  complex_reference() { mpfr_inits2(300, x_, y_, a_, b_, re_, im_, nullptr); }
  ~complex_reference() { mpfr_clears(x_, y_, a_, b_, re_, im_, nullptr); }
  complex_reference(const complex_reference&) = delete;
  complex_reference& operator=(const complex_reference&) = delete;

  template <typename R>
  void exp(std::complex<R> z) {
    read(z);
    mpfr_sin_cos(im_, re_, y_, MPFR_RNDN);
    mpfr_exp(a_, x_, MPFR_RNDN);
    mpfr_mul(re_, re_, a_, MPFR_RNDN);
    mpfr_mul(im_, im_, a_, MPFR_RNDN);
  }

  /// Of a number other than 0. Near |z| = 1 from |z|² - 1, which is x² - 1 + y².
  template <typename R>
  void ln(std::complex<R> z) {
    read(z);
    mpfr_atan2(im_, y_, x_, MPFR_RNDN);
    mpfr_hypot(re_, x_, y_, MPFR_RNDN);
    if (mpfr_cmp_d(re_, 0.5) > 0 && mpfr_cmp_d(re_, 2) < 0) {
      mpfr_sqr(a_, x_, MPFR_RNDN);
      mpfr_sub_ui(a_, a_, 1, MPFR_RNDN);
      mpfr_sqr(b_, y_, MPFR_RNDN);
      // The larger of the squares first, so that what is left of 1 is exact.
      if (mpfr_cmpabs(x_, y_) < 0) {
        mpfr_sub_ui(a_, b_, 1, MPFR_RNDN);
        mpfr_sqr(b_, x_, MPFR_RNDN);
      }
      mpfr_add(a_, a_, b_, MPFR_RNDN);
      mpfr_log1p(re_, a_, MPFR_RNDN);
      mpfr_div_2ui(re_, re_, 1, MPFR_RNDN);
    } else {
      mpfr_log(re_, re_, MPFR_RNDN);
    }
  }

  template <typename R>
  void sqrt(std::complex<R> z) {
    read(z);
    mpfr_hypot(a_, x_, y_, MPFR_RNDN);
    mpfr_abs(b_, x_, MPFR_RNDN);
    mpfr_add(a_, a_, b_, MPFR_RNDN);
    mpfr_div_2ui(a_, a_, 1, MPFR_RNDN);
    mpfr_sqrt(re_, a_, MPFR_RNDN);
    mpfr_div(im_, y_, re_, MPFR_RNDN);
    mpfr_div_2ui(im_, im_, 1, MPFR_RNDN);
    if (mpfr_sgn(x_) < 0) {
      mpfr_swap(re_, im_);
      mpfr_abs(re_, re_, MPFR_RNDN);
      mpfr_setsign(im_, im_, mpfr_signbit(y_), MPFR_RNDN);
    }
  }

  /// The larger of the errors of both parts, in units in the last place.
  template <typename R>
  double ulps(std::complex<R> result) {
    return std::max(part_ulps(result.real(), re_), part_ulps(result.imag(), im_));
  }

  /// Whether a part of the exact value rounds to an infinity.
  template <typename R>
  bool overflows() {
    return overflows<R>(re_) || overflows<R>(im_);
  }

 private:
  template <typename R>
  void read(std::complex<R> z) {
    mpfr_set_d(x_, static_cast<double>(z.real()), MPFR_RNDN);
    mpfr_set_d(y_, static_cast<double>(z.imag()), MPFR_RNDN);
  }

  template <typename R>
  static bool overflows(const mpfr_t& exact) {
    using limits = std::numeric_limits<R>;
    mpfr_t bound;
    mpfr_init2(bound, limits::digits + 1);
    mpfr_set_ui_2exp(bound, 1, limits::max_exponent, MPFR_RNDN);
    mpfr_nextbelow(bound);  // halfway between the largest number and the next power of two
    const bool beyond = mpfr_cmpabs(exact, bound) >= 0;
    mpfr_clear(bound);
    return beyond;
  }

  template <typename R>
  double part_ulps(R result, const mpfr_t& exact) {
    using limits = std::numeric_limits<R>;
    constexpr double infinity = std::numeric_limits<double>::infinity();
    if (overflows<R>(exact)) {
      // Up to a unit below the bound the largest number is as good.
      return std::isinf(result) && std::signbit(result) == (mpfr_signbit(exact) != 0) ? 0
             : std::fabs(result) == limits::max()                                     ? 1
                                                                                      : infinity;
    }
    if (std::isnan(result)) return infinity;
    if (std::isinf(result)) {
      mpfr_abs(a_, exact, MPFR_RNDN);
      return mpfr_cmp_d(a_, static_cast<double>(limits::max())) >= 0 ? 1 : infinity;
    }
    if (result == 0 && mpfr_zero_p(exact)) return 0;
    const long exponent =
        std::max<long>(mpfr_get_exp(exact), limits::min_exponent) - limits::digits;
    mpfr_d_sub(a_, static_cast<double>(result), exact, MPFR_RNDN);
    mpfr_mul_2si(a_, a_, -exponent, MPFR_RNDN);
    return std::fabs(mpfr_get_d(a_, MPFR_RNDA));
  }

  mpfr_t x_, y_, a_, b_, re_, im_;
};

/// The result of a functor on one complex number.
template <typename F, typename T = typename F::input_type>
T complex_result_of(T z) {
  T result = unwritten<T>();
  F::call(&z, &result);
  return result;
}

}  // namespace arbor::lumen::tests
