#!/usr/bin/env python3
"""The table of the comparison with other libraries.

usage: report.py ROUND.json...

Each file is what one run of vorl_peers wrote. Figures are medians over the runs, in millions of
samples or pixels per second of processor time. A ratio is vorl's figure by that of the fastest other
library, or by that of what stands beside it; in brackets the ratio of the best figures, which other
programs on the machine disturb less. Ends with 1 where a result was wrong or a work is unknown.
"""
import json
import statistics
import sys
from dataclasses import dataclass
from typing import Optional

LIBRARIES = ("OpenCV", "VTK", "libyuv")


@dataclass(frozen=True)
class Goal:
    """What vorl is to reach: a multiple of the figure of `over`, or of the fastest library's."""
    ratio: float
    over: Optional[str] = None


@dataclass(frozen=True)
class Row:
    work: str
    title: str
    libraries: tuple
    goals: tuple


def row(work, title, libraries, *goals):
    return Row(work, title, tuple(libraries.split()), goals)


ROWS = (
    row("window", "window 16 to 8 bit, 2048 x 2048", "OpenCV VTK", Goal(1.0)),
    row("minmax/image", "min/max, 16 bit, in cache", "OpenCV", Goal(7)),
    row("minmax/volume", "min/max, 16 bit, whole volume", "OpenCV", Goal(1.8)),
    row("rescale/8bit", "rescale 8 bit", "OpenCV", Goal(1.0)),
    row("rescale/16bit", "rescale 16 bit", "OpenCV", Goal(0.4)),
    row("mpr/nearest/axial", "MPR nearest, axial", "VTK", Goal(7)),
    row("mpr/nearest/coronal", "MPR nearest, coronal", "VTK", Goal(7)),
    row("mpr/nearest/sagittal", "MPR nearest, sagittal", "VTK", Goal(1.15)),
    row("mpr/nearest/oblique", "MPR nearest, oblique", "VTK", Goal(3)),
    row("mpr/linear/axial", "MPR linear, axial", "VTK", Goal(9)),
    row("mpr/linear/coronal", "MPR linear, coronal", "VTK", Goal(9)),
    row("mpr/linear/sagittal", "MPR linear, sagittal", "VTK", Goal(1.9)),
    row("mpr/linear/oblique", "MPR linear, oblique, 512", "VTK", Goal(8)),
    row("mpr/linear/oblique1024", "MPR linear, oblique, 1024", "VTK", Goal(7)),
    row("slab/linear/maximum", "slab maximum, 64 samples, oblique, linear", "VTK", Goal(4)),
    row("slab/linear/mean", "slab mean, 64 samples, oblique, linear", "VTK", Goal(4)),
    row("slab/nearest/maximum", "slab maximum, 64 samples, oblique, nearest", "VTK", Goal(4)),
    row("depth/z", "maximum of all depths, along z", "OpenCV VTK", Goal(1.0), Goal(8, "VTK")),
    row("depth/y", "maximum of all depths, along y", "OpenCV VTK", Goal(2), Goal(12, "VTK")),
    row("depth/x", "maximum of all depths, along x", "OpenCV VTK", Goal(2), Goal(14, "VTK")),
    row("classification/value", "histogram of the volume", "VTK", Goal(2.5)),
    row("classification/edge", "classification by edge strength", "", Goal(0.4, "memcpy")),
    row("selection/value", "selection by value", "", Goal(0.4, "memcpy")),
    row("selection/edge", "selection by edge strength", "", Goal(0.4, "memcpy")),
    row("stretch/8bit/512", "StretchDIBits 8 bit, 512 to 3840 x 2160", "OpenCV libyuv", Goal(5)),
    row("stretch/8bit/2048", "StretchDIBits 8 bit, 2048 to 3840 x 2160", "OpenCV libyuv", Goal(5)),
    row("stretch/32bit/512", "StretchDIBits 32 bit, 512 to 3840 x 2160", "OpenCV libyuv",
        Goal(1.5)),
    row("stretch/32bit/2048", "StretchDIBits 32 bit, 2048 to 3840 x 2160", "OpenCV libyuv",
        Goal(1.5)),
    row("bmp/save", "BMP save, 24 bit, 2048 x 2048", "OpenCV", Goal(1.1)),
    row("bmp/load", "BMP load, 24 bit, 2048 x 2048", "OpenCV", Goal(2)),
    row("bdf/write", "BDF write, 150 MB", "", Goal(0.8, "fwrite")),
    row("bdf/read", "BDF read, 150 MB", "", Goal(0.8, "fread")),
)


