"""The program kdx-ctl as a script meets it: subcommands, what they send and print, exit codes.

Usage: ctl_test.py PATH-OF-KDX-CTL PATH-OF-KDX-SIM
"""

import json
import os
import pathlib
import re
import shutil
import signal
import socket
import subprocess
import sys
import tempfile
import threading
import time
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


class Calls(Ctl):
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
        libraries = subprocess.run(["ldd", CTL], capture_output=True, text=True, check=True).stdout
        self.assertIn("libc.so", libraries)
        self.assertNotIn("Qt", libraries)

    def testAnInstrumentThatIsNotThereIsExitCode4(self):
        run = self.ctl("--lan", "127.0.0.9", "query", "ps", expect=NO_CONNECTION)
        self.assertIn("no connection to 127.0.0.9", run.stderr)
        self.assertIn("-1073807343", run.stderr)

    def testWithoutAnAddressTheSettingsThatLackItAreNamed(self):
        (self.folder / "empty").mkdir()
        for name in ("empty", "none"):
            run = subprocess.run([CTL, "--app-folder", self.folder / name, "query", "ps"], capture_output=True,
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


class Lists(Ctl):
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


class Apply(Ctl):
    def testADryRunPrintsTheCommandsAndSendsNone(self):
        lines = self.ctl("--lan", "127.0.0.9", "apply", "--data-set", "2", "--dry-run").stdout.splitlines()
        self.assertEqual(lines[0], "*IDN?")
        self.assertIn(':STEREO:DIRECT "PS=TALWELLE"', lines)

    def testWhatIsSentIsWhatADryRunPrints(self):
        printed = self.ctl("apply", "--data-set", "3", "--dry-run").stdout.splitlines()
        self.assertEqual(self.sent("apply", "--data-set", "3"), printed)

    def testNoDataSetIsTakenUnasked(self):
        for call in (("apply",), ("apply", "--dry-run"), ("diff",), ("diff", "--fix")):
            with self.subTest(call):
                run = self.simulated("-v", *call, expect=WRONG_CALL)
                self.assertEqual(run.stdout, "")
                self.assertIn("which data set? --data-set N or --file FILE says it", run.stderr)

    def testADryRunPrintsNoControlCharacter(self):
        file = self.write("lab.ini", "[RDS]\r\nPS=A\x1bB\r\n")
        run = self.ctl("--force", "apply", "--file", file, "--dry-run")
        self.assertIn(':STEREO:DIRECT "PS=A.B     "\n', run.stdout)

    def testAnyFileCanBeSent(self):
        file = self.write("lab.ini", "[RDS]\r\nPS=Käse\r\nPI=1234\r\n")
        lines = self.ctl("apply", "--file", file, "--dry-run").stdout.splitlines()
        self.assertIn(':STEREO:DIRECT "PS=Käse    "', lines)
        self.assertIn(':STEREO:DIRECT "PI=1234"', lines)

    def testAFileThatCannotBeReadIsExitCode2(self):
        run = self.simulated("apply", "--file", str(self.folder / "missing.ini"), expect=WRONG_CALL)
        self.assertIn("missing.ini cannot be read", run.stderr)
        self.simulated("apply", "--file", str(self.folder), expect=WRONG_CALL)

    def testIllegalValuesAreNamedAndNothingIsSent(self):
        file = self.write("bad.ini", '[RDS]\r\nPS=A"B\r\nPI=XYZ1\r\nPTY=77\r\n')
        run = self.simulated("-v", "apply", "--file", file, expect=WRONG_CALL)
        self.assertEqual(run.stdout, "")
        for key in ("PS", "PI", "PTY"):
            self.assertIn(f"kdx-ctl: {key} cannot be", run.stderr)
        self.assertIn(':STEREO:DIRECT "PS=A"B     "', self.sent("--force", "apply", "--file", file))

    def testWhatSendingWouldMakeSomethingElseOfIsNamedWithItsPlace(self):
        file = self.write("bad.ini", "[RDS]\r\nPI=1234\r\nPTY=77\r\nMS=Q\r\n[FM]\r\nPREEMPHASIS=7\r\nRDS=2\r\n"
                          "MPX_DEV=99999999\r\n")
        for options in ((), ("--dry-run",)):
            run = self.simulated("-v", "apply", *options, "--file", file, expect=WRONG_CALL)
            self.assertEqual(run.stdout, "")
            for place in ("[RDS] PTY=77", "[RDS] MS=Q", "[FM] PREEMPHASIS=7", "[FM] RDS=2", "[FM] MPX_DEV=99999999"):
                self.assertIn(" Legal: ", run.stderr)
                self.assertIn(f"It stands in {file}, {place}.", run.stderr)
        self.assertIn(":stereo:rds:state OFF", self.sent("--force", "apply", "--file", file))
        text = (self.folder / "Daten" / "RDS_Allg.INI").read_bytes()
        (self.folder / "Daten" / "RDS_Allg.INI").write_bytes(text.replace(b"PILOT=1", b"PILOT=x"))
        run = self.simulated("apply", "--data-set", "2", expect=WRONG_CALL)
        self.assertIn('PILOT cannot be "x". Legal: 0 or 1. It stands in RDS_Allg.INI, [FM] PILOT=x.', run.stderr)

    def testAFileThatHoldsNoDataSetIsExitCode2(self):
        for name, text in (("README.md", "# A programme\n"), ("empty.ini", ""), ("binary", "\x00\x01[RDS\x00"),
                           ("other.ini", "[FM]\r\nRDS=1\r\n")):
            for call in ("apply", "diff"):
                run = self.simulated("-v", call, "--file", self.write(name, text), expect=WRONG_CALL)
                self.assertEqual(run.stdout, "")
                self.assertIn(f"{name} holds no data set: it has no section [RDS]", run.stderr)

    def testAMissingPiIsTold(self):
        file = self.write("lab.ini", "[RDS]\r\nPS=RADIO\r\n")
        run = self.simulated("apply", "--file", file, expect=WRONG_CALL)
        self.assertIn('PI cannot be "". Legal: four hexadecimal digits.', run.stderr)
        self.assertIn(':STEREO:DIRECT "PI=    "', self.sent("--force", "apply", "--file", file))


class Send(Ctl):
    def testKeysGoThroughTheDispatcher(self):
        self.assertEqual(self.sent("send", "PS=Käse", "TP=1", "HF-Frequenz=98.5", "EON_PI=D3C1", "EON_TA=1"),
                         [':STEREO:DIRECT "PS=Käse    "', ":stereo:rds:traffic:program ON", "FREQ 98.5MHZ",
                          ':STEREO:DIRECT "EON-PI=D3C1"', ':STEREO:DIRECT "EON-TA=D3C1,1"'])

    def testAnOptionTakesOneTextAndTheRestAreSettings(self):
        self.assertEqual(self.sent("send", "--raw", "FREQ 99 MHz", "TP=1", "--raw", "*CLS", "PTY=7"),
                         [":stereo:rds:traffic:program ON", ':STEREO:DIRECT "PTY=07"', "FREQ 99 MHz", "*CLS"])

    def testCommandsGoAsTheyStand(self):
        self.assertEqual(self.sent("send", "--raw", "FREQ 99 MHz", "--coder", "PTY=07"),
                         ["FREQ 99 MHz", ':STEREO:DIRECT "PTY=07"'])

    def testLineBreaksCopiedAlongEndNoCommand(self):
        self.assertEqual(self.sent("send", "PS=RADIO\n", "--raw", "FREQ 99 MHZ\r\n*RST"),
                         [':STEREO:DIRECT "PS=RADIO   "', "FREQ 99 MHZ *RST"])

    def testACoderCommandThatADoubleQuoteEndsIsRefused(self):
        run = self.simulated("-v", "send", "TP=1", "--coder", 'PS=x";*RST', expect=WRONG_CALL)
        self.assertEqual(run.stdout, "")
        self.assertIn('the coder command PS=x";*RST cannot be sent: a double quote ends it early', run.stderr)
        self.assertEqual(self.sent("--force", "send", "--coder", 'PS=x";*RST'), [':STEREO:DIRECT "PS=x";*RST"'])
        self.assertEqual(self.sent("send", "--raw", ':STEREO:DIRECT "PS=x";*RST'), [':STEREO:DIRECT "PS=x";*RST'])

    def testIllegalValuesAreNamedBeforeAnythingIsSent(self):
        run = self.simulated("-v", "send", "TP=1", "HF-Frequenz=98,5", "NOKEY=1", expect=WRONG_CALL)
        self.assertEqual(run.stdout, "")
        self.assertIn('HF-Frequenz cannot be "98,5": it has a decimal comma. Legal: 0.1 to 1040 MHz', run.stderr)
        self.assertIn("there is no key NOKEY", run.stderr)
        self.assertEqual(self.sent("--force", "send", "HF-Frequenz=98,5"), ["FREQ 98,5MHZ"])

    def testWhatIsNoSettingIsToldWithExitCode2(self):
        self.assertIn("PS is not KEY=VALUE", self.simulated("send", "PS", expect=WRONG_CALL).stderr)
        self.assertIn("NOKEY is not KEY=VALUE", self.simulated("send", "NOKEY", expect=WRONG_CALL).stderr)

    def testAKeyWhoseValueSaysNothingNeedsNone(self):
        self.assertEqual(self.sent("send", "DEL_RT", "FM_EIN"), [':STEREO:DIRECT "RT=0,0,"', "FM:STAT ON"])

    def testTheAnswerToAQuestionIsShownAndNotTakenForTheNextOne(self):
        run = self.simulated("send", "PS=RADIO", "--raw", "FREQ?", "--raw", "*IDN?", "--raw", 'STER:DIR "RT=0,0,where?"')
        self.assertEqual(run.stdout, "100\nKDX,KDX-X4,100001,1.00\n")
        document = json.loads(self.simulated("--json", "send", "--raw", "FREQ?").stdout)
        self.assertEqual((document["answers"], document["traffic"][-1]["text"]), (["100"], "100"))
        silent = self.simulated("--timeout", "0.2", "send", "--raw", "NOTHING?", expect=FAILED)
        self.assertIn("time-out expired", silent.stderr)

    def testWhichOtherNetworkIsMeantCanBeSaid(self):
        self.assertEqual(self.sent("send", "EON_TA=1"), [':STEREO:DIRECT "EON-TA=D7A2,1"'])
        self.assertEqual(self.sent("send", "--eon", "d3c1", "EON_TA=1"), [':STEREO:DIRECT "EON-TA=D3C1,1"'])
        self.assertEqual(self.sent("send", "--eon", "D3C1", "EON_PI=D3C2", "EON_TA=1"),
                         [':STEREO:DIRECT "EON-PI=D3C2"', ':STEREO:DIRECT "EON-TA=D3C2,1"'])
        self.assertIn(':STEREO:DIRECT? "EON-PS,D3C1"', self.sent("query", "--eon", "D3C1", "eon"))
        for wrong in ("", "D3C", "D3C1A", "D3CX", "\x1b[2J"):
            for call in (("send", "TA=1"), ("query", "eon")):
                run = self.simulated(*call, "--eon", wrong, expect=WRONG_CALL)
                self.assertIn("--eon: takes a PI, four hexadecimal digits", run.stderr)

    def testTheLogTellsWhatWasSent(self):
        self.simulated("send", "PS=RADIO")
        self.assertEqual((self.folder / "Daten" / "RDS_log.txt").read_bytes(),
                         b'             PS= ":STEREO:DIRECT "PS=RADIO   ""\r\n')


class Query(Ctl):
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

    def testAnUnknownNameIsExitCode2(self):
        self.assertIn("no read-back nothing", self.simulated("query", "ps", "nothing", expect=WRONG_CALL).stderr)


class Replay(Ctl):
    LOG = ('             TP= ":stereo:rds:traffic:program ON"\r\n'
           '            PS?= :STEREO:DIRECT? "PS"\r\n'
           '            PS?= Answer ""RADIO   "\n       "\r\n'
           '             PS= ":STEREO:DIRECT "PS=RADIO   ""\r\n')

    def testTheCommandsGoOutInTheirOrder(self):
        self.assertEqual(self.sent("replay", self.write("log.txt", self.LOG)),
                         [":stereo:rds:traffic:program ON", ':STEREO:DIRECT "PS=RADIO   "'])

    def testWhatWasLoggedOnceIsSentOnceMore(self):
        first = self.sent("apply", "--data-set", "4")
        log = self.folder / "first.txt"
        shutil.move(self.folder / "Daten" / "RDS_log.txt", log)
        again = self.sent("replay", str(log))
        self.assertEqual(again, [text for text in first if "?" not in text])

    def testCheckOnlyReads(self):
        self.assertEqual(self.simulated("-v", "replay", "--check", self.write("log.txt", self.LOG)).stdout,
                         "2 commands\n")

    def testALineThatCannotBeReadIsNamedAndNothingIsSent(self):
        log = self.write("log.txt", self.LOG + "what is this\r\n" + self.LOG + "PS=1\r\n")
        run = self.simulated("-v", "replay", log, expect=WRONG_CALL)
        self.assertEqual(run.stdout, "")
        self.assertIn("line 6: not a line of a command log", run.stderr)
        self.assertIn("line 12: not a line of a command log", run.stderr)

    def testALineThatADoubleQuoteEndsIsNamedAndNothingIsSent(self):
        bad = ':STEREO:DIRECT "PS=x";*RST"'
        log = self.write("log.txt", self.LOG + f'             PS= "{bad}"\r\n')
        for options in ((), ("--check",)):
            run = self.simulated("-v", "replay", *options, log, expect=WRONG_CALL)
            self.assertEqual(run.stdout, "")
            self.assertEqual(run.stderr.count("\n"), 1)
            self.assertIn("line 6: a double quote ends the coder command early", run.stderr)
        self.assertEqual(self.sent("--force", "replay", log)[-1], bad)

    def testAMissingLogIsExitCode2(self):
        self.simulated("replay", str(self.folder / "none"), expect=WRONG_CALL)


class Read(Ctl):
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


class Diff(Ctl):
    def testDifferencesAreATableAndExitCode3(self):
        run = self.simulated("diff", "--data-set", "2", expect=DIFFERENT)
        self.assertRegex(run.stdout, r'(?m)^PS +"TALWELLE" +"KDX-X4" +programme service name$')

    def testFixSendsWhatDiffersAndTellsWhatIsLeft(self):
        written = self.sent("diff", "--data-set", "2", "--fix")
        self.assertIn(':STEREO:DIRECT "PS=TALWELLE"', written)
        self.assertNotIn(':STEREO:DIRECT "TA=0"', written)

    def testAFileThatCannotBeReadIsExitCode2(self):
        self.simulated("diff", "--file", str(self.folder / "none.INI"), expect=WRONG_CALL)


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


class OverTheNetwork(Networked):
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
        self.assertTrue(1.9 < self.secondsToNoticeSilence() < 3)

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
    CTL, SIM = sys.argv[1:3]
    del sys.argv[1:3]
    unittest.main()
