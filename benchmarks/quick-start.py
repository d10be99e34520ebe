#!/usr/bin/env python3
"""Measures the phone interface: from the start of the process to the first frame, and its memory.

quick-start.py [VIEWER [RUNS]]: offscreen, with software rendering, on the simulated drive. Prints the least, the median
and the greatest time, and the memory (proportional and resident set) after three seconds. Fails beyond 150 ms (median)
or 90 MB (proportional: what this process adds to the machine), which are the limits on an idle machine.
"""
import os
import re
import statistics
import subprocess
import sys
import time

TIME_LIMIT_MS = 150
MEMORY_LIMIT_MB = 90


def environment():
    env = dict(os.environ)
    env.update(QT_QPA_PLATFORM="offscreen", QT_QUICK_BACKEND="software", QT_LOGGING_RULES="vespscope.quick=true")
    return env


def memory(pid):
    with open(f"/proc/{pid}/smaps_rollup", encoding="ascii") as file:
        sizes = dict(re.findall(r"^(\w+):\s+(\d+) kB", file.read(), re.M))
    return int(sizes["Pss"]) / 1024, int(sizes["Rss"]) / 1024


def run(viewer, rest):
    """Milliseconds to the first frame, then (Pss, Rss) in MB after `rest` seconds."""
    begin = time.monotonic()
    with subprocess.Popen([viewer, "--ui", "quick", "--manager", "embedded:scenario"], env=environment(),
                          stdin=subprocess.DEVNULL, stdout=subprocess.DEVNULL, stderr=subprocess.PIPE) as process:
        try:
            for line in process.stderr:
                if b"first frame" in line:
                    break
            else:
                sys.exit(f"{viewer}: ended without a frame")
            taken = (time.monotonic() - begin) * 1000
            # Further log output must not block it.
            os.set_blocking(process.stderr.fileno(), False)
            end = time.monotonic() + rest
            while time.monotonic() < end:
                process.stderr.read()
                time.sleep(0.05)
            sizes = memory(process.pid)
        finally:
            process.terminate()
            process.stderr.close()
            process.wait()
    return taken, sizes


def main():
    viewer = sys.argv[1] if len(sys.argv) > 1 else "build/release/bin/vespscope"
    runs = int(sys.argv[2]) if len(sys.argv) > 2 else 15
    run(viewer, 0)  # warms the disk's cache
    times = sorted(run(viewer, 0)[0] for _ in range(runs))
    pss, rss = run(viewer, 3)[1]
    middle = statistics.median(times)
    print(f"first frame: {times[0]:.0f} / {middle:.0f} / {times[-1]:.0f} ms (least / middle / greatest of {runs})")
    print(f"memory after 3 s: {pss:.0f} MB proportional, {rss:.0f} MB resident")
    return 0 if middle <= TIME_LIMIT_MS and pss <= MEMORY_LIMIT_MB else 1


sys.exit(main())
