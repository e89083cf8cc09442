// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The scalar functors by name, on arrays of any element type.
#pragma once

#include <cstddef>
#include <cstdint>
#include <ostream>
#include <span>
#include <string_view>

namespace arbor::lumen::accuracy {

/// One functor of the device catalogue. `run` computes `n` elements: operands, constants among
/// them, are arrays in `in`, results are written to the arrays in `out`.
struct functor {
  std::string_view name;
  std::string_view function;
  std::string_view shape;
  char type;
  std::string_view tier;
  std::string_view label;
  void (*run)(const void* const* in, void* const* out, std::uint32_t* status, std::size_t n);
  /// The same by the vectorised loop of host kernels, without status; null where there is none.
  void (*run_loop)(const void* const* in, void* const* out, std::size_t n);

  std::size_t inputs() const { return shape == "v11" || shape == "v12" ? 1 : 2; }
  std::size_t outputs() const { return shape == "v12" ? 2 : 1; }
  bool is_real() const { return type == 'h' || type == 's' || type == 'd'; }
};

/// How GoogleTest names one.
inline void PrintTo(const functor& f, std::ostream* out) { *out << f.name; }

/// All of them, in the catalogue's order.
std::span<const functor> functors();

/// The functor of that name, or null.
const functor* find_functor(std::string_view name);

}  // namespace arbor::lumen::accuracy
