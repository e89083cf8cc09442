// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The reductions of large arguments by themselves, against pi in 1500 bits: over all binades, on
/// the arguments next to multiples of pi/2, and around the thresholds.

#include "scalar/trig/fixed_turn.hpp"
#include "scalar/trig/octants.hpp"
#include "scalar/trig/quarter_turn.hpp"
#include "scalar/trig/tangent_rows_s.hpp"
#include "scalar/trig/turn_rows.hpp"
#include "trig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;

/// What a reduction leaves of x, in high precision.
class angle {
 public:
  angle() { mpfr_inits2(1500, turn_, rest_, part_, nullptr); }
  ~angle() { mpfr_clears(turn_, rest_, part_, nullptr); }
  angle(const angle&) = delete;
  angle& operator=(const angle&) = delete;

  /// The distance of x from 2 pi steps/count + the parts, up to full turns, over |x - 2 pi
  /// steps/count|.
  template <typename... Parts>
  double relative_error(double x, long steps, long count, Parts... parts) {
    full_turn();
    mpfr_mul_si(rest_, turn_, steps, MPFR_RNDN);
    mpfr_div_si(rest_, rest_, count, MPFR_RNDN);
    mpfr_d_sub(rest_, x, rest_, MPFR_RNDN);
    mpfr_remainder(rest_, rest_, turn_, MPFR_RNDN);
    mpfr_abs(part_, rest_, MPFR_RNDN);
    (mpfr_sub_d(rest_, rest_, parts, MPFR_RNDN), ...);
    mpfr_div(rest_, rest_, part_, MPFR_RNDN);
    return std::fabs(mpfr_get_d(rest_, MPFR_RNDN));
  }

  /// frac(x/(2 pi)) 2^64 less \p place, up to multiples of 2^64.
  double error_of_place(double x, std::uint64_t place) {
    full_turn();
    mpfr_d_div(rest_, x, turn_, MPFR_RNDN);
    mpfr_frac(rest_, rest_, MPFR_RNDN);
    mpfr_mul_2ui(rest_, rest_, 64, MPFR_RNDN);
    mpfr_sub_d(rest_, rest_, static_cast<double>(place >> 32) * 0x1p32, MPFR_RNDN);
    mpfr_sub_d(rest_, rest_, static_cast<double>(place & 0xffffffff), MPFR_RNDN);
    const double error = std::fabs(mpfr_get_d(rest_, MPFR_RNDN));
    return std::min(error, 0x1p64 - error);
  }

 private:
  void full_turn() {
    mpfr_const_pi(turn_, MPFR_RNDN);
    mpfr_mul_2ui(turn_, turn_, 1, MPFR_RNDN);
  }
  mpfr_t turn_;
  mpfr_t rest_;
  mpfr_t part_;
};

constexpr std::uint64_t largest = 0x7fefffffffffffff;

std::vector<std::uint64_t> doubles_from(std::uint64_t lowest) {
  auto list = joined(every_binade(lowest, largest, 4), between(hard_doubles, lowest, largest));
  list.push_back(largest);
  for (std::uint64_t e = lowest >> 52; e < 2047; ++e) list.push_back(e << 52);
  return list;
}

TEST(TrigReduction, RowsOf512Steps) {
  angle exact;
  double worst = 0;
  for (const std::uint64_t p : joined(doubles_from(0x40f0000000000000), around(largest - 4))) {
    for (const std::uint64_t sign : {std::uint64_t{0}, std::uint64_t{0x8000000000000000}}) {
      const double x = std::bit_cast<double>(p | sign);
      const auto a = scalar::turn_step::nearest(x);
      ASSERT_GE(a.step, 0);
      ASSERT_LT(a.step, 512);
      ASSERT_LE(std::fabs(a.rest), 0.00614);  // pi/512
      worst = std::max(worst, exact.relative_error(x, a.step, 512, a.rest, a.rest_low));
    }
  }
  EXPECT_LT(worst, 0x1p-64);
}

