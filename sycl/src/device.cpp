// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "sycl/device.hpp"

#include <numeric>
#include <utility>

#include "device_impl.hpp"
#include "sycl/exception.hpp"
#include "sycl/platform.hpp"
#include "sycl/selector.hpp"

namespace sycl {

device::device() : device(default_selector_v) {}

backend device::get_backend() const noexcept { return impl_->description.from; }
bool device::is_cpu() const { return has(aspect::cpu); }
bool device::is_gpu() const { return has(aspect::gpu); }
bool device::is_accelerator() const { return has(aspect::accelerator); }
bool device::has(aspect asp) const { return impl_->has(asp); }

platform device::get_platform() const {
  return detail::handle_access::make<platform>(detail::find_platform(impl_->platform));
}

std::vector<device> device::get_devices(info::device_type type) {
  std::vector<device> result;
  for (const platform& each : platform::get_platforms()) {
    const std::vector<device> devices = each.get_devices(type);
    result.insert(result.end(), devices.begin(), devices.end());
  }
  return result;
}

namespace {

using parts = std::vector<device>;

void check_partition(bool supported) {
  if (!supported) {
    throw exception(errc::feature_not_supported, "the device cannot be partitioned in this way");
  }
}

void add_part(parts& result, const std::shared_ptr<detail::device_impl>& whole, std::size_t units,
              info::partition_property how, info::partition_affinity_domain domain) {
  result.push_back(detail::handle_access::make<device>(std::make_shared<detail::device_impl>(
      whole, static_cast<std::uint32_t>(units), how, domain)));
}

}  // namespace

std::vector<device> device::partition_equally(std::size_t count) const {
  check_partition(impl_->compute_units > 1);
  if (count == 0 || count > impl_->compute_units) {
    throw exception(errc::invalid, "the device has not so many compute units");
  }
  parts result;
  for (std::size_t used = 0; used + count <= impl_->compute_units; used += count) {
    add_part(result, impl_, count, info::partition_property::partition_equally,
             info::partition_affinity_domain::not_applicable);
  }
  return result;
}

std::vector<device> device::partition_by_counts(const std::vector<std::size_t>& counts) const {
  check_partition(impl_->compute_units > 1);
  std::size_t left = impl_->compute_units;
  for (const std::size_t count : counts) {
    if (count == 0 || count > left) {
      throw exception(errc::invalid, "the device has not so many compute units");
    }
    left -= count;
  }
  parts result;
  for (const std::size_t count : counts) {
    add_part(result, impl_, count, info::partition_property::partition_by_counts,
             info::partition_affinity_domain::not_applicable);
  }
  return result;
}

std::vector<device> device::partition_by_affinity_domain(
    info::partition_affinity_domain domain) const {
  const std::uint32_t count = impl_->description.sub_devices;
  check_partition(count > 1 && (domain == info::partition_affinity_domain::numa ||
                                domain == info::partition_affinity_domain::next_partitionable));
  parts result;
  for (std::uint32_t i = 0; i < count; ++i) {
    // The first devices get what does not divide evenly.
    const std::uint32_t units =
        impl_->compute_units / count + (i < impl_->compute_units % count ? 1 : 0);
    add_part(result, impl_, units, info::partition_property::partition_by_affinity_domain,
             info::partition_affinity_domain::numa);
  }
  return result;
}

}  // namespace sycl
