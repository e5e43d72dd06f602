"""spectrel decode on captures, snapshots and DLF files."""

import csv
import glob
import io
import json
import os
import plistlib
import subprocess
import unittest

from harness import BIN, Place, capture, cell_information, record, serving_cell, sim_files


class Decode(Place):
    def decode(self, *arguments):
        return self.run_spectrel("decode", *arguments)

    def display(self, *arguments):
        done = self.decode("--format", "json", *arguments)
        self.assertEqual(done.returncode, 0, done.stderr)
        return json.loads(done.stdout)

    def changes(self, *arguments):
        done = self.decode("--format", "changes", *arguments)
        self.assertEqual(done.returncode, 0, done.stderr)
        return [json.loads(line) for line in done.stdout.splitlines()]


class Formats(Decode):
    def test_json_is_the_display_after_the_last_message(self):
        file = self.write("a.pcap", capture([serving_cell(5), serving_cell(6, 6300), sim_files(ICCID="8900")]))
        display = self.display(file)
        self.assertEqual(len(display), 11)
        self.assertEqual(list(display)[0], "Serving Cell Info")
        self.assertEqual(list(display)[-2:], ["PDP Context Info", "SIM Info"])
        self.assertEqual(display["Serving Cell Info"]["Physical Cell ID"], "6")
        self.assertEqual(display["Serving Cell Info"]["Download Frequency"], "6300")
        self.assertEqual(display["SIM Info"]["EF-ICCID"], "8900")
        self.assertEqual(display["PDP Context Info"], [])

    def test_json_of_no_message_at_all_is_unknown(self):
        file = self.write("a.pcap", capture([]))
        self.assertEqual(self.display(file), "(unknown)")

    def test_each_numbers_the_messages_from_zero(self):
        file = self.write("a.pcap", capture([serving_cell(5), b"short", serving_cell(6)]))
        done = self.decode("--format", "json", "--each", file)
        lines = [json.loads(line) for line in done.stdout.splitlines()]
        self.assertEqual([line["n"] for line in lines], [0, 1, 2])
        self.assertEqual([line["display"]["Serving Cell Info"]["Physical Cell ID"] for line in lines], ["5", "5", "6"])
        self.assertTrue(done.stdout.startswith('{"n": 0, "display": '))

    def test_changes_are_one_line_a_leaf(self):
        file = self.write("a.pcap", capture([
            (1733000000.123456, cell_information(TAC=1, CellId=2, PID=3, BandInfo=4, UARFCN=5)),
            (1733000001.5, serving_cell(3)),
        ]))
        done = self.decode("--format", "changes", file)
        self.assertIn('{"n": 0, "time": 1733000000.123456, "path": "/Serving Cell Info/UARFCN", "value": "5"}\n',
                      done.stdout)
        second = [change for change in map(json.loads, done.stdout.splitlines()) if change["n"] == 1]
        self.assertNotIn("/Serving Cell Info/Physical Cell ID", [change["path"] for change in second])
        self.assertIn({"n": 1, "time": 1733000001.5, "path": "/Serving Cell Info/UARFCN", "value": None}, second)
        self.assertIn('"time": 1733000001.500000, "path": "/Serving Cell Info/UARFCN", "value": null}', done.stdout)

    def test_changes_add_up_to_the_display(self):
        file = self.write("a.pcap", capture(
            [sim_files(ICCID="1"), serving_cell(3), cell_information(TAC=1, UARFCN=9),
             record(0xFF0002, plistlib.dumps([{"APN": "a"}, {"APN": "b"}])),
             record(0xFF0002, plistlib.dumps([{"APN": "b"}])), serving_cell(4)]))
        leaves = {}
        for change in self.changes(file):
            leaves[change["path"]] = change["value"]
        shown = {path: value for path, value in leaves.items() if value is not None}

        def flatten(value, path):
            if isinstance(value, str):
                return {path: value}
            items = value.items() if isinstance(value, dict) else enumerate(value)
            flat = {}
            for name, child in items:
                flat.update(flatten(child, f"{path}/{name}"))
            return flat

        self.assertEqual(shown, flatten(self.display(file), ""))

    def test_csv_is_the_same_as_changes(self):
        context = {"APN": 'a "quoted", text', "Lines": "one\ntwo"}
        file = self.write("a.pcap", capture([record(0xFF0002, plistlib.dumps([context])), serving_cell(3)]))
        done = self.run_bytes("decode", "--format", "csv", file)
        self.assertTrue(done.startswith(b"n,time,path,value\r\n"))
        rows = list(csv.reader(io.StringIO(done.decode(), newline="")))[1:]
        changes = self.changes(file)
        self.assertEqual([(row[0], row[2], row[3]) for row in rows],
                         [(str(change["n"]), change["path"], change["value"] or "") for change in changes])

    def run_bytes(self, *arguments):
        return subprocess.run([os.path.join(BIN, "spectrel"), *arguments], env=self.environment, check=True,
                              stdout=subprocess.PIPE, stderr=subprocess.DEVNULL).stdout

    def test_tree_is_indented(self):
        file = self.write("a.pcap", capture([serving_cell(5)]))
        lines = self.decode(file).stdout.splitlines()
        self.assertEqual(lines[0:2], ["Serving Cell Info", "  Physical Cell ID: 5"])

    def test_none_prints_nothing(self):
        file = self.write("a.pcap", capture([serving_cell(5)]))
        self.assertEqual(self.decode("--format", "none", file).stdout, "")

    def test_values_that_are_no_text_are_unknown(self):
        file = self.write("a.pcap", capture([record(0xFF0002, plistlib.dumps([5, {"n": True}]))]))
        self.assertEqual(self.display(file)["PDP Context Info"], ["(unknown)", {"n": "(unknown)"}])

    def test_several_files_are_one_session(self):
        first = self.write("a.pcap", capture([serving_cell(5)]))
        second = self.write("b.pcap", capture([sim_files(ICCID="2")]))
        display = self.display(first, second)
        self.assertEqual(display["Serving Cell Info"]["Physical Cell ID"], "5")
        self.assertEqual(display["SIM Info"]["EF-ICCID"], "2")

    def test_dash_is_standard_input(self):
        recording = capture([serving_cell(5), serving_cell(6)])
        for given, status, complaint in ((recording, 0, ""), (recording[:-3], 1, "spectrel: standard input: message 1 ")):
            done = subprocess.run([os.path.join(BIN, "spectrel"), "decode", "--format", "json", "-"], input=given,
                                  env=self.environment, capture_output=True)
            self.assertEqual(done.returncode, status)
            self.assertEqual(json.loads(done.stdout)["Serving Cell Info"]["Physical Cell ID"], "56"[1 - status])
            self.assertIn(complaint, done.stderr.decode())

    def test_console_lines_go_to_standard_error(self):
        done = self.decode(self.write("a.pcap", capture([serving_cell()])))
        self.assertIn("Deallocing LTEClassIndex\nDeallocing ClassIndex\n", done.stderr)
        self.assertNotIn("Deallocing", done.stdout)

    def test_log_holds_every_line_in_order_with_control_characters_escaped(self):
        file = self.write("a.pcap", capture([record(0xB0C1, bytes(9)), cell_information(TAC=1)]))
        self.decode("--log", self.path("log"), file)
        with open(self.path("log")) as log:
            lines = log.read().splitlines()
        self.assertEqual(lines[0], "<3>Creating LTELogGenerator object")
        unknown = lines.index("<3>Received an unknown log message: 45249")
        self.assertEqual(lines[unknown - 1], "<4>LTE Serving Cell Info")
        self.assertIn("<3>Serving Cell Info: Failed to retrieve Cell ID\\n", lines)

    def test_resources_come_from_the_named_folder(self):
        os.mkdir(self.path("templates"))
        template = {"_sorted": "", "2;SIM Info": {"x": "y"}, "1;First": "text"}
        self.write("templates/LTE.plist", plistlib.dumps(template))
        file = self.write("a.pcap", capture([serving_cell()]))
        display = self.display("--resources", self.path("templates"), file)
        self.assertEqual(display, {"First": "text", "SIM Info": {"x": "y"}})
        self.write("templates/LTE.plist", b"<plist>")
        self.assertEqual(self.display("--resources", self.path("templates"), file), "(unknown)")


