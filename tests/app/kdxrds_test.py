"""The program kdx-rds as its user meets it from a command line: options, messages, exit codes, where its data are.

Usage: kdxrds_test.py PATH-OF-KDX-RDS
"""

import os
import pathlib
import shutil
import subprocess
import sys
import tempfile
import unittest

import shippeddata

PROGRAM = ""


class Program(unittest.TestCase):
    def setUp(self):
        self.home = pathlib.Path(tempfile.mkdtemp(prefix="kdx-rds-test-"))
        self.addCleanup(shutil.rmtree, self.home)
        self.data = self.home / "share" / "kdx-rds" / "Daten"

    def run_(self, *options, program=None, **variables):
        environment = {name: value for name, value in os.environ.items()
                       if name not in ("DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM")}
        environment.update(HOME=str(self.home), XDG_DATA_HOME=str(self.home / "share"), **variables)
        return subprocess.run([program or PROGRAM, *options], capture_output=True, text=True, timeout=60,
                              env=environment, cwd=self.home)

    def testHelpNamesEveryOption(self):
        result = self.run_("--help")
        self.assertEqual((result.returncode, result.stderr), (0, ""))
        for option in ("--app-folder", "--visa-library", "--simulate", "--tour", "--help", "--version"):
            self.assertIn(option, result.stdout)

    def testVersionSaysHowInstrumentsAreReached(self):
        result = self.run_("--version")
        self.assertEqual((result.returncode, result.stderr), (0, ""))
        self.assertRegex(result.stdout, r"^KDX-RDS \d+\.\d+\.\d+\n(VISA library|Built-in LAN client).+")
        self.assertIn("Virtual instrument", self.run_("--simulate", "--version").stdout)
        self.assertIn("/nowhere.so", self.run_("--visa-library", "/nowhere.so", "--version").stdout)

    def testWrongUsageIsSaidOnStderrAndExitsWith2(self):
        for options in (["--nonsense"], ["file"], ["-h"], ["--tour"], ["--tour="], ["--app-folder"],
                        ["--simulate=1"], ["--simulate", "--visa-library", "x.so"]):
            with self.subTest(options=options):
                result = self.run_(*options)
                self.assertEqual((result.returncode, result.stdout), (2, ""))
                self.assertRegex(result.stderr, r"^kdx-rds: .+\nTry kdx-rds --help.\n$")

    def testAFolderAskedForThatIsMissingIsNamedAndExitsWith2(self):
        result = self.run_("--simulate", "--app-folder", "missing", "--tour", "pictures")
        self.assertEqual((result.returncode, result.stdout), (2, ""))
        self.assertEqual(result.stderr, "kdx-rds: --app-folder: there is no folder missing\n")
        self.assertFalse((self.home / "missing").exists())

    def testAVisaLibraryThatCannotBeUsedIsNamed(self):
        result = self.run_("--visa-library", "/nowhere.so")
        self.assertEqual(result.returncode, 1)
        self.assertRegex(result.stderr, r"^kdx-rds: .*/nowhere\.so")

    def testWithoutADisplayItSaysSo(self):
        for variables in ({}, {"DISPLAY": ""}, {"DISPLAY": "", "WAYLAND_DISPLAY": "", "QT_QPA_PLATFORM": ""}):
            with self.subTest(variables=variables):
                result = self.run_("--simulate", **variables)
                self.assertEqual((result.returncode, result.stdout), (1, ""))
                self.assertEqual(result.stderr, "kdx-rds: there is no display; --tour DIR works without one.\n")

    def testTheTourNeedsNoDisplayAndFillsTheUsersFolder(self):
        result = self.run_("--simulate", "--tour", "pictures", DISPLAY="")
        self.assertEqual(result.returncode, 0, result.stdout + result.stderr)
        self.assertEqual(sorted(path.name for path in (self.home / "pictures").iterdir()),
                         [f"page_{page}.png" for page in range(9)])
        self.assertIn("-> :STEREO:DIRECT \"PS=MESSTURM\"\n", result.stdout)
        self.assertTrue((self.data / "Sprachen.ini").is_file())

    def testTheTourOfTheViewsLeavesThePicturesOfTheManual(self):
        result = self.run_("--simulate", "--tour", "pictures", "--views")
        self.assertEqual(result.returncode, 0, result.stdout[-2000:] + result.stderr)
        views = {path.name for path in (self.home / "pictures").iterdir() if "_" not in path.name}
        manual = pathlib.Path(__file__).resolve().parents[2] / "docs" / "manual" / "pictures" / "en"
        self.assertEqual(views, {path.name for path in manual.iterdir()})
        self.assertTrue(result.stdout.endswith("18 more pictures, 0 failures\n"), result.stdout[-200:])

    def testWhatTheUserHasIsNotOverwritten(self):
        self.data.mkdir(parents=True)
        mine = b"[RDS]\r\nPS=MEINS\r\n"
        (self.data / "DATENSET1.ini").write_bytes(mine)
        result = self.run_("--simulate", "--tour", "pictures")
        self.assertIn("-> :STEREO:DIRECT \"PS=MEINS   \"\n", result.stdout)
        self.assertIn(mine.rstrip(), (self.data / "DATENSET1.ini").read_bytes())
        self.assertFalse((self.data / "Datenset1.INI").exists())

    def testTheFolderAskedForIsUsedAndNothingElseIsMade(self):
        folder = self.home / "lab"
        shippeddata.copyTo(folder / "DATEN")
        result = self.run_("--simulate", "--app-folder", str(folder), "--tour=pictures")
        self.assertEqual(result.returncode, 0, result.stdout + result.stderr)
        self.assertFalse(self.data.exists())
        self.assertTrue((folder / "DATEN" / "RDS_log.txt").is_file())

    def testDataBesideTheProgramAreUsed(self):
        program = self.home / "kdx" / "kdx-rds"
        program.parent.mkdir()
        shutil.copy(PROGRAM, program)
        shippeddata.copyTo(program.parent / "Daten")
        result = self.run_("--simulate", "--tour", "pictures", program=str(program))
        self.assertEqual(result.returncode, 0, result.stdout + result.stderr)
        self.assertFalse(self.data.exists())
        self.assertTrue((program.parent / "Daten" / "RDS_log.txt").is_file())

    def testAUsersFolderThatCannotBeMadeIsSaidAndTheProgramGoesOn(self):
        (self.home / "share").write_text("in the way")
        result = self.run_("--simulate", "--tour", "pictures")
        self.assertRegex(result.stderr, r"kdx-rds: .*share/kdx-rds/Daten")
        self.assertEqual(len(list((self.home / "pictures").iterdir())), 9)


if __name__ == "__main__":
    PROGRAM = os.path.abspath(sys.argv.pop(1))
    unittest.main(verbosity=2)
