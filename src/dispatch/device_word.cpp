// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "dispatch/device_word.hpp"

#include "call/queue_store.hpp"
#include "dispatch/device_extension.hpp"

namespace arbor::lumen::vm::detail::device_word {
namespace {

std::uint64_t tier_of(std::uint32_t identifier) {
  const std::uint32_t family = identifier & 0xFF00;
  if (family == 0x1300) return gpu | integrated | garnet;
  if (family == 0x1500) return gpu | discrete | topaz;
  if (family == 0x1700) return gpu | discrete | onyx;
  if (family == 0x1900) return gpu | integrated | onyx;
  if ((identifier & 0xFFF0) == 0x1D30) return gpu | discrete | jasper;
  if (family == 0x1B00) return gpu | discrete | onyx;
  return gpu | discrete | beryl;
}

}  // namespace

std::uint64_t classify(const sycl::device& device) {
  const bool ours = device.get_info<sycl::info::device::vendor_id>() == norvane_vendor;
  const std::uint64_t vendor = ours ? norvane : 0;
  if (device.is_cpu()) return vendor | cpu;
  if (!device.is_gpu()) return vendor | accelerator;
  const bool has_double = !device.get_info<sycl::info::device::double_fp_config>().empty();
  const auto identifier = device_identifier(device);
  return vendor | (has_double ? fp64 : nofp64) |
         (identifier ? tier_of(*identifier) : gpu | discrete | beryl);
}

std::uint64_t of_queue(const keyed_queue& queue) {
  const std::uint64_t word = classify(queue.device());
  queue_store::instance().record_device_word(queue.key(), word);
  return word;
}

}  // namespace arbor::lumen::vm::detail::device_word
