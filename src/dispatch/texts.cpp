// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "dispatch/texts.hpp"

#include "call/mode_word.hpp"
#include "dispatch/device_word.hpp"
#include "dispatch/key.hpp"

namespace arbor::lumen::vm::detail {
namespace {

struct named_value {
  std::uint64_t value;
  const char* text;
};

constexpr named_value devices[] = {{key::cpu, "device: cpu; "}, {key::gpu, "device: gpu; "}};
constexpr named_value precisions[] = {{0x100000000, "precision: h/half; "},
                                      {0x400000000, "precision: s/float; "},
                                      {0x800000000, "precision: d/double; "},
                                      {0x1000000000, "precision: c/complex_float; "},
                                      {0x1800000000, "precision: z/complex_double; "}};
constexpr named_value accuracies[] = {
    {key::ha, "accuracy: ha; "}, {key::la, "accuracy: la; "}, {key::ep, "accuracy: ep; "}};
constexpr named_value features[] = {
    {key::gen, "feature: gen; "},           {key::nofp64, "feature: nofp64; "},
    {key::nolut, "feature: nolut; "},       {key::fp64only, "feature: fp64only; "},
    {key::fp32cast, "feature: fp32cast; "}, {key::classic, "feature: classic; "}};
constexpr named_value mode_accuracies[] = {{4, "acc: ha; "}, {15, "acc: ep; "}, {12, "acc: la; "}};
constexpr named_value slice_policies[] = {{enums::slice_cyclic, "slice: cyclic; "},
                                          {enums::slice_minimum, "slice: minimum; "},
                                          {enums::slice_normal, "slice: normal; "}};
// One ends in a semicolon and the other does not: callers parse these texts as they are.
constexpr named_value bad_argument_policies[] = {{enums::badarg_quiet, "badarg: quiet;"},
                                                 {enums::badarg_exception, "badarg: exception"}};
constexpr named_value device_bits[] = {{device_word::nofp64, "nofp64;"},
                                       {device_word::garnet, "garnet;"},
                                       {device_word::topaz, "topaz;"},
                                       {device_word::beryl, "beryl;"},
                                       {device_word::discrete, "discrete;"},
                                       {device_word::integrated, "integrated;"},
                                       {device_word::accelerator, "accelerator;"},
                                       {device_word::norvane, "norvane;"}};

template <std::size_t N>
const char* text_of(std::uint64_t value, const named_value (&names)[N]) {
  for (const named_value& name : names) {
    if (name.value == value) return name.text;
  }
  return "";
}

}  // namespace

std::string key_to_text(std::uint64_t key, bool with_feature) {
  std::string text;
  text += text_of(key & key::device_field, devices);
  text += text_of(key & key::precision_field, precisions);
  text += text_of(key & key::accuracy_field, accuracies);
  if (with_feature) text += text_of(key & key::feature_field, features);
  return text;
}

std::string mode_to_text(std::uint32_t mode) {
  if (mode == 0) return "not_defined";
  std::string text = text_of(mode & mode_word::accuracy, mode_accuracies);
  if ((mode & enums::global_status_report) != 0) text += "global_status_report; ";
  text += text_of(mode & mode_word::slice_policy, slice_policies);
  text += text_of(mode & mode_word::bad_argument_policy, bad_argument_policies);
  return text;
}

std::string device_to_text(std::uint64_t device_word) {
  std::string text;
  for (const named_value& bit : device_bits) {
    if ((device_word & bit.value) != 0) text += bit.text;
  }
  return text;
}

}  // namespace arbor::lumen::vm::detail
