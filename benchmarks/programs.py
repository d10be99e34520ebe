"""The programs as users run them: decoding compared with other programs, converting a log, starting, and memory.

Used by run.py. Times are processor seconds (user and system) of the whole process, which a busy machine changes
little; the runs of a comparison alternate.
"""
import json
import os
import pathlib
import pty
import re
import resource
import select
import statistics
import struct
import subprocess
import sys
import tempfile
import time

ROOT = pathlib.Path(__file__).resolve().parent.parent
# The system's programs, not those of this Python's environment.
ENVIRONMENT = {**os.environ, "PATH": "/usr/bin:/bin", "LC_ALL": "C.UTF-8"}


def processor_seconds(command, **options):
    before = resource.getrusage(resource.RUSAGE_CHILDREN)
    subprocess.run(command, check=True, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL, env=ENVIRONMENT,
                   **options)
    after = resource.getrusage(resource.RUSAGE_CHILDREN)
    return after.ru_utime - before.ru_utime + after.ru_stime - before.ru_stime


def make_capture(binaries, folder, seconds):
    capture = folder / "drive.pcap"
    subprocess.run([binaries / "vespctl", "convert", "scenario:seed=1", capture, "--seconds", str(seconds)], check=True)
    return capture


def packets_of(capture):
    data = capture.read_bytes()
    position, count = 24, 0
    while position < len(data):
        position += 16 + int.from_bytes(data[position + 8:position + 12], "little")
        count += 1
    return count


def decode(binaries, repetitions, table):
    """vespctl decode compared with TShark and a Python loop, in packets per processor second."""
    with tempfile.TemporaryDirectory() as name:
        folder = pathlib.Path(name)
        long, short = make_capture(binaries, folder, 36000), folder / "short.pcap"
        long.rename(folder / "long.pcap")
        long = folder / "long.pcap"
        make_capture(binaries, folder, 900).rename(short)
        empty = make_capture(binaries, folder, 0)
        tshark = [ROOT / "integrations/wireshark/run", "tshark", "-V", "-r"]
        loop = ["/usr/bin/python3", ROOT / "benchmarks/peers/python-loop.py", folder]
        subprocess.run(["protoc", f"-I{ROOT}/src/messages/schema", f"-I{ROOT}/src/capture",
                        f"--descriptor_set_out={folder}/schema", f"{ROOT}/src/capture/capture.proto",
                        *ROOT.glob("src/messages/schema/*.proto")], check=True)
        ways = {"vespctl decode": ([binaries / "vespctl", "decode"], long), "tshark -V": (tshark, short),
                "Python, to JSON": ([*loop, "json"], short), "Python, parsing alone": ([*loop, "parse"], short)}
        costs = {way: [] for way in ways}
        counts = {long: packets_of(long), short: packets_of(short), empty: packets_of(empty)}
        for _ in range(repetitions):
            for way, (command, capture) in ways.items():
                start = processor_seconds([*command, empty])
                whole = processor_seconds([*command, capture])
                costs[way].append((whole - start) / (counts[capture] - counts[empty]))
    rates = {way: 1 / statistics.median(values) for way, values in costs.items()}
    ours = rates["vespctl decode"]
    for way, bar in (("tshark -V", 5), ("Python, to JSON", 3), ("Python, parsing alone", None)):
        value = ours / rates[way]
        table.add(f"vespctl decode / {way}, packets/s without start-up",
                  f"{value:.1f} ({ours:,.0f} / {rates[way]:,.0f})", "" if bar is None else f">= {bar}",
                  None if bar is None else value >= bar)


def convert(binaries, repetitions, table, logs):
    """vespctl convert diag: on the given logs one after the other, repeated up to 200 MB."""
    if not logs:
        table.add("vespctl convert diag:", "no modem logs (--logs FILE, or VESPSCOPE_CAPTURES)", ">= 100 MB/s", None)
        return
    with tempfile.TemporaryDirectory() as name:
        folder = pathlib.Path(name)
        whole = folder / "whole.mi2log"
        pieces = b"".join(log.read_bytes() for log in logs)
        with whole.open("wb") as file:
            while file.tell() < 200_000_000:
                file.write(pieces)
        size = whole.stat().st_size / 1e6
        times = [processor_seconds([binaries / "vespctl", "convert", f"diag:{whole}", folder / "out.pcap"])
                 for _ in range(min(repetitions, 5))]
        rate = size / statistics.median(times)
        table.add("vespctl convert diag:, MB of log for each processor second", f"{rate:.0f}", ">= 100", rate >= 100)


