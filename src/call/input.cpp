// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "call/input.hpp"

#include <algorithm>
#include <stdexcept>
#include <string>

#include "arbor/lumen/exception.hpp"

namespace arbor::lumen::vm::detail::input {

void throw_logic_error(std::string_view name, const char* message) {
  throw std::logic_error(
      std::string("ArborLumen::vm::detail::input::").append(name).append(": ").append(message));
}

vxx::~vxx() = default;

void vxx::reject_index(const char* message) const { throw_logic_error(name, message); }

std::int64_t vxx::shortest_length() const {
  bool any = false;
  std::int64_t shortest = 0;
  for (const auto* lengths : {&in_lengths, &out_lengths}) {
    for (const std::int64_t length : *lengths) {
      shortest = any ? std::min(shortest, length) : length;
      any = true;
    }
  }
  return shortest;
}

bool vxx::check(bool throw_on_error) const {
  if (queue == nullptr) throw_logic_error(name, "q is nullptr");
  const std::int64_t shortest = shortest_length();
  if (shortest == 0 || n < 1 || n <= shortest) return true;
  if (throw_on_error) throw invalid_argument("vm", name, "insufficient length of arguments");
  return false;
}

std::uint64_t vxx::precision() const { return 0xff00000000; }

std::int64_t vxx::effective_count() const {
  if (n != 0) return std::max<std::int64_t>(n, 0);
  return has_slices() ? 0 : shortest_length();
}

template <typename T, typename U>
bool typed_vxx<T, U>::check(bool throw_on_error) const {
  if (!vxx::check(throw_on_error)) return false;
  if (n >= 0) return true;
  if (throw_on_error) throw invalid_argument("vm", name, "negative length");
  return false;
}

#define LUMEN_INSTANTIATE(T, U) template class typed_vxx<T, U>;
LUMEN_FOR_EACH_PAIR(LUMEN_INSTANTIATE)
#undef LUMEN_INSTANTIATE

}  // namespace arbor::lumen::vm::detail::input
