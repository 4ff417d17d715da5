"""kdx-ctl play and kdx-ctl check as a script meets them: scenarios, what is played, exit codes.

Usage: ctl_play_test.py PATH-OF-KDX-CTL
"""

import json
import os
import subprocess
import time

import kdxctl
import shippeddata
from kdxctl import DIFFERENT, DONE, NO_CONNECTION, WRONG_CALL
from playing import Playing

SHIPPED = sorted((shippeddata.DATA / "Scenarios").glob("*.yaml"))


class Shipped(Playing):
    def testThereAreSix(self):
        self.assertEqual(len(SHIPPED), 6)

    def testEachIsRightAndPlays(self):
        for file in SHIPPED:
            with self.subTest(file.name):
                self.assertEqual(self.ctl("check", str(file)).stderr, "")
                report = self.folder / (file.stem + ".csv")
                run = self.simulated("-q", "play", str(file), "--yes", "--speed", "500", "--report", str(report),
                                     expect=DIFFERENT)
                self.assertEqual(run.stdout, "")
                self.assertRegex(run.stderr, self.NO_LISTS_BEFORE)
                rows = self.read(report)
                self.assertEqual(rows[0]["command"], "*IDN?")
                self.assertGreater(len([row for row in rows if row["step"] != "data_set"]), 10)
                self.assertEqual({row["status"] for row in rows} - {"0", "", "met", "--yes", "no Return"}, set())


class Check(Playing):
    def testTheScenarioOfTheReadmeIsRight(self):
        text = (shippeddata.DATA.parent / "README.md").read_text(encoding="utf-8").split("```yaml\n")[1].split("```")[0]
        self.assertEqual(self.ctl("check", self.scenario(text)).stdout, "Announcement on another network: 8 steps\n")

    def testARightFileIsToldInOneLine(self):
        run = self.ctl("check", self.scenario("title: Test\nsteps: [note: a, wait: 1 s]\n"))
        self.assertEqual((run.stdout, run.stderr), ("Test: 2 steps\n", ""))
        document = json.loads(self.ctl("--json", "check", self.scenario("title: T\nsteps: [note: a]\n")).stdout)
        self.assertEqual(document, {"title": "T", "steps": 1, "exit_code": 0})

    def testEveryMistakeIsToldWithFileLineAndColumnAndNothingIsSent(self):
        text = "titel: x\nsteps:\n- wait: 2\n- send: {PTY: 99}\n"
        file = self.scenario(text)
        told = [f"kdx-ctl: {file}:1:1: unknown word \"titel\"; known here: title, data_set, steps, restore, report",
                f"kdx-ctl: {file}:3:9: wait needs a unit: 500 ms, 2 s, 1.5 min or 1 h, not \"2\"",
                f"kdx-ctl: {file}:4:15: PTY cannot be \"99\". Legal: 0 to 31."]
        self.assertEqual(self.ctl("check", file, expect=WRONG_CALL).stderr.splitlines(), told)
        run = self.simulated("-v", "play", file, expect=WRONG_CALL)
        self.assertEqual((run.stdout, run.stderr.splitlines()), ("", told))

    def testForcedValuesGoOut(self):
        rows = self.rows("steps: [send: {PTY: 99}]", "--force")
        self.assertEqual([row["command"] for row in rows], [':STEREO:DIRECT "PTY=99"'])

    def testWhatCannotBeReadIsExitCode2(self):
        unreadable = self.folder / "pipe"
        os.mkfifo(unreadable)
        for file in (self.folder / "none", self.folder, unreadable, "/dev/zero"):
            for subcommand in ("check", "play"):
                run = self.simulated(subcommand, str(file), expect=WRONG_CALL)
                self.assertEqual(run.stderr, f"kdx-ctl: {file} cannot be read\n")

    def testADataSetThatIsNotThereOrNotLegalIsExitCode2(self):
        file = self.scenario("data_set: 3\nsteps: [note: a]\n")
        dataSet = self.folder / "Daten" / "Datenset3.INI"
        dataSet.write_text("[RDS]\nPTY=77\n")
        self.assertIn("PTY cannot be", self.ctl("check", file, expect=WRONG_CALL).stderr)
        dataSet.unlink()
        self.assertIn("Datenset3.INI cannot be read", self.ctl("check", file, expect=WRONG_CALL).stderr)


