"""Simulated and scripted modems, services, and live sessions."""

import math
import os
import re
import subprocess

from figures.measuring import NAMES, PALLAX, RATE, ROOT, bench, google, peak_mib, seconds_of


def live_figure(report, setup):
    """A day of the live modem, as fast as it can be simulated and received."""
    day = 24 * 3600
    folders = {"XDG_RUNTIME_DIR": os.path.join(setup.folder, "run"),
               "XDG_STATE_HOME": os.path.join(setup.folder, "state")}
    for each in folders.values():
        os.makedirs(each, mode=0o700)
    os.environ.update(folders)
    service = subprocess.Popen([PALLAX, "service", "--simulate", "lte", "--rate", str(RATE),
                                "--seconds", str(day), "--speed", "max"])
    query = [PALLAX, "sql", "--live", "--format", "csv", "select count(*) from packet"]
    answer = os.path.join(setup.folder, "answer")
    with open(answer, "wb") as output:
        peak = peak_mib(query, output)
    service.terminate()
    service.wait()
    with open(answer, encoding="ascii") as lines:
        if int(lines.read().split()[-1]) != day * RATE:
            raise SystemExit("the live session is not whole")
    report.most(f"Peak resident size of a live session of {day * RATE:,} LTE packets", peak, 128,
                " MiB", 1)


def modem_figures(report, _setup):
    hour = google("simulator_bench", "writeHour")
    report.most("An hour of simulated LTE written", hour["writeHour"] / 1e3, 2, " s")
    cpu = re.search(r"([0-9.]+) ?%", bench("service_bench", "5"))
    report.most("`pallax service`, 2,000 packets a second to two clients", float(cpu[1]), 10,
                " % of a core", 1)


def watched_modem_figure(report, _setup):
    """A scripted modem that moves every second, through ModemManager, to one recorder."""
    seconds = 20
    steps = f"""
        export XDG_RUNTIME_DIR=$WORLD/run
        mkdir -m 700 "$WORLD/run"
        {PALLAX} service --modem & service=$!
        sleep 1
        {PALLAX} record - >"$WORLD/recorded" 2>"$WORLD/told" & recorder=$!
        while :; do
            for cell in "84CD 00D30156" "84CE 00D30201"; do
                echo "cell $cell" >"$WORLD/a.control"
                sleep 1
            done
        done & mover=$!
        sleep 1
        ticks() {{ cut -d " " -f 14,15 /proc/$service/stat; }}
        before=$(ticks)
        sleep {seconds}
        echo $before $(ticks)
        kill $mover $recorder $service
        wait"""
    world = os.path.join(ROOT, "tests", "sources", "modem", "world", "at-world")
    told = subprocess.run([world, "--", "bash", "-c", steps], check=True, stdout=subprocess.PIPE,
                          text=True).stdout.split()
    ticks = int(told[2]) + int(told[3]) - int(told[0]) - int(told[1])
    report.most("`pallax service --modem`, a modem that changes every second",
                100 * ticks / os.sysconf("SC_CLK_TCK") / seconds, 0.5, " % of a core")


def simulate_figures(report, setup):
    for technology, name in NAMES.items():
        goal = 0.5 if technology == "ifx" else 1  # its messages are whole pictures
        seconds = math.inf
        for number in range(setup.rounds):
            # A new file, because replacing one of a gigabyte takes time. Wall-clock time, because
            # one thread builds the setup.packets while another writes them.
            out = os.path.join(setup.folder, f"simulated-{number}.pcap")
            seconds = min(seconds, seconds_of([PALLAX, "simulate", technology, "--seconds",
                                               str(setup.packets // RATE), "--rate", str(RATE),
                                               "-o", out], 1))
            os.remove(out)
        report.least(f"{name}: `simulate` into a file", setup.packets / seconds / 1e6, goal,
                     " M setup.packets/s", 2)
