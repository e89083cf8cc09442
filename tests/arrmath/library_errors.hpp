// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Errors of real functions of one argument against MPFR, over samples.
#pragma once

#include <gtest/gtest.h>
#include <mpfr.h>

#include <cmath>
#include <cstdint>
#include <iostream>
#include <limits>
#include <random>
#include <string>
#include <type_traits>
#include <vector>

#include "accuracy/number_format.hpp"
#include "accuracy/ulp_error.hpp"

namespace arbor::lumen::tests::library {

/// Bits of the exact values.
inline constexpr mpfr_prec_t precision = 180;

/// A number of MPFR that frees itself.
class number {
 public:
  number() { mpfr_init2(value_, precision); }
  explicit number(double x) : number() { mpfr_set_d(value_, x, MPFR_RNDN); }
  ~number() { mpfr_clear(value_); }
  number(const number&) = delete;
  number& operator=(const number&) = delete;
  int sign() const { return mpfr_sgn(value_); }
  operator mpfr_ptr() { return value_; }
  operator mpfr_srcptr() const { return value_; }

 private:
  mpfr_t value_;
};

/// The exact value at x, in `precision` bits.
using exact_function = void (*)(mpfr_ptr y, mpfr_srcptr x);

struct range {
  double low, high;
};

template <typename T>
const accuracy::number_format& format_of() {
  return std::is_same_v<T, float> ? accuracy::float_format : accuracy::double_format;
}

/// Arguments within the ranges: their ends, as many at random by pattern, and as many by value.
template <typename T>
std::vector<T> arguments(const std::vector<range>& ranges, int count) {
  const accuracy::number_format& format = format_of<T>();
  std::mt19937_64 engine(20240917);
  std::vector<T> list;
  for (const range& r : ranges) {
    const T low = static_cast<T>(r.low);
    const T high = static_cast<T>(r.high);
    for (const T end : {low, high}) {
      list.push_back(end);
      list.push_back(std::nextafter(end, low + (high - low) / 2));
    }
    std::uniform_int_distribution<std::int64_t> ranks(format.rank(format.pattern(low)),
                                                      format.rank(format.pattern(high)));
    std::uniform_real_distribution<double> values(0, 1);
    for (int i = 0; i < count; ++i) {
      list.push_back(static_cast<T>(format.value(format.at_rank(ranks(engine)))));
      const double t = values(engine);
      list.push_back(static_cast<T>(r.low * (1 - t) + r.high * t));
    }
  }
  return list;
}

/// The largest error met, and where.
template <typename T>
struct largest_error {
  double ulp = 0;
  T at = 0;

  void meet(double error, T x) {
    if (std::fabs(error) <= ulp) return;
    ulp = std::fabs(error);
    at = x;
  }
};

template <typename T>
std::ostream& operator<<(std::ostream& out, const largest_error<T>& e) {
  return out << e.ulp << " ulp at " << std::hexfloat << e.at << std::defaultfloat << " (" << e.at
             << ")";
}

/// The numbers about the zero of a function between two arguments with values of unlike signs.
template <typename T>
std::vector<T> about_zero(exact_function exact, T low, T high) {
  const accuracy::number_format& format = format_of<T>();
  number y;
  const auto positive = [&](T x) {
    exact(y, number(x));
    return y.sign() > 0;
  };
  std::int64_t from = format.rank(format.pattern(low));
  std::int64_t to = format.rank(format.pattern(high));
  const bool rising = positive(high);
  while (to - from > 1) {
    const std::int64_t middle = from + (to - from) / 2;
    const T x = static_cast<T>(format.value(format.at_rank(middle)));
    (positive(x) == rising ? to : from) = middle;
  }
  std::vector<T> list;
  for (std::int64_t distance = 0; distance < (std::int64_t{1} << 40); distance = 8 * distance + 1) {
    list.push_back(static_cast<T>(format.value(format.at_rank(to + distance))));
    list.push_back(static_cast<T>(format.value(format.at_rank(from - distance))));
    if (sizeof(T) == 4 && distance > (1 << 12)) break;
  }
  return list;
}

/// Numbers about all zeros in a range that a walk of this many steps tells apart.
template <typename T>
std::vector<T> about_zeros(exact_function exact, double low, double high, int steps) {
  std::vector<T> list;
  number y;
  T before = static_cast<T>(low);
  exact(y, number(before));
  int sign = y.sign();
  for (int i = 1; i <= steps; ++i) {
    const T x = static_cast<T>(low + (high - low) * i / steps);
    exact(y, number(x));
    if (y.sign() * sign < 0) {
      for (const T near : about_zero<T>(exact, before, x)) list.push_back(near);
    }
    sign = y.sign();
    before = x;
  }
  return list;
}

/// What a functor errs over the arguments.
template <typename F, typename T = typename F::input_type>
largest_error<T> errors(exact_function exact, const std::vector<T>& list) {
  accuracy::ulp_error error_of(format_of<T>());
  largest_error<T> largest;
  number y;
  for (const T x : list) {
    exact(y, number(x));
    T result = std::numeric_limits<T>::quiet_NaN();
    F::call(&x, &result);
    largest.meet(error_of(result, y), x);
  }
  return largest;
}

/// Asserts a limit, and says what was met where LUMEN_TEST_VERBOSE is set.
template <typename T>
void expect_within(double limit, const largest_error<T>& e, const std::string& what) {
  EXPECT_LE(e.ulp, limit) << what << ": " << e;
  if (std::getenv("LUMEN_TEST_VERBOSE") != nullptr) std::cout << what << ": " << e << '\n';
}

}  // namespace arbor::lumen::tests::library
