"""kdx-ctl shell: one session, a command a line, from a pipe and at a terminal.

Usage: ctl_shell_test.py PATH-OF-KDX-CTL PATH-OF-KDX-SIM
"""

import json
import os
import pty
import select
import signal
import subprocess
import time

import kdxctl
from kdxctl import DIFFERENT, DONE, FAILED, NO_CONNECTION, WRONG_CALL


class Piped(kdxctl.Ctl):
    def shell(self, lines, *options, expect=DONE):
        """What comes of these lines, given all at once."""
        text = lines if isinstance(lines, bytes) else lines.encode()
        run = subprocess.run(self.command("--simulate", *options, "shell"), input=text, capture_output=True, timeout=100)
        self.assertEqual(run.returncode, expect, run.stdout + run.stderr)
        self.problems = run.stderr.decode()
        return run.stdout.decode()

    def answers(self, lines, *options, **how):
        return [json.loads(line) for line in self.shell(lines, "--json", *options, **how).splitlines()]

    def testOneSessionServesAllLines(self):
        self.assertEqual(self.shell("send PS=RADIO TP=1\nquery ps pi\nwait 20 ms\nsend PS=OTHER\nquery ps"),
                         "RADIO   \n1000\nOTHER   \n")

    def testTheOptionsOfSendAndQueryAreThere(self):
        traffic = self.answers('send --raw "FREQ 99 MHz" TP=1 --coder PTY=07 --raw *CLS\n')[0]["traffic"]
        self.assertEqual([passed["text"] for passed in traffic],
                         [":stereo:rds:traffic:program ON", "FREQ 99 MHz", "*CLS", ':STEREO:DIRECT "PTY=07"'])
        self.assertEqual(self.shell("query --raw ari"), "0\n350\n0\nA\n")

    def testTheOtherNetworkIsTheOneSentLast(self):
        told = self.answers("send EON_PI=D3C1\nsend EON_TA=1\n")
        self.assertEqual(told[1]["traffic"][0]["text"], ':STEREO:DIRECT "EON-TA=D3C1,1"')

    def testQuotesHoldBlanksTogether(self):
        lines = ("send \"PS=AB CD\"\nquery ps\nsend PS='E \"F'\nsend 'RT=open\"\nsend PS=\"A\"'B'C\nquery ps\n"
                 "send 'RT=#1 on 98.5'\nquery rt\n")
        self.assertEqual(self.shell(lines, expect=WRONG_CALL), "AB CD   \nABC     \n#1 on 98.5\n")
        self.assertIn('line 3: PS cannot be "E "F"', self.problems)
        self.assertIn("line 4: a quote is not closed", self.problems)

    def testCommentsAndBlankLinesAreDoneAtOnce(self):
        self.assertEqual(self.answers("# first\n\n   \t\n  # PS\nquery ps # behind\n\r\n"),
                         [{"line": 1, "exit_code": 0}, {"line": 2, "exit_code": 0}, {"line": 3, "exit_code": 0},
                          {"line": 4, "exit_code": 0},
                          {"line": 5, "exit_code": 0, "answers": {"ps": {"answers": ["KDX-X4  "], "words": "KDX-X4  "}},
                           "traffic": [{"direction": "written", "status": 0, "text": ':STEREO:DIRECT? "PS"'},
                                       {"direction": "read", "status": 0, "text": '"KDX-X4  "'}]},
                          {"line": 6, "exit_code": 0}])

    def testLinesMayEndAsOnOtherSystems(self):
        self.assertEqual(self.shell("query ps\r\nquery pi\r"), "KDX-X4  \n1000\n")

    def testWrongLinesAreToldWithTheirNumberAndTheNextOnesRun(self):
        wrong = {b"nonsense": "there is no command nonsense", b"send": "required", b"send PS": "PS is not KEY=VALUE",
                 b"send PS=A\0B": "holds a NUL byte", b"send PS=\xfc": "not UTF-8", b"send PS=\xed\xa0\x80": "not UTF-8",
                 b'send "PS=A': "a quote is not closed", b"query nothing": "no read-back nothing",
                 b"query": "required", b"wait": "required", b"wait 5": "is no time", b"wait 2,5 s": "is no time",
                 b"wait 99999999999999999999 s": "is no time", b"quit now": "not expected", b"help me": "no command me",
                 b"send HF-Frequenz=98,5": "decimal comma", b"apply": "there is no command apply",
                 b"--help": "no command", b"send PS=A --nothing": "not expected: --nothing", b"\x1b[A": "no command",
                 b"send PS=" + b"x" * 70000: "more than 65536 bytes", b"y" * 5_000_000: "more than 65536 bytes"}
        for line, problem in wrong.items():
            with self.subTest(line[:40]):
                told = self.answers(line + b"\nquery pi\n" + line, expect=WRONG_CALL)
                self.assertEqual([answer["exit_code"] for answer in told], [WRONG_CALL, DONE, WRONG_CALL])
                self.assertIn(problem, told[0]["problems"][0])
                self.assertEqual(told[1]["answers"]["pi"]["words"], "1000")
                self.assertIn("kdx-ctl: line 1: ", self.problems)
                self.assertIn("kdx-ctl: line 3: ", self.problems)

    def testNothingAtAllIsFine(self):
        self.assertEqual(self.shell(""), "")
        self.assertEqual(self.shell("", "--json"), "")

    def testQuitEndsBeforeTheInputDoes(self):
        self.assertEqual(len(self.answers("quit\nquery ps\n")), 1)
        self.assertEqual(len(self.answers("exit\nquery ps\n")), 1)

    def testWhatIsReadIntoAFileDiffersInNothing(self):
        file = str(self.folder / "Bench.INI")
        lines = ["diff --data-set 2", "diff --data-set 2 --fix", f"read --into {file}", f"diff --file {file}",
                 "send PS=OTHER", f"diff --file {file}", "diff"]
        told = self.answers("\n".join(lines), expect=DIFFERENT)
        self.assertEqual([answer["exit_code"] for answer in told],
                         [DIFFERENT, DONE, DONE, DONE, DONE, DIFFERENT, WRONG_CALL])
        self.assertEqual([row["setting"] for row in told[5]["differences"]], ["PS"])
        self.assertIn("which data set?", told[6]["problems"][0])

    def testHelpListsTheCommands(self):
        listed = self.shell("help")
        for name in ("send", "query", "diff", "read", "wait", "help", "quit"):
            self.assertIn("\n" + name + " ", "\n" + listed)
        self.assertIn("--raw", self.shell("help send"))
        self.assertIn("--raw", self.answers("send --help")[0]["help"])

    def testWaitingWaits(self):
        began = time.monotonic()
        self.shell("wait 1 s\nwait 200ms\n")
        self.assertTrue(1.2 <= time.monotonic() - began < 3)

    def testAnInputThatCannotBeReadIsToldAndNoCrash(self):
        folder = os.open("/", os.O_RDONLY)
        self.addCleanup(os.close, folder)
        run = subprocess.run(self.command("--simulate", "shell"), stdin=folder, capture_output=True, text=True)
        self.assertEqual(run.returncode, FAILED)
        self.assertIn("standard input", run.stderr)

    def testAnswersThatCannotBeWrittenEndTheRun(self):
        with open("/dev/full", "wb") as full:
            run = subprocess.run(self.command("--simulate", "shell"), input=b"query ps\n" * 1000, stdout=full,
                                 stderr=subprocess.PIPE, timeout=10)
        self.assertEqual(run.returncode, FAILED)
        self.assertIn(b"cannot be written", run.stderr)


