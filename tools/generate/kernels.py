# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""The kernels of the array-math module: their definitions per class of processors, their tables,
and the wrappers through which the library's host rows reach them."""

from __future__ import annotations

from dataclasses import dataclass

from catalogue import ELEMENT_TYPES, TIERS, Function, HostRow, Parameter
from output import Output

# About the nanoseconds for one element, float and double; the threading layer weighs them.
_COST = {
    "exact": (0.25, 0.5),
    "exp": (0.4, 1.0),
    "log": (0.5, 1.3),
    "root": (0.4, 1.0),
    "trig": (0.7, 1.5),
    "atrig": (0.7, 2.5),
    "pow": (1.5, 4.0),
}
_COST_OF_COMPLEX = 4.0
_COST_OF_LIBRARY = 80.0


@dataclass(frozen=True)
class Kernel:
    """One entry of the module: an element type of a function."""

    function: Function
    letter: str
    base: str  # the function's name in the module
    functors: tuple[str, ...] | None  # for ha, la, ep; None for a pair of other kernels
    from_library: bool

    @property
    def name(self) -> str:
        return self.letter + self.base

    @property
    def input_letter(self) -> str:
        return self.function.input_letter(self.letter)

    @property
    def output_letter(self) -> str:
        return self.function.output_letter(self.input_letter)

    @property
    def pair(self) -> list[str]:
        """The two kernels that a row runs in place of one of its own; else empty."""
        bases = self.base.split(" + ")
        return [self.letter + base for base in bases] if len(bases) == 2 else []

    @property
    def wrapper(self) -> str:
        """What reaches it through the binding, for messages."""
        return " + ".join("v" + name for name in self.pair or [self.name])

    @property
    def entries(self) -> str:
        """The wrappers without and with increments, as template arguments."""
        wrappers = [f"&cpu::binding::v{name}" for name in self.pair or [self.name]]
        with_increments = [wrapper + "I" for wrapper in wrappers]
        if not self.pair:
            return f"{wrappers[0]}, {with_increments[0]}"
        element = ELEMENT_TYPES[self.letter]
        both = f"&cpu::norvane::both<{element}, {', '.join(wrappers)}>"
        strided = f"&cpu::norvane::both_strided<{element}, {', '.join(with_increments)}>"
        return f"{both}, {strided}"

    @property
    def threader(self) -> tuple[str, str]:
        """The forms of the threading layer that run it, without and with increments."""
        t, u = self.input_letter, self.output_letter
        forms = {
            "v11": (f"{t}_1i_1o", f"{t}_1iI_1oI"),
            "v12": (f"{t}_1i_2o", f"{t}_1iI_2oI"),
            "v21": (f"{t}_2i_1o", f"{t}_2iI_1oI"),
            "v21c": (f"{t}_c{t}_2i_{t}_1o", f"{t}_c{t}_2iI_{t}_1oI"),
            "v61": (f"{t}_6i_1o", f"{t}_6iI_1oI"),
        }
        if t != u:
            forms["v11"] = (f"{t}_1i_{u}_1o", f"{t}_1iI_{u}_1oI")
        return forms[self.function.shape]

    @property
    def cost(self) -> float:
        if self.from_library:
            return _COST_OF_LIBRARY
        if self.letter in "cz":
            return _COST_OF_COMPLEX
        return _COST[self.function.family]["sd".index(self.letter)]

    def type_of(self, parameter: Parameter) -> str:
        if parameter.kind == "in":
            return f"const {ELEMENT_TYPES[self.input_letter]}*"
        if parameter.kind == "constant":
            return ELEMENT_TYPES[self.input_letter]
        return f"{ELEMENT_TYPES[self.output_letter]}*"

    def parameters(self, strided: bool) -> str:
        """The operands as a list of parameters."""
        text = ""
        for parameter in self.function.parameters:
            text += f", {self.type_of(parameter)} {parameter.name}"
            if strided and parameter.kind != "constant":
                text += f", std::int64_t inc{parameter.name}"
        return text

    def arguments(self, strided: bool) -> str:
        text = ""
        for parameter in self.function.parameters:
            text += f", {parameter.name}"
            if strided and parameter.kind != "constant":
                text += f", inc{parameter.name}"
        return text

    def operands(self) -> str:
        """The operands as an initializer of `arguments`."""
        return "{" + ", ".join(
            "{" + ", ".join(p.name for p in self.function.parameters if p.kind == kind) + "}"
            for kind in ("in", "constant", "out")
        ) + "}"

    def increments(self) -> str:
        return "{" + ", ".join(
            "{" + ", ".join(f"inc{p.name}" for p in self.function.parameters if p.kind == kind) + "}"
            for kind in ("in", "out")
        ) + "}"

    def definition(self) -> str:
        text = f"using {self.name} = kernel<shape::{self.function.shape}, {', '.join(self.functors)}>;\n"
        text += f'extern "C" void LUMEN_ARR_KERNEL({self.name})(std::int32_t n{self.parameters(False)}) {{\n'
        text += f"  {self.name}::linear(n, {self.operands()});\n}}\n"
        text += f'extern "C" void LUMEN_ARR_KERNEL({self.name}I)(std::int32_t n{self.parameters(True)}) {{\n'
        text += f"  {self.name}::strided(n, {self.operands()}, {self.increments()});\n}}\n"
        return text


