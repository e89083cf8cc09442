// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "globe.hpp"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <limits>
#include <numbers>
#include <stdexcept>

namespace vm = arbor::lumen::vm;

namespace {

constexpr double earth_radius = 6371.0088;  // km, the mean radius of the IUGG
constexpr double degree = std::numbers::pi / 180;

column radians(sycl::queue& queue, const column& degrees, double factor) {
  column angle(degrees.size());
  vm::mul(queue, degrees, column(degrees.size(), factor * degree), angle);
  return angle;
}

arbor::lumen::slice all_of(const column& x) { return {0, static_cast<std::int64_t>(x.size()), 1}; }

// A cyclic call of two columns runs through all pairs of their elements, the second column turning
// faster.
column differences_of_pairs(sycl::queue& queue, const column& x) {
  column y(x.size() * x.size());
  vm::sub(queue, x, all_of(x), x, all_of(x), y, all_of(y), {}, vm::enums::slice_cyclic);
  return y;
}
column products_of_pairs(sycl::queue& queue, const column& x) {
  column y(x.size() * x.size());
  vm::mul(queue, x, all_of(x), x, all_of(x), y, all_of(y), {}, vm::enums::slice_cyclic);
  return y;
}

/// A result in long double, and what rounding may change of it where every function has an error of
/// at most `ulp` units in the last place.
struct reference {
  long double value;
  long double bound;
};

/// The angle between two cities by the haversine formula: the square of the sine of its half is
/// sin²(Δφ/2) + cos φ₁ cos φ₂ sin²(Δλ/2).
reference angle_between(const zone_table& cities, std::size_t i, std::size_t j, long double ulp) {
  const long double unit = std::numeric_limits<double>::epsilon() / 2;
  const long double scale = std::numbers::pi_v<long double> / 180;
  const auto square = [](long double x) { return x * x; };
  const long double p = cities.latitude[i] * scale, q = cities.latitude[j] * scale;
  const long double l = cities.longitude[i] * scale, m = cities.longitude[j] * scale;
  const long double s = std::sqrt(square(std::sin((p - q) / 2)) +
                                  std::cos(p) * std::cos(q) * square(std::sin((l - m) / 2)));
  const long double slope = 1 / std::sqrt(std::max(1 - s * s, unit));
  // Two roundings of each coordinate in radians; then an error of `ulp` in each of two sines, two
  // cosines and the root, and half a unit in six sums and products; then the arcsine.
  const long double of_coordinates =
      3 * (std::fabs(p) + std::fabs(q) + std::fabs(l) + std::fabs(m));
  const long double of_root = (10 * ulp + 6) * s;
  const long double angle = std::asin(s);
  const long double of_angle = (2 * ulp + 2) * angle;
  return {2 * angle, 2 * unit * (slope * (of_coordinates + of_root) + of_angle)};
}

/// The ordinate ln tan(π/4 + φ/2) of the map.
reference ordinate(double latitude, long double ulp) {
  const long double unit = std::numeric_limits<double>::epsilon() / 2;
  const long double half = latitude * std::numbers::pi_v<long double> / 360;
  const long double y = std::log(std::tan(std::numbers::pi_v<long double> / 4 + half));
  const long double of_argument = 6 / std::cos(2 * half);
  return {y, 2 * unit * (of_argument + ulp + ulp * std::fabs(y))};
}

}  // namespace

column distances(sycl::queue& queue, const zone_table& cities, vm::enums::mode tier) {
  const column latitude = radians(queue, cities.latitude, 1);
  column cosine(cities.size());
  vm::cos(queue, latitude, cosine, {}, tier);
  column north = differences_of_pairs(queue, radians(queue, cities.latitude, 0.5));
  column east = differences_of_pairs(queue, radians(queue, cities.longitude, 0.5));
  column result = products_of_pairs(queue, cosine);

  vm::sin(queue, north, north, {}, tier);
  vm::sin(queue, east, east, {}, tier);
  vm::sqr(queue, north, north);
  vm::sqr(queue, east, east);
  vm::mul(queue, result, east, result);
  vm::add(queue, north, result, result);
  vm::sqrt(queue, result, result, {}, tier);
  vm::asin(queue, result, result, {}, tier);
  vm::mul(queue, result, column(result.size(), 2 * earth_radius), result);
  return result;
}

map_points mercator(sycl::queue& queue, const zone_table& cities, vm::enums::mode tier) {
  map_points points{radians(queue, cities.longitude, 1), radians(queue, cities.latitude, 0.5)};
  vm::add(queue, points.north, column(cities.size(), std::numbers::pi / 4), points.north);
  vm::tan(queue, points.north, points.north, {}, tier);
  vm::ln(queue, points.north, points.north, {}, tier);
  return points;
}

deviation check_globe(const zone_table& cities, const column& distance, const map_points& points,
                      double ulp) {
  deviation largest{0, 0};
  const std::size_t n = cities.size();
  const auto off = [&](double result, const reference& r, long double scale, std::size_t city) {
    const long double difference = std::fabs(result - r.value * scale);
    if (!(difference <= r.bound * scale))
      throw std::runtime_error("too far from the result in long double for " + cities.name[city]);
    return static_cast<double>(difference);
  };
  for (std::size_t i = 0; i < n; ++i) {
    for (std::size_t j = 0; j < n; ++j) {
      const reference r = angle_between(cities, i, j, ulp);
      largest.distance = std::max(largest.distance, off(distance[i * n + j], r, earth_radius, i));
    }
    const reference r = ordinate(cities.latitude[i], ulp);
    largest.map = std::max(largest.map, off(points.north[i], r, 1, i));
  }
  return largest;
}

pair_of_cities closest(const zone_table& cities, const column& distance) {
  column of_others = distance;
  for (std::size_t i = 0; i < cities.size(); ++i)
    of_others[i * cities.size() + i] = std::numeric_limits<double>::infinity();
  const auto at = static_cast<std::size_t>(
      std::distance(of_others.begin(), std::min_element(of_others.begin(), of_others.end())));
  return {at / cities.size(), at % cities.size()};
}

pair_of_cities farthest(const zone_table& cities, const column& distance) {
  const auto at = static_cast<std::size_t>(
      std::distance(distance.begin(), std::max_element(distance.begin(), distance.end())));
  return {at / cities.size(), at % cities.size()};
}
