"""The library in the brokers that this machine has: registered, asked everything, under pressure, for long, unloaded,
taken back. scripts/check-brokers runs it, in namespaces of its own: it mounts.

Prints a line for each thing that holds, and what does not; the exit status is 1 if anything does not.
"""

import argparse
import pathlib
import shutil
import subprocess
import sys
import tempfile
import time

import differences
import inventories
import pegasus
import questions
import sfcb
from cim import CLASSES, COMPUTER_SYSTEM, GLIMMARK, Question
from comparison import Comparison
from described import Described
from endurance import ask_often, grew
from installation import Installation, Inventory
from pressure import ask_at_once
from schema import Schema

FAULTS_SHOWN = 20


class Fault(Exception):
    """What does not hold."""


def hold(condition, text):
    if not condition:
        raise Fault(text)


class Trial:
    """All that is tried with a broker, in the order of steps(); each step says what it found."""

    def __init__(self, broker, described, inventory, options):
        self.broker = broker
        self.described = described
        self.inventory = inventory
        self.options = options
        self.differences = differences.known(broker.like)
        self.comparison = Comparison(broker.ask, described.ask, self.differences, Schema(broker.ask))

    def steps(self):
        return [
            self.register_twice,
            self.small_server,
            self.edge_cases,
            self.many_indicators,
            self.known_differences,
            self.pressure,
            self.endurance,
            self.unloading,
            self.unregister,
            self.register_again,
        ]

    # --- Registering ---

    def register_twice(self):
        self.registering(1, "status")
        self.registering(0, "--providers", "computer-system", "register")
        for expected in ["registered", "already"]:
            said = self.registering(0, "register")
            hold(expected in said, f"register said, and not {expected}:\n{said}")
        self.broker.take_up()
        said = self.registering(0, "status")
        for expected in ["the loader finds all that it needs", "TAVRO_ComputerSystem is served", "log: "]:
            hold(expected in said, f"status said, and not {expected}:\n{said}")
        return "registered, and registered already"

    def unregister(self):
        said = self.registering(0, "unregister")
        self.registering(1, "status")
        self.broker.take_up()
        for class_name in CLASSES:
            answer = self.broker.ask(Question("ein", class_name))
            hold(getattr(answer, "code", None) == 5, f"{class_name} is answered after unregister: {answer}\n{said}")
        hold(not self.broker.holders(), "the library is loaded after unregister")
        return "unregistered: the classes are unknown, the library is gone"

    def register_again(self):
        self.registering(0, "register")
        self.broker.take_up()
        return f"registered again: {self.ask_a_little()}"

    def registering(self, expected, *arguments):
        status, said = self.broker.register(*arguments)
        hold(status == expected, f"glimmark-register {' '.join(arguments)} ended with {status}:\n{said}")
        return said

    # --- Answers ---

    def small_server(self):
        self.take(inventories.small_server(self.broker.installation))
        return self.compare(questions.everything(self.names()), "the small server")

    def edge_cases(self):
        self.take(inventories.edge_cases(self.broker.installation, self.broker.can_carry_quotes))
        return self.compare(questions.of_each_instance(self.names()), "the edge cases")

    def many_indicators(self):
        self.take(inventories.many(1000))
        return self.compare(questions.of_many(self.names()), "1,000 indicators")

    def ask_a_little(self):
        self.take(inventories.small_server(self.broker.installation))
        return self.compare(questions.enumerations(), "the small server")

    def known_differences(self):
        stale = self.comparison.not_seen()
        hold(not stale, "known differences that no answer shows:\n" + "\n".join(stale))
        return f"{len(self.differences)} known differences, each seen"

    def take(self, text):
        self.inventory.replace(text)
        self.described.forget()

    def names(self):
        """Of each class the paths that clients ask with."""
        asked = {name: self.described.ask(Question("ein", name)) for name in [*CLASSES, COMPUTER_SYSTEM]}
        return {name: [path.local() for path in answer.items] for name, answer in asked.items()}

    def compare(self, asked, title):
        count, faults = self.comparison.compare(asked)
        more = [f"... {len(faults) - FAULTS_SHOWN} more"] if len(faults) > FAULTS_SHOWN else []
        shown = "\n".join(faults[:FAULTS_SHOWN] + more)
        hold(not faults, f"{title}: {len(faults)} of {count} answers differ\n{shown}")
        return f"{title}: {count:,} answers as described"

    # --- Many requests ---

    def pressure(self):
        self.take(inventories.small_server(self.broker.installation))
        asked = list(questions.a_few(self.names()))
        self.compare(asked, "the small server")
        expected = [(question, self.broker.ask(question)) for question in asked]
        requests, connections = self.options.requests, self.options.connections
        faults = ask_at_once(self.broker.server.port, expected, requests, connections)
        hold(not faults, f"over {connections} connections:\n" + "\n".join(faults))
        return f"{requests:,} requests over {connections} connections, all answered alike"

    def endurance(self):
        self.take(inventories.many(1))
        self.broker.restart()  # memory that was taken and given back would hide what adds up
        question = Question("ei", GLIMMARK)
        self.compare([question], "one indicator")
        memory = ask_often(self.broker.server, question, self.broker.ask(question), self.options.enumerations)
        looks = ", ".join(f"{kibibytes:,}" for kibibytes in memory)
        hold(not grew(memory), f"memory grew, KiB: {looks}")
        return f"{self.options.enumerations:,} enumerations, memory flat, KiB: {looks}"

    # --- Unloading ---

    def unloading(self):
        self.broker.prepare_unloading()
        for _ in range(2):
            self.ask_a_little()
            hold(self.broker.holders(), "no process has the library loaded")
            self.broker.unload()
            hold(not self.broker.holders(), "the library stays loaded")
            self.broker.reload()
        return f"unloaded twice and loaded again: {self.ask_a_little()}"


