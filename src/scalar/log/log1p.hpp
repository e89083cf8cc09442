// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/log/breakpoint.hpp"
#include "scalar/log/ln_of_one_plus.hpp"
#include "scalar/log/log1p_nolut.hpp"
#include "scalar/log/log1p_parts.hpp"
#include "scalar/log/reduction.hpp"
#include "scalar/protocol.hpp"
#include "scalar/row_lookup.hpp"
#include "scalar/tables/dlog1p.hpp"
#include "scalar/tables/slog1p.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// log1p, float; log1p(±0) is ±0. Code 2 for -1, code 1 below, -infinity included, code 0 for NaNs.
///
/// `la` and `ep`: 1 + x as a rounded sum and its error, reduced to [2/3, 4/3), with the polynomials
/// of ln. Largest error 2.0 and 1570 ulp.
template <tier t>
struct log1p_s : scalar_v11<log1p_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const auto one_plus = one_plus_x<float>::of(x);
    const auto a = two_thirds<float>::of(one_plus.sum);
    const float d = fma(one_plus.error, value(0x3f800000u - a.exponent), 0.0f);
    const float y = fma(a.k, value(0x3f317218u), ln_of_one_plus<t>(a.r + d));
    // The sum is no positive normal number below 2^127.
    const auto range = static_cast<std::int32_t>(bits(one_plus.sum) + 0x01000000u);
    return {or_sign(y, x), flag_if<float>(is_nan(x), range <= 0x017fffff)};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    const auto* table = t == tier::la ? __slog1p_la_CoutTab : __slog1p_ep_CoutTab;
    return breakpoint_log<log1p_path_s>(x + 1.0f, y, table);
  }
};

/// ln 2 in two words as the table of `ha` has it.
inline constexpr std::uint32_t log1p_ln2_high = 0x3f317200, log1p_ln2_low = 0x35bfbe00;

/// The rows R = 128..255 of that table for the exponent field of the scale, which is 253 less that
/// of the sum, and one more for R = 256: 253 ln 2 is added, and the row of 256 is then that of 128.
/// All of this is exact.
constexpr float_columns make_log1p_rows_by_scale() {
  float_columns rows{};
  for (int row = 0; row < 128; ++row) {
    rows.first[row] = value(internal_slog1p_ha_data[2 * row]) + 253 * value(log1p_ln2_high);
    rows.second[row] = value(internal_slog1p_ha_data[2 * row + 1]) + 253 * value(log1p_ln2_low);
  }
  return rows;
}
inline constexpr float_columns log1p_rows_by_scale = make_log1p_rows_by_scale();

