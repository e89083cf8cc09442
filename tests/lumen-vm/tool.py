# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Runs lumen-vm, named by the environment variable LUMEN_VM, and takes its answers apart."""

from __future__ import annotations

import functools
import os
import struct
import subprocess
import unittest
from dataclasses import dataclass

CPU = "cpu"
GPU = "gpu,vendor=51a7"
GPU_WITHOUT_DOUBLE = "gpu,vendor=51a7,fp64=0"


@dataclass
class Answer:
    code: int
    out: str
    err: str

    @property
    def lines(self) -> list[str]:
        return self.out.splitlines()

    @property
    def rows(self) -> list[list[str]]:
        """The columns of the lines that are neither empty nor comments."""
        return [line.split() for line in self.lines if line and not line.startswith("#")]

    def field(self, name: str) -> str:
        """What stands behind the name at the beginning of a line."""
        for line in self.lines:
            if line.startswith(name + " "):
                return line.removeprefix(name).strip()
        raise KeyError(f"{name} in {self.out!r}")


def lumen_vm(*arguments: str, devices: str = CPU, text: str | bytes = b"") -> Answer:
    """Runs the tool beside simulated devices with `text` as standard input."""
    environment = {**os.environ, "LUMEN_SYCL_DEVICES": devices, "LC_ALL": "C"}
    done = subprocess.run(
        [os.environ["LUMEN_VM"], *arguments],
        input=text.encode() if isinstance(text, str) else text,
        capture_output=True,
        env=environment,
        timeout=120,
    )
    return Answer(done.returncode, done.stdout.decode(), done.stderr.decode())


@functools.cache
def _incomplete() -> frozenset[str]:
    """The functions that lack rows of the catalogue."""
    names = set()
    for line in lumen_vm("functions").lines[1:-1]:
        name, rows = line.split()[0], line.split()[-3:]
        if rows[0] != rows[2]:
            names.add(name)
    return frozenset(names)


def needs_rows(*names: str):
    """Skips a test where the library does not have all rows of these functions yet."""

    def decorate(test):
        @functools.wraps(test)
        def checked(self: unittest.TestCase):
            missing = [name for name in names if name in _incomplete()]
            if missing:
                self.skipTest(f"rows are missing: {', '.join(missing)}")
            test(self)

        return checked

    return decorate


def float_bits(value: float) -> str:
    return f"0x{struct.unpack('<I', struct.pack('<f', value))[0]:08x}"


def double_bits(value: float) -> str:
    return f"0x{struct.unpack('<Q', struct.pack('<d', value))[0]:016x}"
