"""What kdx-ctl air writes: the groups of a data set and of commands, with their times.

Usage: ctl_air_test.py PATH-OF-KDX-CTL
"""

import json
import pathlib
import shutil
import subprocess
import sys
import tempfile
import unittest

import shippeddata

CTL = ""
DONE, FAILED, WRONG_CALL = 0, 1, 2
RDS_ON = ":STEREO:RDS:STATE ON\n"


class Air(unittest.TestCase):
    def setUp(self):
        self.folder = pathlib.Path(tempfile.mkdtemp(prefix="kdx-ctl-air-"))
        self.addCleanup(shutil.rmtree, self.folder)
        shippeddata.copyTo(self.folder / "Daten")

    def air(self, *arguments, expect=DONE, before=()):
        run = subprocess.run([CTL, "--app-folder", str(self.folder), *before, "air", *arguments], capture_output=True,
                             text=True, timeout=60)
        self.assertEqual(run.returncode, expect, run.stdout + run.stderr)
        return run

    def lines(self, *arguments):
        return self.air("--start", "2026-01-01 12:00:00", "--groups", "-", *arguments).stdout.splitlines()

    def write(self, name, text, encoding="cp1252"):
        (self.folder / name).write_bytes(text.encode(encoding))
        return str(self.folder / name)

    def testADataSetIsOnTheAir(self):
        """TALWELLE, D7A2, type 1, speech; 91.7, 104.2, 88.1 MHz are the codes 42, 167, 6; then 93.6 is 61, 97.9 104."""
        self.assertEqual(self.lines("--data-set", "2", "--seconds", "0.4"), [
            "D7A2 0020 E32A 5441 @2026/01/01 12:00:00.09",
            "D7A2 0021 A706 4C57 @2026/01/01 12:00:00.18",
            "D7A2 0022 E32A 454C @2026/01/01 12:00:00.26",
            "D7A2 0027 3D68 4C45 @2026/01/01 12:00:00.35"])

    def testADataSetFileIsOnTheAir(self):
        file = self.write("Bench.INI", "[RDS]\r\nPI=ABCD\r\nPS=BENCH\r\nPTY=0\r\nMS=M\r\nGR_FOLGE=0A\r\n")
        self.assertEqual(self.lines("--file", file, "--seconds", "0.1"), ["ABCD 0008 E0CD 4245 @2026/01/01 12:00:00.09"])

    def testAMinuteHoldsTheGroupsThatFitWholly(self):
        """1187.5 bit/s in 60 s are 685 times 104 bits and 10 bits."""
        file = self.folder / "groups.txt"
        run = self.air("--data-set", "2", "--start", "2026-12-31 23:59:00", "--groups", str(file))
        self.assertEqual(run.stdout, "")
        lines = file.read_text().splitlines()
        self.assertEqual(len(lines), 685)
        self.assertTrue(lines[-1].endswith(" @2026/12/31 23:59:59.99"), lines[-1])
        self.assertEqual(len(self.lines("--data-set", "2", "--seconds", "0.087")), 0)
        self.assertEqual(len(self.lines("--data-set", "2", "--seconds", "0.088")), 1)

    def testWithoutADataSetTheInstrumentIsAsAfterSwitchingOn(self):
        self.assertEqual(self.lines(), [])
        file = self.write("on.txt", RDS_ON)
        self.assertEqual(self.lines("--commands", file, "--seconds", "0.1"),
                         ["1000 0008 E0CD 4B44 @2026/01/01 12:00:00.09"])

    def testCommandsComeAtTheirTimesOnTopOfADataSet(self):
        """A group that begins at 0.175 s is the first after the command; umlauts of both encodings are 91 there."""
        text = '@ 0.1 :STEREO:DIRECT "PS=äX"\r\n:STEREO:DIRECT "GS=0A"\r\n:STEREO:DIRECT "AF=N,87.6"\r\n'
        for encoding in ("cp1252", "utf-8-sig"):
            with self.subTest(encoding):
                file = self.write("commands.txt", text, encoding)
                words = [line.split()[:4] for line in self.lines("--data-set", "2", "--commands", file,
                                                                 "--seconds", "0.4")]
                self.assertEqual(words, [["D7A2", "0020", "E101", "5441"], ["D7A2", "0021", "E101", "4C57"],
                                         ["D7A2", "0020", "E101", "9158"], ["D7A2", "0021", "E101", "2020"]])

    def testTheClockGroupEndsNearestToTheFullMinute(self):
        """1 January 2026 is MJD 61041, 01 and 110 1110 0111 0001; 12:01 is 0 1100 and 000001."""
        file = self.write("commands.txt", RDS_ON + '@ 10 :STEREO:DIRECT "CT=12:00:10,01.01.26"')
        clocks = [line for line in self.lines("--commands", file, "--seconds", "119") if line[5:8] == "400"]
        self.assertEqual(clocks, ["1000 4001 DCE2 C040 @2026/01/01 12:00:59.99"])

    def testALogIsCarriedOut(self):
        log = self.write("RDS_log.txt", '            RDS= ":stereo:rds:state ON"\r\n'
                                        '             PI= ":STEREO:DIRECT "PI=BEEF""\r\n')
        self.assertEqual(self.lines("--log", log, "--seconds", "0.1"),
                         ["BEEF 0008 E0CD 4B44 @2026/01/01 12:00:00.09"])

    def testWhatCannotBeSentAsItIsWarnsAndIsDoneAllTheSame(self):
        file = self.write("commands.txt", RDS_ON + ':STEREO:DIRECT "PI=XYZ"\n:STEREO:DIRECT "AF=N,87.6,108.0"\n'
                                                   '@ 0.1 :STEREO:DIRECT "PS=A^"\n')
        run = self.air("--commands", file, "--groups", "-", "--seconds", "1")
        self.assertEqual(len(run.stdout.splitlines()), 11)
        self.assertEqual(run.stderr.splitlines(), [
            'warning: refused: :STEREO:DIRECT "PI=XYZ" (-224,"Illegal parameter value")',
            "warning: AF list 1: 108.0 MHz has no code and is left out",
            'warning: PS: "^" has no place in the RDS character set and is sent as a blank'])

    def testJsonIsOneDocument(self):
        file = self.write("commands.txt", RDS_ON + ":NONSENSE\n")
        run = self.air("--commands", file, "--groups", "-", "--seconds", "0.1", "--start", "2026-01-01 12:00:00",
                       before=["--json"])
        self.assertEqual(json.loads(run.stdout), {
            "exit_code": 0, "groups": 1, "lines": ["1000 0008 E0CD 4B44 @2026/01/01 12:00:00.09"],
            "warnings": ['refused: :NONSENSE (-113,"Undefined header")']})

    def testAWrongCallIsToldWithExitCode2(self):
        log = self.write("log.txt", "what is this, a letter?\r\n")
        commands = self.write("commands.txt", "@ soon *RST\n")
        for call in ((), ("--data-set", "2"), ("--groups", "-", "--seconds", "0"),
                     ("--groups", "-", "--seconds", "2,5"), ("--groups", "-", "--seconds", "nan"),
                     ("--groups", "-", "--start", "2026-02-30 12:00:00"), ("--groups", "-", "--start", "noon"),
                     ("--groups", "-", "--data-set", "6"), ("--groups", "-", "--commands", "missing.txt"),
                     ("--groups", "-", "--log", "missing.txt"), ("--groups", "-", "--log", log),
                     ("--groups", "-", "--commands", commands), ("--groups", "-", "--file", "missing.INI")):
            with self.subTest(call):
                run = self.air(*call, expect=WRONG_CALL)
                self.assertEqual(run.stdout, "")
                self.assertNotEqual(run.stderr, "")

    def testAFileThatCannotBeWrittenFails(self):
        run = self.air("--data-set", "2", "--groups", str(self.folder / "missing" / "groups.txt"), expect=FAILED)
        self.assertIn("cannot be written", run.stderr)
        if pathlib.Path("/dev/full").exists():
            self.air("--data-set", "2", "--groups", "/dev/full", expect=FAILED)


if __name__ == "__main__":
    CTL = sys.argv.pop(1)
    unittest.main()
