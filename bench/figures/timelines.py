"""Timelines, and SQL over them."""

from figures.measuring import NAMES, bench


def timeline_times(path):
    """The figures of `timeline_bench`; of what it times only once, the least of three runs."""
    runs = []
    for arguments in ((path,), (path, "1"), (path, "1")):
        lines = bench("timeline_bench", *arguments).splitlines()
        runs.append({key: float(value) for key, value in map(str.split, lines)})
    return runs[0] | {key: min(run[key] for run in runs) for key in ("ready", "decode")}


def timeline_figures(report, setup):
    for technology, name in NAMES.items():
        # The messages of IFX are whole pictures, so fewer of them show as much.
        count = setup.packets // 5 if technology == "ifx" else setup.packets
        figures = timeline_times(setup.recording(technology, count))
        if technology == "ifx":
            report.most(f"{name}: timeline ready, relative to `--every end`",
                        figures["ready"] / figures["decode"], 1.5)
        else:
            report.most(f"{name}: timeline ready", figures["ready"], 2, " s")
        report.most(f"{name}: frames at random times, 99th percentile", figures["frame-99"] * 1e3,
                    50, " ms", 1)
        report.most(f"{name}: steps by a tick, 99th percentile", figures["step-99"] * 1e3, 16,
                    " ms", 1)
        report.most(f"{name}: 1,000 buckets of a field over the recording",
                    figures["buckets-most"] * 1e3, 50, " ms")
        report.most(f"{name}: peak resident size with a timeline", figures["peak"], 128, " MiB", 1)


def query_figures(report, setup):
    for technology in ["lte", "gsm", "utran"]:
        name = NAMES[technology]
        lines = bench("query_bench", setup.recording(technology)).splitlines()
        figures = {key: float(value) for key, value in map(str.split, lines)}
        report.most(f"{name}: SQL over all samples, relative to an ordinary table of them",
                    figures["samples"] / figures["table"], 3)
        report.most(f"{name}: SQL, `series(field, 1000)`", figures["series"] * 1e3, 50, " ms", 1)
        report.most(f"{name}: SQL, {figures['joined']:.0f} events joined with the state",
                    figures["events"], 2, " s")
