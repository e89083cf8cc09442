# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""The demo on the real table of cities, and on files that it cannot use.

Takes the folder of the programs from the environment variable EXAMPLES_FOLDER.
"""

import os
import re
import subprocess
import tempfile
import unittest
from pathlib import Path

GOOD = "AD\t+4230+00131\tEurope/Andorra\n"


def run(*arguments, devices="cpu;gpu,vendor=51a7,id=1d30"):
    return subprocess.run(
        [Path(os.environ["EXAMPLES_FOLDER"]) / "timezones", *arguments],
        env=os.environ | {"LUMEN_SYCL_DEVICES": devices},
        capture_output=True,
        text=True,
        timeout=300,
    )


class Timezones(unittest.TestCase):
    def test_computes_on_every_device(self):
        result = run()
        self.assertEqual("", result.stderr)
        self.assertEqual(0, result.returncode)
        self.assertEqual(2, result.stdout.count("equal to plain C++ bit by bit"))
        rows = re.findall(r"^Europe/Andorra.*$", result.stdout, re.MULTILINE)
        self.assertEqual(2, len(rows))
        self.assertEqual(rows[0], rows[1])
        self.assertIn("42° 30' 00.0\" N", rows[0])
        # Both devices name the same pairs, whichever of the two cities comes first.
        for what in ("closest", "farthest"):
            pairs = re.findall(rf"^  {what} +(\S+) and (\S+), ([\d.]+) km$", result.stdout, re.MULTILINE)
            self.assertEqual(2, len(pairs))
            self.assertEqual(pairs[0], pairs[1])
        self.assertGreater(float(pairs[0][2]), 19900)  # half the earth's circumference is 20015 km

    def test_prints_every_city_on_request(self):
        self.assertIn("\nEurope/Paris ", run("--all", devices="cpu").stdout)

    def test_says_what_is_wrong_with_a_file(self):
        with tempfile.TemporaryDirectory() as folder:
            path = Path(folder) / "cities.tab"
            for text, message in (
                (None, f"cannot open {path}"),
                ("# nothing\n", f"{path}: no zones in this file"),
                (GOOD + "FR\t+4852\tEurope/Paris\n", f"{path}:2: expected codes, coordinates"),
                (GOOD + "FR\t+4852+00220\n", f"{path}:2: expected codes, coordinates"),
                ("FR\t+9952+00220\tEurope/Paris\n", f"{path}:1: expected codes, coordinates"),
            ):
                with self.subTest(message=message):
                    if text is not None:
                        path.write_text(text)
                    result = run(path, devices="cpu")
                    self.assertEqual(1, result.returncode)
                    self.assertIn(f"timezones: {message}", result.stderr)


if __name__ == "__main__":
    unittest.main()
