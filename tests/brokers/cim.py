"""Object paths, instances, questions and answers, as they are compared. Values are Python's: texts, numbers, truth
values, lists of them, paths; None is CIM's null."""

import dataclasses

NAMESPACE = "root/cimv2"

GLIMMARK = "TAVRO_Glimmark"
CAPABILITIES = "TAVRO_GlimmarkCapabilities"
ELEMENT_CAPABILITIES = "TAVRO_GlimmarkElementCapabilities"
SYSTEM_DEVICE = "TAVRO_GlimmarkSystemDevice"
COMPUTER_SYSTEM = "TAVRO_ComputerSystem"
CLASSES = [GLIMMARK, CAPABILITIES, ELEMENT_CAPABILITIES, SYSTEM_DEVICE]


@dataclasses.dataclass(frozen=True)
class Path:
    """An instance's name; host and namespace are None where the answer has none."""

    class_name: str
    keys: dict
    namespace: str | None = None
    host: str | None = None

    def local(self):
        """The same without host and namespace, as a client asks with it."""
        keys = {name: value.local() if isinstance(value, Path) else value for name, value in self.keys.items()}
        return Path(self.class_name, keys)

    def __str__(self):
        place = f"//{self.host}/" if self.host else ""
        place += f"{self.namespace}:" if self.namespace else ""
        keys = ",".join(f"{name}={literal(value)}" for name, value in sorted(self.keys.items()))
        return f"{place}{self.class_name}.{keys}"


@dataclasses.dataclass(frozen=True)
class Property:
    """A value with its CIM type, "reference" for a path; arrays are lists."""

    type: str
    value: object

    def __str__(self):
        return f"{self.type} {literal(self.value)}"


@dataclasses.dataclass(frozen=True)
class Instance:
    """path is None in the answer to GetInstance, which brings none."""

    class_name: str
    path: Path | None
    properties: dict

    def __str__(self):
        lines = [f"  {name} = {value}" for name, value in sorted(self.properties.items())]
        return "\n".join([str(self.path or self.class_name), *lines])


@dataclasses.dataclass(frozen=True)
class Question:
    """An operation by its short name, asked of a class (its name), a path, or an instance that would be written."""

    operation: str
    target: object
    options: dict = dataclasses.field(default_factory=dict)
    namespace: str = NAMESPACE

    def __str__(self):
        words = [self.operation, str(self.target).splitlines()[0]]
        words += [f"{name}={value}" for name, value in self.options.items()]
        words += [f"namespace={self.namespace}"] if self.namespace != NAMESPACE else []
        return " ".join(words)


@dataclasses.dataclass(frozen=True)
class Answer:
    """A status, and paths or instances after a good one."""

    code: int
    message: str = ""
    items: tuple = ()

    def __str__(self):
        if self.code:
            return f"({self.code}) {self.message}"
        return "\n".join([f"{len(self.items)} items", *map(str, self.items)])


def literal(value):
    """A value as object paths show it."""
    match value:
        case None:
            return "null"
        case bool():
            return "TRUE" if value else "FALSE"
        case list():
            return "{" + ", ".join(literal(item) for item in value) + "}"
        case int():
            return str(value)
        case _:
            return '"' + str(value).replace("\\", "\\\\").replace('"', '\\"') + '"'
