"""SFCB, where it is installed, with its state in a folder of this run.

The installation's configuration and its folder for state are covered by files of this run in its own mount namespace,
so that the broker's tools and glimmark-register need no option to find them; System V semaphores are this run's by its
own IPC namespace.
"""

import os
import pathlib
import shutil
import subprocess

from broker import Broker, version_of
from server import Server, free_port, wait_until

NEVER = 3600  # seconds, longer than a run

# What the shipped configuration says, but for the size of an answer, which 3,000 indicators exceed there.
CONFIGURATION = """\
httpPort: {port}
enableHttp: true
enableHttps: false
httpLocalOnly: true
doBasicAuth: false
registrationDir: {state}/registration
providerDirs: {provider_dir} {prefix}/lib/sfcb {prefix}/lib64/sfcb
localSocketPath: {folder}/local
httpSocketPath: {folder}/http
useChunking: true
httpProcs: 8
provProcs: 32
maxMsgLen: 200000000
providerSampleInterval: {sampling}
providerTimeoutInterval: {idle}
"""


def find():
    """The folder where SFCB is installed, or None."""
    if "SFCB_PREFIX" in os.environ:
        return pathlib.Path(os.environ["SFCB_PREFIX"])
    daemon = shutil.which("sfcbd")
    return pathlib.Path(daemon).resolve().parents[1] if daemon else None


class Sfcb(Broker):
    name = "SFCB"
    like = "sfcb"
    registering_options = ["--no-restart"]  # a service of this machine is none of this run's
    can_carry_quotes = False
    idle = 3  # seconds until a provider is unloaded, where unloading is tested

    def __init__(self, prefix, installation, folder, environment):
        super().__init__(installation)
        self.home = prefix
        self.folder = folder
        self.environment = {**environment, "PATH": f"{prefix}/sbin:{prefix}/bin:{environment['PATH']}"}
        self.daemon = prefix / "sbin/sfcbd"
        self.version = version_of([self.daemon, "-v"], self.environment)
        self.cover_state()
        self.cover_configuration()
        subprocess.run(["sfcbrepos", "-f", "-i"], check=True, capture_output=True, env=self.environment)

    def cover_configuration(self):
        places = [self.home / "etc/sfcb/sfcb.cfg", pathlib.Path("/etc/sfcb/sfcb.cfg")]
        self.configuration = next(place for place in places if place.exists())
        covering = self.folder / "sfcb.cfg"
        covering.touch()
        self.cover(self.configuration, covering)
        self.configure(free_port())

    def cover_state(self):
        places = [self.home / "var/lib/sfcb", pathlib.Path("/var/lib/sfcb")]
        self.state = next(place for place in places if (place / "stage/default.reg").exists())
        covering = self.folder / "state"
        shutil.copytree(self.state / "stage", covering / "stage")
        (covering / "registration").mkdir()
        self.cover(self.state, covering)

    def start(self, idle=NEVER):
        """Starts it; a provider that is not asked for `idle` seconds is unloaded."""
        port = free_port()
        self.configure(port, idle)
        command = [self.daemon, "-c", self.configuration]
        self.server = Server(command, port, self.folder / "sfcbd.log", self.environment)

    def configure(self, port, idle=NEVER):
        values = {"port": port, "state": self.state, "provider_dir": self.installation.provider_dir,
                  "prefix": self.home, "folder": self.folder, "idle": idle, "sampling": max(1, idle // 2)}
        self.configuration.write_text(CONFIGURATION.format(**values))

    def take_up(self):
        """Has it serve what is registered now: it looks when it starts."""
        self.restart()

    def unload(self):
        """Has it unload the providers, which it does with those that nobody asks."""
        wait_until(lambda: not self.holders(), 10 * self.idle)

    def reload(self):
        """Has it be ready to load them: it always is."""

    def prepare_unloading(self):
        self.stop()
        self.start(idle=self.idle)
