// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "numbers.hpp"

#include <bit>
#include <cfenv>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <type_traits>

#include "words.hpp"

namespace arbor::lumen::vm::tool {
namespace {

template <typename R>
constexpr const char* real_name = "double";
template <>
constexpr const char* real_name<float> = "float";
template <>
constexpr const char* real_name<sycl::half> = "half";

/// A conversion of the C library under a rounding direction.
template <typename R>
R convert(const char* text, char** end, int direction) {
  const int before = std::fegetround();
  std::fesetround(direction);
  R value;
  if constexpr (std::is_same_v<R, double>)
    value = std::strtod(text, end);
  else
    value = std::strtof(text, end);
  std::fesetround(before);
  return value;
}

/// Of the two floats around an inexact number the one with the odd pattern. A float rounded thus
/// has the half nearest to the number as its own nearest half.
float round_to_odd(const char* text, char** end) {
  const float below = convert<float>(text, end, FE_DOWNWARD);
  const float above = convert<float>(text, end, FE_UPWARD);
  return (std::bit_cast<std::uint32_t>(below) & 1) != 0 ? below : above;
}

template <typename R>
R nearest(const char* text, char** end) {
  if constexpr (std::is_same_v<R, sycl::half>)
    return R(round_to_odd(text, end));
  else
    return convert<R>(text, end, FE_TONEAREST);
}

bool names_infinity(const std::string& text) {
  const std::size_t first = text.find_first_not_of("+-");
  return first != std::string::npos && (text[first] == 'i' || text[first] == 'I');
}

template <typename R>
bool is_infinite(R value) {
  return std::isinf(static_cast<float>(value)) &&
         (sizeof(R) <= sizeof(float) || std::isinf(static_cast<double>(value)));
}

}  // namespace

template <typename R>
R parse_real(const std::string& text) {
  char* end = nullptr;
  const R value = nearest<R>(text.c_str(), &end);
  if (text.empty() || end != text.c_str() + text.size())
    throw bad_number("\"" + text + "\" is no number");
  if (is_infinite(value) && !names_infinity(text))
    throw bad_number("\"" + text + "\" is beyond the range of " + real_name<R>);
  return value;
}

template <typename R>
std::string to_text(R value) {
  char text[32];
  if constexpr (std::is_same_v<R, sycl::half>) {
    const auto wide = static_cast<float>(value);
    for (int digits = 1; digits <= 5; ++digits) {
      std::snprintf(text, sizeof text, "%.*g", digits, static_cast<double>(wide));
      if (!std::isfinite(wide) || static_cast<float>(nearest<sycl::half>(text, nullptr)) == wide)
        break;
    }
    return text;
  } else {
    return std::string(text, std::to_chars(text, text + sizeof text, value).ptr);
  }
}

template <typename R>
std::string to_bits(R value) {
  using pattern =
      std::conditional_t<sizeof(R) == 2, std::uint16_t,
                         std::conditional_t<sizeof(R) == 4, std::uint32_t, std::uint64_t>>;
  return hex(sycl::bit_cast<pattern>(value), 2 * static_cast<int>(sizeof(R)));
}

#define LUMEN_INSTANTIATE(R)                    \
  template R parse_real<R>(const std::string&); \
  template std::string to_text<R>(R);           \
  template std::string to_bits<R>(R);
LUMEN_INSTANTIATE(sycl::half)
LUMEN_INSTANTIATE(float)
LUMEN_INSTANTIATE(double)
#undef LUMEN_INSTANTIATE

}  // namespace arbor::lumen::vm::tool
