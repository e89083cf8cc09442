// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <arbor/lumen/vm.hpp>
#include <cstddef>

#include "coordinates.hpp"

/// Distances in km between all pairs of n cities along great circles, n by n, row by row.
column distances(sycl::queue& queue, const zone_table& cities, arbor::lumen::vm::enums::mode tier);

/// The cities on a Mercator map of the earth's radius 1: east and north of where the equator meets
/// the prime meridian.
struct map_points {
  column east, north;
};
map_points mercator(sycl::queue& queue, const zone_table& cities,
                    arbor::lumen::vm::enums::mode tier);

/// The largest differences from the same formulas in long double.
struct deviation {
  double distance;  ///< km
  double map;       ///< in radii of the earth
};
/// @throws std::runtime_error that names the city, if a result is farther off than functions of an
/// error of `ulp` units in the last place can be
deviation check_globe(const zone_table& cities, const column& distance, const map_points& points,
                      double ulp);

struct pair_of_cities {
  std::size_t first, second;
};
pair_of_cities closest(const zone_table& cities, const column& distance);
pair_of_cities farthest(const zone_table& cities, const column& distance);
