#pragma once

#include <string>
#include <vector>

namespace kdx::scenario {

/// What can be wrong with a scenario's file. What a sentence about it names, in the order of its words, is said where
/// its sentence is.
enum class Mistake {
    NotUtf8,
    ControlCharacter,
    TabIndents,
    SecondScenario,
    Reference,
    ReferenceName,
    Tag,
    OpenQuote,
    TooDeep,
    NameMissing,
    Twice,
    NoYaml,
    TooLarge,
    NoSteps,
    NoScenario,
    ReportName,
    UnknownWord,
    NoList,
    EmptyList,
    Nesting,
    NoStep,
    TwoThings,
    NoNames,
    NoSuchKey,
    NothingExpected,
    NoQuestion,
    OneAnswer,
    Answers,
    NoNumberToSweep,
    NoPace,
    PointsAndRange,
    NoPoints,
    MostPoints,
    MostPointsOfAll,
    NoRange,
    StepZero,
    StepUpwards,
    StepDownwards,
    TooManyPoints,
    NothingToRepeat,
    Until,
    NoMessage,
    NoValue,
    OneValue,
    ControlInText,
    NoCharacter,
    NoUnit,
    NoTime,
    TimeLimits,
    NoWhole,
    NoChoice,
    Comma,
    NoNumber,
    Value,
};

/// The sentence of kdx-ctl about it, in UTF-8. @param words what it names.
[[nodiscard]] std::string sentence(Mistake mistake, const std::vector<std::string>& words);

}  // namespace kdx::scenario
