"""Asks `cimhost serve` with the CIM client wbemcli, and compares what the client prints with what cimhost
answers when it is asked directly.

The rule of the comparison is `printed()` and what it is made of: cimhost's answer as this client prints it.
"""

import json
import os
import pathlib
import subprocess
import tempfile
import unittest
from xml.etree import ElementTree

from endpoint import Endpoint, call, parameter, post

INVENTORIES = pathlib.Path(os.environ["INVENTORIES"])
GLIMMARK = "TAVRO_Glimmark"
CAPABILITIES = "TAVRO_GlimmarkCapabilities"
ELEMENT_CAPABILITIES = "TAVRO_GlimmarkElementCapabilities"
SYSTEM_DEVICE = "TAVRO_GlimmarkSystemDevice"
COMPUTER_SYSTEM = "TAVRO_ComputerSystem"
CLASSES = [GLIMMARK, CAPABILITIES, ELEMENT_CAPABILITIES, SYSTEM_DEVICE]


def literal(value):
    if isinstance(value, bool):
        return "TRUE" if value else "FALSE"
    if isinstance(value, str):
        return '"' + value.replace("\\", "\\\\").replace('"', '\\"') + '"'
    if isinstance(value, list):
        return ",".join(literal(item) for item in value)
    if isinstance(value, dict):
        # The client leaves out the colon behind a namespace after a host.
        place = f"{value['host']}/{value['namespace']}" if value["host"] else f"{value['namespace']}:"
        return place + named(value)
    return str(value)


def named(path):
    keys = ",".join(f"{name}={literal(value)}" for name, value in path["keys"].items())
    return path["className"] + "." + (keys or '*KEYBINDING="MISSING*"')


def local(path):
    """A path as text for cimhost, without the host, which the client does not send either."""
    return path["text"].partition(f"//{path['host']}/")[2] or path["text"]


class Client:
    """wbemcli before an endpoint."""

    def __init__(self, endpoint):
        self.endpoint = endpoint

    def ask(self, *arguments):
        """What it prints: the answer, or the line of the error."""
        run = subprocess.run(["wbemcli", "-nl", *arguments], capture_output=True)
        return (run.stdout + run.stderr.replace(b"\n*\n", b"\n").removeprefix(b"*\n")).decode()

    def printed(self, answer, place=None):
        """cimhost's answer as the client prints it.

        place: what stands before the class of a path, which the client takes from its URL or from the answer
        """
        status = answer["status"]
        if status["code"] != 0:
            name = status["name"].replace("CMPI_RC_", "CIM_")
            return f"* wbemcli: Cim: ({status['code']}) {name}: {status['message'] or ''}\n"
        if "paths" in answer:
            return "".join(self.path(path, place) + "\n" for path in answer["paths"])
        return "".join(self.instance(instance, place) for instance in answer["instances"])

    def path(self, path, place):
        return (place or f"{path['host']}/{path['namespace']}:") + named(path)

    def instance(self, instance, place):
        lines = [f"-{name}={literal(value)}\n" for name, value in instance["properties"].items()]
        return self.path(instance["path"], place) + "\n" + "".join(lines) + "\n"


def typed(path):
    """A path as it is typed for the client, which puts the texts of keys into its XML as they stand."""

    def text(value):
        if isinstance(value, dict):
            return f"{value['namespace']}:{typed(value)}"
        escaped = value.replace("&", "&amp;").replace("<", "&lt;").replace(">", "&gt;")
        return '"' + escaped.replace('"', "&quot;").replace("\r", "&#13;") + '"'

    return path["className"] + "." + ",".join(f"{name}={text(value)}" for name, value in path["keys"].items())


