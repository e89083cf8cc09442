// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstring>
#include <memory>
#include <sycl/sycl.hpp>

#include "random_call.hpp"

namespace arbor::lumen::tests {

/// Memory of every kind for random calls on one queue.
class pointer_arena {
 public:
  explicit pointer_arena(sycl::queue queue) : queue_(queue) {
    for (const memory kind : all_memories) {
      floats_.push_back(std::make_unique<array<float>>(queue_, kind, zones * zone_size, 0.0f));
      statuses_.push_back(
          std::make_unique<array<enums::status>>(queue_, kind, zone_size, enums::success));
    }
  }

  sycl::queue& queue() { return queue_; }

  template <typename Shape>
  input::usm::linear<Shape, float, float> linear(const random_call& call) {
    auto record = linear_call<Shape, float>(queue_, call.n, {}, {}, call.constants);
    for (const operand& a : call.in) record.in_pointers.push_back(zone(call, a.zone));
    for (const operand& y : call.out) record.out_pointers.push_back(zone(call, y.zone));
    finish(record, call);
    return record;
  }
  template <typename Shape>
  input::usm::strided<Shape, float, float> strided(const random_call& call) {
    auto record = strided_call<Shape, float>(queue_, {}, {}, call.constants);
    for (const operand& a : call.in) {
      record.in_pointers.push_back(zone(call, a.zone));
      record.in_slices.push_back(a.where);
    }
    for (const operand& y : call.out) {
      record.out_pointers.push_back(zone(call, y.zone));
      record.out_slices.push_back(y.where);
    }
    finish(record, call);
    return record;
  }

  void upload(const random_call& call) {
    for (int z = 0; z < zones; ++z) {
      const auto& contents = call.contents[static_cast<std::size_t>(z)];
      copy(zone(call, z), contents.data(), zone_size * sizeof(float),
           call.kinds[static_cast<std::size_t>(z)]);
    }
    copy(status(call), call.status.data(), zone_size * sizeof(enums::status), call.status_kind);
  }
  /// Puts what memory now holds in the place of the call's contents.
  void download(random_call& call) {
    for (int z = 0; z < zones; ++z) {
      auto& contents = call.contents[static_cast<std::size_t>(z)];
      copy(contents.data(), zone(call, z), zone_size * sizeof(float),
           call.kinds[static_cast<std::size_t>(z)]);
    }
    copy(call.status.data(), status(call), zone_size * sizeof(enums::status), call.status_kind);
  }

 private:
  float* zone(const random_call& call, int z) {
    const auto kind = static_cast<std::size_t>(call.kinds[static_cast<std::size_t>(z)]);
    return floats_[kind]->data() + static_cast<std::size_t>(z) * zone_size;
  }
  enums::status* status(const random_call& call) {
    return statuses_[static_cast<std::size_t>(call.status_kind)]->data();
  }
  template <typename Record>
  void finish(Record& record, const random_call& call) {
    record.mode = call.mode;
    record.handler = call.handler;
    if (call.handler.length > 0) record.handler.status_array = status(call);
  }
  void copy(void* to, const void* from, std::size_t bytes, memory kind) {
    if (kind == memory::device)
      queue_.memcpy(to, from, bytes).wait();
    else
      std::memcpy(to, from, bytes);
  }

  sycl::queue queue_;
  std::vector<std::unique_ptr<array<float>>> floats_;
  std::vector<std::unique_ptr<array<enums::status>>> statuses_;
};

/// Carries `actual` out by `run(arena, call)` and compares with the plain loop.
template <typename Shape, typename Run>
void expect_as_the_loop(random_call& actual, bool reports, pointer_arena& arena, Run run) {
  random_call expected = actual;
  const outcome wanted = carry_out<Shape>(expected, reports);
  const std::string text = describe(actual);
  outcome got;
  arena.upload(actual);
  got = run(actual);
  arena.download(actual);
  ASSERT_EQ(got.error, wanted.error) << text;
  ASSERT_EQ(got.queue_status, wanted.queue_status) << text;
  for (std::size_t z = 0; z < zones; ++z) {
    if (!same(actual.contents[z], expected.contents[z])) {
      ASSERT_EQ(actual.contents[z], expected.contents[z]) << "zone " << z << ": " << text;
    }
  }
  ASSERT_EQ(actual.status, expected.status) << text;
}

}  // namespace arbor::lumen::tests
