// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dexpm1.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// s - 1 for the scale s of e^x as a rounded sum and its error. The terms are put in order of size
/// by the sign of x, as the fast two-sum needs them.
template <typename T>
struct less_one {
  T sum;
  T error;
  LUMEN_MAIN less_one of(T s, T x) {
    const T larger = select(x >= T(0), s, T(-1));
    const T smaller = select(x >= T(0), T(-1), s);
    const T sum = s - T(1);
    return {sum, smaller - (sum - larger)};
  }
};

/// What all tiers of expm1 at float share: x = n ln 2 + a rest, and what holds beyond |x| = 87.
///
/// n is truncated, not rounded: it is 0 for all |x| < ln 2, and there the scale less 1 is an exact
/// zero. A `Body` gives e^x - 1, and e^x·2^-64 for where 2^n may overflow.
template <typename Body>
struct expm1_s_paths : scalar_v11<Body, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    return {or_sign(Body::difference(x), x), flag_if<float>(!(fabs(x) <= 87.0f))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    const rare_result<float> limit = beyond(x);
    if (limit.rare == 0) return assign(limit, y);
    if (is_nan(x)) {
      *y = x + or_sign(Body::difference(x), x);
      return mask(code::none);
    }
    *y = Body::scaled_power(x) * value(0x5f800000u);  // 2^64
    return mask(is_infinite(*y) ? code::overflow : code::none);
  }

  /// -1 and infinity.
  LUMEN_MAIN rare_result<float> beyond(float x) {
    const bool below = x < 0;
    const bool above = x >= 128.0f;
    return {select(below, -1.0f, value(format<float>::special)), flag_if<float>(!(below || above)),
            select(above, mask(code::overflow), 0u)};
  }

 protected:
  struct reduction {
    float n;
    std::uint32_t scale;  ///< pattern of 2^n; the exponent field wraps where it does not suffice
    float rest;           ///< x - n ln 2, by the float ln 2

    LUMEN_MAIN reduction of(float x) {
      const float n = trunc(fma(x, value(0x3fb8aa3bu), 0.0f));
      const float shifted = n + value(0x4b40007fu);  // 3·2^22 + 127
      return {n, bits(shifted) << 23, fma(n, value(0xbf317218u), x)};
    }
    float power() const { return value(scale); }
    float scaled_power() const { return value(scale + 0xe0000000u); }  // 2^(n - 64)
  };
};

/// expm1, float; within 0.84, 1.86, 331 ulp for `ha`, `la`, `ep`. expm1(-0) is -0, and a negative x
/// gives a negative result. Code 3 for an infinite result; -1 for large negative arguments and
/// -infinity, with code 0.
///
/// `la` and `ep`: a polynomial of degree 7 and 5 in one word.
template <tier t>
struct expm1_s : expm1_s_paths<expm1_s<t>> {
  LUMEN_MAIN float difference(float x) {
    const auto a = expm1_s::reduction::of(x);
    const float s = a.power();
    return fma(s, rest_of_power(a), s - 1.0f);
  }

  LUMEN_MAIN float scaled_power(float x) {
    const auto a = expm1_s::reduction::of(x);
    const float s = a.scaled_power();
    return fma(s, rest_of_power(a), s);
  }

 private:
  /// e^r - 1 for the rest r of the reduction.
  LUMEN_MAIN float rest_of_power(const typename expm1_s::reduction& a) {
    if constexpr (t == tier::ep) {
      const float r = a.rest;
      const float p = horner(r, 0x3c0b4a77u, 0x3d2e1d2cu, 0x3e2aa0ccu, 0x3efff2b6u, 0x35bb1a40u);
      return fma(p, r, r);
    } else {
      const float r = fma(a.n, value(0x3102e308u), a.rest);
      const float p = horner(r, 0x39533223u, 0x3ab8cbe5u, 0x3c088428u, 0x3d2aa55eu, 0x3e2aaab3u,
                             0x3f000005u, 0xb11f699bu);
      return fma(p, r, r);
    }
  }
};

