// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <sycl/sycl.hpp>

#include "call/input.hpp"
#include "dispatch/table.hpp"

namespace arbor::lumen::vm::detail {

/// How much work per item suits the device: above 1 only on a GPU of the norvane vendor that is not
/// integrated, by its tier and the precision.
std::uint32_t tuning_factor(std::uint64_t device_word, std::string_view function_name,
                            std::uint64_t precision, std::uint64_t key);

/// Runs a call on the row of `table` that serves it. The row is looked for before the arguments are
/// checked, so that bad arguments are reported also where no row exists.
///
/// Under `badarg_quiet` a bad argument, and without `mode_missing_throws` a call that nothing
/// serves, sets `bad_argument` in the queue's status and returns the default event; no output is
/// touched.
/// @throws invalid_argument, unimplemented where the mode says so
sycl::event dispatch_call(const input::vxx& record, const implementation_table& table);

/// The information text of `unimplemented` for a call that nothing serves.
std::string unserved_text(std::uint32_t mode, std::uint64_t precision, std::uint64_t device_word);

}  // namespace arbor::lumen::vm::detail
