"""spectrel channel: bands and frequencies of channel numbers."""

import json
import unittest

from harness import Place


class Channel(Place):
    def channel(self, *arguments):
        return self.run_spectrel("channel", *arguments)

    def bands(self, *arguments):
        done = self.channel(*arguments, "--format", "json")
        self.assertEqual((done.returncode, done.stderr), (0, ""))
        return json.loads(done.stdout)

    def wrong_usage(self, *arguments):
        done = self.channel(*arguments)
        self.assertEqual((done.returncode, done.stdout), (2, ""))
        self.assertEqual(done.stderr.count("\n"), 1)
        return done.stderr

    def test_json_gives_every_key_of_a_pair_in_order(self):
        done = self.channel("lte", "1300", "--format", "json")
        self.assertEqual(done.stdout,
                         '{"technology": "lte", "channel": 1300, "bands": [{"band": "3", "name": "1800 MHz", '
                         '"direction": "downlink", "downlinkMHz": 1815.0, "uplinkMHz": 1720.0, '
                         '"downlinkChannel": 1300, "uplinkChannel": 19300, "duplex": "FDD"}]}\n')
        self.assertEqual((done.returncode, done.stderr), (0, ""))

    def test_an_uplink_number_gives_the_same_pair(self):
        down, up = self.bands("lte", "1300")["bands"][0], self.bands("lte", "19300")["bands"][0]
        self.assertEqual(up.pop("direction"), "uplink")
        self.assertEqual(down.pop("direction"), "downlink")
        self.assertEqual(up, down)

    def test_a_frequency_gives_its_channels(self):
        found = self.bands("lte", "--mhz", "1815")
        self.assertEqual(found["MHz"], 1815.0)
        self.assertNotIn("channel", found)
        self.assertEqual([band["downlinkChannel"] for band in found["bands"]], [1300])

    def test_no_pair_leaves_the_uplink_out(self):
        for number in ("9660", "67136", "68585"):
            (band,) = self.bands("lte", number)["bands"]
            self.assertNotIn("uplinkMHz", band)
            self.assertNotIn("uplinkChannel", band)
            self.assertEqual(band["direction"], "downlink")

    def test_utran_numbers_are_looked_up_in_both_duplexes(self):
        self.assertEqual([(band["band"], band["duplex"], band["direction"])
                          for band in self.bands("utran", "9700")["bands"]],
                         [("1", "FDD", "uplink"), ("2", "FDD", "downlink"), ("36", "TDD", "both")])
        (band,) = self.bands("utran", "10054")["bands"]
        self.assertEqual((band["downlinkMHz"], band["uplinkMHz"]), (2010.8, 2010.8))

    def test_ambiguous_numbers_give_every_band_and_an_option_one(self):
        self.assertEqual([band["band"] for band in self.bands("gsm", "600")["bands"]], ["DCS 1800", "PCS 1900"])
        (band,) = self.bands("gsm", "600", "--band", "PCS 1900")["bands"]
        self.assertEqual((band["downlinkMHz"], band["uplinkMHz"]), (1947.8, 1867.8))
        (band,) = self.bands("cdma", "384", "--band", "0")["bands"]
        self.assertEqual((band["downlinkMHz"], band["direction"]), (881.52, "both"))
        self.assertGreater(len(self.bands("cdma", "384")["bands"]), 10)

    def test_text_says_it_in_a_line_a_band(self):
        for arguments, text in (
                (("lte", "1300"), "LTE band 3, 1800 MHz, FDD: downlink 1300 = 1815.0 MHz with uplink 19300 = 1720.0 MHz"),
                (("lte", "19300"), "LTE band 3, 1800 MHz, FDD: uplink 19300 = 1720.0 MHz with downlink 1300 = 1815.0 MHz"),
                (("lte", "67136"), "LTE band 66, 1700/2100 MHz (AWS-3), FDD: downlink 67136 = 2180.0 MHz without uplink"),
                (("lte", "38000"), "LTE band 38, 2600 MHz (centre gap), TDD: 38000 = 2595.0 MHz both ways"),
                (("gsm", "62"), "GSM P-GSM 900, 900 MHz (primary), FDD: 62 = 947.4 MHz downlink, 902.4 MHz uplink")):
            done = self.channel(*arguments)
            self.assertEqual((done.returncode, done.stdout, done.stderr), (0, text + "\n", ""))

    def test_no_band_is_an_empty_list_and_status_1(self):
        for arguments, answer, complaint in (
                (("lte", "7450"), '"channel": 7450, "bands": []}\n', "LTE has no channel 7450"),
                (("lte", "1300", "--band", "7"), '"channel": 1300, "bands": []}\n', "LTE has no channel 1300 in band '7'"),
                (("gsm", "--mhz", "947.5"), '"MHz": 947.5, "bands": []}\n', "GSM has no channel at 947.5 MHz")):
            done = self.channel(*arguments, "--format", "json")
            self.assertEqual(done.stdout, f'{{"technology": "{arguments[0]}", {answer}')
            self.assertEqual((done.returncode, done.stderr), (1, f"spectrel: {complaint}\n"))
            self.assertEqual(self.channel(*arguments).stdout, "")

    def test_wrong_usage(self):
        self.assertIn("either a channel NUMBER or --mhz", self.wrong_usage("lte"))
        self.assertIn("either a channel NUMBER or --mhz", self.wrong_usage("lte", "1", "--mhz", "2"))
        self.assertIn("is no channel number", self.wrong_usage("lte", "1300.5"))
        self.assertIn("is no frequency in MHz", self.wrong_usage("lte", "--mhz", "nan"))
        self.assertIn("is not one of lte, utran, gsm, cdma", self.wrong_usage("ifx", "1"))
        self.assertIn("is not one of text, json", self.wrong_usage("lte", "1", "--format", "csv"))
        self.wrong_usage()

    def test_needs_neither_templates_nor_a_service(self):
        self.environment["SPECTREL_PORT_DIR"] = "/nowhere"
        self.assertEqual(len(self.bands("lte", "0")["bands"]), 1)


if __name__ == "__main__":
    unittest.main()
