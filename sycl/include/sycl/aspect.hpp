// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <type_traits>

namespace sycl {

/// Characteristics by which devices differ.
enum class aspect : int {
  cpu = 0,
  gpu = 1,
  accelerator = 2,
  custom = 3,
  emulated = 4,
  host_debuggable = 5,
  fp16 = 6,
  fp64 = 7,
  atomic64 = 8,
  image = 9,
  online_compiler = 10,
  online_linker = 11,
  queue_profiling = 12,
  usm_device_allocations = 13,
  usm_host_allocations = 14,
  usm_atomic_host_allocations = 15,
  usm_shared_allocations = 16,
  usm_atomic_shared_allocations = 17,
  usm_system_allocations = 18,
  /// The device answers ext::norvane::info::device::device_id.
  ext_norvane_device_id = 37,
};

/// Whether some device of some configuration can have the aspect.
template <aspect Aspect>
struct any_device_has
    : std::bool_constant<Aspect != aspect::custom && Aspect != aspect::image &&
                         Aspect != aspect::online_compiler && Aspect != aspect::online_linker> {};
template <aspect Aspect>
inline constexpr bool any_device_has_v = any_device_has<Aspect>::value;

/// Whether every device of every configuration has the aspect.
template <aspect Aspect>
struct all_devices_have
    : std::bool_constant<
          Aspect == aspect::host_debuggable || Aspect == aspect::atomic64 ||
          Aspect == aspect::queue_profiling || Aspect == aspect::usm_device_allocations ||
          Aspect == aspect::usm_host_allocations || Aspect == aspect::usm_shared_allocations> {};
template <aspect Aspect>
inline constexpr bool all_devices_have_v = all_devices_have<Aspect>::value;

}  // namespace sycl
