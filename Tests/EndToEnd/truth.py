"""Holds the events that a simulated recording decodes to against what its world decided.

A recording shows a move when, while the phone is on the new cell, some message changes a value that names a serving
cell to the new cell's. Stays that no message shows are left out of the truth: from A to B to C is then from A to C, and
no cause is asked for.
"""

import json
import os
import re
from bisect import bisect_left
from dataclasses import dataclass, field

TECHNOLOGIES = ("lte", "gsm", "utran", "cdma", "ifx")
SCENES = ("drive", "handover", "tunnel", "rejected", "ping-pong", "overshoot", "journey")
LACKING = {("rejected", technology) for technology in TECHNOLOGIES if technology != "gsm"} | {
    ("journey", "cdma"), ("journey", "ifx")}

# Where the displays name the cell that serves on a radio technology.
NAMES = {
    "lte": re.compile(r"/Serving Cell Info/(Physical Cell ID|Cell Identity)|/Serving Cell Measurements/Physical Cell ID"
                      r"|/Connected mode LTE Intra-frequency Measurement/Serving Physical Cell ID"
                      r"|/Reselection Candidates/Serving Cell ID"),
    "umts": re.compile(r"/UMTS/UMTS RR Info/(Cell ID|Scrambling Code)|/Serving Cell Info/Cell (ID|Scrambling Code)"),
    "gsm": re.compile(r"/GSM/GSM Serving Cell/(Cell ID|ARFCN|BSIC)"
                      r"|/Serving Cell/(Cell Identity|BSIC|Carrier/ARFCN)"),
    "cdma": re.compile(r"/1x/System/Base Station ID|/1x/Active Set/\d+"),
    "evdo": re.compile(r"/EV-DO/Serving PN Offset"),
}
# What changes while the technology serves, where a phone comes back to the cell that the display still shows.
SIGNS = {
    "umts": re.compile(r"/UMTS/(UMTS RR Info|Active Set)/"),
    "gsm": re.compile(r"/GSM/GSM (RR Info|Serving Cell)/"),
}


@dataclass
class Score:
    """What came of some recordings."""

    moves: int = 0  # that the recordings show
    unseen: int = 0  # decided, and shown by no message
    found: int = 0
    invented: int = 0
    kinds: int = 0  # asked for
    kinds_right: int = 0
    reselections: int = 0
    rules: int = 0  # named
    rules_right: int = 0
    misses: list = field(default_factory=list)  # for people: what went wrong

    def add(self, other):
        for name, value in vars(other).items():
            setattr(self, name, getattr(self, name) + value)


def share(part, whole):
    return part / whole if whole else 1.0


def track(cell):
    """EV-DO moves beside 1x; the other technologies of a phone take turns."""
    return "evdo" if cell["technology"] == "evdo" else "phone"


def is_same(event_cell, true_cell):
    """Whether a cell of an event is that of the truth, by the names that it has."""
    keys = [key for key in ("technology", "channel", "id", "cell") if key in event_cell and key in true_cell]
    return all(event_cell[key] == true_cell[key] for key in keys) and len(keys) >= 3


def read_lines(path):
    with open(path, encoding="utf-8") as file:
        return [json.loads(line) for line in file]


def stays(truth, end):
    """The phone's stays on cells, in order, with the cause that began each: one list a track."""
    lists = {}
    for move in truth:
        stays_here = lists.setdefault(track(move["to"]), [])
        if stays_here:
            stays_here[-1]["until"] = move["time"]
        stays_here.append({"cell": move["to"], "time": move["time"], "until": end, "cause": move.get("cause")})
    return lists


def names_of(cell):
    """As the displays write them."""
    names = {str(cell[key]) for key in ("id", "cell") if key in cell} | {f"{cell['id']} × 64chips"}
    if cell["technology"] == "gsm":
        names |= {f"{cell['id'] // 8}-{cell['id'] % 8}", str(cell["channel"])}
    return names


