// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The functions of the catalogue in arbitrary precision, with the C library's versions of them and
/// the ranges over which they are measured.
#pragma once

#include <mpfr.h>

#include <span>
#include <string_view>
#include <vector>

namespace arbor::lumen::accuracy {

struct range {
  double low;
  double high;
};

/// One function. A function with two operands is measured over pairs of the ranges at one index,
/// one with two results gives both.
struct reference {
  std::string_view function;
  /// Rounds the results for operands `x` to the precision of `y`.
  void (*exact)(mpfr_t* y, const mpfr_t* x);
  float (*c_float)(float) = nullptr;     ///< the C library's, null where it has none
  double (*c_double)(double) = nullptr;  ///< within 2 ulp of double: 2^-28 ulp of float
  /// Where results are neither trivial nor infinite, by element type and operand.
  std::vector<range> half_ranges, float_ranges, double_ranges;

  const std::vector<range>& ranges(char type) const {
    return type == 'h' ? half_ranges : (type == 's' ? float_ranges : double_ranges);
  }
};

/// The reference of a function of the catalogue, or null: there is none yet.
const reference* find_reference(std::string_view function);

}  // namespace arbor::lumen::accuracy
