// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <span>
#include <vector>

#include "measurement.hpp"

namespace arbor::lumen::accuracy {

/// Measures functions of one float at every float, against the C library's double function: the
/// error of that, below 2 ulp of double, is 2^-28 ulp of float. Uses all processors; the
/// measurements have no histogram.
std::vector<measurement> measure_every_float(std::span<const subject> subjects, const reference& r);

}  // namespace arbor::lumen::accuracy
