// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>

#include "scalar/horner.hpp"
#include "scalar/log/breakpoint.hpp"
#include "scalar/log/half_log.hpp"
#include "scalar/log/ln_of_one_plus.hpp"
#include "scalar/log/reduction.hpp"
#include "scalar/log/zero_or_negative.hpp"
#include "scalar/protocol.hpp"
#include "scalar/tables/dln.hpp"
#include "scalar/tables/sln.hpp"

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {

struct ln_constants_s : natural_constants_s {
  static constexpr std::uint32_t denormal_scale = 0x4d000000;  // 2^27
  static constexpr int denormal_exponent = 27;
};

/// ln, float. Code 2 for zeros, code 1 for negative numbers and -infinity, code 0 for every NaN.
///
/// Reduction to [2/3, 4/3) without a table; degree 10 with ln 2 in two words at `ha`, degree 9 at
/// `la`, 5 at `ep`. Largest error 0.94, 1.21, 1570 ulp.
template <tier t>
struct ln_s : scalar_v11<ln_s<t>, float> {
  LUMEN_MAIN main_result<float> main(float x) {
    const auto a = two_thirds<float>::of(x);
    return {logarithm(a.k, a.r), flag_if<float>(not_positive_normal(x))};
  }

  LUMEN_RARE std::uint32_t rare(float x, float* y) {
    return breakpoint_log<natural_path<float, ln_constants_s>>(x, y, rare_table());
  }

 private:
  LUMEN_MAIN float logarithm(float k, float r) {
    if constexpr (t == tier::ha) {
      float q = horner(r, 0xbe0402c8u, 0x3e0f335du, 0xbdf9889eu, 0x3e0f6b8cu, 0xbe2acee6u,
                       0x3e4ce814u, 0xbe7fff78u, 0x3eaaaa83u, 0xbf000000u);
      q = fma(q, r, 0.0f);
      float s = fma(q, r, r);
      s = fma(k, value(0x35bfbe8eu), s);
      return fma(k, value(0x3f317200u), s);
    } else {
      return fma(k, value(0x3f317218u), ln_of_one_plus<t>(r));
    }
  }

  LUMEN_DEVICE static constexpr const std::uint32_t* rare_table() {
    if constexpr (t == tier::ha) return __sln_ha_CoutTab;
    if constexpr (t == tier::la) return __sln_la_CoutTab;
    if constexpr (t == tier::ep) return __sln_ep_CoutTab;
  }
};

/// ln, double. Code 2 for zeros, code 1 for negative numbers and -infinity. A NaN with its sign bit
/// set has code 1 at `la` and `ep` and code 0 at `ha`, one without has code 0.
///
/// `la` and `ep`: reduction to [2/3, 4/3) without a table, of denormals too; degree 21 and 11.
/// Largest error 1.5 and 4.0e7 ulp.
template <tier t>
struct ln_d : scalar_v11<ln_d<t>, double> {
  static constexpr int interleave = 4;

  LUMEN_MAIN main_result<double> main(double x) {
    const auto a = two_thirds<double>::of(x);
    const double q = polynomial(a.r);
    const double y = fma(a.k, value(0x3fe62e42fefa39efu), fma(q, a.r, a.r));
    return {y, flag_if<double>(not_positive_finite(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) { return log_of_zero_or_negative(x, y); }

 private:
  LUMEN_MAIN double polynomial(double r) {
    if constexpr (t == tier::ep) {
      return horner(r, 0xbfc11e70a5c9b8f8u, 0x3fc20827ee8835feu, 0xbfbedf6494cc1f86u,
                    0x3fc1e531c40397e0u, 0xbfc55d72615e74d3u, 0x3fc99dac1eadbf8eu,
                    0xbfcfffcff3489b95u, 0x3fd5554dfa222c07u, 0xbfe00000145aea06u,
                    0x3e30eba0cce2e0b0u);
    } else {
      return horner(
          r, 0xbfb6e22682c05596u, 0x3fb6c694b21a9875u, 0xbfa68f0acee35e2du, 0x3fa9474ccd075ce5u,
          0xbfb0750f4f9c34f9u, 0x3fb16608748ab72du, 0xbfb23e2ec341eba0u, 0x3fb3aa521d980cd0u,
          0xbfb555fa23866d76u, 0x3fb74629a554d880u, 0xbfb999938abcf213u, 0x3fbc71c472fb2195u,
          0xbfc00000112830d9u, 0x3fc24924982c2697u, 0xbfc55555551fbbdbu, 0x3fc99999998c68b5u,
          0xbfd0000000002697u, 0x3fd5555555555b0eu, 0xbfdffffffffffff0u, 0xbc8a30cfded694ffu);
    }
  }
};

/// `ha`: a row of a table by an integer reciprocal, degree 5, and the sum in two words. Largest
/// error 0.75 ulp.
template <>
struct ln_d<tier::ha> : scalar_v11<ln_d<tier::ha>, double> {
  LUMEN_MAIN main_result<double> main(double x) {
    const auto a = integer_reciprocal::of(x);
    const std::int32_t word = integer_reciprocal::pair_word(a);
    const double t = a.t;
    const double p1 = fma(value(0x3fc9999cacdb4d0au), t, value(0xbfd0000148058ee1u));
    const double p2 = fma(value(0x3fd55555555543c5u), t, value(0xbfdffffffffff81fu));
    const double w = fma(t, t, 0.0);
    const double q = fma(fma(p1, w, p2), w, 0.0);
    const double z =
        fma(a.exponent, value(0x3fe62e42fefa0000u), 0.0) + value(internal_dln_ha_data[word]);
    const double low =
        fma(a.exponent, value(0x3d7cf79abc9e0000u), 0.0) + value(internal_dln_ha_data[word + 1]);
    const double s = z + t;
    const double e = t - (s - z);
    return {((low + e) + q) + s, flag_if<double>(not_positive_normal(x))};
  }

  LUMEN_RARE std::uint32_t rare(double x, double* y) {
    return breakpoint_log<natural_path_d>(x, y, __dln_ha_CoutTab);
  }
};

struct natural_logarithm_h {
  LUMEN_MAIN float of_log2(float l) { return fma(l, value(0x3f317218u), 0.0f); }  // ln 2
};

/// ln, half.
using ln_h = half_log<natural_logarithm_h>;

}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
