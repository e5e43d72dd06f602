"""Faults that a month on a probe brings, one after the other: nothing blocks, nothing is lost without a word."""

import json
import os
import re
import resource
import signal
import socket
import stat
import subprocess
import unittest

from harness import BIN, WAIT, Place, capture, serving_cell, shows_cell

FEW_BYTES = 100_000


def limit_files():
    """Files end at a size, as on a full disk."""
    resource.setrlimit(resource.RLIMIT_FSIZE, (FEW_BYTES, resource.RLIM_INFINITY))


class Blocked(Place):
    """Outputs that nobody reads."""

    def full_pipe(self):
        """The writing end of a pipe without room; the reading end stays open and unread."""
        reading, writing = os.pipe()
        self.addCleanup(os.close, reading)
        self.addCleanup(os.close, writing)
        os.set_blocking(writing, False)
        with self.assertRaises(BlockingIOError):
            while True:
                os.write(writing, bytes(4096))
        os.set_blocking(writing, True)
        return writing

    def test_watch_and_record_into_a_pipe_that_nobody_reads_end_when_told(self):
        self.start_service("--simulate", "lte", "--scene", "stress")
        for number, arguments in enumerate((["watch", "--format", "csv"], ["record", "-"]), start=1):
            process = self.start("spectrel", *arguments, stdout=self.full_pipe(), stderr=subprocess.PIPE)
            self.wait_told(": streaming", number)
            process.send_signal(signal.SIGTERM)
            _, told = process.communicate(timeout=WAIT)
            self.assertEqual(process.returncode, 1, told)
            self.assertRegex(told, r"standard output: the last \d+ bytes found no reader")

    def test_fifo_without_a_reader_is_no_reason_to_wait(self):
        self.start_service("--simulate", "lte")
        os.mkfifo(self.path("fifo"))
        recording = self.start("spectrel", "record", self.path("fifo"), stderr=subprocess.PIPE)
        self.wait_told(": streaming")
        recording.send_signal(signal.SIGINT)
        _, told = recording.communicate(timeout=WAIT)
        self.assertEqual(recording.returncode, 1, told)
        self.assertIn("found no reader", told)

    def test_fifo_finds_its_reader_later_and_gets_all_of_it(self):
        file = self.write("a.pcap", capture([serving_cell(number) for number in range(1, 50)], step=0.001))
        self.start_service("--replay", file)
        os.mkfifo(self.path("fifo"))
        recording = self.start("spectrel", "record", self.path("fifo"), "--count", "49", stderr=subprocess.PIPE)
        self.wait_told(": streaming")
        decoded = self.run_spectrel("decode", "--format", "changes", self.path("fifo"))
        self.assertEqual(recording.wait(WAIT), 0)
        self.assertEqual(len({json.loads(line)["n"] for line in decoded.stdout.splitlines()}), 49)

    def test_service_whose_standard_error_is_full_or_gone_goes_on_and_ends_when_told(self):
        pipe = self.full_pipe()
        for broken in (False, True):
            ready, told = os.pipe()
            errors = pipe
            if broken:
                reading, errors = os.pipe()
                os.close(reading)
            service = self.start("spectrel-telephonyd", "--simulate", "lte", "--status", "100ms", "--ready-fd", str(told),
                                 pass_fds=[told], stderr=errors)
            os.close(told)
            with os.fdopen(ready, "rb") as stream:
                self.await_data(stream, "the service did not get ready")
            done = self.run_spectrel("record", self.path(f"{broken}.pcap"), "--count", "100")
            self.assertEqual(done.returncode, 0, done.stderr)
            service.terminate()
            self.assertEqual(service.wait(WAIT), 0)
            if broken:
                os.close(errors)


