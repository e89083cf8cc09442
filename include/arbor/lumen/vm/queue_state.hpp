// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <sycl/sycl.hpp>

#include "arbor/lumen/export.hpp"
#include "arbor/lumen/vm/enums.hpp"

/// The mode and the status that the library keeps for each queue. All functions may be called from
/// any number of threads at once. Copies of a queue share one mode and one status.
namespace arbor::lumen::vm {

/// The mode in force for calls on `queue` that leave their mode at `not_defined`. A queue whose
/// mode was never set has `default_mode`.
ARBORLUMEN_EXPORT enums::mode get_mode(sycl::queue& queue);

/// Merges `mode` into the mode of `queue`: each group that `mode` names replaces the group.
/// @returns the word stored before, `not_defined` if there was none.
ARBORLUMEN_EXPORT enums::mode set_mode(sycl::queue& queue, enums::mode mode);

/// The status accumulated on `queue` since it was last set or cleared: bad arguments under
/// `badarg_quiet`, calls that nothing serves, and, of calls made under `global_status_report`, the
/// status of their elements.
ARBORLUMEN_EXPORT enums::status get_status(sycl::queue& queue);

/// Replaces the status of `queue`.
/// @returns the status before.
ARBORLUMEN_EXPORT enums::status set_status(sycl::queue& queue, enums::status status);

/// Sets the status of `queue` to `success`.
/// @returns the status before.
ARBORLUMEN_EXPORT enums::status clear_status(sycl::queue& queue);

}  // namespace arbor::lumen::vm
