// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "library_reference.hpp"

#include "library_errors.hpp"

namespace arbor::lumen::tests::library::exact {

namespace {

/// -2/sqrt(pi) e^(-x^2), the derivative of erfc.
void erfc_derivative(mpfr_ptr y, mpfr_srcptr x) {
  number root;
  mpfr_const_pi(root, MPFR_RNDN);
  mpfr_sqrt(root, root, MPFR_RNDN);
  mpfr_sqr(y, x, MPFR_RNDN);
  mpfr_neg(y, y, MPFR_RNDN);
  mpfr_exp(y, y, MPFR_RNDN);
  mpfr_mul_si(y, y, -2, MPFR_RNDN);
  mpfr_div(y, y, root, MPFR_RNDN);
}

/// Newton's method for f(y) = p, f being erf or erfc by `sign` of its derivative, from the value in
/// y. erfc is taken as its logarithm, which is nearly a parabola: the method converges from afar.
void invert(mpfr_ptr y, mpfr_srcptr p, bool complement) {
  number value, slope, step, size;
  for (int i = 0; i < 200; ++i) {
    erfc_derivative(slope, y);
    if (complement) {
      mpfr_erfc(value, y, MPFR_RNDN);
      mpfr_div(slope, slope, value, MPFR_RNDN);
      mpfr_div(step, value, p, MPFR_RNDN);
      mpfr_log(step, step, MPFR_RNDN);
    } else {
      mpfr_erf(value, y, MPFR_RNDN);
      mpfr_neg(slope, slope, MPFR_RNDN);
      mpfr_sub(step, value, p, MPFR_RNDN);
    }
    mpfr_div(step, step, slope, MPFR_RNDN);
    mpfr_sub(y, y, step, MPFR_RNDN);
    // The error after a step is of the order of its square.
    mpfr_mul_2si(size, step, 70, MPFR_RNDN);
    if (mpfr_cmpabs(size, y) < 0) return;
  }
  mpfr_set_nan(y);
}

/// Sum of (x/2)^(2k + n) / (k! (n + k)!) for n = 0, 1.
void modified_bessel(mpfr_ptr y, mpfr_srcptr x, unsigned n) {
  number square, term;
  mpfr_div_2ui(term, x, 1, MPFR_RNDN);
  mpfr_sqr(square, term, MPFR_RNDN);
  if (n == 0) mpfr_set_ui(term, 1, MPFR_RNDN);
  mpfr_set(y, term, MPFR_RNDN);
  for (unsigned long k = 1; !mpfr_zero_p(term); ++k) {
    mpfr_mul(term, term, square, MPFR_RNDN);
    mpfr_div_ui(term, term, k * (k + n), MPFR_RNDN);
    mpfr_add(y, y, term, MPFR_RNDN);
    if (!mpfr_zero_p(term) && mpfr_get_exp(term) < mpfr_get_exp(y) - precision) return;
  }
}

}  // namespace

void erfcx(mpfr_ptr y, mpfr_srcptr x) {
  number square, root;
  mpfr_set_prec(square, 2 * precision);
  mpfr_sqr(square, x, MPFR_RNDN);
  if (mpfr_cmp_ui(x, 10'000) < 0) {
    mpfr_exp(root, square, MPFR_RNDN);
    mpfr_erfc(y, x, MPFR_RNDN);
    mpfr_mul(y, y, root, MPFR_RNDN);
    return;
  }
  // (1 - 1/(2 x^2) + 3/(4 x^4) - 15/(8 x^6)) / (x sqrt(pi)): four terms leave 10^-31.
  number u;
  mpfr_mul_2ui(u, square, 1, MPFR_RNDN);
  mpfr_ui_div(u, 1, u, MPFR_RNDN);
  mpfr_mul_si(y, u, -15, MPFR_RNDN);
  mpfr_add_ui(y, y, 3, MPFR_RNDN);
  mpfr_mul(y, y, u, MPFR_RNDN);
  mpfr_sub_ui(y, y, 1, MPFR_RNDN);
  mpfr_mul(y, y, u, MPFR_RNDN);
  mpfr_add_ui(y, y, 1, MPFR_RNDN);
  mpfr_const_pi(root, MPFR_RNDN);
  mpfr_sqrt(root, root, MPFR_RNDN);
  mpfr_mul(root, root, x, MPFR_RNDN);
  mpfr_div(y, y, root, MPFR_RNDN);
}

void erfinv(mpfr_ptr y, mpfr_srcptr x) {
  number q;
  mpfr_set_d(q, 0.75, MPFR_RNDN);
  if (mpfr_cmpabs(x, q) > 0) {
    mpfr_abs(q, x, MPFR_RNDN);
    mpfr_ui_sub(q, 1, q, MPFR_RNDN);
    erfcinv(y, q);
    mpfr_copysign(y, y, x, MPFR_RNDN);
    return;
  }
  mpfr_set(y, x, MPFR_RNDN);
  invert(y, x, false);
}

void erfcinv(mpfr_ptr y, mpfr_srcptr x) {
  number p;
  mpfr_set_d(p, 0.25, MPFR_RNDN);
  if (mpfr_cmp(x, p) < 0) {
    mpfr_log(y, x, MPFR_RNDN);
    mpfr_neg(y, y, MPFR_RNDN);
    mpfr_sqrt(y, y, MPFR_RNDN);
    invert(y, x, true);
    return;
  }
  mpfr_set_prec(p, 1200);
  mpfr_ui_sub(p, 1, x, MPFR_RNDN);
  erfinv(y, p);
}

void cdfnorm(mpfr_ptr y, mpfr_srcptr x) {
  number root;
  mpfr_set_prec(root, 2 * precision);
  mpfr_sqrt_ui(root, 2, MPFR_RNDN);
  mpfr_div(root, x, root, MPFR_RNDN);
  mpfr_neg(root, root, MPFR_RNDN);
  mpfr_erfc(y, root, MPFR_RNDN);
  mpfr_div_2ui(y, y, 1, MPFR_RNDN);
}

void cdfnorminv(mpfr_ptr y, mpfr_srcptr x) {
  number p;
  mpfr_mul_2ui(p, x, 1, MPFR_RNDN);
  erfcinv(y, p);
  mpfr_sqrt_ui(p, 2, MPFR_RNDN);
  mpfr_mul(y, y, p, MPFR_RNDN);
  mpfr_neg(y, y, MPFR_RNDN);
}

void expint1(mpfr_ptr y, mpfr_srcptr x) {
  number minus;
  mpfr_neg(minus, x, MPFR_RNDN);
  mpfr_eint(y, minus, MPFR_RNDN);
  mpfr_neg(y, y, MPFR_RNDN);
}

void lgamma(mpfr_ptr y, mpfr_srcptr x) {
  int sign;
  mpfr_lgamma(y, &sign, x, MPFR_RNDN);
}

void i0(mpfr_ptr y, mpfr_srcptr x) { modified_bessel(y, x, 0); }
void i1(mpfr_ptr y, mpfr_srcptr x) { modified_bessel(y, x, 1); }

}  // namespace arbor::lumen::tests::library::exact
