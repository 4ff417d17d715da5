"""What kdx-ctl budget reckons of data sets and of commands.

Usage: ctl_budget_test.py PATH-OF-KDX-CTL
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
DONE, WRONG_CALL, DIFFERENT = 0, 2, 3
GROUP = 104 / 1187.5  # seconds
ON = (':STEREO:STATE ON\n:STEREO:RDS:STATE ON\n:STEREO:PILOT:STATE ON\n:STEREO:DEVIATION 40000HZ\n'
      ':STEREO:DIRECT "RT=10,0,HELLO"\n')


class Budget(unittest.TestCase):
    def setUp(self):
        self.folder = pathlib.Path(tempfile.mkdtemp(prefix="kdx-ctl-budget-"))
        self.addCleanup(shutil.rmtree, self.folder)
        shippeddata.copyTo(self.folder / "Daten")

    def budget(self, *arguments, expect, before=()):
        run = subprocess.run([CTL, "--app-folder", str(self.folder), *before, "budget", *arguments],
                             capture_output=True, text=True, timeout=60)
        self.assertEqual(run.returncode, expect, run.stdout + run.stderr)
        return run

    def write(self, name, text):
        (self.folder / name).write_bytes(text.encode("cp1252"))
        return str(self.folder / name)

    def testBothBudgetsAreTables(self):
        """0A, 2A: PS in 7 groups from 0A on, 8 from 2A on, half a group before them on the average, one at most: 8 and 9
        groups of 0.0876 s. "HELLO" and its end mark are two segments: 4 and 5. TA: 2 and 3."""
        run = self.budget("--commands", self.write("on.txt", ON), expect=DONE)
        self.assertEqual(run.stderr, "")
        self.assertEqual(run.stdout.splitlines(), [
            "group  share",
            "0A     50.0 %",
            "2A     50.0 %",
            "",
            "a radio waits for  mean     at most",
            "PS                 0.70 s   0.79 s",
            "AF lists           not set",
            "radiotext          0.35 s   0.44 s",
            "EON networks       not set",
            "traffic message    not set",
            "TA                 0.18 s   0.26 s",
            "",
            "deviation  kHz    of 40.00 in all  of 75",
            "audio      31.25  78.1 %           41.7 %",
            "pilot      6.75   16.9 %           9.0 %",
            "RDS        2.00   5.0 %            2.7 %",
            "ARI        0.00   0.0 %            0.0 %",
            "all        40.00  100.0 %          53.3 %"])

    def testADataSetIsJudgedWithItsWarnings(self):
        """Set 4 sends 0A, 2A, 14A, 8A, of which 8A has no message: two of four slots are 0A."""
        run = self.budget("--data-set", "4", expect=DIFFERENT)
        self.assertEqual([line.split() for line in run.stdout.splitlines()[1:4]],
                         [["0A", "50.0", "%"], ["2A", "25.0", "%"], ["14A", "25.0", "%"]])
        told = run.stderr.splitlines()
        self.assertIn("warning: 8A without 3A", told)
        self.assertIn("warning: 8A in the sequence has nothing to send: the slot sends 0A", told)

    def testAFileIsJudged(self):
        file = self.write("Bench.INI", "[RDS]\r\nPI=ABCD\r\nPS=BENCH\r\nPTY=0\r\nMS=M\r\nGR_FOLGE=0A,\r\n")
        lines = self.budget("--file", file, expect=DONE).stdout.splitlines()
        self.assertEqual(lines[1], "0A     100.0 %")
        self.assertEqual(lines[4].split(), ["PS", "0.39", "s", "0.44", "s"])  # 4.5 and 5 groups

    def testCommandsComeOnTopOfADataSet(self):
        """One 0A in eight: 33 groups at most."""
        slots = ",".join(["0A"] + 7 * ["2A"])
        file = self.write("slots.txt", f'@ 5 :STEREO:DIRECT "GS={slots}"\n:STEREO:DIRECT "RT=10,0,HELLO"\n')
        told = self.budget("--data-set", "4", "--commands", file, expect=DIFFERENT).stderr.splitlines()
        self.assertIn("warning: PS takes 2.9 s: more than 1 s is noticed", told)
        self.assertIn("warning: EON is set but 14A has no slot", told)

    def testARefusedCommandIsToldButNoWarningOfABudget(self):
        run = self.budget("--commands", self.write("on.txt", ON + ":NONSENSE\n"), expect=DONE)
        self.assertEqual(run.stderr, 'warning: refused: :NONSENSE (-113,"Undefined header")\n')

    def testALogIsJudged(self):
        log = self.write("old.txt", '            RDS= ":stereo:rds:state ON"\r\n')
        self.assertEqual(self.budget("--log", log, expect=DIFFERENT).stderr,
                         "warning: 2A in the sequence has nothing to send: the slot sends 0A\n"
                         "warning: the stereo coder is off: no multiplex goes out\n")

    def testJsonHoldsAllOfIt(self):
        commands = self.write("on.txt", ON + ":STEREO:DEVIATION 8000HZ\n")
        document = json.loads(self.budget("--commands", commands, expect=DIFFERENT, before=["--json"]).stdout)
        warning = "pilot, RDS and ARI take 8.75 kHz of 8.00 kHz: nothing is left for the audio"
        self.assertEqual(document["exit_code"], DIFFERENT)
        self.assertEqual(document["warnings"], [warning])
        groups, deviations = document["groups"], document["deviations"]
        self.assertEqual(groups["shares"], {"0A": 0.5, "2A": 0.5})
        self.assertEqual(groups["warnings"], [])
        self.assertEqual([row["what"] for row in groups["waits"]],
                         ["PS", "AF lists", "radiotext", "EON networks", "traffic message", "TA"])
        ps, af = groups["waits"][:2]
        self.assertAlmostEqual(ps["mean_seconds"], 8 * GROUP)
        self.assertAlmostEqual(ps["worst_seconds"], 9 * GROUP)
        self.assertTrue(ps["set"])
        self.assertEqual(af, {"what": "AF lists", "set": False})
        self.assertEqual(deviations["total_hertz"], 8000)
        self.assertEqual({part["name"]: part["hertz"] for part in deviations["parts"]},
                         {"audio": 0, "pilot": 6750, "RDS": 2000, "ARI": 0, "all": 8750})
        self.assertAlmostEqual(deviations["parts"][4]["of_total"], 8750 / 8000)
        self.assertAlmostEqual(deviations["parts"][1]["of_highest"], 0.09)
        self.assertEqual(deviations["warnings"], [warning])

    def testAWrongCallIsToldWithExitCode2(self):
        commands = self.write("commands.txt", "@ soon *RST\n")
        for call in ((), ("--data-set", "6"), ("--data-set", "2", "--file", "x.INI"), ("--file", "missing.INI"),
                     ("--commands", "missing.txt"), ("--commands", commands), ("--seconds", "3", "--data-set", "2")):
            with self.subTest(call):
                run = self.budget(*call, expect=WRONG_CALL)
                self.assertEqual(run.stdout, "")
                self.assertNotEqual(run.stderr, "")


if __name__ == "__main__":
    CTL = sys.argv.pop(1)
    unittest.main()
