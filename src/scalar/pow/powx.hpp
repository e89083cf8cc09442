// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/half.hpp"
#include "scalar/pow/pow.hpp"
#include "scalar/pow/wide_power_s.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// powx, float: pow with a constant exponent, with the same status. Largest error 0.81, 1.2,
/// 1880 ulp for `ha`, `la`, `ep`. `la` is the body of pow without a table; the rare path of `ep` is
/// the one at double.
template <tier t>
struct powx_paths_s : pow_paths_s<t> {};
template <>
struct powx_paths_s<tier::la> : pow_paths_s_nolut {};
template <>
struct powx_paths_s<tier::ep>
    : power_paths<float, quick_power_s, signed_specials_s, careful_power_s> {};
template <tier t>
using powx_s = power_v21c<float, powx_paths_s<t>>;

/// powx, float, `ha`, without a table on the main path: in double, within 0.5001 ulp.
using powx_s_nolut =
    power_v21c<float, power_paths<float, wide_power_s, signed_specials_s, fixed_point_power>>;

/// powx, double: pow with a constant exponent, with the same status. One body for `ha` and `la`.
/// Largest error 0.59 and, at `ep`, 1.29e8 ulp.
template <tier t>
struct powx_main_d : word_power_d {};
template <>
struct powx_main_d<tier::ep> : quick_power_d {};
template <tier t>
using powx_d = power_v21c<double, pow_paths_d<powx_main_d<t>>>;

/// Without a table on the main path; one body for `la` and `ep`. Largest error 0.95, 1.33 ulp for
/// `ha`, `la`.
template <tier t>
using powx_d_nolut = power_v21c<double, pow_paths_d<nolut_power_d<nolut_form(t)>>>;

/// powx, half: the float body of `ep` in every tier.
using powx_h = half_v21c<powx_paths_s<tier::ep>>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
