"""UTRAN: its template, found among the resources, and the diagnostic log of its radio resource control."""

import glob
import json
import os
import plistlib
import unittest

from harness import Place, capture, record


def mode(number, valid=1):
    """A 0xD0E0 record that tells this mode."""
    return record(0xD0E0, bytes([valid, number]))


RRC = {"RRC Info": {"State": "-"}}


class UTRAN(Place):
    def template(self, name, content):
        path = self.path("resources", name)
        os.makedirs(os.path.dirname(path), exist_ok=True)
        with open(path, "wb") as file:
            plistlib.dump(content, file, sort_keys=False)

    def decode(self, messages, *arguments):
        os.makedirs(self.path("resources"), exist_ok=True)
        done = self.run_spectrel("decode", "--format", "json", "--resources", self.path("resources"), *arguments,
                                 self.write("a.pcap", capture(messages, technology="utran")))
        self.assertEqual(done.returncode, 0, done.stderr)
        return json.loads(done.stdout)

    def test_first_template_of_the_name_in_any_case_is_taken(self):
        self.template("a.plist", {"Wrong": "a"})
        self.template("My-uTrAn.2.plist", RRC)
        self.template("UTRAN.plist", {"Wrong": "b"})
        self.assertEqual(self.decode([mode(3)]), {"RRC Info": {"State": "Cell DCH"}})

    def test_template_of_another_kind_of_file_is_none(self):
        self.template("UTRAN.txt", RRC)
        self.assertEqual(self.decode([mode(3)]), "(unknown)")

    def test_without_a_template_records_are_kept_and_nothing_is_shown(self):
        self.template("LTE.plist", RRC)
        messages = [mode(3), record(0xD0E2, bytes(13))]
        self.assertEqual(self.decode(messages, "--log", self.path("log"), "--snapshot", self.path("out")), "(unknown)")
        with open(self.path("log"), encoding="utf-8") as log:
            lines = log.read().splitlines()
        self.assertEqual(set(lines[:-1]), {"<3>Cannot load template for display"}, "no section is there to log")
        [path] = glob.glob(self.path("out", "*.spectrel"))
        with open(path, "rb") as file:
            contents = plistlib.load(file)["Data"]
        self.assertEqual(contents[0], {}, "the raw messages are nowhere collected")
        self.assertTrue(contents[-1]["Description"].startswith("DLF binary ("))

    def test_diagnostic_log_has_one_line_for_each_radio_resource_control_record(self):
        self.template("UTRAN.plist", RRC)
        self.environment["SPECTREL_DIAGNOSTIC_LOG"] = self.path("diagnostics")
        self.decode([mode(3), record(0xD0E2, bytes(13)), mode(3, valid=0), record(0xD0E0, bytes([1]))],
                    "--log", self.path("log"))
        with open(self.path("diagnostics"), encoding="utf-8") as diagnostics:
            lines = [line.partition("Display Dict")[2] for line in diagnostics.read().splitlines()]
        self.assertEqual(lines, [' = {"State": "Cell DCH"}, rrc mode = 3 Cell DCH',
                                 ' = {"State": "Unknown RRC Mode"}, rrc mode = 255 Unknown RRC Mode',
                                 ' = {"State": "Disconnected"}, rrc mode = 0 Disconnected'])
        with open(self.path("log"), encoding="utf-8") as log:
            text = log.read()
        self.assertNotIn("Display Dict", text)
        self.assertIn("<4>LogCode_0xD0E0 is length is 14 expected size 15\n", text)


if __name__ == "__main__":
    unittest.main()
