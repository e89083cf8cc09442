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

import sys
from decimal import Decimal, getcontext
from pathlib import Path

FOLDER = Path(__file__).resolve().parent.parent
sys.path.insert(0, str(FOLDER.parent / "fit"))
from fitting import Array, chebyshev_zeros, doubles, evaluate, floats, interpolate, write_header  # noqa: E402

getcontext().prec = 100


def inverse_cube_root(x: Decimal) -> Decimal:
    return (-x.ln() / 3).exp()


def less_one(f: Decimal) -> Decimal:
    return inverse_cube_root(1 + f) - 1


def slope(g: Decimal) -> Decimal:
    return (inverse_cube_root(1 + g) - 1) / g


def main() -> None:
    f_limit = Decimal(1) / 3
    zeros = chebyshev_zeros(9)
    zeros[4] = Decimal(0)  # exactly, so that the constant term vanishes
    of_f = floats(interpolate([f_limit * zero for zero in zeros], less_one))
    f_error = max(
        abs((evaluate(of_f, f) - less_one(f)) / (1 + less_one(f)))
        for f in (f_limit * i / 2000 for i in range(-2000, 2001))
    )

    g_limit = Decimal(1) / 65
    of_g = doubles(interpolate([g_limit * zero for zero in chebyshev_zeros(8)], slope))
    g_error = max(
        abs((evaluate(of_g, g) - slope(g)) * g)
        for g in (g_limit * i / 2000 for i in range(-2000, 2001))
        if g != 0
    )

    write_header(
        FOLDER / "invcbrt_constants.hpp",
        __file__,
        [
            Array(
                "invcbrt_la_polynomial_s",
                "Highest first: (1 + f)^(-1/3) - 1 for |f| <= 1/3, relative to (1 + f)^(-1/3)"
                f" within\n{f_error:.1e}.",
                of_f[::-1],
                bits=32,
            ),
            Array(
                "invcbrt_ha_polynomial_d",
                "Highest first: ((1 + g)^(-1/3) - 1)/g for |g| <= 1/65; times g within"
                f" {g_error:.1e}.",
                of_g[::-1],
            ),
        ],
    )


if __name__ == "__main__":
    main()
