"""Tests of what tries the library in real brokers, without any: that it can find fault. Run as: python3 -B THIS"""

import dataclasses
import http.server
import os
import pathlib
import sys
import tempfile
import threading
import time
import unittest
import unittest.mock

import cimxml
import differences
import endurance
import pegasus
from changes import with_instances
from cim import COMPUTER_SYSTEM, GLIMMARK, Answer, Instance, Path, Property, Question
from cimxml import message, read_answer
from comparison import Comparison
from differences import Difference
from pressure import ask_at_once
from schema import Schema
from server import Server, free_port, runs

QUESTION = Question("ei", GLIMMARK)
FAN = Path(GLIMMARK, {"DeviceID": "fan"}, "root/cimv2", "host")
LED = Instance(GLIMMARK, FAN, {"Name": Property("string", "fan"), "HealthState": Property("uint16", 5)})


def answer(*items):
    return Answer(0, "", items)


def compared(described, found, known=()):
    """The faults of a single comparison, and the known differences that it did not need."""
    comparison = Comparison(lambda _: found, lambda _: described, list(known), None)
    count, faults = comparison.compare([QUESTION])
    assert count == 1
    return faults, comparison.not_seen()


def without_name(instance):
    return dataclasses.replace(instance, properties={"HealthState": instance.properties["HealthState"]})


def ask_without_names(question, ask, _):
    return with_instances(ask(question), without_name)


NAMELESS = Difference(("sfcb",), "no names", ask_without_names)


class Finding(unittest.TestCase):
    def test_a_server_on_path_that_is_laid_out_otherwise_is_not_tried(self):
        with tempfile.TemporaryDirectory() as folder:
            home = pathlib.Path(folder).resolve() / "pegasus"
            (home / "bin").mkdir(parents=True)
            daemon = home / "bin/cimserver"
            daemon.touch(mode=0o755)
            with unittest.mock.patch.dict(os.environ, {"PATH": str(daemon.parent)}):
                os.environ.pop("PEGASUS_HOME", None)
                self.assertIsNone(pegasus.find())
                for name in ["lib", "repository"]:
                    (home / name).mkdir()
                self.assertEqual(pegasus.find(), home)


class Comparing(unittest.TestCase):
    def test_equal_answers_are_no_fault(self):
        self.assertEqual(compared(answer(LED), answer(LED)), ([], []))
        self.assertEqual(compared(Answer(7, "no"), Answer(7, "no")), ([], []))

    def test_every_other_answer_is_a_fault(self):
        unwell = dataclasses.replace(LED, properties={**LED.properties, "HealthState": Property("uint16", 10)})
        wider = dataclasses.replace(LED, properties={**LED.properties, "HealthState": Property("uint32", 5)})
        elsewhere = dataclasses.replace(LED, path=dataclasses.replace(FAN, host=None))
        for found in [answer(), answer(LED, LED), answer(unwell), answer(wider), answer(elsewhere),
                      answer(without_name(LED)), answer(FAN), Answer(1, "no"), "TimeoutError: timed out"]:
            with self.subTest(found=str(found)):
                self.assertEqual(len(compared(answer(LED), found)[0]), 1)
        self.assertEqual(len(compared(Answer(7, "no"), Answer(7, "No"))[0]), 1)

    def test_a_fault_names_the_question_and_what_differs(self):
        self.assertEqual(
            compared(answer(LED), answer(without_name(LED)))[0],
            ['ei TAVRO_Glimmark\n  1 of 1 items differ, the first:\n-  Name = string "fan"'],
        )
        self.assertEqual(
            compared(answer(), Answer(1, "no"))[0], ["ei TAVRO_Glimmark\n  expected 0 items\n  found (1) no"])

    def test_order_matters_among_items_of_a_class_only(self):
        first, second = (Path(GLIMMARK, {"DeviceID": name}) for name in "ab")
        system = Path(COMPUTER_SYSTEM, {"Name": "a"})
        self.assertEqual(len(compared(answer(first, second), answer(second, first))[0]), 1)
        self.assertEqual(compared(answer(first, second, system), answer(system, first, second))[0], [])

    def test_a_known_difference_is_no_fault(self):
        self.assertEqual(compared(answer(LED), answer(without_name(LED)), [NAMELESS]), ([], []))

    def test_a_known_difference_that_is_none_any_more_is_a_fault(self):
        faults, not_seen = compared(answer(LED), answer(LED), [NAMELESS])
        self.assertEqual(len(faults), 1)
        self.assertEqual(not_seen, ["no names"])

    def test_a_known_difference_that_changes_nothing_is_not_seen(self):
        self.assertEqual(compared(answer(FAN), answer(FAN), [NAMELESS]), ([], ["no names"]))

    def test_a_wrong_answer_shows_no_known_difference(self):
        self.assertEqual(compared(answer(LED), answer(), [NAMELESS])[1], ["no names"])


