// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/half.hpp"
#include "scalar/horner.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// 2^(k/3), k = 0..2, and what its nearest number leaves out, relative to it.
template <typename T>
struct root_of_residue {
  T high;
  T low;
};

/// The steps of cbrt that do not depend on the tier: |x| = m·2^(3n + k), m in [3/4, 3/2), denormals
/// scaled up before, and the cube root as S + S·p with S = 2^(k/3)·2^n and p = cbrt(m) - 1.
/// `Polynomial` gives p for m - 1, `two_words` adds the low word of 2^(k/3). All exact but S and p.
template <typename T>
struct cube_root;

template <>
struct cube_root<float> {
  template <typename Polynomial, bool two_words>
  LUMEN_MAIN float of(float x) {
    const bool denormal = bits(fabs(x)) < 0x00800000u;
    const float scale = select(denormal, value(0x62000000u), 1.0f);  // 2^69
    const std::uint32_t bias = select(denormal, 0x3eu, 0x55u);
    const float v = fma(fabs(x), scale, 0.0f);
    const std::uint32_t w = bits(v);
    const std::uint32_t t = w + 0xffc00000u;
    const std::uint32_t e = t >> 23;
    const std::uint32_t q = (e * 0x5556u) >> 16;
    const std::uint32_t k = e - 3 * q;
    const float power = value(select(w == 0, 0u, (q + bias) << 23));
    const float m = value(w - (t & 0xff800000u) + 0x3f000000u);
    float p = Polynomial::of(m - 1.0f);
    const auto c = residue(k);
    if constexpr (two_words) p = fma(c.low, p, c.low) + p;
    const float s = fma(c.high, power, 0.0f);
    const float y = select(v <= value(0x7f7fffffu), fma(s, p, s), v + v);
    return value(bits(y) ^ sign_bit(x));
  }

 private:
  LUMEN_MAIN root_of_residue<float> residue(std::uint32_t k) {
    const std::uint32_t c = select(k == 0, 0x3f800000u, select(k == 1, 0x3fa14518u, 0x3fcb2ff5u));
    // Half of what is left out, which costs nothing that shows at float.
    const std::uint32_t low = select(k == 0, 0u, select(k == 1, 0xb223c16cu, 0x31d34318u));
    return {value(c), value(low)};
  }
};

template <>
struct cube_root<double> {
  template <typename Polynomial, bool two_words>
  LUMEN_MAIN double of(double x) {
    const bool denormal = bits(fabs(x)) < 0x0010000000000000u;
    const double scale = select(denormal, value(0x4440000000000000u), 1.0);  // 2^69
    const std::uint64_t bias = select<std::uint64_t>(denormal, 0x293u, 0x2aau);
    const double v = fma(fabs(x), scale, 0.0);
    const std::uint64_t w = bits(v);
    const std::uint64_t t = w + 0x0008000000000000u;
    const std::uint64_t e = t >> 52;
    const std::uint64_t q = ((e & 0xfff) * 0x5556u) >> 16;
    const std::uint64_t k = e - 3 * q;
    const double power = value(select<std::uint64_t>(w == 0, 0u, (q + bias) << 52));
    const double m = value(w - (t & 0xfff0000000000000u) + format<double>::one);
    double p = Polynomial::of(m - 1.0);
    const auto c = residue(k);
    if constexpr (two_words) p = fma(c.low, p, c.low) + p;
    const double s = fma(c.high, power, 0.0);
    const double y = select(v <= value(0x7fefffffffffffffu), fma(s, p, s), v + v);
    return value(bits(y) ^ sign_bit(x));
  }

 private:
  LUMEN_MAIN root_of_residue<double> residue(std::uint64_t k) {
    using pattern = std::uint64_t;
    const auto c =
        select<pattern>(k == 0, format<double>::one,
                        select<pattern>(k == 1, 0x3ff428a2f98d728bu, 0x3ff965fea53d6e3du));
    const auto low = select<pattern>(
        k == 0, 0u, select<pattern>(k == 1, 0xbc77b3273beb351cu, 0xbc93bc3a711b3cf7u));
    return {value(c), value(low)};
  }
};

/// cbrt(1 + f) - 1 for f in [-1/4, 1/2).
template <tier t>
struct cbrt_polynomial_s {
  LUMEN_MAIN float of(float f) {
    if constexpr (t == tier::ep) {
      return horner(f, 0x3d492148u, 0xbde8e5c7u, 0x3eab0e79u, 0x3809ac15u);
    } else if constexpr (t == tier::la) {
      return horner(f, 0x3c2e7d00u, 0xbcbfae2eu, 0x3cffc6c2u, 0xbd292181u, 0x3d7cb074u, 0xbde38bc5u,
                    0x3eaaaab7u, 0xb2a18999u);
    } else {
      return horner(f, 0x3bcfaf07u, 0xbc771231u, 0x3ca35241u, 0xbcc266f9u, 0x3cf6f381u, 0xbd2880e9u,
                    0x3d7cd740u, 0xbde38e56u, 0x3eaaaaabu, 0x30144e9bu);
    }
  }
};

