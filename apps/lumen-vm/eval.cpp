// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <cstdio>
#include <string>
#include <utility>
#include <vector>

#include "block.hpp"
#include "choice.hpp"
#include "commands.hpp"
#include "dispatch/key.hpp"
#include "dispatch/select_key.hpp"
#include "numbers.hpp"
#include "progress.hpp"
#include "row_reader.hpp"
#include "unserved.hpp"
#include "words.hpp"

namespace arbor::lumen::vm::tool {
namespace {

/// Rows per call: enough to keep a device busy, few enough to hold in memory.
constexpr std::size_t block_rows = 65536;

std::string counted(std::size_t count, const std::string& noun) {
  return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

/// The names of the columns of `arrays` operands: `only` if there is one, else those of `several`.
std::vector<std::string> operand_names(std::size_t arrays, const char* only,
                                       std::vector<std::string> several) {
  if (arrays == 1) return {only};
  several.resize(arrays);
  return several;
}

/// The evaluation of rows with inputs of `T` and outputs of `U`.
template <typename T, typename U>
class evaluation {
 public:
  evaluation(const chosen_call& call, const std::vector<std::string>& constants)
      : call_(call), queue_(call.device.device) {
    with_shape(call.family.shape, [&]<typename Shape>() {
      operands_.inputs.resize(Shape::inputs);
      operands_.outputs.resize(Shape::outputs);
      take_constants(constants, Shape::constants);
    });
  }

  int run(const std::vector<std::string>& files) {
    const std::uint64_t key = detail::select_key(detail::precision_of_pair<T, U>, call_.device_word,
                                                 call_.mode, call_.family.table());
    if (key == 0) {
      std::fprintf(stderr, "lumen-vm: %s\n", end_of_unserved(call_, queue_).c_str());
      return 1;
    }
    reports_status_ = call_.family.handler && (key & detail::key::device_field) == detail::key::gpu;
    print_head(key);
    row_reader reader(files);
    while (reader.next()) {
      progress_.count_row();
      take_row(reader);
      if (operands_.size() == block_rows) flush();
    }
    flush();
    return reader.failed() ? 1 : 0;
  }

 private:
  using in_element = element<T>;
  using in_real = typename in_element::real;
  using out_element = element<U>;
  using out_real = typename out_element::real;

  void take_constants(const std::vector<std::string>& constants, std::size_t wanted) {
    if (constants.size() != wanted)
      throw usage_error(std::string(call_.family.name) + " takes " + counted(wanted, "constant") +
                        ", and " + std::to_string(constants.size()) +
                        (constants.size() == 1 ? " was" : " were") + " given with --constant");
    for (const std::string& text : constants) operands_.constants.push_back(parse_constant(text));
  }

  /// A complex constant is written as its parts with a comma between them.
  static T parse_constant(const std::string& text) {
    try {
      in_real parts[in_element::parts];
      if constexpr (in_element::parts == 1) {
        parts[0] = parse_real<in_real>(text);
      } else {
        const std::size_t comma = text.find(',');
        if (comma == std::string::npos)
          throw bad_number("\"" + text + "\" is no pair of real and imaginary part, such as 1,0");
        parts[0] = parse_real<in_real>(text.substr(0, comma));
        parts[1] = parse_real<in_real>(text.substr(comma + 1));
      }
      return in_element::from(parts);
    } catch (const bad_number& error) {
      throw usage_error(std::string("--constant: ") + error.what());
    }
  }

  void take_row(row_reader& reader) {
    const std::size_t wanted = operands_.inputs.size() * in_element::parts;
    const auto& columns = reader.columns();
    try {
      if (columns.size() != wanted)
        throw bad_number(counted(wanted, "column") + " expected, " +
                         std::to_string(columns.size()) + " found");
      row_.clear();
      for (const std::string& column : columns) row_.push_back(parse_real<in_real>(column));
    } catch (const bad_number& error) {
      progress_.clear();
      reader.complain(error.what());
      return;
    }
    const in_real* value = row_.data();
    for (auto& input : operands_.inputs) {
      input.push_back(in_element::from(value));
      value += in_element::parts;
    }
  }

  void flush() {
    if (operands_.size() == 0) return;
    evaluate(call_, queue_, operands_);
    text_.clear();
    for (std::size_t i = 0; i < operands_.size(); ++i) print_row(i);
    progress_.clear();
    std::fwrite(text_.data(), 1, text_.size(), stdout);
    for (auto& input : operands_.inputs) input.clear();
  }

  void print_row(std::size_t i) {
    for (const auto& input : operands_.inputs) {
      for (std::size_t part = 0; part < in_element::parts; ++part)
        put(to_text(in_element::part(input[i], part)), text_width<in_real>);
    }
    for (const auto& output : operands_.outputs) {
      for (std::size_t part = 0; part < out_element::parts; ++part) {
        const out_real value = out_element::part(output[i], part);
        put(to_text(value), text_width<out_real>);
        put(to_bits(value), bits_width<out_real>);
      }
    }
    text_ += reports_status_ ? "  " + status_words(operands_.statuses[i]) + "\n" : "  -\n";
  }

  void print_head(std::uint64_t key) {
    text_ = std::string("# ") + call_.family.name + " of " + element_name(call_.in) +
            ", accuracy " + accuracy_words(key) + ", on device " +
            std::to_string(call_.device.number) + ": " +
            call_.family.table().find(key)->implementation + "\n";
    if (!reports_status_)
      text_ += call_.family.handler ? "# no status: the host reports none\n"
                                    : "# no status: the function has no error handler\n";
    const std::size_t line = text_.size();
    for (const auto& name : operand_names(operands_.inputs.size(), "a", {"a", "b"})) {
      for (std::size_t part = 0; part < in_element::parts; ++part)
        put(part_name<in_element>(name, part), text_width<in_real>);
    }
    for (const auto& name : operand_names(operands_.outputs.size(), "y", {"y1", "y2"})) {
      for (std::size_t part = 0; part < out_element::parts; ++part) {
        put(part_name<out_element>(name, part), text_width<out_real>);
        put("bits", bits_width<out_real>);
      }
    }
    text_ += "  status\n";
    text_[line] = '#';
    std::fwrite(text_.data(), 1, text_.size(), stdout);
  }

  template <typename Element>
  static std::string part_name(const std::string& name, std::size_t part) {
    if (Element::parts == 1) return name;
    return (part == 0 ? "re " : "im ") + name;
  }

  /// Appends a column, right-aligned, with its gap.
  void put(const std::string& column, int width) {
    const auto columns = static_cast<std::size_t>(width);
    text_ += "  ";
    if (column.size() < columns) text_.append(columns - column.size(), ' ');
    text_ += column;
  }

  const chosen_call& call_;
  sycl::queue queue_;
  block<T, U> operands_;
  std::vector<in_real> row_;
  std::string text_;
  bool reports_status_ = false;
  progress progress_;
};

}  // namespace

int eval(const eval_request& request) {
  const chosen_call call = choose(request.call);
  return with_types(call.in, call.out, [&]<typename T, typename U>() {
    return evaluation<T, U>(call, request.constants).run(request.files);
  });
}

}  // namespace arbor::lumen::vm::tool
