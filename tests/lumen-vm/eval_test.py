# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Evaluations from files and from standard input."""

import math
import os
import pty
import subprocess
import tempfile
import time
import unittest
from pathlib import Path

from tool import GPU, GPU_WITHOUT_DOUBLE, Answer, double_bits, float_bits, lumen_vm, needs_rows

BLOCK = 65536  # rows per call


def evaluate(function: str, letter: str, text: str, *options: str, devices: str = "cpu") -> Answer:
    return lumen_vm("eval", function, "--type", letter, *options, devices=devices, text=text)


def on_gpu(function: str, letter: str, text: str, *options: str) -> Answer:
    return evaluate(function, letter, text, "--device", "gpu", *options, devices=f"cpu;{GPU}")


class Rows(unittest.TestCase):
    def test_float(self):
        answer = evaluate("add", "s", "0.1 0.2\n")
        self.assertEqual((answer.code, answer.err), (0, ""))
        self.assertEqual(answer.rows, [["0.1", "0.2", "0.3", "0x3e99999a", "-"]])

    def test_double(self):
        answer = evaluate("add", "d", "0.1 0.2\n")
        self.assertEqual(
            answer.rows, [["0.1", "0.2", "0.30000000000000004", "0x3fd3333333333334", "-"]]
        )

    def test_hexadecimal_infinite_and_nan(self):
        answer = evaluate("add", "d", "0x1p-3 -0x1.8p1\ninf 1\n-INF -1\nnan 0\n-0 -0\n")
        self.assertEqual(
            [row[2:4] for row in answer.rows],
            [
                ["-2.875", double_bits(-2.875)],
                ["inf", double_bits(math.inf)],
                ["-inf", double_bits(-math.inf)],
                ["nan", double_bits(math.nan)],
                ["-0", double_bits(-0.0)],
            ],
        )

    def test_complex_has_two_columns(self):
        answer = evaluate("conj", "z", "1.5 -2\n0 0\n")
        self.assertEqual(
            answer.rows,
            [
                ["1.5", "-2", "1.5", double_bits(1.5), "2", double_bits(2.0), "-"],
                ["0", "0", "0", double_bits(0.0), "-0", double_bits(-0.0), "-"],
            ],
        )

    def test_complex_of_two_inputs(self):
        answer = on_gpu("mul", "c", "1 2 3 4\n")
        expected = ["-5", float_bits(-5), "10", float_bits(10)]
        self.assertEqual(answer.rows[0][4:8], expected)

    def test_complex_to_real(self):
        answer = on_gpu("abs", "c", "3 -4\n")
        self.assertEqual(answer.rows, [["3", "-4", "5", float_bits(5), "-"]])

    @needs_rows("cis")
    def test_real_to_complex(self):
        answer = on_gpu("cis", "d", "0\n")
        bits = [double_bits(1), "0", double_bits(0)]
        self.assertEqual(answer.rows[0][:5], ["0", "1", *bits])

    def test_two_outputs(self):
        answer = evaluate("modf", "s", "-2.75\n7\n")
        values = [[row[1], row[3]] for row in answer.rows]
        self.assertEqual(sorted(values[0], key=float), ["-2", "-0.75"])
        self.assertEqual(sorted(values[1], key=float), ["0", "7"])
        for row in answer.rows:
            self.assertEqual([row[2], row[4]], [float_bits(float(row[1])), float_bits(float(row[3]))])

    @needs_rows("add")
    def test_half(self):
        answer = evaluate("add", "h", "1 0.0005\n65504 -65504\n")
        self.assertEqual(
            [row[2:4] for row in answer.rows], [["1.001", "0x3c01"], ["0", "0x0000"]]
        )

    @needs_rows("powx")
    def test_constant(self):
        answer = on_gpu("powx", "d", "3\n-2\n", "--constant", "2")
        self.assertEqual([row[1] for row in answer.rows], ["9", "4"])

    @needs_rows("linearfrac")
    def test_four_constants(self):
        constants = [part for c in ("2", "-1", "0.5", "3") for part in ("--constant", c)]
        answer = evaluate("linearfrac", "d", "5 2\n", *constants)
        self.assertEqual(float(answer.rows[0][2]), (2 * 5 - 1) / (0.5 * 2 + 3))

    def test_blank_lines_and_comments_are_passed_over(self):
        answer = evaluate("floor", "d", "# head\n\n  1.5 # tail\n\t\n-1.5\r\n#\n2.5")
        self.assertEqual((answer.code, answer.err), (0, ""))
        self.assertEqual([row[1] for row in answer.rows], ["1", "-2", "2"])

    def test_no_rows(self):
        answer = evaluate("floor", "d", "")
        self.assertEqual((answer.code, answer.rows), (0, []))

    def test_columns_are_aligned(self):
        answer = evaluate("floor", "d", "1\n-1.7976931348623157e308\n5e-324\n")
        self.assertEqual(len({line.index(" 0x") for line in answer.lines[-3:]}), 1)

    def test_head_says_what_ran(self):
        answer = on_gpu("floor", "d", "1\n")
        self.assertEqual(
            answer.lines[0], "# floor of double, accuracy ha, on device 1: floor_d_ha_gen"
        )
        self.assertEqual(answer.lines[-2].split(), ["#", "a", "y", "bits", "status"])


