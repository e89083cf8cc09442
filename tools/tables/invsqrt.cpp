// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The table of invsqrt.

#include "real.hpp"
#include "table.hpp"

namespace arbor::lumen::tables {
namespace {

table rows() {
  table t{
      "_arrdInvSqrtHATab",
      "Word j = 0..64: 1/sqrt(m), rounded to 26 bits, for m = 1 + j/32 up to j = 32, from there\n"
      "m = j/16: the mantissas of even exponents, then those of odd ones. From word 65 the\n"
      "constants of the path: the series of (1 - t)^(-1/2) from t^8 to t^2, 1/2, 1, 2^60,\n"
      "2^47 + 1, 2^27 and -0. One table for all tiers and types.",
      64,
      4,
      {}};
  for (int j = 0; j <= 64; ++j) {
    const real m = j <= 32 ? real::ratio(32 + j, 32) : real::ratio(j, 16);
    t.words.push_back((real(1) / sqrt(m)).rounded_to(26).double_word());
  }
  t.words.insert(t.words.end(),
                 {0x3fc91a80bfbf8b2a, 0x3fcad28a9e3226df, 0x3fcce000c07a3b3e, 0x3fcf7fffec1426e4,
                  0x3fd17ffffffe2a26, 0x3fd400000000138b, 0x3fd8000000000001, 0x3fe0000000000000,
                  0x3ff0000000000000, 0x43b0000000000000, 0x42e0000000000020, 0x41a0000000000000,
                  0x8000000000000000});
  return t;
}

const registration invsqrt("invsqrt", [] { return std::vector<table>{rows()}; });

}  // namespace
}  // namespace arbor::lumen::tables
