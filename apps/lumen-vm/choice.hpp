// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <stdexcept>
#include <string>
#include <sycl/sycl.hpp>
#include <vector>

#include "commands.hpp"
#include "dispatch/family.hpp"

namespace arbor::lumen::vm::tool {

/// What was asked for does not exist; the text says what does.
class usage_error : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

/// A device and its number in the list of all devices.
struct numbered_device {
  std::size_t number;
  sycl::device device;
};

/// All devices in the order of their numbers.
std::vector<numbered_device> all_devices();

/// A call that exists: what a `call_request` means.
struct chosen_call {
  const detail::family& family;
  char in;   ///< letter of the input elements
  char out;  ///< letter of the output elements
  numbered_device device;
  std::uint64_t device_word;
  std::uint32_t mode;  ///< as merged by a call on a fresh queue
};

/// @throws usage_error for a function, type, mode or device that does not exist
chosen_call choose(const call_request& request);

/// The letter of the output elements for inputs of the letter `in`.
char output_letter(const detail::family& family, char in);

}  // namespace arbor::lumen::vm::tool
