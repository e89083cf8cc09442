// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "dispatch/dispatch_call.hpp"

#include <gtest/gtest.h>

#include <cstdint>
#include <stdexcept>
#include <string>
#include <sycl/sycl.hpp>
#include <vector>

#include "arbor/lumen/exception.hpp"
#include "arbor/lumen/vm/queue_state.hpp"
#include "call/queue_store.hpp"
#include "dispatch/families.hpp"
#include "dispatch/simulated_devices.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail;
namespace enums = arbor::lumen::vm::enums;
using arbor::lumen::invalid_argument;
using arbor::lumen::slice;
using arbor::lumen::unimplemented;

constexpr std::uint32_t default_mode = 0x1811204;
constexpr std::uint32_t quiet = 0x1821204;
/// No fallback at all: what the device has no kernel for is not served.
constexpr std::uint32_t strict = 0x1011204;
constexpr std::uint32_t host_only = 0x1111204;
constexpr std::uint32_t strict_throwing = 0x1411204;

/// What the record and the launchers of this file were asked, in order.
std::vector<std::string> trace;

sycl::event on_gpu(const input::vxx&, TuningInfo info) {
  trace.push_back("gpu " + std::to_string(info.factor));
  return {};
}
sycl::event on_host(const input::vxx&, TuningInfo info) {
  trace.push_back("host " + std::to_string(info.factor));
  return queue_store::instance().default_event();
}
sycl::event failing(const input::vxx&, TuningInfo) {
  throw std::runtime_error("out of the launcher");
}

const implementation_table& both() {
  static const implementation_table table{{0x400000124, on_gpu, "gpu"},
                                          {0x400008014, on_host, "host"}};
  return table;
}
const implementation_table& nothing() {
  static const implementation_table table{};
  return table;
}

/// A record that writes down what it is asked and answers as told.
class traced_record : public input::vxx {
 public:
  bool check(bool throw_on_error) const override {
    trace.push_back(throw_on_error ? "check, may throw" : "check, quietly");
    return accepts;
  }
  std::uint64_t precision() const override {
    trace.push_back("precision");
    return 0x400000000;
  }
  bool accepts = true;
};

class DispatchCall : public testing::Test {
 protected:
  void SetUp() override {
    trace.clear();
    // A queue that stands where an earlier one stood meets the state of that one.
    arbor::lumen::vm::clear_status(garnet_);
  }

  template <typename Record>
  void prepare(Record& record, std::uint32_t mode) {
    record.name = "abs";
    record.queue = &garnet_;
    record.mode = mode;
  }
  std::uint32_t status() { return arbor::lumen::vm::get_status(garnet_); }

  template <typename Error>
  void expect_thrown(const std::string& text, const input::vxx& record,
                     const implementation_table& table) {
    try {
      dispatch_call(record, table);
      ADD_FAILURE() << "nothing was thrown, expected: " << text;
    } catch (const Error& error) {
      EXPECT_EQ(text, error.what());
    }
  }

  sycl::queue garnet_{device_named("garnet")};
  using records = std::vector<std::string>;
};

TEST_F(DispatchCall, AsksPrecisionThenChecksThenLaunches) {
  traced_record record;
  prepare(record, default_mode);
  dispatch_call(record, both());
  EXPECT_EQ((records{"precision", "check, may throw", "gpu 1"}), trace);
  EXPECT_EQ(0u, status());
}

TEST_F(DispatchCall, TellsTheCheckItsPolicy) {
  traced_record record;
  prepare(record, quiet);
  dispatch_call(record, both());
  EXPECT_EQ((records{"precision", "check, quietly", "gpu 1"}), trace);
}

TEST_F(DispatchCall, HandsTheTuningFactorToTheLauncher) {
  sycl::queue beryl(device_named("without_identifier"));
  sycl::queue jasper(device_named("jasper"));
  sycl::queue foreign(device_named("foreign"));
  sycl::queue cpu(device_named("cpu"));
  traced_record record;
  prepare(record, default_mode);
  for (sycl::queue* queue : {&beryl, &jasper, &foreign, &cpu}) {
    trace.clear();
    record.queue = queue;
    dispatch_call(record, both());
    const char* expected = queue == &beryl    ? "gpu 4"
                           : queue == &jasper ? "gpu 2"
                           : queue == &cpu    ? "host 1"
                                              : "gpu 1";
    EXPECT_EQ(expected, trace.back());
  }
}

