"""kdx-ctl play and kdx-ctl check as a script meets them: scenarios, reports, stops, exit codes.

Usage: ctl_play_test.py PATH-OF-KDX-CTL PATH-OF-KDX-SIM
"""

import csv
import json
import os
import pathlib
import pty
import resource
import signal
import subprocess
import sys
import time
import unittest

import ctl_test
import shippeddata
from ctl_test import DIFFERENT, DONE, FAILED, NO_CONNECTION, WRONG_CALL

SHIPPED = sorted((shippeddata.DATA / "Scenarios").glob("*.yaml"))


class Playing(ctl_test.Ctl):
    def scenario(self, text):
        file = self.folder / "scenario.yaml"
        file.write_text(text, encoding="utf-8")
        return str(file)

    def play(self, text, *arguments, **how):
        return self.simulated("play", self.scenario(text), "--speed", "100", *arguments, **how)

    def rows(self, text, *arguments, **how):
        """The report's rows, without those of the data set."""
        report = self.folder / "report.csv"
        self.play(text, "--report", str(report), *arguments, **how)
        return [row for row in self.read(report) if row["step"] != "data_set"]

    @staticmethod
    def read(report):
        with open(report, encoding="utf-8", newline="") as file:
            return list(csv.DictReader(file))

    def begun(self, *arguments, **how):
        process = subprocess.Popen(self.command(*arguments), stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True,
                                   stdin=how.pop("stdin", subprocess.DEVNULL), **how)
        self.addCleanup(process.stdout.close)
        self.addCleanup(process.stderr.close)
        self.addCleanup(process.wait)
        self.addCleanup(process.kill)
        return process

    def until(self, process, text):
        for line in process.stdout:
            if text in line:
                return
        self.fail(process.stderr.read())


class Shipped(Playing):
    # The virtual instrument begins without lists, and a coder that has some cannot be without any again.
    NO_LISTS_BEFORE = r"^kdx-ctl: not as before: AF1(, AF2, AF3, AF4, AF5)?\n$"

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
            self.assertRegex(run.stderr, Shipped.NO_LISTS_BEFORE if name == "play" else "^$")
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


class Persons(Playing):
    PAUSES = "steps: [send: {TA: 1}, pause: 'Radio tuned to 98.5 MHz?', send: {TA: 0}, pause: 'Done?', note: end]"

    def testAPauseTakesALineOfThePipe(self):
        run = subprocess.run(self.command("--simulate", "play", self.scenario(self.PAUSES)), input="\nyes\n",
                             capture_output=True, text=True, timeout=100)
        self.assertEqual(run.returncode, DONE, run.stderr)
        self.assertEqual(run.stderr, "Radio tuned to 98.5 MHz? (Return)\nDone? (Return)\n")
        self.assertIn("note: end", run.stdout)

    def testTheEndOfTheInputIsAStop(self):
        for text in ("\n", "", "no line end"):
            run = subprocess.run(self.command("--simulate", "play", self.scenario(self.PAUSES)), input=text,
                                 capture_output=True, text=True, timeout=100)
            self.assertEqual(run.returncode, FAILED)
            self.assertIn("stopped: the input ended at the pause of step " + ("4" if text == "\n" else "2"), run.stderr)
            self.assertNotIn("note: end", run.stdout)

    def testAClosedInputIsAStopToo(self):
        process = self.begun("--simulate", "play", self.scenario(self.PAUSES), stdin=None,
                             preexec_fn=lambda: os.close(0))
        self.assertEqual(process.wait(100), FAILED)

    def testAnInputWithoutEndAndLineEndHoldsNothingUp(self):
        source = subprocess.Popen(["sh", "-c", "yes | tr -d '\\n'"], stdout=subprocess.PIPE)
        self.addCleanup(source.wait)
        self.addCleanup(source.kill)
        self.addCleanup(source.stdout.close)
        process = self.begun("--simulate", "play", self.scenario(self.PAUSES), stdin=source.stdout)
        time.sleep(0.5)
        process.send_signal(signal.SIGINT)
        self.assertEqual(process.wait(10), FAILED)

    def testWhatIsTypedAheadAtATerminalIsNoAnswer(self):
        person, terminal = pty.openpty()
        self.addCleanup(os.close, person)
        file = self.scenario("steps: [wait: 600 ms, pause: 'Ready?', note: end]")
        process = self.begun("--simulate", "-v", "play", file, stdin=terminal)
        os.close(terminal)
        self.until(process, "wait")
        os.write(person, b"\n\n")
        time.sleep(1)
        self.assertIsNone(process.poll())
        os.write(person, b"\n")
        out, problems = process.communicate(timeout=10)
        self.assertEqual(process.returncode, DONE, problems)
        self.assertIn("note: end", out)

    def testYesGoesOn(self):
        run = self.play(self.PAUSES, "--yes")
        self.assertEqual(run.stderr, "")
        self.assertIn("note: end", run.stdout)

    def testAReturnAtTheTerminalEndsASweepAndTheReportKeepsTheLevel(self):
        report = self.folder / "report.csv"
        text = "steps: [{sweep: HF-Pegel, from: 60, to: 0, step: -1, dwell: 300 ms, until: Return}, note: end]"
        person, terminal = pty.openpty()
        self.addCleanup(os.close, person)
        process = self.begun("--simulate", "play", self.scenario(text), "--report", str(report), "-v", stdin=terminal)
        os.close(terminal)
        self.until(process, ":POW 57DBUV")
        os.write(person, b"\n")
        out, problems = process.communicate(timeout=100)
        self.assertEqual(process.returncode, DONE, problems)
        rows = self.read(report)
        ended = [row for row in rows if row["status"] == "Return"]
        last = [row for row in rows if row["command"].startswith(":POW")][-1]
        self.assertEqual([(row["step"], row["key"], row["value"]) for row in ended],
                         [(last["step"], "HF-Pegel", last["value"])])
        self.assertLess(int(last["value"]), 58)
        self.assertIn(f"step {last['step']}: Return at HF-Pegel={last['value']}", out)
        self.assertEqual(self.read(report)[-1]["value"], "end")


