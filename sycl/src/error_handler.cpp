// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "error_handler.hpp"

#include <cstdio>

namespace sycl::detail {

void default_error_handler(const std::vector<std::exception_ptr>& errors) noexcept {
  for (const std::exception_ptr& error : errors) {
    try {
      std::rethrow_exception(error);
    } catch (const std::exception& caught) {
      std::fprintf(stderr, "SYCL: unhandled asynchronous error: %s\n", caught.what());
    } catch (...) {
      std::fputs("SYCL: unhandled asynchronous error of unknown type\n", stderr);
    }
  }
  std::terminate();
}

}  // namespace sycl::detail
