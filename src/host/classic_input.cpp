// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "host/classic_input.hpp"

#include "arbor/lumen/exception.hpp"

namespace arbor::lumen::vm::detail::classic::input {

vxx::~vxx() = default;

bool vxx::check(bool throw_on_error) const {
  if (n >= 0) return true;
  if (throw_on_error) throw invalid_argument("VM", name, "negative length for classic call");
  return false;
}

void vxx::reject_index(const char* message) const {
  detail::input::throw_logic_error(name, message);
}

}  // namespace arbor::lumen::vm::detail::classic::input
