"""kdx-ctl apply, send and replay: what data sets, settings and command logs send.

Usage: ctl_apply_test.py PATH-OF-KDX-CTL
"""

import json
import shutil

import kdxctl
from kdxctl import FAILED, WRONG_CALL


class Apply(kdxctl.Ctl):
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


class Send(kdxctl.Ctl):
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


class Replay(kdxctl.Ctl):
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


if __name__ == "__main__":
    kdxctl.main()
