// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace sycl::detail {

/// The value of an environment variable, nothing if it is not set.
std::optional<std::string> environment(const char* name);

/// The number that the text is, digits only and all of it; nothing if it is none of 64 bits.
std::optional<std::uint64_t> parse_number(const std::string& text, int base) noexcept;

}  // namespace sycl::detail
