// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// The arguments that functions are timed on.
#pragma once

#include <cmath>
#include <cstdint>
#include <limits>
#include <random>
#include <string_view>
#include <vector>

namespace bench {

enum class spacing { linear, logarithmic };

struct interval {
  spacing how;
  double low, high;
};

/// Ordinary arguments of a function, none of which takes a rare path; large ones of the
/// trigonometric functions stand under a name of their own.
struct arguments {
  std::string_view function;
  interval of_float[2], of_double[2];
};

using enum spacing;

/// Those of each function.
constexpr arguments all_arguments[] = {
    {"acos", {{linear, -1, 1}}, {{linear, -1, 1}}},
    {"acospi", {{linear, -1, 1}}, {{linear, -1, 1}}},
    {"asin", {{linear, -1, 1}}, {{linear, -1, 1}}},
    {"asinpi", {{linear, -1, 1}}, {{linear, -1, 1}}},
    {"atan", {{linear, -10, 10}}, {{linear, -10, 10}}},
    {"atan2", {{linear, -10, 10}, {linear, -10, 10}}, {{linear, -10, 10}, {linear, -10, 10}}},
    {"atan2pi", {{linear, -10, 10}, {linear, -10, 10}}, {{linear, -10, 10}, {linear, -10, 10}}},
    {"atanpi", {{linear, -10, 10}}, {{linear, -10, 10}}},
    {"cbrt", {{logarithmic, 1e-30, 1e30}}, {{logarithmic, 1e-300, 1e300}}},
    {"cos", {{linear, -100, 100}}, {{linear, -100, 100}}},
    {"div", {{linear, 1, 1000}, {linear, 1, 1000}}, {{linear, 1, 1000}, {linear, 1, 1000}}},
    {"exp", {{linear, -80, 80}}, {{linear, -600, 600}}},
    {"exp10", {{linear, -35, 35}}, {{linear, -300, 300}}},
    {"exp2", {{linear, -120, 120}}, {{linear, -1000, 1000}}},
    {"expm1", {{linear, -80, 80}}, {{linear, -600, 600}}},
    {"hypot",
     {{linear, -100, 100}, {linear, -100, 100}},
     {{linear, -100, 100}, {linear, -100, 100}}},
    {"inv", {{logarithmic, 1e-30, 1e30}}, {{logarithmic, 1e-300, 1e300}}},
    {"invcbrt", {{logarithmic, 1e-30, 1e30}}, {{logarithmic, 1e-300, 1e300}}},
    {"invsqrt", {{logarithmic, 1e-30, 1e30}}, {{logarithmic, 1e-300, 1e300}}},
    {"ln", {{logarithmic, 1e-30, 1e30}}, {{logarithmic, 1e-300, 1e300}}},
    {"log10", {{logarithmic, 1e-30, 1e30}}, {{logarithmic, 1e-300, 1e300}}},
    {"log1p", {{logarithmic, 1e-6, 1e6}}, {{logarithmic, 1e-12, 1e12}}},
    {"log2", {{logarithmic, 1e-30, 1e30}}, {{logarithmic, 1e-300, 1e300}}},
    {"pow",
     {{logarithmic, .01, 100}, {linear, -15, 15}},
     {{logarithmic, .01, 100}, {linear, -100, 100}}},
    {"pow2o3", {{logarithmic, 1e-30, 1e30}}, {{logarithmic, 1e-300, 1e300}}},
    {"pow3o2", {{logarithmic, 1e-20, 1e20}}, {{logarithmic, 1e-200, 1e200}}},
    {"powr",
     {{logarithmic, .01, 100}, {linear, -15, 15}},
     {{logarithmic, .01, 100}, {linear, -100, 100}}},
    {"powx",
     {{logarithmic, .01, 100}, {linear, -15, 15}},
     {{logarithmic, .01, 100}, {linear, -100, 100}}},
    {"sin", {{linear, -100, 100}}, {{linear, -100, 100}}},
    {"sincos", {{linear, -100, 100}}, {{linear, -100, 100}}},
    {"sqrt", {{logarithmic, 1e-30, 1e30}}, {{logarithmic, 1e-300, 1e300}}},
    {"tan", {{linear, -100, 100}}, {{linear, -100, 100}}},
};

/// Null for a function that is not timed.
inline const arguments* arguments_of(std::string_view function) {
  for (const arguments& a : all_arguments) {
    if (a.function == function) return &a;
  }
  return nullptr;
}

/// Random arguments: uniform in value, or in the logarithm of it. Zeros where there is no interval.
template <typename T>
std::vector<T> draw(const interval& from, std::int64_t n, std::uint64_t seed) {
  if (from.low == from.high) return std::vector<T>(static_cast<std::size_t>(n));
  std::mt19937_64 engine(seed);
  const bool logarithmic = from.how == spacing::logarithmic;
  std::uniform_real_distribution<double> values(logarithmic ? std::log(from.low) : from.low,
                                                logarithmic ? std::log(from.high) : from.high);
  std::vector<T> x(static_cast<std::size_t>(n));
  for (T& v : x) {
    const double drawn = values(engine);
    v = static_cast<T>(logarithmic ? std::exp(drawn) : drawn);
  }
  return x;
}

/// Arguments that rare paths are for.
enum class special { none, tenth_special, all_denormal };

/// Replaces every tenth argument by a special value, or all of them by denormals.
template <typename T>
void make_special(std::vector<T>& x, special kind) {
  using limits = std::numeric_limits<T>;
  const T specials[] = {limits::infinity(),  limits::quiet_NaN(),  T(0),
                        -limits::infinity(), limits::denorm_min(), limits::max()};
  std::mt19937_64 engine(7);
  for (std::size_t i = 0; i < x.size(); ++i) {
    if (kind == special::tenth_special && engine() % 10 == 0) x[i] = specials[engine() % 6];
    if (kind == special::all_denormal)
      x[i] = limits::min() * static_cast<T>(std::uniform_real_distribution<T>(0, 1)(engine));
  }
}

}  // namespace bench
