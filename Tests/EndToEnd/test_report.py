"""spectrel report: recordings as one HTML page."""

import os
import re
import unittest
import xml.etree.ElementTree as ElementTree
from html.parser import HTMLParser

from harness import Place, capture, serving_cell

GOLDEN = os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "Golden")
VOID = {"br", "meta"}


class Page(HTMLParser):
    """A page's headings, links and nesting."""

    def __init__(self, text):
        super().__init__()
        self.text, self.open, self.headings, self.attributes = text, [], [], []
        self.feed(text)
        assert not self.open, self.open

    def handle_starttag(self, tag, attributes):
        self.attributes += attributes
        if tag not in VOID:
            self.open.append(tag)

    def handle_startendtag(self, tag, attributes):
        self.attributes += attributes

    def handle_endtag(self, tag):
        assert self.open and self.open[-1] == tag, (self.open, tag)
        self.open.pop()

    def handle_data(self, data):
        if self.open and self.open[-1] == "h2":
            self.headings.append(data)

    def charts(self):
        return [ElementTree.fromstring(svg) for svg in re.findall(r"<svg.*?</svg>", self.text, re.S)]

    def rows(self):
        return [re.sub(r"<[^>]*>", "|", row) for row in re.findall(r"<tr>.*?</tr>", self.text, re.S)]


class Report(Place):
    def report(self, *arguments, status=0):
        done = self.run_spectrel("report", *arguments)
        self.assertEqual(done.returncode, status, done.stderr)
        return done

    def page(self, *files, status=0):
        self.report(*files, "-o", self.path("out.html"), status=status)
        with open(self.path("out.html"), encoding="utf-8") as file:
            return Page(file.read())

    def drive(self, name="drive.pcap", start=1_700_000_000.0, identities=(5, 6, 5)):
        """Ten seconds on each cell."""
        return self.write(name, capture([serving_cell(identity) for identity in identities for _ in range(10)],
                                        start=start))

    def test_findings_come_first_and_everything_follows(self):
        page = self.page(self.drive())
        self.assertEqual(page.headings, ["Findings", "What was recorded", "Levels", "Distributions", "Cells", "Events"])

    def test_cells_have_the_time_for_which_they_served(self):
        rows = [row for row in self.page(self.drive()).rows() if "PCI" in row and "visits" not in row]
        self.assertTrue(any("PCI 5|" in row and "0:19" in row for row in rows), rows)
        self.assertTrue(any("PCI 6|" in row and "0:10" in row for row in rows), rows)
        self.assertTrue(any("1815.0" in row for row in rows), rows)

    def test_golden_recordings_are_pages_whose_charts_have_names_and_tables(self):
        for name in ("lte-five-minutes", "gsm-drive", "cdma-drive", "ifx-drive", "utran-five-minutes"):
            page = self.page(os.path.join(GOLDEN, name + ".pcap"))
            charts = page.charts()
            self.assertTrue(charts, name)
            for chart in charts:
                self.assertEqual(chart.get("role"), "img")
                self.assertTrue(chart.find("title").text)
                self.assertTrue(chart.find("desc").text)
            identifiers = [value for key, value in page.attributes if key == "id"]
            self.assertEqual(len(identifiers), len(set(identifiers)))
            self.assertLessEqual(len(charts), page.text.count("<table>"))

    def test_nothing_is_fetched_and_nothing_runs(self):
        page = self.page(os.path.join(GOLDEN, "lte-five-minutes.pcap"))
        self.assertFalse({key for key, _ in page.attributes} & {"src", "href", "onload", "onclick"})
        for text in ("<script", "http://", "https://", "url("):
            self.assertNotIn(text, page.text)

    def test_the_same_recordings_give_the_same_page(self):
        file = os.path.join(GOLDEN, "lte-drive.pcap")
        self.assertEqual(self.page(file).text, self.page(file).text)

    def test_numbered_files_are_one_recording_in_the_order_of_their_messages(self):
        second = self.drive("drive-2.pcap", start=1_700_000_030.0)
        page = self.page(second, self.drive())
        self.assertIn("<title>Radio report: drive</title>", page.text)
        self.assertIn("drive.pcap, drive-2.pcap", page.text)
        self.assertIn("<td>60</td>", page.text)

    def test_bookmarks_and_gaps_are_read(self):
        file = self.drive()
        self.write("drive.marks", b'{"time": 1700000005.5, "note": "a <bridge>"}\n')
        self.write("drive.gaps", b'{"time": 1700000006.5, "lost": 17}\n')
        page = self.page(file)
        self.assertIn("a &lt;bridge&gt;", page.text)
        self.assertTrue(any("lost messages" in row and "17" in row for row in page.rows()))

    def test_a_level_that_served_is_charted_with_its_moves(self):
        page = self.page(os.path.join(GOLDEN, "lte-five-minutes.pcap"))
        (rsrp,) = [chart for chart in page.charts() if chart.find("title").text.startswith("RSRP of")]
        shapes = [path.get("class", "") for path in rsrp.iter("path")]
        self.assertTrue([shape for shape in shapes if shape.startswith("l c")], "no line of a serving cell")
        self.assertIn("move", shapes)

    def test_others_stand_side_by_side(self):
        page = self.page(self.drive("before.pcap"), self.drive("after.pcap", start=1_600_000_000.0))
        self.assertIn("<title>Radio report: after, before</title>", page.text)
        self.assertTrue(any(row.count("0:29") == 2 for row in page.rows() if "duration" in row))

    def test_standard_input_and_output(self):
        with open(self.drive(), "rb") as recording:
            done = self.start("spectrel", "report", "-", "-o", "-", stdin=recording, stdout=-1)
            self.assertIn("Radio report: standard input", done.communicate()[0])
        self.assertEqual(done.returncode, 0)

    def test_only_a_report_is_overwritten(self):
        drive = self.drive()
        self.page(drive)
        self.page(drive)
        done = self.report(drive, "-o", drive, status=1)
        self.assertIn("drive.pcap: is there already and is no report; it is not overwritten", done.stderr)
        with open(drive, "rb") as kept:
            self.assertEqual(kept.read(4), b"\xd4\xc3\xb2\xa1")
        self.report(drive, "-o", self.folder, status=1)
        done = self.report(drive, "-o", self.path("nowhere", "out.html"), status=1)
        self.assertIn("nowhere/out.html: No such file or directory", done.stderr)

    def test_a_damaged_recording_is_reported_up_to_the_damage(self):
        with open(self.drive(), "rb") as file:
            whole = file.read()
        page = self.page(self.write("cut.pcap", whole[:-5]), status=1)
        self.assertIn("remarks", page.text)
        self.assertIn("<td>29</td>", page.text)

    def test_a_missing_file_leaves_the_others(self):
        page = self.page(self.drive(), self.path("nix.pcap"), status=1)
        self.assertIn("Radio report: drive", page.text)
        os.remove(self.path("out.html"))
        self.report(self.path("nix.pcap"), "-o", self.path("out.html"), status=1)
        self.assertFalse(os.path.exists(self.path("out.html")))

    def test_an_empty_recording_is_a_page(self):
        page = self.page(self.write("empty.pcap", capture([])))
        self.assertIn("Nothing remarkable", page.text)
        self.assertEqual(page.charts(), [])

    def test_wrong_usage(self):
        self.report(self.drive(), status=2)
        self.report("-o", self.path("out.html"), status=2)
        self.report(self.drive(), "-o", "", status=2)


if __name__ == "__main__":
    unittest.main()
