"""CDMA2000 and the dictionary-reporting baseband: recordings, snapshots, DLF, and services that come and go."""

import glob
import json
import os
import plistlib
import signal
import struct
import unittest

from harness import Place, capture, record


def air_link(channel, kind=1, size=50):
    """A 0x1183 record that tells this channel."""
    body = record(0x1183, bytes([channel]) + bytes(size - 14))
    return bytes([kind]) + body[1:]


def forward_data(sequence, packets):
    """A 0x1192 record: that many packets of 128 bits up to this second."""
    return record(0x1192, struct.pack("<II", sequence, packets) + bytes(220))


def system_information(system):
    payload = bytearray(173)
    payload[0] = 2
    struct.pack_into("<IHH", payload, 33, 2, system, 1)
    return record(0x134F, bytes(payload))


def report(**content):
    return plistlib.dumps(content, sort_keys=False)


class Baseband(Place):
    def display(self, *arguments):
        done = self.run_spectrel("decode", "--format", "json", *arguments)
        self.assertEqual(done.returncode, 0, done.stderr)
        return json.loads(done.stdout)

    def recording(self, messages, technology, **options):
        return self.write("a.pcap", capture(messages, technology=technology, **options))

    def simulated(self, technology, duration):
        done = self.run_spectrel("--simulate", technology, "--write", self.path("a.pcap"), "--duration", duration,
                                 program="spectrel-telephonyd")
        self.assertEqual(done.returncode, 0, done.stderr)
        return self.path("a.pcap")

    def snapshot(self, file):
        """The path and the content of a snapshot of the recording."""
        done = self.run_spectrel("decode", "--format", "none", "--snapshot", self.path("out"), file)
        self.assertEqual(done.returncode, 0, done.stderr)
        [path] = glob.glob(self.path("out", "*.spectrel"))
        with open(path, "rb") as snapshot:
            return path, plistlib.load(snapshot)

    def log(self, file):
        self.run_spectrel("decode", "--format", "none", "--log", self.path("log"), file)
        with open(self.path("log"), encoding="utf-8") as log:
            return log.read().splitlines()

    def replay(self, name, messages, technology):
        return self.start_service("--replay", self.write(name, capture(messages, technology=technology)),
                                  "--speed", "0")


