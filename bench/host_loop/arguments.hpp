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

/// Random arguments: uniform in value, or in the logarithm of it.
template <typename T>
std::vector<T> draw(const interval& from, std::int64_t n, std::uint64_t seed) {
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
