// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/exp/half_range_power.hpp"
#include "scalar/exp/half_step_power.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// (e^r - 1)/r on |r| <= ln 2/4, and where e^x leaves the normal numbers.
struct natural_base_s {
  static constexpr std::uint32_t log2_of_base = 0x3fb8aa3b;    // log2 e
  static constexpr std::uint32_t half_step_high = 0x3f317218;  // ln 2
  static constexpr std::uint32_t half_step_low = 0xb102e308;
  static constexpr std::uint32_t c5 = 0x3c08ba8b, c4 = 0x3d2aec4e, c3 = 0x3e2aaa9c, c2 = 0x3effffe8,
                                 c1 = 0x3f800000;
  static constexpr std::uint32_t normal_limit = 0x42aeac4f;  // 87.33654
  static constexpr std::uint32_t scaled_limit = 0x432eac4f;  // 174.67308
  static constexpr std::uint32_t zero_limit = 0x42d00000;    // 104: e^-104 < 2^-150
};

/// exp, float; within 0.86 ulp in every tier.
using exp_s = half_step_power<natural_base_s>;

/// e^x = scale·(1 + rest) at double. The exponent field of the scale wraps where it does not
/// suffice.
struct exponential_factors {
  std::uint64_t scale;
  double rest;
};

/// The same by a reduction to half-integers as at float, with a polynomial of degree 9; `ha` adds
/// the rest of the double √2 in the polynomial's last step.
template <tier t>
struct half_step_factors_d {
  LUMEN_MAIN exponential_factors of(double x) {
    const reduced a = reduce(x);
    return with_rest(a.shifted, a.r);
  }

  /// Of x + tail, the tail being small against x. `ha` also keeps what the sum rounds off.
  LUMEN_MAIN exponential_factors of(double x, double tail) {
    const reduced a = reduce(x);
    const double r = a.r + tail;
    if constexpr (t == tier::ha) {
      return with_rest(a.shifted, r, tail - (r - a.r));
    } else {
      return with_rest(a.shifted, r);
    }
  }

 private:
  struct reduced {
    std::uint64_t shifted;
    double r;
  };

  LUMEN_MAIN reduced reduce(double x) {
    const double shifter = value(0x43280000000007feu);  // unit 1/2, 3·2^50 + 1023
    const double shifted = fma(x, value(0x3ff71547652b82feu), shifter);
    const double n = shifted - shifter;
    const double r = fma(value(0xbfe62e42fefa39efu), n, x);
    return {bits(shifted), fma(value(0xbc7abc9e3b39803fu), n, r)};
  }

  LUMEN_MAIN exponential_factors with_rest(std::uint64_t shifted, double r) {
    const std::uint64_t odd = 0u - (shifted & 1u);
    if constexpr (t == tier::ha) {
      return {scale_of(shifted), fma(polynomial(r), r, root_rest(odd))};
    } else {
      return {scale_of(shifted), polynomial(r) * r};
    }
  }

  LUMEN_MAIN exponential_factors with_rest(std::uint64_t shifted, double r, double r_low) {
    const std::uint64_t odd = 0u - (shifted & 1u);
    return {scale_of(shifted), fma(polynomial(r), r, root_rest(odd) + r_low)};
  }

  LUMEN_MAIN double polynomial(double r) {
    return horner(r, 0x3ec722bccc270959u, 0x3efa072e44b58159u, 0x3f2a019f7560fba3u,
                  0x3f56c16b8144bd5bu, 0x3f811111111ac486u, 0x3fa55555556228ceu,
                  0x3fc5555555555462u, 0x3fdffffffffffe76u, 0x3ff0000000000000u);
  }

  LUMEN_MAIN std::uint64_t scale_of(std::uint64_t shifted) {
    const std::uint64_t odd = 0u - (shifted & 1u);
    return (shifted << 51) ^ (odd & 0x000ea09e667f3bcdu);  // √2
  }

  /// What the double √2, or 1, leaves out, relative to it.
  LUMEN_MAIN double root_rest(std::uint64_t odd) {
    return value((odd & 0x80e182ab00000000u) ^ 0x3c6e51c500000000u);
  }
};

/// The same to 28 bits: to integers by a first step in float, with a polynomial of degree 6.
LUMEN_MAIN exponential_factors short_factors(double x) {
  const float shifter = value(0x4b4003ffu);  // 3·2^22 + 1023
  const float shifted = fma(static_cast<float>(x), value(0x3fb8aa3bu), shifter);
  const double n = static_cast<double>(shifted - shifter);
  const double r = fma(value(0xbfe62e42fefa39efu), n, x);
  const double rest =
      horner(r, 0x3f56dd9818211af0u, 0x3f8126fababd1cf2u, 0x3fa55541c4c8cb89u, 0x3fc55540432ea07bu,
             0x3fe00000090aa64au, 0x3ff000000a208385u, 0xbdd63f26cce7780fu);
  return {std::uint64_t{bits(shifted)} << 52, rest};
}

/// exp, double. Code 3 for an infinite result, code 4 for one below the smallest normal number, the
/// results of ±infinity included.
///
/// `ha` and `la` reduce to half-integers, `ep` to integers. Largest error 0.94, 1.28, 1.7e7 ulp.
template <tier t>
struct exp_d : scalar_v11<exp_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const factors e = factorize(x);
    const double scale = value(e.scale);
    return {fma(scale, e.rest, scale), flag_if<double>(is_large(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) { return assign(beyond(x), y); }

  /// A zero is not computed: processors take long for a product that underflows.
  LUMEN_MAIN rare_result<double> beyond(double x) {
    const double infinity = value(format<double>::special);
    const bool computed = (bits(fabs(x)) >> 32) < 0x40879127u && !(x < -746.0);  // 754.144
    const factors e = factorize(select(computed, x, 0.0));
    const bool down = x >= 0;
    const double scale = value(e.scale + select(down, std::uint64_t{0xf800000000000000},
                                                std::uint64_t{0x0800000000000000}));
    const double back = select(down, 0x1p128, 0x1p-128);
    const double power = fma(scale, e.rest, scale) * back;
    const double limit = select(is_nan(x), x + 0.0, select(down, infinity, 0.0));
    const double result = select(computed, power, limit);
    const std::uint64_t above = select(result == infinity, mask(code::overflow), 0u);
    return {
        result, 0,
        select(result < value(0x0010000000000000u), std::uint64_t{mask(code::underflow)}, above)};
  }

 private:
  using factors = exponential_factors;

  LUMEN_MAIN factors factorize(double x) {
    if constexpr (t == tier::ep) {
      return short_factors(x);
    } else {
      return half_step_factors_d<t>::of(x);
    }
  }

  /// The scale of such an argument, or the result, may leave the normal numbers. False for a NaN.
  LUMEN_MAIN bool is_large(double x) {
    if constexpr (t == tier::ep) {
      return fabs(static_cast<float>(x)) > value(0x4431195cu);  // 708.39624
    } else {
      return fabs(x) >= value(0x4086232a00000000u);  // 708.3955078125
    }
  }
};

struct natural_base_h {
  static constexpr float highest = 12.0f;
  static constexpr float lowest = -18.0f;
  static constexpr std::uint32_t half_log2 = 0x3dc5;  // log2 e in two halves, and as a float
  static constexpr std::uint32_t half_log2_low = 0x0d1e;
  static constexpr std::uint32_t float_log2 = 0x3fb8aa3b;
};

/// exp, half; within 0.84, 1.62, 1.62 ulp for `ha`, `la`, `ep`, status 0.
template <tier t>
using exp_h = half_range_power<natural_base_h, t>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
