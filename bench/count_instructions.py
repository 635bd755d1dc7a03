#!/usr/bin/env python3
"""Counts the instructions of every operation with callgrind, split by library.

Time shakes on a shared machine; the number of instructions does not. The programs are run with an environment that is
always the same, and without the C library's functions for newer processors: figures are those of the architecture.

What is spent in a library's own code is its own, and so is what the run-time libraries (C, C++, UTF-8) spend when it
calls them. The columns:

  library            libGlimmarkProvider.so
  locale, logging, common, inventory
                     the four support libraries; the inventory in memory stands for the instrumentation library
  broker             the host's broker: what the library's calls cost there
  calls              of the broker by the library
  allocations        of the library and of the support libraries
  floor              the same calls of broker and support libraries, replayed: without the library
"""

import argparse
import collections
import os
import pathlib
import re
import subprocess
import sys
import tempfile

OURS = ["library", "locale", "logging", "common", "inventory"]
HELD = OURS + ["calls", "allocations"]  # what the guard holds; the broker is the host's matter
SOURCES = {"memory": "bench-instructions", "file": "bench-instructions-of-file"}
LIBRARIES = {
    "libGlimmarkProvider.so": "library",
    "libtavro-locale.so": "locale",
    "libmvlog.so": "logging",
    "libtavro-common.so": "common",
    "libtavro-instrumentation.so": "inventory",
    "libbench-inventory.so": "inventory",
}
RUN_TIME = re.compile(r"/(libc|libm|libstdc\+\+|libgcc_s|ld-linux[^/]*|libutf8proc|libfmt|libspdlog)[-.][^/]*$")
ALLOCATING = re.compile(r"(malloc|calloc|realloc|aligned_alloc|posix_memalign)(@|'|$)")
# The program's own functions: those in front of the support libraries', and the tape.
MEASURING = re.compile(r"(Tavro|MVLog|bench|Allocations)::")

Call = collections.namedtuple("Call", "callee count cost")


class Function:
    def __init__(self, obj, name):
        self.part = part_of(obj, name)
        self.allocates = self.part is None and ALLOCATING.match(name) is not None
        self.cost = 0
        self.calls = []


def part_of(obj, name):
    """The column that a function's own cost belongs to; None: that of whoever calls it."""
    file = pathlib.PurePath(obj).name
    for library, part in LIBRARIES.items():
        if file.startswith(library):
            return part
    if RUN_TIME.search(obj):
        return None
    return "measuring" if MEASURING.match(name) else "broker"


def read_profile(lines):
    """What callgrind wrote of one run. \\return its name, and its functions"""
    name, functions = None, {}
    obj = called_obj = called = count = None

    def function(of, called_name):
        return functions.setdefault((of, called_name), Function(of, called_name))

    current = None
    for line in lines:
        key, _, value = line.rstrip("\n").partition("=")
        if line.startswith("desc: Trigger: Client Request: "):
            name = line.rstrip("\n").rpartition(": ")[2]
        elif key == "ob":
            obj = value
        elif key == "fn":
            current, called_obj = function(obj, value), None
        elif key == "cob":
            called_obj = value
        elif key == "cfn":
            called, called_obj = function(called_obj or obj, value), None
        elif key == "calls":
            count = int(value.split()[0])
        elif line[:1].isdigit() or line[:1] in "+-*":
            if count is not None:
                current.calls.append(Call(called, count, int(line.split()[1])))
                count = None
            elif current is not None:
                current.cost += int(line.split()[1])
    return name, list(functions.values())


class Allocations:
    """How many allocations a call of a run-time function makes on average."""

    def __init__(self, functions):
        self.times_called = collections.Counter()
        for function in functions:
            for call in function.calls:
                self.times_called[id(call.callee)] += call.count
        self.known = {}

    def of_call(self, function):
        if function.allocates:
            return 1
        if function.part is not None:
            return 0
        if id(function) not in self.known:
            self.known[id(function)] = 0  # for those that call themselves
            made = sum(call.count * self.of_call(call.callee) for call in function.calls)
            self.known[id(function)] = made / max(1, self.times_called[id(function)])
        return self.known[id(function)]


def figures_of(functions):
    figures = collections.Counter()
    allocations = Allocations(functions)
    for function in functions:
        if function.part is None:
            continue
        figures[function.part] += function.cost
        for call in function.calls:
            if call.callee.part is None:
                figures[function.part] += call.cost
                if function.part in OURS:
                    figures["allocations"] += call.count * allocations.of_call(call.callee)
            elif function.part == "library" and call.callee.part == "broker":
                figures["calls"] += call.count
    figures["allocations"] = round(figures["allocations"])
    return figures


def count(binaries, source, names, sizes, with_floor):
    """\\return by operation/indicators, the figures of the library, with those of its floor under "floor\""""
    with tempfile.TemporaryDirectory() as folder:
        command = ["valgrind", "--tool=callgrind", "--instr-atstart=no", "--dump-line=no", "--compress-strings=no",
                   "--compress-pos=no", f"--callgrind-out-file={folder}/profile", binaries / SOURCES[source],
                   *(["--floor"] if with_floor else []), names, *map(str, sizes)]
        # Nothing of this machine's: how long an environment is counts too.
        environment = {"PATH": "/usr/bin:/bin",
                       "GLIBC_TUNABLES": "glibc.cpu.hwcaps=-AVX2,-AVX,-BMI2,-ERMS,-FSRM,-SSE4_2,-SSSE3"}
        done = subprocess.run(command, env=environment, cwd="/", capture_output=True, text=True)
        if done.returncode != 0:
            sys.exit(f"{SOURCES[source]} ended with {done.returncode}:\n{done.stdout}{done.stderr}")
        rows = {}
        for file in pathlib.Path(folder).iterdir():
            with open(file, encoding="utf-8", errors="replace") as lines:
                what, functions = read_profile(lines)
            if what is None:
                continue
            row, side = what.split()
            figures = figures_of(functions)
            if side == "library":
                rows.setdefault(row, {}).update(figures)
            else:
                rows.setdefault(row, {})["floor"] = sum(figures[part] for part in OURS + ["broker"])
        return rows


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--source", choices=list(SOURCES), default="memory")
    parser.add_argument("binaries", type=pathlib.Path)
    parser.add_argument("--floor", action="store_true")
    parser.add_argument("names")
    parser.add_argument("sizes", nargs="+")
    arguments = parser.parse_args()
    rows = count(arguments.binaries.resolve(), arguments.source, arguments.names, arguments.sizes, arguments.floor)
    columns = OURS + ["broker", "measuring", "floor", "calls", "allocations"]
    for row, figures in sorted(rows.items()):
        n = int(row.rpartition("/")[2])
        ours = sum(figures.get(p, 0) for p in OURS)
        print(f"{row:70} ours {ours/n:9.0f} " + " ".join(f"{c} {figures.get(c, 0) / n:.1f}" for c in columns))


if __name__ == "__main__":
    main()