class Comparison(unittest.TestCase):
    maxDiff = 2000

    def start(self, inventory):
        self.endpoint = self.enterContext(Endpoint(inventory))
        self.client = Client(self.endpoint)
        self.place = f"{self.endpoint.host}:{self.endpoint.port}/root/cimv2:"

    def compare_class(self, operation, class_name, properties=()):
        """ein and ei: the client shows its URL's host."""
        answer = self.endpoint.ask_directly(operation, class_name, *properties)
        with self.subTest(operation, class_name=class_name, properties=properties):
            self.assertEqual(
                self.client.ask(operation, self.endpoint.url(class_name), *filter(None, [",".join(properties)])),
                self.client.printed(answer, self.place),
            )
        return answer

    def compare_instance(self, path, properties=()):
        """gi: the client shows the path that it was given."""
        with self.subTest("gi", path=path["text"], properties=properties):
            answer = self.endpoint.ask_directly("gi", local(path), *properties)
            self.assertEqual(answer["status"]["code"], 0, answer)
            asked = self.client.ask("gi", self.endpoint.url(typed(path)), *filter(None, [",".join(properties)]))
            # Behind the path the properties, each on a line.
            expected = self.client.instance(answer["instances"][0], "").partition("\n-")[2]
            self.assertEqual(asked.partition("\n-")[2], expected)

    def compare_traversal(self, operation, path, options, properties=()):
        """ai, ain, ri and rin: the answer has its own hosts."""
        answer = self.endpoint.ask_directly(operation, local(path), *properties, *options)
        with self.subTest(operation, path=path["text"], options=options):
            asked = self.client.ask(
                operation, *options, self.endpoint.url(typed(path)), *filter(None, [",".join(properties)])
            )
            self.assertEqual(asked, self.client.printed(answer))
        return answer

    def paths_of(self, class_name):
        return self.endpoint.ask_directly("ein", class_name)["paths"]


