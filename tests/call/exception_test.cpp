// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "arbor/lumen/exception.hpp"

#include <gtest/gtest.h>

#include <exception>
#include <string>
#include <type_traits>

namespace {

using namespace arbor::lumen;

static_assert(std::is_base_of_v<std::exception, exception>);
static_assert(std::is_base_of_v<exception, invalid_argument>);
static_assert(std::is_base_of_v<exception, unimplemented>);
static_assert(std::is_nothrow_copy_constructible_v<exception>);
static_assert(std::is_nothrow_copy_constructible_v<invalid_argument>);

struct text_case {
  const char* domain;
  const char* method;
  const char* info;
  const char* of_argument;
  const char* of_missing;
};

// An empty part leaves out its separator as well.
constexpr text_case texts[] = {
    {"", "", "", "arbor::lumen: invalid argument", "arbor::lumen: unimplemented functionality"},
    {"", "", "why", "arbor::lumen: invalid argument: why",
     "arbor::lumen: unimplemented functionality: why"},
    {"", "exp", "", "arbor::lumen::exp: invalid argument",
     "arbor::lumen::exp: unimplemented functionality"},
    {"", "exp", "why", "arbor::lumen::exp: invalid argument: why",
     "arbor::lumen::exp: unimplemented functionality: why"},
    {"vm", "", "", "arbor::lumen::vm: invalid argument",
     "arbor::lumen::vm: unimplemented functionality"},
    {"vm", "", "why", "arbor::lumen::vm: invalid argument: why",
     "arbor::lumen::vm: unimplemented functionality: why"},
    {"vm", "exp", "", "arbor::lumen::vm::exp: invalid argument",
     "arbor::lumen::vm::exp: unimplemented functionality"},
    {"vm", "exp", "why", "arbor::lumen::vm::exp: invalid argument: why",
     "arbor::lumen::vm::exp: unimplemented functionality: why"},
};

TEST(Exception, NamesDomainMethodAndInfo) {
  for (const text_case& t : texts) {
    EXPECT_STREQ(t.of_argument, invalid_argument(t.domain, t.method, t.info).what());
    EXPECT_STREQ(t.of_missing, unimplemented(t.domain, t.method, t.info).what());
  }
}

TEST(Exception, InfoMayBeLeftOut) {
  EXPECT_STREQ("arbor::lumen::vm::ln: invalid argument", invalid_argument("vm", "ln").what());
  EXPECT_STREQ("arbor::lumen::vm::ln: unimplemented functionality",
               unimplemented("vm", "ln").what());
}

TEST(Exception, RootTakesTheMessageAsItIs) {
  EXPECT_STREQ("arbor::lumen::vm::ln: message", exception("vm", "ln", "message").what());
  EXPECT_STREQ("arbor::lumen: ", exception("", "", "").what());
}

TEST(Exception, TextOutlivesTheOriginal) {
  std::string method(100, 'm');
  exception copy("a", "b", "c");
  {
    const invalid_argument original("vm", method, "info");
    copy = original;
  }
  EXPECT_EQ("arbor::lumen::vm::" + method + ": invalid argument: info", copy.what());
}

TEST(Exception, IsCaughtAsStandardException) {
  try {
    throw unimplemented("vector_math", "sin", "x");
  } catch (const std::exception& caught) {
    EXPECT_STREQ("arbor::lumen::vector_math::sin: unimplemented functionality: x", caught.what());
    EXPECT_NE(nullptr, dynamic_cast<const exception*>(&caught));
  }
}

}  // namespace
