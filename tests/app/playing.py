"""Help for tests of kdx-ctl play."""

import csv
import subprocess

import kdxctl


class Playing(kdxctl.Ctl):
    # The virtual instrument begins without lists, and a coder that has some cannot be without any again.
    NO_LISTS_BEFORE = r"^kdx-ctl: not as before: AF1(, AF2, AF3, AF4, AF5)?\n$"

    def scenario(self, text):
        file = self.folder / "scenario.yaml"
        file.write_text(text, encoding="utf-8")
        return str(file)

    def play(self, text, *arguments, **how):
        return self.simulated("play", self.scenario(text), "--speed", "100", *arguments, **how)

    def rows(self, text, *arguments, **how):
        """The report's rows, without those of the data set."""
        report = self.folder / "report.csv"
        self.play(text, "--report", str(report), *arguments, **how)
        return [row for row in self.read(report) if row["step"] != "data_set"]

    @staticmethod
    def read(report):
        with open(report, encoding="utf-8", newline="") as file:
            return list(csv.DictReader(file))

    def begun(self, *arguments, **how):
        process = subprocess.Popen(self.command(*arguments), stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True,
                                   stdin=how.pop("stdin", subprocess.DEVNULL), **how)
        self.addCleanup(process.stdout.close)
        self.addCleanup(process.stderr.close)
        self.addCleanup(process.wait)
        self.addCleanup(process.kill)
        return process

    def until(self, process, text):
        for line in process.stdout:
            if text in line:
                return
        self.fail(process.stderr.read())
