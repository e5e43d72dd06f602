"""Starts the real programs on real message ports, each test in a temporary place of its own."""

import json
import os
import plistlib
import resource
import select
import shutil
import struct
import subprocess
import tempfile
import time
import unittest

BIN = os.path.abspath(os.environ["SPECTREL_BIN_DIR"])
LINK_TYPES = {"ifx": 147, "gsm": 148, "cdma": 149, "lte": 150, "utran": 151}
with open(os.path.join(BIN, "Resources", "LTE.plist"), "rb") as _template:
    LTE_SECTIONS = list(plistlib.load(_template))  # in the order of the screen
WAIT = 120  # seconds until a test gives up on something that is bound to come
LONGEST_FOLDER = 18  # of the temporary folders, so that a socket's path in them is not too long for the system
resource.setrlimit(resource.RLIMIT_CORE, (0, 0))  # programs that are made to crash leave nothing in this folder


def record(code, payload=b"", wrap=False):
    """One log message: header and payload; a code from 0xFF0000 on is of the extra stream."""
    kind = 0xFF if code >= 0xFF0000 else 0x01
    body = bytes([kind]) + struct.pack("<HH", 12 + len(payload), code & 0xFFFF) + bytes(8) + payload
    return (b"\x81\x00" if wrap else b"") + body


def serving_cell(identity=1, channel=1300):
    """A 0xB0C2 record of the shortest accepted length."""
    payload = struct.pack("<xHHHBBIHI", identity, channel, channel + 18000, 50, 50, 257, 7, 3)
    return record(0xB0C2, payload.ljust(25, b"\0"))


def shows_cell(identity):
    """Whether a display shows this cell."""
    return lambda display: display.get("Serving Cell Info", {}).get("Physical Cell ID") == str(identity)


def sim_files(**files):
    return record(0xFF0000, plistlib.dumps({"kSimFile_" + key: value for key, value in files.items()}))


def cell_information(**keys):
    cell = {
        "kRKCellMonitorCellRadioAccessTechnology": "kRKCellMonitorRadioAccessTechnologyLTE",
        "kRKCellMonitorCellType": "kRKCellMonitorCellTypeServing",
    }
    cell.update({"kRKCellMonitor" + key: value for key, value in keys.items()})
    return record(0xFF0001, plistlib.dumps([cell]))


