"""spectrel view in a real terminal: recordings on their time line, snapshots entry by entry, finding and copying."""

import os
import plistlib
import re
import unittest

from harness import capture, record, serving_cell, sim_files
from test_terminal import TerminalPlace

GOLDEN = os.path.join(os.path.dirname(__file__), "..", "Golden", "lte-drive.pcap")


class View(TerminalPlace):
    def view(self, file, *arguments, **options):
        self.open("view", "--terminal", *arguments, file, **options)

    def hour(self, count=7):
        """A recording of one serving cell every ten minutes, their identities 0, 1, ..."""
        return self.write("hour.pcap", capture([serving_cell(number) for number in range(count)], step=600.0))

    def leave(self, status=0):
        self.keys("q")
        self.see(f"status {status}", "prompt%")

    # Recordings

    def test_golden_recording_plays_to_its_end(self):
        self.view(GOLDEN)
        self.see("Serving Cell Info", "SIM Info", "paused", "message 1 of 452")
        self.keys("Enter")
        screen = self.see("Physical Cell ID")
        self.assertRegex(screen, r"Physical Cell ID +-")
        self.keys("Space")
        screen = self.see("at the end", "message 452 of 452")
        self.assertRegex(screen, r"Physical Cell ID +148\b")
        self.leave()

    def test_end_of_a_recording_shows_what_decode_prints(self):
        self.view(GOLDEN)
        self.see("message 1 of 452")
        self.keys("$")
        self.see("at the end")
        self.keys("Y")
        self.see("Copied ")
        self.wait_until(lambda: "APN: internet.test" in self.buffer(), "nothing was copied")
        with open(GOLDEN.replace(".pcap", ".tree")) as file:
            self.assertEqual(self.buffer(), file.read())
        self.leave()

    def test_steps_and_seeks_both_ways(self):
        self.view(self.hour())
        self.see("message 1 of 7", "0:00:00.000 / 1:00:00.000")
        self.keys("Enter")
        for keys, time, message, identity in (
                (".", "0:10:00.000", 2, 1), (".", "0:20:00.000", 3, 2), (",", "0:10:00.000", 2, 1),
                ("]", "0:10:02.000", 2, 1), ("[", "0:10:00.000", 2, 1), (">", "0:10:10.000", 2, 1),
                ("5", "0:30:00.000", 4, 3), ("<", "0:29:50.000", 3, 2), ("$", "1:00:00.000", 7, 6),
                ("0", "0:00:00.000", 1, 0)):
            with self.subTest(keys=keys):
                self.keys(keys)
                self.see(f"{time} /", f"message {message} of 7")
                self.wait_until(lambda: re.search(rf"Physical Cell ID +{identity}\b", self.screen()),
                                "the tree did not follow")
        self.leave()

    def test_plays_and_pauses(self):
        self.view(self.hour())
        self.see("paused", "0:00:00.000")
        self.keys("+", "Space")
        self.see("playing 2x")
        self.wait_until(lambda: "0:00:00.000" not in self.screen(), "the time stood still")
        self.keys("Space")
        self.see("paused 2x")
        self.leave()

    def test_status_tells_the_recordings_own_time(self):
        self.view(self.hour())
        self.see("Updated 2023-11-14 at 22:13:20")
        self.keys("$")
        self.see("Updated 2023-11-14 at 23:13:20")
        self.leave()

    def test_message_that_would_end_the_program_pauses_and_is_told(self):
        file = self.write("bad.pcap", capture([serving_cell(5), record(0xFF0000, b"garbage"), serving_cell(6)]))
        self.view(file, width=140)
        self.see("message 1 of 3")
        self.keys("Space")
        self.see("message 2 of 3", "paused", "would have ended the program", "UnknownDataException")
        self.keys("Space")
        self.see("message 3 of 3", "at the end")
        self.keys("q")
        screen = self.see("status 0", "prompt%")
        self.assertIn("bad.pcap: message 1 (code 0xFF0000) would have ended the program", screen)

    def test_damaged_recording_is_browsed_up_to_the_damage(self):
        file = self.write("cut.pcap", capture([serving_cell(5), serving_cell(6), serving_cell(7)])[:-9])
        self.view(file)
        self.see("message 1 of 2")
        self.keys("$")
        self.see("at the end", "truncated")
        self.keys("q")
        self.see("cut.pcap: message 2 at byte", "status 1")

    def test_nothing_is_written_and_no_port_is_opened(self):
        os.makedirs(self.path("device", "VexelInternal/Library/PreferenceBundles/Carrier Settings.bundle"))
        self.view(self.hour())
        self.assertNotIn("[Save]", self.see("message 1 of 7"))
        self.keys("s")
        self.leave()
        for name in ("ports", "crash", "config"):
            self.assertFalse(os.path.exists(self.path(name)), name)

    def test_resize_draws_anew(self):
        self.view(self.hour())
        self.see("message 1 of 7")
        self.tmux("resize-window", "-x", "50", "-y", "10")
        self.see("Serving Cell Info", "0:00:00.000 / 1:00:00.000")
        self.leave()

    # Snapshots

    def snapshot(self):
        messages = [(1_700_000_000.0 + 3 * number, serving_cell(number)) for number in range(3)]
        done = self.run_spectrel("decode", "--format", "none", "--snapshot", self.path("crash"),
                                 self.write("a.pcap", capture(messages)))
        self.assertEqual(done.returncode, 0, done.stderr)
        return self.path("crash", os.listdir(self.path("crash"))[0])

    def test_snapshot_lists_its_entries_newest_first_and_opens_them(self):
        self.view(self.snapshot())
        screen = self.see("Snapshot (2023-11-14 22:13:26 +0000)")
        rows = re.findall(r"Snapshot \(2023-11-14 22:13:(\d\d) \+0000\)", screen)
        self.assertEqual(rows, ["26", "24", "22"])
        self.assertRegex(screen, r"DLF binary .* binary log, \d+ bytes")
        self.assertIn("Timestamp", screen)
        self.keys("Enter")
        self.see("Serving Cell Info", "SIM Info")
        self.keys("Enter")
        self.assertRegex(self.see("Physical Cell ID"), r"Physical Cell ID +2\b")
        self.leave()

    def test_description_of_a_snapshot_is_shown(self):
        path = self.snapshot()
        with open(path, "rb") as file:
            snapshot = plistlib.load(file)
        snapshot["Description"] = "in the car park"
        self.view(self.write("b", plistlib.dumps(snapshot)))
        self.assertRegex(self.see("Description"), r"Description +in the car park")
        self.leave()

    # Other files

    def test_files_of_other_kinds_are_one_message_and_status_1(self):
        wrong = {
            self.path("missing"): "No such file or directory",
            self.folder: "Is a directory",
            self.write("empty", b""): "the file is empty",
            self.write("text", b"~~~~ no recording"): "neither a capture nor a snapshot nor a DLF file",
            self.write("list", plistlib.dumps({"a": "b"})): "no snapshot",
            self.write("broken", b"<?xml version='1.0'?><plist>"): "does not parse",
            self.write("none.pcap", capture([])): "holds no message",
            self.write("a.dlf", serving_cell()[1:]): "--technology",
        }
        for file, reason in wrong.items():
            with self.subTest(file=file):
                done = self.run_spectrel("view", file)
                self.assertEqual((done.returncode, done.stdout), (1, ""))
                self.assertEqual(len(done.stderr.splitlines()), 1, done.stderr)
                self.assertIn(file + ": ", done.stderr)
                self.assertIn(reason, done.stderr)

    def test_without_a_terminal_it_says_so(self):
        done = self.run_spectrel("view", self.hour())
        self.assertEqual(done.returncode, 1)
        self.assertIn("neither a terminal nor a display", done.stderr)

    def test_dlf_plays_with_its_technology_named(self):
        self.view(self.write("a.dlf", serving_cell(1)[1:] + serving_cell(2)[1:]), "--technology", "lte")
        self.see("message 1 of 2", "00:00.000 / 00:00.100")
        self.keys(".")
        self.see("message 2 of 2")
        self.leave()

    # Finding, copying, help

    def test_find_opens_the_pane_of_a_row(self):
        self.view(GOLDEN)
        self.see("message 1 of 452")
        self.keys("$")
        self.see("at the end")
        self.keys("/")
        self.see("Find:", "Esc leaves")
        self.keys("ims")
        self.see("1 found", "ims.test", "/PDP Context Info/1")
        self.keys("Enter")
        screen = self.see("APN", "ims.test", "message 452")
        self.assertIn("/PDP Context Info/1", screen.splitlines()[0])
        self.leave()

    def test_value_is_copied_through_tmux(self):
        self.view(self.hour())
        self.see("message 1 of 7")
        self.keys("5", "Enter")
        self.see("Physical Cell ID", "message 4 of 7")
        self.keys("y")
        self.see("Copied the value of Physical Cell ID")
        self.wait_until(lambda: self.buffer() == "3", "the value was not copied")
        self.leave()

    def test_help_in_a_small_window_scrolls(self):
        self.view(self.hour(), height=8)
        self.see("message 1 of 7")
        self.keys("?")
        self.see("Keys", "play, pause", "more below")
        self.keys("NPage", "NPage", "NPage", "NPage")
        self.see("Live radio diagnostics", "more above")
        self.keys("Escape")
        self.see("message 1 of 7", "Serving Cell Info")
        self.leave()


if __name__ == "__main__":
    unittest.main()
