// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <array>
#include <vector>

#include <gtest/gtest.h>
#include <sycl/sycl.hpp>

namespace {

using sycl::errc;

constexpr const char* several =
    "Attempt to set multiple actions for the command group. Command group must consist of a "
    "single kernel or explicit memory operation.";

template <typename Action>
errc code_of(Action&& act) {
  try {
    act();
  } catch (const sycl::exception& e) {
    return static_cast<errc>(e.code().value());
  }
  return errc::success;
}

TEST(BadUse, SeveralActionsInOneCommandGroup) {
  sycl::queue q;
  std::array<int, 4> a{};
  int* const p = a.data();
  using action = void (*)(sycl::handler&, int*);
  const action actions[] = {
      [](sycl::handler& cgh, int* t) { cgh.single_task([=] { *t = 1; }); },
      [](sycl::handler& cgh, int* t) { cgh.parallel_for(2, [=](sycl::id<1> i) { t[i] = 1; }); },
      [](sycl::handler& cgh, int* t) { cgh.host_task([=] { *t = 1; }); },
      [](sycl::handler& cgh, int* t) { cgh.memcpy(t, t + 1, 4); },
      [](sycl::handler& cgh, int* t) { cgh.memset(t, 1, 4); },
      [](sycl::handler& cgh, int* t) { cgh.fill(t, 1, 1); },
      [](sycl::handler& cgh, int* t) { cgh.prefetch(t, 4); },
  };
  for (const action first : actions) {
    for (const action second : actions) {
      try {
        q.submit([&](sycl::handler& cgh) {
          first(cgh, p);
          second(cgh, p);
        });
        FAIL() << "accepted";
      } catch (const sycl::exception& e) {
        EXPECT_EQ(e.code(), errc::runtime);
        EXPECT_STREQ(e.what(), several);
      }
    }
  }
  q.wait();
  EXPECT_EQ(a, (std::array<int, 4>{}));
}

TEST(BadUse, NullPointersInMemoryOperations) {
  sycl::queue q;
  int value = 0;
  EXPECT_EQ(code_of([&] { q.memcpy(nullptr, &value, 4); }), errc::invalid);
  EXPECT_EQ(code_of([&] { q.memcpy(&value, nullptr, 4); }), errc::invalid);
  EXPECT_EQ(code_of([&] { q.memset(nullptr, 0, 4); }), errc::invalid);
  EXPECT_EQ(code_of([&] { q.fill(static_cast<int*>(nullptr), 0, 1); }), errc::invalid);
  EXPECT_EQ(code_of([&] { q.copy(&value, static_cast<int*>(nullptr), 1); }), errc::invalid);
}

TEST(BadUse, DeviceMemoryOfAnotherContext) {
  sycl::queue q;
  const sycl::context other(q.get_device());
  int* const p = sycl::malloc_device<int>(4, q.get_device(), other);
  int value = 0;
  EXPECT_EQ(code_of([&] { q.memcpy(&value, p + 1, 4); }), errc::invalid);
  EXPECT_EQ(code_of([&] { q.memcpy(p, &value, 4); }), errc::invalid);
  EXPECT_EQ(code_of([&] { q.memset(p, 0, 16); }), errc::invalid);
  sycl::free(p, other);
}

TEST(BadUse, PlaceholdersOfNothing) {
  sycl::queue q;
  const sycl::accessor<int, 1, sycl::access_mode::read, sycl::target::device,
                       sycl::access::placeholder::true_t>
      nothing;
  EXPECT_EQ(code_of([&] { q.submit([&](sycl::handler& cgh) { cgh.require(nothing); }); }),
            errc::invalid);
}

TEST(BadUse, CopiesBeyondTheTarget) {
  sycl::queue q;
  sycl::buffer<int> large(sycl::range<1>(8));
  sycl::buffer<int> small(sycl::range<1>(4));
  EXPECT_EQ(code_of([&] {
              q.submit([&](sycl::handler& cgh) {
                const sycl::accessor from(large, cgh, sycl::read_only);
                const sycl::accessor to(small, cgh, sycl::write_only);
                cgh.copy(from, to);
              });
            }),
            errc::invalid);
}

}  // namespace
