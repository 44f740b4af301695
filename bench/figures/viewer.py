"""The viewer in a terminal, and what it costs."""

import math
import os
import pty
import random
import subprocess
import time

from figures.measuring import PALLAX, RATE, memory_mib, peak_mib, processor_ticks, seconds_of


class Viewer:
    """`pallax` in a terminal of 80 by 24."""

    def __init__(self, *arguments):
        self.start = time.perf_counter()
        self.process, self.terminal = pty.fork()
        if self.process == 0:
            os.environ.update({"TERM": "xterm-256color", "LINES": "24", "COLUMNS": "80"})
            os.execv(PALLAX, [PALLAX, *arguments])
        os.set_blocking(self.terminal, False)
        self.shown = b""

    def read(self):
        try:
            self.shown += os.read(self.terminal, 1 << 16)
        except (BlockingIOError, OSError):
            time.sleep(0.0002)

    def seconds_to(self, text):
        while text not in self.shown:
            self.read()
            if time.perf_counter() - self.start > 10:
                raise SystemExit("the viewer shows nothing")
        return time.perf_counter() - self.start

    def share_of_a_core(self, seconds):
        before, since = processor_ticks(self.process), time.perf_counter()
        while time.perf_counter() - since < seconds:
            self.read()
        ticks = processor_ticks(self.process) - before
        return ticks / os.sysconf("SC_CLK_TCK") / (time.perf_counter() - since)

    def rest(self, seconds=0.15):
        """Reads until nothing has come for a while; the time at which the last of it came."""
        last = time.perf_counter()
        while time.perf_counter() - last < seconds:
            length = len(self.shown)
            self.read()
            if len(self.shown) != length:
                last = time.perf_counter()
        self.shown = self.shown[-4096:]
        return last

    def slow_answer_to(self, *keys):
        """Milliseconds until all is drawn that a key changes: the 99th percentile."""
        taken = []
        for key in keys:
            self.rest()
            length, start = len(self.shown), time.perf_counter()
            os.write(self.terminal, key)
            while len(self.shown) == length:
                self.read()
                if time.perf_counter() - start > 10:
                    raise SystemExit(f"nothing answers {key}")
            taken.append((self.rest() - start) * 1e3)
        return sorted(taken)[len(taken) * 99 // 100]

    def resident_mib_at_rest(self):
        """Once the stream has ended: the processor time stands still for a second."""
        before, since = -1, time.perf_counter()
        while time.perf_counter() - since < 1.0:
            self.read()
            self.shown = self.shown[-4096:]
            if processor_ticks(self.process) != before:
                before, since = processor_ticks(self.process), time.perf_counter()
        return memory_mib(self.process, "VmRSS")

    def quit(self):
        os.write(self.terminal, b"q")
        deadline = time.perf_counter() + 10
        while os.waitpid(self.process, os.WNOHANG) == (0, 0):
            self.read()
            if time.perf_counter() > deadline:
                raise SystemExit("the viewer does not quit")
        os.close(self.terminal)


def viewer_after(seconds):
    viewer = Viewer("demo", "lte", "--rate", str(RATE), "--seconds", str(seconds), "--speed", "max")
    viewer.seconds_to(b"Serving")
    resident = viewer.resident_mib_at_rest()
    viewer.quit()
    return resident


def seconds_until_shown(path, text, rounds):
    least = math.inf
    for _ in range(rounds):
        viewer = Viewer(path)
        least = min(least, viewer.seconds_to(text))
        viewer.quit()
    return least


def watching_figure(report, _setup):
    """A live modem, with its levels and their curves on the screen."""
    viewer = Viewer("demo", "lte", "--rate", str(RATE))
    viewer.seconds_to(b"Serving")
    os.write(viewer.terminal, b"o")
    viewer.share_of_a_core(4)  # the first curves
    report.most("Viewer of a live LTE modem, with the overview and its curves",
                viewer.share_of_a_core(30) * 100, 1, " % of a core")
    os.write(viewer.terminal, b"o")
    viewer.rest()
    viewer.quit()


def start_figures(report, setup):
    ten = os.path.join(setup.folder, "ten.pcap")
    subprocess.run([PALLAX, "simulate", "lte", "--seconds", "1", "--rate", "10", "-o", ten],
                   check=True)
    report.most("`pallax --version`", seconds_of([PALLAX, "--version"], 30) * 1e3, 5, " ms")
    report.most("`decode` of ten packets", seconds_of([PALLAX, "decode", ten], 30) * 1e3, 10, " ms")
    report.most("First pane of `pallax RECORDING`", seconds_until_shown(ten, b"Pallax", 5) * 1e3,
                100, " ms", 0)


def memory_figures(report, setup):
    for count in sorted({setup.packets, setup.largest}):
        report.most(f"Peak resident size of `decode`, {count} LTE packets",
                    peak_mib([PALLAX, "decode", setup.recording("lte", count)]), 24, " MiB", 1)
    minute, hour = viewer_after(60), viewer_after(3600)
    # It keeps the index of an hour's packets, to go back in time: about 55 bytes for each.
    report.most(f"Viewer after an hour, compared with {minute:.1f} MiB after a minute",
                hour - minute, 10, " MiB more", 1)


def large_recording_figures(report, setup):
    path = setup.recording("lte", setup.largest)
    report.most(f"First pane of a recording of {setup.largest:,} packets",
                seconds_until_shown(path, b"Pallax", setup.rounds), 1, " s")
    tick = 2  # seconds of the recording, which plays as it was made
    report.most("Its first values, in addition to the two seconds of the first tick",
                seconds_until_shown(path, b"Serving", setup.rounds) - tick, 1, " s")
    report.most("Peak resident size of a query on it",
                peak_mib([PALLAX, "sql", path, "select count(*) from packet"]), 128, " MiB", 1)


def key_figures(report, setup):
    viewer = Viewer(setup.recording("lte"))
    viewer.seconds_to(b"Serving")
    os.write(viewer.terminal, b" ")
    viewer.resident_mib_at_rest()  # indexed whole
    random.seed(1)
    first = 22 * 60 + 14  # minutes since midnight: the first whole one of the recording
    minutes = [first + random.randrange(setup.packets // RATE // 60) for _ in range(100)]
    jumps = [f":{minute // 60 % 24:02}:{minute % 60:02}:00\r".encode() for minute in minutes]
    report.most(f"Viewer, {setup.packets:,} LTE packets: a key that moves, 99th percentile",
                viewer.slow_answer_to(*[b"\x1b[B", b"\x1b[A"] * 100), 16, " ms", 1)
    report.most("Viewer: a jump to any time, 99th percentile", viewer.slow_answer_to(*jumps), 50,
                " ms", 1)
    report.most("Viewer: a tick back or forward, 99th percentile",
                viewer.slow_answer_to(*[b","] * 100, *[b"."] * 100), 16, " ms", 1)
    viewer.quit()
