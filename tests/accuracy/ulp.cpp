// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

/// `ulp NAME…`: the error of scalar functors and of public calls in units in the last place,
/// against MPFR.

#include <CLI/CLI.hpp>

#include <iostream>
#include <string>
#include <vector>

#include "functor.hpp"
#include "measurement.hpp"
#include "public_call.hpp"
#include "reference.hpp"
#include "report.hpp"

namespace {

using namespace arbor::lumen::accuracy;
namespace vm = arbor::lumen::vm;

struct options {
  std::vector<std::string> names;
  std::vector<double> interval, second_interval;
  sampling samples;
  std::string mode = "ha";
  std::string device;
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
  const measurement m = measure({&s, 1}, r, chosen.samples).front();
  if (chosen.markdown)
    write_markdown_row(std::cout, s, interval_text(chosen.samples), m);
  else
    write_report(std::cout, s, chosen.samples, m);
}

vm::enums::mode mode_of(const std::string& word) {
  if (word == "la") return vm::enums::mode::la;
  return word == "ep" ? vm::enums::mode::ep : vm::enums::mode::ha;
}

sycl::queue queue_on(const std::string& device) {
  if (device == "cpu") return sycl::queue(sycl::cpu_selector_v);
  if (device == "gpu") return sycl::queue(sycl::gpu_selector_v);
  return sycl::queue();
}

/// What a name stands for.
struct target {
  subject measured;
  std::string_view function;
  char type;
};

/// Throws CLI::Error with what is wrong with the name.
target find_target(const options& chosen, const std::string& name) {
  if (const functor* f = find_functor(name); f != nullptr && f->is_real())
    return {subject_of(*f), f->function, f->type};
  if (const public_call* call = find_public_call(name))
    return {subject_of(*call, queue_on(chosen.device), mode_of(chosen.mode)), call->function,
            call->type};
  throw CLI::ValidationError(name, "there is no such functor or call; see --list");
}

/// Throws CLI::Error with what is wrong with a name or an interval.
void measure_target(options chosen, const std::string& name) {
  const target t = find_target(chosen, name);
  const reference* r = find_reference(t.function);
  if (r == nullptr) throw CLI::ValidationError(name, "there is no reference for it; see --list");
  auto& ranges = chosen.samples.ranges;
  ranges = r->ranges(t.type);
  if (!chosen.interval.empty()) ranges.at(0) = {chosen.interval[0], chosen.interval[1]};
  if (!chosen.second_interval.empty() && t.measured.inputs == 2)
    ranges.at(1) = {chosen.second_interval[0], chosen.second_interval[1]};
  for (const range& bounds : ranges) {
    if (!(bounds.low <= bounds.high)) throw CLI::ValidationError(name, "the interval is empty");
  }
  if (chosen.samples.step != 0 && t.measured.inputs != 1)
    throw CLI::ValidationError(name, "a walk through the numbers needs one operand");
  show(chosen, t.measured, *r);
  if (chosen.glibc) {
    if (const auto c = c_library_subject(*r, t.type)) show(chosen, *c, *r);
  }
}

}  // namespace

int main(int argc, char** argv) {
  CLI::App app(
      "The error of scalar functors and public calls in units in the last place, against MPFR");
  options chosen;
  bool exhaustive = false;
  app.add_option("name", chosen.names,
                 "names of functors, such as exp_s_la_gen, or of public calls, such as exp_s");
  app.add_option("--mode", chosen.mode, "accuracy of public calls")
      ->check(CLI::IsMember({"ha", "la", "ep"}))
      ->capture_default_str();
  app.add_option("--device", chosen.device, "device of public calls")
      ->check(CLI::IsMember({"cpu", "gpu"}));
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
    if (!chosen.list && chosen.names.empty()) throw CLI::RequiredError("name");
    for (const std::string& name : chosen.names) measure_target(chosen, name);
  } catch (const CLI::Error& error) {
    return app.exit(error) == 0 ? 0 : 2;
  } catch (const sycl::exception& error) {
    std::cerr << "ulp: " << error.what() << "\n";
    return 1;
  }
  return 0;
}
