// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Row i of 0..16: g with (g + 1)(16 + i) close to 4096, and the -log2 of the factor (g + 1)/256 in
/// units of 2^-55.
static constexpr std::uint8_t __spow_ha___rcp_tbl[17] = {0xff, 0xf0, 0xe3, 0xd7, 0xcc, 0xc2,
                                                         0xb9, 0xb1, 0xaa, 0xa3, 0x9d, 0x97,
                                                         0x91, 0x8c, 0x88, 0x83, 0x7f};
static constexpr std::uint64_t __spow_ha___log2_tbl[17] = {
    0x0000000000000000, 0x000b2671360338ac, 0x001563dc29ffacb2, 0x001f5fd8a9063e36,
    0x002906cbcd2baf2e, 0x003243001249ba76, 0x003afcd815786af2, 0x00431b2abc31565c,
    0x004a83cf0d01c170, 0x00523bbc64c5e644, 0x00591db662b66428, 0x006043e946fd97f4,
    0x0067b3d42fd0fc50, 0x006e232e68aad484, 0x007373af48dce654, 0x007a514b229c40a0,
    0x0080000000000000};

/// |x|^y at float in integer arithmetic: what the main paths leave over of finite operands, for
/// every tier but `ep`. Largest error 0.513 ulp, denormal results included, which are rounded once.
/// Code 3 for an infinite result, code 4 for a zero one; none for denormals.
struct fixed_point_power {
  /// x finite and not 0, its sign ignored, y finite and not 0; `sign` is that of the result.
  LUMEN_DEVICE static std::uint32_t of(float x, float y, std::uint32_t sign, float* r) {
    const logarithm a = log2_of(bits(x) & format<float>::magnitude);
    if (a.z == 0) {
      *r = value(sign | format<float>::one);
      return mask(code::none);
    }
    // z to its full length, and the mantissa of y with 30 bits behind the point.
    std::int64_t z = a.z;
    int place = a.place;
    while (((z << 1) ^ z) >= 0) {
      z <<= 1;
      ++place;
    }
    const std::uint32_t field = (bits(y) & format<float>::magnitude) >> 23;
    const std::uint32_t hidden = field != 0 ? 0x00800000u : 0u;
    auto mantissa = static_cast<std::int64_t>((bits(y) & format<float>::fraction) | hidden) << 7;
    if (sign_bit(y) != 0) mantissa = -mantissa;
    place -= field != 0 ? static_cast<int>(field) : -1;
    z = high_product(z, mantissa);
    // y·log2|x| with 32 bits behind the point.
    if (place < 0) {
      const bool down = z < 0;
      *r = value(sign | (down ? 0u : format<float>::special));
      return mask(down ? code::underflow : code::overflow);
    }
    if (place > 63) {
      *r = value(sign | format<float>::one);
      return mask(code::none);
    }
    z >>= place;
    return power_of_two(static_cast<std::int32_t>(z >> 32), static_cast<std::uint32_t>(z), sign, r);
  }

 private:
  /// log2 x = z·2^(93 - place), 93 = 148 - 55.
  struct logarithm {
    std::int64_t z;
    int place;
  };

  /// The upper 32 bits of a number of 64 bits, with their sign.
  LUMEN_DEVICE static constexpr std::int64_t upper(std::int64_t z) { return z >> 32; }

  /// The low 32 bits, with their sign.
  LUMEN_DEVICE static constexpr std::int64_t lower(std::uint64_t z) {
    return static_cast<std::int32_t>(static_cast<std::uint32_t>(z));
  }

  LUMEN_DEVICE static constexpr std::uint64_t product(std::uint64_t a, std::int64_t b) {
    return a * static_cast<std::uint64_t>(b);
  }

