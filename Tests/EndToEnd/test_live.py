"""The live session over real message ports: watch, record, and a telephony service that comes and goes."""

import glob
import json
import os
import plistlib
import signal
import subprocess
import sys
import unittest

from harness import LTE_SECTIONS, Place, WAIT, capture, record, serving_cell, sim_files


class Watch(Place):
    def displays(self, done):
        return [json.loads(line) for line in done.stdout.splitlines()]

    def test_simulated_values_arrive_and_change(self):
        self.start_service("--simulate", "lte")
        done = self.run_spectrel("watch", "--format", "json", "--count", "3")
        self.assertEqual(done.returncode, 0, done.stderr)
        displays = self.displays(done)
        self.assertEqual(len(displays), 3)
        for display in displays:
            self.assertEqual(list(display), LTE_SECTIONS)
            self.assertNotEqual(display["Serving Cell Info"]["Physical Cell ID"], "-")
            self.assertNotEqual(display["SIM Info"]["EF-ICCID"], "-")
            self.assertTrue(display["PDP Context Info"])
        self.assertNotEqual(displays[0], displays[2])

    def test_without_terminal_and_display_the_program_watches(self):
        self.start_service("--replay", self.write("a.pcap", capture([serving_cell(5)])), "--speed", "0")
        process = self.start("spectrel", stdout=subprocess.PIPE, stderr=subprocess.PIPE)
        self.assertEqual(self.next_line(process), "Serving Cell Info\n")
        self.assertEqual(self.next_line(process), "  Physical Cell ID: 5\n")
        process.send_signal(signal.SIGINT)
        self.assertEqual(process.wait(), 0)

    def test_changes_count_the_refreshes(self):
        messages = [(1700000000 + number * 2.5, serving_cell(number)) for number in range(1, 4)]
        self.start_service("--replay", self.write("a.pcap", capture(messages)))
        done = self.run_spectrel("watch", "--format", "changes", "--count", "2")
        changes = [json.loads(line) for line in done.stdout.splitlines()]
        cells = [(change["n"], change["value"]) for change in changes
                 if change["path"] == "/Serving Cell Info/Physical Cell ID"]
        self.assertEqual([n for n, _ in cells], [0, 1])
        self.assertLess(int(cells[0][1]), int(cells[1][1]))

    def test_csv_begins_with_its_header(self):
        self.start_service("--simulate", "lte")
        done = self.run_spectrel("watch", "--format", "csv", "--count", "1")
        self.assertTrue(done.stdout.startswith("n,time,path,value\n"), done.stdout[:80])  # text mode folds CR LF

    def test_duration_ends_it_even_without_a_service(self):
        done = self.run_spectrel("watch", "--duration", "300ms")
        self.assertEqual(done.returncode, 0)
        self.assertIn("Connecting... (Could not create RKServerConnection)", done.stderr)

    def test_flood_does_not_starve_the_refresh(self):
        file = self.write("a.pcap", capture([serving_cell(number) for number in range(500)], step=0.001))
        self.start_service("--replay", file, "--speed", "0", "--loop")
        done = self.run_spectrel("watch", "--format", "json", "--count", "2")
        self.assertEqual([list(display) for display in self.displays(done)],
                         2 * [LTE_SECTIONS])

    def test_reader_that_goes_away_ends_it_and_leaves_no_port_behind(self):
        self.start_service("--simulate", "lte", "--scene", "stress")
        watching = self.start_watch("--format", "json")
        self.next_line(watching)
        watching.stdout.close()
        self.assertEqual(watching.wait(WAIT), 1)
        self.assertIn("spectrel: standard output: cannot be written\n", watching.stderr.read())
        self.assertEqual([name for name in os.listdir(self.path("ports")) if "Watch" in name], [])

    def test_several_programs_watch_at_once(self):
        self.start_service("--simulate", "lte")
        first = self.start_watch("--format", "json")
        second = self.start_watch("--format", "json")
        for process in (first, second, first, second):
            self.assertIn("Serving Cell Info", json.loads(self.next_line(process)))


