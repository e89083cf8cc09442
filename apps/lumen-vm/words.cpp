// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "words.hpp"

#include <cstdio>

#include "arbor/lumen/vm/enums.hpp"
#include "dispatch/device_word.hpp"
#include "dispatch/key.hpp"
#include "dispatch/texts.hpp"

namespace arbor::lumen::vm::tool {
namespace {

struct named_bit {
  std::uint64_t bit;
  const char* name;
};

// device_to_text has no words for these.
constexpr named_bit device_classes[] = {{detail::device_word::cpu, "cpu;"},
                                        {detail::device_word::gpu, "gpu;"}};
constexpr named_bit further_device_bits[] = {{detail::device_word::onyx, "onyx;"},
                                             {detail::device_word::jasper, "jasper;"},
                                             {detail::device_word::fp64, "fp64;"}};

constexpr named_bit features[] = {
    {detail::key::fp32cast, "fp32cast"}, {detail::key::gen, "gen"},
    {detail::key::nofp64, "nofp64"},     {detail::key::nolut, "nolut"},
    {detail::key::fp64only, "fp64only"}, {detail::key::classic, "classic"}};

constexpr named_bit statuses[] = {{enums::errdom, "errdom"},
                                  {enums::sing, "sing"},
                                  {enums::overflow, "overflow"},
                                  {enums::underflow, "underflow"},
                                  {enums::accuracy_warning, "accuracy_warning"},
                                  {enums::bad_argument, "bad_argument"}};

void append(std::string& text, const char* separator, const std::string& word) {
  if (!text.empty()) text += separator;
  text += word;
}

}  // namespace

std::string hex(std::uint64_t value, int digits) {
  char text[19];
  std::snprintf(text, sizeof text, "0x%0*llx", digits, static_cast<unsigned long long>(value));
  return text;
}

std::string device_words(std::uint64_t device_word) {
  std::string text;
  for (const named_bit& bit : device_classes) {
    if ((device_word & bit.bit) != 0) text += bit.name;
  }
  text += detail::device_to_text(device_word);
  for (const named_bit& bit : further_device_bits) {
    if ((device_word & bit.bit) != 0) text += bit.name;
  }
  return text;
}

std::string feature_words(std::uint64_t key) {
  std::string text;
  for (const named_bit& feature : features) {
    if ((key & feature.bit) != 0) append(text, " ", feature.name);
  }
  return text;
}

std::string accuracy_words(std::uint64_t key) {
  switch (key & detail::key::accuracy_field) {
    case detail::key::ha:
      return "ha";
    case detail::key::la:
      return "la";
    case detail::key::ep:
      return "ep";
    default:
      return "";
  }
}

std::string status_words(std::uint32_t status) {
  if (status == enums::success) return "success";
  std::string text;
  for (const named_bit& bit : statuses) {
    if ((status & bit.bit) == 0) continue;
    append(text, "|", bit.name);
    status &= ~static_cast<std::uint32_t>(bit.bit);
  }
  if (status != 0) append(text, "|", hex(status, 1));
  return text;
}

}  // namespace arbor::lumen::vm::tool
