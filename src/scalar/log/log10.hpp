// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/log/breakpoint.hpp"
#include "scalar/log/half_log.hpp"
#include "scalar/log/long_polynomial.hpp"
#include "scalar/log/reduction.hpp"
#include "scalar/log/three_quarters.hpp"
#include "scalar/log/zero_or_negative.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dlog10.hpp"
#include "scalar/tables/slog10.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

struct log10_constants_s {
  static constexpr std::uint32_t denormal_scale = 0x53800000;  // 2^40
  static constexpr int denormal_exponent = 40;
  static constexpr std::uint32_t near_one_limit = 0x3bc00000;  // 0.005859375
  static constexpr std::uint32_t splitter = 0x46000000;        // 8192, unit 2^-10
  static constexpr std::uint32_t low_bits = 0x1fff;
  static constexpr std::uint32_t scale = 0x42de5c00;      // 111.1796875, about 256/ln 10
  static constexpr std::uint32_t log2_high = 0x3e9a0000;  // log10(2)
  static constexpr std::uint32_t log2_low = 0x39826a14;

  LUMEN_DEVICE static float polynomial(float t) {
    return horner(t, 0xa22b5daeu, 0x25aa5bfdu, 0xa92c998bu, 0x2cb3e701u, 0xb04353b9u, 0x33e23666u,
                  0xb7935d5au, 0xbf7f0000u);
  }
};

struct log10_constants_d {
  static constexpr std::uint64_t denormal_scale = 0x43b0000000000000;  // 2^60
  static constexpr int denormal_exponent = 60;
  static constexpr std::uint64_t near_one_limit = 0x3f78000000000000;  // 0.005859375
  static constexpr std::uint64_t splitter = 0x4160000000000000;        // 2^23, unit 2^-29
  static constexpr std::uint64_t low_bits = 0;
  static constexpr std::uint64_t scale = 0x3fdbc00000000000;      // 0.43359375, about 1/ln 10
  static constexpr std::uint64_t log2_high = 0x3fd34413509f8000;  // log10(2)
  static constexpr std::uint64_t log2_low = 0xbd380433b83b532a;

  LUMEN_DEVICE static double polynomial(double t) {
    return horner(t, 0xc045b3214e75eea2u, 0x40358992e1b1aa78u, 0xc025c90e698cfb68u,
                  0x4016ab9f7b1efe5cu, 0xc008930964d42479u, 0x3ffc6a02dc963a31u,
                  0xbff27af2dc77b115u, 0x3f5a7a6cbf2e4107u);
  }
};

