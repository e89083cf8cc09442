// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <atomic>
#include <cmath>
#include <complex>
#include <cstdint>

#include "call/input.hpp"
#include "lumen_arr.h"

/// What a host call does about the errors that array-math kernels report.
namespace arbor::lumen::vm::detail::classic {

/// The untyped part: where statuses go.
class error_handler {
 public:
  virtual ~error_handler();
  /// Takes note of one element and repairs its results in the record. @returns 0
  virtual int handle(lumen_arr_error_record& record) = 0;

  bool active = false;  ///< the one switch: nothing is installed and nothing reported without it
  std::atomic<std::uint32_t>* queue_status = nullptr;
  std::uint32_t local_status = 0;
  enums::status* status_array = nullptr;
  std::int64_t status_length = 0;
  std::uint32_t status_to_fix = 0;

 protected:
  /// Stores the status of a record. @returns whether its results are to be replaced
  bool note(const lumen_arr_error_record& record);
};

/// With the element types of the call.
template <typename T, typename U>
class error_handler_typed : public error_handler {
 public:
  error_handler_typed() = default;
  explicit error_handler_typed(const detail::input::typed_vxx<T, U>& record) {
    if (!record.handler.enabled) return;
    status_array = record.handler.status_array;
    status_length = record.handler.length;
    status_to_fix = record.handler.status_to_fix;
  }

 protected:
  static void replace(U by, bool with_sign, const lumen_arr_error_record& record, double& real,
                      [[maybe_unused]] double& imag) {
    const auto part = [with_sign](double value, double argument) {
      return with_sign ? std::copysign(value, argument) : value;
    };
    if constexpr (requires { by.imag(); }) {
      real = part(static_cast<double>(by.real()), record.argument[0]);
      imag = part(static_cast<double>(by.imag()), record.argument_imag[0]);
    } else {
      real = part(static_cast<double>(by), record.argument[0]);
    }
  }
};

/// Of a function without errors.
template <typename T, typename U>
class error_handler_typed_var0 final : public error_handler_typed<T, U> {
 public:
  using error_handler_typed<T, U>::error_handler_typed;
  int handle(lumen_arr_error_record&) override { return 0; }
};

/// Of a function with one result.
template <typename T, typename U>
class error_handler_typed_var1 final : public error_handler_typed<T, U> {
 public:
  error_handler_typed_var1() = default;
  explicit error_handler_typed_var1(const detail::input::typed_vxx<T, U>& record)
      : error_handler_typed<T, U>(record),
        replacement(record.handler.fixup_value),
        with_sign(record.handler.copy_sign) {}
  int handle(lumen_arr_error_record& record) override {
    if (this->active && this->note(record))
      this->replace(replacement, with_sign, record, record.result[0], record.result_imag[0]);
    return 0;
  }

  U replacement{};
  bool with_sign = false;
};

/// Of a function with two results.
template <typename T, typename U>
class error_handler_typed_var2 final : public error_handler_typed<T, U> {
 public:
  error_handler_typed_var2() = default;
  explicit error_handler_typed_var2(const detail::input::typed_vxx<T, U>& record)
      : error_handler_typed<T, U>(record),
        replacement{record.handler.fixup_value, record.handler.fixup_value},
        with_sign(record.handler.copy_sign) {}
  int handle(lumen_arr_error_record& record) override {
    if (!this->active || !this->note(record)) return 0;
    for (int i = 0; i < 2; ++i)
      this->replace(replacement[i], with_sign, record, record.result[i], record.result_imag[i]);
    return 0;
  }

  U replacement[2]{};
  bool with_sign = false;
};

/// Makes a handler the one that kernels report to, from construction to destruction. There is one
/// in a process at a time: of two concurrent calls the later one's handler gets both reports.
class installed_handler {
 public:
  explicit installed_handler(error_handler& handler);
  installed_handler(const installed_handler&) = delete;
  installed_handler& operator=(const installed_handler&) = delete;
  ~installed_handler();
};

}  // namespace arbor::lumen::vm::detail::classic
