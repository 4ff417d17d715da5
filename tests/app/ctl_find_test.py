"""kdx-ctl find: instruments in the networks of this machine, in a network of their own where the system permits that.

Usage: ctl_find_test.py PATH-OF-KDX-CTL PATH-OF-KDX-SIM PATH-OF-A-VISA-LIBRARY
"""

import json
import signal
import socket
import struct
import subprocess
import sys
import threading
import time

import kdxctl
from kdxctl import FAILED, NO_CONNECTION, WRONG_CALL

LIBRARY = ""


class Find(kdxctl.Ctl):
    def startSim(self, address, *options):
        sim = subprocess.Popen([kdxctl.SIM, "--bind", address, *options], stdout=subprocess.PIPE, text=True)
        self.addCleanup(sim.stdout.close)
        self.addCleanup(sim.wait)
        self.addCleanup(sim.kill)
        self.assertIn("answers port-mapper questions itself", sim.stdout.readline())
        return sim

    def found(self, *arguments, **how):
        return json.loads(self.ctl("--json", "find", "--wait", "0.3", *arguments, **how).stdout)["instruments"]

    def testNoneIsToldWithExitCode4(self):
        run = self.ctl("find", "--wait", "0.2", expect=NO_CONNECTION)
        self.assertEqual(run.stdout, "")
        self.assertIn("no instrument answers", run.stderr)
        self.assertEqual(self.found(expect=NO_CONNECTION), [])

    def testEveryInstrumentIsTold(self):
        self.startSim("127.0.0.1")
        self.startSim("127.0.0.2", "--idn", "KDX,SECOND,7,1.00")
        self.assertEqual(self.ctl("find").stdout, "--lan 127.0.0.1  KDX,KDX-X4,100001,1.00\n"
                                                  "--lan 127.0.0.2  KDX,SECOND,7,1.00\n")
        self.assertEqual(self.found()[1], {"resource": "TCPIP::127.0.0.2::INSTR", "option": "--lan 127.0.0.2",
                                           "identification": "KDX,SECOND,7,1.00", "status": 0})

    def testWhatIsToldCanBeCalled(self):
        self.startSim("127.0.0.3")
        option = self.found()[0]["option"].split()
        self.assertEqual(self.ctl(*option, "query", "ps").stdout, "KDX-X4  \n")

    def fakeMapper(self, *datagrams):
        """A port mapper over UDP alone, which answers so."""
        udp = socket.socket(socket.AF_INET, socket.SOCK_DGRAM)
        udp.bind(("127.0.0.1", 111))

        def serve():
            while True:
                question, client = udp.recvfrom(1000)
                if not question:
                    return
                for datagram in datagrams:
                    udp.sendto(datagram(question[:4]), client)

        thread = threading.Thread(target=serve)
        thread.start()
        self.addCleanup(udp.close)
        self.addCleanup(thread.join)
        self.addCleanup(udp.sendto, b"", ("127.0.0.1", 111))

    def testWhoOnlySaysThatThereIsAnInstrumentIsToldAsSilent(self):
        self.fakeMapper(lambda number: number + struct.pack(">6I", 1, 0, 0, 0, 0, 4711))
        said = self.found()
        self.assertEqual([(one["option"], one["identification"]) for one in said], [("--lan 127.0.0.1", None)])
        self.assertLess(said[0]["status"], 0)
        self.assertIn("--lan 127.0.0.1  no answer to *IDN?: No instrument", self.ctl("find", "--wait", "0.2").stdout)

    def testGarbageIsNoInstrument(self):
        self.fakeMapper(lambda number: b"", lambda number: b"\xff" * 1500, lambda number: number,
                        lambda number: number + b"\xff" * 24, lambda number: number + struct.pack(">6I", 1, 0, 0, 0, 0, 0),
                        lambda number: b"abcd" + struct.pack(">6I", 1, 0, 0, 0, 0, 4711))
        self.assertEqual(self.found(expect=NO_CONNECTION), [])

    def testAnInstrumentThatFallsSilentIsGivenUp(self):
        sim = self.startSim("127.0.0.1")
        self.startSim("127.0.0.2")
        sim.send_signal(signal.SIGSTOP)
        try:
            self.assertEqual([one["option"] for one in self.found()], ["--lan 127.0.0.2"])
        finally:
            sim.send_signal(signal.SIGCONT)

    def testWhatAVisaLibraryListsIsAskedThroughIt(self):
        self.startSim("127.0.0.1")
        said = self.found("--visa-library", LIBRARY)
        self.assertEqual([one["option"] for one in said], ["--lan 127.0.0.1", "--gpib 28"])
        self.assertEqual(said[1]["identification"], "*IDN?", "the library's instrument says what it hears")

    def testALibraryThatCannotBeUsedIsTold(self):
        run = self.ctl("--visa-library", str(self.folder / "none.so"), "find", expect=NO_CONNECTION)
        self.assertIn("none.so", run.stderr)

    def testTheWaitIsAPlainNumberOfSeconds(self):
        for wrong in ("-1", "61", "1,5", "nan", "", "x"):
            self.assertIn("0 to 60 seconds", self.ctl("find", "--wait", wrong, expect=WRONG_CALL).stderr)

    def testARequestToEndEnds(self):
        process = subprocess.Popen(self.command("find", "--wait", "60"), stderr=subprocess.PIPE, text=True)
        time.sleep(0.3)
        process.send_signal(signal.SIGINT)
        _, problems = process.communicate(timeout=5)
        self.assertEqual((process.returncode, problems), (FAILED, "kdx-ctl: stopped\n"))


if __name__ == "__main__":
    LIBRARY = sys.argv.pop(3)
    kdxctl.main(networked=True)
