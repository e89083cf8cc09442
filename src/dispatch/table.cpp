// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "dispatch/table.hpp"

#include <algorithm>
#include <bit>

namespace arbor::lumen::vm::detail {

implementation_table::implementation_table(std::initializer_list<row> rows)
    : slots_(std::bit_ceil(std::max<std::size_t>(2 * rows.size(), 8))), mask_(slots_.size() - 1) {
  for (const row& r : rows) {
    slot& place = slots_[place_of(r.key)];
    if (place.key != 0) continue;
    place = {r.key, {r.run, r.implementation}};
    ++size_;
  }
}

}  // namespace arbor::lumen::vm::detail
