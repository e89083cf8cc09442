# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""The keys that calls find, on devices of every kind."""

import unittest

from tool import CPU, GPU, GPU_WITHOUT_DOUBLE, Answer, lumen_vm, needs_rows

THROWS = "0x400000"  # replaces the fallbacks: neither the host nor a lower accuracy
NO_FALLBACK = "0x200000"
HOST_ONLY = "0x100000"


def explain(function: str, letter: str, *options: str, devices: str = CPU) -> Answer:
    answer = lumen_vm("explain", function, "--type", letter, *options, devices=devices)
    assert answer.code == 0, answer.err
    return answer


def on_gpu(function: str, letter: str, *options: str, devices: str = GPU) -> Answer:
    return explain(function, letter, "--device", "gpu", *options, devices=f"cpu;{devices}")


def key_of(answer: Answer) -> str:
    return answer.field("key").split()[0]


class FoundKeys(unittest.TestCase):
    def test_gpu_without_double_takes_the_host_row_of_every_type(self):
        for letter, precision in (("s", 4), ("d", 8), ("c", 0x10), ("z", 0x18)):
            with self.subTest(letter=letter):
                answer = on_gpu("add", letter, devices=GPU_WITHOUT_DOUBLE)
                self.assertIn("device: cpu; ", answer.field("key"))
                self.assertEqual(key_of(answer), hex(precision << 32 | 0x8014))

    def test_half_on_a_gpu_without_double_ends_with_none(self):
        answer = on_gpu("add", "h", devices=GPU_WITHOUT_DOUBLE)
        self.assertEqual(key_of(answer), "none")
        self.assertEqual(
            answer.field("ends"),
            "the call does nothing: no output is written, and the queue's status becomes 256 "
            "(bad_argument)",
        )

    @needs_rows("abs")
    def test_abs_in_half_casts_to_float(self):
        answer = on_gpu("abs", "h")
        self.assertEqual(
            answer.field("key"), "0x100001124 device: gpu; precision: h/half; accuracy: ha;"
        )
        self.assertEqual(answer.field("runs"), "abs_h_ha_gen_fp32cast")

    @needs_rows("abs")
    def test_half_needs_no_host_row_on_a_cpu(self):
        self.assertEqual(key_of(explain("abs", "h", "--mode", NO_FALLBACK)), "0x100001124")

    @needs_rows("sin")
    def test_sin_in_half_prefers_plain_half(self):
        self.assertEqual(key_of(on_gpu("sin", "h")), "0x100000124")

    @needs_rows("cos")
    def test_cos_in_float(self):
        self.assertEqual(key_of(on_gpu("cos", "s")), "0x400000824")
        self.assertEqual(key_of(on_gpu("cos", "s", "--mode", "la")), "0x400000122")

    @needs_rows("exp")
    def test_exp_in_complex_double_has_no_table(self):
        self.assertEqual(key_of(on_gpu("exp", "z")), "0x1800000424")

    @needs_rows("tgamma")
    def test_tgamma_in_double_lowers_accuracy(self):
        answer = on_gpu("tgamma", "d")
        self.assertEqual(key_of(answer), "0x800000122")
        found = [line for line in answer.lines if "found: " in line]
        self.assertEqual(len(found), 1)
        self.assertEqual(found[0].split()[:4], ["descending", "la", "0x800000122", "gen"])

    @needs_rows("tgamma")
    def test_tgamma_in_double_without_fallback(self):
        self.assertEqual(key_of(on_gpu("tgamma", "d", "--mode", NO_FALLBACK)), "none")
        self.assertEqual(key_of(on_gpu("tgamma", "d", "--mode", HOST_ONLY)), "0x800008014")

    @needs_rows("tgamma")
    def test_tgamma_in_half_on_an_integrated_gpu(self):
        devices = "gpu,vendor=51a7,id=1300"
        answer = on_gpu("tgamma", "h", "--mode", "ep", devices=devices)
        self.assertEqual(key_of(answer), "0x100001821")

    @needs_rows("linearfrac")
    def test_linearfrac_on_a_gpu_runs_on_the_host(self):
        self.assertEqual(key_of(on_gpu("linearfrac", "s")), "0x400008014")

    def test_cpu(self):
        self.assertEqual(key_of(explain("add", "s", "--mode", "ep")), "0x400008011")
        cyclic = explain("add", "s", "--mode", "ep", "--cyclic")
        self.assertEqual(key_of(cyclic), "0x400000121")
        self.assertEqual(cyclic.field("runs"), "add_s_ep_gen")

    def test_accelerator_has_host_rows_only(self):
        devices = "cpu;accelerator"
        for cyclic in ((), ("--cyclic",)):
            answer = explain("add", "s", "--device", "1", *cyclic, devices=devices)
            self.assertEqual(key_of(answer), "0x400008014")
        self.assertEqual(
            key_of(explain("add", "h", "--device", "1", devices=devices)), "none"
        )

    def test_every_tier_and_vendor_runs_the_same_kernel(self):
        for vendor in ("51a7", "beef"):
            for identifier in ("1300", "1500", "1700", "1900", "1d30", "1b00", "ffff"):
                with self.subTest(vendor=vendor, identifier=identifier):
                    devices = f"gpu,vendor={vendor},id={identifier}"
                    self.assertEqual(key_of(on_gpu("add", "d", devices=devices)), "0x800000124")