TEST(TrigReduction, FixedPointToQuarterTurns) {
  angle exact;
  double worst = 0;
  for (const std::uint64_t p : doubles_from(0x4000000000000000)) {
    const double x = std::bit_cast<double>(p);
    const auto a = scalar::quarter_turn::nearest(x);
    ASSERT_LE(std::fabs(a.rest), 0.7853981633974484);
    worst = std::max(
        worst, exact.relative_error(x, static_cast<long>(a.quarters & 3), 4, a.rest, a.rest_low));
  }
  EXPECT_LT(worst, 0x1p-61);
}

TEST(TrigReduction, ArgumentsBelowTwoAreQuarterTurnsAlready) {
  for (const double x : {1.0, 0.5, 1.9999999999999998}) {
    const auto a = scalar::quarter_turn::nearest(x);
    EXPECT_EQ(a.quarters, 0u);
    EXPECT_EQ(a.rest, x);
    EXPECT_EQ(a.rest_low, 0);
  }
}

TEST(TrigReduction, SlicesOfDoubles) {
  angle exact;
  double worst = 0;
  const auto arguments =
      joined(joined(doubles_from(0x4160000000000000), evenly(0x1p30, 2'000)),
             around(std::uint64_t{0x41d0000000000000}));  // 2^30, where the slices begin
  for (const std::uint64_t p : arguments) {
    if (p < 0x4160000000000000) continue;
    for (const std::uint64_t sign : {std::uint64_t{0}, std::uint64_t{0x8000000000000000}}) {
      const double x = std::bit_cast<double>(p | sign);
      const auto a = scalar::octant_rest::of(x);
      ASSERT_LE(std::fabs(a.rest), 0.78539825) << x;
      worst = std::max(
          worst, exact.relative_error(x, static_cast<long>(a.quarters & 3), 4, a.rest, a.rest_low));
    }
  }
  EXPECT_LT(worst, 0x1p-52);
}

TEST(TrigReduction, FixedPointOfFloats) {
  angle exact;
  double worst = 0, worst_by_table = 0;
  const auto arguments =
      joined(every_binade(0x39800000u, 0x7f7fffffu, 60),
             joined({std::begin(hard_floats), std::end(hard_floats)}, around(0x4a000000u)));
  for (const std::uint32_t p : arguments) {
    const float x = std::bit_cast<float>(p);
    if (scalar::is_below_fixed_turn(x)) continue;
    if (!scalar::is_above_fixed_turn(x))
      worst = std::max(worst, exact.error_of_place(x, scalar::fixed_turn(x)));
    if (p >= 0x4a000000)
      worst_by_table =
          std::max(worst_by_table, exact.error_of_place(x, scalar::fixed_turn_by_table(x)));
  }
  EXPECT_LT(worst, 0x1p13);
  EXPECT_LT(worst_by_table, 1);
}

/// The rest has 31 bits, also next to multiples of pi/2.
TEST(TrigReduction, RestOfFloats) {
  angle exact;
  double half_turns = 0, quarter_turns = 0;
  for (const std::uint32_t p : joined(every_binade(0x39800000u, 0x7f7fffffu, 60),
                                      {std::begin(hard_floats), std::end(hard_floats)})) {
    const float x = std::bit_cast<float>(p);
    const std::uint64_t place =
        scalar::is_above_fixed_turn(x) ? scalar::fixed_turn_by_table(x) : scalar::fixed_turn(x);
    const auto error = [&](const scalar::turn_rest& a, int removed) {
      const std::uint64_t unit = std::uint64_t{1} << (64 - removed);
      const std::uint64_t nearest = (place + unit / 2) & (0u - unit);
      const double rest = static_cast<double>(static_cast<std::int64_t>(place - nearest)) * 0x1p-63;
      const double u = static_cast<double>(a.u) + static_cast<double>(a.low);
      return std::fabs(u - rest) / std::fabs(rest);
    };
    half_turns = std::max(half_turns, error(scalar::rest_of_turn<1>(place), 1));
    quarter_turns = std::max(quarter_turns, error(scalar::rest_of_turn<2>(place), 2));
  }
  EXPECT_LT(half_turns, 0x1p-29);
  EXPECT_LT(quarter_turns, 0x1p-29);
}

}  // namespace
