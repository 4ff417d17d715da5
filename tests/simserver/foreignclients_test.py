"""Drives kdx-sim with instrument clients that others wrote: lxi (lxi-tools) and pyvisa with pyvisa-py.

Usage: foreignclients_test.py PATH-OF-KDX-SIM; exit code 77 when port 111 cannot be used here.
"""

import subprocess
import sys
import threading
import unittest

import pyvisa
from kdxsim import KdxSim, RegisteringPortMapper, portIsFree, requirePrograms

PROGRAM = ""
IDENTIFICATION = "KDX,TEST UNIT,4711,1.0"
INST0 = "TCPIP::127.0.0.1::inst0::INSTR"
GPIB = "TCPIP::127.0.0.1::gpib0,28::INSTR"


def lxi(command, *options):
    """What "lxi scpi" prints, as the shell sees it."""
    result = subprocess.run(
        ["lxi", "scpi", "--address", "127.0.0.1", "--timeout", "5", *options, command],
        capture_output=True, text=True, timeout=30,
    )
    assert result.returncode == 0, result
    return result.stdout


class ForeignClients(unittest.TestCase):
    """kdx-sim answers the port-mapper questions itself."""

    def setUp(self):
        self.sim = self.enterContext(self.program())
        self.visa = pyvisa.ResourceManager("@py")
        self.addCleanup(self.visa.close)

    def program(self):
        return KdxSim(PROGRAM, "--idn", IDENTIFICATION)

    def open(self, resource, timeoutMs=5000):
        device = self.visa.open_resource(resource)
        device.timeout = timeoutMs
        self.addCleanup(device.close)
        return device

    def testItIsItsOwnPortMapper(self):
        self.assertIn("answers port-mapper questions itself", self.sim.ready)

    def testLxiAsksForTheIdentification(self):
        self.assertEqual(lxi("*IDN?"), IDENTIFICATION + "\n")

    def testPyvisaAsksForTheIdentification(self):
        self.assertEqual(self.open(INST0).query("*IDN?"), IDENTIFICATION + "\n")
        self.assertEqual(self.open(GPIB).query("*IDN?"), IDENTIFICATION + "\n")

    def testAnUnknownDeviceNameIsRefused(self):
        with self.assertRaisesRegex(Exception, "error creating link: 3"):
            self.visa.open_resource("TCPIP::127.0.0.1::inst1::INSTR")

    def testAnAnswerIsReadInPieces(self):
        device = self.open(INST0)
        device.write("*IDN?")
        self.assertEqual(device.read_bytes(5), IDENTIFICATION[:5].encode())
        self.assertEqual(device.read(), IDENTIFICATION[5:] + "\n")

    def testAMessageOfMoreThanAKilobyteArrivesWhole(self):
        self.assertEqual(self.open(INST0).query(";".join(["*OPC?"] * 400)), ";".join(["1"] * 400) + "\n")

    def testReadingWithNothingToSayTimesOutAndDoesNoHarm(self):
        device = self.open(INST0, timeoutMs=100)
        with self.assertRaises(pyvisa.errors.VisaIOError) as raised:
            device.read()
        self.assertEqual(raised.exception.error_code, pyvisa.constants.StatusCode.error_timeout)
        self.assertEqual(device.query("SYST:ERR?"), '-420,"Query UNTERMINATED"\n')
        self.assertEqual(device.query("*IDN?"), IDENTIFICATION + "\n")

    def testADeviceClearDropsTheAnswer(self):
        device = self.open(INST0, timeoutMs=100)
        device.write("*IDN?")
        device.clear()
        with self.assertRaises(pyvisa.errors.VisaIOError):
            device.read()
        self.assertEqual(device.query("*OPC?"), "1\n")

    def testTheStatusByteShowsAMessageToFetch(self):
        device = self.open(INST0)
        self.assertEqual(device.read_stb() & 0x10, 0)
        device.write("*IDN?")
        self.assertEqual(device.read_stb() & 0x10, 0x10)
        device.read()
        self.assertEqual(device.read_stb() & 0x10, 0)

    def testALockKeepsTheOtherClientOut(self):
        one, two = self.open(INST0), self.open(GPIB)
        one.lock_excl()
        with self.assertRaises(pyvisa.errors.VisaIOError):
            two.query("*IDN?")
        one.unlock()
        self.assertEqual(two.query("*IDN?"), IDENTIFICATION + "\n")

    def testManyClientsAtOnceGetTheirOwnAnswers(self):
        failures = []

        def drive(resource, question, answer):
            try:
                device = pyvisa.ResourceManager("@py").open_resource(resource)
                for _ in range(50):
                    got = device.query(question)
                    if got != answer:
                        failures.append((question, got))
                device.close()
            except Exception as error:  # a thread's exception would get lost
                failures.append((question, error))

        threads = [
            threading.Thread(target=drive, args=(INST0, "*IDN?", IDENTIFICATION + "\n")),
            threading.Thread(target=drive, args=(GPIB, "*OPC?", "1\n")),
            threading.Thread(target=drive, args=(INST0, "*IDN?;*OPC?", IDENTIFICATION + ";1\n")),
        ]
        for thread in threads:
            thread.start()
        for _ in range(5):
            self.assertEqual(lxi("*IDN?"), IDENTIFICATION + "\n")
        for thread in threads:
            thread.join()
        self.assertEqual(failures, [])

    def testAClientThatWaitsInVainHoldsUpNobody(self):
        waiting = self.open(INST0, timeoutMs=1000)
        thread = threading.Thread(target=lambda: self.assertRaises(pyvisa.errors.VisaIOError, waiting.read))
        thread.start()
        self.assertEqual(lxi("*IDN?"), IDENTIFICATION + "\n")
        self.assertTrue(thread.is_alive(), "the other client still waits")
        thread.join()


class ForeignClientsByARunningPortMapper(ForeignClients):
    """Another program holds port 111: kdx-sim registers with it, and all clients find it in the same way."""

    def program(self):
        self.mapper = self.enterContext(RegisteringPortMapper())
        return super().program()

    def testItIsItsOwnPortMapper(self):
        self.assertIn("registered with the running port mapper", self.sim.ready)
        self.assertEqual(self.mapper.ports[0x0607AF], self.sim.port)

    def testTheRegistrationIsTakenBackAtTheEnd(self):
        self.assertEqual(self.sim.end(), 0)
        self.assertEqual(self.mapper.ports, {})


if __name__ == "__main__":
    PROGRAM = sys.argv.pop(1)
    requirePrograms("lxi")
    if not portIsFree(111):
        print("port 111 cannot be used, and this system permits no network of our own")
        sys.exit(77)
    unittest.main(verbosity=2)
