#!/usr/bin/env python3
# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Finds the floats and doubles next to multiples of pi/2; writes trig_hard_arguments.hpp.

A number of p bits is M 2^E with M of p bits. For each E the M for which M 2^E (2/pi) is next to an
integer are denominators of convergents and intermediate fractions of 2^E (2/pi), and multiples of
them; of those in the range the best one is taken.
"""

from fractions import Fraction
from pathlib import Path
import struct

DIGITS = 1400


def scaled_pi() -> int:
    """pi 2^DIGITS, by Machin's formula."""
    one = 1 << (DIGITS + 20)

    def inverse_tangent(x: int) -> int:
        term = total = one // x
        k, sign = 1, -1
        while term:
            term //= x * x
            k += 2
            total += sign * (term // k)
            sign = -sign
        return total

    return (4 * (4 * inverse_tangent(5) - inverse_tangent(239))) >> 20


PI = scaled_pi()


def hardest(bits: int, exponent: int) -> tuple[Fraction, int] | None:
    """The distance to the multiple, in multiples, and M."""
    numerator = 1 << (max(exponent, 0) + DIGITS + 1)
    denominator = PI << max(-exponent, 0)
    numerator %= denominator
    lowest, end = 1 << (bits - 1), 1 << bits
    candidates: set[int] = set()
    q0, q1 = 0, 1
    x, y = denominator, numerator
    while y and q1 < end:
        quotient = x // y
        largest = min(quotient, (end - 1 - q0) // q1)
        candidates.update(q0 + j * q1 for j in {1, 2, largest - 1, largest} if j > 0)
        candidates.update({(end - 1) // q1 * q1, -(-lowest // q1) * q1})
        q0, q1 = q1, q0 + quotient * q1
        x, y = y, x - quotient * y

    def distance(m: int) -> int:
        rest = m * numerator % denominator
        return min(rest, denominator - rest)

    inside = [m for m in candidates if lowest <= m < end]
    if not inside:
        return None
    best = min(inside, key=distance)
    return Fraction(distance(best), denominator), best


def patterns(bits: int, bias: int, lowest: int, highest: int) -> list[tuple[Fraction, int]]:
    found = []
    for exponent in range(lowest, highest + 1):
        hard = hardest(bits, exponent)
        if hard is not None:
            field = exponent + bits - 1 + bias
            found.append((hard[0], (field << (bits - 1)) | (hard[1] & ((1 << (bits - 1)) - 1))))
    return found


def array(name: str, comment: str, width: int, found: list[tuple[Fraction, int]]) -> str:
    per_line = 8 if width == 32 else 4
    words = [f"0x{pattern:0{width // 4}x}," for _, pattern in found]
    lines = ["    " + " ".join(words[i : i + per_line]) for i in range(0, len(words), per_line)]
    closest = min(found)
    text = f"/// {comment}\n/// The closest is 0x{closest[1]:0{width // 4}x}, "
    text += f"{float(closest[0]):.2e} of pi/2 away.\n"
    text += f"inline constexpr std::uint{width}_t {name}[] = {{\n" + "\n".join(lines) + "\n};\n"
    return text


def main() -> None:
    floats = patterns(24, 127, -23, 104)
    doubles = patterns(53, 1023, -51, 971)
    text = f"""// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
//
// Written by trig_hard_arguments.py.

#pragma once

#include <cstdint>

namespace arbor::lumen::tests {{

{array("hard_floats", "Of each binade from 1 on the float next to a multiple of pi/2.", 32, floats)}
{array("hard_doubles", "Of each binade from 2 on the double next to a multiple of pi/2.", 64, doubles)}
}}  // namespace arbor::lumen::tests
"""
    Path(__file__).with_name("trig_hard_arguments.hpp").write_text(text)


if __name__ == "__main__":
    main()
