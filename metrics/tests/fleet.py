"""A fleet of made servers under the real Prometheus on loopback: what is planted is found, and nothing else.

    CIMHOST=build/release/bin/cimhost python3 metrics/tests/fleet.py [--servers 100]

Each server is an inventory; this process hands out over HTTP what `cimhost metrics` printed for it. Prometheus asks every
two seconds and evaluates the alert rules, with seconds in the place of their minutes, hours and days. Then lights go on,
parts degrade, indicators vanish, inventories break, servers go off, and at last all is mended.
"""

import argparse
import http.server
import json
import os
import pathlib
import random
import re
import socket
import subprocess
import sys
import tempfile
import threading
import time
import urllib.error
import urllib.parse
import urllib.request

RULES = pathlib.Path(__file__).resolve().parent.parent / "glimmark.rules.yml"
SECONDS = {"for: 1m": "for: 2s", "for: 5m": "for: 4s", "offset 1h": "offset 18s", "offset 1d": "offset 34s"}
BASELINE = 16  # seconds before anything is planted: one of the offsets then looks back at it, until 34 seconds later
PATIENCE = 60  # seconds for each picture to come, which takes less than ten where the processor is free

OK, DEGRADED, PREDICTED = 1, 22, 20  # a node's status
OFF, STEADY, ALTERNATING = 1, 2, 3  # its alarm state

CONFIGURATION = """
global: {scrape_interval: 2s, scrape_timeout: 2s, evaluation_interval: 1s}
rule_files: [rules.yml]
scrape_configs:
  - job_name: node
    file_sd_configs: [{files: [targets.json], refresh_interval: 1s}]
"""


class Server:
    """What one server has, what it printed, and what is expected of it."""

    # Of faults by their name, and of none, however they shine.
    FAULT = ["Fan {} Fault LED", 'Slot {} "left" \\ Fault LED', "Lüfter {}: Fault\tLED", "PSU {} Failure\nLED"]
    OTHER = ["Identification LED {}", "Slot {} Locate LED", "Power LED {}"]

    def __init__(self, number, chance, folder):
        self.name = f"server-{number:03}"
        self.file = folder / f"{self.name}.json"
        self.nodes = [self.node(chance.choice(self.FAULT), n) for n in range(chance.randint(3, 30))]
        self.nodes += [self.node(name, n, STEADY) for n, name in enumerate(self.OTHER)]
        self.broken = None  # the text of an inventory that is none
        self.off = self.retired = self.stopped = False
        self.alerts = set()

    def node(self, name, number, alarm=OFF):
        description = name.format(number)
        return {"kind": 36, "description": description, "path": f"/{self.name}/{number}", "status": OK,
                "alarmState": alarm}

    @staticmethod
    def identity(node):
        return f"{node['description']}:{node['path']}", node["description"]

    def expect(self, alert, node=None):
        self.alerts.add((alert, self.name, *(self.identity(node) if node else ("", ""))))

    def lit(self):
        """The lights that Prometheus has to find, with their states."""
        if self.off or self.retired or self.broken is not None:
            return set()
        return {(self.name, *self.identity(node), node["alarmState"]) for node in self.nodes
                if node["alarmState"] >= STEADY}

    def print_metrics(self):
        self.file.write_text(json.dumps({"nodes": self.nodes}) if self.broken is None else self.broken)
        answer = subprocess.run([os.environ["CIMHOST"], "metrics", "--inventory", self.file], stdout=subprocess.PIPE,
                                stderr=subprocess.DEVNULL, text=True, timeout=60)
        if answer.returncode != (0 if self.broken is None else 1):
            raise SystemExit(f"{self.name}: cimhost ended with {answer.returncode}, and printed: {answer.stdout}")
        # A timer that does not run leaves what it wrote last, here a thousand seconds ago.
        return answer.stdout if not self.stopped else re.sub(
            r"(timestamp_seconds )([\d.]+)", lambda found: f"{found[1]}{float(found[2]) - 1000:.3f}", answer.stdout)


def printed(servers):
    """What each prints; nothing for one that is off."""
    return {server.name: None if server.off else server.print_metrics().encode() for server in servers}


