// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// `ulp FUNCTOR…`: the error of scalar functors in units in the last place, against MPFR.

#include <CLI/CLI.hpp>

#include <iostream>
#include <string>
#include <vector>

#include "functor.hpp"
#include "measurement.hpp"
#include "reference.hpp"
#include "report.hpp"

namespace {

using namespace arbor::lumen::accuracy;

struct options {
  std::vector<std::string> names;
  std::vector<double> interval, second_interval;
  sampling samples;
  bool markdown = false;
  bool glibc = false;
  bool list = false;
};

void list_functors() {
  for (const functor& f : functors()) {
    if (f.is_real() && find_reference(f.function) != nullptr) std::cout << f.name << "\n";
  }
}

void show(const options& chosen, const subject& s, const reference& r) {
  const measurement m = measure(s, r, chosen.samples);
  if (chosen.markdown)
    write_markdown_row(std::cout, s, chosen.samples, m);
  else
    write_report(std::cout, s, chosen.samples, m);
}

/// Throws CLI::Error with what is wrong with a name or an interval.
void measure_functor(options chosen, const std::string& name) {
  const functor* f = find_functor(name);
  if (f == nullptr) throw CLI::ValidationError(name, "there is no such functor; see --list");
  const reference* r = find_reference(f->function);
  if (r == nullptr || !f->is_real())
    throw CLI::ValidationError(name, "there is no reference for it; see --list");
  auto& ranges = chosen.samples.ranges;
  ranges = r->ranges(f->type);
  if (!chosen.interval.empty()) ranges.at(0) = {chosen.interval[0], chosen.interval[1]};
  if (!chosen.second_interval.empty() && f->inputs() == 2)
    ranges.at(1) = {chosen.second_interval[0], chosen.second_interval[1]};
  for (const range& bounds : ranges) {
    if (!(bounds.low <= bounds.high)) throw CLI::ValidationError(name, "the interval is empty");
  }
  if (chosen.samples.step != 0 && f->inputs() != 1)
    throw CLI::ValidationError(name, "a walk through the numbers needs one operand");
  show(chosen, subject_of(*f), *r);
  if (chosen.glibc) {
    if (const auto c = c_library_subject(*r, f->type)) show(chosen, *c, *r);
  }
}

}  // namespace

int main(int argc, char** argv) {
  CLI::App app("The error of scalar functors in units in the last place, against MPFR");
  options chosen;
  bool exhaustive = false;
  app.add_option("functor", chosen.names, "names of functors, such as exp_s_la_gen");
  app.add_flag("--list", chosen.list, "list the functors that can be measured");
  app.add_option("--interval", chosen.interval, "of the (first) operand")->expected(2);
  app.add_option("--second", chosen.second_interval, "interval of the second operand")->expected(2);
  app.add_option("-n,--count", chosen.samples.count, "number of random arguments")
      ->capture_default_str();
  app.add_flag("--uniform", chosen.samples.uniform,
               "uniform in value; without it every number of the format is equally likely");
  app.add_flag("--exhaustive", exhaustive, "every number of the interval");
  app.add_option("--step", chosen.samples.step, "every STEPth number of the interval");
  app.add_option("--seed", chosen.samples.seed, "of the random arguments")->capture_default_str();
  app.add_flag("--markdown", chosen.markdown, "one row of a table per functor");
  app.add_flag("--glibc", chosen.glibc, "measure the C library's function beside it");
  try {
    app.parse(argc, argv);
    if (exhaustive) chosen.samples.step = 1;
    if (chosen.list) list_functors();
    if (!chosen.list && chosen.names.empty()) throw CLI::RequiredError("functor");
    for (const std::string& name : chosen.names) measure_functor(chosen, name);
  } catch (const CLI::Error& error) {
    return app.exit(error) == 0 ? 0 : 2;
  }
  return 0;
}
