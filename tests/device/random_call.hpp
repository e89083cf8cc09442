// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <algorithm>
#include <array>
#include <bit>
#include <cmath>
#include <cstdint>
#include <random>
#include <sstream>
#include <string>
#include <vector>

#include "functors.hpp"
#include "memory.hpp"
#include "records.hpp"

/// Random calls, and what they have to do by a plain loop.
namespace arbor::lumen::tests {

/// Operands live in zones: two for inputs, two for outputs. In place, an output names the zone of
/// an input.
inline constexpr int zones = 4;
inline constexpr std::size_t zone_size = 96;

struct operand {
  int zone;
  slice where;  ///< {0, n, 1} for whole arrays
};

struct random_call {
  std::uint32_t mode = 0;
  bool sliced = false;
  std::int64_t n = 0;
  std::vector<operand> in, out;
  std::vector<float> constants;
  std::array<memory, zones> kinds{};
  memory status_kind = memory::plain;
  vm::error_handler<float> handler;
  std::array<std::vector<float>, zones> contents;
  std::vector<enums::status> status;
};

/// What is left of a call: an exception's text, or the or of all statuses and the changed arrays.
struct outcome {
  std::string error;
  std::uint32_t queue_status = 0;
};

class random_calls {
 public:
  explicit random_calls(std::uint32_t seed) : engine_(seed) {}

  template <typename Shape>
  random_call next() {
    random_call call;
    call.sliced = one_in(2) || one_in(2);
    const std::uint32_t policies[] = {enums::slice_normal, enums::slice_minimum,
                                      enums::slice_cyclic};
    const std::uint32_t policy = policies[number(0, 2)];
    call.mode = mode_with(policy | (one_in(3) ? enums::badarg_quiet : 0u) |
                          (one_in(4) ? enums::global_status_report : 0u));
    for (memory& kind : call.kinds) kind = all_memories[number(0, 3)];
    call.status_kind = all_memories[number(0, 3)];
    for (auto& zone : call.contents) {
      zone.resize(zone_size);
      for (float& value : zone) value = static_cast<float>(number(-40, 40));
    }
    for (int c = 0; c < Shape::constants; ++c)
      call.constants.push_back(static_cast<float>(number(-9, 9)));

    const bool cyclic = call.sliced && policy == enums::slice_cyclic;
    if (call.sliced) {
      const int common = one_in(10) ? 0 : number(1, 10);
      const auto size = [&] { return one_in(3) ? number(0, 10) : common; };
      for (int k = 0; k < Shape::inputs; ++k)
        call.in.push_back({k, slice_of(size(), one_in(6) ? 0 : stride())});
      const int first = cyclic ? number(0, 24) : size();
      for (int j = 0; j < Shape::outputs; ++j) {
        // A cyclic call goes on to the first output's size.
        const int own = j == 0 || cyclic ? first : size();
        call.out.push_back({2 + j, slice_of(own, stride())});
      }
    } else {
      call.n = number(-2, 20);
      for (int k = 0; k < Shape::inputs; ++k) call.in.push_back({k, {0, call.n, 1}});
      for (int j = 0; j < Shape::outputs; ++j) call.out.push_back({2 + j, {0, call.n, 1}});
    }
    alias(call, cyclic);

    if (one_in(2)) {
      const std::int64_t lengths[] = {0, 1, zone_size};
      call.handler.enabled = !one_in(4);
      call.handler.length = lengths[number(0, 2)];
      call.handler.status_to_fix = static_cast<std::uint32_t>(number(0, 15));
      const float values[] = {-7.5f, 0.25f, -0.0f, 3.0f};
      call.handler.fixup_value = values[number(0, 3)];
      call.handler.copy_sign = one_in(2);
    }
    call.status.assign(zone_size, enums::accuracy_warning);
    return call;
  }

 private:
  int number(int least, int most) {
    return std::uniform_int_distribution<int>(least, most)(engine_);
  }
  bool one_in(int n) { return number(1, n) == 1; }
  std::int64_t stride() { return (one_in(3) ? -1 : 1) * number(1, 3); }

  slice slice_of(std::int64_t size, std::int64_t by) {
    std::int64_t start = number(0, 10);
    // The highest element comes first; now and then it is too low, and the slice is empty.
    if (by < 0 && size > 0 && !one_in(12)) start -= (size - 1) * by;
    return {start, size, by};
  }

  /// Lets inputs share memory, or makes the call an in-place one: each work item reads only the
  /// element that it writes.
  void alias(random_call& call, bool cyclic) {
    if (call.in.size() > 1 && one_in(8)) {
      call.in[1].zone = call.in[0].zone;
    } else if (!cyclic && one_in(5)) {
      const operand& from =
          call.in[static_cast<std::size_t>(number(0, static_cast<int>(call.in.size()) - 1))];
      if (from.where.stride != 0) call.out[0] = from;
    }
  }

