"""The library as it is installed, in a folder of its own."""

import os
import pathlib
import subprocess

SOURCE = pathlib.Path(__file__).resolve().parents[2]


class Installation:
    """What `cmake --install` puts under a prefix, with the stand-in for the provider of the computer system."""

    def __init__(self, build, prefix):
        self.prefix = prefix
        for component in [[], ["--component", "computer-system"]]:
            command = ["cmake", "--install", build, "--prefix", prefix, *component]
            subprocess.run(command, check=True, stdout=subprocess.DEVNULL)
        self.provider_dir = next(prefix.rglob("libGlimmarkProvider.so")).parent
        self.cimhost = prefix / "bin/cimhost"
        self.registering = prefix / "sbin/glimmark-register"
        self.inventories = prefix / "share/glimmark-provider/inventories"


class Inventory:
    """The file that all providers read, at each request; it is replaced as a whole."""

    def __init__(self, file):
        self.file = file

    def replace(self, text):
        beside = self.file.with_suffix(".new")
        beside.write_text(text)
        beside.rename(self.file)

    def environment(self):
        """What every server runs in: the same inventory, the same language, no library of another build."""
        dropped = {"LD_LIBRARY_PATH", "LC_ALL", "LC_MESSAGES", "CIMHOST_PROVIDER_DIR", "CIMHOST_REGISTRATION"}
        kept = {name: value for name, value in os.environ.items() if name not in dropped}
        return {**kept, "LANG": "C.UTF-8", "TAVRO_INVENTORY": str(self.file)}
