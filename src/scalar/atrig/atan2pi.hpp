// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/atrig/arctangent_over_pi.hpp"
#include "scalar/atrig/arctangent_polynomial.hpp"
#include "scalar/atrig/atan2.hpp"
#include "scalar/atrig/careful_angle.hpp"
#include "scalar/atrig/quadrant.hpp"
#include "scalar/half.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/datan2.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// What all bodies of atan2pi at float share: status 0, and the points whose quotient is a NaN: the
/// origin, by the signs of its zeros, both operands infinite, and NaNs. Every other quotient is
/// right without scaling. A `Body` gives the angle from the true quotient.
template <typename Body>
struct atan2pi_s_paths : scalar_v21<Body, float> {
  LUMEN_MAIN main_result<float> main(float y, float x) {
    const bool same = bits(fabs(y)) == bits(fabs(x));
    const bool undefined = same & ((y == 0) | is_infinite(y));
    return {Body::angle(y, x), flag_if<float>(undefined, is_nan(y), is_nan(x))};
  }

  LUMEN_RARE std::uint32_t rare(float y, float x, float* r) {
    const bool negative = sign_bit(x) != 0;
    if (is_nan(y) || is_nan(x)) {
      *r = x + y;
    } else if (is_infinite(y)) {
      *r = or_sign(negative ? 0.75f : 0.25f, y);
    } else {
      *r = or_sign(negative ? 1.0f : 0.0f, y);
    }
    return mask(code::none);
  }
};

/// atan2pi, float, `ha` and `la`: in double, degree 10. Largest error 0.51 ulp.
struct atan2pi_s : atan2pi_s_paths<atan2pi_s> {
  LUMEN_MAIN float angle(float y, float x) {
    const auto q = true_quotient<double>::of(static_cast<double>(y), static_cast<double>(x));
    const double base = q.base(one_half<double>);
    const double v = fma(arctangent_factor_over_pi_short(q.t * q.t), q.t, base);
    return static_cast<float>(
        turned(v, static_cast<double>(y), static_cast<double>(x), format<double>::one));
  }
};

/// Without double arithmetic, `la`: degree 8. Largest error 2.6 ulp.
struct atan2pi_s_nofp64 : atan2pi_s_paths<atan2pi_s_nofp64> {
  LUMEN_MAIN float angle(float y, float x) {
    const auto q = true_quotient<float>::of(y, x, fabs(y) > fabs(x));
    const float base = q.base(one_half<float>);
    return turned(fma(arctangent_factor_over_pi(q.t * q.t), q.t, base), y, x, format<float>::one);
  }
};

/// `ep`: the polynomial of atan, times 1/pi beside the base. Largest error 2.9e3 ulp.
struct atan2pi_s_ep : atan2pi_s_paths<atan2pi_s_ep> {
  LUMEN_MAIN float angle(float y, float x) {
    const auto q = true_quotient<float>::of(y, x);
    const float base = q.base(one_half<float>);
    const float v = arctangent_factor_ep(fabs(q.t)) * q.t;
    return turned(fma(v, value(pi_words<float>::inverse), base), y, x, format<float>::one);
  }
};

/// atan2pi, double; status 0 for all points. `la` and `ep` are one body, with a true division and
/// degree 21. Largest error 0.85 ulp at `ha`, 2.7 at `la` and `ep`.
///
/// The rare paths are those of atan2.
template <tier t>
struct atan2pi_d : scalar_v21<atan2pi_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double y, double x) {
    const auto q = true_quotient<double>::of(y, x);
    const double base = q.base(one_half<double>);
    const double angle = fma(arctangent_factor_over_pi(q.t * q.t), q.t, base);
    return {turned(angle, y, x, format<double>::one), flag_if<double>(is_extreme_point(y, x))};
  }

  LUMEN_RARE std::uint32_t rare(double y, double x, double* r) {
    *r = careful_angle<half_turns>(y, x);
    return mask(code::none);
  }
};

/// `ha`: the segments of atan2, with 1/pi in two words. Where these would underflow for a tiny
/// quotient the rare path holds.
template <>
struct atan2pi_d<tier::ha> : scalar_v21<atan2pi_d<tier::ha>, double> {
  LUMEN_MAIN main_result<double> main(double y, double x) {
    const auto p = quadrant<double>::of(y, x);
    const auto s = point_segment::of(p);
    const double base = value(internal_datan2pi_ha_data[s.row]);
    const double low = value(internal_datan2pi_ha_data[s.row + 1]);
    const double z = s.t * s.t;
    const double rest = fma(arctangent_rest_of_segment(z), z * s.t, s.t_low);
    const double angle = base_and_arctangent_over_pi(base, low, s.t, rest);
    const bool tiny = (fabs(s.t) < 0x1p-900) & (s.row == 0) & (p.smaller != 0);
    return {or_sign(angle, y), flag_if<double>(point_segment::is_rare(p), tiny)};
  }

  LUMEN_RARE std::uint32_t rare(double y, double x, double* r) {
    *r = careful_angle<half_turns>(y, x);
    return mask(code::none);
  }
};

/// atan2pi, half: the float body of `ep` in every tier.
using atan2pi_h = half_v21<atan2pi_s_ep>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
