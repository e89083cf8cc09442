// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/exp/half_range_power.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The status of a power of two of a finite argument, by its pattern.
template <typename T>
LUMEN_MAIN uint_of<T> exp2_status(T result) {
  const uint_of<T> above = select(bits(result) == format<T>::special, mask(code::overflow), 0u);
  return select(bits(result) <= format<T>::fraction, uint_of<T>{mask(code::underflow)}, above);
}

/// What `beyond` gives for 2^x: `power` where the argument is finite and the power is not zero.
/// A zero is not computed: processors take long for a product that underflows.
template <typename T>
LUMEN_MAIN rare_result<T> exp2_result(T x, bool is_zero, T power) {
  const T finite = select(is_zero, T(0), power);
  const T special = select(x < 0, T(0), x + x);
  return {select(is_special(x), special, finite), 0,
          select(is_special(x), uint_of<T>{0}, exp2_status(finite))};
}

/// 2^f at float for |f| <= 1/2, as (1 + f/2) + e: the main part is kept in two words, so that its
/// rounding does not count.
LUMEN_MAIN float exp2_of_fraction(float f) {
  const float a = horner(f, 0x39224c80u, 0x3aafa463u, 0x3c1d94cbu, 0x3d635766u, 0x3e75fdf1u,
                         0x3e45c862u);  // the last one ln 2 - 1/2
  const float b = fma(f, 0.5f, 1.0f);
  const float c = b - 1.0f;
  const float d = fma(f, 0.5f, -c);
  return b + fma(a, f, d);
}

/// exp2, float; one body for all tiers, within 0.79 ulp. Of a finite argument code 3 for an
/// infinite result, code 4 for one below the smallest normal number; ±infinity has code 0.
struct exp2_s : scalar_v11<exp2_s, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float n = rint(x);
    const float y = exp2_of_fraction(x - n);
    // The integer n, exact for |n| < 2^22; from larger ones and NaNs an integer outside -125..126.
    const std::uint32_t shifter = 0x4b400000;  // 3·2^22
    const std::uint32_t i = bits(n + value(shifter)) - shifter;
    return {value(bits(y) + (i << 23)), flag_if<float>(i - 127u < 0xffffff04u)};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) { return assign(beyond(x), y); }

  LUMEN_MAIN rare_result<float> beyond(float x) {
    const bool is_zero = x < -151.0f;
    const float finite = select(is_special(x) || is_zero, 0.0f, x);
    const float c = select(finite > 192.0f, 192.0f, finite);
    const auto k = static_cast<std::int32_t>(rint(c));
    const std::int32_t a = k >> 1;
    const std::int32_t b = k - a;
    const float fraction = finite - rint(finite);
    const float power = (exp2_of_fraction(fraction) * power_of_two(b)) * power_of_two(a);
    return exp2_result(x, is_zero, power);
  }

 private:
  LUMEN_MAIN float power_of_two(std::int32_t e) {
    return value((static_cast<std::uint32_t>(e) << 23) + format<float>::one);
  }
};