class Blocks(unittest.TestCase):
    def test_many_rows_keep_their_order(self):
        count = 2 * BLOCK + 3
        text = "".join(f"{i}.25\n" for i in range(count))
        answer = evaluate("floor", "d", text)
        self.assertEqual(answer.code, 0)
        self.assertEqual([float(row[1]) for row in answer.rows], [float(i) for i in range(count)])

    def test_exactly_one_block(self):
        answer = evaluate("floor", "s", "2.5\n" * BLOCK)
        self.assertEqual(len(answer.rows), BLOCK)
        self.assertEqual({row[1] for row in answer.rows}, {"2"})


class Status(unittest.TestCase):
    def test_kernels_report_it_per_element(self):
        answer = on_gpu("fmod", "d", "5 3\ninf 1\n1 0\n")
        self.assertEqual([row[-1] for row in answer.rows], ["success", "sing", "sing"])

    def test_kernels_tell_kinds_apart(self):
        answer = on_gpu("nextafter", "s", "0 1\n1 2\n3.4028235e38 inf\n")
        words = [row[-1] for row in answer.rows]
        self.assertEqual(words, ["underflow", "success", "overflow"])

    def test_one_row(self):
        answer = on_gpu("fmod", "s", "1 0\n")
        self.assertEqual([row[-1] for row in answer.rows], ["sing"])

    def test_host_reports_none(self):
        answer = evaluate("fmod", "d", "1 0\n")
        self.assertEqual([row[-1] for row in answer.rows], ["-"])
        self.assertIn("# no status: the host reports none", answer.lines)

    def test_function_without_handler(self):
        answer = on_gpu("abs", "d", "-1\n")
        self.assertEqual([row[-1] for row in answer.rows], ["-"])
        self.assertIn("# no status: the function has no error handler", answer.lines)


