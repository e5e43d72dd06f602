"""The terminal screens in a real terminal: tmux shows what a person would see."""

import os
import plistlib
import shlex
import signal
import subprocess
import unittest

from harness import BIN, Place, capture, record, serving_cell, sim_files


class TerminalPlace(Place):
    """A test with a terminal of its own."""

    def setUp(self):
        super().setUp()
        self.terminals = 0
        self.socket = self.path("tmux")
        self.addCleanup(self.end_terminal, self.socket)

    def end_terminal(self, socket):
        """Ends the terminal and waits for the programs in it, which write a last time when it hangs up."""
        self.socket = socket
        shell = self.shell()
        programs = [shell, *self.children(shell)] if shell else []
        self.tmux("kill-server")
        self.wait_until(lambda: not any(map(self.children, programs)) and not any(map(self.lives, programs)),
                        "the terminal's programs did not end")

    @staticmethod
    def lives(process):
        try:
            with open(f"/proc/{process}/stat") as stat:
                return stat.read().rpartition(") ")[2][0] != "Z"
        except OSError:
            return False

    @staticmethod
    def children(process):
        try:
            with open(f"/proc/{process}/task/{process}/children") as children:
                return children.read().split()
        except OSError:
            return []

    def tmux(self, *arguments):
        return subprocess.run(["tmux", "-S", self.socket, "-f", "/dev/null", *arguments], encoding="utf-8",
                              capture_output=True,
                              env={**self.environment, "TERM": "xterm-256color", "SHELL": "/bin/sh"})

    def shell(self):
        return self.tmux("display-message", "-p", "#{pane_pid}").stdout.strip()

    def open(self, *arguments, width=80, height=24, before="true"):
        """Starts a shell in a terminal and the program from it, so that what it leaves behind can be seen."""
        self.tmux("new-session", "-d", "-x", str(width), "-y", str(height), "exec sh", ";",
                  "set-option", "-s", "set-clipboard", "on")
        program = shlex.join([os.path.join(BIN, "spectrel"), *arguments])
        self.keys(f"PS1='prompt% '; {before}; clear; {program}; echo status $?", "Enter")

    def open_anew(self, *arguments):
        """The same in a terminal of its own, for tests that start the program more than once."""
        self.terminals += 1
        self.socket = self.path(f"tmux-{self.terminals}")
        self.addCleanup(self.end_terminal, self.socket)
        self.open(*arguments)

    def program(self):
        """The process number of the program that the shell in the terminal runs."""
        return int(self.children(self.shell())[0])

    def keys(self, *keys):
        self.tmux("send-keys", *keys)

    def screen(self):
        return self.tmux("capture-pane", "-p").stdout

    def see(self, *texts, without=()):
        """Waits until the screen shows all the texts and none of the others."""
        screen = ""

        def shows():
            nonlocal screen
            screen = self.screen()
            return all(text in screen for text in texts) and not any(text in screen for text in without)
        self.wait_until(shows, lambda: f"the screen never showed {texts} without {without}:\n{screen}")
        return screen

    def buffer(self):
        """What was copied last."""
        return self.tmux("show-buffer").stdout


