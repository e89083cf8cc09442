// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "measurement.hpp"

#include <algorithm>
#include <cmath>
#include <random>

#include "ulp_error.hpp"

namespace arbor::lumen::accuracy {

namespace {

/// Arguments of one operand.
class source {
 public:
  source(const number_format& format, range bounds, const sampling& samples, std::uint64_t stream)
      : format_(format),
        bounds_(bounds),
        samples_(samples),
        engine_(samples.seed + stream),
        first_(format.rank(format.pattern(bounds.low))),
        last_(format.rank(format.pattern(bounds.high))),
        next_(first_) {}

  /// The next argument's pattern; nothing after the last one.
  std::optional<std::uint64_t> next() {
    if (samples_.step != 0) {
      if (next_ > last_) return {};
      const std::uint64_t pattern = format_.at_rank(next_);
      next_ += static_cast<std::int64_t>(samples_.step);
      return pattern;
    }
    if (taken_++ == samples_.count) return {};
    if (samples_.uniform) {
      std::uniform_real_distribution<double> values(bounds_.low, bounds_.high);
      return format_.pattern(values(engine_));
    }
    std::uniform_int_distribution<std::int64_t> ranks(first_, last_);
    return format_.at_rank(ranks(engine_));
  }

 private:
  const number_format& format_;
  range bounds_;
  const sampling& samples_;
  std::mt19937_64 engine_;
  std::int64_t first_, last_, next_;
  std::uint64_t taken_ = 0;
};

class mpfr_pair {
 public:
  explicit mpfr_pair(mpfr_prec_t precision) {
    for (auto& x : numbers) mpfr_init2(x, precision);
  }
  ~mpfr_pair() {
    for (auto& x : numbers) mpfr_clear(x);
  }
  mpfr_pair(const mpfr_pair&) = delete;
  mpfr_pair& operator=(const mpfr_pair&) = delete;
  mpfr_t numbers[2];
};

std::string text(const mpfr_t x) {
  char* digits = nullptr;
  mpfr_asprintf(&digits, "%.25Rg", x);
  std::string result(digits);
  mpfr_free_str(digits);
  return result;
}

template <typename T>
subject of_c_function(const std::string& name, T (*f)(T), const number_format& format) {
  return {name, &format, 1, 1, [f](const void* const* in, void* const* out, std::size_t n) {
            for (std::size_t i = 0; i < n; ++i)
              static_cast<T*>(out[0])[i] = f(static_cast<const T*>(in[0])[i]);
          }};
}

}  // namespace

subject subject_of(const functor& f) {
  return {std::string(f.name), &format_of(f.type), f.inputs(), f.outputs(),
          [run = f.run](const void* const* in, void* const* out, std::size_t n) {
            std::vector<std::uint32_t> status(n);
            run(in, out, status.data(), n);
          }};
}

subject loop_subject_of(const functor& f) {
  subject s = subject_of(f);
  if (f.run_loop != nullptr) s.run = f.run_loop;
  return s;
}

std::optional<subject> c_library_subject(const reference& r, char type) {
  if (type == 's' && r.c_float != nullptr)
    return of_c_function("C library, float", r.c_float, float_format);
  if (type == 'd' && r.c_double != nullptr)
    return of_c_function("C library, double", r.c_double, double_format);
  return {};
}

void measurement::add(double error) {
  const double magnitude = std::fabs(error);
  ++count;
  sum += magnitude;
  int bin = 0;
  if (magnitude >= std::ldexp(1.0, first_bin_exponent))
    bin = std::isfinite(magnitude)
              ? std::min(std::ilogb(magnitude) - first_bin_exponent + 1, bins - 1)
              : bins - 1;
  ++histogram[static_cast<std::size_t>(bin)];
}

void measurement::add(const measurement& other) {
  if (other.largest > largest || count == 0) {
    largest = other.largest;
    worst_argument = other.worst_argument;
    worst_result = other.worst_result;
    worst_output = other.worst_output;
    worst_exact = other.worst_exact;
  }
  count += other.count;
  sum += other.sum;
  for (std::size_t i = 0; i < histogram.size(); ++i) histogram[i] += other.histogram[i];
}

std::vector<measurement> measure(std::span<const subject> subjects, const reference& r,
                                 const sampling& samples) {
  constexpr std::size_t block = 1024;
  const subject& form = subjects.front();
  const number_format& format = *form.format;
  std::vector<source> sources;
  for (std::size_t k = 0; k < form.inputs; ++k)
    sources.emplace_back(format, samples.ranges.at(k), samples, k);
  std::array<std::vector<char>, 2> in_storage;
  std::vector<std::array<std::vector<char>, 2>> out_storage(subjects.size());
  for (auto& array : in_storage) array.resize(block * format.size);
  for (auto& arrays : out_storage) {
    for (auto& array : arrays) array.resize(block * format.size);
  }
  const void* in[] = {in_storage[0].data(), in_storage[1].data()};

  ulp_error error_of(format);
  mpfr_pair operands(64), exact(format.precision + 48);
  std::vector<measurement> measured(subjects.size());
  for (bool more = true; more;) {
    std::size_t n = 0;
    for (; n < block && more; ++n) {
      for (std::size_t k = 0; k < form.inputs && more; ++k) {
        const auto pattern = sources[k].next();
        more = pattern.has_value();
        if (more) format.store(in_storage[k].data(), n, *pattern);
      }
      if (!more) break;
    }
    for (std::size_t s = 0; s < subjects.size(); ++s) {
      void* out[] = {out_storage[s][0].data(), out_storage[s][1].data()};
      subjects[s].run(in, out, n);
    }
    for (std::size_t i = 0; i < n; ++i) {
      for (std::size_t k = 0; k < form.inputs; ++k)
        mpfr_set_d(operands.numbers[k], format.value(format.load(in[k], i)), MPFR_RNDN);
      r.exact(exact.numbers, operands.numbers);
      for (std::size_t s = 0; s < subjects.size(); ++s) {
        measurement& m = measured[s];
        for (std::size_t k = 0; k < form.outputs; ++k) {
          const std::uint64_t result = format.load(out_storage[s][k].data(), i);
          const double error = error_of(format.value(result), exact.numbers[k]);
          m.add(error);
          if (std::fabs(error) > m.largest || m.count == 1) {
            m.largest = std::fabs(error);
            for (std::size_t j = 0; j < form.inputs; ++j)
              m.worst_argument[j] = format.load(in[j], i);
            m.worst_result = result;
            m.worst_output = k;
            m.worst_exact = text(exact.numbers[k]);
          }
        }
      }
    }
  }
  return measured;
}

}  // namespace arbor::lumen::accuracy
