// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// What an array library is for, on real data: the coordinates of the world's time zone cities in
/// degrees, minutes and seconds, how far each city's sun is from the clock of its zone, the
/// distances between all of them, and their places on a map.

#include <CLI/CLI.hpp>
#include <arbor/lumen/vm.hpp>
#include <chrono>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <exception>
#include <stdexcept>
#include <string>

#include "coordinates.hpp"
#include "globe.hpp"
#include "zone_table.hpp"

namespace vm = arbor::lumen::vm;

namespace {

void print_row(const zone_table& cities, std::size_t i, const sexagesimal& latitude,
               const sexagesimal& longitude, const column& offset, const map_points& points) {
  std::printf(
      "%-32s %3.0f° %02.0f' %04.1f\" %c  %3.0f° %02.0f' %04.1f\" %c  %+6.1f min  %+7.4f %+7.4f\n",
      cities.name[i].c_str(), latitude.degrees[i], latitude.minutes[i], latitude.seconds[i],
      cities.latitude[i] < 0 ? 'S' : 'N', longitude.degrees[i], longitude.minutes[i],
      longitude.seconds[i], cities.longitude[i] < 0 ? 'W' : 'E', offset[i], points.east[i],
      points.north[i]);
}

void print_pair(const char* what, const zone_table& cities, pair_of_cities pair,
                const column& distance) {
  std::printf("  %-9s %s and %s, %.1f km\n", what, cities.name[pair.first].c_str(),
              cities.name[pair.second].c_str(), distance[pair.first * cities.size() + pair.second]);
}

/// Distances and map at each accuracy, each compared with long double.
void show_globe(sycl::queue& queue, const zone_table& cities) {
  struct {
    const char* name;
    vm::enums::mode mode;
    double ulp;
  } constexpr tiers[] = {{"ha", vm::enums::mode::ha, 1},
                         {"la", vm::enums::mode::la, 4},
                         {"ep", vm::enums::mode::ep, 0x1p27}};
  std::printf("\n%zu distances, and how far they and the map are from long double:\n",
              cities.size() * cities.size());
  for (const auto& tier : tiers) {
    const column distance = distances(queue, cities, tier.mode);
    const map_points points = mercator(queue, cities, tier.mode);
    const deviation off = check_globe(cities, distance, points, tier.ulp);
    std::printf("  %s  at most %8.2g mm, %8.2g mm\n", tier.name, off.distance * 1e6,
                off.map * 6371e6);
    if (tier.mode != vm::enums::mode::ha) continue;
    print_pair("closest", cities, closest(cities, distance), distance);
    print_pair("farthest", cities, farthest(cities, distance), distance);
  }
}

/// Elements per second of one function over a large array in the device's own memory, beside a
/// plain loop.
template <typename Call, typename Plain>
void measure(sycl::queue& queue, const char* name, Call call, Plain plain) {
  constexpr std::int64_t n = std::int64_t{1} << 22;
  constexpr int runs = 5;
  double* a = sycl::malloc_device<double>(n, queue);
  double* b = sycl::malloc_device<double>(n, queue);
  double* y = sycl::malloc_device<double>(n, queue);
  if (a == nullptr || b == nullptr || y == nullptr)
    throw std::runtime_error("the device has no memory for a larger run");
  column x(n), z(n);
  for (std::size_t i = 0; i < x.size(); ++i) x[i] = static_cast<double>(i % 1000 + 1) / 1001;
  queue.memcpy(a, x.data(), n * sizeof(double));
  queue.fill(b, 15.0, n);
  queue.wait_and_throw();
  const auto rate = [&](auto run) {
    run();  // the first run pays for pages and code
    const auto start = std::chrono::steady_clock::now();
    for (int i = 0; i < runs; ++i) run();
    const std::chrono::duration<double> time = std::chrono::steady_clock::now() - start;
    return static_cast<double>(n) * runs / time.count() / 1e6;
  };
  const double of_call = rate([&] { call(queue, n, a, b, y).wait_and_throw(); });
  const double of_loop = rate([&] {
    for (std::size_t i = 0; i < x.size(); ++i) z[i] = plain(x[i]);
    // Somebody may read the results now: else runs that repeat each other would become one.
    asm volatile("" : : "r"(z.data()) : "memory");
  });
  std::printf("  %-10s %8.1f %16.1f\n", name, of_call, of_loop);
  for (double* array : {a, b, y}) sycl::free(array, queue);
}

void measure_all(sycl::queue& queue) {
  std::printf("\nMillion elements per second, 4194304 doubles in device memory:\n");
  std::printf("  %-10s %8s %16s\n", "", "device", "plain std:: loop");
  measure(
      queue, "mul",
      [](auto& q, auto n, auto* a, auto* b, auto* y) { return vm::mul(q, n, a, b, y); },
      [](double x) { return x * 15.0; });
  measure(
      queue, "remainder",
      [](auto& q, auto n, auto* a, auto* b, auto* y) { return vm::remainder(q, n, a, b, y); },
      [](double x) { return std::remainder(x, 15.0); });
  measure(
      queue, "sin", [](auto& q, auto n, auto* a, auto*, auto* y) { return vm::sin(q, n, a, y); },
      [](double x) { return std::sin(x); });
  measure(
      queue, "asin", [](auto& q, auto n, auto* a, auto*, auto* y) { return vm::asin(q, n, a, y); },
      [](double x) { return std::asin(x); });
  measure(
      queue, "ln", [](auto& q, auto n, auto* a, auto*, auto* y) { return vm::ln(q, n, a, y); },
      [](double x) { return std::log(x); });
}

void run_on(const sycl::device& device, const zone_table& cities, bool all) {
  sycl::queue queue(device);
  std::printf("\n%s\n\n", device.get_info<sycl::info::device::name>().c_str());
  const sexagesimal latitude = to_sexagesimal(queue, cities.latitude);
  const sexagesimal longitude = to_sexagesimal(queue, cities.longitude);
  const column offset = solar_offset(queue, cities.longitude);
  check_coordinates(cities, cities.latitude, latitude, cities.longitude, offset);
  check_coordinates(cities, cities.longitude, longitude, cities.longitude, offset);
  const map_points points = mercator(queue, cities, vm::enums::mode::ha);

  std::printf("%-32s %-16s  %-16s  %-11s Mercator: east, north\n", "zone", "latitude", "longitude",
              "sun - clock");
  const std::size_t step = all ? 1 : (cities.size() + 11) / 12;
  for (std::size_t i = 0; i < cities.size(); i += step)
    print_row(cities, i, latitude, longitude, offset, points);
  std::printf("\n%zu cities, coordinates and times equal to plain C++ bit by bit.\n",
              cities.size());
  show_globe(queue, cities);
  measure_all(queue);
}

}  // namespace

int main(int argc, char** argv) {
  CLI::App app(
      "Coordinates, solar time, distances and map of the world's time zone cities, on each device");
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
