// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <cmath>
#include <cstddef>
#include <limits>
#include <thread>
#include <vector>

#include "module.hpp"

namespace {

using namespace arbor::lumen::tests;

using exp_kernel = void (*)(std::int32_t, const double*, double*);

const arr_state& state() {
  static const arr_state all;
  return all;
}

exp_kernel of_class(const char* name, int index = 0) {
  return reinterpret_cast<exp_kernel>(ttab(name)[index]);
}

TEST(ArrState, SettersReturnWhatWasSet) {
  state().set_mode(LUMEN_ARR_LA);
  EXPECT_EQ(state().set_mode(LUMEN_ARR_EP), LUMEN_ARR_LA);
  EXPECT_EQ(state().get_mode(), LUMEN_ARR_EP);
  state().set_status(3);
  EXPECT_EQ(state().set_status(-1), 3);
  EXPECT_EQ(state().get_status(), -1);
  EXPECT_EQ(state().clear_status(), -1);
  EXPECT_EQ(state().get_status(), LUMEN_ARR_STATUS_OK);
  const lumen_arr_error_callback callback = [](lumen_arr_error_record*) { return 0; };
  EXPECT_EQ(state().set_callback(callback), nullptr);
  EXPECT_EQ(state().set_callback(nullptr), callback);
}

TEST(ArrState, BelongsToAThread) {
  state().set_mode(LUMEN_ARR_EP);
  state().set_status(4);
  std::thread([] {
    EXPECT_EQ(state().get_mode(), LUMEN_ARR_HA);
    EXPECT_EQ(state().get_status(), LUMEN_ARR_STATUS_OK);
    state().set_mode(LUMEN_ARR_LA);
    state().set_status(1);
  }).join();
  EXPECT_EQ(state().get_mode(), LUMEN_ARR_EP);
  EXPECT_EQ(state().get_status(), 4);
  state().clear_status();
}

TEST(ArrState, KernelsAddToTheStatus) {
  state().set_mode(LUMEN_ARR_HA);
  state().clear_status();
  double x = 1e300, y;
  of_class("dExp")(1, &x, &y);
  EXPECT_EQ(state().get_status(), LUMEN_ARR_STATUS_OVERFLOW);
  x = -1e300;
  of_class("dExp")(1, &x, &y);
  EXPECT_EQ(state().get_status(), LUMEN_ARR_STATUS_OVERFLOW | LUMEN_ARR_STATUS_UNDERFLOW);
  state().clear_status();
}

TEST(ArrState, TheModeChoosesTheBody) {
  std::vector<double> x(1000), ha(1000), ep(1000), other(1000);
  for (std::size_t i = 0; i < x.size(); ++i) x[i] = 0.01 * static_cast<double>(i) + 0.005;
  const auto with_mode = [&](std::int64_t mode, std::vector<double>& y) {
    state().set_mode(mode);
    of_class("dExp")(1000, x.data(), y.data());
  };
  with_mode(LUMEN_ARR_HA, ha);
  with_mode(LUMEN_ARR_EP, ep);
  EXPECT_NE(ha, ep);
  with_mode(0x40 | LUMEN_ARR_EP, other);
  EXPECT_EQ(other, ep) << "other bits of the mode decide nothing";
  with_mode(0, other);
  EXPECT_EQ(other, ha) << "no accuracy is the highest";
}

struct noted {
  static inline std::vector<lumen_arr_error_record> records;
  static int callback(lumen_arr_error_record* record) {
    records.push_back(*record);
    record->result[0] = 42;
    return 0;
  }
};

TEST(ArrCallback, IsToldOfEveryElementWithAStatusAndMayReplaceItsResult) {
  noted::records.clear();
  const double infinity = std::numeric_limits<double>::infinity();
  std::vector<double> x = {1, 0, 2, -1, 4}, y(5);
  ASSERT_EQ(state().set_callback(&noted::callback), nullptr);
  state().set_mode(LUMEN_ARR_HA);
  of_class("dLn")(5, x.data(), y.data());
  EXPECT_TRUE(noted::records.empty()) << "the mode does not ask for it";
  EXPECT_EQ(y[1], -infinity);

  state().set_mode(LUMEN_ARR_HA | LUMEN_ARR_CALLBACK);
  of_class("dLn")(5, x.data(), x.data());
  state().set_callback(nullptr);
  state().set_mode(LUMEN_ARR_HA);
  ASSERT_EQ(noted::records.size(), 2u);
  EXPECT_EQ(noted::records[0].code, 2);
  EXPECT_EQ(noted::records[0].index, 1);
  EXPECT_EQ(noted::records[0].argument[0], 0);
  EXPECT_EQ(noted::records[0].result[0], -infinity);
  EXPECT_EQ(noted::records[1].code, 1);
  EXPECT_EQ(noted::records[1].index, 3);
  EXPECT_EQ(noted::records[1].argument[0], -1) << "also of a call in place";
  EXPECT_TRUE(std::isnan(noted::records[1].result[0]));
  EXPECT_EQ(x, (std::vector<double>{0, 42, y[2], 42, y[4]}));
  state().clear_status();
}

TEST(ArrRecord, HasTheLayoutOfTheInterface) {
  EXPECT_EQ(offsetof(lumen_arr_error_record, code), 0u);
  EXPECT_EQ(offsetof(lumen_arr_error_record, index), 4u);
  EXPECT_EQ(offsetof(lumen_arr_error_record, argument), 8u);
  EXPECT_EQ(offsetof(lumen_arr_error_record, result), 24u);
  EXPECT_EQ(offsetof(lumen_arr_error_record, argument_imag), 112u);
  EXPECT_EQ(offsetof(lumen_arr_error_record, result_imag), 128u);
}

TEST(ArrTables, TypesHaveTheKernelsOfTheirClassOrOfTheBestBelow) {
  const auto best = static_cast<std::int32_t>(arbor::lumen::arr::own_processor_class());
  const std::int32_t classes[] = {0, 0, 0, 1, 1, 2, 2, 2, 2, 2};
  for (std::int32_t type = 0; type < 10; ++type)
    EXPECT_EQ(state().table_index(type), std::min(classes[type], best)) << type;
  EXPECT_EQ(state().table_index(100), std::min(2, best));
  EXPECT_EQ(state().table_index(-1), 0);
}

TEST(ArrTables, HaveCostsForBothForms) {
  for (const char* name : {"sExp", "sExpI", "dPow", "cMul", "zAbsI"}) {
    const auto* const cost =
        arr_symbol<const float*>(std::string("lumen_arr_kernel_") + name + "_ctab");
    EXPECT_GT(cost[0], 0) << name;
    EXPECT_NE(ttab(name)[0], nullptr) << name;
  }
}

}  // namespace
