"""What the tests do with a broker, whichever it is: start it, ask it, register the providers with it."""

import os
import subprocess

from cimxml import Client

TOOL = 300  # seconds at the most for a program


class Broker:
    """A broker of this run. Its kinds say how it is started, takes a registration up, and unloads the providers.

    name, version: as told to people
    like: as cimhost and glimmark-register call it
    home: the folder that glimmark-register is told of
    environment: of the broker and its tools
    server: that runs; None until start()
    """

    def __init__(self, installation):
        self.installation = installation
        self.server = None
        self.covered = []

    def cover(self, place, covering):
        """Puts another file or folder in the place of one of the machine's, for this run's own mount namespace."""
        subprocess.run(["mount", "--bind", covering, place], check=True)
        self.covered.append(place)

    def close(self):
        """Ends it, and uncovers what was covered."""
        self.stop()
        while self.covered:
            subprocess.run(["umount", self.covered.pop()], check=True)

    def ask(self, question):
        """The answer, over a connection of its own; in the place of one, a text of what came instead."""
        try:
            with Client(self.server.port) as client:
                return client.ask(question)
        except (OSError, RuntimeError) as error:
            return f"{type(error).__name__}: {error}"

    def register(self, *arguments):
        """Runs glimmark-register as on a machine where the broker is installed apart; its exit status and all that it
        said."""
        options = ["--broker", self.like, "--prefix", self.home, *self.registering_options]
        command = [self.installation.registering, *options, *arguments]
        environment = {**self.environment, "PATH": os.environ["PATH"]}
        done = subprocess.run(command, env=environment, capture_output=True, text=True, timeout=TOOL)
        return done.returncode, done.stdout + done.stderr

    def holders(self):
        """The processes that have the provider library loaded."""
        return self.server.holders("libGlimmarkProvider.so")

    def restart(self):
        self.stop()
        self.start()

    def stop(self):
        if self.server:
            self.server.stop()
            self.server = None


def version_of(command, environment):
    """What a program says of its version."""
    done = subprocess.run(command, env=environment, capture_output=True, text=True, timeout=TOOL)
    return (done.stdout + done.stderr).split()[-1]
