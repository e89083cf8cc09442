# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""The programs in the README are the ones that the build compiles."""

import re
import tomllib
import unittest
from pathlib import Path

ROOT = Path(__file__).resolve().parents[2]


class ReadmeTest(unittest.TestCase):
    def test_shows_the_first_steps_as_they_are(self):
        blocks = re.findall(r"```cpp\n(.*?)```", (ROOT / "README.md").read_text(), re.DOTALL)
        for program in sorted((ROOT / "examples/first_steps").glob("*.cpp")):
            text = re.sub(r"^// SPDX-.*\n", "", program.read_text(), flags=re.MULTILINE).lstrip()
            self.assertIn(text, blocks, program.name)

    def test_lists_the_functions_that_have_bodies(self):
        readme = (ROOT / "README.md").read_text()
        listed = re.search(r"have bodies and.*?\n\n(.*?)\n\n", readme, re.DOTALL)
        with (ROOT / "catalogue/functions.toml").open("rb") as file:
            functions = tomllib.load(file)["function"]
        with_bodies = sorted(
            f["name"] for f in functions if f.get("bodies") and not f.get("utility")
        )
        self.assertEqual(with_bodies, re.findall(r"`(\w+)`", listed[1]))


if __name__ == "__main__":
    unittest.main()