class Failures(Decode):
    def test_truncated_capture_yields_what_is_whole_then_status_1(self):
        file = self.write("a.pcap", capture([serving_cell(5), serving_cell(6)])[:-3])
        done = self.decode("--format", "json", file)
        self.assertEqual(done.returncode, 1)
        self.assertEqual(json.loads(done.stdout)["Serving Cell Info"]["Physical Cell ID"], "5")
        self.assertIn("a.pcap: ", done.stderr)

    def test_missing_file_is_status_1_and_named(self):
        done = self.decode(self.path("nowhere.pcap"))
        self.assertEqual(done.returncode, 1)
        self.assertIn("nowhere.pcap: ", done.stderr)

    def test_unknown_kind_is_status_1(self):
        self.assertEqual(self.decode(self.write("a.txt", b"hello, world")).returncode, 1)

    def test_message_that_ends_the_program_ends_the_decoding(self):
        file = self.write("a.pcap", capture([serving_cell(5), record(0xFF0000, b"garbage"), serving_cell(6)]))
        done = self.decode("--format", "json", "--each", file)
        self.assertEqual(done.returncode, 1)
        self.assertEqual(len(done.stdout.splitlines()), 1)
        self.assertIn("message 1 (code 0xFF0000)", done.stderr)
        self.assertIn("UnknownDataException", done.stderr)

    def test_keep_going_reports_it_and_goes_on(self):
        file = self.write("a.pcap", capture([serving_cell(5), record(0xFF0000, b"garbage"), serving_cell(6)]))
        done = self.decode("--format", "json", "--keep-going", file)
        self.assertEqual(json.loads(done.stdout)["Serving Cell Info"]["Physical Cell ID"], "6")
        self.assertIn("message 1 (code 0xFF0000)", done.stderr)

    def test_wrong_usage_is_status_2(self):
        file = self.write("a.pcap", capture([]))
        for arguments in ([], ["--format", "xml", file], ["--technology", "6g", file], ["--nonsense", file],
                          ["--each", file]):
            self.assertEqual(self.decode(*arguments).returncode, 2, arguments)

    def test_help_and_version_are_status_0(self):
        for arguments in (["--help"], ["--version"], ["decode", "--help"], ["watch", "--help"], ["record", "--help"]):
            done = self.run_spectrel(*arguments)
            self.assertEqual((done.returncode, done.stderr), (0, ""), arguments)
            self.assertTrue(done.stdout)

    def test_output_that_cannot_be_written_is_status_1(self):
        file = self.write("a.pcap", capture([serving_cell(5)]))
        with open("/dev/full", "w") as full:
            done = subprocess.run([os.path.join(BIN, "spectrel"), "decode", file], env=self.environment, stdout=full,
                                  stderr=subprocess.PIPE, text=True)
        self.assertEqual(done.returncode, 1)
        self.assertIn("standard output", done.stderr)


    def test_folder_or_file_that_cannot_be_had_is_status_1_and_named_once(self):
        file = self.write("a.pcap", capture([serving_cell(5)]))
        plain = self.write("plain", b"")
        nowhere = self.path("no", "where")
        for arguments, line in (
                (["--resources", nowhere], f"{nowhere}: No such file or directory"),
                (["--resources", plain], f"{plain}: not a folder of display templates"),
                (["--log", nowhere], f"{nowhere}: No such file or directory"),
                (["--log", self.folder], f"{self.folder}: Is a directory")):
            done = self.decode("--format", "none", *arguments, file)
            self.assertEqual((done.returncode, done.stderr), (1, f"spectrel: {line}\n"))


