"""The shipped data folder, for tests of whole programs."""

import pathlib
import shutil

DATA = pathlib.Path(__file__).parents[2] / "Daten"


def copyTo(folder):
    """Copies it, without the log of whoever has worked with it."""
    shutil.copytree(DATA, folder, ignore=shutil.ignore_patterns("RDS_log.txt"))
