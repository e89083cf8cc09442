// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// Polynomials for arctan t = t P(t²).
#pragma once

#include <cstdint>

#include "scalar/horner.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// P(z) on [0, 1], degree 19, relative error 2^-53.
LUMEN_MAIN double arctangent_factor(double z) {
  return horner(z, 0xbef4fdb537abc7a3u, 0x3f2ced0a36665209u, 0xbf52e67c93954c23u,
                0x3f6f5a1dae82afb3u, 0xbf82b2ec618e4badu, 0x3f914f4c661116a5u, 0xbf9a5e83b081f69cu,
                0x3fa169980cb6ad4fu, 0xbfa4efa2e563c1bcu, 0x3fa7ec0fbc50683bu, 0xbfaad261eaa09954u,
                0x3fae1749bd612dcfu, 0xbfb11084009435e0u, 0x3fb3b12a49295651u, 0xbfb745d009bada94u,
                0x3fbc71c707f7d5b5u, 0xbfc2492491ee55c7u, 0x3fc999999997ee34u, 0xbfd55555555553c5u,
                0x3ff0000000000000u);
}

/// The same polynomial less 1, in two halves of pairs by powers of z⁴, for a shorter chain.
LUMEN_MAIN double arctangent_rest(double z) {
  const double z2 = z * z;
  const double z4 = z2 * z2;
  const auto pair = [z](std::uint64_t odd, std::uint64_t even) {
    return fma(value(odd), z, value(even));
  };
  double g1 = pair(0xbef4fdb537abc7a3u, 0x3f2ced0a36665209u);
  g1 = fma(g1, z4, pair(0xbf82b2ec618e4badu, 0x3f914f4c661116a5u));
  g1 = fma(g1, z4, pair(0xbfa4efa2e563c1bcu, 0x3fa7ec0fbc50683bu));
  g1 = fma(g1, z4, pair(0xbfb11084009435e0u, 0x3fb3b12a49295651u));
  g1 = fma(g1, z4, pair(0xbfc2492491ee55c7u, 0x3fc999999997ee34u));
  double g2 = pair(0xbf52e67c93954c23u, 0x3f6f5a1dae82afb3u);
  g2 = fma(g2, z4, pair(0xbf9a5e83b081f69cu, 0x3fa169980cb6ad4fu));
  g2 = fma(g2, z4, pair(0xbfaad261eaa09954u, 0x3fae1749bd612dcfu));
  g2 = fma(g2, z4, pair(0xbfb745d009bada94u, 0x3fbc71c707f7d5b5u));
  g2 = fma(g2, z4, pair(0xbfd55555555553c5u, 0u));
  return fma(g1, z2, g2);
}

/// (P(z) - 1)/z for |t| <= 7/16, relative error of zP 2^-58: the odd and the even coefficients
/// apart.
LUMEN_MAIN double arctangent_rest_of_segment(double z) {
  const double z2 = z * z;
  const double odd = horner(z2, 0x3f8be4fbe6733718u, 0x3fa6ad5558fe19c9u, 0x3fae12f1edf7c393u,
                            0x3fb3b132b731e73au, 0x3fbc71c719f99f96u, 0x3fc9999999998f43u);
  const double even = horner(z2, 0xbfa04cd71f92185eu, 0xbfaa9e755ca13d23u, 0xbfb1108d326c68edu,
                             0xbfb745d119677a4fu, 0xbfc2492492441a21u, 0xbfd5555555555552u);
  return fma(odd, z, even);
}

/// P(z) on [0, 1] to 31 bits.
LUMEN_MAIN double arctangent_factor_ep(double z) {
  const double z2 = z * z;
  const auto pair = [z](std::uint64_t odd, std::uint64_t even) {
    return fma(value(odd), z, value(even));
  };
  double p = pair(0xbf5c95b5ab286a02u, 0x3f85e36a8ced7474u);
  p = fma(p, z2, pair(0xbf9f791909cb44c4u, 0x3fad6ee2dace07afu));
  p = fma(p, z2, pair(0xbfb56fcd7489159au, 0x3fbc0236e7018ba7u));
  p = fma(p, z2, pair(0xbfc2414862594647u, 0x3fc999069c08617cu));
  return fma(p, z2, pair(0xbfd55553391ce4c9u, 0x3feffffffeb5a845u));
}

/// P(z) on [0, 1], float.
LUMEN_MAIN float arctangent_factor(float z) {
  return horner(z, 0xbb9ca55fu, 0x3cc92c07u, 0xbd755ea6u, 0x3dcba0b1u, 0xbe0fa948u, 0x3e4c81c3u,
                0xbeaaa90bu, 0x3f7fffffu);
}

/// arctan(t)/t for t in [0, 1] to 12 bits, in t itself.
LUMEN_MAIN float arctangent_factor_ep(float t) {
  return horner(t, 0xbca5054fu, 0x3e49099du, 0xbecbaf63u, 0x3bef4e52u, 0x3f7ff759u);
}

/// arctan(t)/t - 1 for t in [0, 1], in t - 1/2: the coefficients of atan, and those of atan2.
LUMEN_MAIN float arctangent_rest_at_half(float d) {
  return horner(d, 0xbc8917bfu, 0x3c0afad8u, 0x3cf6afd7u, 0xbd1e9009u, 0xbc0e2ce0u, 0x3d8ee88fu,
                0xbd84d3d8u, 0xbd3a0aceu, 0x3e34898cu, 0xbe05f565u, 0xbe8259aeu, 0xbd94e63fu);
}
LUMEN_MAIN float arctangent_rest_at_half_short(float d) {
  return horner(d, 0x3c909a7bu, 0xbd093579u, 0xbbacabd2u, 0x3d8c9f7bu, 0xbd85ac4eu, 0xbd39a551u,
                0x3e348efbu, 0xbe05f628u, 0xbe8259b8u, 0xbd94e63du);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
