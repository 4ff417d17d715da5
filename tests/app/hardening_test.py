"""That the programs are built hardened, and that the check of it finds whatever is missing.

Usage: hardening_test.py CHECK C-COMPILER PROGRAM..."""

import pathlib
import subprocess
import sys
import tempfile
import unittest

CHECK = ""
COMPILER = ""
PROGRAMS = []

HARDENED = ["-O2", "-fPIE", "-pie", "-fstack-protector-strong", "-U_FORTIFY_SOURCE", "-D_FORTIFY_SOURCE=2",
            "-Wl,-z,relro,-z,now,-z,noexecstack"]
# Keeps a text on the stack and copies into it.
SOURCE = """
#include <stdio.h>
#include <string.h>
int main(int count, char** words) {
    char text[40];
    strcpy(text, words[count - 1]);
    return printf("%s", text);
}
"""


class Hardening(unittest.TestCase):
    def check(self, *arguments):
        result = subprocess.run([CHECK, *arguments], capture_output=True, text=True)
        return result.returncode, result.stdout

    def testTheProgramsAreHardened(self):
        self.assertEqual(self.check(*PROGRAMS), (0, f"{len(PROGRAMS)} programs\n"))

    def testWhateverIsMissingIsNamed(self):
        folder = tempfile.TemporaryDirectory(prefix="kdx-hardening-")
        self.addCleanup(folder.cleanup)
        program = str(pathlib.Path(folder.name) / "program")
        for weakening, named in (([], None), (["-no-pie", "-fno-pie"], "position independent code"),
                                 (["-Wl,-z,norelro"], "read-only relocations"),
                                 (["-Wl,-z,execstack"], "a stack that cannot be executed"),
                                 (["-Wl,-z,lazy"], "binding at the start"),
                                 (["-fno-stack-protector"], "the stack protector"),
                                 (["-U_FORTIFY_SOURCE"], "checked library calls")):
            with self.subTest(weakening=weakening):
                subprocess.run([COMPILER, "-x", "c", "-", "-o", program, *HARDENED, *weakening], input=SOURCE,
                               text=True, check=True, capture_output=True)
                expected = (1, f"{program}: without {named}\n") if named else (0, "1 programs\n")
                self.assertEqual(self.check("--optimised", program), expected)

    def testNoProgramExcusesAnother(self):
        folder = tempfile.TemporaryDirectory(prefix="kdx-hardening-")
        self.addCleanup(folder.cleanup)
        good, bad = (str(pathlib.Path(folder.name) / name) for name in ("good", "bad"))
        for program, weakening in ((good, []), (bad, ["-U_FORTIFY_SOURCE"])):
            subprocess.run([COMPILER, "-x", "c", "-", "-o", program, *HARDENED, *weakening], input=SOURCE, text=True,
                           check=True, capture_output=True)
        self.assertEqual(self.check("--optimised", good, bad), (1, f"{bad}: without checked library calls\n"))


if __name__ == "__main__":
    CHECK, COMPILER, *PROGRAMS = sys.argv[1:]
    unittest.main(argv=sys.argv[:1], verbosity=2)
