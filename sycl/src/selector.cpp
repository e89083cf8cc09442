// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "sycl/selector.hpp"

#include <algorithm>

#include "sycl/exception.hpp"

namespace sycl::detail {

namespace {
constexpr int accepted = 1;
constexpr int rejected = -1;
}  // namespace

device select_device(selector_ref selector) {
  int best = -1;
  const std::vector<device> candidates = device::get_devices();
  const device* chosen = nullptr;
  for (const device& candidate : candidates) {
    const int score = selector.score(selector.object, candidate);
    if (score > best) {
      best = score;
      chosen = &candidate;
    }
  }
  if (chosen == nullptr) throw exception(errc::runtime, "no device of the wanted kind");
  return *chosen;
}

int default_selector::operator()(const device& candidate) const {
  if (candidate.is_gpu()) return 3;
  return candidate.is_accelerator() ? 2 : 1;
}

int cpu_selector::operator()(const device& candidate) const {
  return candidate.is_cpu() ? accepted : rejected;
}

int gpu_selector::operator()(const device& candidate) const {
  return candidate.is_gpu() ? accepted : rejected;
}

int accelerator_selector::operator()(const device& candidate) const {
  return candidate.is_accelerator() ? accepted : rejected;
}

int aspect_based_selector::operator()(const device& candidate) const {
  const auto has = [&](aspect asp) { return candidate.has(asp); };
  const bool suits = std::all_of(required_.begin(), required_.end(), has) &&
                     std::none_of(denied_.begin(), denied_.end(), has);
  return suits ? accepted : rejected;
}

}  // namespace sycl::detail
