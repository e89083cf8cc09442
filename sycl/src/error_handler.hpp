// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <exception>
#include <vector>

namespace sycl::detail {

/// Where neither the queue nor the context has a handler: prints the errors and ends the process.
[[noreturn]] void default_error_handler(const std::vector<std::exception_ptr>& errors) noexcept;

}  // namespace sycl::detail