class Lost(Place):
    def test_stopped_recorder_tells_what_it_lost_and_where(self):
        service = self.start_service("--simulate", "lte", "--scene", "stress", "--rate", "100")
        recording = self.start("spectrel", "record", self.path("r.pcap"), stderr=subprocess.PIPE)
        self.wait_told(": streaming")
        recording.send_signal(signal.SIGSTOP)

        def has_lost():
            service.send_signal(signal.SIGUSR1)
            return re.search(r"queued, \d+ lost", self.told())
        self.wait_until(has_lost, "nothing was lost")
        recording.send_signal(signal.SIGCONT)
        self.wait_until(lambda: os.path.exists(self.path("r.gaps")) and os.path.getsize(self.path("r.gaps")),
                        "the loss was not noted")
        recording.send_signal(signal.SIGTERM)
        _, told = recording.communicate(timeout=WAIT)
        self.assertEqual(recording.returncode, 1)
        with open(self.path("r.gaps")) as file:
            gaps = [json.loads(line) for line in file]
        lost = sum(gap["lost"] for gap in gaps)
        self.assertGreater(lost, 0)
        self.assertEqual([list(gap) for gap in gaps], [["time", "lost"]] * len(gaps))
        self.assertIn(f"{gaps[0]['lost']} message", told)
        self.assertIn(f", {lost} lost", told)
        self.assertEqual(stat.S_IMODE(os.stat(self.path("r.gaps")).st_mode), 0o600)
        done = self.run_spectrel("decode", "--format", "none", self.path("r.pcap"))
        self.assertEqual(done.returncode, 0, done.stderr)

    def test_full_disk_leaves_whole_messages_and_status_1(self):
        self.start_service("--simulate", "lte", "--scene", "stress", "--rate", "20")
        recording = self.start("spectrel", "record", self.path("r.pcap"), stderr=subprocess.PIPE, preexec_fn=limit_files)
        self.wait_for_line(recording, "File too large; what comes waits")
        recording.send_signal(signal.SIGTERM)
        _, told = recording.communicate(timeout=WAIT)
        self.assertEqual(recording.returncode, 1)
        self.assertIn("are lost", told)
        self.assertGreater(os.path.getsize(self.path("r.pcap")), FEW_BYTES // 2)
        done = self.run_spectrel("decode", "--format", "none", self.path("r.pcap"))
        self.assertEqual(done.returncode, 0, done.stderr)

    def test_outputs_on_a_full_device_are_failures(self):
        for program in ("spectrel", "spectrel-telephonyd"):
            with open("/dev/full", "w") as full:
                done = subprocess.run([os.path.join(BIN, program), "--help"], env=self.environment, stdout=full,
                                      stderr=subprocess.PIPE, encoding="utf-8", timeout=WAIT)
            self.assertEqual((done.returncode, done.stderr), (1, f"{program}: standard output: cannot be written\n"))

    def test_recorder_leaves_files_alone_that_are_there(self):
        self.start_service("--simulate", "lte")
        mine = self.write("mine.pcap", b"mine")
        os.symlink("mine.pcap", self.path("link.pcap"))
        for arguments in ([mine], [self.path("link.pcap")], [self.path("link.pcap"), "--overwrite"]):
            done = self.run_spectrel("record", *arguments, "--count", "1")
            self.assertEqual(done.returncode, 1, arguments)
            self.assertIn(arguments[0] + ": ", done.stderr)
        with open(mine, "rb") as file:
            self.assertEqual(file.read(), b"mine")
        os.chmod(mine, 0o644)
        done = self.run_spectrel("record", mine, "--overwrite", "--count", "1")
        self.assertEqual(done.returncode, 0, done.stderr)
        self.assertEqual(stat.S_IMODE(os.stat(mine).st_mode), 0o600)

    def test_two_recorders_in_one_folder_lose_nothing_to_each_other(self):
        self.start_service("--simulate", "lte", "--scene", "stress")
        slow = self.start("spectrel", "record", self.path("both", ""), stderr=subprocess.PIPE)
        first = self.path("both", "spectrel-000001-lte.pcap")
        self.wait_until(lambda: os.path.exists(first), "the recording did not begin")
        done = self.run_spectrel("record", self.path("both", ""), "--rollover", "2k", "--keep", "2", "--count", "300")
        self.assertEqual(done.returncode, 0, done.stderr)
        slow.send_signal(signal.SIGTERM)
        _, told = slow.communicate(timeout=WAIT)
        self.assertEqual(slow.returncode, 0, told)
        self.assertTrue(os.path.exists(first))


class Others(Place):
    def test_web_page_does_not_write_into_the_relay(self):
        self.start_service("--relay", "tcp:0", "--technology", "lte")
        [port] = re.findall(r"tcp:127\.0\.0\.1:(\d+)", self.told())
        watching = self.start_watch("--format", "json")
        self.wait_told(": streaming")
        with socket.create_connection(("127.0.0.1", int(port)), WAIT) as page:
            page.sendall(b"POST / HTTP/1.1\r\nContent-Length: 999\r\n\r\n" + serving_cell(66) * 5)
            self.wait_told("the stream is refused: it starts with the header of neither a capture nor DLF")
        with socket.create_connection(("127.0.0.1", int(port)), WAIT) as writer:
            writer.sendall(capture([serving_cell(5)]))
            self.watch_until(watching, shows_cell(5))
        self.assertNotIn("skipped", self.told())

    def test_ports_folder_that_others_can_write_is_refused_and_left_as_it_is(self):
        os.mkdir(self.path("ports"))
        os.chmod(self.path("ports"), 0o1777)
        for program, arguments in (("spectrel-telephonyd", ["--simulate", "lte"]), ("spectrel", ["watch"])):
            done = self.run_spectrel(*arguments, program=program)
            self.assertEqual(done.returncode, 1)
            self.assertIn("ports: others can write there (mode 1777)", done.stderr)
        self.assertEqual(stat.S_IMODE(os.stat(self.path("ports")).st_mode), 0o1777)

    def test_want_of_descriptors_is_named(self):
        for program, arguments in (("spectrel-telephonyd", ["--simulate", "lte"]),
                                   ("spectrel", ["record", self.path("r.pcap")])):
            done = self.run_spectrel(*arguments, program=program,
                                     preexec_fn=lambda: resource.setrlimit(resource.RLIMIT_NOFILE, (8, 8)))
            self.assertEqual((done.returncode, done.stderr),
                             (1, f"{program}: the run loop gets no descriptors: Too many open files\n"))


if __name__ == "__main__":
    unittest.main()
