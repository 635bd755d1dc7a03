"""A comment on what is deliberate ends with the test that holds it, and there is that test."""

import pathlib
import re
import sys

ROOT = pathlib.Path(__file__).resolve().parent.parent.parent
SOURCES = [file for file in sorted((ROOT / "src").glob("*/*")) if file.suffix in (".cpp", ".h")]
TESTS = [*(ROOT / "src").glob("*/tests/*.cpp"), *(ROOT / "tests").glob("*.cpp")]

comments = [(file, comment) for file in SOURCES
            for comment in re.findall(r"^ *//+ Deliberate:.*(?:\n *//+ (?!Deliberate:).*)*", file.read_text(), re.MULTILINE)]
tests = {f"{suite}.{name}" for file in TESTS
         for suite, name in re.findall(r"^TEST(?:_[FP])?\((\w+), (\w+)\)", file.read_text(), re.MULTILINE)}

wrong = 0
for file, comment in comments:
    test = re.search(r"Test: ([\w.]+)\.$", comment)
    if test is None or test[1] not in tests:
        print(f"{file.relative_to(ROOT)}: this names no test of the library:\n{comment}\n")
        wrong += 1
if not comments or not tests:
    sys.exit("No comments, or no tests, were found")
print(f"{len(comments)} deliberate oddities, {wrong} without a test")
sys.exit(wrong > 0)
