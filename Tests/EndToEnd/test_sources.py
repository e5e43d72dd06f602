"""The telephony service's sources, as the programs meet them, and what it says of itself."""

import glob
import json
import os
import plistlib
import re
import shutil
import signal
import socket
import struct
import subprocess
import time
import unittest

from harness import BIN, Place, WAIT, capture, record, serving_cell, sim_files

TOP = os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "..")


class Sources(Place):
    def start_logged(self, *arguments, stdin=subprocess.DEVNULL):
        """A service whose standard error the test reads; ready when it serves its port."""
        with open(self.path("service.log"), "a") as log:
            process = subprocess.Popen([os.path.join(BIN, "spectrel-telephonyd"), *arguments], env=self.environment,
                                       stdin=stdin, stderr=log, bufsize=0)
        self.processes.append(process)
        self.wait_until(lambda: "serving" in self.log(), "the service did not start")
        return process

    def log(self):
        try:
            with open(self.path("service.log")) as file:
                return file.read()
        except FileNotFoundError:
            return ""

    def wait_for_log(self, text, count=1):
        self.wait_until(lambda: self.log().count(text) >= count, f"the service did not say: {text}")

    def cell(self, line):
        return json.loads(line)["Serving Cell Info"]["Physical Cell ID"]

    def watch_until(self, watching, cell):
        """Reads refreshes until the display shows this cell."""
        end = time.monotonic() + WAIT
        while self.cell(self.next_line(watching)) != str(cell):
            self.assertLess(time.monotonic(), end, f"cell {cell} never came")


class Replay(Sources):
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
                    self.assertEqual(self.replayed(recording), shown, recording)

    def replayed(self, recording):
        service = self.start_service("--replay", recording, "--technology", "lte", "--speed", "0")
        done = self.run_spectrel("watch", "--format", "json", "--count", "1")
        service.terminate()
        service.wait()
        return json.loads(done.stdout)

    def test_wrong_times_are_wrong_usage(self):
        file = self.write("a.pcap", capture([serving_cell(1)]))
        for times in (["--from", "soon"], ["--from", "5s", "--to", "2s"], ["--to", "25:00"]):
            done = self.run_spectrel("--replay", file, *times, program="spectrel-telephonyd")
            self.assertEqual(done.returncode, 2, times)


class Relay(Sources):
    def test_standard_input_in_pieces_of_any_length(self):
        process = self.start_logged("--relay", "-", stdin=subprocess.PIPE)
        data = capture([serving_cell(number) for number in range(1, 6)])
        process.stdin.write(data[:24])
        self.wait_for_log("a stream of technology lte")
        watching = self.start_watch("--format", "json")
        for byte in data[24:]:
            process.stdin.write(bytes([byte]))
        self.watch_until(watching, 5)
        process.stdin.close()
        self.wait_for_log("the stream is over")
        self.assertIsNone(process.poll())

    def test_fifo_serves_one_writer_after_the_other(self):
        os.mkfifo(self.path("fifo"))
        self.start_logged("--relay", self.path("fifo"), "--technology", "lte")
        watching = self.start_watch("--format", "json")
        for cell in (5, 6):
            with open(self.path("fifo"), "wb") as fifo:
                fifo.write(capture([serving_cell(cell)]))
            self.watch_until(watching, cell)
        self.wait_for_log("the writer has ended; waiting for the next one", 2)

    def test_killed_writer_loses_its_last_message_only(self):
        os.mkfifo(self.path("fifo"))
        self.start_logged("--relay", self.path("fifo"))
        data = self.write("a.pcap", capture([serving_cell(5), serving_cell(6), serving_cell(7)])[:-9])
        writer = subprocess.Popen(["sh", "-c", f"exec >'{self.path('fifo')}'; cat '{data}'; exec sleep 1000"])
        self.processes.append(writer)
        self.wait_for_log("a stream of technology lte")
        watching = self.start_watch("--format", "json")
        self.watch_until(watching, 6)
        writer.kill()
        self.wait_for_log("the stream ended within a packet")
        with open(self.path("fifo"), "wb") as fifo:
            fifo.write(capture([serving_cell(8)]))
        self.watch_until(watching, 8)

    def test_unix_socket_carries_dlf(self):
        self.start_logged("--relay", "unix:" + self.path("socket"), "--technology", "lte")
        self.assertEqual(os.stat(self.path("socket")).st_mode & 0o777, 0o600)
        watching = self.start_watch("--format", "json")
        for cell in (5, 6):
            with socket.socket(socket.AF_UNIX) as writer:
                writer.connect(self.path("socket"))
                writer.sendall(serving_cell(cell)[1:] + sim_files(ICCID="1")[1:])
                self.watch_until(watching, cell)

    def test_tcp_listens_on_this_machine_alone_and_another_technology_starts_anew(self):
        self.start_logged("--relay", "tcp:0")
        [port] = re.findall(r"tcp:127\.0\.0\.1:(\d+)", self.log())
        watching = None
        for technology, shown in (("lte", "Serving Cell Info"), ("gsm", "SIM Info")):
            with socket.create_connection(("127.0.0.1", int(port)), WAIT) as writer:
                writer.sendall(capture([serving_cell(5), sim_files(ICCID=technology)], technology))
                self.wait_for_log(f"a stream of technology {technology}")
                watching = watching or self.start_watch("--format", "json")
                end = time.monotonic() + WAIT
                while (display := json.loads(self.next_line(watching)))["SIM Info"].get("EF-ICCID") != technology:
                    self.assertLess(time.monotonic(), end)
                self.assertIn(shown, display)
        self.assertNotIn("Serving Cell Info", display)

    def test_damage_is_told_with_its_place_and_the_rest_is_relayed(self):
        data = capture([serving_cell(number) for number in range(1, 6)])
        size = 16 + len(serving_cell())
        damaged = data[:24 + size] + data[24 + size + 7:]
        os.mkfifo(self.path("fifo"))
        self.start_logged("--relay", self.path("fifo"), "--technology", "lte")
        watching = self.start_watch("--format", "json")
        with open(self.path("fifo"), "wb") as fifo:
            fifo.write(damaged)
            fifo.flush()
            self.watch_until(watching, 5)
        self.assertIn(f"skipped {size - 7} bytes at byte {24 + size} of the stream", self.log())

    def test_slow_client_slows_the_writer(self):
        os.mkfifo(self.path("fifo"))
        self.start_logged("--relay", self.path("fifo"), "--technology", "lte")
        watching = self.start_watch("--format", "json")
        self.wait_for_log("streaming")
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
        self.assertEqual(self.cell(self.next_line(watching)), "1")

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
        first = self.start_logged("--relay", address)
        done = self.run_spectrel("--relay", address, program="spectrel-telephonyd")
        self.assertEqual(done.returncode, 1)
        self.assertIn("another program listens there", done.stderr)
        first.kill()
        first.wait()
        os.remove(self.path("service.log"))
        self.start_logged("--relay", address)


