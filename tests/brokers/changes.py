"""Answers and questions changed in one respect, for the known differences."""

import dataclasses

from cim import Instance, Path, Property


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
            case Property(value=Path()):
                return Property(value.type, inside(value.value))
            case Instance():
                properties = {name: inside(each) for name, each in value.properties.items()}
                return Instance(value.class_name, inside(value.path), properties)
            case _:
                return value

    return dataclasses.replace(answer, items=tuple(map(inside, answer.items)))


def with_texts(path, change):
    """A path whose texts are changed, also those of paths within."""

    def inside(value):
        if isinstance(value, Path):
            return with_texts(value, change)
        return change(value) if isinstance(value, str) else value

    return dataclasses.replace(path, keys={name: inside(value) for name, value in path.keys.items()})


def names_of(question):
    """The names of the property list in small letters, as case does not tell names apart; None if there is no list."""
    names = question.options.get("PropertyList")
    return None if names is None else [name.lower() for name in names]
