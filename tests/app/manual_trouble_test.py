"""Holds the manual's list of error texts against the program's own texts, both ways.

What is in the list must be a text of the program; the section about foreign texts is left out there. What the program
says must be in the list as far as it can be seen in the sources: texts that stand where a box, the window's lower edge,
a hint or a message on the standard error is made. Not seen are texts that reach such a place in a variable, parts of
one or two words, and what libraries and the system say.

Usage: manual_trouble_test.py
"""

import pathlib
import re
import unittest

ROOT = pathlib.Path(__file__).resolve().parents[2]
LANGUAGES = {"de": "deutsch", "en": "english"}
FOREIGN = 9  # which section lists texts of libraries and the system
ESCAPES = {"n": "\n", "t": "\t", "r": "\r", "033": "\033", "0": "\0"}
NO_ERRORS = {
    310, 311,  # box "Hinweis": what the program is for
    878,  # question before an entry is deleted
}


def literals(code):
    """@returns the string literals, those beside each other as one, with the places where they begin."""
    found = []
    end = None
    for match in re.finditer(r'R"\((.*?)\)"|"((?:[^"\\\n]|\\.)*)"|//[^\n]*|\'(?:[^\'\\\n]|\\.)+\'', code):
        raw, plain = match.groups()
        if raw is None and plain is None:
            continue
        text = raw or re.sub(r"\\(033|.)", lambda escape: ESCAPES.get(escape.group(1), escape.group(1)), plain)
        if end is not None and not code[end:match.start()].strip():
            found[-1] = (found[-1][0], found[-1][1] + text)
        else:
            found.append((match.start(), text))
        end = match.end()
    return found


def sources(*folders):
    for folder in folders:
        for file in sorted((ROOT / "src" / folder).rglob("*.cpp")) + sorted((ROOT / "src" / folder).rglob("*.h")):
            yield file, file.read_text(encoding="utf-8")


def arguments(code, opening):
    """@returns the arguments of the call whose parenthesis opens there, as text."""
    parts, depth, begin, place = [], 0, opening + 1, opening
    while place < len(code):
        if code[place] == '"':
            place = re.compile(r'"(?:[^"\\\n]|\\.)*"').match(code, place).end()
            continue
        if code[place] in "({[":
            depth += 1
        elif code[place] in ")}]":
            depth -= 1
        if (depth == 1 and code[place] == ",") or depth == 0:
            parts.append(code[begin:place])
            begin = place + 1
            if depth == 0:
                return parts
        place += 1
    raise ValueError("a parenthesis is not closed")


def captions(language):
    """@returns the texts of the window by their numbers."""
    file = (ROOT / "Daten" / "Sprachen.ini").read_bytes().decode("cp1252")
    section = file.split(f"\n[{LANGUAGES[language]}]", 1)[1].split("\n[", 1)[0]
    return {int(number): text.rstrip("\r") for number, text in re.findall(r"(?m)^(\d+)=(.*)$", section)}


def sections(language):
    """@returns the texts of the list, section by section."""
    page = (ROOT / "docs" / "manual" / language / "trouble.md").read_text(encoding="utf-8")
    found = []
    for section in re.split(r"(?m)^## ", page)[1:]:
        found.append(re.findall(r"(?m)^\| (`+)\s?(.+?)\s?\1 \|", section))
    return [[text for _, text in rows] for rows in found]


def pieces(text, gap="…"):
    return [piece for piece in (part.strip() for part in re.split(gap, text)) if re.search(r"\w", piece)]


def callsOf(pattern, *folders):
    for file, code in sources(*folders):
        for match in re.finditer(pattern, code):
            yield file, match.group(1), arguments(code, match.end() - 1)


class TroubleTest(unittest.TestCase):
    def testBothLanguagesListTheSameTexts(self):
        german, english = sections("de"), sections("en")
        self.assertEqual([len(rows) for rows in german], [len(rows) for rows in english])
        self.assertGreater(sum(len(rows) for rows in german), 250)

    def testWhatIsListedIsATextOfTheProgram(self):
        own = "\n".join(text for _, code in sources(".") for _, text in literals(code))
        for language in LANGUAGES:
            texts = own + "\n" + "\n".join(captions(language).values()).replace("&", "")
            for number, rows in enumerate(sections(language)):
                if number == FOREIGN:
                    continue
                for row in rows:
                    for piece in pieces(row):
                        with self.subTest(language=language, text=row):
                            self.assertIn(piece, texts)

    def assertListed(self, language, where, text, gap):
        for piece in pieces(text, gap):
            with self.subTest(language=language, where=where, text=piece):
                self.assertTrue(any(piece in row for rows in sections(language) for row in rows))

    def testWhatABoxOrTheLowerEdgeSaysIsListed(self):
        numbers = {}
        skipped = {"message": 2, "messageOrStop": 1, "confirm": 1}  # icon and title
        for file, call, said in callsOf(r"dialogs\.(message|messageOrStop|confirm)\(", "."):
            for number in re.findall(r"\{(\d{3,4})[,}]", ",".join(said[skipped[call]:])):
                numbers[int(number)] = file.name
        for file, _, said in callsOf(r"\b(note)\(", "window"):
            for number in re.findall(r"^\s*\{(\d{3,4})[,}]", said[0]):
                numbers[int(number)] = file.name
        for name in ("window/failurehint.cpp", "ui/valuestate.cpp"):
            for number in re.findall(r"\{(\d{3,4}),", (ROOT / "src" / name).read_text(encoding="utf-8")):
                numbers[int(number)] = name
        self.assertGreater(len(numbers), 25)
        for language in LANGUAGES:
            texts = captions(language)
            for number in sorted(set(numbers) - NO_ERRORS):
                self.assertListed(language, f"{numbers[number]} {number}", texts[number], r"%\d")

    def testWhatIsSaidOnTheStandardErrorIsListed(self):
        found = 0
        makers = {
            r"\b(problem|warning|ValidationError)\(": ("app/ctl",),
            r"\b(Wording)\{": ("scenario",),
            r"\b(m_tell|runtime_error|ValidationError)\(": ("simserver",),
            r"std::(fprintf|fputs)\(": ("app",),
        }
        for pattern, folders in makers.items():
            for file, call, said in callsOf(pattern, *folders):
                told = ",".join(said)
                if call in ("fprintf", "fputs") and "stderr" not in told:
                    continue
                for _, text in literals(told):
                    for piece in re.split(r"%[sdzu\d]+|\n|kdx-(?:rds|ctl|sim): ", text):
                        piece = piece.strip(" \".,;:()'\033[K\r-")
                        if len(piece.split()) > 2:
                            found += 1
                            for language in LANGUAGES:
                                self.assertListed(language, file.name, piece, "…")
        self.assertGreater(found, 60)


if __name__ == "__main__":
    unittest.main()
