// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/invsqrt.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// 1/sqrt(x) for positive finite x, denormals included; within 0.51 ulp.
///
/// x = 2^(2k)·m, m in [1, 4). A row of the table gives T close to 1/sqrt(m), so short that T² is
/// exact; 1/sqrt(m) = T·(1 - t)^(-1/2) with t = 1 - T²m in two words, |t| < 1/63, and the term t/2
/// of the series is added in two words.
LUMEN_DEVICE inline double careful_inverse_root(double x) {
  constexpr int scale_exponent = 60;
  const bool denormal = bits(x) < 0x0010000000000000u;
  const double scaled = denormal ? x * value(0x43b0000000000000u) : x;  // 2^60
  const int e = static_cast<int>(bits(scaled) >> 52) - format<double>::bias;
  const int odd = e & 1;
  const int k = (e >> 1) - (denormal ? scale_exponent / 2 : 0);
  const double mantissa = value((bits(scaled) & format<double>::fraction) | format<double>::one);
  const double m = mantissa + (odd != 0 ? mantissa : -0.0);
  // The low bits of mantissa + 2^47 + 1, whose unit is 1/32.
  const std::uint64_t nearest = bits(mantissa + value(0x42e0000000000020u)) & 0x3f;
  const double row = value(_arrdInvSqrtHATab[static_cast<int>(nearest) + 32 * odd]);

  const double splitter = value(0x41a0000000000000u);  // 2^27
  const double w = row * row;
  const double v = m * splitter;
  const double m_high = v - (v - m);
  const double m_low = m - m_high;
  const double g = mad(-w, m_high, 1.0);
  const double g_low = w * m_low;
  const double t = g - g_low;
  double p =
      horner(t, 0x3fc91a80bfbf8b2au, 0x3fcad28a9e3226dfu, 0x3fcce000c07a3b3eu, 0x3fcf7fffec1426e4u,
             0x3fd17ffffffe2a26u, 0x3fd400000000138bu, 0x3fd8000000000001u);
  p = (p * t) * t;
  const double u = g * splitter;
  const double g_leading = u - (u - g);
  const double g_rest = g - g_leading;
  const double q = mad(g_rest - g_low, 0.5, p);
  const double a = row * q;
  const double b = (row * 0.5) * g_leading;
  const double c = row + b;
  const double l = (row - c) + b;
  const auto field = static_cast<std::uint64_t>(format<double>::bias - k);
  return (c + (a + l)) * value(field << 52);
}

/// The rare path of invsqrt: what is not a positive normal number, and normal numbers too.
template <typename T>
LUMEN_DEVICE inline std::uint32_t invsqrt_of_any(T x, T* y) {
  if (is_special(x)) {
    *y = divide(bits(x) == format<T>::special ? T(0) : x, x);
    return mask(bits(x) == (format<T>::special | format<T>::sign) ? code::domain : code::none);
  }
  if (x == 0) {
    *y = divide(T(1), x);
    return mask(code::pole);
  }
  if (x < 0) {
    *y = value(format<T>::nan);
    return mask(code::domain);
  }
  *y = static_cast<T>(careful_inverse_root(static_cast<double>(x)));
  return mask(code::none);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
