"""The program kdx-sim as its user sees it: options, messages, signals, and what it says about the port mapper.

Usage: kdxsim_test.py PATH-OF-KDX-SIM; exit code 77 when port 111 cannot be used here.
"""

import signal
import socket
import struct
import subprocess
import sys
import threading
import time
import unittest

import pyvisa
from kdxsim import KdxSim, RegisteringPortMapper, portIsFree, requirePrograms

PROGRAM = ""
WITHOUT_PORT_RIGHT = ("setpriv", "--bounding-set=-net_bind_service", "--inh-caps=-net_bind_service")


def run(*options):
    return subprocess.run([PROGRAM, *options], capture_output=True, text=True, timeout=30)


def hangUpOnEverybody(listener):
    try:
        while True:
            client, _ = listener.accept()
            client.setsockopt(socket.SOL_SOCKET, socket.SO_LINGER, struct.pack("ii", 1, 0))
            client.close()
    except OSError:
        pass  # the test is over


def trickle(listener):
    """Begins a reply to everybody and goes on with a byte a second."""
    def toOne(client):
        try:
            client.send(struct.pack(">I", 0x80000000 | 28))
            while True:
                client.send(b"\x00")
                time.sleep(1)
        except OSError:
            pass  # it has gone

    try:
        while True:
            threading.Thread(target=toOne, args=(listener.accept()[0],), daemon=True).start()
    except OSError:
        pass  # the test is over


class Options(unittest.TestCase):
    def testHelpNamesEveryOption(self):
        result = run("--help")
        self.assertEqual((result.returncode, result.stderr), (0, ""))
        for option in ("--port", "--bind", "--idn", "--trace", "--groups", "--mpx", "--help",
                       "--version"):
            self.assertIn(option, result.stdout)

    def testVersion(self):
        result = run("--version")
        self.assertEqual((result.returncode, result.stderr), (0, ""))
        self.assertRegex(result.stdout, r"^kdx-sim \d+\.\d+\.\d+\n$")

    def testWrongUsageIsSaidOnStderrAndExitsWith2(self):
        for options in (["--nonsense"], ["--trace=no"], ["inst0"], ["-h"], ["--port"], ["--port", ""], ["--port", "70000"],
                        ["--port", "-1"], ["--port", "12x"], ["--idn"], ["--bind"]):
            with self.subTest(options=options):
                result = run(*options)
                self.assertEqual((result.returncode, result.stdout), (2, ""))
                self.assertRegex(result.stderr, r"^kdx-sim: .+\n$")

    def testNoControlCharacterIsPrinted(self):
        bad = b"x\x1b[2J\xff"
        for options, exitCode in (([b"--" + bad], 2), ([bad], 2), ([b"--port", bad], 2), ([b"--bind", bad], 1)):
            with self.subTest(options=options):
                result = subprocess.run([PROGRAM, *options], capture_output=True, timeout=20)
                self.assertEqual(result.returncode, exitCode)
                self.assertIn(b"[2J", result.stderr)
                self.assertEqual([byte for byte in result.stderr if byte < 0x20 and byte != 0x0A], [])
                result.stderr.decode()

    def testAnAddressThatCannotBeHadIsSaidOnStderrAndExitsWith1(self):
        for address in ("nonsense", "192.0.2.1"):
            result = run("--bind", address)
            self.assertEqual((result.returncode, result.stdout), (1, ""))
            self.assertIn(address, result.stderr)

    def testAPortThatIsTakenIsSaidOnStderrAndExitsWith1(self):
        with KdxSim(PROGRAM) as first:
            result = run("--port", str(first.port))
            self.assertEqual((result.returncode, result.stdout), (1, ""))
            self.assertIn(str(first.port), result.stderr)

    def testPortAndAddressAreTaken(self):
        with socket.socket() as probe:
            probe.bind(("127.0.0.2", 0))
            port = probe.getsockname()[1]
        with KdxSim(PROGRAM, "--bind", "127.0.0.2", "--port", str(port)) as sim:
            self.assertEqual((sim.address, sim.port), ("127.0.0.2", port))
            socket.create_connection(("127.0.0.2", port)).close()

    def testOnlyTheLoopbackAddressIsListenedAt(self):
        with KdxSim(PROGRAM) as sim:
            self.assertEqual(sim.address, "127.0.0.1")
            self.assertRaises(ConnectionRefusedError, socket.create_connection, ("127.0.0.2", sim.port))


