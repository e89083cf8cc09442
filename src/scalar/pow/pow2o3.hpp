// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/root/thirds.hpp"
#include "scalar/tables/pow2o3.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// |x|^(2/3) for normal x at float: |x| = m·2^(3q + k) up to the bias, rows of (2^k·c)^(2/3) in two
/// words for the middles c of 32 intervals of [1, 2), and degree 4 in m/c - 1. `first_power` is the
/// pattern of the power of two that goes with q = 0. Within 0.53 ulp.
LUMEN_MAIN float two_thirds_power_by_row(float x, std::uint32_t first_power) {
  const auto e = thirds<std::uint32_t>::of(((bits(x) >> 23) + 0xff) & 0xff);
  const auto m = thirty_second<float>::of(x);
  const float power = value((e.q << 24) + first_power);
  const std::int32_t row = (static_cast<std::int32_t>(e.k) << 5) | m.i;
  const float high = value(_arrsPow2o3HATab[0x24 + 2 * row]) * power;
  const float low = value(_arrsPow2o3HATab[0x25 + 2 * row]) * power;
  const float g = -m.less * value(_arrsPow2o3HATab[4 + m.i]);
  float p = horner(g, 0xbcebfbc9u, 0x3d4a4588u, 0xbde38e39u, 0x3f2aaaabu);
  p = fma(g, p, 0.0f);
  return high + mad(high, p, low);
}

/// pow2o3, float; status 0. Within 0.53, 2.1, 890 ulp for `ha`, `la`, `ep`; denormals, which are
/// scaled up, within 0.53 ulp.
///
/// `ha` by rows of a table; `la` and `ep` by a polynomial over the whole of [1, 2), degree 7 in
/// m - 1 and degree 3 in m.
template <tier t>
struct pow2o3_s : scalar_v11<pow2o3_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    return {of_normal(x), flag_if<float>(not_normal(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    if (x == 0 || is_special(x)) {
      *y = x * x;
    } else {
      *y = two_thirds_power_by_row(x * value(0x71000000u), 0xf4800000u);  // 2^99, 2^-150
    }
    return mask(code::none);
  }

 private:
  LUMEN_MAIN float of_normal(float x) {
    if constexpr (t == tier::ha) {
      return two_thirds_power_by_row(x, 0x15800000u);  // 2^-84
    } else {
      const auto e = thirds<std::uint32_t>::of(((bits(x) >> 23) + 0xff) & 0xff);
      const float root = value(internal_spow2o3_la_data[static_cast<std::int32_t>(e.k)]);
      const float w = fma(root, value((e.q << 24) + 0x15800000u), 0.0f);
      const float m = value((bits(x) & 0x007fffffu) | 0x3f800000u);
      return fma(polynomial(m), w, 0.0f);
    }
  }

  /// m^(2/3); at `ep` within 5.3e-5, at both ends of the error's range.
  LUMEN_MAIN float polynomial(float m) {
    if constexpr (t == tier::ep) {
      return horner(m, 0x3cabc866u, 0xbe24e4ceu, 0x3f6c7964u, 0x3e5d9408u);
    } else {
      return horner(m - 1.0f, 0x3a83f4c2u, 0xbbaf8e6du, 0x3c663641u, 0xbcdc0785u, 0x3d488a6du,
                    0xbde37609u, 0x3f2aaa8au, 0x3f800000u);
    }
  }
};

/// The steps of pow2o3 at double: |x| = m·2^(3q + k), g = m/c - 1 for the middle c of one of 32
/// intervals of [1, 2), and a row of (2^k·c)^(2/3).
struct pow2o3_reduction {
  std::int32_t row;
  double power;
  double g;

  LUMEN_MAIN pow2o3_reduction of(double x, const std::uint64_t* reciprocals) {
    const auto e = thirds<std::uint64_t>::of((bits(x) >> 52) & 0x7ff);
    const auto m = thirty_second<double>::of(x);
    const double power = value((e.q << 53) + 0x1550000000000000u);  // 2^-682
    const double g = fma(m.less, value(reciprocals[m.i]), 0.0);
    return {static_cast<std::int32_t>(e.k << 5) | m.i, power, g};
  }
};

/// |x|^(2/3) for normal x at double, rows in two words and degree 8 in g; within 0.53 ulp.
LUMEN_MAIN double two_thirds_power_by_row(double x) {
  const auto a = pow2o3_reduction::of(x, internal_dpow2o3_ha_data);
  const double high = value(internal_dpow2o3_ha_data[32 + 2 * a.row]);
  const double low = value(internal_dpow2o3_ha_data[33 + 2 * a.row]);
  const double p = horner_of(a.g, internal_dpow2o3_ha_series);
  const double result = high + fma(high, fma(p, a.g, 0.0), low);
  return fma(result, a.power, 0.0);
}

/// What the tiers of pow2o3 at double share: denormals are scaled up and go by rows in two words.
template <typename Body>
struct pow2o3_d_paths : scalar_v11<Body, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    return {Body::of_normal(x), flag_if<double>(not_normal(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    if (x == 0 || is_special(x)) {
      *y = x * x;
    } else {
      const double scaled = x * value(0x4380000000000000u);               // 2^57
      *y = two_thirds_power_by_row(scaled) * value(0x3d90000000000000u);  // 2^-38
    }
    return mask(code::none);
  }
};

/// pow2o3, double; status 0. `la` and `ep`, one body: rows in one word and degree 6; within 1.6
/// ulp, denormals within 0.53 ulp.
template <tier t>
struct pow2o3_d : pow2o3_d_paths<pow2o3_d<t>> {
  LUMEN_MAIN double of_normal(double x) {
    const auto a = pow2o3_reduction::of(x, internal_dpow2o3_la_data);
    const double w = fma(value(internal_dpow2o3_la_data[32 + a.row]), a.power, 0.0);
    const double p = horner(a.g, 0xbf8c6a85e62359abu, 0x3f93ab53150873bcu, 0xbf9d7f79165bafafu,
                            0x3fa948b0fa0ac59du, 0xbfbc71c71c71d521u, 0x3fe5555555555555u);
    return fma(p, fma(w, a.g, 0.0), 0.0) + w;
  }
};

/// `ha`: by rows in two words; within 0.53 ulp.
template <>
struct pow2o3_d<tier::ha> : pow2o3_d_paths<pow2o3_d<tier::ha>> {
  LUMEN_MAIN double of_normal(double x) { return two_thirds_power_by_row(x); }
};

/// pow2o3, half: the float body of `ep` in every tier.
using pow2o3_h = half_v11<pow2o3_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