def try_out(trial):
    """Whether everything holds."""
    broker = trial.broker
    print(f"{broker.name} ({broker.version})", flush=True)
    passed = True
    for step in trial.steps():
        begin = time.monotonic()
        try:
            text = "passed: " + step()
        except (Fault, OSError, RuntimeError, subprocess.SubprocessError) as fault:
            passed = False
            text = f"FAILED: {step.__name__.replace('_', ' ')}: {fault}"
        print(f"  {text} ({time.monotonic() - begin:.1f} s)".replace("\n", "\n    "), flush=True)
        if not passed and step == trial.register_twice:
            break  # nothing to ask
    return passed


def say_what_is_found():
    """Whether any broker is here."""
    found = [("SFCB", sfcb.find(), "SFCB_PREFIX"), ("OpenPegasus", pegasus.find(), "PEGASUS_HOME")]
    for name, prefix, variable in found:
        print(f"{name}: {prefix or f'skipped, as it is neither on PATH nor named by {variable}'}")
    return any(prefix for _, prefix, _ in found)


def brokers(installation, folder, environment):
    """Each broker that is here, made when its turn has come."""
    prefix = sfcb.find()
    if prefix:
        yield sfcb.Sfcb(prefix, installation, made(folder / "sfcb"), environment)
    prefix = pegasus.find()
    for agents in [False, True] if prefix else []:
        yield pegasus.Pegasus(prefix, installation, made(folder / f"pegasus-{agents}"), environment, agents)


def made(folder):
    folder.mkdir()
    return folder


def run(broker, inventory, folder, environment, options):
    described = Described(broker.installation, broker.like, folder, environment)
    try:
        broker.start()
        return try_out(Trial(broker, described, inventory, options))
    finally:
        broker.close()
        described.stop()


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--build", type=pathlib.Path, help="the build that is installed and tried")
    parser.add_argument("--requests", type=int, default=2000, help="at once (default: %(default)s)")
    parser.add_argument("--connections", type=int, default=8, help="at once (default: %(default)s)")
    parser.add_argument("--enumerations", type=int, default=10000, help="in a row (default: %(default)s)")
    parser.add_argument("--found", action="store_true", help="only say which brokers are here: exit status 1 for none")
    parser.add_argument("--differences", action="store_true", help="only print the table of known differences")
    options = parser.parse_args()

    if options.differences:
        print(differences.table())
        return 0
    if options.found:
        return 0 if say_what_is_found() else 1

    folder = pathlib.Path(tempfile.mkdtemp(prefix="check-brokers."))
    try:
        installation = Installation(options.build, folder / "installed")
        inventory = Inventory(folder / "inventory.json")
        inventory.replace(inventories.small_server(installation))
        environment = inventory.environment()
        passed = [run(broker, inventory, folder, environment, options)
                  for broker in brokers(installation, folder, environment)]
    finally:
        shutil.rmtree(folder)
    return 0 if all(passed) else 1


if __name__ == "__main__":
    sys.exit(main())
