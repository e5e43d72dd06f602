"""spectrel mark: bookmarks beside recordings, named or being recorded."""

import json
import os
import signal
import time
import unittest

from harness import WAIT, Place, capture, serving_cell


class Mark(Place):
    def setUp(self):
        super().setUp()
        self.start_time = time.time()

    def mark(self, *arguments):
        return self.run_spectrel("mark", *arguments)

    def marks(self, name):
        with open(self.path(name), encoding="utf-8") as file:
            return [json.loads(line) for line in file]

    def assert_refused(self, done, complaint):
        self.assertEqual(done.returncode, 1)
        self.assertEqual(done.stderr, f"spectrel: {complaint}\n")

    def record(self, *arguments):
        process = self.start("spectrel", "record", *arguments)
        self.wait_until(lambda: os.path.exists(self.path(arguments[0])), "no recording was begun")
        return process

    def end(self, process):
        process.send_signal(signal.SIGINT)
        self.assertEqual(process.wait(WAIT), 0)

    def test_running_recorder_takes_the_bookmark(self):
        self.start_service("--simulate", "lte")
        recorder = self.record(self.path("drive.pcap"))
        done = self.mark('tunnel, "south"')
        self.assertEqual((done.returncode, done.stdout), (0, ""))
        self.assertEqual(done.stderr, f"spectrel: {self.path('drive.marks')}: one more bookmark\n")
        self.assertEqual(self.mark("second").returncode, 0)
        marks = self.marks("drive.marks")
        self.assertEqual([mark["note"] for mark in marks], ['tunnel, "south"', "second"])
        self.assertTrue(self.start_time - 1 < marks[0]["time"] <= marks[1]["time"] < time.time() + 1)
        self.assertEqual(os.stat(self.path("drive.marks")).st_mode & 0o777, 0o600)
        self.end(recorder)
        self.assert_refused(self.mark("third"), "no recorder is running; name a recording with --recording")

    def test_bookmark_stands_beside_the_file_of_the_moment(self):
        self.start_service("--simulate", "lte")
        os.mkdir(self.path("tapes"))
        process = self.start("spectrel", "record", "tapes/", "--rollover", "2k", cwd=self.folder)
        third = "spectrel-000003-lte"
        self.wait_until(lambda: os.path.exists(self.path("tapes", third + ".pcap")), "no third file was begun")
        self.assertEqual(self.mark("here").returncode, 0)
        beside = [name for name in os.listdir(self.path("tapes")) if name.endswith(".marks")]
        self.assertEqual(len(beside), 1)
        self.assertGreaterEqual(beside[0], third)
        self.end(process)

    def test_several_recorders_are_named(self):
        self.start_service("--simulate", "lte")
        for name in ("a.pcap", "b.pcap"):
            self.record(self.path(name))
        done = self.mark("here")
        self.assertEqual(done.returncode, 1)
        self.assertIn("several recorders are running", done.stderr)
        self.assertIn(self.path("a.pcap"), done.stderr)
        self.assertIn(self.path("b.pcap"), done.stderr)
        self.assertEqual(self.mark("here", "--recording", self.path("a.pcap")).returncode, 0)
        self.assertEqual([mark["note"] for mark in self.marks("a.marks")], ["here"])
        self.assertFalse(os.path.exists(self.path("b.marks")))

    def test_recorder_that_was_killed_is_none(self):
        self.start_service("--simulate", "lte")
        recorder = self.record(self.path("drive.pcap"))
        recorder.kill()
        recorder.wait(WAIT)
        self.assert_refused(self.mark("here"), "no recorder is running; name a recording with --recording")

    def test_recording_on_standard_output_cannot_be_marked(self):
        self.start_service("--simulate", "lte")
        with open(self.path("out"), "wb") as out:
            self.start("spectrel", "record", "-", stdout=out)
        self.wait_until(lambda: os.path.getsize(self.path("out")) > 0, "nothing was recorded")
        self.assert_refused(self.mark("here"),
                            "standard output is recorded to, beside which no bookmark can stand")

    def test_named_recording_must_be_there(self):
        self.assert_refused(self.mark("here", "--recording", self.path("a.pcap")),
                            f"{self.path('a.pcap')}: No such file or directory")
        self.assert_refused(self.mark("here", "--recording", self.folder), f"{self.folder}: is no recording")
        self.write("a.pcap", capture([serving_cell()]))
        os.mkdir(self.path("a.marks"))
        self.assert_refused(self.mark("here", "--recording", self.path("a.pcap")),
                            f"{self.path('a.marks')}: Is a directory")

    def test_bookmarks_are_events_of_their_recording(self):
        file = self.write("a.pcap", capture([serving_cell(5), serving_cell(5), serving_cell(5)]))
        self.write("a.marks", b'{"time": 1700000001.5, "note": "tunnel"}\nnonsense\n')
        done = self.run_spectrel("decode", "--format", "events", file)
        self.assertEqual(done.returncode, 1)
        self.assertIn(f"spectrel: {self.path('a.marks')}: line 2 is not understood\n", done.stderr)
        bookmarks = [event for event in map(json.loads, done.stdout.splitlines()) if event["event"] == "bookmark"]
        self.assertEqual([(event["time"], event["note"]) for event in bookmarks], [(1700000001.5, "tunnel")])

    def test_new_recording_has_no_bookmarks_of_an_earlier_one(self):
        self.start_service("--simulate", "lte")
        self.write("drive.marks", b'{"time": 1, "note": "long ago"}\n')
        recorder = self.record(self.path("drive.pcap"))
        self.assertEqual(self.mark("now").returncode, 0)
        self.end(recorder)
        self.assertEqual([mark["note"] for mark in self.marks("drive.marks")], ["now"])


if __name__ == "__main__":
    unittest.main()
