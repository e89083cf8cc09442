#!/usr/bin/env python3
# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Fits the polynomial of sin and cos at half; writes ../half_sine_constants.hpp.

(sin r - r)/r^3 as a polynomial in z = r^2 of degree 2, interpolated for |r| <= 1.575, a little more
than pi/2, at the zeros of a Chebyshev polynomial in z, of which none is spent at 0, where the
relative error of the sine vanishes.

Computed in decimal arithmetic; a coefficient is rounded to the nearest float.
"""

import math
import sys
from decimal import Decimal, getcontext
from pathlib import Path

FOLDER = Path(__file__).resolve().parent.parent
sys.path.insert(0, str(FOLDER.parent / "fit"))
from fitting import Array, evaluate, floats, interpolate, write_header  # noqa: E402

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


def main() -> None:
    # The error of the sine carries a factor z more, as if 0 were another node.
    top = LIMIT * LIMIT
    angle = math.pi / (2 * (COUNT + 1))
    scale = top / Decimal(1 + math.cos(angle))
    nodes = [
        scale * Decimal(math.cos((2 * i + 1) * angle) + math.cos(angle)) for i in range(COUNT)
    ]
    coefficients = floats(interpolate(nodes, cubic))

    error = Decimal(0)
    for i in range(1, 2001):
        r = LIMIT * i / 2000
        z = r * r
        error = max(error, abs((r + r * z * evaluate(coefficients, z)) / sine(r) - 1))
    write_header(
        FOLDER / "half_sine_constants.hpp",
        __file__,
        [
            Array(
                "half_sine_cubic",
                f"Lowest first: (sin r - r)/r^3 in r^2 for |r| <= {LIMIT}; of the sine within"
                f" {error:.1e} relative.",
                coefficients,
                bits=32,
            )
        ],
    )


if __name__ == "__main__":
    main()
