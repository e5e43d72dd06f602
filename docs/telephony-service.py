#!/usr/bin/env python3
"""A telephony service in sixty lines: answers for an LTE baseband and streams one serving-cell record a second.

Usage: telephony-service.py PORT_DIRECTORY        docs/message-ports.md tells what every line here is for.
"""

import fcntl
import os
import plistlib
import selectors
import socket
import struct
import sys

SERVICE, CHANNEL = "org.spectrel.Telephony", "org.spectrel.Telephony.LogChannel.1"
ONE_WAY, REQUEST, REPLY = 1, 2, 3
HEADER = struct.Struct("<BBHiI")  # mark, kind, zero, message id, sequence number


def serve(directory, name):
    """Takes a port's name: its lock first, then the socket, whatever a dead process has left there."""
    lock = open(os.path.join(directory, f".{name}.lock"), "w")
    fcntl.flock(lock, fcntl.LOCK_EX | fcntl.LOCK_NB)
    path = os.path.join(directory, name)
    if os.path.exists(path):
        os.unlink(path)
    port = socket.socket(socket.AF_UNIX, socket.SOCK_SEQPACKET)
    port.bind(path)
    port.listen()
    return port, lock


def answer(request):
    """What a request is answered with, and the client's local port when it asks for a log channel."""
    if "CreateLogChannel" in request:
        return {"Domain": 0, "Error": 0, "PortName": CHANNEL}, request["CreateLogChannel"]
    if "GetTechnology" in request:
        return {"GetTechnology": "kRKLogChannelTechnology_Zephyr_LTE"}, None
    return {"Error": "the request cannot be understood"}, None


def serving_cell(number):
    payload = struct.pack("<BHHHBBIHI6x", 2, number % 504, 1300, 19300, 100, 100, 257, 1201, 3)
    return b"\x01" + struct.pack("<HHQ", 12 + len(payload), 0xB0C2, 0) + payload


def main(directory):
    os.makedirs(directory, mode=0o700, exist_ok=True)
    ready = selectors.DefaultSelector()
    listening = [serve(directory, name) for name in (SERVICE, CHANNEL)]
    for port, _ in listening:
        ready.register(port, selectors.EVENT_READ, "connection")
    client, sent = None, 0
    while True:
        for key, _ in ready.select(timeout=1):
            if key.data == "connection":
                ready.register(key.fileobj.accept()[0], selectors.EVENT_READ, "packet")
                continue
            packet = key.fileobj.recv(HEADER.size + 256 * 1024)
            if not packet:  # the peer has closed its end
                ready.unregister(key.fileobj)
                key.fileobj.close()
                continue
            _, kind, _, message_id, sequence = HEADER.unpack_from(packet)
            reply, client_port = answer(plistlib.loads(packet[HEADER.size:]))
            if client_port:
                client = socket.socket(socket.AF_UNIX, socket.SOCK_SEQPACKET)
                client.connect(os.path.join(directory, client_port))
            if kind == REQUEST:
                key.fileobj.send(HEADER.pack(0x53, REPLY, 0, message_id, sequence) + plistlib.dumps(reply))
        if client:
            try:
                client.send(HEADER.pack(0x53, ONE_WAY, 0, 0, 0) + serving_cell(sent))
                sent += 1
            except OSError:
                client = None


if __name__ == "__main__":
    main(sys.argv[1])
