// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <string>

/// Words for what the library's own texts leave out, and the look of hexadecimal words.
namespace arbor::lumen::vm::tool {

/// `value` in hexadecimal with `digits` digits, or more where it needs them.
std::string hex(std::uint64_t value, int digits);

/// Every bit of a device word by name.
std::string device_words(std::uint64_t device_word);

/// The variant of a key; one that computes half in float is "fp32cast nolut" and the like.
std::string feature_words(std::uint64_t key);

/// ha, la or ep.
std::string accuracy_words(std::uint64_t key);

/// The names of the set bits, joined by "|"; "success" for 0.
std::string status_words(std::uint32_t status);

}  // namespace arbor::lumen::vm::tool
