"""What a client can ask about a server, made from the names that are there."""

import itertools

from cim import (CAPABILITIES, CLASSES, COMPUTER_SYSTEM, ELEMENT_CAPABILITIES, GLIMMARK, SYSTEM_DEVICE, Instance, Path,
                 Property, Question)

NO_CLASS = "TAVRO_NoSuchClass"

# Of each association, the roles of its ends and their classes.
ENDS = {
    ELEMENT_CAPABILITIES: {"ManagedElement": GLIMMARK, "Capabilities": CAPABILITIES},
    SYSTEM_DEVICE: {"GroupComponent": COMPUTER_SYSTEM, "PartComponent": GLIMMARK},
}

# Classes of the schema of which only ours have instances on such a server.
SUPERCLASSES = ["CIM_AlarmDevice", "CIM_AlarmDeviceCapabilities"]

# Without keys, with keys, without end: a name of each kind, several, unknown ones, none.
PROPERTY_LISTS = {
    GLIMMARK: [["Name"], ["HealthState", "OperationalStatus"], ["DeviceID"], ["EnabledState"], ["name"],
               ["CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName", "AlarmState"]],
    CAPABILITIES: [["RequestedAlarmStatesSupported"], ["InstanceID"], ["InstanceID", "RequestedAlarmStatesSupported"]],
    ELEMENT_CAPABILITIES: [["ManagedElement"], ["Capabilities", "ManagedElement"]],
    SYSTEM_DEVICE: [["PartComponent"], ["GroupComponent", "PartComponent"]],
}
EVERY_CLASS = [["NoSuchProperty"], ["NoSuchProperty", "Caption"], []]


def property_lists(class_name):
    return [{"PropertyList": names} for names in PROPERTY_LISTS[class_name] + EVERY_CLASS]


def everything(names):
    """All questions of a server.

    names: of each class the paths of its instances, as clients ask with them
    """
    yield from enumerations()
    yield from instances(names)
    yield from traversals(names)
    yield from property_lists_of_traversals(names)
    yield from superclasses()
    yield from bad_paths(names)
    yield from bad_starts(names)
    yield from refusals(names)


def enumerations():
    for class_name in CLASSES:
        yield Question("ein", class_name)
        yield Question("ei", class_name)
        for properties in property_lists(class_name):
            yield Question("ei", class_name, properties)
    for operation in ["ein", "ei"]:
        yield Question(operation, COMPUTER_SYSTEM)
        yield Question(operation, NO_CLASS)
        yield Question(operation, GLIMMARK, namespace="root/none")


def instances(names):
    for class_name in CLASSES:
        for path in names[class_name]:
            yield Question("gi", path)
        for properties in property_lists(class_name):
            yield Question("gi", names[class_name][0], properties)


def traversals(names):
    """From each end of both associations, with every filter, also those that the object has no part in."""
    results = [None, GLIMMARK, CAPABILITIES, COMPUTER_SYSTEM, NO_CLASS]
    for start in starts(names):
        for association in [None, *ENDS, NO_CLASS]:
            roles = [None, "", "NoSuchRole", *ENDS.get(association, [])]
            for operation, chosen in itertools.product(["ain", "ai"], itertools.product(results, roles, roles)):
                options = dict(zip(["AssocClass", "ResultClass", "Role", "ResultRole"], [association, *chosen]))
                yield Question(operation, start, given(options))
            for operation, role in itertools.product(["rin", "ri"], roles):
                yield Question(operation, start, given({"ResultClass": association, "Role": role}))


def starts(names):
    return [names[class_name][0] for class_name in [GLIMMARK, CAPABILITIES, COMPUTER_SYSTEM]]


def given(options):
    return {name: value for name, value in options.items() if value is not None}


def property_lists_of_traversals(names):
    for association, ends in ENDS.items():
        for (near, far) in itertools.permutations(ends.values()):
            start = names[near][0]
            if far in CLASSES:
                for properties in property_lists(far):
                    yield Question("ai", start, {"AssocClass": association, **properties})
            for properties in property_lists(association):
                yield Question("ri", start, {"ResultClass": association, **properties})


