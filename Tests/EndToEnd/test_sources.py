"""The telephony service's sources, as the programs meet them."""

import glob
import json
import os
import plistlib
import re
import signal
import socket
import struct
import subprocess
import time
import unittest

from harness import BIN, Place, WAIT, capture, record, serving_cell, shows_cell, sim_files


class Replay(Place):
    def test_part_between_two_times_is_played(self):
        file = self.write("a.pcap", capture([serving_cell(number) for number in range(1, 10)]))
        self.start_service("--replay", file, "--speed", "0", "--from", "2s", "--to", "4s")
        done = self.run_spectrel("record", self.path("r.pcap"), "--count", "3")
        self.assertEqual(done.returncode, 0, done.stderr)
        self.assertEqual(self.bodies("r.pcap"), [serving_cell(number) for number in (3, 4, 5)])

    def test_part_may_start_at_the_very_beginning(self):
        file = self.write("a.pcap", capture([serving_cell(number) for number in range(1, 10)]))
        self.start_service("--replay", file, "--speed", "0", "--from", "0", "--to", "0s")
        done = self.run_spectrel("record", self.path("r.pcap"), "--count", "1")
        self.assertEqual(done.returncode, 0, done.stderr)
        self.assertEqual(self.bodies("r.pcap"), [serving_cell(1)])

    def test_part_is_told_by_the_clock(self):
        file = self.write("a.pcap", capture([serving_cell(number) for number in range(1, 10)]))  # 22:13:20 UTC
        self.start_service("--replay", file, "--speed", "0", "--from", "2023-11-14 22:13:26Z")
        done = self.run_spectrel("record", self.path("r.pcap"), "--count", "3")
        self.assertEqual(done.returncode, 0, done.stderr)
        self.assertEqual(self.bodies("r.pcap"), [serving_cell(number) for number in (7, 8, 9)])

    def bodies(self, name):
        with open(self.path(name), "rb") as file:
            data = file.read()
        found, place = [], 24
        while place < len(data):
            length = struct.unpack_from("<I", data, place + 8)[0]
            found.append(data[place + 16:place + 16 + length])
            place += 16 + length
        return found

    def test_what_the_application_saves_replays_to_the_same_display(self):
        """As a snapshot and as the DLF in it; entries of one record, and of several, whose type bytes stay within."""
        lone = [(1_700_000_000 + 2.5 * number, body) for number, body in
                enumerate([serving_cell(7), sim_files(ICCID="8901"), serving_cell(9)])]
        several = [(1_700_000_000 + 0.2 * number, body) for number, body in
                   enumerate([serving_cell(3), record(0xB0C1, bytes(9), wrap=True), sim_files(ICCID="77"),
                              serving_cell(4)])]
        for name, messages in (("lone", lone), ("several", several)):
            with self.subTest(entries=name):
                file = self.write(f"{name}.pcap", capture(messages))
                done = self.run_spectrel("decode", "--format", "json", "--snapshot", self.path(name), file)
                shown = json.loads(done.stdout)
                [snapshot] = glob.glob(self.path(name, "*.spectrel"))
                with open(snapshot, "rb") as opened:
                    entries = plistlib.load(opened)["Data"]
                self.assertEqual(len(entries), 4 if name == "lone" else 2)
                dlf = self.write(f"{name}.dlf", entries[-1]["DLF"])
                for recording in (snapshot, dlf):
                    self.see_replayed(recording, shown)

    def see_replayed(self, recording, shown):
        service = self.start_service("--replay", recording, "--technology", "lte", "--speed", "0")
        watching = self.start_watch("--format", "json")
        self.watch_until(watching, lambda display: display == shown)
        service.terminate()
        service.wait()
        watching.kill()

    def test_wrong_times_are_wrong_usage(self):
        file = self.write("a.pcap", capture([serving_cell(1)]))
        for times in (["--from", "soon"], ["--from", "5s", "--to", "2s"], ["--to", "25:00"]):
            done = self.run_spectrel("--replay", file, *times, program="spectrel-telephonyd")
            self.assertEqual(done.returncode, 2, times)