TEST_F(DispatchCall, ReturnsTheLaunchersEvent) {
  const implementation_table host_row{{0x400008014, on_host, "host"}};
  traced_record record;
  prepare(record, default_mode);
  EXPECT_EQ(queue_store::instance().default_event(), dispatch_call(record, host_row));
  EXPECT_NE(queue_store::instance().default_event(), dispatch_call(record, both()));
}

TEST_F(DispatchCall, LetsExceptionsOfTheLauncherPass) {
  const implementation_table table{{0x400000124, failing, "failing"}};
  traced_record record;
  prepare(record, default_mode);
  expect_thrown<std::runtime_error>("out of the launcher", record, table);
  record.mode = quiet;
  expect_thrown<std::runtime_error>("out of the launcher", record, table);
  EXPECT_EQ(0u, status());
}

TEST_F(DispatchCall, RejectsWhatTheCheckDeclinesWithoutThrowing) {
  traced_record record;
  prepare(record, default_mode);
  record.accepts = false;
  expect_thrown<invalid_argument>(
      "arbor::lumen::vector_math::abs: invalid argument: device: gpu; precision: s/float; "
      "accuracy: ha; feature: gen; ; api: linear",
      record, both());
  record.in_slices.push_back(slice{0, 1, 1});
  expect_thrown<invalid_argument>(
      "arbor::lumen::vector_math::abs: invalid argument: device: gpu; precision: s/float; "
      "accuracy: ha; feature: gen; ; api: strided",
      record, both());
  record.in_slices.clear();
  record.out_slices.push_back(slice{0, 1, 1});
  record.mode = host_only;
  const implementation_table host_row{{0x400008014, on_host, "host"}};
  expect_thrown<invalid_argument>(
      "arbor::lumen::vector_math::abs: invalid argument: device: cpu; precision: s/float; "
      "accuracy: ha; feature: classic; ; api: strided",
      record, host_row);
  EXPECT_EQ(0u, status());
}

// The search comes before the check, and its failure after it.
TEST_F(DispatchCall, ReportsTheBadArgumentOfAnUnservedCall) {
  traced_record record;
  prepare(record, strict_throwing);
  record.accepts = false;
  expect_thrown<invalid_argument>("arbor::lumen::vector_math::abs: invalid argument: ; api: linear",
                                  record, nothing());
}

TEST_F(DispatchCall, DeclinesBadArgumentsQuietly) {
  traced_record record;
  prepare(record, quiet);
  record.accepts = false;
  sycl::event event = dispatch_call(record, both());
  EXPECT_EQ((records{"precision", "check, quietly"}), trace) << "no launcher runs";
  EXPECT_EQ(queue_store::instance().default_event(), event);
  EXPECT_EQ(sycl::info::event_command_status::complete,
            event.get_info<sycl::info::event::command_execution_status>());
  EXPECT_EQ(256u, status());
}

// With neither policy bit the call is as quiet as with the quiet one.
TEST_F(DispatchCall, ThrowsForBadArgumentsOnlyUnderTheExceptionPolicy) {
  traced_record record;
  prepare(record, 4);
  record.accepts = false;
  dispatch_call(record, both());
  EXPECT_EQ(256u, status());
}

TEST_F(DispatchCall, ReturnsTheDefaultEventOfAnUnservedCall) {
  for (const std::uint32_t mode : {default_mode, strict, host_only, quiet}) {
    arbor::lumen::vm::clear_status(garnet_);
    trace.clear();
    traced_record record;
    prepare(record, mode);
    sycl::event event = dispatch_call(record, nothing());
    EXPECT_EQ(queue_store::instance().default_event(), event);
    EXPECT_EQ(2u, trace.size());
    EXPECT_EQ(256u, status()) << std::hex << mode;
  }
}

