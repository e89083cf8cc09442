// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The error of a result in units in the last place of the exact value.
#pragma once

#include <mpfr.h>

#include "number_format.hpp"

namespace arbor::lumen::accuracy {

/// Measures results of one format. The unit is that of the binade of the exact value, and below the
/// normal numbers that of the denormals. An infinity counts as the power of two behind the largest
/// number, so that an overflow too early or too late has the error that it is; where the exact
/// value rounds to an infinity, an infinity has the error 0. A NaN has an infinite error, unless
/// the exact value is one too.
class ulp_error {
 public:
  explicit ulp_error(const number_format& format);
  ~ulp_error();
  ulp_error(const ulp_error&) = delete;
  ulp_error& operator=(const ulp_error&) = delete;

  /// Signed: positive where the result is too large.
  double operator()(double result, const mpfr_t exact);

 private:
  const number_format& format_;
  mpfr_t behind_;    ///< 2^(max_exponent + 1)
  mpfr_t to_round_;  ///< the smallest magnitude that rounds to an infinity
  mpfr_t difference_;
};

}  // namespace arbor::lumen::accuracy
