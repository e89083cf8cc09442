// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The choice of a row a second time, as a search of written-out lists for a row of the catalogue.
/// It shares nothing with the library but the documented rule.
#pragma once

#include <map>
#include <optional>
#include <string>
#include <vector>

#include "dispatch/catalogue.hpp"

namespace arbor::lumen::tests {

enum class device_class { gpu_with_double, gpu_without_double, cpu, accelerator };

/// What a call asks for, as far as the choice depends on it.
struct request {
  char type;
  std::string tier;  ///< ha, la or ep
  device_class device;
  bool cyclic;
  bool relaxed;  ///< the host, and on a GPU lower accuracies too
  bool host;     ///< the host
};

/// Kernel variants in search order; a star marks those of half that compute in float.
inline const std::vector<std::string>& search_order(device_class device, bool half, bool cyclic) {
  static const std::vector<std::string> none;
  static const std::vector<std::string> on_gpu{"nolut", "gen", "fp64only"};
  static const std::vector<std::string> half_on_gpu{"nolut",  "gen",  "fp64only",
                                                    "nolut*", "gen*", "fp64only*"};
  static const std::vector<std::string> cyclic_on_cpu{"gen", "fp64only"};
  static const std::vector<std::string> half_on_cpu{"nolut*", "gen*", "fp64only*"};
  static const std::vector<std::string> half_cyclic_on_cpu{"gen", "fp64only", "nolut*", "gen*",
                                                           "fp64only*"};
  if (device == device_class::gpu_with_double) return half ? half_on_gpu : on_gpu;
  if (device == device_class::cpu && half) return cyclic ? half_cyclic_on_cpu : half_on_cpu;
  if (device == device_class::cpu && cyclic) return cyclic_on_cpu;
  return none;
}

class reference_choice {
 public:
  explicit reference_choice(const std::vector<catalogued_row>& rows) {
    for (const catalogued_row& row : rows)
      rows_.emplace(row.feature + (row.cast ? "*" : "") + " " + row.type + " " + row.tier, row);
  }

  std::optional<catalogued_row> operator()(const request& wanted) const {
    static const std::map<std::string, std::vector<std::string>> at_least{
        {"ha", {"ha"}}, {"la", {"la", "ha"}}, {"ep", {"ep", "la", "ha"}}};
    const auto& variants = search_order(wanted.device, wanted.type == 'h', wanted.cyclic);
    if (auto row = first(variants, wanted.type, at_least.at(wanted.tier))) return row;
    const bool gpu = wanted.device == device_class::gpu_with_double ||
                     wanted.device == device_class::gpu_without_double;
    if (wanted.relaxed && gpu) {
      if (auto row = first(variants, wanted.type, {"ha", "la", "ep"})) return row;
    }
    if (wanted.relaxed || wanted.host)
      return first({"classic"}, wanted.type, at_least.at(wanted.tier));
    return std::nullopt;
  }

 private:
  std::optional<catalogued_row> first(const std::vector<std::string>& variants, char type,
                                      const std::vector<std::string>& tiers) const {
    for (const std::string& tier : tiers) {
      for (const std::string& variant : variants) {
        const auto row = rows_.find(variant + " " + type + " " + tier);
        if (row != rows_.end()) return row->second;
      }
    }
    return std::nullopt;
  }

  std::map<std::string, catalogued_row> rows_;
};

}  // namespace arbor::lumen::tests
