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
#include "scalar/pow/row_power_d.hpp"
#include "scalar/pow/row_power_s.hpp"
#include "scalar/pow/special_values.hpp"
#include "scalar/pow/three_stage_power.hpp"
#include "scalar/pow/two_stage_power.hpp"
#include "scalar/pow/word_power_d.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// pow, float. Code 1 for zero to a negative power and for a negative number to a power that is no
/// integer, code 3 for an infinite result of finite operands, code 4 for a zero one. Largest error
/// 0.81, 3.1, 1880 ulp for `ha`, `la`, `ep`. At `la`, y = 0 and x = 1 give 1 + 2^-23.
template <tier t>
struct pow_paths_s : power_paths<float, row_power_s<t>, signed_specials_s, fixed_point_power> {};
template <>
struct pow_paths_s<tier::ep>
    : power_paths<float, quick_power_s, signed_specials_s, two_stage_power> {};
template <tier t>
using pow_s = power_v21<float, pow_paths_s<t>>;

/// pow, float, `la`, without a table on the main path. Largest error 1.2 ulp. A denormal result is
/// rounded twice where |y·ln x| <= 87.857, once beyond.
using pow_paths_s_nolut = power_paths<float, artanh_power_s, signed_specials_s, fixed_point_power>;
using pow_s_nolut = power_v21<float, pow_paths_s_nolut>;

/// pow, double. Code 1 for zero to a negative power and for a negative number to a power that is no
/// integer. Code 3 only for an infinite result where the exponents of y and log2 x sum to 11 or
/// more; other infinite results, zeros and denormals of finite operands have none. Largest error
/// 0.59, 1.05, 1.29e8 ulp for `ha`, `la`, `ep`.
template <typename Main>
using pow_paths_d = power_paths<double, Main, signed_specials_d, careful_power_d>;
template <tier t>
struct pow_main_d : row_power_d {};
template <>
struct pow_main_d<tier::ha> : word_power_d {};
template <>
struct pow_main_d<tier::ep> : quick_power_d {};
template <tier t>
using pow_d = power_v21<double, pow_paths_d<pow_main_d<t>>>;

/// Without a table on the main path; one body for `la` and `ep`. Largest error 0.95, 1.33 ulp for
/// `ha`, `la`.
template <tier t>
using pow_d_nolut = power_v21<double, pow_paths_d<nolut_power_d<nolut_form(t)>>>;

/// pow, half: the float body of `ep` in every tier.
using pow_h = half_v21<pow_paths_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
