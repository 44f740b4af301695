"""The page of a report."""

import json
import os
import re
import shutil
import subprocess

from figures.measuring import PALLAX, ROOT, peak_mib, processor_seconds_of


def report_figures(report, setup):
    path = setup.recording("lte")
    page = os.path.join(setup.folder, "drive.html")
    command = [PALLAX, "report", path, "-o", page]
    report.most(f"Report of {setup.packets:,} LTE packets",
                processor_seconds_of(command, 3), 3, " s")
    report.most("Peak resident size of making it", peak_mib(command), 256, " MiB", 1)
    hour = os.path.join(setup.folder, "hour.pcap")
    subprocess.run([PALLAX, "simulate", "lte", "--seconds", "3600", "-o", hour], check=True)
    subprocess.run([PALLAX, "report", hour, "-o", page], check=True)
    with open(page, encoding="utf-8") as file:
        text = file.read()
    data = sum(len(each) for each in re.findall(r'<script type="text/plain".*?</script>\n', text))
    report.most("A report's page without its data", (len(text) - data) / 1e3, 150, " kB", 1)
    report.most("Report of an hour of LTE at every tick", len(text) / 1e6, 1, " MB")
    browser_figures(report, setup.folder)


def browser_figures(report, folder):
    """A drive of a day, opened and zoomed in Chromium."""
    opens, zooms = "Report of a day with a million values, drawn", "Zooming it"
    day = os.path.join(folder, "day.pcap")
    page = os.path.join(folder, "day.html")
    subprocess.run([PALLAX, "simulate", "lte", "--seconds", "86400", "--rate", "12", "-o", day],
                   check=True)
    subprocess.run([PALLAX, "report", day, "-o", page], check=True)
    script = os.path.join(ROOT, "web", "page", "browser", "measure.mjs")
    times = None
    if shutil.which("node") is not None:
        told = subprocess.run(["node", script, page], stdout=subprocess.PIPE, text=True)
        times = json.loads(told.stdout) if told.returncode == 0 else None
    if times is None:
        for figure, goal in ((opens, "at most 2 s"), (zooms, "at most 0.3 s")):
            report.add(figure, goal, "Chromium or the packages of web/page are not installed", None)
        return
    report.most(opens, times["drawn"], 2, " s")
    report.most(zooms, times["zoomed"], 0.3, " s")
