"""The inventories that the brokers are asked about."""

import json


def small_server(installation):
    return (installation.inventories / "small-server.json").read_text()


def edge_cases(installation, with_quotes):
    """Blanks, line ends, backslashes and many scripts in names; quotes only for a broker that can carry them."""
    nodes = json.loads((installation.inventories / "edge-cases-readable.json").read_text())["nodes"]
    texts = [node["description"] + node["path"] for node in nodes]
    kept = [node for node, text in zip(nodes, texts) if with_quotes or '"' not in text]
    return json.dumps({"nodes": kept})


def many(count):
    nodes = [
        {"kind": "diagnostic indicator", "description": f"LED {i}", "path": f"/rack/{i}", "status": i % 30}
        for i in range(count)
    ]
    return json.dumps({"nodes": nodes})
