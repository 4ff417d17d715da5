"""How the program kdx-rds ends: whatever makes it end, the instrument is let go, and in time.

Usage: ending_test.py PATH-OF-KDX-RDS PATH-OF-THE-RECORDING-VISA-LIBRARY
"""

import os
import pathlib
import re
import shutil
import signal
import subprocess
import sys
import tempfile
import time
import unittest

import shippeddata

PROGRAM = ""
LIBRARY = ""
PATIENCE = 120  # seconds, on a machine with much else to do


class Ending(unittest.TestCase):
    def setUp(self):
        self.home = pathlib.Path(tempfile.mkdtemp(prefix="kdx-rds-test-"))
        self.addCleanup(shutil.rmtree, self.home)

    def folder(self, name, address, atStart="AUTO"):
        """A program folder whose settings open the session to that address at the start."""
        folder = self.home / name
        shippeddata.copyTo(folder / "Daten")
        settings = folder / "Daten" / "RDS_Allg.INI"
        text = settings.read_bytes()
        for key, value in (("IECBUS", atStart), ("INTERFACE", "TCPIP"), ("KDX_TCPIP", address)):
            text, found = re.subn(rb"(?im)^(%s=).*?\r$" % key.encode(), rb"\g<1>%s\r" % value.encode(), text)
            self.assertEqual(found, 1, key)
        settings.write_bytes(text)
        return folder

    def start(self, folder, *options, display=None, **how):
        shown = {"QT_QPA_PLATFORM": "xcb", "DISPLAY": display} if display else {"QT_QPA_PLATFORM": "offscreen"}
        environment = dict(os.environ, HOME=str(self.home), KDX_VISA_RECORD=str(folder / "record"), **shown)
        process = subprocess.Popen([PROGRAM, "--visa-library", LIBRARY, "--app-folder", str(folder), *options],
                                   stdout=subprocess.PIPE, stderr=subprocess.STDOUT, text=True, env=environment, **how)
        self.addCleanup(process.stdout.close)
        self.addCleanup(process.wait)
        self.addCleanup(process.kill)
        return process

    @staticmethod
    def record(folder):
        try:
            return (folder / "record").read_text().splitlines()
        except FileNotFoundError:
            return []

    def waitForTheFirstWrite(self, folder, process):
        self.waitFor(process, lambda: "write" in self.record(folder))

    def waitFor(self, process, condition):
        end = time.monotonic() + PATIENCE
        while not condition():
            self.assertIsNone(process.poll(), "it ended by itself")
            self.assertLess(time.monotonic(), end, "nothing happens")
            time.sleep(0.02)

    def testARequestOfTheSystemClosesTheSession(self):
        programs = {}
        for name in ("SIGTERM", "SIGINT", "SIGHUP"):
            folder = self.folder(name, "lab")
            programs[name] = (folder, self.start(folder))
        for name, (folder, process) in programs.items():
            with self.subTest(signal=name):
                self.waitForTheFirstWrite(folder, process)
                process.send_signal(getattr(signal, name))
                self.assertEqual(process.wait(PATIENCE), 0, process.stdout.read())
                self.assertEqual(self.record(folder)[0], "open TCPIP::lab::INSTR")
                self.assertEqual(self.record(folder)[-1], "close")
                self.assertEqual(self.record(folder).count("close"), 1)

    @unittest.skipUnless(shutil.which("Xvfb"), "no Xvfb")
    def testTheLossOfTheDisplayClosesTheSession(self):
        server = subprocess.Popen(["Xvfb", "-displayfd", "1", "-nolisten", "tcp"], stdout=subprocess.PIPE,
                                  stderr=subprocess.DEVNULL, text=True)
        self.addCleanup(server.stdout.close)
        self.addCleanup(server.wait)
        self.addCleanup(server.kill)
        folder = self.folder("display", "lab")
        process = self.start(folder, display=":" + server.stdout.readline().strip())
        self.waitForTheFirstWrite(folder, process)
        server.kill()
        self.assertNotEqual(process.wait(PATIENCE), 0)
        self.assertEqual(self.record(folder)[-1], "close")
        self.assertEqual(self.record(folder).count("close"), 1)

    def testABoxOverADeadInstrumentIsClosedAndTheRestIsNotSent(self):
        folder = self.folder("box", "dead")
        process = self.start(folder)
        self.waitForTheFirstWrite(folder, process)
        time.sleep(1)  # the box is there, and waits
        self.assertIsNone(process.poll())
        asked = time.monotonic()
        process.terminate()
        self.assertEqual(process.wait(PATIENCE), 0, process.stdout.read())
        self.assertLess(time.monotonic() - asked, 30)
        self.assertEqual(self.record(folder), ["open TCPIP::dead::INSTR", "write", "close"])

    def lockedFolder(self):
        """One whose general settings cannot be written, though the start has something to store."""
        folder = self.folder("locked", "lab", "MANUAL")
        settings = folder / "Daten" / "RDS_Allg.INI"
        # Without a state of the pilot tone the start stores one.
        settings.write_bytes(re.sub(rb"(?m)^PILOT=.*\r\n", b"", settings.read_bytes()))
        settings.chmod(0o444)
        return folder

    def testTheTourTellsAtItsEndWhatCouldNotBeSaved(self):
        folder = self.lockedFolder()
        process = self.start(folder, "--tour", str(folder / "pictures"))
        printed = process.communicate(timeout=PATIENCE)[0]
        self.assertEqual(process.returncode, 0, printed)
        self.assertIn("changed last in RDS_Allg.INI could not be saved", printed)

    def testWhatCouldNotBeSavedIsToldAtTheEnd(self):
        folder = self.lockedFolder()
        process = self.start(folder)
        self.waitFor(process, (folder / "Daten" / "RDS_log.txt").exists)  # comes after that
        time.sleep(1)
        process.terminate()
        self.assertEqual(process.wait(PATIENCE), 0)
        self.assertIn("changed last in RDS_Allg.INI could not be saved", process.stdout.read())

    def testWhoSwitchedTheHangUpOffKeepsTheProgram(self):
        folder = self.folder("nohup", "dead")
        process = self.start(folder, preexec_fn=lambda: signal.signal(signal.SIGHUP, signal.SIG_IGN))
        self.waitForTheFirstWrite(folder, process)
        process.send_signal(signal.SIGHUP)
        time.sleep(2)
        self.assertIsNone(process.poll())

    def testTheTourClosesWhateverItOpened(self):
        for name, atStart in (("once", ""), ("twice", "AUTO")):
            with self.subTest(atStart=atStart):
                folder = self.folder(name, "lab", atStart)
                process = self.start(folder, "--tour", str(folder / "pictures"))
                printed = process.communicate(timeout=PATIENCE)[0]
                self.assertEqual(process.returncode, 0, printed)
                calls = [line.split()[0] for line in self.record(folder) if line != "write"]
                self.assertEqual(calls, ["open", "close"] * (2 if atStart else 1))

    def testAnExceptionAtTheStartAndInTheTourIsShownLikeThatOfAHandler(self):
        folder = self.folder("broken", "broken")
        process = self.start(folder, "--tour", str(folder / "pictures"))
        printed = process.communicate(timeout=PATIENCE)[0]
        self.assertEqual(process.returncode, 1, printed)
        boxes = [line for line in printed.splitlines() if line.startswith("!!")]
        self.assertEqual(boxes, ['!! Fehler: Bei "HMenue": the library is broken'] * 2)

    def testAfterAnExceptionAtTheStartTheWindowGoesOn(self):
        folder = self.folder("window", "broken")
        process = self.start(folder)
        self.waitFor(process, lambda: "broken" in self.record(folder))
        time.sleep(2)
        self.assertIsNone(process.poll())
        process.terminate()
        self.assertEqual(process.wait(PATIENCE), 0, process.stdout.read())


if __name__ == "__main__":
    LIBRARY = os.path.abspath(sys.argv.pop(2))
    PROGRAM = os.path.abspath(sys.argv.pop(1))
    unittest.main(verbosity=2)
