// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "device_impl.hpp"

#include <algorithm>
#include <thread>
#include <utility>

#include "context_impl.hpp"
#include "environment.hpp"
#include "processor.hpp"

namespace sycl::detail {

device_impl::device_impl(device_description described, const platform_impl* owner)
    : description(std::move(described)),
      platform(owner),
      compute_units(std::max({1U, std::thread::hardware_concurrency(), description.sub_devices})) {}

namespace {

device_description without_parts(device_description whole) {
  whole.sub_devices = 1;
  return whole;
}

}  // namespace

device_impl::device_impl(std::shared_ptr<device_impl> whole, std::uint32_t units,
                         info::partition_property how, info::partition_affinity_domain by_domain)
    : description(without_parts(whole->description)),
      platform(whole->platform),
      parent(std::move(whole)),
      compute_units(units),
      partitioned_by(how),
      domain(by_domain) {}

bool device_impl::has(aspect asp) const noexcept {
  switch (asp) {
    case aspect::cpu:
      return description.type == info::device_type::cpu;
    case aspect::gpu:
      return description.type == info::device_type::gpu;
    case aspect::accelerator:
      return description.type == info::device_type::accelerator;
    case aspect::emulated:
      return description.type != info::device_type::cpu;
    case aspect::fp16:
      return description.fp16;
    case aspect::fp64:
      return description.fp64;
    case aspect::usm_system_allocations:
      return description.type == info::device_type::cpu;
    case aspect::ext_norvane_device_id:
      return description.id.has_value();
    case aspect::host_debuggable:
    case aspect::atomic64:
    case aspect::queue_profiling:
    case aspect::usm_device_allocations:
    case aspect::usm_host_allocations:
    case aspect::usm_atomic_host_allocations:
    case aspect::usm_shared_allocations:
    case aspect::usm_atomic_shared_allocations:
      return true;
    case aspect::custom:
    case aspect::image:
    case aspect::online_compiler:
    case aspect::online_linker:
      break;
  }
  return false;
}

bool device_impl::is_part_of(const device_impl& whole) const noexcept {
  return this == &whole || (parent != nullptr && parent->is_part_of(whole));
}

platform_impl::platform_impl(backend stands_on, std::uint32_t vendor_number, std::string name)
    : from(stands_on), vendor(vendor_number), vendor_name(std::move(name)) {}

platform_impl::~platform_impl() = default;

namespace {

std::vector<std::shared_ptr<platform_impl>>* make_platforms() {
  const std::optional<std::string> text = environment("LUMEN_SYCL_DEVICES");
  const std::vector<device_description> listed =
      !text || text->empty() ? std::vector<device_description>(1) : parse_devices(*text);

  auto platforms = std::make_unique<std::vector<std::shared_ptr<platform_impl>>>();
  for (const device_description& each : listed) {
    const std::uint32_t vendor = each.vendor.value_or(0);
    const auto found = std::find_if(platforms->begin(), platforms->end(), [&](const auto& known) {
      return known->from == each.from && known->vendor == vendor;
    });
    std::shared_ptr<platform_impl> owner;
    if (found != platforms->end()) {
      owner = *found;
    } else {
      owner = std::make_shared<platform_impl>(each.from, vendor, vendor_text(each));
      platforms->push_back(owner);
    }
    // Devices live as long as the process, so their handles count nothing.
    owner->devices.emplace_back(std::shared_ptr<void>(), new device_impl(each, owner.get()));
  }
  return platforms.release();
}

}  // namespace

const std::vector<std::shared_ptr<platform_impl>>& all_platforms() {
  // Static objects may use devices in their destructors.
  static const std::vector<std::shared_ptr<platform_impl>>& platforms = *make_platforms();
  return platforms;
}

std::vector<std::shared_ptr<device_impl>> all_devices() {
  std::vector<std::shared_ptr<device_impl>> result;
  for (const std::shared_ptr<platform_impl>& each : all_platforms()) {
    result.insert(result.end(), each->devices.begin(), each->devices.end());
  }
  return result;
}

std::shared_ptr<platform_impl> find_platform(const platform_impl* wanted) {
  for (const std::shared_ptr<platform_impl>& each : all_platforms()) {
    if (each.get() == wanted) return each;
  }
  return nullptr;
}

}  // namespace sycl::detail