class Restart(Place):
    def test_session_outlives_a_killed_service(self):
        service = self.start_service("--replay", self.write("a.pcap", capture([serving_cell(5), sim_files(ICCID="1")])),
                                     "--speed", "0")
        watching = self.start_watch("--format", "json")
        before = json.loads(self.next_line(watching))
        self.assertEqual(before["Serving Cell Info"]["Physical Cell ID"], "5")
        service.kill()
        service.wait()
        self.assertIn("Connecting...", watching.stderr.readline())
        self.start_service("--replay", self.write("b.pcap", capture([serving_cell(6)])), "--speed", "0")
        after = json.loads(self.next_line(watching))
        self.assertEqual(after["Serving Cell Info"]["Physical Cell ID"], "6")
        self.assertEqual(after["SIM Info"]["EF-ICCID"], "1", "values from before the restart stay")

    def test_service_may_return_with_another_technology(self):
        service = self.start_service("--replay", self.write("a.pcap", capture([serving_cell(5)])), "--speed", "0")
        watching = self.start_watch("--format", "json")
        self.assertIn("Serving Cell Info", json.loads(self.next_line(watching)))
        service.kill()
        service.wait()
        self.start_service("--replay", self.write("b.pcap", capture([sim_files(ICCID="2")], technology="gsm")),
                           "--speed", "0")
        after = json.loads(self.next_line(watching))
        self.assertNotIn("Serving Cell Info", after)
        self.assertEqual(after["SIM Info"]["EF-ICCID"], "2")

    def test_second_service_on_the_same_ports_is_refused(self):
        self.start_service("--simulate", "lte")
        second = self.run_spectrel("--simulate", "lte", program="spectrel-telephonyd")
        self.assertEqual(second.returncode, 1)
        self.assertTrue(second.stderr)

    def test_service_ends_cleanly_when_told(self):
        service = self.start_service("--simulate", "lte")
        service.send_signal(signal.SIGTERM)
        self.assertEqual(service.wait(), 0)
        self.start_service("--simulate", "lte")


    def test_folder_of_the_ports_that_cannot_be_had_is_told_and_status_1(self):
        self.environment["SPECTREL_PORT_DIR"] = self.write("plain", b"")
        for program, arguments in (("spectrel", ["watch"]), ("spectrel", ["record", self.path("r.pcap")]),
                                   ("spectrel-telephonyd", ["--simulate", "lte"])):
            done = self.run_spectrel(*arguments, program=program)
            self.assertEqual((done.returncode, done.stderr), (
                1, f"{program}: the message ports' folder cannot be had: {self.path('plain')}: "
                   "not a folder of this user\n"))

    def test_folder_too_long_for_the_names_of_ports_is_told_and_status_1(self):
        folder = self.environment["SPECTREL_PORT_DIR"] = self.path("x" * 100)
        for program, arguments in (("spectrel", ["watch"]), ("spectrel-telephonyd", ["--simulate", "lte"])):
            done = self.run_spectrel(*arguments, program=program)
            self.assertEqual((done.returncode, done.stderr), (
                1, f"{program}: the message ports' folder cannot be had: {folder}: "
                   "with a port's name the path is longer than 107 bytes\n"))


