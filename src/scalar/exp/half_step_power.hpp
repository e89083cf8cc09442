// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// b^x = 2^(N/2)·(1 + rest) at float for the base b of `Base`.
///
/// The reduction is to half-integers: x·log2 b = N/2 + a rest, so that the rest is small without a
/// table, and the half is paid for with the constant √2. Adding a shifter whose unit is 1/2 leaves
/// N and the exponent bias in the low bits of the sum, from where one shift puts them into the
/// exponent field: there is no conversion to integer.
template <typename Base>
struct half_step_factors {
  std::uint32_t shifted;  ///< ends in 254 + N, ten bits wide
  std::uint32_t root;     ///< for odd N the bit of the half and the fraction of √2, else 0
  float rest;             ///< holds also what the float √2 leaves out

  LUMEN_MAIN half_step_factors of(float x) {
    const reduced a = reduce(x);
    return with_rest(a.shifted, a.r);
  }

  /// Of x + tail, the tail being small against x.
  LUMEN_MAIN half_step_factors of(float x, float tail) {
    const reduced a = reduce(x);
    return with_rest(a.shifted, a.r + tail);
  }

  /// The power, where its scale is a normal number.
  LUMEN_MAIN float power(const half_step_factors& a) {
    const float scale = value((a.shifted << 22) ^ a.root);
    return fma(a.rest, scale, scale);
  }

  /// The power with the scale in two factors: it may be an infinity, a denormal or zero.
  LUMEN_MAIN float scaled_power(const half_step_factors& a) {
    const std::uint32_t twice_biased = a.shifted + 0xfe;
    const std::uint32_t first = (twice_biased << 21) & format<float>::special;
    const float second = value(((twice_biased << 22) - first) ^ a.root);
    return fma(a.rest, second, second) * value(first);
  }

 private:
  struct reduced {
    std::uint32_t shifted;
    float r;
  };

  LUMEN_MAIN reduced reduce(float x) {
    const float shifter = value(0x4ac000feu);  // 3·2^21 + 127
    const float t = fma(x, value(Base::log2_of_base), shifter);
    const float n = t - shifter;
    const float r = fma(-n, value(Base::half_step_high), x);
    return {bits(t), fma(-n, value(Base::half_step_low), r)};
  }

  LUMEN_MAIN half_step_factors with_rest(std::uint32_t shifted, float r) {
    float p = fma(r, value(Base::c5), value(Base::c4));
    p = fma(r, p, value(Base::c3));
    p = fma(r, p, value(Base::c2));
    p = fma(r, p, value(Base::c1));
    const std::uint32_t odd = 0u - (shifted & 1u);
    const float root_rest = value(odd & 0x329302aeu);
    return {shifted, odd & 0x007504f3u, fma(r, p, root_rest)};
  }
};

/// b^x at float for the base b of `Base`; one body for all tiers.
///
/// Up to `Base::normal_limit` the result is a normal number. From there to `Base::scaled_limit` the
/// scale is applied in two factors, and the status stays 0 although the result may be an infinity,
/// a denormal or zero; below minus `Base::zero_limit` it is zero. Beyond, and at infinities:
/// +infinity with code 3, +0 with code 4.
template <typename Base>
struct half_step_power : scalar_v11<half_step_power<Base>, float> {
  using factors = half_step_factors<Base>;

  LUMEN_MAIN main_result<float> main(float x) {
    return {factors::power(factors::of(x)), flag_if<float>(bits(fabs(x)) > Base::normal_limit)};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) { return assign(beyond(x), y); }

  /// A zero is not computed: processors take long for a product that underflows.
  LUMEN_MAIN rare_result<float> beyond(float x) {
    const bool scaled = bits(fabs(x)) <= Base::scaled_limit;
    const bool computed = scaled && !(x < -value(Base::zero_limit));
    const float power = factors::scaled_power(factors::of(select(computed, x, 0.0f)));
    const float limit = select(x < 0, 0.0f, value(format<float>::special));
    const std::uint32_t limits_status = select(x < 0, mask(code::underflow), mask(code::overflow));
    return {select(computed, power, select(is_nan(x), x + x, limit)), 0,
            select(scaled || is_nan(x), mask(code::none), limits_status)};
  }
};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
