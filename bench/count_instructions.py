#!/usr/bin/env python3
"""Counts the instructions of every operation with callgrind, split by library.

    count_instructions.py PROGRAMS           the cost for one indicator, as a table; leaves the figures of whole requests
                                             in PROGRAMS/instructions.txt
    count_instructions.py PROGRAMS --guard   fails where a figure is more than 2 % above that of instructions.txt here

Time shakes on a shared machine; the number of instructions does not. The programs have an environment that is always
the same and do without the C library's functions for newer processors: figures are those of the architecture.

What is spent in a library's own code is its own, and so is what the run-time libraries (C, C++, UTF-8) spend when it
calls them. The columns:

  library       libGlimmarkProvider.so
  locale, logging, common, inventory
                the four support libraries; an inventory in memory stands for the instrumentation library
  ours          these five together
  broker        the host's broker: what the library's calls cost there
  calls         of the broker by the library
  allocations   of the library and of the support libraries
  floor         the same calls of broker and support libraries, replayed: without the library
"""

import argparse
import collections
import pathlib
import re
import subprocess
import sys
import tempfile

OURS = ["library", "locale", "logging", "common", "inventory"]
HELD = OURS + ["calls", "allocations"]  # what the guard holds; the broker is the host's matter
MOST_GROWTH = 1.02
FILE_OF_FIGURES = pathlib.Path(__file__).with_name("instructions.txt")
SIZES = [1, 100, 1000]

# Where the inventory is: the program, and which of the operations are worth counting.
SOURCES = {
    "memory": ("bench-instructions", "."),
    "file": ("bench-instructions-of-file", "^TAVRO_Glimmark_(EnumInstanceNames|EnumInstances|GetInstance_ByIdentifier)$"),
}
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
# The program's own functions: those in front of others', and the tape.
MEASURING = re.compile(r"(Tavro|MVLog|bench|Allocations)::|uname$")

# Functions for newer processors take fewer instructions, on those that have them.
PLAIN_PROCESSOR = "glibc.cpu.hwcaps=-AVX2,-AVX,-BMI2,-ERMS,-FSRM,-SSE4_2,-SSSE3"

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


def count(programs, source, names, with_floor):
    """Counts one source's operations. \\return figures by "SOURCE OPERATION/INDICATORS\""""
    program, worth_counting = SOURCES[source]
    with tempfile.TemporaryDirectory() as folder:
        command = ["valgrind", "--tool=callgrind", "--instr-atstart=no", "--dump-line=no", "--compress-strings=no",
                   "--compress-pos=no", f"--callgrind-out-file={folder}/profile", programs / program,
                   *(["--floor"] if with_floor else []), names or worth_counting, *map(str, SIZES)]
        environment = {"PATH": "/usr/bin:/bin", "GLIBC_TUNABLES": PLAIN_PROCESSOR}
        done = subprocess.run(command, env=environment, cwd="/", capture_output=True, text=True, check=False)
        if done.returncode != 0:
            sys.exit(f"{program} ended with {done.returncode}:\n{done.stdout}{done.stderr}")
        rows = {}
        for file in pathlib.Path(folder).iterdir():
            with open(file, encoding="utf-8", errors="replace") as lines:
                what, functions = read_profile(lines)
            if what is None:
                continue
            row, side = what.split()
            figures = figures_of(functions)
            kept = rows.setdefault(f"{source} {row}", collections.Counter())
            if side == "library":
                kept.update(figures)
                kept["ours"] = sum(figures[part] for part in OURS)
            else:
                kept["floor"] = sum(figures[part] for part in OURS + ["broker"])
        return rows


def count_all(programs, names, with_floor):
    rows = {}
    for source in SOURCES:
        rows.update(count(programs, source, names, with_floor))
    return dict(sorted(rows.items(), key=lambda row: (row[0].partition("/")[0], indicators(row[0]))))


def indicators(row):
    return int(row.rpartition("/")[2])


def print_table(rows):
    columns = OURS + ["ours", "broker", "floor", "calls", "allocations"]
    width = max(map(len, rows))
    print(f"{'for one indicator':{width}}" + "".join(f"{column:>12}" for column in columns))
    for row, figures in rows.items():
        values = (figures[column] / indicators(row) for column in columns)
        print(f"{row:{width}}" + "".join(f"{value:12.1f}" for value in values))


def write_figures(rows, file):
    """Of whole requests."""
    width = max(map(len, rows))
    lines = ["# Instructions, calls and allocations of whole requests, which scripts/bench --guard holds. Raising one is a\n",
             "# decision, made here by hand; scripts/bench --instructions leaves what it counted in the folder of programs.\n",
             f"{'# inventory operation/indicators':{width}}" + "".join(f" {column:>11}" for column in HELD) + "\n"]
    lines += [f"{row:{width}}" + "".join(f" {figures[column]:11}" for column in HELD) + "\n"
              for row, figures in rows.items()]
    file.write_text("".join(lines))


def read_figures(file):
    rows = {}
    for line in file.read_text().splitlines():
        if line.startswith("#"):
            continue
        source, row, *figures = line.split()
        rows[f"{source} {row}"] = dict(zip(HELD, map(int, figures)))
    return rows


def compared(figures):
    """The instructions of all libraries are one figure: where a piece of memory happens to lie moves a few hundred
    between requests."""
    return {"instructions": sum(figures[part] for part in OURS), "calls": figures["calls"],
            "allocations": figures["allocations"]}


def guard(rows, held):
    """\\return how many figures have grown; says which"""
    grown = fallen = 0
    for row in sorted(set(rows) | set(held)):
        if row not in rows or row not in held:
            print(f"{row}: {'not counted any more' if row in held else 'not yet'} in {FILE_OF_FIGURES.name}")
            grown += 1
            continue
        old, new = compared(held[row]), compared(rows[row])
        for figure in old:
            if new[figure] > old[figure] * MOST_GROWTH:
                print(f"{row}: {figure} {old[figure]} -> {new[figure]}")
                print("".join(f"    {part} {held[row][part]} -> {rows[row][part]}\n" for part in OURS), end="")
                grown += 1
            fallen += new[figure] * MOST_GROWTH < old[figure]
    print(f"{grown} figures of {len(held)} requests have grown by more than 2 %; {fallen} could be lowered")
    return grown


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("programs", type=pathlib.Path, help="the folder of the programs that it runs")
    parser.add_argument("--guard", action="store_true")
    parser.add_argument("--names", help="only the operations whose names match")
    arguments = parser.parse_args()
    rows = count_all(arguments.programs.resolve(), arguments.names, not arguments.guard)
    write_figures(rows, arguments.programs / FILE_OF_FIGURES.name)
    if arguments.guard:
        sys.exit(1 if guard(rows, read_figures(FILE_OF_FIGURES)) else 0)
    print_table(rows)


if __name__ == "__main__":
    main()
