"""What the telephony service says of itself, and how it gets on with a service manager."""

import json
import os
import signal
import socket
import subprocess
import time
import unittest

from harness import BIN, WAIT, Place, capture, serving_cell

TOP = os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "..")


class Status(Place):
    def test_usr1_tells_what_is_streamed_to_whom(self):
        service = self.start_service("--simulate", "lte")
        watching = self.start_watch("--format", "json")
        self.next_line(watching)
        service.send_signal(signal.SIGUSR1)
        self.wait_told("a simulated lte baseband; 1 client, ")
        self.assertRegex(self.told(), r"channel 1 to org\.spectrel\.Watch\.\d+: \d+ codes, [\d.]+ messages/s, \d+ sent"
                                     r".*, 0 queued")

    def test_regular_report_comes_with_news_and_is_quiet_without(self):
        file = self.write("a.pcap", capture([serving_cell(1)]))
        self.start_service("--replay", file, "--speed", "0", "--status", "100ms")
        watching = self.start_watch("--format", "json")
        self.next_line(watching)
        self.wait_told("; 1 client, ")
        watching.terminate()
        self.wait_told("is gone, after 1 messages")
        lines = len(self.told().splitlines())
        time.sleep(0.5)
        self.assertLessEqual(len(self.told().splitlines()), lines + 1, "one report of the client's leaving")


class ServiceManager(Place):
    def notifications(self):
        listener = socket.socket(socket.AF_UNIX, socket.SOCK_DGRAM)
        self.addCleanup(listener.close)
        listener.bind(self.path("notify"))
        listener.settimeout(WAIT)
        self.environment["NOTIFY_SOCKET"] = self.path("notify")
        return listener

    def test_readiness_status_and_end_are_notified(self):
        listener = self.notifications()
        service = self.start_service("--simulate", "lte")
        self.assertEqual(listener.recv(4096), b"READY=1\nSTATUS=a simulated lte baseband; 0 clients\n")
        watching = self.start_watch("--format", "json")
        self.assertIn(b"STATUS=a simulated lte baseband; 1 client", listener.recv(4096))
        watching.kill()
        self.assertIn(b"; 0 clients", listener.recv(4096))
        service.terminate()
        self.assertEqual(listener.recv(4096), b"STOPPING=1\n")
        self.assertEqual(service.wait(WAIT), 0)

    def activate(self, port):
        """The service manager's part: listens at the port and becomes the service once a client comes."""
        activator = self.run_background(
            ["systemd-socket-activate", "--seqpacket", "--listen", port,
             "-E", "SPECTREL_PORT_DIR=" + self.path("ports"), os.path.join(BIN, "spectrel-telephonyd"),
             "--simulate", "lte"],
            stderr=subprocess.PIPE)
        self.wait_for_line(activator, "Listening on")
        return activator

    def test_first_client_starts_the_service_and_the_socket_stays(self):
        os.mkdir(self.path("ports"), 0o700)
        port = self.path("ports", "org.spectrel.Telephony")
        activator = self.activate(port)
        done = self.run_spectrel("watch", "--format", "json", "--count", "1")
        self.assertIn("Serving Cell Info", json.loads(done.stdout))
        activator.terminate()  # by now it is the service
        self.assertEqual(activator.wait(WAIT), 0)
        self.assertTrue(os.path.exists(port), "the socket belongs to the service manager")

    def test_socket_in_the_wrong_place_is_refused(self):
        activator = self.activate(self.path("elsewhere"))
        with socket.socket(socket.AF_UNIX, socket.SOCK_SEQPACKET) as client:
            client.connect(self.path("elsewhere"))
            self.wait_for_line(activator, "clients look for it at")
            self.assertEqual(activator.wait(WAIT), 1)

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
