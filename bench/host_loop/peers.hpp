// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The vector functions of SLEEF and of the C library for the instruction set of this file's
/// compilation, over whole arrays.
#pragma once

#include <cstdint>
#include <span>
#include <string_view>

namespace bench {

struct peer {
  std::string_view function;  ///< the catalogue's name
  char type;
  std::string_view implementation;
  /// `n` is a multiple of the vector length; a second result goes to y + n. One of the two is set.
  void (*run_float)(const float* const* in, float* y, std::int64_t n);
  void (*run_double)(const double* const* in, double* y, std::int64_t n);
};

std::span<const peer> peers();

}  // namespace bench
