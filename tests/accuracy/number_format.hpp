// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The three real element types at run time: formats, patterns and values.
#pragma once

#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>

#include "scalar/half.hpp"

namespace arbor::lumen::accuracy {

/// An IEEE 754 binary format. Normal numbers lie in [2^min_exponent, 2^(max_exponent + 1)).
struct number_format {
  char type;
  int precision;
  int min_exponent;
  int max_exponent;
  std::size_t size;

  int width() const { return static_cast<int>(8 * size); }
  std::uint64_t sign() const { return std::uint64_t{1} << (width() - 1); }
  std::uint64_t magnitude() const { return sign() - 1; }
  std::uint64_t infinity() const {
    return static_cast<std::uint64_t>(2 * max_exponent + 1) << (precision - 1);
  }

  double value(std::uint64_t pattern) const {
    if (type == 'd') return std::bit_cast<double>(pattern);
    if (type == 's') return std::bit_cast<float>(static_cast<std::uint32_t>(pattern));
    return vm::detail::gpu::norvane::scalar::widen({static_cast<std::uint16_t>(pattern)});
  }
  /// The nearest number's pattern.
  std::uint64_t pattern(double x) const {
    if (type == 'd') return std::bit_cast<std::uint64_t>(x);
    const auto narrowed = static_cast<float>(x);
    if (type == 's') return std::bit_cast<std::uint32_t>(narrowed);
    return vm::detail::gpu::norvane::scalar::narrow(narrowed).pattern;
  }

  /// Element `i` of an array.
  std::uint64_t load(const void* array, std::size_t i) const {
    std::uint64_t pattern = 0;
    std::memcpy(&pattern, static_cast<const char*>(array) + i * size, size);
    return pattern;
  }
  void store(void* array, std::size_t i, std::uint64_t pattern) const {
    std::memcpy(static_cast<char*>(array) + i * size, &pattern, size);
  }

  /// Numbers in ascending order as consecutive integers, with -0 below +0: the numbers between two
  /// of them are sampled, or walked through, as integers.
  std::int64_t rank(std::uint64_t pattern) const {
    const auto m = static_cast<std::int64_t>(pattern & magnitude());
    return (pattern & sign()) != 0 ? -1 - m : m;
  }
  std::uint64_t at_rank(std::int64_t rank) const {
    return rank < 0 ? (static_cast<std::uint64_t>(-1 - rank) | sign())
                    : static_cast<std::uint64_t>(rank);
  }
};

inline constexpr number_format half_format{'h', 11, -14, 15, 2};
inline constexpr number_format float_format{'s', 24, -126, 127, 4};
inline constexpr number_format double_format{'d', 53, -1022, 1023, 8};

inline const number_format& format_of(char type) {
  return type == 'h' ? half_format : (type == 's' ? float_format : double_format);
}

}  // namespace arbor::lumen::accuracy
