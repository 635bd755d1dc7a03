"""What a broker answers otherwise than `cimhost` in its habits does, each with its reason.

This is the whole table: any other difference is a fault, and so is an entry that no answer shows any more. An entry is
a function that gets a question, what answers it without this entry, and the broker's classes.
"""

import dataclasses
import platform
import typing

from changes import names_of, with_instances, with_paths, with_texts
from cim import COMPUTER_SYSTEM, GLIMMARK, Answer, Instance, Path, Question
from questions import ENDS, NO_CLASS

# In the order in which the entries change an answer. Of each broker, those that change what is asked come last, so that
# all others see the question changed.
TABLE = []

BROKERS = {"sfcb": "SFCB", "pegasus": "OpenPegasus"}
TRAVERSALS = {"ain": "AssociatorNames", "ai": "Associators", "rin": "ReferenceNames", "ri": "References"}


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
    """The whole table, for people: in Markdown."""
    rows = [f"| {' and '.join(BROKERS[each] for each in row.brokers)} | {row.reason} |" for row in TABLE]
    return "\n".join(["| Broker | What differs |", "|---|---|", *rows])


def associations_option(question):
    """The parameter of a traversal that names the class of the association."""
    return "AssocClass" if question.operation in ("ain", "ai") else "ResultClass"


def with_unset_properties(answer, names, schema):
    """An answer with the other properties of the classes, of these names in small letters; None for all."""

    def complete(instance):
        declared = schema.properties(instance.class_name).items()
        added = {name: each for name, each in declared if names is None or name.lower() in names}
        return dataclasses.replace(instance, properties={**added, **instance.properties})

    return with_instances(answer, complete)


# --- SFCB ---


@differs("sfcb", reason="Properties that the provider does not set come as null, or with the default of the class.")
def unset_properties_of_sfcb(question, ask, schema):
    # No list is applied to references, and an empty one is none.
    names = None if question.operation == "ri" else names_of(question) or None
    return with_unset_properties(ask(question), names, schema)


SFCB_TEXTS = {
    3: "Invalid namespace",
    5: "Class not found",
    6: "The requested object could not be found",
    7: "The requested operation is not supported",
}


@differs("sfcb", reason="Errors that the broker finds itself, and those without a text, have texts of its own.")
def texts_of_sfcb(question, ask, schema):
    answer = ask(question)
    if answer.message and answer.code not in (3, 5):
        return answer
    return dataclasses.replace(answer, message=SFCB_TEXTS.get(answer.code, answer.message))


@differs("sfcb", reason="A query is answered by the broker, which enumerates the class.")
def queries(question, ask, schema):
    if question.operation != "query":
        return ask(question)
    answer = ask(Question("ei", question.target.split()[-1], namespace=question.namespace))
    place = {"host": platform.node(), "namespace": question.namespace}
    return with_instances(
        answer, lambda instance: dataclasses.replace(instance, path=dataclasses.replace(instance.path, **place)))


@differs("sfcb", reason="A traversal from a path without keys is one of classes, which the broker does not answer.")
def starts_without_keys(question, ask, schema):
    if question.operation in TRAVERSALS and not question.target.keys:
        operation = TRAVERSALS[question.operation].replace("Associators", "Associator")
        return Answer(7, f"{operation} operation for classes not supported")
    return ask(question)


@differs("sfcb", reason="A traversal by an association that nobody serves is answered with 6.")
def unknown_associations(question, ask, schema):
    answer = ask(question)
    if question.operation in TRAVERSALS and answer.code == 5:
        return Answer(6, "Provider not found or not loadable")
    return answer


@differs("sfcb", reason="Characters beyond ASCII, and blanks, are cut off the ends of a key that a client sends.")
def ends_of_keys(question, ask, schema):
    if not isinstance(question.target, Path):
        return ask(question)
    return ask(dataclasses.replace(question, target=with_texts(question.target, cut)))


def cut(text):
    return text.strip(" \t\r\n" + "".join(each for each in text if ord(each) > 0x7F))


# --- OpenPegasus ---


@differs("pegasus", reason="Properties that the provider does not set come as null, or with the default of the class.")
def unset_properties_of_pegasus(question, ask, schema):
    return with_unset_properties(ask(question), names_of(question), schema)


