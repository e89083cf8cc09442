// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <string>

/// Keys, modes and device words in words, for the messages of calls that fail and for the command
/// line tool.
namespace arbor::lumen::vm::detail {

/// The fields of a key, each with its blank; the feature only if `with_feature`. Fields are
/// compared as whole values, so a feature byte combined with `fp32cast` prints no feature.
std::string key_to_text(std::uint64_t key, bool with_feature);

/// The fields of a mode word that dispatch reads; "not_defined" for 0.
std::string mode_to_text(std::uint32_t mode);

/// The device word's bits that have a name.
std::string device_to_text(std::uint64_t device_word);

}  // namespace arbor::lumen::vm::detail
