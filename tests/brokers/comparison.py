"""Compares what a broker answers with what is expected of it: what is described, as the known differences change it.
Each known difference has to be needed for at least one question."""

import dataclasses
import difflib

from cim import Answer

SHOWN = 30  # lines of each difference


def expectation(ask, differences, schema):
    """What answers a question as the broker is expected to.

    ask: what answers it as described; differences: in the order in which they change it
    """
    for difference in differences:
        ask = difference.over(ask, schema)
    return ask


class Comparison:
    """Of a broker's answers with those that are described.

    broker and described: each answers a question; schema: the broker's classes, for the differences
    """

    def __init__(self, broker, described, differences, schema):
        self.broker = broker
        self.expected = expectation(described, differences, schema)
        self.without = {
            each: expectation(described, [other for other in differences if other is not each], schema)
            for each in differences
        }

    def compare(self, questions):
        """How many questions were asked, and a text about each answer that is not as expected."""
        count, faults = 0, []
        for question in questions:
            count += 1
            found = sorted_by_class(self.broker(question))
            expected = sorted_by_class(self.expected(question))
            if found != expected:
                faults.append(f"{question}\n{shown(expected, found)}")
                continue
            for difference in [each for each, ask in self.without.items() if sorted_by_class(ask(question)) != found]:
                del self.without[difference]
        return count, faults

    def not_seen(self):
        """The differences that are known and that no answer showed."""
        return [difference.reason for difference in self.without]


def sorted_by_class(answer):
    """An answer whose items of each class stand together, in their order: of several providers any may answer first."""
    if not isinstance(answer, Answer):
        return answer
    return dataclasses.replace(answer, items=tuple(sorted(answer.items, key=lambda item: item.class_name)))


def shown(expected, found):
    """Where two answers differ first."""
    if not (isinstance(found, Answer) and len(expected.items) == len(found.items) > 0):
        return f"  expected {outline(expected)}\n  found {outline(found)}"
    pairs = [(one, other) for one, other in zip(expected.items, found.items) if one != other]
    one, other = (str(each).splitlines() for each in pairs[0])
    lines = list(difflib.unified_diff(one, other, n=0, lineterm=""))[2:]
    kept = [line for line in lines if not line.startswith("@@")] or ["the same in letters, and not in kind"]
    return "\n".join([f"  {len(pairs)} of {len(found.items)} items differ, the first:", *kept[:SHOWN]])


def outline(answer):
    """A status, or how many items; whatever else was found as it is."""
    if not isinstance(answer, Answer):
        return str(answer)
    first = f", the first {str(answer.items[0]).splitlines()[0]}" if answer.items else ""
    return str(answer) if answer.code else f"{len(answer.items)} items{first}"
