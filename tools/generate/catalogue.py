# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""The registry of functions as the generators see it."""

from __future__ import annotations

import re
import tomllib
from dataclasses import dataclass, field
from pathlib import Path

TIERS = ("ha", "la", "ep")
LABELS = ("gen", "nolut", "nofp64", "fp64only")

ELEMENT_TYPES = {
    "h": "sycl::half",
    "s": "float",
    "d": "double",
    "c": "std::complex<float>",
    "z": "std::complex<double>",
}
ELEMENT_NAMES = {
    "h": "half",
    "s": "float",
    "d": "double",
    "c": "complex of float",
    "z": "complex of double",
}
REAL_OF = {"c": "s", "z": "d"}
COMPLEX_OF = {"s": "c", "d": "z"}

PRECISION_KEYS = {"h": 0x1, "s": 0x4, "d": 0x8, "c": 0x10, "z": 0x18}
FEATURE_KEYS = {"gen": 0x100, "nofp64": 0x200, "nolut": 0x400, "fp64only": 0x800, "classic": 0x8000}
FP32CAST_KEY = 0x1000
ACCURACY_KEYS = {"ha": 4, "la": 2, "ep": 1}
GPU_KEY = 0x20
CPU_KEY = 0x10


class CatalogueError(Exception):
    """A defect of the registry, named by function and field."""


@dataclass(frozen=True)
class Parameter:
    """An operand of a public function: an input array, a constant or an output array."""

    name: str
    kind: str  # "in", "constant" or "out"


def _parameters(inputs: str, constants: str, outputs: str) -> tuple[Parameter, ...]:
    kinds = (("in", inputs), ("constant", constants), ("out", outputs))
    return tuple(Parameter(name, kind) for kind, names in kinds for name in names.split())


SHAPES = {
    "v11": _parameters("a", "", "y"),
    "v12": _parameters("a", "", "y1 y2"),
    "v21": _parameters("a b", "", "y"),
    "v21c": _parameters("a", "b", "y"),
    "v31": _parameters("a b c", "", "y"),
    "v61": _parameters("a b", "scalea shifta scaleb shiftb", "y"),
    "vc1": _parameters("", "c", "y"),
    "vc2": _parameters("", "c", "y1 y2"),
    "vi2c1": _parameters("", "start step", "y"),
}


@dataclass(frozen=True)
class Functor:
    """One entry of the device catalogue: a scalar routine of a type, a tier and a label. Functors
    of utilities have neither tier nor label, and serve every tier."""

    function: str
    type: str
    tier: str | None
    label: str | None
    cast: bool
    body: str | None  # the C++ type that does it; None where no body exists yet
    on_device: bool = True  # whether it has rows of its own, beside those of the host

    @property
    def name(self) -> str:
        if self.tier is None:
            return f"{self.function}_{self.type}"
        cast = "_fp32cast" if self.cast else ""
        return f"{self.function}_{self.type}_{self.tier}_{self.label}{cast}"

    @property
    def keys(self) -> list[int]:
        """The keys of the device rows that run it."""
        if not self.on_device:
            return []
        feature = FEATURE_KEYS[self.label or "gen"] | (FP32CAST_KEY if self.cast else 0)
        partial = (PRECISION_KEYS[self.type] << 32) | feature | GPU_KEY
        return [partial | ACCURACY_KEYS[tier] for tier in ([self.tier] if self.tier else TIERS)]

    @property
    def needs_fp64(self) -> bool:
        return self.type in "dz" or self.label == "fp64only"


@dataclass(frozen=True)
class HostRow:
    """One host implementation of a function: an element type at a tier."""

    type: str
    tier: str
    kernel: str

    @property
    def key(self) -> int:
        precision = PRECISION_KEYS[self.type] << 32
        return precision | FEATURE_KEYS["classic"] | CPU_KEY | ACCURACY_KEYS[self.tier]


@dataclass
class Function:
    """One public function with all its element types."""

    name: str
    shape: str
    types: str
    output: str
    handler: bool
    family: str
    brief: str
    formula: str
    domain: str
    accuracy: str
    source: str = ""
    range: str = ""
    units: str = ""
    special: list[str] = field(default_factory=list)
    utility: bool = False
    library: str = ""
    functors: list[Functor] = field(default_factory=list)
    host_rows: list[HostRow] = field(default_factory=list)

    @property
    def parameters(self) -> tuple[Parameter, ...]:
        return SHAPES[self.shape]

    @property
    def namespace(self) -> str:
        """Where the overloads live."""
        return "arbor::lumen::vm::detail" if self.utility else "arbor::lumen::vm"

    @property
    def public_header(self) -> str:
        folder = "utilities" if self.utility else "functions"
        return f"arbor/lumen/vm/{folder}/{self.name}.hpp"

    def output_letter(self, letter: str) -> str:
        """The element type of the outputs of the overload with inputs of type `letter`."""
        if self.output == "real":
            return REAL_OF.get(letter, letter)
        if self.output == "complex":
            return COMPLEX_OF.get(letter, letter)
        return letter

    def input_letter(self, letter: str) -> str:
        """The element type of the inputs of the rows of precision `letter`."""
        return REAL_OF.get(letter, letter) if self.output == "complex" else letter

    @property
    def has_bodies(self) -> bool:
        return any(functor.body for functor in self.functors)

    def compiled_functors(self) -> dict[str, str]:
        """For each functor the one whose code it runs: functors with one body share the code of the
        first of them, unless they ask different things of a device."""
        first: dict[tuple[str, str, bool], str] = {}
        return {
            functor.name: first.setdefault(
                (functor.type, functor.body, functor.needs_fp64), functor.name
            )
            for functor in self.functors
            if functor.body
        }

    def header_of(self, functor: Functor) -> str:
        """The file that holds the functor's body, relative to src/."""
        folder = "complex" if functor.type in "cz" and not self.utility else self.family
        return f"scalar/{folder}/{self.name}.hpp"

    def host_functor(self, row: HostRow) -> Functor | None:
        """The functor whose body serves a host row: the form for a device with full support."""
        for label in ("gen", "fp64only", "nolut"):
            for functor in self.functors:
                serves = functor.tier in (row.tier, None) and functor.label in (label, None)
                if functor.type == row.type and serves and functor.body:
                    return functor
        return None


