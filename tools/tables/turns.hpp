// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The binary digits of 1/(2 pi) and of 4/pi, and words of them.
#pragma once

#include <mpfr.h>

#include <cstdint>
#include <string>

#include "real.hpp"

namespace arbor::lumen::tables {

/// The leading binary digits of a positive number below 2, from the one at 2^0 down.
class binary_digits {
 public:
  /// Those of factor/pi.
  static binary_digits over_pi(double factor) { return binary_digits(factor); }

  /// The integer of the `count` digits of which the first one is that at 2^-place. The number has
  /// no digits before its first.
  std::uint64_t word(int place, int count) const {
    std::uint64_t w = 0;
    for (int i = place; i < place + count; ++i)
      w = (w << 1) | (i >= 0 && digits_.at(static_cast<std::size_t>(i)) == '1' ? 1u : 0u);
    return w;
  }

 private:
  static constexpr int count_ = 1500;

  explicit binary_digits(double factor) {
    mpfr_t x;
    mpfr_init2(x, count_ + 100);
    mpfr_const_pi(x, MPFR_RNDN);
    mpfr_d_div(x, factor, x, MPFR_RNDN);
    mpfr_exp_t exponent = 0;
    char* text = mpfr_get_str(nullptr, &exponent, 2, count_, x, MPFR_RNDZ);
    digits_ = std::string(static_cast<std::size_t>(1 - exponent), '0') + text;
    mpfr_free_str(text);
    mpfr_clear(x);
  }

  std::string digits_;
};

/// The signed power of two nearest to x, or 0 for 0.
inline real nearest_power_of_two(const real& x) {
  const real zero(0.0);
  if (!(x < zero) && !(zero < x)) return zero;
  const bool negative = x < zero;
  const real magnitude = negative ? -x : x;
  real power(1.0);
  while (magnitude < power) power = power / real(2.0);
  if (real(1.5) * power < magnitude) power = power * real(2.0);
  return negative ? -power : power;
}

}  // namespace arbor::lumen::tables
