// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include <CLI/CLI.hpp>
#include <cstdio>
#include <exception>
#include <string>

#include "choice.hpp"
#include "commands.hpp"

namespace {

namespace tool = arbor::lumen::vm::tool;

enum exit_code { ok = 0, failed = 1, wrong_usage = 2 };

void add_call_options(CLI::App& command, tool::call_request& call) {
  command.add_option("FUNCTION", call.function, "name of the function")->required();
  command.add_option("-t,--type", call.type, "element type of the input: h, s, d, c or z")
      ->required()
      ->type_name("LETTER");
  command
      .add_option("-m,--mode", call.mode,
                  "mode of the call, merged into the default mode: ha, la, ep or a word such as "
                  "0x100004")
      ->type_name("MODE");
  command
      .add_option("-d,--device", call.device,
                  "cpu or gpu for the first of its class, or a number from \"lumen-vm devices\"")
      ->type_name("DEVICE");
}

CLI::App* add_explain(CLI::App& app, tool::call_request& call) {
  CLI::App* command = app.add_subcommand("explain", "Show how a call finds what serves it");
  add_call_options(*command, call);
  command->add_flag("--cyclic", call.cyclic, "slices are cyclic");
  command->footer(
      "Lists the keys in the order in which they are looked for, and the one that is found.\n\n"
      "Example: lumen-vm explain add --type s --mode la --device cpu");
  return command;
}

CLI::App* add_eval(CLI::App& app, tool::eval_request& request) {
  CLI::App* command = app.add_subcommand("eval", "Evaluate a function for rows of numbers");
  add_call_options(*command, request.call);
  command
      ->add_option("-c,--constant", request.constants,
                   "a constant of the function, in the order of its parameters; a complex one as "
                   "RE,IM")
      ->type_name("NUMBER")
      ->allow_extra_args(false);
  command->add_option("FILE", request.files, "files of rows; \"-\" and no file are standard input");
  command->footer(
      "A row is a line with one column per input, two at complex types, and blanks between the\n"
      "columns. Numbers are decimal or hexadecimal floats, inf or nan. Empty lines and what\n"
      "follows a \"#\" are passed over. A row that cannot be evaluated is named on standard "
      "error;\n"
      "the others are evaluated, and the exit code is 1.\n\n"
      "Example: echo \"1.5 -0x1p-3\" | lumen-vm eval add --type d");
  return command;
}

int run(int argc, char** argv) {
  CLI::App app("Looks into the vector mathematics library, and evaluates its functions.");
  app.name("lumen-vm");
  app.set_version_flag("--version", "lumen-vm " LUMEN_VM_VERSION);
  app.failure_message([](const CLI::App*, const CLI::Error& error) {
    return std::string("lumen-vm: ") + error.what() + "\n\"lumen-vm --help\" shows the usage.\n";
  });
  app.footer(
      "Exit codes: 0; 1 for a failed evaluation; 2 for wrong usage.\n\n"
      "Example: lumen-vm explain add --type s");

  CLI::App* devices = app.add_subcommand("devices", "List the devices with their device words");
  devices->footer("Example: lumen-vm devices");
  CLI::App* functions = app.add_subcommand("functions", "List the functions of the catalogue");
  functions->footer(
      "\"c>s\" is an element type whose output has another type than its input. \"rows\" are the\n"
      "implementations that exist, of those that the catalogue states.\n\n"
      "Example: lumen-vm functions");
  tool::call_request explained;
  CLI::App* explain = add_explain(app, explained);
  tool::eval_request evaluated;
  CLI::App* eval = add_eval(app, evaluated);

  try {
    app.parse(argc, argv);
  } catch (const CLI::ParseError& error) {
    return app.exit(error) == 0 ? ok : wrong_usage;
  }
  if (devices->parsed()) return tool::devices();
  if (functions->parsed()) return tool::functions();
  if (explain->parsed()) return tool::explain(explained);
  if (eval->parsed()) return tool::eval(evaluated);
  throw tool::usage_error("a command is required: devices, functions, explain or eval");
}

}  // namespace

int main(int argc, char** argv) {
  try {
    const int code = run(argc, argv);
    if (std::fflush(stdout) == 0 && std::ferror(stdout) == 0) return code;
    std::perror("lumen-vm: standard output");
    return failed;
  } catch (const tool::usage_error& error) {
    std::fprintf(stderr, "lumen-vm: %s\n", error.what());
    return wrong_usage;
  } catch (const std::exception& error) {
    std::fflush(stdout);
    std::fprintf(stderr, "lumen-vm: %s\n", error.what());
    return failed;
  }
}
