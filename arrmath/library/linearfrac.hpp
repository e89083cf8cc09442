// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// (scalea a + shifta) / (scaleb b + shiftb). Each linear form is rounded once, so that neither
/// loses digits where it cancels.
#pragma once

#include <cmath>
#include <cstdint>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

template <typename T>
struct linearfrac {
  using input_type = T;
  using output_type = T;
  static std::uint32_t call(const T* a, const T* b, T scalea, T shifta, T scaleb, T shiftb, T* y) {
    const auto numerator = std::fma(widen(scalea), widen(*a), widen(shifta));
    const auto denominator = std::fma(widen(scaleb), widen(*b), widen(shiftb));
    *y = narrow<T>(numerator / denominator);
    return success;
  }
};

}  // namespace arbor::lumen::vm::detail::library
