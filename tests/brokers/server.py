"""A server's process with all that it starts: begun on a free port of the loopback interface, measured, ended."""

import os
import pathlib
import re
import signal
import socket
import subprocess
import time

STARTING = 60  # seconds at the most
ENDING = 20
LINGERING = 2  # what a server has started, once it has ended
MARK = "SERVER_OF_CHECK_BROKERS"


def free_port():
    with socket.socket() as listener:
        listener.bind(("127.0.0.1", 0))
        return listener.getsockname()[1]


def answers(port):
    with socket.socket() as client:
        client.settimeout(1)
        return client.connect_ex(("127.0.0.1", port)) == 0


class Server:
    """A command that listens on a port; its output goes into a file."""

    def __init__(self, command, port, log, environment):
        self.port = port
        self.log = log
        # What it starts inherits this.
        self.mark = f"{MARK}={port}"
        environment = {**environment, MARK: str(port)}
        with open(log, "ab") as output:
            self.process = subprocess.Popen(
                command, stdin=subprocess.DEVNULL, stdout=output, stderr=output, env=environment, start_new_session=True
            )
        try:
            self.wait_until_it_listens()
        except BaseException:
            self.stop()
            raise

    def wait_until_it_listens(self):
        end = time.monotonic() + STARTING
        while not answers(self.port):
            if self.process.poll() is not None or time.monotonic() > end:
                raise RuntimeError(f"{self.process.args[0]} does not start:\n{self.log.read_text()}")
            time.sleep(0.05)

    def processes(self):
        """The numbers of all its processes, also of those that it has let go."""
        numbers = (int(folder.name) for folder in pathlib.Path("/proc").glob("[0-9]*"))
        return {pid for pid in numbers if self.mark in read_of(pid, "environ")}

    def resident(self):
        """KiB of memory that is resident and no file's, of each process."""
        return {pid: resident_memory(pid) for pid in self.processes()}

    def holders(self, library):
        """The processes that have a library loaded, by the library's file name."""
        return {pid for pid in self.processes() if library in read_of(pid, "maps")}

    def stop(self):
        """Asks it to end, which ends what it has started; ends whatever is left."""
        started = self.processes() | {self.process.pid}
        self.process.send_signal(signal.SIGTERM)
        wait_until(lambda: self.process.poll() is not None, ENDING)
        wait_until(lambda: not any(map(runs, started)), LINGERING)
        for pid in filter(runs, started):
            os.kill(pid, signal.SIGKILL)
        self.process.wait()
        wait_until(lambda: not any(map(runs, started)), ENDING)


def wait_until(condition, seconds):
    """Waits for a condition, at the most so long."""
    end = time.monotonic() + seconds
    while not condition() and time.monotonic() < end:
        time.sleep(0.05)


def read_of(pid, name):
    """A file about a process; nothing when the process has ended."""
    try:
        return pathlib.Path(f"/proc/{pid}/{name}").read_text()
    except OSError:
        return ""


def runs(pid):
    state = re.search(r"^State:\s*(\w)", read_of(pid, "status"), re.MULTILINE)
    return state is not None and state[1] != "Z"


def resident_memory(pid):
    found = re.search(r"^RssAnon:\s*(\d+)", read_of(pid, "status"), re.MULTILINE)
    return int(found[1]) if found else 0