def plant(servers, chance):
    """Changes servers, each in one way, and says which alerts that makes. Returns those that are changed."""
    order = chance.sample(servers, len(servers))
    share = len(servers) // 20

    def take(times):
        taken, order[:] = order[:times * share], order[times * share:]
        return taken

    def fault_lights(server, most=3):
        lights = [node for node in server.nodes if re.search("(?i)fault|failure", node["description"])]
        return chance.sample(lights, chance.randint(1, min(most, len(lights))))

    for server in take(4):
        for node in fault_lights(server):
            node["alarmState"] = chance.choice([STEADY, ALTERNATING])
            server.expect("GlimmarkFaultLight", node)
    for server in take(2):
        for node in fault_lights(server):
            node["status"] = DEGRADED
            server.expect("GlimmarkDegraded", node)
    for server in take(2):
        for node in fault_lights(server):
            node["status"] = PREDICTED
            server.expect("GlimmarkDegraded", node)
            server.expect("GlimmarkFailurePredicted", node)
    for server in take(1):  # A light whose name says nothing, of a part that is not well.
        node = next(node for node in server.nodes if "Power" in node["description"])
        node["status"] = DEGRADED
        server.expect("GlimmarkFaultLight", node)
        server.expect("GlimmarkDegraded", node)
    for server in take(1):  # Lit to be found: no alert.
        for node in server.nodes[-3:-1]:
            node["alarmState"] = ALTERNATING
    for server in take(1):
        node = server.nodes.pop(0)
        server.expect("GlimmarkVanished", node)
    for number, server in enumerate(take(1)):
        server.broken = ['{"nodes": [', '{"nodes": []}', '{"nodes": [{"kind": 36}]}', ""][number % 4]
        server.expect("GlimmarkCollectionFailing")
    for server in take(1):
        server.off = True
        server.expect("GlimmarkNoData")
    for server in take(1):
        server.stopped = True
        server.expect("GlimmarkNoData")
    for server in take(1):  # Taken out of Prometheus' list: nobody asks for it any more.
        server.retired = True
    return [server for server in servers if server not in order]


class Exporters(http.server.ThreadingHTTPServer):
    """Hands out the text of each server by its name; without a text, it hangs up."""

    daemon_threads = True
    request_queue_size = 256

    class Handler(http.server.BaseHTTPRequestHandler):
        protocol_version = "HTTP/1.1"

        def do_GET(self):
            text = self.server.texts.get(self.path[1:])
            if text is None:
                self.close_connection = True
                return
            self.send_response(200)
            self.send_header("Content-Type", "text/plain; version=0.0.4")
            self.send_header("Content-Length", str(len(text)))
            self.end_headers()
            self.wfile.write(text)

        def log_message(self, *_):
            pass

    def __init__(self):
        super().__init__(("127.0.0.1", 0), self.Handler)
        self.texts = {}
        threading.Thread(target=self.serve_forever, daemon=True).start()


class Prometheus:
    def __init__(self, folder):
        self.folder = folder
        rules = RULES.read_text()
        for long, short in SECONDS.items():
            if long not in rules:
                raise SystemExit(f"{RULES.name} has no '{long}' any more")
            rules = rules.replace(long, short)
        long = re.findall(r"(?:for:|offset) \d+[mhdw]", rules)
        if long:
            raise SystemExit(f"{RULES.name} has times that are not made short here: {long}")
        (folder / "rules.yml").write_text(rules)
        (folder / "prometheus.yml").write_text(CONFIGURATION)

    def list_targets(self, servers, port):
        targets = [{"targets": [f"127.0.0.1:{port}"],
                    "labels": {"instance": server.name, "__metrics_path__": f"/{server.name}"}}
                   for server in servers]
        new = self.folder / "targets.new"
        new.write_text(json.dumps(targets))
        new.rename(self.folder / "targets.json")

    def start(self):
        with socket.socket() as free:
            free.bind(("127.0.0.1", 0))
            self.url = f"http://127.0.0.1:{free.getsockname()[1]}"
        self.log = open(self.folder / "log", "w+")
        self.process = subprocess.Popen(
            [os.environ.get("PROMETHEUS", "prometheus"), f"--web.listen-address={self.url[7:]}", "--log.level=warn",
             f"--config.file={self.folder}/prometheus.yml", f"--storage.tsdb.path={self.folder}/data"],
            cwd=self.folder, stdout=self.log, stderr=subprocess.STDOUT)
        until(lambda: self.is_ready(), True, "Prometheus is ready")

    def is_ready(self):
        if self.process.poll() is not None:
            self.log.seek(0)
            raise SystemExit(f"Prometheus ended with {self.process.returncode}: {self.log.read()}")
        try:
            return urllib.request.urlopen(f"{self.url}/-/ready", timeout=5).status == 200
        except (OSError, urllib.error.URLError):
            return False

    def stop(self):
        self.process.terminate()
        self.process.wait()
        self.log.close()

    def get(self, path, **parameters):
        query = urllib.parse.urlencode(parameters)
        with urllib.request.urlopen(f"{self.url}/api/v1/{path}?{query}", timeout=30) as answer:
            return json.load(answer)["data"]

    def query(self, expression):
        return [(result["metric"], float(result["value"][1]))
                for result in self.get("query", query=expression)["result"]]

    def number(self, expression):
        return next((int(value) for _, value in self.query(expression)), 0)

    def lit(self):
        return {(labels["instance"], labels["id"], labels["name"], int(value))
                for labels, value in self.query("cim_alarm_device_alarm_state >= 2")}

    def alerts(self):
        return [alert for alert in self.get("alerts")["alerts"] if alert["state"] == "firing"]

    def fired(self):
        return {(alert["labels"]["alertname"], alert["labels"]["instance"], alert["labels"].get("id", ""),
                 alert["labels"].get("name", "")) for alert in self.alerts()}