/// `ha`: degree 8, with the terms of degree 0 to 2 in double-word arithmetic.
template <>
struct expm1_s<tier::ha> : expm1_s_paths<expm1_s<tier::ha>> {
  LUMEN_MAIN float difference(float x) {
    const words a = reduce(x);
    const float s = a.power;
    float p = fma(a.cubic, a.r, value(0xb07ec280u));
    p = fma(p, a.r, value(0xb09f34cfu));
    p = fma(p, a.r, a.low);
    const auto c = less_one<float>::of(s, x);
    const float g = fma(s, a.high, 0.0f);
    const float g_low = fma(s, a.high, -g);
    // 2^n (1 + high) - 1 = h + m; then the square with h doubled, so that q/2 is both.
    const float h = g + c.sum;
    const float h2 = h + h;
    const float k = g - (h - c.sum);
    const float m = (c.error + k) + g_low;
    const float q = fma(g, a.high, h2);
    const float q_low = fma(g, a.high, -(q - h2));
    float w = fma(g, a.low, m);
    w = fma(q_low, 0.5f, w);
    w = fma(s, p, w);
    return fma(q, 0.5f, w);
  }

  LUMEN_MAIN float scaled_power(float x) {
    const words a = reduce(x);
    float p = fma(a.cubic, a.r, 0.5f);
    p = fma(p, a.r, value(0xb07ec280u));
    p = fma(p, a.r, a.low);
    return fma(a.scaled_power, p + a.high, a.scaled_power);
  }

 private:
  /// x = n ln 2 + high + low, r = high + low; `cubic` is (e^r - 1 - r - r²/2)/r³.
  struct words {
    float power;
    float scaled_power;
    float high;
    float low;
    float r;
    float cubic;
  };

  LUMEN_MAIN words reduce(float x) {
    const auto a = reduction::of(x);
    const float low = fma(a.n, value(0x3102e308u), 0.0f);
    const float r = a.rest + low;
    const float cubic =
        horner(r, 0x37d2d82du, 0x3952d831u, 0x3ab606ceu, 0x3c08852cu, 0x3d2aaab0u, 0x3e2aaab0u);
    return {a.power(), a.scaled_power(), a.rest, low, r, cubic};
  }
};

/// What all tiers of expm1 at double share: what holds beyond |x| = 708. A `Body` gives e^x - 1,
/// and e^x·2^-512 for where the scale may overflow.
template <typename Body>
struct expm1_d_paths : scalar_v11<Body, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    return {Body::difference(x), flag_if<double>(!(fabs(static_cast<float>(x)) <= 708.0f))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    const rare_result<double> limit = beyond(x);
    if (limit.rare == 0) return assign(limit, y);
    if (is_nan(x)) {
      *y = Body::difference(x) + x;
      return mask(code::none);
    }
    *y = Body::scaled_power(x) * value(0x5ff0000000000000u);  // 2^512
    return mask(is_infinite(*y) ? code::overflow : code::none);
  }

  /// -1 and infinity.
  LUMEN_MAIN rare_result<double> beyond(double x) {
    const auto narrowed = static_cast<float>(x);
    const bool below = narrowed < 0;
    const bool above = narrowed >= 1024.0f;
    return {select(below, -1.0, value(format<double>::special)), flag_if<double>(!(below || above)),
            select(above, std::uint64_t{mask(code::overflow)}, std::uint64_t{0})};
  }

 protected:
  /// The scale with 512 taken from its exponent.
  LUMEN_MAIN double scaled_down(std::uint64_t scale) { return value(scale + 0xe000000000000000u); }

  /// 2^(j/N) from row j of a table, with the exponent that `field` holds above the index. The row
  /// cancels the bits that the index leaves in the fraction. `rest` is what the double of 2^(j/N)
  /// leaves out, relative to it; only its high half is read.
  struct root {
    std::uint64_t scale;
    double rest;
    LUMEN_MAIN root of(const std::uint64_t* table, std::int32_t word, std::uint64_t field) {
      return {field ^ table[word], value(table[word + 1] & 0xffffffff00000000u)};
    }
  };
};

/// expm1, double; within 0.79, 2.29, 1.2e7 ulp for `ha`, `la`, `ep`. expm1(-0) is +0. Code 3 for an
/// infinite result; -1 for large negative arguments and -infinity, with code 0.
///
/// `la` and `ep`: the first step of the reduction is in float, to multiples of 1/32 and a table of
/// 2^(j/32) with degree 6 at `la`, to integers and without a table with degree 8 at `ep`.
template <tier t>
struct expm1_d : expm1_d_paths<expm1_d<t>> {
  LUMEN_MAIN double difference(double x) {
    const factors a = factorize(x);
    const double s = value(a.scale);
    return fma(s, a.rest, s - 1.0);
  }

