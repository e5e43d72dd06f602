"""The telephony service on a modem: a mocked ModemManager, and the real daemon, on a private system bus."""

import fcntl
import json
import os
import plistlib
import shutil
import signal
import socket
import struct
import subprocess
import time
import unittest

from harness import WAIT, Place

HERE = os.path.dirname(os.path.abspath(__file__))
PYTHON = "/usr/bin/python3"  # the one that Debian's modules belong to
SIM, CELLS, CONTEXTS = 0, 1, 2  # codes of the extra stream
MODEM = "org.freedesktop.ModemManager1.Modem"
BUS = """<busconfig>
  <listen>unix:path={path}</listen>
  <auth>EXTERNAL</auth>
  <policy context="default">
    <allow user="*"/> <allow own="*"/> <allow send_type="method_call"/> <allow send_type="signal"/>
    <allow send_type="method_return"/> <allow send_type="error"/> <allow receive_type="method_call"/>
    <allow receive_type="signal"/> <allow receive_type="method_return"/> <allow receive_type="error"/>
    {rules}
  </policy>
  {include}
</busconfig>
"""
# What the daemon's own policy amounts to, for a user who is not root.
DENIED = f'<deny send_destination="org.freedesktop.ModemManager1" send_interface="{MODEM}" send_member="GetCellInfo"/>'


class Channel:
    """A log channel of the test's own, that wants the three property-list records; ends with the test."""

    HEADER = struct.Struct("<BBHiI")

    def __init__(self, place, name="test"):
        self.place = place
        self.lock = open(place.path("ports", f".{name}.lock"), "w")
        fcntl.flock(self.lock, fcntl.LOCK_EX)
        self.port = self.socket()
        self.port.bind(place.path("ports", name))
        self.port.listen()
        service = self.connect("org.spectrel.Telephony")
        opened = self.ask(service, 1, {"CreateLogChannel": name})
        service.close()
        self.inbound, _ = self.port.accept()
        self.inbound.settimeout(WAIT)
        self.requests = self.connect(opened["PortName"])
        self.technology = self.ask(self.requests, 0, {"GetTechnology": "GetTechnology"})["GetTechnology"]
        self.tell({"SetState": "Streaming", "SetZephyrLogCodes": [], "SetRkExtraCodes": [SIM, CELLS, CONTEXTS]})
        place.addCleanup(self.close)

    def socket(self):
        made = socket.socket(socket.AF_UNIX, socket.SOCK_SEQPACKET)
        made.settimeout(WAIT)
        return made

    def connect(self, name):
        made = self.socket()
        made.connect(self.place.path("ports", name))
        return made

    def ask(self, peer, number, request):
        peer.send(self.HEADER.pack(0x53, 2, 0, number, 1) + plistlib.dumps(request))
        return plistlib.loads(peer.recv(300000)[self.HEADER.size:])

    def tell(self, command):
        self.requests.send(self.HEADER.pack(0x53, 1, 0, 0, 0) + plistlib.dumps(command))

    def next(self, code=None):
        """The next record's code and payload, of that code if it is given; None at the channel's end."""
        while packet := self.inbound.recv(300000):
            record = packet[self.HEADER.size:]
            found, = struct.unpack_from("<H", record, 3)
            if code in (None, found):
                return found, plistlib.loads(record[13:])
        return None

    def payload(self, code):
        return self.next(code)[1]

    def wait_for(self, code, condition):
        """The next payload of the code that fulfils the condition."""
        end = time.monotonic() + WAIT
        while not condition(payload := self.payload(code)):
            self.place.assertLess(time.monotonic(), end, f"the last of code {code} was {payload}")
        return payload

    def wait_end(self):
        """Waits until the service ends the channel."""
        while self.next():
            pass

    def close(self):
        for held in (self.port, self.inbound, self.requests, self.lock):
            held.close()


def cell(payload, place=0):
    """A cell dictionary with its keys and constants shortened."""
    def short(text):
        return text.replace("kRKCellMonitor", "") if isinstance(text, str) else text

    return {short(key): short(value) for key, value in payload[place].items()}


