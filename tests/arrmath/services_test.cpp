// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <omp.h>

#include <atomic>
#include <cstdlib>
#include <cstring>
#include <set>
#include <string>
#include <thread>
#include <vector>

#include "module.hpp"

namespace {

using namespace arbor::lumen::tests;

TEST(Services, TheModuleIsLoadedOnce) {
  void* const module = lumen_serv_load_arr();
  ASSERT_NE(module, nullptr);
  EXPECT_EQ(lumen_serv_load_arr(), module);
  EXPECT_NE(lumen_serv_find_symbol(module, "lumen_arr_kernel_sAbs_ttab"), nullptr);
  EXPECT_EQ(lumen_serv_find_symbol(module, "lumen_arr_kernel_sNothing_ttab"), nullptr);
}

TEST(Services, EnvironmentVariablesAreCutToTheBuffer) {
  char text[8] = "before";
  unsetenv("LUMEN_TEST_VARIABLE");
  EXPECT_EQ(lumen_serv_getenv("LUMEN_TEST_VARIABLE", text, sizeof text), 0);
  EXPECT_STREQ(text, "");
  setenv("LUMEN_TEST_VARIABLE", "12345", 1);
  EXPECT_EQ(lumen_serv_getenv("LUMEN_TEST_VARIABLE", text, sizeof text), 5);
  EXPECT_STREQ(text, "12345");
  EXPECT_EQ(lumen_serv_getenv("LUMEN_TEST_VARIABLE", text, 4), 3);
  EXPECT_STREQ(text, "123");
  EXPECT_EQ(lumen_serv_getenv("LUMEN_TEST_VARIABLE", nullptr, 0), 0);
  unsetenv("LUMEN_TEST_VARIABLE");
}

TEST(Services, TheDetectedClassIsThatOfTheProcessor) {
  constexpr std::int32_t numbers[] = {0, 7, 9};  // of the baseline, AVX2, AVX-512
  const auto own = static_cast<std::size_t>(arbor::lumen::arr::own_processor_class());
  EXPECT_EQ(lumen_serv_arr_cpu_detect(), numbers[own]);
}

TEST(Services, TheDefaultReportNamesRoutineAndArgument) {
  const std::int64_t wide = 3;
  const std::int32_t narrow = 4;
  ::testing::internal::CaptureStderr();
  lumen_serv_set_xerbla_interface(8);
  lumen_serv_xerbla("vsAbsXYZ", &wide, 5);
  lumen_serv_set_xerbla_interface(4);
  lumen_serv_default_xerbla("vdExp", &narrow, 5);
  EXPECT_EQ(::testing::internal::GetCapturedStderr(),
            "arbor lumen: argument 3 of vsAbs is wrong\n"
            "arbor lumen: argument 4 of vdExp is wrong\n");
}

TEST(Services, MessagesCarryTheirTexts) {
  ::testing::internal::CaptureStderr();
  lumen_serv_print(1, 772, 1, "lumen_arr_kernel_sNothing_ttab");
  EXPECT_EQ(::testing::internal::GetCapturedStderr(),
            "arbor lumen: liblumen_arr.so has no symbol lumen_arr_kernel_sNothing_ttab\n");
}

TEST(Services, TheLockKeepsThreadsApart) {
  std::int32_t word = 0;
  long counter = 0;
  std::vector<std::thread> threads;
  for (int t = 0; t < 4; ++t) {
    threads.emplace_back([&] {
      for (int i = 0; i < 10'000; ++i) {
        lumen_serv_lock(&word);
        ++counter;
        lumen_serv_unlock(&word);
      }
    });
  }
  for (std::thread& t : threads) t.join();
  EXPECT_EQ(counter, 40'000);
  EXPECT_EQ(word, 0);
}

TEST(ServicesDeathTest, ExitEndsTheProcessUnlessAHookIsSet) {
  EXPECT_EXIT(lumen_serv_exit(2), ::testing::ExitedWithCode(2), "");
  static std::int32_t seen = 0;
  EXPECT_EQ(lumen_serv_set_exit_hook([](std::int32_t code) { seen = code; }), nullptr);
  lumen_serv_exit(7);
  lumen_serv_set_exit_hook(nullptr);
  EXPECT_EQ(seen, 7);
}

/// A kernel that notes who ran it, under what mode, and leaves a status for negative elements.
struct probe {
  static inline std::atomic<int> calls;
  static inline std::atomic<std::int64_t> elements;
  static inline std::atomic<std::int64_t> modes;  // ored
  static inline const arr_state* state;

  static void kernel(std::int32_t n, const float* a, float* y) {
    ++calls;
    elements += n;
    modes |= state->get_mode();
    for (std::int32_t i = 0; i < n; ++i) {
      y[i] = a[i] + 1;
      if (a[i] < 0) state->set_status(state->get_status() | 1);
    }
  }
  static void strided(std::int32_t n, const float* a, std::int64_t inca, float* y,
                      std::int64_t incy) {
    ++calls;
    for (std::int32_t i = 0; i < n; ++i) y[i * incy] = a[i * inca] + 1;
  }
};

class Threader : public ::testing::Test {
 protected:
  void SetUp() override {
#ifdef __SANITIZE_THREAD__
    GTEST_SKIP() << "the sanitizer does not see the synchronisation of the OpenMP runtime";
#endif
  }
  static constexpr std::int32_t n = 100'001;
  static constexpr float expensive = 1000;
  Threader() : x_(n), y_(n) {
    for (std::size_t i = 0; i < x_.size(); ++i) x_[i] = static_cast<float>(i);
    probe::state = &state_;
    probe::calls = 0;
    probe::elements = 0;
    probe::modes = 0;
    state_.clear_status();
    omp_set_num_threads(4);
  }
  ~Threader() override { state_.set_mode(LUMEN_ARR_HA); }

  int calls_of(std::int32_t count, float cost) {
    probe::calls = 0;
    probe::elements = 0;
    lumen_arr_serv_threader_s_1i_1o(&probe::kernel, count, x_.data(), y_.data(), cost,
                                    lumen_serv_load_arr());
    EXPECT_EQ(probe::elements, count);
    for (std::int32_t i = 0; i < count; ++i) EXPECT_EQ(y_[i], x_[i] + 1) << i;
    return probe::calls;
  }

  std::vector<float> x_, y_;
  arr_state state_;
};

TEST_F(Threader, CoversEveryElementOnceOnSeveralThreads) {
  EXPECT_EQ(calls_of(n, expensive), 4);
  EXPECT_EQ(calls_of(8192, expensive), 2) << "no thread has less than a grain";
  EXPECT_EQ(calls_of(100, expensive), 1);
  EXPECT_EQ(calls_of(n, 1e-3f), 1) << "not worth a thread";
  omp_set_num_threads(1);
  EXPECT_EQ(calls_of(n, expensive), 1);
}

TEST_F(Threader, ThreadsHaveTheCallersModeAndGiveItTheirStatus) {
  state_.set_mode(LUMEN_ARR_EP);
  x_[10] = -1;
  x_[n - 1] = -1;
  EXPECT_EQ(calls_of(n, expensive), 4);
  EXPECT_EQ(probe::modes, LUMEN_ARR_EP);
  EXPECT_EQ(state_.get_status(), 1);
  EXPECT_EQ(state_.get_mode(), LUMEN_ARR_EP);
}

TEST_F(Threader, CallbacksKeepACallOnItsThread) {
  state_.set_mode(LUMEN_ARR_HA | LUMEN_ARR_CALLBACK);
  EXPECT_EQ(calls_of(n, expensive), 1);
}

TEST_F(Threader, InAParallelRegionACallStaysOnItsThread) {
  std::set<int> calls;
#pragma omp parallel num_threads(2)
#pragma omp single
  calls.insert(calls_of(n, expensive));
  EXPECT_EQ(calls, std::set<int>{1});
}

TEST_F(Threader, IncrementsMoveEachThreadToItsElements) {
  std::vector<float> x(2 * n), y(3 * n, 0.0f);
  for (std::size_t i = 0; i < x.size(); ++i) x[i] = static_cast<float>(i);
  lumen_arr_serv_threader_s_1iI_1oI(&probe::strided, n, &x[2 * (n - 1)], -2, y.data(), 3, expensive,
                                    lumen_serv_load_arr());
  EXPECT_EQ(probe::calls, 4);
  for (std::size_t i = 0; i < n; ++i) ASSERT_EQ(y[3 * i], x[2 * (n - 1 - i)] + 1) << i;
}

}  // namespace
