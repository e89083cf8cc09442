// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <cstdint>
#include <limits>
#include <type_traits>
#include <typeindex>  // the lightest standard header that declares std::hash

#include "bit_cast.hpp"
#include "detail/export.hpp"

namespace sycl {

class half;

namespace detail {

/// The binary16 pattern nearest to a binary32 or binary64 pattern, ties to even. NaNs are quieted
/// and keep the leading bits of their payload.
template <typename Bits, int FractionBits>
constexpr std::uint16_t round_to_half(Bits pattern) noexcept {
  constexpr int width = 8 * sizeof(Bits);
  constexpr int dropped = FractionBits - 10;
  constexpr Bits bias = (Bits{1} << (width - 2 - FractionBits)) - 1;
  constexpr Bits infinity = (2 * bias + 1) << FractionBits;
  constexpr Bits smallest_normal = (bias - 14) << FractionBits;
  // 65520 = 2^15 (2 - 2^-11), halfway between the largest finite half and 2^16.
  constexpr Bits overflow = ((bias + 16) << FractionBits) - (Bits{1} << (dropped - 1));

  const Bits magnitude = pattern & (~Bits{0} >> 1);
  const auto sign = static_cast<std::uint32_t>(pattern >> (width - 16)) & 0x8000U;
  std::uint32_t rounded = 0;
  if (magnitude >= overflow) {
    rounded = 0x7C00U;
    if (magnitude > infinity) {
      rounded |= 0x0200U | (static_cast<std::uint32_t>(magnitude >> dropped) & 0x03FFU);
    }
  } else if (magnitude >= smallest_normal) {
    const Bits rebiased = magnitude - ((bias - 15) << FractionBits);
    const Bits odd = (rebiased >> dropped) & 1;
    rounded =
        static_cast<std::uint32_t>((rebiased + ((Bits{1} << (dropped - 1)) - 1) + odd) >> dropped);
  } else {
    // A multiple of 2^-24. Patterns below its half shift out altogether, denormals among them.
    const Bits exponent = magnitude >> FractionBits;
    const Bits distance = bias + static_cast<Bits>(FractionBits - 24) - exponent;
    if (distance < static_cast<Bits>(FractionBits + 2)) {
      const auto shift = static_cast<int>(distance);
      const Bits significand =
          (magnitude & ((Bits{1} << FractionBits) - 1)) | (Bits{1} << FractionBits);
      const Bits odd = (significand >> shift) & 1;
      rounded =
          static_cast<std::uint32_t>((significand + ((Bits{1} << (shift - 1)) - 1) + odd) >> shift);
    }
  }
  return static_cast<std::uint16_t>(sign | rounded);
}

/// The binary32 pattern of a binary16 pattern's value; signalling NaNs are quieted.
constexpr std::uint32_t widen_half(std::uint16_t pattern) noexcept {
  const std::uint32_t sign = (pattern & 0x8000U) << 16;
  const std::uint32_t magnitude = pattern & 0x7FFFU;
  if (magnitude >= 0x7C00U) {
    const std::uint32_t quiet = magnitude > 0x7C00U ? 0x00400000U : 0U;
    return sign | 0x7F800000U | quiet | ((magnitude & 0x03FFU) << 13);
  }
  if (magnitude >= 0x0400U) return sign | ((magnitude << 13) + 0x38000000U);
  // m 2^-24 with m < 2^10: the conversion and the product are exact.
  return sign | bit_cast<std::uint32_t>(static_cast<float>(static_cast<std::int32_t>(magnitude)) *
                                        0x1p-24F);
}

constexpr std::uint16_t float_to_half(float value) noexcept {
#ifdef __F16C__
  if (!__builtin_is_constant_evaluated()) {
    using float4 [[gnu::vector_size(16)]] = float;
    const auto packed = __builtin_ia32_vcvtps2ph(float4{value, 0, 0, 0}, 0);
    return static_cast<std::uint16_t>(packed[0]);
  }
#endif
  return round_to_half<std::uint32_t, 23>(bit_cast<std::uint32_t>(value));
}

constexpr float half_to_float(std::uint16_t pattern) noexcept {
#ifdef __F16C__
  if (!__builtin_is_constant_evaluated()) {
    using short8 [[gnu::vector_size(16)]] = short;
    const auto widened =
        __builtin_ia32_vcvtph2ps(short8{static_cast<short>(pattern), 0, 0, 0, 0, 0, 0, 0});
    return widened[0];
  }
#endif
  return bit_cast<float>(widen_half(pattern));
}

constexpr std::uint16_t double_to_half(double value) noexcept {
  return round_to_half<std::uint64_t, 52>(bit_cast<std::uint64_t>(value));
}

/// Rounds to odd on the way through double, which keeps the final rounding the only one.
constexpr std::uint16_t long_double_to_half(long double value) noexcept {
  const auto nearest = static_cast<double>(value);
  const auto back = static_cast<long double>(nearest);
  if (back == value || value != value) return double_to_half(nearest);
  auto pattern = bit_cast<std::uint64_t>(nearest);
  const bool away_from_zero = value < 0 ? back < value : back > value;
  if (away_from_zero) --pattern;
  return round_to_half<std::uint64_t, 52>(pattern | 1U);
}

template <typename T>
concept arithmetic = std::is_arithmetic_v<T>;

/// The type in which a half and a T are combined: that of the wider one, half for integers.
template <arithmetic T>
using half_common_t = std::conditional_t<std::is_floating_point_v<T>, T, half>;

}  // namespace detail

/// IEEE 754 binary16. Every operation rounds once, to nearest even: sums, products and quotients
/// of halves are formed in float, whose 24 bits make the second rounding harmless.
class ARBOR_LUMEN_SYCL_API half {
 public:
  half() = default;

