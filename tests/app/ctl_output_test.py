"""What kdx-ctl prints, and what becomes of it when nobody can read it.

Usage: ctl_output_test.py PATH-OF-KDX-CTL PATH-OF-KDX-SIM
"""

import json
import os
import pathlib
import pty
import re
import resource
import signal
import subprocess

import kdxctl
from kdxctl import DIFFERENT, DONE, FAILED, NO_CONNECTION, WRONG_CALL


class Lost(kdxctl.Networked):
    """Output that cannot be written."""

    def into(self, output, *arguments, **how):
        return subprocess.run(self.command(*arguments), stdout=output, stderr=subprocess.PIPE, text=True, timeout=100,
                              **how)

    def testAFullDiskIsToldAtTheEndAndNothingStops(self):
        for call in (("--simulate", "query", "ps"), ("--simulate", "--json", "query", "ps"), ("list", "keys"),
                     ("--help",), ("apply", "--data-set", "2", "--dry-run"), ("diff", "--simulate", "--data-set", "2"),
                     ("--lan", "127.0.0.1", "-v", "apply", "--data-set", "2")):
            with self.subTest(call), open("/dev/full", "wb") as full:
                run = self.into(full, *call)
                self.assertEqual((run.returncode, run.stderr), (FAILED, "kdx-ctl: the output cannot be written\n"))
        self.assertEqual(self.lan("diff", "--data-set", "2").stdout, "")

    def testAClosedOutputIsTold(self):
        for call in (("--simulate", "query", "ps"), ("--simulate", "--json", "query", "ps"), ("list", "keys")):
            with self.subTest(call):
                run = self.into(None, *call, preexec_fn=lambda: os.close(1))
                self.assertEqual((run.returncode, run.stderr), (FAILED, "kdx-ctl: the output cannot be written\n"))

    def testWhoPrintsNothingNeedsNoOutput(self):
        run = self.into(None, "--simulate", "send", "PS=RADIO", preexec_fn=lambda: os.close(1))
        self.assertEqual((run.returncode, run.stderr), (DONE, ""))

    def testAnotherFailureKeepsItsExitCode(self):
        with open("/dev/full", "wb") as full:
            self.assertEqual(self.into(full, "--lan", "127.0.0.9", "--json", "query", "ps").returncode, NO_CONNECTION)
            self.assertEqual(self.into(full, "--json", "nonsense").returncode, WRONG_CALL)

    def testAFullDiskUnderTheFileThatIsReadIntoLeavesTheOldOneWhole(self):
        """As on a full disk no file of the program can grow."""
        file = self.write("Bench.INI", "; bench\r\n[RDS]\r\nPS=OLD\r\n")
        before = pathlib.Path(file).read_bytes()

        def fill():
            signal.signal(signal.SIGXFSZ, signal.SIG_IGN)  # else the system ends the program
            resource.setrlimit(resource.RLIMIT_FSIZE, (0, 0))

        for target in (file, str(self.folder / "New.INI")):
            with self.subTest(target):
                run = self.into(subprocess.PIPE, "--simulate", "read", "--into", target, preexec_fn=fill)
                self.assertEqual((run.returncode, run.stdout), (FAILED, ""))
                self.assertIn(f"kdx-ctl: {target} cannot be written\n", run.stderr)
        self.assertEqual(pathlib.Path(file).read_bytes(), before)
        self.assertEqual(sorted(path.name for path in self.folder.iterdir()), ["Bench.INI", "Daten"])

    def testAReaderThatHasGoneIsNoFailure(self):
        for call in (("list", "keys"), ("--simulate", "--json", "query", "all"), ("--help",)):
            with self.subTest(call):
                reading, writing = os.pipe()
                os.close(reading)
                run = self.into(writing, *call)
                os.close(writing)
                self.assertEqual((run.returncode, run.stderr), (DONE, ""))


