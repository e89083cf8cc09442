// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>
#include <sycl/sycl.hpp>

#include "gate.hpp"

namespace {

using sycl::backend;
using sycl::errc;

template <typename Action>
errc code_of(Action&& act) {
  try {
    act();
  } catch (const sycl::exception& e) {
    return static_cast<errc>(e.code().value());
  }
  return errc::success;
}

TEST(Native, HandlesLeadBackToTheirObjects) {
  const sycl::queue q;
  const sycl::device d = q.get_device();
  const sycl::context c = q.get_context();
  const sycl::platform p = d.get_platform();
  EXPECT_EQ(sycl::make_device<backend::host>(sycl::get_native<backend::host>(d)), d);
  EXPECT_EQ(sycl::make_platform<backend::host>(sycl::get_native<backend::host>(p)), p);
  EXPECT_EQ(sycl::make_context<backend::host>(sycl::get_native<backend::host>(c)), c);
  EXPECT_EQ(sycl::make_queue<backend::host>(sycl::get_native<backend::host>(q), c), q);
  const auto handle = sycl::get_native<backend::host>(q);
  EXPECT_EQ(sycl::detail::make_platform(sycl::get_native<backend::host>(p), backend::host), p);
  EXPECT_EQ(
      sycl::detail::make_context(sycl::get_native<backend::host>(c), {}, backend::host, true, {d}),
      c);
  EXPECT_EQ(sycl::detail::make_queue(handle, true, c, &d, false, {}, {}, backend::host), q);
}

TEST(Native, BadHandlesAreRefused) {
  const sycl::queue q;
  const sycl::context c = q.get_context();
  int local = 0;
  const auto wrong = reinterpret_cast<sycl::detail::native_handle>(&local);
  EXPECT_EQ(code_of([&] { sycl::make_device<backend::host>(wrong); }), errc::invalid);
  EXPECT_EQ(code_of([&] { sycl::make_platform<backend::host>(0); }), errc::invalid);
  EXPECT_EQ(code_of([&] { sycl::make_context<backend::host>(wrong); }), errc::invalid);
  EXPECT_EQ(code_of([&] { sycl::make_queue<backend::host>(wrong, c); }), errc::invalid);
  const auto context_handle = sycl::get_native<backend::host>(c);
  EXPECT_EQ(code_of([&] { sycl::make_queue<backend::host>(context_handle, c); }), errc::invalid);
  EXPECT_EQ(code_of([&] { sycl::make_context<backend::opencl>(context_handle); }),
            errc::backend_mismatch);
  EXPECT_EQ(code_of([&] { sycl::get_native<backend::stratum>(q); }), errc::backend_mismatch);
  EXPECT_EQ(code_of([&] { sycl::get_native<backend::opencl>(q.get_device()); }),
            errc::backend_mismatch);
  EXPECT_EQ(code_of([&] {
              sycl::make_queue<backend::host>(sycl::get_native<backend::host>(q),
                                              sycl::context(q.get_device()));
            }),
            errc::invalid);
  sycl::detail::native_handle dead = 0;
  {
    const sycl::queue gone;
    dead = sycl::get_native<backend::host>(gone);
  }
  EXPECT_EQ(code_of([&] { sycl::make_queue<backend::host>(dead, c); }), errc::invalid);
}

TEST(Native, QueuesFromOneHandleShareOneOrder) {
  sycl::queue original{sycl::property::queue::in_order()};
  int errors = 0;
  sycl::queue made = sycl::make_queue<backend::host>(
      sycl::get_native<backend::host>(original), original.get_context(),
      [&](const sycl::exception_list& list) { errors += static_cast<int>(list.size()); });
  EXPECT_FALSE(made == original);
  EXPECT_TRUE(made.is_in_order());
  gate g;
  g.close(original);
  const sycl::event after = made.single_task([] { throw 1; });
  EXPECT_FALSE(is_complete(after));
  g.open();
  original.wait();
  EXPECT_TRUE(is_complete(after));
  made.throw_asynchronous();
  EXPECT_EQ(errors, 1);
}

TEST(Native, ContextsFromOneHandleShareAllocations) {
  const sycl::queue q;
  const sycl::context c = q.get_context();
  const sycl::context made = sycl::make_context<backend::host>(sycl::get_native<backend::host>(c),
                                                               [](const sycl::exception_list&) {});
  EXPECT_FALSE(made == c);
  void* const p = sycl::malloc_device(16, q);
  EXPECT_EQ(sycl::get_pointer_type(p, made), sycl::usm::alloc::device);
  sycl::free(p, made);
}

}  // namespace