  template <detail::arithmetic T>
  constexpr half(T value) noexcept : pattern_(0) {
    if constexpr (std::is_same_v<T, double>) {
      pattern_ = detail::double_to_half(value);
    } else if constexpr (std::is_same_v<T, long double>) {
      pattern_ = detail::long_double_to_half(value);
    } else {
      // Integers that float does not hold exactly lie beyond the halves.
      pattern_ = detail::float_to_half(static_cast<float>(value));
    }
  }

  constexpr operator float() const noexcept { return detail::half_to_float(pattern_); }

  constexpr half operator+() const noexcept { return *this; }
  constexpr half operator-() const noexcept {
    return bit_cast<half>(static_cast<std::uint16_t>(pattern_ ^ 0x8000U));
  }

#define SYCL_DETAIL_HALF_ARITHMETIC(op)                                                          \
  friend constexpr half operator op(half a, half b) noexcept {                                   \
    return half(static_cast<float>(a) op static_cast<float>(b));                                 \
  }                                                                                              \
  template <detail::arithmetic T>                                                                \
  friend constexpr detail::half_common_t<T> operator op(half a, T b) noexcept {                  \
    return static_cast<detail::half_common_t<T>>(a) op static_cast<detail::half_common_t<T>>(b); \
  }                                                                                              \
  template <detail::arithmetic T>                                                                \
  friend constexpr detail::half_common_t<T> operator op(T a, half b) noexcept {                  \
    return static_cast<detail::half_common_t<T>>(a) op static_cast<detail::half_common_t<T>>(b); \
  }                                                                                              \
  friend constexpr half& operator op##=(half& a, half b) noexcept { return a = a op b; }         \
  template <detail::arithmetic T>                                                                \
  friend constexpr half& operator op##=(half& a, T b) noexcept {                                 \
    return a = half(a op b);                                                                     \
  }
  SYCL_DETAIL_HALF_ARITHMETIC(+)
  SYCL_DETAIL_HALF_ARITHMETIC(-)
  SYCL_DETAIL_HALF_ARITHMETIC(*)
  SYCL_DETAIL_HALF_ARITHMETIC(/)
#undef SYCL_DETAIL_HALF_ARITHMETIC

#define SYCL_DETAIL_HALF_COMPARISON(op)                                                          \
  friend constexpr bool operator op(half a, half b) noexcept {                                   \
    return static_cast<float>(a) op static_cast<float>(b);                                       \
  }                                                                                              \
  template <detail::arithmetic T>                                                                \
  friend constexpr bool operator op(half a, T b) noexcept {                                      \
    return static_cast<detail::half_common_t<T>>(a) op static_cast<detail::half_common_t<T>>(b); \
  }                                                                                              \
  template <detail::arithmetic T>                                                                \
  friend constexpr bool operator op(T a, half b) noexcept {                                      \
    return static_cast<detail::half_common_t<T>>(a) op static_cast<detail::half_common_t<T>>(b); \
  }
  SYCL_DETAIL_HALF_COMPARISON(==)
  SYCL_DETAIL_HALF_COMPARISON(!=)
  SYCL_DETAIL_HALF_COMPARISON(<)
  SYCL_DETAIL_HALF_COMPARISON(>)
  SYCL_DETAIL_HALF_COMPARISON(<=)
  SYCL_DETAIL_HALF_COMPARISON(>=)
#undef SYCL_DETAIL_HALF_COMPARISON

