#!/usr/bin/env python3
# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Fits arctan(t)/(pi t) in z = t^2 on [0, 1]; writes ../arctangent_over_pi_constants.hpp.

For float results computed in double: interpolated at the Chebyshev nodes of [0, 1], the relative
error is near the smallest of the degree. Computed in decimal arithmetic; a coefficient is rounded
to the nearest double.
"""

import sys
from decimal import Decimal, getcontext
from pathlib import Path

FOLDER = Path(__file__).resolve().parent.parent
sys.path.insert(0, str(FOLDER.parent / "fit"))
from fitting import Array, chebyshev_zeros, doubles, evaluate, interpolate, write_header  # noqa: E402

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


def main() -> None:
    nodes = [(1 + zero) / 2 for zero in chebyshev_zeros(DEGREE + 1)]
    coefficients = doubles(interpolate(nodes, target))
    samples = [Decimal(i) / 1000 for i in range(1001)]
    error = max(abs(evaluate(coefficients, z) / target(z) - 1) for z in samples)
    write_header(
        FOLDER / "arctangent_over_pi_constants.hpp",
        __file__,
        [
            Array(
                "arctangent_over_pi_coefficients",
                f"Lowest first: arctan(t)/(pi t) in z = t^2 on [0, 1], within {error:.1e} relative.",
                coefficients,
            )
        ],
    )


if __name__ == "__main__":
    main()