TEST_F(DispatchCall, ThrowsForAnUnservedCallUnderMissingThrows) {
  traced_record record;
  prepare(record, strict_throwing);
  expect_thrown<unimplemented>(
      "arbor::lumen::vector_math::abs: unimplemented functionality: mode: acc: ha; slice: normal; "
      "badarg: exception; precision: precision: s/float; ; architecture: "
      "garnet;integrated;norvane;",
      record, nothing());
  record.mode = 0x1C2410F;
  expect_thrown<unimplemented>(
      "arbor::lumen::vector_math::abs: unimplemented functionality: mode: acc: ep; "
      "global_status_report; slice: cyclic; badarg: quiet;; precision: precision: s/float; ; "
      "architecture: garnet;integrated;norvane;",
      record, nothing());
  EXPECT_EQ(0u, status());
}

TEST_F(DispatchCall, KeepsOtherBitsOfTheStatus) {
  arbor::lumen::vm::set_status(garnet_, enums::sing | enums::underflow);
  traced_record record;
  prepare(record, strict);
  dispatch_call(record, nothing());
  EXPECT_EQ(0x10Au, status());
}

TEST_F(DispatchCall, FallsBackByItsModeBits) {
  const implementation_table host_row{{0x400008014, on_host, "host"}};
  const struct {
    std::uint32_t bits;
    bool served;
  } cases[] = {{0x000000, false}, {0x100000, true}, {0x200000, false}, {0x800000, true},
               {0x900000, true},  {0x500000, true}, {0xC00000, true},  {0xF00000, true}};
  for (const auto& c : cases) {
    arbor::lumen::vm::clear_status(garnet_);
    trace.clear();
    traced_record record;
    prepare(record, 0x1011204 | c.bits);
    dispatch_call(record, host_row);
    EXPECT_EQ(c.served ? "host 1" : "check, may throw", trace.back()) << std::hex << c.bits;
    EXPECT_EQ(c.served ? 0u : 256u, status());
  }
}

TEST_F(DispatchCall, ChecksRecordsOfRealCalls) {
  input::usm::linear<shape::v11, float, float> record;
  prepare(record, default_mode);
  record.n = -3;
  expect_thrown<invalid_argument>("arbor::lumen::vm::abs: invalid argument: negative length",
                                  record, both());
  record.n = 10;
  record.in_lengths = {12};
  record.out_lengths = {8};
  expect_thrown<invalid_argument>(
      "arbor::lumen::vm::abs: invalid argument: insufficient length of arguments", record, both());
  EXPECT_EQ(0u, status());
  record.mode = quiet;
  dispatch_call(record, both());
  EXPECT_EQ(256u, status());
  arbor::lumen::vm::clear_status(garnet_);
  record.n = -3;
  EXPECT_EQ(queue_store::instance().default_event(), dispatch_call(record, both()));
  EXPECT_EQ(256u, status());
  EXPECT_TRUE(trace.empty()) << "no launcher runs";
}

TEST_F(DispatchCall, ThrowsForANullQueueUnderBothPolicies) {
  input::usm::linear<shape::v11, float, float> record;
  prepare(record, default_mode);
  record.queue = nullptr;
  for (const std::uint32_t mode : {default_mode, quiet, strict_throwing}) {
    record.mode = mode;
    expect_thrown<std::logic_error>("ArborLumen::vm::detail::input::abs: q is nullptr", record,
                                    both());
  }
}

TEST_F(DispatchCall, LaunchersRefuseForeignRecords) {
  const auto refusal = [](const char* where, const char* shape_name) {
    return std::string("vm::detail::") + where + "::norvane::" + shape_name +
           " function was called with incorrect argument types";
  };
  // A record of two inputs at a function of one, and of one input at a function of two.
  input::usm::linear<shape::v21, float, float> two;
  prepare(two, default_mode);
  expect_thrown<std::runtime_error>(refusal("gpu", "v11"), two, abs_table());
  input::buffer::strided<shape::v11, double, double> one;
  prepare(one, default_mode);
  expect_thrown<std::runtime_error>(refusal("gpu", "v21"), one, add_table());
  sycl::queue cpu(device_named("cpu"));
  two.queue = &cpu;
  expect_thrown<std::runtime_error>(refusal("cpu", "v11"), two, abs_table());
}

}  // namespace
