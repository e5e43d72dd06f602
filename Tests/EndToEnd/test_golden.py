"""Golden recordings: each Tests/Golden/NAME.pcap decodes to exactly what stands beside it.

A mismatch writes NAME.FORMAT.fail and shows the difference. After reading it, accept the new output with
    SPECTREL_BIN_DIR=build/dev/bin python3 Tests/EndToEnd/test_golden.py --accept

Each may stand there compressed, such as NAME.changes.gz. A new recording is made with
    spectrel-telephonyd --simulate TECH --seed N --write Tests/Golden/NAME.pcap --duration 5m
"""

import difflib
import glob
import gzip
import os
import sys
import unittest

from harness import Place

GOLDEN = os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "Golden")
FORMATS = ("json", "changes", "tree", "cells", "events")
LONG = 200_000


def read(path):
    """The text of a file that may stand there compressed."""
    if os.path.exists(path + ".gz"):
        with gzip.open(path + ".gz", "rt", encoding="utf-8") as file:
            return file.read()
    with open(path, encoding="utf-8") as file:
        return file.read()


def write(path, text):
    """Writes the file as it stands there; a long new one compressed."""
    if os.path.exists(path + ".gz") or len(text) > LONG and not os.path.exists(path):
        with open(path + ".gz", "wb") as file:
            file.write(gzip.compress(text.encode(), mtime=0))
    else:
        with open(path, "w", encoding="utf-8") as file:
            file.write(text)


class Golden(Place):
    accepting = False

    def test_every_recording_decodes_to_what_stands_beside_it(self):
        recordings = sorted(glob.glob(os.path.join(GOLDEN, "*.pcap")))
        self.assertTrue(recordings)
        for recording in recordings:
            for form in FORMATS:
                with self.subTest(recording=os.path.basename(recording), format=form):
                    self.compare(recording, form)

    def compare(self, recording, form):
        done = self.run_spectrel("decode", "--format", form, recording)
        self.assertEqual(done.returncode, 0, done.stderr)
        beside = recording.removesuffix(".pcap") + "." + form
        if self.accepting:
            write(beside, done.stdout)
        expected = read(beside)
        if done.stdout != expected:
            with open(beside + ".fail", "w", encoding="utf-8") as file:
                file.write(done.stdout)
            difference = list(difflib.unified_diff(expected.splitlines(), done.stdout.splitlines(), lineterm=""))
            self.fail("\n".join(difference[:60]))


if __name__ == "__main__":
    if "--accept" in sys.argv:
        sys.argv.remove("--accept")
        Golden.accepting = True
    unittest.main()