class Held(kdxctl.Ctl):
    """A shell that a program holds: it writes a line and reads its answer."""

    def setUp(self):
        super().setUp()
        self.sims = []

    def hold(self, *options):
        self.process = subprocess.Popen(self.command(*options, "shell"), stdin=subprocess.PIPE, stdout=subprocess.PIPE,
                                        stderr=subprocess.PIPE, text=True, bufsize=1)
        self.addCleanup(self.process.communicate)
        self.addCleanup(self.process.kill)

    def tell(self, line):
        self.process.stdin.write(line + "\n")

    def ask(self, line):
        self.tell(line)
        return json.loads(self.process.stdout.readline())

    def end(self):
        """The exit code, what was not read yet, and the problems."""
        rest, problems = self.process.communicate(timeout=20)
        return self.process.returncode, rest, problems

    def startSim(self):
        sim = subprocess.Popen([kdxctl.SIM, "--bind", "127.0.0.1"], stdout=subprocess.PIPE, text=True)
        self.addCleanup(sim.stdout.close)
        self.addCleanup(sim.wait)
        self.addCleanup(sim.kill)
        self.assertIn("127.0.0.1", sim.stdout.readline())
        return sim

    def testEveryAnswerComesAtOnce(self):
        self.hold("--simulate")
        self.tell("query pi")
        self.assertEqual(self.process.stdout.readline(), "1000\n")
        self.tell("query ps")
        self.assertEqual(self.process.stdout.readline(), "KDX-X4  \n")
        self.assertEqual(self.end(), (DONE, "", ""))

    def testAProgramThatGoesAwayLeavesNothingBehind(self):
        self.hold("--simulate", "--json")
        self.ask("query ps")
        self.process.stdout.close()
        self.tell("query ps")
        self.assertEqual(self.process.wait(timeout=10), FAILED)

    def testARequestToEndEndsAWaitingShell(self):
        for request in (signal.SIGINT, signal.SIGTERM):
            for line in ("query ps", "wait 60 s"):
                self.hold("--simulate")
                self.tell("query ps")
                self.process.stdout.readline()
                self.tell(line)
                time.sleep(0.3)
                self.process.send_signal(request)
                code, _, problems = self.end()
                self.assertEqual(code, FAILED)
                self.assertEqual(problems.count("stopped"), 1, problems)

    def testNoConnectionIsExitCode4BeforeAnyLine(self):
        self.hold("--lan", "127.0.0.9", "--json")
        code, rest, problems = self.end()
        self.assertEqual((code, rest.count("\n")), (NO_CONNECTION, 1))
        answer = json.loads(rest)
        self.assertEqual(answer["exit_code"], NO_CONNECTION)
        self.assertIn("no connection to 127.0.0.9", answer["problems"][0])
        self.assertEqual(problems.count("no connection to 127.0.0.9"), 1)

    def testAFailedCommandMakesTheExitCode(self):
        sim = self.startSim()
        self.hold("--lan", "127.0.0.1", "--json", "--timeout", "0.3")
        self.assertEqual(self.ask("query ps")["exit_code"], DONE)
        sim.send_signal(signal.SIGSTOP)
        silent = self.ask("query ps pi")
        self.assertEqual((silent["exit_code"], len(silent["problems"])), (FAILED, 1))
        sim.send_signal(signal.SIGCONT)
        self.assertEqual(self.ask("query pi")["answers"]["pi"]["words"], "1000")
        code, _, problems = self.end()
        self.assertEqual((code, problems.count("\n")), (FAILED, 1))

    def testALostLinkIsToldOnceAndMadeAnewWithTheInstrument(self):
        sim = self.startSim()
        self.hold("--lan", "127.0.0.1", "--json")
        self.ask("send PS=BEFORE")
        sim.kill()
        sim.wait()
        lost = self.ask("send PS=NOW PI=1234")
        self.assertEqual(lost["exit_code"], FAILED)
        self.assertIn("the link to the instrument is broken", lost["problems"][0])
        for _ in range(3):
            gone = self.ask("query ps")
            self.assertEqual(gone["exit_code"], NO_CONNECTION)
            self.assertIn("no connection to 127.0.0.1", gone["problems"][0])
        self.startSim()
        back = self.ask("query ps")
        self.assertEqual((back["exit_code"], back["connected_again"]), (DONE, True))
        self.assertNotIn("connected_again", self.ask("query ps"))
        code, _, problems = self.end()
        self.assertEqual(code, NO_CONNECTION)
        self.assertEqual(problems.count("\n"), 1, problems)


