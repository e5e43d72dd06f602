#!/usr/bin/env python3
"""Writes the seeds of the property-list and recording corpora beside itself; found inputs stay as they are."""
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
    return {"fuzz_property_list": lists, "fuzz_recording": recordings, "fuzz_stream": streams}


for target, inputs in seeds().items():
    (HERE / target).mkdir(exist_ok=True)
    for name, content in inputs.items():
        (HERE / target / f"seed-{name}").write_bytes(content)
