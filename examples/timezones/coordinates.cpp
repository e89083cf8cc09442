// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "coordinates.hpp"

#include <arbor/lumen/vm.hpp>
#include <bit>
#include <cmath>
#include <cstdint>
#include <stdexcept>

namespace vm = arbor::lumen::vm;

namespace {

/// Added to a magnitude before it is cut, so that 31 minutes, which have no exact decimal degrees,
/// do not come out as 30 minutes and 60 seconds: a nanodegree, 0.1 mm on the ground.
constexpr double nudge = 1e-9;

}  // namespace

sexagesimal to_sexagesimal(sycl::queue& queue, const column& angle) {
  const std::size_t n = angle.size();
  const column sixty(n, 60.0);
  column magnitude(n), fraction(n), rest(n);
  sexagesimal result{column(n), column(n), column(n)};
  vm::abs(queue, angle, magnitude);
  vm::add(queue, magnitude, column(n, nudge), magnitude);
  vm::trunc(queue, magnitude, result.degrees);
  vm::frac(queue, magnitude, fraction);
  vm::mul(queue, fraction, sixty, rest);
  vm::trunc(queue, rest, result.minutes);
  vm::frac(queue, rest, fraction);
  vm::mul(queue, fraction, sixty, result.seconds);
  return result;
}

column solar_offset(sycl::queue& queue, const column& longitude) {
  const std::size_t n = longitude.size();
  column offset(n);
  vm::remainder(queue, longitude, column(n, 15.0), offset);
  vm::mul(queue, offset, column(n, 4.0), offset);
  return offset;
}

void check_coordinates(const zone_table& cities, const column& angle, const sexagesimal& parts,
                       const column& longitude, const column& offset) {
  const auto same = [](double a, double b) {
    return std::bit_cast<std::uint64_t>(a) == std::bit_cast<std::uint64_t>(b);
  };
  for (std::size_t i = 0; i < cities.size(); ++i) {
    const double magnitude = std::fabs(angle[i]) + nudge;
    const double rest = (magnitude - std::trunc(magnitude)) * 60.0;
    const bool equal = same(parts.degrees[i], std::trunc(magnitude)) &&
                       same(parts.minutes[i], std::trunc(rest)) &&
                       same(parts.seconds[i], (rest - std::trunc(rest)) * 60.0) &&
                       same(offset[i], std::remainder(longitude[i], 15.0) * 4.0);
    if (!equal) throw std::runtime_error("results differ from plain C++ for " + cities.name[i]);
  }
}
