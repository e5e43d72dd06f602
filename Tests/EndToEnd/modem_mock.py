#!/usr/bin/python3
"""A mocked ModemManager on the system bus of the environment, driven by lines of JSON on standard input.

Each line is {"do": COMMAND, ...}; each is answered by one line of JSON once it is done. Commands:

    add      a modem: "number", "technology" (gsm, umts, lte, cdma), "sim", "cells" (listed, denied, unsupported,
             hanging: from then on the whole service answers nothing), "registered", "model", "rate"
    remove   the modem "number", as when it is unplugged
    become   the modem "number" changes to "technology"
    signal   the modem "number" measures "values" on "technology"
    traffic  the bearer of the modem "number" has "received" and "sent" so many bytes
    calls    answers the methods called on the modem "number", with their arguments
"""

import json
import signal
import sys

import dbus
import dbus.mainloop.glib
from dbusmock.mockobject import DBusMockObject, objects
from gi.repository import GLib

NAME = "org.freedesktop.ModemManager1"
ROOT = "/org/freedesktop/ModemManager1"
MODEM = NAME + ".Modem"
TECHNOLOGIES = {"none": 0, "gsm": 1 << 1, "edge": 1 << 4, "umts": 1 << 5, "hspa": 1 << 8, "cdma": 1 << 10, "lte": 1 << 14}
SIGNALS = {
    "gsm": {"rssi": -71.0},
    "umts": {"rssi": -70.0, "rscp": -85.0, "ecio": -7.5},
    "lte": {"rssi": -60.0, "rsrp": -91.0, "rsrq": -10.0, "snr": 14.0},
    "cdma": {"rssi": -80.0},
}
CELLS = {
    "gsm": [
        {"cell-type": dbus.UInt32(2), "serving": True, "operator-id": "00101", "lac": "84CD", "ci": "2BAF",
         "arfcn": dbus.UInt32(50), "rx-level": dbus.UInt32(40)},
        {"cell-type": dbus.UInt32(2), "serving": False, "operator-id": "00101", "lac": "84CD", "ci": "2BB0",
         "arfcn": dbus.UInt32(62), "rx-level": dbus.UInt32(21)},
    ],
    "umts": [
        {"cell-type": dbus.UInt32(3), "serving": True, "operator-id": "00101", "lac": "8BE3", "ci": "D30156",
         "uarfcn": dbus.UInt32(10700), "psc": dbus.UInt32(301)},
        {"cell-type": dbus.UInt32(3), "serving": False, "uarfcn": dbus.UInt32(10700), "psc": dbus.UInt32(302),
         "rscp": -97.0, "ecio": -12.0},
    ],
    "lte": [
        {"cell-type": dbus.UInt32(5), "serving": True, "operator-id": "001001", "tac": "6FFE", "ci": "1CEAD80",
         "physical-ci": "1A0", "earfcn": dbus.UInt32(1300), "rsrp": -93.0, "rsrq": -11.0},
        {"cell-type": dbus.UInt32(5), "serving": False, "physical-ci": "1A1", "earfcn": dbus.UInt32(6300),
         "rsrp": -101.0, "rsrq": -14.0},
        {"cell-type": dbus.UInt32(6), "serving": False, "physical-ci": "2", "nrarfcn": dbus.UInt32(630000)},
    ],
    "cdma": [],
}
LOCATIONS = {
    "gsm": "001,01,84CD,2BAF,0",
    "umts": "001,01,8BE3,D30156,0",
    "lte": "001,001,FFFE,1CEAD80,6FFE",
}


