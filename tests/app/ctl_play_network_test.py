"""kdx-ctl play over the network, with kdx-sim at the other end.

Usage: ctl_play_network_test.py PATH-OF-KDX-CTL PATH-OF-KDX-SIM
"""

import signal

import kdxctl
from kdxctl import DIFFERENT, FAILED
from playing import Playing


class OverTheNetwork(Playing, kdxctl.Networked):
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
        process.send_signal(signal.SIGINT)
        self.assertEqual(process.wait(10), FAILED)


if __name__ == "__main__":
    kdxctl.main(networked=True)
