// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/integer_part.hpp"
#include "scalar/exact/zeros.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// frac(x): the fraction of x with the sign of x, exact in every tier, status 0. The fraction of an
/// infinity is +0, also at float, whose rare path goes through double.
template <typename T>
struct frac_body : scalar_v11<frac_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x) {
    return {or_sign(x - integer_part(x), x), flag_if<T>(is_special(x))};
  }

  LUMEN_RARE std::uint32_t rare(T x, T* y) {
    const double wide = x;
    *y = static_cast<T>(is_nan(wide) ? wide + wide : zero_of_infinity(wide));
    return 0;
  }
};

using frac_s = frac_body<float>;
using frac_d = frac_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