class ModemPlace(Place):
    """A test with a system bus of its own."""

    def start_bus(self, rules="", include=""):
        configuration = self.write("bus.conf", BUS.format(path=self.path("bus"), rules=rules, include=include).encode())
        self.environment["DBUS_SYSTEM_BUS_ADDRESS"] = "unix:path=" + self.path("bus")
        return super().start_bus("--config-file=" + configuration)

    def background(self, command, log, **options):
        with open(self.path(log), "w") as errors:
            return self.run_background(command, stderr=errors, **options)

    def start_script(self, name):
        script = self.background([PYTHON, "-B", os.path.join(HERE, name)], name + ".log", stdin=subprocess.PIPE,
                                 stdout=subprocess.PIPE)
        self.assertEqual(self.next_line(script), "ready\n", self.text(name + ".log"))
        return script

    def start_mock(self):
        self.mock = self.start_script("modem_mock.py")

    def command(self, do, **arguments):
        self.mock.stdin.write(json.dumps({"do": do, **arguments}) + "\n")
        self.mock.stdin.flush()
        return json.loads(self.next_line(self.mock))

    def rates(self):
        return [arguments[0] for name, arguments in self.command("calls") if name == "Setup"]

    def start_modem(self, *arguments, **modem):
        """The bus, the mock with one modem, and the telephony service on it."""
        self.bus = self.start_bus()
        self.start_mock()
        self.command("add", **modem)
        service = self.start_modem_service(*arguments)
        self.wait_told("using modem 0")
        return service

    def start_modem_service(self, *arguments):
        return self.start_service("--modem", *arguments)

    def text(self, name):
        with open(self.path(name)) as file:
            return file.read()


