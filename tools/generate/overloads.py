# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""The exported overloads: each builds its argument record and calls the family's dispatcher."""

from __future__ import annotations

from catalogue import ELEMENT_TYPES, Function
from output import Output
from signatures import FORMS, Form, arguments, wrap_call


def _definition(function: Function, letter: str, form: Form) -> str:
    element = ELEMENT_TYPES[letter]
    out_element = ELEMENT_TYPES[function.output_letter(letter)]
    record = f"input::{form.record}<shape::{function.shape}, {element}, {out_element}>"
    count = "n" if form.counted else "0"
    handler = ", handler" if function.handler else ""
    steps = []
    if form.memory == "pointer":
        steps.append("after(depends)")  # the span forms take the argument and do not wait for it
    for parameter in function.parameters:
        verb = {"in": "in", "constant": "constant", "out": "out"}[parameter.kind]
        with_slice = form.strided and parameter.kind != "constant"
        operands = f"{parameter.name}, slice_{parameter.name}" if with_slice else parameter.name
        steps.append(f"{verb}({operands})")
    chain = "".join(f"\n      .{step}" for step in steps)
    parameters = arguments(function, letter, form, defaults=False)
    if form.memory == "span":
        parameters = [text.removesuffix(" depends") for text in parameters]
    return (
        wrap_call(f"sycl::event {function.name}(", parameters, ") {") + "\n"
        f'  return call<{record}>("{function.name}", queue, {count}, mode{handler}){chain}\n'
        f"      .run(arbor::lumen::vm::detail::{function.name}_dispatch);\n}}\n"
    )


def generate(functions: list[Function], output: Output) -> None:
    for family in sorted({function.family for function in functions}):
        members = [function for function in functions if function.family == family]
        namespace = members[0].namespace
        header = "utilities.hpp" if members[0].utility else "functions.hpp"
        text = f'#include "arbor/lumen/vm/{header}"\n#include "dispatch/families.hpp"\n'
        text += f'#include "frontend/call.hpp"\n\nnamespace {namespace} {{\n\n'
        if not members[0].utility:
            text += "namespace input = detail::input;\nnamespace shape = detail::shape;\n"
            text += "using detail::call;\n\n"
        for function in members:
            for letter in function.types:
                text += "".join(_definition(function, letter, form) + "\n" for form in FORMS)
        output.cpp(f"src/frontend/overloads/{family}.cpp", text + f"}}  // namespace {namespace}\n")
