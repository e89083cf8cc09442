// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Half precision (binary16): elements, conversion, arithmetic, and the calls of functors on
/// halves.
///
/// Bodies compute on floats, into which every half converts exactly. A body made for half keeps its
/// values rounded to halves by the operations below; a float body between the two conversions is a
/// functor on halves as it stands, with the status of the float body: a result that becomes an
/// infinity or a zero only by the conversion has none of its own.
#pragma once

#include <bit>
#include <cstdint>
#include <type_traits>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// A half as it is stored.
struct binary16 {
  std::uint16_t pattern;
};

/// The value of a half. A signalling NaN stays one, until an operation quietens it.
LUMEN_MAIN float widen(binary16 x) {
  const std::uint32_t magnitude = (std::uint32_t{x.pattern} & 0x7fffu) << 13;
  const std::uint32_t sign = (std::uint32_t{x.pattern} & 0x8000u) << 16;
  const std::uint32_t finite = bits(value(magnitude) * value(0x77800000u));  // 2^112
  return value(select(magnitude >= 0x0f800000u, magnitude | 0x7f800000u, finite) | sign);
}

/// The nearest half, ties to even. A NaN is quietened and keeps the leading bits of its payload.
LUMEN_MAIN binary16 narrow(float x) {
  const std::uint32_t magnitude = bits(x) & 0x7fffffffu;
  const std::uint32_t odd = (magnitude >> 13) & 1u;
  const std::uint32_t normal = (magnitude - 0x38000000u + 0xfffu + odd) >> 13;
  // The unit of [1/2, 1) at float is that of denormal halves.
  const std::uint32_t denormal = bits(value(magnitude) + 0.5f) - 0x3f000000u;
  const std::uint32_t finite = select(magnitude < 0x38800000u, denormal, normal);
  const std::uint32_t quiet = 0x7e00u | ((magnitude >> 13) & 0x3ffu);
  const std::uint32_t special = select(magnitude > 0x7f800000u, quiet, 0x7c00u);
  const std::uint32_t result = select(magnitude >= 0x47800000u, special, finite);  // 2^16
  return {static_cast<std::uint16_t>(result | ((bits(x) >> 16) & 0x8000u))};
}

/// The nearest half, as a float.
LUMEN_MAIN float rounded_to_half(float x) { return widen(narrow(x)); }

/// The half that `x`, exactly a half, is stored as.
LUMEN_MAIN std::uint32_t half_pattern(float x) { return narrow(x).pattern; }

/// The value of a half's pattern.
LUMEN_MAIN float half_value(std::uint32_t pattern) {
  return widen({static_cast<std::uint16_t>(pattern)});
}

/// Half arithmetic on floats that are halves, each correctly rounded. The rounding of the float sum
/// and then of the half is innocuous, as 24 >= 2·11 + 2.
LUMEN_MAIN float half_add(float a, float b) { return rounded_to_half(a + b); }

/// ab + c with one rounding. The product is exact in float; the sum is rounded to odd, so that it
/// still tells on which side of a half or of a tie the exact sum lies.
LUMEN_MAIN float half_fma(float a, float b, float c) {
  const float product = a * b;
  const float sum = product + c;
  const float c_part = sum - product;
  const float error = (product - (sum - c_part)) + (c - c_part);
  const bool inexact = fabs(error) > 0.0f;  // false where the sum is an infinity or a NaN
  const bool outwards = (error > 0.0f) == (sum > 0.0f);
  const std::uint32_t step = select(outwards, 1u, 0xffffffffu);
  const bool even = (bits(sum) & 1u) == 0;
  return rounded_to_half(value(bits(sum) + select(inexact & even, step, 0u)));
}

/// The functors of a body on floats for arrays of halves. `Element` is `binary16` or the type of
/// the same layout that a runtime has for halves.
template <typename Element>
concept half_element = sizeof(Element) == 2 && std::is_trivially_copyable_v<Element>;

template <half_element Element>
struct rare_flag<Element> {
  using type = std::uint32_t;
};

template <half_element Element>
LUMEN_MAIN float load_half(const Element* a) {
  return widen(std::bit_cast<binary16>(*a));
}
template <half_element Element>
LUMEN_MAIN void store_half(Element* y, float x) {
  *y = std::bit_cast<Element>(narrow(x));
}

template <typename Body>
struct half_v11 {
  using input_type = binary16;
  using output_type = binary16;
  template <half_element Element>
  LUMEN_DEVICE static inline std::uint32_t call(const Element* a, Element* y) {
    const float x = load_half(a);
    const main_result<float> result = Body::main(x);
    store_half(y, result.value);
    if constexpr (requires(float* r) { Body::rare(x, r); }) {
      if (result.rare) [[unlikely]] {
        float r;
        const std::uint32_t status = Body::rare(x, &r);
        store_half(y, r);
        return status;
      }
      return 0;
    }
    return result.rare;
  }
};

template <typename Body>
struct half_v12 {
  using input_type = binary16;
  using output_type = binary16;
  template <half_element Element>
  LUMEN_DEVICE static inline std::uint32_t call(const Element* a, Element* y1, Element* y2) {
    const float x = load_half(a);
    const main_result2<float> result = Body::main(x);
    store_half(y1, result.first);
    store_half(y2, result.second);
    if constexpr (requires(float* r) { Body::rare(x, r, r); }) {
      if (result.rare) [[unlikely]] {
        float first, second;
        const std::uint32_t status = Body::rare(x, &first, &second);
        store_half(y1, first);
        store_half(y2, second);
        return status;
      }
      return 0;
    }
    return result.rare;
  }
};

/// Of two operands, the second one in an array; and as a constant.
template <typename Body>
struct half_v21 {
  using input_type = binary16;
  using output_type = binary16;
  template <half_element Element>
  LUMEN_DEVICE static inline std::uint32_t call(const Element* a, const Element* b, Element* y) {
    const float x = load_half(a);
    const float second = load_half(b);
    const main_result<float> result = Body::main(x, second);
    store_half(y, result.value);
    if constexpr (requires(float* r) { Body::rare(x, second, r); }) {
      if (result.rare) [[unlikely]] {
        float r;
        const std::uint32_t status = Body::rare(x, second, &r);
        store_half(y, r);
        return status;
      }
      return 0;
    }
    return result.rare;
  }
};
template <typename Body>
struct half_v21c {
  using input_type = binary16;
  using output_type = binary16;
  template <half_element Element>
  LUMEN_DEVICE static inline std::uint32_t call(const Element* a, Element c, Element* y) {
    return half_v21<Body>::call(a, &c, y);
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
