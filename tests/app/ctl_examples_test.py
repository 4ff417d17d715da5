"""Every example that the README and --help give is a call that works as it stands.

Usage: ctl_examples_test.py PATH-OF-KDX-CTL
"""

import os
import pathlib
import re
import shlex
import shutil
import subprocess

import kdxctl
from kdxctl import DIFFERENT, DONE, NO_CONNECTION

README = pathlib.Path(__file__).parents[2] / "README.md"
# What they find out: differences, what a file does not keep, warnings, that no instrument is in this network.
ALSO = {"budget": DIFFERENT, "diff": DIFFERENT, "play": DIFFERENT, "read": DIFFERENT, "find": NO_CONNECTION}


class Examples(kdxctl.Ctl):
    def setUp(self):
        super().setUp()
        # Where an example needs an instrument the virtual one takes its place.
        self.program = self.folder / "kdx-ctl"
        self.program.write_text(f"""#!/bin/sh
case " $* " in *" --simulate "*) ;; *) set -- --simulate "$@" ;; esac
exec {shlex.quote(kdxctl.CTL)} --app-folder {shlex.quote(str(self.folder))} "$@"
""")
        self.program.chmod(0o755)
        self.simulated("send", "PS=RADIO")  # so that there is a log
        shutil.copy(self.folder / "Daten" / "RDS_log.txt", self.folder / "drive.log")

    def runs(self, example):
        environment = dict(os.environ, PATH=f"{self.folder}:{os.environ['PATH']}")
        run = subprocess.run(["sh", "-c", example], cwd=self.folder, env=environment, stdin=subprocess.DEVNULL,
                             capture_output=True, text=True, timeout=100)
        allowed = {DONE, *(code for name, code in ALSO.items() if f" {name} " in example)}
        self.assertIn(run.returncode, allowed, example + "\n" + run.stdout + run.stderr)
        return run

    def testThoseOfTheReadme(self):
        section = README.read_text(encoding="utf-8").split("## Without the window")[1].split("\n## ")[0]
        blocks = "".join(re.findall(r"(?s)```sh\n(.*?)```", section))
        examples = [line for line in blocks.splitlines() if line]
        self.assertGreaterEqual(len(examples), 5)
        for example in examples:
            with self.subTest(example):
                self.assertIn("build/release/bin/kdx-ctl ", example)
                self.runs(example.replace("build/release/bin/kdx-ctl ", "kdx-ctl "))

    def testFiveCallsOfTheHelp(self):
        examples = re.findall(r"(?m)^  (kdx-ctl .+)$", self.ctl("--help").stdout)
        self.assertEqual(len(examples), 5)
        for example in examples:
            with self.subTest(example):
                # Who tries them need have no instrument.
                self.assertTrue("--simulate" in example or "--dry-run" in example or " list " in example)
                self.runs(example)

    def testThoseOfEachSubcommand(self):
        names = re.findall(r"(?m)^  ([a-z]+) ", self.ctl("--help").stdout.split("Subcommands:")[1])
        self.assertGreaterEqual(len(names), 11)
        for name in names:
            with self.subTest(name):
                examples = re.findall(r"(?m)^(?:Example|Through a pipe): (.+)$", self.ctl(name, "--help").stdout)
                self.assertEqual(len(examples), 2 if name == "shell" else 1)
                shown = [self.runs(example).stdout for example in examples]
        self.assertEqual(shown, ["", "RADIO   \n"])  # of the shell, the last of them

    def testThoseOfTheShell(self):
        for name in ("wait", "send", "query", "diff", "read"):
            told = subprocess.run(self.command("--simulate", "shell"), input=f"help {name}\n", capture_output=True,
                                  text=True, timeout=100).stdout
            example = re.search(r"(?m)^Example: (?:kdx-ctl )?(.+)$", told)[1]
            with self.subTest(example):
                run = subprocess.run(self.command("--simulate", "shell"), input=example + "\n", capture_output=True,
                                     text=True, cwd=self.folder, timeout=100)
                self.assertIn(run.returncode, {DONE, ALSO.get(name, DONE)}, run.stderr)


if __name__ == "__main__":
    kdxctl.main()