  /// z·f/2^32 for a signed f of 32 bits: by the halves of z, the last bit of the lower one lost.
  LUMEN_DEVICE static std::int64_t high_product(std::int64_t z, std::int64_t f) {
    const std::int64_t low = (z >> 1) & 0x7fffffff;
    const auto carried = static_cast<std::uint64_t>((low * f) >> 31) & 0xfffffffeu;
    return upper(z) * f + lower(carried);
  }

  LUMEN_DEVICE static logarithm log2_of(std::uint32_t pattern) {
    std::uint32_t fraction = pattern & format<float>::fraction;
    int exponent = static_cast<int>(pattern >> 23) - 127;
    if (exponent == -127) {
      exponent = -126;
      for (; (fraction & 0x00800000u) == 0; fraction <<= 1) --exponent;
    }
    const std::uint32_t m = fraction | 0x00800000u;
    const std::uint32_t nearest = (m + 0x40000u) >> 19;  // 16..32
    const std::uint32_t row = nearest - 16;
    const std::uint32_t factor = __spow_ha___rcp_tbl[row] + 1u;
    // m times the factor is 2^31 but for a small part, of which v is the fraction in 2^-32.
    const std::int64_t v = lower((m * factor) << 1);
    const std::uint64_t a = ((product(0xffffffffe158260eu, v) >> 32) + 0x24f7fd36u) & 0xffffffffu;
    const std::int64_t b = lower((product(a, v) >> 32) + 0xd1d568f0u);
    const auto bu = static_cast<std::uint64_t>(b);
    const std::uint64_t c = ((product(bu, v) >> 32) + 0x3d8e12edu) & 0xffffffffu;
    const auto d =
        static_cast<std::int32_t>(static_cast<std::uint32_t>((product(c, v) >> 32) + 0xa3aae26cu));
    std::int64_t z = std::int64_t{d >> 8} * v + 0x00b8aa3b295ebb00;  // 1/ln 2
    const std::uint64_t h = product((static_cast<std::uint32_t>(d) << 23) & 0x7f800000u, v);
    z += lower((h >> 31) & 0xfffffffeu);
    // Next to 1 the integer and the row cancel, and there are seven bits more.
    int place = 0x94;
    if (exponent * 16 == 16 - static_cast<int>(nearest)) {
      z <<= 7;
      place = 0x9b;
    }
    z = high_product(z, v) + static_cast<std::int64_t>(__spow_ha___log2_tbl[row]);
    z += static_cast<std::int64_t>(exponent) << 55;
    return {z, place};
  }

  /// ±2^(i + f/2^32), rounded once.
  LUMEN_DEVICE static std::uint32_t power_of_two(std::int32_t i, std::uint32_t f,
                                                 std::uint32_t sign, float* r) {
    const std::uint64_t fraction = f;
    // (2^f - 1)·2^32, the last coefficient ln 2.
    constexpr std::uint32_t coefficients[] = {0x95e83u,   0x580436u,   0x27607deu,
                                              0xe359872u, 0x3d7f7977u, 0xb1721817u};
    std::uint64_t t = (fraction * 0x16b68u) >> 32;
    for (const std::uint32_t c : coefficients) t = ((t + c) * fraction) >> 32;
    const auto root = static_cast<std::uint32_t>(t >> 1);
    const std::uint32_t rounded = root + 0x80u;
    int exponent = i + 127;
    const int carried = exponent + static_cast<int>(rounded >> 31);
    if (carried > 254) {
      *r = value(sign | format<float>::special);
      return mask(code::overflow);
    }
    if (carried < -24) {
      *r = value(sign);
      return mask(code::underflow);
    }
    if (carried < 1) {
      std::uint32_t shifted = root | 0x80000000u;
      for (; exponent < 1; ++exponent) shifted >>= 1;
      shifted += 0x80u;
      *r = value(sign | (shifted >> 8));
      return mask(shifted < 0x100u ? code::underflow : code::none);
    }
    *r = value(sign | ((static_cast<std::uint32_t>(exponent) << 23) + (rounded >> 8)));
    return mask(code::none);
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
