"""What is installed, and that the programs find it wherever it is.

Usage: install_test.py CMAKE BUILD-FOLDER SOURCE-FOLDER
"""

import os
import pathlib
import pty
import shutil
import struct
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
        self.assertEqual(sorted(path.name for path in user.iterdir()), sorted([*files, "kdx-rds-shipped.txt"]))
        for name in files:
            self.assertEqual((user / name).read_bytes(), (shipped / name).read_bytes(), name)

    def ctlOnATerminal(self, *words, home):
        """@returns what a person at a terminal is told."""
        main, terminal = pty.openpty()
        environment = {**os.environ, "HOME": str(self.folder / home)}
        environment.pop("XDG_DATA_HOME", None)
        subprocess.run([self.prefix / "bin" / "kdx-ctl", *words], stdout=subprocess.DEVNULL, stderr=terminal,
                       env=environment, check=True)
        os.write(terminal, b"end\n")
        told = b""
        while not told.endswith(b"end\r\n"):
            told += os.read(main, 4096)
        os.close(main)
        os.close(terminal)
        return told[:-len(b"end\r\n")].decode()

    def testAnEarlierEventListIsRenewedAndOneOfTheUsersOwnIsKeptAndToldOnce(self):
        data = self.folder / "third home" / ".local" / "share" / "kdx-rds" / "Daten"
        shipped = self.prefix / "share" / "kdx-rds" / "Daten"
        earlier = (pathlib.Path(SOURCE) / "tests" / "settings" / "event_earlier.txt").read_bytes()
        data.mkdir(parents=True)
        (data / "Event.txt").write_bytes(earlier)
        (data / "Location.txt").write_bytes(b"Mein Ort;00999\r\n")
        run = self.ctl("list", "keys", home="third home")
        self.assertEqual((run.returncode, run.stderr), (0, ""))  # nobody may read what a script prints
        self.assertEqual((data / "Event.txt").read_bytes(), (shipped / "Event.txt").read_bytes())
        self.assertEqual(self.ctlOnATerminal("list", "keys", home="third home"),
                         f"warning: Location.txt stays as you changed it; a new version of it is "
                         f"{shipped / 'Location.txt'}\r\n")
        self.assertEqual(self.ctlOnATerminal("list", "keys", home="third home"), "")
        self.assertEqual((data / "Location.txt").read_bytes(), b"Mein Ort;00999\r\n")

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

    def testTheDesktopFindsTheProgram(self):
        share = self.prefix / "share"
        entry = (share / "applications" / "kdx-rds.desktop").read_text()
        self.assertIn("\nExec=kdx-rds\n", entry)
        self.assertTrue((share / "icons" / "hicolor" / "scalable" / "apps" / "kdx-rds.svg").is_file())
        sizes = {}
        for icon in (share / "icons" / "hicolor").glob("*/apps/kdx-rds.png"):
            sizes[icon.parts[-3]] = "{}x{}".format(*struct.unpack(">II", icon.read_bytes()[16:24]))
        self.assertEqual(len(sizes), 8)
        for folder, size in sizes.items():
            self.assertEqual(folder, size)

    def testManualPagesCompletionAndLicencesAreThere(self):
        for file in ("man/man1/kdx-rds.1", "man/man1/kdx-ctl.1", "man/man1/kdx-sim.1", "doc/kdx-rds/LICENSE",
                     "bash-completion/completions/kdx-ctl", "doc/kdx-rds/licences.md",
                     "metainfo/org.kdx_rds.kdx_rds.metainfo.xml"):
            self.assertTrue((self.prefix / "share" / file).is_file(), file)

    def testNoProgramNamesTheFolderItWasBuiltFrom(self):
        for program in PROGRAMS:
            texts = self.folder / "texts"
            subprocess.run(["objcopy", "-O", "binary", "--only-section=.rodata", "--only-section=.data",
                            self.prefix / "bin" / program, texts], check=True)
            content = texts.read_bytes()
            self.assertIn(b"--help", content, program)
            if b".Lubsan_data" in content:
                self.skipTest("what the sanitizer says names the sources")
            self.assertFalse(os.fsencode(SOURCE) in content, program)


if __name__ == "__main__":
    CMAKE, BUILD, SOURCE = sys.argv[1:]
    unittest.main(argv=sys.argv[:1], verbosity=2)