/// `ha`: a row of a table by an integer reciprocal, degree 3, and the sum in two words. Largest
/// error 0.61 ulp.
template <>
struct log1p_s<tier::ha> : scalar_v11<log1p_s<tier::ha>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const reduced a = reduce(x);
    const auto word = static_cast<std::int32_t>((bits(a.integer) >> 15) - 0x8600u);
    const auto exponent = static_cast<float>(static_cast<std::int32_t>(bits(a.sum) >> 23));
    const float high = fma(exponent, value(log1p_ln2_high), value(internal_slog1p_ha_data[word]));
    const float low = fma(exponent, value(log1p_ln2_low), value(internal_slog1p_ha_data[word + 1]));
    return {or_sign(logarithm(a.u, a.w, high, low), x), flag_if<float>(is_beyond_reach(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    return breakpoint_log<log1p_path_s>(x + 1.0f, y, __slog1p_ha_CoutTab);
  }

  /// The rows for all elements of a block at once.
  template <std::int64_t Length>
  requires wide_vectors static bool block(const float* __restrict x, float* __restrict y) {
    float u[Length], w[Length], exponent[Length], row_high[Length], row_low[Length];
    std::uint32_t row[Length];
    bool unserved = false;
    for (std::int64_t i = 0; i < Length; ++i) {
      const reduced a = reduce(x[i]);
      u[i] = a.u;
      w[i] = a.w;
      exponent[i] = static_cast<float>(static_cast<std::int32_t>(bits(a.scale) >> 23));
      row[i] = bits(a.integer) >> 16;
      unserved |= is_beyond_reach(x[i]);
    }
    if (unserved) return false;
    row_lookup<log1p_rows_by_scale>::rows<Length>(row, row_high, row_low);
    for (std::int64_t i = 0; i < Length; ++i) {
      const float high = fma(exponent[i], -value(log1p_ln2_high), row_high[i]);
      const float low = fma(exponent[i], -value(log1p_ln2_low), row_low[i]);
      y[i] = or_sign(logarithm(u[i], w[i], high, low), x[i]);
    }
    return true;
  }

 private:
  /// 1 + x = 2^k·m, its rounded sum and an integer R close to 256/m, with scale = 2^(-k-8)·R:
  /// u + w is (1 + x)·scale - 1.
  struct reduced {
    float sum;
    float integer;
    float scale;
    float u;
    float w;
  };

  LUMEN_MAIN reduced reduce(float x) {
    const auto one_plus = one_plus_x<float>::of(x);
    const std::uint32_t b = bits(one_plus.sum);
    const float m = value((b & 0x007fffffu) | 0x3b800000u);  // 2^-8
    const float integer = rint(divide(1.0f, m));             // 128..256
    const float scale = fma(value(0x7b000000u - (b & format<float>::special)), integer, 0.0f);
    const float s = fma(one_plus.sum, scale, -1.0f);
    const float u = fma(one_plus.error, scale, s);
    return {one_plus.sum, integer, scale, u, fma(one_plus.error, scale, -(u - s))};
  }

  LUMEN_MAIN float logarithm(float u, float w, float high, float low) {
    const float p = fma(value(0x3eaaab39u), u, value(0xbf000036u));
    const float q = fma(p, fma(u, u, 0.0f), w);
    const float sum = high + u;
    const float e = u - (sum - high);
    return ((low + e) + q) + sum;
  }

  /// 2^118 is the largest number whose scale is normal.
  LUMEN_MAIN bool is_beyond_reach(float x) { return is_outside(x, 0xbf7fffffu, 0x7a800000u); }
};

/// log1p, double; log1p(±0) is ±0. Code 2 for -1, code 1 below, -infinity included, code 0 for
/// NaNs.
///
/// 1 + x as a rounded sum and its error; a row of a table by an integer reciprocal of the sum.
/// Degree 5, at `ep` 3; `ha` has pairs in the table and the sum in two words. Largest error 0.75,
/// 1.7, 2.1e6 ulp for `ha`, `la`, `ep`.
template <tier t>
struct log1p_d : scalar_v11<log1p_d<t>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const auto one_plus = one_plus_x<double>::of(x);
    const auto a = integer_reciprocal::of(one_plus.sum);
    const std::uint64_t exponent = bits(one_plus.sum) & format<double>::special;
    const double scale = fma(value(0x7f40000000000000u - exponent), a.integer, 0.0);
    const double u = fma(one_plus.error, scale, a.t);
    const double p2 = fma(value(0x3fd55555555543c5u), u, value(0xbfdffffffffff81fu));
    const double w = fma(u, u, 0.0);
    double p = p2;
    if constexpr (t != tier::ep) {
      const double p1 = fma(value(0x3fc9999cacdb4d0au), u, value(0xbfd0000148058ee1u));
      p = fma(p1, w, p2);
    }
    double y;
    if constexpr (t == tier::ha) {
      const std::int32_t word = integer_reciprocal::pair_word(a);
      const double high =
          fma(a.exponent, value(0x3fe62e42fefa0000u), value(internal_dlog1p_ha_data[word]));
      const double low =
          fma(a.exponent, value(0x3d7cf79abc9e0000u), value(internal_dlog1p_ha_data[word + 1]));
      const double n = fma(one_plus.error, scale, -(u - a.t));
      const double sum = high + u;
      const double e = u - (sum - high);
      y = (e + fma(p, w, low + n)) + sum;
    } else {
      const double row = value(single_values()[integer_reciprocal::single_word(a)]);
      const double two =
          fma(integer_reciprocal::exponent_of_row(a), value(0x3fe62e42fefa39efu), 0.0);
      y = (fma(p, w, u) + row) + two;
    }
    return {or_sign(y, x),
            flag_if<double>(is_outside(x, 0xbfefffffffffffffu, 0x7f3ffffffffff000u))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    return breakpoint_log<natural_path_d>(x + 1.0, y, log1p_rare_table<t>());
  }

 private:
  LUMEN_DEVICE static constexpr const std::uint64_t* single_values() {
    return t == tier::la ? internal_dlog1p_la_data : internal_dlog1p_ep_data;
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
