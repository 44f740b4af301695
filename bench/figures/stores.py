"""Stores of measurements, in a file and on a server."""

import os
import shutil
import subprocess
import urllib.request

from figures.measuring import PALLAX, RATE, ROOT, seconds_of

DEVICES = 20
RSRP = "serving_cell_measurements.measured_rsrp"


def import_seconds(folder, store):
    """Of the sqlite3 shell, for the rows of a store's intervals."""
    rows = os.path.join(folder, "intervals.csv")
    with open(rows, "wb") as file:
        subprocess.run(["sqlite3", "-csv", store, "SELECT * FROM intervals"], check=True,
                       stdout=file)
    imported = os.path.join(folder, "imported.db")
    table = ("CREATE TABLE intervals (id INTEGER PRIMARY KEY, time INTEGER, hold INTEGER, number, "
             "text INTEGER, packet INTEGER, whole INTEGER)")
    seconds = seconds_of(["sqlite3", imported, table, ".mode csv", f".import {rows} intervals"], 1)
    os.remove(imported)
    return seconds


def store_figures(report, setup):
    """Days of devices, of which only one recording is there at a time."""
    day = 86400 * RATE
    store = os.path.join(setup.folder, "store.db")
    server = Server()
    for seed in range(1, DEVICES + 1):
        path = os.path.join(setup.folder, f"day-{seed}.pcap")
        subprocess.run([PALLAX, "simulate", "lte", "--seconds", "86400", "--rate", str(RATE),
                        "--seed", str(seed), "-o", path], check=True)
        load = [PALLAX, "store", "load", "--into", store, "--device", f"car{seed}", path]
        seconds = seconds_of(load, 1)
        if seed == 1:
            size = os.path.getsize(store) / 2**20
            decode = seconds_of([PALLAX, "decode", "--samples", path], 1)
            report.most("A day of one device into a store, relative to `decode --samples` and the "
                        "import of the same rows by `sqlite3`",
                        seconds / (decode + import_seconds(setup.folder, store)), 1.5)
            report.most(f"A day of one device in a store ({day:,} packets)", size, 20, " MiB", 1)
        if server.address:
            subprocess.run([*load[:4], server.address, *load[5:]], check=True,
                           stdout=subprocess.DEVNULL)
            if seed == 1:
                report.most(f"A day of one device in ClickHouse ({day:,} packets)",
                            server.size() / 1e6, 5, " MB", 1)
        os.remove(path)
    query = [PALLAX, "store", "query", "--store", store]
    report.most(f"One of {DEVICES} device-days by the minute",
                seconds_of([*query, "series", RSRP, "--device", "car2"], 5) * 1000, 50, " ms", 0)
    report.most(f"The worst cells of {DEVICES} device-days by one level",
                seconds_of([*query, "cells", "--level", RSRP], 3), 0.5, " s")
    hours = ("SELECT s.site, (r.first + i.time) / 3600000 AS hour, quantile(i.number * s.step, "
             "i.hold, 0.05), quantile(i.number * s.step, i.hold, 0.5) FROM fields f CROSS JOIN "
             "series s ON s.field = f.id CROSS JOIN recordings r ON r.id = s.recording CROSS JOIN "
             "intervals i ON i.id BETWEEN s.first_row AND s.last_row "
             f"WHERE f.name = 'lte.{RSRP}' GROUP BY s.site, hour")
    report.most(f"Weighted percentiles of a level by cell and hour in {DEVICES} device-days",
                seconds_of([*query, "--sql", hours], 3), 0.5, " s")
    server_figures(report, server)
    server.end()
    duckdb_figures(report, setup, store)


class Server:
    """A private server of ClickHouse with a store on it; none where it is not installed."""

    def __init__(self):
        self.address = None
        if not shutil.which("clickhouse-server", path=os.environ["PATH"] + ":/usr/sbin"):
            return
        self.process = subprocess.Popen(
            [os.path.join(ROOT, "tests", "fleet", "cluster", "servers"), "1"],
            stdin=subprocess.PIPE, stdout=subprocess.PIPE, text=True)
        port = self.process.stdout.readline().split()[2]
        self.process.stdout.readline()  # ready
        self.address = f"clickhouse://127.0.0.1:{port}/fleet"
        subprocess.run([PALLAX, "store", "setup", "--into", self.address], check=True)

    def size(self):
        """Of all tables of the store in bytes, once their parts are merged."""
        tables = self.ask("SELECT name FROM system.tables WHERE database = 'fleet' AND engine LIKE "
                          "'%MergeTree'").split()[1:]
        for table in tables:
            self.run(f"OPTIMIZE TABLE fleet.{table} FINAL")
        return int(self.ask("SELECT sum(bytes_on_disk) AS b FROM system.parts WHERE active AND "
                            "database = 'fleet'").split()[1])

    def ask(self, query):
        command = [PALLAX, "store", "query", "--store", self.address, "--format", "csv", "--sql"]
        return subprocess.run([*command, query], check=True, stdout=subprocess.PIPE,
                              text=True).stdout

    def run(self, statement):
        host = "http://" + self.address.split("/")[2]
        opener = urllib.request.build_opener(urllib.request.ProxyHandler({}))
        opener.open(host, statement.encode()).read()

    def end(self):
        if self.address:
            self.process.stdin.close()
            self.process.wait()