def _functors(function: Function, letter: str, rows: list[HostRow]) -> tuple[str, ...] | None:
    """For each tier the functor of a kernel; None where one of them has no body yet."""
    of_tiers = {row.tier: function.host_functor(row) for row in rows if row.type == letter}
    if any(of_tiers[tier] is None for tier in TIERS):
        return None
    compiled = function.compiled_functors()
    return tuple(f"scalar::{compiled[of_tiers[tier].name]}" for tier in TIERS)


def kernels_of(function: Function) -> list[Kernel]:
    """What serves the host rows of one function, as far as it exists."""
    if function.utility:
        return []
    kernels = []
    for letter, base in dict.fromkeys((row.type, row.kernel) for row in function.host_rows):
        functors = _functors(function, letter, function.host_rows)
        from_library = letter in function.library
        if from_library:
            element = ELEMENT_TYPES[function.input_letter(letter)]
            functors = (f"library::{function.name}<{element}>",) * len(TIERS)
        if functors is not None or "+" in base:
            kernels.append(Kernel(function, letter, base, functors, from_library))
    return kernels


def has_rows(function: Function) -> bool:
    """Whether anything can run the function."""
    return function.has_bodies or bool(kernels_of(function))


def _unit(kernels: list[Kernel], include: str, using: str) -> str:
    text = f'#include "module/kernel.hpp"\n#include "{include}"\n\n'
    text += f"namespace arbor::lumen::arr {{\n\n{using}\n"
    definitions = "\n".join(kernel.definition() for kernel in kernels)
    return text + definitions + "\n}  // namespace arbor::lumen::arr\n"


def _tables(kernels: list[Kernel]) -> str:
    text = '#include "module/tables.hpp"\n\n'
    for kernel in kernels:
        for name in (kernel.name, kernel.name + "I"):
            define = "LUMEN_ARR_TABLE_OF_ANY" if kernel.from_library else "LUMEN_ARR_TABLE"
            text += f"{define}({name}, {kernel.cost}f)\n"
    return text


def _list(kernels: list[Kernel]) -> str:
    """Every kernel with its coordinates, for the tests."""
    rows = [
        f"  M({k.name}, {k.function.shape}, {k.input_letter}, {k.output_letter},"
        f" {', '.join(functor.removeprefix('scalar::') for functor in k.functors)})"
        for k in kernels
        if not k.from_library
    ]
    text = "#pragma once\n\n/// M(name, shape, input letter, output letter, functors of ha, la and ep)"
    text += " for every kernel that is\n/// made of functors.\n"
    return text + "#define LUMEN_KERNELS(M) \\\n" + " \\\n".join(rows) + "\n"


def _declarations(kernels: list[Kernel]) -> str:
    text = "#pragma once\n\n#include <complex>\n#include <cstdint>\n\n"
    text += "/// One wrapper per kernel of the array-math module and form.\n"
    text += "namespace arbor::lumen::vm::detail::cpu::binding {\n\n"
    for kernel in kernels:
        for suffix, strided in (("", False), ("I", True)):
            text += f"void v{kernel.name}{suffix}(std::int64_t n{kernel.parameters(strided)},"
            text += " std::int64_t mode);\n"
    return text + "\n}  // namespace arbor::lumen::vm::detail::cpu::binding\n"


def _wrappers(kernels: list[Kernel]) -> str:
    text = '#include "host/kernels.hpp"\n\n#include "host/kernel_binding.hpp"\n\n'
    text += "namespace arbor::lumen::vm::detail::cpu::binding {\n\n"
    for kernel in kernels:
        for suffix, strided in (("", False), ("I", True)):
            name = kernel.name + suffix
            text += f"void v{name}(std::int64_t n{kernel.parameters(strided)}, std::int64_t mode) {{\n"
            text += f'  static kernel_binding binding{{"v{name}", "lumen_arr_kernel_{name}_ttab",'
            text += f' "lumen_arr_kernel_{name}_ctab"}};\n'
            text += f"  run(binding, &lumen_arr_serv_threader_{kernel.threader[strided]}, n, mode"
            text += f"{kernel.arguments(strided)});\n}}\n"
    return text + "\n}  // namespace arbor::lumen::vm::detail::cpu::binding\n"


def generate(functions: list[Function], output: Output) -> None:
    kernels = []
    for function in functions:
        of_function = [kernel for kernel in kernels_of(function) if not kernel.pair]
        kernels += of_function
        own = [kernel for kernel in of_function if not kernel.from_library]
        if own:
            using = "namespace scalar = vm::detail::gpu::norvane::scalar;\n"
            include = f"scalar/generated/{function.name}.hpp"
            output.cpp(f"arrmath/kernels/{function.name}.cpp", _unit(own, include, using))
    library = [kernel for kernel in kernels if kernel.from_library]
    using = "namespace library = vm::detail::library;\n"
    output.cpp("arrmath/library_kernels.cpp", _unit(library, "library/functions.hpp", using))
    output.cpp("arrmath/tables.cpp", _tables(kernels))
    output.cpp("tests/kernel_list.hpp", _list(kernels))
    output.cpp("src/host/kernels.hpp", _declarations(kernels))
    output.cpp("src/host/kernels.cpp", _wrappers(kernels))
