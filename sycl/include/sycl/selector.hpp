// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <initializer_list>
#include <type_traits>
#include <vector>

#include "aspect.hpp"
#include "detail/export.hpp"
#include "device.hpp"

namespace sycl {

namespace detail {

struct ARBOR_LUMEN_SYCL_API default_selector {
  int operator()(const device& candidate) const;
};
struct ARBOR_LUMEN_SYCL_API cpu_selector {
  int operator()(const device& candidate) const;
};
struct ARBOR_LUMEN_SYCL_API gpu_selector {
  int operator()(const device& candidate) const;
};
struct ARBOR_LUMEN_SYCL_API accelerator_selector {
  int operator()(const device& candidate) const;
};

class ARBOR_LUMEN_SYCL_API aspect_based_selector {
 public:
  aspect_based_selector(std::vector<aspect> required, std::vector<aspect> denied)
      : required_(std::move(required)), denied_(std::move(denied)) {}
  int operator()(const device& candidate) const;

 private:
  std::vector<aspect> required_;
  std::vector<aspect> denied_;
};

}  // namespace detail

/// Prefers a GPU to an accelerator to the CPU.
inline constexpr detail::default_selector default_selector_v{};
inline constexpr detail::cpu_selector cpu_selector_v{};
inline constexpr detail::gpu_selector gpu_selector_v{};
inline constexpr detail::accelerator_selector accelerator_selector_v{};

/// Selects a device that has all required aspects and none of the denied ones.
inline detail::aspect_based_selector aspect_selector(const std::vector<aspect>& required,
                                                     const std::vector<aspect>& denied = {}) {
  return {required, denied};
}
template <typename... Aspects>
requires(std::is_same_v<Aspects, aspect>&&...) detail::aspect_based_selector
    aspect_selector(Aspects... required) {
  return {{required...}, {}};
}
template <aspect... Required>
detail::aspect_based_selector aspect_selector() {
  return {{Required...}, {}};
}

}  // namespace sycl
