// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <string>
#include <string_view>
#include <vector>

#include "device_impl.hpp"
#include "environment.hpp"
#include "sycl/exception.hpp"

namespace sycl::detail {

namespace {

[[noreturn]] void malformed(std::string_view text, const char* why) {
  throw exception(errc::runtime,
                  "LUMEN_SYCL_DEVICES: '" + std::string(text) + "' " + std::string(why));
}

std::vector<std::string_view> split(std::string_view text, char separator) {
  std::vector<std::string_view> parts;
  for (;;) {
    const std::size_t end = text.find(separator);
    parts.push_back(text.substr(0, end));
    if (end == std::string_view::npos) return parts;
    text.remove_prefix(end + 1);
  }
}

std::uint32_t number(std::string_view pair, std::string_view value, int base) {
  const std::string_view digits =
      base == 16 && (value.substr(0, 2) == "0x" || value.substr(0, 2) == "0X") ? value.substr(2)
                                                                               : value;
  const std::optional<std::uint64_t> parsed = parse_number(std::string(digits), base);
  if (!parsed || *parsed > 0xFFFFFFFFU) {
    malformed(pair, base == 16 ? "needs a hexadecimal number of 32 bits" : "needs a number");
  }
  return static_cast<std::uint32_t>(*parsed);
}

bool flag(std::string_view pair, std::string_view value) {
  if (value != "0" && value != "1") malformed(pair, "needs 0 or 1");
  return value == "1";
}

backend backend_named(std::string_view pair, std::string_view value) {
  if (value == "host") return backend::host;
  if (value == "opencl") return backend::opencl;
  if (value == "stratum") return backend::stratum;
  malformed(pair, "needs host, opencl or stratum");
}

info::device_type type_named(std::string_view value) {
  if (value == "cpu") return info::device_type::cpu;
  if (value == "gpu") return info::device_type::gpu;
  if (value == "accelerator") return info::device_type::accelerator;
  malformed(value, "is no device: cpu, gpu or accelerator");
}

device_description parse_device(std::string_view text) {
  const std::vector<std::string_view> fields = split(text, ',');
  device_description result;
  result.type = type_named(fields.front());
  std::vector<std::string_view> seen;
  for (std::size_t i = 1; i < fields.size(); ++i) {
    const std::string_view pair = fields[i];
    const std::size_t equals = pair.find('=');
    if (equals == std::string_view::npos) malformed(pair, "is not of the form key=value");
    const std::string_view key = pair.substr(0, equals);
    const std::string_view value = pair.substr(equals + 1);
    for (const std::string_view earlier : seen) {
      if (earlier == key) malformed(pair, "repeats a key");
    }
    seen.push_back(key);
    if (key == "vendor") {
      result.vendor = number(pair, value, 16);
    } else if (key == "id") {
      result.id = number(pair, value, 16);
    } else if (key == "fp64") {
      result.fp64 = flag(pair, value);
    } else if (key == "fp16") {
      result.fp16 = flag(pair, value);
    } else if (key == "subdevices") {
      result.sub_devices = number(pair, value, 10);
      if (result.sub_devices == 0 || result.sub_devices > 1024) {
        malformed(pair, "needs a number from 1 to 1024");
      }
    } else if (key == "backend") {
      result.from = backend_named(pair, value);
    } else if (key == "name") {
      if (value.empty()) malformed(pair, "needs a name");
      result.name = std::string(value);
    } else {
      malformed(pair, "has an unknown key");
    }
  }
  return result;
}

}  // namespace

std::vector<device_description> parse_devices(const std::string& text) {
  std::vector<device_description> result;
  for (const std::string_view each : split(text, ';')) result.push_back(parse_device(each));
  return result;
}

}  // namespace sycl::detail
