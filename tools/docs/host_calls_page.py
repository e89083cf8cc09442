# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""host_calls_page.py FOLDER RESULTS…: FOLDER/host_calls.md and a picture for each instruction set,
from the results of bench_host_calls_<set> in host_calls_<set>.json files (Google Benchmark)."""

from __future__ import annotations

import sys
from collections import defaultdict
from pathlib import Path

from host_loop_page import TIERS, TYPES, Case, draw_bars, mean, processor, times

# What a tier is measured by: SLEEF's functions of 1 ulp, or of 3.5 ulp where it has them.
REFERENCES = {"ha": ("sleef_u10",), "la": ("sleef_u10",), "ep": ("sleef_u35", "sleef_u10")}

HEADER = """# Speed of calls on a CPU queue

Whole public calls, from the function's entry to its return, on one thread, beside the vector
functions of SLEEF and of the C library (libmvec) in plain loops in the same runs. `ha` and `la` are
measured by SLEEF's functions of 1 ulp, `ep` by those of 3.5 ulp where there are any: their time stands
in nanoseconds per element, all else is the ratio of times, below 1 if the call is faster. Times are
medians of the repetitions. Written by `scripts/bench host_calls`.
"""


def reference(measured: dict[str, float], tier: str) -> float | None:
    return next((measured[name] for name in REFERENCES[tier] if name in measured), None)


def ratio(measured: dict[str, float], tier: str) -> float | None:
    of_peer = reference(measured, tier)
    call = measured.get(f"{tier}_call")
    return call / of_peer if call and of_peer else None


def text_of(value: float | None) -> str:
    return "" if value is None else f"{value:.2f}"


def means(found: dict[Case, dict[str, float]]) -> str:
    ratios: dict[tuple[int, str], list[float]] = defaultdict(list)
    for case, measured in found.items():
        for tier in TIERS:
            value = ratio(measured, tier)
            if case.arguments == "ordinary" and value:
                ratios[case.n, tier].append(value)
    lines = ["| n | " + " | ".join(f"`{t}`, mean | largest" for t in TIERS) + " |", "|" + "---|" * 7]
    for n in sorted({n for n, _ in ratios}):
        cells = []
        for tier in TIERS:
            values = ratios[n, tier]
            cells += [f"{mean(values):.2f}", f"{max(values):.2f}"]
        lines.append(f"| {n} | " + " | ".join(cells) + " |")
    return "\n".join(lines) + "\n"


def table(found: dict[Case, dict[str, float]]) -> str:
    lines = [
        "| Function | Type | n | SLEEF u10, ns | u35, ns | `ha` | `la` | `ep` | libmvec to u10 |",
        "|" + "---|" * 9,
    ]
    for case in sorted(found, key=lambda c: (c.function, c.type != "s", c.n)):
        measured = found[case]
        if case.arguments != "ordinary" or "sleef_u10" not in measured:
            continue
        cells = [case.function, TYPES[case.type], str(case.n)]
        cells += [text_of(measured.get(name)) for name in ("sleef_u10", "sleef_u35")]
        cells += [text_of(ratio(measured, tier)) for tier in TIERS]
        libmvec = measured.get("libmvec")
        cells.append(text_of(libmvec / measured["sleef_u10"] if libmvec else None))
        lines.append("| " + " | ".join(cells) + " |")
    return "\n".join(lines) + "\n"


def threads(found: dict[Case, dict[str, float]]) -> str:
    lines = ["| Function | Type | one thread, ns | two, ns | gain |", "|" + "---|" * 5]
    for case in sorted(found, key=lambda c: (c.function, c.type != "s")):
        if case.arguments != "two_threads":
            continue
        two = found[case]["ha_call"]
        one = found[Case(case.function, case.type, "ordinary", case.n)]["ha_call"]
        cells = (case.function, TYPES[case.type], f"{one:.2f}", f"{two:.2f}", f"{one / two:.2f}")
        lines.append("| " + " | ".join(cells) + " |")
    return "\n".join(lines) + "\n"


def memory(found: dict[Case, dict[str, float]]) -> str:
    lines = ["| Function | Type | n | call, ns | plain loop, ns | loop to call |", "|" + "---|" * 6]
    for case in sorted(found, key=lambda c: (c.function, c.type != "s")):
        call = found[case].get("call")
        if case.arguments != "memory" or call is None:
            continue
        loop = "copy_sum" if case.function in ("add", "mul") else "copy"
        plain = found[Case(loop, case.type, "memory", case.n)]["loop"]
        cells = (case.function, TYPES[case.type], str(case.n), f"{call:.3f}", f"{plain:.3f}")
        lines.append("| " + " | ".join((*cells, f"{plain / call:.2f}")) + " |")
    return "\n".join(lines) + "\n"


def picture(found: dict[Case, dict[str, float]], name: str, path: Path) -> bool:
    rows = []
    for case in sorted(found, key=lambda c: (c.function, c.type != "s")):
        values = [ratio(found[case], tier) for tier in TIERS]
        if case.arguments == "ordinary" and case.n == 4096 and values[0] is not None:
            rows.append((f"{case.function}_{case.type}", [value or 0 for value in values]))
    title = f"calls on a CPU queue, {name.removeprefix('host_calls_')}, n = 4096"
    return draw_bars(rows, title, "time / time of SLEEF", path)


def main() -> None:
    folder = Path(sys.argv[1])
    results = [Path(name) for name in sys.argv[2:]]
    text = HEADER + f"\n{processor(results[0])}.\n"
    for path in results:
        found = times(path, "real_time")
        name = path.stem
        text += f"\n## {name.removeprefix('host_calls_')}\n\n"
        one = [found[Case("add", letter, "ordinary", 1)]["ha_call"] for letter in "sd"]
        text += f"A call of `add` with one element: {one[0]:.0f} ns at float, {one[1]:.0f} at double.\n\n"
        text += "Geometric means of the ratios:\n\n" + means(found)
        svg = folder / f"{name}.svg"
        if picture(found, name, svg):
            text += f"\n![Ratios of times]({svg.name})\n"
        text += "\n### One thread\n\n" + table(found)
        text += "\n### Two threads, `ha`\n\n" + threads(found)
        text += "\n### Cheap functions beside a plain loop over the same memory\n\n" + memory(found)
    (folder / "host_calls.md").write_text(text)


if __name__ == "__main__":
    main()
