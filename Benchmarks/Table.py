"""The table of ./bench: proves the answers, measures in processor time, compares with targets and an earlier run."""

import argparse
import gzip
import json
import os
import subprocess
import sys
import tempfile
import time
from pathlib import Path

TOP = Path(__file__).resolve().parent.parent
RELEASE = TOP / "build" / "release"
SPECTREL = str(RELEASE / "bin" / "spectrel")
SERVICE = str(RELEASE / "bin" / "spectrel-telephonyd")
RUNS = 5  # of which the best counts
SLOWER = 1.10  # by so much is said to be slower


class Row:
    """One figure: what it is, its target, and its ratio to a yardstick with a target of its own."""

    def __init__(self, name, figure, unit, target=None, ratio=None, ratio_target=None, yardstick="", at_most=False):
        self.name, self.figure, self.unit, self.target = name, figure, unit, target
        self.ratio, self.ratio_target, self.yardstick, self.at_most = ratio, ratio_target, yardstick, at_most

    def meets(self):
        figure = self.target is None or (self.figure <= self.target if self.at_most else self.figure >= self.target)
        return figure and (self.ratio_target is None or self.ratio <= self.ratio_target)

    def cost(self):
        """Greater is slower; the ratio where there is one, for it holds on a noisy machine, too."""
        if self.ratio is not None:
            return self.ratio
        return self.figure if self.at_most else 1 / self.figure

    def line(self):
        sign = "<=" if self.at_most else ">="
        target = "" if self.target is None else f"{sign} {self.target:g}"
        ratio = "" if self.ratio is None else f"{self.ratio:.2f} x {self.yardstick}"
        ratio_target = "" if self.ratio_target is None else f"<= {self.ratio_target:g}"
        return (f"{self.name:<44} {self.figure:>12.4g} {self.unit:<11} {target:<10} {ratio:<24} {ratio_target:<9} "
                f"{'met' if self.meets() else 'NOT MET'}")


def fail(line):
    sys.exit(f"bench: {line}")


def run_timed(command, stdout=subprocess.DEVNULL):
    """Processor seconds and wall seconds that a command took."""
    start = time.monotonic()
    process = subprocess.Popen(command, stdout=stdout, stderr=subprocess.DEVNULL)
    _, status, usage = os.wait4(process.pid, 0)
    process.returncode = os.waitstatus_to_exitcode(status)
    if process.returncode != 0:
        fail(f"{' '.join(command)}: exit status {process.returncode}")
    return usage.ru_utime + usage.ru_stime, time.monotonic() - start