  LUMEN_MAIN double scaled_power(double x) {
    const factors a = factorize(x);
    const double s = expm1_d::scaled_down(a.scale);
    return fma(s, a.rest, s);
  }

 private:
  /// e^x = scale·(1 + rest).
  struct factors {
    std::uint64_t scale;
    double rest;
  };

  LUMEN_MAIN factors factorize(double x) {
    const auto narrowed = static_cast<float>(x);
    const float log2_e = value(0x3fb8aa3bu);
    if constexpr (t == tier::ep) {
      const float shifter = value(0x4b4003ffu);  // 3·2^22 + 1023
      const float shifted = fma(narrowed, log2_e, shifter);
      const auto n = static_cast<double>(shifted - shifter);
      const double r = fma(n, value(0xbfe62e42fefa39efu), x);
      const double p = horner(r, 0x3efa5b0597ae2842u, 0x3f2a5b062ac4ca1au, 0x3f56c0d9c1d50009u,
                              0x3f8110a57824968bu, 0x3fa555560b7d4cbeu, 0x3fc55555faec57afu,
                              0x3fdfffffff013d80u, 0xbe13e699df82e534u);
      return {std::uint64_t{bits(shifted)} << 52, fma(p, r, r)};
    } else {
      const float shifter = value(0x48c07fe0u);  // 3·2^17 + 1023, unit 1/32
      const float shifted = fma(narrowed, log2_e, shifter);
      const auto n = static_cast<double>(shifted - shifter);
      double r = fma(n, value(0xbfe62e42fefa39efu), x);
      r = fma(n, value(0xbc7abc9e3b39803fu), r);
      const std::uint32_t w = bits(shifted);
      const auto word = static_cast<std::int32_t>((w << 1) & 0x3e);
      const auto root = expm1_d::root::of(__dexpm1_la_Tbl_exp, word, std::uint64_t{w} << 47);
      const double p = horner(r, 0x3f56c17256147174u, 0x3f811115c0928f3bu, 0x3fa5555555547138u,
                              0x3fc5555555547d38u, 0x3fe0000000000000u, 0x3ff0000000000000u);
      return {root.scale, fma(p, r, root.rest)};
    }
  }
};

/// `ha`: multiples of 1/16, truncated, a table of 2^(j/16), degree 9, and the terms of degree 0 and
/// 1 in double-word arithmetic.
template <>
struct expm1_d<tier::ha> : expm1_d_paths<expm1_d<tier::ha>> {
  static constexpr int interleave = 4;

  LUMEN_MAIN double difference(double x) {
    const words a = reduce(x);
    const double s = value(a.scale);
    const auto c = less_one<double>::of(s, x);
    const double g = fma(s, a.high, 0.0);
    const double g_low = fma(s, a.high, -g);
    const double h = g + c.sum;
    const double k = g - (h - c.sum);
    return fma(s, a.rest, (c.error + k) + g_low) + h;
  }

  LUMEN_MAIN double scaled_power(double x) {
    const words a = reduce(x);
    const double s = scaled_down(a.scale);
    return fma(s, a.rest + a.high, s);
  }

 private:
  /// e^x = scale·(1 + high + rest).
  struct words {
    std::uint64_t scale;
    double high;
    double rest;
  };

  LUMEN_MAIN words reduce(double x) {
    const auto narrowed = static_cast<float>(x);
    const float steps = trunc(fma(narrowed, value(0x41b8aa3bu), 0.0f));  // 16 log2 e
    const std::uint32_t w = bits(steps + value(0x4b403ff0u));            // 3·2^22 + 16·1023
    const auto n = static_cast<double>(steps);
    const double high = fma(n, value(0xbfa62e42fefa39f0u), x);
    const double low = fma(n, value(0x3c5950d871319ff0u), 0.0);
    const double r = high + low;
    const auto word = static_cast<std::int32_t>((w << 1) & 0x1e);
    const auto root = root::of(__dexpm1_ha_Tbl_exp, word, std::uint64_t{w} << 48);
    const double p = horner(r, 0x3efa01f8f4be0535u, 0x3f2a01f8f4b129ccu, 0x3f56c16c16304601u,
                            0x3f81111110a65711u, 0x3fa555555555560au, 0x3fc55555555555f9u,
                            0x3fe0000000000000u, 0xbc13b588106b310fu);
    return {root.scale, high, fma(p, r, low + root.rest)};
  }
};

/// expm1, half: the float body of `ep` in every tier.
using expm1_h = half_v11<expm1_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
