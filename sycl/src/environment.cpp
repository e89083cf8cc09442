// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "environment.hpp"

#include <charconv>
#include <cstdlib>

namespace sycl::detail {

std::optional<std::string> environment(const char* name) {
  const char* const value = std::getenv(name);
  if (value == nullptr) return std::nullopt;
  return std::string(value);
}

std::optional<std::uint64_t> parse_number(const std::string& text, int base) noexcept {
  std::uint64_t number = 0;
  const char* const end = text.data() + text.size();
  const auto [last, error] = std::from_chars(text.data(), end, number, base);
  if (error != std::errc() || last != end || text.empty()) return std::nullopt;
  return number;
}

}  // namespace sycl::detail
