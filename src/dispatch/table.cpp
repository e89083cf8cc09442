// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "dispatch/table.hpp"

namespace arbor::lumen::vm::detail {

implementation_table::implementation_table(std::initializer_list<row> rows) : entries_(8) {
  for (const row& r : rows) entries_.emplace(r.key, entry{r.run, r.implementation});
}

const implementation_table::entry* implementation_table::find(std::uint64_t key) const {
  const auto found = entries_.find(key);
  return found == entries_.end() ? nullptr : &found->second;
}

}  // namespace arbor::lumen::vm::detail
