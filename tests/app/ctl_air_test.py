"""What kdx-ctl air writes: the groups of a data set and of commands, with their times, and their multiplex.

Usage: ctl_air_test.py PATH-OF-KDX-CTL
"""

import array
import json
import pathlib
import resource
import shutil
import signal
import struct
import subprocess
import sys
import tempfile
import time
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

    def testWhatTheUserWillHaveWantedOtherwiseIsTold(self):
        silent = self.air("--groups", "-", "--seconds", "0.5")
        self.assertEqual((silent.stdout, silent.stderr),
                         ("", "warning: no group goes out: RDS is off, or a test pattern on\n"))
        file = self.write("commands.txt", RDS_ON + ":STEREO:STATE OFF\n@ 5 :STEREO:DIRECT \"TA=1\"\n@ 6 *CLS\n")
        late = self.air("--commands", file, "--mpx", str(self.folder / "x.wav"), "--seconds", "1").stderr
        self.assertIn("warning: the stereo coder is off: the multiplex is silent\n", late)
        self.assertIn("warning: commands that come after the end are left out: 2\n", late)

    def testNoFileIsTwoThings(self):
        file = self.write("commands.txt", RDS_ON)
        (self.folder / "link").symlink_to(file)
        for call in (("--groups", "same", "--mpx", "same"), ("--commands", file, "--groups", file),
                     ("--commands", file, "--mpx", str(self.folder / "link")), ("--log", file, "--groups", file),
                     ("--groups", "same", "--mpx", "./same")):
            with self.subTest(call):
                self.assertIn("is named twice", self.air(*call, "--seconds", "1", expect=WRONG_CALL).stderr)
        self.assertEqual(pathlib.Path(file).read_text(), RDS_ON)

    def testARequestToEndIsHeardWhileCommandsAreCarriedOut(self):
        """Judged by what it takes of the processor, as others may work beside it: a tenth of the commands is measured,
        and the end asked for after two tenths."""
        def begun(count):
            file = self.write("commands.txt", ':STEREO:DIRECT "AF=N,98.5,87.6,88.1,88.2"\n' * count)
            command = [CTL, "--app-folder", str(self.folder), "air", "--commands", file, "--groups", "-"]
            return subprocess.Popen(command, stdout=subprocess.DEVNULL, stderr=subprocess.PIPE)

        def taken():
            return resource.getrusage(resource.RUSAGE_CHILDREN).ru_utime

        before = taken()
        begun(20000).communicate(timeout=60)
        tenth = taken() - before
        process = begun(200000)
        time.sleep(2 * tenth)
        process.terminate()
        before = taken()
        self.assertIn(b"stopped", process.communicate(timeout=60)[1])
        self.assertLess(taken() - before, 5 * tenth)
        self.assertEqual(process.returncode, FAILED)

    def testJsonIsOneDocument(self):
        file = self.write("commands.txt", RDS_ON + ":NONSENSE\n")
        run = self.air("--commands", file, "--groups", "-", "--seconds", "0.1", "--start", "2026-01-01 12:00:00",
                       before=["--json"])
        self.assertEqual(json.loads(run.stdout), {
            "exit_code": 0, "groups": 1, "lines": ["1000 0008 E0CD 4B44 @2026/01/01 12:00:00.09"],
            "warnings": ['refused: :NONSENSE (-113,"Undefined header")']})

    def wav(self, *arguments):
        """The rate and the samples of a multiplex that is written."""
        path = self.folder / "multiplex.wav"
        self.air("--start", "2026-01-01 12:00:00", "--mpx", str(path), *arguments)
        content = path.read_bytes()
        self.assertEqual((content[:4], content[8:12]), (b"RIFF", b"WAVE"))
        self.assertEqual(struct.unpack("<I", content[4:8])[0], len(content) - 8)
        chunks, at = {}, 12
        while at < len(content):
            name, size = struct.unpack("<4sI", content[at:at + 8])
            chunks[name] = content[at + 8:at + 8 + size]
            at += 8 + size + size % 2
        kind, channels, rate, _, _, bits = struct.unpack("<HHIIHH", chunks[b"fmt "][:16])
        self.assertEqual(channels, 1)
        samples = array.array({(3, 32): "f", (1, 16): "h"}[kind, bits], chunks[b"data"])
        self.assertIn(b"full scale 1.0 = 100 kHz", chunks[b"LIST"])
        return rate, samples

    def testAMultiplexBeginsWithAGroupAndEndsAfterTheLast(self):
        """11 groups of 104 bits fit into a second, 0.2 s come after them: 1.163368 s."""
        rate, samples = self.wav("--data-set", "2", "--seconds", "1")
        self.assertEqual((rate, len(samples), samples.typecode), (228000, 11 * 104 * 192 + 45600, "f"))
        self.assertLess(max(map(abs, samples)), 1)
        self.assertGreater(max(map(abs, samples)), 0.01)
        rate, samples = self.wav("--data-set", "2", "--seconds", "1", "--rate", "192000", "--format", "s16")
        self.assertEqual((rate, len(samples), samples.typecode), (192000, 223367, "h"))

    def testWithoutGroupsAMultiplexLastsAsLongAsWasSaid(self):
        pilot = self.write("pilot.txt", ":STEREO:STATE ON;:STEREO:PILOT:STATE ON;:STEREO:PILOT:DEVIATION 6750HZ\n")
        pattern = self.write("pattern.txt", ":STEREO:STATE ON\n" + RDS_ON + ':STEREO:DIRECT "BIN=4"\n')
        for commands, peak in ((pilot, 0.0675), (pattern, 0.02)):
            _, samples = self.wav("--commands", commands, "--seconds", "0.55")
            self.assertEqual(len(samples), 125400)
            self.assertLessEqual(max(samples), peak + 1e-6)
            self.assertGreater(max(samples), 0.8 * peak)
        _, samples = self.wav("--seconds", "0.05")
        self.assertEqual(samples, array.array("f", [0] * 11400))

    def testGroupsAndMultiplexAreOfOneRun(self):
        path = self.folder / "multiplex.wav"
        run = self.air("--data-set", "2", "--seconds", "1", "--groups", "-", "--mpx", str(path), before=["--json"])
        document = json.loads(run.stdout)
        self.assertEqual((document["groups"], document["samples"], document["exit_code"]), (11, 265248, 0))
        first = path.read_bytes()
        self.air("--data-set", "2", "--seconds", "1", "--mpx", str(path))
        self.assertEqual(path.read_bytes(), first)

    def testCtrlCEndsAMultiplex(self):
        path = self.folder / "multiplex.wav"
        with subprocess.Popen([CTL, "--app-folder", str(self.folder), "air", "--data-set", "2", "--seconds", "86400",
                               "--mpx", str(path)], stderr=subprocess.PIPE, text=True) as run:
            while not path.exists() or path.stat().st_size < 10000:
                time.sleep(0.01)
            run.send_signal(signal.SIGINT)
            problem = run.stderr.read()
            self.assertEqual(run.wait(20), FAILED)
        self.assertIn("stopped", problem)
        self.assertGreater(path.stat().st_size, 10000)

    def testAWrongCallIsToldWithExitCode2(self):
        log = self.write("log.txt", "what is this, a letter?\r\n")
        commands = self.write("commands.txt", "@ soon *RST\n")
        for call in ((), ("--data-set", "2"), ("--groups", "-", "--seconds", "0"),
                     ("--groups", "-", "--seconds", "2,5"), ("--groups", "-", "--seconds", "nan"),
                     ("--groups", "-", "--start", "2026-02-30 12:00:00"), ("--groups", "-", "--start", "noon"),
                     ("--groups", "-", "--data-set", "6"), ("--groups", "-", "--commands", "missing.txt"),
                     ("--groups", "-", "--log", "missing.txt"), ("--groups", "-", "--log", log),
                     ("--groups", "-", "--commands", commands), ("--groups", "-", "--file", "missing.INI"),
                     ("--mpx", "-"), ("--mpx", str(self.folder / "m.wav"), "--rate", "48000"),
                     ("--mpx", str(self.folder / "m.wav"), "--format", "s24")):
            with self.subTest(call):
                run = self.air(*call, expect=WRONG_CALL)
                self.assertEqual(run.stdout, "")
                self.assertNotEqual(run.stderr, "")

    def testAFileThatCannotBeWrittenFails(self):
        run = self.air("--data-set", "2", "--groups", str(self.folder / "missing" / "groups.txt"), expect=FAILED)
        self.assertIn("cannot be written", run.stderr)
        if pathlib.Path("/dev/full").exists():
            self.air("--data-set", "2", "--groups", "/dev/full", expect=FAILED)

    def testAMultiplexThatCannotBeWrittenFails(self):
        def full_disk():
            signal.signal(signal.SIGXFSZ, signal.SIG_IGN)
            resource.setrlimit(resource.RLIMIT_FSIZE, (50000, 50000))

        for path, before in ((self.folder / "missing" / "m.wav", None), (self.folder, None),
                             (self.folder / "m.wav", full_disk)):
            with self.subTest(path):
                run = subprocess.run([CTL, "--app-folder", str(self.folder), "air", "--data-set", "2", "--seconds",
                                      "86400", "--mpx", str(path)], stderr=subprocess.PIPE, text=True, timeout=60,
                                     preexec_fn=before)
                self.assertEqual(run.returncode, FAILED)
                self.assertIn(f"{path} cannot be written", run.stderr)


if __name__ == "__main__":
    CTL = sys.argv.pop(1)
    unittest.main()