def until(ask, expected, what):
    """Asks until the answer is as expected three times in a row; says what differs if that does not come."""
    end = time.monotonic() + PATIENCE
    right = 0
    while right < 3:
        answer = ask()
        right = right + 1 if answer == expected else 0
        if time.monotonic() > end:
            if isinstance(expected, set):
                answer = f"missing {sorted(expected - answer)[:5]}, found instead {sorted(answer - expected)[:5]}"
            raise SystemExit(f"{what}: not within {PATIENCE} seconds: {answer}")
        time.sleep(0.5 if isinstance(expected, set) else 0.1)
    return answer


def check_summaries(alerts):
    """A person who is called reads the server, the light and since when."""
    for alert in alerts:
        summary, labels = alert["annotations"]["summary"], alert["labels"]
        wanted = [labels["instance"], labels.get("name", ""), "since 20"]
        if not all(word in summary for word in wanted):
            raise SystemExit(f"{labels['alertname']}: the summary lacks one of {wanted}: {summary}")


def main():
    parser = argparse.ArgumentParser()
    parser.add_argument("--servers", type=int, default=100)
    parser.add_argument("--draw", type=int, default=random.SystemRandom().randrange(1 << 32))
    options = parser.parse_args()
    print(f"draw {options.draw}")
    chance = random.Random(options.draw)

    with tempfile.TemporaryDirectory(prefix="fleet-") as name:
        folder = pathlib.Path(name)
        servers = [Server(number, chance, folder) for number in range(options.servers)]
        # All is printed beforehand, so that everything changes at once.
        well = printed(servers)
        lit_before = set().union(*(server.lit() for server in servers))
        indicators = sum(len(server.nodes) for server in servers)
        changed = plant(servers, chance)
        lit = set().union(*(server.lit() for server in servers))
        expected = set().union(*(server.alerts for server in servers))
        ill = {**well, **printed(server for server in changed if not server.retired)}

        exporters = Exporters()
        exporters.texts = well
        prometheus = Prometheus(folder)
        prometheus.list_targets(servers, exporters.server_port)
        prometheus.start()
        try:
            until(lambda: prometheus.number("count(up == 1)"), len(servers), "all servers are asked")
            until(prometheus.lit, lit_before, "the lights before")
            time.sleep(BASELINE)
            until(prometheus.fired, set(), "no alert before")

            exporters.texts = ill
            prometheus.list_targets([server for server in servers if not server.retired], exporters.server_port)
            lights = until(prometheus.lit, lit, "the lights")
            alerts = until(prometheus.fired, expected, "the alerts")
            check_summaries(prometheus.alerts())

            exporters.texts = well
            until(prometheus.fired, set(), "all is mended")
            scrapes = prometheus.number("sum(count_over_time(up[1h]))")
            unhealthy = [rule["name"] for group in prometheus.get("rules")["groups"] for rule in group["rules"]
                         if rule["health"] != "ok"]
            if unhealthy:
                raise SystemExit(f"rules that could not be evaluated: {unhealthy}")
        finally:
            prometheus.stop()
            exporters.shutdown()
        print(f"{len(servers)} servers with {indicators} indicators, {scrapes} scrapes")
        print(f"{len(lit)} lights planted, {len(lights)} found")
        print(f"{len(expected)} alerts planted, {len(alerts)} fired; none before, none after")


if __name__ == "__main__":
    sys.exit(main())
