// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>
#include <sycl/sycl.hpp>

#include "choice.hpp"

namespace arbor::lumen::vm::tool {

/// Makes a call of no elements that nothing serves, and says how it ended: with the text of an
/// exception, or with a status.
std::string end_of_unserved(const chosen_call& call, sycl::queue& queue);

}  // namespace arbor::lumen::vm::tool
