// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string_view>
#include <sycl/sycl.hpp>
#include <vector>

#include "call/input.hpp"

namespace arbor::lumen::vm::detail {

/// The mode of one call: what is in force on the queue, with the groups that the caller named.
std::uint32_t effective_mode(const keyed_queue& queue, enums::mode mode);

/// Builds the argument record of one call, operand by operand in argument order, and runs it.
template <typename Record>
class call;

template <input::form Form, typename Shape, typename T, typename U>
class call<input::record<Form, Shape, T, U>> {
 public:
  call(std::string_view name, sycl::queue& queue, std::int64_t n, enums::mode mode) {
    describe(name, queue, n, mode);
  }
  call(std::string_view name, sycl::queue& queue, std::int64_t n, enums::mode mode,
       const error_handler<U>& handler)
      : record_(handler) {
    describe(name, queue, n, mode);
  }

  call& after(const std::vector<sycl::event>& depends) {
    if (!depends.empty()) record_.depends = std::vector<sycl::event>(depends);
    return *this;
  }

  call& in(const T* a) {
    record_.in_pointers.push_back(a);
    return *this;
  }
  call& in(const T* a, const slice& s) {
    record_.in_slices.push_back(s);
    return in(a);
  }
  call& in(std::span<const T> a) {
    record_.in_lengths.push_back(static_cast<std::int64_t>(a.size()));
    return in(a.data());
  }
  call& in(std::span<const T> a, const slice& s) {
    record_.in_slices.push_back(s);
    return in(a);
  }
  call& in(sycl::buffer<T, 1>& a) {
    record_.in_buffers.push_back(&a);
    record_.in_lengths.push_back(static_cast<std::int64_t>(a.size()));
    return *this;
  }
  call& in(sycl::buffer<T, 1>& a, const slice& s) {
    record_.in_slices.push_back(s);
    return in(a);
  }

  call& constant(const T& c) {
    record_.constants.push_back(c);
    return *this;
  }

  call& out(U* y) {
    record_.out_pointers.push_back(y);
    return *this;
  }
  call& out(U* y, const slice& s) {
    record_.out_slices.push_back(s);
    return out(y);
  }
  call& out(std::span<U> y) {
    record_.out_lengths.push_back(static_cast<std::int64_t>(y.size()));
    return out(y.data());
  }
  call& out(std::span<U> y, const slice& s) {
    record_.out_slices.push_back(s);
    return out(y);
  }
  call& out(sycl::buffer<U, 1>& y) {
    record_.out_buffers.push_back(&y);
    record_.out_lengths.push_back(static_cast<std::int64_t>(y.size()));
    return *this;
  }
  call& out(sycl::buffer<U, 1>& y, const slice& s) {
    record_.out_slices.push_back(s);
    return out(y);
  }

  sycl::event run(sycl::event (*dispatcher)(const input::vxx&)) { return dispatcher(record_); }

 private:
  void describe(std::string_view name, sycl::queue& queue, std::int64_t n, enums::mode mode) {
    record_.name = name;
    record_.queue = &queue;
    record_.n = n;
    record_.mode = effective_mode(record_.queue, mode);
  }

  input::record<Form, Shape, T, U> record_;
};

}  // namespace arbor::lumen::vm::detail
