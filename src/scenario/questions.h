#pragma once

#include <optional>
#include <string>
#include <vector>

#include "coder/readback.h"

namespace kdx {
class Instrument;
}

namespace kdx::scenario {

/// What a scenario can expect an answer to.
struct Question {
    std::vector<Query> queries;
    bool generator = false;  ///< the generator is asked, not the coder
};

/// The question of that name: a read-back ("ps", "pilot"), or one value by the coder's own name ("TA", "EON-TA").
/// Nothing for an unknown name. @param eonIdentifier PI of the other network at work.
[[nodiscard]] std::optional<Question> questionOf(const std::string& name, const std::string& eonIdentifier);

/// A question that can be expected an answer to.
struct QuestionFacts {
    std::string name;
    std::size_t answers = 1;
    std::string meaning;  ///< in English; "" where the coder's own name says it
    std::string asked;    ///< by the coder's own names, with commas between
};
[[nodiscard]] std::vector<QuestionFacts> allQuestions();

/// The instrument's answers as it gave them, without quotation marks, line end and blanks at the end; "" for one that
/// could not be read.
[[nodiscard]] std::vector<std::string> ask(Instrument& instrument, const Question& question);

/// Whether the answer is the one expected: the same text, blanks at the end aside, or the same decimal number.
[[nodiscard]] bool isAnswer(const std::string& answer, const std::string& expected);

}  // namespace kdx::scenario
