// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// `accuracy_pages FOLDER FUNCTION…` writes FOLDER/<function>.md: the errors of all functors of a
/// function beside those of the C library at the same arguments.

#include <CLI/CLI.hpp>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <set>
#include <string>
#include <string_view>
#include <thread>
#include <vector>

#include "float_walk.hpp"
#include "functor.hpp"
#include "measurement.hpp"
#include "reference.hpp"
#include "report.hpp"

namespace {

using namespace arbor::lumen::accuracy;

/// Where the errors of a function of one operand peak.
struct peak {
  std::string_view function;
  range interval;
};
constexpr peak peaks[] = {
    {"acos", {.5, 1}},   {"asin", {.3, 1}},   {"cos", {-4, 4}},   {"exp", {-2, 2}},
    {"exp10", {-2, 2}},  {"exp2", {-2, 2}},   {"expm1", {-1, 1}}, {"ln", {.5, 2}},
    {"log10", {.5, 2}},  {"log1p", {-.5, 1}}, {"log2", {.5, 2}},  {"sin", {-4, 4}},
    {"sincos", {-4, 4}}, {"tan", {-4, 4}},    {"atan", {-8, 8}},  {"atanpi", {-8, 8}},
    {"acospi", {.5, 1}}, {"asinpi", {.3, 1}}, {"cbrt", {1, 8}},   {"invcbrt", {1, 8}},
    {"invsqrt", {1, 4}}, {"inv", {1, 2}},     {"pow2o3", {1, 8}}, {"pow3o2", {1, 4}},
};

struct options {
  std::filesystem::path folder;
  std::vector<std::string> functions;
  std::uint64_t count = 10'000'000;
  bool every_float = true;
};

std::vector<std::string> measurable_functions() {
  std::set<std::string> names;
  for (const functor& f : functors()) {
    if (f.is_real() && find_reference(f.function) != nullptr) names.emplace(f.function);
  }
  return {names.begin(), names.end()};
}

/// Half of the samples uniform over the numbers, half uniform in value, shared among the
/// processors.
std::vector<measurement> measure_random(std::span<const subject> subjects, const reference& r,
                                        sampling samples) {
  std::vector<sampling> kinds(2, samples);
  kinds[1].uniform = true;
  for (const peak& p : peaks) {
    if (p.function != r.function) continue;
    kinds.push_back(kinds[1]);
    kinds[2].ranges = {p.interval};
  }
  const std::uint64_t threads = std::max(1u, std::thread::hardware_concurrency());
  std::vector<std::vector<measurement>> parts(kinds.size() * threads);
  {
    std::vector<std::jthread> running;
    for (std::uint64_t t = 0; t < threads; ++t) {
      running.emplace_back([&, t] {
        for (std::size_t k = 0; k < kinds.size(); ++k) {
          const std::size_t part = kinds.size() * t + k;
          sampling mine = kinds[k];
          mine.count = samples.count / parts.size() + 1;
          mine.seed += 16 * part;
          parts[part] = measure(subjects, r, mine);
        }
      });
    }
  }
  for (std::size_t p = 1; p < parts.size(); ++p) {
    for (std::size_t s = 0; s < subjects.size(); ++s) parts[0][s].add(parts[p][s]);
  }
  return parts[0];
}

/// The rows of one element type. Halves and, on request, floats of one operand are measured at
/// every number, all else at random arguments.
void write_type(std::ostream& out, const std::string& function, char type, const options& chosen) {
  const reference& r = *find_reference(function);
  std::vector<subject> subjects;
  for (const functor& f : functors()) {
    if (f.function == function && f.type == type) subjects.push_back(loop_subject_of(f));
  }
  if (subjects.empty()) return;
  if (const auto c = c_library_subject(r, type)) subjects.push_back(*c);
  const bool one_operand = subjects.front().inputs == 1;

  sampling samples;
  samples.ranges = r.ranges(type);
  samples.count = chosen.count;
  std::vector<measurement> measured;
  std::string how = "random";
  if (type == 's' && one_operand && chosen.every_float && r.c_double != nullptr) {
    measured = measure_every_float(subjects, r);
    how = "every float";
  } else if (type == 'h' && one_operand) {
    samples.ranges = {{-65504, 65504}};
    samples.step = 1;
    measured = measure(subjects, r, samples);
    how = "every half";
  } else {
    measured = measure_random(subjects, r, samples);
    how = "random " + interval_text(samples);
  }
  for (std::size_t s = 0; s < subjects.size(); ++s)
    write_markdown_row(out, subjects[s], how, measured[s]);
}

void write_page(const std::string& function, const options& chosen) {
  if (find_reference(function) == nullptr)
    throw CLI::ValidationError(function, "there is no reference for it");
  const std::filesystem::path path = chosen.folder / (function + ".md");
  std::ostringstream page;
  page << "# Accuracy of " << function << "\n\n"
       << "Errors in ulp against MPFR; of floats where every one was measured, against the C "
          "library's double\nfunction. Random arguments are in equal parts uniform over the "
          "numbers of the interval, uniform\nin value, and uniform in a narrow interval where "
          "errors "
          "peak, if the function has one. Written by `scripts/accuracy`.\n\n"
       << "| | Arguments | Number | Largest | At | Mean |\n|---|---|---|---|---|---|\n";
  for (const char type : {'h', 's', 'd'}) {
    std::cerr << function << ", " << type << std::endl;
    write_type(page, function, type, chosen);
  }
  std::ofstream file(path);
  file << page.str();
  if (!file.flush()) throw CLI::FileError(path.string());
}

}  // namespace

int main(int argc, char** argv) {
  CLI::App app("Writes the accuracy pages of functions");
  options chosen;
  app.add_option("folder", chosen.folder, "where to write")
      ->required()
      ->check(CLI::ExistingDirectory);
  app.add_option("function", chosen.functions, "functions; without any, all that have a reference");
  app.add_option("-n,--count", chosen.count, "number of random arguments")->capture_default_str();
  app.add_flag("--every-float,!--random-floats", chosen.every_float,
               "measure functions of one float at every float");
  try {
    app.parse(argc, argv);
    if (chosen.functions.empty()) chosen.functions = measurable_functions();
    for (const std::string& function : chosen.functions) write_page(function, chosen);
  } catch (const CLI::Error& error) {
    return app.exit(error) == 0 ? 0 : 2;
  }
  return 0;
}
