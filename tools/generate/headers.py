# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""The public header of each function: documentation and declarations."""

from __future__ import annotations

import textwrap

from catalogue import ELEMENT_NAMES, Function
from output import Output
from signatures import FORMS, Form, arguments, wrap_call

TIER_BOUNDS = (
    "`ha` at most 1 ulp, `la` at most 4 ulp, `ep` at least 11 correct bits at float and 26 at"
    " double; half as its float body, rounded once"
)


def _accuracy(function: Function) -> str:
    return function.accuracy.replace("tiers", TIER_BOUNDS, 1)


def _paragraph(text: str, indent: str = "/// ", hanging: str = "/// ") -> str:
    lines = textwrap.wrap(
        text, 100, initial_indent=indent, subsequent_indent=hanging, break_long_words=False
    )
    return "\n".join(lines) + "\n"


def documentation(function: Function) -> str:
    """The contract of a function as a comment block."""
    text = _paragraph(f"@file {function.brief}") + "///\n"
    facts = [
        ("Result", f"`{function.formula}`"),
        ("Domain", function.domain),
        ("Range", function.range),
        ("Units", function.units),
        ("Element types", ", ".join(ELEMENT_NAMES[letter] for letter in function.types)),
        ("Error bound", _accuracy(function)),
        ("Definition", function.source),
    ]
    for title, fact in facts:
        if fact:
            text += _paragraph(f"- {title}: {fact}", hanging="///   ")
    if function.special:
        text += "///\n/// Special values and status:\n"
        for line in function.special:
            text += _paragraph(f"- {line}", hanging="///   ")
    text += "///\n"
    text += _paragraph(
        "Each overload returns the event of the work that it submitted; where host memory had to be"
        " copied, or the host does the work, the call blocks until the results are there."
        " `invalid_argument` is thrown for a negative count, for arrays shorter than the count and"
        " for slices that do not fit together (under `badarg_quiet` the call instead does nothing"
        " and raises `bad_argument` on the queue), `unimplemented` under `mode_missing_throws`"
        " where the device cannot serve the call. Exceptions of the SYCL runtime pass through."
    )
    if function.utility:
        text += _paragraph("A helper of the library's own: one implementation serves all accuracies.")
    elif function.handler:
        text += _paragraph(
            "`handler` says where the status of elements is reported and which results are replaced."
        )
    else:
        text += _paragraph("No status is reported, so there is no handler.")
    return text


def _declaration(function: Function, letter: str, form: Form) -> str:
    lead = f"ARBORLUMEN_EXPORT sycl::event {function.name}("
    items = arguments(function, letter, form, defaults=True)
    return f"/// {form.brief}\n{wrap_call(lead, items, ');')}\n"


def header(function: Function) -> str:
    text = documentation(function)
    text += """\
#pragma once

#include <complex>
#include <cstdint>
#include <span>
#include <sycl/sycl.hpp>
#include <vector>

#include "arbor/lumen/export.hpp"
#include "arbor/lumen/slice.hpp"
#include "arbor/lumen/vm/enums.hpp"
#include "arbor/lumen/vm/error_handler.hpp"

"""
    text += f"namespace {function.namespace} {{\n"
    for letter in function.types:
        text += f"\n/// @name {function.name} of {ELEMENT_NAMES[letter]}\n/// @{{\n\n"
        text += "\n".join(_declaration(function, letter, form) for form in FORMS)
        text += "/// @}\n"
    return text + f"\n}}  // namespace {function.namespace}\n"


def _umbrella(brief: str, headers: list[str]) -> str:
    includes = "".join(f'#include "{header}"\n' for header in headers)
    return f"/// @file\n/// {brief}\n#pragma once\n\n{includes}"


def generate(functions: list[Function], output: Output) -> None:
    for function in functions:
        output.cpp(f"include/{function.public_header}", header(function))
    public = [function.public_header for function in functions if not function.utility]
    output.cpp("include/arbor/lumen/vm/functions.hpp", _umbrella("All functions.", public))
    utilities = [function.public_header for function in functions if function.utility]
    output.cpp("include/arbor/lumen/vm/utilities.hpp", _umbrella("All utilities.", utilities))