class SmallServer(Comparison):
    def setUp(self):
        self.start(INVENTORIES / "small-server.json")

    def test_enumerations_of_all_classes(self):
        for class_name in [*CLASSES, COMPUTER_SYSTEM]:
            self.assertGreater(len(self.compare_class("ein", class_name)["paths"]), 0)
            self.assertGreater(len(self.compare_class("ei", class_name)["instances"]), 0)

    def test_instances_of_all_classes(self):
        for class_name in CLASSES:
            paths = self.paths_of(class_name)
            for path in [paths[0], paths[-1]]:
                self.compare_instance(path)

    def test_property_lists(self):
        for properties in [["Name"], ["HealthState", "OperationalStatus"], ["NoSuchProperty"]]:
            self.compare_class("ei", GLIMMARK, properties)
            self.compare_instance(self.paths_of(GLIMMARK)[0], properties)
        self.compare_class("ei", CAPABILITIES, ["RequestedAlarmStatesSupported"])
        self.compare_class("ei", SYSTEM_DEVICE, ["PartComponent"])

    def test_both_directions_of_both_associations(self):
        ends = {
            ELEMENT_CAPABILITIES: [(GLIMMARK, "ManagedElement"), (CAPABILITIES, "Capabilities")],
            SYSTEM_DEVICE: [(COMPUTER_SYSTEM, "GroupComponent"), (GLIMMARK, "PartComponent")],
        }
        for association, (left, right) in ends.items():
            for (near, role), (far, far_role) in [(left, right), (right, left)]:
                path = self.paths_of(near)[0]
                for operation in ["ain", "ai"]:
                    filters = ["-ar", role, "-arr", far_role, "-arc", far]
                    for options in [["-ac", association], ["-ac", association, *filters]]:
                        answer = self.compare_traversal(operation, path, options)
                        self.assertTrue(answer.get("paths") or answer.get("instances"), answer)
                for operation in ["rin", "ri"]:
                    for options in [["-arc", association], ["-arc", association, "-ar", role]]:
                        answer = self.compare_traversal(operation, path, options)
                        self.assertTrue(answer.get("paths") or answer.get("instances"), answer)

    def test_traversals_with_property_lists(self):
        path = self.paths_of(CAPABILITIES)[0]
        self.compare_traversal("ai", path, ["-ac", ELEMENT_CAPABILITIES], ["Name", "AlarmState"])

    def test_traversals_that_lead_nowhere(self):
        path = self.paths_of(GLIMMARK)[0]
        for operation in ["ain", "ai"]:
            self.compare_traversal(operation, path, [])
            self.compare_traversal(operation, path, ["-ac", "TAVRO_NoSuchClass"])
            self.compare_traversal(operation, path, ["-ac", SYSTEM_DEVICE, "-ar", "GroupComponent"])
        for operation in ["rin", "ri"]:
            self.compare_traversal(operation, path, [])
            self.compare_traversal(operation, path, ["-arc", "TAVRO_NoSuchClass"])

    def test_errors(self):
        for operation in ["ein", "ei"]:
            answer = self.compare_class(operation, "TAVRO_NoSuchClass")
            self.assertEqual(answer["status"]["code"], 5)
        url = self.endpoint.url(GLIMMARK + '.DeviceID="none"')
        answer = self.endpoint.ask_directly("gi", GLIMMARK + '.DeviceID="none"')
        self.assertEqual(answer["status"]["code"], 6)
        self.assertEqual(self.client.ask("gi", url), self.client.printed(answer))
        answer = self.endpoint.ask_directly("ein", "root/none:" + GLIMMARK)
        self.assertEqual(answer["status"]["code"], 3)
        url = self.endpoint.url(GLIMMARK).replace("cimv2", "none")
        self.assertEqual(self.client.ask("ein", url), self.client.printed(answer))

    def test_what_would_change_something_is_refused_by_the_provider(self):
        for class_name in CLASSES:
            url = self.endpoint.url(typed(self.paths_of(class_name)[0]))
            refusal = "* wbemcli: Cim: (7) CIM_ERR_NOT_SUPPORTED: \n"
            with self.subTest(class_name):
                self.assertEqual(self.client.ask("di", url), refusal)
        url = self.endpoint.url(typed(self.paths_of(GLIMMARK)[0]))
        self.assertEqual(self.client.ask("mi", url, "Name=x"), refusal)

    def test_operations_that_the_client_cannot_ask_alone(self):
        instance = '<INSTANCE CLASSNAME="{0}"/>'
        named_instance = '<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME="{0}"/>' + instance + "</VALUE.NAMEDINSTANCE>"
        connection = self.endpoint.connect()
        self.addCleanup(connection.close)
        for class_name in CLASSES:
            for method, parameters in [
                ("CreateInstance", parameter("NewInstance", instance.format(class_name))),
                ("ModifyInstance", parameter("ModifiedInstance", named_instance.format(class_name))),
                (
                    "ExecQuery",
                    parameter("QueryLanguage", "<VALUE>WQL</VALUE>")
                    + parameter("Query", f"<VALUE>SELECT * FROM {class_name}</VALUE>"),
                ),
            ]:
                with self.subTest(method, class_name=class_name):
                    status, text = post(connection, *call(method, parameters))
                    self.assertEqual(status, 200, text)
                    # The provider's refusal has no description, the endpoint's own would have one.
                    self.assertIn(f'<IMETHODRESPONSE NAME="{method}"><ERROR CODE="7"></ERROR>', text)

    def test_what_is_not_served(self):
        self.assertEqual(
            self.client.ask("gp", self.endpoint.url(typed(self.paths_of(GLIMMARK)[0])), "Name"),
            "* wbemcli: Cim: (7) CIM_ERR_NOT_SUPPORTED: the operation GetProperty is not served\n",
        )
        self.assertEqual(
            self.client.ask("cm", self.endpoint.url(typed(self.paths_of(CAPABILITIES)[0])), "NoSuchMethod"),
            "* wbemcli: Cim: (7) CIM_ERR_NOT_SUPPORTED: methods of classes are not served\n",
        )

    def test_superclasses(self):
        for operation in ["ein", "ei"]:
            answer = self.compare_class(operation, "CIM_AlarmDevice")
            self.assertEqual(self.endpoint.ask_directly(operation, GLIMMARK), answer)
        self.assertEqual(len(self.compare_class("ein", "CIM_EnabledLogicalElement")["paths"]), 14)
        indicator = self.paths_of(GLIMMARK)[0]
        for operation in ["ain", "ai"]:
            for association, far, result_class in [
                ("CIM_Component", "CIM_ManagedElement", COMPUTER_SYSTEM),
                ("CIM_ElementCapabilities", "CIM_Capabilities", CAPABILITIES),
            ]:
                answer = self.compare_traversal(operation, indicator, ["-ac", association, "-arc", far])
                found = answer.get("paths") or [instance["path"] for instance in answer["instances"]]
                self.assertEqual([path["className"] for path in found], [result_class])
            answer = self.compare_traversal(operation, indicator, ["-ac", "CIM_Component", "-arc", "CIM_Capabilities"])
            self.assertFalse(answer.get("paths") or answer.get("instances"))
        for operation in ["rin", "ri"]:
            answer = self.compare_traversal(operation, indicator, ["-arc", "CIM_SystemDevice"])
            self.assertEqual(self.endpoint.ask_directly(operation, local(indicator), "-arc", SYSTEM_DEVICE), answer)


