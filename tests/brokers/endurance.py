"""Many requests one after the other, and what memory the broker has meanwhile."""

import concurrent.futures
import itertools
import statistics

from cimxml import Client

AT_ONCE = 2  # a request each, over a connection of its own
LOOKS = 10
ALLOWED = 32  # KiB from look to look, of all processes together
ALLOWED_IN_ALL = 2048


def ask_often(server, question, answer, requests):
    """Asks a question so often; memory at each look, in KiB, of the processes that lived from the first to the last."""
    looks = [look(server)]
    with concurrent.futures.ThreadPoolExecutor(AT_ONCE) as pool:
        for _ in range(LOOKS):
            for found in pool.map(lambda _: ask(server.port, question), range(requests // LOOKS)):
                if found != answer:
                    raise RuntimeError(f"after many requests another answer: {found}")
            looks.append(look(server))
    lived = set.intersection(*(set(each) for each in looks))
    return [sum(each[pid] for pid in lived) for each in looks]


def ask(port, question):
    with Client(port) as client:
        return client.ask(question)


def look(server):
    return {pid: memory for pid, memory in server.resident().items() if memory}


def grew(memory):
    """Whether memory adds up: at most looks there is more than at the one before.

    A thread that is started late takes memory for itself once, so that the sum at the end tells little. The first look
    is before anything has warmed up.
    """
    steps = [later - earlier for earlier, later in itertools.pairwise(memory[1:])]
    return statistics.median(steps) > ALLOWED or memory[-1] - memory[1] > ALLOWED_IN_ALL
