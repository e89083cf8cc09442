// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "frontend/forms.hpp"
#include "scalar/functors.hpp"
#include "scalar/generated/list.hpp"

namespace arbor::lumen::tests {

#define LUMEN_CASE_h(...)
#define LUMEN_CASE_s(...)
#define LUMEN_CASE_d(...)
#define LUMEN_CASE_c(...)
#define LUMEN_CASE_z LUMEN_FUNCTOR_CASE
#define LUMEN_CASE(function, shape, type, tier, label, functor) \
  LUMEN_CASE_##type(function, shape, type, tier, label, functor)

std::vector<functor_case> complex_double_cases() { return {LUMEN_FUNCTORS(LUMEN_CASE)}; }

}  // namespace arbor::lumen::tests
