// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/exact/rint.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// nearbyint(x) is rint(x): the two differ in a floating-point flag only, and no body raises flags.
using nearbyint_s = rint_s;
using nearbyint_d = rint_d;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
