"""The viewer in a window, on an X server without a GPU, and what it costs."""

import math
import mmap
import os
import shutil
import struct
import subprocess
import time

from figures.measuring import BUILD, RATE, memory_mib, processor_ticks

WINDOW = os.path.join(BUILD, "pallax-window")
NEEDED = ("Xvfb", "dbus-daemon", "xdotool")
SECONDS = 30  # in which processor time is counted


class Screen:
    """An X server whose pixels are in a file, and a session bus."""

    def __init__(self, folder):
        reading, writing = os.pipe()
        self.server = subprocess.Popen(
            ["Xvfb", "-displayfd", str(writing), "-screen", "0", "1280x1024x24", "-nolisten", "tcp",
             "-noreset", "-fbdir", folder], pass_fds=[writing], stderr=subprocess.DEVNULL)
        os.close(writing)
        with os.fdopen(reading, encoding="ascii") as number:
            display = ":" + number.readline().strip()
        self.bus = subprocess.Popen(["dbus-daemon", "--session", "--print-address", "--nofork"],
                                    stdout=subprocess.PIPE, stderr=subprocess.DEVNULL, text=True)
        run = os.path.join(folder, "window-run")
        os.makedirs(run, mode=0o700, exist_ok=True)
        self.environment = dict(os.environ, DISPLAY=display, GDK_BACKEND="x11",
                                GSETTINGS_BACKEND="memory", HOME=run, XDG_RUNTIME_DIR=run,
                                DBUS_SESSION_BUS_ADDRESS=self.bus.stdout.readline().strip())
        with open(os.path.join(folder, "Xvfb_screen0"), "rb") as file:
            self.memory = mmap.mmap(file.fileno(), 0, prot=mmap.PROT_READ)
        self.begin = struct.unpack(">I", self.memory[:4])[0]  # the header says how long it is

    def pixels(self):
        return self.memory[self.begin:]

    def do(self, *command):
        return subprocess.run(["xdotool", *command], env=self.environment, check=True,
                              stdout=subprocess.PIPE, text=True).stdout.split()

    def end(self):
        for process in (self.bus, self.server):
            process.terminate()
            process.wait()


class Window:
    """`pallax-window`, from its first frame on, which takes `first_frame` seconds."""

    def __init__(self, screen, *arguments):
        self.screen = screen
        before, start = screen.pixels(), time.perf_counter()
        self.process = subprocess.Popen([WINDOW, *arguments], env=screen.environment,
                                        stderr=subprocess.DEVNULL)
        while screen.pixels() == before:
            time.sleep(0.001)
            if time.perf_counter() - start > 20:
                raise SystemExit("the window shows nothing")
        self.first_frame = time.perf_counter() - start

    def number(self):
        return self.screen.do("search", "--sync", "--onlyvisible", "--name", "^Pallax$")[0]

    def share_of_a_core(self, rounds):
        """The least of several: other programs may run beside it."""
        least = math.inf
        for _ in range(rounds):
            before, since = processor_ticks(self.process.pid), time.perf_counter()
            time.sleep(SECONDS)
            ticks = processor_ticks(self.process.pid) - before
            seconds = ticks / os.sysconf("SC_CLK_TCK")
            least = min(least, seconds / (time.perf_counter() - since))
        return least

    def await_rest(self):
        """Once the stream has ended, or time is held: next to no processor time in a second."""
        ticks = math.inf
        while ticks > 1:
            before = processor_ticks(self.process.pid)
            time.sleep(1)
            ticks = processor_ticks(self.process.pid) - before

    def end(self):
        self.process.terminate()
        self.process.wait()


def first_frame(screen, rounds, *arguments):
    least = math.inf
    for _ in range(rounds):
        window = Window(screen, *arguments)
        least = min(least, window.first_frame)
        window.end()
    return least


def resident_mib_after(screen, seconds):
    window = Window(screen, "demo", "lte", "--rate", str(RATE), "--seconds", str(seconds),
                    "--speed", "max")
    window.await_rest()
    resident = memory_mib(window.process.pid, "VmRSS")
    window.end()
    return resident


def peak_mib_with(screen, path):
    """With the whole recording indexed, because time is held."""
    window = Window(screen, path)
    screen.do("key", "--window", window.number(), "space")
    window.await_rest()
    peak = memory_mib(window.process.pid, "VmHWM")
    window.end()
    return peak


def watching_figures(report, screen, rounds):
    window = Window(screen, "demo", "lte", "--rate", str(RATE))
    number = window.number()
    time.sleep(10)
    report.most("Window of a live LTE modem, with the overview", window.share_of_a_core(rounds) *
                100, 0.5, " % of a core")
    screen.do("windowunmap", number)
    time.sleep(3)
    report.most("The same window, hidden", window.share_of_a_core(rounds) * 100, 0.2,
                " % of a core")
    window.end()


def window_figures(report, setup):
    missing = [name for name in (WINDOW, *NEEDED) if shutil.which(name) is None]
    if missing:
        report.add("Window", "-", " and ".join(missing) + " are not installed", None)
        return
    screen = Screen(setup.folder)
    report.most("First frame of a window, without a GPU", first_frame(screen, 5, "demo", "lte"),
                0.5, " s")
    watching_figures(report, screen, setup.rounds)
    # The first half hour fills the toolkit's caches. As the viewer, it keeps the packets' index.
    early, late = resident_mib_after(screen, 1800), resident_mib_after(screen, 5400)
    report.most(f"Window an hour later, compared with {early:.1f} MiB after half an hour",
                late - early, 10, " MiB more", 1)
    path = setup.recording("lte", setup.largest)
    report.most(f"First frame of a window of a recording of {setup.largest:,} packets",
                first_frame(screen, setup.rounds, path), 1, " s")
    short = peak_mib_with(screen, setup.recording("lte", 10000))
    report.most(f"Its peak resident size with the whole recording indexed, compared with "
                f"{short:.1f} MiB for 10,000 packets", peak_mib_with(screen, path) - short, 128,
                " MiB more", 1)
    screen.end()