class Restored(Playing):
    def testWhatCannotComeBackIsNamed(self):
        run = self.play("restore: true\nsteps: [send: {AF1: \"N,98.5,87.6\", PS: OTHER}]", expect=DIFFERENT)
        self.assertEqual(run.stderr, "kdx-ctl: not as before: AF1\n")

    def testARequestToEndDoesNotStopTheRestoring(self):
        for request in (signal.SIGINT, signal.SIGTERM):
            process = self.begun("--simulate", "-v", "play",
                                 self.scenario("restore: true\nsteps: [send: {PS: OTHER, TA: 1}, note: end]"))
            self.until(process, "note: end")
            time.sleep(0.3)
            process.send_signal(request)
            out, problems = process.communicate(timeout=100)
            self.assertEqual((process.returncode, problems), (DONE, ""))
            self.assertIn('PS=KDX-X4', out)
            self.assertIn('TA=0', out)

    def testAFullDiskUnderTheReportRestoresToo(self):
        def fullDisk():
            resource.setrlimit(resource.RLIMIT_FSIZE, (300, 300))

        text = "restore: true\nsteps: [{repeat: 50, steps: [send: {PS: OTHER}]}]"
        process = self.begun("--simulate", "-v", "play", self.scenario(text), "--report", str(self.folder / "r.csv"),
                             preexec_fn=fullDisk, restore_signals=False)
        out, problems = process.communicate(timeout=100)
        self.assertEqual((process.returncode, problems.count("the report cannot be written")), (FAILED, 1))
        self.assertIn('PS=KDX-X4', out)


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


class Reports(Playing):
    def testAFileThatIsNoReportStaysAsItIs(self):
        text = "steps: [note: a]"
        file = self.scenario(text)
        run = self.simulated("play", file, "--report", file, expect=WRONG_CALL)
        self.assertIn("is there, and is no report", run.stderr)
        self.assertEqual(pathlib.Path(file).read_text(encoding="utf-8"), text)

    TEXT = "steps: [{repeat: 50, steps: [send: {TA: 1}, wait: 10 ms]}]"

    def testWhatIsNoPlainFileIsExitCode2BeforeAnythingIsSent(self):
        (self.folder / "link").symlink_to(self.folder / "elsewhere")
        for report in ("/dev/full", self.folder, self.folder / "none" / "r.csv", self.folder / "link"):
            run = self.play(self.TEXT, "--report", str(report), "-v", expect=WRONG_CALL)
            self.assertEqual(run.stderr, f"kdx-ctl: the report {report} cannot be written\n")
            self.assertNotIn("->", run.stdout)

    def testAFullDiskUnderTheReportIsToldOnceAndEndsTheRun(self):
        report = self.folder / "report.csv"

        def fullDisk():
            resource.setrlimit(resource.RLIMIT_FSIZE, (500, 500))

        # Python ignores the signal of the limit; the program is to inherit that, as a full disk sends none.
        process = self.begun("--simulate", "play", self.scenario(self.TEXT), "--report", str(report),
                             preexec_fn=fullDisk, restore_signals=False)
        out, problems = process.communicate(timeout=100)
        self.assertEqual(process.returncode, FAILED)
        self.assertEqual(problems, "kdx-ctl: the report cannot be written any more; the run ends\n")
        self.assertLess(out.count("send TA=1"), 10)
        self.assertEqual(report.stat().st_size, 500)

    def testARunThatIsKilledHasLeftWhatItDid(self):
        report = self.folder / "report.csv"
        process = self.begun("--simulate", "-v", "play", self.scenario("steps: [send: {PS: RADIO}, wait: 1 h]"),
                             "--report", str(report))
        self.until(process, "wait 3600 s")
        process.kill()
        process.wait()
        self.assertEqual([row["value"] for row in self.read(report)], ["RADIO"])


