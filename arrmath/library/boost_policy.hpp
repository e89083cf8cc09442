// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// How Boost.Math is asked: nothing is thrown, and nothing is computed in a wider type than the one
/// passed, since the functions of this folder widen their arguments themselves.
#pragma once

#include <boost/math/policies/policy.hpp>

#include "library/wide.hpp"

namespace arbor::lumen::vm::detail::library {

namespace policies = boost::math::policies;

using boost_policy =
    policies::policy<policies::domain_error<policies::ignore_error>,
                     policies::pole_error<policies::ignore_error>,
                     policies::overflow_error<policies::ignore_error>,
                     policies::underflow_error<policies::ignore_error>,
                     policies::denorm_error<policies::ignore_error>,
                     policies::evaluation_error<policies::ignore_error>,
                     policies::rounding_error<policies::ignore_error>,
                     policies::promote_float<false>, policies::promote_double<false>>;

}  // namespace arbor::lumen::vm::detail::library