class Technologies(ModemPlace):
    def test_lte_is_displayed(self):
        self.start_modem(technology="lte")
        display = self.watch_until(self.start_watch("--format", "json"), lambda display: display["PDP Context Info"]
                                   and display["SIM Info"]["EF-ICCID"] != "-"
                                   and display["Serving Cell Info"]["Physical Cell ID"] != "-")
        serving = display["Serving Cell Info"]
        self.assertEqual({key: serving[key] for key in ("Physical Cell ID", "Cell Identity", "Tracking Area Code",
                                                        "Freq Band Indicator", "UARFCN")},
                         {"Physical Cell ID": "416", "Cell Identity": "30322048", "Tracking Area Code": "28670",
                          "Freq Band Indicator": "3", "UARFCN": "1300"})
        self.assertEqual({key: value for key, value in display["SIM Info"].items() if value != "-"},
                         {"EF-ICCID": "8900101000000000017", "EF-MSISDN": "+10015550100", "EF-ACTING HPLMN": "001-01",
                          "EF-PLMN NETWORK NAME": "Test Network"})
        self.assertEqual(display["PDP Context Info"],
                         [{"Context ID": "3", "APN": "internet.test", "Type": "IPv4v6", "Interface": "wwan0",
                           "Address": "192.0.2.17", "IPv6 Address": "2001:db8::17", "Gateway": "192.0.2.1",
                           "DNS": "192.0.2.53", "State": "Active", "Bytes Received": "1000", "Bytes Sent": "2000"}])

    def test_lte_cells_and_their_measurements(self):
        self.start_modem(technology="lte")
        channel = Channel(self)
        self.assertEqual(channel.technology, "kRKLogChannelTechnology_Zephyr_LTE")
        cells = channel.wait_for(CELLS, lambda cells: "kRKCellMonitorSNR" in cells[0])
        self.assertEqual(len(cells), 2, "the 5G cell is left out")
        self.assertEqual(cell(cells), {
            "CellRadioAccessTechnology": "RadioAccessTechnologyLTE", "CellType": "CellTypeServing", "MCC": 1, "MNC": 1,
            "PLMN": "001-001", "CellId": 0x1CEAD80, "TAC": 0x6FFE, "PID": 0x1A0, "BandInfo": 3, "UARFCN": 1300,
            "RSRP": -91, "RSRQ": -10, "RSSI": -60, "SNR": 14})
        self.assertEqual(cell(cells, 1), {
            "CellRadioAccessTechnology": "RadioAccessTechnologyLTE", "CellType": "CellTypeNeighbor", "PID": 0x1A1,
            "BandInfo": 20, "UARFCN": 6300, "RSRP": -101, "RSRQ": -14})

    def test_umts_is_of_the_gsm_baseband(self):
        self.start_modem(technology="umts")
        channel = Channel(self)
        self.assertEqual(channel.technology, "kRKLogChannelTechnology_Zephyr_GSM")
        cells = channel.wait_for(CELLS, lambda cells: cells[0]["kRKCellMonitorRSCP"] != 32767)
        self.assertEqual(cell(cells), {
            "CellRadioAccessTechnology": "RadioAccessTechnologyUMTS", "CellType": "CellTypeServing", "MCC": 1, "MNC": 1,
            "PLMN": "001-01", "CellId": 0xD30156, "LAC": 0x8BE3, "UARFCN": 10700, "SCN": 301, "RSCP": -85, "ECN0": -8,
            "RSSI": -70})
        self.assertEqual(cell(cells, 1), {
            "CellRadioAccessTechnology": "RadioAccessTechnologyUMTS", "CellType": "CellTypeNeighbor", "UARFCN": 10700,
            "SCN": 302, "RSCP": -97, "ECN0": -12})

    def test_gsm(self):
        self.start_modem(technology="gsm")
        channel = Channel(self)
        self.assertEqual(channel.technology, "kRKLogChannelTechnology_Zephyr_GSM")
        cells = channel.payload(CELLS)
        self.assertEqual(cell(cells, 1), {
            "CellRadioAccessTechnology": "RadioAccessTechnologyGSM", "CellType": "CellTypeNeighbor", "MCC": 1, "MNC": 1,
            "PLMN": "001-01", "CellId": 0x2BB0, "LAC": 0x84CD, "ARFCN": 62, "RSSI": -45})
        self.assertEqual(cell(cells)["CellType"], "CellTypeServing")

    def test_cdma_has_its_technology(self):
        self.start_modem(technology="cdma")
        self.assertEqual(Channel(self).technology, "kRKLogChannelTechnology_Zephyr_CDMA")

    def test_change_of_technology_ends_the_channel_and_the_application_asks_again(self):
        self.start_modem(technology="lte")
        watching = self.start_watch("--format", "json")
        self.watch_until(watching, lambda display: "Serving Cell Info" in display)
        channel = Channel(self)
        self.command("become", technology="umts")
        while channel.next():
            pass
        self.wait_told("the technology is now gsm")
        self.watch_until(watching, lambda display: "Serving Cell Info" not in display)
        self.assertEqual(Channel(self, "second").technology, "kRKLogChannelTechnology_Zephyr_GSM")

    def test_unknown_technology_keeps_the_last_known(self):
        self.start_modem(technology="lte")
        channel = Channel(self)
        self.command("become", technology="none")
        self.command("traffic", received=1, sent=1)
        channel.wait_for(CONTEXTS, lambda contexts: contexts[0]["Bytes Sent"] == "1")
        self.assertEqual(Channel(self, "second").technology, "kRKLogChannelTechnology_Zephyr_LTE")