class Relay(Place):
    def test_standard_input_in_pieces_of_any_length(self):
        process = self.start_service("--relay", "-", stdin=subprocess.PIPE, encoding=None, bufsize=0)
        data = capture([serving_cell(number) for number in range(1, 6)])
        process.stdin.write(data[:24])
        self.wait_told("a stream of technology lte")
        watching = self.start_watch("--format", "json")
        for byte in data[24:]:
            process.stdin.write(bytes([byte]))
        self.watch_until(watching, shows_cell(5))
        process.stdin.close()
        self.wait_told("the stream is over")
        self.assertIsNone(process.poll())

    def test_fifo_serves_one_writer_after_the_other(self):
        os.mkfifo(self.path("fifo"))
        self.start_service("--relay", self.path("fifo"), "--technology", "lte")
        watching = self.start_watch("--format", "json")
        for cell in (5, 6):
            with open(self.path("fifo"), "wb") as fifo:
                fifo.write(capture([serving_cell(cell)]))
            self.watch_until(watching, shows_cell(cell))
        self.wait_told("the writer has ended; waiting for the next one", 2)

    def test_killed_writer_loses_its_last_message_only(self):
        os.mkfifo(self.path("fifo"))
        self.start_service("--relay", self.path("fifo"))
        data = self.write("a.pcap", capture([serving_cell(5), serving_cell(6), serving_cell(7)])[:-9])
        writer = self.run_background(["sh", "-c", f"exec >'{self.path('fifo')}'; cat '{data}'; exec sleep 1000"])
        self.wait_told("a stream of technology lte")
        watching = self.start_watch("--format", "json")
        self.watch_until(watching, shows_cell(6))
        writer.kill()
        self.wait_told("the stream ended within a packet")
        with open(self.path("fifo"), "wb") as fifo:
            fifo.write(capture([serving_cell(8)]))
        self.watch_until(watching, shows_cell(8))

    def test_unix_socket_carries_dlf(self):
        self.start_service("--relay", "unix:" + self.path("socket"), "--technology", "lte")
        self.assertEqual(os.stat(self.path("socket")).st_mode & 0o777, 0o600)
        watching = self.start_watch("--format", "json")
        for cell in (5, 6):
            with socket.socket(socket.AF_UNIX) as writer:
                writer.connect(self.path("socket"))
                writer.sendall(serving_cell(cell)[1:] + sim_files(ICCID="1")[1:])
                self.watch_until(watching, shows_cell(cell))

    def test_tcp_listens_on_this_machine_alone_and_another_technology_starts_anew(self):
        self.start_service("--relay", "tcp:0")
        [port] = re.findall(r"tcp:127\.0\.0\.1:(\d+)", self.told())
        watching = None
        for technology, shown in (("lte", "Serving Cell Info"), ("gsm", "SIM Info")):
            with socket.create_connection(("127.0.0.1", int(port)), WAIT) as writer:
                writer.sendall(capture([serving_cell(5), sim_files(ICCID=technology)], technology))
                self.wait_told(f"a stream of technology {technology}")
                watching = watching or self.start_watch("--format", "json")
                display = self.watch_until(watching, lambda display: display["SIM Info"].get("EF-ICCID") == technology)
                self.assertIn(shown, display)
        self.assertNotIn("Serving Cell Info", display)

    def test_damage_is_told_with_its_place_and_the_rest_is_relayed(self):
        data = capture([serving_cell(number) for number in range(1, 6)])
        size = 16 + len(serving_cell())
        damaged = data[:24 + size] + data[24 + size + 7:]
        os.mkfifo(self.path("fifo"))
        self.start_service("--relay", self.path("fifo"), "--technology", "lte")
        watching = self.start_watch("--format", "json")
        with open(self.path("fifo"), "wb") as fifo:
            fifo.write(damaged)
            fifo.flush()
            self.watch_until(watching, shows_cell(5))
        self.assertIn(f"skipped {size - 7} bytes at byte {24 + size} of the stream", self.told())

    def test_slow_client_slows_the_writer(self):
        os.mkfifo(self.path("fifo"))
        self.start_service("--relay", self.path("fifo"), "--technology", "lte")
        watching = self.start_watch("--format", "json")
        self.wait_told("streaming")
        watching.send_signal(signal.SIGSTOP)
        descriptor = os.open(self.path("fifo"), os.O_WRONLY)
        self.addCleanup(os.close, descriptor)
        os.set_blocking(descriptor, False)
        os.write(descriptor, capture([]))
        piece = capture([serving_cell(1)] * 100)[24:]
        written, blocked_since = 0, None
        end = time.monotonic() + WAIT
        while blocked_since is None or time.monotonic() < blocked_since + 0.5:
            self.assertLess(time.monotonic(), end, "the writer never had to wait")
            try:
                written += os.write(descriptor, piece[written % len(piece):])
                blocked_since = None
            except BlockingIOError:
                blocked_since = blocked_since or time.monotonic()
                time.sleep(0.01)
        self.assertLess(written, 4_000_000, "what is read and not delivered is bounded")
        watching.send_signal(signal.SIGCONT)
        self.watch_until(watching, shows_cell(1))

    def test_source_that_cannot_be_had_is_refused_in_one_line(self):
        self.write("file", b"")
        for address in (self.path("nowhere"), self.path("file"), self.folder, "tcp:99999", "tcp:nowhere.invalid:1",
                        "unix:" + self.path("file"), "unix:" + self.path("no", "folder")):
            done = self.run_spectrel("--relay", address, program="spectrel-telephonyd")
            self.assertEqual(done.returncode, 1, address)
            self.assertEqual(done.stderr.count("\n"), 1, done.stderr)
            self.assertIn(address, done.stderr)

    def test_value_out_of_its_bounds_is_told_with_them_and_wrong_usage(self):
        simulate = ["--simulate", "lte"]
        replay = ["--replay", self.write("a.pcap", capture([serving_cell(1)]))]
        for arguments, complaint in (
                ([*simulate, "--rate", "nan"], "--rate: 'nan' is no number from 0.01 to 1000"),
                ([*simulate, "--rate", "1e9"], "--rate: '1e9' is no number from 0.01 to 1000"),
                ([*simulate, "--seed", "-1"], "--seed: '-1' is no whole number from 0 to 4294967295"),
                ([*simulate, "--ready-fd", "-2"], "--ready-fd: '-2' is no number of a descriptor"),
                ([*simulate, "--write", ""], "--write: '' names no file"),
                ([*replay, "--speed", "-1"], "--speed: '-1' is neither 0 nor a number from 0.001 to 1000000"),
                ([*replay, "--speed", "nan"], "--speed: 'nan' is neither 0 nor a number from 0.001 to 1000000"),
                (["--relay", ""], "--relay: '' is neither -, a FIFO, unix:PATH nor tcp:HOST:PORT"),
                (["--modem", "--technology", "lte"], "--technology excludes --modem")):
            done = self.run_spectrel(*arguments, program="spectrel-telephonyd")
            self.assertEqual((done.returncode, done.stderr),
                             (2, f"spectrel-telephonyd: {complaint} (see spectrel-telephonyd --help)\n"))

    def test_standard_input_that_is_no_stream_is_refused(self):
        done = subprocess.run([os.path.join(BIN, "spectrel-telephonyd"), "--relay", "-"], env=self.environment,
                              input=b"hello, world", stderr=subprocess.PIPE, timeout=WAIT)
        self.assertEqual(done.returncode, 1)
        self.assertIn(b"refused: it starts neither as a capture nor as DLF", done.stderr)

    def test_two_services_do_not_share_a_socket_and_a_dead_ones_is_taken_over(self):
        address = "unix:" + self.path("socket")
        first = self.start_service("--relay", address)
        done = self.run_spectrel("--relay", address, program="spectrel-telephonyd")
        self.assertEqual(done.returncode, 1)
        self.assertIn("another program listens there", done.stderr)
        first.kill()
        first.wait()
        self.start_service("--relay", address)


if __name__ == "__main__":
    unittest.main()
