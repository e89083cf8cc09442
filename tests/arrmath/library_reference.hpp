// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Exact values of functions that MPFR has not, or has under another name.
#pragma once

#include <mpfr.h>

namespace arbor::lumen::tests::library::exact {

void erfcx(mpfr_ptr y, mpfr_srcptr x);
void erfinv(mpfr_ptr y, mpfr_srcptr x);
void erfcinv(mpfr_ptr y, mpfr_srcptr x);
void cdfnorm(mpfr_ptr y, mpfr_srcptr x);
void cdfnorminv(mpfr_ptr y, mpfr_srcptr x);
void expint1(mpfr_ptr y, mpfr_srcptr x);
void lgamma(mpfr_ptr y, mpfr_srcptr x);
void i0(mpfr_ptr y, mpfr_srcptr x);
void i1(mpfr_ptr y, mpfr_srcptr x);

}  // namespace arbor::lumen::tests::library::exact
