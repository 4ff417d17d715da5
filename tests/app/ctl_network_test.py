"""kdx-ctl over the network, with kdx-sim at the other end: what arrives, what becomes of links that break.

Usage: ctl_network_test.py PATH-OF-KDX-CTL PATH-OF-KDX-SIM
"""

import json
import signal
import subprocess
import time

import kdxctl
from kdxctl import DIFFERENT, DONE, FAILED, NO_CONNECTION


class OverTheNetwork(kdxctl.Networked):
    def testWhatIsSentIsReadBack(self):
        self.lan("send", "PS=TESTTURM", "PI=ABCD", "HF-Frequenz=98.5")
        self.assertEqual(self.lan("query", "ps", "pi", "frequency").stdout, "TESTTURM\nABCD\n98.5 MHz\n")

    def testTheAddressOfTheGeneralSettingsIsTheDefault(self):
        self.assertEqual(self.ctl("query", "ps").stdout, "KDX-X4  \n")

    def testAnAddressCopiedWithItsLineEnd(self):
        self.assertEqual(self.ctl("--lan", "127.0.0.1\r\n", "query", "ps").stdout, "KDX-X4  \n")

    def testAReaderThatGoesAwayStopsNothing(self):
        process = subprocess.Popen(self.command("--lan", "127.0.0.1", "-v", "apply", "--data-set", "2"),
                                   stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True)
        process.stdout.readline()
        process.stdout.close()
        with process.stderr:
            self.assertEqual(process.stderr.read(), "")
        self.assertEqual(process.wait(100), DONE)
        names = ("ps", "groups", "eon", "frequency")
        cut = self.lan("query", *names).stdout
        self.lan("apply", "--data-set", "2")
        self.assertEqual(cut, self.lan("query", *names).stdout)
        self.assertIn("TALWELLE", cut)

    def testADeviceNameIsGivenBehindAComma(self):
        self.assertEqual(self.ctl("--lan", "127.0.0.1,inst0", "query", "ps").stdout, "KDX-X4  \n")
        self.ctl("--lan", "127.0.0.1,nothing", "query", "ps", expect=NO_CONNECTION)

    def testWhatIsReadAndAppliedDiffersInNothing(self):
        file = str(self.folder / "Gelesen.INI")
        self.lan("apply", "--data-set", "4")
        self.assertEqual(self.lan("diff", "--data-set", "4").stdout, "")
        self.lan("read", "--into", file)
        self.lan("send", "PS=ANDERS", "TA=1", "HF-Pegel=20")
        changed = json.loads(self.lan("--json", "diff", "--file", file, expect=DIFFERENT).stdout)["differences"]
        self.assertEqual([row["setting"] for row in changed], ["PS", "TA", "HF-Pegel"])
        self.lan("diff", "--file", file, "--fix")
        self.lan("send", "PI=ABCD")
        self.lan("apply", "--file", file)
        self.assertEqual(self.lan("diff", "--file", file).stdout, "")

    def killInTheMiddle(self, *options):
        process = subprocess.Popen(self.command("--lan", "127.0.0.1", "-v", *options, "apply", "--data-set", "1"),
                                   stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True)
        for line in process.stdout:
            if "PS=" in line:
                break
        self.sim.kill()
        rest, problems = process.communicate(timeout=100)
        return process.returncode, rest.splitlines(), problems

    def testABrokenLinkIsToldOnceAndEndsTheRun(self):
        code, rest, problems = self.killInTheMiddle()
        self.assertEqual(code, FAILED)
        self.assertEqual(problems.count("the link to the instrument is broken"), 1, problems)
        self.assertRegex(problems, r"\(-\d+\)\. Look whether it is switched on")
        self.assertLess(len(rest), 5)

    def testARunToBeContinuedGoesOnOverABrokenLink(self):
        code, rest, problems = self.killInTheMiddle("--continue")
        self.assertEqual(code, FAILED)
        self.assertEqual(problems.count("the link to the instrument is broken"), 1, problems)
        self.assertGreater(len(rest), 10)

    def secondsToNoticeSilence(self, *options):
        """How long a read takes when the instrument falls silent in the middle."""
        process = subprocess.Popen(self.command("--lan", "127.0.0.1", "-v", *options, "query", "all"),
                                   stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True)
        process.stdout.readline()
        self.sim.send_signal(signal.SIGSTOP)
        began = time.monotonic()
        problem = process.stderr.readline()
        took = time.monotonic() - began
        _, rest = process.communicate(timeout=100)
        self.sim.send_signal(signal.SIGCONT)
        self.assertEqual(process.returncode, FAILED)
        self.assertRegex(problem, r"time-out.*\(-1073807339\).*keeps silent")
        self.assertEqual(rest, "")
        return took

    def testHowLongAnAnswerMayTakeCanBeSaid(self):
        self.assertLess(self.secondsToNoticeSilence("--timeout", "0.5"), 1.5)
        self.assertGreater(self.secondsToNoticeSilence("--timeout", "3"), 2.9)

    def testAnAnswerMayTakeTwoSecondsElse(self):
        self.assertTrue(1.9 < self.secondsToNoticeSilence() < 3.5)

    def testARequestToEndStopsAfterTheRunningCommand(self):
        for request in (signal.SIGINT, signal.SIGTERM):
            process = subprocess.Popen(self.command("--lan", "127.0.0.1", "-v", "apply", "--data-set", "1"),
                                       stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True)
            for line in process.stdout:
                if "PS=" in line:
                    break
            process.send_signal(request)
            rest, problems = process.communicate(timeout=100)
            self.assertEqual((process.returncode, problems), (FAILED, "kdx-ctl: stopped\n"))
            self.assertLess(len(rest.splitlines()), 5)
        self.assertEqual(self.lan("query", "pi").stdout, "D7A1\n")


if __name__ == "__main__":
    kdxctl.main(networked=True)
