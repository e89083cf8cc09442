// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <sycl/sycl.hpp>
#include <vector>

#include "zone_table.hpp"

using column = std::vector<double>;

/// Magnitudes of angles, taken apart.
struct sexagesimal {
  column degrees, minutes, seconds;
};

/// Degrees in decimals to degrees, minutes and seconds of arc, all in whole arrays.
sexagesimal to_sexagesimal(sycl::queue& queue, const column& angle);

/// Minutes by which the mean sun is ahead of the clock: 4 for each degree east of the middle of the
/// nearest zone of 15 degrees.
column solar_offset(sycl::queue& queue, const column& longitude);

/// Compares both with the same computation in plain C++, bit by bit.
/// @throws std::runtime_error that names the city where they differ
void check_coordinates(const zone_table& cities, const column& angle, const sexagesimal& parts,
                       const column& longitude, const column& offset);