class CDMA(Baseband):
    def test_snapshot_and_dlf_of_a_drive_decode_to_its_display(self):
        file = self.simulated("cdma", "9s")  # as much as five refreshes hold
        path, snapshot = self.snapshot(file)
        expected = self.display(file)
        self.assertNotEqual(expected["EV-DO"]["Forward Rate"], "")
        self.assertEqual(self.display("--technology", "cdma", path), expected)
        self.assertTrue(snapshot["Data"][-1]["Description"].startswith("DLF binary ("))
        dlf = self.write("a.dlf", snapshot["Data"][-1]["DLF"])
        self.assertEqual(self.display("--technology", "cdma", dlf), expected)

    def test_snapshot_holds_the_records_without_wrappers_and_only_known_codes(self):
        shortest = b"\x01" + struct.pack("<HH", 10, 0x1183) + bytes(6)  # 11 bytes, 13 with its wrapper
        messages = [air_link(7), b"\x81\x00" + air_link(8), record(0x1234, b"unknown"), b"short", air_link(9, kind=2),
                    record(0x1183, b"refused"), b"\x81\x2a" + shortest, air_link(11)]
        file = self.recording(messages, "cdma", step=0.1)
        path, snapshot = self.snapshot(file)
        kept = [air_link(7), air_link(8), air_link(9, kind=2), record(0x1183, b"refused"), shortest, air_link(11)]
        self.assertEqual(snapshot["Data"][0]["DisplayState"], b"".join(kept))
        expected = self.display(file)
        self.assertEqual(expected["EV-DO"]["Channel"], "11")
        self.assertEqual(self.display("--technology", "cdma", path), expected)
        dlf = self.write("a.dlf", snapshot["Data"][-1]["DLF"])
        self.assertEqual(self.display("--technology", "cdma", dlf), expected)

    def test_records_of_a_wrong_type_are_cut_wherever_they_stand(self):
        for messages in ([air_link(1, kind=2), air_link(2)], [air_link(1), air_link(2, kind=2)],
                         [air_link(1), air_link(2, kind=9), air_link(3)], [air_link(4, kind=2)]):
            with self.subTest(messages=len(messages)):
                file = self.recording(messages, "cdma", step=3)
                path, snapshot = self.snapshot(file)
                self.assertEqual(b"".join(entry["DisplayState"] for entry in snapshot["Data"][:-1]),
                                 b"".join(messages))
                self.assertEqual(self.display("--technology", "cdma", path), self.display(file))
                dlf = self.write("a.dlf", snapshot["Data"][-1]["DLF"])
                self.assertEqual(self.display("--technology", "cdma", dlf), self.display(file))
                os.remove(path)

    def test_log_lines_come_in_order(self):
        lines = self.log(self.recording(
            [air_link(1, kind=2), air_link(1, size=49), record(0x119D, bytes(4)), record(0x119C, bytes(3))], "cdma"))
        self.assertEqual(lines[0].split(": 0x")[0], "<4>Creating Log object")
        self.assertEqual([line for line in lines[1:] if line != "<4>Processing the template"], [
            "<3>Invalid log type: 2. Dropping.",
            "<3>Log code 0x1183 is 49 bytes long but should be 50 bytes.",
            "<4>Log code 0x119d: missing traffic demod subpacket.",
            "<3>Log code 0x119c is 16 bytes long but must be at least 17 bytes.",
        ])

    def test_endless_and_escaping_subpackets_end(self):
        endless = bytes([1, 255, 0, 0]) + bytes(40)
        escaping = bytes([1, 255, 0, 0]) + bytes([9, 0, 0xFF, 0xFF])
        file = self.recording([record(code, chain) for code in (0x119C, 0x119D) for chain in (endless, escaping)],
                              "cdma")
        self.assertEqual(self.log(file).count("<3>Log code error in subpkt#0: bad size (65535)."), 5)

    def test_session_goes_on_with_display_and_counters_after_a_restart(self):
        service = self.replay("a.pcap", [forward_data(1, 0), system_information(4139)], "cdma")
        watching = self.start_watch("--format", "json")
        self.watch_until(watching, lambda display: display["1x"]["System"]["System ID"] == "4139")
        service.send_signal(signal.SIGKILL)
        service.wait()
        self.replay("b.pcap", [forward_data(3, 800), air_link(5)], "cdma")
        after = self.watch_until(watching, lambda display: display["EV-DO"]["Channel"] == "5")
        self.assertEqual(after["EV-DO"]["Forward Rate"], "50.00 kbps", "counted from before the restart")
        self.assertEqual(after["1x"]["System"]["System ID"], "4139")

    def test_replayed_drive_is_watched_as_it_decodes(self):
        file = self.simulated("cdma", "2m")
        self.start_service("--replay", file, "--speed", "0")
        expected = self.display(file)
        watching = self.start_watch("--format", "json")
        self.watch_until(watching, lambda display: display == expected)