KEYS = {
    COMPUTER_SYSTEM: ["CreationClassName", "Name"],
    GLIMMARK: ["CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName"],
}


@differs("pegasus", reason="Keys that a path in an answer lacks are filled with empty text.")
def filled_keys(question, ask, schema):
    def fill(path):
        return dataclasses.replace(path, keys={**dict.fromkeys(KEYS.get(path.class_name, []), ""), **path.keys})

    return with_paths(ask(question), fill)


@differs("pegasus", reason="A traversal asks the associations of which the object can be an end, each with its class.")
def fitting_associations(question, ask, schema):
    if question.operation not in TRAVERSALS:
        return ask(question)
    option = associations_option(question)
    wanted = question.options.get(option)
    fitting = [association for association, ends in ENDS.items()
               if wanted in (None, association) and question.target.class_name in ends.values()]
    answers = [ask(dataclasses.replace(question, options={**question.options, option: each})) for each in fitting]
    errors = [answer for answer in answers if answer.code]
    return errors[0] if errors else Answer(0, "", tuple(item for answer in answers for item in answer.items))


# What the association's class says of an end where it says less than what is served.
DECLARED = {COMPUTER_SYSTEM: "CIM_ComputerSystem"}


@differs("pegasus", reason="A traversal from a path without keys is one of classes too: the far class comes first.")
def classes_too(question, ask, schema):
    answer = ask(question)
    if question.operation not in TRAVERSALS or question.target.keys or answer.code:
        return answer
    association = question.options[associations_option(question)]
    far = [each for each in ENDS[association].values() if each != question.target.class_name][0]
    found = association if question.operation in ("rin", "ri") else DECLARED.get(far, far)
    item = Path(found, {}, question.namespace, platform.node())
    if question.operation in ("ai", "ri"):
        item = Instance(found, item, schema.properties(found))
    return dataclasses.replace(answer, items=(item, *answer.items))


@differs("pegasus", reason="A class that is not in the namespace is an error, wherever it is named.")
def unknown_classes(question, ask, schema):
    if question.operation in TRAVERSALS:
        association, far = associations_option(question), "ResultClass"
        if NO_CLASS in (question.target.class_name, question.options.get(association)):
            return Answer(4, NO_CLASS)
        if question.options.get(far) == NO_CLASS:
            return Answer(5, NO_CLASS)
    elif question.operation == "gi" and NO_CLASS in [key.class_name for key in references_of(question.target)]:
        return Answer(5, NO_CLASS)
    return ask(question)


def references_of(path):
    return [key for key in path.keys.values() if isinstance(key, Path)]


@differs("pegasus", reason="Keys that are missing are filled with empty text: nothing is found.")
def missing_keys(question, ask, schema):
    if question.operation == "gi" and not question.target.keys:
        return Answer(6)
    return ask(question)


@differs("pegasus", reason="A reference that is no path is an error of its own.")
def malformed_references(question, ask, schema):
    if question.operation == "gi" and question.target.class_name in ENDS:
        for name, key in question.target.keys.items():
            if name in ENDS[question.target.class_name] and not isinstance(key, Path):
                return Answer(1, f'malformed object name: {key}, reason:"class name {key} not a legal CIM name"')
    return ask(question)


PEGASUS_NAMES = {
    1: "CIM_ERR_FAILED",
    3: "CIM_ERR_INVALID_NAMESPACE",
    4: "CIM_ERR_INVALID_PARAMETER",
    5: "CIM_ERR_INVALID_CLASS",
    6: "CIM_ERR_NOT_FOUND",
    7: "CIM_ERR_NOT_SUPPORTED",
}


@differs("pegasus", reason="Texts of errors begin with the name of the code; the broker's own name what is wrong.")
def texts_of_pegasus(question, ask, schema):
    answer = ask(question)
    if not answer.code:
        return answer
    texts = {3: question.namespace, 5: NO_CLASS}
    text = texts.get(answer.code, answer.message)
    return dataclasses.replace(answer, message=PEGASUS_NAMES[answer.code] + (f": {text}" if text else ""))
