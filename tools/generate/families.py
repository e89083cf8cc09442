# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""The family of each function: its implementation table and its dispatcher."""

from __future__ import annotations

from catalogue import ELEMENT_TYPES, Function, HostRow
from kernels import Kernel, has_rows, kernels_of
from output import Output

# Accuracies as the array-math layer numbers them.
ARRAY_MATH_MODES = {"la": 1, "ha": 2, "ep": 3}


def _classic_row(row: HostRow, kernel: Kernel) -> str:
    function = kernel.function
    results = "two_results" if function.shape == "v12" else "one_result"
    arguments = ", ".join(
        (
            f"shape::{function.shape}",
            ELEMENT_TYPES[kernel.input_letter],
            ELEMENT_TYPES[kernel.output_letter],
            kernel.entries,
            str(ARRAY_MATH_MODES[row.tier]),
            f"cpu::norvane::error_kind::{results if function.handler else 'none'}",
        )
    )
    launcher = f"&cpu::norvane::classic_launcher<{arguments}>"
    return f'      {{0x{row.key:x}, {launcher}, "{kernel.wrapper}"}},'


def _rows(function: Function) -> list[str]:
    rows = []
    compiled = function.compiled_functors()
    for functor in function.functors:
        if functor.body:
            # Bodies know halves as patterns; kernels, as the arrays hold them.
            elements = ", sycl::half, sycl::half" if functor.type == "h" else ""
            arguments = f"shape::{function.shape}, scalar::{compiled[functor.name]}{elements}"
            launcher = f"&gpu::norvane::launcher<{arguments}>"
            rows.extend(f'      {{0x{key:x}, {launcher}, "{functor.name}"}},'
                        for key in functor.keys)
    if function.utility:
        for row in function.host_rows:
            functor = function.host_functor(row)
            loop = f"shape::{function.shape}, scalar::{compiled[functor.name]}"
            executor = f"&cpu::norvane::loop_launcher<{loop}>"
            rows.append(f'      {{0x{row.key:x}, {executor}, "host loop over {functor.name}"}},')
    else:
        kernels = {kernel.letter: kernel for kernel in kernels_of(function)}
        rows.extend(_classic_row(row, kernels[row.type]) for row in function.host_rows
                    if row.type in kernels)
    return rows


def _family(function: Function) -> str:
    table = "".join(row + "\n" for row in _rows(function))
    initializer = f"{{\n{table}  }}" if table else "{}"
    return (
        f"const implementation_table& {function.name}_table() {{\n"
        f"  static const implementation_table table{initializer};\n  return table;\n}}\n\n"
        f"sycl::event {function.name}_dispatch(const input::vxx& record) {{\n"
        f"  return dispatch_call(record, {function.name}_table());\n}}\n"
    )


def _unit(functions: list[Function]) -> str:
    text = '#include "dispatch/families.hpp"\n\n#include "dispatch/dispatch_call.hpp"\n'
    if any(function.has_bodies for function in functions):
        text += '#include "device/launch.hpp"\n'
    if any(function.utility and function.has_bodies for function in functions):
        text += '#include "host/loop.hpp"\n'
    if any(kernels_of(function) for function in functions):
        text += '#include "host/classic_row.hpp"\n'
    for function in functions:
        if function.has_bodies:
            text += f'#include "scalar/generated/{function.name}.hpp"\n'
    text += "\nnamespace arbor::lumen::vm::detail {\n\n"
    if any(function.has_bodies for function in functions):
        text += "namespace scalar = gpu::norvane::scalar;\n\n"
    text += "\n".join(_family(function) for function in functions)
    return text + "\n}  // namespace arbor::lumen::vm::detail\n"


def _header(functions: list[Function]) -> str:
    text = '#pragma once\n\n#include "dispatch/family.hpp"\n\nnamespace arbor::lumen::vm::detail {\n\n'
    for function in functions:
        text += f"const implementation_table& {function.name}_table();\n"
        text += f"sycl::event {function.name}_dispatch(const input::vxx& record);\n"
    return text + "\n}  // namespace arbor::lumen::vm::detail\n"


def _list(name: str, functions: list[Function]) -> str:
    text = f"namespace {{\nconstexpr family all_{name}[] = {{\n"
    for function in functions:
        handler = "true" if function.handler else "false"
        full = sum(len(functor.keys) for functor in function.functors) + len(function.host_rows)
        outputs = "".join(function.output_letter(letter) for letter in function.types)
        text += f'    {{"{function.name}", shape::{function.shape}::name, "{function.types}",'
        text += f' "{outputs}",'
        text += f" {handler}, {full}, &{function.name}_table, &{function.name}_dispatch}},\n"
    text += "};\n}  // namespace\n\n"
    return text + f"std::span<const family> {name}() {{ return all_{name}; }}\n\n"


def generate(functions: list[Function], output: Output) -> None:
    public = [function for function in functions if not function.utility]
    utilities = [function for function in functions if function.utility]
    output.cpp("src/dispatch/families.hpp", _header(functions))
    text = '#include "dispatch/families.hpp"\n\nnamespace arbor::lumen::vm::detail {\n\n'
    text += _list("families", public) + _list("utility_families", utilities)
    text += "}  // namespace arbor::lumen::vm::detail\n"
    output.cpp("src/dispatch/families/list.cpp", text)
    for function in functions:
        if has_rows(function):
            output.cpp(f"src/dispatch/families/{function.name}.cpp", _unit([function]))
    pending = [function for function in functions if not has_rows(function)]
    if pending:
        output.cpp("src/dispatch/families/without_rows.cpp", _unit(pending))
