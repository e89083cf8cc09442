# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""What the scripts that fit polynomials share: interpolation in decimal arithmetic at the nodes where
its error is near the smallest of the degree, rounding to a type, and the header that is written."""

from __future__ import annotations

import math
import struct
from collections.abc import Callable, Sequence
from dataclasses import dataclass
from decimal import Decimal
from pathlib import Path

NAMESPACE = "arbor::lumen::vm::detail::gpu::norvane::scalar"


def chebyshev_zeros(count: int) -> list[Decimal]:
    """The zeros of a Chebyshev polynomial in [-1, 1], to the precision of a double."""
    return [Decimal(math.cos((2 * i + 1) * math.pi / (2 * count))) for i in range(count)]


def interpolate(
    points: Sequence[Decimal], function: Callable[[Decimal], Decimal]
) -> list[Decimal]:
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


def least_squares(
    points: Sequence[Decimal],
    function: Callable[[Decimal], Decimal],
    weight: Callable[[Decimal], Decimal],
    degree: int,
) -> list[Decimal]:
    """Coefficients, lowest first, of the smallest sum of squares of the weighted errors; by the
    normal equations, so that the arithmetic must have more than twice the digits of the error."""
    size = degree + 1
    rows = [[Decimal(0)] * (size + 1) for _ in range(size)]
    for x in points:
        w = weight(x)
        terms = [w * x**i for i in range(size)] + [w * function(x)]
        for i in range(size):
            for j in range(size + 1):
                rows[i][j] += terms[i] * terms[j]
    for i in range(size):
        for k in range(i + 1, size):
            factor = rows[k][i] / rows[i][i]
            rows[k] = [a - factor * b for a, b in zip(rows[k], rows[i])]
    result = [Decimal(0)] * size
    for i in range(size - 1, -1, -1):
        known = sum(rows[i][j] * result[j] for j in range(i + 1, size))
        result[i] = (rows[i][size] - known) / rows[i][i]
    return result


def evaluate(coefficients: Sequence[float], x: Decimal) -> Decimal:
    """Coefficients lowest first."""
    value = Decimal(0)
    for c in reversed(coefficients):
        value = value * x + Decimal(c)
    return value


def doubles(coefficients: Sequence[Decimal]) -> list[float]:
    return [float(c) for c in coefficients]


def floats(coefficients: Sequence[Decimal]) -> list[float]:
    """The nearest floats: no double next to a coefficient lies on a tie of floats."""
    return [struct.unpack("<f", struct.pack("<f", float(c)))[0] for c in coefficients]


@dataclass(frozen=True)
class Array:
    """Coefficients in the order in which they are written, as patterns of 32 or 64 bits."""

    name: str
    comment: str
    coefficients: Sequence[float]
    bits: int = 64

    def text(self) -> str:
        code = ">d" if self.bits == 64 else ">f"
        lines = [f"/// {line}\n" for line in self.comment.splitlines()]
        lines.append(
            f"static constexpr std::uint{self.bits}_t {self.name}[{len(self.coefficients)}] = {{\n"
        )
        for c in self.coefficients:
            decimal = repr(c) if self.bits == 64 else f"{c:.9g}"
            lines.append(f"    0x{struct.pack(code, c).hex()},  // {decimal}\n")
        return "".join(lines) + "};\n"


def write_header(path: Path, script: str, arrays: Sequence[Array]) -> None:
    text = "// SPDX-FileCopyrightText: The Arbor Lumen authors\n"
    text += "// SPDX-License-Identifier: Apache-2.0\n"
    text += f"//\n// Written by fit/{Path(script).name}.\n\n#pragma once\n\n#include <cstdint>\n\n"
    text += f"namespace {NAMESPACE} {{\n\n"
    text += "\n".join(array.text() for array in arrays)
    text += f"\n}}  // namespace {NAMESPACE}\n"
    path.write_text(text, encoding="utf-8")
