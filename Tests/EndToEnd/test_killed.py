"""kill -9, of anybody at any time, leaves nobody stuck and every file readable."""

import glob
import json
import os
import re
import shutil
import signal
import subprocess
import time
import unittest

from harness import WAIT, Place, capture, serving_cell


class Killed(Place):
    def test_killed_client_frees_its_channel_and_harms_no_other(self):
        service = self.start_service("--simulate", "lte", "--scene", "stress")
        watching = self.start_watch("--format", "json")
        self.next_line(watching)
        others = [self.start_watch("--format", "json") for _ in range(3)]
        for number, other in enumerate(others, start=1):
            self.next_line(other)
            other.kill()
            self.wait_told("is gone, after", number)
        service.send_signal(signal.SIGUSR1)
        self.wait_told("; 1 client, ")
        self.next_line(watching)

    def test_stopped_client_harms_no_other(self):
        file = self.write("a.pcap", capture([serving_cell(number) for number in range(1, 200)], step=0.001))
        self.start_service("--replay", file, "--speed", "0", "--loop")
        stuck = self.start_watch("--format", "json")
        self.next_line(stuck)
        stuck.send_signal(signal.SIGSTOP)
        done = self.run_spectrel("record", self.path("r.pcap"), "--count", "20000")
        self.assertEqual(done.returncode, 0, done.stderr)
        stuck.send_signal(signal.SIGCONT)
        self.next_line(stuck)

    def test_killed_recorder_leaves_readable_files_and_the_next_goes_on_in_the_folder(self):
        file = self.write("a.pcap", capture([serving_cell(number) for number in range(1, 500)], step=0.001))
        self.start_service("--replay", file, "--speed", "0", "--loop")
        files = []
        interrupted = []  # the files that a recorder was killed at
        for _ in range(3):
            recorder = self.start("spectrel", "record", self.path("folder", ""), "--rollover", "300k",
                                  stderr=subprocess.DEVNULL)
            before = len(files)
            self.wait_until(lambda: len(self.recorded()) >= before + 3, "nothing was recorded")
            recorder.kill()
            recorder.wait()
            files = self.recorded()
            interrupted.append(files[-1])
        names = [f"spectrel-{number:06}-lte.pcap" for number in range(1, len(files) + 1)]
        self.assertEqual([os.path.basename(each) for each in files], names)
        for each in files:
            self.check_readable(each, each in interrupted)

    def recorded(self):
        return sorted(glob.glob(self.path("folder", "*.pcap")))

    def check_readable(self, file, is_interrupted):
        """Every message of a file is read; only one that was being written when its writer was killed may be cut."""
        whole, half = divmod(os.path.getsize(file) - 24, 16 + len(serving_cell()))
        done = self.run_spectrel("decode", "--format", "changes", file)
        changed = {json.loads(line)["n"] for line in done.stdout.splitlines()}  # each message shows another cell
        self.assertEqual(len(changed), whole)
        if half:
            self.assertTrue(is_interrupted, file)
            self.assertIn("truncated", done.stderr)
        self.assertEqual(done.returncode, 1 if half else 0, done.stderr)

    def test_killed_recorder_has_lost_no_more_than_the_last_second(self):
        messages = [(1_700_000_000 + 0.1 * number, serving_cell(number)) for number in range(1, 600)]
        self.start_service("--replay", self.write("a.pcap", capture(messages)))
        recorder = self.start("spectrel", "record", self.path("r.pcap"), stderr=subprocess.DEVNULL)
        # Whatever the file holds at this moment, it holds more within the second that may be lost, again and again.
        size = 0
        for _ in range(5):
            self.wait_until(lambda: os.path.exists(self.path("r.pcap")) and os.path.getsize(self.path("r.pcap")) > size,
                            "the recording does not grow")
            size = os.path.getsize(self.path("r.pcap"))
        recorder.kill()
        recorder.wait()
        self.check_readable(self.path("r.pcap"), True)

    def test_killed_service_is_survived_in_the_middle_of_a_flood(self):
        file = self.write("a.pcap", capture([serving_cell(number) for number in range(1, 500)], step=0.001))
        arguments = ["--replay", file, "--speed", "0", "--loop"]
        service = self.start_service(*arguments)
        watching = self.start_watch("--format", "json")
        recorder = self.start("spectrel", "record", self.path("r.pcap"), stderr=subprocess.PIPE)
        self.wait_until(lambda: os.path.exists(self.path("r.pcap")), "the recording did not begin")
        for _ in range(2):
            self.next_line(watching)
            service.kill()
            service.wait()
            service = self.start_service(*arguments)
        end = time.monotonic() + WAIT
        size = os.path.getsize(self.path("r.pcap"))
        while os.path.getsize(self.path("r.pcap")) <= size:
            self.assertLess(time.monotonic(), end, "the recorder did not come back")
            self.next_line(watching)
        recorder.send_signal(signal.SIGTERM)
        recorder.communicate(timeout=WAIT)
        self.assertEqual(recorder.returncode, 0)

    def test_recordings_are_ordinary_captures(self):
        self.start_service("--simulate", "lte", "--rate", "10")
        done = self.run_spectrel("record", self.path("r.pcap"), "--count", "20")
        self.assertEqual(done.returncode, 0, done.stderr)
        listed = subprocess.run(["tcpdump", "-r", self.path("r.pcap"), "-n", "-q"], env=self.environment,
                                capture_output=True, text=True)
        self.assertEqual(listed.returncode, 0, listed.stderr)
        self.assertEqual(len([line for line in listed.stdout.splitlines() if re.match(r"\d\d:", line)]), 20)
        for reader in ("capinfos", "tshark"):  # heavy ones, where they are installed
            if shutil.which(reader):
                done = subprocess.run([reader, *(["-r"] if reader == "tshark" else []), self.path("r.pcap")],
                                      env=self.environment, capture_output=True, text=True)
                self.assertEqual(done.returncode, 0, done.stderr)


if __name__ == "__main__":
    unittest.main()
