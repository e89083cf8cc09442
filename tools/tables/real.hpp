// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Real numbers of 400 bits, and their rounding to words of tables.
#pragma once

#include <mpfr.h>

#include <bit>
#include <cstdint>
#include <utility>

namespace arbor::lumen::tables {

class real {
 public:
  real() {
    mpfr_init2(x_, precision);
    mpfr_set_zero(x_, 1);
  }
  real(double x) : real() { mpfr_set_d(x_, x, MPFR_RNDN); }
  real(const real& other) : real() { mpfr_set(x_, other.x_, MPFR_RNDN); }
  real& operator=(const real& other) {
    mpfr_set(x_, other.x_, MPFR_RNDN);
    return *this;
  }
  ~real() { mpfr_clear(x_); }

  /// a/b for integers.
  static real ratio(long a, long b) {
    real r;
    mpfr_set_si(r.x_, a, MPFR_RNDN);
    mpfr_div_si(r.x_, r.x_, b, MPFR_RNDN);
    return r;
  }
  /// The value of a pattern of a double, and of a float.
  static real of_double(std::uint64_t pattern) { return real(std::bit_cast<double>(pattern)); }
  static real of_float(std::uint32_t pattern) {
    return real(static_cast<double>(std::bit_cast<float>(pattern)));
  }

  friend real operator+(const real& a, const real& b) { return binary(mpfr_add, a, b); }
  friend real operator-(const real& a, const real& b) { return binary(mpfr_sub, a, b); }
  friend real operator*(const real& a, const real& b) { return binary(mpfr_mul, a, b); }
  friend real operator/(const real& a, const real& b) { return binary(mpfr_div, a, b); }
  friend real operator-(const real& a) { return unary(mpfr_neg, a); }
  friend bool operator<(const real& a, const real& b) { return mpfr_less_p(a.x_, b.x_) != 0; }

  friend real exp2(const real& x) { return unary(mpfr_exp2, x); }
  friend real exp(const real& x) { return unary(mpfr_exp, x); }
  friend real log(const real& x) { return unary(mpfr_log, x); }
  friend real log2(const real& x) { return unary(mpfr_log2, x); }
  friend real log10(const real& x) { return unary(mpfr_log10, x); }
  friend real sin(const real& x) { return unary(mpfr_sin, x); }
  friend real cos(const real& x) { return unary(mpfr_cos, x); }
  friend real tan(const real& x) { return unary(mpfr_tan, x); }
  friend real atan(const real& x) { return unary(mpfr_atan, x); }
  friend real sqrt(const real& x) { return unary(mpfr_sqrt, x); }
  friend real cbrt(const real& x) { return unary(mpfr_cbrt, x); }
  friend real pow(const real& x, const real& y) { return binary(mpfr_pow, x, y); }
  static real pi() {
    real r;
    mpfr_const_pi(r.x_, MPFR_RNDN);
    return r;
  }

  /// The nearest double and float, ties to even.
  double to_double(mpfr_rnd_t rounding = MPFR_RNDN) const { return mpfr_get_d(x_, rounding); }
  float to_float(mpfr_rnd_t rounding = MPFR_RNDN) const { return mpfr_get_flt(x_, rounding); }
  std::uint64_t double_word(mpfr_rnd_t rounding = MPFR_RNDN) const {
    return std::bit_cast<std::uint64_t>(to_double(rounding));
  }
  std::uint32_t float_word(mpfr_rnd_t rounding = MPFR_RNDN) const {
    return std::bit_cast<std::uint32_t>(to_float(rounding));
  }
  /// The value rounded to `bits` significant bits, for words that must be short.
  real rounded_to(int bits, mpfr_rnd_t rounding = MPFR_RNDN) const {
    real r(*this);
    mpfr_prec_round(r.x_, bits, rounding);
    mpfr_prec_round(r.x_, precision, rounding);
    return r;
  }

 private:
  static constexpr mpfr_prec_t precision = 400;

  template <typename Operation>
  static real unary(Operation operation, const real& a) {
    real r;
    operation(r.x_, a.x_, MPFR_RNDN);
    return r;
  }
  template <typename Operation>
  static real binary(Operation operation, const real& a, const real& b) {
    real r;
    operation(r.x_, a.x_, b.x_, MPFR_RNDN);
    return r;
  }

  mpfr_t x_;
};

/// A value as the sum of two doubles: the nearest one and the nearest one to what is left.
struct double_words {
  std::uint64_t high;
  std::uint64_t low;
};
inline double_words split(const real& x) {
  const double high = x.to_double();
  return {std::bit_cast<std::uint64_t>(high), (x - real(high)).double_word()};
}

/// A value as high·(1 + low).
inline double_words relative_split(const real& x) {
  const real high(x.to_double());
  return {high.double_word(), (x / high - real(1)).double_word()};
}

}  // namespace arbor::lumen::tables