class Streaming(ModemPlace):
    def test_cells_are_polled(self):
        self.start_modem()
        channel = Channel(self)
        channel.payload(CELLS)
        self.wait_until(lambda: [name for name, _ in self.command("calls")].count("GetCellInfo") >= 2,
                        "the cells were asked for but once")

    def test_changes_come_by_themselves(self):
        self.start_modem()
        channel = Channel(self)
        self.command("traffic", received=5_000_000_000, sent=7)
        contexts = channel.wait_for(CONTEXTS, lambda contexts: contexts[0]["Bytes Sent"] == "7")
        self.assertEqual(contexts[0]["Bytes Received"], "5000000000")
        self.wait_until(lambda: self.rates() == [2], "the signal was not asked for")  # which measures it once
        self.command("signal", technology="lte", values={"rsrp": -77.0})
        channel.wait_for(CELLS, lambda cells: cells[0].get("kRKCellMonitorRSRP") == -77)

    def test_signal_rate_is_put_back_when_the_service_ends(self):
        service = self.start_modem(rate=10)
        channel = Channel(self)
        channel.payload(CELLS)
        self.assertEqual(self.rates(), [2])
        service.send_signal(signal.SIGTERM)
        self.assertEqual(service.wait(WAIT), 0)
        self.assertEqual(self.rates(), [2, 10])

    def test_signal_rate_is_put_back_when_the_last_client_leaves(self):
        self.start_modem(rate=30)
        channel = Channel(self)
        channel.payload(CELLS)
        channel.close()
        self.wait_until(lambda: self.rates() == [2, 30], "the rate was not put back")

    def test_modem_that_takes_its_time_holds_nobody_up(self):
        self.start_modem(cells="hanging")
        channel = Channel(self)
        self.assertEqual(channel.payload(SIM)["kSimFile_PNN"], "Test Network")
        self.assertEqual(Channel(self, "second").technology, "kRKLogChannelTechnology_Zephyr_LTE")

    def test_recorded_session_decodes_to_the_same_values(self):
        self.start_modem()
        recording = self.start("spectrel", "record", self.path("modem.pcap"), stderr=subprocess.DEVNULL)
        self.wait_until(lambda: self.recorded_channel() == "1300", "the serving cell was not recorded")
        recording.send_signal(signal.SIGINT)
        self.assertEqual(recording.wait(WAIT), 0)
        self.assertEqual(self.recorded_channel(), "1300")

    def recorded_channel(self):
        done = self.run_spectrel("decode", "--format", "json", self.path("modem.pcap"))
        display = json.loads(done.stdout or "{}")
        return "Serving Cell Info" in display and display["Serving Cell Info"]["UARFCN"]

    def test_subscriber_identities_and_passwords_stay_out_of_the_log_and_passwords_out_of_the_stream(self):
        service = self.start_modem(cells="denied")
        channel = Channel(self)
        contexts = channel.payload(CONTEXTS)
        self.assertNotIn("secret", str(contexts))
        self.assertNotIn("somebody", str(contexts))
        channel.payload(CELLS)
        self.command("remove")
        self.wait_told("waiting for one")
        service.send_signal(signal.SIGTERM)
        service.wait()
        for identity in ("8900101", "00101012345", "35000000", "5550100", "secret"):
            self.assertNotIn(identity, self.told())


