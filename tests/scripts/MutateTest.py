"""Tests of what scripts/mutate plants and of the lists of explanations. Run as: python3 -B THIS"""

import importlib.machinery
import importlib.util
import pathlib
import sys
import unittest

SCRIPTS = pathlib.Path(__file__).resolve().parents[2] / "scripts"
sys.path.insert(0, str(SCRIPTS))

import explanations  # noqa: E402: found by the path above


def load(name):
    loader = importlib.machinery.SourceFileLoader(name, str(SCRIPTS / name))
    module = importlib.util.module_from_spec(importlib.util.spec_from_loader(name, loader))
    loader.exec_module(module)
    return module


mutate = load("mutate")


def planted(text, rule):
    """What a rule makes of a text."""
    return [mutant.text for mutant in mutate.plant("file.cpp", text) if mutant.rule == rule]


class Rules(unittest.TestCase):
    def test_texts_lose_blanks_and_change_letters(self):
        self.assertEqual(planted('f("a  bcd");', "blank fewer"), ['f("a bcd");'])
        self.assertEqual(planted('f("abc");', "letter"), ['f("axc");'])
        self.assertEqual(planted('f(L"x");', "letter"), ['f(L"y");'])

    def test_escapes_and_conversions_stay_whole(self):
        self.assertEqual(planted(r'f("\n");', "letter"), [])
        self.assertEqual(planted('f("%s");', "letter"), [])

    def test_comments_directives_and_blanks_of_code_are_left_alone(self):
        self.assertEqual(list(mutate.plant("file.cpp", '// f(1, 2) == "a b"\n#include "a b.h"\n/* 1 < 2 */\n')), [])

    def test_calls_are_dropped_and_doubled(self):
        text = "{ Cmpi::returnDone(rslt); }"
        self.assertEqual(planted(text, "dropped statement"), ["{ ; }"])
        self.assertEqual(planted(text, "doubled statement"), ["{ Cmpi::returnDone(rslt); Cmpi::returnDone(rslt); }"])
        self.assertEqual(planted("{ if (a) b.c->d(); }", "dropped statement"), ["{ if (a) ; }"])
        self.assertEqual(planted("{ status->rc = 1; }", "dropped statement"), ["{ ; }"])
        self.assertEqual(planted("switch (a) { case B::c: f(); }", "dropped statement"), ["switch (a) { case B::c: ; }"])

    def test_values_are_not_assigned_twice(self):
        self.assertEqual(planted("{ status->rc = 1; }", "doubled statement"), [])
        self.assertEqual(planted("{ list[key] = take(all); }", "doubled statement"),
                         ["{ list[key] = take(all); list[key] = take(all); }"])

    def test_what_has_no_order_is_not_swapped(self):
        self.assertEqual(planted("if (std::strcmp(a, b) == 0)", "swapped neighbours"), [])
        self.assertEqual(planted("enum class End\n{\n    near,\n    far\n};", "swapped neighbours"), [])

    def test_declarations_are_not_dropped(self):
        self.assertEqual(planted("{ const Factory factory(true); int i = 0; return f(x); }", "dropped statement"), [])

    def test_comparisons_and_their_boundaries(self):
        self.assertEqual(planted("a < b;", "boundary"), ["a <= b;"])
        self.assertEqual(planted("a == b;", "comparison"), ["a != b;"])
        self.assertEqual(planted("a && b;", "and or"), ["a || b;"])

    def test_template_brackets_and_references_are_no_operators(self):
        self.assertEqual(planted("std::vector<int> f(T&& t);", "boundary"), [])
        self.assertEqual(planted("std::vector<int> f(T&& t);", "and or"), [])

    def test_conditions_become_constant(self):
        self.assertEqual(planted("if (a == b) c;", "condition"), ["if (true) c;", "if (false) c;"])
        self.assertEqual(planted("while (f(a)) c;", "condition"), ["while (false) c;"])
        self.assertEqual(
            planted("if (const int* a = f()) g(a);", "condition"),
            ["if (const int* a = f(); true) g(a);", "if (const int* a = f(); false) g(a);"],
        )
        self.assertEqual(planted("if (int a = 1; f(a)) c;", "condition"), ["if (int a = 1; true) c;", "if (int a = 1; false) c;"])
        self.assertEqual(planted("x = a ? b : c;", "condition"), ["x = a || true ? b : c;", "x = a && false ? b : c;"])

    def test_neighbours_are_swapped_but_not_parameters(self):
        self.assertEqual(planted("f(a, g(b, b), c);", "swapped neighbours"), ["f(g(b, b), a, c);", "f(a, c, g(b, b));"])
        self.assertEqual(planted("x = {a, b};", "swapped neighbours"), ["x = {b, a};"])
        self.assertEqual(planted("int f(const A* a, B& b) { c(); d(); }", "swapped neighbours"), [])

    def test_numbers_truths_levels_and_statuses(self):
        self.assertEqual(planted("x = 0x1FU;", "number"), ["x = 32U;"])
        self.assertEqual(planted("x = true;", "truth"), ["x = false;"])
        self.assertEqual(planted("trace(CMPI_LEV_INFO);", "trace level"), ["trace(CMPI_LEV_WARNING);"])
        self.assertEqual(planted("return CMPI_RC_OK;", "status"), ["return CMPI_RC_ERR_FAILED;"])
        self.assertEqual(planted("return !a;", "dropped not"), ["return a;"])

    def test_results_and_jumps(self):
        self.assertEqual(planted("{ return f(a); }", "returned nothing"), ["{ return {}; }"])
        self.assertEqual(planted("{ return; }", "dropped jump"), ["{ ; }"])

    def test_enumerators_and_names(self):
        self.assertEqual(planted("enum class E { a, b }; x = E::a;".replace(" a", "\na").replace(" b", "\nb"),
                                 "other constant"), ["enum class E {\na,\nb }; x = E::b;"])
        self.assertEqual(len(planted("f(GlimmarkClass); g(ComputerSystemClass);", "other constant")), 2)


