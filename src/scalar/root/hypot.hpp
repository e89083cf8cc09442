// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/root/careful_hypot.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// hypot, float, without double arithmetic; status 0, also on overflow. An infinity gives
/// +infinity, also beside a NaN.
///
/// The larger operand is brought to [1/2, 1) or [2, 4), by a power of two whose inverse is normal
/// too, so that no square overflows and none that matters underflows. Within 0.88, 0.97, 0.97 ulp
/// for `ha`, `la`, `ep`: at `ha` the sum of squares is in two words, and one step of Newton
/// corrects the root that the reciprocal root gives. From one word such a step gives the rounded
/// root for every sum, so that `la` and `ep` leave it to the device.
template <tier t>
struct hypot_s : scalar_v21<hypot_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x, float y) {
    const std::uint32_t ax = bits(fabs(x)), ay = bits(fabs(y));
    const std::uint32_t larger = select(ax > ay, ax, ay);
    const std::uint32_t smaller = select(ax > ay, ay, ax);
    const std::uint32_t scale =
        (((larger >> 6) & 0x01000000u) | 0x7e800000u) - (larger & format<float>::special);
    const float a = value(larger) * value(scale);
    const float b = value(smaller) * value(scale);
    const float finite = root(a, b) * value(0x7f000000u - scale);
    const bool infinite_x = is_infinite(x), infinite_y = is_infinite(y);
    const float sum = select(larger >= format<float>::special, x + y, finite);
    return {select(infinite_x | infinite_y, value(format<float>::special), sum)};
  }

 private:
  LUMEN_MAIN float root(float a, float b) {
    const float b2 = fma(b, b, 0.0f);
    if constexpr (t == tier::ha)
      return two_word_root(a, b, b2);
    else
      return sqrt(fma(a, a, b2));
  }

  LUMEN_MAIN float two_word_root(float a, float b, float b2) {
    const float s = fma(a, a, 0.0f) + b2;
    const float r = divide(1.0f, sqrt(s));
    const float g = fma(s, r, 0.0f);
    const float d = fma(g, -g, s) + rest_of_sum(a, b, b2, s);
    return select(s == 0, 0.0f, fma(r * 0.5f, d, g));
  }

  /// What s, the sum of the two rounded squares, leaves out.
  LUMEN_MAIN float rest_of_sum(float a, float b, float b2, float s) {
    const float a2 = fma(a, a, 0.0f);
    const float rests = fma(b, b, -b2) + fma(a, a, -a2);
    return rests + (a2 - (s - b2));
  }
};

/// hypot, double, every tier; status 0, also on overflow. An infinity gives +infinity, also beside
/// a NaN.
///
/// Where the sum of squares s is in [2^-67, 2^66], the float reciprocal root c of s leaves
/// e = sc² - 1 below 2^-22, and the series of (1 + e)^(-1/2) turns sc into the root: within 1.21
/// ulp, by two roundings of s, halved by the root, and that of the result. Elsewhere within 0.51
/// ulp.
struct hypot_d : scalar_v21<hypot_d, double> {
  LUMEN_MAIN main_result<double> main(double x, double y) {
    const double sum = fma(x, x, fma(y, y, 0.0));
    const bool out_of_band = bits(sum) + 0xc440000000000000u >= 0x0850000100000000u;
    const double s = select(out_of_band, 1.0, sum);
    const auto c = static_cast<double>(divide(1.0f, sqrt(static_cast<float>(s))));
    const double e = fma(s, fma(c, c, 0.0), -1.0);
    double p = horner(e, 0x3fd1800000000000u, 0xbfd4000000000000u, 0x3fd8000000000000u,
                      0xbfe0000000000000u);
    p = fma(p, e, 0.0);
    const double u = fma(fma(p, c, 0.0), s, 0.0);
    return {fma(s, c, u), flag_if<double>(out_of_band)};
  }

  LUMEN_RARE std::uint32_t rare(double x, double y, double* r) {
    if (is_infinite(x) || is_infinite(y)) {
      *r = value(format<double>::special);
    } else if (is_nan(x) || is_nan(y)) {
      *r = x + y;
    } else if (x == 0 && y == 0) {
      *r = 0;
    } else {
      *r = careful_hypot(x, y);
    }
    return mask(code::none);
  }

  LUMEN_MAIN main_result<double> beyond(double x, double y) { return normal_hypot(x, y); }
};

/// hypot, half: the float body of `ep` in every tier.
using hypot_h = half_v21<hypot_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
