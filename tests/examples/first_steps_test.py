# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""The first programs print what the README says, on a machine with a CPU alone and on a GPU.

Takes the folder of the programs from the environment variable EXAMPLES_FOLDER.
"""

import os
import subprocess
import unittest
from pathlib import Path

ROOT = Path(__file__).resolve().parents[2]
DEVICES = ("cpu", "gpu,vendor=51a7,id=1d30", "cpu;gpu,vendor=51a7,id=1d30")

OUTPUTS = {
    "first_program": "19.90\n54.00\n13.00\n",
    "first_error": "arbor::lumen::vm::add: invalid argument: negative length\nbad argument\n",
    "slices": "2 4 6 \n6 4 2 \n10 100 10 100 10 100 \n10 100 -20 -200 30 300 \n",
    "status": "1.00000012\ninf overflow\n1.40129846e-45 underflow\n",
    "fixup": "1.5\n0\n-1.5\n-0\n",
}
SHOWN = OUTPUTS.keys() - {"first_program"}


class FirstSteps(unittest.TestCase):
    def test_print_their_results(self):
        for program, expected in OUTPUTS.items():
            for devices in DEVICES:
                with self.subTest(program=program, devices=devices):
                    result = subprocess.run(
                        [Path(os.environ["EXAMPLES_FOLDER"]) / program],
                        env=os.environ | {"LUMEN_SYCL_DEVICES": devices},
                        capture_output=True,
                        text=True,
                        timeout=60,
                    )
                    self.assertEqual("", result.stderr)
                    self.assertEqual(0, result.returncode)
                    self.assertEqual(expected, result.stdout)

    def test_all_have_an_expected_output(self):
        programs = {path.stem for path in (ROOT / "examples/first_steps").glob("*.cpp")}
        self.assertEqual(programs, set(OUTPUTS))

    def test_are_shown_with_their_results(self):
        readme = (ROOT / "README.md").read_text()
        for program in SHOWN:
            lines = [line.rstrip() for line in OUTPUTS[program].splitlines()]
            self.assertIn("```\n" + "\n".join(lines) + "\n```", readme, program)


if __name__ == "__main__":
    unittest.main()
