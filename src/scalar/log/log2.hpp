// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/log/breakpoint.hpp"
#include "scalar/log/half_log.hpp"
#include "scalar/log/log2_rare.hpp"
#include "scalar/log/long_polynomial.hpp"
#include "scalar/log/reduction.hpp"
#include "scalar/log/three_quarters.hpp"
#include "scalar/log/zero_or_negative.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dlog2.hpp"
#include "scalar/tables/slog2.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

struct log2_constants_s {
  static constexpr std::uint32_t denormal_scale = 0x4d000000;  // 2^27
  static constexpr int denormal_exponent = 27;
  static constexpr std::uint32_t near_one_limit = 0x3bc00000;  // 0.005859375
  static constexpr std::uint32_t splitter = 0x46000000;        // 8192, unit 2^-10
  static constexpr std::uint32_t low_bits = 0x1fff;
  static constexpr std::uint32_t scale = 0x43b8aa40;      // 369.330078125, about 256/ln 2
  static constexpr std::uint32_t log2_high = 0x3f800000;  // log2 of 2
  static constexpr std::uint32_t log2_low = 0;

  LUMEN_DEVICE static float polynomial(float t) {
    return horner(t, 0x9c1d865eu, 0x2081cd9du, 0xa4da74dcu, 0x293d1988u, 0xadaa8223u, 0x3223fe93u,
                  0xb6b1720fu, 0xbf7f0000u);
  }
};

