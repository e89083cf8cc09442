// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The public functions as types, so that templates can be written over them.
#pragma once

#include <arbor/lumen/vm.hpp>
#include <utility>

#include "catalogue_lists.hpp"

namespace arbor::lumen::tests::functions {

#define LUMEN_FUNCTION(function, shape)                                          \
  struct function {                                                              \
    static constexpr const char* name = #function;                               \
    template <typename... A>                                                     \
    auto operator()(A&&... arguments) const                                      \
        -> decltype(arbor::lumen::vm::function(std::forward<A>(arguments)...)) { \
      return arbor::lumen::vm::function(std::forward<A>(arguments)...);          \
    }                                                                            \
  };
LUMEN_FUNCTIONS(LUMEN_FUNCTION)
#undef LUMEN_FUNCTION

}  // namespace arbor::lumen::tests::functions
