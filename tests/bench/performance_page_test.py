"""docs/performance.md cannot fall behind what was measured, nor this behind the sources, without somebody being told."""
import importlib.machinery
import importlib.util
import io
import json
import subprocess
import tempfile
import unittest
from contextlib import redirect_stderr, redirect_stdout
from pathlib import Path

PROGRAM = Path(__file__).resolve().parents[2] / "tools/check_performance"
SOURCE = """#include "bench/Ratios.h"
// 12 "words" of a comment
void add() { bench::addRatio({"ours / bare", "ours", "bare", 1.5}); }
"""


def program():
    loader = importlib.machinery.SourceFileLoader("check_performance", str(PROGRAM))
    module = importlib.util.module_from_spec(importlib.util.spec_from_loader("check_performance", loader))
    loader.exec_module(module)
    return module


checker = program()


def benchmark(name, **values):
    return {"name": name, "seconds": 0.002, "instructions": 0, "runs": 7, "units": 1, **values}


def figure(**values):
    return {"what": "ours / bare", "value": 1.25, "wobble": 0.05, "unit": "x", "most": 1.5, "missed": False,
            "by": "time", "how": "", "source": "../../bench/Some.cpp", "measured": benchmark("ours"),
            "base": benchmark("bare", seconds=0.0016), **values}