/// log2, float. Code 2 for zeros, code 1 for negative numbers and -infinity. A NaN has code 0 at
/// `la` and `ep`, and code 1 at `ha`.
///
/// `la` and `ep`: reduction to [2/3, 4/3) without a table, degree 9 and 5. Largest error 2.1 and
/// 895 ulp.
template <tier t>
struct log2_s : scalar_v11<log2_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const auto a = two_thirds<float>::of(x);
    return {fma(polynomial(a.r), a.r, a.k), flag_if<float>(not_positive_normal(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    const auto* table = t == tier::la ? __slog2_la_CoutTab : __slog2_ep_CoutTab;
    return breakpoint_log<scaled_path<float, log2_constants_s>>(x, y, table);
  }

 private:
  LUMEN_MAIN float polynomial(float r) {
    if constexpr (t == tier::ep) {
      return horner(r, 0x3eaae01bu, 0xbecb686cu, 0x3ef4fa41u, 0xbf38658au, 0x3fb8aaedu);
    } else {
      const float w = fma(r, r, 0.0f);
      const float a = fma(value(0x3e554012u), r, value(0xbe638e14u));
      const float b = fma(value(0x3e4d660bu), r, value(0xbe727824u));
      const float c = fma(value(0x3e93dd07u), r, value(0xbeb8b969u));
      const float d = fma(value(0x3ef637c0u), r, value(0xbf38aa2bu));
      const float p = fma(fma(fma(a, w, b), w, c), w, d);
      return fma(p, r, value(0x3fb8aa3bu));
    }
  }
};

/// `ha`, for devices with double: degree 10 in float, with the last two steps in double. Largest
/// error 0.89 ulp.
template <>
struct log2_s<tier::ha> : scalar_v11<log2_s<tier::ha>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    return {logarithm(three_quarters::of(x)), flag_if<float>(not_positive_normal(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    return rare_of_three_quarters<log2_s<tier::ha>>(x, y);
  }

  LUMEN_MAIN float logarithm(const three_quarters& a) {
    const float p = horner(a.r, 0xbd8770dcu, 0x3e1c5827u, 0xbe434bdeu, 0x3e55e9b0u, 0xbe75d6cau,
                           0x3e93a7cbu, 0xbeb8aabcu, 0x3ef6389fu, 0xbf38aa3bu);
    const auto r = static_cast<double>(a.r);
    const double q = fma(static_cast<double>(p), r, value(0x3ff715476395bd86u));
    return static_cast<float>(fma(q, r, static_cast<double>(a.k)));
  }
};

/// log2, double. Code 2 for zeros, code 1 for negative numbers and -infinity, code 0 for every NaN.
///
/// `la` and `ep`: a row of a table by an integer reciprocal, degree 5 and 3. Largest error 2.1 and
/// 1.6e6 ulp.
template <tier t>
struct log2_d : scalar_v11<log2_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const auto a = integer_reciprocal::of(x);
    const double row = value(single_values()[integer_reciprocal::single_word(a)]);
    const double p2 = fma(value(0x3fdec709dc39e926u), a.t, value(0xbfe71547652b7cf8u));
    const double w = fma(a.t, a.t, 0.0);
    const double g = fma(a.t, value(0x3ff71547652b82feu), 0.0);
    double p = p2;
    if constexpr (t == tier::la) {
      const double p1 = fma(value(0x3fd2776e996da1d2u), a.t, value(0xbfd715494c3e7c9bu));
      p = fma(p1, w, p2);
    }
    return {(fma(p, w, g) + row) + integer_reciprocal::exponent_of_row(a),
            flag_if<double>(not_positive_normal(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    if constexpr (t == tier::la)
      return log2_rare(x, y, __dlog2_la___libm_rcp_table_256, __dlog2_la___libm_log2_table_256);
    else
      return log2_rare(x, y, __dlog2_ep___libm_rcp_table_256, __dlog2_ep___libm_log2_table_256);
  }

 private:
  LUMEN_DEVICE static constexpr const std::uint64_t* single_values() {
    return t == tier::la ? internal_dlog2_la_data : internal_dlog2_ep_data;
  }
};

/// `ha`: the integer comes from the reciprocal times C = 1.44140625, close to 1/ln 2, so that the
/// rest t is already the first-order term but for a factor close to 1; the sum is in two words.
/// Largest error 0.52 ulp.
template <>
struct log2_d<tier::ha> : scalar_v11<log2_d<tier::ha>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const double scale = value(0x3ff7100000000000u);
    const double m = mantissa_at(0x3f60000000000000u, x);  // 2^-9
    const auto reciprocal = static_cast<double>(quick_reciprocal(m));
    const double integer = rounded_by_shifter(fma(reciprocal, scale, 0.0));  // 369..738
    const double t = fma(m, integer, -scale);
    const auto word = static_cast<std::int32_t>((bits(integer) >> 42) - 0x101dc4u);
    const double z = value(internal_dlog2_ha_data[word]) + small_integer(bits(x) >> 52);
    const double low = value(internal_dlog2_ha_data[word + 1]);
    const double p1 = fma(value(0xbf9b743ca0b38eebu), t, value(0x3fa7be52039fb7ceu));
    const double p2 = fma(value(0xbfb563d0fce18810u), t, value(0x3fc48dead300e7bfu));
    const double p3 = fma(value(0xbfd6386b9b9b5d42u), t, value(0x3f4d4c6d2bc5aea6u));
    const double w = fma(t, t, 0.0);
    const double q = fma(fma(fma(p1, w, p2), w, p3), t, 0.0);
    const double s = z + t;
    const double e = t - (s - z);
    return {((low + e) + q) + s, flag_if<double>(not_positive_normal(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    return log2_rare(x, y, __dlog2_ha___libm_rcp_table_256, __dlog2_ha___libm_log2_table_256);
  }
};

/// log2, double, without a table; one body for `la` and `ep`. Code 1 also for a NaN with its sign
/// bit set. Largest error 1.81 ulp.
struct log2_d_nolut : scalar_v11<log2_d_nolut, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const auto a = two_thirds<double>::of(x);
    const double z = ln_by_long_polynomial(a);
    return {fma(value(0x3ff71547652b82feu), z, a.k), flag_if<double>(not_positive_finite(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) { return log_of_zero_or_negative(x, y); }
};

struct binary_logarithm_h {
  LUMEN_MAIN float of_log2(float l) { return l; }
};

/// log2, half.
using log2_h = half_log<binary_logarithm_h>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
