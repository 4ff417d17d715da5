"""What kdx-ctl play leaves behind: its report, and the instrument as it was.

Usage: ctl_play_report_test.py PATH-OF-KDX-CTL
"""

import pathlib
import resource
import signal
import time

import kdxctl
from kdxctl import DIFFERENT, DONE, FAILED, WRONG_CALL
from playing import Playing


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


if __name__ == "__main__":
    kdxctl.main()