class Terminal(TerminalPlace):
    def replay(self, *messages, technology="lte", **options):
        file = self.write(f"{len(self.processes)}.pcap", capture(messages, technology=technology, **options))
        return self.start_service("--replay", file, "--speed", "0")

    def test_browsing_down_and_back(self):
        self.replay(serving_cell(321), sim_files(ICCID="890011"))
        self.open("--terminal")
        screen = self.see("Serving Cell Info", "SIM Info", "PDP Context Info", "Updated ")
        self.assertIn("Spectrel", screen.splitlines()[0])
        self.keys("Enter")
        self.see("Physical Cell ID", "321", "10 MHz")
        self.keys("Left")
        self.see("SIM Info", "PDP Context Info")
        self.keys("End", "Enter")
        self.see("EF-ICCID", "890011")
        self.keys("BSpace")
        self.see("Serving Cell Info")
        self.keys("q")
        self.see("status 0", "prompt%")

    def test_without_a_service_it_says_so_and_why(self):
        self.open("--terminal")
        self.see("Connecting...", "RKServerConnection")
        self.keys("q")
        self.see("status 0")

    def test_open_pane_outlives_the_service(self):
        service = self.replay(serving_cell(321))
        self.open("--terminal")
        self.see("Serving Cell Info", "Updated ")
        self.keys("Enter")
        self.see("321")
        service.kill()
        service.wait()
        self.see("Connecting...", "321", without=["Updated"])  # an old time must not pass for life
        self.replay(serving_cell(322))
        self.see("322", "Updated ")

    def test_pane_that_vanishes_with_its_technology_is_closed(self):
        service = self.replay(serving_cell(321))
        self.open("--terminal")
        self.see("Serving Cell Info", "Updated ")
        self.keys("Enter")
        self.see("321")
        service.kill()
        service.wait()
        self.replay(sim_files(ICCID="77"), technology="gsm")
        self.see("SIM Info", "PDP Context Info", without=["Serving Cell Info"])

    def test_exception_of_a_record_gives_the_terminal_back(self):
        self.replay(serving_cell(5), record(0xFF0000, b"garbage"))
        self.open("--terminal")
        self.see("UnknownDataException", "status 134", "prompt%")
        self.keys("echo still $((40 + 2))", "Enter")
        self.see("still 42")

    def test_signals_give_the_terminal_back(self):
        for number in (signal.SIGTERM, signal.SIGSEGV):
            with self.subTest(signal=number.name):
                self.open_anew("--terminal")
                self.see("Connecting...")
                os.kill(self.program(), number)
                self.see("status", "prompt%")
                self.keys("echo still $((40 + 2))", "Enter")
                self.see("still 42")

    def start_bus(self):
        """A message bus of the test's own, and a file that gathers the notices on it."""
        address = self.environment["DBUS_SESSION_BUS_ADDRESS"] = "unix:path=" + self.path("bus")
        super().start_bus("--session", "--address", address)
        with open(self.path("notices"), "w") as notices:
            self.run_background(
                ["dbus-monitor", "--address", address, "type='signal',interface='org.spectrel.Preferences'"],
                stdout=notices, stderr=subprocess.STDOUT)
        # It hears of its own coming first: from then on it listens.
        self.wait_until(lambda: self.notices(), "nobody listens on the bus")

    def notices(self):
        with open(self.path("notices")) as file:
            return file.read()

    def test_every_wish_to_end_writes_the_preference_with_its_notice(self):
        self.start_bus()
        preference = self.path("config", "spectrel", "org.spectrel.HomeScreen.conf")
        ways = [number.name for number in (signal.SIGINT, signal.SIGTERM, signal.SIGHUP)] + ["q"]
        for count, way in enumerate(ways, start=1):
            with self.subTest(way=way):
                self.open_anew("--terminal")
                self.see("Connecting...")
                self.assertFalse(os.path.exists(preference), "it is written at the end only")
                if way == "q":
                    self.keys("q")
                else:
                    os.kill(self.program(), signal.Signals[way])
                self.see("status 0", "prompt%")
                with open(preference) as file:
                    self.assertEqual(file.read(), "[General]\nTHShowGSMRSSI=false\n")
                os.remove(preference)
                self.wait_until(lambda: self.notices().count('string "THShowGSMRSSI"') == count,
                                f"no notice came: {self.notices()}")
                self.assertIn("member=Changed", self.notices())

    def allow_saving(self):
        os.makedirs(self.path("device", "VexelInternal/Library/PreferenceBundles/Carrier Settings.bundle"))

    def saved(self):
        return sorted(os.listdir(self.path("crash"))) if os.path.exists(self.path("crash")) else []

    def test_snapshot_is_saved_with_its_description(self):
        self.allow_saving()
        self.replay(serving_cell(321))
        self.open("--terminal")
        self.see("Serving Cell Info", "Updated ", "[Save]")
        self.keys("s")
        self.see("Save Snapshot", "Snapshot (", "DLF binary")
        self.keys("in car park", *["Left"] * 8, "the ", "Enter")
        self.see("Description: in the car park")
        self.keys("Enter")
        self.see("Serving Cell Info")
        self.wait_until(self.saved, "nothing was saved")
        path = self.path("crash", self.saved()[0])
        self.assertRegex(path, r"/SpectrelSnapshot-\d+\.spectrel$")
        self.assertEqual(os.stat(path).st_mode & 0o777, 0o600)
        with open(path, "rb") as file:
            snapshot = plistlib.load(file)
        self.assertEqual(list(snapshot), ["Timestamp", "Data", "Description"])
        self.assertEqual(snapshot["Description"], "in the car park")
        self.assertEqual(snapshot["Data"][0]["Display"]["Serving Cell Info"]["Physical Cell ID"], "321")

    def test_save_without_room_alerts_and_leaves_older_snapshots(self):
        self.allow_saving()
        self.replay(serving_cell(321))
        os.makedirs(self.path("crash"))
        older = self.write("crash/SpectrelSnapshot-1.spectrel", b"older")
        self.open("--terminal", before="ulimit -f 2")  # no file may have more than 1024 bytes
        self.see("Serving Cell Info", "Updated ", "[Save]")
        self.keys("s")
        self.see("Save Snapshot")
        self.keys("Enter", "Enter")
        self.see("File Error", "Unable to write file to disk", "[Close]")
        self.keys("Enter")
        self.see("Serving Cell Info", "Updated ")
        self.assertEqual(self.saved(), [os.path.basename(older)])
        with open(older, "rb") as file:
            self.assertEqual(file.read(), b"older")
        self.keys("q")
        self.see("status 0")

    def test_resize_draws_anew(self):
        self.replay(serving_cell(321))
        self.open("--terminal")
        self.see("Serving Cell Info", "Updated ")
        self.tmux("resize-window", "-x", "50", "-y", "12")
        self.see("Serving Cell Info", "Updated ")


if __name__ == "__main__":
    unittest.main()
