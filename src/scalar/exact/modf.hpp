// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/integer_part.hpp"
#include "scalar/exact/zeros.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// modf(x): the integer part, then the fraction, both with the sign of x; exact in every tier,
/// status 0. The fraction of an infinity is a zero of its sign at float and +0 at double; a NaN is
/// in both results.
template <typename T>
struct modf_body : scalar_v12<modf_body<T>, T> {
  LUMEN_MAIN main_result2<T> main(T x) {
    const T integer = integer_part(x);
    return {integer, or_sign(x - integer, x), flag_if<T>(is_special(x))};
  }

  LUMEN_RARE std::uint32_t rare(T x, T* integer, T* fraction) {
    *integer = is_nan(x) ? x + x : x;
    *fraction = is_nan(x) ? x + x : zero_of_infinity(x);
    return 0;
  }
};

using modf_s = modf_body<float>;
using modf_d = modf_body<double>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
