// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

#include "aspect.hpp"
#include "atomic_ref.hpp"
#include "range.hpp"

namespace sycl {

class platform;
class device;
class context;

namespace info {

enum class device_type : std::uint32_t { cpu, gpu, accelerator, custom, automatic, host, all };

enum class partition_property : int {
  no_partition = 0,
  partition_equally = 1,
  partition_by_counts = 2,
  partition_by_affinity_domain = 3,
};

enum class partition_affinity_domain : int {
  not_applicable = 0,
  numa = 1,
  L4_cache = 2,
  L3_cache = 4,
  L2_cache = 8,
  L1_cache = 16,
  next_partitionable = 32,
};

enum class local_mem_type : int { none, local, global };

enum class fp_config : int {
  denorm,
  inf_nan,
  round_to_nearest,
  round_to_zero,
  round_to_inf,
  fma,
  correctly_rounded_divide_sqrt,
  soft_float,
};

enum class global_mem_cache_type : int { none, read_only, read_write };

enum class execution_capability : unsigned int { exec_kernel, exec_native_kernel };

enum class event_command_status : int { submitted = 0, running = 1, complete = 2 };

#define SYCL_DETAIL_INFO(type, name) \
  struct name {                      \
    using return_type = type;        \
  };

namespace platform {
SYCL_DETAIL_INFO(std::string, profile)
SYCL_DETAIL_INFO(std::string, version)
SYCL_DETAIL_INFO(std::string, name)
SYCL_DETAIL_INFO(std::string, vendor)
SYCL_DETAIL_INFO(std::vector<std::string>, extensions)
}  // namespace platform

namespace context {
SYCL_DETAIL_INFO(sycl::platform, platform)
SYCL_DETAIL_INFO(std::vector<sycl::device>, devices)
SYCL_DETAIL_INFO(std::vector<sycl::memory_order>, atomic_memory_order_capabilities)
SYCL_DETAIL_INFO(std::vector<sycl::memory_order>, atomic_fence_order_capabilities)
SYCL_DETAIL_INFO(std::vector<sycl::memory_scope>, atomic_memory_scope_capabilities)
SYCL_DETAIL_INFO(std::vector<sycl::memory_scope>, atomic_fence_scope_capabilities)
}  // namespace context

namespace device {
SYCL_DETAIL_INFO(info::device_type, device_type)
SYCL_DETAIL_INFO(std::uint32_t, vendor_id)
SYCL_DETAIL_INFO(std::uint32_t, max_compute_units)
SYCL_DETAIL_INFO(std::uint32_t, max_work_item_dimensions)
template <int Dimensions = 3>
struct max_work_item_sizes {
  using return_type = range<Dimensions>;
};
SYCL_DETAIL_INFO(std::size_t, max_work_group_size)
SYCL_DETAIL_INFO(std::uint32_t, max_num_sub_groups)
SYCL_DETAIL_INFO(std::vector<std::size_t>, sub_group_sizes)
SYCL_DETAIL_INFO(bool, sub_group_independent_forward_progress)
SYCL_DETAIL_INFO(std::uint32_t, preferred_vector_width_char)
SYCL_DETAIL_INFO(std::uint32_t, preferred_vector_width_short)
SYCL_DETAIL_INFO(std::uint32_t, preferred_vector_width_int)
SYCL_DETAIL_INFO(std::uint32_t, preferred_vector_width_long)
SYCL_DETAIL_INFO(std::uint32_t, preferred_vector_width_float)
SYCL_DETAIL_INFO(std::uint32_t, preferred_vector_width_double)
SYCL_DETAIL_INFO(std::uint32_t, preferred_vector_width_half)
SYCL_DETAIL_INFO(std::uint32_t, native_vector_width_char)
SYCL_DETAIL_INFO(std::uint32_t, native_vector_width_short)
SYCL_DETAIL_INFO(std::uint32_t, native_vector_width_int)
SYCL_DETAIL_INFO(std::uint32_t, native_vector_width_long)
SYCL_DETAIL_INFO(std::uint32_t, native_vector_width_float)
SYCL_DETAIL_INFO(std::uint32_t, native_vector_width_double)
SYCL_DETAIL_INFO(std::uint32_t, native_vector_width_half)
SYCL_DETAIL_INFO(std::uint32_t, max_clock_frequency)
SYCL_DETAIL_INFO(std::uint32_t, address_bits)
SYCL_DETAIL_INFO(std::uint64_t, max_mem_alloc_size)
SYCL_DETAIL_INFO(bool, image_support)
SYCL_DETAIL_INFO(std::size_t, max_parameter_size)
SYCL_DETAIL_INFO(std::uint32_t, mem_base_addr_align)
SYCL_DETAIL_INFO(std::vector<info::fp_config>, half_fp_config)
SYCL_DETAIL_INFO(std::vector<info::fp_config>, single_fp_config)
SYCL_DETAIL_INFO(std::vector<info::fp_config>, double_fp_config)
SYCL_DETAIL_INFO(info::global_mem_cache_type, global_mem_cache_type)
SYCL_DETAIL_INFO(std::uint32_t, global_mem_cache_line_size)
SYCL_DETAIL_INFO(std::uint64_t, global_mem_cache_size)
SYCL_DETAIL_INFO(std::uint64_t, global_mem_size)
SYCL_DETAIL_INFO(info::local_mem_type, local_mem_type)
SYCL_DETAIL_INFO(std::uint64_t, local_mem_size)
SYCL_DETAIL_INFO(bool, error_correction_support)
SYCL_DETAIL_INFO(bool, host_unified_memory)
SYCL_DETAIL_INFO(std::vector<sycl::memory_order>, atomic_memory_order_capabilities)
SYCL_DETAIL_INFO(std::vector<sycl::memory_order>, atomic_fence_order_capabilities)
SYCL_DETAIL_INFO(std::vector<sycl::memory_scope>, atomic_memory_scope_capabilities)
SYCL_DETAIL_INFO(std::vector<sycl::memory_scope>, atomic_fence_scope_capabilities)
SYCL_DETAIL_INFO(std::size_t, profiling_timer_resolution)
SYCL_DETAIL_INFO(bool, is_endian_little)
SYCL_DETAIL_INFO(bool, is_available)
SYCL_DETAIL_INFO(bool, is_compiler_available)
SYCL_DETAIL_INFO(bool, is_linker_available)
SYCL_DETAIL_INFO(std::vector<info::execution_capability>, execution_capabilities)
SYCL_DETAIL_INFO(bool, queue_profiling)
SYCL_DETAIL_INFO(std::vector<std::string>, built_in_kernels)
SYCL_DETAIL_INFO(sycl::platform, platform)
SYCL_DETAIL_INFO(std::string, name)
SYCL_DETAIL_INFO(std::string, vendor)
SYCL_DETAIL_INFO(std::string, driver_version)
SYCL_DETAIL_INFO(std::string, profile)
SYCL_DETAIL_INFO(std::string, version)
SYCL_DETAIL_INFO(std::string, backend_version)
SYCL_DETAIL_INFO(std::vector<sycl::aspect>, aspects)
SYCL_DETAIL_INFO(std::vector<std::string>, extensions)
SYCL_DETAIL_INFO(std::size_t, printf_buffer_size)
SYCL_DETAIL_INFO(bool, preferred_interop_user_sync)
SYCL_DETAIL_INFO(sycl::device, parent_device)
SYCL_DETAIL_INFO(std::uint32_t, partition_max_sub_devices)
SYCL_DETAIL_INFO(std::vector<info::partition_property>, partition_properties)
SYCL_DETAIL_INFO(std::vector<info::partition_affinity_domain>, partition_affinity_domains)
SYCL_DETAIL_INFO(info::partition_property, partition_type_property)
SYCL_DETAIL_INFO(info::partition_affinity_domain, partition_type_affinity_domain)
}  // namespace device

namespace queue {
SYCL_DETAIL_INFO(sycl::context, context)
SYCL_DETAIL_INFO(sycl::device, device)
}  // namespace queue

namespace event {
SYCL_DETAIL_INFO(info::event_command_status, command_execution_status)
}  // namespace event

namespace event_profiling {
SYCL_DETAIL_INFO(std::uint64_t, command_submit)
SYCL_DETAIL_INFO(std::uint64_t, command_start)
SYCL_DETAIL_INFO(std::uint64_t, command_end)
}  // namespace event_profiling

}  // namespace info

namespace ext::norvane::info::device {
/// The model number of a device with aspect::ext_norvane_device_id.
SYCL_DETAIL_INFO(std::uint32_t, device_id)
}  // namespace ext::norvane::info::device

#undef SYCL_DETAIL_INFO

}  // namespace sycl