/// exp2, double. Of a finite argument code 3 for an infinite result, code 4 for one below the
/// smallest normal number; ±infinity has code 0.
///
/// As at float, with 1 + f/2 in one word at `la` and `ep`, in two at `ha`; degree 11, at `ep` 9.
/// Largest error 0.79, 1.16, 6.1e4 ulp for `ha`, `la`, `ep`.
template <tier t>
struct exp2_d : scalar_v11<exp2_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const reduced a = reduce(x);
    return {a.power * value(a.shifted << 52), flag_if<double>(fabs(x) >= 1022.0)};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) { return assign(beyond(x), y); }

  LUMEN_MAIN rare_result<double> beyond(double x) {
    const bool is_zero = x < -1076.0;
    const reduced a = reduce(select(is_special(x) || is_zero, 0.0, x));
    // The integer of the reduction and not that of x anew: a shifter of other parity would send an
    // argument halfway between two integers to the other one.
    const double n = select(a.integer > 1536.0, 1536.0, a.integer);
    const std::uint64_t u = bits(n + value(0x43380000000007feu)) & 0xffffffffu;  // n + 2046
    // Beyond 2^51 the sum with the shifter is no longer exact, and the fraction means nothing.
    const double fraction = select(a.power < 0.5, 0.5, select(a.power > 2.0, 2.0, a.power));
    const std::uint64_t first = u >> 1;
    const std::uint64_t second = u - first;
    const double power = (fraction * value(second << 52)) * value(first << 52);
    return exp2_result(x, is_zero, power);
  }

 private:
  /// 2^x = 2^integer·power.
  struct reduced {
    std::uint64_t shifted;  ///< ends in integer + 1023
    double integer;
    double power;
  };

  LUMEN_MAIN reduced reduce(double x) {
    const double shifter = value(0x43380000000003ffu);  // 3·2^51 + 1023
    const double shifted = x + shifter;
    const double n = shifted - shifter;
    const double f = x - n;
    return {bits(shifted), n, power_of_fraction(f)};
  }

  LUMEN_MAIN double power_of_fraction(double f) {
    const double b = fma(f, 0.5, 1.0);
    if constexpr (t == tier::ep) {
      const double p = horner(f, 0x3e7b524ca9ff39ccu, 0x3eb62bfc2c7be078u, 0x3eeffcbfc7e3f872u,
                              0x3f2430913112cae8u, 0x3f55d87fe78a0586u, 0x3f83b2ab6fb9f1a3u,
                              0x3fac6b08d704a0dbu, 0x3fcebfbdff82c5aeu, 0x3fc8b90bfbe8e7bcu);
      return fma(p, f, b);
    } else {
      const double p = horner(f, 0x3dfea1c678ded0efu, 0x3e3e6228be5a9ffdu, 0x3e7b524ca9ff39ccu,
                              0x3eb62bfc2c7be078u, 0x3eeffcbfc7e3f872u, 0x3f2430913112cae8u,
                              0x3f55d87fe78a0586u, 0x3f83b2ab6fb9f1a3u, 0x3fac6b08d704a0dbu,
                              0x3fcebfbdff82c5aeu, 0x3fc8b90bfbe8e7bcu);
      if constexpr (t == tier::ha) {
        const double c = b - 1.0;
        const double d = fma(f, 0.5, -c);
        return b + fma(p, f, d);
      } else {
        return fma(p, f, b);
      }
    }
  }
};

/// exp2, half; within 0.94, 1.52, 1.52 ulp for `ha`, `la`, `ep`. Straight-line code for every
/// argument, status 0. x, clamped to where the result is an infinity or zero, is n + r with an even
/// integer n; `ha` keeps the coefficient ln 2 apart from the other terms.
template <tier t>
struct exp2_h : half_v11<exp2_h<t>> {
  LUMEN_MAIN main_result<float> main(float x) {
    const float below = select(x < 16.0f, x, 16.0f);
    const float c = select(below > -26.0f, below, -26.0f);
    const float shifter = 3102.0f;
    const float shifted = half_add(c, shifter);
    const float n = shifted - shifter;  // exact, as is the rest
    const float r = c - n;
    const float s = half_value((half_pattern(shifted) << 10) & 0xffffu);  // 2^(n/2)
    const float factor = scale_or_nan(s, x);
    return {half_fma(power_less_one(r), factor, factor) * factor};
  }

 private:
  LUMEN_MAIN float power_less_one(float r) {
    if constexpr (t == tier::ha) {
      float p = half_fma(half_value(0x1596), r, half_value(0x210b));
      p = half_fma(p, r, half_value(0x2b1a));
      p = half_fma(p, r, half_value(0x33af));
      p = half_fma(p, r, half_value(0x8adc));
      p = half_fma(p, r, 0.0f);
      return half_fma(r, half_value(0x398c), p);
    } else {
      float p = half_fma(half_value(0x2110), r, half_value(0x2b52));
      p = half_fma(p, r, half_value(0x33af));
      p = half_fma(p, r, half_value(0x398b));
      return half_fma(p, r, 0.0f);
    }
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