def superclasses():
    """The classes of the schema that ours derive from."""
    for operation in ["ein", "ei"]:
        for class_name in SUPERCLASSES:
            yield Question(operation, class_name)


def bad_paths(names):
    for path in wrong_paths(names):
        yield Question("gi", path)
    yield Question("gi", names[GLIMMARK][0], namespace="root/none")


def wrong_paths(names):
    for class_name in CLASSES:
        path = names[class_name][0]
        yield Path(class_name, {})
        yield Path(NO_CLASS, path.keys)
        yield Path(class_name, {**path.keys, "NoSuchKey": "x"})
        yield Path(class_name, {"NoSuchKey": "x"})
        for key, value in path.keys.items():
            yield Path(class_name, {name: value for name, value in path.keys.items() if name != key})
            yield Path(class_name, {key: value})
            yield Path(class_name, {**path.keys, key: 7})
            for other in others(value):
                yield Path(class_name, {**path.keys, key: other})


def others(value):
    """What is no key of an instance that there is."""
    if not isinstance(value, Path):
        return ["none", "", value.upper()]
    unknown = {name: "none" for name in value.keys}
    return [Path(value.class_name, unknown), Path(NO_CLASS, value.keys), Path(value.class_name, {})]


def bad_starts(names):
    """Traversals from what is not there or is no end of an association."""
    glimmark = names[GLIMMARK][0]
    paths = [
        Path(GLIMMARK, {**glimmark.keys, "DeviceID": "none"}),
        Path(GLIMMARK, {"DeviceID": glimmark.keys["DeviceID"]}),
        Path(CAPABILITIES, {"InstanceID": "none"}),
        Path(COMPUTER_SYSTEM, {"CreationClassName": COMPUTER_SYSTEM, "Name": "none"}),
        names[ELEMENT_CAPABILITIES][0],
        Path(NO_CLASS, glimmark.keys),
        Path(GLIMMARK, {}),
    ]
    for path in paths:
        for association in ENDS:
            for operation in ["ain", "ai"]:
                yield Question(operation, path, {"AssocClass": association})
            for operation in ["rin", "ri"]:
                yield Question(operation, path, {"ResultClass": association})


def refusals(names):
    """What would change something, and queries."""
    for class_name in CLASSES:
        path = names[class_name][0]
        changed = {name: Property("string", value) for name, value in path.keys.items() if isinstance(value, str)}
        yield Question("ci", Instance(class_name, None, changed))
        yield Question("mi", Instance(class_name, path, changed))
        yield Question("di", path)
        yield Question("query", f"SELECT * FROM {class_name}")


# --- Fewer questions, for other servers and other purposes ---


def of_each_instance(names):
    """The enumerations of all classes, every instance, and a traversal of each kind from it."""
    for class_name in [*CLASSES, COMPUTER_SYSTEM]:
        yield Question("ein", class_name)
        yield Question("ei", class_name)
    for class_name in CLASSES:
        for path in names[class_name]:
            yield Question("gi", path)
    for association, ends in ENDS.items():
        for class_name in ends.values():
            for path in names[class_name]:
                yield from whole_traversals(path, association)


def whole_traversals(path, association):
    for operation in ["ain", "ai"]:
        yield Question(operation, path, {"AssocClass": association})
    for operation in ["rin", "ri"]:
        yield Question(operation, path, {"ResultClass": association})


def of_many(names):
    """The long answers, and what has to be looked for among many."""
    yield from of_each_instance({class_name: paths[:: max(1, len(paths) - 1)] for class_name, paths in names.items()})


def a_few(names):
    """One of each kind."""
    for class_name in CLASSES:
        yield Question("ein", class_name)
        yield Question("ei", class_name)
        yield Question("gi", names[class_name][-1])
    for association, ends in ENDS.items():
        for class_name in ends.values():
            yield from whole_traversals(names[class_name][0], association)
    yield Question("gi", Path(GLIMMARK, {"DeviceID": "none"}))
    yield Question("di", names[GLIMMARK][0])
