"""The live session over real message ports: what watch shows of this service and of others."""

import json
import os
import signal
import subprocess
import sys
import unittest

from harness import LTE_SECTIONS, WAIT, Place, capture, serving_cell


class Watch(Place):
    def displays(self, done):
        return [json.loads(line) for line in done.stdout.splitlines()]

    def test_simulated_values_arrive_and_change(self):
        self.start_service("--simulate", "lte")
        watching = self.start_watch("--format", "json")
        first = self.watch_until(watching, lambda display: display["Serving Cell Info"]["Physical Cell ID"] != "-"
                                 and display["SIM Info"]["EF-ICCID"] != "-" and display["PDP Context Info"])
        self.assertEqual(list(first), LTE_SECTIONS)
        self.watch_until(watching, lambda display: display != first)

    def test_without_terminal_and_display_the_program_watches(self):
        self.start_service("--replay", self.write("a.pcap", capture([serving_cell(5)])), "--speed", "0")
        process = self.start("spectrel", stdout=subprocess.PIPE, stderr=subprocess.PIPE)
        self.assertEqual(self.next_line(process), "Serving Cell Info\n")
        self.assertEqual(self.next_line(process), "  Physical Cell ID: 5\n")
        process.send_signal(signal.SIGINT)
        self.assertEqual(process.wait(WAIT), 0)

    def test_changes_count_the_refreshes(self):
        messages = [serving_cell(number) for number in range(1, 1000)]
        self.start_service("--replay", self.write("a.pcap", capture(messages, step=0.2)))
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


class Ports(Place):
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
        self.run_background([sys.executable, script, self.path("ports")])
        self.wait_until(lambda: os.path.exists(self.path("ports", "org.spectrel.Telephony.LogChannel.1")),
                        "the example service did not start")

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
        process = self.run_background([sys.executable, script, self.path("ports")], stdout=subprocess.PIPE)
        self.next_line(process)
        watching = self.start_watch()
        self.wait_for_line(watching, f"Connecting... (_RKServerConnectionNetworkMonitorCreateLogChannel {reason})")
        watching.send_signal(signal.SIGINT)
        self.assertEqual(watching.wait(WAIT), 0)
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


if __name__ == "__main__":
    unittest.main()
