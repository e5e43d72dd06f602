"""The events of simulated recordings against what their worlds decided.

SPECTREL_TRUTH_SEEDS: how many seeds each technology and scene is tried with (1). SPECTREL_TRUTH_TABLE: a file for the
table of `docs/analysis.md`.
"""

import json
import os
import unittest

import truth
from harness import Place

SEEDS = int(os.environ.get("SPECTREL_TRUTH_SEEDS", "1"))
DURATION = "10m"


class Truth(Place):
    def lines(self, file_format, files):
        done = self.run_spectrel("decode", "--format", file_format, *files)
        self.assertEqual(done.returncode, 0, done.stderr)
        return [json.loads(line) for line in done.stdout.splitlines()]

    def score(self, technology, scene, seed):
        path = self.path(f"{technology}-{scene}-{seed}.pcap")
        done = self.run_spectrel("--simulate", technology, "--scene", scene, "--seed", str(seed), "--duration", DURATION,
                                 "--write", path, "--truth", path + ".truth", program="spectrel-telephonyd")
        self.assertEqual(done.returncode, 0, done.stderr)
        files = truth.recordings(path)
        changes = [change for file in files for change in self.lines("changes", [file])]
        score = truth.compare(truth.read_lines(path + ".truth"), self.lines("events", files), changes,
                              changes[-1]["time"] + 1)
        for file in files:
            os.remove(file)
        return score

    def scores(self, technology):
        """By technology and scene."""
        scores = {}
        for scene in truth.SCENES:
            if (scene, technology) in truth.LACKING:
                continue
            total = scores[technology, scene] = truth.Score()
            for seed in range(1, SEEDS + 1):
                total.add(self.score(technology, scene, seed))
        return scores

    def check(self, technology, kinds=0.98, names_rules=False):
        scores = self.scores(technology)
        if path := os.environ.get("SPECTREL_TRUTH_TABLE"):
            with open(path, "a", encoding="utf-8") as file:
                file.write(truth.table(scores) + "\n")
        total = truth.Score()
        for (_, scene), score in scores.items():
            self.assertGreater(score.moves, 0, scene)
            total.add(score)
        wrong = "\n".join(f"{what}: decided {move}, told {event}" for what, move, event in total.misses)
        self.assertGreaterEqual(truth.share(total.found, total.moves), 0.99, wrong)
        self.assertLessEqual(total.invented, max(1, total.moves // 200), wrong)
        self.assertGreaterEqual(truth.share(total.kinds_right, total.kinds), kinds, wrong)
        if names_rules:
            self.assertGreaterEqual(truth.share(total.rules_right, total.rules), 0.98, wrong)
            self.assertGreaterEqual(truth.share(total.rules, total.reselections), 0.80, wrong)

    def test_lte(self):
        self.check("lte", names_rules=True)

    def test_gsm(self):
        self.check("gsm", names_rules=True)

    # Here the records show the phone's mode only now and then: a move beside its change is told by the one before.
    def test_utran(self):
        self.check("utran", kinds=0.95)

    def test_cdma(self):
        self.check("cdma", kinds=0.95)

    def test_ifx(self):
        self.check("ifx", kinds=0.90)


def cell(number):
    return {"technology": "lte", "channel": 1300, "id": number, "cell": 256 * number}


def moved(time, to, **more):
    return {"time": time, "to": cell(to), **more}


def handed_over(time, from_, to):
    return {"event": "cell", "n": 0, "cause": {"kind": "handover"}, **moved(time, to, **{"from": cell(from_)})}


class Comparison(unittest.TestCase):
    """The yardstick itself."""

    truth = [moved(0, 1), moved(10, 2, cause={"kind": "handover"}),
             moved(20, 3, cause={"kind": "reselection", "rule": "equal-priority"})]
    changes = [{"time": time, "path": "/Serving Cell Info/Physical Cell ID", "value": str(number)}
               for time, number in ((0, 1), (10.4, 2), (20.4, 3))]

    def compare(self, events, changes=None):
        return truth.compare(self.truth, events, changes or self.changes, 30)

    def test_right_events_score_full(self):
        reselected = moved(20.4, 3, event="cell", cause={"kind": "reselection", "rule": "equal-priority"},
                           **{"from": cell(2)})
        score = self.compare([{"event": "area"}, handed_over(10.4, 1, 2), reselected])
        self.assertEqual((score.moves, score.found, score.invented, score.kinds_right, score.rules_right),
                         (2, 2, 0, 2, 1))

    def test_wrong_kind_counts(self):
        score = self.compare([handed_over(10.4, 1, 2), handed_over(20.4, 2, 3)])
        self.assertEqual((score.found, score.kinds, score.kinds_right, score.reselections), (2, 2, 1, 0))

    def test_rule_left_open_is_neither_told_nor_wrong(self):
        open_ = moved(20.4, 3, event="cell", cause={"kind": "reselection", "rule": "unknown"}, **{"from": cell(2)})
        score = self.compare([handed_over(10.4, 1, 2), open_])
        self.assertEqual((score.reselections, score.rules, score.rules_right), (1, 0, 0))

    def test_missing_early_and_additional_events_count(self):
        score = self.compare([handed_over(9.9, 1, 2), handed_over(25, 3, 4)])
        self.assertEqual((score.moves, score.found, score.invented), (2, 0, 2))

    def test_cell_that_no_message_shows_is_passed_over(self):
        changes = [change for change in self.changes if change["value"] != "2"]
        score = self.compare([handed_over(20.4, 1, 3)], changes)
        self.assertEqual((score.moves, score.unseen, score.found, score.invented, score.kinds), (1, 1, 1, 0, 0))

    def test_value_of_a_neighbour_shows_no_cell(self):
        changes = self.changes[:1] + [{"time": 10.4, "path": "/Neighbor Cells List/0/Physical Cell ID", "value": "2"}]
        self.assertEqual(self.compare([], changes).unseen, 2)


if __name__ == "__main__":
    unittest.main()
