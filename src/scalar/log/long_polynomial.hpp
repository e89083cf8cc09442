// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include "scalar/log/reduction.hpp"
#include "scalar/protocol.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

/// ln(1 + r) for 1 + r in [2/3, 4/3) by a polynomial of degree 21 in pairs; the two leading pairs
/// are in 1 + r.
LUMEN_MAIN double ln_by_long_polynomial(const two_thirds<double>& a) {
  const double r = a.r;
  const double w = r * r;
  const double w2 = w * w;
  const double a1 = fma(value(0x3fb66f75676ae3eau), a.m, value(0xbfc65a6d34a6dd3du));
  const double a2 = fma(value(0x3fa49f86632433feu), a.m, value(0xbfb5ea03fef4c746u));
  const double b1 = fma(value(0x3faf2a14615c2bb3u), r, value(0xbfb062accb1ad8aau));
  const double b2 = fma(value(0x3fb1038ce60c1b2fu), r, value(0xbfb2406abbb6c334u));
  const double b3 = fma(value(0x3fb3b219a9287c7fu), r, value(0xbfb555d0d4781fd1u));
  const double b4 = fma(value(0x3fb745c847eeb960u), r, value(0xbfb99995585870b8u));
  const double b5 = fma(value(0x3fbc71c758cfdb39u), r, value(0xbfc000000b3d2e0fu));
  const double b6 = fma(value(0x3fc2492491d4fd71u), r, value(0xbfc555555534c686u));
  const double b7 = fma(value(0x3fc99999999a7fc1u), r, value(0xbfd0000000001596u));
  const double b8 = fma(value(0x3fd55555555554fcu), r, value(0xbfdffffffffffff8u));
  const double c1 = fma(a1, w, a2);
  const double c2 = fma(b1, w, b2);
  const double c3 = fma(b3, w, b4);
  const double c4 = fma(b5, w, b6);
  const double c5 = fma(b7, w, b8);
  double d = fma(c1, w2, c2);
  d = fma(d, w2, c3);
  d = fma(d, w2, c4);
  d = fma(d, w2, c5);
  return fma(w, d, r);
}

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