def start(binaries, repetitions, table):
    """From the start of the process to the first drawn screen in a terminal."""
    times = []
    for _ in range(max(repetitions, 11)):
        begin = time.monotonic()
        child, terminal = pty.fork()
        if child == 0:
            os.environ["TERM"] = "xterm-256color"
            os.execv(binaries / "vespscope", ["vespscope", "--ui", "terminal", "--manager", "embedded:scenario"])
        seen = b""
        while b"Device Info" not in seen or b"GSM" not in seen:
            if not select.select([terminal], [], [], 10)[0]:
                sys.exit("vespscope drew nothing in ten seconds")
            seen += os.read(terminal, 65536)
        times.append((time.monotonic() - begin) * 1000)
        os.kill(child, 15)
        try:
            while os.read(terminal, 65536):
                pass
        except OSError:
            pass
        os.waitpid(child, 0)
        os.close(terminal)
    middle = statistics.median(times)
    table.add("start to first drawn screen, terminal, ms (least/middle/greatest)",
              f"{min(times):.0f} / {middle:.0f} / {max(times):.0f}", "< 50", middle < 50)


def bus(binaries, rate, seconds, table):
    """Manager to viewer without its interface."""
    run = subprocess.run([binaries / "bench_bus", str(rate), str(seconds)], stdout=subprocess.PIPE, check=True)
    result = json.loads(run.stdout)
    viewer, alone = result["viewer"], result["bus"]
    lost = result["sent"] - viewer["events"]
    table.add(f"bus: {rate:,} events/s for {seconds} s, lost", f"{lost:,} of {result['sent']:,}", "0", lost == 0)
    table.add("  processor us for each event, manager + viewer", f"{viewer['sender_us']:.1f} + "
              f"{viewer['receiver_us']:.1f}", "", None)
    table.add("  the bus alone", f"{alone['sender_us']:.1f} + {alone['receiver_us']:.1f}", "", None)
    slow = rate <= 1000
    met = viewer["median_ms"] < 0.3 and viewer["p99_ms"] < 1
    table.add("  delivered to stored, ms at the median and 99th percentile",
              f"{viewer['median_ms']:.3f}, {viewer['p99_ms']:.3f}", "< 0.3, < 1" if slow else "", met if slow else None)
    table.add("  the bus alone", f"{alone['median_ms']:.3f}, {alone['p99_ms']:.3f}", "", None)


def sizes(process):
    text = pathlib.Path(f"/proc/{process}/smaps_rollup").read_text(encoding="ascii")
    found = dict(re.findall(r"^(\w+):\s+(\d+) kB", text, re.M))
    return int(found["Pss"]) / 1024, int(found["Rss"]) / 1024


MEMORY_MARKS = (0.1, 0.2, 0.5, 1)


def every_event(folder):
    """A folder of resources whose configuration selects every event of every metric."""
    usual = (ROOT / "resources/ice_test_lte.deviceconfig").read_text(encoding="utf-8")
    metrics = re.findall(r"^(K_\w+) =", usual, re.M)
    (folder / "ice_test_lte.deviceconfig").write_text(
        "[metrics]\n" + "".join(f'{metric} = {{ on = "event" }}\n' for metric in metrics), encoding="utf-8")
    return folder


