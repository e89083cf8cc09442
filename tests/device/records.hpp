// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <string>
#include <sycl/sycl.hpp>
#include <vector>

#include "call/input.hpp"

/// Argument records as exported functions build them.
namespace arbor::lumen::tests {

namespace enums = arbor::lumen::vm::enums;
namespace input = arbor::lumen::vm::detail::input;
namespace shape = arbor::lumen::vm::detail::shape;
using arbor::lumen::slice;

/// The default mode with some groups replaced.
inline std::uint32_t mode_with(std::uint32_t words) {
  std::uint32_t mode = enums::default_mode;
  for (const std::uint32_t group : {0xFu, 0x300u, 0x7000u, 0x30000u, 0xF00000u, 0x7000000u})
    if ((words & group) != 0) mode = (mode & ~group) | (words & group);
  return mode;
}

template <typename Record>
Record record_on(sycl::queue& queue, std::int64_t n = 0) {
  Record record;
  record.name = "name";
  record.queue = &queue;
  record.n = n;
  record.mode = enums::default_mode;
  return record;
}

template <typename Shape, typename T, typename U = T>
input::usm::linear<Shape, T, U> linear_call(sycl::queue& queue, std::int64_t n,
                                            std::vector<const T*> in, std::vector<U*> out,
                                            std::vector<T> constants = {}) {
  auto record = record_on<input::usm::linear<Shape, T, U>>(queue, n);
  record.in_pointers = in;
  record.out_pointers = out;
  record.constants = constants;
  return record;
}

template <typename T>
struct sliced {
  T operand;
  slice where;
};

template <typename Shape, typename T, typename U = T>
input::usm::strided<Shape, T, U> strided_call(sycl::queue& queue, std::vector<sliced<const T*>> in,
                                              std::vector<sliced<U*>> out,
                                              std::vector<T> constants = {}) {
  auto record = record_on<input::usm::strided<Shape, T, U>>(queue);
  for (const auto& [pointer, where] : in) {
    record.in_pointers.push_back(pointer);
    record.in_slices.push_back(where);
  }
  for (const auto& [pointer, where] : out) {
    record.out_pointers.push_back(pointer);
    record.out_slices.push_back(where);
  }
  record.constants = constants;
  return record;
}

template <typename T>
using buffers = std::vector<sycl::buffer<T, 1>*>;

template <typename Shape, typename T, typename U = T>
input::buffer::linear<Shape, T, U> buffer_call(sycl::queue& queue, std::int64_t n, buffers<T> in,
                                               buffers<U> out, std::vector<T> constants = {}) {
  auto record = record_on<input::buffer::linear<Shape, T, U>>(queue, n);
  record.in_buffers = in;
  record.out_buffers = out;
  record.constants = constants;
  for (const auto* a : in) record.in_lengths.push_back(static_cast<std::int64_t>(a->size()));
  for (const auto* y : out) record.out_lengths.push_back(static_cast<std::int64_t>(y->size()));
  return record;
}

template <typename Shape, typename T, typename U = T>
input::buffer::strided<Shape, T, U> buffer_strided_call(
    sycl::queue& queue, std::vector<sliced<sycl::buffer<T, 1>*>> in,
    std::vector<sliced<sycl::buffer<U, 1>*>> out, std::vector<T> constants = {}) {
  auto record = record_on<input::buffer::strided<Shape, T, U>>(queue);
  for (const auto& [operand, where] : in) {
    record.in_buffers.push_back(operand);
    record.in_slices.push_back(where);
    record.in_lengths.push_back(static_cast<std::int64_t>(operand->size()));
  }
  for (const auto& [operand, where] : out) {
    record.out_buffers.push_back(operand);
    record.out_slices.push_back(where);
    record.out_lengths.push_back(static_cast<std::int64_t>(operand->size()));
  }
  record.constants = constants;
  return record;
}

template <typename T>
std::vector<T> contents_of(sycl::buffer<T, 1>& buffer) {
  const sycl::host_accessor access(buffer, sycl::read_only);
  return std::vector<T>(access.begin(), access.end());
}

/// The text of the exception of type `Expected` that `call` throws; says what happened otherwise.
template <typename Expected, typename Call>
std::string message_of(Call call) {
  try {
    call();
  } catch (const Expected& thrown) {
    return thrown.what();
  } catch (const std::exception& thrown) {
    return std::string("another exception: ") + thrown.what();
  }
  return "no exception";
}

}  // namespace arbor::lumen::tests
