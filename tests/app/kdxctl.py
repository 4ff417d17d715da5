"""Help for tests that run kdx-ctl as a script does, on the virtual instrument or over the network."""

import json
import os
import pathlib
import shutil
import subprocess
import sys
import tempfile
import unittest

import shippeddata

CTL = SIM = ""
DONE, FAILED, WRONG_CALL, DIFFERENT, NO_CONNECTION = 0, 1, 2, 3, 4


class Ctl(unittest.TestCase):
    def setUp(self):
        self.folder = pathlib.Path(tempfile.mkdtemp(prefix="kdx-ctl-test-"))
        self.addCleanup(shutil.rmtree, self.folder)
        shippeddata.copyTo(self.folder / "Daten")

    def command(self, *arguments):
        return [CTL, "--app-folder", str(self.folder), *arguments]

    def ctl(self, *arguments, expect=DONE, timeout=100):
        run = subprocess.run(self.command(*arguments), capture_output=True, text=True, timeout=timeout)
        self.assertEqual(run.returncode, expect, run.stdout + run.stderr)
        return run

    def simulated(self, *arguments, **how):
        return self.ctl("--simulate", *arguments, **how)

    def sent(self, *arguments, **how):
        """The commands that a call writes to the virtual instrument."""
        document = json.loads(self.simulated("--json", *arguments, **how).stdout)
        return [passed["text"] for passed in document["traffic"] if passed["direction"] == "written"]

    def write(self, name, text):
        (self.folder / name).write_bytes(text.encode("cp1252"))
        return str(self.folder / name)


class Networked(Ctl):
    """Against kdx-sim as a process of its own; in a network of its own where the system permits that."""

    def setUp(self):
        super().setUp()
        self.sim = subprocess.Popen([SIM, "--bind", "127.0.0.1"], stdout=subprocess.PIPE, text=True)
        self.addCleanup(self.sim.stdout.close)
        self.addCleanup(self.sim.wait)
        self.addCleanup(self.sim.kill)
        self.assertIn("127.0.0.1", self.sim.stdout.readline())

    def lan(self, *arguments, **how):
        return self.ctl("--lan", "127.0.0.1", *arguments, **how)


def main(networked=False):
    """Runs the tests of the script that is called with the path of kdx-ctl, and that of kdx-sim if networked."""
    global CTL, SIM
    CTL = os.path.abspath(sys.argv.pop(1))
    if networked:
        SIM = os.path.abspath(sys.argv.pop(1))
    unittest.main()
