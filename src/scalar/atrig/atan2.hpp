// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/atrig/arctangent_polynomial.hpp"
#include "scalar/atrig/careful_angle.hpp"
#include "scalar/atrig/half_angle.hpp"
#include "scalar/atrig/quadrant.hpp"
#include "scalar/half.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/datan2.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// atan2, float: the angle of the point (x, y), status 0 for all points. With q the smaller
/// magnitude over the larger it is arctan q, pi/2 - arctan q, pi - arctan q or pi/2 + arctan q by
/// the octant. Largest error 0.98, 2.5 and 2.3e3 ulp for `ha`, `la`, `ep`.
///
/// The rare path serves a smaller magnitude of 0 and magnitudes that are not from a range of
/// ordinary numbers: it handles the specials, and scales what is finite into that range.
template <tier t>
struct atan2_s : scalar_v21<atan2_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float y, float x) {
    const auto p = quadrant<float>::of(y, x);
    const bool unscaled = bits(p.larger) - lowest <= highest - lowest;
    return {value(bits(angle(p)) ^ sign_bit(y)),
            flag_if<float>(!unscaled, bits(p.smaller) < smallest)};
  }

  LUMEN_RARE std::uint32_t rare(float y, float x, float* r) {
    auto p = quadrant<float>::of(y, x);
    const float base = p.base(pi_words<float>::half, pi_words<float>::whole);
    if (is_nan(p.larger)) {
      *r = value(bits(is_nan(x) ? x : y) | 0x00400000u);
    } else if (p.smaller == 0) {
      *r = or_sign(base, y);
    } else if (is_infinite(p.larger)) {
      const float diagonal = value(p.left != 0 ? 0x4016cbe4u : 0x3f490fdbu);  // 3·pi/4, pi/4
      *r = or_sign(is_infinite(p.smaller) ? diagonal : base, y);
    } else {
      const float scale = scale_for(p.larger);
      p.smaller *= scale;
      p.larger *= scale;
      *r = value(bits(angle(p)) ^ sign_bit(y));
    }
    return mask(code::none);
  }

 private:
  /// The larger magnitudes of the main path: their reciprocals are normal.
  static constexpr std::uint32_t lowest = 0x00800000u;
  static constexpr std::uint32_t highest = 0x7e800000u;  // 2^126
  /// The least of the smaller ones: at `ha` 2^-102, from which on the error of the quotient does
  /// not underflow.
  static constexpr std::uint32_t smallest = t == tier::ha ? 0x0c800000u : 1u;

  /// What brings a point into the range: 2^-64, 2^64, or 1 where the larger magnitude is from
  /// 2^62 to 2^126, beside which the smaller one of a point on the rare path counts as 0.
  LUMEN_DEVICE static float scale_for(float larger) {
    if (bits(larger) > highest) return value(0x1f800000u);
    return value(bits(larger) <= 0x5e800000u ? 0x5f800000u : format<float>::one);
  }

  LUMEN_MAIN float angle(const quadrant<float>& p) {
    const float base = p.base(pi_words<float>::half, pi_words<float>::whole);
    const float reciprocal = divide(1.0f, p.larger);
    const float q = reciprocal * p.smaller;
    if constexpr (t == tier::ha) {
      const float low = p.base(pi_words<float>::half_low, pi_words<float>::whole_low);
      const float q_low = fma(-p.larger, q, p.smaller) * reciprocal;
      const float polynomial = arctangent_rest_at_half((q - 0.5f) + q_low);
      const float rest = fma(q, polynomial, fma(polynomial, q_low, q_low));
      const float signed_q = value(bits(q) ^ p.down());
      const float sum = base + signed_q;
      const float error = signed_q - (sum - base);
      return sum + (error + (value(bits(rest) ^ p.down()) + low));
    } else {
      float v;
      if constexpr (t == tier::ep) {
        v = q * arctangent_factor_ep(q);
      } else {
        v = fma(arctangent_rest_at_half_short(fma(p.smaller, reciprocal, -0.5f)), q, q);
      }
      return value(bits(v) ^ p.down()) + base;
    }
  }
};

/// atan2, double; status 0 for all points. `la` and `ep` are one body, with a true division and
/// degree 19. Largest error 0.75 ulp at `ha`, 2.4 at `la` and `ep`.
///
/// Points with an operand below 2^-1020, from 2^993 or a NaN take the rare path. A zero beside
/// another number does not at `la` and `ep`: the quotient is 0 then.
template <tier t>
struct atan2_d : scalar_v21<atan2_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double y, double x) {
    const auto q = true_quotient<double>::of(y, x);
    const double base = q.base(pi_words<double>::half);
    const double angle = fma(arctangent_rest(q.t * q.t), q.t, q.t) + base;
    return {turned(angle, y, x, pi_words<double>::whole), flag_if<double>(is_extreme_point(y, x))};
  }

  LUMEN_RARE std::uint32_t rare(double y, double x, double* r) {
    *r = careful_angle<radians>(y, x);
    return mask(code::none);
  }
};

/// The segments of the angle of a point with magnitudes n <= m: arctan k + arctan((n - km)/(m +
/// kn)) with k = 0, 1/2, 1. The numerator is exact, and so is the denominator in its two words.
struct point_segment {
  std::int32_t row;  ///< of tables by octant and k
  double t;
  double t_low;

  LUMEN_MAIN point_segment of(const quadrant<double>& p) {
    const double m = p.larger, n = p.smaller;
    const auto j = std::int32_t{n > 0.4375 * m} + std::int32_t{n > 0.6875 * m};
    const double k = 0.5 * static_cast<double>(j);
    const double above = fma(-k, m, n);
    const double below = fma(k, n, m);
    const double below_low = fma(k, n, m - below);
    const double reciprocal = divide(1.0, below);
    const double t = above * reciprocal;
    const double rest = fma(-t, below_low, fma(-t, below, above));
    const auto octant = static_cast<std::int32_t>((p.left & 2u) + (p.steep & 1u));
    return {2 * (3 * octant + j), value(bits(t) ^ p.down()),
            value(bits(rest * reciprocal) ^ p.down())};
  }

  /// The rare path serves extreme magnitudes, but a smaller one of 0 is ordinary.
  LUMEN_MAIN bool is_rare(const quadrant<double>& p) {
    const bool larger = is_extreme(p.larger), smaller = is_extreme(p.smaller);
    const bool flat = p.smaller == 0;
    return larger | (smaller & !flat);
  }
};

/// `ha`: three segments, with the quotient in two words and one table for the octants and segments
/// together.
template <>
struct atan2_d<tier::ha> : scalar_v21<atan2_d<tier::ha>, double> {
  LUMEN_MAIN main_result<double> main(double y, double x) {
    const auto p = quadrant<double>::of(y, x);
    const auto s = point_segment::of(p);
    const double base = value(internal_datan2_ha_data[s.row]);
    const double low = value(internal_datan2_ha_data[s.row + 1]);
    const double z = s.t * s.t;
    const double rest = fma(arctangent_rest_of_segment(z), z * s.t, s.t_low);
    const double sum = base + s.t;
    const double error = s.t - (sum - base);
    return {or_sign(sum + (error + (rest + low)), y), flag_if<double>(point_segment::is_rare(p))};
  }

  LUMEN_RARE std::uint32_t rare(double y, double x, double* r) {
    *r = careful_angle<radians>(y, x);
    return mask(code::none);
  }
};

/// atan2, half: the float body of `ep` in every tier.
using atan2_h = half_v21<atan2_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
