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

from decimal import Decimal, getcontext
from pathlib import Path
import math
import struct

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


def array(name: str, comment: str, coefficients: list[float]) -> str:
    text = "".join(f"/// {line}\n" for line in comment.splitlines())
    text += f"static constexpr std::uint64_t {name}[{len(coefficients)}] = {{\n"
    text += "".join(f"    {pattern(c)},  // {c!r}\n" for c in coefficients)
    return text + "};\n"


def main() -> None:
    k_coefficients = [float(c) for c in interpolate(K_POINTS, of_k)]
    k_error = max(abs((evaluate(k_coefficients, k) - of_k(k)) * k**3) for k in K_POINTS)

    count = A_DEGREE + 1
    nodes = [
        A_LIMIT * Decimal(math.cos((2 * i + 1) * math.pi / (2 * count))) for i in range(count)
    ]
    a_coefficients = [float(c) for c in interpolate(nodes, of_a)]
    samples = [A_LIMIT * i / 2000 for i in range(-2000, 2001)]
    a_error = max(abs((evaluate(a_coefficients, a) - of_a(a)) * a**2) for a in samples)

    header = "// SPDX-FileCopyrightText: The Arbor Lumen authors\n"
    header += "// SPDX-License-Identifier: Apache-2.0\n"
    header += "//\n// Written by fit/log1p_nolut.py.\n\n#pragma once\n\n#include <cstdint>\n\n"
    header += "namespace arbor::lumen::vm::detail::gpu::norvane::scalar {\n\n"
    header += array(
        "log1p_nolut_ha_coarse",
        "Lowest first: (-ln(1 - k) - k - k^2/2)/k^3 at the multiples of 3/32 from -3/16 to 3/8;\n"
        f"times k^3 within {k_error:.1e}.",
        k_coefficients,
    )
    header += "\n" + array(
        "log1p_nolut_ha_fine",
        f"Lowest first: (ln(1 - a) + a)/a^2 for |a| <= {A_LIMIT}; times a^2 within {a_error:.1e}.",
        a_coefficients,
    )
    header += "\n}  // namespace arbor::lumen::vm::detail::gpu::norvane::scalar\n"
    path = Path(__file__).resolve().parent.parent / "log1p_nolut_constants.hpp"
    path.write_text(header, encoding="utf-8")


if __name__ == "__main__":
    main()
