"""What kdx-sim sends on the air while it is worked with: groups and multiplex in real time.

Usage: simair_test.py PATH-OF-KDX-CTL PATH-OF-KDX-SIM
"""

import array
import os
import re
import resource
import signal
import struct
import subprocess
import time

import kdxctl
from kdxctl import DONE

FAILED, WRONG_USAGE = 1, 2
SAMPLES_A_SECOND = 228000
LINE = re.compile(r"^(?:[0-9A-F]{4} ){4}@\d{4}/\d\d/\d\d \d\d:\d\d:\d\d\.\d\d$")


class OnAir(kdxctl.Ctl):
    def begun(self, *options, ready="stdout", **how):
        sim = subprocess.Popen([kdxctl.SIM, "--bind", "127.0.0.1", *options], stdout=subprocess.PIPE,
                               stderr=subprocess.PIPE, **how)
        self.addCleanup(sim.stdout.close)
        self.addCleanup(sim.stderr.close)
        self.addCleanup(sim.wait)
        self.addCleanup(sim.kill)
        self.assertIn(b"ready: 127.0.0.1", getattr(sim, ready).readline())
        return sim

    def sends(self, *settings):
        self.ctl("--lan", "127.0.0.1", "send", *settings)

    def ended(self, sim):
        sim.send_signal(signal.SIGTERM)
        self.assertEqual(sim.wait(10), DONE)
        return sim.stderr.read().decode()

    def testGroupsGoOutInRealTimeAndFollowWhatIsSent(self):
        file = self.folder / "groups.txt"
        sim = self.begun("--groups", str(file))
        self.sends("STEREO_EIN", "RDS=1", "PI=1111", "GROUPSEQ=0A")
        time.sleep(1)
        before, begin = len(file.read_text().splitlines()), time.monotonic()
        time.sleep(2)
        after, end = len(file.read_text().splitlines()), time.monotonic()
        self.assertAlmostEqual(after - before, (end - begin) / 0.08758, delta=8)
        self.sends("PI=ABCD")
        time.sleep(0.5)
        self.assertEqual(self.ended(sim), "")
        lines = file.read_text().splitlines()
        for line in lines:
            self.assertRegex(line, LINE)
        identifiers = [line[:4] for line in lines]
        self.assertEqual(sorted(set(identifiers) - {"1000"}), ["1111", "ABCD"])
        self.assertEqual(identifiers[-1], "ABCD")

    def testTheStandardOutputTakesGroupsAlone(self):
        sim = self.begun("--groups", "-", ready="stderr")
        self.sends("STEREO_EIN", "RDS=1")
        for _ in range(5):
            self.assertRegex(sim.stdout.readline().decode().rstrip("\n"), LINE)
        self.ended(sim)

    def testSamplesComeAsFastAsTheyAreSent(self):
        sim = self.begun("--mpx", "-", ready="stderr")
        self.sends("STEREO_EIN", "PILOT=1", "PILOT_HUB=675")
        while not any(sim.stdout.read(65536)):
            pass  # what went out before the pilot was switched on
        begin = time.monotonic()
        # What the stream keeps for a late reader comes at once, the rest as it is sent.
        samples = array.array("f", sim.stdout.read(4 * SAMPLES_A_SECOND))[-20000:]
        self.assertLess(time.monotonic() - begin, 3)
        self.assertAlmostEqual(max(abs(sample) for sample in samples), 0.0675, delta=0.0007)
        self.ended(sim)

    def testAReaderThatDoesNotReadHoldsNothingUp(self):
        sim = self.begun("--mpx", "-", ready="stderr")
        time.sleep(6)
        self.sends("PI=1111")
        self.assertIn("there are gaps", sim.stderr.readline().decode())
        sim.stdout.close()
        time.sleep(0.5)
        self.sends("PI=2222")
        self.assertIn("the standard output cannot be written any more", self.ended(sim))

    def testProblemsThatNobodyReadsHoldNothingUp(self):
        sim = self.begun("--groups", str(self.folder / "groups.txt"))
        lists = [",".join(f"9{i % 10}.{number:04}{i:03}" for i in range(22)) for number in range(60)]
        text = "".join(f"send --coder AF=N,99.5,{frequencies}\n" for frequencies in lists)
        run = subprocess.run(self.command("--lan", "127.0.0.1", "shell"), input=text, capture_output=True, text=True,
                             timeout=100)
        self.assertEqual(run.returncode, DONE, run.stderr)
        self.sends("PI=1111")
        sim.send_signal(signal.SIGTERM)
        self.assertEqual(sim.wait(10), DONE)
        self.assertEqual(sim.stderr.readline(), b"kdx-sim: AF list 1: 92.0000002 MHz has no code and is left out\n")

    def testAStallIsMadeUpForInOrder(self):
        file = self.folder / "groups.txt"
        sim = self.begun("--groups", str(file))
        self.sends("STEREO_EIN", "RDS=1")
        time.sleep(0.5)
        sim.send_signal(signal.SIGSTOP)
        time.sleep(0.8)
        sim.send_signal(signal.SIGCONT)
        time.sleep(1)
        self.ended(sim)
        stamps = [line.split("@")[1] for line in file.read_text().splitlines()]
        self.assertEqual(stamps, sorted(set(stamps)))
        hundredths = [int(stamp[-5:-3]) * 100 + int(stamp[-2:]) for stamp in stamps]
        steps = {(after - before) % 6000 for before, after in zip(hundredths, hundredths[1:])}
        self.assertLess(max(steps), 14)

    def testAFileThatIsKilledIsReadableAsFarAsItIs(self):
        file = self.folder / "air.wav"
        sim = self.begun("--mpx", str(file))
        time.sleep(3)
        sim.kill()
        sim.wait()
        size = struct.unpack("<I", file.read_bytes()[4:8])[0] + 8
        self.assertGreater(size, 4 * SAMPLES_A_SECOND)
        self.assertLessEqual(size, file.stat().st_size)

    def testTheFileIsAWholeWavFileAtTheEnd(self):
        file = self.folder / "air.wav"
        begin = time.monotonic()
        sim = self.begun("--mpx", str(file), "--groups", str(self.folder / "groups.txt"))
        ready = time.monotonic()
        time.sleep(1.5)
        stopped = time.monotonic()
        self.assertEqual(self.ended(sim), "")
        end = time.monotonic()
        header = file.read_bytes()[:12]
        self.assertEqual((header[:4], header[8:]), (b"RIFF", b"WAVE"))
        self.assertEqual(struct.unpack("<I", header[4:8])[0] + 8, file.stat().st_size)
        length = file.stat().st_size / 4 / SAMPLES_A_SECOND
        self.assertGreater(length, stopped - ready - 0.5)
        self.assertLess(length, end - begin + 0.5)

    def testAPlaceThatCannotBeWrittenIsToldAtTheBegin(self):
        os.mkfifo(self.folder / "pipe")
        for place, why in (("/dev/full", "is no plain file"), (self.folder, "is no plain file"),
                           (self.folder / "pipe", "is no plain file"),
                           (self.folder / "none" / "x", "cannot be written")):
            for option in ("--groups", "--mpx"):
                run = subprocess.run([kdxctl.SIM, "--bind", "127.0.0.1", option, str(place)], capture_output=True,
                                     timeout=10)
                self.assertEqual(run.returncode, FAILED)
                self.assertIn(f"kdx-sim: {place} {why}", run.stderr.decode())

    def testADiskThatGetsFullIsToldOnceAndTheInstrumentGoesOn(self):
        sim = self.begun("--groups", str(self.folder / "groups.txt"), restore_signals=False,
                         preexec_fn=lambda: resource.setrlimit(resource.RLIMIT_FSIZE, (200, 200)))
        self.sends("STEREO_EIN", "RDS=1")
        time.sleep(1.5)
        self.sends("PI=1111")
        self.assertEqual(self.ended(sim).count("groups.txt cannot be written any more"), 1)

    def testTheStandardOutputIsGivenToOneOnly(self):
        for options in (("--groups", "-", "--mpx", "-"), ("--groups", "-", "--trace"), ("--mpx", "-", "--trace")):
            run = subprocess.run([kdxctl.SIM, *options], capture_output=True, timeout=10)
            self.assertEqual((run.returncode, run.stdout), (WRONG_USAGE, b""))
            self.assertIn(b"only one of", run.stderr)
        same = str(self.folder / "same")
        run = subprocess.run([kdxctl.SIM, "--groups", same, "--mpx", same], capture_output=True, timeout=10)
        self.assertEqual((run.returncode, os.path.exists(same)), (WRONG_USAGE, False))
        self.assertIn(b"name the same file", run.stderr)


if __name__ == "__main__":
    kdxctl.main(networked=True)
