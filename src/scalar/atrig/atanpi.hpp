// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/atrig/arctangent_over_pi.hpp"
#include "scalar/atrig/arctangent_polynomial.hpp"
#include "scalar/atrig/atan.hpp"
#include "scalar/atrig/bitwise_choice.hpp"
#include "scalar/atrig/careful_angle.hpp"
#include "scalar/atrig/tangent_reduction.hpp"
#include "scalar/half.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/datan2.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// atanpi, float; status 0 for every argument. `la` and `ep`: atan times the float 1/pi. Largest
/// error 0.51, 3.9 and 2.9e3 ulp for `ha`, `la`, `ep`.
template <tier t>
struct atanpi_s : scalar_v11<atanpi_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    return {atan_s<t>::main(x).value * value(pi_words<float>::inverse)};
  }
};

/// `ha`: in double, x up to 1 and 1/2 + arctan(-1/x)/pi beyond, degree 10.
template <>
struct atanpi_s<tier::ha> : scalar_v11<atanpi_s<tier::ha>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const auto a = static_cast<double>(fabs(x));
    const bool inverted = a > 1.0;
    const double t = select(inverted, divide(-1.0, a), a);
    const double base = select(inverted, 0.5, 0.0);
    const double y = fma(arctangent_factor_over_pi_short(t * t), t, base);
    return {or_sign(static_cast<float>(y), x)};
  }
};

/// atanpi, double; status 0 for every argument. Largest error 0.80, 2.5 and 2.2e7 ulp for `ha`,
/// `la`, `ep`.
template <tier t>
struct atanpi_d;

/// `la`: x up to 1 and 1/2 + arctan(-1/x)/pi beyond, degree 21. The reciprocal starts from a float
/// whose pattern is a constant less that of a, within 1/8, and takes three cubic corrections; a is
/// clamped where its reciprocal no longer counts, so that infinity needs no case of its own.
template <>
struct atanpi_d<tier::la> : scalar_v11<atanpi_d<tier::la>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const double a = fabs(x);
    const auto inverted = mask_of<double>(a > 1.0);
    const double t = chosen(inverted, -reciprocal(select(a < 0x1p100, a, 0x1p100)), a);
    const double base = value(inverted & one_half<double>);
    return {or_sign(fma(arctangent_factor_over_pi(t * t), t, base), x)};
  }

 private:
  /// 1/a for a in [1, 2^100].
  LUMEN_MAIN double reciprocal(double a) {
    const auto seed = value(0x7ef311c7u - bits(static_cast<float>(a)));
    return corrected(a, corrected(a, corrected(a, static_cast<double>(seed))));
  }
  LUMEN_MAIN double corrected(double a, double c) {
    const double e = fma(-a, c, 1.0);
    return fma(fma(e, e, e), c, c);
  }
};

/// `ep`: as atan, times 1/pi beside the base.
template <>
struct atanpi_d<tier::ep> : scalar_v11<atanpi_d<tier::ep>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const auto r = short_reciprocal::of(x);
    const double base = or_sign(value(~r.direct & one_half<double>), x);
    const double angle = arctangent_factor_ep(r.t * r.t) * r.t;
    return {fma(angle, value(pi_words<double>::inverse), base), flag_if<double>(is_special(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    *y = is_nan(x) ? x + x : or_sign(0.5, x);
    return mask(code::none);
  }
};

/// `ha`: the segments of atan, with 1/pi in two words. The rare path serves what these two words
/// would underflow for, and huge arguments.
template <>
struct atanpi_d<tier::ha> : scalar_v11<atanpi_d<tier::ha>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const auto s = tangent_segment::of(fabs(x), internal_datanpi_ha_data);
    const double z = s.t * s.t;
    const double rest = arctangent_rest_of_segment(z) * (z * s.t);
    const double y = base_and_arctangent_over_pi(s.high, s.low, s.t, rest);
    return {or_sign(y, x), flag_if<double>(!(fabs(x) >= 0x1p-900), is_extreme(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    *y = careful_angle<half_turns>(x, 1.0);
    return mask(code::none);
  }
};

/// atanpi, half: the float body of `ep` in every tier.
using atanpi_h = half_v11<atanpi_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