class Progress(kdxctl.Ctl):
    """The count on the standard error while that is a terminal."""

    def shown(self, *arguments, expect=DONE):
        terminal, other = pty.openpty()
        self.addCleanup(os.close, terminal)
        process = subprocess.Popen(self.command("--simulate", *arguments), stdin=subprocess.DEVNULL,
                                   stdout=subprocess.DEVNULL, stderr=other)
        os.close(other)
        text = b""
        try:
            while piece := os.read(terminal, 4096):
                text += piece
        except OSError:  # the program has gone
            pass
        self.assertEqual(process.wait(100), expect, text)
        return text.decode()

    def counted(self, text):
        """Number and total, "" where nobody knows it, as they came."""
        return re.findall(r"\rcommand (\d+)(?: of (\d+))? \x1b\[K", text)

    def testQuestionsCount(self):
        for call in (("query", "all"), ("query", "ari", "ps")):
            counted = self.counted(self.shown(*call))
            self.assertEqual(counted, [(str(number), str(len(counted)))
                                       for number in range(1, len(counted) + 1)])
        self.assertEqual(len(counted), 5)

    def testWhatIsReadOutCountsWithoutATotal(self):
        for call in (("read", "--into", str(self.folder / "a.INI")), ("diff", "--data-set", "2")):
            counted = self.counted(self.shown(*call, expect=DIFFERENT))
            self.assertGreater(len(counted), 20)
            self.assertEqual(counted, [(str(number), "") for number in range(1, len(counted) + 1)])

    def testMendingCountsWhatDiffers(self):
        counted = self.counted(self.shown("diff", "--data-set", "2", "--fix"))
        mended = [number for number, total in counted if total]
        self.assertGreater(len(mended), 5)
        self.assertEqual(counted[counted.index(("1", str(len(mended)))):][:len(mended)],
                         [(str(number), str(len(mended))) for number in range(1, len(mended) + 1)])

    def testALogAndADataSetCount(self):
        counted = self.counted(self.shown("apply", "--data-set", "1"))
        self.assertEqual(counted[0], ("1", counted[0][1]))
        self.assertEqual(counted[-1][0], counted[-1][1])
        log = self.write("log.txt", '             PS= ":STEREO:DIRECT "PS=A""\r\n' * 3)
        self.assertEqual(self.counted(self.shown("replay", log)), [("1", "3"), ("2", "3"), ("3", "3")])

    def testBringingBackCounts(self):
        scenario = self.write("a.yaml", "steps: [{send: {PS: OTHER}}]\nrestore: true\n")
        text = self.shown("play", scenario, "--speed", "100")
        kept = self.counted(text)
        without = self.write("b.yaml", "steps: [{send: {PS: OTHER}}]\n")
        self.assertGreater(len(kept), len(self.counted(self.shown("play", without, "--speed", "100"))) + 20)

    def testTheLineIsGoneAtTheEnd(self):
        self.assertTrue(self.shown("query", "all").endswith("\r\x1b[K"))

    def testQuietAndVerboseCountNothing(self):
        self.assertEqual(self.shown("-q", "query", "ari"), "")
        self.assertEqual(self.shown("-v", "query", "ari"), "")


class Manner(kdxctl.Networked):
    def testQuietPrintsOnlyResultsAndProblems(self):
        into = str(self.folder / "a.INI")
        self.assertIn("written", self.simulated("read", "--into", into, expect=DIFFERENT).stdout)
        run = self.simulated("-q", "read", "--into", into, expect=DIFFERENT)
        # What gets lost is a result.
        self.assertTrue(run.stdout.startswith("no data set sends these:\n"), run.stdout)
        self.assertNotIn("written", run.stdout)
        self.assertIn("does not come back", run.stderr)
        self.assertEqual(self.simulated("-q", "query", "pi").stdout, "1000\n")
        self.assertEqual(self.ctl("-q", "-v", "list", expect=WRONG_CALL).stdout, "")

    def testVerboseTellsTheStatusOfEveryCommand(self):
        lines = self.simulated("-v", "send", "PS=RADIO", "TP=1").stdout.splitlines()
        self.assertEqual(len(lines), 2)
        for line in lines:
            self.assertRegex(line, r"^\d\d:\d\d:\d\d -> .+  \[0\]$")

    def testVerboseTellsAFailureInWords(self):
        process = subprocess.Popen(self.command("--lan", "127.0.0.1", "-v", "--timeout", "0.3", "query", "all"),
                                   stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True)
        process.stdout.readline()
        self.sim.send_signal(signal.SIGSTOP)
        shown, _ = process.communicate(timeout=100)
        self.sim.send_signal(signal.SIGCONT)
        self.assertRegex(shown, r"(?m)  \[-1073807339: .*time-out.*\]$")


class Documents(kdxctl.Ctl):
    def testAWrongCallIsADocumentToo(self):
        for call in (("nonsense",), ("apply", "--data-set", "6"), ("send",), ("--lan",), ("--gpib", "31", "query", "ps"),
                     ("--timeout", "0", "query", "ps"), ("diff", "--data-set", "1", "--file", "x"), ()):
            for arguments in (("--json", *call), (*call, "--json")):
                with self.subTest(arguments):
                    run = self.ctl(*arguments, expect=WRONG_CALL)
                    document = json.loads(run.stdout)
                    self.assertEqual(document["exit_code"], WRONG_CALL)
                    self.assertEqual(len(document["problems"]), 1)
                    self.assertIn(document["problems"][0], run.stderr)

    def testHelpStaysWords(self):
        self.assertIn("Usage:", self.ctl("--json", "--help").stdout)


if __name__ == "__main__":
    kdxctl.main(networked=True)
