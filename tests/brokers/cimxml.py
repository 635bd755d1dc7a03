"""A CIM client: questions to a server as CIM-XML over HTTP (DMTF DSP0200 and DSP0201), and its answers."""

import http.client
import time
import xml.etree.ElementTree as ET

from cim import Answer, Instance, Path, Property, Question

# The intrinsic method behind each short name, and its parameter for the target.
METHODS = {
    "ein": ("EnumerateInstanceNames", "ClassName"),
    "ei": ("EnumerateInstances", "ClassName"),
    "gi": ("GetInstance", "InstanceName"),
    "ain": ("AssociatorNames", "ObjectName"),
    "ai": ("Associators", "ObjectName"),
    "rin": ("ReferenceNames", "ObjectName"),
    "ri": ("References", "ObjectName"),
    "ci": ("CreateInstance", "NewInstance"),
    "mi": ("ModifyInstance", "ModifiedInstance"),
    "di": ("DeleteInstance", "InstanceName"),
    "query": ("ExecQuery", "Query"),
    "gc": ("GetClass", "ClassName"),
}

# Said where the operation has the parameter, as its default differs from broker to broker.
ALWAYS = {
    "ei": {"LocalOnly": False, "DeepInheritance": True, "IncludeQualifiers": False, "IncludeClassOrigin": False},
    "gi": {"LocalOnly": False, "IncludeQualifiers": False, "IncludeClassOrigin": False},
    "ai": {"IncludeQualifiers": False, "IncludeClassOrigin": False},
    "ri": {"IncludeQualifiers": False, "IncludeClassOrigin": False},
    "gc": {"LocalOnly": False, "IncludeQualifiers": False, "IncludeClassOrigin": False},
    "query": {"QueryLanguage": "WQL"},
}

CLASS_NAMES = {"ClassName", "AssocClass", "ResultClass"}


# Servers close connections that are idle for longer than this.
IDLE = 5


class Client:
    """A kept connection to a server, opened again where the server says that it closed it, and where it may have closed it
    because nothing was asked for long; for one thread."""

    def __init__(self, port, timeout=120):
        self.connection = http.client.HTTPConnection("127.0.0.1", port, timeout=timeout)
        self.used = time.monotonic()

    def __enter__(self):
        return self

    def __exit__(self, *_):
        self.connection.close()

    def ask(self, question):
        """The answer; a RuntimeError for what is no CIM-XML response."""
        return read_answer(question, self.send(question))

    def send(self, question):
        """The bytes of the response to a question."""
        method = METHODS[question.operation][0]
        headers = {
            "Content-Type": 'application/xml; charset="utf-8"',
            "CIMOperation": "MethodCall",
            "CIMMethod": method,
            "CIMObject": question.namespace,
        }
        if time.monotonic() - self.used > IDLE:
            self.connection.close()
        self.connection.request("POST", "/cimom", message(question), headers)
        response = self.connection.getresponse()
        body = response.read()
        self.used = time.monotonic()
        if response.status != 200:
            raise RuntimeError(f"{question}: HTTP status {response.status} {response.reason}")
        return body


# --- Questions ---


def message(question):
    """The request message of a question."""
    method, target = METHODS[question.operation]
    root = ET.Element("CIM", CIMVERSION="2.0", DTDVERSION="2.0")
    simple = ET.SubElement(ET.SubElement(root, "MESSAGE", ID="1", PROTOCOLVERSION="1.0"), "SIMPLEREQ")
    call = ET.SubElement(simple, "IMETHODCALL", NAME=method)
    call.append(local_namespace(question.namespace))
    for name, value in {target: question.target, **ALWAYS.get(question.operation, {}), **question.options}.items():
        ET.SubElement(call, "IPARAMVALUE", NAME=name).append(parameter(name, value))
    return ET.tostring(root, encoding="utf-8", xml_declaration=True)


def local_namespace(namespace):
    element = ET.Element("LOCALNAMESPACEPATH")
    for name in namespace.split("/"):
        ET.SubElement(element, "NAMESPACE", NAME=name)
    return element


def parameter(name, value):
    match value:
        case Path():
            return instance_name(value)
        case Instance(path=None):
            return instance(value)
        case Instance():
            named = ET.Element("VALUE.NAMEDINSTANCE")
            named.extend([instance_name(value.path), instance(value)])
            return named
        case list():
            array = ET.Element("VALUE.ARRAY")
            array.extend(text_element("VALUE", item) for item in value)
            return array
        case bool():
            return text_element("VALUE", "TRUE" if value else "FALSE")
        case _ if name in CLASS_NAMES:
            return ET.Element("CLASSNAME", NAME=value)
        case _:
            return text_element("VALUE", value)


