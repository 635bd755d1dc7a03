"""Interrupts glimmark-register wherever it can be, and compares the broker with what the exit status claims.

    interruptions.py            a signal in each call of a tool, in turn TERM, INT and HUP, one for several questions
                                alike, and at some moments; where taking back fails, only in a third of the calls
    interruptions.py --all      each signal at the beginning and at the end of each call, and at every millisecond
    interruptions.py --case TEXT   only the cases whose name contains TEXT, or one of several

What it claims: 0, as after a run that nobody disturbed; 3 and 4, as before; 5, otherwise, and the last lines say what
is left; killed by a signal, as before. REGISTER is the program under test, SCHEMA the folder of its classes. The
brokers' tools are the stand-ins beside this file.
"""

import argparse
import collections
import itertools
import os
import pathlib
import re
import shutil
import signal
import subprocess
import sys
import tempfile
import time

HERE = pathlib.Path(__file__).resolve().parent
SIGNALS = ["TERM", "INT", "HUP"]
KILLED = [-getattr(signal, f"SIG{name}") for name in SIGNALS]
TIMEOUT = 60  # seconds for a run, which takes less than one
# What is left after a failure while steps were taken back, and where the stand-ins have it.
LEFT = {r"(there|missing|changed) since: class (\S+) in root/cimv2": r"root/cimv2/class \2",
        r"(there|missing|changed) since: module (\S+) in root/PG_InterOp": r"root/PG_InterOp/module \2",
        r"(there|missing|changed) since: registration of .* in (\S+)": r"root/PG_InterOp/module \2",
        r"not restarted: the service sblim-sfcb": "running"}

Case = collections.namedtuple("Case", "name broker before arguments fail", defaults=[""])
CASES = [
    Case("SFCB, register", "sfcb", [], ["register"]),
    Case("SFCB, register without restart", "sfcb", [], ["--no-restart", "register"]),
    Case("SFCB, register for another namespace", "sfcb", ["register"], ["--namespace", "root/other", "register"]),
    Case("SFCB, unregister", "sfcb", ["register"], ["unregister"]),
    Case("SFCB, register, and no restart succeeds", "sfcb", [], ["register"], "1+ systemctl restart"),
    Case("OpenPegasus, register", "pegasus", [], ["register"]),
    Case("OpenPegasus, unregister", "pegasus", ["register"], ["unregister"]),
    Case("OpenPegasus, register, and no class is deleted", "pegasus", [], ["register"], "1+ cimcli dc"),
    Case("OpenPegasus, register, and no module is removed", "pegasus", [], ["register"], "1+ cimprovider -r"),
    Case("OpenPegasus, unregister, and no MOF is compiled", "pegasus", ["register"], ["unregister"], "1+ cimmof"),
]


class Machine:
    """A machine with the stand-ins for a broker's tools, as machine.bash makes it for all tests."""

    def __init__(self, folder, case):
        self.folder = folder
        self.case = case
        script = (f'cd {HERE} && . ./machine.bash && make_machine_of_{case.broker} && export UNIT=sblim-sfcb && '
                  '{ [ ! -d "$stage" ] || { sfcbrepos -f && systemctl restart $UNIT; }; } && '
                  '{ [ $# -eq 0 ] || "$REGISTER" "$@"; } && declare -p BROKER CALLS TMPDIR PATH STAND_INS')
        environment = {**os.environ, "BATS_TEST_DIRNAME": str(HERE), "BATS_TEST_TMPDIR": str(folder)}
        made = subprocess.run(["bash", "-c", script, "machine", *case.before], env=environment, check=True, text=True,
                              stdout=subprocess.PIPE)
        self.environment = {**os.environ, "UNIT": "sblim-sfcb", "FAIL": case.fail,
                            **dict(re.findall(r'^declare -x (\w+)="(.*)"$', made.stdout, re.M))}
        self.broker = pathlib.Path(self.environment["BROKER"])
        self.calls = pathlib.Path(self.environment["CALLS"])
        self.temporary = pathlib.Path(self.environment["TMPDIR"])
        self.saved = folder / "saved"
        shutil.copytree(self.broker, self.saved, symlinks=True)
        self.before = self.state()
        self.environment["FAIL"] = ""
        self.duration = -time.monotonic()
        assert self.run() == (0, ""), f"{case.name}: the undisturbed run fails"
        self.duration += time.monotonic()
        self.calls_made = self.calls.read_text().splitlines()
        self.after = self.state()
        assert self.after != self.before
        self.environment["FAIL"] = case.fail

    def state(self):
        """Kind, permissions and content of all that is on the machine."""
        return {str(path.relative_to(self.broker)): (path.lstat().st_mode, path.is_file() and path.read_bytes())
                for path in self.broker.rglob("*")}

    def restore(self):
        shutil.rmtree(self.broker)
        shutil.copytree(self.saved, self.broker, symlinks=True)
        self.calls.write_text("")

    def start(self, *, arguments=None, stdout=subprocess.DEVNULL, stderr=subprocess.PIPE, **environment):
        return subprocess.Popen([os.environ["REGISTER"], *(arguments or self.case.arguments)], text=True,
                                stdin=subprocess.DEVNULL, stdout=stdout, stderr=stderr,
                                env={**self.environment, **environment}, start_new_session=True)

    def run(self, **how):
        self.restore()
        process = self.start(**how)
        complaints = process.communicate(timeout=TIMEOUT)[1]
        return process.returncode, complaints

    def falsehood(self, status, complaints):
        """What is false in what a run claims; none, if all is true."""
        now = self.state()
        if any(self.temporary.iterdir()):
            return "a temporary folder is left"
        if status == 0:
            return None if now == self.after else "it is not done"
        if status in (3, 4, *KILLED):
            return None if now == self.before else "it is not as before"
        if status != 5:
            return "nothing is to end so"
        differing = {name for name in {*now, *self.before} if now.get(name) != self.before.get(name)}
        told = told_to_be_left(complaints)
        return None if told == differing else f"left is {sorted(differing)}, and told is {sorted(told)}"


