# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""What the registry states, as lists for the tests: every row of the family tables, also those
without an implementation yet, every function and every set of overloads."""

from __future__ import annotations

from catalogue import ELEMENT_TYPES, Function
from output import Output


def _rows(function: Function) -> list[str]:
    kernels = [
        f"  M({function.name}, {functor.type}, {functor.label}, {str(functor.cast).lower()},"
        f" {functor.tier})"
        for functor in function.functors
    ]
    host = [f"  M({function.name}, {row.type}, classic, false, {row.tier})"
            for row in function.host_rows]
    return kernels + host


def _overloads(function: Function) -> list[str]:
    handler = str(function.handler).lower()
    return [
        f"  M({function.name}, {function.shape}, {letter}, {ELEMENT_TYPES[letter]},"
        f" {ELEMENT_TYPES[function.output_letter(letter)]}, {handler})"
        for letter in function.types
    ]


def _macro(name: str, comment: str, lines: list[str]) -> str:
    return f"/// {comment}\n#define {name}(M) \\\n" + " \\\n".join(lines) + "\n"


def generate(functions: list[Function], output: Output) -> None:
    public = [function for function in functions if not function.utility]
    rows = [line for function in public for line in _rows(function)]
    overloads = [line for function in public for line in _overloads(function)]
    text = "#pragma once\n\n"
    text += _macro("LUMEN_ROWS", "M(function, type letter, feature, cast to float, tier)", rows)
    text += "\n"
    functions_and_shapes = [f"  M({function.name}, {function.shape})" for function in public]
    text += _macro("LUMEN_FUNCTIONS", "M(function, shape)", functions_and_shapes)
    text += "\n"
    text += _macro("LUMEN_OVERLOADS", "M(function, shape, letter, input, output, handler)",
                   overloads)
    output.cpp("tests/catalogue_lists.hpp", text)