class Page(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.root = Path(folder.name)
        for name in ("bench", "docs"):
            (self.root / name).mkdir()
        self.source = self.root / "bench/Some.cpp"
        self.source.write_text(SOURCE)
        self.page = self.root / "docs/performance.md"
        self.page.write_text(f"Before.\n\n{checker.BEGIN}\n{checker.END}\n\nAfter.\n")
        (self.root / "bench/results.json").write_text("{}")

    def take(self, *figures, group="some", names=("some",)):
        return checker.take(self.root, {group: {"whyNothingCounts": "", "figures": list(figures)}}, names)

    def faults(self, names=("some",)):
        return list(checker.faults(self.root, checker.stored(self.root), names))

    def text(self):
        return self.page.read_text()


class WhatIsShown(Page):
    def test_is_the_figure_with_wobble_limit_and_machine(self):
        self.assertTrue(self.take(figure()))
        self.assertIn("\n| ours / bare | 1.250 x | ± 4.0 % | 1.5 | 2 ms / 1.6 ms | 7 / 7 | 1 |\n", self.text())
        self.assertIn(f"\n1. {checker.machine()}\n", self.text())

    def test_stands_between_the_marks_and_leaves_the_rest_alone(self):
        self.take(figure())
        self.take(figure())
        self.assertTrue(self.text().startswith(f"Before.\n\n{checker.BEGIN}\n\nMachines:\n"))
        self.assertTrue(self.text().endswith(f" | 1 |\n\n{checker.END}\n\nAfter.\n"), self.text())

    def test_says_which_limits_are_missed(self):
        self.take(figure(value=2.0, missed=True))
        self.assertIn("| 2.000 x | ± 2.5 % | 1.5, **missed** |", self.text())

    def test_says_what_was_not_measured(self):
        self.take(figure(value=0, missed=True, measured=benchmark("ours", runs=0, seconds=0)))
        self.assertIn("| not measured | - | 1.5, **missed** | nothing / 1.6 ms | 0 / 7 |", self.text())

    def test_is_how_it_was_measured_where_the_names_do_not_say_it(self):
        self.take(figure(how="A sentence."), figure(what="plain"))
        self.assertIn("| 1 |\n\n- *ours / bare*: A sentence.\n\n<!--", self.text())

    def test_counts_instructions_and_units(self):
        self.take(figure(by="instructions", measured=benchmark("ours", instructions=2.5e6, runs=9, units=10),
                         base=benchmark("bare", instructions=2e6, units=5)))
        self.assertIn("| 1.250 x by instructions | ± 4.0 % | 1.5 | 2 ms / 2 ms; 2.500 / 2.000 million instructions "
                      "for 10 / 5 | 9 / 7 |", self.text())

    def test_has_no_limit_nor_wobble_where_there_is_none(self):
        self.take({"what": "memory", "value": 3.5, "wobble": 0, "unit": "MB", "most": 0, "missed": False, "by": "time",
                   "how": "", "source": "bench/Some.cpp"})
        self.assertIn("| memory | 3.500 MB | - | - | - | - | 1 |", self.text())

    def test_keeps_the_groups_that_were_not_run(self):
        names = ("some", "others")
        self.take(figure(what="first"), names=names)
        self.take(figure(what="second"), group="others", names=names)
        self.assertIn("| first |", self.text())
        self.assertIn("| second |", self.text())
        self.assertEqual(self.faults(names), [])

    def test_loses_the_groups_that_are_gone(self):
        self.take(figure(what="first"))
        self.take(figure(what="second"), group="others", names=("others",))
        self.assertNotIn("first", self.text())


class TheCheck(Page):
    def setUp(self):
        super().setUp()
        self.take(figure())

    def assert_told(self, words, names=("some",)):
        found = self.faults(names)
        self.assertEqual(len(found), 1, found)
        self.assertIn(words, found[0])

    def test_is_content_with_what_was_just_written(self):
        self.assertEqual(self.faults(), [])

    def test_tells_of_another_page(self):
        self.page.write_text(self.text().replace("1.250 x", "1.150 x"))
        self.assert_told("docs/performance.md shows something else")

    def test_tells_of_other_results(self):
        results = checker.stored(self.root)
        results["some"]["figures"][0]["value"] = 1.3
        (self.root / "bench/results.json").write_text(json.dumps(results))
        self.assert_told("docs/performance.md shows something else")

    def test_tells_of_a_limit_that_has_changed(self):
        self.source.write_text(SOURCE.replace("1.5", "1.2"))
        self.assert_told("bench/Some.cpp has other texts or numbers")

    def test_tells_of_a_figure_that_was_added(self):
        self.source.write_text(SOURCE + 'void more() { bench::addFigure("more", value(), "MB", kMost); }')
        self.assert_told("bench/Some.cpp has other texts or numbers")

    def test_does_not_mind_names_layout_and_comments(self):
        self.source.write_text(SOURCE.replace("add()", "addAll2()\n").replace("12", "13") + "// 9\n")
        self.assertEqual(self.faults(), [])

    def test_tells_of_a_source_that_is_gone(self):
        self.source.unlink()
        self.assert_told("bench/Some.cpp has other texts or numbers")

    def test_tells_of_a_file_whose_figures_nothing_has_measured(self):
        (self.root / "bench/New.mm").write_text('void add() { bench::addFigure("a", 1, "x", 2); }')
        self.assert_told("bench/New.mm adds figures")

    def test_tells_of_a_group_that_nothing_has_measured(self):
        names = ("some", "new")
        (self.root / "docs/performance.md").write_text(
            checker.with_tables(self.text(), checker.tables(checker.stored(self.root), names)))
        self.assert_told("The group new has not been measured", names)
        self.assertIn("### new\n\nNot measured yet.", self.text())

    def test_tells_of_a_group_that_is_gone(self):
        checker.write(self.root, {**checker.stored(self.root), "old": checker.stored(self.root)["some"]}, ("some",))
        self.assert_told("bench/results.json holds old")

    def test_ends_when_the_page_has_lost_its_marks(self):
        self.page.write_text("Nothing.")
        with self.assertRaises(SystemExit) as ended:
            self.faults()
        self.assertIn("has lost its marks", str(ended.exception))


class ASummary(unittest.TestCase):
    def summary(self, **groups):
        out, err = io.StringIO(), io.StringIO()
        with redirect_stdout(out), redirect_stderr(err):
            status = checker.summary(groups)
        return status, out.getvalue(), err.getvalue()

    def test_says_once_why_nothing_counts(self):
        group = {"whyNothingCounts": "No such file", "figures": [figure()]}
        status, out, err = self.summary(one=group, other=group)
        self.assertEqual((status, out.count("No such file"), err), (0, 1, ""))

    def test_says_nothing_where_all_is_counted(self):
        self.assertEqual(self.summary(one={"whyNothingCounts": "", "figures": [figure()]}), (0, "", ""))

    def test_refuses_a_run_without_figures(self):
        status, out, err = self.summary(one={"whyNothingCounts": "No such file", "figures": []})
        self.assertEqual((status, out), (2, ""))
        self.assertIn("No figure has been measured", err)


class TheTool(unittest.TestCase):
    """What tools/bench says before it builds anything."""

    def run_tool(self, *words):
        return subprocess.run([PROGRAM.parent / "bench", *words], capture_output=True, text=True, check=False)

    def assert_refused(self, sentence, *words):
        ran = self.run_tool(*words)
        self.assertEqual((ran.returncode, ran.stdout), (2, ""))
        self.assertEqual(ran.stderr, f"{sentence} See tools/bench --help.\n")

    def test_names_the_groups_that_the_program_knows_and_the_dialogs(self):
        rows = (PROGRAM.parents[1] / "bench/main.cpp").read_text().count(", add")
        groups = self.run_tool("--list").stdout.split()
        self.assertEqual(len(groups), rows + 1)
        self.assertLessEqual({"loading", "lists", "dialogs"}, set(groups))

    def test_refuses_what_it_does_not_know(self):
        known = " ".join(self.run_tool("--list").stdout.split())
        self.assert_refused(f'There is no group of benchmarks called "list"; there are {known}.', "lists", "list")
        self.assert_refused("There is no option --fast.", "--fast")
        self.assert_refused("After --only comes what the names of the figures hold.", "--only")

    def test_writes_nothing_but_whole_groups(self):
        sentence = "What is written has to be whole: --write goes with neither --quick nor --only."
        self.assert_refused(sentence, "--write", "--quick")
        self.assert_refused(sentence, "--only", "read", "--write")

    def test_explains_itself(self):
        ran = self.run_tool("--help", "nonsense")
        self.assertEqual(ran.returncode, 0)
        for option in ("--list", "--only", "--quick", "--write"):
            self.assertIn(f"\n    {option} ", ran.stdout)


if __name__ == "__main__":
    unittest.main()