class Run(unittest.TestCase):
    def testSignalsEndItCleanly(self):
        for end in (signal.SIGTERM, signal.SIGINT):
            with KdxSim(PROGRAM) as sim:
                self.assertEqual(sim.end(end), 0)
                self.assertEqual((sim.output, sim.errors), ("", ""))

    def testItEndsWhileAClientIsConnected(self):
        with KdxSim(PROGRAM) as sim, socket.create_connection((sim.address, sim.port)):
            self.assertEqual(sim.end(), 0)

    def testTheTraceIsPrinted(self):
        with KdxSim(PROGRAM, "--trace", "--idn", "ME") as sim:
            device = pyvisa.ResourceManager("@py").open_resource("TCPIP::127.0.0.1::gpib0,28::INSTR")
            device.query("*IDN?")
            device.close()
            self.assertEqual(sim.end(), 0)
            self.assertEqual(sim.output.splitlines(), ["link 1 opened: gpib0,28", r"link 1 < *IDN?\r\n",
                                                       r"link 1 > ME\n", "link 1 closed"])

    def testTheTraceSaysWhatBecameOfAMessage(self):
        with KdxSim(PROGRAM, "--trace") as sim:
            device = pyvisa.ResourceManager("@py").open_resource("TCPIP::127.0.0.1::inst0::INSTR")
            device.write(':STEREO:DIRECT "PTY=07";:STEREO:DIRECT "PTY=32";:STEREO:PILOT:STATE ON;NONSENSE 1')
            device.write(':STEREO:RDS:STATE ON')
            device.write(':STEREO:RDS:STATE ON;:STEREO:DIRECT "BIN=0";DIRECT "BIN=2"')
            device.close()
            self.assertEqual(sim.end(), 0)
            words = [line for line in sim.output.splitlines() if not line.startswith("link")]
            self.assertEqual(words, ['       programme type 07; refused: -222,"Data out of range"; '
                                     'refused: -113,"Undefined header"',
                                     "       normal operation; test pattern 2"])

    def testTheTraceShowsControlCharactersAsEscapes(self):
        with KdxSim(PROGRAM, "--trace") as sim:
            device = pyvisa.ResourceManager("@py").open_resource("TCPIP::127.0.0.1::inst0::INSTR")
            device.write_raw(b':STEREO:DIRECT "STORE=1\x1b[2J\x07";:STEREO:DIRECT "BIN=1\t"')
            device.write_raw(b':STEREO:DIRECT "STORE=\x0b1"')
            device.close()
            self.assertEqual(sim.end(), 0)
            self.assertIn(r"\x1B[2J", sim.output)
            self.assertIn(r"set-up stored in memory \x0B1", sim.output)
            self.assertEqual([c for c in sim.output if c < " " and c != "\n"], [])

    def testATraceThatNobodyReadsHoldsUpNobody(self):
        with KdxSim(PROGRAM, "--trace") as sim:
            device = pyvisa.ResourceManager("@py").open_resource("TCPIP::127.0.0.1::inst0::INSTR")
            for _ in range(1000):
                device.write("X" * 1000)
            self.assertEqual(device.query("*OPC?"), "1\n")
            device.close()
            self.assertEqual(sim.end(), 0)
            self.assertRegex(sim.output, r"(?m)^\d+ lines dropped that nobody read$")

    def testItEndsThoughNobodyReadsItsTrace(self):
        with KdxSim(PROGRAM, "--trace") as sim:
            device = pyvisa.ResourceManager("@py").open_resource("TCPIP::127.0.0.1::inst0::INSTR")
            for _ in range(200):
                device.write("X" * 1000)
            sim.sendSignal(signal.SIGTERM)
            self.assertEqual(sim.wait(), 0)

    def testTheIdentificationIsAnsweredAsItWasGiven(self):
        for identification in ("KDX,KDX-X4,7,2.00", "[a,b]", "-7", "--trace", "'x' \"y\"", "%%", "{}"):
            with self.subTest(identification=identification), KdxSim(PROGRAM, "--idn", identification) as sim:
                device = pyvisa.ResourceManager("@py").open_resource("TCPIP::127.0.0.1::inst0::INSTR")
                self.assertEqual(device.query("*IDN?"), identification + "\n")
                device.close()
                self.assertEqual(sim.end(), 0)

    def testAnIdentificationIsALineWithoutControlCharacters(self):
        with KdxSim(PROGRAM, "--idn", "\tA\nB\x01\x7f") as sim:
            device = pyvisa.ResourceManager("@py").open_resource("TCPIP::127.0.0.1::inst0::INSTR")
            self.assertEqual(device.query("*IDN?"), "A B\n")
            device.close()

    def testTheLastOfTwoEqualOptionsCounts(self):
        with KdxSim(PROGRAM, "--bind", "nonsense", "--bind", "127.0.0.2") as sim:
            self.assertEqual(sim.address, "127.0.0.2")

    def testASecondOneSaysThatClientsWillFindTheFirst(self):
        with KdxSim(PROGRAM) as first, KdxSim(PROGRAM) as second:
            self.assertIn("unknown to any port mapper", second.ready)
            self.assertNotEqual(first.port, second.port)
            socket.create_connection((second.address, second.port)).close()
            self.assertEqual(second.end(), 0)
            self.assertIn("did not take the registration", second.errors)
            self.assertIn(f"port to the client: {second.port}", second.errors)
            self.assertIn("tried again every few seconds", second.errors)
            self.assertIn("--bind 127.0.0.2 and open TCPIP::127.0.0.2::INSTR", second.errors)

    def testASecondOneAtAnotherAddressSaysSoToo(self):
        with KdxSim(PROGRAM, "--bind", "127.0.0.2"), KdxSim(PROGRAM, "--bind", "127.0.0.2") as second:
            self.assertEqual(second.end(), 0)
            self.assertIn("did not take the registration", second.errors)
            self.assertIn("--bind 127.0.0.3 and open TCPIP::127.0.0.3::INSTR", second.errors)

    def testASecondOneAtTheAddressThatTheFirstNamesIsFound(self):
        with KdxSim(PROGRAM) as first, KdxSim(PROGRAM, "--bind", "127.0.0.2", "--idn", "SECOND") as second:
            device = pyvisa.ResourceManager("@py").open_resource("TCPIP::127.0.0.2::inst0::INSTR")
            self.assertEqual(device.query("*IDN?"), "SECOND\n")
            device.close()
            self.assertEqual((first.end(), second.end()), (0, 0))

    def testAPortMapperThatAnswersAByteASecondHoldsNothingUp(self):
        with socket.create_server(("127.0.0.1", 111)) as other:
            threading.Thread(target=trickle, args=(other,), daemon=True).start()
            start = time.monotonic()
            with KdxSim(PROGRAM) as sim:
                self.assertLess(time.monotonic() - start, 5)
                start = time.monotonic()
                self.assertEqual(sim.end(), 0)
                self.assertLess(time.monotonic() - start, 5)
            other.shutdown(socket.SHUT_RDWR)

    def testAPortMapperThatGetsThatSlowLaterDoesNotHoldUpTheEnd(self):
        with RegisteringPortMapper() as mapper, KdxSim(PROGRAM) as sim:
            self.assertIn("registered with the running port mapper", sim.ready)
            mapper.secondsPerByte = 1
            time.sleep(2.5)  # it looks after its registration every two seconds
            start = time.monotonic()
            self.assertEqual(sim.end(), 0)
            self.assertLess(time.monotonic() - start, 5)

    def testAPortMapperThatIsStartedAnewIsToldAgain(self):
        with RegisteringPortMapper() as mapper, KdxSim(PROGRAM) as sim:
            self.assertEqual(mapper.ports[0x0607AF], sim.port)
            mapper.ports.clear()
            for _ in range(100):
                if 0x0607AF in mapper.ports and 0x0607B0 in mapper.ports:
                    break
                time.sleep(0.1)
            self.assertEqual(mapper.ports.get(0x0607AF), sim.port)
            self.assertEqual(sim.end(), 0)
            self.assertEqual(mapper.ports, {})

    def testItIsFoundByAskingEverybody(self):
        with KdxSim(PROGRAM) as sim, socket.socket(socket.AF_INET, socket.SOCK_DGRAM) as client:
            client.setsockopt(socket.SOL_SOCKET, socket.SO_BROADCAST, 1)
            client.settimeout(5)
            question = (7, 0, 2, 100000, 2, 3, 0, 0, 0, 0, 0x0607AF, 1, 6, 0)
            client.sendto(struct.pack(">14I", *question), ("127.255.255.255", 111))
            answer, address = client.recvfrom(100)
            self.assertEqual(struct.unpack(">7I", answer), (7, 1, 0, 0, 0, 0, sim.port))
            self.assertEqual(address, ("127.0.0.1", 111))

    def testAPortMapperThatHangsUpDoesNoHarm(self):
        with socket.create_server(("127.0.0.1", 111)) as other:
            threading.Thread(target=hangUpOnEverybody, args=(other,), daemon=True).start()
            with KdxSim(PROGRAM) as sim:
                self.assertIn("unknown to any port mapper", sim.ready)
                self.assertEqual(sim.end(), 0)
            other.shutdown(socket.SHUT_RDWR)

    def testWithoutTheRightToPort111ItSaysWhatToDoAndServesAllTheSame(self):
        with KdxSim(PROGRAM, wrapper=WITHOUT_PORT_RIGHT) as sim:
            self.assertIn("unknown to any port mapper", sim.ready)
            socket.create_connection((sim.address, sim.port)).close()
            self.assertEqual(sim.end(), 0)
            for word in ("root", "setcap", "net.ipv4.ip_unprivileged_port_start"):
                self.assertIn(word, sim.errors)


if __name__ == "__main__":
    PROGRAM = sys.argv.pop(1)
    requirePrograms("setpriv")
    if not portIsFree(111):
        print("port 111 cannot be used, and this system permits no network of our own")
        sys.exit(77)
    unittest.main(verbosity=2)