class Killed(Sources):
    """kill -9, of anybody at any time, leaves nobody stuck and every file readable."""

    def test_killed_client_frees_its_channel_and_harms_no_other(self):
        service = self.start_logged("--simulate", "lte", "--scene", "stress")
        watching = self.start_watch("--format", "json")
        self.next_line(watching)
        for number in range(3):
            other = self.start_watch("--format", "json")
            self.next_line(other)
            other.kill()
            self.wait_for_log("is gone, after", number + 1)
        service.send_signal(signal.SIGUSR1)
        self.wait_for_log("; 1 client, ")
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
        for run in range(1, 4):
            recorder = self.start("spectrel", "record", self.path("folder", ""), "--rollover", "300k",
                                  stderr=subprocess.DEVNULL)
            self.wait_until(lambda: len(glob.glob(self.path("folder", "*"))) >= 3 * run, "nothing was recorded")
            recorder.kill()
            recorder.wait()
        files = sorted(glob.glob(self.path("folder", "*.pcap")))
        names = [f"spectrel-{number:06}-lte.pcap" for number in range(1, len(files) + 1)]
        self.assertEqual([os.path.basename(each) for each in files], names)
        for each in files:
            done = self.run_spectrel("decode", "--format", "none", each)
            self.assertEqual(done.returncode, 0, done.stderr)

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
        done = self.run_spectrel("decode", "--format", "none", self.path("r.pcap"))
        self.assertEqual(done.returncode, 0, done.stderr)
        with open(self.path("r.pcap"), "rb") as file:
            self.assertEqual((len(file.read()) - 24) % (16 + len(serving_cell())), 0)

    def test_killed_service_is_survived_in_the_middle_of_a_flood(self):
        file = self.write("a.pcap", capture([serving_cell(number) for number in range(1, 500)], step=0.001))
        arguments = ["--replay", file, "--speed", "0", "--loop"]
        service = self.start_service(*arguments)
        watching = self.start_watch("--format", "json")
        recorder = self.start("spectrel", "record", self.path("r.pcap"), stderr=subprocess.PIPE)
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
        self.start_service("--simulate", "lte")
        done = self.run_spectrel("record", self.path("r.pcap"), "--count", "20")
        self.assertEqual(done.returncode, 0, done.stderr)
        listed = subprocess.run(["tcpdump", "-r", self.path("r.pcap"), "-n", "-q"], capture_output=True, text=True)
        self.assertEqual(listed.returncode, 0, listed.stderr)
        self.assertEqual(len([line for line in listed.stdout.splitlines() if re.match(r"\d\d:", line)]), 20)
        for reader in ("capinfos", "tshark"):  # heavy ones, where they are installed
            if shutil.which(reader):
                done = subprocess.run([reader, *(["-r"] if reader == "tshark" else []), self.path("r.pcap")],
                                      capture_output=True, text=True)
                self.assertEqual(done.returncode, 0, done.stderr)


