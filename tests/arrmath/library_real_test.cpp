// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The errors of the real functions of one argument, over their domains.

#include <gtest/gtest.h>

#include "library/functions.hpp"
#include "library_errors.hpp"
#include "library_reference.hpp"

namespace arbor::lumen::tests::library {
namespace {

namespace lib = vm::detail::library;

/// A function of MPFR with rounding to the nearest.
template <int (*F)(mpfr_ptr, mpfr_srcptr, mpfr_rnd_t)>
void mpfr(mpfr_ptr y, mpfr_srcptr x) {
  F(y, x, MPFR_RNDN);
}
template <int (*F)(mpfr_ptr, mpfr_srcptr, unsigned long, mpfr_rnd_t)>
void mpfr_degrees(mpfr_ptr y, mpfr_srcptr x) {
  F(y, x, 360, MPFR_RNDN);
}

template <template <typename> typename F, typename T>
void expect_type(const std::string& name, exact_function exact, const std::vector<range>& ranges) {
  expect_within(1.0, errors<F<T>>(exact, arguments<T>(ranges, 500)),
                name + (sizeof(T) == 4 ? ", float" : ", double"));
}

/// Ranges of double beyond those of float are cut for float.
template <template <typename> typename F>
void expect_function(const std::string& name, exact_function exact,
                     const std::vector<range>& float_ranges,
                     const std::vector<range>& double_ranges) {
  expect_type<F, float>(name, exact, float_ranges);
  expect_type<F, double>(name, exact, double_ranges);
}

constexpr double flt = std::numeric_limits<float>::max();
constexpr double dbl = std::numeric_limits<double>::max();
const std::vector<range> all_floats = {{-flt, flt}, {-8, 8}};
const std::vector<range> all_doubles = {{-dbl / 2, dbl / 2}, {-8, 8}};

TEST(LibraryErrors, HyperbolicFunctions) {
  expect_function<lib::sinh>("sinh", mpfr<mpfr_sinh>, {{-90, 90}, {-1, 1}}, {{-711, 711}, {-1, 1}});
  expect_function<lib::cosh>("cosh", mpfr<mpfr_cosh>, {{-90, 90}, {-1, 1}}, {{-711, 711}, {-1, 1}});
  expect_function<lib::tanh>("tanh", mpfr<mpfr_tanh>, {{-20, 20}, {-1, 1}}, {{-30, 30}, {-1, 1}});
  expect_function<lib::asinh>("asinh", mpfr<mpfr_asinh>, all_floats, all_doubles);
  expect_function<lib::acosh>("acosh", mpfr<mpfr_acosh>, {{1, flt}, {1, 3}}, {{1, dbl}, {1, 3}});
  expect_function<lib::atanh>("atanh", mpfr<mpfr_atanh>, {{-0x1.fffffep-1, 0x1.fffffep-1}},
                              {{-0x1.fffffffffffffp-1, 0x1.fffffffffffffp-1}});
}

TEST(LibraryErrors, TrigonometryInDegrees) {
  const std::vector<range> ranges = {{-1e6, 1e6}, {0, 360}};
  expect_function<lib::sind>("sind", mpfr_degrees<mpfr_sinu>, ranges, ranges);
  expect_function<lib::cosd>("cosd", mpfr_degrees<mpfr_cosu>, ranges, ranges);
  expect_function<lib::tand>("tand", mpfr_degrees<mpfr_tanu>, ranges, ranges);
  expect_function<lib::sind>("sind", mpfr_degrees<mpfr_sinu>, all_floats, all_doubles);
  expect_function<lib::cosd>("cosd", mpfr_degrees<mpfr_cosu>, all_floats, all_doubles);
  expect_function<lib::tand>("tand", mpfr_degrees<mpfr_tanu>, all_floats, all_doubles);
}

TEST(LibraryErrors, TrigonometryInMultiplesOfPi) {
  const std::vector<range> ranges = {{-1e6, 1e6}, {0, 2}};
  expect_function<lib::sinpi>("sinpi", mpfr<mpfr_sinpi>, ranges, ranges);
  expect_function<lib::cospi>("cospi", mpfr<mpfr_cospi>, ranges, ranges);
  expect_function<lib::tanpi>("tanpi", mpfr<mpfr_tanpi>, ranges, ranges);
  expect_function<lib::sinpi>("sinpi", mpfr<mpfr_sinpi>, all_floats, all_doubles);
  expect_function<lib::cospi>("cospi", mpfr<mpfr_cospi>, all_floats, all_doubles);
  expect_function<lib::tanpi>("tanpi", mpfr<mpfr_tanpi>, all_floats, all_doubles);
}

TEST(LibraryErrors, ErrorFunctions) {
  expect_function<lib::erf>("erf", mpfr<mpfr_erf>, {{-5, 5}, {-1, 1}}, {{-7, 7}, {-1, 1}});
  expect_function<lib::erfc>("erfc", mpfr<mpfr_erfc>, {{-5, 10.3}, {0, 10}}, {{-7, 27.3}, {0, 27}});
  expect_function<lib::erfcx>("erfcx", exact::erfcx, {{-9.39, 12}, {0, flt}, {-1, 1}},
                              {{-26.64, 30}, {0, dbl}, {80, 120}, {-1, 1}});
  expect_function<lib::cdfnorm>("cdfnorm", exact::cdfnorm, {{-14.2, 6}, {-1, 1}},
                                {{-38.5, 9}, {-1, 1}});
}

TEST(LibraryErrors, InverseErrorFunctions) {
  const std::vector<range> inside_float = {{-0x1.fffffep-1, 0x1.fffffep-1}};
  const std::vector<range> inside_double = {{-0x1.fffffffffffffp-1, 0x1.fffffffffffffp-1}};
  expect_function<lib::erfinv>("erfinv", exact::erfinv, inside_float, inside_double);
  expect_function<lib::erfcinv>("erfcinv", exact::erfcinv, {{0x1p-149, 0x1.fffffep0}, {0.99, 1.01}},
                                {{0x1p-1074, 0x1.fffffffffffffp0}, {0.99, 1.01}});
  expect_function<lib::cdfnorminv>("cdfnorminv", exact::cdfnorminv,
                                   {{0x1p-149, 0x1.fffffep-1}, {0.49, 0.51}},
                                   {{0x1p-1074, 0x1.fffffffffffffp-1}, {0.49, 0.51}});
}

TEST(LibraryErrors, GammaAndExponentialIntegral) {
  expect_function<lib::tgamma>("tgamma", mpfr<mpfr_gamma>, {{-46.1, 35.5}, {-5, 3}, {0, 1}},
                               {{-186.1, 172}, {-5, 3}, {0, 1}});
  expect_function<lib::lgamma>("lgamma", exact::lgamma, {{0, 1e6}, {0, 4}, {-20.5, -0.1}, {1, flt}},
                               {{0, 1e6}, {0, 4}, {-40.5, -0.1}, {1, dbl}});
  expect_function<lib::expint1>("expint1", exact::expint1, {{0x1p-149, 105}, {0x1p-149, 2}},
                                {{0x1p-1074, 745}, {0x1p-1074, 2}});
}

template <typename T>
void expect_log_gamma_near_zeros() {
  const auto near = about_zeros<T>(exact::lgamma, -20.03, 3, 2303);
  EXPECT_GT(near.size(), 1000u / sizeof(T));
  expect_within(1.0, errors<lib::lgamma<T>>(exact::lgamma, near), "lgamma near zeros");
}

TEST(LibraryErrors, LogGammaNearItsZeros) {
  expect_log_gamma_near_zeros<float>();
  expect_log_gamma_near_zeros<double>();
}

TEST(LibraryErrors, ModifiedBesselFunctions) {
  expect_function<lib::i0>("i0", exact::i0, {{-92, 92}, {-8, 8}}, {{-714, 714}, {-8, 8}});
  expect_function<lib::i1>("i1", exact::i1, {{-92, 92}, {-8, 8}}, {{-714, 714}, {-8, 8}});
}

}  // namespace
}  // namespace arbor::lumen::tests::library
