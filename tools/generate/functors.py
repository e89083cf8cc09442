# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""One type per functor of the device catalogue, also where bodies coincide."""

from __future__ import annotations

from catalogue import Function
from output import Output

NAMESPACE = "arbor::lumen::vm::detail::gpu::norvane::scalar"


def _functor_header(function: Function) -> str:
    existing = [functor for functor in function.functors if functor.body]
    headers = {function.header_of(functor) for functor in existing}
    if any("half_v" in functor.body for functor in existing):
        headers.add("scalar/half.hpp")
    text = "#pragma once\n\n" + "".join(f'#include "{header}"\n' for header in sorted(headers))
    text += f"\nnamespace {NAMESPACE} {{\n\n"
    for functor in existing:
        needs = "true" if functor.needs_fp64 else "false"
        text += f"struct {functor.name} : {functor.body} {{\n"
        text += f'  static constexpr const char* name = "{functor.name}";\n'
        text += f"  static constexpr bool needs_fp64 = {needs};\n}};\n"
    return text + f"\n}}  // namespace {NAMESPACE}\n"


def _list_header(functions: list[Function]) -> str:
    """Every functor with its coordinates, for tests, measurements and benchmarks."""
    rows = [
        f"  M({function.name}, {function.shape}, {functor.type}, {functor.tier},"
        f" {functor.label}, {functor.name})"
        for function in functions
        for functor in function.functors
        if functor.body and not function.utility
    ]
    text = "#pragma once\n\n"
    text += "/// M(function, shape, type letter, tier, label, functor) for every functor.\n"
    return text + "#define LUMEN_FUNCTORS(M) \\\n" + " \\\n".join(rows) + "\n"


def generate(functions: list[Function], output: Output) -> None:
    present = [function for function in functions if function.has_bodies]
    for function in present:
        output.cpp(f"src/scalar/generated/{function.name}.hpp", _functor_header(function))
    umbrella = "#pragma once\n\n" + "".join(
        f'#include "scalar/generated/{function.name}.hpp"\n' for function in present
    )
    output.cpp("src/scalar/generated/all.hpp", umbrella)
    output.cpp("src/scalar/generated/list.hpp", _list_header(functions))
