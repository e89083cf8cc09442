// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <span>

namespace sycl {

using std::dynamic_extent;
using std::span;

}  // namespace sycl
