// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "reference.hpp"

#include <cmath>

namespace arbor::lumen::accuracy {

namespace {

template <int (*operation)(mpfr_ptr, mpfr_srcptr, mpfr_rnd_t)>
void of_one(mpfr_t* y, const mpfr_t* x) {
  operation(y[0], x[0], MPFR_RNDN);
}
template <int (*operation)(mpfr_ptr, mpfr_srcptr, mpfr_srcptr, mpfr_rnd_t)>
void of_two(mpfr_t* y, const mpfr_t* x) {
  operation(y[0], x[0], x[1], MPFR_RNDN);
}
void reciprocal(mpfr_t* y, const mpfr_t* x) { mpfr_ui_div(y[0], 1, x[0], MPFR_RNDN); }
/// IEEE's rSqrt: the pole at -0 is -infinity.
void reciprocal_root(mpfr_t* y, const mpfr_t* x) {
  mpfr_rec_sqrt(y[0], x[0], MPFR_RNDN);
  if (mpfr_zero_p(x[0])) mpfr_setsign(y[0], y[0], mpfr_signbit(x[0]), MPFR_RNDN);
}
void reciprocal_cube_root(mpfr_t* y, const mpfr_t* x) {
  mpfr_cbrt(y[0], x[0], MPFR_RNDN);
  mpfr_ui_div(y[0], 1, y[0], MPFR_RNDN);
}
void two_thirds_power(mpfr_t* y, const mpfr_t* x) {
  mpfr_cbrt(y[0], x[0], MPFR_RNDN);
  mpfr_sqr(y[0], y[0], MPFR_RNDN);
}
void three_halves_power(mpfr_t* y, const mpfr_t* x) {
  mpfr_sqrt(y[0], x[0], MPFR_RNDN);
  mpfr_mul(y[0], y[0], x[0], MPFR_RNDN);
}
void sine_and_cosine(mpfr_t* y, const mpfr_t* x) { mpfr_sin_cos(y[0], y[1], x[0], MPFR_RNDN); }

// One line per function: name, reference, C library at float and double, ranges at half, float and
// double. Add a function here, and its functors are measured and held to the limits of their tier.
const reference all_references[] = {
    {"acos", of_one<mpfr_acos>, acosf, acos, {{-1, 1}}, {{-1, 1}}, {{-1, 1}}},
    {"acospi", of_one<mpfr_acospi>, nullptr, nullptr, {{-1, 1}}, {{-1, 1}}, {{-1, 1}}},
    {"asin", of_one<mpfr_asin>, asinf, asin, {{-1, 1}}, {{-1, 1}}, {{-1, 1}}},
    {"asinpi", of_one<mpfr_asinpi>, nullptr, nullptr, {{-1, 1}}, {{-1, 1}}, {{-1, 1}}},
    {"atan", of_one<mpfr_atan>, atanf, atan, {{-6e4, 6e4}}, {{-1e38, 1e38}}, {{-1e300, 1e300}}},
    {"atan2",
     of_two<mpfr_atan2>,
     nullptr,
     nullptr,
     {{-6e4, 6e4}, {-6e4, 6e4}},
     {{-1e38, 1e38}, {-1e38, 1e38}},
     {{-1e300, 1e300}, {-1e300, 1e300}}},
    {"atan2pi",
     of_two<mpfr_atan2pi>,
     nullptr,
     nullptr,
     {{-6e4, 6e4}, {-6e4, 6e4}},
     {{-1e38, 1e38}, {-1e38, 1e38}},
     {{-1e300, 1e300}, {-1e300, 1e300}}},
    {"atanpi",
     of_one<mpfr_atanpi>,
     nullptr,
     nullptr,
     {{-6e4, 6e4}},
     {{-1e38, 1e38}},
     {{-1e300, 1e300}}},
    {"cbrt", of_one<mpfr_cbrt>, cbrtf, cbrt, {{-6e4, 6e4}}, {{-1e38, 1e38}}, {{-1e300, 1e300}}},
    {"cos", of_one<mpfr_cos>, cosf, cos, {{-6e4, 6e4}}, {{-2e4, 2e4}}, {{-2e6, 2e6}}},
    {"div",
     of_two<mpfr_div>,
     nullptr,
     nullptr,
     {{-6e4, 6e4}, {-6e4, 6e4}},
     {{-1e38, 1e38}, {-1e38, 1e38}},
     {{-1e308, 1e308}, {-1e308, 1e308}}},
    {"exp", of_one<mpfr_exp>, expf, exp, {{-18, 12}}, {{-104, 89}}, {{-746, 710}}},
    {"exp10", of_one<mpfr_exp10>, exp10f, exp10, {{-8, 6}}, {{-46, 39}}, {{-324, 309}}},
    {"exp2", of_one<mpfr_exp2>, exp2f, exp2, {{-26, 17}}, {{-151, 129}}, {{-1076, 1025}}},
    {"expm1", of_one<mpfr_expm1>, expm1f, expm1, {{-9, 12}}, {{-20, 89}}, {{-40, 710}}},
    {"hypot",
     of_two<mpfr_hypot>,
     nullptr,
     nullptr,
     {{-6e4, 6e4}, {-6e4, 6e4}},
     {{-1e38, 1e38}, {-1e38, 1e38}},
     {{-1e300, 1e300}, {-1e300, 1e300}}},
    {"inv", reciprocal, nullptr, nullptr, {{-6e4, 6e4}}, {{-3e38, 3e38}}, {{-1e308, 1e308}}},
    {"invcbrt",
     reciprocal_cube_root,
     nullptr,
     nullptr,
     {{-6e4, 6e4}},
     {{-3e38, 3e38}},
     {{-1e308, 1e308}}},
    {"invsqrt", reciprocal_root, nullptr, nullptr, {{0, 65504}}, {{0, 3e38}}, {{0, 1e308}}},
    {"ln", of_one<mpfr_log>, logf, log, {{0, 65504}}, {{0, 3e38}}, {{0, 1e308}}},
    {"log10", of_one<mpfr_log10>, log10f, log10, {{0, 65504}}, {{0, 3e38}}, {{0, 1e308}}},
    {"log1p", of_one<mpfr_log1p>, log1pf, log1p, {{-1, 65504}}, {{-1, 3e38}}, {{-1, 1e308}}},
    {"log2", of_one<mpfr_log2>, log2f, log2, {{0, 65504}}, {{0, 3e38}}, {{0, 1e308}}},
    {"pow",
     of_two<mpfr_pow>,
     nullptr,
     nullptr,
     {{0, 65504}, {-2, 2}},
     {{0, 3e38}, {-1.6, 1.6}},
     {{0, 1e308}, {-1.05, 1.05}}},
    {"pow2o3",
     two_thirds_power,
     nullptr,
     nullptr,
     {{-6e4, 6e4}},
     {{-3e38, 3e38}},
     {{-1e308, 1e308}}},
    {"pow3o2", three_halves_power, nullptr, nullptr, {{0, 1600}}, {{0, 5e25}}, {{0, 2e205}}},
    {"powr",
     of_two<mpfr_pow>,
     nullptr,
     nullptr,
     {{0, 65504}, {-2, 2}},
     {{0, 3e38}, {-1.6, 1.6}},
     {{0, 1e308}, {-1.05, 1.05}}},
    {"powx",
     of_two<mpfr_pow>,
     nullptr,
     nullptr,
     {{0, 65504}, {-2, 2}},
     {{0, 3e38}, {-1.6, 1.6}},
     {{0, 1e308}, {-1.05, 1.05}}},
    {"sin", of_one<mpfr_sin>, sinf, sin, {{-6e4, 6e4}}, {{-2e4, 2e4}}, {{-2e6, 2e6}}},
    {"sincos", sine_and_cosine, nullptr, nullptr, {{-6e4, 6e4}}, {{-2e4, 2e4}}, {{-2e6, 2e6}}},
    {"sqr", of_one<mpfr_sqr>, nullptr, nullptr, {{-300, 300}}, {{-2e19, 2e19}}, {{-1e154, 1e154}}},
    {"sqrt", of_one<mpfr_sqrt>, sqrtf, sqrt, {{0, 65504}}, {{0, 3e38}}, {{0, 1e308}}},
    {"tan", of_one<mpfr_tan>, tanf, tan, {{-6e4, 6e4}}, {{-2e4, 2e4}}, {{-2e6, 2e6}}},
};

}  // namespace

const reference* find_reference(std::string_view function) {
  for (const reference& r : all_references) {
    if (r.function == function) return &r;
  }
  return nullptr;
}

}  // namespace arbor::lumen::accuracy
