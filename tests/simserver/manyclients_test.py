"""kdx-sim under clients that come in crowds, go without a word, or send nonsense, slowly or fast.

Usage: manyclients_test.py PATH-OF-KDX-SIM; exit code 77 when port 111 cannot be used here.
"""

import os
import select
import socket
import struct
import sys
import threading
import time
import unittest

from kdxsim import KdxSim, portIsFree

PROGRAM = ""
IDENTIFICATION = b"M" * 300
CORE = 0x0607AF
NULL, CREATE_LINK, WRITE, READ = 0, 10, 11, 12
END = 8


def call(procedure, arguments=b""):
    message = struct.pack(">10I", 7, 0, 2, CORE, 1, procedure, 0, 0, 0, 0) + arguments
    return struct.pack(">I", 0x80000000 | len(message)) + message


def padded(data):
    return struct.pack(">I", len(data)) + data + bytes(-len(data) % 4)


class Client:
    """A connection to the core channel; closed by a reset, so that no port is kept behind."""

    def __init__(self, sim, source="127.0.0.1"):
        self.socket = socket.create_connection((sim.address, sim.port), timeout=10, source_address=(source, 0))
        self.socket.setsockopt(socket.SOL_SOCKET, socket.SO_LINGER, struct.pack("ii", 1, 0))

    def __enter__(self):
        return self

    def __exit__(self, *_):
        self.socket.close()

    def fileno(self):
        return self.socket.fileno()

    def send(self, data):
        self.socket.sendall(data)

    def bytes(self, count):
        data = b""
        while len(data) < count:
            piece = self.socket.recv(count - len(data))
            if not piece:
                raise ConnectionError("closed")
            data += piece
        return data

    def results(self, procedure, arguments=b""):
        self.send(call(procedure, arguments))
        return self.reply()

    def reply(self):
        message = self.bytes(struct.unpack(">I", self.bytes(4))[0] & 0x7FFFFFFF)
        assert struct.unpack_from(">6I", message) == (7, 1, 0, 0, 0, 0), message
        return message[24:]

    def link(self):
        error, link = struct.unpack_from(">2I", self.results(CREATE_LINK, struct.pack(">3I", 1, 0, 0) + padded(b"inst0")))
        assert error == 0, error
        return link

    def query(self, link, question):
        written = self.results(WRITE, struct.pack(">4I", link, 2000, 0, END) + padded(question))
        assert struct.unpack(">2I", written) == (0, len(question)), written
        answer = self.results(READ, struct.pack(">6I", link, 1000, 2000, 0, 0, 0))
        error, _, length = struct.unpack_from(">3I", answer)
        assert error == 0, error
        return answer[12:12 + length]


