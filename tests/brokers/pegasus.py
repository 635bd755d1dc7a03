"""OpenPegasus, where it is installed, with its state in a folder of this run.

The home of this run has the installation's programs and libraries and a copy of its repository; its socket lies in a
/var/tmp of this run's own mount namespace.
"""

import os
import pathlib
import shutil
import subprocess

from broker import TOOL, Broker, version_of
from server import Server, free_port

MODULE = "GlimmarkProviderModule"


def find():
    """The folder with bin, lib and repository of OpenPegasus, or None. One on PATH that is laid out otherwise is none."""
    if "PEGASUS_HOME" in os.environ:
        return pathlib.Path(os.environ["PEGASUS_HOME"])
    daemon = shutil.which("cimserver")
    home = pathlib.Path(daemon).resolve().parents[1] if daemon else None
    return home if home and all((home / name).is_dir() for name in ["bin", "lib", "repository"]) else None


class Pegasus(Broker):
    like = "pegasus"
    registering_options = []
    can_carry_quotes = True

    def __init__(self, prefix, installation, folder, environment, agents):
        super().__init__(installation)
        self.name = "OpenPegasus, providers in an agent" if agents else "OpenPegasus, providers in its own process"
        self.agents = agents
        self.log = folder / "cimserver.log"
        self.home = folder / "home"
        for name in ["logs", "trace", "cache"]:
            (self.home / name).mkdir(parents=True)
        for name in ["bin", "lib"]:
            (self.home / name).symlink_to(prefix / name)
        shutil.copytree(prefix / "repository", self.home / "repository")
        self.environment = {
            **environment,
            "PATH": f"{prefix}/bin:{environment['PATH']}",
            "PEGASUS_HOME": str(self.home),
            "LD_LIBRARY_PATH": str(prefix / "lib"),
        }
        self.daemon = self.home / "bin/cimserver"
        self.version = version_of([self.daemon, "--version"], self.environment)
        sockets = folder / "sockets"
        sockets.mkdir()
        self.cover("/var/tmp", sockets)

    def start(self):
        port = free_port()
        settings = {
            "daemon": "false",
            "enableHttpConnection": "true",
            "enableHttpsConnection": "false",
            "httpPort": port,
            "listenAddress": "127.0.0.1",
            "enableAuthentication": "false",
            "forceProviderProcesses": str(self.agents).lower(),
            "providerDir": f"lib:{self.installation.provider_dir}",
        }
        command = [self.daemon, *(f"{name}={value}" for name, value in settings.items())]
        self.server = Server(command, port, self.log, self.environment)

    def take_up(self):
        """Has it serve what is registered now: it does at once."""

    def unload(self):
        """Has it unload the providers, which are refused from then on."""
        self.run_tool("cimprovider", "-d", "-m", MODULE)

    def reload(self):
        """Has it be ready to load them."""
        self.run_tool("cimprovider", "-e", "-m", MODULE)

    def prepare_unloading(self):
        """Nothing has to be set for that."""

    def run_tool(self, *command):
        subprocess.run(command, env=self.environment, check=True, capture_output=True, timeout=TOOL)