def server_figures(report, server):
    if not server.address:
        for name in ("A day of one device in ClickHouse", "The worst cells in ClickHouse",
                     "Weighted percentiles in ClickHouse"):
            report.add(name, "-", "clickhouse-server is not installed", None)
        return
    query = [PALLAX, "store", "query", "--store", server.address]
    report.most(f"The worst cells of {DEVICES} device-days by one level in ClickHouse",
                seconds_of([*query, "cells", "--level", RSRP], 5), 0.2, " s")
    value = ("(steps * step + rest, toUInt64(hold_minutes) * 60000 + toUInt64(hold_seconds) * 1000 "
             "+ hold_ms)")
    hours = ("SELECT cell, intDiv(day * 1440 + minute, 60) AS hour, "
             f"quantileExactWeighted(0.05){value} AS p5, quantileExactWeighted(0.5){value} AS p50 "
             f"FROM intervals_local WHERE field = 'lte.{RSRP}' AND known = 1 AND load IN (SELECT "
             "load FROM current_local) GROUP BY cell, hour")
    report.most(f"Weighted percentiles of a level by cell and hour in {DEVICES} device-days in "
                "ClickHouse", seconds_of([*query, "--sql", hours], 5), 0.2, " s")


# The rows of a store that have numbers, and the questions above to them, for DuckDB.
NUMBERS = ("SELECT r.device, f.name AS field, s.entry, s.site, r.first + i.time AS time, i.hold, "
           "CASE typeof(i.number) WHEN 'integer' THEN i.number * s.step ELSE i.number END AS "
           "number FROM fields f CROSS JOIN series s ON s.field = f.id CROSS JOIN recordings r ON "
           "r.id = s.recording CROSS JOIN intervals i ON i.id BETWEEN s.first_row AND s.last_row "
           "WHERE i.number IS NOT NULL AND i.hold > 0")
ASKED = {
    "One of {} device-days by the minute":
        "SELECT minute, entry, min(number), sum(number * part) / sum(part), max(number), sum(part) "
        "FROM (SELECT entry, number, minute, least(time + hold, (minute + 1) * 60000) - "
        "greatest(time, minute * 60000) AS part FROM (SELECT *, unnest(range(time // 60000, "
        "(time + hold - 1) // 60000 + 1)) AS minute FROM level WHERE device = 'car2')) "
        "GROUP BY minute, entry ORDER BY entry, minute",
    "The worst cells of {} device-days by one level":
        "SELECT site, sum(hold) AS hold, sum(hold) FILTER (number < -110) / sum(hold) AS below, "
        "min(number) FILTER (upto >= 0.05 * whole), min(number) FILTER (upto >= 0.5 * whole), "
        "min(number) FILTER (upto >= 0.95 * whole) FROM (SELECT *, sum(hold) OVER (PARTITION BY "
        "site ORDER BY number) AS upto, sum(hold) OVER (PARTITION BY site) AS whole FROM (SELECT "
        "site, number, sum(hold) AS hold FROM level GROUP BY site, number)) GROUP BY site "
        "ORDER BY below DESC",
    "Weighted percentiles of a level by cell and hour in {} device-days":
        "SELECT site, hour, min(number) FILTER (upto >= 0.05 * whole), min(number) FILTER "
        "(upto >= 0.5 * whole) FROM (SELECT *, sum(hold) OVER (PARTITION BY site, hour ORDER BY "
        "number) AS upto, sum(hold) OVER (PARTITION BY site, hour) AS whole FROM (SELECT site, "
        "time // 3600000 AS hour, number, sum(hold) AS hold FROM level GROUP BY site, hour, "
        "number)) GROUP BY site, hour",
}


def duckdb_figures(report, setup, store):
    """The same questions to DuckDB, over a file of Parquet with the same numbers."""
    duckdb = shutil.which("duckdb")
    rows = os.path.join(setup.folder, "numbers.parquet")
    if duckdb:
        copy = f"COPY (SELECT * FROM read_csv('/dev/stdin', header = true)) TO '{rows}'"
        csv = subprocess.Popen(["sqlite3", "-csv", "-header", store, NUMBERS],
                               stdout=subprocess.PIPE)
        subprocess.run([duckdb, "-c", copy], stdin=csv.stdout, check=True,
                       stdout=subprocess.DEVNULL)
    level = f"WITH level AS (SELECT * FROM '{rows}' WHERE field = 'lte.{RSRP}') "
    for question, query in ASKED.items():
        seconds = seconds_of([duckdb, "-c", level + query], 5) if duckdb else None
        report.add(question.format(DEVICES) + " in DuckDB", "-",
                   f"{seconds:.2f} s" if duckdb else "duckdb is not installed", None)
