// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <exception>
#include <functional>
#include <memory>
#include <string>
#include <system_error>
#include <vector>

#include "detail/export.hpp"

namespace sycl {

class context;

/// The error codes of SYCL.
enum class errc : int {
  success = 0,
  runtime = 1,
  kernel = 2,
  accessor = 3,
  nd_range = 4,
  event = 5,
  kernel_argument = 6,
  build = 7,
  invalid = 8,
  memory_allocation = 9,
  platform = 10,
  profiling = 11,
  feature_not_supported = 12,
  kernel_not_supported = 13,
  backend_mismatch = 14,
};

ARBOR_LUMEN_SYCL_API const std::error_category& sycl_category() noexcept;
ARBOR_LUMEN_SYCL_API std::error_code make_error_code(errc code) noexcept;

/// What every failing operation of SYCL throws.
class ARBOR_LUMEN_SYCL_API exception : public virtual std::exception {
 public:
  exception(std::error_code code, const std::string& what_arg);
  exception(std::error_code code, const char* what_arg);
  exception(std::error_code code);
  exception(int value, const std::error_category& category, const std::string& what_arg);
  exception(int value, const std::error_category& category, const char* what_arg);
  exception(int value, const std::error_category& category);

  exception(context ctx, std::error_code code, const std::string& what_arg);
  exception(context ctx, std::error_code code, const char* what_arg);
  exception(context ctx, std::error_code code);
  exception(context ctx, int value, const std::error_category& category,
            const std::string& what_arg);
  exception(context ctx, int value, const std::error_category& category, const char* what_arg);
  exception(context ctx, int value, const std::error_category& category);

  exception(const exception&) noexcept;
  exception& operator=(const exception&) noexcept;
  ~exception() override;

  const std::error_code& code() const noexcept;
  const std::error_category& category() const noexcept;
  const char* what() const noexcept override;
  bool has_context() const noexcept;
  /// The context the error is about; errc::invalid where there is none.
  context get_context() const;

 private:
  struct details;
  exception(std::shared_ptr<const context> ctx, std::error_code code, const char* what_arg);

  std::shared_ptr<const details> details_;
};

/// The asynchronous errors that are handed to an async_handler.
class ARBOR_LUMEN_SYCL_API exception_list {
 public:
  using value_type = std::exception_ptr;
  using reference = value_type&;
  using const_reference = const value_type&;
  using size_type = std::size_t;
  using iterator = std::vector<std::exception_ptr>::const_iterator;
  using const_iterator = std::vector<std::exception_ptr>::const_iterator;

  exception_list() = default;
  explicit exception_list(std::vector<std::exception_ptr> exceptions) noexcept
      : exceptions_(std::move(exceptions)) {}

  size_type size() const { return exceptions_.size(); }
  iterator begin() const { return exceptions_.begin(); }
  iterator end() const { return exceptions_.end(); }

 private:
  std::vector<std::exception_ptr> exceptions_;
};

using async_handler = std::function<void(sycl::exception_list)>;

namespace detail {
[[noreturn]] ARBOR_LUMEN_SYCL_API void throw_error(errc code, const char* what);
}

}  // namespace sycl

template <>
struct std::is_error_code_enum<sycl::errc> : std::true_type {};