class Files(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = Path(folder.name)

    def write(self, name: str, text: str) -> str:
        path = self.folder / name
        path.write_text(text)
        return str(path)

    def test_several_and_standard_input(self):
        first, last = self.write("first", "1.5\n"), self.write("last", "3.5")
        answer = evaluate("floor", "d", "2.5\n", first, "-", last)
        self.assertEqual((answer.code, answer.err), (0, ""))
        self.assertEqual([row[1] for row in answer.rows], ["1", "2", "3"])

    def test_bad_lines_are_named_and_the_others_evaluated(self):
        file = self.write("numbers.txt", "1.5\n# comment\nabc\n2.5 3\n1e999\n-1.5\n")
        answer = evaluate("floor", "d", "", file)
        self.assertEqual(answer.code, 1)
        self.assertEqual([row[1] for row in answer.rows], ["1", "-2"])
        self.assertEqual(
            answer.err.splitlines(),
            [
                f'lumen-vm: {file}:3: "abc" is no number',
                f"lumen-vm: {file}:4: 1 column expected, 2 found",
                f'lumen-vm: {file}:5: "1e999" is beyond the range of double',
            ],
        )

    def test_lines_count_from_1_in_each_file(self):
        first, last = self.write("first", "1\n2\n"), self.write("last", "x\n")
        answer = evaluate("floor", "d", "", first, last)
        self.assertEqual(answer.err, f'lumen-vm: {last}:1: "x" is no number\n')

    def test_bad_line_of_standard_input(self):
        answer = evaluate("add", "d", "1 2\n1\n")
        self.assertEqual(answer.code, 1)
        self.assertEqual(
            answer.err, "lumen-vm: (standard input):2: 2 columns expected, 1 found\n"
        )
        self.assertEqual(len(answer.rows), 1)

    def test_complex_counts_columns_in_parts(self):
        answer = evaluate("conj", "c", "1\n")
        self.assertIn("2 columns expected, 1 found", answer.err)

    def test_missing_file_is_named_and_the_others_evaluated(self):
        missing, there = str(self.folder / "missing"), self.write("there", "1.5\n")
        answer = evaluate("floor", "d", "", missing, there)
        self.assertEqual(answer.code, 1)
        self.assertEqual(answer.err, f"lumen-vm: {missing}: No such file or directory\n")
        self.assertEqual([row[1] for row in answer.rows], ["1"])

    def test_folder_is_no_file(self):
        answer = evaluate("floor", "d", "", str(self.folder))
        self.assertEqual(answer.code, 1)
        self.assertIn(f"lumen-vm: {self.folder}: ", answer.err)

    @unittest.skipUnless(os.path.exists("/dev/full"), "there is no /dev/full")
    def test_full_disk_is_an_error(self):
        with open("/dev/full", "w") as full:
            done = subprocess.run(
                [os.environ["LUMEN_VM"], "eval", "floor", "--type", "d"],
                input=b"1.5\n",
                stdout=full,
                stderr=subprocess.PIPE,
            )
        self.assertEqual(done.returncode, 1)
        self.assertIn(b"standard output", done.stderr)


class Progress(unittest.TestCase):
    """Input that takes longer than a second."""

    def slow_input(self, errors) -> str:
        environment = {**os.environ, "LUMEN_SYCL_DEVICES": "cpu"}
        tool = subprocess.Popen(
            [os.environ["LUMEN_VM"], "eval", "floor", "--type", "d"],
            stdin=subprocess.PIPE,
            stdout=subprocess.PIPE,
            stderr=errors,
            env=environment,
        )
        tool.stdin.write(b"1.5\n" * 2000)
        tool.stdin.flush()
        time.sleep(1.3)
        out, _ = tool.communicate(b"1.5\n" * 4000)
        self.assertEqual(tool.returncode, 0)
        return out.decode()

    def test_is_shown_and_taken_away_on_a_terminal(self):
        terminal, errors = pty.openpty()
        self.addCleanup(os.close, terminal)
        out = self.slow_input(errors)
        os.close(errors)
        shown = os.read(terminal, 4096).decode()
        self.assertRegex(shown, r"lumen-vm: \d+ rows read")
        self.assertTrue(shown.endswith("\r\033[K"), repr(shown))
        self.assertNotIn("rows read", out)

    def test_is_not_shown_elsewhere(self):
        with tempfile.TemporaryFile() as errors:
            self.slow_input(errors)
            errors.seek(0)
            self.assertEqual(errors.read(), b"")


class Unserved(unittest.TestCase):
    def unserved(self, mode: str) -> Answer:
        devices = f"cpu;{GPU_WITHOUT_DOUBLE}"
        return evaluate("floor", "h", "1.5\n", "--device", "1", "--mode", mode, devices=devices)

    def test_exception(self):
        answer = self.unserved("0x400000")
        self.assertEqual((answer.code, answer.out), (1, ""))
        self.assertIn("arbor::lumen::vector_math::floor: unimplemented functionality: ", answer.err)

    def test_status(self):
        answer = self.unserved("ha")
        self.assertEqual((answer.code, answer.out), (1, ""))
        self.assertIn("status becomes 256 (bad_argument)", answer.err)


if __name__ == "__main__":
    unittest.main()