  std::mt19937 engine_;
};

inline bool is_empty(const slice& s) {
  return s.size == 0 || s.start + (s.size - 1) * s.stride < 0;
}

/// The number of computations of a sliced call, or the message of its rejection.
inline std::int64_t computations(const random_call& call, std::string& error) {
  const bool quiet = (call.mode & enums::badarg_quiet) != 0;
  const std::uint32_t policy = call.mode & 0x7000;
  std::vector<slice> slices;
  for (const operand& a : call.in) slices.push_back(a.where);
  for (const operand& y : call.out) slices.push_back(y.where);
  const std::int64_t target = call.out[0].where.size;
  std::int64_t least = target;
  bool none = false, differ = false;
  for (const slice& s : slices) {
    none = none || is_empty(s);
    differ = differ || s.size != target;
    least = std::min(least, s.size);
  }
  if (none) {
    if (!quiet) error = "arbor::lumen::VM::name: invalid argument: slice(s) is/are empty";
    return 0;
  }
  if (policy == enums::slice_cyclic) return target;
  if (policy == enums::slice_minimum || !differ) return least;
  if (!quiet)
    error = "arbor::lumen::VM::name: invalid argument: different slice sizes in slice_normal mode";
  return 0;
}

/// Carries a call out on its own contents. Without `reports`, status and handler have no effect.
template <typename Shape>
outcome carry_out(random_call& call, bool reports) {
  outcome result;
  const std::int64_t count =
      call.sliced ? computations(call, result.error) : std::max<std::int64_t>(call.n, 0);
  const bool cyclic = call.sliced && (call.mode & 0x7000) == enums::slice_cyclic;
  const auto& handler = call.handler;
  // Positions within the inputs, counted like the digits of a number where the call is cyclic.
  std::array<std::int64_t, Shape::inputs> position{};
  for (std::int64_t i = 0; i < count; ++i) {
    std::array<const float*, Shape::inputs> a{};
    for (std::size_t k = 0; k < Shape::inputs; ++k) {
      const slice& s = call.in[k].where;
      a[k] = &call.contents[static_cast<std::size_t>(call.in[k].zone)].at(
          static_cast<std::size_t>(s.start + position[k] * s.stride));
    }
    std::array<float*, Shape::outputs> y{};
    for (std::size_t j = 0; j < Shape::outputs; ++j) {
      const slice& s = call.out[j].where;
      y[j] = &call.contents[static_cast<std::size_t>(call.out[j].zone)].at(
          static_cast<std::size_t>(s.start + i * s.stride));
    }
    const float first = *a[0];
    std::uint32_t status;
    using functor = tag<Shape, float>;
    if constexpr (Shape::constants == 1)
      status = functor::call(a[0], call.constants[0], y[0]);
    else if constexpr (Shape::inputs == 2)
      status = functor::call(a[0], a[1], y[0]);
    else if constexpr (Shape::outputs == 2)
      status = functor::call(a[0], y[0], y[1]);
    else
      status = functor::call(a[0], y[0]);

    if (reports && status != 0) {
      if ((call.mode & enums::global_status_report) != 0) result.queue_status |= status;
      if (handler.enabled) {
        const slice& s = call.out[0].where;
        if (handler.length == 1)
          call.status[0] |= static_cast<enums::status>(status);
        else if (handler.length > 1)
          call.status.at(static_cast<std::size_t>(s.start + i * s.stride)) =
              static_cast<enums::status>(status);
        if ((handler.status_to_fix & status) != 0) {
          *y[0] =
              handler.copy_sign ? std::copysign(handler.fixup_value, first) : handler.fixup_value;
          if constexpr (Shape::outputs == 2) {
            const double value = handler.fixup_value;
            *y[1] = static_cast<float>(std::sqrt(1 - value * value));
          }
        }
      }
    }

    for (std::size_t k = Shape::inputs; k-- > 0;) {
      ++position[k];
      if (!cyclic) continue;
      if (position[k] < call.in[k].where.size) break;
      position[k] = 0;
    }
  }
  return result;
}

inline std::string describe(const random_call& call) {
  std::ostringstream text;
  text << "mode " << std::hex << call.mode << std::dec << " n " << call.n;
  for (const auto* operands : {&call.in, &call.out}) {
    text << (operands == &call.in ? " in" : " out");
    for (const operand& each : *operands)
      text << " zone " << each.zone << ' '
           << name_of(call.kinds[static_cast<std::size_t>(each.zone)]) << " {" << each.where.start
           << ", " << each.where.size << ", " << each.where.stride << '}';
  }
  const auto& handler = call.handler;
  text << " handler " << handler.enabled << " length " << handler.length << " in "
       << name_of(call.status_kind) << " fixes " << handler.status_to_fix << " to "
       << handler.fixup_value << (handler.copy_sign ? " with sign" : "");
  return text.str();
}

/// Equal patterns; any two NaNs are equal.
inline bool same(const std::vector<float>& a, const std::vector<float>& b) {
  for (std::size_t i = 0; i < a.size(); ++i)
    if (std::bit_cast<std::uint32_t>(a[i]) != std::bit_cast<std::uint32_t>(b[i]) &&
        !(std::isnan(a[i]) && std::isnan(b[i])))
      return false;
  return true;
}

/// How many random calls a test makes: fewer under a sanitizer.
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
inline constexpr int calls_divisor = 10;
#else
inline constexpr int calls_divisor = 1;
#endif

}  // namespace arbor::lumen::tests
