"""Starts the real programs on real message ports, each test in a temporary place of its own."""

import os
import plistlib
import select
import shutil
import signal
import struct
import subprocess
import tempfile
import time
import unittest

BIN = os.environ["SPECTREL_BIN_DIR"]
LINK_TYPES = {"ifx": 147, "gsm": 148, "cdma": 149, "lte": 150, "utran": 151}
with open(os.path.join(BIN, "Resources", "LTE.plist"), "rb") as _template:
    LTE_SECTIONS = list(plistlib.load(_template))  # in the order of the screen
WAIT = 60  # seconds until a test gives up on something that is bound to come


def record(code, payload=b"", wrap=False):
    """One log message: header and payload; a code from 0xFF0000 on is of the extra stream."""
    kind = 0xFF if code >= 0xFF0000 else 0x01
    body = bytes([kind]) + struct.pack("<HH", 12 + len(payload), code & 0xFFFF) + bytes(8) + payload
    return (b"\x81\x00" if wrap else b"") + body


def serving_cell(identity=1, channel=1300):
    """A 0xB0C2 record of the shortest accepted length."""
    payload = struct.pack("<xHHHBBIHI", identity, channel, channel + 18000, 50, 50, 257, 7, 3)
    return record(0xB0C2, payload.ljust(25, b"\0"))


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
        self.folder = tempfile.mkdtemp(prefix="spectrel-test-")
        self.addCleanup(shutil.rmtree, self.folder, ignore_errors=True)
        self.processes = []
        self.gathered = {}  # what a process has printed beyond the lines asked for
        self.addCleanup(self.end_processes)
        self.environment = {
            **{key: value for key, value in os.environ.items() if not key.startswith(("SPECTREL_PORT", "XDG_"))},
            "HOME": self.folder,
            "SPECTREL_PORT_DIR": self.path("ports"),
            "SPECTREL_CRASH_LOG_DIR": self.path("crash"),
            "SPECTREL_DEVICE_ROOT": self.path("device"),
            "XDG_CONFIG_HOME": self.path("config"),
            "XDG_STATE_HOME": self.path("state"),
        }
        for name in ("DISPLAY", "WAYLAND_DISPLAY", "DBUS_SESSION_BUS_ADDRESS"):
            self.environment.pop(name, None)

    def path(self, *parts):
        return os.path.join(self.folder, *parts)

    def write(self, name, data):
        with open(self.path(name), "wb") as file:
            file.write(data)
        return self.path(name)

    def run_spectrel(self, *arguments, program="spectrel", **options):
        """Runs a program to its end: the completed process, its output as text."""
        return subprocess.run([os.path.join(BIN, program), *arguments], env=self.environment, text=True,
                              stdin=subprocess.DEVNULL, capture_output=True, timeout=WAIT, **options)

    def start(self, program, *arguments, **options):
        process = subprocess.Popen([os.path.join(BIN, program), *arguments], env=self.environment, text=True,
                                   stdin=subprocess.DEVNULL, **options)
        self.processes.append(process)
        return process

    def start_service(self, *arguments):
        """Starts the telephony service and returns once it serves its port."""
        read_end, write_end = os.pipe()
        log = open(self.path(f"service-{len(self.processes)}.log"), "w")
        self.addCleanup(log.close)
        process = self.start("spectrel-telephonyd", *arguments, "--ready-fd", str(write_end), pass_fds=[write_end],
                             stderr=log)
        os.close(write_end)
        self.addCleanup(os.close, read_end)
        readable, _, _ = select.select([read_end], [], [], WAIT)
        self.assertTrue(readable and os.read(read_end, 1), "the service did not get ready")
        return process

    def start_watch(self, *arguments):
        return self.start("spectrel", "watch", *arguments, stdout=subprocess.PIPE, stderr=subprocess.PIPE)

    def next_line(self, process):
        """The next line of a process's standard output."""
        gathered = self.gathered.setdefault(process, b"")
        while b"\n" not in gathered:
            readable, _, _ = select.select([process.stdout], [], [], WAIT)
            data = os.read(process.stdout.fileno(), 65536) if readable else b""
            self.assertTrue(data, "no further line came")
            gathered += data
        line, _, self.gathered[process] = gathered.partition(b"\n")
        return line.decode() + "\n"

    def last_line(self, process):
        """The last line of a process that has been told to end; empty when no further one came."""
        lines = (self.gathered.get(process, b"").decode() + process.stdout.read()).splitlines()
        return lines[-1] if lines else ""

    def wait_until(self, condition, what):
        end = time.monotonic() + WAIT
        while not condition():
            self.assertLess(time.monotonic(), end, what)
            time.sleep(0.05)

    def end_processes(self):
        for process in self.processes:
            if process.poll() is None:
                process.send_signal(signal.SIGKILL)
            process.wait()
            for stream in (process.stdout, process.stderr):
                if stream:
                    stream.close()