class TheSchema(Comparison):
    """gc, gcd, ec, ecn: what the installed MOF declares."""

    def setUp(self):
        self.start(INVENTORIES / "small-server.json")

    def names(self, class_name):
        return self.client.ask("ecn", self.endpoint.url(class_name)).replace(self.place, "").split()

    def test_a_class(self):
        printed = self.client.ask("gc", self.endpoint.url(CAPABILITIES))
        properties = ["Caption", "Description", "ElementName", "InstanceID", "RequestedAlarmStatesSupported"]
        self.assertEqual(printed, self.place + CAPABILITIES + "\n" + "".join(f"-{each}=\n" for each in properties) + "\n")
        for superclass in ["CIM_AlarmDevice", "CIM_SystemDevice", "CIM_ManagedElement"]:
            self.assertTrue(self.client.ask("gc", self.endpoint.url(superclass)).startswith(self.place + superclass))

    def test_an_unknown_class(self):
        url = self.endpoint.url("CIM_NoSuchClass")
        said = "no class CIM_NoSuchClass is known in root/cimv2"
        self.assertEqual(self.client.ask("gc", url), f"* wbemcli: Cim: (6) CIM_ERR_NOT_FOUND: {said}\n")
        for operation in ["ec", "ecn"]:
            self.assertEqual(self.client.ask(operation, url), f"* wbemcli: Cim: (5) CIM_ERR_INVALID_CLASS: {said}\n")

    def test_classes_of_a_class(self):
        self.assertEqual(self.names("CIM_AlarmDevice"), [GLIMMARK])
        self.assertEqual(self.names(GLIMMARK), [])
        self.assertEqual(len(self.names("")), 20)
        self.assertEqual(set(self.names("")) & set(CLASSES), set(CLASSES))
        declared = self.client.ask("ec", self.endpoint.url("CIM_Capabilities"))
        self.assertIn(f"{CAPABILITIES} : CIM_AlarmDeviceCapabilities\n", declared)

    def test_the_keys_of_a_class(self):
        connection = self.endpoint.connect()
        self.addCleanup(connection.close)
        parameters = parameter("ClassName", f'<CLASSNAME NAME="{GLIMMARK}"/>')
        text = post(connection, *call("GetClass", parameters + parameter("LocalOnly", "<VALUE>false</VALUE>")))[1]
        declared = ElementTree.fromstring(text).find(".//CLASS")
        keys = [each.get("NAME") for each in declared if each.find("QUALIFIER[@NAME='Key']") is not None]
        self.assertEqual(sorted(keys), sorted(self.paths_of(GLIMMARK)[0]["keys"]))


