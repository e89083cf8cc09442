// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

// Nothing consumes the verbosity level, but its reading can be watched: this file replaces the C
// library's getenv by one that counts. Each case runs in a process of its own, since the store of a
// process reads the level once.

#include <gtest/gtest.h>

#include <atomic>
#include <cstdlib>
#include <cstring>

#include "call/queue_store.hpp"

extern "C" char** environ;

namespace {
std::atomic<int> reads{0};
constexpr const char* variable = "ARBORLUMEN_VM_VERBOSE";
}  // namespace

extern "C" char* getenv(const char* name) noexcept {
  if (std::strcmp(name, variable) == 0) ++reads;
  const std::size_t length = std::strlen(name);
  for (char** entry = environ; entry != nullptr && *entry != nullptr; ++entry) {
    if (std::strncmp(*entry, name, length) == 0 && (*entry)[length] == '=')
      return *entry + length + 1;
  }
  return nullptr;
}

namespace {

using arbor::lumen::vm::detail::queue_store;

/// Ends the process with the number of reads that five uses of the store made.
[[noreturn]] void use_store_and_exit(const char* value) {
  if (value == nullptr)
    unsetenv(variable);
  else
    setenv(variable, value, 1);
  reads = 0;
  for (int use = 0; use < 5; ++use) queue_store::instance().stored_mode(0);
  std::_Exit(reads.load());
}

class Verbosity : public testing::Test {
 protected:
  void SetUp() override { GTEST_FLAG_SET(death_test_style, "threadsafe"); }
};

#define EXPECT_READS(count, value) \
  EXPECT_EXIT(use_store_and_exit(value), testing::ExitedWithCode(count), "")

TEST_F(Verbosity, DigitsAboveZeroAreReadOnce) {
  EXPECT_READS(1, "1");
  EXPECT_READS(1, "9");
  EXPECT_READS(1, "3 and more");
}

TEST_F(Verbosity, AnythingElseIsReadOnce) {
  EXPECT_READS(1, nullptr);
  EXPECT_READS(1, "");
  EXPECT_READS(1, "x");
  EXPECT_READS(1, "-1");
  EXPECT_READS(1, " 0");
  EXPECT_READS(1, "/");  // the characters beside the digits
  EXPECT_READS(1, ":");
}

// A level of 0 cannot be told from a level that was never read.
TEST_F(Verbosity, ZeroIsReadAgainAtEachUse) {
  EXPECT_READS(5, "0");
  EXPECT_READS(5, "01");
}

}  // namespace
