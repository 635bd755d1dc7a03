"""What `cimhost serve` spends on requests that are made to cost much, beside plain ones of the same size; how long it
takes to end while it reads them; and what it holds while it answers with 65,535 indicators.

    CIMHOST=build/release/bin/cimhost python3 tests/clients/costs.py

It measures, and so it is no test: docs/figures.md has what it printed.
"""

import itertools
import json
import os
import pathlib
import re
import signal
import socket
import string
import tempfile
import threading
import time

from endpoint import Endpoint, call, parameter

REPEATED = int(os.environ.get("REPEATED", 20))
INDICATORS = 65535
GLIMMARK = '<CLASSNAME NAME="TAVRO_Glimmark"/>'


def names():
    """Names of attributes, the shortest first."""
    for length in itertools.count(1):
        others = [string.ascii_letters + string.digits] * (length - 1)
        yield from map("".join, itertools.product(string.ascii_letters, *others))


def attributes(count):
    message = "<CIM " + " ".join(f'{name}=""' for name in itertools.islice(names(), count)) + "/>"
    return message.encode(), call("GetInstance", "")[1]


def created(properties):
    instance = f'<INSTANCE CLASSNAME="TAVRO_Glimmark">{properties}</INSTANCE>'
    return call("CreateInstance", parameter("NewInstance", instance))


def properties(count):
    return created("".join(f'<PROPERTY NAME="p{number}" TYPE="string"/>' for number in range(count)))


def keys(count):
    bindings = "".join(f'<KEYBINDING NAME="k{number}"><KEYVALUE/></KEYBINDING>' for number in range(count))
    name = f'<INSTANCENAME CLASSNAME="TAVRO_Glimmark">{bindings}</INSTANCENAME>'
    return call("GetInstance", parameter("InstanceName", name))


def plain(size):
    """One property with a long text, in a message of that size."""
    def message(length):
        return created(f'<PROPERTY NAME="p" TYPE="string"><VALUE>{"x" * length}</VALUE></PROPERTY>')
    return message(size - len(message(0)[0]))


class Client:
    def __init__(self, endpoint):
        self.socket = socket.create_connection((endpoint.host, endpoint.port))
        self.host = f"{endpoint.host}:{endpoint.port}"

    def send(self, message, headers):
        lines = [f"{name}: {value}" for name, value in {"Host": self.host, "Connection": "close", **headers}.items()]
        head = "POST /cimom HTTP/1.1\r\n" + "\r\n".join(lines) + f"\r\nContent-Length: {len(message)}\r\n\r\n"
        self.socket.sendall(head.encode() + message)

    def receive(self):
        """The status, and how many bytes came."""
        first = received = self.socket.recv(1 << 20)
        size = len(first)
        while received:
            received = self.socket.recv(1 << 20)
            size += len(received)
        return first[9:12].decode(), size


def processor_time(endpoint):
    fields = pathlib.Path(f"/proc/{endpoint.process.pid}/stat").read_text().rpartition(")")[2].split()
    return (int(fields[11]) + int(fields[12])) / os.sysconf("SC_CLK_TCK")


def resident(endpoint, which):
    status = pathlib.Path(f"/proc/{endpoint.process.pid}/status").read_text()
    return int(re.search(which + r":\s+(\d+)", status)[1]) // 1024


def ask(endpoint, request):
    """Status and milliseconds of processor time, of one of several alike."""
    before = processor_time(endpoint)
    for _ in range(REPEATED):
        client = Client(endpoint)
        client.send(*request)
        status, _ = client.receive()
    return status, 1000 * (processor_time(endpoint) - before) / REPEATED


def compare_costs(inventory):
    print(f"{'request':28}{'bytes':>10}{'status':>8}{'ms':>8}    plain, of the same size:{'status':>8}{'ms':>8}")
    with Endpoint(inventory) as endpoint:
        for name, request in [
            ("148,991 attributes in a tag", attributes(148991)),
            ("19,900 properties", properties(19900)),
            ("9,950 properties", properties(9950)),
            ("9,990 keys", keys(9990)),
            ("4,995 keys", keys(4995)),
        ]:
            size = len(request[0])
            status, cost = ask(endpoint, request)
            plain_status, plain_cost = ask(endpoint, plain(size))
            print(f"{name:28}{size:10}{status:>8}{cost:8.1f}{plain_status:>37}{plain_cost:8.1f}", flush=True)


def end_while_reading(inventory):
    for name, request in [("148,991 attributes", attributes(148991)), ("19,900 properties", properties(19900))]:
        with Endpoint(inventory) as endpoint:
            clients = [Client(endpoint) for _ in range(4)]
            threads = [threading.Thread(target=client.send, args=request) for client in clients]
            for thread in threads:
                thread.start()
            for thread in threads:
                thread.join()
            started = time.monotonic()
            endpoint.process.send_signal(signal.SIGTERM)
            endpoint.process.wait()
            print(f"four requests with {name}: ended after {time.monotonic() - started:.2f} s", flush=True)


def hold_many(inventory):
    path = "/chassis-1/front-panel/indicator-"
    node = {"kind": "diagnostic indicator", "description": "System Health LED", "status": 1, "alarmState": 1}
    nodes = [{**node, "path": path + str(number)} for number in range(INDICATORS)]
    inventory.write_text(json.dumps({"nodes": nodes}))
    request = call("EnumerateInstances", parameter("ClassName", GLIMMARK))
    for count in [1, 4]:
        with Endpoint(inventory) as endpoint:
            clients = [Client(endpoint) for _ in range(count)]
            answers = []
            threads = [threading.Thread(target=lambda client: answers.append(client.receive()), args=(client,))
                       for client in clients]
            for client, thread in zip(clients, threads):
                client.send(*request)
                thread.start()
            for thread in threads:
                thread.join()
            time.sleep(1)
            print(f"{count} clients, answers {sorted(set(answers))}: at most {resident(endpoint, 'VmHWM')} MiB, "
                  f"then {resident(endpoint, 'VmRSS')} MiB", flush=True)


def main():
    with tempfile.TemporaryDirectory() as folder:
        inventory = pathlib.Path(folder) / "inventory.json"
        inventory.write_text('{"nodes": [{"kind": "diagnostic indicator", "path": "/a", "status": 1, "description": "Power LED"}]}')
        compare_costs(inventory)
        end_while_reading(inventory)
        hold_many(inventory)


main()
