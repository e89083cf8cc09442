// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// The smallest denormals, indexed by a sign bit.
static constexpr std::uint32_t _min_subnormal_32[2] = {0x00000001, 0x80000001};
static constexpr std::uint64_t _min_subnormal_64[2] = {0x0000000000000001, 0x8000000000000001};

LUMEN_DEVICE inline float smallest_denormal(float sign) {
  return value(_min_subnormal_32[bits(sign) >> 31]);
}
LUMEN_DEVICE inline double smallest_denormal(double sign) {
  return value(_min_subnormal_64[bits(sign) >> 63]);
}

/// nextafter(x, y): the neighbour of x on the side of y, exact in every tier; y itself where the
/// two are equal, so that nextafter(+0, -0) is -0. Code 4 where the step ends in a denormal or a
/// zero, code 3 where it ends in an infinity.
///
/// Patterns of one sign are ordered like their magnitudes, so that the neighbour is the pattern
/// next to that of x: one lower towards zero, one higher away from it.
template <typename T>
struct nextafter_body : scalar_v21<nextafter_body<T>, T> {
  using uint = uint_of<T>;
  using sint = int_of<T>;

  LUMEN_MAIN main_result<T> main(T x, T y) {
    const sint bx = static_cast<sint>(bits(x));
    const sint by = static_cast<sint>(bits(y));
    const sint outwards = ((bx ^ by) >> (8 * sizeof(T) - 1)) | 1;
    const sint step = select(bx > by, sint(-1), outwards);
    const uint next = bits(x) + static_cast<uint>(select(bx == by, sint(0), step));
    return {value(next),
            flag_if<T>(out_of_range(bits(x)), out_of_range(bits(y)), out_of_range(next))};
  }

  LUMEN_RARE std::uint32_t rare(T x, T y, T* r) {
    if (is_nan(x) || is_nan(y)) {
      *r = x + y;
      return mask(code::none);
    }
    if (x == y) {
      *r = y;
      return mask(code::none);
    }
    if (x == 0) {
      *r = smallest_denormal(y);
      return mask(code::underflow);
    }
    const bool inwards = sign_bit(x) != sign_bit(y) || fabs(x) > fabs(y);
    const uint next = inwards ? bits(x) - 1 : bits(x) + 1;
    *r = value(next);
    const uint magnitude = next & format<T>::magnitude;
    if (magnitude <= format<T>::fraction) return mask(code::underflow);
    return mask(magnitude >= format<T>::special ? code::overflow : code::none);
  }

 private:
  /// The exponent field is 0 or all ones: one signed comparison, since the sum wraps to the lowest
  /// integer exactly at the smallest normal number.
  LUMEN_DEVICE static bool out_of_range(uint pattern) {
    constexpr uint smallest_normal = format<T>::fraction + 1;
    constexpr uint largest_finite = format<T>::special - 1;
    constexpr uint shift = format<T>::sign - smallest_normal;
    return static_cast<sint>((pattern & format<T>::magnitude) + shift) >
           static_cast<sint>(largest_finite + shift);
  }
};

using nextafter_s = nextafter_body<float>;
using nextafter_d = nextafter_body<double>;

/// nextafter, half: the same on patterns of 16 bits, with the same codes.
struct nextafter_h {
  using input_type = binary16;
  using output_type = binary16;
  template <half_element Element>
  LUMEN_DEVICE static inline std::uint32_t call(const Element* a, const Element* b, Element* r) {
    const result next =
        step(std::bit_cast<binary16>(*a).pattern, std::bit_cast<binary16>(*b).pattern);
    *r = std::bit_cast<Element>(binary16{static_cast<std::uint16_t>(next.pattern)});
    return mask(next.status);
  }

 private:
  struct result {
    std::uint32_t pattern;
    code status;
  };

  LUMEN_DEVICE static result step(std::uint32_t x, std::uint32_t y) {
    const std::uint32_t x_magnitude = x & 0x7fffu;
    const std::uint32_t y_magnitude = y & 0x7fffu;
    if (x_magnitude > 0x7c00u || y_magnitude > 0x7c00u)
      return {half_pattern(half_value(x) + half_value(y)), code::none};
    if (x == y || (x_magnitude | y_magnitude) == 0) return {y, code::none};
    if (x_magnitude == 0) return {(y & 0x8000u) | 1u, code::underflow};
    const bool inwards = ((x ^ y) & 0x8000u) != 0 || x_magnitude > y_magnitude;
    const std::uint32_t next = inwards ? x - 1 : x + 1;
    const std::uint32_t magnitude = next & 0x7fffu;
    if (magnitude < 0x0400u) return {next, code::underflow};
    return {next, magnitude > 0x7bffu ? code::overflow : code::none};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
