// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Sine and cosine at double from the rest to the nearest quarter turn: the short reduction of the
/// main paths, and the kernels for rests of two words.
#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// (sin r - r)/r^3 and (cos r - 1 + r^2/2)/r^4 on |r| <= pi/4 from z = r^2, highest first.
struct quarter_turn_series {
  static constexpr std::uint64_t sine[6] = {0x3de5d877cbbe8daa, 0xbe5ae5e382f0f31c,
                                            0x3ec71de35310c44b, 0xbf2a01a019ba9d47,
                                            0x3f8111111110f3e0, 0xbfc5555555555543};
  static constexpr std::uint64_t cosine[6] = {0xbda8f9f637c8424c, 0x3e21ee9ccb7c6dbf,
                                              0xbe927e4f7d8e4bf3, 0x3efa01a019c687a9,
                                              0xbf56c16c16c14e4a, 0x3fa555555555554b};

  LUMEN_MAIN double of_sine(double z) {
    return horner(z, sine[0], sine[1], sine[2], sine[3], sine[4], sine[5]);
  }
  LUMEN_MAIN double of_cosine(double z) {
    return horner(z, cosine[0], cosine[1], cosine[2], cosine[3], cosine[4], cosine[5]);
  }
  /// One of them, by selected coefficients.
  LUMEN_MAIN double of_either(bool is_cosine, double z) {
    return horner(z, select(is_cosine, cosine[0], sine[0]), select(is_cosine, cosine[1], sine[1]),
                  select(is_cosine, cosine[2], sine[2]), select(is_cosine, cosine[3], sine[3]),
                  select(is_cosine, cosine[4], sine[4]), select(is_cosine, cosine[5], sine[5]));
  }
};

/// sin r and cos r on |r| <= pi/4 from z = r^2, to 28 bits.
LUMEN_MAIN double short_sine_series(double r, double z) {
  return fma(
      horner(z, 0xbf299076bb901430u, 0x3f8110630f1a5f72u, 0xbfc55553fe6f4534u, 0xbe2a670b2f4764e4u),
      r, r);
}
LUMEN_MAIN double short_cosine_series(double z) {
  return horner(z, 0x3ef9906ffd58bf6du, 0xbf56c078624df59au, 0x3fa55553a875b0c5u,
                0xbfdffffffbdee95eu, 0x3feffffffff97c47u);
}

/// sin(r + low) from q = z times the sine's series.
LUMEN_MAIN double sine_kernel(double r, double low, double q) { return fma(r, q, low) + r; }

/// cos(r + low) from q = z times the cosine's series; 1 - r^2/2 is kept with its rounding error.
LUMEN_MAIN double cosine_kernel(double r, double low, double z, double q) {
  const double b = fma(-r, r, 2.0);
  const double d = fma(r, r, b - 2.0);
  const double f = fma(d, 0.5, r * low);
  const double g = fma(z, q, -f);
  return fma(b, 0.5, g);
}

/// sin and cos of rest + low behind the long reduction; the cubic term is rounded otherwise.
LUMEN_MAIN double long_sine_kernel(double r, double low) {
  const double z = r * r;
  return fma(r * z, quarter_turn_series::of_sine(z), low) + r;
}
LUMEN_MAIN double long_cosine_kernel(double r, double low) {
  const double z = r * r;
  return cosine_kernel(r, low, z, quarter_turn_series::of_cosine(z) * z);
}

/// Not below 2^20, or a NaN.
LUMEN_MAIN bool is_beyond_short_quarter_turns(double a) {
  return !(a <= value(0x412fffffffffffffu));
}

/// 0 <= a < 2^20 as n pi + rest for the half-integer n nearest to a/pi, by pi in three parts, of
/// which the product of n with the second is exact; |rest| <= pi/4 and a little.
struct short_quarter_turn {
  std::uint64_t quarters;  ///< 2n in the low bits
  double rest;
  double rest_low;

  LUMEN_MAIN short_quarter_turn of(double a) {
    const counted c = count(a);
    const double t1 = fma(c.n, value(0xc00921fb54442d18u), a);
    const double t2 = fma(c.n, value(0xbca1a62633000000u), t1);
    const double r = fma(c.n, value(0xbaa45c06e0e68948u), t2);
    const double low = fma(c.n, value(0xbca1a62633000000u), t1 - t2) +
                       fma(c.n, value(0xbaa45c06e0e68948u), t2 - r);
    return {c.quarters, r, low};
  }

  /// The same with rounded products of the second and the third part.
  LUMEN_MAIN short_quarter_turn by_products(double a) {
    const counted c = count(a);
    const double t1 = fma(c.n, value(0xc00921fb54442d18u), a);
    const double p2 = c.n * value(0x3ca1a62633000000u);
    const double p3 = c.n * value(0x3aa45c06e0e68948u);
    const double t2 = t1 - p2;
    const double r = t2 - p3;
    return {c.quarters, r, ((t1 - t2) - p2) + ((t2 - r) - p3)};
  }

  /// In one word, by two or three parts.
  template <int parts>
  LUMEN_MAIN short_quarter_turn in_one_word(double a) {
    const counted c = count(a);
    double r = fma(c.n, value(0xc00921fb54442d18u), a);
    r = fma(c.n, value(0xbca1a62633000000u), r);
    if constexpr (parts == 3) r = fma(c.n, value(0xbaa45c06e0e68948u), r);
    return {c.quarters, r, 0.0};
  }

 private:
  struct counted {
    std::uint64_t quarters;
    double n;
  };
  LUMEN_MAIN counted count(double a) {
    const double shifter = value(0x4328000000000000u);  // 3·2^50, unit 1/2
    const double shifted = fma(a, value(0x3fd45f306dc9c883u), shifter);
    return {bits(shifted), shifted - shifter};
  }
};

/// An infinity or a NaN of the bodies that reduce to quarter turns: the negative NaN with an empty
/// payload and code 1 for an infinity; a NaN without its sign.
LUMEN_DEVICE inline std::uint32_t quiet_of_special(double x, double* y) {
  const double a = fabs(x);
  *y = is_nan(x) ? a * a : value(0xfff8000000000000u);
  return mask(is_nan(x) ? code::none : code::domain);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
