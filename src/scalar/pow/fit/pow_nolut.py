#!/usr/bin/env python3
# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Fits the polynomial of the table-free powers at double, `ha`; writes ../nolut_polynomial.hpp.

    ln(1 + t) = t - t^2/2 + (t^3/2)·(c + p(t)),   |t| <= 1/9,

with c the double next to 2/3 and p of degree 15. Its four highest coefficients are given; the others
interpolate what these leave at the Chebyshev nodes. Computed in decimal arithmetic; a coefficient is
rounded to the nearest double.
"""

import struct
import sys
from decimal import Decimal, getcontext
from pathlib import Path

FOLDER = Path(__file__).resolve().parent.parent
sys.path.insert(0, str(FOLDER.parent / "fit"))
from fitting import Array, chebyshev_zeros, doubles, evaluate, interpolate, write_header  # noqa: E402

getcontext().prec = 100

LIMIT = Decimal(1) / 9
GIVEN = (0xBFBE5076359402E1, 0x3FBFDC3E56EADF2E, 0xBFBFF1E76B514EBF, 0x3FC10B56B95C010D)
FITTED = 12


def value(pattern: int) -> Decimal:
    return Decimal(struct.unpack("<d", struct.pack("<Q", pattern))[0])


def p(t: Decimal) -> Decimal:
    """By its series: 2/3 - 2t/4 + 2t^2/5 - ..., less c."""
    series = -value(0x3FE5555555555555)
    power = Decimal(2)
    for k in range(110):
        series += power / (k + 3)
        power *= -t
    return series


def main() -> None:
    given = [value(g) for g in reversed(GIVEN)]
    nodes = [LIMIT * zero for zero in chebyshev_zeros(FITTED)]
    fitted = interpolate(nodes, lambda t: p(t) - evaluate(given, t) * t**FITTED)
    coefficients = doubles([*fitted, *given])
    samples = [LIMIT * i / 1000 for i in range(-1000, 1001)]
    error = max(abs((evaluate(coefficients, t) - p(t)) * t**2 / 2) for t in samples)
    write_header(
        FOLDER / "nolut_polynomial.hpp",
        __file__,
        [
            Array(
                "nolut_power_polynomial",
                "p, from the highest coefficient down, in ln(1 + t) = t - t^2/2 + (t^3/2)·(2/3 + p(t))"
                f" for\n|t| <= 1/9, 2/3 as a double; the error of ln(1 + t) is below {error:.1e} of t.",
                coefficients[::-1],
            )
        ],
    )


if __name__ == "__main__":
    main()
