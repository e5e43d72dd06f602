#!/usr/bin/env python3
"""Random property lists for the tests, and python's own reading of lists that the tests wrote.

make FOLDER SEED COUNT   writes N.xml, N.bin and N.txt (the value as ValueText.h spells it) for N below COUNT
check FOLDER             reads every *.plist and compares it with the *.txt beside it
"""
import datetime
import math
import pathlib
import plistlib
import random
import struct
import sys

ORIGIN = datetime.datetime(2001, 1, 1)
ALPHABETS = ["abc XYZ 019", "<>&\"'\t\n ]]>", "\u00e4\u00f6\u00df\u20ac\u4e2d", "\U0001f4f6\U0001f600x", "{}%/\\\u0085\u2028"]
INTEGERS = [0, 1, -1, 127, 128, 255, 256, 65535, 65536, 2**31 - 1, 2**31, -2**31, 2**32, 2**63 - 1, -2**63, 2**63, 2**64 - 1]
REALS = [0.0, -0.0, 1.0, -1.5, 0.1, 1e300, 5e-324, 1.7976931348623157e308, math.inf, -math.inf, math.nan, 123456789.125]


def text(dice):
    return "".join(dice.choice(dice.choice(ALPHABETS)) for _ in range(dice.choice([0, 1, 3, 14, 15, 16, 40, 300])))


def value(dice, depth):
    kind = dice.randrange(9 if depth < 6 else 7)
    if kind == 0:
        return text(dice)
    if kind == 1:
        return dice.choice(INTEGERS) if dice.random() < 0.5 else dice.randint(-2**63, 2**64 - 1)
    if kind == 2:
        return dice.choice(REALS) if dice.random() < 0.5 else dice.uniform(-1e6, 1e6)
    if kind == 3:
        return dice.random() < 0.5
    if kind == 4:
        return ORIGIN + datetime.timedelta(seconds=dice.randint(-2000 * 365 * 86400, 7900 * 365 * 86400))
    if kind == 5:
        return dice.randbytes(dice.choice([0, 1, 2, 3, 14, 15, 60, 300]))
    if kind == 6:
        return text(dice)
    count = dice.choice([0, 1, 2, 5, 16])
    if kind == 7:
        return [value(dice, depth + 1) for _ in range(count)]
    return {text(dice): value(dice, depth + 1) for _ in range(count)}


def spelled(held):
    if isinstance(held, bool):
        return "T" if held else "F"
    if isinstance(held, str):
        return "s" + held.encode().hex()
    if isinstance(held, int):
        return "i%d" % held
    if isinstance(held, float):
        return "rnan" if math.isnan(held) else "r" + struct.pack(">d", held).hex()
    if isinstance(held, bytes):
        return "d" + held.hex()
    if isinstance(held, datetime.datetime):
        return "t%d" % ((held - ORIGIN) // datetime.timedelta(seconds=1))
    if isinstance(held, list):
        return "[" + ",".join(spelled(element) for element in held) + "]"
    return "{" + ",".join(key.encode().hex() + ":" + spelled(element) for key, element in held.items()) + "}"


def make(folder, seed, count):
    dice = random.Random(seed)
    for number in range(count):
        held = value(dice, 0) if number % 4 else {"top": value(dice, 1), "list": [value(dice, 1) for _ in range(4)]}
        for suffix, form in (("xml", plistlib.FMT_XML), ("bin", plistlib.FMT_BINARY)):
            (folder / f"{number}.{suffix}").write_bytes(plistlib.dumps(held, fmt=form, sort_keys=False))
        (folder / f"{number}.txt").write_text(spelled(held))


def check(folder):
    paths = sorted(folder.glob("*.plist"))
    wrong = 0
    for path in paths:
        expected = path.with_suffix(".txt").read_text()
        try:
            found = spelled(plistlib.loads(path.read_bytes()))
        except Exception as error:
            found = repr(error)
        if found != expected:
            wrong += 1
            print(f"{path.name}: expected {expected[:400]}\n  python read {found[:400]}")
    print(f"{len(paths)} lists, {wrong} wrong")
    return 1 if wrong or not paths else 0


if sys.argv[1] == "make":
    make(pathlib.Path(sys.argv[2]), int(sys.argv[3]), int(sys.argv[4]))
else:
    sys.exit(check(pathlib.Path(sys.argv[2])))
