"""Chosen leaves (--path), and tables of columns, of recordings and of a live session."""

import csv
import io
import json
import os
import unittest

from harness import Place, capture, cell_information, serving_cell, sim_files

GOLDEN = os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "Golden")
PCI = "/Serving Cell Info/Physical Cell ID"


class Paths(Place):
    def decode(self, *arguments):
        done = self.run_spectrel("decode", *arguments)
        self.assertEqual(done.returncode, 0, done.stderr)
        return done.stdout

    def test_one_leaf_in_every_format(self):
        file = self.write("a.pcap", capture([serving_cell(5), serving_cell(6)]))
        self.assertEqual(self.decode("--path", PCI, file), "Serving Cell Info\n  Physical Cell ID: 6\n")
        self.assertEqual(json.loads(self.decode("--format", "json", "--path", PCI, file)),
                         {"Serving Cell Info": {"Physical Cell ID": "6"}})
        each = self.decode("--format", "json", "--each", "--path", PCI, file).splitlines()
        self.assertEqual(json.loads(each[0]), {"n": 0, "display": {"Serving Cell Info": {"Physical Cell ID": "5"}}})
        changes = [json.loads(line) for line in self.decode("--format", "changes", "--path", PCI, file).splitlines()]
        self.assertEqual([(change["n"], change["path"], change["value"]) for change in changes],
                         [(0, PCI, "5"), (1, PCI, "6")])
        self.assertEqual(self.decode("--format", "csv", "--path", PCI, file).splitlines()[1:],
                         [f"0,1700000000.000000,{PCI},5", f"1,1700000001.000000,{PCI},6"])

    def test_chosen_changes_are_those_of_all_changes_that_match(self):
        for name in ("gsm-drive", "cdma-drive", "ifx-drive"):
            file = os.path.join(GOLDEN, name + ".pcap")
            everything = self.decode("--format", "changes", file).splitlines(keepends=True)
            first = json.loads(everything[0])["path"].split("/")[1]
            expected = [line for line in everything if json.loads(line)["path"].startswith(f"/{first}/")]
            self.assertTrue(0 < len(expected) < len(everything))
            self.assertEqual(self.decode("--format", "changes", "--path", f"/{first}/**", file), "".join(expected))
            self.assertEqual(self.decode("--format", "changes", "--path", "**", file), "".join(everything))

    def test_several_globs_choose_together(self):
        file = self.write("a.pcap", capture([serving_cell(5), sim_files(ICCID="8900"), cell_information(TAC=1)]))
        display = json.loads(self.decode("--format", "json", "--path", "/SIM*/EF-I*", "--path", "**/Physical*", file))
        self.assertEqual(list(display)[0], "Serving Cell Info")
        self.assertEqual(display["SIM Info"]["EF-ICCID"], "8900")
        self.assertTrue(all(key.startswith("EF-I") for key in display["SIM Info"]))

    def test_live(self):
        self.start_service("--replay", self.write("a.pcap", capture([serving_cell(5)])), "--speed", "0")
        done = self.run_spectrel("watch", "--format", "json", "--count", "1", "--path", PCI)
        self.assertEqual(json.loads(done.stdout), {"Serving Cell Info": {"Physical Cell ID": "5"}})


class Table(Place):
    def rows(self, *arguments):
        done = self.run_spectrel(*arguments)
        self.assertEqual(done.returncode, 0, done.stderr)
        return list(csv.reader(io.StringIO(done.stdout)))

    def decode(self, file, columns):
        return self.rows("decode", "--format", "table", "--columns", columns, file)

    def test_one_row_a_tick_and_one_after_the_last_message(self):
        file = self.write("a.pcap", capture([serving_cell(number) for number in range(6)]))
        self.assertEqual(self.decode(file, PCI), [
            ["time", PCI], ["1700000002.000000", "2"], ["1700000004.000000", "4"], ["1700000005.000000", "5"]])

    def test_columns_have_their_names_and_stay_empty_without_a_leaf(self):
        file = self.write("a.pcap", capture([serving_cell(5)]))
        self.assertEqual(self.decode(file, f"{PCI}=PCI,/No/Such=none,/SIM Info/EF-ICCID"), [
            ["time", "PCI", "none", "/SIM Info/EF-ICCID"], ["1700000000.000000", "5", "", "-"]])

    def test_cells_are_the_keys_and_levels_of_the_serving_cell(self):
        for name in ("lte-five-minutes", "gsm-drive", "cdma-drive", "ifx-drive", "utran-five-minutes"):
            file = os.path.join(GOLDEN, name + ".pcap")
            rows = self.decode(file, "cells")
            reports = [json.loads(line) for line in
                       self.run_spectrel("decode", "--format", "cells", file).stdout.splitlines()]
            self.assertEqual(rows[0][:4], ["time", "technology", "plmn", "operator"])
            self.assertEqual(rows[0][-10:], ["RSRP", "RSRQ", "RSSI", "RSCP", "EcNo", "EcIo", "Srxlev", "C1", "C2", "age"])
            self.assertEqual(len(rows) - 1, len(reports))
            for row, report in zip(rows[1:], reports):
                self.assertEqual(len(row), len(rows[0]))
                shown = {key: value for key, value in zip(rows[0], row) if value}
                serving = report.get("serving", {})
                expected = {"time": report["time"], **serving, **serving.get("levels", {})}
                expected.pop("levels", None)
                self.assertEqual(list(shown), [key for key in rows[0] if key in expected])
                for key, value in shown.items():
                    same = float(value) if isinstance(expected[key], (int, float)) else value
                    self.assertEqual(same, expected[key])

    def test_recording_without_a_message_has_no_row(self):
        self.assertEqual(self.decode(self.write("a.pcap", capture([])), "/A"), [["time", "/A"]])

    def test_table_shows_what_the_display_showed_at_the_tick(self):
        file = os.path.join(GOLDEN, "lte-five-minutes.pcap")
        rows = self.decode(file, "/Serving Cell Measurements/Measured RSRP=RSRP")
        changes = [json.loads(line) for line in self.run_spectrel(
            "decode", "--format", "changes", "--path", "/Serving Cell Measurements/Measured RSRP", file)
            .stdout.splitlines()]
        self.assertGreater(len(rows), 100)
        for time, value in rows[1:]:
            shown = [change["value"] for change in changes if change["time"] <= float(time)]
            self.assertEqual(value, shown[-1])

    def test_live_rows_come_with_the_refreshes(self):
        self.start_service("--simulate", "lte")
        rows = self.rows("watch", "--format", "table", "--columns", f"{PCI}=PCI", "--count", "2")
        self.assertEqual(rows[0], ["time", "PCI"])
        self.assertEqual(len(rows), 3)
        self.assertLess(float(rows[1][0]), float(rows[2][0]))


if __name__ == "__main__":
    unittest.main()