class Snapshots(Decode):
    def snapshot(self, messages, **options):
        file = self.write("a.pcap", capture(messages, **options))
        done = self.decode("--format", "none", "--snapshot", self.path("out"), file)
        self.assertEqual(done.returncode, 0, done.stderr)
        [path] = glob.glob(self.path("out", "*.spectrel"))
        with open(path, "rb") as snapshot:
            return path, plistlib.load(snapshot)

    def test_snapshot_is_written_at_the_last_messages_time(self):
        path, snapshot = self.snapshot([(1709647651.25, serving_cell(5))])
        self.assertTrue(path.endswith("SpectrelSnapshot-1709647651.spectrel"))
        self.assertEqual(snapshot["Timestamp"], "2024-03-05 14:07:31 +0000")
        self.assertEqual(snapshot["Description"], "")
        self.assertEqual([entry["Description"] for entry in snapshot["Data"]],
                         ["Snapshot (2024-03-05 14:07:31 +0000)", f"DLF binary ({161 + 37} bytes)"])
        self.assertEqual(snapshot["Data"][0]["DisplayState"], serving_cell(5))

    def test_ticks_fall_two_seconds_apart_after_the_first_message(self):
        start = 1709647651.0
        times = [0, 1.9, 2.0, 2.1, 7.0]
        _, snapshot = self.snapshot([(start + offset, serving_cell(5)) for offset in times])
        entries = snapshot["Data"][:-1]
        size = len(serving_cell())
        # At 2.0 s the first three; at 4.0 s the fourth; at the end the last.
        self.assertEqual([len(entry["DisplayState"]) // size for entry in entries], [3, 1, 1])
        self.assertEqual([entry["Date"] for entry in entries],
                         ["2024-03-05 14:07:33 +0000", "2024-03-05 14:07:35 +0000", "2024-03-05 14:07:38 +0000"])

    def test_history_keeps_five_entries(self):
        _, snapshot = self.snapshot([serving_cell(number) for number in range(1, 41)], step=2.5)
        self.assertEqual(len(snapshot["Data"]), 6)

    def test_snapshot_decodes_to_the_display_it_was_made_from(self):
        path, _ = self.snapshot([serving_cell(9), sim_files(ICCID="77"), cell_information(TAC=8)], step=1.5)
        again = self.display("--technology", "lte", path)
        self.assertEqual(again, self.display(self.path("a.pcap")))

    def test_dlf_decodes_to_the_display_it_was_made_from(self):
        _, snapshot = self.snapshot([serving_cell(9), sim_files(ICCID="77"), cell_information(TAC=8)], step=0.1)
        dlf = self.write("a.dlf", snapshot["Data"][-1]["DLF"])
        self.assertEqual(self.display("--technology", "lte", dlf), self.display(self.path("a.pcap")))

    def test_file_that_does_not_tell_its_technology_wants_it_named(self):
        path, _ = self.snapshot([serving_cell(9)])
        done = self.decode(path)
        self.assertEqual(done.returncode, 1)
        self.assertIn("--technology", done.stderr)

    def test_recording_without_messages_has_nothing_to_save(self):
        file = self.write("a.pcap", capture([]))
        done = self.decode("--snapshot", self.path("out"), file)
        self.assertEqual(done.returncode, 1)


class Separate(Decode):
    """decode --separate: each file a session of its own."""

    def setUp(self):
        super().setUp()
        self.files = [self.write(f"{number}.pcap", capture([(1733000000 + number, serving_cell(5 + number)), b"short"]))
                      for number in range(5)]

    def separate(self, *arguments):
        return self.decode("--separate", *arguments)

    def test_each_file_is_a_session_of_its_own_in_the_order_of_the_files(self):
        for jobs in ("1", "2", "9"):
            done = self.separate("--jobs", jobs, "--format", "json", *self.files)
            self.assertEqual(done.returncode, 0, done.stderr)
            lines = [json.loads(line) for line in done.stdout.splitlines()]
            self.assertEqual([line["file"] for line in lines], self.files)
            self.assertEqual([line["display"] for line in lines], [self.display(file) for file in self.files])

    def test_lines_begin_with_the_file(self):
        for arguments in (["--format", "changes"], ["--format", "json", "--each"]):
            expected = ""
            for file in self.files:
                lines = self.decode(*arguments, file).stdout.splitlines()
                expected += "".join('{"file": "%s", %s\n' % (file, line[1:]) for line in lines)
            self.assertEqual(self.separate(*arguments, *self.files).stdout, expected)

    def test_csv_has_one_header_and_the_file_in_front(self):
        rows = list(csv.reader(io.StringIO(self.separate("--format", "csv", *self.files).stdout)))
        self.assertEqual(rows[0], ["file", "n", "time", "path", "value"])
        expected = [[file] + row for file in self.files
                    for row in list(csv.reader(io.StringIO(self.decode("--format", "csv", file).stdout)))[1:]]
        self.assertEqual(rows[1:], expected)

    def test_trees_have_their_file_above(self):
        expected = "".join(f"==> {file} <==\n" + self.decode(file).stdout for file in self.files)
        self.assertEqual(self.separate(*self.files).stdout, expected)

    def test_each_damage_is_reported_with_its_file_and_the_others_are_decoded(self):
        whole = capture([serving_cell(1), serving_cell(2)])
        cut = self.write("cut.pcap", whole[:-3])
        missing = self.path("missing.pcap")
        files = [self.files[0], cut, missing, self.files[1]]
        done = self.separate("--format", "json", *files)
        self.assertEqual(done.returncode, 1)
        self.assertEqual([json.loads(line)["file"] for line in done.stdout.splitlines()], files)
        complaints = [line for line in done.stderr.splitlines() if line.startswith("spectrel: ")]
        self.assertEqual([line.split(": ")[:2] for line in complaints], [["spectrel", cut], ["spectrel", missing]])

    def test_a_message_that_ends_the_program_ends_its_file_alone(self):
        ends = self.write("ends.pcap", capture([serving_cell(1), record(0xFF0000, b"no list"), serving_cell(2)]))
        done = self.separate("--format", "changes", ends, self.files[0])
        self.assertEqual(done.returncode, 1)
        self.assertIn(ends + ": message 1", done.stderr)
        self.assertIn(self.files[0], done.stdout)

    def test_standard_input_has_its_name(self):
        with open(self.files[0], "rb") as file:
            done = subprocess.run([os.path.join(BIN, "spectrel"), "decode", "--separate", "--format", "json", "-"],
                                  stdin=file, env=self.environment, capture_output=True, encoding="utf-8")
        self.assertEqual(json.loads(done.stdout)["file"], "standard input")

    def test_options_that_need_the_other_are_wrong_without_it(self):
        self.assertEqual(self.decode("--jobs", "2", *self.files).returncode, 2)
        self.assertEqual(self.separate("--jobs", "0", *self.files).returncode, 2)
        self.assertEqual(self.separate("--log", self.path("log"), *self.files).returncode, 2)

    @unittest.skipUnless(os.path.exists("/dev/full"), "there is no /dev/full")
    def test_an_output_that_cannot_be_written_fails(self):
        with open("/dev/full", "w") as full:
            done = subprocess.run([os.path.join(BIN, "spectrel"), "decode", "--separate", *self.files], stdout=full,
                                  env=self.environment, stderr=subprocess.PIPE, encoding="utf-8")
        self.assertEqual(done.returncode, 1)
        self.assertIn("standard output: cannot be written", done.stderr)


if __name__ == "__main__":
    unittest.main()