class Ends(unittest.TestCase):
    def test_sin_without_double_and_fallback_throws(self):
        answer = on_gpu("sin", "s", "--mode", THROWS, devices=GPU_WITHOUT_DOUBLE)
        self.assertEqual(key_of(answer), "none")
        self.assertEqual(
            answer.field("ends"),
            "arbor::lumen::vector_math::sin: unimplemented functionality: mode: acc: ha; slice: "
            "normal; badarg: exception; precision: precision: s/float; ; architecture: "
            "nofp64;beryl;discrete;norvane;",
        )

    def test_same_mode_with_double_is_served(self):
        answer = on_gpu("abs", "s", "--mode", THROWS)
        self.assertEqual(
            answer.field("key"),
            "0x400000124 device: gpu; precision: s/float; accuracy: ha; feature: gen;",
        )

    def test_message_for_a_garnet(self):
        devices = "gpu,vendor=51a7,id=1301,fp64=0"
        answer = on_gpu("abs", "s", "--mode", THROWS, devices=devices)
        self.assertTrue(
            answer.field("ends").endswith("architecture: nofp64;garnet;integrated;norvane;"),
            answer.out,
        )

    def test_message_names_merged_mode(self):
        mode = hex(0x400000 | 0x20000 | 0x2000 | 0x100 | 0xC)
        answer = on_gpu("abs", "z", "--mode", mode, devices="gpu,vendor=1,fp64=0")
        self.assertEqual(
            answer.field("ends"),
            "arbor::lumen::vector_math::abs: unimplemented functionality: mode: acc: la; "
            "global_status_report; slice: minimum; badarg: quiet;; precision: precision: "
            "z/complex_double; ; architecture: nofp64;beryl;discrete;",
        )


class Steps(unittest.TestCase):
    def steps(self, answer: Answer) -> list[list[str]]:
        passes = ("ascending ", "descending ", "host ")
        return [line.split()[:3] for line in answer.lines if line.startswith(passes)]

    def test_every_step_of_a_search_that_finds_nothing(self):
        answer = on_gpu("expint1", "h", "--mode", "la")
        half = [0x420, 0x120, 0x820, 0x1420, 0x1120, 0x1820]
        accuracies = {4: "ha", 2: "la", 1: "ep"}
        expected = []
        for name, codes, features in (
            ("ascending", (2, 4), half),
            ("descending", (4, 2, 1), half),
            ("host", (2, 4), [0x8010, *half]),
        ):
            for code in codes:
                for feature in features:
                    key = hex(0x100000000 | feature | code)
                    expected.append([name, accuracies[code], key])
        self.assertEqual(self.steps(answer), expected)
        self.assertNotIn("found", answer.out)
        self.assertNotIn("not reached", answer.out)

    def test_search_without_candidates_says_so(self):
        answer = on_gpu("add", "s", "--mode", NO_FALLBACK, devices=GPU_WITHOUT_DOUBLE)
        self.assertEqual(self.steps(answer), [])
        self.assertIn("(no candidates)", answer.lines)

    def test_steps_behind_the_found_one_are_not_reached(self):
        answer = on_gpu("add", "s")
        marks = [line.split("gen", 1)[-1] for line in answer.lines if "0x400000124" in line]
        self.assertTrue(marks[0].strip().startswith("found: add_s_ha_gen"), answer.out)
        self.assertEqual(sum("no row" in line for line in answer.lines), 1)
        self.assertEqual(sum("found: " in line for line in answer.lines), 1)
        self.assertEqual(sum("not reached" in line for line in answer.lines), 14)

    def test_features_of_casts_are_in_words(self):
        answer = explain("expint1", "h")
        words = [" ".join(line.split()[3:5]) for line in answer.lines if "0x10000" in line]
        self.assertEqual(
            words[:3], ["fp32cast nolut", "fp32cast gen", "fp32cast fp64only"], answer.out
        )


class Head(unittest.TestCase):
    def test_default_mode(self):
        answer = explain("add", "s")
        self.assertEqual(
            answer.field("mode"), "0x01811204 acc: ha; slice: normal; badarg: exception"
        )
        self.assertEqual(answer.field("function"), "add (v21), float")

    def test_modes_by_name(self):
        for name, word, text in (("ha", 4, "ha"), ("la", 0xC, "la"), ("ep", 0xF, "ep")):
            mode = explain("add", "s", "--mode", name).field("mode")
            self.assertEqual(
                mode, f"0x{0x1811200 | word:08x} acc: {text}; slice: normal; badarg: exception"
            )

    def test_mode_0_leaves_the_default(self):
        self.assertTrue(explain("add", "s", "--mode", "0x0").field("mode").startswith("0x01811204"))

    def test_cyclic(self):
        mode = explain("add", "s", "--cyclic").field("mode")
        self.assertEqual(mode, "0x01814204 acc: ha; slice: cyclic; badarg: exception")

    def test_fallbacks(self):
        fallback = explain("add", "s").field("fallback")
        self.assertEqual(fallback, "relaxed: on a GPU any accuracy, then the host")
        for mode, text in ((HOST_ONLY, "the host"), (NO_FALLBACK, "none"), (THROWS, "none")):
            self.assertEqual(explain("add", "s", "--mode", mode).field("fallback"), text)

    def test_types_that_change(self):
        function = explain("abs", "c").field("function")
        self.assertEqual(function, "abs (v11), complex float to float")

    def test_device(self):
        answer = on_gpu("add", "s", devices="gpu,vendor=51a7,id=1700,name=Test Card")
        self.assertEqual(answer.field("device"), "1, Test Card")
        self.assertIn("0x8002000900000008 gpu;discrete;norvane;onyx;fp64;", answer.out)


if __name__ == "__main__":
    unittest.main()
