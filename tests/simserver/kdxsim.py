"""Help for tests that start kdx-sim and look at it from outside."""

import re
import shutil
import signal
import socket
import socketserver
import struct
import subprocess
import threading
import time


class KdxSim:
    """A running kdx-sim; started by "with", ended by SIGTERM at the end of the block."""

    def __init__(self, program, *options, wrapper=()):
        self._command = [*wrapper, program, *options]

    def __enter__(self):
        self._process = subprocess.Popen(self._command, stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True)
        self.ready = self._process.stdout.readline().rstrip("\n")
        match = re.match(r"ready: (\S+) port (\d+), ", self.ready)
        if not match:
            self._process.kill()
            raise AssertionError(f"not ready: {self.ready!r}, {self._process.communicate()}")
        self.address, self.port = match.group(1), int(match.group(2))
        return self

    def __exit__(self, *_):
        if self._process.poll() is None:
            self.end()

    @property
    def processId(self):
        return self._process.pid

    def sendSignal(self, number):
        self._process.send_signal(number)

    def wait(self):
        """The exit code, without reading what the program prints."""
        return self._process.wait(timeout=30)

    def end(self, by=signal.SIGTERM):
        """Ends the program; its exit code, and what it printed since it was ready."""
        self._process.send_signal(by)
        self.output, self.errors = self._process.communicate(timeout=30)
        return self._process.returncode


class RegisteringPortMapper:
    """A port mapper on 127.0.0.1:111 over TCP with which other programs can register; runs within "with"."""

    PORT = 111

    def __enter__(self):
        self.ports = {}
        self.secondsPerByte = 0
        mapper = self

        class Handler(socketserver.StreamRequestHandler):
            def handle(self):
                while len(mark := self.rfile.read(4)) == 4:
                    call = self.rfile.read(struct.unpack(">I", mark)[0] & 0x7FFFFFFF)
                    reply = mapper.reply(call)
                    mapper.send(self.wfile, struct.pack(">I", 0x80000000 | len(reply)) + reply)

        class Server(socketserver.ThreadingTCPServer):
            allow_reuse_address = True
            daemon_threads = True

        self._server = Server(("127.0.0.1", self.PORT), Handler)
        threading.Thread(target=self._server.serve_forever, args=(0.02,), daemon=True).start()
        return self

    def __exit__(self, *_):
        self._server.shutdown()
        self._server.server_close()

    def send(self, client, record):
        if not self.secondsPerByte:
            client.write(record)
            return
        try:
            for byte in record:
                client.write(bytes([byte]))
                time.sleep(self.secondsPerByte)
        except OSError:
            pass  # it has gone

    def reply(self, call):
        xid, _, _, program, version, procedure, _, credentials = struct.unpack_from(">8I", call)
        head = struct.pack(">5I", xid, 1, 0, 0, 0)
        if (program, version) != (100000, 2):
            return head + struct.pack(">3I", 2, 2, 2)
        arguments = call[40 + credentials:]
        answer = 0
        if procedure in (1, 2, 3):
            asked, _, _, port = struct.unpack(">4I", arguments)
            if procedure == 1 and asked not in self.ports:
                self.ports[asked] = port
                answer = 1
            elif procedure == 2:
                answer = int(self.ports.pop(asked, 0) != 0)
            elif procedure == 3:
                answer = self.ports.get(asked, 0)
        return head + struct.pack(">2I", 0, answer)


def portIsFree(port):
    """Whether nobody listens on 127.0.0.1 at the TCP port and this process might."""
    with socket.socket() as probe:
        probe.setsockopt(socket.SOL_SOCKET, socket.SO_REUSEADDR, 1)
        try:
            probe.bind(("127.0.0.1", port))
        except OSError:
            return False
    return True


def requirePrograms(*names):
    """Fails with a clear word when a program that the tests need is not installed."""
    missing = [name for name in names if not shutil.which(name)]
    if missing:
        raise SystemExit(f"not installed: {', '.join(missing)}")
