// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/exp/exp.hpp"
#include "scalar/log/long_polynomial.hpp"
#include "scalar/log/reduction.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// x^y at float computed in double and narrowed, without a table: for positive normal x and
/// |y·ln x| <= 87.857.
struct wide_power_s {
  LUMEN_MAIN main_result<float> main(float x, float y) {
    const auto a = two_thirds<double>::of(double{x});
    const double z = ln_by_long_polynomial(a);
    const double l = fma(a.k, value(0x3fe62e42fefa39efu), z);
    const double p = l * double{y};
    const bool large = bits(fabs(static_cast<float>(p))) > 0x42afb6dfu;
    const auto result = static_cast<float>(exp_d<tier::la>::main(p).value);
    return {result, flag_if<float>(not_positive_normal(x), large)};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
