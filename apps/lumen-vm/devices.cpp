// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <algorithm>
#include <cstdio>
#include <string>

#include "choice.hpp"
#include "commands.hpp"
#include "dispatch/device_word.hpp"
#include "words.hpp"

namespace arbor::lumen::vm::tool {

int devices() {
  const auto devices = all_devices();
  std::vector<std::uint64_t> device_words_of;
  std::size_t width = std::string("in words").size();
  for (const numbered_device& entry : devices) {
    const std::uint64_t word = detail::device_word::classify(entry.device);
    width = std::max(width, device_words(word).size());
    device_words_of.push_back(word);
  }
  const int columns = static_cast<int>(width);
  std::printf("%6s  %-18s  %-*s  %s\n", "number", "device word", columns, "in words", "name");
  for (std::size_t i = 0; i < devices.size(); ++i) {
    const std::uint64_t word = device_words_of[i];
    const auto name = devices[i].device.get_info<sycl::info::device::name>();
    std::printf("%6zu  %-18s  %-*s  %s\n", devices[i].number, hex(word, 16).c_str(), columns,
                device_words(word).c_str(), name.c_str());
  }
  return 0;
}

}  // namespace arbor::lumen::vm::tool
