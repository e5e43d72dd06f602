"""A telephony service that comes and goes under a live session."""

import json
import signal
import unittest

from harness import WAIT, Place, capture, serving_cell, shows_cell, sim_files


class Restart(Place):
    def test_session_outlives_a_killed_service(self):
        service = self.start_service("--replay", self.write("a.pcap", capture([serving_cell(5), sim_files(ICCID="1")])),
                                     "--speed", "0")
        watching = self.start_watch("--format", "json")
        before = self.watch_until(watching, lambda display: display["SIM Info"].get("EF-ICCID") == "1")
        self.assertEqual(before["Serving Cell Info"]["Physical Cell ID"], "5")
        service.kill()
        service.wait()
        self.wait_for_line(watching, "Connecting...")
        self.start_service("--replay", self.write("b.pcap", capture([serving_cell(6)])), "--speed", "0")
        after = self.watch_until(watching, shows_cell(6))
        self.assertEqual(after["SIM Info"]["EF-ICCID"], "1", "values from before the restart stay")

    def test_service_may_return_with_another_technology(self):
        service = self.start_service("--replay", self.write("a.pcap", capture([serving_cell(5)])), "--speed", "0")
        watching = self.start_watch("--format", "json")
        self.assertIn("Serving Cell Info", json.loads(self.next_line(watching)))
        service.kill()
        service.wait()
        self.start_service("--replay", self.write("b.pcap", capture([sim_files(ICCID="2")], technology="gsm")),
                           "--speed", "0")
        after = self.watch_until(watching, lambda display: display["SIM Info"].get("EF-ICCID") == "2")
        self.assertNotIn("Serving Cell Info", after)

    def test_second_service_on_the_same_ports_is_refused(self):
        self.start_service("--simulate", "lte")
        second = self.run_spectrel("--simulate", "lte", program="spectrel-telephonyd")
        self.assertEqual(second.returncode, 1)
        self.assertTrue(second.stderr)

    def test_service_ends_cleanly_when_told(self):
        service = self.start_service("--simulate", "lte")
        service.send_signal(signal.SIGTERM)
        self.assertEqual(service.wait(WAIT), 0)
        self.start_service("--simulate", "lte")


if __name__ == "__main__":
    unittest.main()