template <tier t>
struct cbrt_polynomial_d {
  LUMEN_MAIN double of(double f) {
    if constexpr (t == tier::ep) {
      return horner(f, 0x3f66265d455d2f3du, 0xbf7f28188ab6f97du, 0x3f862d9aecdbbe91u,
                    0xbf88cf1311f32642u, 0x3f8baf27159d88d7u, 0xbf902ed64bd783cbu,
                    0x3f9373b60f839d1cu, 0xbf98094c2c00020cu, 0x3f9ee71ebfb3619eu,
                    0xbfa511e8668cde63u, 0x3faf9add22f5b630u, 0xbfbc71c71cbbbba6u,
                    0x3fd5555555587857u, 0x3d35c6550bd707adu);
    } else if constexpr (t == tier::la) {
      return horner(
          f, 0xbf5258530f7103eeu, 0x3f6f30182507f509u, 0xbf7986b7eabb0f78u, 0x3f7d87b2b4a9762au,
          0xbf7efbebaa4d1f28u, 0x3f80bd903b4ac117u, 0xbf82a96763bdeb5bu, 0x3f85095e87087a1bu,
          0xbf87f17e129ff05cu, 0x3f8b9fee9509eb5du, 0xbf9036dc67cd7b0du, 0x3f93750a6fcca6b6u,
          0xbf98090d6918910du, 0x3f9ee71136c830fdu, 0xbfa511e8d2ad4e91u, 0x3faf9add3c0aff15u,
          0xbfbc71c71c71c90cu, 0x3fd5555555555572u, 0x3c5338db1759ca85u);
    } else {
      return horner(f, 0xbf4aab4475c7ef1du, 0x3f6845d681374289u, 0xbf750d677402621au,
                    0x3f7919308ccde911u, 0xbf7a28cf5604db64u, 0x3f7ba63c9b8e020du,
                    0xbf7e454bb3957abau, 0x3f80c67d884efe94u, 0xbf82b43f401b165du,
                    0x3f850a3bd549b4dau, 0xbf87f0ec417b8c4cu, 0x3f8b9fd77d05593fu,
                    0xbf9036de5b78af16u, 0x3f93750adbcc9f27u, 0xbf98090d625599c1u,
                    0x3f9ee71134f3a579u, 0xbfa511e8d2b2bc58u, 0x3faf9add3c0cb194u,
                    0xbfbc71c71c71c74cu, 0x3fd5555555555555u, 0x3c1c5f9b7eb4a982u);
    }
  }
};

/// cbrt, float, status 0; within 0.81, 1.22, 1250 ulp for `ha`, `la`, `ep`: degree 9 with 2^(k/3)
/// in two words, 7, 3.
template <tier t>
struct cbrt_s : scalar_v11<cbrt_s<t>, float> {
  static constexpr int interleave = 4;

  LUMEN_MAIN main_result<float> main(float x) {
    return {cube_root<float>::of<cbrt_polynomial_s<t>, t == tier::ha>(x)};
  }
};

/// cbrt, double, status 0 at `la` and `ep`; within 0.74, 1.53, 2680 ulp for `ha`, `la`, `ep`:
/// degree 20 with 2^(k/3) in two words, 18, 13.
template <tier t>
struct cbrt_d : scalar_v11<cbrt_d<t>, double> {
  static constexpr int interleave = 4;

  LUMEN_MAIN main_result<double> main(double x) {
    return {cube_root<double>::of<cbrt_polynomial_d<t>, false>(x)};
  }
};

/// `ha`: its status is no condition but (1 << i) >> 1, reduced to 8 bits, for the result's integer
/// part i, and so 0 unless i is one of 1 to 8.
template <>
struct cbrt_d<tier::ha> : scalar_v11<cbrt_d<tier::ha>, double> {
  static constexpr int interleave = 4;

  LUMEN_MAIN main_result<double> main(double x) {
    const double y = cube_root<double>::of<cbrt_polynomial_d<tier::ha>, true>(x);
    const bool from_one = y >= 1.0;
    const bool below_nine = y < 9.0;
    const double i = select(from_one & below_nine, y, 0.0);
    return {y, (std::uint64_t{1} << static_cast<std::int32_t>(i)) >> 1};
  }
};

/// cbrt, half: the float body of `ep` in every tier.
using cbrt_h = half_v11<cbrt_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