class Calls(Playing):
    def testHelpHasAnExampleThatWorks(self):
        for name in ("play", "check"):
            example = self.ctl(name, "--help").stdout.split("Example: kdx-ctl ")[1].split()
            run = subprocess.run(self.command("-q", *example), capture_output=True, text=True, cwd=self.folder,
                                 timeout=100)
            self.assertEqual(run.returncode, DIFFERENT if name == "play" else DONE, run.stderr)
            self.assertRegex(run.stderr, self.NO_LISTS_BEFORE if name == "play" else "^$")
        played = [row for row in self.read(self.folder / "af.csv") if row["step"] != "restore"]
        self.assertEqual((played[-1]["key"], played[-1]["value"]), ("HF-Pegel", "60"))

    def testSpeedIsForTheVirtualInstrumentOnly(self):
        file = self.scenario("steps: [note: a]")
        run = self.ctl("--lan", "127.0.0.9", "play", file, "--speed", "10", expect=WRONG_CALL)
        self.assertIn("--speed is for rehearsals", run.stderr)
        self.simulated("play", file, "--speed", "0.5", expect=WRONG_CALL)

    def testARehearsalTakesAPartOfTheTime(self):
        begin = time.monotonic()
        rows = self.rows("steps: [send: {TA: 1}, wait: 60 s, send: {TA: 0}]")
        self.assertLess(time.monotonic() - begin, 10)
        seconds = [time.mktime(time.strptime(row["time"][:19], "%Y-%m-%d %H:%M:%S")) for row in rows]
        self.assertAlmostEqual(seconds[1] - seconds[0], 60, delta=5)

    def testWithoutSpeedTimesAreTheOnesOfTheFile(self):
        begin = time.monotonic()
        self.simulated("play", self.scenario("steps: [wait: 300 ms, wait: 400 ms]"))
        self.assertGreaterEqual(time.monotonic() - begin, 0.7)

    def testAStepThatIsNotThereIsExitCode2(self):
        file = self.scenario("steps: [note: a, {repeat: 2, steps: [note: b]}]")
        for option, step in (("--from", "3"), ("--until", "1.1"), ("--from", "x"), ("--from", "2#3"),
                             ("--from", ""), ("--until", "")):
            run = self.simulated("play", file, option, step, expect=WRONG_CALL)
            self.assertIn(f'there is no step "{step}";', run.stderr)
        run = self.simulated("play", file, "--from", "2", "--until", "1", expect=WRONG_CALL)
        self.assertIn("step 1 comes before step 2", run.stderr)

    def testAPartIsPlayed(self):
        text = "steps: [note: a, {repeat: 3, steps: [note: b, note: c]}, note: d]"
        rows = self.rows(text, "--from", "2#2.2", "--until", "2#3.1")
        self.assertEqual([(row["step"], row["value"]) for row in rows], [("2#2.2", "c"), ("2#3.1", "b")])

    def testNoConnectionIsExitCode4AndKeepsTheReportOfBefore(self):
        report = self.folder / "kept.csv"
        report.write_text("kept")
        self.ctl("--lan", "127.0.0.9", "play", self.scenario("steps: [note: a]"), "--report", str(report),
                 expect=NO_CONNECTION)
        self.assertEqual(report.read_text(), "kept")


class Plays(Playing):
    def testWordsTellEachStep(self):
        out = self.play("steps: [send: {TA: 1}, note: done]").stdout.splitlines()
        self.assertRegex(out[0], r"^\d\d:\d\d:\d\d  1  send TA=1$")
        self.assertRegex(out[1], r"^\d\d:\d\d:\d\d  2  note: done$")
        self.assertIn("-> :STEREO:DIRECT", self.play("steps: [send: {TA: 1}]", "-v").stdout)

    def testTheReportHasARowForEverything(self):
        rows = self.rows('steps: [send: {PS: Süd, TP: 1}, expect: {PS: Süd}, note: "a, \\"b\\""]')
        self.assertEqual([(row["step"], row["key"], row["value"], row["command"], row["status"], row["answer"])
                          for row in rows],
                         [("1", "PS", "Süd", ':STEREO:DIRECT "PS=Süd     "', "0", ""),
                          ("1", "TP", "1", ":stereo:rds:traffic:program ON", "0", ""),
                          ("2", "PS", "Süd", ':STEREO:DIRECT? "PS"', "met", "Süd"),
                          ("3", "note", 'a, "b"', "", "", "")])

    def testTheScenariosOwnReportIsRelativeToTheCurrentFolder(self):
        file = self.scenario("report: own.csv\nsteps: [note: a]")
        subprocess.run(self.command("-q", "--simulate", "play", file), cwd=self.folder, check=True, timeout=100)
        self.assertEqual(len(self.read(self.folder / "own.csv")), 1)

    def testTheDocumentHasTheSteps(self):
        document = json.loads(self.play("steps: [send: {TA: 1}, expect: {TA: 0}]", "--json", expect=DIFFERENT).stdout)
        self.assertEqual([(step["step"], step["status"]) for step in document["steps"]], [("1", "0"), ("2", "not met")])
        self.assertEqual((document["complete"], document["unmet"], document["exit_code"]), (True, 1, 3))

    def testAnUnmetExpectationIsExitCode3(self):
        run = self.play("steps: [send: {TA: 1}, expect: {TA: 0, within: 1 s}, note: on]", expect=DIFFERENT)
        self.assertEqual(run.stderr, 'kdx-ctl: step 2: expected TA=0, answered was "1"\n'
                                     'kdx-ctl: 1 expectation was not met\n')
        self.assertIn("note: on", run.stdout)

    def testADataSetGoesOutFirst(self):
        sent = self.sent("play", self.scenario("data_set: 4\nsteps: [send: {PS: LAST}]"), "--speed", "100")
        self.assertEqual(sent, self.sent("apply", "--data-set", "4") + [':STEREO:DIRECT "PS=LAST    "'])

    def testCommandsAboutTheOtherNetworkAreLedByTheDataSetsPi(self):
        sent = self.sent("play", self.scenario("steps: [send: {EON_TA: 1}]"))
        self.assertEqual(sent, self.sent("send", "EON_TA=1"))


class Memory(Playing):
    def testALongRunTakesNoMoreThanAShortOne(self):
        # The address sanitizer would keep freed memory for a while.
        environment = dict(os.environ, ASAN_OPTIONS="quarantine_size_mb=0:thread_local_quarantine_size_kb=0")

        def most(passes):
            process = self.begun("--simulate", "-q", "play", "--speed", "1000", self.scenario(
                f"steps: [{{repeat: {passes}, steps: [note: a line of some length, send: {{TA: 1}}]}}]"),
                env=environment)
            _, status, used = os.wait4(process.pid, 0)
            process.returncode = os.waitstatus_to_exitcode(status)
            self.assertEqual(process.returncode, DONE)
            return used.ru_maxrss

        self.assertLess(most(20000) - most(100), 4000)  # KiB; each pass kept would be 2


if __name__ == "__main__":
    kdxctl.main()
