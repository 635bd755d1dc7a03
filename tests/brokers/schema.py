"""The classes that a broker knows, by asking it."""

import functools

from cim import Question


class Schema:
    def __init__(self, ask):
        self.ask = ask

    @functools.cache
    def properties(self, class_name):
        """The properties of a class by name, each with its default or null."""
        answer = self.ask(Question("gc", class_name))
        return answer.items[0].properties if answer.items else {}
