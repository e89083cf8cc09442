# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""The checker of layers finds what it is there to find."""

import tempfile
import unittest
from pathlib import Path

import layers


class LayersTest(unittest.TestCase):
    def violations(self, name: str, text: str) -> list[str]:
        with tempfile.TemporaryDirectory() as folder:
            path = Path(folder) / name
            path.parent.mkdir(parents=True)
            path.write_text(text)
            return layers.violations(Path(folder))

    def test_accepts_includes_of_lower_layers(self):
        text = '#include "call/input.hpp"\n#include <vector>\n#include <sycl/sycl.hpp>\n'
        self.assertEqual(self.violations("device/launch.hpp", text), [])

    def test_finds_an_include_of_a_higher_layer(self):
        found = self.violations("device/launch.hpp", '#include "dispatch/table.hpp"\n')
        self.assertEqual(found, ["device/launch.hpp: device must not include dispatch/table.hpp"])

    def test_keeps_the_scalar_bodies_free_of_everything(self):
        self.assertEqual(len(self.violations("scalar/exp/exp.hpp", "#include <sycl/sycl.hpp>\n")), 1)
        self.assertEqual(self.violations("scalar/ops.hpp", "#include <sycl/sycl.hpp>\n"), [])

    def test_finds_a_folder_without_a_layer(self):
        self.assertEqual(len(self.violations("misc/helpers.hpp", "")), 1)


if __name__ == "__main__":
    unittest.main()
