"""What kdx-ctl prints, and what becomes of it when nobody can read it.

Usage: ctl_output_test.py PATH-OF-KDX-CTL PATH-OF-KDX-SIM
"""

import json
import os
import subprocess
import sys
import unittest

import ctl_test
from ctl_test import DIFFERENT, DONE, FAILED, NO_CONNECTION, WRONG_CALL


class Lost(ctl_test.Networked):
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

    def testAReaderThatHasGoneIsNoFailure(self):
        for call in (("list", "keys"), ("--simulate", "--json", "query", "all"), ("--help",)):
            with self.subTest(call):
                reading, writing = os.pipe()
                os.close(reading)
                run = self.into(writing, *call)
                os.close(writing)
                self.assertEqual((run.returncode, run.stderr), (DONE, ""))


class Documents(ctl_test.Ctl):
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
    ctl_test.CTL, ctl_test.SIM = sys.argv[1:3]
    del sys.argv[1:3]
    unittest.main()
