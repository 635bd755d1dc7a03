"""`cimhost serve` in the habits of a broker: what the answers are compared with."""

from cimxml import Client
from server import Server, free_port


class Described:
    """The endpoint, and its answers, each asked for once."""

    def __init__(self, installation, like, folder, environment):
        port = free_port()
        command = [installation.cimhost, "--like", like, "serve", "--port", str(port)]
        self.server = Server(command, port, folder / "cimhost.log", environment)
        self.client = Client(port)
        self.answers = {}

    def ask(self, question):
        key = repr(question)
        if key not in self.answers:
            self.answers[key] = self.client.ask(question)
        return self.answers[key]

    def forget(self):
        """For another inventory."""
        self.answers.clear()

    def stop(self):
        self.client.connection.close()
        self.server.stop()
