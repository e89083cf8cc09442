// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include "sycl/exception.hpp"

#include <utility>

#include "sycl/context.hpp"

namespace sycl {

namespace {

class category final : public std::error_category {
 public:
  const char* name() const noexcept override { return "sycl"; }

  std::string message(int value) const override {
    switch (static_cast<errc>(value)) {
      case errc::success:
        return "success";
      case errc::runtime:
        return "runtime error";
      case errc::kernel:
        return "kernel error";
      case errc::accessor:
        return "accessor error";
      case errc::nd_range:
        return "nd_range error";
      case errc::event:
        return "event error";
      case errc::kernel_argument:
        return "kernel argument error";
      case errc::build:
        return "build error";
      case errc::invalid:
        return "invalid argument or use";
      case errc::memory_allocation:
        return "memory allocation failed";
      case errc::platform:
        return "platform error";
      case errc::profiling:
        return "profiling error";
      case errc::feature_not_supported:
        return "feature not supported";
      case errc::kernel_not_supported:
        return "kernel not supported";
      case errc::backend_mismatch:
        return "backend mismatch";
    }
    return "unknown error";
  }
};

}  // namespace

const std::error_category& sycl_category() noexcept {
  static const category instance;
  return instance;
}

std::error_code make_error_code(errc code) noexcept {
  return {static_cast<int>(code), sycl_category()};
}

struct exception::details {
  std::error_code code;
  std::string what;
  std::shared_ptr<const context> ctx;
};

exception::exception(std::shared_ptr<const context> ctx, std::error_code code, const char* what_arg)
    : details_(std::make_shared<details>(details{code, what_arg, std::move(ctx)})) {}

exception::exception(std::error_code code, const std::string& what_arg)
    : exception(std::shared_ptr<const context>(), code, what_arg.c_str()) {}
exception::exception(std::error_code code, const char* what_arg)
    : exception(std::shared_ptr<const context>(), code, what_arg) {}
exception::exception(std::error_code code) : exception(code, code.message()) {}
exception::exception(int value, const std::error_category& category, const std::string& what_arg)
    : exception(std::error_code(value, category), what_arg) {}
exception::exception(int value, const std::error_category& category, const char* what_arg)
    : exception(std::error_code(value, category), what_arg) {}
exception::exception(int value, const std::error_category& category)
    : exception(std::error_code(value, category)) {}

exception::exception(context ctx, std::error_code code, const std::string& what_arg)
    : exception(std::move(ctx), code, what_arg.c_str()) {}
exception::exception(context ctx, std::error_code code, const char* what_arg)
    : exception(std::make_shared<const context>(std::move(ctx)), code, what_arg) {}
exception::exception(context ctx, std::error_code code)
    : exception(std::move(ctx), code, code.message()) {}
exception::exception(context ctx, int value, const std::error_category& category,
                     const std::string& what_arg)
    : exception(std::move(ctx), std::error_code(value, category), what_arg) {}
exception::exception(context ctx, int value, const std::error_category& category,
                     const char* what_arg)
    : exception(std::move(ctx), std::error_code(value, category), what_arg) {}
exception::exception(context ctx, int value, const std::error_category& category)
    : exception(std::move(ctx), std::error_code(value, category)) {}

exception::exception(const exception&) noexcept = default;
exception& exception::operator=(const exception&) noexcept = default;
exception::~exception() = default;

const std::error_code& exception::code() const noexcept { return details_->code; }
const std::error_category& exception::category() const noexcept {
  return details_->code.category();
}
const char* exception::what() const noexcept { return details_->what.c_str(); }
bool exception::has_context() const noexcept { return details_->ctx != nullptr; }
context exception::get_context() const {
  if (!has_context()) throw exception(errc::invalid, "the exception has no context");
  return *details_->ctx;
}

namespace detail {
void throw_error(errc code, const char* what) { throw exception(code, what); }
}  // namespace detail

namespace property::buffer {
context_bound::context_bound(sycl::context bound_context)
    : context_(std::make_shared<const sycl::context>(std::move(bound_context))) {}
sycl::context context_bound::get_context() const { return *context_; }
}  // namespace property::buffer

}  // namespace sycl
