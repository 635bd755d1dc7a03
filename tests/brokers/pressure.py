"""Requests over several connections at once, each answered as when it is asked alone."""

import threading

from cimxml import Client


def ask_at_once(port, expected, requests, connections):
    """Asks `requests` questions of `expected` (pairs of question and answer) over `connections` kept connections.

    The faults, at most one of each connection.
    """
    faults = []
    each = requests // connections

    def ask(first):
        try:
            with Client(port) as client:
                for index in range(first, first + each):
                    question, answer = expected[index % len(expected)]
                    found = client.ask(question)
                    if found != answer:
                        faults.append(f"{question}: {found}")
                        return
        except (OSError, RuntimeError) as error:
            faults.append(f"{type(error).__name__}: {error}")

    # Each connection begins elsewhere, so that different questions meet.
    threads = [threading.Thread(target=ask, args=(each * number,)) for number in range(connections)]
    for thread in threads:
        thread.start()
    for thread in threads:
        thread.join()
    return faults
