// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <string>
#include <vector>

#include "device_impl.hpp"
#include "native_objects.hpp"
#include "processor.hpp"
#include "sycl/device.hpp"
#include "sycl/exception.hpp"
#include "sycl/platform.hpp"

namespace sycl {

namespace {

/// Work-groups exist in name only: there are no nd-ranges.
constexpr std::size_t work_group_size = 1024;

std::uint32_t vector_width(std::size_t element_size) {
  return detail::vector_bytes() / static_cast<std::uint32_t>(element_size);
}

std::vector<info::fp_config> fp_config(bool supported) {
  if (!supported) return {};
  return {info::fp_config::denorm,
          info::fp_config::inf_nan,
          info::fp_config::round_to_nearest,
          info::fp_config::round_to_zero,
          info::fp_config::round_to_inf,
          info::fp_config::fma,
          info::fp_config::correctly_rounded_divide_sqrt};
}

std::vector<memory_order> memory_orders() {
  return {memory_order::relaxed, memory_order::acquire, memory_order::release,
          memory_order::acq_rel, memory_order::seq_cst};
}

std::vector<memory_scope> memory_scopes() {
  return {memory_scope::work_item, memory_scope::sub_group, memory_scope::work_group,
          memory_scope::device, memory_scope::system};
}

std::vector<aspect> aspects_of(const detail::device_impl& impl) {
  std::vector<aspect> result;
  for (int number = 0; number <= static_cast<int>(aspect::ext_norvane_device_id); ++number) {
    if (impl.has(static_cast<aspect>(number))) result.push_back(static_cast<aspect>(number));
  }
  return result;
}

std::uint32_t clock_frequency() {
  const std::string megahertz = detail::processor_field("cpu MHz");
  return megahertz.empty() ? 0 : static_cast<std::uint32_t>(std::stod(megahertz));
}

std::vector<info::partition_property> partitions(const detail::device_impl& impl) {
  std::vector<info::partition_property> result;
  if (impl.compute_units > 1) {
    result = {info::partition_property::partition_equally,
              info::partition_property::partition_by_counts};
  }
  if (impl.description.sub_devices > 1) {
    result.push_back(info::partition_property::partition_by_affinity_domain);
  }
  return result;
}

std::vector<info::partition_affinity_domain> affinity_domains(const detail::device_impl& impl) {
  if (impl.description.sub_devices <= 1) return {};
  return {info::partition_affinity_domain::numa,
          info::partition_affinity_domain::next_partitionable};
}

device parent_of(const detail::device_impl& impl) {
  if (impl.parent == nullptr) {
    throw exception(errc::invalid, "the device is no sub-device");
  }
  return detail::handle_access::make<device>(impl.parent);
}

std::uint32_t device_id(const detail::device_impl& impl) {
  if (!impl.description.id) {
    throw exception(errc::feature_not_supported, "the device has no device identifier");
  }
  return *impl.description.id;
}

}  // namespace

#define SYCL_DETAIL_ANSWER(query, value)                                    \
  template <>                                                               \
  ARBOR_LUMEN_SYCL_API query::return_type device::get_info<query>() const { \
    [[maybe_unused]] const detail::device_impl& impl = *impl_;              \
    return value;                                                           \
  }
#define SYCL_DETAIL_DEVICE(name, value) SYCL_DETAIL_ANSWER(info::device::name, value)

SYCL_DETAIL_DEVICE(device_type, impl.description.type)
SYCL_DETAIL_DEVICE(vendor_id, impl.description.vendor.value_or(0))
SYCL_DETAIL_DEVICE(max_compute_units, impl.compute_units)
SYCL_DETAIL_DEVICE(max_work_item_dimensions, 3)
SYCL_DETAIL_DEVICE(max_work_item_sizes<1>, range<1>(work_group_size))
SYCL_DETAIL_DEVICE(max_work_item_sizes<2>, range<2>(work_group_size, work_group_size))
SYCL_DETAIL_DEVICE(max_work_item_sizes<3>,
                   range<3>(work_group_size, work_group_size, work_group_size))
SYCL_DETAIL_DEVICE(max_work_group_size, work_group_size)
SYCL_DETAIL_DEVICE(max_num_sub_groups, static_cast<std::uint32_t>(work_group_size))
SYCL_DETAIL_DEVICE(sub_group_sizes, std::vector<std::size_t>{1})
SYCL_DETAIL_DEVICE(sub_group_independent_forward_progress, false)
SYCL_DETAIL_DEVICE(preferred_vector_width_char, vector_width(1))
SYCL_DETAIL_DEVICE(preferred_vector_width_short, vector_width(2))
SYCL_DETAIL_DEVICE(preferred_vector_width_int, vector_width(4))
SYCL_DETAIL_DEVICE(preferred_vector_width_long, vector_width(8))
SYCL_DETAIL_DEVICE(preferred_vector_width_float, vector_width(4))
SYCL_DETAIL_DEVICE(preferred_vector_width_double, impl.description.fp64 ? vector_width(8) : 0)
SYCL_DETAIL_DEVICE(preferred_vector_width_half, impl.description.fp16 ? vector_width(2) : 0)
SYCL_DETAIL_DEVICE(native_vector_width_char, vector_width(1))
SYCL_DETAIL_DEVICE(native_vector_width_short, vector_width(2))
SYCL_DETAIL_DEVICE(native_vector_width_int, vector_width(4))
SYCL_DETAIL_DEVICE(native_vector_width_long, vector_width(8))
SYCL_DETAIL_DEVICE(native_vector_width_float, vector_width(4))
SYCL_DETAIL_DEVICE(native_vector_width_double, impl.description.fp64 ? vector_width(8) : 0)
SYCL_DETAIL_DEVICE(native_vector_width_half, impl.description.fp16 ? vector_width(2) : 0)
SYCL_DETAIL_DEVICE(max_clock_frequency, clock_frequency())
SYCL_DETAIL_DEVICE(address_bits, static_cast<std::uint32_t>(8 * sizeof(void*)))
SYCL_DETAIL_DEVICE(max_mem_alloc_size, detail::physical_memory())
SYCL_DETAIL_DEVICE(image_support, false)
SYCL_DETAIL_DEVICE(max_parameter_size, std::size_t{1} << 20)
SYCL_DETAIL_DEVICE(mem_base_addr_align, detail::mem_base_addr_align_bits)
SYCL_DETAIL_DEVICE(half_fp_config, fp_config(impl.description.fp16))
SYCL_DETAIL_DEVICE(single_fp_config, fp_config(true))
SYCL_DETAIL_DEVICE(double_fp_config, fp_config(impl.description.fp64))
SYCL_DETAIL_DEVICE(global_mem_cache_type, info::global_mem_cache_type::read_write)
SYCL_DETAIL_DEVICE(global_mem_cache_line_size, detail::cache_line_size())
SYCL_DETAIL_DEVICE(global_mem_cache_size, detail::cache_size())
SYCL_DETAIL_DEVICE(global_mem_size, detail::physical_memory())
SYCL_DETAIL_DEVICE(local_mem_type, info::local_mem_type::none)
SYCL_DETAIL_DEVICE(local_mem_size, 0)
SYCL_DETAIL_DEVICE(error_correction_support, false)
SYCL_DETAIL_DEVICE(host_unified_memory, true)
SYCL_DETAIL_DEVICE(atomic_memory_order_capabilities, memory_orders())
SYCL_DETAIL_DEVICE(atomic_fence_order_capabilities, memory_orders())
SYCL_DETAIL_DEVICE(atomic_memory_scope_capabilities, memory_scopes())
SYCL_DETAIL_DEVICE(atomic_fence_scope_capabilities, memory_scopes())
SYCL_DETAIL_DEVICE(profiling_timer_resolution, 1)
SYCL_DETAIL_DEVICE(is_endian_little, __BYTE_ORDER__ == __ORDER_LITTLE_ENDIAN__)
SYCL_DETAIL_DEVICE(is_available, true)
SYCL_DETAIL_DEVICE(is_compiler_available, false)
SYCL_DETAIL_DEVICE(is_linker_available, false)
SYCL_DETAIL_DEVICE(execution_capabilities, std::vector{info::execution_capability::exec_kernel})
SYCL_DETAIL_DEVICE(queue_profiling, true)
SYCL_DETAIL_DEVICE(built_in_kernels, {})
SYCL_DETAIL_DEVICE(platform, get_platform())
SYCL_DETAIL_DEVICE(name, detail::name_text(impl.description))
SYCL_DETAIL_DEVICE(vendor, detail::vendor_text(impl.description))
SYCL_DETAIL_DEVICE(driver_version, ARBOR_LUMEN_SYCL_VERSION)
SYCL_DETAIL_DEVICE(profile, "FULL_PROFILE")
SYCL_DETAIL_DEVICE(version, "2020.0")
SYCL_DETAIL_DEVICE(backend_version, ARBOR_LUMEN_SYCL_VERSION)
SYCL_DETAIL_DEVICE(aspects, aspects_of(impl))
SYCL_DETAIL_DEVICE(extensions, {})
SYCL_DETAIL_DEVICE(printf_buffer_size, 0)
SYCL_DETAIL_DEVICE(preferred_interop_user_sync, false)
SYCL_DETAIL_DEVICE(parent_device, parent_of(impl))
SYCL_DETAIL_DEVICE(partition_max_sub_devices, partitions(impl).empty() ? 1 : impl.compute_units)
SYCL_DETAIL_DEVICE(partition_properties, partitions(impl))
SYCL_DETAIL_DEVICE(partition_affinity_domains, affinity_domains(impl))
SYCL_DETAIL_DEVICE(partition_type_property, impl.partitioned_by)
SYCL_DETAIL_DEVICE(partition_type_affinity_domain, impl.domain)
SYCL_DETAIL_ANSWER(ext::norvane::info::device::device_id, sycl::device_id(impl))

#undef SYCL_DETAIL_DEVICE
#undef SYCL_DETAIL_ANSWER

}  // namespace sycl