class Status(Sources):
    def test_usr1_tells_what_is_streamed_to_whom(self):
        service = self.start_logged("--simulate", "lte")
        watching = self.start_watch("--format", "json")
        self.next_line(watching)
        service.send_signal(signal.SIGUSR1)
        self.wait_for_log("a simulated lte baseband; 1 client, ")
        self.assertRegex(self.log(), r"channel 1 to org\.spectrel\.Watch\.\d+: \d+ codes, [\d.]+ messages/s, \d+ sent"
                                     r".*, 0 queued")

    def test_regular_report_comes_with_news_and_is_quiet_without(self):
        file = self.write("a.pcap", capture([serving_cell(1)]))
        self.start_logged("--replay", file, "--speed", "0", "--status", "100ms")
        done = self.run_spectrel("watch", "--format", "none", "--count", "1")
        self.assertEqual(done.returncode, 0)
        self.wait_for_log("; 1 client, ")
        self.wait_for_log("is gone, after 1 messages")
        lines = len(self.log().splitlines())
        time.sleep(1)
        self.assertLessEqual(len(self.log().splitlines()), lines + 1, "one report of the client's leaving")


class ServiceManager(Sources):
    def notifications(self):
        listener = socket.socket(socket.AF_UNIX, socket.SOCK_DGRAM)
        self.addCleanup(listener.close)
        listener.bind(self.path("notify"))
        listener.settimeout(WAIT)
        self.environment["NOTIFY_SOCKET"] = self.path("notify")
        return listener

    def test_readiness_status_and_end_are_notified(self):
        listener = self.notifications()
        service = self.start_logged("--simulate", "lte")
        self.assertEqual(listener.recv(4096), b"READY=1\nSTATUS=a simulated lte baseband; 0 clients\n")
        watching = self.start_watch("--format", "json")
        self.assertIn(b"STATUS=a simulated lte baseband; 1 client", listener.recv(4096))
        watching.kill()
        self.assertIn(b"; 0 clients", listener.recv(4096))
        service.terminate()
        self.assertEqual(listener.recv(4096), b"STOPPING=1\n")
        self.assertEqual(service.wait(), 0)

    def test_first_client_starts_the_service_and_the_socket_stays(self):
        os.mkdir(self.path("ports"), 0o700)
        port = self.path("ports", "org.spectrel.Telephony")
        activator = subprocess.Popen(
            ["systemd-socket-activate", "--seqpacket", "--listen", port, "-E", "SPECTREL_PORT_DIR=" + self.path("ports"),
             os.path.join(BIN, "spectrel-telephonyd"), "--simulate", "lte"],
            env=self.environment, stdin=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
        self.processes.append(activator)
        self.wait_until(lambda: os.path.exists(port), "nobody listens")
        done = self.run_spectrel("watch", "--format", "json", "--count", "1")
        self.assertIn("Serving Cell Info", json.loads(done.stdout))
        activator.terminate()  # by now it is the service
        self.assertEqual(activator.wait(), 0)
        self.assertTrue(os.path.exists(port), "the socket belongs to the service manager")

    def test_socket_in_the_wrong_place_is_refused(self):
        activator = subprocess.Popen(
            ["systemd-socket-activate", "--seqpacket", "--listen", self.path("elsewhere"),
             "-E", "SPECTREL_PORT_DIR=" + self.path("ports"), os.path.join(BIN, "spectrel-telephonyd"),
             "--simulate", "lte"],
            env=self.environment, stdin=subprocess.DEVNULL, stderr=subprocess.PIPE, text=True)
        self.processes.append(activator)
        self.wait_until(lambda: os.path.exists(self.path("elsewhere")), "nobody listens")
        with socket.socket(socket.AF_UNIX, socket.SOCK_SEQPACKET) as client:
            client.connect(self.path("elsewhere"))
            self.assertEqual(activator.wait(WAIT), 1)
        self.assertIn("clients look for it at", activator.stderr.read())

    def test_units_are_in_order(self):
        units = self.path("units")
        os.mkdir(units)
        folder = os.path.join(TOP, "packaging", "systemd")
        with open(os.path.join(folder, "spectrel-telephonyd.service.in")) as file:
            service = file.read().replace("@CMAKE_INSTALL_FULL_BINDIR@", BIN)
        self.write("units/spectrel-telephonyd.service", service.encode())
        with open(os.path.join(folder, "spectrel-telephonyd.socket"), "rb") as file:
            self.write("units/spectrel-telephonyd.socket", file.read())
        os.mkdir(self.path("run"), 0o700)
        done = subprocess.run(
            ["systemd-analyze", "--user", "--man=no", "verify", os.path.join(units, "spectrel-telephonyd.service"),
             os.path.join(units, "spectrel-telephonyd.socket")],
            env={**self.environment, "XDG_RUNTIME_DIR": self.path("run"), "SYSTEMD_UNIT_PATH": units + ":"},
            capture_output=True, text=True)
        self.assertEqual((done.returncode, done.stdout + done.stderr), (0, ""))


if __name__ == "__main__":
    unittest.main()