class EnumerationsInPieces(Comparison):
    """Which wbemcli does not know."""

    def setUp(self):
        self.start(INVENTORIES / "small-server.json")
        self.connection = self.endpoint.connect()
        self.addCleanup(self.connection.close)

    def call(self, method, **parameters):
        """The root of the response, and the context and the end that it tells."""
        given = "".join(
            parameter(name, value if value.startswith("<") else f"<VALUE>{value}</VALUE>")
            for name, value in parameters.items()
        )
        status, text = post(self.connection, *call(method, given))
        self.assertEqual(status, 200, text)
        response = ElementTree.fromstring(text).find(".//IMETHODRESPONSE")
        out = {each.get("NAME"): each.findtext("VALUE") for each in response.findall("PARAMVALUE")}
        return response, out.get("EnumerationContext"), out.get("EndOfSequence")

    def error(self, method, **parameters):
        return self.call(method, **parameters)[0].find("ERROR").get("CODE")

    def compare(self, method, pull, element, whole, whole_element, **parameters):
        """Pieces of five are together the whole answer."""
        response, context, end = self.call("Open" + method, MaxObjectCount="5", **parameters)
        found = response.findall(f"IRETURNVALUE/{element}")
        sizes = [len(found)]
        while end == "FALSE":
            response, context, end = self.call(pull, EnumerationContext=context, MaxObjectCount="5")
            sizes.append(len(response.findall(f"IRETURNVALUE/{element}")))
            found += response.findall(f"IRETURNVALUE/{element}")
        names = {"ObjectName" if name == "InstanceName" else name: value for name, value in parameters.items()}
        expected = self.call(whole, **names)[0].findall(f"IRETURNVALUE/{whole_element}")
        def keys(items):
            return [[key.text for key in item.find(".//INSTANCENAME").iter("KEYVALUE")] for item in items]

        self.assertEqual(sizes, [5, 5, 3])
        self.assertEqual(keys(found), keys(expected))
        self.assertEqual([len(item.findall("INSTANCE/*")) for item in found],
                         [len(item.findall("INSTANCE/*")) for item in expected])

    def test_all_six(self):
        devices = '<CLASSNAME NAME="CIM_AlarmDevice"/>'
        tie = f'<CLASSNAME NAME="{ELEMENT_CAPABILITIES}"/>'
        start = (
            f'<INSTANCENAME CLASSNAME="{CAPABILITIES}"><KEYVALUE VALUETYPE="string">TAVRO:GlimmarkCapabilities1'
            "</KEYVALUE></INSTANCENAME>"
        )
        with_path = ("PullInstancesWithPath", "VALUE.INSTANCEWITHPATH")
        of_path = ("PullInstancePaths", "INSTANCEPATH")
        self.compare("EnumerateInstances", *with_path, "EnumerateInstances", "VALUE.NAMEDINSTANCE", ClassName=devices)
        self.compare("AssociatorInstances", *with_path, "Associators", "VALUE.OBJECTWITHPATH",
                     InstanceName=start, AssocClass=tie)
        self.compare("ReferenceInstances", *with_path, "References", "VALUE.OBJECTWITHPATH",
                     InstanceName=start, ResultClass=tie)
        self.compare("AssociatorInstancePaths", *of_path, "AssociatorNames", "OBJECTPATH/INSTANCEPATH",
                     InstanceName=start, AssocClass=tie)
        self.compare("ReferenceInstancePaths", *of_path, "ReferenceNames", "OBJECTPATH/INSTANCEPATH",
                     InstanceName=start, ResultClass=tie)
        response, _, end = self.call("OpenEnumerateInstancePaths", ClassName=devices, MaxObjectCount="13")
        self.assertEqual((len(response.findall("IRETURNVALUE/INSTANCEPATH")), end), (13, "TRUE"))

    def test_counting_and_closing(self):
        devices = f'<CLASSNAME NAME="{GLIMMARK}"/>'
        _, context, end = self.call("OpenEnumerateInstances", ClassName=devices)
        self.assertEqual(end, "FALSE")
        count = self.call("EnumerationCount", EnumerationContext=context)[0].findtext("IRETURNVALUE/VALUE")
        self.assertEqual(count, "13")
        self.assertEqual(self.error("PullInstancePaths", EnumerationContext=context, MaxObjectCount="1"), "21")
        self.assertIsNone(self.call("CloseEnumeration", EnumerationContext=context)[0].find("ERROR"))
        self.assertEqual(self.error("CloseEnumeration", EnumerationContext=context), "21")

    def test_the_most_at_once(self):
        devices = f'<CLASSNAME NAME="{GLIMMARK}"/>'
        contexts = [self.call("OpenEnumerateInstancePaths", ClassName=devices)[1] for _ in range(64)]
        self.assertEqual(self.error("OpenEnumerateInstancePaths", ClassName=devices), "27")
        self.call("CloseEnumeration", EnumerationContext=contexts[0])
        self.assertTrue(self.call("OpenEnumerateInstancePaths", ClassName=devices)[1])

    def test_properties_of_the_class_asked_for_alone(self):
        asked = {"ClassName": '<CLASSNAME NAME="CIM_EnabledLogicalElement"/>', "MaxObjectCount": "100"}
        for deep in ["true", "false"]:
            response = self.call("OpenEnumerateInstances", DeepInheritance=deep, **asked)[0]
            names = {each.get("NAME") for each in response.iterfind(".//INSTANCE/*")}
            self.assertIn("HealthState", names)
            self.assertEqual("AlarmState" in names, deep == "true")


