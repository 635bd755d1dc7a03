"""Tests of what bench/count_instructions.py makes of callgrind's files, and of its guard. Run as: python3 -B THIS"""

import collections
import contextlib
import importlib.util
import io
import pathlib
import sys
import unittest

FILE = pathlib.Path(__file__).resolve().parents[2] / "bench" / "count_instructions.py"
spec = importlib.util.spec_from_file_location("count_instructions", FILE)
count_instructions = importlib.util.module_from_spec(spec)
sys.modules[spec.name] = count_instructions
spec.loader.exec_module(count_instructions)

# An operation that calls the C library twice, the locale library and the broker; the locale library allocates in C++.
PROFILE = """desc: Trigger: Client Request: Some_EnumInstances/10 library
ob=/build/lib/libGlimmarkProvider.so
fn=operation
0 100
cob=/lib/libc.so.6
cfn=memcpy
calls=2 0
0 40
cob=/build/lib/libtavro-locale.so.1.0.0
cfn=caption
calls=1 0
0 90
cob=/build/bin/bench-instructions
cfn=cimhost::newObjectPath
calls=3 0
0 300

ob=/build/lib/libtavro-locale.so.1.0.0
fn=caption
0 20
cob=/lib/libstdc++.so.6
cfn=operator new(unsigned long)
calls=1 0
0 70

ob=/lib/libstdc++.so.6
fn=operator new(unsigned long)
0 10
cob=/lib/libc.so.6
cfn=malloc
calls=1 0
0 60

ob=/lib/libc.so.6
fn=malloc
0 60

fn=memcpy
0 40

ob=/build/bin/bench-instructions
fn=cimhost::newObjectPath
0 300
"""


class Profile(unittest.TestCase):
    def test_the_run_time_costs_whoever_calls_it(self):
        name, functions = count_instructions.read_profile(io.StringIO(PROFILE))
        self.assertEqual(name, "Some_EnumInstances/10 library")
        self.assertEqual(
            dict(count_instructions.figures_of(functions)),
            {"library": 140, "locale": 90, "broker": 300, "calls": 3, "allocations": 1},
        )


class Guard(unittest.TestCase):
    def setUp(self):
        self.held = {"memory A/1": dict.fromkeys(count_instructions.HELD, 0) | {"library": 600, "locale": 400}}

    def grown(self, **figures):
        rows = {row: collections.Counter(held | figures) for row, held in self.held.items()}
        with contextlib.redirect_stdout(io.StringIO()) as said:
            count = count_instructions.guard(rows, self.held)
        return count, said.getvalue()

    def test_two_in_a_hundred_more_is_let_pass(self):
        self.assertEqual(self.grown(library=620)[0], 0)

    def test_more_is_told_with_the_old_and_the_new_figure(self):
        count, said = self.grown(locale=421)
        self.assertEqual(count, 1)
        self.assertIn("memory A/1: instructions 1000 -> 1021\n", said)
        self.assertIn("    locale 400 -> 421\n", said)

    def test_a_figure_that_was_nothing_stays_so(self):
        self.assertEqual(self.grown(allocations=1)[0], 1)
        self.assertEqual(self.grown(calls=1)[0], 1)

    def test_an_operation_of_which_nothing_is_held_is_told(self):
        rows = {row: collections.Counter(held) for row, held in self.held.items()}
        rows["memory B/1"] = rows["memory A/1"]
        with contextlib.redirect_stdout(io.StringIO()):
            self.assertEqual(count_instructions.guard(rows, self.held), 1)
            self.assertEqual(count_instructions.guard({}, self.held), 1)


if __name__ == "__main__":
    unittest.main()