def most_memory(command):
    """The most memory that a command had resident, in MiB, as the kernel said shortly before its end."""
    process = subprocess.Popen(command, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
    most = 0
    while process.poll() is None:
        try:
            if os.readlink(f"/proc/{process.pid}/exe") == SPECTREL:
                most = max([most] + [int(line.split()[1]) / 1024
                                     for line in Path(f"/proc/{process.pid}/status").read_text().splitlines()
                                     if line.startswith("VmHWM:")])
        except OSError:
            pass  # it has just ended
        time.sleep(0.001)
    return most


def best(measure):
    return min(measure() for _ in range(RUNS))


def prove_golden_answers():
    proven = 0
    for golden in sorted((TOP / "Tests" / "Golden").glob("*.pcap")):
        for form, suffix in (("json", ".json"), ("tree", ".tree"), ("changes", ".changes")):
            wanted = golden.with_suffix(suffix)
            packed = wanted.with_name(wanted.name + ".gz")
            text = wanted.read_bytes() if wanted.exists() else gzip.decompress(packed.read_bytes())
            done = subprocess.run([SPECTREL, "decode", "--format", form, str(golden)], capture_output=True)
            if done.stdout != text:
                fail(f"{golden.name}: wrong answer in the form {form}")
            proven += 1
    print(f"{proven} answers proven against the golden recordings")


def counters(program, pattern):
    """The counters of a benchmark's measurements by name."""
    done = subprocess.run([str(RELEASE / "benchmarks" / program), f"--benchmark_filter={pattern}",
                           "--benchmark_format=json"], capture_output=True, text=True)
    if done.returncode != 0 or not done.stdout:
        fail(f"{program}: {done.stderr.strip()[-200:]}")
    measured = {}
    for each in json.loads(done.stdout)["benchmarks"]:
        if each.get("error_occurred"):
            fail(f"{program}: {each['name']}: {each.get('error_message')}")
        measured[each["name"].split("/iterations")[0]] = each
    return measured


def property_list_rows():
    lists = counters("property_list_benchmark", "ReadXML")
    for name, title, target, ratio in (("ReadXML", "XML property list to new values", 500, None),
                                       ("ReadXMLOverEarlier", "XML property list over the one before", 500, 5)):
        yield Row(title, lists[name]["MB/s"], "MB/s", target, lists[name]["x_bare_scan"], ratio, "bare scan")
    yield Row("allocations a list over the one before", lists["ReadXMLOverEarlier"]["allocations"], "", 1, at_most=True)


def decoding_rows():
    drives = counters("recording_benchmark", "^Drive/")
    for technology, target, ratio in (("lte", 1.5e6, 7), ("gsm", 1.5e6, 7), ("utran", 1.5e6, 7), ("cdma", 3e6, None),
                                      ("ifx", 120e3, None)):
        drive = drives[f"Drive/{technology}"]
        yield Row(f"decode a simulated drive, {technology}", drive["records/s"], "messages/s", target,
                  drive["x_bare_read"], ratio, "bare read")
    cells = counters("decode_benchmark", "DecodeServingCells|RebuildDisplay")
    yield Row("decode binary records alone", cells["DecodeServingCells"]["records/s"], "messages/s", 6e6,
              cells["DecodeServingCells"]["x_bare_read"], 3, "bare read")
    yield Row("the same, beyond the read", cells["DecodeServingCells"]["records/s"], "messages/s", None,
              cells["DecodeServingCells"]["x_to_chars"], None, "to_chars")
    yield Row("rebuild the display", cells["RebuildDisplay"]["cpu_time"], "us", 8, at_most=True)


def live_rows():
    delivery = counters("delivery_benchmark", "DeliverMessages")["DeliverMessages"]
    yield Row("deliver messages", delivery["messages/s"], "messages/s", None, delivery["x_raw_sockets"], 1.15,
              "raw sockets")


def seconds_to_write(data, path):
    start = time.process_time()
    with open(path, "wb", buffering=0) as file:
        for place in range(0, len(data), 64 * 1024):
            file.write(data[place:place + 64 * 1024])
    return time.process_time() - start


def output_rows(drive, folder):
    """With the decoding, and without it (what the same drive takes with --format none)."""
    nothing = best(lambda: run_timed([SPECTREL, "decode", "--format", "none", drive])[0])
    for name, options in (("changes", ["changes"]), ("csv", ["csv"]), ("json --each", ["json", "--each"])):
        out = folder / "out"

        def measure():
            with open(out, "wb") as file:
                return run_timed([SPECTREL, "decode", "--format", *options, drive], stdout=file)[0]

        seconds = best(measure)
        data = out.read_bytes()
        writing = best(lambda: seconds_to_write(data, folder / "copy"))
        yield Row(f"--format {name}, with its decoding", len(data) / seconds / 1e6, "MB/s", 200, seconds / writing, None,
                  "write")
        yield Row(f"--format {name}, beyond decoding", len(data) / max(seconds - nothing, 1e-3) / 1e6, "MB/s")


def length_rows(drive):
    decode = [SPECTREL, "decode", "--format", "none"]
    one = best(lambda: run_timed([*decode, drive])[0])
    day = best(lambda: run_timed([*decode, *[drive] * 12])[0])
    memory, day_memory = most_memory([*decode, drive]), most_memory([*decode, *[drive] * 12])
    yield Row("a day of LTE, 730,000 messages", day, "s", 0.6, at_most=True)
    yield Row("seconds a message, a day to two hours", day / (12 * one), "times", 1.1, at_most=True)
    yield Row("resident while decoding", memory, "MiB", 10, at_most=True)
    yield Row("resident, a day to two hours", day_memory / memory, "times", 1.05, at_most=True)


def separate_rows(drive):
    def measure(jobs):
        command = [SPECTREL, "decode", "--separate", "--jobs", jobs, "--format", "none", *[drive] * 32]
        times = [run_timed(command) for _ in range(3)]
        return min(processor for processor, _ in times), min(wall for _, wall in times)

    (one, one_wall), (two, two_wall) = measure("1"), measure("2")
    yield Row("32 files: --jobs 2 to --jobs 1, wall clock", one_wall / two_wall, "times", 1.8)
    yield Row("32 files: --jobs 2 to --jobs 1, processor", two / one, "times", 1.1, at_most=True)


def all_rows():
    with tempfile.TemporaryDirectory() as name:
        folder = Path(name)
        drive = str(folder / "drive.pcap")
        subprocess.run([SERVICE, "--simulate", "lte", "--scene", "drive", "--seed", "1", "--duration", "2h", "--write",
                        drive], check=True, stderr=subprocess.DEVNULL)
        yield from property_list_rows()
        yield from decoding_rows()
        yield from output_rows(drive, folder)
        yield from length_rows(drive)
        yield from separate_rows(drive)
        yield from live_rows()


def compare(rows, earlier):
    slower = 0
    for row in rows:
        before = earlier.get(row.name)
        if before and row.cost() > before["cost"] * SLOWER:
            print(f"slower: {row.name}: {row.cost() / before['cost']:.2f} times what it was")
            slower += 1
    print(f"{slower} of {len(rows)} figures got slower by more than {round((SLOWER - 1) * 100)} %")


def main():
    parser = argparse.ArgumentParser(prog="bench")
    parser.add_argument("--json", default=str(TOP / "build" / "bench.json"))
    parser.add_argument("--against")
    arguments = parser.parse_args()
    earlier = json.loads(Path(arguments.against).read_text()) if arguments.against else None
    prove_golden_answers()
    busy = os.getloadavg()[0]
    if busy > os.cpu_count() / 2:
        print(f"the machine is busy (load {busy:.1f}): wall clock means little now, processor time and ratios hold")
    rows = []
    for row in all_rows():
        print(row.line(), flush=True)
        rows.append(row)
    Path(arguments.json).write_text(json.dumps({row.name: {**vars(row), "cost": row.cost()} for row in rows}, indent=1))
    print(f"{sum(row.meets() for row in rows)} of {len(rows)} within their targets; figures in {arguments.json}")
    if earlier:
        compare(rows, earlier)


if __name__ == "__main__":
    main()