  constexpr half& operator++() noexcept { return *this += 1; }
  constexpr half& operator--() noexcept { return *this -= 1; }
  constexpr half operator++(int) noexcept {
    const half before = *this;
    ++*this;
    return before;
  }
  constexpr half operator--(int) noexcept {
    const half before = *this;
    --*this;
    return before;
  }

 private:
  std::uint16_t pattern_;
};

static_assert(sizeof(half) == 2 && std::is_trivially_copyable_v<half>);

}  // namespace sycl

template <>
struct std::numeric_limits<sycl::half> {
  static constexpr bool is_specialized = true;
  static constexpr bool is_signed = true;
  static constexpr bool is_integer = false;
  static constexpr bool is_exact = false;
  static constexpr bool has_infinity = true;
  static constexpr bool has_quiet_NaN = true;
  static constexpr bool has_signaling_NaN = true;
  static constexpr std::float_denorm_style has_denorm = std::denorm_present;
  static constexpr bool has_denorm_loss = false;
  static constexpr std::float_round_style round_style = std::round_to_nearest;
  static constexpr bool is_iec559 = true;
  static constexpr bool is_bounded = true;
  static constexpr bool is_modulo = false;
  static constexpr int digits = 11;
  static constexpr int digits10 = 3;
  static constexpr int max_digits10 = 5;
  static constexpr int radix = 2;
  static constexpr int min_exponent = -13;
  static constexpr int min_exponent10 = -4;
  static constexpr int max_exponent = 16;
  static constexpr int max_exponent10 = 4;
  static constexpr bool traps = false;
  static constexpr bool tinyness_before = false;

  static constexpr sycl::half min() noexcept { return of(0x0400); }
  static constexpr sycl::half lowest() noexcept { return of(0xFBFF); }
  static constexpr sycl::half max() noexcept { return of(0x7BFF); }
  static constexpr sycl::half epsilon() noexcept { return of(0x1400); }
  static constexpr sycl::half round_error() noexcept { return of(0x3800); }
  static constexpr sycl::half infinity() noexcept { return of(0x7C00); }
  static constexpr sycl::half quiet_NaN() noexcept { return of(0x7E00); }
  static constexpr sycl::half signaling_NaN() noexcept { return of(0x7D00); }
  static constexpr sycl::half denorm_min() noexcept { return of(0x0001); }

 private:
  static constexpr sycl::half of(std::uint16_t pattern) noexcept {
    return sycl::bit_cast<sycl::half>(pattern);
  }
};

template <>
struct std::hash<sycl::half> {
  std::size_t operator()(sycl::half value) const noexcept {
    const auto pattern = sycl::bit_cast<std::uint16_t>(value);
    const bool zero = (pattern & 0x7FFFU) == 0;  // both zeros are equal
    return zero ? 0 : pattern;
  }
};
