// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "functor.hpp"

namespace arbor::lumen::accuracy {

/// The largest error that a functor may have, in ulp of its type: 1 at `ha`, 4 at `la`; at `ep` 11
/// correct bits at float and 26 at double. Bodies made for half: 1 at `ha`, 2 at `la` and `ep`. A
/// half functor through float runs the float body of `ep`: an error of 2^-11 of the result, which
/// is at most 1 ulp, and the rounding.
inline double limit_of(const functor& f) {
  const bool cast = f.name.ends_with("_fp32cast");
  if (f.type == 'h') return cast ? 1.5 : (f.tier == "ha" ? 1 : 2);
  if (f.tier == "ha") return 1;
  if (f.tier == "la") return 4;
  return f.type == 's' ? 0x1p13 : 0x1p27;  // 2^(24 - 11), 2^(53 - 26)
}

}  // namespace arbor::lumen::accuracy
