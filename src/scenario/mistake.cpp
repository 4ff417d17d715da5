#include "scenario/mistake.h"

#include <algorithm>
#include <array>
#include <string_view>

#include "base/filled.h"

namespace kdx::scenario {

namespace {

struct Wording {
    Mistake mistake;
    std::string_view pattern;
};

// %1 is the first word, and so on. A value that the key does not take brings the sentence about it as its third.
constexpr std::array kWordings = {
    Wording{Mistake::NotUtf8, "this is not UTF-8"},
    Wording{Mistake::ControlCharacter, "a control character"},
    Wording{Mistake::TabIndents, "a tab indents this line; YAML wants blanks"},
    Wording{Mistake::SecondScenario, "a file holds one scenario; a second one begins here"},
    Wording{Mistake::Reference, "references (*) are not taken; repeat does things again"},
    Wording{Mistake::ReferenceName, "names for references (&) are not taken; repeat does things again"},
    Wording{Mistake::Tag, "tags (!) are not taken; every value is a text"},
    Wording{Mistake::OpenQuote, "a quotation mark is opened here and never closed"},
    Wording{Mistake::TooDeep, "this is nested too deeply"},
    Wording{Mistake::NameMissing, "a name belongs here"},
    Wording{Mistake::Twice, "%1 stands here twice"},
    Wording{Mistake::NoYaml, "this is not YAML: %1; a text with special characters needs quotation marks"},
    Wording{Mistake::TooLarge, "a scenario has %1 KiB at most"},
    Wording{Mistake::NoSteps, "there are no steps"},
    Wording{Mistake::NoScenario, "a scenario is written as names with values: title, steps and so on"},
    Wording{Mistake::ReportName, "report needs the name of a file"},
    Wording{Mistake::UnknownWord, R"(unknown word "%1"; known here: %2)"},
    Wording{Mistake::NoList, "steps are a list: each begins with a dash, as - wait: 2 s"},
    Wording{Mistake::EmptyList, "there are no steps in this list"},
    Wording{Mistake::Nesting, "steps are nested %1 deep at most"},
    Wording{Mistake::NoStep, "a step is a word, a colon and what belongs to it, as wait: 2 s"},
    Wording{Mistake::TwoThings, "a step does one thing; %1 needs a dash of its own"},
    Wording{Mistake::NoNames, "%1 takes names with values, as %2"},
    Wording{Mistake::NoSuchKey, "there is no key %1; kdx-ctl list keys names them"},
    Wording{Mistake::NothingExpected, "nothing is expected here"},
    Wording{Mistake::NoQuestion, "there is no read-back and no question %1; kdx-ctl list questions names them"},
    Wording{Mistake::OneAnswer, "%1 has %2 answer; expected are %3"},
    Wording{Mistake::Answers, "%1 has %2 answers; expected are %3"},
    Wording{Mistake::NoNumberToSweep, "%1 is no number that could be swept"},
    Wording{Mistake::NoPace, "a sweep needs dwell or steps, or both"},
    Wording{Mistake::PointsAndRange, "a sweep has points, or from, to and step; not both"},
    Wording{Mistake::NoPoints, "points are a list of numbers, as [60, 40, 20]"},
    Wording{Mistake::MostPoints, "a sweep has %1 points at most"},
    Wording{Mistake::MostPointsOfAll, "all sweeps together have %1 points at most"},
    Wording{Mistake::NoRange, "a sweep needs from, to and step, or points"},
    Wording{Mistake::StepZero, "with a step of 0 the sweep never ends"},
    Wording{Mistake::StepUpwards, "the step leads away from the end: %1 to %2 needs a step above 0"},
    Wording{Mistake::StepDownwards, "the step leads away from the end: %1 to %2 needs a step below 0"},
    Wording{Mistake::TooManyPoints, "a sweep has %1 points at most, this one %2"},
    Wording{Mistake::NothingToRepeat, "repeat needs steps"},
    Wording{Mistake::Until, R"(until knows Return only, not "%1")"},
    Wording{Mistake::NoMessage, R"(tmc takes ten hexadecimal digits, the first 0 or 1, as 0B90E400CC; not "%1")"},
    Wording{Mistake::NoValue, R"(%1 has no value; an empty text is written "", a word like null in quotation marks)"},
    Wording{Mistake::OneValue, "%1 takes one value, no list and no further names"},
    Wording{Mistake::ControlInText, "%1 holds a line end or another control character"},
    Wording{Mistake::NoCharacter, "%1: %2"},
    Wording{Mistake::NoUnit, R"(%1 needs a unit: 500 ms, 2 s, 1.5 min or 1 h, not "%2")"},
    Wording{Mistake::NoTime, R"(%1 is a time: 500 ms, 2 s, 1.5 min or 1 h, not "%2")"},
    Wording{Mistake::TimeLimits, R"(%1 is 1 ms at least and 168 h at most, not "%2")"},
    Wording{Mistake::NoWhole, R"(%1 is a whole number, %2 to %3, not "%4")"},
    Wording{Mistake::NoChoice, R"(%1 is true or false, not "%2")"},
    Wording{Mistake::Comma, R"(%1 is a number with a decimal point, not "%2")"},
    Wording{Mistake::NoNumber, R"(%1 is a number, not "%2")"},
    Wording{Mistake::Value, "%3"},
};

}  // namespace

std::string sentence(Mistake mistake, const std::vector<std::string>& words) {
    const auto* const wording = std::find_if(kWordings.begin(), kWordings.end(),
                                             [mistake](const Wording& one) { return one.mistake == mistake; });
    return wording == kWordings.end() ? std::string() : filled(wording->pattern, words);
}

}  // namespace kdx::scenario
