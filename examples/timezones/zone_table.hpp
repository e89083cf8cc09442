// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <filesystem>
#include <string>
#include <vector>

/// The principal cities of the world's time zones, one array per column.
struct zone_table {
  std::vector<std::string> name;
  std::vector<double> latitude;   ///< degrees, north positive
  std::vector<double> longitude;  ///< degrees, east positive

  std::size_t size() const { return name.size(); }
};

/// Reads a table in the format of tzdata's zone1970.tab: country codes, coordinates as
/// ±DDMM±DDDMM or ±DDMMSS±DDDMMSS, zone name, separated by tabs; lines that start with # are
/// comments.
/// @throws std::runtime_error that names the file, and the line where one is malformed
zone_table read_zone_table(const std::filesystem::path& file);
