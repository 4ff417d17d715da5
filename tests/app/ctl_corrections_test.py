"""What section Berichtigungen of the data folder makes kdx-ctl do, both ways.

Usage: ctl_corrections_test.py PATH-OF-KDX-CTL
"""

import kdxctl
from kdxctl import DIFFERENT, WRONG_CALL


class Corrected(kdxctl.Ctl):
    def change(self, name, section, key, value):
        """Puts a value in the place of a section's key, which need not be there."""
        file = self.folder / "Daten" / name
        before, after = file.read_bytes().decode("cp1252").split(f"[{section}]\r\n")
        end = after.find("\r\n[")
        mine, others = (after, "") if end < 0 else (after[:end], after[end:])
        lines = [line for line in mine.split("\r\n") if line.split("=")[0] != key]
        text = "\r\n".join([before + f"[{section}]", f"{key}={value}", *lines]) + others
        file.write_bytes(text.encode("cp1252"))

    def correct(self, key):
        self.change("RDS_Allg.INI", "Berichtigungen", key, "1")

    def scenario(self, steps):
        file = self.folder / "scenario.yaml"
        file.write_text(f"steps: [{steps}]\n", encoding="utf-8")
        return str(file)

    def testTheStereoModeGoesOutWithTheDataSet(self):
        self.change("RDS_Allg.INI", "FM", "Stereo_Mode", "1")
        self.assertEqual([c for c in self.sent("apply", "--data-set", "1") if "audio:mode" in c], [])
        self.correct("Stereo_Mode")
        self.assertEqual([c for c in self.sent("apply", "--data-set", "1") if "audio:mode" in c],
                         [":stereo:audio:mode RIGHT"])
        diff = self.simulated("diff", "--data-set", "1", expect=DIFFERENT)
        self.assertIn("STEREO_MODE", diff.stdout)

    def testTheImpedanceOfAnOpeningIsTheFirstOne(self):
        self.assertEqual([c for c in self.sent("apply", "--data-set", "1") if ":IMP" in c], [])
        self.correct("Impedanz")
        self.assertEqual([c for c in self.sent("apply", "--data-set", "1") if ":IMP" in c],
                         [":STEREO:EXTERNAL:IMP 600"])

    def testTheOtherNetworksTypeIsANumber(self):
        self.change("Datenset1.INI", "RDS", "EON_PTY", "Nachrichten")
        self.assertEqual([c for c in self.sent("apply", "--data-set", "1") if "EON-PTY" in c], [])
        self.correct("EON_PTY")
        told = [c for c in self.sent("apply", "--data-set", "1") if "EON-PTY" in c]
        self.assertEqual([c.split(",")[1] for c in told], ['1"'])

    def testTheLevelBearsItsUnit(self):
        self.assertTrue(self.simulated("query", "level").stdout.endswith(" dBm\n"))
        self.correct("Pegel")
        self.assertTrue(self.simulated("query", "level").stdout.endswith(" dBµV\n"))

    def testEachApplySwitchesTheOutputOn(self):
        for correct in (False, True):
            if correct:
                self.correct("HF_Ausgang")
            self.assertIn(":OUTPUT:STAT ON", self.sent("apply", "--data-set", "1"))

    def testADecimalCommaIsAPoint(self):
        run = self.simulated("send", "HF-Frequenz=98,7", expect=WRONG_CALL)
        self.assertIn("it has a decimal comma", run.stderr)
        file = self.scenario('{send: {HF-Frequenz: "98,7"}}')
        self.simulated("play", file, expect=WRONG_CALL)
        self.change("Datenset1.INI", "VRN", "HF_Frequenz", "98,7")
        self.simulated("apply", "--data-set", "1", expect=WRONG_CALL)
        self.correct("Komma")
        self.assertEqual(self.sent("send", "HF-Frequenz=98,7", "AF1=N,98.7,90.1"),
                         ["FREQ 98.7MHZ", ':STEREO:DIRECT "AF=N,98.7,90.1"'])
        self.assertEqual(self.sent("play", file), ["FREQ 98.7MHZ"])
        self.assertIn("FREQ 98.7MHZ", self.sent("apply", "--data-set", "1"))
        self.simulated("send", "HF-Frequenz=98,7x", expect=WRONG_CALL)
        self.simulated("send", "HF-Frequenz=1.000,5", expect=WRONG_CALL)

    def testAQuoteGoesOutDoubled(self):
        self.change("Datenset1.INI", "RDS", "RTA", 'sag "ja" x')
        calls = (("send", 'PS=A"B'), ("send", "--coder", 'PS=A"B'), ("apply", "--data-set", "1"),
                 ("play", self.scenario("{send: {PS: 'A\"B'}}")))
        for call in calls:
            self.assertIn("double quote", self.simulated(*call, expect=WRONG_CALL).stderr)
        self.correct("Anfuehrung")
        padded, bare = ':STEREO:DIRECT "PS=A""B     "', ':STEREO:DIRECT "PS=A""B"'
        text = ':STEREO:DIRECT "RT=10,0,sag ""ja"" x"'
        for call, command in zip(calls, (padded, bare, text, padded)):
            self.assertIn(command, self.sent(*call))
        self.assertEqual(self.sent("send", "--raw", padded), [padded])
        run = self.simulated("diff", "--data-set", "1", "--fix")
        self.assertIn('sag "ja" x', run.stdout)
        self.assertIn("all of it is mended", run.stdout + run.stderr)


if __name__ == "__main__":
    kdxctl.main()
