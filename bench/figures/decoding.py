"""Reading recordings, and the screen's part of a tick."""

import os
import shutil
import struct

from figures.document import growth_table
from figures.measuring import NAMES, PALLAX, ROOT, bench, google, processor_seconds_of, seconds_of


def xml_only(path, packets):
    """The packets of an object stream that are property lists in the XML form."""
    out = path.replace("ifx", "ifx-xml")
    with open(path, "rb") as source, open(out, "wb") as target:
        target.write(source.read(24))
        while packets > 0 and len(header := source.read(16)) == 16:
            packet = source.read(struct.unpack("<IIII", header)[2])
            if packet.startswith(b"<?xml"):
                target.write(header + packet)
                packets -= 1
    return out


def decode_times(path, rounds):
    """Way to (seconds, bytes written); "recording" to (packets, bytes)."""
    lines = [line.split() for line in bench("decode_bench", path, str(rounds)).splitlines()]
    return {name: (float(first), int(second)) for name, first, second in lines}


def decode_figures(report, setup):
    limits = {"lte": 4, "gsm": 6, "utran": 8, "cdma": 8}
    limits_of_samples = {"lte": 6, "gsm": 9, "utran": 6, "cdma": 9}
    for technology, limit in limits.items():
        times = decode_times(setup.recording(technology), setup.rounds)
        name = NAMES[technology]
        end = times["end"][0]
        report.most(f"{name}: `--every end`, relative to the bare libpcap loop",
                    end / times["bare"][0], limit)
        report.most(f"{name}: all samples to a checksum, relative to the bare libpcap loop",
                    times["samples"][0] / times["bare"][0], limits_of_samples[technology])
        report.most(f"{name}: `--every tick --format csv`, relative to `--every end`",
                    times["tick-csv"][0] / end, 2)
        seconds, written = times["packet"]
        report.least(f"{name}: `--every packet` JSON", written / seconds / 1e6, 150, " MB/s")
    times = decode_times(setup.recording("ifx", setup.packets // 20), setup.rounds)
    report.most("IFX: all samples to a checksum, relative to `--every end`",
                times["samples"][0] / times["end"][0], 1.3)
    xml = xml_only(setup.recording("ifx"), setup.packets // 20)
    times = decode_times(xml, setup.rounds)
    report.least("IFX: XML property lists", times["recording"][1] / times["end"][0] / 1e6, 150,
                 " MB/s")


def tshark_figure(report, setup):
    goal = "at least 60"
    figure = "LTE: speed relative to `tshark -T fields`"
    tshark = shutil.which("tshark")
    if tshark is None:
        report.add(figure, goal, "tshark is not installed", None)
        return
    path = setup.recording("lte", min(setup.packets, 100000))
    fields = []
    for field in ["type", "code", "length", "earfcn", "pci", "rsrp", "rsrq", "rssi", "neighbour",
                  "neighbour_rsrp", "measured", "measured_rsrp"]:
        fields += ["-e", "pallax_lte." + field]
    script = os.path.join(ROOT, "bench", "pallax_lte.lua")
    slow = processor_seconds_of([tshark, "-r", path, "-X", "lua_script:" + script, "-T", "fields",
                                 *fields], 1, quiet=True)
    report.least(figure, slow / processor_seconds_of([PALLAX, "decode", path], 3), 60, digits=1)


def jobs_figure(report, setup):
    recordings = [setup.recording("gsm")] * 2
    one = seconds_of([PALLAX, "decode", "--jobs", "1", *recordings], setup.rounds)
    two = seconds_of([PALLAX, "decode", "--jobs", "2", *recordings], setup.rounds)
    report.most("Two files with `--jobs 2`, relative to `--jobs 1`", two / one, 0.55)


def screen_figures(report, _setup):
    ticks = google("screen_bench", "^tickOf")
    report.most("Tick to screen, a usual LTE tree", ticks["tickOfAUsualTree"], 1, " ms")
    for name, what in [("InSections", "in 2,500 sections"), ("InOnePane", "in one pane"),
                       ("InOneFilteredPane", "in one filtered pane")]:
        report.most(f"Tick to screen, 50,000 leaves {what}", ticks["tickOf50000Leaves" + name], 100,
                    " ms", 0)


def growth_figures(report, setup):
    decodes = []
    count = 10000
    while count <= setup.largest:
        path = setup.recording("lte", count)
        decodes.append((count, processor_seconds_of([PALLAX, "decode", path], setup.rounds)))
        count *= 10
    leaves = google("screen_bench", "^growingTick")
    ticks = sorted((int(name.split("/")[1]), taken) for name, taken in leaves.items())
    report.tables = [*growth_table("LTE packets", "seconds of `decode`", decodes), "",
                     *growth_table("leaves in one pane", "milliseconds of a tick", ticks)]
    print("\n".join(report.tables))
