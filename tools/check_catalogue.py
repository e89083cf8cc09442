# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Checks catalogue/functions.toml: its form, its totals, and its rows.

The signatures, the rows of the family tables and the names of the host kernels are kept here a
second time, in another notation than the registry's, so that a slip in either shows. Usage:

    python3 tools/check_catalogue.py [functions.toml]

Prints the totals, then every difference; the exit status is 1 if there is any.
"""

import re
import sys
import tomllib
from collections import Counter
from pathlib import Path

TIERS = ("ep", "la", "ha")
FORMS_PER_OVERLOAD_SET = 6
HOST_FORMS = 2  # linear and strided
SHAPES = {"v11", "v12", "v21", "v21c", "v31", "v61", "vc1", "vc2", "vi2c1"}
OUTPUTS = {"same", "real", "complex"}
FAMILIES = {
    "log", "exp", "pow", "root", "exact", "trig", "normal", "erf", "complex", "atrig", "hyper",
    "gamma", "bessel", "utility",
}
PARAMETERS = {
    "v11": ("a",), "v12": ("a",), "v21": ("a", "b"), "v21c": ("a", "b"), "v31": ("a", "b", "c"),
    "v61": ("a", "b", "scalea", "shifta", "scaleb", "shiftb"),
}
TWO_OUTPUTS = {"v12", "vc2"}
REQUIRED = {
    "name": str, "shape": str, "types": str, "output": str, "handler": bool, "family": str,
    "kernels": list, "host": list, "bodies": dict, "brief": str, "formula": str, "domain": str,
    "special": list, "accuracy": str, "source": str,
}
OPTIONAL = {"library": str, "range": str, "units": str, "utility": bool}
NOT_REQUIRED_OF_UTILITIES = {"source"}

KERNEL_ENTRY = re.compile(r"([sdhcz]): (.+)")
KERNEL_ITEM = re.compile(
    r"(gen|nolut|fp64only|nofp64)(_fp32cast)?(?:\(((?:ha|la|ep)(?:/(?:ha|la|ep))*)\))?")
HOST_ENTRY = re.compile(r"([sdcz]): (\w+)(?: \+ (\w+))?")
STATUS = ("success", "errdom", "sing", "overflow", "underflow")

TOTALS = {
    "public functions": 91,
    "public overloads": 1890,
    "utilities": 10,
    "utility overloads": 240,
    "families": 101,
    "rows": 1797,
    "functors": 897,
    "functions with functors": 89,
    "host kernel forms": 452,
}

FUNCTORS = {
    ("s", "gen"): 180, ("s", "fp64only"): 59, ("s", "nofp64"): 32, ("s", "nolut"): 10,
    ("d", "gen"): 236, ("d", "nolut"): 20,
    ("h", "gen_fp32cast"): 177, ("h", "fp64only_fp32cast"): 46, ("h", "nofp64_fp32cast"): 27,
    ("h", "nolut_fp32cast"): 6, ("h", "gen"): 30,
    ("c", "gen"): 36, ("c", "nolut"): 1,
    ("z", "gen"): 34, ("z", "nolut"): 3,
}

# Shape, input types, handler, names.
SIGNATURES = """
v11 hsd yes: expint1
v11 cz no: arg conj
v11 hsd no: atanpi cbrt ceil erf erfcx floor frac i0 i1 j0 j1 nearbyint pow2o3 rint round sqr trunc
v11 hsd no: y0 y1
v11 hsd yes: acospi asinpi cdfnorm cdfnorminv cosd cospi erfc erfcinv erfinv exp10 exp2 expm1 inv
v11 hsd yes: invcbrt invsqrt lgamma log1p log2 logb pow3o2 sind sinpi tand tanpi tgamma
v11 hsdcz no: abs asinh atan tanh
v11 hsdcz yes: acos acosh asin atanh cos cosh exp ln log10 sin sinh sqrt tan
v11 sd yes: cis
v12 hsd no: modf
v12 hsd yes: sincos sincospi
v21 cz yes: mulbyconj
v21 hsd no: atan2 atan2pi copysign fdim fmax fmin hypot maxmag minmag
v21 hsd yes: fmod nextafter powr remainder
v21 hsdcz yes: add div mul pow sub
v21c hsd no: jn
v21c hsd yes: yn
v21c hsdcz yes: powx
v61 hsd yes: linearfrac
v31 sdcz no: fma fmm faa
v11 sdcz no: copy1
v12 sdcz no: copy2
v21c sdcz no: compare
v21 sdcz no: compare2
vc1 sdcz no: assign
vc2 sdcz no: assign2
vi2c1 sdcz no: iota
"""

# Families, then the rows: feature, and per element type the tiers. `gen+` and the like are the
# rows of half whose functor computes in float, with the variant they are combined with.
ROWS = """
acospi asinpi atan2 cbrt ceil copysign erf erfcx fdim floor fmax fmin fmod inv maxmag minmag modf \
nearbyint pow2o3 pow3o2 remainder rint round sincospi sqr tanpi trunc \
| classic s:all d:all | gen s:all d:all | gen+ h:all
cdfnorm cdfnorminv cosd erfc erfcinv frac hypot invcbrt invsqrt sind tand \
| classic s:all d:all | gen d:all | fp64only s:all | fp64only+ h:all
i0 j0 j1 jn y0 y1 yn | classic s:all d:all | gen s:ep d:ep | gen+ h:all
assign assign2 copy1 faa fma fmm \
| classic s:all d:all c:all z:all | gen s:all d:all c:all z:all
compare compare2 copy2 iota | classic s:all d:all c:all z:all | gen s:all d:all
abs add sqrt sub | classic s:all d:all c:all z:all | gen s:all d:all c:all z:all | gen+ h:all
exp10 exp2 logb nextafter | classic s:all d:all | gen h:all s:all d:all
arg cis conj mulbyconj | classic c:all z:all | gen c:all z:all
acos acosh asin atanh | classic s:all d:all c:all z:all | gen s:all d:all | gen+ h:all
cospi sincos sinpi \
| classic s:all d:all | gen s:ep/la d:all | fp64only s:ha | nofp64 s:ep/la | gen+ h:all | nofp64+ h:all
asinh tan | classic s:all d:all c:all z:all \
| gen s:ep/la d:all | fp64only s:ha | nofp64 s:ep/la | gen+ h:all | nofp64+ h:all
cosh sinh | classic s:all d:all c:all z:all | gen s:ep/la d:all | fp64only s:ha | gen+ h:all
cos sin | classic s:all d:all c:all z:all | gen h:all s:ep/la d:all | fp64only s:ha | nofp64 s:ep/la
expint1 linearfrac | classic s:all d:all
tgamma | classic s:all d:all | gen d:ep/la | fp64only s:all | fp64only+ h:all
tanh | classic s:all d:all c:all z:all | gen s:all d:all | nofp64 s:all | gen+ h:all | nofp64+ h:all
powx | classic s:all d:all c:all z:all \
| gen d:all | nolut s:all d:all | fp64only s:all | nolut+ h:all | fp64only+ h:all
powr | classic s:all d:all | gen s:ep/la d:all | nolut s:la/ha d:all | fp64only s:ha | gen+ h:all
pow | classic s:all d:all c:all z:all \
| gen s:ep/la d:all | nolut s:la/ha d:all | fp64only s:ha | gen+ h:all
mul | classic s:all d:all c:all z:all \
| gen s:all d:all c:all z:all | nolut c:ha z:ha | gen+ h:all
log2 | classic s:all d:all \
| gen h:all s:ep/la d:all | nolut d:ep/la | fp64only s:ha | nofp64 s:ep/la
log1p | classic s:all d:all | gen s:all d:all | nolut d:all | gen+ h:all
log10 | classic s:all d:all c:all z:all \
| gen h:all s:ep/la d:all | nolut d:ep/la | fp64only s:ha | nofp64 s:ep/la
ln | classic s:all d:all c:all z:all \
| gen h:all s:all d:all c:all z:ep/la | nolut d:ep/la z:ha | nofp64 s:all
lgamma | classic s:all d:all | gen s:ep/la d:ep | fp64only s:ha | gen+ h:ep/la | fp64only+ h:ha
i1 | classic s:all d:all | gen s:ep d:ep | gen+ h:ep
expm1 | classic s:all d:all | gen s:all d:all | nofp64 s:all | gen+ h:all | nofp64+ h:all
exp | classic s:all d:all c:all z:all | gen h:all s:all d:all c:all z:ep/la | nolut d:la z:ha
erfinv | classic s:all d:all | gen d:all | nolut s:all | fp64only s:all | nolut+ h:all | fp64only+ h:all
div | classic s:all d:all c:all z:all \
| gen s:ep/la d:all c:all z:all | fp64only s:ha | nofp64 s:ep/la | gen+ h:all | nofp64+ h:all
atanpi | classic s:all d:all | gen s:all d:all | nofp64 s:ep/la | gen+ h:all | nofp64+ h:all
atan2pi | classic s:all d:all | gen s:la d:all | fp64only s:ep/ha | nofp64 s:la | fp64only+ h:all
atan | classic s:all d:all c:all z:all | gen s:all d:all | nolut d:la | gen+ h:all
"""

HOST_KERNELS = {
    "sd": """
    Abs Acos Acosh Acospi Add Asin Asinh Asinpi Atan Atan2 Atan2pi Atanh Atanpi Cbrt CdfNorm
    CdfNormInv Ceil CopySign Cos Cosd Cosh Cospi Div Erf ErfInv Erfc ErfcInv Erfcx Exp Exp10 Exp2
    ExpInt1 Expm1 Fdim Floor Fmax Fmin Fmod Frac Hypot I0 I1 Inv InvCbrt InvSqrt J0 J1 Jn LGamma
    LinearFrac Ln Log10 Log1p Log2 Logb MaxMag MinMag Modf Mul NearbyInt NextAfter Pow Pow2o3
    Pow3o2 Powr Powx Remainder Rint Round Sin SinCos Sind Sinh Sinpi Sqr Sqrt Sub TGamma Tan Tand
    Tanh Tanpi Trunc Y0 Y1 Yn
    """,
    "cz": """
    Abs Acos Acosh Add Arg Asin Asinh Atan Atanh CIS Conj Cos Cosh Div Exp Ln Log10 Mul MulByConj
    Pow Powx Sin Sinh Sqrt Sub Tan Tanh
    """,
}


class Problems:
    """Differences found so far, in the order of their discovery."""

    def __init__(self):
        self.texts = []

    def add(self, where, text):
        self.texts.append(f"{where}: {text}")


def expected_signatures():
    table = {}
    for line in SIGNATURES.strip().splitlines():
        head, names = line.split(":")
        shape, types, handler = head.split()
        for name in names.split():
            table[name] = (shape, types, handler == "yes")
    return table


def expected_rows():
    table = {}
    for line in ROWS.strip().splitlines():
        names, *columns = (part.strip() for part in line.split("|"))
        rows = set()
        for column in columns:
            feature, *cells = column.split()
            for cell in cells:
                element, tiers = cell.split(":")
                for tier in TIERS if tiers == "all" else tiers.split("/"):
                    rows.add((feature, element, tier))
        for name in names.split():
            table[name] = rows
    return table


def expected_host_kernels():
    return {(t, name) for types, names in HOST_KERNELS.items() for t in types for name in names.split()}


def parse_kernels(entries, where, problems):
    """The functors of an entry as a list of (type, label, tier); a label may end in _fp32cast."""
    functors = []
    seen_types = []
    for entry in entries:
        match = KERNEL_ENTRY.fullmatch(entry)
        if not match:
            problems.add(where, f"kernels: cannot read '{entry}'")
            continue
        element, items = match.groups()
        seen_types.append(element)
        for text in re.split(r", (?![^(]*\))", items):
            item = KERNEL_ITEM.fullmatch(text)
            if not item:
                problems.add(where, f"kernels: cannot read '{text}'")
                continue
            label, cast, tiers = item.groups()
            if cast and element != "h":
                problems.add(where, f"kernels: _fp32cast at '{element}'")
            for tier in tiers.split("/") if tiers else TIERS:
                functors.append((element, label + (cast or ""), tier))
    if len(set(seen_types)) != len(seen_types):
        problems.add(where, "kernels: an element type stands twice")
    if len(set(functors)) != len(functors):
        problems.add(where, "kernels: a functor stands twice")
    return functors


def parse_host(entries, where, problems):
    """The host entries as {type: [kernel names]}."""
    result = {}
    for entry in entries:
        match = HOST_ENTRY.fullmatch(entry)
        if not match:
            problems.add(where, f"host: cannot read '{entry}'")
            continue
        element, *names = match.groups()
        if element in result:
            problems.add(where, f"host: '{element}' stands twice")
        result[element] = [name for name in names if name]
    return result


def derived_rows(functors, host):
    rows = {("classic", element, tier) for element in host for tier in TIERS}
    for element, label, tier in functors:
        rows.add((label.replace("_fp32cast", "+"), element, tier))
    return rows


def check_text(entry, where, problems):
    """The documentation fields: sentences, operands, outputs, status names, accuracy."""
    for key in ("brief", "formula", "domain", "range", "units", "accuracy", "source"):
        text = entry.get(key)
        if text is not None and (not text or text != text.strip()):
            problems.add(where, f"{key}: empty, or blanks at its ends")
    if not re.fullmatch(r"[A-Z].*[^.]\.", entry["brief"]) or ". " in entry["brief"]:
        problems.add(where, "brief: not one sentence")
    for text in entry["special"]:
        if not isinstance(text, str) or not text or text.endswith((".", " ")):
            problems.add(where, f"special: '{text}'")
    words = set(re.findall(r"[A-Za-z0-9]+", entry["formula"]))
    for parameter in PARAMETERS.get(entry["shape"], ()):
        if parameter not in words:
            problems.add(where, f"formula: does not name {parameter}")
    outputs = ("y1", "y2") if entry["shape"] in TWO_OUTPUTS else ("y",)
    for output in outputs:
        if output not in words and entry["name"] != "fma":
            problems.add(where, f"formula: does not name {output}")
    if not re.match(r"(exact|tiers)(; .+)?$", entry["accuracy"]) and not entry.get("utility"):
        problems.add(where, "accuracy: starts with neither 'exact' nor 'tiers'")
    for text in entry["special"]:
        last = re.search(r": .*, (?:status )?([a-z]+)(?: \(not [a-z]+\))?$", text)
        if last and last[1] not in STATUS:
            problems.add(where, f"special: unknown status '{last[1]}'")


def check_form(entry, where, problems):
    utility = entry.get("utility", False)
    for key, kind in REQUIRED.items():
        if key not in entry:
            if not (utility and key in NOT_REQUIRED_OF_UTILITIES):
                problems.add(where, f"no {key}")
        elif not isinstance(entry[key], kind):
            problems.add(where, f"{key}: not of type {kind.__name__}")
    for key, value in entry.items():
        if key in OPTIONAL:
            if not isinstance(value, OPTIONAL[key]):
                problems.add(where, f"{key}: not of type {OPTIONAL[key].__name__}")
        elif key not in REQUIRED:
            problems.add(where, f"unknown field {key}")
    for key, allowed in (("shape", SHAPES), ("output", OUTPUTS), ("family", FAMILIES)):
        if entry[key] not in allowed:
            problems.add(where, f"{key}: unknown value '{entry[key]}'")
    if not re.fullmatch(r"h?s?d?c?z?", entry["types"]) or not entry["types"]:
        problems.add(where, f"types: '{entry['types']}'")
    if utility != (entry["family"] == "utility"):
        problems.add(where, "family utility and the mark utility do not agree")


def check_types(entry, functors, host, where, problems):
    """Rows stand at the type that answers a call: the complex one where it is output or input."""
    to_complex = {"s": "c", "d": "z"}
    served = set(entry["types"])
    if entry["output"] == "complex":
        served = {to_complex[t] for t in served}
    kernel_types = {element for element, _, _ in functors}
    if not kernel_types <= served:
        problems.add(where, f"kernels: types {kernel_types - served} are none of the function's")
    if set(host) != served - {"h"}:
        problems.add(where, f"host: types {sorted(host)}, expected {sorted(served - {'h'})}")
    for element in entry.get("library", ""):
        if element not in host:
            problems.add(where, f"library: no host kernel of type '{element}'")
        if any(key.split(".")[0] == element for key in entry["bodies"]):
            problems.add(where, f"library: type '{element}' has a body")
    for key in entry["bodies"]:
        element, *rest = key.split(".")
        if entry.get("utility") and element in host:
            continue  # serves the host, with or without kernels
        if not any(functor[0] == element and set(rest) <= set(functor[1:]) for functor in functors):
            problems.add(where, f"bodies: no functor for '{key}'")


def compare(what, got, expected, problems):
    if got != expected:
        problems.add(what, f"{got}, expected {expected}")


def compare_sets(where, got, expected, problems):
    for item in sorted(expected - got):
        problems.add(where, f"missing {item}")
    for item in sorted(got - expected):
        problems.add(where, f"too many {item}")


def check(path):
    problems = Problems()
    with open(path, "rb") as file:
        entries = tomllib.load(file)["function"]

    names = [entry.get("name") for entry in entries]
    if names != sorted(names):
        problems.add("order", "the entries are not in alphabetical order")
    for name in (name for name, count in Counter(names).items() if count > 1):
        problems.add(name, "stands more than once")

    signatures = expected_signatures()
    rows = expected_rows()
    compare_sets("names", set(names), set(signatures), problems)
    compare_sets("names of the row table", set(rows), set(signatures), problems)

    counts = Counter()
    functor_counts = Counter()
    host_kernels = set()
    for entry in entries:
        name = entry["name"]
        utility = entry.get("utility", False)
        before = len(problems.texts)
        check_form(entry, name, problems)
        if len(problems.texts) > before:
            continue
        check_text(entry, name, problems)
        functors = parse_kernels(entry["kernels"], name, problems)
        host = parse_host(entry["host"], name, problems)
        check_types(entry, functors, host, name, problems)
        if name in signatures:
            compare(f"{name}: signature", (entry["shape"], entry["types"], entry["handler"]),
                    signatures[name], problems)
            got = derived_rows(functors, host)
            compare_sets(f"{name}: rows", got, rows[name], problems)
            counts["rows"] += len(got)
        counts["families"] += 1
        overloads = FORMS_PER_OVERLOAD_SET * len(entry["types"])
        if utility:
            counts["utilities"] += 1
            counts["utility overloads"] += overloads
            if any(label != "gen" for _, label, _ in functors):
                problems.add(name, "kernels: a utility has gen rows only")
            if any(kernels != ["local"] for kernels in host.values()):
                problems.add(name, "host: the entries of a utility are local")
            continue
        counts["public functions"] += 1
        counts["public overloads"] += overloads
        counts["functors"] += len(functors)
        counts["functions with functors"] += bool(functors)
        functor_counts.update((element, label) for element, label, _ in functors)
        host_kernels.update((t, kernel) for t, kernels in host.items() for kernel in kernels)

    counts["host kernel forms"] = HOST_FORMS * len(host_kernels)
    compare_sets("host kernels", host_kernels, expected_host_kernels(), problems)
    for what, expected in TOTALS.items():
        compare(what, counts[what], expected, problems)
    for key in sorted(FUNCTORS.keys() | functor_counts.keys()):
        compare(f"functors at {key[0]}, {key[1]}", functor_counts[key], FUNCTORS.get(key, 0), problems)
    return counts, functor_counts, problems.texts


def main(arguments):
    default = Path(__file__).resolve().parent.parent / "catalogue" / "functions.toml"
    counts, functor_counts, problems = check(arguments[0] if arguments else default)
    for what in TOTALS:
        print(f"{counts[what]:6d} {what}")
    for (element, label), count in sorted(functor_counts.items()):
        print(f"{count:6d} functors at {element}, {label}")
    for problem in problems:
        print(f"check_catalogue: {problem}", file=sys.stderr)
    return 1 if problems else 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