class Shortcomings(ModemPlace):
    def test_modem_without_cell_list_tells_its_serving_cell(self):
        self.start_modem(cells="unsupported")
        channel = Channel(self)
        cells = channel.wait_for(CELLS, lambda cells: "kRKCellMonitorRSRP" in cells[0])
        self.assertEqual(len(cells), 1)
        self.assertEqual(cell(cells), {
            "CellRadioAccessTechnology": "RadioAccessTechnologyLTE", "CellType": "CellTypeServing", "MCC": 1, "MNC": 1,
            "PLMN": "001-001", "CellId": 0x1CEAD80, "TAC": 0x6FFE, "RSRP": -91, "RSRQ": -10, "RSSI": -60, "SNR": 14})
        self.assertIn("modem 0 (MOCK-1) cannot list its cells", self.told())

    def assert_denied(self):
        for number in (1, 2):  # the second client has it tried, and denied, again
            channel = Channel(self, f"test-{number}")
            cells = channel.payload(CELLS)
            self.assertEqual(cell(cells)["TAC"], 0x6FFE)
            self.assertEqual(len(cells), 1)
            channel.close()
            self.wait_told("is gone, after", number)
        self.assertEqual(self.told().count("may not list the modem's cells"), 1)
        self.assertIn("spectrel-modem.conf", self.told())

    def test_cell_list_denied_by_modemmanager(self):
        self.start_modem(cells="denied")
        self.assert_denied()

    def test_cell_list_denied_by_the_bus(self):
        self.start_bus(rules=DENIED)
        self.start_mock()
        self.command("add")
        self.start_modem_service()
        self.assert_denied()
        self.assertNotIn("GetCellInfo", str(self.command("calls")), "the bus let it through")

    def test_shipped_policy_permits_the_cell_list_to_its_group(self):
        shipped = os.path.join(HERE, "..", "..", "packaging", "spectrel-modem.conf")
        with open(shipped) as file:
            policy = file.read()
        self.assertIn('<policy group="spectrel">', policy)
        self.write("permit.conf", policy.replace('group="spectrel"', f'group="{os.getgid()}"').encode())
        self.start_bus(rules=DENIED, include=f"<include>{self.path('permit.conf')}</include>")
        self.start_mock()
        self.command("add")
        self.start_modem_service()
        self.assertEqual(cell(Channel(self).payload(CELLS))["PID"], 0x1A0)

    def test_modem_without_a_sim(self):
        self.start_modem(sim=False)
        files = Channel(self).payload(SIM)
        self.assertEqual(set(files.values()), {"-"})
        self.assertIn("using modem 0 (MOCK-1), without a SIM", self.told())

    def test_modem_that_is_not_registered(self):
        self.start_modem(technology="none", registered=False, cells="unsupported")
        channel = Channel(self)
        self.assertEqual(channel.technology, "kRKLogChannelTechnology_Zephyr_GSM")
        self.assertEqual(channel.payload(CELLS), [])


class Presence(ModemPlace):
    def test_unplugged_modem_ends_the_channels_and_a_plugged_one_is_heard_in_new_ones(self):
        self.start_modem()
        channel = Channel(self)
        self.assertEqual(len(channel.payload(CELLS)), 2)
        self.command("remove")
        channel.wait_end()
        self.wait_told("modem 0 (MOCK-1) is no longer used")
        self.wait_told("no modem; waiting for one")
        channel = Channel(self, "anew")
        self.assertEqual(channel.technology, "kRKLogChannelTechnology_Zephyr_LTE", "the last one")
        self.command("add", number=1)
        channel.wait_for(CELLS, lambda cells: len(cells) == 2)
        self.wait_told("using modem 1 (MOCK-1)")

    def test_programs_go_on_with_the_next_modem(self):
        self.start_modem(technology="lte")
        watching = self.start_watch("--format", "json")
        self.watch_until(watching, lambda display: display["SIM Info"]["EF-ICCID"] == "8900101000000000017")
        self.command("remove")
        self.command("add", number=1, sim=False, model="MOCK-2")
        self.watch_until(watching, lambda display: display["SIM Info"]["EF-ICCID"] == "-")

    def test_modem_may_come_after_the_service(self):
        self.start_bus()
        self.start_mock()
        self.start_modem_service()
        self.wait_told("no modem; waiting for one")
        channel = Channel(self)
        self.assertEqual(channel.technology, "kRKLogChannelTechnology_Zephyr_GSM")
        self.command("add", technology="umts")
        self.assertEqual(cell(channel.payload(CELLS))["LAC"], 0x8BE3)

    def test_modemmanager_may_come_be_killed_and_come_again(self):
        self.start_bus()
        self.start_modem_service()
        self.wait_told("no ModemManager on the system bus; waiting for it")
        self.start_mock()
        self.command("add", technology="gsm")
        self.wait_told("using modem 0 (MOCK-1)")
        channel = Channel(self)
        self.assertEqual(len(channel.payload(CELLS)), 2)
        self.mock.kill()
        channel.wait_end()
        channel = Channel(self, "anew")
        self.start_mock()
        self.command("add", technology="gsm", number=3)
        channel.wait_for(CELLS, lambda cells: len(cells) == 2)

    def test_registered_modem_is_chosen(self):
        self.start_bus()
        self.start_mock()
        self.command("add", number=0, registered=False, model="FIRST")
        self.command("add", number=1, model="SECOND")
        self.start_modem_service()
        self.wait_told("using modem 1 (SECOND)")

    def test_modem_can_be_named(self):
        self.start_bus()
        self.start_mock()
        self.command("add", number=0, model="FIRST")
        self.command("add", number=1, model="SECOND")
        for name in ("1", "/org/freedesktop/ModemManager1/Modem/1", "second", "cdc-wdm1"):
            with self.subTest(name=name):
                service = self.start_modem_service(name)
                self.wait_told("using modem 1 (SECOND)")
                service.send_signal(signal.SIGTERM)
                self.assertEqual(service.wait(WAIT), 0)

    def test_lost_bus_is_found_again(self):
        self.start_modem()
        channel = Channel(self)
        self.bus.kill()
        self.bus.wait()
        channel.wait_end()
        channel = Channel(self, "anew")
        self.wait_told("the system bus is gone")
        self.start_bus()
        self.mock.kill()
        self.start_mock()
        self.command("add", number=5)
        channel.wait_for(CELLS, lambda cells: len(cells) == 2)