class IFX(Baseband):
    def test_collapsing_is_shown(self):
        file = self.recording([report(Cell={"ARFCN": "12"}, A={"B": {"C": "x"}}, List=["a", "b", {"k": "c"}])], "ifx")
        self.assertEqual(self.display(file), {"Cell": "12", "A": "x", "List": ["b", "c"]})

    def test_binary_report_is_shown(self):
        file = self.recording([plistlib.dumps({"A": {"B": "x"}}, fmt=plistlib.FMT_BINARY)], "ifx")
        self.assertEqual(self.display(file), {"A": "x"})

    def test_snapshot_of_a_drive_tells_its_technology_and_decodes_to_its_display(self):
        file = self.simulated("ifx", "1m")
        path, snapshot = self.snapshot(file)
        self.assertEqual(len(snapshot["Data"]), 5, "no DLF")
        self.assertEqual(self.display(path), self.display(file))
        entry = snapshot["Data"][-1]
        self.assertEqual(list(entry), ["DisplayState", "Display", "ExtraInfo", "Date", "Description"])
        self.assertIn("Neighbours, strongest first", entry["DisplayState"]["Neighbour Cells"])

    def test_each_entry_is_one_message(self):
        reports = [report(Number=str(number), Same={"a": "1", "b": "2"}) for number in range(3)]
        path, _ = self.snapshot(self.recording(reports, "ifx", step=2.5))
        done = self.run_spectrel("decode", "--format", "json", "--each", path)
        self.assertEqual([json.loads(line)["display"]["Number"] for line in done.stdout.splitlines()], ["0", "1", "2"])

    def test_report_with_other_types_survives_the_snapshot(self):
        content = {"Text": "x", "Number": 5, "Real": 0.5, "Truth": True, "Data": b"\x00\xff", "List": ["h", 6, "y"]}
        file = self.recording([plistlib.dumps(content, sort_keys=False)], "ifx")
        path, snapshot = self.snapshot(file)
        self.assertEqual(snapshot["Data"][0]["DisplayState"], content)
        self.assertEqual(self.display(file), {"Text": "x", "List": ["y"]})
        self.assertEqual(self.display(path), {"Text": "x", "List": ["y"]})

    def test_failed_assertions_are_logged_and_the_session_goes_on(self):
        file = self.recording([report(A="x"), b"<plist>", report(A="y", N=5)], "ifx")
        lines = self.log(file)
        self.assertEqual(lines[1:], ["<3>Could not deserialize the object (LogGenerator/GSM/GSMLogGenerator:90)",
                                     "<3>Unknown object of type integer encountered (LogGenerator/GSM/GSMLogGenerator:78)"])
        self.assertEqual(self.display(file), {"A": "y"})
        done = self.run_spectrel("decode", "--format", "json", "--each", file)
        self.assertEqual([json.loads(line)["display"] for line in done.stdout.splitlines()],
                         [{"A": "x"}, "(unknown)", {"A": "y"}])

    def test_undecodable_message_leaves_an_empty_entry_in_the_snapshot(self):
        path, snapshot = self.snapshot(self.recording([report(A="x"), b"<plist>"], "ifx", step=3))
        self.assertEqual([sorted(entry) for entry in snapshot["Data"]],
                         [["Date", "Description", "Display", "DisplayState", "ExtraInfo"], []])
        self.assertEqual(self.display(path), {"A": "x"})

    def test_session_keeps_its_display_over_a_restart_until_the_next_report(self):
        service = self.replay("a.pcap", [report(A="x", B="y")], "ifx")
        watching = self.start_watch("--format", "json")
        self.assertEqual(json.loads(self.next_line(watching)), {"A": "x", "B": "y"})
        service.send_signal(signal.SIGKILL)
        service.wait()
        self.replay("b.pcap", [report(B="z", C="1")], "ifx")
        self.assertEqual(json.loads(self.next_line(watching)), {"B": "z", "C": "1"})

    def test_other_technology_starts_with_its_own_display(self):
        service = self.replay("a.pcap", [report(A="x", B="y")], "ifx")
        watching = self.start_watch("--format", "json")
        self.assertEqual(json.loads(self.next_line(watching)), {"A": "x", "B": "y"})
        service.send_signal(signal.SIGKILL)
        service.wait()
        self.replay("b.pcap", [air_link(5)], "cdma")
        after = json.loads(self.next_line(watching))
        self.assertEqual(list(after), ["Summary", "1x", "EV-DO"])
        self.assertEqual(after["EV-DO"]["Channel"], "5")

    def test_replayed_drive_is_watched_as_it_decodes(self):
        file = self.simulated("ifx", "1m")
        self.start_service("--replay", file, "--speed", "0")
        expected = self.display(file)
        watching = self.start_watch("--format", "json")
        self.watch_until(watching, lambda display: display == expected)


if __name__ == "__main__":
    unittest.main()