class Mock:
    def __init__(self):
        self.technologies = {}  # of the modems, by number
        name = dbus.service.BusName(NAME, dbus.SystemBus(), do_not_queue=True)
        self.root = DBusMockObject(name, ROOT, NAME, {}, logfile="/dev/null", is_object_manager=True)
        objects[ROOT] = self.root

    @staticmethod
    def path(kind, number):
        return f"{ROOT}/{kind}/{number}"

    def modem(self, number):
        return objects[self.path("Modem", number)]

    def change(self, path, interface, **properties):
        """Sets properties and tells of them; the mock's own UpdateProperties takes no dictionaries."""
        changed = dbus.Dictionary(properties, signature="sv")
        objects[path].props[interface].update(changed)
        objects[path].EmitSignal("org.freedesktop.DBus.Properties", "PropertiesChanged", "sa{sv}as",
                                 [interface, changed, dbus.Array([], signature="s")])

    def add(self, number=0, technology="lte", sim=True, cells="listed", registered=True, model="MOCK-1",
            rate=0):
        self.technologies[number] = technology
        modem_path, sim_path, bearer_path = (self.path(kind, number) for kind in ("Modem", "SIM", "Bearer"))
        if sim:
            self.root.AddObject(sim_path, NAME + ".Sim", dbus.Dictionary({
                "SimIdentifier": "8900101000000000017", "Imsi": "001010123456789", "OperatorIdentifier": "00101",
                "OperatorName": "Test Network"}, signature="sv"), [])
        self.root.AddObject(bearer_path, NAME + ".Bearer", dbus.Dictionary({
            "Interface": "wwan0", "Connected": True, "Suspended": False, "ProfileId": dbus.Int32(3),
            "Properties": dbus.Dictionary({"apn": "internet.test", "ip-type": dbus.UInt32(4), "user": "somebody",
                                           "password": "secret"}, signature="sv"),
            "Ip4Config": dbus.Dictionary({"method": dbus.UInt32(2), "address": "192.0.2.17", "gateway": "192.0.2.1",
                                          "dns1": "192.0.2.53"}, signature="sv"),
            "Ip6Config": dbus.Dictionary({"method": dbus.UInt32(2), "address": "2001:db8::17"}, signature="sv"),
            "Stats": dbus.Dictionary({"rx-bytes": dbus.UInt64(1000), "tx-bytes": dbus.UInt64(2000)}, signature="sv"),
        }, signature="sv"), [])
        self.root.AddObject(modem_path, MODEM, dbus.Dictionary({
            "Model": model, "PrimaryPort": f"cdc-wdm{number}", "State": dbus.Int32(8 if registered else 6),
            "EquipmentIdentifier": "350000000000001",
            "AccessTechnologies": dbus.UInt32(TECHNOLOGIES[technology]),
            "OwnNumbers": dbus.Array(["+10015550100"], signature="s"),
            "Sim": dbus.ObjectPath(sim_path if sim else "/"),
            "Bearers": dbus.Array([dbus.ObjectPath(bearer_path)], signature="o"),
        }, signature="sv"), [])
        modem = objects[modem_path]
        modem.AddProperties(MODEM + ".Modem3gpp", dbus.Dictionary({
            "OperatorCode": "00101" if registered else "", "Imei": "350000000000001",
            "InitialEpsBearer": dbus.ObjectPath("/")}, signature="sv"))
        modem.AddProperties(MODEM + ".Signal", dbus.Dictionary({
            "Rate": dbus.UInt32(rate), "Gsm": self.nothing(), "Umts": self.nothing(), "Lte": self.nothing()},
            signature="sv"))
        modem.AddProperties(MODEM + ".Location", dbus.Dictionary({"Enabled": dbus.UInt32(1)}, signature="sv"))
        modem.AddMethod(MODEM, "GetCellInfo", "", "aa{sv}", lambda _: self.list_cells(number, cells))
        modem.AddMethod(MODEM + ".Signal", "Setup", "u", "", lambda _, rate: self.set_rate(number, rate))
        modem.AddMethod(MODEM + ".Location", "GetLocation", "", "a{uv}", lambda _: self.locate(number))
        self.root.object_manager_emit_added(modem_path)

    @staticmethod
    def nothing():
        return dbus.Dictionary({}, signature="sv")

    def list_cells(self, number, cells):
        if cells == "denied":
            raise dbus.exceptions.DBusException("operation not allowed", name=NAME + ".Error.Core.Unauthorized")
        if cells == "unsupported":
            raise dbus.exceptions.DBusException("not supported", name=NAME + ".Error.Core.Unsupported")
        if cells == "hanging":
            signal.pause()
        return dbus.Array([dbus.Dictionary(cell, signature="sv") for cell in CELLS[self.technologies[number]]],
                          signature="a{sv}")

    def set_rate(self, number, rate):
        self.change(self.path("Modem", number), MODEM + ".Signal", Rate=dbus.UInt32(rate))
        if rate:
            technology = self.technologies[number]
            self.signal(technology, SIGNALS[technology], number)

    def locate(self, number):
        place = LOCATIONS.get(self.technologies[number])
        return dbus.Dictionary({dbus.UInt32(1): place} if place else {}, signature="uv")

    def remove(self, number=0):
        self.root.object_manager_emit_removed(self.path("Modem", number))
        for kind in ("Modem", "SIM", "Bearer"):
            if self.path(kind, number) in objects:
                self.root.RemoveObject(self.path(kind, number))

    def become(self, technology, number=0):
        self.technologies[number] = technology
        self.change(self.path("Modem", number), MODEM, AccessTechnologies=dbus.UInt32(TECHNOLOGIES[technology]))

    def signal(self, technology, values, number=0):
        self.change(self.path("Modem", number), MODEM + ".Signal",
                    **{technology.capitalize(): dbus.Dictionary(values, signature="sv")})

    def traffic(self, received, sent, number=0):
        self.change(self.path("Bearer", number), NAME + ".Bearer", Stats=dbus.Dictionary(
            {"rx-bytes": dbus.UInt64(received), "tx-bytes": dbus.UInt64(sent)}, signature="sv"))

    def calls(self, number=0):
        return [[str(name), [int(argument) for argument in arguments]]
                for _, name, arguments in self.modem(number).call_log if name != "GetAll"]

    def do(self, do, **arguments):
        return getattr(self, do)(**arguments)


def main():
    dbus.mainloop.glib.DBusGMainLoop(set_as_default=True)
    mock = Mock()
    loop = GLib.MainLoop()

    def obey(_channel, _condition):
        line = sys.stdin.readline()
        if not line:
            loop.quit()
            return False
        print(json.dumps(mock.do(**json.loads(line))), flush=True)
        return True

    GLib.io_add_watch(0, GLib.PRIORITY_DEFAULT, GLib.IO_IN | GLib.IO_HUP, obey)
    print("ready", flush=True)
    loop.run()


if __name__ == "__main__":
    main()
