# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""packed.py OBJECT…: whether the loop of every body is vectorised, by its machine code.

Counts packed and scalar fused multiply-adds in the functions that run the loops, in all objects
together. A loop with scalar ones only has silently become scalar: prints it and ends with 1. The code
of rare paths stands in functions of its own and does not count.
"""

from __future__ import annotations

import re
import subprocess
import sys
from collections import defaultdict

LOOP = re.compile(
    r"^[0-9a-f]+ <.*?block_loop<(.*?), (?:float|double|std::complex<(?:float|double)>), .*>::"
    r"(?:run|run_strided|whole_blocks|copied_block)\b",
    re.MULTILINE,
)
PACKED = re.compile(r"\bvfn?m(?:add|sub)\d+p[sd]\b.*%[yz]mm")
SCALAR = re.compile(r"\bvfn?m(?:add|sub)\d+s[sd]\b")


def loops(text: str) -> dict[str, str]:
    """The code of each body's loops by the body's name."""
    found: dict[str, str] = defaultdict(str)
    for function in text.split("\n\n"):
        match = LOOP.search(function)
        if match:
            name = re.sub(r"arbor::lumen::vm::detail::gpu::norvane::scalar::", "", match[1])
            found[name] += function
    return found


def main() -> int:
    found: dict[str, str] = {}
    for path in sys.argv[1:]:
        text = subprocess.run(
            ["objdump", "--disassemble", "--demangle", "--no-show-raw-insn", path],
            capture_output=True, text=True, check=True,
        ).stdout
        found.update(loops(text))
    scalar = [
        name for name, code in found.items() if SCALAR.search(code) and not PACKED.search(code)
    ]
    packed = sum(1 for code in found.values() if PACKED.search(code))
    print(f"{len(found)} bodies, {packed} with packed multiply-adds")
    for name in scalar:
        print(f"  scalar: {name}")
    return 1 if scalar or packed == 0 else 0


if __name__ == "__main__":
    sys.exit(main())
