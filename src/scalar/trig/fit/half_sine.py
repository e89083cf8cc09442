#!/usr/bin/env python3
# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Fits the polynomial of sin and cos at half; writes ../half_sine_constants.hpp.

(sin r - r)/r^3 as a polynomial in z = r^2 of degree 2, interpolated for |r| <= 1.575, a little more
than pi/2, at the zeros of a Chebyshev polynomial in z, of which none is spent at 0, where the
relative error of the sine vanishes.

Computed in decimal arithmetic; a coefficient is rounded to the nearest float.
"""

from decimal import Decimal, getcontext
from pathlib import Path
import math
import struct

getcontext().prec = 60

LIMIT = Decimal("1.575")
COUNT = 3


def sine(r: Decimal) -> Decimal:
    term, total, k = r, Decimal(0), 1
    while abs(term) > Decimal(10) ** -55:
        total += term
        term = -term * r * r / ((k + 1) * (k + 2))
        k += 2
    return total


def cubic(z: Decimal) -> Decimal:
    r = z.sqrt()
    return (sine(r) - r) / (r * z)


def interpolate(points: list[Decimal]) -> list[Decimal]:
    """Coefficients, lowest first, by Newton's divided differences."""
    table = [cubic(x) for x in points]
    for level in range(1, len(points)):
        for i in range(len(points) - 1, level - 1, -1):
            table[i] = (table[i] - table[i - 1]) / (points[i] - points[i - level])
    result = [Decimal(0)] * len(points)
    for i in range(len(points) - 1, -1, -1):
        shifted = [Decimal(0)] + result[:-1]
        result = [s - points[i] * r for s, r in zip(shifted, result)]
        result[0] += table[i]
    return result


def to_float(x: Decimal) -> float:
    """The nearest float: the double next to x does not lie on a tie of floats."""
    return struct.unpack("<f", struct.pack("<f", float(x)))[0]


def main() -> None:
    # The error of the sine carries a factor z more, as if 0 were another node.
    top = LIMIT * LIMIT
    angle = math.pi / (2 * (COUNT + 1))
    scale = top / Decimal(1 + math.cos(angle))
    nodes = [
        scale * Decimal(math.cos((2 * i + 1) * angle) + math.cos(angle)) for i in range(COUNT)
    ]
    coefficients = [to_float(c) for c in interpolate(nodes)]

    error = Decimal(0)
    for i in range(1, 2001):
        r = LIMIT * i / 2000
        z = r * r
        p = Decimal(0)
        for c in reversed(coefficients):
            p = p * z + Decimal(c)
        error = max(error, abs((r + r * z * p) / sine(r) - 1))

    lines = "".join(
        "    0x%08x,  // %.9g\n" % (struct.unpack("<I", struct.pack("<f", c))[0], c)
        for c in coefficients
    )
    text = f"""// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
//
// Written by fit/half_sine.py.

#pragma once

#include <cstdint>

namespace arbor::lumen::vm::detail::gpu::norvane::scalar {{

/// Lowest first: (sin r - r)/r^3 in r^2 for |r| <= {LIMIT}; of the sine within {error:.1e} relative.
static constexpr std::uint32_t half_sine_cubic[{COUNT}] = {{
{lines}}};

}}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar
"""
    (Path(__file__).resolve().parent.parent / "half_sine_constants.hpp").write_text(text)


if __name__ == "__main__":
    main()
