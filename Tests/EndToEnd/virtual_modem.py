#!/usr/bin/python3
"""A virtual AT modem for the real ModemManager daemon, on the system bus of the environment; a GSM modem that is
registered and can list no cells. Says "ready" once the daemon may start; obeys lines on standard input, each answered
by "done":

    plug     gives the daemon the modem
    enable   enables it
"""

import socket
import sys
import threading
import uuid

import dbus
import dbus.mainloop
import dbus.mainloop.glib
from dbusmock.mockobject import DBusMockObject
from gi.repository import GLib

NAME, ROOT = "org.freedesktop.ModemManager1", "/org/freedesktop/ModemManager1"
POLKIT, AUTHORITY = "org.freedesktop.PolicyKit1", "/org/freedesktop/PolicyKit1/Authority"
ANSWERS = {
    "+CGMI": "Test", "+CGMM": "AT-1", "+CGMR": "1.0", "+CGSN": "350000000000001", "+GCAP": "+GCAP: +CGSM,+DS,+ES",
    "+CPIN?": "+CPIN: READY", "+CIMI": "001010123456789", "+CFUN?": "+CFUN: 1", "+CSQ": "+CSQ: 20,99",
    "+CREG?": '+CREG: 2,1,"84CD","2BAF",0', "+CGREG?": '+CGREG: 2,1,"84CD","2BAF",0', "+COPS?": '+COPS: 0,2,"00101",0',
    "+CRSM=176,12258,0,0,10": '+CRSM: 144,0,"980910100000000010F7"', "+CNUM": '+CNUM: ,"+10015550100",145',
    "+CGDCONT=?": '+CGDCONT: (1-11),"IP",,,(0,1),(0,1)', "+WS46=?": "+WS46: (12,22)", "+CLCK=?": '+CLCK: ("SC")',
}
ACCEPTED = {"", "E0", "V1", "+CMEE=1", "X4", "&C1", "Z", "I", "+CREG=2", "+CGREG=2", "+COPS=3,2", "+COPS=3,0", "+CFUN=1"}


def answer(line):
    command = line.strip().removeprefix("AT")
    if command in ANSWERS:
        return f"\r\n{ANSWERS[command]}\r\n\r\nOK\r\n"
    return "\r\nOK\r\n" if command in ACCEPTED else "\r\nERROR\r\n"


def serve(connection):
    gathered = b""
    while data := connection.recv(4096):
        gathered += data
        *lines, gathered = gathered.split(b"\r")
        for line in lines:
            if line.strip():
                connection.sendall(answer(line.decode(errors="replace")).encode())


def listen(port):
    server = socket.socket(socket.AF_UNIX, socket.SOCK_STREAM)
    server.bind("\0" + port)
    server.listen()

    def accept():
        while True:
            connection, _ = server.accept()
            threading.Thread(target=serve, args=(connection,), daemon=True).start()

    threading.Thread(target=accept, daemon=True).start()


def obey(bus, port, command):
    if command == "plug":
        daemon = dbus.Interface(bus.get_object(NAME, ROOT), NAME + ".Test")
        daemon.SetProfile("p1", "generic", [port])
    elif command == "enable":
        dbus.Interface(bus.get_object(NAME, ROOT + "/Modem/0"), NAME + ".Modem").Enable(True, timeout=120)


def main():
    dbus.mainloop.glib.threads_init()
    dbus.mainloop.glib.DBusGMainLoop(set_as_default=True)
    bus = dbus.SystemBus()
    polkit = DBusMockObject(dbus.service.BusName(POLKIT, bus), AUTHORITY, POLKIT + ".Authority", {}, logfile="/dev/null")
    polkit.AddTemplate("polkitd", {})
    polkit.allow_unknown = True
    port = f"abstract:spectrel-test-{uuid.uuid4()}"  # the daemon takes the prefix for a part of the name
    listen(port)
    loop = GLib.MainLoop()

    def commands():
        # A thread and a connection of its own, which the loop must not touch: the daemon asks the authority above
        # while it carries a command out.
        for line in sys.stdin:
            obey(dbus.SystemBus(private=True, mainloop=dbus.mainloop.NULL_MAIN_LOOP), port, line.strip())
            print("done", flush=True)
        loop.quit()

    threading.Thread(target=commands, daemon=True).start()
    print("ready", flush=True)
    loop.run()


if __name__ == "__main__":
    main()