class KnownDifferences(unittest.TestCase):
    def test_each_has_a_reason_and_a_broker(self):
        for difference in differences.TABLE:
            self.assertTrue(difference.reason.endswith("."), difference.reason)
            self.assertTrue(set(difference.brokers) <= {"sfcb", "pegasus"}, difference.brokers)

    def test_the_page_has_the_whole_table(self):
        page = pathlib.Path(__file__).resolve().parents[2] / "docs/real-brokers.md"
        self.assertIn("\n\n" + differences.table() + "\n\n", page.read_text())

    def test_unset_properties_come_as_the_class_has_them(self):
        declared = {"Name": Property("string", None), "EnabledState": Property("uint16", 5)}
        schema = Schema(lambda _: answer(Instance(GLIMMARK, None, declared)))
        completed = differences.with_unset_properties(answer(LED), None, schema)
        self.assertEqual(completed.items[0].properties, {**LED.properties, "EnabledState": Property("uint16", 5)})
        self.assertEqual(differences.with_unset_properties(answer(LED), ["caption"], schema), answer(LED))


class Messages(unittest.TestCase):
    RESPONSE = (
        '<CIM><MESSAGE><SIMPLERSP><IMETHODRESPONSE NAME="m">{}</IMETHODRESPONSE></SIMPLERSP></MESSAGE></CIM>'
    )

    def test_questions_are_sent_as_they_stand(self):
        sent = message(Question("gi", Path(GLIMMARK, {"DeviceID": 'a "&" b'}), {"PropertyList": ["Name"]})).decode()
        self.assertIn('<KEYVALUE VALUETYPE="string">a "&amp;" b</KEYVALUE>', sent)
        self.assertIn('<IPARAMVALUE NAME="PropertyList"><VALUE.ARRAY><VALUE>Name</VALUE></VALUE.ARRAY>', sent)

    def test_errors_and_empty_answers_are_told_apart(self):
        error = self.RESPONSE.format('<ERROR CODE="6" DESCRIPTION="none"/>')
        self.assertEqual(read_answer(QUESTION, error), Answer(6, "none"))
        self.assertEqual(read_answer(QUESTION, self.RESPONSE.format("<IRETURNVALUE/>")), answer())

    def test_what_is_no_response_is_an_error(self):
        for text in ["", "<CIM/>", "<html>", self.RESPONSE.format("<IRETURNVALUE><VALUE/></IRETURNVALUE>")]:
            with self.subTest(text), self.assertRaises(RuntimeError):
                read_answer(QUESTION, text)

    def test_values_have_their_type_and_kind(self):
        found = read_answer(QUESTION, self.RESPONSE.format(
            '<IRETURNVALUE><INSTANCE CLASSNAME="C">'
            '<PROPERTY NAME="A" TYPE="string"><VALUE>5</VALUE></PROPERTY>'
            '<PROPERTY NAME="B" TYPE="uint16"><VALUE>5</VALUE></PROPERTY>'
            '<PROPERTY NAME="C" TYPE="boolean"><VALUE>false</VALUE></PROPERTY>'
            '<PROPERTY NAME="D" TYPE="uint16"/>'
            '<PROPERTY.ARRAY NAME="E" TYPE="uint16"><VALUE.ARRAY><VALUE>2</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>'
            "</INSTANCE></IRETURNVALUE>"))
        self.assertEqual(found.items[0].properties, {
            "A": Property("string", "5"), "B": Property("uint16", 5), "C": Property("boolean", False),
            "D": Property("uint16", None), "E": Property("uint16[]", [2])})


