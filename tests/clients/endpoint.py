"""`cimhost serve` as a child process, and requests to it without a client's help.

The program is named by the environment variable CIMHOST.
"""

import http.client
import json
import os
import re
import signal
import subprocess

CIMHOST = os.environ["CIMHOST"]
NAMESPACE = "root/cimv2"


class Endpoint:
    """A server on a free port with an inventory, ended by the with statement that it stands in."""

    def __init__(self, inventory):
        self.environment = dict(os.environ, TAVRO_INVENTORY=str(inventory), LANG="C.UTF-8")

    def __enter__(self):
        self.process = subprocess.Popen(
            [CIMHOST, "serve", "--port", "0"], stderr=subprocess.PIPE, text=True, env=self.environment
        )
        announcement = self.process.stderr.readline()
        found = re.match(r"cimhost: listening on http://([\d.]+):(\d+), ", announcement)
        if not found:
            raise RuntimeError("no address in: " + announcement + self.process.stderr.read())
        self.host, self.port = found[1], int(found[2])
        return self

    def __exit__(self, *_):
        self.process.send_signal(signal.SIGTERM)
        reports = self.process.stderr.read()
        self.process.stderr.close()
        status = self.process.wait()
        if status != 0 or reports != "cimhost: ending\n":
            raise RuntimeError(f"the server ended with {status} and said: {reports}")

    def url(self, path):
        return f"http://{self.host}:{self.port}/{NAMESPACE}:{path}"

    def ask_directly(self, *arguments):
        """What cimhost itself answers: its JSON document."""
        command = [CIMHOST, "--format", "json", *arguments]
        return json.loads(subprocess.run(command, capture_output=True, env=self.environment).stdout)

    def connect(self):
        return http.client.HTTPConnection(self.host, self.port)


def call(method, parameters):
    """A request message, and its headers."""
    spaces = "".join(f'<NAMESPACE NAME="{name}"/>' for name in NAMESPACE.split("/"))
    message = (
        '<?xml version="1.0" encoding="utf-8"?><CIM CIMVERSION="2.0" DTDVERSION="2.0">'
        '<MESSAGE ID="1" PROTOCOLVERSION="1.0"><SIMPLEREQ>'
        f'<IMETHODCALL NAME="{method}"><LOCALNAMESPACEPATH>{spaces}</LOCALNAMESPACEPATH>{parameters}'
        "</IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>"
    )
    headers = {
        "Content-Type": 'application/xml; charset="utf-8"',
        "CIMOperation": "MethodCall",
        "CIMMethod": method,
        "CIMObject": NAMESPACE.replace("/", "%2F"),
    }
    return message.encode(), headers


def parameter(name, value):
    return f'<IPARAMVALUE NAME="{name}">{value}</IPARAMVALUE>'


def post(connection, message, headers):
    """The status and the text of the response."""
    connection.request("POST", "/cimom", message, headers)
    response = connection.getresponse()
    return response.status, response.read().decode()
