# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Makes everything repetitive from the registry: `python3 tools/generate CATALOGUE OUT`.

Writes the public headers, the exported overloads, the functor types, the family tables, the kernels
of the array-math module with their wrappers, and lists for the tests below OUT. Ends with 1 and a message that names the entry if the registry makes no
sense.
"""

from __future__ import annotations

import sys
from pathlib import Path

import catalogue
import families
import functors
import headers
import kernels
import overloads
import row_list
from output import Output


def main() -> int:
    if len(sys.argv) != 3:
        print("usage: python3 tools/generate CATALOGUE OUT", file=sys.stderr)
        return 2
    try:
        functions = catalogue.load(Path(sys.argv[1]))
    except (OSError, ValueError, KeyError, catalogue.CatalogueError) as error:
        print(f"{sys.argv[1]}: {error}", file=sys.stderr)
        return 1
    output = Output(Path(sys.argv[2]))
    for generator in (headers, overloads, functors, families, kernels, row_list):
        generator.generate(functions, output)
    output.remove_stale()
    return 0


if __name__ == "__main__":
    sys.exit(main())
