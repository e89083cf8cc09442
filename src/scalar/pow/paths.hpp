// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// A power put together: a main path, which may serve a band of its own on the rare path; what
/// holds for special operands; and the power of what these leave over.
template <typename T, typename Main, typename Specials, typename Others>
struct power_paths : Main {
  LUMEN_RARE std::uint32_t rare(T x, T y, T* r) {
    if constexpr (requires { Main::serve_band(x, y, r); }) {
      if (Main::serve_band(x, y, r)) return mask(code::none);
    }
    const auto special = Specials::of(x, y);
    if (special.found) {
      *r = special.value;
      return mask(special.status);
    }
    return Others::of(x, y, special.sign, r);
  }
};

/// The paths as a functor with the exponent in an array, and with a constant one.
template <typename T, typename Paths>
struct power_v21 : Paths, scalar_v21<power_v21<T, Paths>, T> {};
template <typename T, typename Paths>
struct power_v21c : Paths, scalar_v21c<power_v21c<T, Paths>, T> {};

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
