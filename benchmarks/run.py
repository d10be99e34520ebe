#!/usr/bin/env python3
"""Runs the benchmarks and prints one table: run.py BIN [--repetitions N] [PART…]

Each figure is the median of N repetitions (at least 5), whose order is shuffled within one process, so that a machine
of varying speed affects both sides of a ratio alike.

Parts: decode, event, reload, rrc, logs and programs by default; bus (two minutes), follow (one) and memory (several minutes)
only if named, best on an otherwise idle machine. The status is 1 when a bar is not met.
"""
import argparse
import json
import os
import pathlib
import platform
import re
import statistics
import subprocess
import sys
import time

import programs

LIST_LENGTHS = [1, 4, 16, 64, 256, 1024]


class Table:
    def __init__(self):
        self.rows = []

    def missed(self):
        return sum(row[-1] == "NO" for row in self.rows)

    def add(self, what, figure, bar, met):
        self.rows.append((what, figure, bar, {True: "yes", False: "NO", None: ""}[met]))

    def show(self):
        head = ("what", "measured", "bar", "met")
        widths = [max(len(row[column]) for row in [head, *self.rows]) for column in range(4)]
        for row in [head, *self.rows]:
            print("  ".join(text.ljust(width) for text, width in zip(row, widths)).rstrip())


def medians(program, repetitions):
    """Median nanoseconds by benchmark, and the context."""
    run = subprocess.run([program, f"--benchmark_repetitions={repetitions}", "--benchmark_min_time=0.05",
                          "--benchmark_enable_random_interleaving=true", "--benchmark_format=json"],
                         stdout=subprocess.PIPE, stderr=subprocess.DEVNULL, check=True)
    report = json.loads(run.stdout)
    times = {}
    for each in report["benchmarks"]:
        if each["run_type"] == "iteration":
            scale = {"ns": 1, "us": 1e3, "ms": 1e6}[each["time_unit"]]
            times.setdefault(each["run_name"], []).append(each["cpu_time"] * scale)
    return {name: statistics.median(values) for name, values in times.items()}, report["context"]


def ratio(table, what, ours, peer, bar=None):
    value = ours / peer
    table.add(what, f"{value:.2f} ({ours:.0f} / {peer:.0f} ns)", "" if bar is None else f"<= {bar}",
              None if bar is None else value <= bar)


def decode(binaries, repetitions, table):
    times, context = medians(binaries / "bench_decode", repetitions)
    print(f"corpus: {context['corpus']}")
    message, dictionary = times["ours: message"], times["ours: dictionary"]
    bars = {"protobuf: reused message": (message, 1.0), "protozero: owning dictionary": (dictionary, 0.8)}
    for name, peer in sorted(times.items(), key=lambda each: each[1]):
        if name.startswith("ours"):
            print(f"{peer:8.0f} ns  {name}")
            continue
        print(f"{peer:8.0f} ns  {name}  (our message {message / peer:.2f}, our dictionary {dictionary / peer:.2f})")
        if name in bars:
            ours, bar = bars[name]
            ratio(table, f"our {'message' if ours == message else 'dictionary'} / {name}", ours, peer, bar)
    for name in ("protozero: reused struct of views", "protozero: fresh owning struct", "protobuf: fresh message"):
        ratio(table, f"our message / {name}", message, times[name])
    for name in ("protozero: owning dictionary, static names", "protozero: arena of views"):
        ratio(table, f"our dictionary / {name}", dictionary, times[name])
    ratio(table, "mixed identifiers / one after the other", dictionary,
          times["ours: dictionary, one metric after the other"])


def event(binaries, repetitions, table):
    times, context = medians(binaries / "bench_event", repetitions)
    part = {name.removeprefix("event: "): value for name, value in times.items() if name.startswith("event: ")}
    whole, decoding = part["whole"], part["decode to dictionary"]
    ratio(table, "whole event / decode to dictionary", whole, decoding, 3.0)
    text = part["decode, text of the log line"]
    parts = {"decode to dictionary": decoding, "timestamp": part["timestamp"],
             "text of the log line": text - decoding,
             "three lines through the log": part["decode, text of the log line, three lines through the log"] - text,
             "holders and conversions": part["decode, holders and conversions"] - decoding}
    parts["the rest"] = whole - sum(parts.values())
    for name, value in parts.items():
        table.add(f"  {name}", f"{value:.0f} ns, {100 * value / whole:.0f} %", "", None)
    for way in ("decode to dictionary", "whole event"):
        whole_list = {length: times[f"list: {way}/{length}"] for length in (0, *LIST_LENGTHS)}
        # The cost of each further element; the first one includes the list itself.
        each = [(whole_list[longer] - whole_list[shorter]) / (longer - shorter)
                for shorter, longer in zip(LIST_LENGTHS, LIST_LENGTHS[1:])]
        spread = max(each) / min(each) - 1
        figures = " ".join(f"{value:.0f}" for value in each)
        table.add(f"{way}, ns per further list element ({' to '.join(map(str, LIST_LENGTHS))})",
                  f"{figures}: {100 * spread:.0f} %", "<= 20 %", spread <= 0.2)
        table.add("  the first element, with the list", f"{whole_list[1] - whole_list[0]:.0f} ns", "", None)
    once, often = int(context["heap_after_10_rounds"]), int(context["heap_after_100_rounds"])
    table.add("heap after 870,000 events - after 87,000", f"{often - once:+d} bytes", "0", often <= once)


