// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>
#include <vector>

/// The commands of the tool. Each prints its answer on standard output and returns the exit code.
namespace arbor::lumen::vm::tool {

/// Which call a command is about, as given on the command line.
struct call_request {
  std::string function;
  std::string type;     ///< letter of the input elements
  std::string mode;     ///< ha, la, ep, 0x… or empty
  std::string device;   ///< cpu, gpu, a number or empty
  bool cyclic = false;  ///< slices are cyclic
};

struct eval_request {
  call_request call;
  std::vector<std::string> constants;
  std::vector<std::string> files;  ///< none means standard input
};

/// Every device with its number, its device word and its name.
int devices();

/// The catalogue.
int functions();

/// How dispatch finds the row that serves a call.
/// @throws usage_error
int explain(const call_request& request);

/// Evaluates a function for the rows of files or of standard input.
/// @throws usage_error
int eval(const eval_request& request);

}  // namespace arbor::lumen::vm::tool
