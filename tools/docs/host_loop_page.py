# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""host_loop_page.py FOLDER RESULTS…: FOLDER/host_loop.md and a picture for each instruction set,
from the results of bench_host_loop_<set> in <set>.json files (Google Benchmark)."""

from __future__ import annotations

import json
import math
import shutil
import subprocess
import sys
from collections import defaultdict
from dataclasses import dataclass
from pathlib import Path

REFERENCE = "sleef_u10"
TIERS = ("ha", "la", "ep")
PEERS = ("sleef_u35", "libmvec")
TYPES = {"s": "float", "d": "double"}

HEADER = """# Speed of host loops

Each body in the loop that host kernels are made of, on one thread, beside the vector functions of
SLEEF and of the C library (libmvec) in the same run. SLEEF's functions of 1 ulp are the measure: their
time stands in nanoseconds per element, all else is the ratio of times to theirs, below 1 if faster. A
tier without a figure of its own has the body of the one on its left; a figure for a device without
tables or without double stands behind a slash where that is another body. Times are the least of the
repetitions. Written by `scripts/bench host_loop`.
"""

COLUMNS = "| Function | Type | n | SLEEF u10, ns | `ha` | `la` | `ep` | SLEEF u35 | libmvec |"


@dataclass(frozen=True)
class Case:
    function: str
    type: str
    arguments: str
    n: int


def times(path: Path, clock: str = "cpu_time") -> dict[Case, dict[str, float]]:
    """Least time per element in ns, by case and implementation."""
    found: dict[Case, dict[str, float]] = defaultdict(dict)
    for run in json.loads(path.read_text())["benchmarks"]:
        if run.get("run_type") == "aggregate":
            continue
        function, letter, implementation, arguments, n = run["name"].split("/")[:5]
        case = Case(function, letter, arguments, int(n))
        time = run[clock] / case.n
        found[case][implementation] = min(time, found[case].get(implementation, math.inf))
    return found


def bodies(measured: dict[str, float], tier: str) -> list[float]:
    return [time for name, time in measured.items() if name.startswith(tier + "_")]


def ratio(time: float, measured: dict[str, float]) -> str:
    return f"{time / measured[REFERENCE]:.2f}"


def row(case: Case, measured: dict[str, float]) -> str:
    cells = [case.function, TYPES[case.type], str(case.n), f"{measured[REFERENCE]:.2f}"]
    cells += [" / ".join(ratio(time, measured) for time in bodies(measured, t)) for t in TIERS]
    cells += [ratio(measured[peer], measured) if peer in measured else "" for peer in PEERS]
    return "| " + " | ".join(cells) + " |"


def table(found: dict[Case, dict[str, float]], arguments: str) -> str:
    cases = sorted(
        (c for c, m in found.items() if c.arguments == arguments and REFERENCE in m),
        key=lambda c: (c.function, c.type != "s", c.n),
    )
    lines = [COLUMNS, "|" + "---|" * 9] + [row(case, found[case]) for case in cases]
    return "\n".join(lines) + "\n"


def geometric_means(found: dict[Case, dict[str, float]]) -> str:
    ratios: dict[tuple[int, str], list[float]] = defaultdict(list)
    for case, measured in found.items():
        if case.arguments != "ordinary" or REFERENCE not in measured:
            continue
        inherited: list[float] = []
        for tier in TIERS:
            inherited = bodies(measured, tier) or inherited
            for time in inherited:
                ratios[case.n, tier].append(time / measured[REFERENCE])
    lines = ["| n | " + " | ".join(f"`{t}`" for t in TIERS) + " | all | largest |", "|" + "---|" * 6]
    for n in sorted({n for n, _ in ratios}):
        of_tiers = [ratios[n, tier] for tier in TIERS]
        every = [value for values in of_tiers for value in values]
        cells = [f"{math.exp(sum(map(math.log, v)) / len(v)):.2f}" for v in (*of_tiers, every)]
        lines.append(f"| {n} | " + " | ".join(cells) + f" | {max(every):.2f} |")
    return "\n".join(lines) + "\n"


def draw_bars(rows: list[tuple[str, list[float]]], title: str, axis: str, path: Path) -> bool:
    """Three bars for the tiers of each row, if gnuplot is there."""
    if shutil.which("gnuplot") is None:
        return False
    data = "\n".join(f"{name} " + " ".join(f"{v:.3f}" for v in values) for name, values in rows)
    script = f"""$data << END
{data}
END
set terminal svg size {200 + 28 * len(rows)},420 font 'sans,11'
set output '{path}'
set title '{title}' noenhanced
set style data histogram
set style histogram clustered gap 1
set style fill solid 0.9
set xtics rotate by -60 noenhanced
set ylabel '{axis}'
set yrange [0:1.2]
set grid ytics
set key top right
plot $data using 2:xtic(1) title 'ha' lc rgb '#1b6ca8', $data using 3 title 'la' lc rgb '#5fa8d3', \\
  $data using 4 title 'ep' lc rgb '#b8d8ea'
"""
    subprocess.run(["gnuplot"], input=script, text=True, check=True)
    return True


def draw(found: dict[Case, dict[str, float]], title: str, path: Path) -> bool:
    """The ratios at the smaller n."""
    rows = []
    for case in sorted(found, key=lambda c: (c.function, c.type != "s")):
        measured = found[case]
        if case.arguments != "ordinary" or case.n != 4096 or REFERENCE not in measured:
            continue
        inherited: list[float] = []
        values = []
        for tier in TIERS:
            inherited = bodies(measured, tier)[:1] or inherited
            values.append(inherited[0] / measured[REFERENCE] if inherited else 0)
        rows.append((f"{case.function}_{case.type}", values))
    return draw_bars(rows, title, "time / time of SLEEF, 1 ulp", path)


def processor(path: Path) -> str:
    model = "unknown processor"
    for line in Path("/proc/cpuinfo").read_text().splitlines():
        if line.startswith("model name"):
            model = line.partition(":")[2].strip()
            break
    date = json.loads(path.read_text())["context"]["date"].partition("T")[0]
    return f"{model}, {date}"


def main() -> None:
    folder = Path(sys.argv[1])
    results = [Path(name) for name in sys.argv[2:]]
    text = HEADER + f"\n{processor(results[0])}.\n"
    for path in results:
        found = times(path)
        name = path.stem
        text += f"\n## {name}\n\nGeometric means of the ratios, ordinary arguments:\n\n"
        text += geometric_means(found)
        picture = folder / f"host_loop_{name}.svg"
        if draw(found, f"{name}, n = 4096", picture):
            text += f"\n![Ratios of times]({picture.name})\n"
        text += "\n### Ordinary arguments\n\n" + table(found, "ordinary")
        text += "\n### One argument in ten a zero, infinity, NaN, denormal or the largest number\n\n"
        text += table(found, "tenth_special")
        text += "\n### All arguments denormal\n\n" + table(found, "denormal")
        if any(case.arguments == "large" for case in found):
            text += "\n### Large arguments, to 1e38 at float and 1e300 at double\n\n"
            text += table(found, "large")
    (folder / "host_loop.md").write_text(text)


if __name__ == "__main__":
    main()
