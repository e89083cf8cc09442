// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "ulp_error.hpp"

#include <algorithm>
#include <cmath>
#include <limits>

namespace arbor::lumen::accuracy {

ulp_error::ulp_error(const number_format& format) : format_(format) {
  mpfr_init2(behind_, 64);
  mpfr_init2(to_round_, 64);
  mpfr_init2(difference_, 160);
  mpfr_set_ui_2exp(behind_, 1, format.max_exponent + 1, MPFR_RNDN);
  mpfr_set_ui_2exp(to_round_, 1, format.max_exponent - format.precision, MPFR_RNDN);
  mpfr_sub(to_round_, behind_, to_round_, MPFR_RNDN);
}

ulp_error::~ulp_error() {
  mpfr_clear(behind_);
  mpfr_clear(to_round_);
  mpfr_clear(difference_);
}

double ulp_error::operator()(double result, const mpfr_t exact) {
  constexpr double infinity = std::numeric_limits<double>::infinity();
  if (std::isnan(result) || mpfr_nan_p(exact)) {
    return std::isnan(result) && mpfr_nan_p(exact) ? 0 : infinity;
  }
  const bool overflows = mpfr_cmpabs(exact, to_round_) >= 0;
  if (std::isinf(result)) {
    const bool same_sign = (result < 0) == (mpfr_sgn(exact) < 0);
    if (overflows && same_sign) return 0;
    mpfr_setsign(difference_, behind_, result < 0, MPFR_RNDN);
  } else {
    mpfr_set_d(difference_, result, MPFR_RNDN);
  }
  int exponent = format_.min_exponent;
  if (overflows) {
    exponent = format_.max_exponent;
    if (mpfr_sgn(exact) < 0)
      mpfr_add(difference_, difference_, behind_, MPFR_RNDN);
    else
      mpfr_sub(difference_, difference_, behind_, MPFR_RNDN);
  } else {
    if (!mpfr_zero_p(exact))
      exponent = std::max(exponent, static_cast<int>(std::max<mpfr_exp_t>(mpfr_get_exp(exact) - 1,
                                                                          format_.min_exponent)));
    mpfr_sub(difference_, difference_, exact, MPFR_RNDN);
  }
  mpfr_mul_2si(difference_, difference_, format_.precision - 1 - exponent, MPFR_RNDN);
  return mpfr_get_d(difference_, MPFR_RNDN);
}

}  // namespace arbor::lumen::accuracy
