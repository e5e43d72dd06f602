"""The simulated basebands: written without waiting, and streamed."""

import json
import os
import subprocess
import unittest

from harness import BIN, WAIT, Place

TECHNOLOGIES = ("lte", "gsm", "utran", "cdma", "ifx")


def leaves(display):
    if isinstance(display, dict):
        return [leaf for value in display.values() for leaf in leaves(value)]
    if isinstance(display, list):
        return [leaf for value in display for leaf in leaves(value)]
    return [display]


class Simulate(Place):
    def service(self, *arguments):
        return self.run_spectrel(*arguments, program="spectrel-telephonyd")

    def written(self, name, *arguments):
        done = self.service(*arguments, "--write", self.path(name))
        self.assertEqual((done.returncode, done.stdout, done.stderr), (0, "", ""))
        with open(self.path(name), "rb") as file:
            return file.read()

    def test_same_options_write_the_same_bytes(self):
        for technology in TECHNOLOGIES:
            with self.subTest(technology=technology):
                options = ("--simulate", technology, "--seed", "3", "--duration", "2m")
                self.assertEqual(self.written("a.pcap", *options), self.written("b.pcap", *options))

    def test_every_scene_decodes_cleanly(self):
        for technology in TECHNOLOGIES:
            for scene in ("still", "walk", "drive", "stress", "handover", "tunnel", "ping-pong", "overshoot"):
                with self.subTest(technology=technology, scene=scene):
                    self.written("a.pcap", "--simulate", technology, "--scene", scene, "--duration", "30s")
                    done = self.run_spectrel("decode", "--format", "none", self.path("a.pcap"))
                    self.assertEqual(done.returncode, 0, done.stderr)

    def test_long_drive_decodes_to_values(self):
        for technology in TECHNOLOGIES:
            with self.subTest(technology=technology):
                self.written("a.pcap", "--simulate", technology, "--duration", "30m")
                done = self.run_spectrel("decode", "--format", "json", self.path("a.pcap"))
                self.assertEqual(done.returncode, 0, done.stderr)
                values = leaves(json.loads(done.stdout))
                self.assertGreater(sum(value != "-" for value in values), len(values) / 2)

    def test_live_values_arrive_and_change(self):
        watches = {}
        for technology in TECHNOLOGIES:  # at once, each in a place of its own
            self.environment["SPECTREL_PORT_DIR"] = self.path(technology)
            self.start_service("--simulate", technology, "--rate", "5")
            watches[technology] = self.start_watch("--format", "json")
        for technology, watching in watches.items():
            with self.subTest(technology=technology):
                first = json.loads(self.next_line(watching))
                self.watch_until(watching, lambda display: display != first)

    def test_file_that_cannot_be_written_is_named(self):
        path = self.path("no", "such", "folder")
        done = self.service("--simulate", "lte", "--write", path)
        self.assertEqual((done.returncode, done.stderr),
                         (1, f"spectrel-telephonyd: {path}: No such file or directory\n"))

    def test_full_disk_is_told(self):
        if os.path.exists("/dev/full"):
            done = self.service("--simulate", "lte", "--write", "/dev/full", "--duration", "10m")
            self.assertEqual((done.returncode, done.stderr),
                             (1, "spectrel-telephonyd: /dev/full: No space left on device\n"))

    def test_rejected_registration_is_shown(self):
        self.written("a.pcap", "--simulate", "gsm", "--scene", "rejected", "--duration", "10m")
        done = self.run_spectrel("decode", "--format", "changes", self.path("a.pcap"))
        self.assertEqual(done.returncode, 0, done.stderr)
        for value in ("MM_LOCATION_UPDATE_REJECTED", "MM_LIMITED_SERVICE", "LOCATION_AREA_NOT_ALLOWED",
                      "GMM_GU3_ROUTING_AREA_NOT_ALLOWED"):
            self.assertIn(f'"value": "{value}"', done.stdout)

    def test_journey_goes_on_in_further_files(self):
        self.written("a.pcap", "--simulate", "lte", "--scene", "journey", "--duration", "3m", "--truth",
                     self.path("truth"))
        files = sorted(name for name in os.listdir(self.folder) if name.endswith(".pcap"))
        self.assertLessEqual({"a.pcap", "a-2.pcap", "a-3.pcap"}, set(files))
        for name in files:
            done = self.run_spectrel("decode", "--format", "none", self.path(name))
            self.assertEqual(done.returncode, 0, done.stderr)
        with open(self.path("truth"), encoding="utf-8") as file:
            radios = [json.loads(line)["to"]["technology"] for line in file]
        self.assertEqual({"lte", "umts", "gsm"}, set(radios))

    def test_journey_on_standard_output_ends_with_the_technology(self):
        with open(self.path("a.pcap"), "wb") as file:
            process = self.run_background(
                [os.path.join(BIN, "spectrel-telephonyd"), "--simulate", "lte", "--scene", "journey", "--duration",
                 "3m", "--write", "-"], stdout=file, stderr=subprocess.PIPE)
            _, complaint = process.communicate(timeout=WAIT)
        self.assertEqual((process.returncode, complaint), (
            1, "spectrel-telephonyd: -: standard output holds the messages of one technology only\n"))
        self.assertEqual(self.run_spectrel("decode", "--format", "none", self.path("a.pcap")).returncode, 0)

    def test_live_journey_has_clients_ask_anew(self):
        self.start_service("--simulate", "lte", "--scene", "journey", "--rate", "20")
        done = self.run_spectrel("record", self.path("live.pcap"), "--duration", "20s")
        self.assertEqual(done.returncode, 0, done.stderr)
        self.assertTrue(os.path.exists(self.path("live-2.pcap")))

    def test_scene_that_a_technology_lacks_is_told(self):
        for technology, scene, there in (("lte", "rejected", "gsm"), ("cdma", "journey", "lte, gsm, utran")):
            done = self.service("--simulate", technology, "--scene", scene)
            self.assertEqual((done.returncode, done.stderr), (
                2, f"spectrel-telephonyd: --scene: '{scene}' is there for {there}, not for {technology} "
                   "(see spectrel-telephonyd --help)\n"))

    def truth(self, name, *arguments):
        self.written(name, *arguments, "--truth", self.path(name + ".truth"))
        with open(self.path(name + ".truth"), encoding="utf-8") as file:
            return [json.loads(line) for line in file]

    def test_truth_names_each_move_and_its_cause(self):
        kinds = {"reselection", "handover", "redirection", "service-lost"}
        rules = {"higher-priority", "equal-priority", "lower-priority", "not-suitable"}
        for technology in TECHNOLOGIES:
            with self.subTest(technology=technology):
                moves = self.truth("a.pcap", "--simulate", technology, "--seed", "4", "--duration", "20m")
                times = [move["time"] for move in moves]
                self.assertEqual(times, sorted(times))
                first, *others = [move for move in moves if move["to"]["technology"] != "evdo"]
                self.assertEqual(set(first), {"time", "to"})
                self.assertTrue(others)
                for previous, move in zip([first, *others], others):
                    self.assertEqual(list(move), ["time", "from", "to", "cause"])
                    self.assertEqual(list(move["to"]), ["technology", "channel", "id", "cell"])
                    self.assertEqual(move["from"], previous["to"])
                    self.assertIn(move["cause"]["kind"], kinds)
                    if move["cause"]["kind"] == "reselection":
                        self.assertIn(move["cause"]["rule"], rules)
                    else:
                        self.assertNotIn("rule", move["cause"])

    def test_truth_leaves_the_recording_as_it_is(self):
        options = ("--simulate", "gsm", "--duration", "2m")
        plain = self.written("a.pcap", *options)
        self.assertEqual(self.written("b.pcap", *options, "--truth", self.path("truth")), plain)

    def test_truth_that_cannot_be_written_is_named(self):
        options = ("--simulate", "lte", "--write", self.path("a.pcap"), "--truth")
        done = self.service(*options, self.path("no", "such", "folder"))
        self.assertEqual((done.returncode, done.stderr),
                         (1, f"spectrel-telephonyd: {self.path('no', 'such', 'folder')}: No such file or directory\n"))
        if os.path.exists("/dev/full"):
            done = self.service(*options, "/dev/full")
            self.assertEqual((done.returncode, done.stderr),
                             (1, "spectrel-telephonyd: /dev/full: No space left on device\n"))

    def test_wrong_use_is_told(self):
        for arguments in (["--simulate", "lte", "--scene", "fly"], ["--write", "a.pcap"],
                          ["--simulate", "lte", "--duration", "5m"],
                          ["--simulate", "lte", "--truth", "a.truth"],
                          ["--simulate", "lte", "--write", "a", "--duration", "soon"],
                          ["--simulate", "lte", "--write", "a", "--rate", "2"]):
            with self.subTest(arguments=arguments):
                done = self.service(*arguments)
                self.assertEqual(done.returncode, 2)
                self.assertIn("see spectrel-telephonyd --help", done.stderr)


if __name__ == "__main__":
    unittest.main()
