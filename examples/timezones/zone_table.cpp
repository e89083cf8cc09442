// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "zone_table.hpp"

#include <charconv>
#include <fstream>
#include <optional>
#include <stdexcept>
#include <string_view>
#include <utility>

namespace {

std::optional<int> to_int(std::string_view digits) {
  int value = 0;
  const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), value);
  if (error != std::errc() || end != digits.data() + digits.size()) return std::nullopt;
  return value;
}

/// An angle as sign, degrees of `degree_digits` digits, minutes and perhaps seconds of two each.
std::optional<double> to_degrees(std::string_view text, std::size_t degree_digits) {
  if (text.size() != degree_digits + 3 && text.size() != degree_digits + 5) return std::nullopt;
  if (text[0] != '+' && text[0] != '-') return std::nullopt;
  const auto degrees = to_int(text.substr(1, degree_digits));
  const auto minutes = to_int(text.substr(degree_digits + 1, 2));
  const auto seconds =
      text.size() == degree_digits + 5 ? to_int(text.substr(degree_digits + 3)) : 0;
  if (!degrees || !minutes || !seconds || *minutes > 59 || *seconds > 59) return std::nullopt;
  const double magnitude = *degrees + (*minutes * 60 + *seconds) / 3600.0;
  return text[0] == '-' ? -magnitude : magnitude;
}

struct coordinates {
  double latitude;
  double longitude;
};

std::optional<coordinates> to_coordinates(std::string_view text) {
  const std::size_t second = text.find_first_of("+-", 1);
  if (second == std::string_view::npos) return std::nullopt;
  const auto latitude = to_degrees(text.substr(0, second), 2);
  const auto longitude = to_degrees(text.substr(second), 3);
  if (!latitude || !longitude) return std::nullopt;
  if (*latitude < -90 || *latitude > 90 || *longitude < -180 || *longitude > 180)
    return std::nullopt;
  return coordinates{*latitude, *longitude};
}

/// Cuts the next field off `line`.
std::string_view next_field(std::string_view& line) {
  const std::size_t tab = line.find('\t');
  const std::string_view field = line.substr(0, tab);
  line.remove_prefix(tab == std::string_view::npos ? line.size() : tab + 1);
  return field;
}

}  // namespace

zone_table read_zone_table(const std::filesystem::path& file) {
  std::ifstream input(file);
  if (!input) throw std::runtime_error("cannot open " + file.string());
  zone_table table;
  std::string line;
  for (int number = 1; std::getline(input, line); ++number) {
    if (line.empty() || line[0] == '#') continue;
    std::string_view rest = line;
    next_field(rest);  // country codes
    const auto position = to_coordinates(next_field(rest));
    const std::string_view name = next_field(rest);
    if (!position || name.empty())
      throw std::runtime_error(file.string() + ":" + std::to_string(number) +
                               ": expected codes, coordinates and a zone name separated by tabs");
    table.name.emplace_back(name);
    table.latitude.push_back(position->latitude);
    table.longitude.push_back(position->longitude);
  }
  if (input.bad()) throw std::runtime_error("cannot read " + file.string());
  if (table.size() == 0) throw std::runtime_error(file.string() + ": no zones in this file");
  return table;
}
