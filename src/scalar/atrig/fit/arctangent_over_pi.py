#!/usr/bin/env python3
# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Fits arctan(t)/(pi t) in z = t^2 on [0, 1]; writes ../arctangent_over_pi_constants.hpp.

For float results computed in double: interpolated at the Chebyshev nodes of [0, 1], the relative
error is near the smallest of the degree. Computed in decimal arithmetic; a coefficient is rounded
to the nearest double.
"""

from decimal import Decimal, getcontext
from pathlib import Path
import math
import struct

getcontext().prec = 60

DEGREE = 10


def arctan(x: Decimal) -> Decimal:
    """By Euler's series, for 0 <= x <= 1."""
    ratio = x * x / (1 + x * x)
    term, total, n = x / (1 + x * x), Decimal(0), 1
    while term > Decimal(10) ** -65:
        total += term
        term *= ratio * (2 * n) / (2 * n + 1)
        n += 1
    return total


PI = 4 * arctan(Decimal(1))


def target(z: Decimal) -> Decimal:
    t = z.sqrt()
    return arctan(t) / (t * PI) if z != 0 else 1 / PI


def interpolate(points: list[Decimal], function) -> list[Decimal]:
    """Coefficients, lowest first, by Newton's divided differences."""
    table = [function(x) for x in points]
    for level in range(1, len(points)):
        for i in range(len(points) - 1, level - 1, -1):
            table[i] = (table[i] - table[i - 1]) / (points[i] - points[i - level])
    result = [Decimal(0)] * len(points)
    for i in range(len(points) - 1, -1, -1):
        # result = result·(x - points[i]) + table[i]
        shifted = [Decimal(0)] + result[:-1]
        result = [s - points[i] * r for s, r in zip(shifted, result)]
        result[0] += table[i]
    return result


def evaluate(coefficients: list[float], x: Decimal) -> Decimal:
    value = Decimal(0)
    for c in reversed(coefficients):
        value = value * x + Decimal(c)
    return value


def pattern(x: float) -> str:
    return "0x%016x" % struct.unpack("<Q", struct.pack("<d", x))[0]


def main() -> None:
    count = DEGREE + 1
    angles = [(2 * i + 1) * math.pi / (2 * count) for i in range(count)]
    nodes = [(1 + Decimal(math.cos(angle))) / 2 for angle in angles]
    coefficients = [float(c) for c in interpolate(nodes, target)]
    samples = [Decimal(i) / 1000 for i in range(1001)]
    error = max(abs(evaluate(coefficients, z) / target(z) - 1) for z in samples)

    text = "// SPDX-FileCopyrightText: The Arbor Lumen authors\n"
    text += "// SPDX-License-Identifier: Apache-2.0\n"
    text += "//\n// Written by fit/arctangent_over_pi.py.\n\n#pragma once\n\n#include <cstdint>\n\n"
    text += "namespace arbor::lumen::vm::detail::gpu::norvane::scalar {\n\n"
    text += f"/// Lowest first: arctan(t)/(pi t) in z = t^2 on [0, 1], within {error:.1e} relative.\n"
    text += f"static constexpr std::uint64_t arctangent_over_pi_coefficients[{count}] = {{\n"
    text += "".join(f"    {pattern(c)},  // {c!r}\n" for c in coefficients)
    text += "};\n\n}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar\n"
    path = Path(__file__).resolve().parent.parent / "arctangent_over_pi_constants.hpp"
    path.write_text(text, encoding="utf-8")


if __name__ == "__main__":
    main()