def is_shown(stay, changes, last):
    """Whether some message names the cell while the phone is on it; `last`: shown before by its technology."""
    cell = stay["cell"]
    technology = cell["technology"]
    names = names_of(cell)
    for change in changes:
        if change["time"] < stay["time"]:
            continue
        if change["time"] >= stay["until"]:
            break
        path, value = change["path"], change["value"] or ""
        is_reference = "ref pilot" in value and path.split("/")[-1] in names
        if NAMES[technology].fullmatch(path) and (value in names or is_reference):
            return True
        if cell == last and technology in SIGNS and SIGNS[technology].match(path):
            return True
    return False


def seen_moves(stays_here, changes):
    """The moves between stays that are shown, each with the time in which it may be told, and how many are not."""
    moves, unseen, previous, is_merged, last = [], 0, None, False, {}
    times = [change["time"] for change in changes]
    for stay in stays_here:
        technology = stay["cell"]["technology"]
        here = changes[bisect_left(times, stay["time"]):bisect_left(times, stay["until"])]
        if not is_shown(stay, here, last.get(technology)):
            unseen += 1
            is_merged = True
            continue
        if previous is not None and previous["cell"] != stay["cell"]:
            moves.append({"from": previous["cell"], "to": stay["cell"], "time": stay["time"], "until": stay["until"],
                          "cause": None if is_merged else stay["cause"]})
        last[technology] = stay["cell"]
        previous, is_merged = stay, False
    return moves, unseen


def match(moves, events, score):
    waiting = list(events)
    for move in moves:
        fits = [event for event in waiting
                if is_same(event["to"], move["to"]) and move["time"] <= event["time"] <= move["until"]]
        score.moves += 1
        if not fits:
            score.misses.append(("missed", move, None))
            continue
        waiting.remove(fits[0])
        score.found += 1
        judge(move, fits[0], score)
    score.invented += len(waiting)
    score.misses += [("invented", None, event) for event in waiting]


def judge(move, event, score):
    if move["cause"] is None:
        return
    kind, told = move["cause"]["kind"], event.get("cause", {})
    score.kinds += 1
    if told.get("kind") == kind:
        score.kinds_right += 1
    else:
        score.misses.append(("kind", move, event))
    if kind != "reselection" or told.get("kind") != kind:
        return
    score.reselections += 1
    if told.get("rule", "unknown") == "unknown":
        score.misses.append(("no rule", move, event))
        return
    score.rules += 1
    if told["rule"] == move["cause"]["rule"]:
        score.rules_right += 1
    else:
        score.misses.append(("rule", move, event))


def compare(truth, events, changes, end):
    """Scores the `cell` events of a recording, its first cells left out."""
    score = Score()
    told = [event for event in events if event["event"] == "cell" and "from" in event]
    for name, stays_here in stays(truth, end).items():
        moves, unseen = seen_moves(stays_here, changes)
        score.unseen += unseen
        match(moves, [event for event in told if track(event["to"]) == name], score)
    return score


def recordings(path):
    """A recording's files in order: NAME.pcap, NAME-2.pcap and so on."""
    folder, name = os.path.split(path)
    stem, extension = os.path.splitext(name)
    numbered = {}
    for file in os.listdir(folder):
        fits = re.fullmatch(re.escape(stem) + r"(?:-(\d+))?" + re.escape(extension), file)
        if fits:
            numbered[int(fits.group(1) or 1)] = os.path.join(folder, file)
    return [numbered[number] for number in sorted(numbered)]


def table(scores):
    """The rows of `docs/analysis.md`: scores by technology and scene."""
    rows = ["| technology | scene | moves | unseen | found | invented | kind right | rule told | rule right |",
            "|---|---|---|---|---|---|---|---|---|"]
    for (technology, scene), score in scores.items():
        percent = [f"{100 * share(part, whole):.1f} %" if whole else "–" for part, whole in (
            (score.found, score.moves), (score.kinds_right, score.kinds), (score.rules, score.reselections),
            (score.rules_right, score.rules))]
        rows.append(f"| {technology} | {scene} | {score.moves} | {score.unseen} | {percent[0]} | {score.invented} | "
                    f"{percent[1]} | {percent[2]} | {percent[3]} |")
    return "\n".join(rows)
