"""The program kdx-ctl as a script calls it: exit codes, what it prints for wrong calls, what it lists.

Usage: ctl_calls_test.py PATH-OF-KDX-CTL
"""

import json
import os
import re
import subprocess

import kdxctl
from kdxctl import NO_CONNECTION, WRONG_CALL


class Calls(kdxctl.Ctl):
    def testAWrongCallIsToldWithExitCode2(self):
        for call in ((), ("nonsense",), ("send",), ("query",), ("apply", "--data-set", "6"), ("list", "nothing"),
                     ("send", "--eon", "D3C1"), ("apply", "--file", ""), ("air", "--file", "", "--groups", "-"),
                     ("--gpib", "31", "query", "ps"), ("--lan", "a", "--gpib", "3", "query", "ps"),
                     ("apply", "--data-set", "1", "--file", "x")):
            with self.subTest(call):
                run = self.ctl(*call, expect=WRONG_CALL)
                self.assertNotEqual(run.stderr, "")
                self.assertEqual(run.stdout, "")

    def testATimeoutIsAPlainNumberOfSeconds(self):
        for wrong in ("0", "0.05", "601", "2,5", "nan", "inf", "-1", "1e1", "0x1", "500m", "", "soon"):
            with self.subTest(wrong):
                run = self.ctl("--simulate", "--timeout", wrong, "query", "ps", expect=WRONG_CALL)
                self.assertIn("0.1 to 600", run.stderr)
        for right in ("0.1", "2.5", "600"):
            self.ctl("--simulate", "--timeout", right, "query", "ps")

    def testHelpOfEachSubcommandHasAnExample(self):
        overview = self.ctl("--help").stdout
        names = re.findall(r"(?m)^  ([a-z]+) ", overview.split("Subcommands:")[1])
        self.assertGreaterEqual(len(names), 6)
        for name in names:
            self.assertIn("Example: kdx-ctl " + name, self.ctl(name, "--help").stdout)

    def testNoWindowToolkitIsLinked(self):
        libraries = subprocess.run(["ldd", kdxctl.CTL], capture_output=True, text=True, check=True).stdout
        self.assertIn("libc.so", libraries)
        self.assertNotIn("Qt", libraries)

    def testAnInstrumentThatIsNotThereIsExitCode4(self):
        run = self.ctl("--lan", "127.0.0.9", "query", "ps", expect=NO_CONNECTION)
        self.assertIn("no connection to 127.0.0.9", run.stderr)
        self.assertIn("-1073807343", run.stderr)

    def testWithoutAnAddressTheSettingsThatLackItAreNamed(self):
        (self.folder / "empty").mkdir()
        for name in ("empty", "none"):
            run = subprocess.run([kdxctl.CTL, "--app-folder", self.folder / name, "query", "ps"], capture_output=True,
                                 text=True, timeout=100)
            self.assertEqual((run.returncode, run.stdout), (NO_CONNECTION, ""))
            self.assertIn(f"{name}/Daten/RDS_Allg.INI cannot be read. Name it with --lan", run.stderr)
        (self.folder / "Daten" / "RDS_Allg.INI").write_bytes(b"[BUS]\r\nINTERFACE=TCPIP\r\n")
        run = self.ctl("query", "ps", expect=NO_CONNECTION)
        self.assertIn("RDS_Allg.INI has no address", run.stderr)

    def testAGpibAddressNeedsALibrary(self):
        run = self.ctl("--gpib", "28", "query", "ps", expect=NO_CONNECTION)
        self.assertIn("GPIB address 28", run.stderr)

    def testWithoutALibraryADryRunStillRuns(self):
        gone = ("--visa-library", str(self.folder / "none.so"))
        self.assertIn("PS=MESSTURM", self.ctl(*gone, "apply", "--data-set", "1", "--dry-run").stdout)
        for call in (("apply", "--data-set", "1"), ("find",), ("read", "--into", str(self.folder / "new.INI")),
                     ("diff", "--data-set", "1"), ("shell",), ("send", "TP=1"), ("query", "all")):
            with self.subTest(call):
                self.assertIn("none.so", self.ctl(*gone, *call, expect=NO_CONNECTION).stderr)

    def testAVisaLibraryThatCannotBeLoadedIsExitCode4(self):
        run = self.ctl("--visa-library", str(self.folder / "none.so"), "query", "ps", expect=NO_CONNECTION)
        self.assertIn("none.so", run.stderr)

    def testAnUnknownSubcommandIsNamed(self):
        for call in (("sned", "PS=A"), ("--simulate", "sned"), ("--json", "sned")):
            self.assertIn("there is no subcommand sned", self.ctl(*call, expect=WRONG_CALL).stderr)
        self.assertIn("A subcommand is required", self.ctl(expect=WRONG_CALL).stderr)

    def testNoControlCharacterIsPrinted(self):
        """What the terminal would take for a command: in a name of a file, a key, an address."""
        bad = b"x\x1b[2J\xff"
        log = self.folder / os.fsdecode(bad)
        log.write_bytes(b"no log\n")
        for call in (("--visa-library", bad, "query", "ps"), ("--simulate", "apply", "--file", bad),
                     ("--simulate", "replay", bad), ("--simulate", "replay", os.fsencode(log)),
                     ("--simulate", "send", bad), ("--simulate", "send", bad + b"=1"),
                     ("--simulate", "send", b"PS=" + bad + b'"'), ("--simulate", "send", "--coder", bad + b'"'),
                     ("--simulate", "query", bad), ("--simulate", "list", bad),
                     ("--lan", b"127.0.0.9,x\x1b[2J", "query", "ps"), ("--simulate", "query", "ps", b"--" + bad)):
            with self.subTest(call):
                run = subprocess.run(self.command(*call), capture_output=True, timeout=100)
                self.assertIn(run.returncode, (WRONG_CALL, NO_CONNECTION))
                self.assertIn(b"[2J", run.stderr)
                self.assertEqual([byte for byte in run.stdout + run.stderr if byte < 0x20 and byte != 0x0A], [])
                run.stderr.decode()
        self.write("Daten/Datenset5.INI", "[RDS]\r\nPS=A\x1b[2J\x7f\u0178\r\nPI=1000\r\n")
        text = self.ctl("list").stdout
        self.assertIn("A.[2J.\u0178", text)
        self.write("Daten/Datenset5.INI", "[RDS]\r\nPI=1000\r\n")
        with open(self.folder / "Daten" / "Datenset5.INI", "ab") as file:
            file.write(b"PS=\x81\x8d\r\n")  # what the code page leaves open are control characters too
        self.assertRegex(self.ctl("list").stdout, r"(?m)^5  \.\.  +1000$")

    def testACharacterThatTheInstrumentDoesNotHaveIsToldBeforeAnythingIsSent(self):
        for call in (("PS=日本",), ("--raw", ":OUTP 日"), ("--coder", "PS=日")):
            with self.subTest(call):
                run = self.simulated("-v", "send", "TP=1", *call, expect=WRONG_CALL)
                self.assertIn("(Windows-1252) has no 日", run.stderr)
                self.assertEqual(run.stdout, "")
        for call in ((b"PS=\xff",), (b"--raw", b"\xff")):
            with self.subTest(call):
                run = self.simulated("send", *call, expect=WRONG_CALL)
                self.assertIn(r"its byte \xFF is no UTF-8", run.stderr)
        self.assertEqual(self.sent("--force", "send", "PS=日本"), [':STEREO:DIRECT "PS=??      "'])

    def testAnUnknownKeyIsToldAlsoWithForce(self):
        run = self.simulated("--force", "send", "XY=1", expect=WRONG_CALL)
        self.assertIn("there is no key XY; kdx-ctl list keys names them", run.stderr)

    def testALogThatCannotBeWrittenIsToldOnce(self):
        (self.folder / "Daten" / "RDS_log.txt").mkdir()
        run = self.simulated("send", "PS=RADIO", "TP=1")
        self.assertRegex(run.stderr, r"^kdx-ctl: the command log .*RDS_log\.txt cannot be written\n$")


