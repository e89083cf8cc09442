// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The rare path that logarithms share: every argument that is not a positive normal number, by a
/// table of 65 breakpoints.
#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// What a path is told of x = 2^k·m, m in [1, 2).
template <typename T>
struct breakpoint {
  const uint_of<T>* row;  ///< reciprocal of m rounded to 1/64, and two words of its -log
  T k;
  T high;  ///< m rounded, so that its product with the row's reciprocal is exact
  T low;   ///< the rest of m
  bool was_denormal;
};

/// Added to m in [1, 2), it leaves 64(m - 1), rounded, in the low bits: its unit is 1/64.
LUMEN_DEVICE constexpr float index_shifter(float) { return 0x1p17f + 1; }
LUMEN_DEVICE constexpr double index_shifter(double) { return 0x1p46 + 1; }

/// The logarithm of `x` by the rows at `table`; returns the status. `Path` holds the scale of
/// denormals, the bound of the neighbourhood of 1, the splitter of m, and computes the two cases.
template <typename Path, typename T>
LUMEN_DEVICE inline std::uint32_t breakpoint_log(T x, T* y, const uint_of<T>* table) {
  if (is_special(x)) {
    const bool minus_infinity = bits(x) == (format<T>::sign | format<T>::special);
    *y = minus_infinity ? value(format<T>::nan) : x * x;
    return mask(minus_infinity ? code::domain : code::none);
  }
  const bool denormal = (bits(x) & format<T>::special) == 0;
  const T scaled = denormal ? x * value(Path::denormal_scale) : x;
  if (!(scaled > 0)) {
    *y = value(scaled == 0 ? format<T>::sign | format<T>::special : format<T>::nan);
    return mask(scaled == 0 ? code::pole : code::domain);
  }
  const T d = scaled - T(1);
  // Only for callers without a main path: the main paths serve all normal numbers.
  if (fabs(d) <= value(Path::near_one_limit)) {
    *y = Path::near_one(d);
    return mask(code::none);
  }
  const int field = static_cast<int>(bits(scaled) >> format<T>::fraction_bits);
  const int offset = denormal ? -Path::denormal_exponent : 0;
  const T m = value((bits(scaled) & format<T>::fraction) | format<T>::one);
  const auto i = static_cast<std::int32_t>(bits(m + index_shifter(m)) & 0x7f);
  const T splitter = value(Path::splitter);
  const T high = (m + splitter) - splitter;
  *y = Path::from_row(
      breakpoint<T>{table + 3 * i, T(field - format<T>::bias + offset), high, m - high, denormal});
  return mask(code::none);
}

/// The natural logarithm; `Constants` are those of a format.
template <typename T, typename Constants>
struct natural_path : Constants {
  LUMEN_DEVICE static T near_one(T d) { return (Constants::polynomial(d) * d) * d + d; }

  LUMEN_DEVICE static T from_row(const breakpoint<T>& p) {
    const T h = p.k * value(Constants::ln2_high) + value(p.row[1]);
    const T l = p.k * value(Constants::ln2_low) + value(p.row[2]);
    const T u_high = mad(value(p.row[0]), p.high, T(-1));
    const T u_low = value(p.row[0]) * p.low;
    const T t = u_high + u_low;
    const T q = (Constants::polynomial(t) * t) * t;
    return (h + u_high) + ((l + u_low) + q);
  }
};

/// ln(1 + t) = t + t²·polynomial(t).
struct natural_constants_s {
  static constexpr std::uint32_t near_one_limit = 0x3c200000;  // 0.009765625
  static constexpr std::uint32_t splitter = 0x46000000;        // 8192, unit 2^-10
  static constexpr std::uint32_t ln2_high = 0x3f317200;
  static constexpr std::uint32_t ln2_low = 0x35bfbe8e;

  LUMEN_DEVICE static float polynomial(float t) {
    return horner(t, 0xbe0005a0u, 0x3e124e01u, 0xbe2aaaabu, 0x3e4ccccdu, 0xbe800000u, 0x3eaaaaabu,
                  0xbf000000u);
  }
};
struct natural_constants_d {
  static constexpr std::uint64_t denormal_scale = 0x43b0000000000000;  // 2^60
  static constexpr int denormal_exponent = 60;
  static constexpr std::uint64_t near_one_limit = 0x3f84000000000000;  // 0.009765625
  static constexpr std::uint64_t splitter = 0x4140000000000000;        // 2^21, unit 2^-31
  static constexpr std::uint64_t ln2_high = 0x3fe62e42fefa3800;
  static constexpr std::uint64_t ln2_low = 0x3d2ef35793c76730;

  LUMEN_DEVICE static double polynomial(double t) {
    return horner(t, 0xbfc000b405a2836du, 0x3fc249c02481059du, 0xbfc555555228b38fu,
                  0x3fc9999997b36c81u, 0xbfd0000000000262u, 0x3fd5555555555613u,
                  0xbfe0000000000000u);
  }
};
using natural_path_d = natural_path<double, natural_constants_d>;

/// The logarithm to the base of `Constants`, whose rows hold the reciprocal times a scale S, close
/// to a multiple of 1/ln(base): the difference cm - S is that multiple of the first-order term, and
/// the polynomial's last coefficient undoes the multiple. Where the product cm would not be exact,
/// c is split as well: `low_bits` are those that its high word lacks.
template <typename T, typename Constants>
struct scaled_path : Constants {
  LUMEN_DEVICE static T near_one(T d) {
    const T t = d * value(Constants::scale);
    return Constants::polynomial(t) * t + t;
  }

  LUMEN_DEVICE static T from_row(const breakpoint<T>& p) {
    const T h = p.k * value(Constants::log2_high) + value(p.row[1]);
    const T l = p.k * value(Constants::log2_low) + value(p.row[2]);
    const T c = value(p.row[0]);
    const T c_high = value(bits(c) & ~uint_of<T>{Constants::low_bits});
    const T c_low = c - c_high;
    const T u_high = mad(c_high, p.high, -value(Constants::scale));
    const T u_low = mad(c_low, p.high, c * p.low);
    const T t = u_high + u_low;
    const T q = Constants::polynomial(t);
    return (h + u_high) + mad(q, u_high, mad(q, u_low, l) + u_low);
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
