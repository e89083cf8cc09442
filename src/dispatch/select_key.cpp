// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "dispatch/select_key.hpp"

#include "call/mode_word.hpp"
#include "dispatch/device_word.hpp"
#include "dispatch/key.hpp"

namespace arbor::lumen::vm::detail {

candidate_list kernel_candidates(std::uint64_t precision, std::uint64_t device_word,
                                 std::uint32_t mode) {
  constexpr std::uint64_t cast = key::half | key::gpu | key::fp32cast;
  const bool half = precision == key::half;
  candidate_list candidates;
  if ((device_word & device_word::gpu) != 0) {
    if ((device_word & device_word::nofp64) != 0) return candidates;
    candidates.push_front(precision | key::gpu | key::fp64only);
    candidates.push_front(precision | key::gpu | key::gen);
    candidates.push_front(precision | key::gpu | key::nolut);
    if (half) {
      candidates.push_back(cast | key::nolut);
      candidates.push_back(cast | key::gen);
      candidates.push_back(cast | key::fp64only);
    }
  } else if ((device_word & device_word::cpu) != 0) {
    if (half) {
      candidates.push_front(cast | key::fp64only);
      candidates.push_front(cast | key::gen);
      candidates.push_front(cast | key::nolut);
    }
    if ((mode & mode_word::slice_policy) == enums::slice_cyclic) {
      candidates.push_front(precision | key::gpu | key::fp64only);
      candidates.push_front(precision | key::gpu | key::gen);
    }
  }
  return candidates;
}

keyed_row select_row(std::uint64_t precision, std::uint64_t device_word, std::uint32_t mode,
                     const implementation_table& table) {
  const implementation_table::entry* entry = nullptr;
  const std::uint64_t key =
      search(precision, device_word, mode, [&](search_pass, std::uint64_t candidate) {
        entry = table.find(candidate);
        return entry != nullptr;
      });
  return {key, entry};
}

std::uint64_t select_key(std::uint64_t precision, std::uint64_t device_word, std::uint32_t mode,
                         const implementation_table& table) {
  return select_row(precision, device_word, mode, table).key;
}

}  // namespace arbor::lumen::vm::detail
