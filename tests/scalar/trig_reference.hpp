// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Sine, cosine and tangent of floats and doubles in 200 bits, and errors against them.
#pragma once

#include <mpfr.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <vector>

#include "bits.hpp"

namespace arbor::lumen::tests {

enum class trig { sine, cosine, tangent };

class trig_reference {
 public:
  trig_reference() { mpfr_inits2(200, x_, y_, nullptr); }
  ~trig_reference() { mpfr_clears(x_, y_, nullptr); }
  trig_reference(const trig_reference&) = delete;
  trig_reference& operator=(const trig_reference&) = delete;

  /// The distance of `result` from f(x), in units in the last place of f(x). x is not 0.
  template <typename T>
  double ulps(trig f, T x, T result) {
    if (std::isnan(result)) return std::numeric_limits<double>::infinity();
    mpfr_set_d(x_, static_cast<double>(x), MPFR_RNDN);
    const auto function = f == trig::sine ? mpfr_sin : f == trig::cosine ? mpfr_cos : mpfr_tan;
    function(y_, x_, MPFR_RNDN);
    using limits = std::numeric_limits<T>;
    const long exponent = std::max<long>(mpfr_get_exp(y_), limits::min_exponent) - limits::digits;
    mpfr_d_sub(y_, static_cast<double>(result), y_, MPFR_RNDN);
    mpfr_mul_2si(y_, y_, -exponent, MPFR_RNDN);
    return std::fabs(mpfr_get_d(y_, MPFR_RNDA));
  }

 private:
  mpfr_t x_;
  mpfr_t y_;
};

/// A functor of one result, or one of a functor of two, on one argument.
template <typename F, int output = 0, typename T = typename F::input_type>
T result_of(T x) {
  T first = unwritten<T>();
  if constexpr (requires { F::call(&x, &first, &first); }) {
    T second = unwritten<T>();
    F::call(&x, &first, &second);
    return output == 0 ? first : second;
  } else {
    F::call(&x, &first);
    return first;
  }
}

/// The results for the arguments and their negatives are within `limit` ulp of f.
template <typename F, int output = 0, typename U>
void expect_within(trig f, const std::vector<U>& arguments, double limit,
                   location where = location::current()) {
  using T = typename F::input_type;
  trig_reference exact;
  double largest = 0;
  T worst = 0;
  for (const U p : arguments) {
    for (const U sign : {U(0), named<U>::sign}) {
      const T x = element<T>::value(p ^ sign);
      const double error = exact.ulps(f, x, result_of<F, output>(x));
      if (error > largest) {
        largest = error;
        worst = x;
      }
    }
  }
  if (!(largest <= limit)) {
    ADD_FAILURE_AT(where.file, where.line)
        << functor_name<F>() << "\n  " << largest << " ulp at " << std::hexfloat << worst;
  }
}

/// Positive patterns in a range, `count` per binade.
template <typename U>
std::vector<U> every_binade(U lowest, U highest, int count) {
  constexpr int fraction_bits = sizeof(U) == 4 ? 23 : 52;
  pattern_source<U> source(lowest);
  std::vector<U> list;
  for (U e = lowest >> fraction_bits; e <= highest >> fraction_bits; ++e) {
    for (int i = 0; i < count; ++i) {
      const U p = (e << fraction_bits) | (source.any() & ((U(1) << fraction_bits) - 1));
      if (lowest <= p && p <= highest) list.push_back(p);
    }
  }
  return list;
}

/// Positive patterns of numbers evenly spread up to `highest`.
template <typename T>
std::vector<pattern_of<T>> evenly(T highest, int count) {
  pattern_source<pattern_of<T>> source(17);
  std::vector<pattern_of<T>> list;
  for (int i = 0; i < count; ++i) {
    const auto part = static_cast<double>(source.below(std::uint64_t{1} << 53)) * 0x1p-53;
    list.push_back(std::bit_cast<pattern_of<T>>(static_cast<T>(part * highest)));
  }
  return list;
}

/// A pattern and its neighbours.
template <typename U>
std::vector<U> around(U pattern) {
  std::vector<U> list;
  for (U p = pattern - 4; p <= pattern + 4; ++p) list.push_back(p);
  return list;
}

template <typename U>
std::vector<U> joined(std::vector<U> a, const std::vector<U>& b) {
  a.insert(a.end(), b.begin(), b.end());
  return a;
}

/// Those of `list` from `lowest` to `highest`.
template <typename U, std::size_t N>
std::vector<U> between(const U (&list)[N], U lowest, U highest) {
  std::vector<U> result;
  std::copy_if(std::begin(list), std::end(list), std::back_inserter(result),
               [=](U p) { return lowest <= p && p <= highest; });
  return result;
}

}  // namespace arbor::lumen::tests