class Memory(unittest.TestCase):
    def test_growth_is_told_from_warming_up_and_late_threads(self):
        self.assertFalse(endurance.grew([100, 5000, 5000, 5016, 5016, 5020, 5020]))
        self.assertFalse(endurance.grew([2432, 3128, 3272, 3272, 3280, 3284, 3568, 3568, 3584, 3704, 3716]))

    def test_what_adds_up_is_found(self):
        self.assertTrue(endurance.grew([100, 5000, 5100, 5200, 5300, 5400, 5500]))
        self.assertTrue(endurance.grew([100, 5000, 5040, 5080, 5120, 5160, 5200]))
        self.assertTrue(endurance.grew([100, 5000, 5000, 5000, 5000, 5000, 9000]))


class OneWrongAnswer(http.server.BaseHTTPRequestHandler):
    """Answers every request alike but the tenth."""

    protocol_version = "HTTP/1.1"
    count = 0

    def do_POST(self):
        self.rfile.read(int(self.headers["Content-Length"]))
        OneWrongAnswer.count += 1
        code = 6 if OneWrongAnswer.count == 10 else 7
        body = Messages.RESPONSE.format(f'<ERROR CODE="{code}"/>').encode()
        self.send_response(200)
        self.send_header("Content-Length", str(len(body)))
        self.end_headers()
        self.wfile.write(body)

    def log_message(self, *_):
        """Says nothing."""


class Pressure(unittest.TestCase):
    def test_one_wrong_answer_among_many_is_found(self):
        with http.server.ThreadingHTTPServer(("127.0.0.1", 0), OneWrongAnswer) as server:
            threading.Thread(target=server.serve_forever, daemon=True).start()
            expected = [(QUESTION, Answer(7))]
            self.assertEqual(len(ask_at_once(server.server_port, expected, 40, 4)), 1)
            self.assertEqual(ask_at_once(server.server_port, expected, 40, 4), [])
            server.shutdown()

    def test_a_connection_that_was_idle_is_opened_again(self):
        class Closing(OneWrongAnswer):
            timeout = 0.2

        with http.server.ThreadingHTTPServer(("127.0.0.1", 0), Closing) as server:
            threading.Thread(target=server.serve_forever, daemon=True).start()
            with cimxml.Client(server.server_port) as client:
                client.ask(QUESTION)
                time.sleep(0.5)
                client.used -= 2 * cimxml.IDLE
                client.ask(QUESTION)
            server.shutdown()

    def test_a_server_that_is_not_there_is_found(self):
        self.assertEqual(len(ask_at_once(free_port(), [(QUESTION, Answer(7))], 4, 2)), 2)


# A server with a process that has left it, as an agent may.
LEAVING = """
import http.server, os, sys
if os.fork() == 0:
    os.setsid()
    if os.fork() == 0:
        import time
        time.sleep(60)
    os._exit(0)
os.wait()
http.server.HTTPServer(("127.0.0.1", int(sys.argv[1])), http.server.BaseHTTPRequestHandler).serve_forever()
"""


class Servers(unittest.TestCase):
    def setUp(self):
        self.log = pathlib.Path(self.enterContext(tempfile.TemporaryDirectory())) / "log"

    def start(self, program):
        port = free_port()
        return Server([sys.executable, "-c", program, str(port)], port, self.log, dict(os.environ))

    def test_processes_that_have_left_are_seen_and_ended(self):
        server = self.start(LEAVING)
        started = server.processes()
        self.assertEqual(len(started), 2)
        self.assertTrue(all(server.resident().values()))
        server.stop()
        self.assertFalse(any(map(runs, started)))

    def test_a_server_that_ends_at_once_is_an_error_with_what_it_said(self):
        with self.assertRaisesRegex(RuntimeError, "no such thing"):
            self.start("raise SystemExit('no such thing')")


if __name__ == "__main__":
    unittest.main()
