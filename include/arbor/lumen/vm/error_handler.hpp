// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <complex>
#include <cstdint>
#include <sycl/sycl.hpp>
#include <utility>

#include "arbor/lumen/exception.hpp"
#include "arbor/lumen/export.hpp"
#include "arbor/lumen/vm/enums.hpp"

namespace arbor::lumen::vm {
namespace detail {

/// Polymorphic root of all error handlers.
class ARBORLUMEN_EXPORT error_handler_base {
 public:
  error_handler_base();
  error_handler_base(const error_handler_base&);
  error_handler_base& operator=(const error_handler_base&);
  virtual ~error_handler_base();
};

/// What to report of one call and what to repair in its results.
///
/// Reporting: `length` 0 reports nothing; 1 ors the status of all elements into one cell; more
/// stores the status of each element that is not a success beside it, so the storage needs one cell
/// per output element (per element up to the highest index, where the output is a slice). Pointer
/// and span calls report into `status_array`, buffer calls into `status_buffer`.
///
/// Repair: an element whose status has a bit of `status_to_fix` gets `fixup_value` instead of its
/// result, with the sign of the first input if `copy_sign` is set.
///
/// A call copies the handler; copies share `status_buffer`. A handler that is not `enabled`, such
/// as a default-constructed one, does nothing.
///
/// @tparam T element type of the results: half, float, double, complex of float or double.
template <typename T>
class ARBORLUMEN_EXPORT error_handler : public error_handler_base {
 public:
  error_handler();
  error_handler(const error_handler&);
  error_handler(error_handler&&);
  error_handler& operator=(const error_handler&);
  error_handler& operator=(error_handler&&);
  ~error_handler() override;

  /// Reports into `array`, host or USM memory of `cells` cells that outlives the call.
  /// @throws invalid_argument if `cells` is negative, or positive with a null `array`.
  error_handler(enums::status* array, std::int64_t cells) : error_handler() {
    report_into(array, cells);
  }

  /// Reports into `buffer`, of at least `cells` cells.
  /// @throws invalid_argument if `cells` is negative or beyond the size of the buffer.
  error_handler(sycl::buffer<enums::status, 1> buffer, std::int64_t cells) : error_handler() {
    report_into(std::move(buffer), cells);
  }

  /// Repairs results whose status has a bit of `status_to_fix`.
  error_handler(T fixup, enums::status to_fix, bool with_sign_of_input = false) : error_handler() {
    repair(to_fix, fixup, with_sign_of_input);
  }

  /// Reports into `array` and repairs.
  error_handler(enums::status* array, std::int64_t cells, enums::status to_fix, T fixup,
                bool with_sign_of_input = false)
      : error_handler(array, cells) {
    repair(to_fix, fixup, with_sign_of_input);
  }

  /// Reports into `buffer` and repairs.
  error_handler(sycl::buffer<enums::status, 1> buffer, std::int64_t cells, enums::status to_fix,
                T fixup, bool with_sign_of_input = false)
      : error_handler(std::move(buffer), cells) {
    repair(to_fix, fixup, with_sign_of_input);
  }

  bool enabled = false;                          ///< the handler is in force
  bool usm_flag = false;                         ///< reserved; travels with the handler
  sycl::buffer<enums::status, 1> status_buffer;  ///< status storage of buffer calls
  enums::status* status_array = nullptr;         ///< status storage of pointer and span calls
  std::int64_t length = 0;                       ///< cells in the storage
  std::uint32_t status_to_fix = 0;               ///< statuses whose results are replaced
  T fixup_value{};                               ///< the replacement
  bool copy_sign = false;                        ///< the replacement takes the input's sign

 private:
  void report_into(enums::status* array, std::int64_t cells) {
    if (cells < 0) throw invalid_argument("vm", "error_handler", "negative length");
    if (cells > 0 && array == nullptr)
      throw invalid_argument("vm", "error_handler", "status array is nullptr");
    enabled = true;
    status_array = array;
    length = cells;
  }
  void report_into(sycl::buffer<enums::status, 1> buffer, std::int64_t cells) {
    if (cells < 0) throw invalid_argument("vm", "error_handler", "negative length");
    if (static_cast<std::uint64_t>(cells) > buffer.size())
      throw invalid_argument("vm", "error_handler", "status buffer is shorter than length");
    enabled = true;
    status_buffer = std::move(buffer);
    length = cells;
  }
  void repair(enums::status to_fix, T fixup, bool with_sign_of_input) {
    enabled = true;
    status_to_fix = to_fix;
    fixup_value = fixup;
    copy_sign = with_sign_of_input;
  }
};

extern template class error_handler<sycl::half>;
extern template class error_handler<float>;
extern template class error_handler<double>;
extern template class error_handler<std::complex<float>>;
extern template class error_handler<std::complex<double>>;

}  // namespace detail

using detail::error_handler;

}  // namespace arbor::lumen::vm
