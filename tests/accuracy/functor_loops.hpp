// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <span>

#include "functor.hpp"

namespace arbor::lumen::accuracy {

/// The vectorised loop of each functor, in the order of `functors()`.
std::span<const decltype(functor::run_loop)> functor_loops();

}  // namespace arbor::lumen::accuracy
