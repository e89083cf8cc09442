// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <exception>
#include <stdexcept>
#include <string>
#include <system_error>
#include <type_traits>
#include <vector>

#include "support.hpp"

namespace {

using conformance::throws;
using sycl::errc;

static_assert(std::is_base_of_v<std::exception, sycl::exception>);
static_assert(std::is_nothrow_copy_constructible_v<sycl::exception>);
static_assert(std::is_nothrow_copy_assignable_v<sycl::exception>);
static_assert(!std::is_default_constructible_v<sycl::exception>);
static_assert(std::is_constructible_v<sycl::exception, std::error_code>);
static_assert(std::is_constructible_v<sycl::exception, std::error_code, std::string>);
static_assert(std::is_constructible_v<sycl::exception, std::error_code, const char*>);
static_assert(std::is_constructible_v<sycl::exception, int, const std::error_category&>);
static_assert(
    std::is_constructible_v<sycl::exception, int, const std::error_category&, std::string>);
static_assert(
    std::is_constructible_v<sycl::exception, int, const std::error_category&, const char*>);
static_assert(std::is_constructible_v<sycl::exception, sycl::context, std::error_code>);
static_assert(
    std::is_constructible_v<sycl::exception, sycl::context, std::error_code, std::string>);
static_assert(std::is_constructible_v<sycl::exception, sycl::context, int,
                                      const std::error_category&, const char*>);
static_assert(std::is_error_code_enum_v<errc>);
static_assert(std::is_convertible_v<errc, std::error_code>);
static_assert(noexcept(sycl::sycl_category()));
static_assert(noexcept(sycl::make_error_code(errc::invalid)));
static_assert(noexcept(std::declval<const sycl::exception&>().code()));
static_assert(noexcept(std::declval<const sycl::exception&>().category()));
static_assert(noexcept(std::declval<const sycl::exception&>().what()));
static_assert(noexcept(std::declval<const sycl::exception&>().has_context()));
static_assert(std::is_same_v<decltype(std::declval<const sycl::exception&>().code()),
                             const std::error_code&>);
static_assert(std::is_same_v<decltype(std::declval<const sycl::exception&>().category()),
                             const std::error_category&>);

static_assert(std::is_same_v<sycl::exception_list::value_type, std::exception_ptr>);
static_assert(std::is_same_v<sycl::exception_list::reference, std::exception_ptr&>);
static_assert(std::is_same_v<sycl::exception_list::const_reference, const std::exception_ptr&>);
static_assert(std::is_same_v<sycl::exception_list::size_type, std::size_t>);
static_assert(std::is_same_v<sycl::exception_list::iterator, sycl::exception_list::const_iterator>);
static_assert(std::is_same_v<sycl::async_handler, std::function<void(sycl::exception_list)>>);

TEST(ConformanceException, CategoryAndCodes) {
  EXPECT_STREQ(sycl::sycl_category().name(), "sycl");
  EXPECT_EQ(&sycl::sycl_category(), &sycl::sycl_category());
  for (const errc code :
       {errc::runtime, errc::kernel, errc::accessor, errc::nd_range, errc::event,
        errc::kernel_argument, errc::build, errc::invalid, errc::memory_allocation, errc::platform,
        errc::profiling, errc::feature_not_supported, errc::kernel_not_supported,
        errc::backend_mismatch}) {
    const std::error_code error = code;
    EXPECT_EQ(error.value(), static_cast<int>(code));
    EXPECT_EQ(error.category(), sycl::sycl_category());
    EXPECT_EQ(error, sycl::make_error_code(code));
    EXPECT_TRUE(error == code);
    EXPECT_TRUE(static_cast<bool>(error));
    EXPECT_FALSE(error.message().empty());
  }
  EXPECT_EQ(static_cast<int>(errc::success), 0);
  EXPECT_FALSE(static_cast<bool>(std::error_code(errc::success)));
}

TEST(ConformanceException, CarriesCodeAndText) {
  const sycl::exception with_string(errc::nd_range, std::string("a text"));
  EXPECT_EQ(with_string.code(), errc::nd_range);
  EXPECT_EQ(with_string.category(), sycl::sycl_category());
  EXPECT_NE(std::string(with_string.what()).find("a text"), std::string::npos);

  const sycl::exception with_literal(make_error_code(errc::build), "other");
  EXPECT_NE(std::string(with_literal.what()).find("other"), std::string::npos);

  const sycl::exception bare(make_error_code(errc::accessor));
  EXPECT_EQ(bare.code(), errc::accessor);
  EXPECT_NE(bare.what(), nullptr);

  const sycl::exception foreign(static_cast<int>(std::errc::timed_out), std::generic_category(),
                                "late");
  EXPECT_EQ(foreign.code(), std::make_error_code(std::errc::timed_out));
  EXPECT_EQ(foreign.category(), std::generic_category());
  EXPECT_FALSE(foreign.code() == errc::runtime);

  const sycl::exception copy = with_string;
  EXPECT_EQ(copy.code(), with_string.code());
  EXPECT_STREQ(copy.what(), with_string.what());
}

TEST(ConformanceException, ContextIsOptional) {
  const sycl::exception without(make_error_code(errc::runtime));
  EXPECT_FALSE(without.has_context());
  EXPECT_TRUE(throws(errc::invalid, [&] { without.get_context(); }));

  const sycl::context context;
  const sycl::exception with(context, make_error_code(errc::runtime), "text");
  EXPECT_TRUE(with.has_context());
  EXPECT_EQ(with.get_context(), context);
  EXPECT_EQ(with.code(), errc::runtime);
  const sycl::exception numbered(context, 7, sycl::sycl_category());
  EXPECT_EQ(numbered.get_context(), context);
  EXPECT_EQ(numbered.code().value(), 7);
}

TEST(ConformanceException, IsCaughtAsAStandardException) {
  bool caught = false;
  try {
    throw sycl::exception(errc::invalid, "thrown");
  } catch (const std::exception& error) {
    caught = true;
    EXPECT_NE(std::string(error.what()).find("thrown"), std::string::npos);
  }
  EXPECT_TRUE(caught);
}

TEST(ConformanceException, EmptyListIsEmpty) {
  const sycl::exception_list list;
  EXPECT_EQ(list.size(), 0U);
  EXPECT_TRUE(list.begin() == list.end());
}

TEST(ConformanceException, AsynchronousErrorsAreListed) {
  std::vector<std::string> texts;
  std::size_t calls = 0;
  sycl::queue q([&](sycl::exception_list errors) {
    ++calls;
    std::size_t counted = 0;
    for (const std::exception_ptr& error : errors) {
      ++counted;
      try {
        std::rethrow_exception(error);
      } catch (const std::exception& caught) {
        texts.emplace_back(caught.what());
      }
    }
    EXPECT_EQ(counted, errors.size());
  });
  q.submit([](sycl::handler& cgh) {
    cgh.host_task([] { throw sycl::exception(errc::runtime, "first"); });
  });
  q.submit([](sycl::handler& cgh) { cgh.host_task([] { throw std::runtime_error("second"); }); });
  q.wait();
  EXPECT_EQ(calls, 0U) << "wait() must leave the errors to wait_and_throw()";
  q.wait_and_throw();
  ASSERT_EQ(texts.size(), 2U);
  const std::string all = texts[0] + texts[1];
  EXPECT_NE(all.find("first"), std::string::npos);
  EXPECT_NE(all.find("second"), std::string::npos);
  const std::size_t calls_before = calls;
  q.throw_asynchronous();
  EXPECT_EQ(calls, calls_before) << "errors are delivered once, and the handler not for none";
}

}  // namespace
