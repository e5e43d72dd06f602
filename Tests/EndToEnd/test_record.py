"""Recording a live session, and what a record that ends the program leaves."""

import glob
import json
import os
import plistlib
import signal
import subprocess
import unittest

from harness import WAIT, Place, capture, record, serving_cell, sim_files


class Record(Place):
    def test_recording_decodes_to_what_was_watched(self):
        messages = [serving_cell(5), sim_files(ICCID="1"), serving_cell(7), record(0xB0C1, bytes(9)), b"\x01short"]
        replayed = self.write("a.pcap", capture(messages, step=0.01))
        self.start_service("--replay", replayed)
        done = self.run_spectrel("record", self.path("b.pcap"), "--count", "5")
        self.assertEqual(done.returncode, 0, done.stderr)
        with open(self.path("b.pcap"), "rb") as recorded:
            data = recorded.read()
        for message in messages:
            self.assertIn(message, data)
        decoded = [json.loads(self.run_spectrel("decode", "--format", "json", file).stdout)
                   for file in (replayed, self.path("b.pcap"))]
        self.assertEqual(decoded[0], decoded[1])

    def test_recording_the_simulator_beside_a_watch_ends_in_the_same_values(self):
        service = self.start_service("--simulate", "lte")
        recording = self.start("spectrel", "record", self.path("r.pcap"), stderr=subprocess.PIPE)
        self.wait_until(lambda: os.path.exists(self.path("r.pcap")), "the recording did not begin")
        watching = self.start_watch("--format", "json")
        shown = self.next_line(watching)
        service.terminate()  # in its own time, so that both have been sent the same
        for process in (watching, recording):
            self.wait_for_line(process, "Connecting...")
            process.send_signal(signal.SIGINT)
        self.assertEqual(recording.wait(WAIT), 0)
        shown = json.loads([shown, *self.rest(watching)][-1])
        decoded = json.loads(self.run_spectrel("decode", "--format", "json", self.path("r.pcap")).stdout)
        self.assertEqual(decoded, shown)

    def test_interrupted_recording_is_whole(self):
        self.start_service("--simulate", "lte")
        recording = self.start("spectrel", "record", self.path("r.pcap"), stderr=subprocess.PIPE)
        self.wait_until(lambda: os.path.exists(self.path("r.pcap")) and os.path.getsize(self.path("r.pcap")) > 2000,
                        "nothing was recorded")
        recording.send_signal(signal.SIGTERM)
        self.assertEqual(recording.wait(WAIT), 0)
        done = self.run_spectrel("decode", "--format", "none", self.path("r.pcap"))
        self.assertEqual(done.returncode, 0, done.stderr)

    def test_record_that_cannot_write_says_so(self):
        self.start_service("--simulate", "lte")
        done = self.run_spectrel("record", self.path("nowhere", "r.pcap"))
        self.assertEqual(done.returncode, 1)
        self.assertIn("r.pcap", done.stderr)

    def test_record_takes_what_would_end_the_application(self):
        messages = [serving_cell(5), record(0xFF0000, b"garbage"), serving_cell(6)]
        self.start_service("--replay", self.write("a.pcap", capture(messages, step=0.01)))
        done = self.run_spectrel("record", self.path("r.pcap"), "--count", "3")
        self.assertEqual(done.returncode, 0, done.stderr)


class Ending(Place):
    def test_exception_of_a_record_is_told_and_leaves_a_snapshot(self):
        garbage = record(0xFF0000, b"garbage")
        self.start_service("--replay", self.write("a.pcap", capture([serving_cell(5), garbage], step=0.01)))
        done = self.run_spectrel("watch")
        self.assertEqual(done.returncode, -signal.SIGABRT)
        self.assertIn("UnknownDataException", done.stderr)
        self.assertIn(garbage.hex(), done.stderr)
        [path] = glob.glob(self.path("crash", "*.spectrel"))
        with open(path, "rb") as file:
            snapshot = plistlib.load(file)
        *history, _ = snapshot["Data"]
        self.assertEqual(b"".join(entry["DisplayState"] for entry in history), serving_cell(5) + garbage)
        done = self.run_spectrel("decode", "--format", "json", "--keep-going", "--technology", "lte", path)
        self.assertEqual(json.loads(done.stdout)["Serving Cell Info"]["Physical Cell ID"], "5")


if __name__ == "__main__":
    unittest.main()
