// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

namespace arbor::lumen::vm::detail {

/// How much work a device of the chosen class likes per work item. A launch shape may use it to cut
/// its range; results do not depend on it.
struct TuningInfo {
  std::uint32_t factor;
};

}  // namespace arbor::lumen::vm::detail