def capture(messages, technology="lte", start=1_700_000_000.0, step=1.0):
    """The bytes of a capture file, one packet a message; a message may be a pair (time, bytes)."""
    out = struct.pack("<IHHiIII", 0xA1B2C3D4, 2, 4, 0, 0, 262144, LINK_TYPES[technology])
    for number, message in enumerate(messages):
        moment, body = message if isinstance(message, tuple) else (start + number * step, message)
        micros = round(moment * 1_000_000)
        out += struct.pack("<IIII", micros // 1_000_000, micros % 1_000_000, len(body), len(body)) + body
    return out


class Place(unittest.TestCase):
    """A test with a temporary folder, an environment that points into it, and processes that end with it."""

    def setUp(self):
        folder = tempfile.gettempdir()
        self.folder = tempfile.mkdtemp(prefix="spectrel-test-", dir=folder if len(folder) <= LONGEST_FOLDER else "/tmp")
        self.addCleanup(shutil.rmtree, self.folder, ignore_errors=True)
        self.processes = []
        self.gathered = {}  # what a process has printed beyond the lines asked for
        self.addCleanup(self.end_processes)
        # Nothing of the user's own: neither places nor language, time zone, terminal, display or bus.
        self.environment = {
            **{key: value for key, value in os.environ.items()
               if key in ("PATH", "LD_LIBRARY_PATH") or key.endswith("SAN_OPTIONS")},
            "HOME": self.folder,
            "TMPDIR": self.folder,
            "LC_ALL": "C.UTF-8",
            "TZ": "UTC",
            "SPECTREL_PORT_DIR": self.path("ports"),
            "SPECTREL_CRASH_LOG_DIR": self.path("crash"),
            "SPECTREL_DEVICE_ROOT": self.path("device"),
            "XDG_CONFIG_HOME": self.path("config"),
            "XDG_STATE_HOME": self.path("state"),
        }

    def path(self, *parts):
        return os.path.join(self.folder, *parts)

    def write(self, name, data):
        with open(self.path(name), "wb") as file:
            file.write(data)
        return self.path(name)

    def run_spectrel(self, *arguments, program="spectrel", **options):
        """Runs a program to its end: the completed process, its output as text."""
        return subprocess.run([os.path.join(BIN, program), *arguments], env=self.environment, encoding="utf-8",
                              stdin=subprocess.DEVNULL, capture_output=True, timeout=WAIT, **options)

    def run_background(self, command, **options):
        """A process that ends with the test."""
        options = {"stdin": subprocess.DEVNULL, "encoding": "utf-8", "env": self.environment, **options}
        process = subprocess.Popen(command, **options)
        self.processes.append(process)
        return process

    def start(self, program, *arguments, **options):
        return self.run_background([os.path.join(BIN, program), *arguments], **options)

    def start_service(self, *arguments, **options):
        """Starts the telephony service and returns once it serves its port."""
        read_end, write_end = os.pipe()
        self.service_log = self.path(f"service-{len(self.processes)}.log")
        with open(self.service_log, "w") as log:
            process = self.start("spectrel-telephonyd", *arguments, "--ready-fd", str(write_end), pass_fds=[write_end],
                                 stderr=log, **options)
        os.close(write_end)
        with os.fdopen(read_end, "rb") as ready:
            self.await_data(ready, lambda: f"the service did not get ready: {self.told()}")
        return process

    def start_bus(self, *options):
        """A message bus; returns once it serves the path "bus"."""
        with open(self.path("bus.log"), "a") as log:
            bus = self.run_background(["dbus-daemon", "--nofork", "--nopidfile", "--print-address", *options],
                                      stdout=subprocess.PIPE, stderr=log)
        self.next_line(bus)
        return bus

    def told(self):
        """What the telephony service started last has said."""
        with open(self.service_log) as log:
            return log.read()

    def wait_told(self, text, count=1):
        self.wait_until(lambda: self.told().count(text) >= count, lambda: f"'{text}' was not told, but: {self.told()}")

    def start_watch(self, *arguments):
        return self.start("spectrel", "watch", *arguments, stdout=subprocess.PIPE, stderr=subprocess.PIPE)

    def await_data(self, stream, what):
        """What a stream has to give next, at least a byte of it."""
        readable, _, _ = select.select([stream], [], [], WAIT)
        data = os.read(stream.fileno(), 65536) if readable else b""
        self.assertTrue(data, what() if callable(what) else what)
        return data

    def next_line(self, process, stream="stdout"):
        """The next line that a process prints."""
        source = getattr(process, stream)
        gathered = self.gathered.get(source, b"")
        while b"\n" not in gathered:
            gathered += self.await_data(source, "no further line came")
        line, _, self.gathered[source] = gathered.partition(b"\n")
        return line.decode() + "\n"

    def wait_for_line(self, process, text, stream="stderr"):
        """The next line that a process prints with this text."""
        while text not in (line := self.next_line(process, stream)):
            pass
        return line

    def rest(self, process):
        """The lines beyond those asked for of a process that has been told to end."""
        return (self.gathered.pop(process.stdout, b"").decode() + process.stdout.read()).splitlines()

    def watch_until(self, watching, condition):
        """Reads the refreshes of a watch; the first display that fulfils the condition."""
        end = time.monotonic() + WAIT
        while not condition(display := json.loads(self.next_line(watching))):
            self.assertLess(time.monotonic(), end, f"the last display was {display}")
        return display

    def wait_until(self, condition, what):
        end = time.monotonic() + WAIT
        while not condition():
            if time.monotonic() > end:
                self.fail(what() if callable(what) else what)
            time.sleep(0.02)

    def end_processes(self):
        for process in self.processes:
            if process.poll() is None:
                process.kill()
            process.wait()
            for stream in (process.stdin, process.stdout, process.stderr):
                if stream:
                    stream.close()
