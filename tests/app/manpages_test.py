"""That the manual pages and --help name the same subcommands and options.

Usage: manpages_test.py FOLDER-OF-MANUAL-PAGES FOLDER-OF-PROGRAMS
"""

import pathlib
import re
import subprocess
import sys
import unittest

PAGES = PROGRAMS = pathlib.Path()


def help_(program, *subcommand):
    return subprocess.run([PROGRAMS / program, *subcommand, "--help"], capture_output=True, text=True, check=True).stdout


def optionsOfHelp(text):
    """Short and long names at the beginnings of the lines below "Options:"."""
    listed = text.split("\nOptions:\n")[1].split("\n\n")[0]
    names = [name for line in re.findall(r"(?m)^ {2}(-\S+)", listed) for name in line.split(",")]
    return sorted(names)


def subcommandsOfHelp(text):
    return re.findall(r"(?m)^ {2}([a-z]+) ", text.split("\nSubcommands:\n")[1].split("\n\n")[0])


def section(page, name):
    """The part of the page below that heading, up to the next one."""
    return re.split(r"(?m)^\.SH ", page.split(f"\n.SH {name}\n")[1])[0]


def optionsOfPage(text):
    """Names in the lines below .TP: there an option is explained; elsewhere it is only spoken of."""
    tags = re.findall(r"(?m)^\.TP\n(\..*)$", text)
    return sorted(name.replace("\\", "") for tag in tags for name in re.findall(r"\\-(?:\\-)?[a-z](?:[a-z]|\\-)*", tag))


class ManualPages(unittest.TestCase):
    def page(self, program):
        return (PAGES / f"{program}.1").read_text()

    def testTheProgramsOptionsAreExplainedAndNoOthers(self):
        for program in ("kdx-rds", "kdx-sim", "kdx-ctl"):
            with self.subTest(program):
                wanted = optionsOfHelp(help_(program))
                self.assertGreaterEqual(len(wanted), 6)
                self.assertEqual(optionsOfPage(section(self.page(program), "OPTIONS")), wanted)

    def testEverySubcommandIsExplainedWithItsOptionsAndNoOthers(self):
        names = subcommandsOfHelp(help_("kdx-ctl"))
        self.assertGreaterEqual(len(names), 13)
        parts = re.split(r"(?m)^\.SS (\w+)\n", "\n" + section(self.page("kdx-ctl"), "SUBCOMMANDS"))[1:]
        self.assertEqual(parts[0::2], names)
        for name, text in zip(names, parts[1::2]):
            with self.subTest(name):
                wanted = [option for option in optionsOfHelp(help_("kdx-ctl", name)) if option not in ("-h", "--help")]
                self.assertEqual(optionsOfPage(text), wanted)

    def testTheSynopsisNamesTheOptionsToo(self):
        for program in ("kdx-rds", "kdx-sim"):
            synopsis = section(self.page(program), "SYNOPSIS").replace("\\", "")
            for option in optionsOfHelp(help_(program)):
                self.assertIn(option, synopsis)

    def testTheyBearTheVersionOfThePrograms(self):
        for program in ("kdx-rds", "kdx-sim", "kdx-ctl"):
            run = subprocess.run([PROGRAMS / program, "--version"], capture_output=True, text=True, check=True)
            version = re.search(r"\d+\.\d+\.\d+", run.stdout)[0]
            self.assertRegex(self.page(program), rf'(?m)^\.TH \S+ 1 "\d{{4}}-\d\d-\d\d" "KDX\\-RDS {re.escape(version)}"')

    def testNoLineConfusesTheTypesetter(self):
        for program in ("kdx-rds", "kdx-sim", "kdx-ctl"):
            run = subprocess.run(["groff", "-man", "-Tutf8", "-ww", "-z", PAGES / f"{program}.1"], capture_output=True, text=True)
            self.assertEqual((run.returncode, run.stderr), (0, ""), program)


if __name__ == "__main__":
    PAGES, PROGRAMS = map(pathlib.Path, sys.argv[1:])
    unittest.main(argv=sys.argv[:1], verbosity=2)
