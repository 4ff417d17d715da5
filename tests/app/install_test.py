"""What is installed, and that the programs find it wherever it is.

Usage: install_test.py CMAKE BUILD-FOLDER SOURCE-FOLDER
"""

import os
import pathlib
import shutil
import subprocess
import sys
import tempfile
import unittest

CMAKE = BUILD = SOURCE = ""
PROGRAMS = ("kdx-rds", "kdx-ctl", "kdx-sim")


class Installed(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.folder = pathlib.Path(tempfile.mkdtemp(prefix="kdx-install-"))
        cls.addClassCleanup(shutil.rmtree, cls.folder)
        subprocess.run([CMAKE, "--install", BUILD, "--prefix", cls.folder / "first"], check=True, capture_output=True)
        cls.prefix = (cls.folder / "first").rename(cls.folder / "elsewhere")

    def ctl(self, *words, prefix=None, home="home"):
        environment = {**os.environ, "HOME": str(self.folder / home)}
        environment.pop("XDG_DATA_HOME", None)
        return subprocess.run([(prefix or self.prefix) / "bin" / "kdx-ctl", *words], capture_output=True, text=True,
                              env=environment)

    def testTheProgramsFindTheDataWhereverTheyWereMoved(self):
        run = self.ctl("apply", "--data-set", "2", "--dry-run")
        self.assertEqual((run.returncode, run.stderr), (0, ""))
        user = self.folder / "home" / ".local" / "share" / "kdx-rds" / "Daten"
        shipped = self.prefix / "share" / "kdx-rds" / "Daten"
        files = sorted(path.name for path in shipped.iterdir() if path.is_file())
        self.assertEqual(sorted(path.name for path in user.iterdir() if path.name != "RDS_log.txt"), files)
        for name in files:
            self.assertEqual((user / name).read_bytes(), (shipped / name).read_bytes(), name)

    def testDataOfTheToolsAloneAreFound(self):
        alone = self.folder / "alone"
        shutil.copytree(self.prefix / "bin", alone / "bin")
        shutil.copytree(self.prefix / "share" / "kdx-rds" / "Daten", alone / "share" / "kdx-tools" / "Daten")
        run = self.ctl("apply", "--data-set", "2", "--dry-run", prefix=alone, home="second home")
        self.assertEqual((run.returncode, run.stderr), (0, ""))

    def testWhatIsShippedIsWhatIsKeptInTheSources(self):
        for folder, installed in (("Daten", "Daten"), ("docs/manual", "manual")):
            source = pathlib.Path(SOURCE) / folder
            target = self.prefix / "share" / "kdx-rds" / installed
            for file in (path.relative_to(source) for path in source.rglob("*") if path.is_file()):
                if file.name != "RDS_log.txt":
                    self.assertEqual((target / file).read_bytes(), (source / file).read_bytes(), file)
            self.assertFalse((target / "RDS_log.txt").exists())

    def testNoProgramNamesTheFolderItWasBuiltFrom(self):
        for program in PROGRAMS:
            texts = self.folder / "texts"
            subprocess.run(["objcopy", "-O", "binary", "--only-section=.rodata", "--only-section=.data",
                            self.prefix / "bin" / program, texts], check=True)
            content = texts.read_bytes()
            self.assertIn(b"--help", content, program)
            self.assertNotIn(os.fsencode(SOURCE), content, program)


if __name__ == "__main__":
    CMAKE, BUILD, SOURCE = sys.argv[1:]
    unittest.main(argv=sys.argv[:1], verbosity=2)