class Refusals(ModemPlace):
    def test_without_a_system_bus_the_service_says_so_and_ends(self):
        self.environment["DBUS_SYSTEM_BUS_ADDRESS"] = "unix:path=" + self.path("nowhere")
        done = self.run_spectrel("--modem", program="spectrel-telephonyd")
        self.assertEqual(done.returncode, 1)
        self.assertTrue(done.stderr.startswith("spectrel-telephonyd: there is no system bus to reach modems by: "),
                        done.stderr)
        self.assertEqual(done.stderr.count("\n"), 1)

    def test_modem_and_another_source_are_wrong_usage(self):
        done = self.run_spectrel("--modem", "--simulate", "lte", program="spectrel-telephonyd")
        self.assertEqual(done.returncode, 2)


class RealDaemon(ModemPlace):
    def start_daemon(self):
        self.start_bus()
        self.modem = self.start_script("virtual_modem.py")
        daemon = shutil.which("ModemManager", path=os.environ["PATH"] + ":/usr/sbin:/sbin")
        self.background([daemon, "--test-enable", "--test-no-udev", "--test-no-suspend-resume"], "daemon.log")

    def obey(self, command):
        self.modem.stdin.write(command + "\n")
        self.modem.stdin.flush()
        self.assertEqual(self.next_line(self.modem), "done\n", self.text("virtual_modem.py.log"))

    def test_without_a_modem(self):
        self.start_daemon()
        self.start_modem_service()
        self.wait_told("no modem; waiting for one")
        self.assertEqual(Channel(self).technology, "kRKLogChannelTechnology_Zephyr_GSM")

    def test_with_its_virtual_modem(self):
        self.start_daemon()
        self.start_modem_service()
        self.wait_told("no modem; waiting for one")
        self.obey("plug")
        self.wait_told("using modem 0 (AT-1), not enabled")
        channel = Channel(self)
        files = channel.wait_for(SIM, lambda files: files["kSimFile_ICCID"] != "-")
        self.assertEqual(files["kSimFile_ICCID"], "8990010100000000017")
        self.obey("enable")
        cells = channel.wait_for(CELLS, lambda cells: cells and "kRKCellMonitorCellId" in cells[0])
        self.assertEqual(cell(cells), {
            "CellRadioAccessTechnology": "RadioAccessTechnologyGSM", "CellType": "CellTypeServing", "MCC": 1, "MNC": 1,
            "PLMN": "001-01", "CellId": 0x2BAF, "LAC": 0x84CD, "RSSI": 32767})
        self.wait_told("modem 0 (AT-1) cannot list its cells")


if __name__ == "__main__":
    unittest.main()