class Results:
    """The figures of all runs, and what went wrong."""

    def __init__(self):
        self.rates = {}  # (work, contender): samples per second, one figure a run
        self.problems = {}  # (work, contender): message

    def add_run(self, run):
        for benchmark in run["benchmarks"]:
            if benchmark.get("run_type", "iteration") != "iteration":
                continue
            name = benchmark["name"].removesuffix("/process_time")
            key = tuple(name.rsplit("/", 1))
            if benchmark.get("error_occurred"):
                self.problems[key] = benchmark["error_message"]
            else:
                self.rates.setdefault(key, []).append(benchmark["items_per_second"])

    def rate(self, work, contender, summary=statistics.median):
        """None for who was not measured, or wrong even once."""
        key = (work, contender)
        return summary(self.rates[key]) if key in self.rates and key not in self.problems else None

    def has(self, work):
        return any(entered == work for entered, _ in list(self.rates) + list(self.problems))

    def contenders(self, work):
        return [contender for entered, contender in self.rates if entered == work]

    def fastest(self, row):
        measured = [name for name in row.libraries if self.rate(row.work, name) is not None]
        return max(measured, key=lambda name: self.rate(row.work, name), default=None)

    def ratio(self, work, over, summary=statistics.median):
        rates = [self.rate(work, name, summary) for name in ("vorl", over)]
        return None if None in rates else rates[0] / rates[1]


def figure(rate):
    if rate is None:
        return "not measured"
    millions = rate / 1e6
    return f"{millions:,.0f}" if millions >= 100 else f"{millions:.1f}"


def named_figures(results, row, names):
    return ", ".join(f"{name} {figure(results.rate(row.work, name))}" for name in names)


def library_cell(results, row):
    fastest = results.fastest(row)
    others = [name for name in row.libraries if name != fastest]
    if fastest is None:
        return named_figures(results, row, others) or "-"
    cell = named_figures(results, row, [fastest])
    return f"{cell} ({named_figures(results, row, others)})" if others else cell


def yardstick_cell(results, row):
    names = [name for name in results.contenders(row.work)
             if name not in LIBRARIES and name != "vorl"]
    return named_figures(results, row, names) or "-"


def goal_cells(results, row, goal):
    """The ratio, what is asked for, and whether it is met; `?` where nobody can tell."""
    over = goal.over or results.fastest(row)
    suffix = f" ({goal.over})" if goal.over else ""
    ratio = results.ratio(row.work, over)
    if ratio is None:
        return "?", f">= {goal.ratio:g}{suffix}", "?"
    best = results.ratio(row.work, over, max)
    is_met = "yes" if ratio >= goal.ratio else "no"
    return f"{ratio:.2f} [{best:.2f}]{suffix}", f">= {goal.ratio:g}{suffix}", is_met


def table_line(results, row):
    goals = [goal_cells(results, row, goal) for goal in row.goals]
    cells = [row.title, figure(results.rate(row.work, "vorl")), library_cell(results, row),
             yardstick_cell(results, row)]
    cells += ["; ".join(column) for column in zip(*goals)]
    return "| " + " | ".join(cells) + " |"


def notes(results):
    """What the table does not show: who is missing, what was left out, and who was wrong."""
    entered = list(results.rates) + list(results.problems)
    works = {work for work, _ in entered}
    names = {name for _, name in entered}
    unknown = sorted(works - {row.work for row in ROWS})
    lines = [f"{name}: no figures at all; is it installed?" for name in LIBRARIES
             if name not in names]
    lines += [f"{row.title}: not measured" for row in ROWS if row.work not in works]
    lines += [f"{work}: {name} does not count: {message}"
              for (work, name), message in results.problems.items()]
    lines += [f"{work}: not in the table" for work in unknown]
    return lines, not results.problems and not unknown


def report(results):
    """The lines to print, and whether all that was measured counts."""
    lines = ["| work | vorl | fastest library (others) | plain loop, ceiling | ratio [of the best] "
             "| asked | met |", "|---" * 7 + "|"]
    lines += [table_line(results, row) for row in ROWS if results.has(row.work)]
    remarks, is_sound = notes(results)
    return lines + ([""] + remarks if remarks else []), is_sound


def main(paths):
    if not paths:
        sys.exit(__doc__)
    results = Results()
    for path in paths:
        with open(path, encoding="utf-8") as file:
            results.add_run(json.load(file))
    lines, is_sound = report(results)
    print("\n".join(lines))
    return 0 if is_sound else 1


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