class OtherServices(Place):
    def start_example(self):
        script = os.path.join(os.path.dirname(__file__), "..", "..", "docs", "telephony-service.py")
        process = subprocess.Popen([sys.executable, script, self.path("ports")], env=self.environment)
        self.processes.append(process)
        self.wait_until(lambda: os.path.exists(self.path("ports", "org.spectrel.Telephony.LogChannel.1")),
                        "the example service did not start")
        return process

    def test_example_of_the_manual_serves_a_session(self):
        self.start_example()
        done = self.run_spectrel("watch", "--format", "json", "--count", "2")
        first, second = [json.loads(line)["Serving Cell Info"]["Physical Cell ID"] for line in done.stdout.splitlines()]
        self.assertLess(int(first), int(second))

    def test_service_that_misbehaves_is_told_and_tried_again(self):
        for answer, reason in (("peer.send(packet[:1] + b'\\3' + packet[2:12] + b'garbage')", "returns error: -11"),
                               ("peers.append(peer)", "returns error: -2"),
                               ("peer.close()", "returns error: -5")):
            with self.subTest(answer=answer):
                self.misbehave(answer, reason)

    def misbehave(self, answer, reason):
        script = self.write("service.py", MISBEHAVING_SERVICE.replace("ANSWER", answer).encode())
        process = subprocess.Popen([sys.executable, script, self.path("ports")], stdout=subprocess.PIPE, text=True)
        self.processes.append(process)
        process.stdout.readline()
        done = self.run_spectrel("watch", "--duration", "500ms")
        self.assertEqual(done.returncode, 0)
        self.assertIn("Connecting... (_RKServerConnectionNetworkMonitorCreateLogChannel " + reason, done.stderr)
        process.kill()
        process.wait()


MISBEHAVING_SERVICE = """
import os, socket, sys
os.makedirs(sys.argv[1], mode=0o700, exist_ok=True)
path = os.path.join(sys.argv[1], "org.spectrel.Telephony")
if os.path.exists(path):
    os.unlink(path)
port = socket.socket(socket.AF_UNIX, socket.SOCK_SEQPACKET)
port.bind(path)
port.listen()
print("ready", flush=True)
peers = []
while True:
    peer, _ = port.accept()
    packet = peer.recv(300000)
    ANSWER
"""


class Record(Place):
    def test_recording_decodes_to_what_was_watched(self):
        messages = [serving_cell(5), sim_files(ICCID="1"), serving_cell(7), record(0xB0C1, bytes(9)), b"\x01short"]
        replayed = self.write("a.pcap", capture(messages, step=0.01))
        self.start_service("--replay", replayed)
        done = self.run_spectrel("record", self.path("b.pcap"), "--duration", "1s")
        self.assertEqual(done.returncode, 0, done.stderr)
        with open(self.path("b.pcap"), "rb") as recorded:
            data = recorded.read()
        for message in messages[:4]:
            self.assertIn(message, data)
        decoded = [json.loads(self.run_spectrel("decode", "--format", "json", file).stdout)
                   for file in (replayed, self.path("b.pcap"))]
        self.assertEqual(decoded[0], decoded[1])

    def test_recording_the_simulator_beside_a_watch_ends_in_the_same_values(self):
        service = self.start_service("--simulate", "lte")
        recording = self.start("spectrel", "record", self.path("r.pcap"), stderr=subprocess.PIPE)
        self.wait_until(lambda: os.path.exists(self.path("r.pcap")), "the recording did not begin")
        watching = self.start_watch("--format", "json")
        for _ in range(3):
            last = self.next_line(watching)
        service.kill()
        for process in (watching, recording):
            self.assertIn("Connecting...", process.stderr.readline())
            process.send_signal(signal.SIGINT)
        self.assertEqual(recording.wait(), 0)
        shown = json.loads(self.last_line(watching) or last)
        decoded = json.loads(self.run_spectrel("decode", "--format", "json", self.path("r.pcap")).stdout)
        self.assertEqual(decoded, shown)

    def test_interrupted_recording_is_whole(self):
        self.start_service("--simulate", "lte")
        recording = self.start("spectrel", "record", self.path("r.pcap"), stderr=subprocess.PIPE)
        self.wait_until(lambda: os.path.exists(self.path("r.pcap")) and os.path.getsize(self.path("r.pcap")) > 2000,
                        "nothing was recorded")
        recording.send_signal(signal.SIGTERM)
        self.assertEqual(recording.wait(), 0)
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
        self.assertEqual(snapshot["Data"][0]["DisplayState"], serving_cell(5) + garbage)
        done = self.run_spectrel("decode", "--format", "json", "--keep-going", "--technology", "lte", path)
        self.assertEqual(json.loads(done.stdout)["Serving Cell Info"]["Physical Cell ID"], "5")


if __name__ == "__main__":
    unittest.main()
