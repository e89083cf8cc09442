// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// What an array library is for, on real data: the coordinates of the world's time zone cities in
/// degrees, minutes and seconds, and how far each city's sun is from the clock of its zone.

#include <CLI/CLI.hpp>
#include <arbor/lumen/vm.hpp>
#include <bit>
#include <chrono>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <exception>
#include <stdexcept>
#include <string>
#include <vector>

#include "zone_table.hpp"

namespace vm = arbor::lumen::vm;

namespace {

using column = std::vector<double>;

/// Magnitudes of angles, taken apart.
struct sexagesimal {
  column degrees, minutes, seconds;
};

/// Added to a magnitude before it is cut, so that 31 minutes, which have no exact decimal degrees,
/// do not come out as 30 minutes and 60 seconds: a nanodegree, 0.1 mm on the ground.
constexpr double nudge = 1e-9;

/// Degrees in decimals to degrees, minutes and seconds of arc, all in whole arrays.
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

/// Minutes by which the mean sun is ahead of the clock: 4 for each degree east of the middle of the
/// nearest zone of 15 degrees.
column solar_offset(sycl::queue& queue, const column& longitude) {
  const std::size_t n = longitude.size();
  column offset(n);
  vm::remainder(queue, longitude, column(n, 15.0), offset);
  vm::mul(queue, offset, column(n, 4.0), offset);
  return offset;
}

/// Compares with the same computation in plain C++, bit by bit.
/// @throws std::runtime_error that names the city where they differ
void check(const zone_table& cities, const column& angle, const sexagesimal& parts,
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

void print_row(const zone_table& cities, std::size_t i, const sexagesimal& latitude,
               const sexagesimal& longitude, const column& offset) {
  std::printf("%-32s %3.0f° %02.0f' %04.1f\" %c  %3.0f° %02.0f' %04.1f\" %c  %+6.1f min\n",
              cities.name[i].c_str(), latitude.degrees[i], latitude.minutes[i], latitude.seconds[i],
              cities.latitude[i] < 0 ? 'S' : 'N', longitude.degrees[i], longitude.minutes[i],
              longitude.seconds[i], cities.longitude[i] < 0 ? 'W' : 'E', offset[i]);
}

/// Elements per second of one function over a large array in the device's own memory.
template <typename Call>
void measure(sycl::queue& queue, const char* name, Call call) {
  constexpr std::int64_t n = std::int64_t{1} << 22;
  double* a = sycl::malloc_device<double>(n, queue);
  double* b = sycl::malloc_device<double>(n, queue);
  double* y = sycl::malloc_device<double>(n, queue);
  if (a == nullptr || b == nullptr || y == nullptr)
    throw std::runtime_error("the device has no memory for a larger run");
  queue.fill(a, 137.036, n);
  queue.fill(b, 15.0, n).wait();
  call(queue, n, a, b, y).wait_and_throw();  // the first run pays for pages and code
  constexpr int runs = 5;
  const auto start = std::chrono::steady_clock::now();
  for (int run = 0; run < runs; ++run) call(queue, n, a, b, y).wait_and_throw();
  const std::chrono::duration<double> time = std::chrono::steady_clock::now() - start;
  std::printf("  %-10s %8.1f million elements per second\n", name,
              static_cast<double>(n) * runs / time.count() / 1e6);
  for (double* array : {a, b, y}) sycl::free(array, queue);
}

void run_on(const sycl::device& device, const zone_table& cities, bool all) {
  sycl::queue queue(device);
  std::printf("\n%s\n\n", device.get_info<sycl::info::device::name>().c_str());
  const sexagesimal latitude = to_sexagesimal(queue, cities.latitude);
  const sexagesimal longitude = to_sexagesimal(queue, cities.longitude);
  const column offset = solar_offset(queue, cities.longitude);
  check(cities, cities.latitude, latitude, cities.longitude, offset);
  check(cities, cities.longitude, longitude, cities.longitude, offset);

  std::printf("%-32s %-16s  %-16s  %s\n", "zone", "latitude", "longitude", "sun ahead of clock");
  const std::size_t step = all ? 1 : (cities.size() + 11) / 12;
  for (std::size_t i = 0; i < cities.size(); i += step)
    print_row(cities, i, latitude, longitude, offset);
  std::printf("\n%zu cities, all results equal to plain C++ bit by bit.\n", cities.size());

  std::printf("Larger runs, 4194304 elements of double in device memory:\n");
  const auto mul = [](auto&... args) { return vm::mul(args...); };
  const auto remainder = [](auto&... args) { return vm::remainder(args...); };
  const auto trunc = [](sycl::queue& q, std::int64_t n, double* a, double*, double* y) {
    return vm::trunc(q, n, a, y);
  };
  measure(queue, "trunc", trunc);
  measure(queue, "mul", mul);
  measure(queue, "remainder", remainder);
}

}  // namespace

int main(int argc, char** argv) {
  CLI::App app("Coordinates and solar time of the world's time zone cities, on each device");
  std::string file = "/usr/share/zoneinfo/zone1970.tab";
  bool all = false;
  app.add_option("file", file, "table of cities in the format of tzdata's zone1970.tab")
      ->capture_default_str();
  app.add_flag("--all", all, "print every city instead of a dozen");
  CLI11_PARSE(app, argc, argv);
  try {
    const zone_table cities = read_zone_table(file);
    for (const sycl::device& device : sycl::device::get_devices()) run_on(device, cities, all);
  } catch (const std::exception& error) {
    std::fflush(stdout);
    std::fprintf(stderr, "timezones: %s\n", error.what());
    return 1;
  }
  return 0;
}
