#!/usr/bin/env python3
# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Fits the polynomials of the complex logarithms; writes ../ln_constants.hpp.

- of t, (ln(1 + t)/2 - t/2)/t on [-1/2, 1], degree 30, the four lowest coefficients given: least
  squares of the error relative to the logarithm, at the Chebyshev nodes;
- of w = f^2, (artanh f - f)/f^3 for |f| <= (√2 - 1)/(√2 + 1), degree 9, and for |f| <= 1/3, degree
  5, interpolated at the Chebyshev nodes in w.

Computed in decimal arithmetic; a coefficient is rounded to the nearest double.
"""

import struct
import sys
from collections.abc import Sequence
from decimal import Decimal, getcontext
from pathlib import Path

FOLDER = Path(__file__).resolve().parent.parent
sys.path.insert(0, str(FOLDER.parent / "fit"))
from fitting import (  # noqa: E402
    Array,
    chebyshev_zeros,
    doubles,
    evaluate,
    interpolate,
    least_squares,
    write_header,
)

getcontext().prec = 100

LOWEST = ["bc7c6f043d7aa41f", "bfcfffffffffffb0", "3fc5555555555896", "bfc0000000006621"]
GIVEN = [struct.unpack(">d", bytes.fromhex(word))[0] for word in LOWEST]
T_DEGREE = 30

NARROW = (Decimal(2).sqrt() - 1) ** 2
NARROW_DEGREE = 9
WIDE = Decimal(1) / 3
WIDE_DEGREE = 5


def of_t(t: Decimal) -> Decimal:
    return ((1 + t).ln() / 2 - t / 2) / t


def relative_weight(t: Decimal) -> Decimal:
    return 2 * t / (1 + t).ln()


def fit_of_t() -> list[float]:
    points = [Decimal("0.25") + Decimal("0.75") * zero for zero in chebyshev_zeros(200)]
    power = len(GIVEN)
    rest = least_squares(
        points,
        lambda t: (of_t(t) - evaluate(GIVEN, t)) / t**power,
        lambda t: t**power * relative_weight(t),
        T_DEGREE - power,
    )
    return GIVEN + doubles(rest)


def error_of_t(coefficients: Sequence[float]) -> Decimal:
    samples = [Decimal(i) / 2000 for i in range(-1000, 2001) if i != 0]
    return max(abs((evaluate(coefficients, t) - of_t(t)) * relative_weight(t)) for t in samples)


def blocks_of(coefficients: Sequence[float]) -> list[Array]:
    """Three arrays by powers: 30 to 21, 20 to 11, 10 to 0."""
    highest_first = coefficients[::-1]
    return [
        Array(
            "half_log1p_high",
            "Highest first: (ln(1 + t)/2 - t/2)/t on [-1/2, 1], the powers from 21 to 30; the\n"
            f"logarithm within {error_of_t(coefficients):.1e} of itself.",
            highest_first[:10],
        ),
        Array("half_log1p_middle", "Those from 11 to 20.", highest_first[10:20]),
        Array("half_log1p_low", "Those from 0 to 10.", highest_first[20:]),
    ]


def of_w(w: Decimal) -> Decimal:
    f = w.sqrt()
    return (((1 + f) / (1 - f)).ln() / 2 - f) / (f * w)


def fit_of_w(limit: Decimal, degree: int) -> tuple[list[float], Decimal]:
    half = limit * limit / 2
    coefficients = doubles(interpolate([half + half * z for z in chebyshev_zeros(degree + 1)], of_w))
    samples = [2 * half * i / 2000 for i in range(1, 2001)]
    return coefficients, max(abs((evaluate(coefficients, w) - of_w(w)) * w) for w in samples)


def main() -> None:
    logarithm = fit_of_t()
    narrow, narrow_error = fit_of_w(NARROW, NARROW_DEGREE)
    wide, wide_error = fit_of_w(WIDE, WIDE_DEGREE)
    write_header(
        FOLDER / "ln_constants.hpp",
        __file__,
        [
            *blocks_of(logarithm),
            Array(
                "artanh_rest",
                "Highest first: (artanh f - f)/f^3 of f^2 for |f| <= (√2 - 1)/(√2 + 1);\nartanh f"
                f" within {narrow_error:.1e} of itself.",
                narrow[::-1],
            ),
            Array(
                "artanh_rest_c",
                "Highest first: the same for |f| <= 1/3; artanh f within"
                f" {wide_error:.1e} of itself.",
                wide[::-1],
            ),
        ],
    )


if __name__ == "__main__":
    main()