def reload(binaries, repetitions, table):
    times, _ = medians(binaries / "bench_reload", repetitions)
    for name, value in times.items():
        table.add(name, f"{value / 1e6:.3f} ms", "< 0.5 ms", value < 0.5e6)


def rrc(binaries, repetitions, table):
    times, _ = medians(binaries / "bench_rrc", repetitions)
    for name, value in times.items():
        # A message of a modem's log; those of the tests are larger than most.
        bar = 2000 if "captured" in name else None
        table.add(name, f"{value:.0f} ns", "" if bar is None else f"<= {bar} ns", None if bar is None else value <= bar)


def run_programs(arguments, table):
    programs.decode(arguments.binaries, arguments.repetitions, table)
    programs.start(arguments.binaries, arguments.repetitions, table)


def recorded_logs():
    """The modem logs that lie beside the tree, as its tests find them."""
    folder = os.environ.get("VESPSCOPE_CAPTURES") or programs.ROOT.parent / "shared" / "captures"
    return sorted(pathlib.Path(folder).glob("*.mi2log"))


def run_bus(arguments, table):
    programs.bus(arguments.binaries, 1000, 20, table)
    programs.bus(arguments.binaries, 100_000, arguments.seconds, table)


PARTS = {
    "decode": lambda arguments, table: decode(arguments.binaries, arguments.repetitions, table),
    "event": lambda arguments, table: event(arguments.binaries, arguments.repetitions, table),
    "reload": lambda arguments, table: reload(arguments.binaries, arguments.repetitions, table),
    "rrc": lambda arguments, table: rrc(arguments.binaries, arguments.repetitions, table),
    "logs": lambda arguments, table: programs.convert(arguments.binaries, arguments.repetitions, table,
                                                      arguments.logs or recorded_logs()),
    "programs": run_programs,
    "bus": run_bus,
    "follow": lambda arguments, table: programs.follow(arguments.binaries, 100_000, arguments.seconds, table),
    "memory": lambda arguments, table: programs.memory(arguments.binaries, arguments.events, arguments.rate, table),
}
BY_DEFAULT = ["decode", "event", "reload", "rrc", "logs", "programs"]


def main():
    parser = argparse.ArgumentParser()
    parser.add_argument("binaries", type=pathlib.Path)
    parser.add_argument("parts", nargs="*", default=BY_DEFAULT)
    parser.add_argument("--repetitions", type=int, default=7)
    parser.add_argument("--logs", nargs="+", type=pathlib.Path, help="modem logs for the logs part; without, those in VESPSCOPE_CAPTURES")
    parser.add_argument("--seconds", type=int, default=60, help="of the bus part at full rate, and of the follow part")
    parser.add_argument("--events", type=int, default=10_000_000, help="of the memory part")
    parser.add_argument("--rate", type=int, default=50_000, help="of the memory part, events a second")
    arguments = parser.parse_args()
    arguments.binaries = arguments.binaries.resolve()
    arguments.repetitions = max(arguments.repetitions, 5)
    if unknown := set(arguments.parts) - set(PARTS):
        sys.exit(f"no such part: {' '.join(sorted(unknown))}; there are {' '.join(PARTS)}")
    model = re.search(r"^model name\s*: (.*)$", pathlib.Path("/proc/cpuinfo").read_text(encoding="ascii"), re.M)
    print(f"{time.strftime('%Y-%m-%d %H:%M')}, {os.cpu_count()} x {model[1] if model else platform.machine()}, "
          f"load {os.getloadavg()[0]:.1f}, {arguments.repetitions} repetitions")
    table = Table()
    for part in arguments.parts:
        PARTS[part](arguments, table)
    print()
    table.show()
    if missed := table.missed():
        sys.exit(f"bars not met: {missed}")


main()
