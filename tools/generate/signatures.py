# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""The six overload forms of a public function."""

from __future__ import annotations

from dataclasses import dataclass

from catalogue import ELEMENT_TYPES, Function, Parameter


@dataclass(frozen=True)
class Form:
    """One way to pass arrays."""

    key: str
    record: str  # the argument record's class
    strided: bool
    memory: str  # "pointer", "buffer" or "span"
    brief: str

    @property
    def counted(self) -> bool:
        """Whether the count is an argument of its own."""
        return not self.strided and self.memory != "span"


FORMS = (
    Form("pointer", "usm::linear", False, "pointer", "Pointers to `n` elements."),
    Form("pointer_slice", "usm::strided", True, "pointer", "Slices of arrays at pointers."),
    Form("buffer", "buffer::linear", False, "buffer", "The first `n` elements of buffers, all of the shortest if `n` is 0."),
    Form("buffer_slice", "buffer::strided", True, "buffer", "Slices of buffers."),
    Form("span", "usm::linear", False, "span", "Spans; the shortest gives the count."),
    Form("span_slice", "usm::strided", True, "span", "Slices of spans."),
)


def wrap_call(lead: str, items: list[str], tail: str, indent: str = "    ") -> str:
    """`lead` + items + `tail` in lines of at most 100 columns, broken between items only."""
    lines, line = [], lead
    for number, item in enumerate(items):
        piece = item + (tail if number == len(items) - 1 else ",")
        glue = "" if line in (lead, indent) else " "
        if len(line) + len(glue) + len(piece) > 100 and line != indent:
            lines.append(line)
            line, glue = indent, ""
        line += glue + piece
    return "\n".join([*lines, line])


def _operand(form: Form, parameter: Parameter, element: str) -> str:
    if parameter.kind == "constant":
        return f"{element} {parameter.name}"
    const = "const " if parameter.kind == "in" else ""
    array = {
        "pointer": f"{const}{element}* {parameter.name}",
        "buffer": f"sycl::buffer<{element}, 1>& {parameter.name}",
        "span": f"std::span<{const}{element}> {parameter.name}",
    }[form.memory]
    return f"{array}, slice slice_{parameter.name}" if form.strided else array


def arguments(function: Function, letter: str, form: Form, defaults: bool) -> list[str]:
    """The parameter list of one overload, for its declaration or its definition."""
    out_element = ELEMENT_TYPES[function.output_letter(letter)]
    result = ["sycl::queue& queue"]
    if form.counted:
        result.append("std::int64_t n")
    for parameter in function.parameters:
        element = out_element if parameter.kind == "out" else ELEMENT_TYPES[letter]
        result.append(_operand(form, parameter, element))
    tail = []
    if form.memory != "buffer":
        tail.append(("const std::vector<sycl::event>& depends", "{}"))
    tail.append(("enums::mode mode", "enums::not_defined"))
    if function.handler:
        tail.append((f"const error_handler<{out_element}>& handler", "{}"))
    return result + [f"{text} = {default}" if defaults else text for text, default in tail]
