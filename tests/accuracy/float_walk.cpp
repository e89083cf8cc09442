// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "float_walk.hpp"

#include <algorithm>
#include <atomic>
#include <bit>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <iterator>
#include <limits>
#include <mutex>
#include <string>
#include <thread>

namespace arbor::lumen::accuracy {

namespace {

constexpr std::size_t block = 8192;
constexpr std::uint64_t floats = std::uint64_t{1} << 32;

/// The magnitude of a float's error in ulp of `exact`, without a branch; the conventions are those
/// of `ulp_error`.
inline double float_error(float result, double exact) {
  constexpr double behind = 0x1p128, to_round = 0x1.ffffffp127;
  const double magnitude = std::fabs(exact);
  const double r = static_cast<double>(result);
  const double near_r = std::fabs(r) > behind ? std::copysign(behind, r) : r;
  const double near_e = magnitude >= to_round ? std::copysign(behind, exact) : exact;
  double binade = magnitude < 0x1p-126 ? 0x1p-126 : magnitude;
  binade = binade >= behind ? 0x1p127 : binade;
  // 2^23 over the power of two below.
  const std::uint64_t scale = (std::uint64_t{2 * 1023 + 23} << 52) -
                              (std::bit_cast<std::uint64_t>(binade) & 0x7ff0000000000000u);
  const double error = std::fabs((near_r - near_e) * std::bit_cast<double>(scale));
  const bool result_is_nan = result != result, exact_is_nan = exact != exact;
  const double of_nans =
      result_is_nan == exact_is_nan ? 0 : std::numeric_limits<double>::infinity();
  return result_is_nan | exact_is_nan ? of_nans : error;
}

/// The walk of one thread.
class walk {
 public:
  walk(std::span<const subject> subjects, const reference& r)
      : subjects_(subjects),
        reference_(r),
        x_(block),
        exact_(block),
        results_(subjects.size(), std::vector<float>(block)),
        total_(subjects.size()) {}

  void measure_block(std::uint32_t first) {
    for (std::size_t i = 0; i < block; ++i) {
      x_[i] = std::bit_cast<float>(first + static_cast<std::uint32_t>(i));
      exact_[i] = reference_.c_double(static_cast<double>(x_[i]));
    }
    std::vector<measurement> of_block(subjects_.size());
    for (std::size_t k = 0; k < subjects_.size(); ++k) {
      const void* in[] = {x_.data()};
      void* out[] = {results_[k].data()};
      subjects_[k].run(in, out, block);
      // Tiers that are one body have the same errors.
      std::size_t same = 0;
      while (same != k &&
             std::memcmp(results_[same].data(), results_[k].data(), block * sizeof(float)) != 0)
        ++same;
      of_block[k] = same != k ? of_block[same] : errors(results_[k], first);
      total_[k].add(of_block[k]);
    }
  }

  const std::vector<measurement>& total() const { return total_; }

 private:
  measurement errors(const std::vector<float>& results, std::uint32_t first) const {
    std::vector<double> error(block);
    double sum = 0;
    for (std::size_t i = 0; i < block; ++i) error[i] = float_error(results[i], exact_[i]);
    for (std::size_t i = 0; i < block; ++i) sum += error[i];
    const auto worst = static_cast<std::size_t>(
        std::distance(error.begin(), std::max_element(error.begin(), error.end())));
    measurement m;
    m.count = block;
    m.sum = sum;
    m.largest = error[worst];
    m.worst_argument[0] = first + worst;
    m.worst_result = std::bit_cast<std::uint32_t>(results[worst]);
    m.worst_exact = std::to_string(exact_[worst]);
    return m;
  }

  std::span<const subject> subjects_;
  const reference& reference_;
  std::vector<float> x_;
  std::vector<double> exact_;
  std::vector<std::vector<float>> results_;
  std::vector<measurement> total_;
};

}  // namespace

std::vector<measurement> measure_every_float(std::span<const subject> subjects,
                                             const reference& r) {
  std::vector<measurement> total(subjects.size());
  std::atomic<std::uint64_t> next = 0;
  std::mutex mutex;
  const auto work = [&] {
    walk mine(subjects, r);
    for (std::uint64_t first; (first = next.fetch_add(block)) < floats;)
      mine.measure_block(static_cast<std::uint32_t>(first));
    const std::lock_guard lock(mutex);
    for (std::size_t k = 0; k < subjects.size(); ++k) total[k].add(mine.total()[k]);
  };
  std::vector<std::jthread> threads(std::max(1u, std::thread::hardware_concurrency()));
  for (std::jthread& t : threads) t = std::jthread(work);
  threads.clear();
  return total;
}

}  // namespace arbor::lumen::accuracy