def told_to_be_left(complaints):
    said = [line.partition(": ")[2] for line in complaints.splitlines()]
    found = [(re.fullmatch(pattern, line), place) for line in said for pattern, place in LEFT.items()]
    return {match.expand(place) for match, place in found if match}


def at_calls(machine, everything):
    """A signal in each call of a tool."""
    kinds = list(itertools.product(SIGNALS, ["begin", "end"]))
    numbers = [number for number in range(1, len(machine.calls_made) + 1)
               if everything or not asks_again(machine.calls_made[max(number - 2, 0):number])]
    for number in numbers[::3 if machine.case.fail and not everything else 1]:
        for name, moment in kinds if everything else [kinds[number % len(kinds)]]:
            yield f"{name} at the {moment} of call {number}", machine.run(INTERRUPT_AT=f"{number} {name} {moment}")


def asks_again(calls):
    """Is the last of two calls one of several questions for classes, and not the first of them?"""
    return len(calls) == 2 and all(call.startswith("cimcli gc") for call in calls)


def at_moments(machine, everything):
    """A signal some milliseconds after the start, wherever that is."""
    count = int(1100 * machine.duration) if everything else 2
    for number, name in zip(range(count), itertools.cycle(SIGNALS)):
        machine.restore()
        process = machine.start()
        moment = 1.1 * machine.duration * (number + 0.5) / count
        time.sleep(moment)
        os.killpg(process.pid, getattr(signal, f"SIG{name}"))
        complaints = process.communicate(timeout=TIMEOUT)[1]
        # Python, while it starts itself and has not begun with the program, ends so.
        early = process.returncode == 1 and "KeyboardInterrupt" in complaints
        yield f"{name} after {1000 * moment:.0f} ms", (-signal.SIGINT if early else process.returncode, complaints)


def without_streams(machine, _):
    """Standard output and error of which only a line is read, or that are full or closed: it is done all the same."""
    for name, redirection in [("a pipe of one line", "2>&1 | head -n 1"), ("a full device", ">/dev/full 2>&1"),
                              ("closed streams", "<&- >&- 2>&-")]:
        machine.restore()
        command = f'"$REGISTER" "$@" {redirection}; exit ${{PIPESTATUS[0]}}'
        done = subprocess.run(["bash", "-c", command, "bash", *machine.case.arguments], stdout=subprocess.DEVNULL,
                              env=machine.environment, timeout=TIMEOUT)
        yield name, (done.returncode if done.returncode == 0 else "not 0", "")


def at_once(machine, everything):
    """Two at the same time: both end well, and it is done."""
    for number in range(40 if everything else 1):
        machine.restore()
        processes = [machine.start(stderr=subprocess.DEVNULL) for _ in range(2)]
        statuses = {process.wait(TIMEOUT) for process in processes}
        yield f"two at once, run {number}", (max(statuses, key=abs), "")


def try_case(case, everything, outcomes):
    """Counts the outcomes, and yields what was claimed and is false."""
    with tempfile.TemporaryDirectory() as folder:
        machine = Machine(pathlib.Path(folder), case)
        ways = [at_calls]
        if everything or not case.fail:
            ways.append(at_moments)
        if not case.fail and (everything or len(case.arguments) == 1):
            ways += [without_streams, at_once]
        for way in ways:
            for moment, (status, complaints) in way(machine, everything):
                false = machine.falsehood(status, complaints)
                outcomes["false" if false else "killed" if status in KILLED else status] += 1
                if false:
                    yield f"{case.name}, {moment}: exit status {status}, but {false}\n{complaints}"
                shutil.rmtree(machine.temporary)
                machine.temporary.mkdir()


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--all", action="store_true")
    parser.add_argument("--case", nargs="+", default=[""])
    options = parser.parse_args()
    everything = options.all
    cases = [case for case in CASES if any(part in case.name for part in options.case)]
    if not cases:
        parser.error(f"no case is named so; there are: {'; '.join(case.name for case in CASES)}")
    kinds = [0, 3, 4, 5, "killed", "false"]
    print(f"{'':50}{'moments':>8}" + "".join(f"{kind:>8}" for kind in kinds))
    falsehoods = []
    for case in cases:
        outcomes = collections.Counter()
        falsehoods += try_case(case, everything, outcomes)
        numbers = [sum(outcomes.values())] + [outcomes[kind] for kind in kinds]
        print(f"{case.name:50}" + "".join(f"{number:8}" for number in numbers), flush=True)
    print(*falsehoods, sep="\n", end="")
    sys.exit(1 if falsehoods else 0)


main()
