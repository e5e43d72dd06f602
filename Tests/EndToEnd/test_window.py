"""The graphical screens in a real window, used as a person would: an X server of its own, a mouse and a keyboard."""

import glob
import os
import plistlib
import signal
import subprocess
import time
import unittest

from harness import LTE_SECTIONS, WAIT, Place, capture, serving_cell, sim_files

MARKER = "VexelInternal/Library/PreferenceBundles/Carrier Settings.bundle"
WIDTH, HEIGHT = 480, 800
ROW = 90  # the middle of the first row; each has 50 pixels


class Window(Place):
    @classmethod
    def setUpClass(cls):
        read_end, write_end = os.pipe()
        cls.server = subprocess.Popen(["Xvfb", "-noreset", "-displayfd", str(write_end), "-screen", "0", "800x1000x24"],
                                      pass_fds=[write_end], stderr=subprocess.DEVNULL)
        os.close(write_end)
        with os.fdopen(read_end) as answer:
            cls.display = ":" + answer.readline().strip()

    @classmethod
    def tearDownClass(cls):
        cls.server.terminate()
        cls.server.wait()

    def setUp(self):
        super().setUp()
        runtime = self.path("runtime")
        os.mkdir(runtime, 0o700)
        self.environment.update({"DISPLAY": self.display, "XDG_RUNTIME_DIR": runtime})
        self.log = self.path("log")

    def allow_saving(self):
        os.makedirs(self.path("device", MARKER))

    def xdotool(self, *arguments):
        return subprocess.run(["xdotool", *arguments], env=self.environment, text=True, capture_output=True)

    def open(self, *arguments, program="spectrel"):
        """Starts the program and gives its window the keyboard, as a window manager would."""
        self.output = open(self.path("output"), "w+")
        self.addCleanup(self.output.close)
        process = self.start(program, *arguments, stdout=self.output, stderr=subprocess.STDOUT)
        self.wait_until(lambda: self.window(process), "no window came")
        self.xdotool("windowfocus", "--sync", self.window(process))
        return process

    def window(self, process):
        return self.xdotool("search", "--onlyvisible", "--pid", str(process.pid)).stdout.strip()

    def title(self, process):
        return self.xdotool("getwindowname", self.window(process)).stdout.strip()

    def see_title(self, process, title):
        """The window's title is that of the pane in sight."""
        self.wait_until(lambda: self.title(process).startswith(title),
                        f"the title never was {title}, but {self.title(process)}")

    def key(self, *keys):
        self.xdotool("key", *keys)

    def type(self, text):
        self.xdotool("type", text)

    def click(self, x, y):
        self.xdotool("mousemove", str(x), str(y), "click", "1")

    def drag(self, x, y, to_x, to_y):
        self.xdotool("mousemove", str(x), str(y), "mousedown", "1")
        for step in range(1, 11):
            self.xdotool("mousemove", str(x + (to_x - x) * step // 10), str(y + (to_y - y) * step // 10))
        self.xdotool("mouseup", "1")

    def picture(self, x=0, y=0, width=WIDTH, height=HEIGHT):
        """The pixels of a part of the screen."""
        return subprocess.run(["import", "-silent", "-window", "root", "-crop", f"{width}x{height}+{x}+{y}", "rgb:-"],
                              env=self.environment, capture_output=True, check=True).stdout

    def see_change(self, before, x, y, width, height, what):
        self.wait_until(lambda: self.picture(x, y, width, height) != before, what)

    def shows_row(self):
        """There is something where the first row's name stands."""
        pixels = self.picture(20, 70, 300, 40)
        return len({pixels[at:at + 3] for at in range(0, len(pixels), 3)}) > 4

    def see_row(self):
        self.wait_until(self.shows_row, "no row came")

    def wait_until_still(self, *place):
        """Nothing slides any more."""
        last = [None]

        def same():
            now = self.picture(*place)
            last[0], was = now, last[0]
            return now == was
        self.wait_until(same, "the picture never stood still")

    def logged(self):
        with open(self.log) as file:
            return file.read()

    def snapshots(self):
        return glob.glob(self.path("crash", "*.spectrel"))

    def printed(self):
        self.output.seek(0)
        return self.output.read()

    def end(self, process, how=signal.SIGTERM):
        process.send_signal(how)
        self.assertEqual(process.wait(WAIT), 0)

    def home_screen_preference(self):
        with open(self.path("config", "spectrel", "org.spectrel.HomeScreen.conf")) as file:
            return file.read()

    def replay(self, *messages, **options):
        file = self.write(f"{len(self.processes)}.pcap", capture(messages, **options))
        return self.start_service("--replay", file, "--speed", "0")


class Session(Window):
    def test_browse_save_and_fail_to_save(self):
        self.allow_saving()
        self.start_service("--simulate", "lte")
        process = self.open("--log", self.log)
        self.see_title(process, "Spectrel")
        self.see_row()

        # Three levels down by the mouse, and back.
        self.wait_until_still(0, 60, WIDTH, 600)
        self.click(150, ROW + 50 * LTE_SECTIONS.index("PDP Context Info"))
        self.see_title(process, "PDP Context Info")
        self.wait_until_still(0, 60, WIDTH, 600)
        self.click(150, ROW)
        self.see_title(process, "0")
        self.wait_until_still(0, 0, WIDTH, 60)
        self.click(28, 30)
        self.see_title(process, "PDP Context Info")
        self.key("Escape")
        self.see_title(process, "Spectrel")
        self.wait_until_still(0, 60, WIDTH, 600)

        # Saved with a description that is not confirmed.
        self.click(448, 772)
        self.wait_until_still()
        self.type("Below the mast")
        pressed = time.time()
        self.key("ctrl+s")
        self.wait_until(self.snapshots, "no snapshot was written")
        self.check_snapshot(self.snapshots()[0], pressed)

        # What stands in the directory's place lets nobody write, not even the administrator.
        self.wait_until_still()
        os.rename(self.path("crash"), self.path("crash-before"))
        self.write("crash", b"")
        self.key("ctrl+s")
        self.wait_until_still()
        self.key("ctrl+s")
        self.wait_until(lambda: "<3>Unable to write snapshot to " + self.path("crash") in self.logged(),
                        "the failure was not logged")
        self.wait_until_still()
        alert = self.picture()
        self.key("Return")
        self.see_change(alert, 0, 0, WIDTH, HEIGHT, "the alert did not close")
        self.wait_until_still(0, 60, WIDTH, 600)
        self.key("Return")
        self.see_title(process, "PDP Context Info")  # the save screen is closed: the pane takes the keys

        self.end(process)
        self.assertEqual(self.printed(), "Deallocing LTEClassIndex\nDeallocing ClassIndex\n")
        self.assertIn("THShowGSMRSSI=false", self.home_screen_preference())

    def check_snapshot(self, path, pressed):
        self.assertEqual(os.stat(path).st_mode & 0o777, 0o600)
        with open(path, "rb") as file:
            head = file.read(200)
            file.seek(0)
            snapshot = plistlib.load(file)
        self.assertIn(b"<?xml", head)
        self.assertEqual(list(snapshot), ["Timestamp", "Data", "Description"])
        self.assertEqual(snapshot["Description"], "Below the mast")
        opened = time.mktime(time.strptime(snapshot["Timestamp"], "%Y-%m-%d %H:%M:%S +0000")) - time.timezone
        self.assertLessEqual(opened, pressed)
        saved = int(os.path.basename(path)[len("SpectrelSnapshot-"):-len(".spectrel")])
        self.assertGreaterEqual(saved, int(pressed))
        *history, log = snapshot["Data"]
        self.assertTrue(1 <= len(history) <= 5)
        for entry in history:
            self.assertEqual(list(entry), ["DisplayState", "Display", "ExtraInfo", "Date", "Description"])
            self.assertIn("Serving Cell Info", entry["Display"])
        self.assertTrue(log["DLF"])

    def test_long_value_scrolls_sideways_in_its_row(self):
        self.replay(serving_cell(321), sim_files(ICCID="8" * 80, IMSI="42"))
        process = self.open("--gui")
        self.see_row()
        self.key(*["Down"] * (1 + LTE_SECTIONS.index("SIM Info")), "Return")  # the first marks the first row
        self.see_title(process, "SIM Info")
        self.wait_until_still(0, 60, WIDTH, 600)
        row = self.picture(0, 65, WIDTH, 48)
        below = self.picture(0, 116, WIDTH, 200)
        self.drag(400, 90, 150, 90)
        self.see_change(row, 0, 65, WIDTH, 48, "the value did not move")
        self.wait_until_still(0, 60, WIDTH, 600)
        self.assertEqual(self.picture(0, 116, WIDTH, 200), below, "another row moved, too")
        self.end(process)

    def test_every_way_out_shuts_the_application_down(self):
        for way in (signal.SIGINT, signal.SIGHUP):
            with self.subTest(way=way):
                process = self.open("--gui")
                self.end(process, way)
                self.assertIn("THShowGSMRSSI=false", self.home_screen_preference())
                os.remove(self.path("config", "spectrel", "org.spectrel.HomeScreen.conf"))
        process = self.open("--gui")
        self.key("ctrl+q")
        self.assertEqual(process.wait(WAIT), 0)
        self.assertIn("THShowGSMRSSI=false", self.home_screen_preference())

    def test_second_start_raises_the_window_of_the_first(self):
        first = self.open("--gui")
        other = self.open("view", self.write("one.pcap", capture([serving_cell(7)])), "--gui")
        self.see_row()  # it covers the first window, which has no rows
        second = self.run_spectrel("--gui")
        self.assertEqual((second.returncode, second.stdout, second.stderr), (0, "", ""))
        self.wait_until(lambda: not self.shows_row(), "the first window did not come to the front")
        self.end(other)
        self.end(first)

    def test_exception_of_a_record_keeps_the_data(self):
        garbage = b"\xff" + (16).to_bytes(2, "little") + bytes(10) + b"bad!"
        self.replay(serving_cell(5), garbage)
        process = self.start("spectrel", "--gui", stdout=subprocess.DEVNULL, stderr=subprocess.PIPE)
        self.assertEqual(process.wait(WAIT), -signal.SIGABRT)
        self.assertIn("UnknownDataException", process.stderr.read())
        self.assertEqual(len(self.snapshots()), 1)

    def test_without_a_service_it_says_so(self):
        process = self.open("--gui", "--log", self.log)
        self.wait_until(lambda: "RKServerConnection" in self.logged(), "no attempt was logged")
        self.see_title(process, "Spectrel")
        self.end(process)
        self.assertEqual(self.printed(), "")


class Viewing(Window):
    def test_recording_plays_and_seeks(self):
        file = self.write("drive.pcap", capture([serving_cell(identity) for identity in range(1, 40)]))
        process = self.open("view", file, "--gui")
        self.see_row()
        self.key("Return")
        self.see_title(process, "Serving Cell Info")
        self.wait_until_still()
        start = self.picture(0, 65, WIDTH, 48)
        self.key("5")
        self.see_change(start, 0, 65, WIDTH, 48, "seeking showed nothing new")
        self.wait_until_still()
        middle = self.picture(0, 65, WIDTH, 48)
        self.key("comma")
        self.see_change(middle, 0, 65, WIDTH, 48, "a step back showed nothing new")
        self.wait_until_still()
        stepped = self.picture(0, 65, WIDTH, 48)
        self.key("space")
        self.see_change(stepped, 0, 65, WIDTH, 48, "playing showed nothing new")
        self.end(process)

    def test_snapshot_shows_its_entries(self):
        recording = self.write("one.pcap", capture([serving_cell(7)]))
        self.run_spectrel("decode", "--format", "none", "--snapshot", self.path("crash"), recording)
        process = self.open("view", self.snapshots()[0], "--gui")
        self.see_row()
        self.key("Return")
        self.see_title(process, "Snapshot (")
        self.end(process)
        self.assertFalse(os.path.exists(self.path("config", "spectrel")), "viewing wrote a preference")

    def test_file_of_another_kind_is_refused_in_one_line(self):
        file = self.write("notes.txt", b"nothing of ours")
        result = self.run_spectrel("view", file, "--gui")
        self.assertEqual(result.returncode, 1)
        self.assertEqual(len(result.stderr.splitlines()), 1)
        self.assertIn("notes.txt", result.stderr)


if __name__ == "__main__":
    unittest.main()
