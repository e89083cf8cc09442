// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <span>
#include <sycl/sycl.hpp>

#include "call/input.hpp"
#include "dispatch/table.hpp"

namespace arbor::lumen::vm::detail {

/// A function as the catalogue states it.
struct family {
  const char* name;
  const char* shape;
  const char* types;         ///< the element letters of its overloads' inputs
  const char* output_types;  ///< those of their outputs, in the same order
  bool handler;              ///< whether its overloads take an error handler
  int catalogued_rows;  ///< how many rows the catalogue states; the table holds those that exist
  const implementation_table& (*table)();
  sycl::event (*dispatch)(const input::vxx&);
};

/// All families of public functions in alphabetical order.
std::span<const family> families();

/// The families of the library's own element-wise utilities, likewise.
std::span<const family> utility_families();

}  // namespace arbor::lumen::vm::detail
