# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""The device words of devices of every kind."""

import unittest

from tool import lumen_vm

FP64 = 0x800000000
NO_FP64 = 0x400000000
OURS = 0x8000000000000000

GARNET = (0x2000200000002, "gpu;garnet;integrated;")
TOPAZ = (0x2000100000004, "gpu;topaz;discrete;")
BERYL = (0x2000100000020, "gpu;beryl;discrete;")
ONYX = (0x2000100000008, "gpu;discrete;", "onyx;")
INTEGRATED_ONYX = (0x2000200000008, "gpu;integrated;", "onyx;")
JASPER = (0x2000100000010, "gpu;discrete;", "jasper;")

TIERS = {
    "1300": GARNET,
    "13ff": GARNET,
    "1512": TOPAZ,
    "1700": ONYX,
    "1901": INTEGRATED_ONYX,
    "1d30": JASPER,
    "1d3f": JASPER,
    "1d40": BERYL,
    "1b00": ONYX,
    "2": BERYL,
}


def words_of(devices: str) -> list[list[str]]:
    answer = lumen_vm("devices", devices=devices)
    assert answer.code == 0, answer.err
    return [line.split(maxsplit=3) for line in answer.lines[1:]]


class Devices(unittest.TestCase):
    def test_has_a_head_and_aligned_columns(self):
        lines = lumen_vm("devices", devices="cpu;gpu,vendor=51a7").lines
        self.assertEqual(lines[0].split(), ["number", "device", "word", "in", "words", "name"])
        starts = {line.index(" 0x") for line in lines[1:]}
        self.assertEqual(starts, {lines[0].index(" device word")})

    def test_numbers_devices_from_0(self):
        numbers = [row[0] for row in words_of("cpu;gpu;gpu,fp64=0;accelerator")]
        self.assertEqual(numbers, ["0", "1", "2", "3"])

    def test_cpu(self):
        for row in words_of("cpu,vendor=1"):
            self.assertEqual(row[1:3], ["0x0001000000000000", "cpu;"])

    def test_cpu_of_the_vendor(self):
        for row in words_of("cpu,vendor=51a7"):
            self.assertEqual(row[1:3], ["0x8001000000000000", "cpu;norvane;"])

    def test_accelerator(self):
        row = words_of("cpu;accelerator,vendor=1")[1]
        self.assertEqual(row[1:3], ["0x0004000000000000", "accelerator;"])

    def test_every_tier_with_and_without_double(self):
        for identifier, (word, before, *after) in TIERS.items():
            for fp64, bit in ((1, FP64), (0, NO_FP64)):
                with self.subTest(identifier=identifier, fp64=fp64):
                    description = f"cpu;gpu,vendor=51a7,id={identifier},fp64={fp64}"
                    row = words_of(description)[1]
                    self.assertEqual(int(row[1], 16), word | bit | OURS)
                    text = before + "norvane;" + "".join(after)
                    if fp64:
                        text += "fp64;"
                    else:
                        text = text.replace("gpu;", "gpu;nofp64;")
                    self.assertEqual(row[2], text)

    def test_gpu_without_identifier_is_beryl_and_discrete(self):
        row = words_of("cpu;gpu,vendor=51a7")[1]
        self.assertEqual(row[1:3], ["0x8002000900000020", "gpu;beryl;discrete;norvane;fp64;"])

    def test_gpu_of_another_vendor(self):
        row = words_of("cpu;gpu,vendor=beef,id=1300")[1]
        self.assertEqual(row[1:3], ["0x0002000a00000002", "gpu;garnet;integrated;fp64;"])

    def test_shows_the_name(self):
        row = words_of("cpu;gpu,name=Test Card")[1]
        self.assertEqual(row[3], "Test Card")

    def test_malformed_environment_is_an_error(self):
        answer = lumen_vm("devices", devices="toaster")
        self.assertEqual(answer.code, 1)
        self.assertIn("lumen-vm: ", answer.err)


if __name__ == "__main__":
    unittest.main()
