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
from statistics import median

REFERENCE = "sleef_u10"
TIERS = ("ha", "la", "ep")
EXPONENTIALS_AND_LOGARITHMS = {
    "exp", "exp2", "exp10", "expm1", "ln", "log2", "log10", "log1p",
}
REDUCED = ("_nolut", "_nofp64")
PEERS = ("sleef_u35", "libmvec")
TYPES = {"s": "float", "d": "double"}

HEADER = """# Speed of host loops

Each body in the loop that host kernels are made of, on one thread, beside the vector functions of
SLEEF and of the C library (libmvec) in the same run. SLEEF's functions of 1 ulp are the measure: their
time stands in nanoseconds per element, all else is the ratio of times to theirs, below 1 if faster. A
tier without a figure of its own has the body of the one on its left; a figure for a device without
tables or without double stands behind a slash where that is another body; means are over the bodies that host
kernels run, in the last column over all. Times are medians of the
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
    """Median time per element in ns, by case and implementation: a clock that moves between two
    speeds gives the least of a few repetitions to whoever met its fast moments."""
    found: dict[Case, dict[str, list[float]]] = defaultdict(lambda: defaultdict(list))
    for run in json.loads(path.read_text())["benchmarks"]:
        if run.get("run_type") == "aggregate":
            continue
        function, letter, implementation, arguments, n = run["name"].split("/")[:5]
        case = Case(function, letter, arguments, int(n))
        found[case][implementation].append(run[clock] / case.n)
    return {
        case: {name: median(runs) for name, runs in measured.items()}
        for case, measured in found.items()
    }


def bodies(measured: dict[str, float], tier: str, reduced: bool = True) -> list[float]:
    """Those of a tier, with or without the ones made for devices without tables or double."""
    return [
        time
        for name, time in measured.items()
        if name.startswith(tier + "_") and (reduced or not name.endswith(REDUCED))
    ]


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


def mean(values: list[float]) -> float:
    return math.exp(sum(map(math.log, values)) / len(values))


def ratios_by_tier(
    found: dict[Case, dict[str, float]], reduced: bool
) -> dict[tuple[int, str], list[float]]:
    ratios: dict[tuple[int, str], list[float]] = defaultdict(list)
    for case, measured in found.items():
        if case.arguments != "ordinary" or REFERENCE not in measured:
            continue
        inherited: list[float] = []
        for tier in TIERS:
            inherited = bodies(measured, tier, reduced) or inherited
            ratios[case.n, tier] += [time / measured[REFERENCE] for time in inherited]
    return ratios


def geometric_means(found: dict[Case, dict[str, float]]) -> str:
    host, every = ratios_by_tier(found, False), ratios_by_tier(found, True)
    lines = [
        "| n | " + " | ".join(f"`{t}`" for t in TIERS) + " | all | largest | with reduced bodies |",
        "|" + "---|" * 7,
    ]
    for n in sorted({n for n, _ in host}):
        all_host = [value for tier in TIERS for value in host[n, tier]]
        with_reduced = [value for tier in TIERS for value in every[n, tier]]
        cells = [f"{mean(host[n, tier]):.2f}" for tier in TIERS]
        cells += [f"{mean(all_host):.2f}", f"{max(all_host):.2f}", f"{mean(with_reduced):.2f}"]
        lines.append(f"| {n} | " + " | ".join(cells) + " |")
    return "\n".join(lines) + "\n"


def of_family(found: dict[Case, dict[str, float]], functions: set[str]) -> dict:
    return {case: measured for case, measured in found.items() if case.function in functions}


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
        text += "\nThe same for exponentials and logarithms alone:\n\n"
        text += geometric_means(of_family(found, EXPONENTIALS_AND_LOGARITHMS))
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
