# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""processes_test.py PROBE SERVICES MODULE COMPILER: how a process finds the array-math module, and
which of its kernels it runs."""

from __future__ import annotations

import os
import shutil
import subprocess
import sys
import tempfile
import unittest
from pathlib import Path

PROBE, SERVICES, MODULE, COMPILER = (Path(argument) for argument in sys.argv[1:5])
TYPE_VARIABLE = "LUMEN_ARR_DEBUG_CPU_TYPE"


def run(folder: Path | None = None, **environment: str) -> subprocess.CompletedProcess[str]:
    """The probe, with the services of `folder` if one is given."""
    inherited = {k: v for k, v in os.environ.items() if k != TYPE_VARIABLE}
    if folder is not None:
        environment["LD_LIBRARY_PATH"] = str(folder)
    return subprocess.run(
        [PROBE], env=inherited | environment, capture_output=True, text=True, check=False
    )


def type_and_index(text: str) -> tuple[int, int]:
    first, second = text.split("\n", 1)[0].split()
    return int(first), int(second)


class ProcessorType(unittest.TestCase):
    def setUp(self) -> None:
        self.own = run()
        self.assertEqual(self.own.returncode, 0, self.own.stderr)
        self.own_type, self.own_index = type_and_index(self.own.stdout)

    def forced(self, value: str) -> tuple[int, int]:
        result = run(**{TYPE_VARIABLE: value})
        self.assertEqual(result.returncode, 0, result.stderr)
        return type_and_index(result.stdout)

    def test_a_number_below_ten_forces_a_type(self) -> None:
        for value in (0, 1, 2, 3, 4, 5, 6, 7, 9):
            self.assertEqual(self.forced(str(value))[0], value)
        self.assertEqual(self.forced("05")[0], 5)
        self.assertEqual(self.forced("3x")[0], 3, "one digit is taken")
        self.assertEqual(self.forced("345")[0], 3, "two digits only of a text of two")

    def test_anything_else_leaves_the_detected_type(self) -> None:
        for value in ("8", "08", "10", "99", "x3", "-1", " 3", ""):
            self.assertEqual(self.forced(value)[0], self.own_type, value)

    def test_every_class_gives_the_same_bits(self) -> None:
        bits = self.own.stdout.split("\n", 1)[1]
        indices = set()
        for value in (0, 3, 5):
            result = run(**{TYPE_VARIABLE: str(value)})
            indices.add(type_and_index(result.stdout)[1])
            self.assertEqual(result.stdout.split("\n", 1)[1], bits)
        self.assertEqual(indices, set(range(self.own_index + 1)))

    def test_a_type_that_the_machine_is_not_of_is_warned_of_once(self) -> None:
        result = run(**{TYPE_VARIABLE: "9"})
        self.assertEqual(type_and_index(result.stdout)[1], self.own_index)
        lines = result.stderr.splitlines()
        self.assertEqual(len(lines), 0 if self.own_index == 2 else 1)


class Module(unittest.TestCase):
    def setUp(self) -> None:
        self.folder = Path(tempfile.mkdtemp())
        self.addCleanup(shutil.rmtree, self.folder)
        shutil.copy(SERVICES, self.folder)

    def test_it_is_found_beside_the_services(self) -> None:
        shutil.copy(MODULE, self.folder)
        result = run(self.folder)
        self.assertEqual((result.returncode, result.stderr), (0, ""))
        self.assertEqual(result.stdout, run().stdout)

    def test_without_it_the_process_ends(self) -> None:
        result = run(self.folder)
        self.assertEqual(result.returncode, 2)
        self.assertEqual(result.stdout, "")
        self.assertRegex(result.stderr, r"^arbor lumen: cannot load liblumen_arr\.so: .+\n$")

    def test_without_a_symbol_the_process_ends(self) -> None:
        source = self.folder / "empty.cpp"
        source.write_text(
            'extern "C" int lumen_arr_kernel_GetTTableIndex(int) { return 0; }\n', "utf-8"
        )
        command = [COMPILER, "-shared", "-fPIC", source, "-o", self.folder / MODULE.name]
        subprocess.run(command, check=True)
        result = run(self.folder)
        self.assertEqual(result.returncode, 2)
        self.assertEqual(
            result.stderr,
            "arbor lumen: liblumen_arr.so has no symbol lumen_arr_kernel_dExp_ttab\n",
        )


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