class Lists(kdxctl.Ctl):
    def testTheDataSetsWithPsAndPi(self):
        lines = self.ctl("list").stdout.splitlines()
        self.assertEqual(len(lines), 5)
        self.assertEqual(lines[0].split(), ["1", "MESSTURM", "D7A1"])
        listed = json.loads(self.ctl("list", "--json").stdout)["data_sets"]
        self.assertEqual(listed[1], {"number": 2, "ps": "TALWELLE", "pi": "D7A2"})

    def testTheKeysWithMeaningAndRange(self):
        keys = json.loads(self.ctl("list", "keys", "--json").stdout)["keys"]
        self.assertEqual(len(keys), 60)
        self.assertIn({"key": "PTY", "meaning": "programme type", "range": "0 to 31"}, keys)
        self.assertRegex(self.ctl("list", "keys").stdout, r"(?m)^PTY +programme type +0 to 31$")

    def testWhatAScenarioCanExpectAnswersTo(self):
        lines = self.ctl("list", "questions").stdout.splitlines()
        self.assertEqual(lines[0].split(), ["name", "answers", "what", "is", "asked"])
        self.assertIn(["pilot", "3"], [line.split()[:2] for line in lines])
        self.assertIn(["EON-TA", "1", "EON-TA,PI"], [line.split()[:3] for line in lines])
        questions = json.loads(self.ctl("--json", "list", "questions").stdout)["questions"]
        self.assertEqual(len(questions), 31)

    def testTheReadBacks(self):
        self.assertEqual(len(self.ctl("list", "queries").stdout.splitlines()), 20)


if __name__ == "__main__":
    kdxctl.main()
