"""kdx-ctl play with a person before it: pauses, sweeps that a Return ends.

Usage: ctl_play_persons_test.py PATH-OF-KDX-CTL
"""

import os
import pty
import signal
import subprocess
import time

import kdxctl
from kdxctl import DONE, FAILED
from playing import Playing


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


if __name__ == "__main__":
    kdxctl.main()
