// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/log/reduction.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The exponent field of x as a number.
LUMEN_MAIN float exponent_field(float x) {
  return static_cast<float>(static_cast<std::int32_t>(bits(fabs(x)) >> 23));
}
LUMEN_MAIN double exponent_field(double x) { return small_integer(bits(fabs(x)) >> 52); }

/// logb: the exponent of two of |x|, exact; one body for all tiers. A zero gives -infinity with
/// code 1, where a pole would have code 2. Infinities and NaNs give |x| with code 0.
template <typename T>
struct logb_body : scalar_v11<logb_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x) {
    const T field = exponent_field(x);
    const bool denormal = field < T(1);
    return {field - T(format<T>::bias), flag_if<T>(denormal, is_special(x))};
  }

  LUMEN_RARE std::uint32_t rare(T x, T* y) {
    if (x == 0) {
      *y = value(format<T>::sign | format<T>::special);
      return mask(code::domain);
    }
    if (is_special(x)) {
      *y = fabs(x);
      return mask(code::none);
    }
    constexpr T scale = sizeof(T) == 4 ? T(0x1p25) : T(0x1p55);
    constexpr T bias = sizeof(T) == 4 ? T(152) : T(1078);
    *y = exponent_field(x * scale) - bias;
    return mask(code::none);
  }
};

using logb_s = logb_body<float>;
using logb_d = logb_body<double>;

/// logb, half: a denormal half is a normal number as a float.
struct logb_h : half_v11<logb_s> {};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