def closer(capture, factor):
    """Divides the time between the packets of a capture with nanoseconds by a factor."""
    data = bytearray(capture.read_bytes())
    if struct.unpack_from("<I", data)[0] != 0xA1B23C4D:
        raise ValueError(f"{capture} is no capture with nanoseconds")
    position, first = 24, None
    while position < len(data):
        seconds, nanoseconds, length = struct.unpack_from("<III", data, position)
        moment = seconds * 10**9 + nanoseconds
        first = moment if first is None else first
        struct.pack_into("<II", data, position, *divmod(first + (moment - first) // factor, 10**9))
        position += 16 + length
    capture.write_bytes(data)


class Manager:
    """A manager that replays ten hours of a drive in a loop, at a given number of events a second, as a context."""

    def __init__(self, binaries, folder, rate):
        capture = folder / "drive.pcap"
        if not capture.exists():
            make_capture(binaries, folder, 36000)
            closer(capture, 10)  # the highest speed of a replay is 10,000
        self.socket = folder / "socket"
        self.address = f"unix:path={self.socket}"
        self.said = folder / "rhoxd.txt"
        with self.said.open("w", encoding="utf-8") as errors:
            speed = rate * 3600 / packets_of(capture)
            self.started = subprocess.Popen([binaries / "rhoxd", "--state", "none", "--listen", self.address,
                                             "--source", f"replay:{capture},speed={speed:.2f},loop"], stderr=errors,
                                            stdout=subprocess.DEVNULL)
        self.process = self.started.pid

    def __enter__(self):
        while not self.socket.exists():
            if self.started.poll() is not None:
                raise RuntimeError(self.said.read_text(encoding="utf-8").strip())
            time.sleep(0.01)
        return self

    def __exit__(self, *_):
        self.started.kill()
        self.started.wait()
        self.socket.unlink(missing_ok=True)


def processor_time(process):
    """The processor seconds of the process so far."""
    fields = pathlib.Path(f"/proc/{process}/stat").read_text(encoding="utf-8").rpartition(")")[2].split()
    return (int(fields[11]) + int(fields[12])) / os.sysconf("SC_CLK_TCK")


class Viewer:
    """A viewer without its interface, whose events are counted by its printed lines, or one in a tmux window."""

    def __init__(self, binaries, interface, address, folder):
        environment = {**os.environ, "VESPSCOPE_RESOURCES": str(folder)}
        command = [str(binaries / "vespscope"), "--ui", interface, "--manager", address]
        self.counter = self.tmux = None
        if interface == "terminal":
            self.tmux = ["tmux", "-S", str(folder / "tmux")]
            subprocess.run([*self.tmux, "-f", "/dev/null", "new-session", "-d", "-x", "80", "-y", "24", "env",
                            f"VESPSCOPE_RESOURCES={folder}", *command], check=True)
            found = subprocess.run([*self.tmux, "list-panes", "-F", "#{pane_pid}"], stdout=subprocess.PIPE, check=True)
            self.process = int(found.stdout)
            # Opens the largest screen of measurements, so that something is drawn.
            time.sleep(1)
            subprocess.run([*self.tmux, "send-keys", "Enter", "Down", "Enter"], check=True)
        else:
            started = subprocess.Popen(command, env=environment, stdin=subprocess.DEVNULL, stdout=subprocess.PIPE,
                                       stderr=subprocess.DEVNULL)
            self.counter = subprocess.Popen(["grep", "-c", "^Metric ID in Hex"], stdin=started.stdout,
                                            stdout=subprocess.PIPE, env={**environment, "LC_ALL": "C"})
            started.stdout.close()
            self.started, self.process = started, started.pid

    def end(self):
        """Ends the viewer; returns the number of events, if they were counted."""
        if self.tmux:
            subprocess.run([*self.tmux, "kill-server"], check=True)
            return None
        self.started.terminate()
        self.started.wait()
        return int(self.counter.communicate()[0])


def client(binaries, address):
    """What the manager reports about its viewer."""
    told = subprocess.run([binaries / "vespctl", "status", "--manager", address], stdout=subprocess.PIPE, check=True)
    return next(each for each in json.loads(told.stdout)["clients"] if each.get("name") == "vespscope")


def follow(binaries, rate, seconds, table):
    """The programs themselves, with the lines of each event written to a pipe: how many events of a replay are lost."""
    with tempfile.TemporaryDirectory() as name:
        folder = every_event(pathlib.Path(name))
        # Slightly more than the bar, because a replay that was delayed does not catch up.
        with Manager(binaries, folder, rate * 1.01) as manager:
            viewer = Viewer(binaries, "none", manager.address, folder)
            time.sleep(1)
            begin, told = time.monotonic(), client(binaries, manager.address)
            used = {each: processor_time(each) for each in (manager.process, viewer.process)}
            first = told["delivered"]
            while time.monotonic() - begin < seconds:
                time.sleep(1)
                told = client(binaries, manager.address)
            events = told["delivered"] - first
            passed = time.monotonic() - begin
            used = {each: (processor_time(each) - before) * 1e6 / events for each, before in used.items()}
            counted = viewer.end()
    met = told["lost"] == 0 and events / passed >= rate
    table.add(f"rhoxd to vespscope --ui none, {rate:,} events/s for {seconds} s, lost since it connected",
              f"{told['lost']:,} of {told['delivered']:,} at {events / passed:,.0f}/s", "0", met)
    table.add("  lines counted", f"{counted:,}", "", None)
    table.add("  processor us for each event, rhoxd + vespscope",
              f"{used[manager.process]:.1f} + {used[viewer.process]:.1f}", "", None)


def memory(binaries, events, rate, table):
    """The viewer's memory as the number of events grows, at a rate that it follows, from a separate manager."""
    with tempfile.TemporaryDirectory() as name:
        folder = every_event(pathlib.Path(name))
        for interface, bar in (("none", 12), ("terminal", 16)):
            with Manager(binaries, folder, rate) as manager:
                viewer = Viewer(binaries, interface, manager.address, folder)
                found, told = [], {"delivered": 0, "lost": 0}
                while len(found) < len(MEMORY_MARKS):
                    time.sleep(0.5)
                    told = client(binaries, manager.address)
                    if told["delivered"] >= MEMORY_MARKS[len(found)] * events:
                        found.append((told["delivered"], *sizes(viewer.process)))
                counted = viewer.end()
            each = ", ".join(f"{pss:.1f} ({rss:.1f}) at {delivered / 1e6:.1f}" for delivered, pss, rss in found)
            seen = "" if counted is None else f", {counted:,} of about {told['delivered']:,} counted"
            table.add(f"memory, --ui {interface}, MB proportional (resident) at millions of events", each,
                      f"<= {bar}, flat", found[-1][1] <= bar and found[-1][1] < found[0][1] + 0.5)
            table.add(f"  at {rate:,} events/s, lost", f"{told['lost']:,}{seen}", "0", told["lost"] == 0)
