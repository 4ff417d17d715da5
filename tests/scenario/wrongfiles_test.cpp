#include <gtest/gtest.h>

#include <ostream>

#include "scenario/reader.h"

namespace kdx::scenario {
namespace {

/// A file and everything that is told about it, as "LINE:COLUMN: SENTENCE".
struct WrongFile {
    const char* name;
    std::string text;
    std::vector<std::string> told;
    friend void PrintTo(const WrongFile& file, std::ostream* out) { *out << file.name; }
};

/// The steps of a file whose other lines are right; the first step stands in line 2.
std::string steps(const std::string& lines) {
    return "steps:\n" + lines;
}

class WrongFiles : public ::testing::TestWithParam<WrongFile> {};

TEST_P(WrongFiles, EveryMistakeIsToldWithItsPlace) {
    std::vector<std::string> told;
    for (const Problem& problem : readScenario(GetParam().text).problems)
        told.push_back(std::to_string(problem.line) + ":" + std::to_string(problem.column) + ": " + problem.sentence);
    EXPECT_EQ(told, GetParam().told);
}

INSTANTIATE_TEST_SUITE_P(
    Whole, WrongFiles,
    ::testing::Values(
        WrongFile{"Empty", "", {"1:1: a scenario is written as names with values: title, steps and so on"}},
        WrongFile{
            "AList", "- wait: 2 s\n", {"1:1: a scenario is written as names with values: title, steps and so on"}},
        WrongFile{"NoSteps", "title: Test\n", {"1:1: there are no steps"}},
        WrongFile{"EmptySteps", "steps: []\n", {"1:8: there are no steps in this list"}},
        WrongFile{"StepsWithoutValue", "steps:\n", {"2:1: steps are a list: each begins with a dash, as - wait: 2 s"}},
        WrongFile{"StepsAreNoList",
                  "steps: {wait: 2 s}\n",
                  {"1:8: steps are a list: each begins with a dash, as - wait: 2 s"}},
        WrongFile{"UnknownWord",
                  "titel: Test\nsteps: [note: x]\n",
                  {"1:1: unknown word \"titel\"; known here: title, data_set, steps, restore, report"}},
        WrongFile{"StandsTwice", "title: a\ntitle: b\nsteps: [note: x]\n", {"2:1: title stands here twice"}},
        WrongFile{
            "DataSetSix", "data_set: 6\nsteps: [note: x]\n", {"1:11: data_set is a whole number, 1 to 5, not \"6\""}},
        WrongFile{"DataSetOneAndAHalf",
                  "data_set: 1.5\nsteps: [note: x]\n",
                  {"1:11: data_set is a whole number, 1 to 5, not \"1.5\""}},
        WrongFile{"RestoreYes", "restore: yes\nsteps: [note: x]\n", {"1:10: restore is true or false, not \"yes\""}},
        WrongFile{"ReportEmpty", "report: \"\"\nsteps: [note: x]\n", {"1:10: report needs the name of a file"}},
        WrongFile{"TitleWithoutValue",
                  "title:\nsteps: [note: x]\n",
                  {"2:1: title has no value; an empty text is written \"\", a word like null in quotation marks"}},
        WrongFile{"TitleIsAList",
                  "title: [a]\nsteps: [note: x]\n",
                  {"1:8: title takes one value, no list and no further names"}},
        WrongFile{"TitleWithEscape",
                  "title: \"\\e[2J\"\nsteps: [note: x]\n",
                  {"1:9: title holds a line end or another control character"}},
        WrongFile{"TooLarge", "title: " + std::string(kLargestFile, 'x'), {"1:1: a scenario has 512 KiB at most"}}),
    ::testing::PrintToStringParamName());

INSTANTIATE_TEST_SUITE_P(
    Yaml, WrongFiles,
    ::testing::Values(WrongFile{"NotUtf8", "title: \xE4\n", {"1:8: this is not UTF-8"}},
                      WrongFile{"NotUtf8Behind", "title: äö \xC3\x28\n", {"1:11: this is not UTF-8"}},
                      WrongFile{"Utf16", std::string("\xFF\xFEt\0i\0", 6), {"1:1: this is not UTF-8"}},
                      WrongFile{"ControlCharacter",
                                "title: a\x04 b\nnote: \x01\n",
                                {"1:9: a control character", "2:7: a control character"}},
                      WrongFile{"TabIndents",
                                "steps:\n\t- note: x\n \t- note: y\n",
                                {"2:1: a tab indents this line; YAML wants blanks",
                                 "3:2: a tab indents this line; YAML wants blanks"}},
                      WrongFile{"TwoDocuments",
                                "steps: [note: x]\n---\nsteps: [note: y]\n",
                                {"2:1: a file holds one scenario; a second one begins here"}},
                      WrongFile{"Anchor",
                                "title: &name a\nsteps: [note: x]\n",
                                {"1:8: names for references (&) are not taken; repeat does things again"}},
                      WrongFile{"BillionLaughs",
                                "a: &a [x, x]\nb: &b [*a, *a]\nc: [*b, *b]\n",
                                {"1:4: names for references (&) are not taken; repeat does things again"}},
                      WrongFile{"Reference",
                                "title: *a\n",
                                {"1:8: this is not YAML: the referenced anchor is not defined; a text with special "
                                 "characters needs quotation marks"}},
                      WrongFile{"Tag", "title: !!str a\n", {"1:8: tags (!) are not taken; every value is a text"}},
                      WrongFile{"QuoteNotClosed",
                                "title: \"a\nsteps: [note: x]\n",
                                {"1:8: a quotation mark is opened here and never closed"}},
                      WrongFile{"BracketNotClosed",
                                "steps: [note: x\n",
                                {"2:1: this is not YAML: end of sequence flow not found; a text with special "
                                 "characters needs quotation marks"}},
                      WrongFile{"TooDeep", "steps: " + std::string(100, '['), {"1:28: this is nested too deeply"}},
                      WrongFile{"ANameThatIsAList", "? [a, b]\n: c\nsteps: [note: x]\n", {"1:3: a name belongs here"}}),
    ::testing::PrintToStringParamName());

INSTANTIATE_TEST_SUITE_P(
    Steps, WrongFiles,
    ::testing::Values(
        WrongFile{"AWord", steps("- pause\n"), {"2:3: a step is a word, a colon and what belongs to it, as wait: 2 s"}},
        WrongFile{"UnknownStep",
                  steps("- sned: {TA: 1}\n"),
                  {"2:3: unknown word \"sned\"; known here: send, wait, expect, sweep, repeat, tmc, pause, note"}},
        WrongFile{"TwoThingsAtOnce",
                  steps("- send: {TA: 1}\n  wait: 1 s\n"),
                  {"3:3: a step does one thing; wait needs a dash of its own"}},
        WrongFile{
            "AWordTooMany", steps("- wait: 1 s\n  dwell: 2 s\n"), {"3:3: unknown word \"dwell\"; known here: wait"}},
        WrongFile{"SendNothing",
                  steps("- send: {}\n"),
                  {"2:9: send takes names with values, as send: {PS: MESSTURM, TP: 1}"}},
        WrongFile{"SendAText",
                  steps("- send: TA=1\n"),
                  {"2:9: send takes names with values, as send: {PS: MESSTURM, TP: 1}"}},
        WrongFile{"UnknownKeys",
                  steps("- send: {TAA: 1, ps: X}\n"),
                  {"2:10: there is no key TAA; kdx-ctl list keys names them",
                   "2:18: there is no key ps; kdx-ctl list keys names them"}},
        WrongFile{"KeyTwice", steps("- send: {TA: 1, TA: 0}\n"), {"2:17: TA stands here twice"}},
        WrongFile{"NoBlankAfterTheColon",
                  steps("- send: {TA:1}\n"),
                  {"2:10: there is no key TA:1; kdx-ctl list keys names them"}},
        WrongFile{"OutOfRange", steps("- send: {PTY: 32}\n"), {"2:15: PTY cannot be \"32\". Legal: 0 to 31."}},
        WrongFile{"DecimalComma",
                  steps("- send: {HF-Frequenz: \"98,5\"}\n"),
                  {"2:24: HF-Frequenz cannot be \"98,5\": it has a decimal comma. Legal: 0.1 to 1040 MHz, with a "
                   "decimal point."}},
        WrongFile{"PiTooShort",
                  steps("- send: {PI: 1E1}\n"),
                  {"2:14: PI cannot be \"1E1\". Legal: four hexadecimal digits."}},
        WrongFile{"NoRdsCode",
                  steps("- send: {PS: A¶}\n"),
                  {"2:14: PS cannot be \"A¶\": RDS has no code for its character ¶. Legal: at most 8 characters of the "
                   "RDS character set, no double quote."}},
        WrongFile{"NotInTheCodePage",
                  steps("- send: {RT: Stau → A1}\n"),
                  {"2:19: RT: the instrument's character set (Windows-1252) has no →"}},
        WrongFile{"NotInTheCodePageEscaped",
                  steps("- send: {RT: \"\\xe4→\"}\n"),
                  {"2:15: RT: the instrument's character set (Windows-1252) has no →"}},
        WrongFile{"LineEndInAValue",
                  steps("- send: {RT: \"a\\nb\"}\n"),
                  {"2:15: RT holds a line end or another control character"}},
        WrongFile{"NoValue",
                  steps("- send: {TA: }\n"),
                  {"2:14: TA has no value; an empty text is written \"\", a word like null in quotation marks"}},
        WrongFile{"TimeWithoutUnit",
                  steps("- wait: 2\n"),
                  {"2:9: wait needs a unit: 500 ms, 2 s, 1.5 min or 1 h, not \"2\""}},
        WrongFile{"NoTime",
                  steps("- wait: soon\n- wait: -1 s\n- wait: 2 sec\n"),
                  {"2:9: wait is a time: 500 ms, 2 s, 1.5 min or 1 h, not \"soon\"",
                   "3:9: wait is a time: 500 ms, 2 s, 1.5 min or 1 h, not \"-1 s\"",
                   "4:9: wait is a time: 500 ms, 2 s, 1.5 min or 1 h, not \"2 sec\""}},
        WrongFile{"TimeOutOfRange",
                  steps("- wait: 0 s\n- wait: 200 h\n"),
                  {"2:9: wait is 1 ms at least and 168 h at most, not \"0 s\"",
                   "3:9: wait is 1 ms at least and 168 h at most, not \"200 h\""}},
        WrongFile{"ExpectUnknown",
                  steps("- expect: {nothing: 1, within: 1 s}\n"),
                  {"2:12: there is no read-back and no question nothing; kdx-ctl list questions names them"}},
        WrongFile{"ExpectNothing", steps("- expect: {within: 1 s}\n"), {"2:11: nothing is expected here"}},
        WrongFile{"ExpectWithoutUnit",
                  steps("- expect: {TA: 1, within: 1}\n"),
                  {"2:27: within needs a unit: 500 ms, 2 s, 1.5 min or 1 h, not \"1\""}},
        WrongFile{
            "ExpectTooFewAnswers", steps("- expect: {pilot: 1}\n"), {"2:19: pilot has 3 answers; expected are 1"}},
        WrongFile{"TmcTooShort",
                  steps("- tmc: 0B90E400C\n"),
                  {"2:8: tmc takes ten hexadecimal digits, the first 0 or 1, as 0B90E400CC; not \"0B90E400C\""}},
        WrongFile{"TmcFirstDigit",
                  steps("- tmc: 2B90E400CC\n"),
                  {"2:8: tmc takes ten hexadecimal digits, the first 0 or 1, as 0B90E400CC; not \"2B90E400CC\""}},
        WrongFile{
            "NoteWithNames", steps("- note: {a: b}\n"), {"2:9: note takes one value, no list and no further names"}},
        WrongFile{"ManyAtOnce",
                  "title: a\ndata_set: 9\n" + steps("- wait: 2\n- send: {PTY: 40}\n- jump: 1\n"),
                  {"2:11: data_set is a whole number, 1 to 5, not \"9\"",
                   "4:9: wait needs a unit: 500 ms, 2 s, 1.5 min or 1 h, not \"2\"",
                   "5:15: PTY cannot be \"40\". Legal: 0 to 31.",
                   "6:3: unknown word \"jump\"; known here: send, wait, expect, sweep, repeat, tmc, pause, note"}}),
    ::testing::PrintToStringParamName());

INSTANTIATE_TEST_SUITE_P(
    Loops, WrongFiles,
    ::testing::Values(
        WrongFile{"SweepsTogetherTooLong",
                  steps("- {sweep: HF-Pegel, from: 0, to: 99, step: 0.0019, dwell: 1 s}\n"
                        "- {sweep: HF-Pegel, from: 0, to: 99, step: 0.0019, dwell: 1 s}\n"),
                  {"3:44: all sweeps together have 100000 points at most"}},
        WrongFile{"SweepUnknownKey",
                  steps("- sweep: Level\n  points: [1]\n  dwell: 1 s\n"),
                  {"2:10: there is no key Level; kdx-ctl list keys names them"}},
        WrongFile{"SweepNoNumber",
                  steps("- sweep: PS\n  points: [1]\n  dwell: 1 s\n"),
                  {"2:10: PS is no number that could be swept"}},
        WrongFile{"SweepWithoutAll",
                  steps("- sweep: PTY\n"),
                  {"2:3: a sweep needs from, to and step, or points", "2:3: a sweep needs dwell or steps, or both"}},
        WrongFile{"SweepWithoutStep",
                  steps("- sweep: PTY\n  from: 1\n  to: 5\n  dwell: 1 s\n"),
                  {"2:3: a sweep needs from, to and step, or points"}},
        WrongFile{"StepOfZero",
                  steps("- sweep: PTY\n  from: 1\n  to: 5\n  step: 0\n  dwell: 1 s\n"),
                  {"5:9: with a step of 0 the sweep never ends"}},
        WrongFile{"WrongDirection",
                  steps("- sweep: PTY\n  from: 1\n  to: 5\n  step: -1\n  dwell: 1 s\n"),
                  {"5:9: the step leads away from the end: 1 to 5 needs a step above 0"}},
        WrongFile{"WrongDirectionDown",
                  steps("- sweep: HF-Pegel\n  from: 60\n  to: 10\n  step: 2\n  dwell: 1 s\n"),
                  {"5:9: the step leads away from the end: 60 to 10 needs a step below 0"}},
        WrongFile{"BothKinds",
                  steps("- sweep: PTY\n  from: 1\n  to: 5\n  points: [1]\n  dwell: 1 s\n"),
                  {"5:11: a sweep has points, or from, to and step; not both"}},
        WrongFile{"TooManyPoints",
                  steps("- sweep: HF-Pegel\n  from: 0\n  to: 120\n  step: 0.001\n  dwell: 1 s\n"),
                  {"5:9: a sweep has 100000 points at most, this one 120001"}},
        WrongFile{"EndOutOfRange",
                  steps("- sweep: HF-Pegel\n  from: 60\n  to: 130\n  step: 10\n  dwell: 1 s\n"),
                  {"4:7: HF-Pegel cannot be \"130\". Legal: 0 to 120 dBuV, with a decimal point."}},
        WrongFile{"HalfAProgrammeType",
                  steps("- sweep: PTY\n  from: 0\n  to: 5\n  step: 0.5\n  dwell: 1 s\n"),
                  {"5:9: PTY cannot be \"0.5\". Legal: 0 to 31."}},
        WrongFile{"RangeWithComma",
                  steps("- sweep: HF-Pegel\n  from: 60,5\n  to: 10\n  step: -1\n  dwell: 1 s\n"),
                  {"3:9: from is a number with a decimal point, not \"60,5\""}},
        WrongFile{"PointOutOfRange",
                  steps("- sweep: PTY\n  points: [1, 99, x]\n  dwell: 1 s\n"),
                  {"3:15: PTY cannot be \"99\". Legal: 0 to 31.", "3:19: a point is a number, not \"x\""}},
        WrongFile{"NoPoints",
                  steps("- sweep: PTY\n  points: []\n  dwell: 1 s\n"),
                  {"3:11: points are a list of numbers, as [60, 40, 20]"}},
        WrongFile{"RepeatZero",
                  steps("- repeat: 0\n  steps: [note: x]\n"),
                  {"2:11: repeat is a whole number, 1 to 1000000, not \"0\""}},
        WrongFile{"RepeatTooOften",
                  steps("- repeat: 1000001\n  steps: [note: x]\n"),
                  {"2:11: repeat is a whole number, 1 to 1000000, not \"1000001\""}},
        WrongFile{"RepeatNothing", steps("- repeat: 3\n"), {"2:3: repeat needs steps"}},
        WrongFile{"RepeatEmpty", steps("- repeat: 3\n  steps: []\n"), {"3:10: there are no steps in this list"}},
        WrongFile{"UntilNoon",
                  steps("- repeat: 3\n  until: noon\n  steps: [note: x]\n"),
                  {"3:10: until knows Return only, not \"noon\""}},
        WrongFile{"MistakeInside",
                  steps("- repeat: 3\n  steps:\n  - sweep: HF-Pegel\n    points: [20]\n    steps: [wait: 1]\n"),
                  {"6:19: wait needs a unit: 500 ms, 2 s, 1.5 min or 1 h, not \"1\""}},
        WrongFile{"NestedTooDeeply",
                  "steps: [{repeat: 1, steps: [{repeat: 1, steps: [{repeat: 1, steps: [{repeat: 1, steps: [{repeat: 1, "
                  "steps: [{repeat: 1, steps: [{repeat: 1, steps: [{repeat: 1, steps: [note: x]}]}]}]}]}]}]}]}]\n",
                  {"1:168: steps are nested 8 deep at most"}}),
    ::testing::PrintToStringParamName());

}  // namespace
}  // namespace kdx::scenario
