#!/usr/bin/env python3
# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Fits the polynomials of log1p_d_nolut at `ha`; writes ../log1p_nolut_constants.hpp.

Two polynomials:

- of k, (-ln(1 - k) - k - k^2/2)/k^3, interpolated at the six multiples of 3/32 that k takes beside
  0: there is no error but that of the rounded coefficients;
- of a, (ln(1 - a) + a)/a^2 on |a| <= 0.1125, degree 11, interpolated at the Chebyshev nodes.

Computed in decimal arithmetic; a coefficient is rounded to the nearest double.
"""

import sys
from decimal import Decimal, getcontext
from pathlib import Path

FOLDER = Path(__file__).resolve().parent.parent
sys.path.insert(0, str(FOLDER.parent / "fit"))
from fitting import Array, chebyshev_zeros, doubles, evaluate, interpolate, write_header  # noqa: E402

getcontext().prec = 100

A_LIMIT = Decimal("0.1125")
A_DEGREE = 11
K_POINTS = [Decimal(3 * j) / 32 for j in (-2, -1, 1, 2, 3, 4)]


def of_k(k: Decimal) -> Decimal:
    return (-(1 - k).ln() - k - k * k / 2) / k**3


def of_a(a: Decimal) -> Decimal:
    if a == 0:
        return Decimal(-1) / 2
    return ((1 - a).ln() + a) / a**2


def main() -> None:
    of_k_coefficients = doubles(interpolate(K_POINTS, of_k))
    k_error = max(abs((evaluate(of_k_coefficients, k) - of_k(k)) * k**3) for k in K_POINTS)

    nodes = [A_LIMIT * zero for zero in chebyshev_zeros(A_DEGREE + 1)]
    of_a_coefficients = doubles(interpolate(nodes, of_a))
    samples = [A_LIMIT * i / 2000 for i in range(-2000, 2001)]
    a_error = max(abs((evaluate(of_a_coefficients, a) - of_a(a)) * a**2) for a in samples)

    write_header(
        FOLDER / "log1p_nolut_constants.hpp",
        __file__,
        [
            Array(
                "log1p_nolut_ha_coarse",
                "Lowest first: (-ln(1 - k) - k - k^2/2)/k^3 at the multiples of 3/32 from -3/16 to"
                f" 3/8;\ntimes k^3 within {k_error:.1e}.",
                of_k_coefficients,
            ),
            Array(
                "log1p_nolut_ha_fine",
                f"Lowest first: (ln(1 - a) + a)/a^2 for |a| <= {A_LIMIT}; times a^2 within"
                f" {a_error:.1e}.",
                of_a_coefficients,
            ),
        ],
    )


if __name__ == "__main__":
    main()
