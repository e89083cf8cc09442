// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "choice.hpp"

#include <algorithm>
#include <charconv>
#include <numeric>
#include <optional>
#include <string_view>

#include "call/mode_word.hpp"
#include "dispatch/device_word.hpp"
#include "element_types.hpp"

namespace arbor::lumen::vm::tool {
namespace {

/// How many letters have to be put in, left out or replaced to make `a` of `b`.
std::size_t edit_distance(std::string_view a, std::string_view b) {
  std::vector<std::size_t> row(b.size() + 1);
  std::iota(row.begin(), row.end(), std::size_t{0});
  for (std::size_t i = 0; i < a.size(); ++i) {
    std::size_t diagonal = row[0];
    row[0] = i + 1;
    for (std::size_t j = 0; j < b.size(); ++j) {
      const std::size_t replaced = diagonal + (a[i] == b[j] ? 0 : 1);
      diagonal = row[j + 1];
      row[j + 1] = std::min({replaced, row[j] + 1, diagonal + 1});
    }
  }
  return row[b.size()];
}

/// The names that `name` may have been meant for: those that are spelled most alike, and those that
/// begin with it.
std::vector<std::string> near_names(std::string_view name) {
  std::size_t nearest = name.size() < 4 ? 1 : 2;
  for (const detail::family& family : detail::families())
    nearest = std::min(nearest, edit_distance(name, family.name));
  std::vector<std::string> names;
  for (const detail::family& family : detail::families()) {
    if (edit_distance(name, family.name) == nearest ||
        (name.size() > 1 && std::string_view(family.name).starts_with(name)))
      names.emplace_back(family.name);
  }
  return names;
}

std::string enumerate(const std::vector<std::string>& words, const std::string& last_joint) {
  std::string text;
  for (std::size_t i = 0; i < words.size(); ++i) {
    if (i > 0) text += i + 1 == words.size() ? last_joint : ", ";
    text += words[i];
  }
  return text;
}

const detail::family& find_family(const std::string& name) {
  for (const detail::family& family : detail::families()) {
    if (name == family.name) return family;
  }
  const auto names = near_names(name);
  throw usage_error("there is no function \"" + name + "\"; " +
                    (names.empty() ? "\"lumen-vm functions\" lists all"
                                   : "did you mean " + enumerate(names, " or ") + "?"));
}

char find_type(const detail::family& family, const std::string& type) {
  const std::string_view types = family.types;
  if (type.size() == 1 && types.find(type[0]) != std::string_view::npos) return type[0];
  std::vector<std::string> served;
  for (const char letter : types)
    served.push_back(std::string(1, letter) + " (" + element_name(letter) + ")");
  throw usage_error(std::string(family.name) + " has no element type \"" + type + "\"; it has " +
                    enumerate(served, " and "));
}

template <typename Number>
std::optional<Number> parse_whole(std::string_view text, int base) {
  Number value{};
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value, base);
  if (error != std::errc{} || end != text.data() + text.size()) return std::nullopt;
  return value;
}

std::uint32_t mode_argument(const std::string& text) {
  if (text.empty()) return enums::not_defined;
  if (text == "ha") return enums::ha;
  if (text == "la") return enums::la;
  if (text == "ep") return enums::ep;
  if (text.starts_with("0x") || text.starts_with("0X")) {
    if (const auto word = parse_whole<std::uint32_t>(std::string_view(text).substr(2), 16))
      return *word;
  }
  throw usage_error("\"" + text +
                    "\" is no mode; a mode is ha, la, ep or a word of 32 bits in "
                    "hexadecimal, such as 0x100004");
}

numbered_device default_device(const std::vector<numbered_device>& devices) {
  const sycl::device preferred;
  for (const numbered_device& candidate : devices) {
    if (candidate.device == preferred) return candidate;
  }
  throw std::runtime_error("the default device is not among the devices");
}

numbered_device find_device(const std::string& text) {
  const auto devices = all_devices();
  if (text.empty()) return default_device(devices);
  const auto number = parse_whole<std::size_t>(text, 10);
  if (!number && text != "cpu" && text != "gpu")
    throw usage_error("\"" + text + "\" is no device; a device is cpu, gpu or a number");
  for (const numbered_device& candidate : devices) {
    if (number          ? *number == candidate.number
        : text == "cpu" ? candidate.device.is_cpu()
                        : candidate.device.is_gpu())
      return candidate;
  }
  throw usage_error("there is no device " + text + "; \"lumen-vm devices\" lists those there are");
}

}  // namespace

std::vector<numbered_device> all_devices() {
  std::vector<numbered_device> devices;
  for (const sycl::device& device : sycl::device::get_devices())
    devices.push_back({devices.size(), device});
  return devices;
}

char output_letter(const detail::family& family, char in) {
  return family.output_types[std::string_view(family.types).find(in)];
}

chosen_call choose(const call_request& request) {
  const detail::family& family = find_family(request.function);
  const char in = find_type(family, request.type);
  std::uint32_t mode = detail::mode_word::merge(enums::default_mode, mode_argument(request.mode));
  if (request.cyclic) mode = detail::mode_word::merge(mode, enums::slice_cyclic);
  const numbered_device device = find_device(request.device);
  return {
      family, in, output_letter(family, in), device, detail::device_word::classify(device.device),
      mode};
}

}  // namespace arbor::lumen::vm::tool