class OverTheNetwork(Playing, ctl_test.Networked):
    SWEEP = "steps: [{sweep: HF-Pegel, from: 60, to: 0, step: -1, dwell: 200 ms}, note: never]"

    def testWhatIsPlayedIsReadBack(self):
        run = self.lan("play", self.scenario("steps: [send: {PS: TESTTURM}, expect: {PS: TESTTURM, pilot: [0, 675, 0]}]"))
        self.assertEqual(run.stderr, "")
        self.assertEqual(self.lan("query", "ps").stdout, "TESTTURM\n")

    def testAServerThatIsKilledIsToldOnceAndEndsTheRun(self):
        process = self.begun("--lan", "127.0.0.1", "-v", "play", self.scenario(self.SWEEP))
        self.until(process, ":POW 58DBUV")
        self.sim.kill()
        out, problems = process.communicate(timeout=100)
        self.assertEqual(process.returncode, FAILED)
        self.assertEqual(problems.count("the link to the instrument is broken"), 1, problems)
        self.assertNotIn("never", out)

    def testARequestToEndStopsASweepAfterTheRunningCommand(self):
        for request in (signal.SIGINT, signal.SIGTERM):
            process = self.begun("--lan", "127.0.0.1", "-v", "play", self.scenario(self.SWEEP))
            self.until(process, ":POW 58DBUV")
            process.send_signal(request)
            out, problems = process.communicate(timeout=10)
            self.assertEqual((process.returncode, problems), (FAILED, "kdx-ctl: stopped\n"))
            self.assertNotIn("never", out)

    RESTORED = "restore: true\nsteps: [send: {PS: CHANGED, TA: 1, PI: 1E10}, {sweep: HF-Pegel, from: 60, to: 0, " \
               "step: -1, dwell: 200 ms}]"

    def testWhatStoodBeforeComesBackAfterAStopInASweep(self):
        self.lan("apply", "--data-set", "4")
        process = self.begun("--lan", "127.0.0.1", "-v", "play", self.scenario(self.RESTORED))
        self.until(process, ":POW 58DBUV")
        process.send_signal(signal.SIGINT)
        out, problems = process.communicate(timeout=60)
        self.assertEqual((process.returncode, problems), (FAILED, "kdx-ctl: stopped\n"))
        self.assertIn("PS=", out)
        self.assertEqual(self.lan("diff", "--data-set", "4").stdout, "")

    def testWhatStoodBeforeComesBackAtTheEndWithARowForEachCommand(self):
        self.lan("apply", "--data-set", "4")
        report = self.folder / "report.csv"
        text = "data_set: 2\nrestore: true\nsteps: [send: {PS: CHANGED, EON_TA: 1}]"
        self.lan("play", self.scenario(text), "--report", str(report))
        self.assertEqual(self.lan("diff", "--data-set", "4").stdout, "")
        back = [row for row in self.read(report) if row["step"] == "restore"]
        self.assertIn("PS", [row["key"] for row in back])
        self.assertFalse([row for row in back if "?" in row["command"]])

    def testWithoutRestoreItStaysAsPlayed(self):
        self.lan("apply", "--data-set", "4")
        self.lan("play", self.scenario("steps: [send: {PS: CHANGED}]"))
        self.assertIn("CHANGED", self.lan("diff", "--data-set", "4", expect=DIFFERENT).stdout)

    def testAKilledServerLeavesNothingToBringBackAndThatIsTold(self):
        process = self.begun("--lan", "127.0.0.1", "-v", "play", self.scenario(self.RESTORED))
        self.until(process, ":POW 58DBUV")
        self.sim.kill()
        _, problems = process.communicate(timeout=60)
        self.assertEqual(process.returncode, FAILED)
        self.assertEqual(problems.count("the link to the instrument is broken"), 1, problems)
        self.assertTrue(problems.endswith("kdx-ctl: what stood before could not be brought back\n"
                                          "kdx-ctl: perhaps not as before: HF-Pegel, PI, PS, TA\n"), problems)

    def testALongWaitEndsAtOnce(self):
        process = self.begun("--lan", "127.0.0.1", "-v", "play", self.scenario("steps: [send: {TA: 1}, wait: 100 h]"))
        self.until(process, "wait")
        begin = time.monotonic()
        process.send_signal(signal.SIGINT)
        self.assertEqual(process.wait(10), FAILED)
        self.assertLess(time.monotonic() - begin, 2)


if __name__ == "__main__":
    ctl_test.CTL, ctl_test.SIM = map(os.path.abspath, sys.argv[1:3])
    del sys.argv[1:3]
    unittest.main()
