#!/usr/bin/env python3
"""Writes the seeds of the corpora (but for LTE's) beside itself; found inputs stay as they are."""
import datetime
import pathlib
import plistlib
import struct

HERE = pathlib.Path(__file__).parent
HEAD = b"<?xml version=\"1.0\" encoding=\"UTF-8\"?><!DOCTYPE plist PUBLIC \"-//Apple//DTD PLIST 1.0//EN\" \"http://www.apple.com/DTDs/PropertyList-1.0.dtd\">"
EVERYTHING = {
    "text": "a<&>\u00e4\u20ac\U0001f4f6", "whole": [0, -1, 255, 65536, 2**63, -2**63], "real": [0.5, float("inf"), float("nan")],
    "truth": [True, False], "date": datetime.datetime(2024, 3, 5, 14, 7, 31), "data": bytes(range(20)), "empty": [{}, [], "", b""],
    "deep": [[[{"k": [["x" * 20]]}]]],
}


def record(code, payload=b"", kind=1):
    return struct.pack("<BHHQ", kind, 12 + len(payload), code, 0xE0DCBA9876543210) + payload


def capture(link_type, packets, order="<", magic=0xA1B2C3D4):
    head = struct.pack(order + "IHHiIII", magic, 2, 4, 0, 0, 262144, link_type)
    return head + b"".join(struct.pack(order + "IIII", 1700000000 + i, i, len(p), len(p)) + p for i, p in enumerate(packets))


def version_report():
    report = bytearray(161)
    struct.pack_into("<HH8xHH7s16s", report, 0, 161, 0x1FFD, 1, 1, b"Spectr", b"EXECUTABLE_NAME")
    struct.pack_into("<I", report, 81, 1700000000)
    return bytes(report)


def snapshot(entries, form):
    return plistlib.dumps({"Timestamp": "2024-03-05 14:07:31 +0000", "Data": entries}, fmt=form, sort_keys=False)


def binary_records(lengths, counts):
    """One record of each code; where it holds lists, with two entries, and once with counts past its end. `counts`: each code's (offset, unit of the count)."""
    inputs = {}
    for code, length in lengths.items():
        content = bytearray(record(code, bytes(i % 256 for i in range(1, length - 12))))
        for name, count in (("", 2), ("-past-its-end", 255)):
            for offset, unit in counts.get(code, ()):
                content[offset] = 255 if name else count * unit & 255
            if not name or code in counts:
                inputs[f"{code:04x}{name}"] = bytes(content)
    return inputs


def lte_records():
    lengths = {0xB0C1: 22, 0xB0C2: 38, 0xB179: 45, 0xB17F: 33, 0xB180: 61, 0xB186: 37}
    return binary_records(lengths, {0xB179: ((27, 1), (28, 1)), 0xB180: ((19, 64), (20, 0)), 0xB186: ((19, 1), (20, 0))})


def utran_records():
    lengths = {0xD0E0: 15, 0xD0E2: 26, 0xD00A: 200, 0xD00E: 33, 0xD00C: 373}
    inputs = binary_records(lengths, {0xD00A: ((16, 2),), 0xD00E: ((16, 1),), 0xD00C: ((14, 64), (15, 16))})
    cell = "kRKCellMonitor"
    cells = [{cell + key: i for i, key in enumerate(("LAC", "CellId", "BandInfo", "SCN", "UARFCN"))}
             | {cell + "CellRadioAccessTechnology": cell + "RadioAccessTechnologyUTRAN2", cell + "CellType": cell + "CellType" + kind} for kind in ("Serving", "Serving", "Neighbor")]
    inputs["cells"] = record(1, plistlib.dumps(cells, fmt=plistlib.FMT_BINARY), 0xFF)
    inputs["d0e0-short"] = b"\x81\x00" + record(0xD0E0, b"")
    return inputs


def gsm_records():
    lengths = {0x4005: 32, 0x4031: 44, 0x4116: 34, 0x4125: 14, 0x4127: 29, 0x4157: 19, 0x417A: 134, 0x4221: 360, 0x5072: 20, 0x5076: 17, 0x512C: 17,
               0x5134: 26, 0x5137: 57, 0x51F4: 15, 0x51F5: 18, 0x51F6: 24, 0x51F8: 19, 0x51FB: 34, 0x51FD: 35, 0x51FF: 23, 0x7130: 16, 0x7131: 16,
               0x7132: 16, 0x7135: 32, 0x7150: 26}
    counts = {0x4005: (13, 14), 0x4031: (14,), 0x4116: (13,), 0x417A: (15,), 0x4221: (16, 17), 0x5137: (28,), 0x51F8: (14,), 0x51FF: (14,), 0x7150: (16,)}
    inputs = binary_records(lengths, {code: [(offset, 1) for offset in offsets] for code, offsets in counts.items()})
    cell = "kRKCellMonitor"
    numbers = {cell + key: i for i, key in enumerate(("MCC", "MNC", "LAC", "CellId", "UARFCN", "ARFCN", "SCN", "RSCP", "ECN0", "RSSI"))}
    cells = [numbers | {cell + "CellRadioAccessTechnology": cell + "RadioAccessTechnology" + technology, cell + "CellType": cell + "CellType" + kind}
             for technology in ("UMTS", "GSM") for kind in ("Serving", "Neighbor")]
    inputs["cells"] = record(1, plistlib.dumps(cells, fmt=plistlib.FMT_BINARY), 0xFF)
    inputs["sim"] = record(0, plistlib.dumps({"kSimFile_ICCID": "89"}, fmt=plistlib.FMT_BINARY), 0xFF)
    inputs["contexts"] = b"\x81\x00" + record(2, plistlib.dumps([{"APN": "internet"}], fmt=plistlib.FMT_BINARY), 0xFF)
    return inputs


