// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <chrono>
#include <memory>
#include <stdexcept>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>
#include <sycl/sycl.hpp>

namespace {

static_assert(std::is_error_code_enum_v<sycl::errc>);
static_assert(std::is_base_of_v<std::exception, sycl::exception>);
static_assert(std::is_nothrow_copy_constructible_v<sycl::exception>);
static_assert(static_cast<int>(sycl::errc::success) == 0);
static_assert(static_cast<int>(sycl::errc::runtime) == 1);
static_assert(static_cast<int>(sycl::errc::invalid) == 8);
static_assert(static_cast<int>(sycl::errc::backend_mismatch) == 14);

/// Collects the messages of asynchronous errors.
struct collector {
  std::shared_ptr<std::vector<std::string>> messages = std::make_shared<std::vector<std::string>>();

  void operator()(sycl::exception_list list) const {
    for (const std::exception_ptr& each : list) {
      try {
        std::rethrow_exception(each);
      } catch (const std::exception& e) {
        messages->push_back(e.what());
      }
    }
  }
};

TEST(Exception, CarriesCodeTextAndContext) {
  const sycl::exception plain(sycl::errc::kernel, "text");
  EXPECT_EQ(plain.code(), sycl::errc::kernel);
  EXPECT_EQ(plain.code().value(), 2);
  EXPECT_EQ(plain.category(), sycl::sycl_category());
  EXPECT_STREQ(plain.category().name(), "sycl");
  EXPECT_STREQ(plain.what(), "text");
  EXPECT_FALSE(plain.has_context());
  try {
    plain.get_context();
    FAIL();
  } catch (const sycl::exception& e) {
    EXPECT_EQ(e.code(), sycl::errc::invalid);
  }
  const sycl::context ctx;
  const sycl::exception with(ctx, 3, sycl::sycl_category(), std::string("more"));
  EXPECT_EQ(with.code(), sycl::errc::accessor);
  EXPECT_TRUE(with.has_context());
  EXPECT_EQ(with.get_context(), ctx);
  const sycl::exception copy = with;  // NOLINT: the copy is the point
  EXPECT_STREQ(copy.what(), "more");
  EXPECT_STRNE(sycl::exception(sycl::errc::build).what(), "");
  EXPECT_EQ(sycl::make_error_code(sycl::errc::event).value(), 5);
}

TEST(AsynchronousErrors, OfKernelsReachTheHandlerByWaitAndThrow) {
  const collector errors;
  sycl::queue q(errors);
  q.single_task([] { throw std::runtime_error("one"); });
  q.parallel_for(100000, [](sycl::id<1> i) {
    if (i[0] == 77777) throw std::runtime_error("two");
  });
  q.wait();
  EXPECT_TRUE(errors.messages->empty());
  q.wait_and_throw();
  std::sort(errors.messages->begin(), errors.messages->end());
  EXPECT_EQ(*errors.messages, (std::vector<std::string>{"one", "two"}));
  q.wait_and_throw();
  EXPECT_EQ(errors.messages->size(), 2U);
}

TEST(AsynchronousErrors, OfHostTasksReachTheHandler) {
  const collector errors;
  sycl::queue q(errors);
  q.submit([](sycl::handler& cgh) { cgh.host_task([] { throw std::runtime_error("host"); }); });
  q.wait();
  q.throw_asynchronous();
  EXPECT_EQ(*errors.messages, std::vector<std::string>{"host"});
}

TEST(AsynchronousErrors, ReachTheHandlerThroughTheEvent) {
  const collector errors;
  sycl::queue q(errors);
  sycl::event e = q.single_task([] { throw std::runtime_error("event"); });
  e.wait();
  EXPECT_TRUE(errors.messages->empty());
  e.wait_and_throw();
  EXPECT_EQ(*errors.messages, std::vector<std::string>{"event"});
  sycl::event second = q.single_task([] { throw std::runtime_error("second"); });
  sycl::event::wait_and_throw({e, second});
  EXPECT_EQ(errors.messages->back(), "second");
}

TEST(AsynchronousErrors, ReachTheHandlerOfTheContextWithoutOneOfTheQueue) {
  const collector of_context;
  const collector of_queue;
  const sycl::context ctx(sycl::device(), of_context);
  sycl::queue without(ctx, ctx.get_devices()[0]);
  sycl::queue with(ctx, ctx.get_devices()[0], of_queue);
  without.single_task([] { throw std::runtime_error("a"); });
  with.single_task([] { throw std::runtime_error("b"); });
  without.wait_and_throw();
  with.wait_and_throw();
  EXPECT_EQ(*of_context.messages, std::vector<std::string>{"a"});
  EXPECT_EQ(*of_queue.messages, std::vector<std::string>{"b"});
}

TEST(AsynchronousErrors, ReachTheHandlerWhenTheQueueIsDestroyed) {
  const collector errors;
  {
    sycl::queue q(errors);
    q.single_task([] { throw std::runtime_error("late"); }).wait();
    // The thread that ran the command lets go of the queue a little after the command's end.
    sycl::queue other(errors);
    q = other;
  }
  for (int i = 0; i < 10000 && errors.messages.use_count() > 1; ++i) {
    std::this_thread::sleep_for(std::chrono::milliseconds(1));
  }
  EXPECT_EQ(errors.messages.use_count(), 1);
  EXPECT_EQ(*errors.messages, std::vector<std::string>{"late"});
}

TEST(AsynchronousErrors, AHandlerMayThrow) {
  sycl::queue q([](const sycl::exception_list& list) {
    EXPECT_EQ(list.size(), 1U);
    std::rethrow_exception(*list.begin());
  });
  q.single_task([] { throw sycl::exception(sycl::errc::kernel, "up"); });
  try {
    q.wait_and_throw();
    FAIL();
  } catch (const sycl::exception& e) {
    EXPECT_EQ(e.code(), sycl::errc::kernel);
  }
}

TEST(AsynchronousErrors, DoNotStopWhatComesAfter) {
  const collector errors;
  sycl::queue q(errors, {sycl::property::queue::in_order()});
  int value = 0;
  int* const p = &value;
  q.single_task([] { throw std::runtime_error("x"); });
  q.single_task([=] { *p = 1; });
  q.wait_and_throw();
  EXPECT_EQ(value, 1);
  EXPECT_EQ(errors.messages->size(), 1U);
}

TEST(AsynchronousErrorsDeathTest, WithoutAHandlerEndTheProgram) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  EXPECT_DEATH(
      {
        sycl::queue q;
        q.single_task([] { throw std::runtime_error("nobody listens"); });
        q.wait_and_throw();
      },
      "nobody listens");
}

TEST(AsynchronousErrors, ThrowingFromTheCommandGroupSubmitsNothing) {
  sycl::queue q;
  bool ran = false;
  bool* const p = &ran;
  EXPECT_THROW(q.submit([&](sycl::handler& cgh) {
    cgh.single_task([=] { *p = true; });
    throw std::logic_error("no");
  }),
               std::logic_error);
  q.wait();
  EXPECT_FALSE(ran);
}

}  // namespace
