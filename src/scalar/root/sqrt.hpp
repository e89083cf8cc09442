// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <type_traits>

#include "scalar/half.hpp"
#include "scalar/inverse_root.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Of floats, the divider takes 12 cycles for a vector of 512 bits, the steps from an estimate 10.
template <typename T>
constexpr bool root_is_faster_by_estimate = std::is_same_v<T, float> ? wide_vectors : false;

/// sqrt, float and double; correctly rounded in every tier. sqrt(-0) is -0. Code 1 for every other
/// pattern with its sign bit set: negative numbers, -infinity, and NaNs of negative sign.
template <typename T>
struct sqrt_body : scalar_v11<sqrt_body<T>, T> {
  LUMEN_MAIN main_result<T> main(T x) { return {sqrt(x), flag_if<T>(bits(x) > format<T>::sign)}; }

  LUMEN_RARE std::uint32_t rare(T x, T* y) {
    *y = sqrt(x);
    return mask(code::domain);
  }

  /// Without the divider.
  template <std::int64_t Length>
  requires root_is_faster_by_estimate<T>
  static bool block(const float* __restrict x, float* __restrict y) {
    constexpr float small = 0x1p-64f;  // scaled, so that the rest to x is no denormal
    float scaled[Length], estimate[Length];
    for (std::int64_t i = 0; i < Length; ++i)
      scaled[i] = select(x[i] < small, x[i] * 0x1p64f, x[i]);
    estimate_inverse_roots<Length>(scaled, estimate);
    bool unserved = false;
    for (std::int64_t i = 0; i < Length; ++i) {
      const float root = root_by_estimate(scaled[i], estimate[i]);
      const bool zero = x[i] == 0;
      y[i] = select(zero, x[i], select(x[i] < small, root * 0x1p-32f, root));
      unserved |= !(zero || bits(x[i]) < format<float>::special);
    }
    return !unserved;
  }
};
using sqrt_s = sqrt_body<float>;
using sqrt_d = sqrt_body<double>;

/// sqrt, half, through float.
using sqrt_h = half_v11<sqrt_s>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
