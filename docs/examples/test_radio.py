#!/usr/bin/env python3
"""An example to begin with: tests of a car radio that hold the instrument by kdx-ctl.

The shell of kdx-ctl is started once for all tests. Each line written to it is answered by one line of JSON; exit_code
tells how it went, as kdx-ctl itself does: 0 done, 1 a command failed, 2 a wrong line, 4 no connection.

    KDX_CTL="kdx-ctl --simulate" python3 test_radio.py     # on the virtual instrument, as when nothing is set
    KDX_CTL="kdx-ctl --lan 192.168.0.5" python3 test_radio.py
"""

import json
import os
import shlex
import subprocess
import unittest


class Instrument:
    """The session with the instrument, open until the end of the "with" block."""

    def __init__(self, program):
        self._process = subprocess.Popen([*shlex.split(program), "--json", "shell"], stdin=subprocess.PIPE,
                                         stdout=subprocess.PIPE, text=True, encoding="utf-8", bufsize=1)

    def __enter__(self):
        return self

    def __exit__(self, *_):
        self._process.communicate("quit\n")  # the instrument is let go

    def tell(self, *words):
        """Runs one line; gives its answer, and raises what went wrong."""
        self._process.stdin.write(shlex.join(words) + "\n")
        line = self._process.stdout.readline()
        if not line:
            raise ConnectionError(f"kdx-ctl has ended with exit code {self._process.wait()}")
        answer = json.loads(line)
        if answer["exit_code"] != 0:
            raise ValueError("; ".join(answer.get("problems", ["failed"])))
        return answer

    def send(self, **settings):
        return self.tell("send", *(f"{key}={value}" for key, value in settings.items()))

    def query(self, name):
        return self.tell("query", name)["answers"][name]["words"]

    def wait(self, seconds):
        self.tell("wait", f"{seconds} s")


class RadioTest(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.instrument = Instrument(os.environ.get("KDX_CTL", "kdx-ctl --simulate"))
        cls.addClassCleanup(cls.instrument.__exit__)

    def testTheProgrammeNameIsOnTheAir(self):
        self.instrument.send(PS="RADIO 7", PI="D3C1")
        self.instrument.wait(0.1)  # here a test of a real radio reads its display
        self.assertEqual(self.instrument.query("ps"), "RADIO 7 ")
        self.assertEqual(self.instrument.query("pi"), "D3C1")

    def testRadiotextMayHoldBlanksAndQuotationMarks(self):
        self.instrument.send(RT="It's a Käse song")
        self.assertEqual(self.instrument.query("rt").rstrip(), "It's a Käse song")

    def testASweepOfTheLevel(self):
        for level in (60, 50, 40):
            # Keys with a hyphen or a colon are no names of Python.
            self.instrument.send(**{"HF-Pegel": level})
            self.assertIn(str(level), self.instrument.query("level"))

    def testAWrongValueIsToldBeforeItIsSent(self):
        with self.assertRaisesRegex(ValueError, "PTY cannot be"):
            self.instrument.send(PTY=77)


if __name__ == "__main__":
    unittest.main()
