"""What is measured, and how: programs of the preset "bench", recordings, times and sizes."""

import json
import math
import os
import re
import subprocess
import sys
import time
from dataclasses import dataclass

ROOT = os.path.dirname(os.path.dirname(os.path.dirname(os.path.abspath(__file__))))
BUILD = os.path.join(ROOT, "build", "bench")
PALLAX = os.path.join(BUILD, "pallax")
RATE = 50  # simulated packets a second
NAMES = {"lte": "LTE", "gsm": "GSM/UMTS", "utran": "UTRAN", "cdma": "CDMA", "ifx": "IFX"}


@dataclass
class Setup:
    """What the measurements are made with; the meaning of the numbers is that of the options."""

    folder: str  # of the recordings
    packets: int
    rounds: int
    largest: int

    def recording(self, technology, packets=None):
        """The path of a simulated one, which is made if it is not there yet."""
        packets = packets or self.packets
        path = os.path.join(self.folder, f"{technology}-{packets}.pcap")
        if not os.path.exists(path):
            subprocess.run([PALLAX, "simulate", technology, "--seconds", str(packets // RATE),
                            "--rate", str(RATE), "-o", path], check=True)
        return path


def build():
    if not os.path.exists(os.path.join(BUILD, "build.ninja")):
        subprocess.run(["cmake", "--preset", "bench"], cwd=ROOT, check=True)
    targets = ["pallax", "decode_bench", "screen_bench", "service_bench", "simulator_bench",
               "timeline_bench", "query_bench"]
    if subprocess.run(["pkg-config", "--exists", "libadwaita-1 >= 1.2"]).returncode == 0:
        targets.append("pallax-window")
    subprocess.run(["cmake", "--build", "--preset", "bench", "--target", *targets], cwd=ROOT,
                   check=True, stdout=sys.stderr)


def bench(name, *arguments):
    program = os.path.join(BUILD, "bench", name)
    return subprocess.run([program, *arguments], check=True, stdout=subprocess.PIPE,
                          text=True).stdout


def google(name, pattern):
    """Name to milliseconds of processor time, the least of several repetitions."""
    text = bench(name, "--benchmark_filter=" + pattern, "--benchmark_format=json",
                 "--benchmark_repetitions=5", "--benchmark_min_time=0.2")
    scale = {"ns": 1e-6, "us": 1e-3, "ms": 1.0, "s": 1e3}
    least = {}
    for run in json.loads(text)["benchmarks"]:
        if run["run_type"] == "iteration":
            taken = run["cpu_time"] * scale[run["time_unit"]]
            least[run["run_name"]] = min(taken, least.get(run["run_name"], math.inf))
    return least


def processor_seconds_of(command, rounds, quiet=False):
    """User and system time; disturbed less by what else runs than the time of day."""
    least = math.inf
    for _ in range(rounds):
        process = subprocess.Popen(command, stdout=subprocess.DEVNULL,
                                   stderr=subprocess.DEVNULL if quiet else None)
        _, process.returncode, usage = os.wait4(process.pid, 0)
        if process.returncode != 0:
            raise SystemExit(f"{command} has failed")
        least = min(least, usage.ru_utime + usage.ru_stime)
    return least


def seconds_of(command, rounds):
    least = math.inf
    for _ in range(rounds):
        start = time.perf_counter()
        subprocess.run(command, check=True, stdout=subprocess.DEVNULL)
        least = min(least, time.perf_counter() - start)
    return least


def processor_ticks(process):
    with open(f"/proc/{process}/stat", encoding="ascii") as stat:
        fields = stat.read().rsplit(")", 1)[1].split()
    return int(fields[11]) + int(fields[12])


def memory_mib(process, line):
    """A line of the process's status, such as VmRSS; 0 once it has ended."""
    with open(f"/proc/{process}/status", encoding="ascii") as status:
        found = re.search(line + r":\s+(\d+)", status.read())
    return int(found[1]) / 1024.0 if found else 0.0


def peak_mib(command, output=subprocess.DEVNULL):
    """As the kernel counts it for the program itself, asked until it ends."""
    process = subprocess.Popen(command, stdout=output)
    peak = 0.0
    while process.poll() is None:
        peak = max(peak, memory_mib(process.pid, "VmHWM"))
        time.sleep(0.001)
    if process.returncode != 0:
        raise SystemExit(f"{command} has failed")
    return peak

