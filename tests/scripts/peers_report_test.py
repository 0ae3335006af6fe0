"""The report of the comparison with other libraries: peers_report_test.py FOLDER_OF_REPORT_PY"""
import contextlib
import io
import json
import os
import sys
import tempfile
import unittest

sys.path.insert(0, sys.argv.pop())
sys.dont_write_bytecode = True
import report  # noqa: E402


def run_of(**figures):
    """A run in which the contenders of 'window' have so many millions a second."""
    return {"benchmarks": [{"name": f"window/{name}/process_time", "run_type": "iteration",
                            "items_per_second": millions * 1e6}
                           for name, millions in figures.items()]}


def failure_of(work, contender, message):
    return {"benchmarks": [{"name": f"{work}/{contender}/process_time", "run_type": "iteration",
                            "error_occurred": True, "error_message": message}]}


def results_of(*runs):
    results = report.Results()
    for run in runs:
        results.add_run(run)
    return results


def cells(results, goals=(report.Goal(1.0),), libraries=("OpenCV", "VTK")):
    line = report.table_line(results, report.Row("window", "Window", libraries, goals))
    return [cell.strip() for cell in line.strip("|").split("|")]


class Table(unittest.TestCase):
    def test_figures_are_medians_of_the_runs(self):
        results = results_of(run_of(vorl=100, OpenCV=50), run_of(vorl=900, OpenCV=60),
                             run_of(vorl=300, OpenCV=90))
        self.assertEqual(cells(results, libraries=("OpenCV",)),
                         ["Window", "300", "OpenCV 60.0", "-", "5.00 [10.00]", ">= 1", "yes"])

    def test_fastest_library_decides_and_others_are_named(self):
        row = cells(results_of(run_of(vorl=3000, OpenCV=1000, VTK=2000)))
        self.assertEqual(row[2], "VTK 2,000 (OpenCV 1,000)")
        self.assertEqual(row[4], "1.50 [1.50]")

    def test_what_is_no_library_stands_beside_and_does_not_decide(self):
        row = cells(results_of(run_of(vorl=3000, OpenCV=1000, VTK=100, plain=9000, memcpy=99.96)))
        self.assertEqual(row[3], "plain 9,000, memcpy 100.0")
        self.assertEqual(row[4], "3.00 [3.00]")

    def test_goal_over_a_named_one_stands_beside_that_over_the_fastest(self):
        goals = (report.Goal(2), report.Goal(12, "VTK"))
        row = cells(results_of(run_of(vorl=1000, OpenCV=500, VTK=100)), goals)
        self.assertEqual(row[4:], ["2.00 [2.00]; 10.00 [10.00] (VTK)", ">= 2; >= 12 (VTK)",
                                   "yes; no"])

    def test_goal_is_met_when_reached_exactly_and_missed_below(self):
        goals = (report.Goal(0.8, "fwrite"),)
        self.assertEqual(cells(results_of(run_of(vorl=80, fwrite=100)), goals, ())[6], "yes")
        self.assertEqual(cells(results_of(run_of(vorl=79, fwrite=100)), goals, ())[6], "no")

    def test_missing_library_is_said(self):
        results = results_of(run_of(vorl=100, OpenCV=50))
        self.assertEqual(cells(results)[2], "OpenCV 50.0 (VTK not measured)")
        self.assertIn("VTK: no figures at all; is it installed?", report.notes(results)[0])
        self.assertNotIn("OpenCV: no figures at all; is it installed?", report.notes(results)[0])

    def test_without_any_library_nobody_knows_whether_a_goal_is_met(self):
        row = cells(results_of(run_of(vorl=100, plain=50)))
        self.assertEqual(row[2], "OpenCV not measured, VTK not measured")
        self.assertEqual(row[4:], ["?", ">= 1", "?"])

    def test_aggregates_are_no_figures(self):
        run = run_of(vorl=100, OpenCV=50)
        run["benchmarks"].append({"name": "window/vorl/process_time", "run_type": "aggregate",
                                  "items_per_second": 1e12})
        self.assertEqual(cells(results_of(run))[1], "100")


class Notes(unittest.TestCase):
    def test_wrong_result_does_not_count_in_any_run(self):
        results = results_of(run_of(vorl=100, OpenCV=50),
                             failure_of("window", "OpenCV", "wrong: 1 instead of 2 at 3"))
        self.assertEqual(cells(results, libraries=("OpenCV",))[2:7],
                         ["OpenCV not measured", "-", "?", ">= 1", "?"])
        lines, is_sound = report.notes(results)
        self.assertIn("window: OpenCV does not count: wrong: 1 instead of 2 at 3", lines)
        self.assertFalse(is_sound)

    def test_work_that_was_not_measured_is_said(self):
        lines, is_sound = report.notes(results_of(run_of(vorl=100)))
        self.assertIn("BDF read, 150 MB: not measured", lines)
        self.assertNotIn("window 16 to 8 bit, 2048 x 2048: not measured", lines)
        self.assertTrue(is_sound)

    def test_work_without_a_row_is_said(self):
        lines, is_sound = report.notes(results_of({"benchmarks": [
            {"name": "sorting/vorl/process_time", "items_per_second": 1.0}]}))
        self.assertIn("sorting: not in the table", lines)
        self.assertFalse(is_sound)


class Program(unittest.TestCase):
    def run_with(self, run):
        with tempfile.TemporaryDirectory() as folder:
            path = os.path.join(folder, "round1.json")
            with open(path, "w", encoding="utf-8") as file:
                json.dump(run, file)
            with contextlib.redirect_stdout(io.StringIO()) as output:
                return report.main([path]), output.getvalue().splitlines()

    def test_prints_a_line_for_every_work_that_was_measured_and_succeeds(self):
        result, lines = self.run_with(run_of(vorl=100, OpenCV=50, VTK=20))
        self.assertEqual(result, 0)
        self.assertEqual(lines[2], "| window 16 to 8 bit, 2048 x 2048 | 100 | OpenCV 50.0 "
                                   "(VTK 20.0) | - | 2.00 [2.00] | >= 1 | yes |")
        self.assertEqual(sum(line.startswith("|") for line in lines), 3)
        self.assertEqual(sum(line.endswith(": not measured") for line in lines),
                         len(report.ROWS) - 1)

    def test_fails_where_a_result_was_wrong(self):
        self.assertEqual(self.run_with(failure_of("window", "vorl", "wrong"))[0], 1)


if __name__ == "__main__":
    unittest.main()