def seeds():
    lists = {"everything.xml": plistlib.dumps(EVERYTHING, sort_keys=False), "everything.bin": plistlib.dumps(EVERYTHING, fmt=plistlib.FMT_BINARY, sort_keys=False)}
    lists["one.bin"] = plistlib.dumps(True, fmt=plistlib.FMT_BINARY)
    lists["plain.xml"] = b"<plist><dict><key>a</key><integer>0x1F</integer></dict></plist>"
    lists["head.xml"] = HEAD + b"<plist version=\"1.0\"><true/></plist>"
    lists["utf16.xml"] = "<plist><string>\u00e4</string></plist>".encode("utf-16")
    lists["entity.xml"] = b"<!DOCTYPE plist [<!ENTITY a \"b\">]><plist><string>&a;</string></plist>"
    a, b, c = record(0xB0C2, b"\x05" * 25), record(0x0C00, b"<plist/>", 0xFF), b"\x81\x2a" + record(0xB0C3, b"xy")
    entry = {"DisplayState": a + b + c, "Display": {}, "ExtraInfo": {}, "Date": "2024-03-05 14:07:31 +0000", "Description": "Snapshot"}
    refused = {"DisplayState": a + b"short" + record(1, b"", 0x10) + a + b, "Display": {}, "Date": "2024-03-05 14:07:33 +0000"}
    dlf = version_report() + (a + b + c)[1:] + (c + a)[1:] + a[1:]
    recordings = {
        "micro.pcap": capture(150, [a, b, c]), "nano.pcap": capture(148, [a, b], "<", 0xA1B23C4D), "swapped.pcap": capture(151, [c, a], ">"),
        "foreign.pcap": capture(1, [a]), "cut.pcap": capture(147, [a, b])[:-7], "history.dlf": dlf, "cut.dlf": dlf[:-5], "bare.dlf": a[1:] + b[1:],
        "history.spectrel": snapshot([entry, refused, {"Description": "DLF binary", "DLF": dlf}], plistlib.FMT_XML),
        "history.bin.spectrel": snapshot([entry, refused], plistlib.FMT_BINARY),
        "reports.spectrel": snapshot([{"DisplayState": {"Cell": {"ARFCN": "12"}}, "Date": "never"}], plistlib.FMT_XML),
    }
    cap = capture(150, [a, b, c])
    streams = {
        "capture": b"\x06" + cap, "two-captures": b"\x11" + cap + capture(148, [c, b"short", a], ">"), "lost": b"\x00" + cap[:30] + cap[37:] + cap[24:],
        "noise": b"\x03" + cap + b"noise between the packets" + cap[24:], "dlf": b"\x05" + dlf, "messages": b"\x40" + 3 * (a + b + c),
        "damaged-dlf": b"\x02" + dlf + bytes(30) + 3 * (a + b + c), "pcapng": b"\x01\x0a\x0d\x0d\x0a",
    }
    return {"fuzz_property_list": lists, "fuzz_recording": recordings, "fuzz_stream": streams,
            "fuzz_update_gsm": gsm_records(),
            "fuzz_update_lte": lte_records(), "fuzz_update_utran": utran_records(),
            "fuzz_update_cdma": cdma(), "fuzz_update_ifx": ifx()}


def messages(golden):
    data = (HERE / "../../Tests/Golden" / golden).read_bytes()
    place = 24
    while place < len(data):
        size = struct.unpack_from("<I", data, place + 8)[0]
        yield data[place + 16:place + 16 + size]
        place += 16 + size


def cdma():
    seeds = {}
    for message in messages("cdma-drive.pcap"):  # the last of each code
        seeds[f"{struct.unpack_from('<H', message, 3)[0]:04x}"] = message
    chain = struct.pack("<BBH", 1, 255, 0)
    seeds["endless"] = record(0x119C, chain + struct.pack("<BBH", 1, 0, 0) + bytes(20))
    seeds["escaping"] = record(0x119D, chain + struct.pack("<BBH", 9, 0, 0xFFFF))
    seeds["at-bound"] = record(0x119D, struct.pack("<BBH", 1, 1, 0) + struct.pack("<BBH", 11, 0, 21))
    seeds["missing"] = record(0x119C, struct.pack("<BBH", 1, 1, 0) + struct.pack("<BBHI", 1, 0, 8, 8))
    seeds["wrapped"] = b"\x81\x00" + seeds["1183"]
    seeds["wrong-type"] = b"\x02" + seeds["1183"][1:]
    return seeds


def ifx():
    whole = next(messages("ifx-drive.pcap"))
    nested = [["h", {"a": {"b": {"c": "x"}}}, []], {"n": 5, "d": b"x", "t": True}, "text"]
    return {"report": whole, "binary": plistlib.dumps(plistlib.loads(whole), fmt=plistlib.FMT_BINARY),
            "nested": plistlib.dumps(nested), "number": plistlib.dumps(5), "text": plistlib.dumps("x"), "cut": whole[:200]}


for target, inputs in seeds().items():
    (HERE / target).mkdir(exist_ok=True)
    for name, content in inputs.items():
        (HERE / target / f"seed-{name}").write_bytes(content)
