"""Reads the lists of what scripts/coverage and scripts/mutate excuse, each entry with its reason.

An entry is the name of a source file; lines of that file, each behind a mark; and the reason. Blank lines stand
between entries, and comments begin with #. Lines are compared without the blanks around them, wherever they are in
the file, so that an entry holds for as long as the line is there.

    src/example/Example.cpp
    - if (path != nullptr)
    + if (true)
      Every caller has looked.
"""

import collections
import re

Explanation = collections.namedtuple("Explanation", "file lines reason")


def read(name, text, marks, sources):
    """The entries of the list `name`. Explanation.lines has a tuple of lines for each mark, in their order. Those
    behind @, - and | must be in the file: an entry for what is no longer there is an error, as is one without a
    reason. `sources` are texts by file name."""
    entries = []
    text = re.sub(r"^#.*\n", "", text, flags=re.MULTILINE)
    for block in filter(None, (part.strip("\n") for part in re.split(r"\n\s*\n", text))):
        file, *rest = (line.strip() for line in block.splitlines())
        lines = tuple(tuple(line[1:].strip() for line in rest if line.startswith(mark)) for mark in marks)
        reason = " ".join(line for line in rest if line[0] not in marks)
        if file not in sources:
            raise SystemExit(f"{name}: expected a source file, found: {file}")
        if not any(lines) or not reason:
            raise SystemExit(f"{name}: expected lines behind {' '.join(marks)} and a reason:\n{block}")
        present = {line.strip() for line in sources[file].splitlines()}
        for line in (line for mark, group in zip(marks, lines) if mark in "@-|" for line in group):
            if line not in present:
                raise SystemExit(f"{name}: {file} no longer has the line:\n{line}")
        entries.append(Explanation(file, lines, reason))
    return entries