class Mutants(unittest.TestCase):
    def test_lines_keep_their_numbers(self):
        for mutant in mutate.plant("file.cpp", "{\n    f(a,\n      b);\n    // a comment\n    g(1);\n}\n"):
            self.assertEqual(mutant.text.count("\n"), 6, mutant)

    def test_a_mutant_is_named_by_its_lines_and_not_by_their_place(self):
        first, moved = (next(m for m in mutate.plant("file.cpp", text) if m.rule == "comparison") for text in ("f();\na == b;\n", "f();\n\n    a == b;\n"))
        self.assertEqual(first.key(), moved.key())
        self.assertEqual((first.line, moved.line), (2, 3))
        self.assertEqual(str(first), "file.cpp\n@ f();\n- a == b;\n+ a != b;")

    def test_each_text_comes_once(self):
        texts = [mutant.text for mutant in mutate.plant("file.cpp", "if (true) f(1);")]
        self.assertEqual(len(texts), len(set(texts)))

    def test_a_draw_takes_from_each_rule(self):
        mutants = list(mutate.plant("file.cpp", 'f("a b c d e f g");\nif (!a) f("h i j k");\n'))
        drawn = mutate.draw(mutants, len({mutant.rule for mutant in mutants}), number=1)
        self.assertEqual(sorted(m.rule for m in drawn), sorted({m.rule for m in mutants}))
        self.assertEqual([m.key() for m in drawn], [m.key() for m in mutate.draw(mutants, len(drawn), number=1)])


class Explanations(unittest.TestCase):
    SOURCES = {"a.cpp": "one\n  two\n"}

    def read(self, text):
        return explanations.read("list.txt", text, "-+", self.SOURCES)

    def test_entries_have_lines_and_a_reason(self):
        entries = self.read("# A comment.\n\na.cpp\n- two\n+ three\n  Because\n  of it.\n\na.cpp\n- one\n  Why.\n")
        self.assertEqual(entries[0], explanations.Explanation("a.cpp", (("two",), ("three",)), "Because of it."))
        self.assertEqual(entries[1].lines, (("one",), ()))

    def test_an_entry_for_what_is_no_longer_there_is_an_error(self):
        for text, message in (
            ("b.cpp\n- one\n  Why.\n", "expected a source file, found: b.cpp"),
            ("a.cpp\n- gone\n  Why.\n", "a.cpp no longer has the line:\ngone"),
            ("a.cpp\n- one\n", "a reason"),
            ("a.cpp\n  Why.\n", "expected lines behind - +"),
        ):
            with self.assertRaises(SystemExit) as raised:
                self.read(text)
            self.assertIn(message, str(raised.exception))


class Repository(unittest.TestCase):
    def test_the_sources_have_mutants_of_every_rule(self):
        sources = mutate.read_sources()
        self.assertIn("src/providers/ResultLists.h", sources)
        self.assertIn("src/model/Glimmark.h", sorted(sources))
        mutants = [mutant for file, text in sources.items() for mutant in mutate.plant(file, text)]
        self.assertGreaterEqual(len(mutants), 150)
        self.assertEqual({mutant.rule for mutant in mutants}, set(mutate.RULES))

    def test_the_lists_fit_the_sources(self):
        sources = mutate.read_sources()
        for name, marks in (("mutate-equivalents.txt", mutate.MARKS), ("coverage-exceptions.txt", "|")):
            explanations.read(name, (SCRIPTS / name).read_text(), marks, sources)


if __name__ == "__main__":
    unittest.main()
