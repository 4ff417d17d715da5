"""What bash completes of a call of kdx-ctl.

Usage: ctl_completion_test.py PATH-OF-KDX-CTL PATH-OF-THE-COMPLETION
"""

import os
import re
import subprocess
import sys
import tempfile
import unittest

CTL = COMPLETION = ""

SCRIPT = """
source "$1"; shift
eval "$(complete -p kdx-ctl | sed 's/^complete -F \\([a-z_]*\\) .*/function=\\1/')"
COMP_LINE="$*" COMP_POINT=${#COMP_LINE}
"$function"
printf '%s\\n' "${COMPREPLY[@]}"
"""


class Completion(unittest.TestCase):
    def complete(self, *words, folder=None):
        run = subprocess.run(["bash", "--norc", "-c", SCRIPT, "bash", COMPLETION, CTL, *words], cwd=folder,
                             capture_output=True, text=True, check=True)
        self.assertEqual(run.stderr, "")
        return run.stdout.split()

    def help(self, *subcommand):
        return subprocess.run([CTL, *subcommand, "--help"], capture_output=True, text=True, check=True).stdout

    def subcommands(self):
        return re.findall(r"(?m)^  ([a-z]+) ", self.help().split("Subcommands:")[1])

    def testEverySubcommandIsOffered(self):
        self.assertGreaterEqual(len(self.subcommands()), 7)
        self.assertEqual(self.complete(""), self.subcommands())
        self.assertEqual(self.complete("--simulate", "--timeout", "3", "qu"), ["query"])
        self.assertEqual(self.complete("--lan", "send", "qu"), ["query"])
        self.assertEqual(self.complete("--lan=127.0.0.1", "qu"), ["query"])

    def testEveryOptionOfTheHelpIsOffered(self):
        own = set(re.findall(r"(?m)^  (?:-\w,)?(--[a-z-]+)", self.help()))
        self.assertTrue({"--lan", "--timeout", "--json", "--verbose", "--help", "--continue"} <= own)
        self.assertEqual(set(self.complete("--")), own)
        for name in self.subcommands():
            with self.subTest(name):
                options = set(re.findall(r"(?m)^  (?:-\w,)?(--[a-z-]+)", self.help(name)))
                self.assertEqual(set(self.complete(name, "--")), own | options)

    def testEveryOptionAsTheHelpSpellsItIsFound(self):
        """By another way than the completion reads it: nothing that looks like an option in the help is missing."""
        for name in self.subcommands():
            listed = self.help(name).split("Options:")[1].split("\n\n")[0]
            for option in re.findall(r"(?m)^ {2}\S*?(--[\w-]+)", listed):
                self.assertIn(option, self.complete(name, option))

    def testKeysAndReadBacksComeFromTheProgram(self):
        keys = self.complete("send", "")
        self.assertEqual(len(keys), 60)
        self.assertEqual(self.complete("send", "TP=1", "HF-F"), ["HF-Frequenz="])
        self.assertEqual(self.complete("send", "PS="), [])
        self.assertEqual(self.complete("send", "PS=A"), [])
        self.assertEqual(self.complete("send", "HF"), ["HF:PEGEL:STATE=", "HF-Frequenz=", "HF-Pegel="])
        self.assertEqual(self.complete("send", "HF:PE"), ["PEGEL:STATE="])
        self.assertEqual(self.complete("send", "HF:PEGEL:"), ["STATE="])
        self.assertEqual(self.complete("query", "freq"), ["frequency"])
        self.assertEqual(len(self.complete("query", "")), 21)
        self.assertEqual(self.complete("query", "--raw", "freq"), ["frequency"])
        self.assertEqual(self.complete("send", "--raw", ""), [])

    def testValuesOfOptions(self):
        self.assertEqual(self.complete("apply", "--data-set", ""), ["1", "2", "3", "4", "5"])
        self.assertEqual(self.complete("--gpib", "2"), ["2", *map(str, range(20, 30))])
        self.assertEqual(self.complete("list", "k"), ["keys"])
        with tempfile.TemporaryDirectory() as folder:
            os.mkdir(os.path.join(folder, "lab"))
            open(os.path.join(folder, "lab.INI"), "w").close()
            self.assertEqual(sorted(self.complete("apply", "--file", "la", folder=folder)), ["lab", "lab.INI"])
            self.assertEqual(sorted(self.complete("apply", "--file=la", folder=folder)), ["lab", "lab.INI"])
            self.assertEqual(self.complete("--app-folder", "la", folder=folder), ["lab"])
            self.assertEqual(sorted(self.complete("replay", "la", folder=folder)), ["lab", "lab.INI"])

    def testNothingIsOfferedWhereNothingFits(self):
        self.assertEqual(self.complete("nonsense", ""), [])
        self.assertEqual(self.complete("query", "nonsense"), [])


if __name__ == "__main__":
    CTL, COMPLETION = sys.argv[1:3]
    CTL = os.path.abspath(CTL)
    COMPLETION = os.path.abspath(COMPLETION)
    del sys.argv[1:3]
    unittest.main()
