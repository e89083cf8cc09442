# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""The printed catalogue against the file it comes from, named by LUMEN_CATALOGUE."""

import os
import tomllib
import unittest

from tool import lumen_vm

REAL_OF = {"c": "s", "z": "d"}
COMPLEX_OF = {"s": "c", "d": "z"}


def catalogue() -> dict[str, dict]:
    with open(os.environ["LUMEN_CATALOGUE"], "rb") as file:
        functions = tomllib.load(file)["function"]
    return {f["name"]: f for f in functions if not f.get("utility", False)}


def types_of(function: dict) -> list[str]:
    mapped = {"same": {}, "real": REAL_OF, "complex": COMPLEX_OF}[function["output"]]
    return [f"{t}>{mapped[t]}" if t in mapped else t for t in function["types"]]


class Functions(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.answer = lumen_vm("functions")
        cls.rows = [line.split() for line in cls.answer.lines[1:-1]]

    def test_succeeds(self):
        self.assertEqual((self.answer.code, self.answer.err), (0, ""))

    def test_names_in_order(self):
        self.assertEqual([row[0] for row in self.rows], sorted(catalogue()))

    def test_shape_types_and_handler(self):
        entries = catalogue()
        for name, shape, *types, handler, _present, of, _full in self.rows:
            with self.subTest(name=name):
                entry = entries[name]
                self.assertEqual(shape, entry["shape"])
                self.assertEqual(types, types_of(entry))
                self.assertEqual(handler, "yes" if entry["handler"] else "no")
                self.assertEqual(of, "of")

    def test_total(self):
        present = sum(int(row[-3]) for row in self.rows)
        full = sum(int(row[-1]) for row in self.rows)
        self.assertEqual(len(self.rows), 91)
        self.assertEqual(
            self.answer.lines[-1], f"total: {len(self.rows)} functions, {present} of {full} rows"
        )

    def test_no_family_has_more_rows_than_the_catalogue(self):
        for row in self.rows:
            self.assertLessEqual(int(row[-3]), int(row[-1]), row[0])

    def test_columns_are_aligned(self):
        ends = {len(line) for line in self.answer.lines[1:-1]}
        self.assertEqual(len(ends), 1)


if __name__ == "__main__":
    unittest.main()
