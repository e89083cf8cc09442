// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

#include "sycl/aspect.hpp"
#include "sycl/backend.hpp"
#include "sycl/detail/handle.hpp"
#include "sycl/info.hpp"

namespace sycl::detail {

/// What LUMEN_SYCL_DEVICES says of a device.
struct device_description {
  info::device_type type = info::device_type::cpu;
  /// Set where the list says so; the processor's own values hold otherwise.
  std::optional<std::uint32_t> vendor;
  std::optional<std::uint32_t> id;
  std::optional<std::string> name;
  bool fp64 = true;
  bool fp16 = true;
  std::uint32_t sub_devices = 1;
  backend from = backend::host;
};

/// errc::runtime, naming the text that is no part of the grammar.
std::vector<device_description> parse_devices(const std::string& text);

class device_impl {
 public:
  device_impl(device_description described, const platform_impl* owner);
  /// A part of `whole`.
  device_impl(std::shared_ptr<device_impl> whole, std::uint32_t units, info::partition_property how,
              info::partition_affinity_domain domain);

  bool has(aspect asp) const noexcept;
  bool is_part_of(const device_impl& whole) const noexcept;
  const device_impl& root() const noexcept { return parent ? parent->root() : *this; }

  const device_description description;
  const platform_impl* const platform;
  const std::shared_ptr<device_impl> parent;
  const std::uint32_t compute_units;
  const info::partition_property partitioned_by = info::partition_property::no_partition;
  const info::partition_affinity_domain domain = info::partition_affinity_domain::not_applicable;
};

class platform_impl {
 public:
  platform_impl(backend stands_on, std::uint32_t vendor_number, std::string vendor_name);
  ~platform_impl();

  const backend from;
  const std::uint32_t vendor;
  const std::string vendor_name;
  std::vector<std::shared_ptr<device_impl>> devices;

  mutable std::mutex default_context_mutex;
  mutable std::shared_ptr<context_impl> default_context;
};

/// All platforms, as LUMEN_SYCL_DEVICES has them when this is first called. They live as long as
/// the process.
const std::vector<std::shared_ptr<platform_impl>>& all_platforms();
std::vector<std::shared_ptr<device_impl>> all_devices();
std::shared_ptr<platform_impl> find_platform(const platform_impl* wanted);

}  // namespace sycl::detail
