// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstddef>
#include <stdexcept>
#include <string>
#include <sycl/sycl.hpp>
#include <vector>

/// Numbers as text: read to the nearest value of the type, written so that reading restores them.
namespace arbor::lumen::vm::tool {

/// A text that is no number of the type; the message says why.
class bad_number : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

/// Reads a decimal or hexadecimal number, inf or nan. A finite number beyond the range of `R` is
/// bad, one that rounds to zero is not.
/// @tparam R half, float or double
template <typename R>
R parse_real(const std::string& text);

/// The shortest decimal number that reads back as `value`.
template <typename R>
std::string to_text(R value);

/// The bit pattern of `value` in hexadecimal.
template <typename R>
std::string to_bits(R value);

/// What an element consists of: one real number, or two.
template <typename T>
struct element {
  using real = T;
  static constexpr std::size_t parts = 1;
  static T from(const T* values) { return values[0]; }
  static T part(const T& value, std::size_t) { return value; }
};
template <typename R>
struct element<std::complex<R>> {
  using real = R;
  static constexpr std::size_t parts = 2;
  static std::complex<R> from(const R* values) { return {values[0], values[1]}; }
  static R part(const std::complex<R>& value, std::size_t i) {
    return i == 0 ? value.real() : value.imag();
  }
};

/// Widths of the texts of the longest numbers and of the bit patterns.
template <typename R>
inline constexpr int text_width = sizeof(R) == 2   ? 11
                                  : sizeof(R) == 4 ? 15
                                                   : 24;
template <typename R>
inline constexpr int bits_width = 2 + 2 * static_cast<int>(sizeof(R));

}  // namespace arbor::lumen::vm::tool
