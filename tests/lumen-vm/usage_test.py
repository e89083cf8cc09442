# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Help, and what is said of wrong usage."""

import re
import unittest

from tool import lumen_vm

COMMANDS = ("devices", "functions", "explain", "eval")


class Help(unittest.TestCase):
    def test_of_the_tool_names_the_commands(self):
        answer = lumen_vm("--help")
        self.assertEqual((answer.code, answer.err), (0, ""))
        for command in COMMANDS:
            self.assertIn(command, answer.out)

    def test_of_each_command_has_an_example_that_works(self):
        for command in COMMANDS:
            with self.subTest(command=command):
                answer = lumen_vm(command, "--help")
                self.assertEqual(answer.code, 0)
                example = re.search(r"Example: .*lumen-vm (.*)", answer.out)
                self.assertIsNotNone(example, answer.out)
                arguments = example[1].split()
                self.assertEqual(arguments[0], command)
                self.assertEqual(lumen_vm(*arguments, text="1.5 -0x1p-3\n").code, 0)

    def test_version(self):
        answer = lumen_vm("--version")
        self.assertEqual(answer.code, 0)
        self.assertRegex(answer.out, r"^lumen-vm \d+\.\d+\.\d+\n$")


class WrongUsage(unittest.TestCase):
    def assert_wrong(self, *arguments: str, says: str, devices: str = "cpu"):
        answer = lumen_vm(*arguments, devices=devices, text="1\n")
        self.assertEqual(answer.code, 2, answer.err)
        self.assertEqual(answer.out, "")
        self.assertIn(says, answer.err)

    def test_no_command(self):
        self.assert_wrong(says="a command is required: devices, functions, explain or eval")

    def test_unknown_command(self):
        self.assert_wrong("evaluate", says="evaluate")

    def test_unknown_option(self):
        self.assert_wrong("devices", "--verbose", says="--verbose")

    def test_no_type(self):
        for command in ("explain", "eval"):
            self.assert_wrong(command, "add", says="--type")

    def test_no_function(self):
        for command in ("explain", "eval"):
            self.assert_wrong(command, "--type", "s", says="FUNCTION")

    def test_unknown_function_with_near_names(self):
        for command in ("explain", "eval"):
            says = 'there is no function "flor"; did you mean floor?'
            self.assert_wrong(command, "flor", "--type", "s", says=says)
        answer = lumen_vm("explain", "sinp", "--type", "s")
        self.assertEqual(answer.code, 2)
        for name in ("sin", "sinpi", "sinh"):
            self.assertIn(name, answer.err.split("did you mean")[1])

    def test_unknown_function_without_near_names(self):
        says = 'there is no function "hypergeometric"; "lumen-vm functions" lists all'
        self.assert_wrong("explain", "hypergeometric", "--type", "s", says=says)

    def test_type_that_the_function_has_not(self):
        says = 'floor has no element type "c"; it has h (half), s (float) and d (double)'
        self.assert_wrong("explain", "floor", "--type", "c", says=says)
        self.assert_wrong("eval", "floor", "--type", "float", says='element type "float"')
        self.assert_wrong("eval", "conj", "--type", "s", says="c (complex float) and z")

    def test_bad_mode(self):
        for mode in ("xa", "4", "0x", "0xg", "0x100000000", "ha,la"):
            self.assert_wrong("explain", "add", "--type", "s", "--mode", mode, says="is no mode")

    def test_device_that_is_not_there(self):
        call = ("explain", "add", "--type", "s", "--device")
        self.assert_wrong(*call, "gpu", says="there is no device gpu")
        self.assert_wrong(*call, "1", says="there is no device 1")
        self.assert_wrong(*call, "99999999999999999999", says="is no device")
        self.assert_wrong(*call, "fpga", says='"fpga" is no device')

    def test_device_by_class(self):
        call = ("explain", "add", "--type", "s", "--device")
        devices = "cpu;gpu,name=First;gpu,name=Second"
        self.assertEqual(lumen_vm(*call, "gpu", devices=devices).field("device"), "1, First")
        self.assertEqual(lumen_vm(*call, "2", devices=devices).field("device"), "2, Second")

    def test_constants(self):
        call = ("eval", "powx", "--type", "s")
        self.assert_wrong(*call, says="powx takes 1 constant, and 0 were given")
        self.assert_wrong(*call, "-c", "1", "-c", "2", says="and 2 were given")
        self.assert_wrong(*call, "--constant", "x", says='--constant: "x" is no number')
        self.assert_wrong("eval", "floor", "--type", "s", "-c", "-1", says="takes 0 constants")
        call = ("eval", "powx", "--type", "c", "--constant")
        self.assert_wrong(*call, "1", says='"1" is no pair')
        self.assert_wrong(*call, "1,", says='"" is no number')


if __name__ == "__main__":
    unittest.main()