class ManyClients(unittest.TestCase):
    def setUp(self):
        self.sim = self.enterContext(KdxSim(PROGRAM, "--idn", IDENTIFICATION.decode()))

    def tearDown(self):
        with Client(self.sim, "127.0.0.9") as client:
            self.assertEqual(client.query(client.link(), b"*IDN?"), IDENTIFICATION + b"\n", "it goes on as ever")
        self.assertEqual(self.sim.end(), 0)
        self.assertEqual(self.sim.errors, "")

    def process(self, name):
        return f"/proc/{self.sim.processId}/{name}"

    def descriptors(self):
        return len(os.listdir(self.process("fd")))

    def kilobytes(self):
        with open(self.process("status")) as status:
            return next(int(line.split()[1]) for line in status if line.startswith("VmRSS"))

    def secondsOfProcessor(self):
        with open(self.process("stat")) as stat:
            fields = stat.read().rpartition(")")[2].split()
        return (int(fields[11]) + int(fields[12])) / os.sysconf("SC_CLK_TCK")

    def isChecked(self):
        with open(self.process("maps")) as maps:
            return "libasan" in maps.read()

    def come(self, times):
        for i in range(times):
            with Client(self.sim) as client:
                if i % 4 == 1:
                    client.link()
                elif i % 4 == 2:
                    client.send(call(CREATE_LINK)[:30])
                elif i % 4 == 3:
                    client.query(client.link(), b"*IDN?")

    def testTenThousandInTurnLeaveNothingBehind(self):
        self.come(1000)
        descriptors, kilobytes = self.descriptors(), self.kilobytes()
        self.come(10000)
        for _ in range(100):  # the last ones may not be noticed yet
            if self.descriptors() <= descriptors:
                break
            time.sleep(0.02)
        self.assertLessEqual(self.descriptors(), descriptors)
        if not self.isChecked():  # what is freed stays there for a while, to find its use
            self.assertLess(self.kilobytes() - kilobytes, 512)

    def testFiveHundredAtOnceAreServedInTurn(self):
        clients = [Client(self.sim, f"127.0.0.{1 + i % 10}") for i in range(500)]
        for client in clients:
            client.send(call(NULL))
        waiting = set(clients)
        while waiting:
            ready, _, _ = select.select(list(waiting), [], [], 10)
            self.assertNotEqual(ready, [], f"{len(waiting)} are never served")
            for client in ready:
                self.assertEqual(client.reply(), b"")
                client.socket.close()
                waiting.discard(client)

    def testFiveHundredOfOnePeerDoNotKeepOthersOut(self):
        clients = [Client(self.sim) for _ in range(500)]
        with Client(self.sim, "127.0.0.2") as other:
            self.assertEqual(other.query(other.link(), b"*IDN?"), IDENTIFICATION + b"\n")
        served = 0
        for client in clients:
            try:
                client.send(call(NULL))
                client.reply()
                served += 1
            except ConnectionError:
                pass  # turned away
        self.assertEqual(served, 96)
        for client in clients:
            client.socket.close()

    def longestAnswer(self, seconds):
        """How long another client waits for an answer at most, in a time of so many seconds."""
        longest = 0
        with Client(self.sim, "127.0.0.2") as other:
            link = other.link()
            end = time.monotonic() + seconds
            while time.monotonic() < end:
                start = time.monotonic()
                self.assertEqual(other.query(link, b"*IDN?"), IDENTIFICATION + b"\n")
                longest = max(longest, time.monotonic() - start)
                time.sleep(0.01)
        return longest

    def testAFloodOfFragmentsHoldsUpNobodyAndCostsLittle(self):
        fragments = struct.pack(">IB", 1, 0x78) * 13000
        over = threading.Event()

        def flood():
            sent = 0
            while not over.is_set():
                with Client(self.sim) as client:
                    try:
                        while sent < 10_000_000:
                            client.send(fragments)
                            sent += len(fragments)
                        over.wait()
                    except OSError:
                        pass  # its record is too long by now

        before = self.secondsOfProcessor()
        sender = threading.Thread(target=flood)
        sender.start()
        self.assertLess(self.longestAnswer(1), 0.5)
        over.set()
        sender.join()
        self.assertLess(self.secondsOfProcessor() - before, 5 if self.isChecked() else 1)

    def testEmptyFragmentsEndTheConnectionAtOnce(self):
        with Client(self.sim) as client:
            client.send(bytes(4) * 1000)
            with self.assertRaises(ConnectionError):
                client.bytes(1)

    def testAClientThatNeverFetchesItsRepliesTakesNoMemory(self):
        before = self.kilobytes()
        with Client(self.sim) as client:
            link = client.link()
            ask = call(WRITE, struct.pack(">4I", link, 2000, 0, END) + padded(b"*IDN?;*IDN?"))
            pairs = (ask + call(READ, struct.pack(">6I", link, 1000, 2000, 0, 0, 0))) * 100
            client.socket.settimeout(0.5)
            with self.assertRaises(TimeoutError, msg="it is never made to wait"):
                for _ in range(2000):  # 34 MB, for which there are 126 MB of answers
                    client.send(pairs)
            if not self.isChecked():
                self.assertLess(self.kilobytes() - before, 8 * 1024)

    def testSlowSendersHoldUpNobodyAndCostLittle(self):
        clients = [Client(self.sim) for _ in range(90)]
        over = threading.Event()

        def trickle():
            while not over.wait(0.01):
                for client in clients:
                    client.send(b"\x00")

        for client in clients:
            client.send(struct.pack(">I", 0x80000000 | 100000))
        before = self.secondsOfProcessor()
        sender = threading.Thread(target=trickle)
        sender.start()
        self.assertLess(self.longestAnswer(1), 0.5)
        over.set()
        sender.join()
        self.assertLess(self.secondsOfProcessor() - before, 0.7)
        for client in clients:
            client.socket.close()


if __name__ == "__main__":
    PROGRAM = sys.argv.pop(1)
    if not portIsFree(111):
        print("port 111 cannot be used, and this system permits no network of our own")
        sys.exit(77)
    unittest.main(verbosity=2)
