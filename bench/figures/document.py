"""The table of the figures, and docs/performance.md."""

import math
import os
import platform
import re
import subprocess

from figures.measuring import ROOT

DOCUMENT = os.path.join(ROOT, "docs", "performance.md")
HEAD = "| group | figure | goal | measured | met |\n|---|---|---|---|---|\n"
GROWTH = "\n## How the cost grows\n\n"
BY_HAND = "\n<!-- by hand -->\n"


class Report:
    """The rows of the table; one is printed as soon as it is known."""

    def __init__(self):
        self.group = ""  # of the rows that are added
        self.rows = []
        self.tables = []  # how the cost grows

    def add(self, figure, goal, measured, met):
        words = {True: "yes", False: "NO", None: "-"}[met]
        self.rows.append((self.group, figure, goal, measured, words))
        print("| " + " | ".join(self.rows[-1]) + " |", flush=True)

    def most(self, figure, value, limit, unit="", digits=2):
        self.add(figure, f"at most {limit:g}{unit}", f"{value:.{digits}f}{unit}", value <= limit)

    def least(self, figure, value, limit, unit="", digits=0):
        self.add(figure, f"at least {limit:g}{unit}", f"{value:.{digits}f}{unit}", value >= limit)


def growth_table(title, unit, points):
    """A Markdown table with the exponent from each row to the next."""
    lines = [f"| {title} | {unit} | exponent |", "|---:|---:|---:|"]
    before = None
    for count, cost in points:
        exponent = "" if before is None else \
            f"{math.log(cost / before[1]) / math.log(count / before[0]):.2f}"
        lines.append(f"| {count:,} | {cost:.4g} | {exponent} |")
        before = (count, cost)
    return lines


def conditions(setup):
    """What all figures of the document have in common: its text above the table."""
    with open("/proc/cpuinfo", encoding="ascii", errors="replace") as info:
        model = re.search(r"model name\s*:\s*(.+)", info.read())
    compiler = subprocess.run(["c++", "--version"], check=True, stdout=subprocess.PIPE,
                              text=True).stdout.splitlines()[0]
    return (f"# Performance\n\nMeasured and written by `bench/run` (recordings of "
            f"{setup.packets:,} packets, the best of {setup.rounds} rounds).\n\n"
            f"{model[1] if model else platform.machine()}, {os.cpu_count()} cores; {compiler}; "
            f"{platform.system()} {platform.release().split('-')[0]}.\n\n")


class Document:
    """docs/performance.md in its parts; all are empty if there is no such file."""

    def __init__(self):
        text = ""
        if os.path.exists(DOCUMENT):
            with open(DOCUMENT, encoding="utf-8") as document:
                text = document.read()
        measured, _, self.by_hand = text.partition(BY_HAND)
        self.conditions, _, measured = measured.partition(HEAD)
        table, _, self.growth = measured.partition(GROWTH)
        self.rows = [tuple(line.strip("| ").split(" | ")) for line in table.splitlines()]

    def adopt(self, report, groups, measured):
        """Replaces the rows of the groups that were measured; `groups` is the order of all."""
        rows = [row for row in self.rows if row[0] not in measured] + report.rows
        self.rows = [row for group in groups for row in rows if row[0] == group]
        self.growth = "\n".join([*report.tables, ""]) if report.tables else self.growth

    def write(self):
        table = "".join("| " + " | ".join(row) + " |\n" for row in self.rows)
        with open(DOCUMENT, "w", encoding="utf-8") as document:
            document.write(self.conditions + HEAD + table + GROWTH + self.growth + BY_HAND +
                           self.by_hand)
