"""What the program kdx-rds sends and shows where a comma stands for the decimal point: the same bytes as anywhere.

Usage: locale_test.py PATH-OF-KDX-RDS
"""

import os
import pathlib
import re
import shutil
import subprocess
import sys
import tempfile
import unittest

import shippeddata

PROGRAM = ""
COMMA = "de_DE.UTF-8"


class DecimalComma(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.home = pathlib.Path(tempfile.mkdtemp(prefix="kdx-rds-test-"))
        cls.addClassCleanup(shutil.rmtree, cls.home)
        # Made here: few machines have it installed.
        subprocess.run(["localedef", "-i", "de_DE", "-f", "UTF-8", str(cls.home / COMMA)], check=True)

    def environment(self, locale):
        return dict(os.environ, HOME=str(self.home), QT_QPA_PLATFORM="offscreen", LOCPATH=str(self.home),
                    LC_ALL=locale, LANG=locale)

    def tour(self, locale):
        """What is sent and answered, and the settings and the log that are left."""
        folder = self.home / ("folder-" + locale)
        shippeddata.copyTo(folder / "Daten")
        command = [PROGRAM, "--simulate", "--app-folder", str(folder), "--tour", str(folder / "pictures")]
        run = subprocess.run(command, stdout=subprocess.PIPE, env=self.environment(locale), timeout=100)
        self.assertEqual(run.returncode, 0, run.stdout)
        left = {file.name: file.read_bytes() for file in (folder / "Daten").iterdir() if file.is_file()}
        lines = [re.sub(rb"\d\d:\d\d:\d\d", b"hh:mm:ss", line) for line in run.stdout.splitlines()]
        # The timer of the dynamic PS sends when it is due, and that is not always between the same two others, nor
        # equally often.
        names = [at for at, line in enumerate(lines) if line.startswith(b'-> :STEREO:DIRECT "PS=')]
        return [line for at, line in enumerate(lines) if at not in names[1:]], left

    def testTheLocaleIsInForce(self):
        show = "import locale; locale.setlocale(locale.LC_ALL, ''); print(locale.localeconv()['decimal_point'])"
        shown = subprocess.run([sys.executable, "-c", show], env=self.environment(COMMA), stdout=subprocess.PIPE,
                               check=True, text=True).stdout
        self.assertEqual(shown, ",\n")

    def testTheTourIsTheSameAsWithADecimalPoint(self):
        traffic, left = self.tour("C")
        self.assertTrue(any(b"FREQ " in line and b"." in line for line in traffic), "no number with a fraction")
        trafficWithComma, leftWithComma = self.tour(COMMA)
        self.assertEqual(trafficWithComma, traffic)
        for name in left.keys() | leftWithComma.keys():
            if name != "RDS_log.txt":
                self.assertEqual(leftWithComma.get(name), left.get(name), name)


if __name__ == "__main__":
    PROGRAM = sys.argv.pop(1)
    unittest.main()
