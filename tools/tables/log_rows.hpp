// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Rows of the logarithms' tables.
#pragma once

#include <cmath>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "real.hpp"
#include "table.hpp"

namespace arbor::lumen::tables {

/// The multiple of 2^exponent nearest to x, |x| < 2^(exponent + 51).
inline real nearest_multiple(const real& x, int exponent) {
  const real shifter(std::ldexp(1.5, exponent + 52));
  return real((x + shifter).to_double()) - shifter;
}

inline std::uint64_t word_of(const real& x, int word_bits) {
  return word_bits == 32 ? x.float_word() : x.double_word();
}
inline real value_of(std::uint64_t word, int word_bits) {
  return word_bits == 32 ? real::of_float(static_cast<std::uint32_t>(word)) : real::of_double(word);
}

/// round(grid / (1 + i/64)) / grid; there are no ties.
inline real rounded_reciprocal(int i, long grid) {
  const long divisor = 64 + i;
  return real::ratio((2 * 64 * grid + divisor) / (2 * divisor), grid);
}

/// How a logarithm v >= 0 is split into a short high word and a low one. The high word is the
/// nearest multiple of 2^small_grid where v < 1/16, of 2^grid elsewhere, so that its sum with a
/// multiple of the logarithm of two is exact; if the low word, rounded, misses v by `error` or
/// more, of the next finer grid for which it does not.
struct short_split {
  int small_grid;
  int grid;
  double error;
};

struct words {
  std::uint64_t high;
  std::uint64_t low;
};

inline words split_short(const real& v, const short_split& rule, int word_bits) {
  for (int grid = v < real::ratio(1, 16) ? rule.small_grid : rule.grid;; --grid) {
    const real high = nearest_multiple(v, grid);
    const std::uint64_t low = word_of(v - high, word_bits);
    const real error = v - high - value_of(low, word_bits);
    if (error < real(rule.error) && -error < real(rule.error))
      return {word_of(high, word_bits), low};
  }
}

/// Of the two words next to x the nearer one, in a tie the larger one; x > 0.
inline std::uint64_t nearest_ties_up(const real& x, int word_bits) {
  const auto word = [&](mpfr_rnd_t rounding) -> std::uint64_t {
    return word_bits == 32 ? x.float_word(rounding) : x.double_word(rounding);
  };
  const std::uint64_t down = word(MPFR_RNDD);
  const std::uint64_t up = word(MPFR_RNDU);
  return x - value_of(down, word_bits) < value_of(up, word_bits) - x ? down : up;
}

/// The 65 rows at the breakpoints 1 + i/64: the reciprocal, times `scale` if the path is a scaled
/// one, and its logarithm with the sign changed.
struct breakpoint_rule {
  int word_bits;
  long grid;  ///< reciprocals are multiples of 1/grid
  real scale;
  real (*logarithm)(const real&);
  short_split split;
};

inline std::vector<std::uint64_t> breakpoint_rows(const breakpoint_rule& rule) {
  std::vector<std::uint64_t> rows;
  for (int i = 0; i <= 64; ++i) {
    const real reciprocal = rounded_reciprocal(i, rule.grid);
    const words logarithm =
        split_short(real(0) - rule.logarithm(reciprocal), rule.split, rule.word_bits);
    rows.insert(rows.end(), {nearest_ties_up(reciprocal * rule.scale, rule.word_bits),
                             logarithm.high, logarithm.low});
  }
  return rows;
}

inline real natural_logarithm(const real& x) { return log(x); }
inline real binary_logarithm(const real& x) { return log2(x); }
inline real decimal_logarithm(const real& x) { return log10(x); }

/// -log(R/512) for R = 512..724 and -log(R/1024) for R = 725..1024 in word R - 512.
inline table single_values(const std::string& name, const std::string& logarithm,
                           real (*function)(const real&)) {
  table t{name,
          "Word R - 512: -" + logarithm + "(R/512) up to R = 724, -" + logarithm +
              "(R/1024) from there to\nR = 1024, to the nearest.",
          64,
          4,
          {}};
  for (int r = 512; r <= 1024; ++r)
    t.words.push_back((-function(real::ratio(r, r <= 724 ? 512 : 1024))).double_word());
  return t;
}

/// Pairs whose high and low word absorb an exponent bias: -log(R/last) less `bias` times the
/// logarithm of two in its two words `two`. As the bodies add multiples of those, they stand also
/// for -log(1/2). The high word is a multiple of 2^high_unit, the unit of the high word of `two`;
/// the low one is a multiple of 2^low_unit or, without a unit, the nearest word.
struct biased_pair_rule {
  int word_bits;
  int first, last;  ///< of R; last = 2·first
  int bias;
  words two;
  int high_unit;
  std::optional<int> low_unit;
};

inline words biased_pair(const biased_pair_rule& rule, int r, real (*function)(const real&)) {
  const real two_high = value_of(rule.two.high, rule.word_bits);
  const real two_low = value_of(rule.two.low, rule.word_bits);
  real high = two_high;
  real low = two_low;
  if (r != rule.first) {
    const real logarithm = -function(real::ratio(r, rule.last));
    high = nearest_multiple(logarithm, rule.high_unit);
    low = logarithm - high;
    if (rule.low_unit) low = nearest_multiple(low, *rule.low_unit);
  }
  const real bias(rule.bias);
  return {word_of(high - bias * two_high, rule.word_bits),
          word_of(low - bias * two_low, rule.word_bits)};
}

/// The rows of R, two words each, where R's own pattern leads: in the binade of `last` they follow
/// each other, in the one below, that is below `power_of_two`, each is followed by two unused
/// words.
inline std::vector<std::uint64_t> biased_pairs(const biased_pair_rule& rule, int power_of_two,
                                               real (*function)(const real&)) {
  std::vector<std::uint64_t> list;
  for (int r = rule.first; r <= rule.last; ++r) {
    const words pair = biased_pair(rule, r, function);
    list.insert(list.end(), {pair.high, pair.low});
    if (r < power_of_two) list.insert(list.end(), {0, 0});
  }
  return list;
}

}  // namespace arbor::lumen::tables