_ENTRY = re.compile(r"^(?P<label>[a-z0-9]+)(?P<cast>_fp32cast)?(?:\((?P<tiers>[a-z/]+)\))?$")


def _functors(name: str, kernels: list[str], bodies: dict[str, str]) -> list[Functor]:
    functors = []
    for line in kernels:
        letter, _, entries = line.partition(":")
        letter = letter.strip()
        for entry in entries.split(","):
            match = _ENTRY.match(entry.strip())
            if match is None or match["label"] not in LABELS or letter not in ELEMENT_TYPES:
                raise CatalogueError(f"{name}: kernels: cannot read {entry.strip()!r} of {line!r}")
            tiers = match["tiers"].split("/") if match["tiers"] else TIERS
            for tier in TIERS:
                if tier in tiers:
                    label, cast = match["label"], match["cast"] is not None
                    body = _body(bodies, letter, label + ("_fp32cast" if cast else ""), tier)
                    functors.append(Functor(name, letter, tier, label, cast, body))
    return functors


def _utility_functors(
    name: str, kernels: list[str], host: list[str], bodies: dict[str, str]
) -> list[Functor]:
    letters = {line.partition(":")[0].strip() for line in kernels}
    return [
        Functor(name, letter, None, None, False, bodies.get(letter), on_device=letter in letters)
        for letter in (line.partition(":")[0].strip() for line in host)
    ]


def _body(bodies: dict[str, str], letter: str, label: str, tier: str) -> str | None:
    """The most specific body that the registry names for a functor."""
    for selector in (f"{letter}.{label}.{tier}", f"{letter}.{label}", f"{letter}.{tier}", letter):
        if selector in bodies:
            return bodies[selector].replace("{tier}", tier)
    return None


def _check_bodies(name: str, bodies: dict[str, str], kernels: list[str]) -> None:
    letters = {line.partition(":")[0].strip() for line in kernels}
    for selector in bodies:
        parts = selector.split(".")
        plain = {part.removesuffix("_fp32cast") for part in parts[1:]}
        if parts[0] not in letters or not plain <= set(TIERS) | set(LABELS):
            raise CatalogueError(f"{name}: bodies: {selector!r} selects no functor")


def _host_rows(name: str, host: list[str]) -> list[HostRow]:
    rows = []
    for line in host:
        letter, _, kernel = (part.strip() for part in line.partition(":"))
        if letter not in ELEMENT_TYPES or not kernel:
            raise CatalogueError(f"{name}: host: cannot read {line!r}")
        rows.extend(HostRow(letter, tier, kernel) for tier in TIERS)
    return rows


def load(path: Path) -> list[Function]:
    """Reads the registry. Raises CatalogueError, naming the entry, where it makes no sense."""
    with path.open("rb") as file:
        entries = tomllib.load(file)["function"]
    functions = []
    known = set(Function.__dataclass_fields__) - {"functors", "host_rows"}
    for entry in entries:
        name = entry.get("name", "(an entry without a name)")
        kernels, host = entry.pop("kernels", []), entry.pop("host", [])
        bodies = entry.pop("bodies", {})
        unknown = set(entry) - known
        if unknown:
            raise CatalogueError(f"{name}: unknown fields {sorted(unknown)}")
        try:
            function = Function(**entry)
        except TypeError as error:
            raise CatalogueError(f"{name}: {error}") from error
        if function.shape not in SHAPES:
            raise CatalogueError(f"{name}: unknown shape {function.shape!r}")
        if function.utility:
            _check_bodies(name, bodies, host)
            function.functors = _utility_functors(name, kernels, host, bodies)
        else:
            _check_bodies(name, bodies, kernels)
            function.functors = _functors(name, kernels, bodies)
        function.host_rows = _host_rows(name, host)
        functions.append(function)
    names = [function.name for function in functions]
    if names != sorted(set(names)):
        raise CatalogueError("entries are not in alphabetical order, or one stands twice")
    return functions