def text_element(tag, text, **attributes):
    element = ET.Element(tag, attributes)
    element.text = text
    return element


def instance_name(path):
    element = ET.Element("INSTANCENAME", CLASSNAME=path.class_name)
    for name, value in path.keys.items():
        binding = ET.SubElement(element, "KEYBINDING", NAME=name)
        if isinstance(value, Path):
            binding.append(reference(value))
        elif isinstance(value, int):
            binding.append(text_element("KEYVALUE", str(value), VALUETYPE="numeric"))
        else:
            binding.append(text_element("KEYVALUE", value, VALUETYPE="string"))
    return element


def reference(path):
    element = ET.Element("VALUE.REFERENCE")
    local = ET.SubElement(element, "LOCALINSTANCEPATH")
    local.extend([local_namespace(path.namespace or "root/cimv2"), instance_name(path)])
    return element


def instance(value):
    element = ET.Element("INSTANCE", CLASSNAME=value.class_name)
    for name, each in value.properties.items():
        prop = ET.SubElement(element, "PROPERTY", NAME=name, TYPE=each.type)
        prop.append(text_element("VALUE", str(each.value)))
    return element


# --- Answers ---


def read_answer(question, body):
    try:
        response = ET.fromstring(body).find("MESSAGE/SIMPLERSP/IMETHODRESPONSE")
    except ET.ParseError as error:
        raise RuntimeError(f"{question}: {error} in {body[:2000]!r}") from error
    if response is None:
        raise RuntimeError(f"{question}: no response in {body[:2000]!r}")
    error = response.find("ERROR")
    if error is not None:
        return Answer(int(error.get("CODE")), error.get("DESCRIPTION", ""))
    return Answer(0, "", tuple(map(read_item, response.findall("IRETURNVALUE/*"))))


def read_item(element):
    """A path, or an instance; of a class its properties with their defaults, as an instance."""
    match element.tag:
        case "INSTANCENAME":
            return read_path(element)
        case "OBJECTPATH":
            return read_path(element[0])
        case "INSTANCE" | "CLASS":
            return read_instance(element, None)
        case "VALUE.NAMEDINSTANCE" | "VALUE.OBJECTWITHPATH":
            return read_instance(element[1], read_path(element[0]))
        case _:
            raise RuntimeError(f"an item {element.tag} in an answer")


def read_path(element):
    """An INSTANCENAME, or what puts it into a namespace or onto a host."""
    name = next(element.iter("INSTANCENAME"))
    keys = {binding.get("NAME"): read_key(binding[0]) for binding in name.findall("KEYBINDING")}
    # The path's own, and not those of paths among its keys.
    local = element if element.tag == "LOCALINSTANCEPATH" else element.find("NAMESPACEPATH")
    namespace = local.find("LOCALNAMESPACEPATH") if local is not None else None
    spaces = None if namespace is None else "/".join(each.get("NAME") for each in namespace)
    return Path(name.get("CLASSNAME"), keys, spaces, element.findtext("NAMESPACEPATH/HOST"))


def read_key(element):
    if element.tag == "VALUE.REFERENCE":
        return read_path(element[0])
    text = element.text or ""
    return int(text) if element.get("VALUETYPE") == "numeric" else text


def read_instance(element, path):
    properties = {each.get("NAME"): read_property(each) for each in element if each.tag.startswith("PROPERTY")}
    return Instance(element.get("CLASSNAME") or element.get("NAME"), path, properties)


def read_property(element):
    type_name = element.get("TYPE", "reference")
    match element.tag:
        case "PROPERTY.REFERENCE":
            found = element.find("VALUE.REFERENCE")
            value = None if found is None else read_path(found[0])
        case "PROPERTY.ARRAY":
            found = element.find("VALUE.ARRAY")
            value = None if found is None else [read_value(type_name, each) for each in found]
            type_name += "[]"
        case _:
            found = element.find("VALUE")
            value = None if found is None else read_value(type_name, found)
    return Property(type_name, value)


def read_value(type_name, element):
    text = element.text or ""
    if element.tag == "VALUE.NULL":
        return None
    if type_name == "boolean":
        return text.upper() == "TRUE"
    if type_name in ("string", "datetime", "char16"):
        return text
    return float(text) if type_name.startswith("real") else int(text)
