// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "dispatch/texts.hpp"

#include <gtest/gtest.h>

#include <cstdint>
#include <string>

#include "dispatch/dispatch_call.hpp"

namespace {

using arbor::lumen::vm::detail::device_to_text;
using arbor::lumen::vm::detail::key_to_text;
using arbor::lumen::vm::detail::mode_to_text;
using arbor::lumen::vm::detail::unserved_text;

TEST(KeyToText, NamesEachField) {
  EXPECT_EQ("device: cpu; ", key_to_text(0x10, true));
  EXPECT_EQ("device: gpu; ", key_to_text(0x20, true));
  EXPECT_EQ("precision: h/half; ", key_to_text(0x100000000, true));
  EXPECT_EQ("precision: s/float; ", key_to_text(0x400000000, true));
  EXPECT_EQ("precision: d/double; ", key_to_text(0x800000000, true));
  EXPECT_EQ("precision: c/complex_float; ", key_to_text(0x1000000000, true));
  EXPECT_EQ("precision: z/complex_double; ", key_to_text(0x1800000000, true));
  EXPECT_EQ("accuracy: ep; ", key_to_text(1, true));
  EXPECT_EQ("accuracy: la; ", key_to_text(2, true));
  EXPECT_EQ("accuracy: ha; ", key_to_text(4, true));
  EXPECT_EQ("feature: gen; ", key_to_text(0x100, true));
  EXPECT_EQ("feature: nofp64; ", key_to_text(0x200, true));
  EXPECT_EQ("feature: nolut; ", key_to_text(0x400, true));
  EXPECT_EQ("feature: fp64only; ", key_to_text(0x800, true));
  EXPECT_EQ("feature: fp32cast; ", key_to_text(0x1000, true));
  EXPECT_EQ("feature: classic; ", key_to_text(0x8000, true));
}

TEST(KeyToText, KeepsTheOrderOfFields) {
  EXPECT_EQ("device: gpu; precision: s/float; accuracy: ha; feature: gen; ",
            key_to_text(0x400000124, true));
  EXPECT_EQ("device: cpu; precision: z/complex_double; accuracy: ep; feature: classic; ",
            key_to_text(0x1800008011, true));
}

TEST(KeyToText, LeavesOutTheFeatureUnlessAsked) {
  EXPECT_EQ("device: gpu; precision: s/float; accuracy: ha; ", key_to_text(0x400000124, false));
  EXPECT_EQ("", key_to_text(0x100, false));
}

TEST(KeyToText, PrintsNoFeatureForCombinedBytes) {
  for (const std::uint64_t feature : {0x1100u, 0x1200u, 0x1400u, 0x1800u, 0x300u, 0x8100u}) {
    EXPECT_EQ("device: gpu; precision: h/half; accuracy: la; ",
              key_to_text(0x100000022 | feature, true));
  }
}

TEST(KeyToText, PrintsNothingForUnknownValues) {
  EXPECT_EQ("", key_to_text(0, true));
  EXPECT_EQ("", key_to_text(0, false));
  EXPECT_EQ("", key_to_text(0x30, true));         // both devices
  EXPECT_EQ("", key_to_text(0x80, true));         // no device
  EXPECT_EQ("", key_to_text(0x500000000, true));  // half and float
  EXPECT_EQ("", key_to_text(0xff00000000, true));
  EXPECT_EQ("", key_to_text(3, true));
  EXPECT_EQ("", key_to_text(7, true));
  EXPECT_EQ("", key_to_text(0xFFFF0008, true));  // bits of no field
  EXPECT_EQ("", key_to_text(0xFFFFFF0000000000, true));
}

TEST(ModeToText, OfNothingIsNotDefined) { EXPECT_EQ("not_defined", mode_to_text(0)); }

TEST(ModeToText, NamesEachGroup) {
  EXPECT_EQ("acc: ha; ", mode_to_text(4));
  EXPECT_EQ("acc: la; ", mode_to_text(12));
  EXPECT_EQ("acc: ep; ", mode_to_text(15));
  EXPECT_EQ("global_status_report; ", mode_to_text(0x100));
  EXPECT_EQ("slice: normal; ", mode_to_text(0x1000));
  EXPECT_EQ("slice: minimum; ", mode_to_text(0x2000));
  EXPECT_EQ("slice: cyclic; ", mode_to_text(0x4000));
  EXPECT_EQ("badarg: quiet;", mode_to_text(0x20000));
  EXPECT_EQ("badarg: exception", mode_to_text(0x10000));
}

TEST(ModeToText, KeepsTheOrderOfGroups) {
  EXPECT_EQ("acc: ha; slice: normal; badarg: exception", mode_to_text(0x1811204));
  EXPECT_EQ("acc: la; global_status_report; slice: minimum; badarg: quiet;",
            mode_to_text(0x182210C));
  EXPECT_EQ("acc: ep; global_status_report; slice: cyclic; badarg: quiet;", mode_to_text(0x2410F));
}

// Only a word of 0 is "not_defined"; a word of which nothing has a name is empty.
TEST(ModeToText, PrintsNothingForUnknownValues) {
  for (const std::uint32_t mode :
       {0x1u, 0xBu, 0x200u, 0x3000u, 0x7000u, 0x30000u, 0x100000u, 0x800000u, 0x7000000u})
    EXPECT_EQ("", mode_to_text(mode)) << std::hex << mode;
  EXPECT_EQ("global_status_report; ", mode_to_text(0x300));
}

TEST(DeviceToText, NamesEachBit) {
  EXPECT_EQ("nofp64;", device_to_text(1ull << 34));
  EXPECT_EQ("garnet;", device_to_text(1ull << 1));
  EXPECT_EQ("topaz;", device_to_text(1ull << 2));
  EXPECT_EQ("beryl;", device_to_text(1ull << 5));
  EXPECT_EQ("discrete;", device_to_text(1ull << 32));
  EXPECT_EQ("integrated;", device_to_text(1ull << 33));
  EXPECT_EQ("accelerator;", device_to_text(1ull << 50));
  EXPECT_EQ("norvane;", device_to_text(1ull << 63));
}

TEST(DeviceToText, KeepsTheOrderOfWords) {
  EXPECT_EQ("nofp64;garnet;topaz;beryl;discrete;integrated;accelerator;norvane;",
            device_to_text(~std::uint64_t{0}));
  EXPECT_EQ("garnet;integrated;norvane;", device_to_text(0x8002000A00000002));
  EXPECT_EQ("nofp64;beryl;discrete;", device_to_text(0x0002000500000020));
}

// Two tiers, the classes of CPU and GPU and the presence of double have no word.
TEST(DeviceToText, PrintsNothingForBitsWithoutAWord) {
  constexpr std::uint64_t named = (1ull << 34) | (1ull << 1) | (1ull << 2) | (1ull << 5) |
                                  (1ull << 32) | (1ull << 33) | (1ull << 50) | (1ull << 63);
  EXPECT_EQ("", device_to_text(0));
  EXPECT_EQ("", device_to_text(~named));
  EXPECT_EQ("discrete;norvane;", device_to_text(0x8002000900000008));  // onyx
  EXPECT_EQ("discrete;norvane;", device_to_text(0x8002000900000010));  // jasper
  EXPECT_EQ("", device_to_text(0x0001000000000000));                   // a CPU
}

// The words "precision" and the semicolons are doubled.
TEST(UnservedText, JoinsModePrecisionAndDevice) {
  EXPECT_EQ(
      "mode: acc: ha; slice: normal; badarg: exception; precision: precision: s/float; ; "
      "architecture: garnet;integrated;norvane;",
      unserved_text(0x1811204, 0x400000000, 0x8002000A00000002));
  EXPECT_EQ("mode: not_defined; precision: precision: h/half; ; architecture: ",
            unserved_text(0, 0x100000000, 0x0001000000000000));
  EXPECT_EQ("mode: badarg: quiet;; precision: ; architecture: accelerator;",
            unserved_text(0x20000, 0xff00000000, 0x0004000000000000));
}

}  // namespace