/// log10, float. Code 2 for zeros, code 1 for negative numbers and -infinity. A NaN has code 0 at
/// `la` and `ep`, and code 1 at `ha`.
///
/// `la` and `ep`: reduction to [2/3, 4/3) without a table; degree 9 with log10(2) in two words, and
/// degree 5. Largest error 2.8 and 996 ulp.
template <tier t>
struct log10_s : scalar_v11<log10_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const auto a = two_thirds<float>::of(x);
    return {logarithm(a.k, a.r), flag_if<float>(not_positive_normal(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    const auto* table = t == tier::la ? __slog10_la_CoutTab : __slog10_ep_CoutTab;
    return breakpoint_log<scaled_path<float, log10_constants_s>>(x, y, table);
  }

 private:
  LUMEN_MAIN float logarithm(float k, float r) {
    if constexpr (t == tier::ep) {
      const float p = horner(r, 0x3dcdc127u, 0xbdf4ed71u, 0x3e137dbeu, 0xbe5e0922u, 0x3ede5caeu);
      const float l = fma(k, value(0x3e9a209bu), 0.0f);
      return fma(p, r, l);
    } else {
      const float w = fma(r, r, 0.0f);
      const float a = fma(value(0x3d8063b4u), r, value(0xbd890073u));
      const float b = fma(value(0x3d775317u), r, value(0xbd91fb27u));
      const float c = fma(value(0x3db20b96u), r, value(0xbdde6e20u));
      const float d = fma(value(0x3e143ce5u), r, value(0xbe5e5bc5u));
      float p = fma(fma(fma(a, w, b), w, c), w, d);
      p = fma(p, r, value(0x3ede5bd9u));
      const float l = fma(k, value(0xb64af600u), 0.0f);
      return fma(k, value(0x3e9a2100u), fma(p, r, l));
    }
  }
};

/// `ha`: degree 10, with the term of degree 1 and the exponent's in two words. Largest error
/// 0.84 ulp.
template <>
struct log10_s<tier::ha> : scalar_v11<log10_s<tier::ha>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    return {logarithm(three_quarters::of(x)), flag_if<float>(not_positive_normal(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    return rare_of_three_quarters<log10_s<tier::ha>>(x, y);
  }

  LUMEN_MAIN float logarithm(const three_quarters& x) {
    const float r = x.r;
    const float p = horner(r, 0xbca31649u, 0x3d3c41e2u, 0xbd6b2906u, 0x3d80c9d2u, 0xbd940285u,
                           0x3db1cb7cu, 0xbdde5c73u, 0x3e143d6bu, 0xbe5e5bd8u);
    const float q = fma(p, r, 0.0f);
    const float q_low = fma(p, r, -q);
    const float l = fma(value(0x3e9a209au), x.k, 0.0f);
    float l_low = fma(value(0x3e9a209au), x.k, -l);
    l_low = fma(value(0x3284fbd0u), x.k, l_low);
    // q + 1/ln 10, times r, plus the exponent's term.
    const float s = q + value(0x3ede5bd8u);
    const float s_low = (q_low + value(0x3299f261u)) + (q - (s - value(0x3ede5bd8u)));
    const float t = fma(s, r, 0.0f);
    float t_low = fma(s, r, -t);
    t_low = fma(s_low, r, t_low);
    const float u = t + l;
    const float d = t - (u - l);
    return u + ((t_low + l_low) + d);
  }
};

/// log10, double. Code 2 for zeros, code 1 for negative numbers and -infinity, code 0 for every
/// NaN.
///
/// `la` and `ep`: a row of a table by an integer reciprocal, degree 5 and 3. Largest error 2.1 and
/// 1.9e6 ulp.
template <tier t>
struct log10_d : scalar_v11<log10_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const auto a = integer_reciprocal::of(x);
    const double row = value(single_values()[integer_reciprocal::single_word(a)]);
    const double exponent =
        fma(integer_reciprocal::exponent_of_row(a), value(0x3fd34413509f79ffu), 0.0);
    const double p2 = fma(value(0x3fc287a7636f341eu), a.t, value(0xbfcbcb7b1526de36u));
    const double w = fma(a.t, a.t, 0.0);
    const double g = fma(a.t, value(0x3fdbcb7b1526e50eu), 0.0);
    double p = p2;
    if constexpr (t == tier::la) {
      const double p1 = fma(value(0x3fb63c65231fbd16u), a.t, value(0xbfbbcb7d4efbe80bu));
      p = fma(p1, w, p2);
    }
    return {(fma(p, w, g) + row) + exponent, flag_if<double>(not_positive_normal(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    const auto* table = t == tier::la ? __dlog10_la_CoutTab : __dlog10_ep_CoutTab;
    return breakpoint_log<scaled_path<double, log10_constants_d>>(x, y, table);
  }

 private:
  LUMEN_DEVICE static constexpr const std::uint64_t* single_values() {
    return t == tier::la ? internal_dlog10_la_data : internal_dlog10_ep_data;
  }
};

/// `ha`: the integer comes from the reciprocal times C = 0.43359375, close to 1/ln 10, so that the
/// rest t is already the first-order term but for a factor close to 1; the sum is in two words.
/// Largest error 0.52 ulp.
template <>
struct log10_d<tier::ha> : scalar_v11<log10_d<tier::ha>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const double scale = value(0x3fdbc00000000000u);
    const double m = mantissa_at(0x3f50000000000000u, x);  // 2^-10
    const auto reciprocal = static_cast<double>(quick_reciprocal(m));
    const double integer = rounded_by_shifter(fma(reciprocal, scale, 0.0));  // 222..444
    const double t = fma(m, integer, -scale);
    const auto word = static_cast<std::int32_t>((bits(integer) >> 43) - 0x80d78u);
    const double exponent = small_integer(bits(x) >> 52);
    const double z =
        fma(exponent, value(0x3fd34413509f0000u), value(internal_dlog10_ha_data[word]));
    const double low =
        fma(exponent, value(0x3d7e7fbcc47c0000u), value(internal_dlog10_ha_data[word + 1]));
    const double p1 = fma(value(0xc025c91a15f7eb9fu), t, value(0x4016aba863a166dbu));
    const double p2 = fma(value(0xc008930964d2fa9bu), t, value(0x3ffc6a02dc954978u));
    const double p3 = fma(value(0xbff27af2dc77b115u), t, value(0x3f5a7a6cbf2e410cu));
    const double w = fma(t, t, 0.0);
    const double q = fma(fma(fma(p1, w, p2), w, p3), t, 0.0);
    const double s = z + t;
    const double e = t - (s - z);
    return {((low + e) + q) + s, flag_if<double>(not_positive_normal(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    return breakpoint_log<scaled_path<double, log10_constants_d>>(x, y, __dlog10_ha_CoutTab);
  }
};

/// log10, double, without a table; one body for `la` and `ep`. Code 1 also for a NaN with its sign
/// bit set. Largest error 2.8 ulp.
struct log10_d_nolut : scalar_v11<log10_d_nolut, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const auto a = two_thirds<double>::of(x);
    const double z = ln_by_long_polynomial(a);
    const double y = fma(value(0x3fd34413509f79ffu), a.k, z * value(0x3fdbcb7b1526e50eu));
    return {y, flag_if<double>(not_positive_finite(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) { return log_of_zero_or_negative(x, y); }
};

struct decimal_logarithm_h {
  LUMEN_MAIN float of_log2(float l) { return fma(l, value(0x3e9a209bu), 0.0f); }  // log10(2)
};

/// log10, half.
using log10_h = half_log<decimal_logarithm_h>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
