"""What the metrics of a server cost, and what Prometheus spends on many: the figures of docs/figures.md.

    CIMHOST=build/release/bin/cimhost python3 metrics/tests/cost.py [--servers 1000]
"""

import argparse
import gzip
import json
import os
import pathlib
import subprocess
import tempfile
import time
import urllib.request

import fleet

INDICATORS = [13, 200]
MINUTES = 120  # of samples in a block on the disk


def printed(folder, count, faults=0):
    """What a server prints that has so many indicators, and how many of them have a fault."""
    nodes = [{"kind": 36, "description": f"Drive {n} Fault LED", "path": f"/chassis-1/drive-bay-{n}/indicator-1",
              "status": 22 if n < faults else 1, "alarmState": 2 if n < faults else 1} for n in range(count)]
    (folder / "inventory.json").write_text(json.dumps({"nodes": nodes}))
    return subprocess.run([os.environ["CIMHOST"], "metrics", "--inventory", folder / "inventory.json"],
                          stdout=subprocess.PIPE, check=True).stdout


def series_of(text):
    return [line for line in text.decode().splitlines() if not line.startswith("#")]


def bytes_on_disk(folder, text, servers):
    """Of a sample a minute, in a block as Prometheus keeps it."""
    start = int(time.time()) // 7200 * 7200 - 7200
    with open(folder / "samples", "w") as samples:
        for line in series_of(text):
            name, value = line.rsplit(" ", 1)
            head, brace, labels = name.partition("{")
            for server in range(servers):
                for minute in range(MINUTES):
                    stamp = start + 60 * minute
                    shown = stamp + server / 7 if "timestamp" in head else float(value) + server * minute % 7 / 1e3 \
                        if "duration" in head else value
                    samples.write(f'{head}{{instance="s{server}",job="node"{"," + labels if brace else "}"} '
                                  f"{shown} {stamp}\n")
        samples.write("# EOF\n")
    blocks = folder / "blocks"
    subprocess.run(["promtool", "tsdb", "create-blocks-from", "openmetrics", folder / "samples", blocks], check=True,
                   stdout=subprocess.DEVNULL)
    size = sum(file.stat().st_size for file in blocks.rglob("*") if file.is_file())
    return size / (servers * MINUTES * len(series_of(text)))


def watched(folder, servers):
    """What Prometheus spends on so many servers, of which one in fifty has a fault, each asked every ten seconds."""
    well, ill = (printed(folder, INDICATORS[0], faults) for faults in (0, 1))
    exporters = fleet.Exporters()
    exporters.texts = {f"s{number}": well if number % 50 else ill for number in range(servers)}
    prometheus = fleet.Prometheus(folder)
    configuration = folder / "prometheus.yml"
    configuration.write_text(configuration.read_text().replace("scrape_interval: 2s", "scrape_interval: 10s").replace(
        "evaluation_interval: 1s", "evaluation_interval: 10s"))
    targets = [{"targets": [f"127.0.0.1:{exporters.server_port}"],
                "labels": {"instance": name, "__metrics_path__": f"/{name}"}} for name in exporters.texts]
    (folder / "targets.json").write_text(json.dumps(targets))
    prometheus.start()

    def own(name):
        lines = urllib.request.urlopen(f"{prometheus.url}/metrics", timeout=30).read().decode().splitlines()
        return sum(float(line.split()[-1]) for line in lines if line.startswith((f"{name} ", name + "{")))

    try:
        empty = own("process_resident_memory_bytes")
        fleet.until(lambda: prometheus.number("count(up == 1)"), servers, "all servers are asked")
        time.sleep(20)
        cpu, began = own("process_cpu_seconds_total"), time.monotonic()
        time.sleep(30)
        cpu, seconds = own("process_cpu_seconds_total") - cpu, time.monotonic() - began
        return {"series": own("prometheus_tsdb_head_series"),
                "memory": own("process_resident_memory_bytes") - empty,
                "cpu": cpu / (seconds * servers / 10)}
    finally:
        prometheus.stop()
        exporters.shutdown()


def main():
    parser = argparse.ArgumentParser()
    parser.add_argument("--servers", type=int, default=1000)
    options = parser.parse_args()
    with tempfile.TemporaryDirectory(prefix="fleet-") as name:
        folder = pathlib.Path(name)
        for count in INDICATORS:
            text = printed(folder, count)
            print(f"{count} indicators: {len(series_of(text))} series, {len(text)} bytes, "
                  f"{len(gzip.compress(text))} compressed")
        print(f"on the disk: {bytes_on_disk(folder, printed(folder, INDICATORS[0]), 50):.2f} bytes for a sample")
        spent = watched(folder, options.servers)
        print(f"{options.servers} servers of {INDICATORS[0]} indicators: {spent['series']:.0f} series, "
              f"{spent['memory'] / spent['series']:.0f} bytes of memory for each; "
              f"{spent['cpu'] * 1e6:.0f} µs of processor time for a server that is asked, with the rules as often")


if __name__ == "__main__":
    main()
