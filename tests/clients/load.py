"""Requests in a row over several kept connections at once, good ones and hostile ones; every answer is checked.

    CIMHOST=build/asan/bin/cimhost INVENTORIES=platform/instrumentation/inventories \\
        python3 tests/clients/load.py --requests 10000 --connections 8
"""

import argparse
import collections
import os
import pathlib
import threading

from endpoint import Endpoint, call, parameter, post

GLIMMARK = '<CLASSNAME NAME="TAVRO_Glimmark"/>'
FAN = (
    '<INSTANCENAME CLASSNAME="TAVRO_Glimmark"><KEYBINDING NAME="DeviceID"><KEYVALUE>'
    "Fan 1 Fault LED:/chassis-1/fan-1/indicator-1</KEYVALUE></KEYBINDING></INSTANCENAME>"
)
CAPABILITIES = (
    '<INSTANCENAME CLASSNAME="TAVRO_GlimmarkCapabilities"><KEYBINDING NAME="InstanceID"><KEYVALUE>'
    "TAVRO:GlimmarkCapabilities1</KEYVALUE></KEYBINDING></INSTANCENAME>"
)
ASSOCIATION = '<CLASSNAME NAME="TAVRO_GlimmarkElementCapabilities"/>'
MOST = ("MaxObjectCount", "<VALUE>100</VALUE>")
BOMB = b'<!DOCTYPE CIM [<!ENTITY a "aaaa"><!ENTITY b "&a;&a;&a;&a;">]><CIM>&b;&b;&b;&b;</CIM>'

Case = collections.namedtuple("Case", "name message headers status count_of count")


def operation(method, parameters, count_of, count):
    message, headers = call(method, "".join(parameter(*each) for each in parameters))
    return Case(method, message, headers, 200, count_of, count)


def hostile(name, message, status, text, **headers):
    return Case(name, message, {**call("GetInstance", "")[1], **headers}, status, text, 1)


# The inventory has 13 indicators.
CASES = [
    operation("EnumerateInstanceNames", [("ClassName", GLIMMARK)], "<INSTANCENAME ", 13),
    operation("EnumerateInstances", [("ClassName", GLIMMARK)], "<VALUE.NAMEDINSTANCE>", 13),
    operation("GetInstance", [("InstanceName", FAN)], "<INSTANCE ", 1),
    operation("AssociatorNames", [("ObjectName", CAPABILITIES), ("AssocClass", ASSOCIATION)], "<OBJECTPATH>", 13),
    operation("Associators", [("ObjectName", FAN), ("AssocClass", ASSOCIATION)], "<VALUE.OBJECTWITHPATH>", 1),
    operation("References", [("ObjectName", FAN), ("ResultClass", ASSOCIATION)], "<VALUE.OBJECTWITHPATH>", 1),
    operation("ReferenceNames", [("ObjectName", CAPABILITIES), ("ResultClass", ASSOCIATION)], "<OBJECTPATH>", 13),
    operation("DeleteInstance", [("InstanceName", FAN)], '<ERROR CODE="7">', 1),
    operation("EnumerateInstanceNames", [("ClassName", '<CLASSNAME NAME="CIM_AlarmDevice"/>')], "<INSTANCENAME ", 13),
    operation("GetClass", [("ClassName", GLIMMARK)], "<CLASS ", 1),
    operation("EnumerateClassNames", [("DeepInheritance", "<VALUE>true</VALUE>")], "<CLASSNAME ", 20),
    operation("OpenEnumerateInstancePaths", [("ClassName", GLIMMARK), MOST], "<INSTANCEPATH>", 13),
    operation("GetQualifier", [], '<ERROR CODE="7" ', 1),
    operation("EnumerateInstances", [("ClassName", '<CLASSNAME NAME="CIM_Fan"/>')], '<ERROR CODE="5" ', 1),
    operation("EnumerateInstances", [], '<ERROR CODE="4" ', 1),
    hostile("an entity bomb", BOMB, 400, "found a document type declaration"),
    hostile("deep nesting", b"<CIM>" * 2000, 413, "deep in each other"),
    hostile("many elements", b"<CIM>" + b"<VALUE/>" * 20000 + b"</CIM>", 413, "at most 20000 elements"),
    hostile("many attributes", b"<CIM" + b" a=''" * 150000 + b"/>", 413, "at most 100 attributes of an element"),
    hostile("a page in a browser", call("GetInstance", "")[0], 403, "Origin", Origin="http://evil.example"),
    hostile("another host's name", call("GetInstance", "")[0], 421, "Host", Host="evil.example"),
    hostile("a huge attribute", b'<CIM CIMVERSION="' + b"x" * 100000 + b'"/>', 501, "expected 2.x"),
    hostile("another encoding", "<CIM/>".encode("utf-16"), 400, "not UTF-8"),
    hostile("half a message", call("GetInstance", "")[0][:-20], 400, "well-formed"),
]


def check(case, status, text):
    if status != case.status or text.count(case.count_of) != case.count:
        raise AssertionError(
            f"{case.name}: expected status {case.status} and {case.count} times {case.count_of}, "
            f"found status {status} and {text[:2000]}"
        )


def ask(endpoint, first, requests, failures):
    """Sends that many requests over one connection, beginning at that place in the list of cases."""
    try:
        connection = endpoint.connect()
        for index in range(requests):
            case = CASES[(first + index) % len(CASES)]
            check(case, *post(connection, case.message, case.headers))
        connection.close()
    except Exception as error:  # told by the main thread
        failures.append(f"{type(error).__name__}: {error}")


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--requests", type=int, default=10000, help="in all (default: %(default)s)")
    parser.add_argument("--connections", type=int, default=8, help="at once (default: %(default)s)")
    options = parser.parse_args()

    failures = []
    each = options.requests // options.connections
    with Endpoint(pathlib.Path(os.environ["INVENTORIES"]) / "small-server.json") as endpoint:
        threads = [
            threading.Thread(target=ask, args=(endpoint, first, each, failures))
            for first in range(options.connections)
        ]
        for thread in threads:
            thread.start()
        for thread in threads:
            thread.join()
    for failure in failures:
        print(failure)
    if failures:
        raise SystemExit(1)
    print(f"{each * options.connections} requests over {options.connections} connections, all answered as expected")


if __name__ == "__main__":
    main()
