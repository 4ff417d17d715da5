"""What kdx-ctl and the window put on the wire, as the trace of kdx-sim tells it, and what becomes of a run that ends.

Usage: ctl_wire_test.py PATH-OF-KDX-CTL PATH-OF-KDX-RDS PATH-OF-KDX-SIM
"""

import os
import re
import signal
import subprocess
import sys

import kdxctl
import shippeddata
from kdxctl import FAILED

RDS = ""


class Wire(kdxctl.Ctl):
    def setUp(self):
        super().setUp()
        self.trace = self.folder / "trace.txt"
        self.startSim()

    def startSim(self):
        """A new instrument, as after switching on."""
        with open(self.trace, "w", encoding="ascii") as trace:
            self.sim = subprocess.Popen([kdxctl.SIM, "--bind", "127.0.0.1", "--trace"], stdout=trace)
        self.addCleanup(self.sim.wait)
        self.addCleanup(self.sim.kill)
        self.waitFor(lambda text: "ready:" in text)

    def waitFor(self, condition):
        for _ in range(200):
            text = self.trace.read_text()
            if condition(text):
                return text
            if self.sim.poll() is None:
                subprocess.run(["sleep", "0.05"], check=True)
        self.fail(text)

    def lan(self, *arguments, **how):
        return self.ctl("--lan", "127.0.0.1", *arguments, **how)

    def lines(self):
        """What happened on the last link, without what it means; the next instrument is a new one."""
        self.sim.terminate()
        self.sim.wait()
        trace = self.trace.read_text().splitlines()
        self.startSim()
        last = max(int(line.split()[1]) for line in trace if line.startswith("link "))
        return [line.split(" ", 2)[2] for line in trace if line.startswith(f"link {last} ")]

    def messages(self):
        return [line[2:] for line in self.lines() if line.startswith("< ")]


class TheWindow(Wire):
    def testApplySendsByteForByteWhatTheWindowSends(self):
        """The window opens data set 1: every other set is put in its place, beside the carrier that set 1 keeps."""
        carrier = re.search(rb"(?ms)^\[VRN\].*?(?=^\[|\Z)", (shippeddata.DATA / "Datenset1.INI").read_bytes())[0]
        for number in "12345":
            with self.subTest(number):
                self.lan("apply", "--data-set", number)
                applied = self.messages()
                self.assertGreater(len(applied), 30)
                other = self.folder / ("window" + number)
                shippeddata.copyTo(other / "Daten")
                dataSet = (shippeddata.DATA / f"Datenset{number}.INI").read_bytes()
                if number != "1":
                    dataSet = re.sub(rb"(?ms)^\[VRN\].*?(?=^\[|\Z)", b"", dataSet) + b"\r\n" + carrier
                (other / "Daten" / "Datenset1.INI").write_bytes(dataSet)
                subprocess.run([RDS, "--app-folder", str(other), "--tour", str(other / "tour")], timeout=100,
                               stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL,
                               env=dict(os.environ, HOME=str(self.folder), QT_QPA_PLATFORM="offscreen"))
                sent = self.messages()
                self.assertEqual(sent[:len(applied)], applied)
                # After the opening the tour only asks, and the programme service name may change with the time.
                later = [text for text in sent[len(applied):] if "?" not in text and '"PS=' not in text]
                self.assertEqual(later, [])

    def testADryRunPrintsWhatGoesOut(self):
        for number in "12345":
            with self.subTest(number):
                printed = self.ctl("apply", "--data-set", number, "--dry-run").stdout.splitlines()
                self.lan("apply", "--data-set", number)
                self.assertEqual(self.messages(), printed)


class Closing(Wire):
    def testNoCommandMakesTheInstrumentLocal(self):
        self.lan("apply", "--data-set", "2")
        closed = self.lines()
        self.lan("apply", "--data-set", "2", "--keep-open")
        kept = self.lines()
        self.assertEqual(closed[-1], "closed")
        self.assertEqual(kept[-1], "closed with its connection")
        self.assertEqual(kept[:-1], closed[:-1])
        for line in kept[1:-1]:
            self.assertIn(line[:2], ("< ", "> "))


class OtherCalls(Wire):
    def testALogIsReplayed(self):
        log = self.write("log.txt", '             TP= ":stereo:rds:traffic:program ON"\r\n'
                                    '             PS= ":STEREO:DIRECT "PS=RADIO   ""\r\n')
        self.lan("replay", log)
        self.assertEqual(self.messages(), [":stereo:rds:traffic:program ON", ':STEREO:DIRECT "PS=RADIO   "'])

    def testCommandsGoAsTheyStand(self):
        self.lan("send", "--raw", "FREQ 99 MHz  ", "--coder", "RT=K\u00e4se ", "--raw", "*CLS")
        self.assertEqual(self.messages(), ["FREQ 99 MHz  ", "*CLS", ':STEREO:DIRECT "RT=K\\xE4se "'])


class Ended(Wire):
    """A run that is stopped, or that loses its instrument, in the middle."""

    def begin(self, *arguments):
        process = subprocess.Popen(self.command("--lan", "127.0.0.1", "-v", *arguments), stdout=subprocess.PIPE,
                                   stderr=subprocess.PIPE, text=True)
        self.addCleanup(process.wait)
        self.addCleanup(process.kill)
        for _ in range(3):
            process.stdout.readline()
        return process

    def calls(self):
        log = self.write("log.txt", '             PS= ":STEREO:DIRECT "PS=RADIO   ""\r\n' * 200)
        return ("query", "all"), ("replay", log)

    def testControlCStopsAndClosesTheLink(self):
        for call in self.calls():
            with self.subTest(call):
                process = self.begin(*call)
                process.send_signal(signal.SIGINT)
                rest, problems = process.communicate(timeout=20)
                self.assertEqual((process.returncode, problems), (FAILED, "kdx-ctl: stopped\n"))
                # Of a read-back the questions that belong together are asked still.
                self.assertLess(len(re.findall("(?m)^[0-9:]+ -> ", rest)), 6)
                self.assertEqual(self.lines()[-1], "closed")

    def testAServerThatIsKilledIsToldOnce(self):
        for call in self.calls():
            with self.subTest(call):
                process = self.begin(*call)
                self.sim.kill()
                self.sim.wait()
                rest, problems = process.communicate(timeout=20)
                self.assertEqual(process.returncode, FAILED)
                self.assertEqual(problems.count("\n"), 1, problems)
                self.assertIn("the link to the instrument is broken", problems)
                self.assertLess(len(rest.splitlines()), 10)
                self.startSim()


if __name__ == "__main__":
    RDS = sys.argv.pop(2)
    kdxctl.main(networked=True)
