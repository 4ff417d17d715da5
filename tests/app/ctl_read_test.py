"""kdx-ctl query, read and diff: what the instrument answers.

Usage: ctl_read_test.py PATH-OF-KDX-CTL
"""

import json
import pathlib
import signal
import subprocess

import kdxctl
from kdxctl import DIFFERENT, FAILED, WRONG_CALL


class Query(kdxctl.Ctl):
    def testWordsAndBareAnswers(self):
        self.assertEqual(self.simulated("query", "ps", "PI").stdout, "KDX-X4  \n1000\n")
        self.assertEqual(self.simulated("query", "ari").stdout, "ARI aus\nARI Hub: 3500 Hz\naus\nA\n")
        self.assertEqual(self.simulated("query", "--raw", "ari").stdout, "0\n350\n0\nA\n")

    def testAllTwenty(self):
        document = json.loads(self.simulated("query", "all", "--json").stdout)
        self.assertEqual(len(document["answers"]), 20)
        self.assertEqual(document["answers"]["frequency"], {"words": "100 MHz", "answers": ["100"]})

    def testAllOfThemHaveTheirNamesBeforeThem(self):
        lines = self.simulated("query", "all").stdout.splitlines()
        self.assertIn("frequency    100 MHz", lines)
        at = lines.index("ari          ARI aus")
        self.assertEqual(lines[at + 1:at + 4], ["             ARI Hub: 3500 Hz", "             aus", "             A"])
        self.assertEqual(len([line for line in lines if not line.startswith(" ")]), 20)

    def testBeforeALanguageWasChosenTheWordsAreThoseOfTheWindow(self):
        general = self.folder / "Daten" / "RDS_Allg.INI"
        text = general.read_bytes()
        self.assertIn(b"\nSprache=", text)
        general.write_bytes(text.replace(b"\nSprache=", b"\nUnused="))
        self.assertEqual(self.simulated("query", "ari").stdout, "ARI aus\nARI Hub: 3500 Hz\naus\nA\n")

    def testAnUnknownNameIsExitCode2(self):
        self.assertIn("no read-back nothing", self.simulated("query", "ps", "nothing", expect=WRONG_CALL).stderr)


class Read(kdxctl.Ctl):
    def testTheFileIsADataSetThatApplyTakes(self):
        file = str(self.folder / "Gelesen.INI")
        run = self.simulated("read", "--into", file, expect=DIFFERENT)
        self.assertIn("STEREO_MODE=3", run.stdout)
        self.assertIn('HF:PEGEL:STATE is "OFF" and does not come back', run.stderr)
        self.assertIn('":STEREO:DIRECT "PS=KDX-X4  ""', ['"' + text + '"' for text in self.sent("apply", "--file", file)])

    def testTheDocumentNamesWhatIsNotKept(self):
        file = str(self.folder / "Gelesen.INI")
        document = json.loads(self.simulated("--json", "read", "--into", file, expect=DIFFERENT).stdout)
        self.assertEqual(document["not_kept"], ["RT_N", "HF:PEGEL:STATE"])
        self.assertEqual(document["not_sent_by_a_data_set"]["STEREO_MODE"], "3")

    def testWhatTheFileHoldsBesidesStays(self):
        file = self.write("Gelesen.INI", "; Prüfstand\r\n[RDS]\r\nPS=ALT\r\nRTB=Zweiter\r\n")
        self.simulated("read", "--into", file, expect=DIFFERENT)
        text = pathlib.Path(file).read_bytes().decode("cp1252")
        self.assertTrue(text.startswith("; Prüfstand\r\n[RDS]\r\nPS=KDX-X4\r\nRTB=Zweiter\r\n"), text)

    def testAPlaceThatCannotBeWrittenIsTold(self):
        (self.folder / "folder.INI").mkdir()
        self.assertIn("no settings file", self.simulated("read", "--into", str(self.folder / "folder.INI"),
                                                         expect=WRONG_CALL).stderr)
        self.assertIn("cannot be written", self.simulated("read", "--into", str(self.folder / "none" / "a.INI"),
                                                          expect=FAILED).stderr)

    def testARequestToEndStopsBetweenTwoQuestions(self):
        for call in (("read", "--into", str(self.folder / "Gelesen.INI")), ("diff", "--data-set", "2")):
            process = subprocess.Popen(self.command("--simulate", "-v", *call), stdout=subprocess.PIPE,
                                       stderr=subprocess.PIPE, text=True)
            for line in process.stdout:
                if '"PI"' in line:
                    break
            process.send_signal(signal.SIGINT)
            rest, problems = process.communicate(timeout=100)
            self.assertEqual((process.returncode, problems), (FAILED, "kdx-ctl: stopped\n"))
            self.assertLess(len(rest.splitlines()), 6)
        self.assertFalse((self.folder / "Gelesen.INI").exists())


class Diff(kdxctl.Ctl):
    def testDifferencesAreATableAndExitCode3(self):
        run = self.simulated("diff", "--data-set", "2", expect=DIFFERENT)
        self.assertRegex(run.stdout, r'(?m)^PS +"TALWELLE" +"KDX-X4" +programme service name$')

    def testFixSendsWhatDiffersAndTellsWhatIsLeft(self):
        written = self.sent("diff", "--data-set", "2", "--fix")
        self.assertIn(':STEREO:DIRECT "PS=TALWELLE"', written)
        self.assertNotIn(':STEREO:DIRECT "TA=0"', written)

    def testAFileThatCannotBeReadIsExitCode2(self):
        self.simulated("diff", "--file", str(self.folder / "none.INI"), expect=WRONG_CALL)


if __name__ == "__main__":
    kdxctl.main()
