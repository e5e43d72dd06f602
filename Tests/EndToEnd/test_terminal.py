"""The terminal screens in a real terminal: tmux shows what a person would see."""

import os
import shlex
import subprocess
import unittest

from harness import BIN, Place, capture, record, serving_cell, sim_files


class Terminal(Place):
    def setUp(self):
        super().setUp()
        self.socket = self.path("tmux")
        self.addCleanup(self.tmux, "kill-server")

    def tmux(self, *arguments):
        return subprocess.run(["tmux", "-S", self.socket, "-f", "/dev/null", *arguments], text=True,
                              capture_output=True, env={**self.environment, "TERM": "xterm-256color",
                                                        "LANG": "C.UTF-8", "LC_ALL": "C.UTF-8"})

    def open(self, *arguments, width=80, height=24):
        """Starts a shell in a terminal and the program from it, so that what it leaves behind can be seen."""
        self.tmux("new-session", "-d", "-x", str(width), "-y", str(height), "sh")
        program = shlex.join([os.path.join(BIN, "spectrel"), *arguments])
        self.keys(f"PS1='prompt% '; clear; {program}; echo status $?", "Enter")

    def keys(self, *keys):
        self.tmux("send-keys", *keys)

    def screen(self):
        return self.tmux("capture-pane", "-p").stdout

    def see(self, *texts):
        """Waits until the screen shows all the texts."""
        def shows():
            screen = self.screen()
            return all(text in screen for text in texts)
        self.wait_until(shows, f"the screen never showed {texts}:\n{self.screen()}")
        return self.screen()

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
        screen = self.see("Connecting...", "321")
        self.assertNotIn("Updated", screen, "an old time must not pass for life")
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
        screen = self.see("SIM Info", "PDP Context Info")
        self.assertNotIn("Serving Cell Info", screen)

    def test_exception_of_a_record_gives_the_terminal_back(self):
        self.replay(serving_cell(5), record(0xFF0000, b"garbage"))
        self.open("--terminal")
        self.see("UnknownDataException", "status 134", "prompt%")
        self.keys("echo still $((40 + 2))", "Enter")
        self.see("still 42")

    def test_signals_give_the_terminal_back(self):
        for name in ("TERM", "SEGV"):
            with self.subTest(signal=name):
                self.socket = self.path(f"tmux-{name}")
                self.addCleanup(self.tmux, "kill-server")
                self.open("--terminal")
                self.see("Connecting...")
                subprocess.run(["pkill", f"-{name}", "-f", f"^{BIN}/spectrel --terminal"], env=self.environment)
                self.see("status", "prompt%")
                self.keys("echo still $((40 + 2))", "Enter")
                self.see("still 42")
                self.keys("exit", "Enter")

    def test_resize_draws_anew(self):
        self.replay(serving_cell(321))
        self.open("--terminal")
        self.see("Serving Cell Info", "Updated ")
        self.tmux("resize-window", "-x", "50", "-y", "12")
        self.see("Serving Cell Info", "Updated ")


if __name__ == "__main__":
    unittest.main()
