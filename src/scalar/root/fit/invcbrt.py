#!/usr/bin/env python3
# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Fits the polynomials of invcbrt_s at `la` and of invcbrt_d at `ha`; writes
../invcbrt_constants.hpp.

- float, `la`: (1 + f)^(-1/3) - 1 on |f| <= 1/3, degree 8;
- double, `ha`: ((1 + g)^(-1/3) - 1)/g on |g| <= 1/65, degree 7.

Interpolated at the Chebyshev nodes in decimal arithmetic; a coefficient is rounded to the nearest
number of its type.
"""

from decimal import Decimal, getcontext
from pathlib import Path
import math
import struct

getcontext().prec = 100


def inverse_cube_root(x: Decimal) -> Decimal:
    return (-x.ln() / 3).exp()


def less_one(f: Decimal) -> Decimal:
    return inverse_cube_root(1 + f) - 1


def slope(g: Decimal) -> Decimal:
    return (inverse_cube_root(1 + g) - 1) / g


def interpolate(points: list[Decimal], function) -> list[Decimal]:
    """Coefficients, lowest first, by Newton's divided differences."""
    table = [function(x) for x in points]
    for level in range(1, len(points)):
        for i in range(len(points) - 1, level - 1, -1):
            table[i] = (table[i] - table[i - 1]) / (points[i] - points[i - level])
    result = [Decimal(0)] * len(points)
    for i in range(len(points) - 1, -1, -1):
        shifted = [Decimal(0)] + result[:-1]
        result = [s - points[i] * r for s, r in zip(shifted, result)]
        result[0] += table[i]
    return result


def chebyshev_nodes(limit: Decimal, count: int) -> list[Decimal]:
    """Nodes in [-limit, limit]; 0 is one of them where `count` is odd."""
    nodes = [limit * Decimal(math.cos((2 * i + 1) * math.pi / (2 * count))) for i in range(count)]
    if count % 2 == 1:
        nodes[count // 2] = Decimal(0)
    return nodes


def evaluate(coefficients: list[Decimal], x: Decimal) -> Decimal:
    value = Decimal(0)
    for c in reversed(coefficients):
        value = value * x + c
    return value


def rounded(coefficients: list[Decimal], code: str) -> list[Decimal]:
    return [Decimal(struct.unpack(code, struct.pack(code, float(c) + 0.0))[0]) for c in coefficients]


def pattern(c: Decimal, code: str) -> str:
    return "0x" + struct.pack(">" + code, float(c)).hex()


def array(name: str, comment: str, coefficients: list[Decimal], code: str) -> str:
    word = 32 if code == "f" else 64
    text = "".join(f"/// {line}\n" for line in comment.splitlines())
    text += f"static constexpr std::uint{word}_t {name}[{len(coefficients)}] = {{\n"
    text += "".join(f"    {pattern(c, code)},  // {float(c)!r}\n" for c in reversed(coefficients))
    return text + "};\n"


def main() -> None:
    f_limit = Decimal(1) / 3
    of_f = rounded(interpolate(chebyshev_nodes(f_limit, 9), less_one), "f")
    f_error = max(
        abs((evaluate(of_f, f) - less_one(f)) / (1 + less_one(f)))
        for f in (f_limit * i / 2000 for i in range(-2000, 2001))
    )

    g_limit = Decimal(1) / 65
    of_g = rounded(interpolate(chebyshev_nodes(g_limit, 8), slope), "d")
    g_error = max(
        abs((evaluate(of_g, g) - slope(g)) * g)
        for g in (g_limit * i / 2000 for i in range(-2000, 2001))
        if g != 0
    )

    header = "// SPDX-FileCopyrightText: The Arbor Lumen authors\n"
    header += "// SPDX-License-Identifier: Apache-2.0\n"
    header += "//\n// Written by fit/invcbrt.py.\n\n#pragma once\n\n#include <cstdint>\n\n"
    header += "namespace arbor::lumen::vm::detail::gpu::norvane::scalar {\n\n"
    header += array(
        "invcbrt_la_polynomial_s",
        "Highest first: (1 + f)^(-1/3) - 1 for |f| <= 1/3, relative to (1 + f)^(-1/3) within\n"
        f"{f_error:.1e}.",
        of_f,
        "f",
    )
    header += "\n" + array(
        "invcbrt_ha_polynomial_d",
        "Highest first: ((1 + g)^(-1/3) - 1)/g for |g| <= 1/65; times g within "
        f"{g_error:.1e}.",
        of_g,
        "d",
    )
    header += "\n}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar\n"
    path = Path(__file__).resolve().parent.parent / "invcbrt_constants.hpp"
    path.write_text(header, encoding="utf-8")


if __name__ == "__main__":
    main()
