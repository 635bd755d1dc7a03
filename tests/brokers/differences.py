"""What a broker answers otherwise than `cimhost` in its habits does, each with its reason.

This is the whole table: any other difference is a fault, and so is an entry that no answer shows any more. An entry is
a function that gets a question, what answers it without this entry, and the broker's classes.
"""

import dataclasses
import typing

from cim import Answer, Instance, Path, Property

TABLE = []


@dataclasses.dataclass(frozen=True, eq=False)
class Difference:
    brokers: tuple
    reason: str
    answer: typing.Callable

    def over(self, ask, schema):
        """What answers as `ask` does, but for this difference."""
        return lambda question: self.answer(question, ask, schema)


def differs(*brokers, reason):
    """Enters a function into the table."""

    def enter(function):
        TABLE.append(Difference(brokers, reason, function))
        return function

    return enter


def known(broker):
    return [difference for difference in TABLE if broker in difference.brokers]


def table():
    """The whole table, a line each, for people."""
    return "\n".join(f"{', '.join(each.brokers)}: {each.reason}" for each in TABLE)


def with_instances(answer, change):
    """An answer whose instances are changed; paths stay."""
    items = (change(item) if isinstance(item, Instance) else item for item in answer.items)
    return dataclasses.replace(answer, items=tuple(items))


def with_paths(answer, change):
    """An answer whose paths are changed, also those within."""

    def inside(value):
        match value:
            case Path():
                return change(dataclasses.replace(value, keys={name: inside(key) for name, key in value.keys.items()}))
            case Property():
                return Property(value.type, inside(value.value))
            case Instance():
                properties = {name: inside(each) for name, each in value.properties.items()}
                return Instance(value.class_name, inside(value.path), properties)
            case _:
                return value

    return dataclasses.replace(answer, items=tuple(map(inside, answer.items)))


@differs("sfcb", "pegasus", reason="Properties that the provider does not set come as null, or with the default of the class.")
def unset_properties(question, ask, schema):
    wanted = question.options.get("PropertyList")

    def complete(instance):
        declared = schema.properties(instance.class_name)
        names = [name for name in declared if wanted is None or name in wanted]
        return dataclasses.replace(instance, properties={**{name: declared[name] for name in names}, **instance.properties})

    return with_instances(ask(question), complete)


SFCB_TEXTS = {
    3: "Invalid namespace",
    5: "Class not found",
    6: "The requested object could not be found",
    7: "The requested operation is not supported",
}


@differs("sfcb", reason="The broker has texts of its own for errors that it finds itself, and for those without a text.")
def texts_of_sfcb(question, ask, schema):
    answer = ask(question)
    return dataclasses.replace(answer, message=SFCB_TEXTS.get(answer.code, answer.message))


@differs("sfcb", reason="References come without the host.")
def references_without_host(question, ask, schema):
    def without(path):
        return dataclasses.replace(path, host=None)

    def at_top(before, after):
        """Paths that are items themselves keep theirs."""
        if isinstance(after, Path):
            return dataclasses.replace(after, host=before.host)
        if after.path is None:
            return after
        return dataclasses.replace(after, path=dataclasses.replace(after.path, host=before.path.host))

    answer = ask(question)
    changed = with_paths(answer, without)
    return dataclasses.replace(changed, items=tuple(map(at_top, answer.items, changed.items)))
