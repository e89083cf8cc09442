// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/half.hpp"
#include "scalar/pow/artanh_power_s.hpp"
#include "scalar/pow/fixed_point_power.hpp"
#include "scalar/pow/nolut_power_d.hpp"
#include "scalar/pow/paths.hpp"
#include "scalar/pow/quick_power_d.hpp"
#include "scalar/pow/quick_power_s.hpp"
#include "scalar/pow/row_power_s.hpp"
#include "scalar/pow/special_values.hpp"
#include "scalar/pow/three_stage_power.hpp"
#include "scalar/pow/two_stage_power.hpp"
#include "scalar/pow/wide_power_s.hpp"
#include "scalar/pow/word_power_d.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// powr, float. Code 1 for a base with its sign bit set but -0, NaNs included, for 0^0 and for zero
/// to a negative power; code 3 for an infinite result of finite operands, code 4 for a zero one.
/// Largest error 0.81, 1.2, 1880 ulp for `ha`, `la`, `ep`.
template <typename Main, typename Others>
using powr_paths_s = power_paths<float, Main, nonnegative_specials<float>, Others>;
template <tier t>
struct powr_of_tier_s : powr_paths_s<row_power_s<t>, fixed_point_power> {};
template <>
struct powr_of_tier_s<tier::la> : powr_paths_s<artanh_power_s, fixed_point_power> {};
template <>
struct powr_of_tier_s<tier::ep> : powr_paths_s<quick_power_s, two_stage_power> {};
template <tier t>
using powr_s = power_v21<float, powr_of_tier_s<t>>;

/// powr, float, `ha`, without a table on the main path: in double, within 0.5001 ulp.
using powr_s_nolut = power_v21<float, powr_paths_s<wide_power_s, fixed_point_power>>;

/// powr, double. Code 1 as at float. Code 3 only for an infinite result where the exponents of y
/// and log2 x sum to 11 or more. One body for `ha` and `la`. Largest error 0.59 and, at
/// `ep`, 1.29e8 ulp.
template <typename Main>
using powr_paths_d = power_paths<double, Main, nonnegative_specials<double>, careful_power_d>;
template <tier t>
struct powr_main_d : word_power_d {};
template <>
struct powr_main_d<tier::ep> : quick_power_d {};
template <tier t>
using powr_d = power_v21<double, powr_paths_d<powr_main_d<t>>>;

/// Without a table on the main path; one body for `la` and `ep`. Largest error 0.95, 1.33 ulp for
/// `ha`, `la`.
template <tier t>
using powr_d_nolut = power_v21<double, powr_paths_d<nolut_power_d<nolut_form(t)>>>;

/// powr, half: the float body of `ep` in every tier.
using powr_h = half_v21<powr_of_tier_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
