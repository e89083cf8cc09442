// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Tables over 32 intervals of [1, 2), of roots and powers at their middles.
#pragma once

#include <cstdint>
#include <vector>

#include "real.hpp"

namespace arbor::lumen::tables {

/// The middle of the i-th of 32 intervals of [1, 2).
inline real middle(int i) { return real::ratio(65 + 2 * i, 64); }

inline std::uint64_t nearest_word(const real& x, int word_bits) {
  return word_bits == 32 ? x.float_word() : x.double_word();
}

/// The nearest word, and the one nearest to what it leaves out.
inline void append_pair(std::vector<std::uint64_t>& list, const real& x, int word_bits) {
  const std::uint64_t high = nearest_word(x, word_bits);
  const real value =
      word_bits == 32 ? real::of_float(static_cast<std::uint32_t>(high)) : real::of_double(high);
  list.insert(list.end(), {high, nearest_word(x - value, word_bits)});
}

/// sign/middle(i), i = 0..31: bodies that take the middle less the mantissa need the negative one.
inline void append_reciprocals(std::vector<std::uint64_t>& list, int sign, int word_bits) {
  for (int i = 0; i < 32; ++i) list.push_back(nearest_word(real(sign) / middle(i), word_bits));
}

/// (2^k·middle(i))^(a/b).
inline real power_of_row(int k, int i, int a, int b) {
  return pow(exp2(real(k)) * middle(i), real::ratio(a, b));
}

/// The coefficients of (1 + g)^(a/b), from g^degree down to g^1.
inline std::vector<real> binomial_series(int a, int b, int degree) {
  std::vector<real> highest_first;
  real c(1);
  for (int j = 1; j <= degree; ++j) {
    c = c * real::ratio(a - b * (j - 1), b * j);
    highest_first.insert(highest_first.begin(), c);
  }
  return highest_first;
}

}  // namespace arbor::lumen::tables
