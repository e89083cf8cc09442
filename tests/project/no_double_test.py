# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""The functors for devices without double hold no double operation: compiles each of them, rare
paths included, and looks for one in the assembly.

    no_double_test.py LIST COMPILER FLAG…

LIST is the header with the list of functors.
"""

from __future__ import annotations

import re
import subprocess
import sys
from pathlib import Path

# Arithmetic, comparison and conversion of doubles, scalar or packed, with and without VEX. Moves of
# 64 bits are no operation on a double.
DOUBLE = re.compile(
    r"^\s+v?(?:(?:add|sub|mul|div|sqrt|min|max|round|(?:u?com|cmp)\w*|fn?m(?:add|sub)\d*)[sp]d"
    r"|cvt\w*[sp]d\w*)\s",
    re.MULTILINE,
)


_LABEL = re.compile(r"^(_Z\w+):$", re.MULTILINE)

_PARAMETERS = {
    "v11": ("const E* a, E* y", "a, y"),
    "v12": ("const E* a, E* y, E* z", "a, y, z"),
    "v21": ("const E* a, const E* b, E* y", "a, b, y"),
    "v21c": ("const E* a, E b, E* y", "a, b, y"),
}


def functors(list_header: Path) -> list[tuple[str, str]]:
    """Shape and name of the functors labelled nofp64."""
    rows = re.findall(r"M\(\w+, (\w+), \w, \w+, (\w+), (\w+)\)", list_header.read_text())
    return [(shape, name) for shape, label, name in rows if label == "nofp64"]


def source(probed: list[tuple[str, str]]) -> str:
    text = '#include "scalar/functors.hpp"\n'
    text += "namespace scalar = arbor::lumen::vm::detail::gpu::norvane::scalar;\n"
    for shape, name in probed:
        parameters, arguments = _PARAMETERS[shape]
        text += f"namespace probe_{name} {{ using E = scalar::{name}::input_type;\n"
        text += f"unsigned probe({parameters}) {{ return scalar::{name}::call({arguments}); }} }}\n"
    return text


def functions_with_double(probed: list[tuple[str, str]], compiler: list[str]) -> list[str]:
    """The functions, mangled, in which a double operation stands."""
    command = [*compiler, "-O1", "-S", "-x", "c++", "-", "-o", "-"]
    assembly = subprocess.run(
        command, input=source(probed), text=True, stdout=subprocess.PIPE, check=True
    ).stdout
    parts = _LABEL.split(assembly)[1:]
    return [name for name, body in zip(parts[::2], parts[1::2]) if DOUBLE.search(body)]


def main() -> int:
    list_header, compiler = Path(sys.argv[1]), sys.argv[2:]
    if not functions_with_double([("v11", "exp_d_la_gen")], compiler):
        print("no double operation is found in exp_d_la_gen: the search is blind")
        return 1
    probed = functors(list_header)
    found = functions_with_double(probed, compiler)
    print(f"{len(probed)} functors", *found, sep="\n")
    return 1 if found or not probed else 0


if __name__ == "__main__":
    sys.exit(main())