class TextOfManyKinds(Comparison):
    """Blanks, quotes, backslashes, ampersands, line ends and many scripts."""

    def setUp(self):
        nodes = json.loads((INVENTORIES / "edge-cases-readable.json").read_text())["nodes"]
        for text in ["Ampersand & <angle> &amp; ]]>", "100% \u00e9\u20ac\U0001f6a8", "apostrophe's"]:
            nodes.append({"kind": "diagnostic indicator", "description": text, "path": "/" + text, "status": 1})
        file = self.enterContext(tempfile.NamedTemporaryFile("w", suffix=".json"))
        json.dump({"nodes": nodes}, file)
        file.flush()
        self.start(file.name)

    def test_enumerations(self):
        for class_name in CLASSES:
            self.compare_class("ein", class_name)
            self.compare_class("ei", class_name)

    def test_instances(self):
        for path in self.paths_of(GLIMMARK):
            self.compare_instance(path)

    def test_traversals(self):
        for path in self.paths_of(GLIMMARK):
            self.compare_traversal("ain", path, ["-ac", SYSTEM_DEVICE])
            self.compare_traversal("rin", path, ["-arc", ELEMENT_CAPABILITIES])


class ManyIndicators(Comparison):
    def setUp(self):
        nodes = [
            {"kind": "diagnostic indicator", "description": f"LED {i}", "path": f"/rack/{i}", "status": i % 30}
            for i in range(5000)
        ]
        file = self.enterContext(tempfile.NamedTemporaryFile("w", suffix=".json"))
        json.dump({"nodes": nodes}, file)
        file.flush()
        self.start(file.name)

    def test_enumerations(self):
        self.assertEqual(len(self.compare_class("ein", GLIMMARK)["paths"]), 5000)
        self.assertEqual(len(self.compare_class("ei", GLIMMARK)["instances"]), 5000)

    def test_traversal(self):
        answer = self.compare_traversal("ain", self.paths_of(CAPABILITIES)[0], ["-ac", ELEMENT_CAPABILITIES])
        self.assertEqual(len(answer["paths"]), 5000)


if __name__ == "__main__":
    unittest.main()
