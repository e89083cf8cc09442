# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Holds the library's includes to its layers: `python3 layers.py SOURCE [GENERATED]`.

Each folder may include its own headers and those of the folders listed for it, nothing else of the
library. Prints every include that goes another way and ends with 1 if there is one.
"""

from __future__ import annotations

import re
import sys
from pathlib import Path

PUBLIC = {"arbor", "sycl"}
LAYERS = {
    "scalar": set(),
    "call": PUBLIC,
    "device": PUBLIC | {"call", "scalar"},
    "host": PUBLIC | {"call", "device"},
    "dispatch": PUBLIC | {"call", "device", "host", "scalar"},
    "frontend": PUBLIC | {"call", "dispatch"},
}
# The one place where the scalar bodies meet a SYCL compiler's built-ins.
EXCEPTIONS = {("scalar/ops.hpp", "sycl/sycl.hpp")}

_INCLUDE = re.compile(r'^\s*#\s*include\s*[<"]([^">]+)[">]', re.MULTILINE)


def violations(root: Path) -> list[str]:
    """The includes below `root`, a folder with one folder per layer, that break the order."""
    found = []
    for path in sorted(root.rglob("*.[ch]pp")):
        name = path.relative_to(root).as_posix()
        layer = name.partition("/")[0]
        if layer not in LAYERS:
            found.append(f"{name}: the folder {layer} is in no layer")
            continue
        for include in _INCLUDE.findall(path.read_text()):
            target = include.partition("/")[0]
            ours = "/" in include and (target in LAYERS or target in PUBLIC)
            allowed = target == layer or target in LAYERS[layer]
            if ours and not allowed and (name, include) not in EXCEPTIONS:
                found.append(f"{name}: {layer} must not include {include}")
    return found


def main() -> int:
    if len(sys.argv) < 2:
        print(__doc__, file=sys.stderr)
        return 2
    found = [text for root in sys.argv[1:] for text in violations(Path(root))]
    print("\n".join(found) if found else "every include keeps the order of the layers")
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
