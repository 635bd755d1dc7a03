"""Many requests one after the other, and what memory the broker has meanwhile."""

import concurrent.futures

from cimxml import Client

AT_ONCE = 2  # a request each, over a connection of its own
LOOKS = 10
ALLOWED = 256  # KiB, of all processes together: what allocators and thread pools take and give


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
    """By how much the second half of the looks exceeds the first, in KiB, beyond what is allowed; the first look is
    before all have warmed up."""
    half = 1 + len(memory[1:]) // 2
    return max(0, max(memory[half:]) - max(memory[1:half]) - ALLOWED)
