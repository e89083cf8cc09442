// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/horner.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// Q(z) = arcsin(√z)/√z on [0, 1/4], with a constant term that the caller gives: that of Q, or what
/// Q has beside an exact 1.
LUMEN_MAIN float arcsine_polynomial(float z, std::uint32_t constant) {
  return horner(z, 0x3d2edc07u, 0x3cc32a6bu, 0x3d3a9ab4u, 0x3d997c12u, 0x3e2aaaffu, constant);
}
LUMEN_MAIN double arcsine_polynomial(double z, std::uint64_t constant) {
  return horner(z, 0x3fa07520c559a401u, 0xbf90fb17f2824aa0u, 0x3f943f44bc0c21f0u,
                0x3f7a58339bb6f20cu, 0x3f88f8dc2a3c76d7u, 0x3f8c6dbbcba98e67u, 0x3f91c6dcf536c796u,
                0x3f96e89cebdf209cu, 0x3f9f1c72e13ad6d3u, 0x3fa6db6db3b44600u, 0x3fb333333337e0deu,
                0x3fc555555555529cu, constant);
}

/// Q(z), and Q(z) - 1.
LUMEN_MAIN float arcsine_factor(float z) { return arcsine_polynomial(z, 0x3f800000u); }
LUMEN_MAIN double arcsine_factor(double z) { return arcsine_polynomial(z, 0x3ff0000000000000u); }
LUMEN_MAIN float arcsine_rest(float z) { return arcsine_polynomial(z, 0xb19b5f15u); }
LUMEN_MAIN double arcsine_rest(double z) { return arcsine_polynomial(z, 0x3c70d208999dc313u); }

/// Q(z) to 29 bits.
LUMEN_MAIN double arcsine_factor_ep(double z) {
  return horner(z, 0x3fa5db80ed4c0893u, 0x3f98654d51d83552u, 0x3fa7535682d76f42u,
                0x3fb32f82392c8a5fu, 0x3fc5555fdd993e8bu, 0x3feffffffd9283adu);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
