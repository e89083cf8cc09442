// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/root/invcbrt_constants.hpp"
#include "scalar/root/thirds.hpp"
#include "scalar/tables/dinvcbrt.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// invcbrt, float, without double arithmetic. Code 2 for zeros; ±0 for ±infinity.
///
/// |x|, times 2^26 below 1, is m·2^e with m in [2/3, 4/3), and e = -3n - k up to the bias, so that
/// the result is m^(-1/3)·2^(k/3)·2^n; 2^(k/3) is in two words. Within 0.86, 1.14, 0.86 ulp for
/// `ha`, `la`, `ep`: degree 9, at `la` 8.
template <tier t>
struct invcbrt_s : scalar_v11<invcbrt_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const std::uint32_t sign = sign_bit(x);
    const bool small = fabs(x) < 1.0f;
    const float v = fma(fabs(x), select(small, value(0x4c800000u), 1.0f), 0.0f);  // 2^26
    const std::uint32_t w = bits(v);
    const std::uint32_t e = ((w + 0x00555555u) >> 23) - 127u;
    const float f = value(w - (e << 23)) - 1.0f;
    const std::uint32_t d = select(small, 0x197u, 0x17du) - e;
    const std::uint32_t q = (d * 0x2aabu) >> 15;
    const std::uint32_t k = d - 3 * q;
    const float power = value(sign | (q << 23));
    const std::uint32_t c = select(k == 0, 0x3f800000u, select(k == 2, 0x3fcb2ff5u, 0x3fa14518u));
    const std::uint32_t c_low = select(k == 0, 0u, select(k == 2, 0x32a7adc8u, 0xb2ce51afu));
    const float g = fma(polynomial(f), value(c), value(c_low)) + value(c);
    const float finite = fma(g, power, select(is_nan(v), v, 0.0f));
    const float y = select(is_infinite(x), value(sign), finite);
    return {y, flag_if<float>(x == 0)};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    *y = or_sign(value(format<float>::special), x);
    return mask(code::pole);
  }

 private:
  /// (1 + f)^(-1/3) - 1.
  LUMEN_MAIN float polynomial(float f) {
    if constexpr (t == tier::la) {
      return horner_of(f, invcbrt_la_polynomial_s);
    } else {
      return horner(f, 0xbde8ab54u, 0x3df23fc9u, 0xbdc6824eu, 0x3dddb759u, 0xbe000263u, 0x3e139a3du,
                    0xbe30fbd5u, 0x3e638dd0u, 0xbeaaaaabu, 0x317089ffu);
    }
  }
};

/// invcbrt of zeros, infinities, NaNs and denormals at double; also of normal numbers. Within 0.51
/// ulp.
///
/// |x| = m·2^(3n), m in [1, 8), denormals scaled up before. A row of the table gives T close to
/// m^(-1/3), so short that its cube is exact; e = 1 - T^3·m, |e| < 1/64, is rounded once, and
/// m^(-1/3) = T·(1 - e)^(-1/3) by the series, which stands in the table.
LUMEN_DEVICE inline std::uint32_t invcbrt_of_any(double x, double* y) {
  if (x == 0 || is_special(x)) {
    *y = divide(1.0, x);
    return mask(x == 0 ? code::pole : code::none);
  }
  const bool denormal = bits(fabs(x)) < 0x0010000000000000u;
  const double scaled = denormal ? fabs(x) * value(0x43b0000000000000u) : fabs(x);  // 2^60
  const auto e = thirds<std::uint64_t>::of(bits(scaled) >> 52);
  const auto i = thirty_second<double>::of(scaled).i;
  const double row = value(_arrdInvCbrtHATab[32 * static_cast<std::int32_t>(e.k) + i]);
  const double m =
      value((bits(scaled) & format<double>::fraction) | (format<double>::one + (e.k << 52)));
  const double rest = fma(-(row * row * row), m, 1.0);
  double p = 0;
  for (int j = 0; j < 9; ++j) p = mad(p, rest, value(_arrdInvCbrtHATab[96 + j]));
  const double root = mad(row, p * rest, row);
  const std::uint64_t unscaled = denormal ? 20 : 0;
  *y = or_sign(root * value((0x554 - e.q + unscaled) << 52), x);
  return mask(code::none);
}

/// What the tiers of invcbrt at double share: |x| = m·2^(3n + k), m in the interval of [1, 2) whose
/// middle is c, and g = m/c - 1.
template <typename Body>
struct invcbrt_d_paths : scalar_v11<Body, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    return {Body::inverse_root(x), flag_if<double>(not_normal(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) { return invcbrt_of_any(x, y); }

 protected:
  struct reduction {
    std::int32_t row;  ///< 32k + i
    double power;      ///< 2^-n with the sign of x
    double g;

    LUMEN_MAIN reduction of(double x, const std::uint64_t* reciprocals) {
      const std::uint64_t field = bits(x) >> 52;
      const auto e = thirds<std::uint64_t>::of(field & 0x7ff);
      const auto m = thirty_second<double>::of(x);
      const double power = value((((field & 0x800) | 0x554) - e.q) << 52);
      const double g = fma(m.less, value(reciprocals[m.i]), 0.0);
      return {static_cast<std::int32_t>(e.k << 5) | m.i, power, g};
    }
  };
};

/// invcbrt, double. Code 2 for zeros; ±0 for ±infinity. Denormals are within 0.51 ulp.
///
/// One row of (2^k·c)^(-1/3), and the series of (1 + g)^(-1/3) to degree 7, |g| <= 1/65. `la` and
/// `ep`, one body: rows in one word; within 3.2 ulp, most of it by the end of the series.
template <tier t>
struct invcbrt_d : invcbrt_d_paths<invcbrt_d<t>> {
  LUMEN_MAIN double inverse_root(double x) {
    const auto a = invcbrt_d::reduction::of(x, internal_dinvcbrt_la_data);
    const double w = fma(value(internal_dinvcbrt_la_data[32 + a.row]), a.power, 0.0);
    const double p =
        horner(a.g, 0xbfb9b33ca7a65562u, 0x3fbc67c9dd3d11bbu, 0xbfbff4c33f90ef5fu,
               0x3fc26fabb85d0196u, 0xbfc61f9add3c0ca3u, 0x3fcc71c71c71c71cu, 0xbfd5555555555555u);
    return fma(p, fma(w, a.g, 0.0), 0.0) + w;
  }
};

/// `ha`: rows in two words and degree 8; within 0.52 ulp.
template <>
struct invcbrt_d<tier::ha> : invcbrt_d_paths<invcbrt_d<tier::ha>> {
  LUMEN_MAIN double inverse_root(double x) {
    const auto a = reduction::of(x, internal_dinvcbrt_ha_data);
    const double high = value(internal_dinvcbrt_ha_data[32 + 2 * a.row]);
    const double low = value(internal_dinvcbrt_ha_data[33 + 2 * a.row]);
    const double p = horner_of(a.g, invcbrt_ha_polynomial_d);
    const double root = high + fma(high, fma(p, a.g, 0.0), low);
    return fma(root, a.power, 0.0);
  }
};

/// invcbrt, half: the float body of `ep` in every tier.
using invcbrt_h = half_v11<invcbrt_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