class AtATerminal(kdxctl.Ctl):
    def setUp(self):
        super().setUp()
        self.terminal, other = pty.openpty()
        self.addCleanup(os.close, self.terminal)
        environment = dict(os.environ, TERM="vt100", LC_ALL="C")
        self.process = subprocess.Popen(self.command("--simulate", "shell"), stdin=other, stdout=other, stderr=other,
                                        env=environment, start_new_session=True,
                                        preexec_fn=lambda: os.close(os.open(os.ttyname(0), os.O_RDWR)))
        os.close(other)
        self.addCleanup(self.process.wait)
        self.addCleanup(self.process.kill)
        self.shown = ""
        self.awaits("kdx> ")

    def awaits(self, text):
        """Reads until the terminal has shown it; what came before is gone then."""
        end = time.monotonic() + 10
        while text not in self.shown:
            ready, _, _ = select.select([self.terminal], [], [], max(0, end - time.monotonic()))
            self.assertTrue(ready, f"{text!r} does not come: {self.shown!r}")
            try:
                self.shown += os.read(self.terminal, 4096).decode()
            except OSError:  # the program has gone
                self.fail(f"{text!r} did not come: {self.shown!r}")
        before, self.shown = self.shown.split(text, 1)
        return before

    def types(self, text):
        os.write(self.terminal, text.encode())

    def testLinesAreEditedAndRun(self):
        self.types("query pppp\b\b\bs\n")
        self.awaits("KDX-X4  \r\n")
        self.awaits("kdx> ")
        self.types("send PS=K\u00e4se\n")
        self.awaits("kdx> ")
        self.types("query ps\n")
        self.awaits("K\u00e4se    \r\n")

    def testTheTabKeyCompletesCommandsKeysReadBacksAndOptions(self):
        for typed, told in (("query freq\t\n", "100 MHz"), ("send HF-F\t98.5\n", None), ("que\tfreq\t\n", "98.5 MHz"),
                            ("send --c\tPTY=07\n", None), ("query pty\n", "07"), ("help qui\t\n", "end")):
            self.types(typed)
            if told:
                self.awaits("\n")
                self.awaits(told)
            self.awaits("kdx> ")
        self.types("qui\t\n")
        self.assertEnds(DONE)

    def testSeveralCandidatesAreShown(self):
        self.types("query p\t")
        shown = self.awaits("ps  ")
        shown += self.awaits("preemphasis  ")
        self.awaits("kdx> query p")

    def testTheHistoryBringsLinesBack(self):
        self.types("query pi\n")
        self.awaits("1000\r\n")
        self.awaits("kdx> ")
        self.types("\x10\n")  # as the arrow key upwards
        self.awaits("1000\r\n")

    def assertEnds(self, expected):
        """The program ends with this exit code; if not, all it had to say is told."""
        code = self.process.wait(timeout=10)
        os.set_blocking(self.terminal, False)
        try:
            while code != expected:
                self.shown += os.read(self.terminal, 4096).decode(errors="replace")
        except OSError:  # there is no more
            pass
        self.assertEqual(code, expected, repr(self.shown))

    def testQuitAndEndOfInputEndWithoutAnExitCode(self):
        self.types("nonsense\n")
        self.awaits("kdx-ctl: there is no command nonsense")
        self.types("quit\n")
        self.assertEnds(DONE)

    def testEndOfInputEnds(self):
        self.types("\x04")
        self.assertEnds(DONE)

    def testControlCEndsAtThePromptAndInTheMiddle(self):
        self.types("wait 60 s\n")
        self.awaits("\r\n")
        time.sleep(0.3)
        self.process.send_signal(signal.SIGINT)
        self.awaits("stopped")
        self.assertEnds(FAILED)

    def testControlCAtThePromptEnds(self):
        self.process.send_signal(signal.SIGINT)
        self.awaits("stopped")
        self.assertEnds(FAILED)


if __name__ == "__main__":
    kdxctl.main(networked=True)
